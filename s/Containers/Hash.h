// The hash that determines the order of `NameTable`: h = h * 33 + byte, starting from 5381, with
// signed bytes, in 32 bits. Look-ups without a visible order use `HashByEights`, which is faster
// and seeded.
#pragma once

#include "Port/Ascii.h"

#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

class NameHash {
public:
    void Add(char c) noexcept {
        value_ = value_ * 33U + static_cast<std::uint32_t>(static_cast<signed char>(c));
    }
    void AddUpper(char c) noexcept { Add(Port::ToUpper(c)); }
    std::uint32_t GetValue() const noexcept { return value_; }

private:
    std::uint32_t value_ = 5381;
};

inline std::uint32_t HashExact(std::string_view name) noexcept {
    NameHash hash;
    for (const char c : name) {
        hash.Add(c);
    }
    return hash.GetValue();
}

inline std::uint32_t HashIgnoringCase(std::string_view name) noexcept {
    NameHash hash;
    for (const char c : name) {
        hash.AddUpper(c);
    }
    return hash.GetValue();
}

} // namespace Orn_Hdl
