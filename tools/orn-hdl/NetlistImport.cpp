#include "NetlistImport.h"

#include "CellFiles.h"
#include "CommandsOutput.h"
#include "Gzip.h"
#include "NetlistNames.h"
#include "Output.h"
#include "diagnostics/SourceLines.h"
#include "explain/FileKind.h"
#include "import/CellComponents.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/Ascii.h"
#include "Port/File.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Tool {

namespace {

using Orn_Hdl::ReaderRenaming;
using Orn_Hdl::ReaderUndeclared;
using std::string_view;

/// What stands behind the place in the message of a reader.
constexpr string_view Separator = ": error: ";

/// Takes ":NUMBER" off the end of a text. \return 0 if it does not end so.
std::uint32_t TakeNumber(string_view& text) {
    const std::size_t colon = text.rfind(':');
    std::uint32_t number = 0;
    if (colon == string_view::npos) {
        return 0;
    }
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data() + colon + 1, end, number);
    if (result.ec != std::errc() || result.ptr != end) {
        return 0;
    }
    text = text.substr(0, colon);
    return number;
}

/// How many characters the word at a column has; 1 for anything else.
std::size_t GetWordLength(string_view line, std::size_t column) {
    std::size_t length = 0;
    while (column + length < line.size() &&
           (Port::IsLetter(line[column + length]) || Port::IsDigit(line[column + length]) ||
            line[column + length] == '_' || line[column + length] == '$')) {
        ++length;
    }
    return std::max<std::size_t>(length, 1);
}

/// The message of a reader, "FILE:LINE:COLUMN: error: TEXT" and lines that show the place.
Diagnostic ReadMessage(string_view message) {
    const std::size_t separator = message.find(Separator);
    string_view file = message.substr(0, separator);
    const std::size_t begin = separator + Separator.size();
    const string_view text = message.substr(begin, message.find('\n', begin) - begin);
    const std::uint32_t column = TakeNumber(file);
    const std::uint32_t line = column == 0 ? 0 : TakeNumber(file);
    Diagnostic diagnostic =
        MakeFileDiagnostic(std::string(file), Severity::Error, std::string(text));
    SourceLines lines(diagnostic.place.file);
    string_view source;
    if (line > 0 && lines.Get(line, source)) {
        diagnostic.place.line = line;
        diagnostic.place.source = source;
        diagnostic.place.columns = {column - 1, GetWordLength(source, column - 1)};
    }
    return diagnostic;
}

/// What a file is that no reader could read, if it is no netlist; empty if that is not known.
std::string DescribeIfOther(const std::string& name) {
    Port::File file;
    std::string beginning(BeginningSize, '\0');
    file.open(name.c_str(), Port::File::Read, true);
    beginning.resize(file.read(beginning.data(), BeginningSize));
    std::string kind = DescribeOtherFile(beginning);
    const bool isNetlist = kind.find("--from") != std::string::npos;
    return isNetlist ? std::string() : kind;
}

/// Adds what helps.
void AddNotes(Diagnostic& diagnostic) {
    if (diagnostic.message.find(" a library file ") != std::string::npos) {
        diagnostic.notes.push_back(
            {"-l FILE names a file that declares cells: Verilog, VHDL, Liberty or JSON"});
    }
    if (const std::string kind = DescribeIfOther(diagnostic.place.file); !kind.empty()) {
        diagnostic.notes.push_back({kind});
    }
}

/// Whether a file can be read, and more than once. Prints a message if not.
Status CheckReadable(const std::string& name) {
    char first = '\0';
    Port::File file;
    if (IsGzip(name)) {
        SystemFileName(name.c_str());
        return Status::Success;
    }
    if (name != "-" && CanReadAgain(name)) {
        file.open(name.c_str(), Port::File::Read, true);
        file.read(&first, 1);
        return file.GetError() == 0 ? Status::Success : ComplainUnreadable(name, file.GetError());
    }
    if (name != "-" && !file.open(name.c_str(), Port::File::Read, true)) {
        return ComplainUnreadable(name, file.GetError());
    }
    Complain("cannot read " + name + ": a netlist is read twice, which needs a file");
    return Status::File;
}

/// The language of a library of cells; nothing for what no reader of the library reads.
std::optional<ImportFormat> GetFormat(const std::string& library) {
    const string_view name = WithoutGzip(library);
    if (HasExtension(name, ".vhd") || HasExtension(name, ".vhdl")) {
        return ImportFormat::Vhdl;
    }
    const bool isOther =
        HasExtension(name, ".lib") || HasExtension(name, ".liberty") || HasExtension(name, ".json");
    return isOther ? std::nullopt : std::optional<ImportFormat>(ImportFormat::Verilog);
}

/// The import of one netlist.
class Importer {
public:
    Importer(const ImportOptions& options, ImportFormat format, Reporter& reporter)
        : options_(options), format_(format), reporter_(reporter),
          names_(GetNameLanguages(options), !options.commandFile.empty()) {}

    Status Run();

private:
    Status ReadAndWrite();
    Status ReadLibraries();
    template <class Reader> Status Read(Reader& reader);
    template <class Reader> void SetUp(Reader& reader);
    void SetUpVerilog(Orn_Hdl::VerilogReader& reader);
    void ShowCompressedName(std::string& file) const;
    bool KeepsName(string_view name) const;
    Status TellRenamedPorts(const std::vector<ReaderRenaming>& renamings);
    void TellUnknownDefaults();
    Status WriteAll(const std::vector<ReaderRenaming>& renamings);

    const ImportOptions& options_;
    const ImportFormat format_;
    Reporter& reporter_;
    const Import::NameRules names_;
    Orn_Hdl::Engine engine_;
    Orn_Hdl::Model* model_ = nullptr;
    /// The cells of libraries that no reader reads.
    Orn_Hdl::Netlist cells_;
};

Status Importer::ReadLibraries() {
    std::vector<std::string> others;
    for (const std::string& library : options_.libraries) {
        const std::optional<ImportFormat> format = GetFormat(library);
        if (format != format_ && format != ImportFormat::Vhdl) {
            others.push_back(library);
        } else if (const Status status = CheckReadable(library); status != Status::Success) {
            return status;
        } else if (format != format_) {
            Orn_Hdl::VhdlReader::ReadComponents(SystemFileName(library.c_str()), cells_);
        }
    }
    Import::CellLibrary library;
    const Status status = ReadCellFiles(others, library, reporter_);
    if (status == Status::Success) {
        AddComponents(library, cells_);
    }
    return status;
}

/// A "$" is no part of a basic name, but Verilog allows it.
bool Importer::KeepsName(string_view name) const {
    if (names_.HasVhdl() || name.find('$') == string_view::npos) {
        return names_.IsLegal(name);
    }
    std::string plain(name);
    std::replace(plain.begin(), plain.end(), '$', '_');
    return names_.IsLegal(plain);
}

template <class Reader> void Importer::SetUp(Reader& reader) {
    reader.SetTop(options_.top.c_str());
    reader.KeepAttributes(options_.attributes);
    reader.KeepComments(options_.comments);
    reader.KeepDontCares(options_.unknownAs == "-");
    reader.SetKeptNames([this](string_view name) { return KeepsName(name); });
    for (const std::string& library : options_.libraries) {
        if (GetFormat(library) == format_) {
            reader.AddLibrary(SystemFileName(library.c_str()));
        }
    }
    reader.AddLibrary(cells_);
}

/// Messages name a compressed file, and not the contents that were read.
void Importer::ShowCompressedName(std::string& file) const {
    std::vector<std::string> names = options_.libraries;
    names.push_back(options_.file);
    for (const std::string& name : names) {
        if (IsGzip(name) && file == SystemFileName(name.c_str())) {
            file = name;
            return;
        }
    }
}

void Importer::SetUpVerilog(Orn_Hdl::VerilogReader& reader) {
    if (IsGzip(options_.file)) {
        // The contents lie in another folder.
        const std::string folder = std::filesystem::path(options_.file).parent_path().string();
        reader.AddIncludeFolder(folder.empty() ? "." : folder.c_str());
    }
    reader.SetUndeclared(ReaderUndeclared::Infer);
    for (const std::string& folder : options_.includeFolders) {
        reader.AddIncludeFolder(folder.c_str());
    }
    for (const std::string& macro : options_.macros) {
        const std::size_t equals = std::min(macro.find('='), macro.size());
        const std::string text = equals < macro.size() ? macro.substr(equals + 1) : std::string();
        reader.Define(macro.substr(0, equals).c_str(), text.c_str());
    }
}

Status Importer::TellRenamedPorts(const std::vector<ReaderRenaming>& renamings) {
    for (const ReaderRenaming& renaming : renamings) {
        const Orn_Hdl::Signal* const signal =
            renaming.kind == ReaderRenaming::Kind::Signal
                ? FindDeclared(*model_->GetNetlist(), renaming.newName)
                : nullptr;
        if (signal == nullptr || !signal->IsPort()) {
            continue;
        }
        const std::string quoted = "\"" + renaming.name + "\"";
        const std::string reason = KeepsName(renaming.name)
                                       ? "another object has the name " + quoted
                                       : quoted + names_.GetComplaint();
        if (options_.keepPorts) {
            reporter_.Report(
                MakeFileDiagnostic(options_.file, Severity::Error,
                                   reason + ", and --keep-ports forbids renaming the port"));
            return Status::Failed;
        }
        reporter_.Report(
            MakeFileDiagnostic(options_.file, Severity::Warning,
                               reason + "; the port is renamed to " + renaming.newName));
    }
    return Status::Success;
}

/// Warns of parameters that some instances leave to a default that is not known: these have an
/// attribute without an option in its place.
void Importer::TellUnknownDefaults() {
    std::map<string_view, std::set<std::string>> names;
    for (const Orn_Hdl::Instance* instance : model_->GetNetlist()->GetInstanceIterator()) {
        for (const Orn_Hdl::Attribute* attribute : instance->GetAttrIterator()) {
            if (attribute->GetGenericOption() == Orn_Hdl::Attribute::GenericNone &&
                attribute->GetSynAttrOption() == Orn_Hdl::Attribute::SynAttrNone) {
                names[instance->GetComponent()->GetNameView()].emplace(attribute->GetNameView());
            }
        }
    }
    for (const auto& [component, parameters] : names) {
        std::string list;
        for (const std::string& parameter : parameters) {
            list.append(list.empty() ? "" : ", ").append(parameter);
        }
        reporter_.Report(MakeFileDiagnostic(options_.file, Severity::Warning,
                                            "instances of \"" + std::string(component) +
                                                "\" leave out parameters whose defaults are "
                                                "unknown; in VHDL they are 0 or empty: " +
                                                list));
    }
}

/// Writes all files. The command file and the name map are replaced last, and only if every file
/// was written.
Status Importer::WriteAll(const std::vector<ReaderRenaming>& renamings) {
    std::optional<Orn_Hdl::LegalNetlist> legal;
    if (options_.legal) {
        legal.emplace(*model_->GetNetlist(), *model_->GetOptions());
        if (TellWhyNotLegal(*legal, options_.file, reporter_)) {
            return Status::Failed;
        }
    }
    // The name of the netlist that was read is in no output.
    model_->SetSourceFileName("");
    // A write changes the design, so the commands come first.
    const std::vector<std::string> files =
        MakeCommandFiles(options_, {std::string(model_->GetNetlist()->GetNameView())});
    if (files.empty()) {
        return Status::File;
    }
    CommandsOutput commands(files.front());
    OutputFile nameMap(options_.nameMap);
    if (Port::Stream* out = nameMap.GetStream()) {
        WriteNetlistNames(*model_->GetNetlist(), renamings, legal ? &*legal : nullptr, *out);
    }
    Status status = Worse(commands.Write(*model_), nameMap.Flush());
    if (status == Status::Success) {
        status = WriteNetlists(*model_, options_, legal ? &*legal : nullptr, reporter_);
    }
    if (status == Status::Success) {
        status = Worse(commands.Commit(), nameMap.Commit());
    }
    return status == Status::Success ? WriteCommandList(options_, files) : status;
}

template <class Reader> Status Importer::Read(Reader& reader) {
    SetUp(reader);
    reader.Read(SystemFileName(options_.file.c_str()), *model_);
    const Status status = TellRenamedPorts(reader.GetRenamings());
    if (status == Status::Success && names_.HasVhdl()) {
        TellUnknownDefaults();
    }
    return status == Status::Success ? WriteAll(reader.GetRenamings()) : status;
}

Status Importer::Run() {
    try {
        return ReadAndWrite();
    } catch (const Orn_Hdl::Exception& exception) {
        const string_view message = exception.getLocalized().GetView();
        if (message.find(Separator) == string_view::npos) {
            throw;
        }
        Diagnostic diagnostic = ReadMessage(message);
        AddNotes(diagnostic);
        ShowCompressedName(diagnostic.place.file);
        reporter_.Report(std::move(diagnostic));
        return Status::Failed;
    }
}

Status Importer::ReadAndWrite() {
    Status status = CheckReadable(options_.file);
    if (status == Status::Success) {
        status = ReadLibraries();
    }
    if (status != Status::Success) {
        return status;
    }
    engine_.CreateAndAddModel("import", options_.file.c_str());
    model_ = engine_.GetModel("import");
    model_->GetOptions()->threads = options_.threads;
    if (format_ == ImportFormat::Vhdl) {
        Orn_Hdl::VhdlReader reader;
        return Read(reader);
    }
    Orn_Hdl::VerilogReader reader;
    SetUpVerilog(reader);
    return Read(reader);
}

} // namespace

Status ImportNetlist(const ImportOptions& options, ImportFormat format, Reporter& reporter) {
    return Importer(options, format, reporter).Run();
}

} // namespace Tool
