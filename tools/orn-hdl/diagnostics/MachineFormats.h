// Diagnostics for programs: SARIF 2.1.0, and a JSON form of our own.
#pragma once

#include "diagnostics/Diagnostic.h"

#include <string>
#include <string_view>
#include <vector>

namespace Tool {

/// What a SARIF log says about a rule. Empty texts are omitted.
struct RuleTexts {
    std::string_view name;
    /// What is wrong, in one line.
    std::string_view what;
    std::string_view why;
    std::string_view help;
};

/// \param rules the rules that a diagnostic may name.
std::string FormatSarif(const std::vector<Diagnostic>& diagnostics,
                        const std::vector<RuleTexts>& rules);

/// The diagnostics, and the numbers of errors and warnings.
std::string FormatJson(const std::vector<Diagnostic>& diagnostics);

} // namespace Tool
