#include "HdlCmd/Arguments.h"

#include "Containers/EightBytes.h"

namespace Orn_Hdl {

void Arguments::Set(std::initializer_list<std::string_view> texts) {
    std::size_t end = 0;
    count_ = 0;
    flags_ = 0;
    for (const std::string_view text : texts) {
        if (room_.size() - end <= text.size()) {
            room_.resize(end + text.size() + 1);
        }
        EightBytes::Copy(text.data(), text.size(), room_.data() + end);
        starts_[count_++] = end;
        end += text.size() + 1;
        room_[end - 1] = '\0';
    }
}

} // namespace Orn_Hdl
