#include "Output.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Progress.h"

#include <algorithm>

namespace Tool {

namespace {

Status WriteOutput(Orn_Hdl::Model& model, Orn_Hdl::Language language, const std::string& file,
                   bool noHeader, Progress& progress) {
    if (file.empty()) {
        return Status::Success;
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

Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress) {
    Status status = Status::Success;
    for (const auto& [language, file] : outputs.files) {
        status = Worse(status, WriteOutput(model, language, file, outputs.noHeader, progress));
    }
    return status;
}

} // namespace Tool
