#include "diagnostics/SourceLines.h"

#include <filesystem>
#include <system_error>

namespace Tool {

namespace {

std::string GetAbsolute(const std::string& name) {
    std::error_code error;
    const std::filesystem::path path = std::filesystem::absolute(name, error);
    return error ? name : path.string();
}

} // namespace

bool CanReadAgain(const std::string& name) {
    std::error_code error;
    return std::filesystem::is_regular_file(name, error);
}

SourceLines::SourceLines(const std::string& name) : name_(GetAbsolute(name)) {}

bool SourceLines::Get(std::uint64_t line, std::string_view& text) {
    if (line == 0 || ((!file_.IsOpen() || line < line_) && !Open())) {
        return false;
    }
    while (line_ < line) {
        if (!file_.NextLine(text_)) {
            file_.Discard();
            return false;
        }
        ++line_;
    }
    text = text_;
    return true;
}

bool SourceLines::Open() {
    line_ = 0;
    return CanReadAgain(name_) && file_.open(name_.c_str(), Port::File::Read, true);
}

} // namespace Tool
