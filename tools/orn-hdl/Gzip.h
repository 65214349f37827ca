// Files that are compressed: those whose names end in ".gz".
#pragma once

#include "Tool.h"

#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>

/// An open file of zlib.
struct gzFile_s; // NOLINT(readability-identifier-naming)

namespace Tool {

class TemporaryFile;

/// Whether a file of that name is compressed.
bool IsGzip(std::string_view file) noexcept;
/// The name without ".gz", which tells what is compressed.
std::string_view WithoutGzip(std::string_view file) noexcept;

/// A compressed file cannot be read.
class GzipError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Reads the contents of a compressed file piece by piece.
class GzipReader {
public:
    /// \throws GzipError if the file cannot be opened.
    explicit GzipReader(const std::string& file);
    GzipReader(const GzipReader&) = delete;
    GzipReader& operator=(const GzipReader&) = delete;
    ~GzipReader();

    /// Reads the next bytes, at most `count`. \return how many were read; 0 at the end.
    /// \throws GzipError if the file cannot be read, or is damaged.
    std::size_t Read(char* to, std::size_t count);

private:
    std::string file_;
    gzFile_s* input_ = nullptr;
};

/// Appends the contents of a compressed file to a text.
/// \throws GzipError if the file cannot be read, or is damaged.
void ReadGzip(const std::string& file, std::string& text);
/// The name under which the system opens the contents of a compressed file. They are unpacked once,
/// into a temporary file that lasts as long as the process.
/// \throws GzipError if the file cannot be read, or is damaged.
const char* UnpackGzip(const std::string& file);
/// Writes the contents of a temporary file into a compressed file, which is replaced as a whole.
/// Prints a message if that fails. The same contents give the same bytes.
Status WriteGzip(const TemporaryFile& contents, const std::string& file);

} // namespace Tool
