// `orn-hdl run --output-commands`: the commands from which the design of a replay comes.
#pragma once

#include "Output.h"
#include "Tool.h"

#include <string>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

/// A command file that gets the commands of a model. An existing file does not change before
/// `Commit`.
class CommandsOutput {
public:
    /// Prints a message if the file cannot be written.
    /// \param name "-" is standard output; an empty name is no file, and nothing fails.
    explicit CommandsOutput(const std::string& name);

    /// Writes the commands of the model as it is now, and prints a message if that fails.
    Status Write(Orn_Hdl::Model& model);
    /// Replaces the named file, and prints a message if that fails.
    Status Commit() { return file_.Commit(); }

private:
    const bool isStandardOutput_;
    OutputFile file_;
};

} // namespace Tool
