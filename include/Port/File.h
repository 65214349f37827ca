/// \file
/// Files: `Port::File` reads and writes one, `Port::Stream` gathers text for one in a large buffer,
/// `Port::FileName` takes file names apart. Nothing here throws for an input or output failure; the
/// first failure's system error number is kept and can be asked for.
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
    /// `Replace` is `Overwrite` that takes effect as a whole: what is written goes into a temporary
    /// file in the same folder, which `close` puts in the place of the named one when nothing has
    /// failed. Until then, and after any failure, the former file stands as it was; its permission
    /// bits are kept, and a symbolic link stays one; the file's other names, hard links, go on
    /// leading to the former file. Written directly, as by `Overwrite`, are devices, pipes and
    /// other files that are not regular, and a file that may be written in a folder that takes no
    /// new file.
    ///
    /// `Append` to a regular file ends as it began when anything fails: `close` and `Discard` then
    /// give the file its former length back. A file that was made to be appended to stays, empty.
    enum Mode { Read = 1, Overwrite = 2, Append = 6, Replace = 10 };

    /// No file is open.
    File() noexcept = default;
    /// Closes the file as `Discard` does.
    ~File();
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    /// Opens a file, closing the one that was open.
    /// \param name the file's name; null is read as "", the name of no file.
    /// \param fromStart for `Overwrite`: whether what the file holds is dropped first, or written
    ///        over from its first byte on. Of no meaning for the other modes.
    /// \return false when the file cannot be opened; a directory never can.
    bool open(const char* name, Mode mode, bool fromStart);
    /// Opens a file below a folder, closing the one that was open. No link is followed, neither on
    /// the way to the file nor by its own name, and nothing but a regular file is opened: no other
    /// process can make this write outside of the folder.
    /// \param folder only needed during the call.
    /// \param path the file's path below the folder, without "..".
    bool OpenBelow(const Folder& folder, const char* path, Mode mode, bool fromStart);
    /// Opens a file, as the overload with a `Mode` does.
    /// \param mode the value of a `Mode`: 1, 2, 6 or 10. With any other number no file is opened,
    ///        and the error is EINVAL.
    bool open(const char* name, int mode, bool fromStart);
    /// The modes of another class mean something else here.
    template <class Other, std::enable_if_t<std::is_enum_v<Other>, int> = 0>
    bool open(const char* name, Other mode, bool fromStart) = delete;
    /// \return false when anything has failed since `open`: what was written may be lost.
    bool close();
    /// Closes the file. What was written to replace a file is dropped, and so is what was appended
    /// when anything has failed since `open`; anything else stays.
    void Discard() noexcept;
    /// Whether a file is open.
    bool IsOpen() const noexcept { return descriptor_ >= 0; }

    /// Reads up to `size` bytes into a buffer that has room for them.
    /// \return their number; 0 at the end of the file, on a failure and when no file is open.
    std::size_t read(char* buffer, std::size_t size);
    /// Writes `size` bytes, all of them unless it fails.
    /// \return false on a failure and when no file is open.
    bool write(const char* data, std::size_t size);

    /// Reads the next line.
    /// \param line receives it without its line end, valid until the next call.
    /// \return false at the end of the file or on a failure.
    bool NextLine(std::string_view& line);
    /// How many bytes the last line given takes in the file, its line end included.
    std::size_t GetLineSize() const noexcept { return lineSize_; }

    /// The system's error number of the first failure since `open`; 0 when there was none.
    int GetError() const noexcept { return error_; }
    /// How many bytes were appended to the file that was closed last and stand there although
    /// appending has failed, since the file did not take its former length back; 0 otherwise.
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
    /// What was read behind the last line.
    std::string_view GetUnread() const noexcept {
        return std::string_view(lineBuffer_.get() + lineStart_, lineEnd_ - lineStart_);
    }
    std::string_view TakeLine(std::size_t length) noexcept;

    int descriptor_ = -1;
    /// Where names begin; closed for the current folder.
    Folder folder_;
    int error_ = 0;
    /// The file that is being written to replace another; empty when there is none.
    std::string temporary_;
    /// What it is to replace, or the file that is being appended to.
    std::string target_;
    /// Whether a regular file is being appended to; which one, and how long it was.
    bool appends_ = false;
    std::uint64_t device_ = 0;
    std::uint64_t inode_ = 0;
    std::uint64_t formerSize_ = 0;
    std::uint64_t written_ = 0;
    std::uint64_t leftover_ = 0;
    /// What was read and not given yet stands from `lineStart_` to `lineEnd_`.
    std::unique_ptr<char[]> lineBuffer_;
    std::size_t lineCapacity_ = 0;
    std::size_t lineStart_ = 0;
    std::size_t lineEnd_ = 0;
    std::size_t lineSize_ = 0;
    bool atEnd_ = false;
};

/// Collects text for a file and hands it over in large pieces.
class ORN_HDL_API Stream {
public:
    /// A stream with nothing in it yet. The buffer is taken here, not at each text.
    /// \param file an open file, not owned; it must outlive the stream.
    explicit Stream(File& file);
    /// Does not flush: who writes must `flush` and look at the result.
    ~Stream();
    Stream(const Stream&) = delete;
    Stream& operator=(const Stream&) = delete;

    /// Adds a text; null adds nothing.
    Stream& operator<<(TextView text);
    /// Hands everything over to the file.
    /// \return false when something could not be written, now or before.
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
