// A file on the command line that is read more than once.
#pragma once

#include <cstdio>
#include <string>

namespace Tool {

/// A file that can be opened again: standard input is copied.
class RereadableFile {
public:
    /// \param file the file; "-" is standard input.
    explicit RereadableFile(const std::string& file);
    RereadableFile(const RereadableFile&) = delete;
    RereadableFile& operator=(const RereadableFile&) = delete;
    ~RereadableFile();

    /// The name under which the system opens the file.
    const char* GetName() const noexcept { return name_.c_str(); }

private:
    void Copy();

    std::string name_;
    std::FILE* copy_ = nullptr;
};

} // namespace Tool
