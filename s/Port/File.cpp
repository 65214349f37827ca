#include "Port/File.h"

#include "Port/System.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <climits>
#include <cstring>
#include <fcntl.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace Port {

namespace {

constexpr std::size_t ReadSize = std::size_t(1) << 18;
constexpr unsigned DefaultPermissions = 0666;
constexpr unsigned PermissionBits = 07777;
constexpr int MostLinks = 40;

int OpenFlags(File::Mode mode, bool fromStart) noexcept {
    switch (mode) {
    case File::Read:
        return O_RDONLY;
    case File::Overwrite:
    case File::Replace:
        return O_WRONLY | O_CREAT | (fromStart ? O_TRUNC : 0);
    case File::Append:
        break;
    }
    return O_WRONLY | O_CREAT | O_APPEND;
}

/// The folder of a file, with its closing "/"; empty for the current folder.
std::string FolderOf(const std::string& name) {
    return name.substr(0, name.rfind('/') + 1);
}

/// Whether a name is in one of the system's own file systems. Such names refer to open files and
/// devices, which cannot be replaced.
bool IsServedBySystem(std::string_view name) noexcept {
    constexpr std::string_view Devices = "/dev/";
    constexpr std::string_view Processes = "/proc/";
    return name.substr(0, Devices.size()) == Devices ||
           name.substr(0, Processes.size()) == Processes;
}

/// Replaces a name by the target of its chain of symbolic links, which need not exist.
/// \return false, with errno set, if a link cannot be read.
bool FollowLinks(std::string& name) {
    char link[PATH_MAX];
    for (int i = 0; i < MostLinks && !IsServedBySystem(name); ++i) {
        const ssize_t length = System::Get().ReadLink(name.c_str(), link, sizeof link);
        if (length < 0) {
            // The name is not a link, or does not exist.
            return errno == EINVAL || errno == ENOENT;
        }
        const std::string_view next(link, static_cast<std::size_t>(length));
        name = next.substr(0, 1) == "/" ? std::string(next) : FolderOf(name).append(next);
    }
    return true;
}

/// Whether an error means that no file can be created in a folder, although files in it may be
/// writable.
bool IsRefusal(int error) noexcept {
    return error == EACCES || error == EPERM || error == EROFS;
}

/// A name that no other file of this process has. It is short, because the name of the target may
/// have the maximum length.
std::string TemporaryName(const std::string& folder) {
    static std::atomic<unsigned> count{0};
    return folder + ".orn_hdl_" + std::to_string(getpid()) + "_" + std::to_string(++count);
}

} // namespace

File::~File() {
    Discard();
}

bool File::Fail(int error) noexcept {
    if (error_ == 0) {
        error_ = error;
    }
    return false;
}

bool File::OpenDescriptor(const char* name, int flags, unsigned mode) {
    do {
        descriptor_ = folder_.IsOpen() ? OpenInFolder(name, flags | O_CLOEXEC, mode)
                                       : System::Get().Open(name, flags | O_CLOEXEC, mode);
    } while (descriptor_ < 0 && errno == EINTR);
    return descriptor_ >= 0;
}

void File::CloseDescriptor() noexcept {
    const int result = System::Get().Close(descriptor_);
    descriptor_ = -1;
    // An interrupted close has closed the file nevertheless.
    if (result != 0 && errno != EINTR) {
        Fail(errno);
    }
}

bool File::open(const char* name, Mode mode, bool fromStart) {
    close();
    folder_.Close();
    return OpenNamed(name, mode, fromStart);
}

bool File::OpenBelow(const Folder& folder, const char* path, Mode mode, bool fromStart) {
    close();
    error_ = 0;
    const char* name = nullptr;
    if (const int error = folder.OpenParent(path, folder_, name); error != 0) {
        folder_.Close();
        return Fail(error);
    }
    if (!OpenNamed(name, mode, fromStart)) {
        folder_.Close();
        return false;
    }
    return true;
}

/// Opens a name in the open folder. \return the descriptor, or -1 with errno set.
int File::OpenInFolder(const char* name, int flags, unsigned mode) const {
    // Without O_NONBLOCK, opening a pipe would block until its other end is opened.
    const int opened =
        System::Get().OpenAt(folder_.GetDescriptor(), name, flags | O_NOFOLLOW | O_NONBLOCK, mode);
    // A file that the call has created is a regular one.
    if (opened < 0 || (flags & O_EXCL) != 0) {
        return opened;
    }
    struct stat status {};
    const int error = System::Get().GetStatus(opened, &status) != 0 ? errno
                      : S_ISREG(status.st_mode)                     ? 0
                                                                    : EINVAL;
    if (error == 0) {
        return opened;
    }
    System::Get().Close(opened);
    errno = error;
    return -1;
}

int File::RenameTemporary() const {
    return folder_.IsOpen() ? System::Get().RenameAt(folder_.GetDescriptor(), temporary_.c_str(),
                                                     target_.c_str())
                            : System::Get().Rename(temporary_.c_str(), target_.c_str());
}

void File::UnlinkTemporary() const {
    if (folder_.IsOpen()) {
        System::Get().UnlinkAt(folder_.GetDescriptor(), temporary_.c_str());
    } else {
        System::Get().Unlink(temporary_.c_str());
    }
}

bool File::OpenNamed(const char* name, Mode mode, bool fromStart) {
    error_ = 0;
    lineStart_ = 0;
    lineEnd_ = 0;
    lineSize_ = 0;
    atEnd_ = false;
    isRegular_ = false;
    appends_ = false;
    written_ = 0;
    leftover_ = 0;
    name = name == nullptr ? "" : name;
    if (mode == Replace) {
        return OpenToReplace(name);
    }
    if (mode == Append) {
        target_ = name;
    }
    if (!OpenDescriptor(name, OpenFlags(mode, fromStart), DefaultPermissions)) {
        return Fail(errno);
    }
    struct stat status {};
    const bool isKnown = System::Get().GetStatus(descriptor_, &status) == 0;
    if (isKnown && S_ISDIR(status.st_mode)) {
        Fail(EISDIR);
        Discard();
        return false;
    }
    isRegular_ = isKnown && S_ISREG(status.st_mode);
    if (mode == Append && (!isKnown || isRegular_)) {
        // If the status is unknown, the inode is zero, which no file has.
        appends_ = true;
        device_ = static_cast<std::uint64_t>(status.st_dev);
        inode_ = static_cast<std::uint64_t>(status.st_ino);
        formerSize_ = static_cast<std::uint64_t>(status.st_size);
    }
    return true;
}

/// Restores the former length of the file, unless another process has appended to it, too.
bool File::CutAppended() noexcept {
    struct stat status {};
    if (System::Get().GetStatus(descriptor_, &status) != 0 || device_ != status.st_dev ||
        inode_ != status.st_ino) {
        return false;
    }
    const auto size = static_cast<std::uint64_t>(status.st_size);
    return size <= formerSize_ ||
           (size - formerSize_ <= written_ &&
            System::Get().Truncate(descriptor_, static_cast<off_t>(formerSize_)) == 0);
}

void File::CloseAppended() noexcept {
    const bool hasFailed = error_ != 0;
    bool endsAsItBegan = !hasFailed || written_ == 0 || CutAppended();
    CloseDescriptor();
    if (!hasFailed && error_ != 0 && written_ > 0) {
        // Closing has reported the failure, so the file is opened again, without blocking if the
        // name now refers to a pipe.
        endsAsItBegan = OpenDescriptor(target_.c_str(), O_WRONLY | O_NONBLOCK, 0) && CutAppended();
        if (IsOpen()) {
            CloseDescriptor();
        }
    }
    leftover_ = endsAsItBegan ? 0 : written_;
    appends_ = false;
}

bool File::open(const char* name, int mode, bool fromStart) {
    switch (mode) {
    case Read:
    case Overwrite:
    case Append:
    case Replace:
        return open(name, static_cast<Mode>(mode), fromStart);
    default:
        close();
        error_ = EINVAL;
        return false;
    }
}

bool File::OpenToReplace(const char* name) {
    std::string target(name);
    if (!folder_.IsOpen() && !FollowLinks(target)) {
        return Fail(errno);
    }
    if (IsServedBySystem(target)) {
        return open(name, Overwrite, true);
    }
    // Opened without a change, to find out whether the file can be written and what kind it is.
    if (!OpenDescriptor(target.c_str(), O_WRONLY, 0)) {
        if (errno != ENOENT || target.empty()) {
            return Fail(errno);
        }
        target_ = std::move(target);
        const int error = OpenTemporary(DefaultPermissions);
        return error == 0 || Fail(error);
    }
    struct stat status {};
    if (System::Get().GetStatus(descriptor_, &status) != 0) {
        Fail(errno);
        Discard();
        return false;
    }
    if (!S_ISREG(status.st_mode)) {
        return true;
    }
    CloseDescriptor();
    target_ = std::move(target);
    const unsigned permissions = status.st_mode & PermissionBits;
    if (const int error = OpenTemporary(permissions); error != 0) {
        return IsRefusal(error) ? OpenTarget() : Fail(error);
    }
    if (System::Get().ChangeMode(descriptor_, permissions) != 0) {
        Fail(errno);
        Discard();
        return false;
    }
    return true;
}

/// \return 0, or the system's error number if the file cannot be created.
int File::OpenTemporary(unsigned mode) {
    const std::string folder = FolderOf(target_);
    std::string name;
    do {
        name = TemporaryName(folder);
    } while (!OpenDescriptor(name.c_str(), O_WRONLY | O_CREAT | O_EXCL, mode) && errno == EEXIST);
    if (!IsOpen()) {
        return errno;
    }
    temporary_ = std::move(name);
    return 0;
}

std::string File::GetTemporaryName() const {
    if (temporary_.empty() || !folder_.IsOpen()) {
        return temporary_;
    }
    // A name below the folder says nothing when the folder was moved.
    return "/dev/fd/" + std::to_string(descriptor_);
}

bool File::OpenTarget() {
    return OpenDescriptor(target_.c_str(), O_WRONLY | O_TRUNC, 0) || Fail(errno);
}

bool File::close() {
    if (!IsOpen()) {
        return true;
    }
    if (appends_) {
        CloseAppended();
    } else {
        CloseDescriptor();
    }
    if (!temporary_.empty() && error_ == 0) {
        if (RenameTemporary() == 0) {
            temporary_.clear();
        } else {
            Fail(errno);
        }
    }
    Discard();
    return error_ == 0;
}

void File::Discard() noexcept {
    if (IsOpen() && appends_) {
        CloseAppended();
    } else if (IsOpen()) {
        CloseDescriptor();
    }
    if (!temporary_.empty()) {
        UnlinkTemporary();
        temporary_.clear();
    }
    folder_.Close();
}

std::size_t File::read(char* buffer, std::size_t size) {
    if (descriptor_ < 0) {
        return 0;
    }
    ssize_t count = 0;
    do {
        count = System::Get().Read(descriptor_, buffer, size);
    } while (count < 0 && errno == EINTR);
    if (count < 0) {
        Fail(errno);
        return 0;
    }
    return static_cast<std::size_t>(count);
}

bool File::write(const char* data, std::size_t size) {
    if (descriptor_ < 0) {
        return false;
    }
    while (size > 0) {
        const ssize_t count = System::Get().Write(descriptor_, data, size);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return Fail(count < 0 ? errno : EIO);
        }
        data += count;
        size -= static_cast<std::size_t>(count);
        written_ += static_cast<std::uint64_t>(count);
    }
    return true;
}

bool File::FillLineBuffer() {
    if (atEnd_) {
        return false;
    }
    // The beginning of an incomplete line moves to the front.
    const std::string_view rest = GetUnread();
    if (rest.size() + ReadSize > lineCapacity_) {
        const std::size_t capacity = rest.size() + std::max(ReadSize, rest.size());
        std::unique_ptr<char[]> larger(new char[capacity]);
        std::copy(rest.begin(), rest.end(), larger.get());
        lineBuffer_ = std::move(larger);
        lineCapacity_ = capacity;
    } else {
        std::copy(rest.begin(), rest.end(), lineBuffer_.get());
    }
    lineStart_ = 0;
    lineEnd_ = rest.size();
    const std::size_t count = read(lineBuffer_.get() + lineEnd_, lineCapacity_ - lineEnd_);
    lineEnd_ += count;
    atEnd_ = count == 0;
    return !atEnd_;
}

bool File::NextLine(std::string_view& line) {
    std::size_t length = GetUnread().find('\n');
    while (length == std::string_view::npos) {
        const std::size_t searched = GetUnread().size();
        if (!FillLineBuffer()) {
            break;
        }
        length = GetUnread().find('\n', searched);
    }
    if (length == std::string_view::npos) {
        if (error_ != 0 || GetUnread().empty()) {
            return false;
        }
        length = GetUnread().size();
    }
    line = TakeLine(length);
    return true;
}

std::string_view File::TakeLine(std::size_t length) noexcept {
    std::string_view line = GetUnread().substr(0, length);
    lineSize_ = std::min(length + 1, GetUnread().size());
    lineStart_ += lineSize_;
    if (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    return line;
}

Stream::Stream(File& file) : file_(file), buffer_(new char[BufferSize]) {}

Stream::~Stream() = default;

Stream& Stream::operator<<(TextView added) {
    std::string_view text = added;
    while (!text.empty()) {
        if (used_ == BufferSize) {
            flush();
        }
        const std::size_t count = std::min(text.size(), BufferSize - used_);
        std::memcpy(buffer_.get() + used_, text.data(), count);
        used_ += count;
        text.remove_prefix(count);
    }
    return *this;
}

bool Stream::flush() {
    // After a failure nothing more is written: a file with a gap would be worse than a short one.
    good_ = good_ && (used_ == 0 || file_.write(buffer_.get(), used_));
    used_ = 0;
    return good_;
}

String FileName::GetTail() const {
    const std::string_view name = name_.GetView();
    const std::size_t slash = name.rfind('/');
    return slash == std::string_view::npos ? name : name.substr(slash + 1);
}

String FileName::GetStem() const {
    const String tail = GetTail();
    const std::size_t dot = tail.GetView().rfind('.');
    return dot == 0 ? tail.GetView() : tail.GetView().substr(0, dot);
}

String ErrorText(int error) {
    return std::generic_category().message(error);
}

} // namespace Port
