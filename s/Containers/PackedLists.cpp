#include "Containers/PackedLists.h"

#include "Containers/EightBytes.h"

namespace Orn_Hdl {

std::size_t PackedLists::SplitUsualLine(std::string_view text, StringArray& list) noexcept {
    constexpr std::size_t Step = EightBytes::Count;
    list.text_.clear();
    list.slots_.clear();
    if (text.size() < Step) {
        return 0;
    }
    std::size_t start = 0;
    // \return false if there is no memory for the word.
    const auto addWord = [&list, &start](std::size_t end) {
        if (end > start) {
            if (list.slots_.size() == list.slots_.capacity()) {
                return false;
            }
            list.slots_.push_back({start, end - start});
        }
        start = end + 1;
        return true;
    };
    const std::size_t last = text.size() - Step;
    for (std::size_t i = 0; i <= last; i += Step) {
        // Blanks, quotes, line ends and NUL, and some characters that need no attention.
        std::uint64_t marks = EightBytes::MarkUpTo(EightBytes::Load(text.data() + i), '\'');
        for (; marks != 0; marks &= marks - 1) {
            const std::size_t end = i + EightBytes::FirstMarked(marks);
            const char c = text[end];
            if (c == ' ') {
                if (!addWord(end)) {
                    return 0;
                }
            } else if (c == '\n') {
                const std::size_t size = end > 0 && text[end - 1] == '\r' ? end - 1 : end;
                if (!addWord(size) || size > list.text_.capacity()) {
                    return 0;
                }
                list.text_.append(text.data(), size);
                return end + 1;
            } else if (c == '"' || c == '\'' || c == '\0') {
                return 0;
            }
        }
    }
    return 0;
}

} // namespace Orn_Hdl
