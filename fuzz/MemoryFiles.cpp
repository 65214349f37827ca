#include "MemoryFiles.h"

#include "Check.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>

namespace Fuzz {

namespace {

int FailWith(int error) {
    errno = error;
    return -1;
}

} // namespace

const std::string* MemoryFiles::Find(std::string_view name) const noexcept {
    const std::size_t place = PlaceOf(name);
    return place == None ? nullptr : &files_[place].text;
}

std::size_t MemoryFiles::CountNames() const noexcept {
    return static_cast<std::size_t>(std::count_if(files_.begin(), files_.end(),
                                                  [](const File& file) { return file.isLinked; }));
}

void MemoryFiles::Put(std::string_view name, std::string_view text) {
    const std::size_t place = PlaceOf(name);
    files_[place == None ? Create(name) : place].text = text;
}

std::size_t MemoryFiles::PlaceOf(std::string_view name) const noexcept {
    for (std::size_t place = 0; place < files_.size(); ++place) {
        if (files_[place].isLinked && files_[place].name == name) {
            return place;
        }
    }
    return None;
}

std::size_t MemoryFiles::Create(std::string_view name) {
    files_.push_back({std::string(name), std::string(), true});
    return files_.size() - 1;
}

std::size_t& MemoryFiles::GetOpen(int descriptor) {
    const auto index = static_cast<std::size_t>(descriptor) - 1;
    Check(index < descriptors_.size() && descriptors_[index] != None,
          "a descriptor that is used is open");
    return descriptors_[index];
}

int MemoryFiles::Open(const char* name, int flags, unsigned /*mode*/) {
    std::size_t place = PlaceOf(name);
    if (place != None && (flags & O_EXCL) != 0) {
        return FailWith(EEXIST);
    }
    if (*name == '\0' || (place == None && (flags & O_CREAT) == 0)) {
        return FailWith(ENOENT);
    }
    place = place == None ? Create(name) : place;
    if ((flags & O_TRUNC) != 0) {
        files_[place].text.clear();
    }
    descriptors_.push_back(place);
    offsets_.push_back(0);
    ++openCount_;
    return static_cast<int>(descriptors_.size());
}

ssize_t MemoryFiles::Read(int descriptor, void* buffer, std::size_t size) {
    const std::string& text = files_[GetOpen(descriptor)].text;
    std::size_t& offset = offsets_[static_cast<std::size_t>(descriptor) - 1];
    const std::size_t count = std::min(size, text.size() - std::min(offset, text.size()));
    std::copy_n(text.data() + std::min(offset, text.size()), count, static_cast<char*>(buffer));
    offset += count;
    return static_cast<ssize_t>(count);
}

ssize_t MemoryFiles::Write(int descriptor, const void* data, std::size_t size) {
    files_[GetOpen(descriptor)].text.append(static_cast<const char*>(data), size);
    return static_cast<ssize_t>(size);
}

int MemoryFiles::Close(int descriptor) {
    GetOpen(descriptor) = None;
    --openCount_;
    return 0;
}

int MemoryFiles::GetStatus(int descriptor, struct stat* status) {
    status->st_mode = S_IFREG | 0644;
    status->st_size = static_cast<off_t>(files_[GetOpen(descriptor)].text.size());
    return 0;
}

int MemoryFiles::Truncate(int descriptor, off_t size) {
    files_[GetOpen(descriptor)].text.resize(static_cast<std::size_t>(size));
    return 0;
}

int MemoryFiles::ChangeMode(int /*descriptor*/, unsigned /*mode*/) {
    return 0;
}

ssize_t MemoryFiles::ReadLink(const char* name, char* /*target*/, std::size_t /*size*/) {
    return FailWith(PlaceOf(name) != None ? EINVAL : ENOENT);
}

int MemoryFiles::Rename(const char* from, const char* to) {
    const std::size_t place = PlaceOf(from);
    if (*to == '\0' || place == None) {
        return FailWith(ENOENT);
    }
    const std::size_t replaced = PlaceOf(to);
    if (replaced != None) {
        files_[replaced].isLinked = false;
    }
    files_[place].name = to;
    files_[place].isLinked = true;
    return 0;
}

int MemoryFiles::Unlink(const char* name) {
    const std::size_t place = PlaceOf(name);
    if (place == None) {
        return FailWith(ENOENT);
    }
    files_[place].isLinked = false;
    return 0;
}

} // namespace Fuzz
