#include "design/DesignOutput.h"

#include "Gzip.h"
#include "NetlistText.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/NameScope.h"
#include "Progress.h"
#include "import/NameRules.h"
#include "proof/Certificate.h"

#include <algorithm>
#include <filesystem>
#include <string_view>
#include <system_error>

namespace Tool {

namespace {

using Orn_Hdl::Language;

/// The models that one file holds.
class DesignFileWriter {
public:
    /// \param file "-" is standard output.
    DesignFileWriter(const std::vector<DesignModel>& models, Language language,
                     const std::string& file, bool noHeader)
        : models_(models), language_(language), file_(file), noHeader_(noHeader) {}

    Status Write();

private:
    Status WriteByTemporary();
    Status Replace();
    void WriteHeader(Orn_Hdl::OutStream& out) const;
    void WriteBodies(Orn_Hdl::TextFileOutStream& out);
    bool IsProven() const { return models_.front().model->GetOptions()->verify; }

    const std::vector<DesignModel>& models_;
    const Language language_;
    const std::string& file_;
    const bool noHeader_;
    /// The model in hand.
    const DesignModel* present_ = nullptr;
};

Status DesignFileWriter::Write() {
    for (const DesignModel& design : models_) {
        design.model->GetOptions()->writeHeader = false;
        if (design.legal != nullptr) {
            design.legal->Prepare(language_);
        }
    }
    try {
        return file_ == "-" || IsGzip(file_) ? WriteByTemporary() : Replace();
    } catch (const Orn_Hdl::ProofException& exception) {
        return present_->tell(exception.GetDifferences(), file_ == "-" ? "standard output" : file_);
    }
}

/// Only a file that is opened by its name gets indentation, and standard output may be a socket,
/// which cannot be opened.
Status DesignFileWriter::WriteByTemporary() {
    const TemporaryFile file;
    Orn_Hdl::TextFileOutStream out;
    if (!file.IsOpen()) {
        return Status::File;
    }
    if (out.Open(file.GetName().c_str(), Orn_Hdl::TextFileOutStream::Overwrite)) {
        WriteHeader(out);
        WriteBodies(out);
        out.Close();
    }
    if (out.GetError() != 0) {
        return ComplainUnwritable("a temporary file", out.GetError());
    }
    return file_ == "-" ? file.Print() : WriteGzip(file, file_);
}

Status DesignFileWriter::Replace() {
    Orn_Hdl::TextFileOutStream out(file_.c_str(), Orn_Hdl::TextFileOutStream::Replace);
    WriteHeader(out);
    if (!IsProven()) {
        WriteBodies(out);
    } else {
        // A proof reads the file of one netlist.
        const TemporaryFile file;
        Orn_Hdl::TextFileOutStream bodies;
        if (!file.IsOpen()) {
            return Status::File;
        }
        if (bodies.Open(file.GetName().c_str(), Orn_Hdl::TextFileOutStream::Overwrite)) {
            WriteBodies(bodies);
            bodies.Close();
        }
        if (bodies.GetError() != 0 || out.WriteFile(file.GetName().c_str()) != 0) {
            return ComplainUnwritable("a temporary file", bodies.GetError());
        }
    }
    out.Close();
    return out.GetError() == 0 ? Status::Success : ComplainUnwritable(file_, out.GetError());
}

/// The header of the last model, which uses the others.
void DesignFileWriter::WriteHeader(Orn_Hdl::OutStream& out) const {
    const DesignModel& top = models_.back();
    if (noHeader_) {
        return;
    }
    const Orn_Hdl::Netlist& netlist = *top.model->GetNetlist();
    const std::string name =
        top.legal != nullptr ? top.legal->GetName(netlist) : std::string(netlist.GetNameView());
    Orn_Hdl::HdlUtilities::WriteHeader(name.c_str(), language_, *top.model->GetOptions(), out);
}

void DesignFileWriter::WriteBodies(Orn_Hdl::TextFileOutStream& out) {
    for (const DesignModel& design : models_) {
        // A netlist in VHDL ends with an empty line.
        if (present_ != nullptr && language_ == Language::Verilog) {
            out.WriteEmptyLine();
        }
        present_ = &design;
        const auto write = [&](Orn_Hdl::OutStream& stream) {
            WriteNetlist(*design.model, design.legal, language_, stream);
        };
        if (IsProven()) {
            Orn_Hdl::Proof::Write(out, file_.c_str(), language_, write,
                                  [&] { return GetWritten(*design.model, design.legal); });
        } else {
            write(out);
        }
    }
}

Status WriteFile(const std::vector<DesignModel>& models, Language language, const std::string& file,
                 bool noHeader, Certificate& certificate) {
    Status status = DesignFileWriter(models, language, file, noHeader).Write();
    if (status != Status::Success || !certificate.IsWanted()) {
        return status;
    }
    for (const DesignModel& design : models) {
        const Orn_Hdl::Proof::Written written = GetWritten(*design.model, design.legal);
        status = Worse(status, certificate.AddNetlist(file, language, written.netlist));
    }
    return status;
}

Status WriteFolder(const std::vector<DesignModel>& models, Language language,
                   const Outputs& outputs, const std::string& list, Progress& progress,
                   Certificate& certificate) {
    std::vector<std::string> names;
    for (const DesignModel& design : models) {
        const Orn_Hdl::Netlist& netlist = *design.model->GetNetlist();
        names.push_back(design.legal != nullptr ? design.legal->GetName(netlist)
                                                : std::string(netlist.GetNameView()));
    }
    const std::vector<std::string> files =
        MakeFileNames(names, outputs.folder, language == Language::Verilog ? ".v" : ".vhd");
    Status status = MakeFolder(outputs.folder);
    for (std::size_t i = 0; i < models.size() && status == Status::Success; ++i) {
        progress.Writing(files[i]);
        status = WriteFile({models[i]}, language, files[i], outputs.noHeader, certificate);
        progress.Erase();
    }
    return status == Status::Success ? WriteFileList(list, files) : status;
}

/// Whether a file can have the name.
bool IsPlain(std::string_view name) noexcept {
    return !name.empty() && std::all_of(name.begin(), name.end(), [](char c) {
        return Port::IsLetter(c) || Port::IsDigit(c) || c == '_' || c == '$';
    });
}

} // namespace

Status WriteDesign(const std::vector<DesignModel>& models, const Outputs& outputs,
                   Progress& progress, Certificate& certificate) {
    if (models.size() == 1 && outputs.folder.empty()) {
        return WriteOutputs(*models.front().model, outputs, progress, models.front().legal,
                            models.front().tell, certificate);
    }
    Status status = Status::Success;
    for (const auto& [language, file] : outputs.files) {
        if (file.empty()) {
            continue;
        }
        if (!outputs.folder.empty()) {
            status =
                Worse(status, WriteFolder(models, language, outputs, file, progress, certificate));
            continue;
        }
        progress.Writing(file == "-" ? "standard output" : file);
        const Status written = WriteFile(models, language, file, outputs.noHeader, certificate);
        progress.Erase();
        status = Worse(status, written);
    }
    return status;
}

std::vector<std::string> MakeFileNames(const std::vector<std::string>& models,
                                       const std::string& folder, const std::string& extension) {
    Port::NameScope names;
    std::vector<std::string> files;
    for (const std::string& model : models) {
        const std::string identifier(Import::NameRules::WithoutEscape(model));
        const std::string wanted =
            IsPlain(identifier) ? identifier : Import::MakeSimilarName(identifier, 'm');
        std::string name = names.ClaimNumbered(wanted, true, [](std::string_view) { return true; });
        files.push_back((std::filesystem::path(folder) / name.append(extension)).string());
    }
    return files;
}

Status MakeFolder(const std::string& folder) {
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    return error ? ComplainUnwritable(folder, error.value()) : Status::Success;
}

Status WriteFileList(const std::string& name, const std::vector<std::string>& files) {
    std::string text;
    for (const std::string& file : files) {
        text.append(file).append("\n");
    }
    if (name == "-") {
        return Print(text);
    }
    OutputFile list(name);
    if (Port::Stream* const out = list.GetStream()) {
        *out << text;
    }
    return list.Commit();
}

} // namespace Tool
