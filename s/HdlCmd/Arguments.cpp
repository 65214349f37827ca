#include "HdlCmd/Arguments.h"

#include "Port/Pool.h"

#include <cstring>
#include <utility>

namespace Orn_Hdl {

namespace {

constexpr std::size_t HeaderSize = 2;

} // namespace

Arguments::Arguments(std::initializer_list<std::string_view> texts, unsigned flags) {
    std::size_t size = HeaderSize;
    for (const std::string_view text : texts) {
        size += text.size() + 1;
    }
    block_ = static_cast<char*>(Port::Pool::Allocate(size, Port::Pool::Commands));
    block_[0] = static_cast<char>(texts.size());
    block_[1] = static_cast<char>(flags);
    char* place = block_ + HeaderSize;
    for (const std::string_view text : texts) {
        place += text.copy(place, text.size());
        *place++ = '\0';
    }
}

Arguments& Arguments::operator=(Arguments&& other) noexcept {
    std::swap(block_, other.block_);
    return *this;
}

Arguments::~Arguments() {
    Port::Pool::Free(block_);
}

const char* Arguments::Get(int index) const noexcept {
    if (block_ == nullptr || index < 0 || index >= block_[0]) {
        return "";
    }
    const char* text = block_ + HeaderSize;
    for (; index > 0; --index) {
        text += std::strlen(text) + 1;
    }
    return text;
}

} // namespace Orn_Hdl
