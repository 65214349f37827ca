// Command lines and command files that are carried out for the C interface.
#pragma once

#include "C/Calls.h"

namespace Orn_Hdl::CInterface {

/// Who is told of a replay; each may be null.
struct ReplayListeners {
    orn_hdl_progress_t progress = nullptr;
    orn_hdl_failure_t failure = nullptr;
    void* user = nullptr;
};

/// Carries out a line. A file that it cannot write is a failure, too.
void RunLine(Model& model, std::string_view line);

/// Fails when a write has failed since the model's error was cleared.
void RequireWritten(Model& model);

/// Forgets that an earlier write has failed.
void ClearWriteError(Model& model);

/// Replays a command file. A line that fails is remembered in `error`.
/// \return the status of the last line that failed.
orn_hdl_status_t Replay(ModelEntity& entity, const char* fileName, const ReplayListeners& listeners,
                        LastError& error);

} // namespace Orn_Hdl::CInterface
