// The lines of a file that has been read before.
#pragma once

#include "Port/File.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Tool {

/// Reads lines of a file again, for messages. A file that can be read only once, such as a pipe,
/// has no lines. Nothing is opened before the first line is asked for.
class SourceLines {
public:
    /// \param name the name under which the system opens the file. Later changes of the current
    ///        folder do not matter.
    explicit SourceLines(const std::string& name);
    SourceLines(const SourceLines&) = delete;
    SourceLines& operator=(const SourceLines&) = delete;

    /// Finds the text of a line without its line end, valid until the next call. Lines that are
    /// asked for in ascending order take one pass over the file.
    /// \return false if there is no such line.
    bool Get(std::uint64_t line, std::string_view& text);

    /// The absolute name of the file.
    const std::string& GetName() const noexcept { return name_; }

private:
    bool Open();

    const std::string name_;
    Port::File file_;
    /// The number of the line in `text_`; 0 before the first one.
    std::uint64_t line_ = 0;
    std::string_view text_;
};

/// Whether a file can be read more than once.
bool CanReadAgain(const std::string& name);

} // namespace Tool
