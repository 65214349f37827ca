#include "Port/Folder.h"

#include "Port/System.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <string_view>

namespace Port {

Folder::~Folder() {
    Close();
}

void Folder::Close() noexcept {
    if (IsOpen()) {
        System::Get().Close(descriptor_);
        descriptor_ = -1;
    }
}

int Folder::OpenAt(int base, const char* name, bool followLinks) {
    const int flags = O_RDONLY | O_DIRECTORY | O_CLOEXEC | (followLinks ? 0 : O_NOFOLLOW);
    int opened = -1;
    do {
        opened = System::Get().OpenAt(base, name, flags, 0);
    } while (opened < 0 && errno == EINTR);
    if (opened < 0) {
        return errno;
    }
    Close();
    descriptor_ = opened;
    return 0;
}

int Folder::Open(const char* name) {
    return OpenAt(AT_FDCWD, name == nullptr ? "" : name, true);
}

int Folder::OpenParent(const char* path, Folder& parent, const char*& name) const {
    if (const int error = parent.OpenAt(descriptor_, ".", false); error != 0) {
        return error;
    }
    name = path;
    while (const char* slash = std::strchr(name, '/')) {
        const std::string step(name, slash);
        name = slash + 1;
        if (step == "..") {
            return EXDEV;
        }
        if (step.empty() || step == ".") {
            continue;
        }
        if (const int error = parent.OpenAt(parent.descriptor_, step.c_str(), false); error != 0) {
            return error;
        }
    }
    const std::string_view last(name);
    return last.empty() || last == "." || last == ".." ? EISDIR : 0;
}

} // namespace Port
