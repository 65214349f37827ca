#include "JsonFile.h"

#include "explain/FileKind.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <system_error>

namespace Tool {

JsonFile::JsonFile(const std::string& name, Progress& progress) : name_(name), progress_(progress) {
    if (IsGzip(name)) {
        compressed_.emplace(name);
    }
    isOpen_ = compressed_ || file_.open(SystemFileName(name.c_str()), Port::File::Read, true);
}

std::size_t JsonFile::Read(char* to, std::size_t count) {
    if (!isOpen_) {
        return 0;
    }
    const std::size_t read = compressed_ ? compressed_->Read(to, count) : file_.read(to, count);
    if (beginning_.size() < BeginningSize) {
        beginning_.append(to, std::min(read, BeginningSize - beginning_.size()));
    }
    bytes_ += read;
    progress_.Reading(bytes_, compressed_.has_value());
    return read;
}

bool JsonFile::IsLarge() const noexcept {
    constexpr std::uintmax_t LeastSize = std::uintmax_t(1) << 18;
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(name_, error);
    return !error && size >= LeastSize;
}

void JsonFile::CheckRest() {
    std::array<char, 4096> piece;
    while (compressed_ && compressed_->Read(piece.data(), piece.size()) > 0) {
    }
}

Status JsonFile::GetStatus() const {
    return file_.GetError() == 0 ? Status::Success : ComplainUnreadable(name_, file_.GetError());
}

} // namespace Tool
