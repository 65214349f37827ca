#include "JsonImport.h"

#include "CellFiles.h"
#include "explain/FileKind.h"
#include "import/CellLibrary.h"
#include "import/CellModels.h"
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

#include <cstddef>
#include <optional>
#include <utility>

namespace Tool {

namespace {

using namespace Import;

UnknownValues GetUnknownValues(const ImportOptions& options) {
    if (options.unknownAs.empty()) {
        return UnknownValues(std::nullopt);
    }
    return UnknownValues(options.unknownAs == "1" ? One : Zero);
}

Status WriteImported(const ImportedNetlist& netlist, const ImportOptions& options,
                     Reporter& reporter) {
    if (options.outputs.IsEmpty()) {
        return Status::Success;
    }
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel(netlist.name.c_str(), options.file.c_str());
    Orn_Hdl::Model& model = *engine.GetModel(netlist.name.c_str());
    ModelSink sink(model);
    EmitNetlist(netlist, sink);
    if (!options.legal) {
        return WriteNetlists(model, options, nullptr, reporter);
    }
    Orn_Hdl::LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
    return TellWhyNotLegal(legal, options.file, reporter)
               ? Status::Failed
               : WriteNetlists(model, options, &legal, reporter);
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
        status = WriteImported(netlist, options, reporter);
    }
    return status == Status::Success ? Worse(commands.Commit(), nameMap.Commit()) : status;
}

/// \param beginning the beginning of the file.
Diagnostic MakeError(const ImportOptions& options, const Import::Error& error,
                     const std::string& beginning) {
    Diagnostic diagnostic = MakeFileDiagnostic(options.file, Severity::Error, error.what());
    diagnostic.place = MakeJsonPlace(options.file, error.GetPlace());
    if (const std::string kind = DescribeOtherFile(beginning); !kind.empty()) {
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
        OutputFile models(options.cellModels);
        if (Port::Stream* out = models.GetStream()) {
            WriteCellModels({&netlist}, *out, warnings);
        }
        Status written = models.Flush();
        if (written == Status::Success) {
            written = WriteAll(netlist, options, reporter);
        }
        written = written == Status::Success ? models.Commit() : written;
        for (std::string& warning : warnings.GetLines()) {
            reporter.Report(
                MakeFileDiagnostic(options.file, Severity::Warning, std::move(warning)));
        }
        return written;
    } catch (const Import::Error& error) {
        reporter.Report(MakeError(options, error, beginning));
        return Status::Failed;
    }
}

} // namespace

Status ImportJson(const ImportOptions& options, Reporter& reporter) {
    CellLibrary library;
    Status status = ReadCellFiles(options.libraries, library, reporter);
    if (status != Status::Success) {
        return status;
    }
    std::string text;
    status = ReadWholeFile(options.file, text);
    return status == Status::Success ? ImportText(std::move(text), options, library, reporter)
                                     : status;
}

} // namespace Tool
