// What holds whenever a reader is given a netlist, in whatever language.
#pragma once

#include "Check.h"
#include "Consistency.h"
#include "MemoryFiles.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Writes.h"

#include <string_view>

namespace Fuzz {

/// FILE:LINE:COLUMN: error: TEXT, or FILE: error: TEXT.
inline void CheckReaderMessage(std::string_view message) {
    const std::size_t error = message.find(": error: ");
    Check(error != std::string_view::npos && error > 0, "the message names a file and an error");
    Check(message.back() == '\n', "the message ends in a line end");
    Check(message.find('\0') == std::string_view::npos, "the message holds no NUL");
}

/// Reads a file into a model and checks what becomes of it.
/// \return false when the file was refused.
template <class Reader>
bool ReadWithChecks(Reader& reader, const char* fileName, const MemoryFiles& files,
                    Orn_Hdl::Model& model) {
    model.AddSignal("former");
    try {
        reader.Read(fileName, model);
    } catch (const Orn_Hdl::Exception& exception) {
        CheckReaderMessage(exception.what());
        Check(!files.HasOpenFiles(), "every file is closed");
        Check(model.GetSignal("former") != nullptr, "the model is as it was");
        return false;
    }
    Check(!files.HasOpenFiles(), "every file is closed");
    CheckNetlist(*model.GetNetlist());
    CheckNames(*model.GetNetlist());
    WriteWithChecks(*model.GetNetlist(), *model.GetOptions());
    return true;
}

} // namespace Fuzz
