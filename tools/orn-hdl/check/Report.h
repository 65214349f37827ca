// How findings and rules are printed.
#pragma once

#include "check/Check.h"
#include "check/Located.h"

#include <string>
#include <vector>

namespace Tool::Checking {

/// The findings in the format asked for, with their counts.
std::string Format(const std::vector<Located>& findings, CheckFormat format);
/// A line a rule.
std::string ListRules();
/// The table of the documentation.
std::string ListRulesAsMarkdown();
/// All that the table says of one rule.
std::string Explain(const Orn_Hdl::Check::Rule& rule);

} // namespace Tool::Checking
