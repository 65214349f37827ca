#include "load/RereadableFile.h"

#include "Tool.h"

#include <cstddef>

namespace Tool {

RereadableFile::RereadableFile(const std::string& file) : name_(SystemFileName(file.c_str())) {
    if (file == "-") {
        Copy();
    }
}

RereadableFile::~RereadableFile() {
    if (copy_ != nullptr) {
        std::fclose(copy_);
    }
}

void RereadableFile::Copy() {
    copy_ = std::tmpfile();
    if (copy_ == nullptr) {
        return;
    }
    char piece[1 << 16];
    std::size_t count = 0;
    while ((count = std::fread(piece, 1, sizeof piece, stdin)) > 0) {
        std::fwrite(piece, 1, count, copy_);
    }
    std::fflush(copy_);
    name_ = "/dev/fd/" + std::to_string(::fileno(copy_));
}

} // namespace Tool
