#include "Output.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Progress.h"

namespace Tool {

namespace {

Status WriteOutput(Orn_Hdl::Model& model, const char* language, const std::string& file,
                   bool noHeader, Progress& progress) {
    if (file.empty()) {
        return Status::Success;
    }
    progress.Writing(file);
    Orn_Hdl::StringArray words;
    words.Add("WRITE");
    words.Add(language);
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
    const Status verilog =
        WriteOutput(model, "VERILOG", outputs.verilog, outputs.noHeader, progress);
    return Worse(verilog, WriteOutput(model, "VHDL", outputs.vhdl, outputs.noHeader, progress));
}

} // namespace Tool
