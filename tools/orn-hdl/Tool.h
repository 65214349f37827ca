// Exit statuses and messages, for all commands of the tool.
#pragma once

#include <string_view>

namespace Tool {

/// The exit status of the tool; after several failures, the greatest one.
enum class Status {
    Success = 0,
    /// A command failed, or the contents of a file are invalid.
    Failed = 1,
    Usage = 2,
    /// A file could not be read or written.
    File = 3,
    /// A netlist does not mean what its design does.
    Unproven = 4
};

inline Status Worse(Status a, Status b) noexcept {
    return a < b ? b : a;
}

/// Prints one line on standard error, unchanged.
void PrintError(std::string_view line);
/// Prints "orn-hdl: TEXT" on standard error.
void Complain(std::string_view text);
/// Reports that a file cannot be read. \param error the system's error number.
Status ComplainUnreadable(std::string_view file, int error);
/// Reports that a file cannot be written. \param error the system's error number.
Status ComplainUnwritable(std::string_view file, int error);

/// Prints a text on standard output, or a message if that fails.
Status Print(std::string_view text);

/// The name to open for an input file on the command line: "-" is standard input, and a compressed
/// file is unpacked.
/// \throws GzipError if a compressed file cannot be unpacked.
const char* SystemFileName(const char* file);

} // namespace Tool
