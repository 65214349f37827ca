/// \file
/// Files: `Port::File` reads and writes one, `Port::Stream` gathers text for one in a large buffer,
/// `Port::FileName` takes file names apart. Nothing here throws for an input or output failure; the
/// first failure's system error number is kept and can be asked for.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace Port {

/// One open file, or none. Closed by its destructor.
class ORN_HDL_API File {
public:
    enum Mode { Read = 1, Overwrite = 2, Append = 6 };

    File() noexcept = default;
    ~File();
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    /// Opens a file, closing the one that was open.
    /// \param fromStart reading and overwriting begin at the first byte, appending (false) at the end.
    /// \return false when the file cannot be opened; a directory never can.
    bool open(const char* name, Mode mode, bool fromStart);
    /// \return false when the system reports that what was written is lost.
    bool close();
    bool IsOpen() const noexcept { return descriptor_ >= 0; }

    /// Reads up to `size` bytes. \return their number, 0 at the end of the file or on a failure.
    std::size_t read(char* buffer, std::size_t size);
    /// Writes all bytes. \return false on a failure.
    bool write(const char* data, std::size_t size);

    /// Reads the next line. \param line receives it without its line end, valid until the next call.
    /// \return false at the end of the file or on a failure.
    bool NextLine(std::string_view& line);

    /// The system's error number of the first failure since `open`; 0 when there was none.
    int GetError() const noexcept { return error_; }

private:
    bool Fail(int error) noexcept;
    bool FillLineBuffer();

    int descriptor_ = -1;
    int error_ = 0;
    std::string lineBuffer_;
    std::size_t lineStart_ = 0;
    bool atEnd_ = false;
};

/// Collects text for a file and hands it over in large pieces.
class ORN_HDL_API Stream {
public:
    /// \param file an open file, not owned; it must outlive the stream.
    explicit Stream(File& file);
    /// Does not flush: who writes must `flush` and look at the result.
    ~Stream();
    Stream(const Stream&) = delete;
    Stream& operator=(const Stream&) = delete;

    Stream& operator<<(std::string_view text);
    /// \return false when something could not be written.
    bool flush();

private:
    static constexpr std::size_t BufferSize = std::size_t(1) << 18;

    File& file_;
    std::unique_ptr<char[]> buffer_;
    std::size_t used_ = 0;
    bool good_ = true;
};

/// The parts of a file name.
class ORN_HDL_API FileName {
public:
    explicit FileName(const char* name) : name_(name) {}
    /// What follows the last "/".
    String GetTail() const;
    /// The tail without its extension (the last "." and what follows, unless the "." comes first).
    String GetStem() const;

private:
    String name_;
};

/// The system's text for an error number.
ORN_HDL_API String ErrorText(int error);

} // namespace Port
