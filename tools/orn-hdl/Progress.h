// The line on the terminal that shows how far a long replay has come.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

namespace Tool {

/// Shows lines and percent on standard error once the work has lasted a second, if that is a
/// terminal. What it shows is erased when it ends.
class Progress {
public:
    /// \param quiet shows nothing at all.
    /// \param file what is read; its size tells how far the work is.
    Progress(bool quiet, const std::string& file);
    ~Progress() { Erase(); }
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// Tells how far the work is. Looks at the clock: call it every some thousand lines.
    void Update(std::uint64_t lines, std::uint64_t bytes);
    /// Tells that a file is being written.
    void Writing(std::string_view file);
    /// Takes the line off the terminal, so that a message can be printed.
    void Erase();

private:
    using Clock = std::chrono::steady_clock;

    bool IsDue();
    void Show(const std::string& text);

    const bool enabled_;
    const std::uint64_t totalBytes_;
    bool shown_ = false;
    Clock::time_point next_;
};

} // namespace Tool
