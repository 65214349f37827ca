// How findings and rules are printed.
#pragma once

#include "check/Check.h"
#include "check/Located.h"
#include "diagnostics/Diagnostic.h"
#include "diagnostics/Reporter.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Tool {
class CommandLines;
}

namespace Tool::Checking {

/// A finding as it is printed.
struct Reported {
    Diagnostic diagnostic;
    /// Every target of which it speaks.
    std::vector<Orn_Hdl::Check::Target> targets;
};

/// The findings in a command file, in their order. What no line brought in is reported at the line
/// that writes it.
std::vector<Reported> MakeReports(const std::vector<Located>& findings, CommandLines& lines);

/// What matters for text alone.
struct TextStyle {
    bool useColor = false;
    /// How many lines failed, which was reported before; they count as errors.
    std::size_t failures = 0;
};

/// The findings in the format asked for, with their counts.
std::string Format(const std::vector<Reported>& findings, ReportFormat format,
                   const TextStyle& style);
/// A line a rule.
std::string ListRules();
/// The table of the documentation.
std::string ListRulesAsMarkdown();
/// All that the table says of one rule.
std::string Explain(const Orn_Hdl::Check::Rule& rule);

} // namespace Tool::Checking
