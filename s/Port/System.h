// The operating system's file calls. All code that opens, reads, writes, closes, renames or removes
// a file uses this class, so that a test can make the N-th call fail.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <sys/stat.h>
#include <sys/types.h>

namespace Port {

/// The file calls of the system, as defined by POSIX: -1 and errno on a failure.
class ORN_HDL_API System {
public:
    virtual ~System();
    virtual int Open(const char* name, int flags, unsigned mode);
    virtual ssize_t Read(int descriptor, void* buffer, std::size_t size);
    virtual ssize_t Write(int descriptor, const void* data, std::size_t size);
    virtual int Close(int descriptor);
    virtual int GetStatus(int descriptor, struct stat* status);
    virtual int Truncate(int descriptor, off_t size);
    virtual int ChangeMode(int descriptor, unsigned mode);
    virtual ssize_t ReadLink(const char* name, char* target, std::size_t size);
    virtual int Rename(const char* from, const char* to);
    virtual int Unlink(const char* name);

    /// \{
    /// The calls for names below an open folder.
    virtual int OpenAt(int folder, const char* name, int flags, unsigned mode);
    virtual int RenameAt(int folder, const char* from, const char* to);
    virtual int UnlinkAt(int folder, const char* name);
    /// \}

    /// The calls in use.
    static System& Get() noexcept;
    /// Replaces the calls in use; null restores the system's own. The object is not owned. For
    /// tests, before any file is open.
    static void Replace(System* system) noexcept;
};

} // namespace Port
