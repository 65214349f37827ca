// Diagnostics as people read them.
#pragma once

#include "diagnostics/Diagnostic.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace Tool {

enum class ColorChoice { Auto, Always, Never };

/// Whether text for a file is coloured. `Auto` colours for a terminal, unless the environment
/// variable NO_COLOR is set or TERM is "dumb".
bool UsesColor(ColorChoice choice, std::FILE* file);

/// A diagnostic as lines of text: "FILE:LINE: error: MESSAGE", the source line with the marked
/// part underlined, and the notes.
std::string FormatText(const Diagnostic& diagnostic, bool useColor);

/// "2 errors, 1 warning", without a part that is zero; "0 errors" if both are.
std::string FormatCounts(std::uint64_t errors, std::uint64_t warnings);

} // namespace Tool
