/// \file
/// The benchmark design in every language that a program of the comparison reads.
#pragma once

#include "design.h"

#include <span>
#include <string_view>

namespace bench {

struct Format {
    std::string_view name;
    std::string_view description;
    void (*write)(Output& out, const Design& design);
};

std::span<const Format> GetFormats() noexcept;

} // namespace bench
