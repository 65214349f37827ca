// Prints the diagnostics of one run of the tool, and counts them.
#pragma once

#include "diagnostics/Diagnostic.h"
#include "diagnostics/MachineFormats.h"
#include "diagnostics/TextFormat.h"

#include <cstdint>
#include <functional>
#include <utility>
#include <vector>

namespace Tool {

enum class ReportFormat { Text, Json, Sarif };

/// How diagnostics are reported, as the command line asks for.
struct ReportOptions {
    ReportFormat format = ReportFormat::Text;
    ColorChoice color = ColorChoice::Auto;
    /// Stop after so many errors; 0 for never.
    std::uint64_t errorLimit = 0;
};

/// Prints diagnostics on standard error: text at once, JSON and SARIF as one document in `Finish`.
class Reporter {
public:
    /// \param beforePrinting called before anything is printed, to erase a progress line.
    explicit Reporter(const ReportOptions& options, std::function<void()> beforePrinting = {});

    void Report(Diagnostic diagnostic);
    /// Whether so many errors were reported that work should stop.
    bool IsAtLimit() const noexcept {
        return options_.errorLimit != 0 && errors_ >= options_.errorLimit;
    }
    std::uint64_t GetErrorCount() const noexcept { return errors_; }
    std::uint64_t GetWarningCount() const noexcept { return warnings_; }

    /// Ends the report: text with the numbers of errors and warnings if there are at least two
    /// diagnostics, JSON and SARIF with the document.
    /// \param rules the rules that the diagnostics name, for SARIF.
    void Finish(const std::vector<RuleTexts>& rules = {});
    /// Takes what a document would contain, for a caller that prints a document of its own.
    std::vector<Diagnostic> TakeCollected() noexcept { return std::move(collected_); }

private:
    void Print(const std::string& text);

    const ReportOptions options_;
    const std::function<void()> beforePrinting_;
    const bool useColor_;
    /// What a document will contain.
    std::vector<Diagnostic> collected_;
    std::uint64_t errors_ = 0;
    std::uint64_t warnings_ = 0;
};

} // namespace Tool
