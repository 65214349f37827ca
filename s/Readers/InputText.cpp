#include "Readers/InputText.h"

#include <cstring>

namespace Orn_Hdl::Readers {

namespace {

#if defined(FUZZING_BUILD_MODE_UNSAFE_FOR_PRODUCTION)
// The short texts of a fuzz target are read in several pieces too.
constexpr std::size_t PieceSize = 64;
#else
constexpr std::size_t PieceSize = std::size_t(1) << 17;
#endif

} // namespace

bool InputText::Open(const std::string& fileName) {
    if (!file_.open(fileName.c_str(), Port::File::Read, true)) {
        return false;
    }
    capacity_ = PieceSize;
    buffer_.reset(new char[capacity_ + 1]);
    buffer_[0] = '\0';
    current = buffer_.get();
    end = current;
    return true;
}

void InputText::Take(std::string_view text) {
    capacity_ = text.size();
    buffer_.reset(new char[capacity_ + 1]);
    std::memcpy(buffer_.get(), text.data(), text.size());
    buffer_[text.size()] = '\0';
    current = buffer_.get();
    end = current + text.size();
}

bool InputText::ReadOn() {
    if (!file_.IsOpen()) {
        return false;
    }
    const char* const from = mark != nullptr ? mark : current;
    const auto kept = static_cast<std::size_t>(end - from);
    const auto behindMark = static_cast<std::size_t>(current - from);
    start_ += static_cast<std::uint64_t>(from - buffer_.get());
    if (kept > capacity_ / 2) {
        std::unique_ptr<char[]> larger(new char[capacity_ * 2 + 1]);
        std::memcpy(larger.get(), from, kept);
        buffer_ = std::move(larger);
        capacity_ *= 2;
    } else {
        std::memmove(buffer_.get(), from, kept);
    }
    const std::size_t added = file_.read(buffer_.get() + kept, capacity_ - kept);
    mark = mark != nullptr ? buffer_.get() : nullptr;
    current = buffer_.get() + behindMark;
    end = buffer_.get() + kept + added;
    buffer_[kept + added] = '\0';
    return added > 0;
}

} // namespace Orn_Hdl::Readers
