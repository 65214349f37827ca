#include "HdlCmd/Arguments.h"

namespace Orn_Hdl {

void Arguments::Set(std::initializer_list<std::string_view> texts) {
    std::size_t size = 0;
    for (const std::string_view text : texts) {
        size += text.size() + 1;
    }
    if (room_.size() < size) {
        room_.resize(size);
    }
    char* place = room_.data();
    count_ = 0;
    flags_ = 0;
    for (const std::string_view text : texts) {
        texts_[count_++] = place;
        place += text.copy(place, text.find('\0'));
        *place++ = '\0';
    }
}

} // namespace Orn_Hdl
