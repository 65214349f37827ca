// Where the text of a JSON netlist comes from.
#pragma once

#include <cstddef>
#include <string_view>

namespace Tool::Import {

/// A text that is read piece by piece.
class TextSource {
public:
    TextSource() = default;
    TextSource(const TextSource&) = delete;
    TextSource& operator=(const TextSource&) = delete;
    virtual ~TextSource() = default;

    /// Reads the next bytes, at most `count`. \return how many were read; 0 at the end of the text.
    virtual std::size_t Read(char* to, std::size_t count) = 0;
};

/// A text in memory.
class TextInMemory final : public TextSource {
public:
    /// \param text not copied.
    explicit TextInMemory(std::string_view text) noexcept : text_(text) {}

    std::size_t Read(char* to, std::size_t count) override {
        const std::size_t size = text_.copy(to, count);
        text_.remove_prefix(size);
        return size;
    }

private:
    std::string_view text_;
};

} // namespace Tool::Import
