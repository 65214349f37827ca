#include "C/Lines.h"

#include "C/Texts.h"
#include "Orn_Hdl/Commands.h"
#include "Port/File.h"

namespace Orn_Hdl::CInterface {

namespace {

/// The number of lines between two calls that tell of the progress.
constexpr std::uint64_t LinesPerCall = 4096;

template <class Line> void RunAnyLine(Model& model, const Line& line) {
    ClearWriteError(model);
    if constexpr (std::is_same_v<Line, StringArray>) {
        model.Execute(line);
    } else {
        model.ExecuteLine(line);
    }
    RequireWritten(model);
}

[[noreturn]] void FailUnreadable(const char* fileName, int error) {
    throw CallFailure{ORN_HDL_FILE, std::string("cannot read ")
                                        .append(Port::ViewOf(fileName))
                                        .append(": ")
                                        .append(Port::ErrorText(error).GetView())};
}

/// Whether the caller wants to go on behind the line that has failed.
bool GoesOn(const ReplayListeners& listeners, const LastError& error) {
    if (listeners.failure == nullptr) {
        return false;
    }
    const orn_hdl_error_t told{error.status,
                               {error.text.c_str(), error.text.size()},
                               {error.file.c_str(), error.file.size()},
                               error.line};
    return listeners.failure(listeners.user, &told) == 0;
}

} // namespace

void ClearWriteError(Model& model) {
    if (model.GetWriteError() != 0) {
        model.RecordWrite(model.GetWrittenFileName(), 0);
    }
}

void RequireWritten(Model& model) {
    if (model.GetWriteError() == 0) {
        return;
    }
    std::string text("cannot write ");
    text.append(model.GetWrittenFileName().GetView()).append(": ");
    text.append(Port::ErrorText(model.GetWriteError()).GetView());
    if (const std::uint64_t leftover = model.GetWriteLeftover(); leftover != 0) {
        text.append("; the last ").append(std::to_string(leftover));
        text.append(" bytes of the file are a part of the new text");
    }
    throw CallFailure{ORN_HDL_FILE, std::move(text)};
}

void RunLine(Model& model, std::string_view line) {
    RunAnyLine(model, line);
}

orn_hdl_status_t Replay(ModelEntity& entity, const char* fileName, const ReplayListeners& listeners,
                        LastError& error) {
    const Changing changing(entity);
    Model& model = entity.model;
    CommandReader reader(model);
    if (!reader.Open(fileName)) {
        FailUnreadable(fileName, reader.GetError());
    }
    orn_hdl_status_t last = ORN_HDL_OK;
    std::uint64_t lines = 0;
    while (const StringArray* const words = reader.Next()) {
        ++lines;
        const orn_hdl_status_t status = Attempt(&error, [&] { RunAnyLine(model, *words); });
        if (status != ORN_HDL_OK) {
            error.SetPlace(Port::ViewOf(fileName), lines);
            last = status;
            if (!GoesOn(listeners, error)) {
                return status;
            }
        }
        if (lines % LinesPerCall == 0 && listeners.progress != nullptr &&
            listeners.progress(listeners.user, lines, reader.GetPosition()) != 0) {
            End(ORN_HDL_STOPPED);
        }
    }
    if (reader.GetError() != 0) {
        FailUnreadable(fileName, reader.GetError());
    }
    model.SetModifiedFlag(false);
    return last;
}

} // namespace Orn_Hdl::CInterface
