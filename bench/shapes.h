/// \file
/// Command files of the shapes that break naive code: each drives one kind of list, table or text
/// to a size at which anything worse than linear shows.
#pragma once

#include "text_io.h"

#include <cstddef>
#include <span>
#include <string_view>

namespace bench {

/// What a program reads a shape with.
enum class Reader { Run, Import };

struct Shape {
    std::string_view name;
    std::string_view description;
    void (*write)(Output& out, std::size_t size);
    Reader reader = Reader::Run;
};

std::span<const Shape> GetShapes() noexcept;

} // namespace bench
