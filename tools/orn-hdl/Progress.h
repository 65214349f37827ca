// The progress line of a long replay or import.
#pragma once

#include <chrono>
#include <cstdint>
#include <cstdio>
#include <functional>
#include <string>
#include <string_view>

namespace Tool {

/// Shows lines and percentage on standard error, if that is a terminal, once the work has lasted a
/// second. The destructor erases the line.
class Progress {
public:
    using Clock = std::chrono::steady_clock;

    /// \param quiet shows nothing at all.
    /// \param file the file that is read; its size is needed for the percentage.
    Progress(bool quiet, const std::string& file);
    /// Shows the line on `terminal`, by the time that `now` returns.
    ///
    /// \param terminal null shows nothing at all.
    Progress(std::FILE* terminal, const std::string& file, std::function<Clock::time_point()> now);
    ~Progress() { Erase(); }
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// Shows the progress. Reads the clock, so call it once for some thousand lines.
    void Update(std::uint64_t lines, std::uint64_t bytes);
    /// Shows how much of the file was read. Reads the clock, so call it once for some thousand
    /// bytes.
    ///
    /// \param isUnpacked whether the bytes are what was unpacked of a compressed file, so that
    /// their
    ///        number is not known before.
    void Reading(std::uint64_t bytes, bool isUnpacked);
    /// Shows that the design of a netlist is being made.
    void Making(std::string_view design);
    /// Shows that a file is being written.
    void Writing(std::string_view file);
    /// Erases the line on the terminal, so that a message can be printed.
    void Erase();

private:
    /// How much of the file's bytes these are; there are some.
    std::string GetPercentage(std::uint64_t bytes) const;
    bool IsDue();
    void Show(const std::string& text);

    /// Null if nothing is shown.
    std::FILE* const terminal_;
    const std::uint64_t totalBytes_;
    const std::function<Clock::time_point()> now_;
    bool shown_ = false;
    Clock::time_point next_;
};

} // namespace Tool
