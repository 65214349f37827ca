// What a command keeps of its line: its argument texts, packed into one block of memory.
#pragma once

#include <cstdint>
#include <initializer_list>
#include <string_view>

namespace Orn_Hdl {

/// Up to fifteen texts and eight flags. Millions of done commands each hold one, so it is a single
/// pointer to one block.
class Arguments {
public:
    Arguments() noexcept = default;
    explicit Arguments(std::initializer_list<std::string_view> texts, unsigned flags = 0);
    Arguments(Arguments&& other) noexcept : block_(other.block_) { other.block_ = nullptr; }
    Arguments& operator=(Arguments&& other) noexcept;
    Arguments(const Arguments&) = delete;
    Arguments& operator=(const Arguments&) = delete;
    ~Arguments();

    /// The text at `index`, closed by a NUL; empty when there is none.
    const char* Get(int index) const noexcept;
    bool HasFlag(unsigned flag) const noexcept { return (GetFlags() & flag) != 0; }

private:
    unsigned GetFlags() const noexcept {
        return block_ == nullptr ? 0U : static_cast<unsigned char>(block_[1]);
    }

    /// The number of texts, the flags, then the texts, each closed by a NUL.
    char* block_ = nullptr;
};

} // namespace Orn_Hdl
