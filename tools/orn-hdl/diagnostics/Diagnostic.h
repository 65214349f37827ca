// Errors, warnings and notes, with their places.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace Tool {

enum class Severity { Note, Warning, Error };

/// The name of a severity: "note", "warning" or "error".
constexpr const char* GetSeverityName(Severity severity) noexcept {
    return severity == Severity::Error     ? "error"
           : severity == Severity::Warning ? "warning"
                                           : "note";
}

/// Bytes of a line, the first one counted as 0. None if `count` is 0.
struct Columns {
    std::size_t first = 0;
    std::size_t count = 0;
};

/// What a message is about.
struct Place {
    /// The file, as the user named it.
    std::string file;
    /// The line, the first one counted as 1; 0 if the message is about the whole file.
    std::uint64_t line = 0;
    /// The text of that line without its line end; empty if it is not known.
    std::string source;
    /// The part of the text that is marked.
    Columns columns;
    /// Whether `source` is the line to the byte. Otherwise it is only good enough to be shown, and
    /// its columns mean nothing to another program.
    bool isExact = true;
};

/// What a user may want to know besides the message.
struct Note {
    std::string text;
    /// Another place; without a line, the note is about the place of its diagnostic.
    Place place = {};
};

/// One error or warning.
struct Diagnostic {
    Severity severity = Severity::Error;
    /// The name of the rule that was broken, such as "pin-width"; empty for none.
    std::string rule;
    Place place;
    std::string message;
    std::vector<Note> notes;
};

} // namespace Tool
