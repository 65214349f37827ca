// A text that is read piece by piece: a file, or the text of a macro.
#pragma once

#include "Port/File.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers {

/// The part of a text that is in memory. A NUL that is not part of the text stands behind it, so a
/// scanner need not ask at every character whether there is another one.
class InputText {
public:
    InputText() = default;
    InputText(const InputText&) = delete;
    InputText& operator=(const InputText&) = delete;

    /// Opens a file. \return false if it cannot be opened; the system's error number is kept.
    bool Open(const std::string& fileName);
    /// Takes a text as it stands.
    void Take(std::string_view text);
    /// The system's error number of the first failure; 0 if there was none.
    int GetError() const noexcept { return file_.GetError(); }

    /// Reads on. The text from `mark` on, or from `current` without a mark, stays, at another
    /// address: `current`, `end` and `mark` follow it.
    /// \return false at the end of the text.
    bool ReadOn();

    /// How many characters stand in front of one that is in memory.
    std::uint64_t GetOffset(const char* character) const noexcept {
        return start_ + static_cast<std::uint64_t>(character - buffer_.get());
    }

    /// The next character.
    const char* current = nullptr;
    /// Behind the last character in memory.
    const char* end = nullptr;
    /// From where on the text is needed; null for nothing before `current`.
    const char* mark = nullptr;

private:
    Port::File file_;
    std::unique_ptr<char[]> buffer_;
    std::size_t capacity_ = 0;
    /// How many characters stood in front of the buffer's first one.
    std::uint64_t start_ = 0;
};

} // namespace Orn_Hdl::Readers
