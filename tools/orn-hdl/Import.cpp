#include "Import.h"

#include "cells/CellDeclaration.h"
#include "explain/FileKind.h"
#include "explain/Syntax.h"
#include "import/CellLibrary.h"
#include "import/CommandSink.h"
#include "import/DesignReader.h"
#include "import/EmitNetlist.h"
#include "import/ImportedNetlist.h"
#include "import/ModelSink.h"
#include "import/NameMap.h"
#include "import/TopModule.h"

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"
#include "Progress.h"
#include "proof/Differences.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <system_error>
#include <utility>

namespace Tool {

namespace {

using namespace Import;

/// Room for the padding that the JSON parser needs behind the text; without it the parser would
/// copy the text.
constexpr std::size_t Margin = 4096;

Status ReadFile(const std::string& name, std::string& text) {
    Port::File file;
    if (!file.open(SystemFileName(name.c_str()), Port::File::Read, true)) {
        return ComplainUnreadable(name, file.GetError());
    }
    constexpr std::size_t Piece = std::size_t(1) << 20;
    std::error_code unknown;
    const std::uintmax_t expected = std::filesystem::file_size(name, unknown);
    text.reserve((unknown ? 0 : expected) + Piece + Margin);
    std::size_t size = 0;
    std::size_t count = 0;
    do {
        text.resize(size + Piece);
        count = file.read(text.data() + size, Piece);
        size += count;
    } while (count > 0);
    text.resize(size);
    return file.GetError() == 0 ? Status::Success : ComplainUnreadable(name, file.GetError());
}

/// A command file can be written in both languages.
NameLanguages GetNameLanguages(const ImportOptions& options) {
    const auto isWritten = [&](Orn_Hdl::Language language) {
        const auto file = options.outputs.files.find(language);
        return file != options.outputs.files.end() && !file->second.empty();
    };
    const bool verilog = isWritten(Orn_Hdl::Language::Verilog);
    const bool vhdl = isWritten(Orn_Hdl::Language::Vhdl);
    if (options.names) {
        return *options.names;
    }
    if (!options.commandFile.empty() || verilog == vhdl) {
        return NameLanguages::Both;
    }
    return verilog ? NameLanguages::Verilog : NameLanguages::Vhdl;
}

UnknownValues GetUnknownValues(const ImportOptions& options) {
    if (options.unknownAs.empty()) {
        return UnknownValues(std::nullopt);
    }
    return UnknownValues(options.unknownAs == "1" ? One : Zero);
}

Tool::Place MakePlace(const std::string& file, const Import::TextPlace& place) {
    return Tool::Place{file, place.line, place.source, Columns{place.column, 1}};
}

Diagnostic MakeDiagnostic(const std::string& file, Severity severity, std::string message) {
    Diagnostic diagnostic;
    diagnostic.severity = severity;
    diagnostic.place.file = file;
    diagnostic.message = std::move(message);
    return diagnostic;
}

/// Reads the cell libraries, and reports it if one cannot be read.
Status ReadLibrary(const std::vector<std::string>& files, CellLibrary& library,
                   Reporter& reporter) {
    for (const std::string& file : files) {
        std::string text;
        const Status read = ReadFile(file, text);
        if (read != Status::Success) {
            return read;
        }
        try {
            library.Add(file, std::move(text));
        } catch (const Cells::Error& error) {
            Diagnostic diagnostic = MakeDiagnostic(file, Severity::Error, error.what());
            diagnostic.place.line = error.GetLine();
            reporter.Report(std::move(diagnostic));
            return Status::Failed;
        } catch (const Import::Error& error) {
            Diagnostic diagnostic = MakeDiagnostic(file, Severity::Error, error.what());
            diagnostic.place = MakePlace(file, error.GetPlace());
            reporter.Report(std::move(diagnostic));
            return Status::Failed;
        }
    }
    return Status::Success;
}

Status WriteNetlists(const ImportedNetlist& netlist, const ImportOptions& options,
                     Reporter& reporter) {
    if (options.outputs.IsEmpty()) {
        return Status::Success;
    }
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel(netlist.name.c_str(), options.file.c_str());
    Orn_Hdl::Model& model = *engine.GetModel(netlist.name.c_str());
    ModelSink sink(model);
    EmitNetlist(netlist, sink);
    Progress progress(false, options.file);
    model.GetOptions()->verify = options.verify;
    const auto tell = [&reporter](const std::vector<Orn_Hdl::Proof::Difference>& differences,
                                  const std::string& file) {
        return ReportDifferences(differences, file, reporter);
    };
    if (!options.legal) {
        return WriteOutputs(model, options.outputs, progress, nullptr, tell);
    }
    Orn_Hdl::LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
    for (const Orn_Hdl::Check::Finding& error : legal.GetErrors()) {
        Diagnostic diagnostic = MakeDiagnostic(options.file, Severity::Error, error.message);
        diagnostic.rule = error.rule->name;
        reporter.Report(std::move(diagnostic));
    }
    return legal.GetErrors().empty() ? WriteOutputs(model, options.outputs, progress, &legal, tell)
                                     : Status::Failed;
}

/// Writes all files. The command file and the name map are replaced last, and only if every file
/// was written.
Status WriteAll(const ImportedNetlist& netlist, const ImportOptions& options, Reporter& reporter) {
    OutputFile commands(options.commandFile);
    if (Port::Stream* out = commands.GetStream()) {
        CommandSink sink(*out);
        EmitNetlist(netlist, sink);
    }
    OutputFile nameMap(options.nameMap);
    if (Port::Stream* out = nameMap.GetStream()) {
        WriteNameMap(netlist, *out);
    }
    Status status = Worse(commands.Flush(), nameMap.Flush());
    if (status == Status::Success) {
        status = WriteNetlists(netlist, options, reporter);
    }
    return status == Status::Success ? Worse(commands.Commit(), nameMap.Commit()) : status;
}

/// How much of a file tells what it is.
constexpr std::size_t BeginningSize = 4096;

/// What the file is if it is no JSON; empty if that is not known.
std::string DescribeKind(const std::string& beginning) {
    const std::size_t first = beginning.find_first_not_of(" \t\r\n");
    if (first == std::string::npos || beginning[first] == '{' || beginning[first] == '[') {
        return {};
    }
    Orn_Hdl::StringArray words;
    words.ParseCommandLine(beginning.substr(first, beginning.find_first_of("\r\n", first) - first));
    return Explain::FindPhrase(words) != nullptr ? "this looks like a command file; use orn-hdl run"
                                                 : DescribeFileKind(beginning);
}

/// \param beginning the beginning of the file.
Diagnostic MakeError(const ImportOptions& options, const Import::Error& error,
                     const std::string& beginning) {
    Diagnostic diagnostic = MakeDiagnostic(options.file, Severity::Error, error.what());
    diagnostic.place = MakePlace(options.file, error.GetPlace());
    if (const std::string kind = DescribeKind(beginning); !kind.empty()) {
        diagnostic.notes.push_back({kind});
    }
    return diagnostic;
}

/// Imports the text of a file.
Status ImportText(std::string text, const ImportOptions& options, const CellLibrary& library,
                  Reporter& reporter) {
    const std::string beginning = text.substr(0, BeginningSize);
    try {
        const std::unique_ptr<ImportedDesign> design =
            ReadDesign(std::move(text), options.attributes);
        Module& top = FindTop(*design, options.top);
        Warnings warnings;
        const NameRules names(GetNameLanguages(options), !options.commandFile.empty());
        const ImportRules rules{GetUnknownValues(options), names, options.keepPorts, library};
        const ImportedNetlist netlist = MakeNetlist(*design, top, rules, warnings);
        const Status written = WriteAll(netlist, options, reporter);
        for (std::string& warning : warnings.GetLines()) {
            reporter.Report(MakeDiagnostic(options.file, Severity::Warning, std::move(warning)));
        }
        return written;
    } catch (const Import::Error& error) {
        reporter.Report(MakeError(options, error, beginning));
        return Status::Failed;
    }
}

Status ImportFile(const ImportOptions& options, Reporter& reporter) {
    CellLibrary library;
    Status status = ReadLibrary(options.cells, library, reporter);
    if (status != Status::Success) {
        return status;
    }
    std::string text;
    status = ReadFile(options.file, text);
    return status == Status::Success ? ImportText(std::move(text), options, library, reporter)
                                     : status;
}

} // namespace

Status ImportDesign(const ImportOptions& options) {
    Reporter reporter(options.report);
    const Status status = ImportFile(options, reporter);
    reporter.Finish();
    return status;
}

} // namespace Tool
