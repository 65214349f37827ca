// Lines of a file that need no reading.
#pragma once

#include "Port/File.h"

#include <string_view>

namespace Port {

/// The way past the public interface of `File` to what it has read and not given yet.
class LinesAtHand {
public:
    /// As `File::NextLine`, without reading: false also when the rest of the line has yet to be
    /// read.
    static bool Next(File& file, std::string_view& line) {
        const std::size_t length = file.GetUnread().find('\n');
        if (length == std::string_view::npos) {
            return false;
        }
        line = file.TakeLine(length);
        return true;
    }
};

} // namespace Port
