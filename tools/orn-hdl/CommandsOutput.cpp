#include "CommandsOutput.h"

#include "import/Sink.h"

#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Streams.h"

#include <string_view>

namespace Tool {

namespace {

/// Hands the lines to a file, or to standard output in large pieces.
class LineDestination final : public Orn_Hdl::StreamDst {
public:
    /// \param file null for standard output.
    LineDestination(Port::Stream* file, Status& status) : file_(file), status_(status) {}

    void Write(const char* text) override { WriteView(text); }
    void Write(int number) override { WriteView(std::to_string(number)); }
    void WriteView(std::string_view text) override {
        if (file_ != nullptr) {
            *file_ << text;
            return;
        }
        buffer_ += text;
        if (buffer_.size() >= PieceSize) {
            Flush();
        }
    }
    void Flush() override {
        if (status_ == Status::Success && !buffer_.empty()) {
            status_ = Print(buffer_);
        }
        buffer_.clear();
    }

private:
    static constexpr std::size_t PieceSize = std::size_t(1) << 16;

    Port::Stream* const file_;
    Status& status_;
    std::string buffer_;
};

} // namespace

CommandsOutput::CommandsOutput(const std::string& name)
    : isStandardOutput_(name == "-"), file_(isStandardOutput_ ? std::string() : name) {}

Status CommandsOutput::Write(Orn_Hdl::Model& model) {
    if (!isStandardOutput_ && file_.GetStream() == nullptr) {
        return file_.Flush();
    }
    Status status = Status::Success;
    Orn_Hdl::OutStream out(new LineDestination(file_.GetStream(), status));
    try {
        if (model.GetOptions()->dontCares) {
            out << Import::DontCareNote;
        }
        model.WriteCommands(out);
    } catch (const Orn_Hdl::Exception& exception) {
        std::string_view text = exception.getLocalized().GetView();
        text.remove_suffix(text.empty() || text.back() != '\n' ? 0 : 1);
        Complain(text);
        return Status::Failed;
    }
    out << Orn_Hdl::OutStream::Flush;
    return Worse(status, file_.Flush());
}

} // namespace Tool
