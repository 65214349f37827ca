// Lines of a file that are in its buffer.
#pragma once

#include "Port/File.h"

#include <string_view>

namespace Port {

/// Private access to the lines that a `File` has read but not returned yet.
class LinesAtHand {
public:
    /// The next line, like `File::NextLine`, but only from the buffer.
    /// \return false if the buffer does not contain the whole line.
    static bool Next(File& file, std::string_view& line) {
        const std::size_t length = file.GetUnread().find('\n');
        if (length == std::string_view::npos) {
            return false;
        }
        line = file.TakeLine(length);
        return true;
    }
    /// The text of the coming lines, as far as it is in the buffer.
    static std::string_view GetUnread(const File& file) noexcept { return file.GetUnread(); }
    /// Skips the first line of that text. \param bytes its size, line end included; 0 for none.
    static void Skip(File& file, std::size_t bytes) noexcept {
        file.lineStart_ += bytes;
        file.lineSize_ = bytes;
    }
    /// Whether the file is a regular one that goes on behind its buffer, as far as is known.
    static bool GoesOn(const File& file) noexcept {
        return file.isRegular_ && !file.atEnd_ && file.lineCapacity_ > 0 &&
               file.lineEnd_ == file.lineCapacity_;
    }
};

} // namespace Port
