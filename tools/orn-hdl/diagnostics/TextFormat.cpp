#include "diagnostics/TextFormat.h"

#include "diagnostics/Utf8.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>
#include <unistd.h>

namespace Tool {

using std::string_view;

namespace {

/// A longer line is shown in part.
constexpr std::size_t WidestLine = 160;
/// How much of a long line is shown before the marked part.
constexpr std::size_t Lead = 40;
constexpr string_view Ellipsis = "...";

constexpr string_view Bold = "\033[1m";
constexpr string_view Plain = "\033[0m";
constexpr string_view Green = "\033[1;32m";

string_view GetColor(Severity severity) {
    return severity == Severity::Error     ? "\033[1;31m"
           : severity == Severity::Warning ? "\033[1;35m"
                                           : "\033[1;36m";
}

/// Text with colours, or without any.
class Painter {
public:
    explicit Painter(bool useColor) : useColor_(useColor) {}

    Painter& Add(string_view text) {
        text_.append(text);
        return *this;
    }
    Painter& Add(string_view text, string_view color) {
        return useColor_ && !text.empty() ? Add(color).Add(text).Add(Plain) : Add(text);
    }
    std::string Take() { return std::move(text_); }

private:
    const bool useColor_;
    std::string text_;
};

/// A part of a line that fits on a screen.
struct Excerpt {
    std::string text;
    Columns columns;
};

/// The first byte of the character that a byte of the line belongs to.
std::size_t GetCharacterStart(string_view line, std::size_t at) {
    constexpr std::size_t LongestCharacter = 4;
    for (std::size_t back = 1; back < LongestCharacter && back <= at; ++back) {
        if (at - back + GetCharacterSize(line.substr(at - back)) > at) {
            return at - back;
        }
    }
    return at;
}

/// Characters that would move the cursor become visible ones of width 1.
void MakePrintable(std::string& text) {
    for (char& c : text) {
        const auto byte = static_cast<unsigned char>(c);
        c = c == '\t' ? ' ' : byte < ' ' || byte == 0x7F ? '?' : c;
    }
}

Excerpt CutOut(string_view line, Columns columns) {
    columns.first =
        columns.first < line.size() ? GetCharacterStart(line, columns.first) : line.size();
    std::size_t start = 0;
    std::size_t end = line.size();
    if (line.size() > WidestLine) {
        start = columns.first > Lead ? GetCharacterStart(line, columns.first - Lead) : 0;
        end = std::min(line.size(), start + WidestLine);
        end = end < line.size() ? GetCharacterStart(line, end) : end;
    }
    Excerpt excerpt;
    excerpt.text = start > 0 ? Ellipsis : string_view();
    excerpt.columns.first = columns.first - start + excerpt.text.size();
    // A mark behind the last character stands for something that is missing.
    excerpt.columns.count =
        std::min(columns.count, std::max<std::size_t>(end, columns.first + 1) - columns.first);
    excerpt.text.append(line.substr(start, end - start));
    excerpt.text.append(end < line.size() ? Ellipsis : string_view());
    MakePrintable(excerpt.text);
    return excerpt;
}

/// The source line behind its number, and the mark below.
void AddSource(const Place& place, Painter& painter) {
    if (place.line == 0 || place.source.empty()) {
        return;
    }
    constexpr std::size_t NumberWidth = 5;
    const Excerpt excerpt = CutOut(place.source, place.columns);
    std::string number = std::to_string(place.line);
    number.insert(0, NumberWidth - std::min(NumberWidth, number.size()), ' ');
    painter.Add(number).Add(" | ").Add(excerpt.text).Add("\n");
    if (excerpt.columns.count == 0) {
        return;
    }
    const string_view text = excerpt.text;
    const std::size_t width =
        CountCharacters(text.substr(excerpt.columns.first, excerpt.columns.count));
    painter.Add(std::string(number.size(), ' ')).Add(" | ");
    painter.Add(std::string(CountCharacters(text.substr(0, excerpt.columns.first)), ' '));
    painter.Add("^" + std::string(std::max<std::size_t>(width, 1) - 1, '~'), Green).Add("\n");
}

void AddHead(const Place& place, Severity severity, Painter& painter) {
    std::string head = place.file + ":";
    if (place.line != 0) {
        head.append(std::to_string(place.line)).append(":");
    }
    painter.Add(head, Bold).Add(" ");
    painter.Add(std::string(GetSeverityName(severity)) + ":", GetColor(severity)).Add(" ");
}

void AddNote(const Note& note, Painter& painter) {
    if (note.place.line != 0) {
        AddHead(note.place, Severity::Note, painter);
    } else {
        painter.Add("note:", GetColor(Severity::Note)).Add(" ");
    }
    painter.Add(note.text).Add("\n");
    AddSource(note.place, painter);
}

std::string Count(std::uint64_t number, string_view what) {
    return std::to_string(number).append(" ").append(what).append(number == 1 ? "" : "s");
}

} // namespace

bool UsesColor(ColorChoice choice, std::FILE* file) {
    if (choice != ColorChoice::Auto) {
        return choice == ColorChoice::Always;
    }
    const char* const noColor = std::getenv("NO_COLOR");
    const char* const terminal = std::getenv("TERM");
    return (noColor == nullptr || *noColor == '\0') &&
           (terminal == nullptr || string_view(terminal) != "dumb") && isatty(fileno(file)) == 1;
}

std::string FormatText(const Diagnostic& diagnostic, bool useColor) {
    Painter painter(useColor);
    AddHead(diagnostic.place, diagnostic.severity, painter);
    painter.Add(diagnostic.message, Bold);
    if (!diagnostic.rule.empty()) {
        painter.Add(" [").Add(diagnostic.rule, GetColor(diagnostic.severity)).Add("]");
    }
    painter.Add("\n");
    AddSource(diagnostic.place, painter);
    for (const Note& note : diagnostic.notes) {
        AddNote(note, painter);
    }
    return painter.Take();
}

std::string FormatCounts(std::uint64_t errors, std::uint64_t warnings) {
    std::string text;
    if (errors != 0 || warnings == 0) {
        text = Count(errors, "error");
    }
    if (warnings != 0) {
        text.append(text.empty() ? "" : ", ").append(Count(warnings, "warning"));
    }
    return text;
}

} // namespace Tool
