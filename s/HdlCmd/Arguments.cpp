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
        const std::size_t length = text.copy(place, text.find('\0'));
        place[length] = '\0';
        texts_[count_++] = std::string_view(place, length);
        place += length + 1;
    }
}

} // namespace Orn_Hdl
