#include "Import.h"

#include "JsonImport.h"
#include "NetlistImport.h"
#include "Progress.h"
#include "explain/FileKind.h"
#include "explain/Syntax.h"
#include "proof/Differences.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <iterator>
#include <string_view>
#include <utility>

namespace Tool {

namespace {

using Import::NameLanguages;

struct Extension {
    std::string_view text;
    ImportFormat format;
};

constexpr Extension Extensions[] = {
    {".v", ImportFormat::Verilog}, {".vh", ImportFormat::Verilog}, {".sv", ImportFormat::Verilog},
    {".vhd", ImportFormat::Vhdl},  {".vhdl", ImportFormat::Vhdl},  {".json", ImportFormat::Json},
};

/// What a netlist is written in. A name that does not tell is that of a JSON netlist.
ImportFormat GetFormat(const ImportOptions& options) {
    const auto* const found =
        std::find_if(std::begin(Extensions), std::end(Extensions), [&](const Extension& extension) {
            return HasExtension(options.file, extension.text);
        });
    const ImportFormat told = found == std::end(Extensions) ? ImportFormat::Json : found->format;
    return options.format.value_or(told);
}

/// The first option that does not apply to the format; empty if all do.
std::string_view FindForeignOption(const ImportOptions& options, ImportFormat format) {
    if (format != ImportFormat::Json) {
        return !options.unknownAs.empty()    ? "--x-as"
               : !options.cellModels.empty() ? "--write-cells"
                                             : "";
    }
    if (options.comments) {
        return "--comments";
    }
    return !options.includeFolders.empty() ? "-I" : !options.macros.empty() ? "-D" : "";
}

} // namespace

std::string DescribeOtherFile(const std::string& beginning) {
    const std::size_t first = beginning.find_first_not_of(" \t\r\n");
    if (first == std::string::npos || beginning[first] == '{' || beginning[first] == '[') {
        return {};
    }
    Orn_Hdl::StringArray words;
    words.ParseCommandLine(beginning.substr(first, beginning.find_first_of("\r\n", first) - first));
    return Explain::FindPhrase(words) != nullptr ? "this looks like a command file; use orn-hdl run"
                                                 : DescribeFileKind(beginning);
}

bool HasExtension(std::string_view file, std::string_view extension) noexcept {
    return file.size() >= extension.size() &&
           Port::EqualIgnoringCase(file.substr(file.size() - extension.size()), extension);
}

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

Diagnostic MakeFileDiagnostic(const std::string& file, Severity severity, std::string message) {
    Diagnostic diagnostic;
    diagnostic.severity = severity;
    diagnostic.place.file = file;
    diagnostic.message = std::move(message);
    return diagnostic;
}

bool TellWhyNotLegal(const Orn_Hdl::LegalNetlist& legal, const std::string& file,
                     Reporter& reporter) {
    for (const Orn_Hdl::Check::Finding& error : legal.GetErrors()) {
        Diagnostic diagnostic = MakeFileDiagnostic(file, Severity::Error, error.message);
        diagnostic.rule = error.rule->name;
        reporter.Report(std::move(diagnostic));
    }
    return !legal.GetErrors().empty();
}

Status WriteNetlists(Orn_Hdl::Model& model, const ImportOptions& options,
                     Orn_Hdl::LegalNetlist* legal, Reporter& reporter) {
    Progress progress(false, options.file);
    model.GetOptions()->verify = options.verify;
    return WriteOutputs(model, options.outputs, progress, legal,
                        [&reporter](const std::vector<Orn_Hdl::Proof::Difference>& differences,
                                    const std::string& file) {
                            return ReportDifferences(differences, file, reporter);
                        });
}

Status ImportDesign(const ImportOptions& options) {
    const ImportFormat format = GetFormat(options);
    const std::string_view foreign = FindForeignOption(options, format);
    if (!foreign.empty()) {
        Complain(std::string(foreign) + (format == ImportFormat::Json
                                             ? " does not apply to a JSON netlist; see --help"
                                             : " applies to JSON netlists alone; see --help"));
        return Status::Usage;
    }
    if (!options.cellModels.empty() && GetNameLanguages(options) == NameLanguages::Verilog) {
        Complain("--write-cells needs names that are legal in VHDL, too; see --names");
        return Status::Usage;
    }
    Reporter reporter(options.report);
    const Status status = format == ImportFormat::Json ? ImportJson(options, reporter)
                                                       : ImportNetlist(options, format, reporter);
    reporter.Finish();
    return status;
}

} // namespace Tool
