#include "Import.h"

#include "cells/CellDeclaration.h"
#include "import/CellLibrary.h"
#include "import/CommandSink.h"
#include "import/DesignReader.h"
#include "import/EmitNetlist.h"
#include "import/ImportedNetlist.h"
#include "import/ModelSink.h"
#include "import/NameMap.h"
#include "import/TopModule.h"

#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"
#include "Progress.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <system_error>

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

/// Reads the cell libraries, and prints a message if one cannot be read.
Status ReadLibrary(const std::vector<std::string>& files, CellLibrary& library) {
    for (const std::string& file : files) {
        std::string text;
        const Status read = ReadFile(file, text);
        if (read != Status::Success) {
            return read;
        }
        try {
            library.Add(file, std::move(text));
        } catch (const Cells::Error& error) {
            PrintError(file + ":" + std::to_string(error.GetLine()) + ": error: " + error.what());
            return Status::Failed;
        } catch (const Import::Error& error) {
            PrintError(file + ": error: " + error.what());
            return Status::Failed;
        }
    }
    return Status::Success;
}

Status WriteNetlists(const ImportedNetlist& netlist, const ImportOptions& options) {
    if (options.outputs.IsEmpty()) {
        return Status::Success;
    }
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel(netlist.name.c_str(), options.file.c_str());
    Orn_Hdl::Model& model = *engine.GetModel(netlist.name.c_str());
    ModelSink sink(model);
    EmitNetlist(netlist, sink);
    Progress progress(false, options.file);
    return WriteOutputs(model, options.outputs, progress);
}

/// Writes all files. The command file and the name map are replaced last, and only if every file
/// was written.
Status WriteAll(const ImportedNetlist& netlist, const ImportOptions& options) {
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
        status = WriteNetlists(netlist, options);
    }
    return status == Status::Success ? Worse(commands.Commit(), nameMap.Commit()) : status;
}

} // namespace

Status ImportDesign(const ImportOptions& options) {
    CellLibrary library;
    const Status libraryRead = ReadLibrary(options.cells, library);
    if (libraryRead != Status::Success) {
        return libraryRead;
    }
    std::string text;
    const Status read = ReadFile(options.file, text);
    if (read != Status::Success) {
        return read;
    }
    try {
        const std::unique_ptr<ImportedDesign> design =
            ReadDesign(std::move(text), options.attributes);
        Module& top = FindTop(*design, options.top);
        Warnings warnings;
        const NameRules names(GetNameLanguages(options), !options.commandFile.empty());
        const ImportRules rules{GetUnknownValues(options), names, options.keepPorts, library};
        const ImportedNetlist netlist = MakeNetlist(*design, top, rules, warnings);
        const Status written = WriteAll(netlist, options);
        for (const std::string& warning : warnings.GetLines()) {
            PrintError(options.file + ": warning: " + warning);
        }
        return written;
    } catch (const Import::Error& error) {
        PrintError(options.file + ": error: " + error.what());
        return Status::Failed;
    }
}

} // namespace Tool
