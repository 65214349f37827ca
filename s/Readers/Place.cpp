#include "Readers/Place.h"

#include "Exception/Failure.h"
#include "Port/File.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstring>
#include <utility>

namespace Orn_Hdl::Readers {

namespace {

/// How much of a long line is shown on either side of the place.
constexpr std::size_t ShownBefore = 70;
constexpr std::size_t ShownBehind = 30;
constexpr std::size_t LongestShownName = 120;

/// Walks a file piece by piece: a line may be as long as the file.
class LineFinder {
public:
    explicit LineFinder(const std::string& fileName) {
        file_.open(fileName.c_str(), Port::File::Read, true);
    }

    /// Reads on behind the next so many line feeds. \return false when the file ends before.
    bool SkipLines(std::uint32_t count) {
        while (count > 0) {
            if (!Fill()) {
                return false;
            }
            const void* const found = std::memchr(piece_.data() + start_, '\n', end_ - start_);
            start_ =
                found == nullptr
                    ? end_
                    : static_cast<std::size_t>(static_cast<const char*>(found) + 1 - piece_.data());
            count -= found == nullptr ? 0 : 1;
        }
        return true;
    }

    void SkipCharacters(std::size_t count) {
        while (count > 0 && Fill()) {
            const std::size_t skipped = std::min(count, end_ - start_);
            start_ += skipped;
            count -= skipped;
        }
    }

    /// Up to so many characters, at most to the end of the line.
    std::string Take(std::size_t count) {
        std::string text;
        while (text.size() < count && Fill() && piece_[start_] != '\n') {
            text += piece_[start_++];
        }
        return text;
    }

private:
    bool Fill() {
        if (start_ == end_) {
            start_ = 0;
            end_ = file_.read(piece_.data(), piece_.size());
        }
        return start_ < end_;
    }

    Port::File file_;
    std::array<char, 16384> piece_;
    std::size_t start_ = 0;
    std::size_t end_ = 0;
};

void ReplaceControls(std::string& text) {
    std::replace_if(
        text.begin(), text.end(),
        [](char c) { return static_cast<unsigned char>(c) < ' ' || c == '\x7f'; }, ' ');
}

/// The line around a place and a caret below it; empty when the file cannot be read again.
std::string ShowLine(const std::string& fileName, const Place& place) {
    LineFinder finder(fileName);
    if (!finder.SkipLines(place.line - 1)) {
        return "";
    }
    const std::size_t column = place.column - 1;
    const std::size_t hidden = column > ShownBefore ? column - ShownBefore : 0;
    finder.SkipCharacters(hidden);
    std::string line = finder.Take(ShownBefore + ShownBehind);
    ReplaceControls(line);
    line.erase(line.find_last_not_of(' ') + 1);
    return line.append("\n").append(column - hidden, ' ').append("^\n");
}

} // namespace

std::uint32_t Files::Add(std::string name) {
    const auto found = std::find(names_.begin(), names_.end(), name);
    if (found != names_.end()) {
        return static_cast<std::uint32_t>(found - names_.begin());
    }
    names_.push_back(std::move(name));
    return static_cast<std::uint32_t>(names_.size() - 1);
}

std::string TextOf(const Files& files, const Place& place) {
    std::string text = files.GetName(place.file);
    if (place.line > 0) {
        text.append(":").append(std::to_string(place.line));
        text.append(":").append(std::to_string(place.column));
    }
    return text;
}

void FailAt(const Files& files, const Place& place, std::string_view text) {
    const std::string line =
        place.line == 0 ? std::string() : ShowLine(files.GetName(place.file), place);
    // A text may quote a character of the file, and a message with a NUL would end there.
    std::string printable(text);
    ReplaceControls(printable);
    Fail(ReaderUnit, __LINE__, "%s: error: %s\n%s", {TextOf(files, place), printable, line});
}

std::string Quoted(std::string_view name) {
    std::string text("\"");
    text.append(name.substr(0, LongestShownName));
    ReplaceControls(text);
    return text.append(name.size() > LongestShownName ? "...\"" : "\"");
}

} // namespace Orn_Hdl::Readers
