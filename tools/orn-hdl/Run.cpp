#include "Run.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"
#include "Progress.h"

#include <cstdint>
#include <string_view>
#include <system_error>
#include <utility>

namespace Tool {

namespace {

/// The number of lines between two readings of the clock.
constexpr std::uint64_t LinesPerUpdate = 4096;

/// The name of the model if the commands come from standard input and do not name it.
constexpr const char* NamelessModel = "HDL_NETLIST";

/// The replay of one file: its progress, messages and status.
class Replayer {
public:
    Replayer(Orn_Hdl::Model& model, const std::string& file, Progress& progress)
        : model_(model), file_(file), progress_(progress) {}

    /// Executes one line, which ends at `position` in the file. \return whether it succeeded.
    bool Execute(const Orn_Hdl::StringArray& words, std::uint64_t position) {
        ++lines_;
        if (lines_ % LinesPerUpdate == 0) {
            progress_.Update(lines_, position);
        }
        try {
            model_.Execute(words);
        } catch (const Orn_Hdl::Exception& exception) {
            Report(WithoutLineEnd(exception.getLocalized().GetView()));
            status_ = Worse(status_, Status::Failed);
            return false;
        }
        return model_.GetWriteError() == 0 || ReportWriteError();
    }

    Status GetStatus() const noexcept { return status_; }

private:
    static std::string_view WithoutLineEnd(std::string_view text) noexcept {
        if (!text.empty() && text.back() == '\n') {
            text.remove_suffix(1);
        }
        return text;
    }

    void Report(std::string_view text) {
        progress_.Erase();
        std::string message(file_);
        message.append(":").append(std::to_string(lines_)).append(": error: ").append(text);
        PrintError(message);
    }

    bool ReportWriteError() {
        std::string text("cannot write ");
        text.append(model_.GetWrittenFileName().GetView()).append(": ");
        text.append(Port::ErrorText(model_.GetWriteError()).GetView());
        if (const std::uint64_t leftover = model_.GetWriteLeftover(); leftover != 0) {
            text.append("; the last ").append(std::to_string(leftover));
            text.append(" bytes of the file are a part of the new text");
        }
        Report(text);
        status_ = Status::File;
        // The model keeps the error of its last write. Clear it, so that it is reported once.
        model_.RecordWrite("", 0);
        return false;
    }

    Orn_Hdl::Model& model_;
    const std::string& file_;
    Progress& progress_;
    std::uint64_t lines_ = 0;
    Status status_ = Status::Success;
};

std::string GetModelName(const RunOptions& options) {
    if (options.model) {
        return *options.model;
    }
    if (options.file == "-") {
        return NamelessModel;
    }
    return std::string(Port::FileName(options.file.c_str()).GetStem().GetView());
}

} // namespace

Replayed Replay(Orn_Hdl::Model& model, const std::string& file, bool keepGoing, Progress& progress,
                const WriteRules& rules) {
    Orn_Hdl::CommandReader input(model);
    if (!input.Open(SystemFileName(file.c_str()))) {
        return {ComplainUnreadable(file, input.GetError()), false};
    }
    std::optional<RulesInForce> inForce;
    try {
        inForce.emplace(model, rules);
    } catch (const std::system_error& error) {
        return {ComplainUnwritable(rules.folder.value_or(""), error.code().value()), false};
    }
    Replayer replayer(model, file, progress);
    while (const Orn_Hdl::StringArray* words = input.Next()) {
        if (!replayer.Execute(*words, input.GetPosition()) && !keepGoing) {
            return {replayer.GetStatus(), false};
        }
    }
    if (input.GetError() != 0) {
        progress.Erase();
        return {ComplainUnreadable(file, input.GetError()), false};
    }
    return {replayer.GetStatus(), true};
}

Status Run(const RunOptions& options) {
    Progress progress(options.quiet, options.file);
    // The design is not destroyed before the process ends: freeing it object by object would take a
    // tenth of the time of the whole run.
    static Orn_Hdl::Engine* engine = nullptr;
    delete std::exchange(engine, nullptr); // From an earlier run.
    engine = new Orn_Hdl::Engine;
    const std::string name = GetModelName(options);
    engine->CreateAndAddModel(name.c_str(), options.file.c_str());
    Orn_Hdl::Model& model = *engine->GetModel(name.c_str());
    const Replayed replayed =
        Replay(model, options.file, options.keepGoing, progress, options.writeRules);
    if (!replayed.complete) {
        return replayed.status;
    }
    return Worse(replayed.status, WriteOutputs(model, options.outputs, progress));
}

} // namespace Tool
