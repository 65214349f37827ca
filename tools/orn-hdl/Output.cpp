#include "Output.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Progress.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <memory>
#include <string_view>

namespace Tool {

namespace {

void WriteNetlist(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal, Orn_Hdl::Language language,
                  Orn_Hdl::OutStream& out) {
    if (legal != nullptr) {
        legal->Write(language, out);
        return;
    }
    switch (language) {
    case Orn_Hdl::Language::Verilog:
        Orn_Hdl::VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        break;
    case Orn_Hdl::Language::Vhdl:
        Orn_Hdl::VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
        break;
    }
}

Orn_Hdl::Proof::Written GetWritten(Orn_Hdl::Model& model, const Orn_Hdl::LegalNetlist* legal) {
    return legal != nullptr
               ? Orn_Hdl::Proof::Written{legal->GetWrittenNetlist(), legal->GetWrittenOptions()}
               : Orn_Hdl::Proof::Written{*model.GetNetlist(), *model.GetOptions()};
}

/// Copies a file from its start to standard output.
Status PrintFile(std::FILE* file) {
    std::rewind(file);
    std::array<char, 65536> piece;
    while (const std::size_t count = std::fread(piece.data(), 1, piece.size(), file)) {
        if (const Status status = Print(std::string_view(piece.data(), count));
            status != Status::Success) {
            return status;
        }
    }
    return std::ferror(file) == 0 ? Status::Success : ComplainUnreadable("a temporary file", errno);
}

/// Writes a netlist to standard output, by way of a temporary file: only a file that is opened by
/// its name gets indentation, and standard output may be a socket, which cannot be opened.
Status PrintOutput(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal, Orn_Hdl::Language language,
                   bool noHeader, Progress& progress) {
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::tmpfile(), &std::fclose);
    if (file == nullptr) {
        return ComplainUnwritable("a temporary file", errno);
    }
    progress.Writing("standard output");
    model.GetOptions()->writeHeader = !noHeader;
    Orn_Hdl::TextFileOutStream out;
    const std::string name = "/dev/fd/" + std::to_string(fileno(file.get()));
    if (out.Open(name.c_str(), Orn_Hdl::TextFileOutStream::Overwrite)) {
        WriteNetlist(model, legal, language, out);
        out.Close();
    }
    if (model.GetOptions()->verify && out.GetError() == 0) {
        const Orn_Hdl::Proof::Written written = GetWritten(model, legal);
        Orn_Hdl::Proof::Require(name.c_str(), "standard output", language, written.netlist,
                                written.options);
    }
    progress.Erase();
    return out.GetError() == 0 ? PrintFile(file.get())
                               : ComplainUnwritable("a temporary file", out.GetError());
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
    if (file == "-") {
        return PrintOutput(model, legal, language, noHeader, progress);
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
    if (!name_.empty() &&
        Check(file_.open(name_.c_str(), Port::File::Replace, true)) == Status::Success) {
        stream_.emplace(file_);
    }
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
    return stream_ && Flush() == Status::Success ? Check(file_.close()) : status_;
}

Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress,
                    Orn_Hdl::LegalNetlist* legal, const TellDifferences& tell) {
    Status status = Status::Success;
    for (const auto& [language, file] : outputs.files) {
        try {
            status = Worse(status,
                           WriteOutput(model, legal, language, file, outputs.noHeader, progress));
        } catch (const Orn_Hdl::ProofException& exception) {
            progress.Erase();
            status = Worse(
                status, tell(exception.GetDifferences(), file == "-" ? "standard output" : file));
        }
    }
    return status;
}

} // namespace Tool
