#include "MemoryFiles.h"

#include <cerrno>
#include <fcntl.h>

namespace Fuzz {

namespace {

int FailWith(int error) {
    errno = error;
    return -1;
}

} // namespace

int MemoryFiles::Open(const char* name, int flags, unsigned /*mode*/) {
    const bool exists = files_.count(name) != 0;
    if (exists && (flags & O_EXCL) != 0) {
        return FailWith(EEXIST);
    }
    if (*name == '\0' || (!exists && (flags & O_CREAT) == 0)) {
        return FailWith(ENOENT);
    }
    std::string& text = files_[name];
    if ((flags & O_TRUNC) != 0) {
        text.clear();
    }
    open_[++last_] = name;
    return last_;
}

ssize_t MemoryFiles::Read(int /*descriptor*/, void* /*buffer*/, std::size_t /*size*/) {
    return FailWith(EIO);
}

ssize_t MemoryFiles::Write(int descriptor, const void* data, std::size_t size) {
    files_[open_.at(descriptor)].append(static_cast<const char*>(data), size);
    return static_cast<ssize_t>(size);
}

int MemoryFiles::Close(int descriptor) {
    return open_.erase(descriptor) == 1 ? 0 : FailWith(EBADF);
}

int MemoryFiles::GetStatus(int /*descriptor*/, struct stat* status) {
    status->st_mode = S_IFREG | 0644;
    return 0;
}

int MemoryFiles::Truncate(int descriptor, off_t size) {
    files_[open_.at(descriptor)].resize(static_cast<std::size_t>(size));
    return 0;
}

int MemoryFiles::ChangeMode(int /*descriptor*/, unsigned /*mode*/) {
    return 0;
}

ssize_t MemoryFiles::ReadLink(const char* name, char* /*target*/, std::size_t /*size*/) {
    return FailWith(files_.count(name) != 0 ? EINVAL : ENOENT);
}

int MemoryFiles::Rename(const char* from, const char* to) {
    if (*to == '\0' || files_.count(from) == 0) {
        return FailWith(ENOENT);
    }
    auto file = files_.extract(from);
    file.key() = to;
    files_.erase(to);
    files_.insert(std::move(file));
    return 0;
}

int MemoryFiles::Unlink(const char* name) {
    return files_.erase(name) == 1 ? 0 : FailWith(ENOENT);
}

} // namespace Fuzz
