#include "Progress.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace Tool {

namespace {

constexpr std::chrono::milliseconds Patience(1000);
constexpr std::chrono::milliseconds Refresh(100);

/// The size of a file; 0 if it is unknown, as for a pipe.
std::uint64_t GetFileSize(const std::string& file) noexcept {
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(file, error);
    return error ? 0 : size;
}

} // namespace

Progress::Progress(bool quiet, const std::string& file)
    : Progress(!quiet && isatty(STDERR_FILENO) == 1 ? stderr : nullptr, file, &Clock::now) {}

Progress::Progress(std::FILE* terminal, const std::string& file,
                   std::function<Clock::time_point()> now)
    : terminal_(terminal), totalBytes_(terminal != nullptr ? GetFileSize(file) : 0),
      now_(std::move(now)), next_(now_() + Patience) {}

void Progress::Update(std::uint64_t lines, std::uint64_t bytes) {
    if (!IsDue()) {
        return;
    }
    std::string text = std::to_string(lines) + " lines";
    if (totalBytes_ > 0) {
        text += ", " + GetPercentage(bytes);
    }
    Show(text);
}

void Progress::Reading(std::uint64_t bytes, bool isUnpacked) {
    constexpr std::uint64_t Megabyte = 1000000;
    if (IsDue()) {
        Show("reading, " + (totalBytes_ > 0 && !isUnpacked
                                ? GetPercentage(bytes)
                                : std::to_string(bytes / Megabyte) + " MB"));
    }
}

void Progress::Making(std::string_view design) {
    if (IsDue()) {
        Show(std::string("making the design ").append(design));
    }
}

void Progress::Writing(std::string_view file) {
    if (IsDue()) {
        Show(std::string("writing ").append(file));
    }
}

std::string Progress::GetPercentage(std::uint64_t bytes) const {
    return std::to_string(std::min<std::uint64_t>(bytes * 100 / totalBytes_, 100)) + " %";
}

bool Progress::IsDue() {
    if (terminal_ == nullptr) {
        return false;
    }
    const Clock::time_point now = now_();
    if (now < next_) {
        return false;
    }
    next_ = now + Refresh;
    return true;
}

void Progress::Show(const std::string& text) {
    Erase();
    std::fprintf(terminal_, "orn-hdl: %s", text.c_str());
    std::fflush(terminal_);
    shown_ = true;
}

void Progress::Erase() {
    if (shown_) {
        std::fputs("\r\033[K", terminal_);
        shown_ = false;
    }
}

} // namespace Tool
