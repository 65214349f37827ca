#include "Port/File.h"

#include "Port/System.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <system_error>

namespace Port {

namespace {

constexpr std::size_t ReadSize = std::size_t(1) << 18;

int OpenFlags(File::Mode mode, bool fromStart) noexcept {
    switch (mode) {
    case File::Read:
        return O_RDONLY | O_CLOEXEC;
    case File::Overwrite:
        return O_WRONLY | O_CREAT | O_CLOEXEC | (fromStart ? O_TRUNC : 0);
    case File::Append:
        break;
    }
    return O_WRONLY | O_CREAT | O_CLOEXEC | O_APPEND;
}

bool IsDirectory(int descriptor) noexcept {
    struct stat status {};
    return fstat(descriptor, &status) == 0 && S_ISDIR(status.st_mode);
}

} // namespace

File::~File() {
    close();
}

bool File::Fail(int error) noexcept {
    if (error_ == 0) {
        error_ = error;
    }
    return false;
}

bool File::open(const char* name, Mode mode, bool fromStart) {
    close();
    error_ = 0;
    lineBuffer_.clear();
    lineStart_ = 0;
    atEnd_ = false;
    do {
        descriptor_ = System::Get().Open(name == nullptr ? "" : name, OpenFlags(mode, fromStart),
                                         0666);
    } while (descriptor_ < 0 && errno == EINTR);
    if (descriptor_ < 0) {
        return Fail(errno);
    }
    if (IsDirectory(descriptor_)) {
        close();
        return Fail(EISDIR);
    }
    return true;
}

bool File::close() {
    if (descriptor_ < 0) {
        return true;
    }
    const int result = System::Get().Close(descriptor_);
    descriptor_ = -1;
    // An interrupted close has closed the file all the same.
    return result == 0 || errno == EINTR || Fail(errno);
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
    }
    return true;
}

bool File::FillLineBuffer() {
    if (atEnd_) {
        return false;
    }
    // The rest of a line that the last piece cut moves to the front.
    lineBuffer_.erase(0, lineStart_);
    lineStart_ = 0;
    const std::size_t kept = lineBuffer_.size();
    lineBuffer_.resize(kept + std::max(ReadSize, kept));
    const std::size_t count = read(lineBuffer_.data() + kept, lineBuffer_.size() - kept);
    lineBuffer_.resize(kept + count);
    atEnd_ = count == 0;
    return !atEnd_;
}

bool File::NextLine(std::string_view& line) {
    std::size_t searched = lineStart_;
    std::size_t end = lineBuffer_.find('\n', searched);
    while (end == std::string::npos) {
        searched = lineBuffer_.size() - lineStart_;
        if (!FillLineBuffer()) {
            break;
        }
        end = lineBuffer_.find('\n', searched);
    }
    if (end == std::string::npos) {
        if (error_ != 0 || lineStart_ == lineBuffer_.size()) {
            return false;
        }
        end = lineBuffer_.size();
    }
    line = std::string_view(lineBuffer_).substr(lineStart_, end - lineStart_);
    lineStart_ = std::min(end + 1, lineBuffer_.size());
    if (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    return true;
}

Stream::Stream(File& file) : file_(file), buffer_(new char[BufferSize]) {}

Stream::~Stream() = default;

Stream& Stream::operator<<(std::string_view text) {
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
    // After a failure nothing more is sent: a file with a hole in it would be worse than a short one.
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
