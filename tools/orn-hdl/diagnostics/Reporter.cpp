#include "diagnostics/Reporter.h"

#include <cstdio>
#include <utility>

namespace Tool {

Reporter::Reporter(const ReportOptions& options, std::function<void()> beforePrinting)
    : options_(options), beforePrinting_(std::move(beforePrinting)),
      useColor_(options.format == ReportFormat::Text && UsesColor(options.color, stderr)) {}

void Reporter::Report(Diagnostic diagnostic) {
    ++(diagnostic.severity == Severity::Error ? errors_ : warnings_);
    if (options_.format == ReportFormat::Text) {
        Print(FormatText(diagnostic, useColor_));
    } else {
        collected_.push_back(std::move(diagnostic));
    }
}

void Reporter::Finish(const std::vector<RuleTexts>& rules) {
    switch (options_.format) {
    case ReportFormat::Text:
        if (errors_ + warnings_ > 1) {
            Print(FormatCounts(errors_, warnings_) +
                  (IsAtLimit() ? "; stopped at --error-limit\n" : "\n"));
        }
        break;
    case ReportFormat::Json:
        Print(FormatJson(collected_));
        break;
    case ReportFormat::Sarif:
        Print(FormatSarif(collected_, rules));
        break;
    }
}

void Reporter::Print(const std::string& text) {
    if (beforePrinting_) {
        beforePrinting_();
    }
    // In one call, so that the lines of programs that share a terminal are not mixed.
    std::fwrite(text.data(), 1, text.size(), stderr);
}

} // namespace Tool
