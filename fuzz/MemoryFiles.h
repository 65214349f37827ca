// A file system in memory, put in the place of the system's, so that no input of a fuzz target can
// touch a real file.
#pragma once

#include "Port/System.h"

#include <cstddef>
#include <map>
#include <string>

namespace Fuzz {

class MemoryFiles : public Port::System {
public:
    MemoryFiles() { System::Replace(this); }
    MemoryFiles(const MemoryFiles&) = delete;
    MemoryFiles& operator=(const MemoryFiles&) = delete;
    ~MemoryFiles() override { System::Replace(nullptr); }

    const std::map<std::string, std::string>& GetFiles() const noexcept { return files_; }
    bool HasOpenFiles() const noexcept { return !open_.empty(); }

    int Open(const char* name, int flags, unsigned mode) override;
    ssize_t Read(int descriptor, void* buffer, std::size_t size) override;
    ssize_t Write(int descriptor, const void* data, std::size_t size) override;
    int Close(int descriptor) override;
    int GetStatus(int descriptor, struct stat* status) override;
    int Truncate(int descriptor, off_t size) override;
    int ChangeMode(int descriptor, unsigned mode) override;
    ssize_t ReadLink(const char* name, char* target, std::size_t size) override;
    int Rename(const char* from, const char* to) override;
    int Unlink(const char* name) override;

private:
    std::map<std::string, std::string> files_;
    /// The file's name, by descriptor.
    std::map<int, std::string> open_;
    int last_ = 0;
};

} // namespace Fuzz
