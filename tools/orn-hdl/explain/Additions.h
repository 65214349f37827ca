// Which line of a command file added something.
#pragma once

#include "diagnostics/SourceLines.h"
#include "diagnostics/WordPlaces.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace Tool::Explain {

enum class ObjectKind { Component, Instance, Signal, Pin };

/// The line that added something.
struct Addition {
    std::uint64_t line = 0;
    /// The word that names it.
    Mark mark;
    /// Whether it was added without being declared: by a connection or a constant.
    bool isFirstUse = false;
};

/// Finds the first line that adds an object, by reading the file from its start.
/// \param owner the component of a pin; ignored for other kinds.
std::optional<Addition> FindAddition(SourceLines& lines, ObjectKind kind, std::string_view name,
                                     std::string_view owner = {});

} // namespace Tool::Explain
