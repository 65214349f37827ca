// The lines that a manager has done.
#pragma once

#include "HdlCmd/PhraseTable.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Pooled.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// The words of lines, packed. A design of a million instances has millions of lines, so a phrase
/// of the language takes one byte, and so does the length of a word.
class Journal {
public:
    /// Where a line begins.
    struct Place {
        std::size_t block = 0;
        std::size_t offset = 0;
    };

    /// Packs a line.
    /// \param room memory for the line, which grows where it is too short.
    /// \return the packed line, which stands in `room`.
    static std::string_view Pack(const StringArray& words, const PhraseTable::Match& phrase,
                                 std::string& room);

    int GetSize() const noexcept { return count_; }
    /// Adds a packed line. If allocation fails, the journal stays as it was.
    void Add(std::string_view packed);
    /// Gives the words of the next line. Phrases of the language are spelled as registered.
    /// \param place where the walk is; the first line has the default. Lines may be added
    /// meanwhile. \return false if there is none.
    bool Next(Place& place, StringArray& words) const;

private:
    struct Free {
        void operator()(char* text) const noexcept { Port::Pool::Free(text); }
    };
    /// Some lines. The last block has room for more.
    struct Block {
        std::unique_ptr<char, Free> text;
        std::size_t size;
        std::size_t room;
    };

    std::vector<Block> blocks_;
    int count_ = 0;
};

} // namespace Orn_Hdl
