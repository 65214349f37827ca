#include "Output.h"

#include "Gzip.h"
#include "NetlistText.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Progress.h"
#include "proof/Certificate.h"

#include <algorithm>
#include <cerrno>

namespace Tool {

namespace {

/// Writes a netlist to standard output or into a compressed file, by way of a temporary file: only
/// a file that is opened by its name gets indentation, and standard output may be a socket, which
/// cannot be opened.
Status WriteByTemporary(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal,
                        Orn_Hdl::Language language, const std::string& target, bool noHeader,
                        Progress& progress) {
    const std::string shown = target == "-" ? "standard output" : target;
    const TemporaryFile file;
    if (!file.IsOpen()) {
        return Status::File;
    }
    progress.Writing(shown);
    model.GetOptions()->writeHeader = !noHeader;
    Orn_Hdl::TextFileOutStream out;
    if (out.Open(file.GetName().c_str(), Orn_Hdl::TextFileOutStream::Overwrite)) {
        WriteNetlist(model, legal, language, out);
        out.Close();
    }
    if (model.GetOptions()->verify && out.GetError() == 0) {
        const Orn_Hdl::Proof::Written written = GetWritten(model, legal);
        Orn_Hdl::Proof::Require(file.GetName().c_str(), shown.c_str(), language, written.netlist,
                                written.options);
    }
    progress.Erase();
    if (out.GetError() != 0) {
        return ComplainUnwritable("a temporary file", out.GetError());
    }
    return target == "-" ? file.Print() : WriteGzip(file, target);
}

/// Writes a legal netlist into a file, which is replaced once all of it has been written.
Status WriteLegally(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist& legal, Orn_Hdl::Language language,
                    const std::string& file, bool noHeader, Progress& progress) {
    progress.Writing(file);
    model.GetOptions()->writeHeader = !noHeader;
    legal.Prepare(language);
    Orn_Hdl::TextFileOutStream out(file.c_str(), Orn_Hdl::TextFileOutStream::Replace);
    if (model.GetOptions()->verify) {
        Orn_Hdl::Proof::Write(
            out, file.c_str(), language,
            [&](Orn_Hdl::OutStream& stream) { legal.Write(language, stream); },
            [&] { return GetWritten(model, &legal); });
    } else {
        legal.Write(language, out);
    }
    out.Close();
    progress.Erase();
    return out.GetError() == 0 ? Status::Success : ComplainUnwritable(file, out.GetError());
}

Status WriteOutput(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal, Orn_Hdl::Language language,
                   const std::string& file, bool noHeader, Progress& progress) {
    if (file.empty()) {
        return Status::Success;
    }
    if (file == "-" || IsGzip(file)) {
        return WriteByTemporary(model, legal, language, file, noHeader, progress);
    }
    if (legal != nullptr) {
        return WriteLegally(model, *legal, language, file, noHeader, progress);
    }
    progress.Writing(file);
    Orn_Hdl::StringArray words;
    words.Add("WRITE");
    words.Add(Orn_Hdl::GetLanguageName(language));
    if (noHeader) {
        words.Add("-NOHEADER");
    }
    words.Add(file.c_str());
    model.Execute(words);
    progress.Erase();
    const int error = model.GetWriteError();
    return error == 0 ? Status::Success : ComplainUnwritable(file, error);
}

} // namespace

bool Outputs::IsEmpty() const {
    return std::all_of(files.begin(), files.end(),
                       [](const auto& output) { return output.second.empty(); });
}

OutputFile::OutputFile(const std::string& name) : name_(name) {
    if (!name_.empty() && Check(Open()) == Status::Success) {
        stream_.emplace(file_);
    }
}

OutputFile::~OutputFile() = default;

bool OutputFile::Open() {
    if (!IsGzip(name_)) {
        return file_.open(name_.c_str(), Port::File::Replace, true);
    }
    contents_ = std::make_unique<TemporaryFile>();
    return contents_->IsOpen() &&
           file_.open(contents_->GetName().c_str(), Port::File::Overwrite, true);
}

Status OutputFile::Check(bool good) {
    if (!good && status_ == Status::Success) {
        status_ = ComplainUnwritable(name_, file_.GetError());
    }
    return status_;
}

Status OutputFile::Flush() {
    return stream_ ? Check(stream_->flush()) : status_;
}

Status OutputFile::Commit() {
    if (!stream_ || Flush() != Status::Success || Check(file_.close()) != Status::Success) {
        return status_;
    }
    return contents_ == nullptr ? Status::Success : WriteGzip(*contents_, name_);
}

Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress,
                    Orn_Hdl::LegalNetlist* legal, const TellDifferences& tell,
                    Certificate& certificate) {
    Status status = Status::Success;
    for (const auto& [language, file] : outputs.files) {
        try {
            Status written = WriteOutput(model, legal, language, file, outputs.noHeader, progress);
            if (written == Status::Success && !file.empty() && certificate.IsWanted()) {
                written = certificate.AddNetlist(file, language, GetWritten(model, legal).netlist);
            }
            status = Worse(status, written);
        } catch (const Orn_Hdl::ProofException& exception) {
            progress.Erase();
            status = Worse(
                status, tell(exception.GetDifferences(), file == "-" ? "standard output" : file));
        }
    }
    return status;
}

} // namespace Tool
