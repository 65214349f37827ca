#include "JsonImport.h"

#include "CellFiles.h"
#include "JsonFile.h"
#include "design/DesignOutput.h"
#include "explain/FileKind.h"
#include "import/CellLibrary.h"
#include "import/CellModels.h"
#include "import/CommandSink.h"
#include "import/DesignReader.h"
#include "import/DesignUnits.h"
#include "import/EmitNetlist.h"
#include "import/FirstValues.h"
#include "import/Hierarchy.h"
#include "import/ImportedNetlist.h"
#include "import/ModelSink.h"
#include "import/NameMap.h"
#include "import/TopModule.h"

#include "LastingEngines.h"
#include "Orn_Hdl/Engine.h"
#include "Orn_Hdl/Model.h"
#include "Port/File.h"
#include "Port/NameScope.h"
#include "Port/OrderedWork.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

namespace Tool {

namespace {

using namespace Import;

UnknownValues GetUnknownValues(const ImportOptions& options) {
    if (options.unknownAs.empty()) {
        return UnknownValues(std::nullopt);
    }
    return UnknownValues(options.unknownAs == "-"   ? Unknown
                         : options.unknownAs == "1" ? One
                                                    : Zero);
}

/// The modules that are written, in the order of compilation.
using Netlists = std::vector<ImportedNetlist>;

/// The command files of an import.
class CommandFiles {
public:
    /// \param netlists must outlive this object, as must the options.
    CommandFiles(const Netlists& netlists, const ImportOptions& options);

    /// Writes the text of all files. The files on disk do not change before `Commit`.
    Status Write();
    Status Commit();

private:
    const Netlists& netlists_;
    const ImportOptions& options_;
    std::vector<std::string> names_;
    std::vector<std::unique_ptr<OutputFile>> files_;
};

CommandFiles::CommandFiles(const Netlists& netlists, const ImportOptions& options)
    : netlists_(netlists), options_(options) {}

Status CommandFiles::Write() {
    for (const ImportedNetlist& netlist : netlists_) {
        names_.push_back(netlist.name);
    }
    names_ = MakeCommandFiles(options_, names_);
    Status status = names_.empty() ? Status::File : Status::Success;
    for (std::size_t i = 0; i < names_.size() && status == Status::Success; ++i) {
        files_.push_back(std::make_unique<OutputFile>(names_[i]));
        if (Port::Stream* const out = files_.back()->GetStream()) {
            CommandSink sink(*out);
            EmitNetlist(netlists_[i], sink);
        }
        status = files_.back()->Flush();
    }
    return status;
}

Status CommandFiles::Commit() {
    Status status = Status::Success;
    for (const std::unique_ptr<OutputFile>& file : files_) {
        status = Worse(status, file->Commit());
    }
    return status == Status::Success ? WriteCommandList(options_, names_) : status;
}

Status WriteImported(const Netlists& netlists, const ImportOptions& options, Progress& progress,
                     Reporter& reporter) {
    if (options.outputs.IsEmpty()) {
        return Status::Success;
    }
    DropLastingEngines();
    Orn_Hdl::Engine& engine = MakeLastingEngine();
    engine.SetThreads(options.threads);
    std::vector<Orn_Hdl::Model*> models;
    for (const ImportedNetlist& netlist : netlists) {
        engine.CreateAndAddModel(netlist.name.c_str(), options.file.c_str());
        models.push_back(engine.GetModel(netlist.name.c_str()));
        ModelSink sink(*models.back());
        progress.Making(netlist.name);
        EmitNetlist(netlist, sink);
    }
    progress.Erase();
    return WriteNetlists(models, options, reporter);
}

/// Writes all files. The command files and the name map are replaced last, and only if every file
/// was written.
Status WriteAll(const Netlists& netlists, const ImportOptions& options, Progress& progress,
                Reporter& reporter) {
    CommandFiles commands(netlists, options);
    OutputFile nameMap(options.nameMap);
    if (Port::Stream* out = nameMap.GetStream()) {
        for (const ImportedNetlist& netlist : netlists) {
            WriteNameMap(netlist, *out);
        }
    }
    Status status = Worse(commands.Write(), nameMap.Flush());
    if (status == Status::Success) {
        status = WriteImported(netlists, options, progress, reporter);
    }
    return status == Status::Success ? Worse(commands.Commit(), nameMap.Commit()) : status;
}

/// The modules to import: those asked for, or the top module.
std::vector<Module*> FindWanted(ImportedDesign& design, const Hierarchy& hierarchy,
                                const ImportOptions& options) {
    if (options.modules.empty()) {
        return {&FindTop(design, options.top)};
    }
    std::vector<Module*> wanted;
    for (const std::string& name : options.modules) {
        Module& module = FindTop(design, name);
        if (std::find(hierarchy.GetModules().begin(), hierarchy.GetModules().end(), &module) ==
            hierarchy.GetModules().end()) {
            Fail(JsonPath("modules").AddKey(name), "the module has no contents");
        }
        wanted.push_back(&module);
    }
    return wanted;
}

/// The configuration of a module stands beside the entities.
void CheckConfigurationNames(const Netlists& netlists) {
    Port::NameScope names;
    for (const ImportedNetlist& netlist : netlists) {
        names.Claim(netlist.name);
    }
    for (const ImportedNetlist& netlist : netlists) {
        const std::string name = "CFG_" + netlist.name;
        if (names.IsTaken(name)) {
            Fail(JsonPath("modules").AddKey(netlist.top.name),
                 "another module has the name of its configuration, " + Quote(name));
        }
    }
}

/// Makes the netlists of the modules to import and of all modules that these use; of modules that
/// were asked for by their names, these alone.
Netlists MakeNetlists(ImportedDesign& design, const ImportOptions& options, ImportRules rules,
                      Warnings& warnings) {
    const Hierarchy hierarchy(design);
    const std::vector<Module*> wanted = FindWanted(design, hierarchy, options);
    std::optional<DesignUnits> units;
    const std::vector<Module*> modules = hierarchy.Order(wanted);
    if (modules.size() > 1 || !options.modules.empty()) {
        units.emplace(design, hierarchy, rules.names, warnings);
        rules.units = &*units;
    }
    Netlists netlists;
    for (Module* module : modules) {
        ImportedNetlist netlist = MakeNetlist(design, *module, rules, warnings);
        if (options.modules.empty() ||
            std::find(wanted.begin(), wanted.end(), module) != wanted.end()) {
            netlists.push_back(std::move(netlist));
        }
    }
    if (options.vhdl.configuration) {
        CheckConfigurationNames(netlists);
    }
    if (netlists.size() > 1 && !options.commandFile.empty() && !HasCommandFolder(options)) {
        throw Error("the design has " + std::to_string(netlists.size()) +
                    " modules, and a command file holds one: -o DIR/ writes one file a module");
    }
    return netlists;
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

/// Reads a file.
/// \return the design; null if the file cannot be read, of which a message was printed.
std::unique_ptr<ImportedDesign> ReadFile(JsonFile& file, const ImportOptions& options) {
    std::unique_ptr<ImportedDesign> design;
    try {
        design = file.IsLarge() && Port::OrderedWork::GetWorkersFor(options.threads) > 0
                     ? ReadDesign(file, options.attributes, TokenBatches::Settings())
                     : ReadDesign(file, options.attributes);
    } catch (const Import::Error&) {
        // A file that cannot be read to its end seems to end too early, and a damaged one is no
        // JSON.
        file.CheckRest();
        if (file.GetStatus() == Status::Success) {
            throw;
        }
        return nullptr;
    }
    return file.GetStatus() == Status::Success ? std::move(design) : nullptr;
}

Status ImportFile(JsonFile& file, const ImportOptions& options, const CellLibrary& library,
                  Progress& progress, Reporter& reporter) {
    try {
        const std::unique_ptr<ImportedDesign> design = ReadFile(file, options);
        if (design == nullptr) {
            return Status::File;
        }
        if (options.initialValues) {
            SetFirstValues(*design);
        }
        Warnings warnings;
        const NameRules names(GetNameLanguages(options), !options.commandFile.empty());
        const ImportRules rules{
            GetUnknownValues(options), names, options.keepPorts, library, nullptr, options.vhdl};
        const Netlists netlists = MakeNetlists(*design, options, rules, warnings);
        OutputFile models(options.cellModels);
        if (Port::Stream* out = models.GetStream()) {
            WriteCellModels(netlists, *out, warnings);
        }
        Status written = models.Flush();
        if (written == Status::Success) {
            written = WriteAll(netlists, options, progress, reporter);
        }
        progress.Erase();
        written = written == Status::Success ? models.Commit() : written;
        for (std::string& warning : warnings.GetLines()) {
            reporter.Report(
                MakeFileDiagnostic(options.file, Severity::Warning, std::move(warning)));
        }
        return written;
    } catch (const Import::Error& error) {
        progress.Erase();
        reporter.Report(MakeError(options, error, file.GetBeginning()));
        return Status::Failed;
    }
}

} // namespace

Status ImportJson(const ImportOptions& options, Reporter& reporter) {
    CellLibrary library;
    const Status status = ReadCellFiles(options.libraries, library, reporter);
    if (status != Status::Success) {
        return status;
    }
    Progress progress(false, options.file);
    JsonFile file(options.file, progress);
    return ImportFile(file, options, library, progress, reporter);
}

} // namespace Tool
