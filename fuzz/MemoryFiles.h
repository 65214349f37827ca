// A file system in memory, used in place of the system's, so that no input of a fuzz target can
// touch a real file.
#pragma once

#include "Port/System.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Fuzz {

class MemoryFiles : public Port::System {
public:
    struct File {
        std::string name;
        std::string text;
        /// Whether the name still leads to the file.
        bool isLinked = true;
    };

    MemoryFiles() { System::Replace(this); }
    MemoryFiles(const MemoryFiles&) = delete;
    MemoryFiles& operator=(const MemoryFiles&) = delete;
    ~MemoryFiles() override { System::Replace(nullptr); }

    /// The text of the file of that name; null if there is none.
    const std::string* Find(std::string_view name) const noexcept;
    /// Every file that was ever created, the unlinked ones included, in the order of creation.
    const std::vector<File>& GetFiles() const noexcept { return files_; }
    /// How many names lead to a file.
    std::size_t CountNames() const noexcept;
    bool HasOpenFiles() const noexcept { return openCount_ > 0; }
    /// Creates a file, or gives a file another text.
    void Put(std::string_view name, std::string_view text);

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
    static constexpr std::size_t None = static_cast<std::size_t>(-1);

    /// The place in `files_`, None if no file has the name. There are never more than a few files.
    std::size_t PlaceOf(std::string_view name) const noexcept;
    std::size_t Create(std::string_view name);
    /// The place of the file that a descriptor writes to; aborts if the descriptor is not open.
    std::size_t& GetOpen(int descriptor);

    std::vector<File> files_;
    /// For each descriptor, from 1 on, the place of its file, None once it is closed.
    std::vector<std::size_t> descriptors_;
    /// For each descriptor how many characters have been read.
    std::vector<std::size_t> offsets_;
    std::size_t openCount_ = 0;
};

} // namespace Fuzz
