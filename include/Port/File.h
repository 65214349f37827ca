/// \file
/// Files: `Port::File` reads and writes one, `Port::Stream` buffers text for one, `Port::FileName`
/// splits file names. A failure of input or output throws nothing; the system's error number of the
/// first failure is kept.
#pragma once

#include "Port/Export.h"
#include "Port/Folder.h"
#include "Port/String.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <type_traits>

namespace Port {

/// One open file, or none. Closed by its destructor.
class ORN_HDL_API File {
public:
    /// `Replace` overwrites a file as a whole: the text is written to a temporary file in the same
    /// folder, which replaces the named file in `close` if nothing has failed. Until then, and
    /// after any failure, the former file is unchanged. Permission bits are kept, and a symbolic
    /// link stays one; other hard links keep the former file. Devices, pipes and other files that
    /// are not regular are written directly, as by `Overwrite`, and so is a writable file in a
    /// folder in which no file can be created.
    ///
    /// `Append` to a regular file has no effect if anything fails: `close` and `Discard` then
    /// restore its former length. A file that was created for appending stays, empty.
    enum Mode { Read = 1, Overwrite = 2, Append = 6, Replace = 10 };

    /// No file is open.
    File() noexcept = default;
    /// Closes the file like `Discard`.
    ~File();
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    /// Opens a file, closing the one that was open.
    /// \param name the file's name; null is read as "", which opens none.
    /// \param fromStart for `Overwrite`: whether the contents are dropped first or overwritten from
    ///        the first byte on. It has no meaning for other modes.
    /// \return false if the file cannot be opened; a directory never can.
    bool open(const char* name, Mode mode, bool fromStart);
    /// Opens a file below a folder, closing the one that was open. No link is followed, and only a
    /// regular file is opened, so no other process can make this write outside the folder.
    /// \param folder needed only during the call.
    /// \param path the file's path below the folder, without "..".
    bool OpenBelow(const Folder& folder, const char* path, Mode mode, bool fromStart);
    /// Opens a file like the overload with a `Mode`.
    /// \param mode the value of a `Mode`: 1, 2, 6 or 10. For any other number no file is opened,
    ///        and the error is EINVAL.
    bool open(const char* name, int mode, bool fromStart);
    /// Rejects the modes of other classes, whose values differ.
    template <class Other, std::enable_if_t<std::is_enum_v<Other>, int> = 0>
    bool open(const char* name, Other mode, bool fromStart) = delete;
    /// Closes the file.
    /// \return false if anything has failed since `open`: written text may be lost.
    bool close();
    /// Closes the file. Text written to replace a file is dropped, and so is appended text if
    /// anything has failed since `open`; any other text stays.
    void Discard() noexcept;
    /// Whether a file is open.
    bool IsOpen() const noexcept { return descriptor_ >= 0; }

    /// The name under which the temporary file that is to replace another can be opened; empty if
    /// there is none.
    std::string GetTemporaryName() const;

    /// Reads up to `size` bytes into a buffer that has room for them.
    /// \return their number; 0 at the end of the file, on a failure and when no file is open.
    std::size_t read(char* buffer, std::size_t size);
    /// Writes `size` bytes, all of them unless it fails.
    /// \return false on a failure and when no file is open.
    bool write(const char* data, std::size_t size);

    /// Reads the next line.
    /// \param line receives the line without its line end, valid until the next call.
    /// \return false at the end of the file or on a failure.
    bool NextLine(std::string_view& line);
    /// The number of bytes of the last line in the file, including its line end.
    std::size_t GetLineSize() const noexcept { return lineSize_; }

    /// The system's error number of the first failure since `open`; 0 if there was none.
    int GetError() const noexcept { return error_; }
    /// The number of bytes left at the end of the file that was closed last, if appending failed
    /// and its former length could not be restored; 0 otherwise.
    std::uint64_t GetLeftoverSize() const noexcept { return leftover_; }

private:
    friend class LinesAtHand;

    bool Fail(int error) noexcept;
    bool OpenDescriptor(const char* name, int flags, unsigned mode);
    bool OpenNamed(const char* name, Mode mode, bool fromStart);
    int OpenInFolder(const char* name, int flags, unsigned mode) const;
    int RenameTemporary() const;
    void UnlinkTemporary() const;
    void CloseDescriptor() noexcept;
    bool OpenToReplace(const char* name);
    int OpenTemporary(unsigned mode);
    bool OpenTarget();
    bool CutAppended() noexcept;
    void CloseAppended() noexcept;
    bool FillLineBuffer();
    /// The text behind the last line that was read from the file already.
    std::string_view GetUnread() const noexcept {
        return std::string_view(lineBuffer_.get() + lineStart_, lineEnd_ - lineStart_);
    }
    std::string_view TakeLine(std::size_t length) noexcept;

    int descriptor_ = -1;
    /// The folder to which names are relative; closed for the current folder.
    Folder folder_;
    int error_ = 0;
    /// The file that is being written to replace another; empty if there is none.
    std::string temporary_;
    /// The file to replace, or to append to.
    std::string target_;
    /// Whether a regular file is being appended to; its identity and former length.
    bool appends_ = false;
    std::uint64_t device_ = 0;
    std::uint64_t inode_ = 0;
    std::uint64_t formerSize_ = 0;
    std::uint64_t written_ = 0;
    std::uint64_t leftover_ = 0;
    /// Text that was read but not returned yet is between `lineStart_` and `lineEnd_`.
    std::unique_ptr<char[]> lineBuffer_;
    std::size_t lineCapacity_ = 0;
    std::size_t lineStart_ = 0;
    std::size_t lineEnd_ = 0;
    std::size_t lineSize_ = 0;
    bool atEnd_ = false;
    /// Whether a regular file is open: reading it never waits for another process.
    bool isRegular_ = false;
};

/// Buffers text for a file.
class ORN_HDL_API Stream {
public:
    /// An empty stream, which allocates its buffer at once.
    /// \param file an open file, not owned; it must outlive the stream.
    explicit Stream(File& file);
    /// Does not flush: call `flush` and check its result.
    ~Stream();
    Stream(const Stream&) = delete;
    Stream& operator=(const Stream&) = delete;

    /// Adds a text; null adds nothing.
    Stream& operator<<(TextView text);
    /// Writes the buffered text to the file.
    /// \return false if this or an earlier write failed.
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
    /// The parts of a copy of `name`; null is read as "".
    explicit FileName(TextView name) : name_(name.GetView()) {}
    /// The part behind the last "/".
    String GetTail() const;
    /// The tail without its extension, which begins at the last "." unless that is the first
    /// character.
    String GetStem() const;

private:
    String name_;
};

/// The system's text for an error number.
ORN_HDL_API String ErrorText(int error);

} // namespace Port
