#include "Import.h"

#include "Gzip.h"
#include "JsonImport.h"
#include "NetlistImport.h"
#include "Progress.h"
#include "design/DesignOutput.h"
#include "design/LegalDesign.h"
#include "explain/FileKind.h"
#include "explain/Syntax.h"
#include "proof/Certificate.h"
#include "proof/Differences.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <filesystem>
#include <iterator>
#include <string_view>
#include <system_error>
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
            return HasExtension(WithoutGzip(options.file), extension.text);
        });
    const ImportFormat told = found == std::end(Extensions) ? ImportFormat::Json : found->format;
    return options.format.value_or(told);
}

/// The first option that applies to JSON netlists alone; empty for none.
std::string_view FindJsonOption(const ImportOptions& options) {
    if (options.unknownAs == "0" || options.unknownAs == "1") {
        return options.unknownAs == "0" ? "--x-as 0" : "--x-as 1";
    }
    if (!options.modules.empty()) {
        return "--module";
    }
    if (!options.cellModels.empty()) {
        return "--write-cells";
    }
    return options.initialValues        ? "--initial-values"
           : options.vhdl.configuration ? "--configuration"
           : options.vhdl.ieeeAlone     ? "--no-kestra"
                                        : "";
}

/// The first option that does not apply to the format; empty if all do.
std::string_view FindForeignOption(const ImportOptions& options, ImportFormat format) {
    if (format != ImportFormat::Json) {
        return FindJsonOption(options);
    }
    if (options.comments) {
        return "--comments";
    }
    return !options.includeFolders.empty() ? "-I" : !options.macros.empty() ? "-D" : "";
}

DesignModel MakeDesignModel(Orn_Hdl::Model& model, const ImportOptions& options,
                            Orn_Hdl::LegalNetlist* legal, Reporter& reporter) {
    model.GetOptions()->verify = options.verify;
    return {&model, legal,
            [&reporter](const std::vector<Orn_Hdl::Proof::Difference>& differences,
                        const std::string& file) {
                return ReportDifferences(differences, file, reporter);
            }};
}

/// Writes the netlists, and the certificate if there is to be one. An input is hashed first, since
/// a netlist can take its place.
Status WriteCertified(const std::vector<DesignModel>& models, const ImportOptions& options) {
    Progress progress(false, options.file);
    Certificate certificate(options.certificate);
    if (!certificate.IsWanted()) {
        return WriteDesign(models, options.outputs, progress, certificate);
    }
    Status status = certificate.AddInput(options.file);
    for (const std::string& library : options.libraries) {
        status = Worse(status, certificate.AddInput(library));
    }
    if (status == Status::Success) {
        status = WriteDesign(models, options.outputs, progress, certificate);
    }
    return status == Status::Success ? certificate.Write() : status;
}

bool IsWritten(const ImportOptions& options, Orn_Hdl::Language language) {
    const auto file = options.outputs.files.find(language);
    return file != options.outputs.files.end() && !file->second.empty();
}

/// Whether a certificate can name what is read and written.
bool HasOnlyFiles(const ImportOptions& options) {
    const auto& files = options.outputs.files;
    return options.file != "-" && !options.outputs.IsEmpty() &&
           std::none_of(files.begin(), files.end(), [&](const auto& output) {
               return output.second == "-" && options.outputs.folder.empty();
           });
}

/// Whether the command file is a folder, for one file a module.
bool IsFolder(const std::string& file) {
    std::error_code unknown;
    return !file.empty() && (file.back() == '/' || std::filesystem::is_directory(file, unknown));
}

} // namespace

bool HasCommandFolder(const ImportOptions& options) {
    return IsFolder(options.commandFile) ||
           (!options.commandFile.empty() && !options.outputs.folder.empty());
}

std::vector<std::string> MakeCommandFiles(const ImportOptions& options,
                                          const std::vector<std::string>& modules) {
    if (!HasCommandFolder(options)) {
        return {options.commandFile};
    }
    const std::string& folder =
        IsFolder(options.commandFile) ? options.commandFile : options.outputs.folder;
    return MakeFolder(folder) == Status::Success ? MakeFileNames(modules, folder, ".cmd")
                                                 : std::vector<std::string>();
}

Status WriteCommandList(const ImportOptions& options, const std::vector<std::string>& files) {
    if (!HasCommandFolder(options)) {
        return Status::Success;
    }
    const std::filesystem::path list = options.commandFile;
    return WriteFileList(IsFolder(list) ? (list / "commands.txt").string() : list.string(), files);
}

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
    const bool verilog = IsWritten(options, Orn_Hdl::Language::Verilog);
    const bool vhdl = IsWritten(options, Orn_Hdl::Language::Vhdl);
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
    return WriteCertified({MakeDesignModel(model, options, legal, reporter)}, options);
}

Status WriteNetlists(const std::vector<Orn_Hdl::Model*>& models, const ImportOptions& options,
                     Reporter& reporter) {
    std::optional<LegalDesign> legal;
    if (options.legal) {
        legal.emplace(models);
        bool isLegal = true;
        for (std::size_t i = 0; i < models.size(); ++i) {
            isLegal &= !TellWhyNotLegal(legal->Get(i), options.file, reporter);
        }
        if (!legal->GetProblem().empty()) {
            reporter.Report(MakeFileDiagnostic(options.file, Severity::Error, legal->GetProblem()));
        }
        if (!isLegal || !legal->GetProblem().empty()) {
            return Status::Failed;
        }
    }
    std::vector<DesignModel> design;
    for (std::size_t i = 0; i < models.size(); ++i) {
        design.push_back(
            MakeDesignModel(*models[i], options, legal ? &legal->Get(i) : nullptr, reporter));
    }
    return WriteCertified(design, options);
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
    if (!options.certificate.empty() && !HasOnlyFiles(options)) {
        Complain("a certificate is of files: name the netlist to read and those to write");
        return Status::Usage;
    }
    if (!options.cellModels.empty() && GetNameLanguages(options) == NameLanguages::Verilog) {
        Complain("--write-cells needs names that are legal in VHDL, too; see --names");
        return Status::Usage;
    }
    if (options.initialValues && IsWritten(options, Orn_Hdl::Language::Verilog)) {
        Complain("--initial-values is for VHDL: the registers of Yosys have no such parameter");
        return Status::Usage;
    }
    Reporter reporter(options.report);
    const Status status = format == ImportFormat::Json ? ImportJson(options, reporter)
                                                       : ImportNetlist(options, format, reporter);
    reporter.Finish();
    return status;
}

} // namespace Tool
