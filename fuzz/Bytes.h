// Turns the bytes of a fuzz input into choices and texts. At the end of the input every choice is
// the first one and every text is empty, so any input is valid. No expression may make two choices
// in an order that the compiler is free to pick: inputs would then mean different things.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace Fuzz {

class Bytes {
public:
    Bytes(const std::uint8_t* data, std::size_t size)
        : rest_(reinterpret_cast<const char*>(data), size) {}

    bool IsAtEnd() const noexcept { return rest_.empty(); }

    /// A number below `count`, which is at most 256.
    int Choose(int count) noexcept {
        if (rest_.empty()) {
            return 0;
        }
        const auto byte = static_cast<unsigned char>(rest_.front());
        rest_.remove_prefix(1);
        return byte % count;
    }

    /// One of the elements of a table.
    template <class T, std::size_t Count> const T& Pick(const T (&table)[Count]) noexcept {
        static_assert(Count <= 256);
        return table[Choose(static_cast<int>(Count))];
    }

    /// A text of any bytes, shorter than `limit`.
    std::string Text(int limit) {
        // Chosen first: that takes a byte away.
        const auto wanted = static_cast<std::size_t>(Choose(limit));
        const std::size_t length = std::min(wanted, rest_.size());
        std::string text(rest_.substr(0, length));
        rest_.remove_prefix(length);
        return text;
    }

    std::string_view Rest() const noexcept { return rest_; }

private:
    std::string_view rest_;
};

} // namespace Fuzz
