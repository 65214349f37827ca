// Many lists of texts in two blocks of memory.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Prefetch.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// Lists of texts, one behind the other. Another processor reads them faster than as many
/// `StringArray`s, each of which has memory of its own.
class PackedLists {
public:
    /// Drops all lists. Memory for more than `most` characters is freed.
    void Empty(std::size_t most) {
        if (text_.capacity() > most || slots_.capacity() > most) {
            *this = PackedLists();
        }
        text_.clear();
        slots_.clear();
        ends_.clear();
    }
    /// Appends a copy of a list. If an allocation fails, the lists are as before.
    void Add(const StringArray& list) {
        const End last = GetEnd(ends_.size());
        try {
            text_ += list.text_;
            slots_.insert(slots_.end(), list.slots_.begin(), list.slots_.end());
            ends_.push_back({text_.size(), slots_.size()});
        } catch (...) {
            text_.resize(last.text);
            slots_.resize(last.slots);
            throw;
        }
    }
    std::size_t GetSize() const noexcept { return ends_.size(); }
    /// Fetches a list, if there is one, which is to be copied soon.
    void Prefetch(std::size_t index) const noexcept {
        if (index < ends_.size()) {
            const End begin = GetEnd(index);
            Port::Prefetch(text_.data() + begin.text);
            Port::Prefetch(slots_.data() + begin.slots);
        }
    }
    /// Makes `list` a copy of a list that is here.
    void Copy(std::size_t index, StringArray& list) const {
        const End begin = GetEnd(index);
        const End end = ends_[index];
        list.Empty();
        list.text_.assign(text_, begin.text, end.text - begin.text);
        list.slots_.assign(slots_.data() + begin.slots, slots_.data() + end.slots);
    }

    /// Makes `list` the words of the first line of a text, as `StringArray::ParseCommandLine`
    /// would, if it is a usual line: one that ends with a line feed some characters before the text
    /// does, contains no quotes and no NUL, and fits the memory that the list has. \return how many
    /// bytes the line takes with its end, "\n" or "\r\n"; 0, with any words in
    ///         the list, if the line is not a usual one.
    static std::size_t SplitUsualLine(std::string_view text, StringArray& list) noexcept;

private:
    struct End {
        std::size_t text = 0;
        std::size_t slots = 0;
    };

    /// Where the first lists end together.
    End GetEnd(std::size_t count) const noexcept { return count == 0 ? End() : ends_[count - 1]; }

    std::string text_;
    std::vector<StringArray::Slot> slots_;
    std::vector<End> ends_;
};

} // namespace Orn_Hdl
