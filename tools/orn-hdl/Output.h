// Writing the files that the user asked for on the command line.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Port/File.h"
#include "Tool.h"

#include <map>
#include <optional>
#include <string>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

class Progress;

/// The netlists to write.
struct Outputs {
    /// The file of each language. An empty name writes none.
    std::map<Orn_Hdl::Language, std::string> files;
    bool noHeader = false;

    /// Whether there is nothing to write.
    bool IsEmpty() const;
};

/// A text file to be written as a whole: its name stands for what it stood for before until
/// `Commit`, and without one for ever. Without a name there is no file, and nothing fails.
class OutputFile {
public:
    /// Complains when the file cannot be written.
    explicit OutputFile(const std::string& name);

    /// Where the text goes; null when there is no file, or none that can be written.
    Port::Stream* GetStream() noexcept { return stream_ ? &*stream_ : nullptr; }
    /// Writes what is left to be written, and complains when anything of the text got lost.
    Status Flush();
    /// Puts the file in its place, and complains when that fails.
    Status Commit();

private:
    Status Check(bool good);

    const std::string name_;
    Port::File file_;
    std::optional<Port::Stream> stream_;
    Status status_ = Status::Success;
};

/// Writes the netlists in the order of their languages, and complains of those that did not reach
/// their file.
Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress);

} // namespace Tool
