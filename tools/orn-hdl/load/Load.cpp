#include "load/Load.h"

#include "CellFiles.h"
#include "Gzip.h"
#include "NoWrites.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/Ascii.h"
#include "Progress.h"
#include "Run.h"
#include "diagnostics/CommandLines.h"
#include "explain/FailureExplainer.h"
#include "import/CellComponents.h"
#include "import/CellLibrary.h"
#include "import/DesignReader.h"
#include "import/EmitNetlist.h"
#include "import/ImportedNetlist.h"
#include "import/ModelSink.h"
#include "import/TopModule.h"

#include <charconv>
#include <cstddef>
#include <string_view>
#include <type_traits>
#include <utility>

namespace Tool {

namespace {

/// How many lines are replayed between two looks at the clock.
constexpr std::uint64_t LinesPerUpdate = 4096;

/// The name that a design has until a command names it.
constexpr const char* Unnamed = "(design without a name)";

/// Takes a line off a text.
std::string TakeLine(std::string& text) {
    const std::size_t end = std::min(text.find('\n'), text.size());
    std::string line = text.substr(0, end);
    text.erase(0, end + 1);
    return line;
}

/// Takes the number behind the last colon off a text; 0 if there is none.
std::uint64_t TakeNumber(std::string& text) {
    const std::size_t colon = text.rfind(':');
    std::uint64_t number = 0;
    if (colon != std::string::npos) {
        const char* const end = text.data() + text.size();
        const auto read = std::from_chars(text.data() + colon + 1, end, number);
        if (read.ec == std::errc() && read.ptr == end) {
            text.erase(colon);
            return number;
        }
    }
    return 0;
}

Diagnostic MakeDiagnostic(const std::string& file, std::string message) {
    Diagnostic diagnostic;
    diagnostic.place.file = file;
    diagnostic.message = std::move(message);
    return diagnostic;
}

Diagnostic MakeDiagnostic(const std::string& file, const Import::Error& error) {
    Diagnostic diagnostic = MakeDiagnostic(file, error.what());
    diagnostic.place = MakeJsonPlace(file, error.GetPlace());
    return diagnostic;
}

} // namespace

DesignFormat GetFormatOf(const std::string& name) {
    const std::string_view file = WithoutGzip(name);
    const std::size_t dot = file.rfind('.');
    const std::string_view extension =
        file.substr(dot == std::string_view::npos ? file.size() : dot);
    if (Port::EqualIgnoringCase(extension, ".v")) {
        return DesignFormat::Verilog;
    }
    if (Port::EqualIgnoringCase(extension, ".vhd") || Port::EqualIgnoringCase(extension, ".vhdl")) {
        return DesignFormat::Vhdl;
    }
    return Port::EqualIgnoringCase(extension, ".json") ? DesignFormat::Json
                                                       : DesignFormat::Commands;
}

LoadedDesign::LoadedDesign(const DesignFile& file) : file_(file), source_(file.name) {
    engine_.CreateAndAddModel(Unnamed, file_.name);
    model_ = engine_.GetModel(Unnamed);
}

Status LoadedDesign::Replay(Reporter& reporter, bool quiet) {
    DropWrites(*model_->GetCommandFactory());
    Progress progress(quiet, GetSystemName());
    Orn_Hdl::CommandReader input(*model_);
    if (!input.Open(GetSystemName())) {
        return ComplainUnreadable(file_.name, input.GetError());
    }
    std::uint64_t line = 0;
    while (const Orn_Hdl::StringArray* words = input.Next()) {
        if (++line % LinesPerUpdate == 0) {
            progress.Update(line, input.GetPosition());
        }
        try {
            model_->Execute(*words);
        } catch (const Orn_Hdl::Exception& exception) {
            progress.Erase();
            CommandLines lines(file_.name, GetSystemName());
            reporter.Report(FailureExplainer(*model_, lines)
                                .Explain(line, *words, exception.getLocalized().GetView()));
            return Status::Failed;
        }
    }
    if (input.GetError() != 0) {
        progress.Erase();
        return ComplainUnreadable(file_.name, input.GetError());
    }
    hasName_ = model_->GetName() != Unnamed;
    if (!hasName_) {
        model_->SetName(GetModelName(file_.name, {}));
    }
    model_->GetNetlist()->SortNetlist();
    return Status::Success;
}

/// A reader's text is "FILE:LINE:COLUMN: error: TEXT", the line of the file, and a mark.
void LoadedDesign::ReportReadError(std::string text, Reporter& reporter) const {
    constexpr std::string_view Separator = ": error: ";
    std::string first = TakeLine(text);
    const std::size_t at = first.find(Separator);
    if (at == std::string::npos) {
        reporter.Report(MakeDiagnostic(file_.name, first));
        return;
    }
    Diagnostic diagnostic =
        MakeDiagnostic(first.substr(0, at), first.substr(at + Separator.size()));
    std::string& place = diagnostic.place.file;
    const std::uint64_t column = TakeNumber(place);
    const std::uint64_t line = TakeNumber(place);
    diagnostic.place.line = line == 0 ? column : line;
    if (line != 0) {
        diagnostic.place.source = TakeLine(text);
        diagnostic.place.columns = {static_cast<std::size_t>(column) - 1, 1};
    }
    if (place == GetSystemName()) {
        place = file_.name;
    }
    reporter.Report(std::move(diagnostic));
}

/// Reads the libraries that the reader of the design's format does not read itself.
Status LoadedDesign::ReadOtherLibraries(const Libraries& libraries, Orn_Hdl::Netlist& components,
                                        Reporter& reporter) const {
    std::vector<std::string> others;
    for (const std::string& name : libraries.files) {
        const DesignFormat format = GetFormatOf(name);
        if (format == DesignFormat::Vhdl && format != GetFormat()) {
            Orn_Hdl::VhdlReader::ReadComponents(SystemFileName(name.c_str()), components);
        } else if (format != GetFormat()) {
            others.push_back(name);
        }
    }
    Import::CellLibrary library;
    const Status status = ReadCellFiles(others, library, reporter);
    if (status == Status::Success) {
        AddComponents(library, components);
    }
    return status;
}

template <class Reader>
Status LoadedDesign::ReadNetlist(const Libraries& libraries, Reporter& reporter) {
    Reader reader;
    Orn_Hdl::Netlist components;
    try {
        const Status status = ReadOtherLibraries(libraries, components, reporter);
        if (status != Status::Success) {
            return status;
        }
        for (const std::string& name : libraries.files) {
            if (GetFormatOf(name) == GetFormat()) {
                reader.AddLibrary(SystemFileName(name.c_str()));
            }
        }
        reader.AddLibrary(components);
        if (libraries.components != nullptr) {
            reader.AddLibrary(*libraries.components);
        }
        reader.KeepComments(true);
        reader.KeepDontCares(true);
        reader.SetNames(Orn_Hdl::ReaderNames::Literal);
        if constexpr (std::is_same_v<Reader, Orn_Hdl::VerilogReader>) {
            reader.SetUndeclared(Orn_Hdl::ReaderUndeclared::Infer);
        }
        reader.Read(GetSystemName(), *model_);
    } catch (const Orn_Hdl::Exception& exception) {
        ReportReadError(std::string(exception.getLocalized().GetView()), reporter);
        return Status::Failed;
    }
    renamings_ = reader.GetRenamings();
    return Status::Success;
}

Status LoadedDesign::ReadJson(const Libraries& libraries, Reporter& reporter) {
    std::vector<std::string> files;
    for (const std::string& name : libraries.files) {
        if (GetFormatOf(name) != DesignFormat::Vhdl) {
            files.push_back(name);
        }
    }
    Import::CellLibrary library;
    Status status = ReadCellFiles(files, library, reporter);
    std::string text;
    if (status == Status::Success) {
        status = ReadWholeFile(GetSystemName(), text);
    }
    if (status != Status::Success) {
        return status;
    }
    try {
        const std::unique_ptr<Import::ImportedDesign> design = Import::ReadDesign(text, false);
        Import::Module& top = Import::FindTop(*design, "");
        Import::Warnings warnings;
        const Import::NameRules names(Import::NameLanguages::Verilog, false);
        const Import::ImportRules rules{Import::UnknownValues(Import::Unknown), names, false,
                                        library};
        const Import::ImportedNetlist netlist = Import::MakeNetlist(*design, top, rules, warnings);
        Import::ModelSink sink(*model_);
        Import::EmitNetlist(netlist, sink);
        model_->SetName(netlist.name);
    } catch (const Import::Error& error) {
        reporter.Report(MakeDiagnostic(file_.name, error));
        return Status::Failed;
    }
    return Status::Success;
}

Status LoadedDesign::Load(const Libraries& libraries, Reporter& reporter, bool quiet) {
    switch (GetFormat()) {
    case DesignFormat::Verilog:
        return ReadNetlist<Orn_Hdl::VerilogReader>(libraries, reporter);
    case DesignFormat::Vhdl:
        return ReadNetlist<Orn_Hdl::VhdlReader>(libraries, reporter);
    case DesignFormat::Json:
        return ReadJson(libraries, reporter);
    default:
        return Replay(reporter, quiet);
    }
}

} // namespace Tool
