#include "Port/System.h"

#include <cstdio>
#include <fcntl.h>
#include <unistd.h>

namespace Port {

namespace {

System systemCalls;
System* inUse = &systemCalls;

} // namespace

System::~System() = default;

int System::Open(const char* name, int flags, unsigned mode) {
    return ::open(name, flags, mode);
}

ssize_t System::Read(int descriptor, void* buffer, std::size_t size) {
    return ::read(descriptor, buffer, size);
}

ssize_t System::Write(int descriptor, const void* data, std::size_t size) {
    return ::write(descriptor, data, size);
}

int System::Close(int descriptor) {
    return ::close(descriptor);
}

int System::GetStatus(int descriptor, struct stat* status) {
    return ::fstat(descriptor, status);
}

int System::Truncate(int descriptor, off_t size) {
    return ::ftruncate(descriptor, size);
}

int System::ChangeMode(int descriptor, unsigned mode) {
    return ::fchmod(descriptor, mode);
}

ssize_t System::ReadLink(const char* name, char* target, std::size_t size) {
    return ::readlink(name, target, size);
}

int System::Rename(const char* from, const char* to) {
    return std::rename(from, to);
}

int System::Unlink(const char* name) {
    return ::unlink(name);
}

int System::OpenAt(int folder, const char* name, int flags, unsigned mode) {
    return ::openat(folder, name, flags, mode);
}

int System::RenameAt(int folder, const char* from, const char* to) {
    return ::renameat(folder, from, folder, to);
}

int System::UnlinkAt(int folder, const char* name) {
    return ::unlinkat(folder, name, 0);
}

System& System::Get() noexcept {
    return *inUse;
}

void System::Replace(System* system) noexcept {
    inUse = system == nullptr ? &systemCalls : system;
}

} // namespace Port
