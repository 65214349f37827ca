// Where the words of a command stand in its line.
#pragma once

#include "diagnostics/Diagnostic.h"

#include "Orn_Hdl/Containers/StringArray.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Tool {

/// One word of a line.
struct WordPlace {
    std::string text;
    /// The bytes that the word takes in the line, quotes included.
    Columns columns;
    /// Whether each byte of the text stands in the line, from `textFirst` on. Otherwise the line
    /// has backslashes or quotes in between.
    bool isPlain = true;
    std::size_t textFirst = 0;
};

/// Splits a line as `StringArray::ParseCommandLine` does.
std::vector<WordPlace> FindWords(std::string_view line);

/// Words of a command, or a part of one word.
struct Mark {
    static constexpr std::size_t ToEnd = std::string_view::npos;

    /// The first and the last marked word. If `first` is the number of words, the mark stands
    /// behind the last word.
    int first = 0;
    int last = 0;
    /// The marked part of the word, if it is only one.
    std::size_t offset = 0;
    std::size_t length = ToEnd;

    static Mark Word(int index) noexcept { return Mark{index, index, 0, ToEnd}; }
    static Mark Words(int first, int last) noexcept { return Mark{first, last, 0, ToEnd}; }
    static Mark Part(int index, std::size_t offset, std::size_t length = ToEnd) noexcept {
        return Mark{index, index, offset, length};
    }
};

/// The columns of a mark. `words` are those of the line.
Columns GetColumns(const Mark& mark, const std::vector<WordPlace>& words);

/// The words as a line that would be split into them.
std::string JoinWords(const Orn_Hdl::StringArray& words);

} // namespace Tool
