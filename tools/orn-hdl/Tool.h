// What every command of the tool shares: exit statuses and messages.
#pragma once

#include <string_view>

namespace Tool {

/// How the tool ends. Of several failures the greatest status is the tool's.
enum class Status {
    Success = 0,
    /// A command failed, or the contents of a file are not what they have to be.
    Failed = 1,
    Usage = 2,
    /// A file could not be read or written.
    File = 3
};

inline Status Worse(Status a, Status b) noexcept {
    return a < b ? b : a;
}

/// Prints one line on standard error, as it is.
void PrintError(std::string_view line);
/// The same, said by the tool itself: "orn-hdl: TEXT".
void Complain(std::string_view text);
/// Complains that a file cannot be read or written, for the reason that `error` numbers.
Status ComplainUnreadable(std::string_view file, int error);
Status ComplainUnwritable(std::string_view file, int error);

/// Prints a text on standard output and complains when it does not arrive.
Status Print(std::string_view text);

/// The name under which the system opens a file that the user named: "-" is standard input.
const char* SystemFileName(const char* file) noexcept;

} // namespace Tool
