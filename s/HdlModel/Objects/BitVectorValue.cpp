#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Text.h"

namespace Orn_Hdl {

int BitVectorValue::ConvertToBase(std::string_view text) noexcept {
    switch (text.empty() ? '\0' : text.front()) {
    case 'O':
    case 'o':
        return 8;
    case 'H':
    case 'h':
        return 16;
    default:
        return 2;
    }
}

void BitVectorValue::SetValue(const char* text) {
    const StringArray parts(text, ":", true, nullptr);
    hasBaseAndLength_ = parts.GetSize() >= 3;
    if (hasBaseAndLength_) {
        length_ = Port::ToIntSaturated(parts.GetView(0));
        base_ = ConvertToBase(parts.GetView(1));
        digits_ = parts.GetAt(2);
    } else {
        length_ = 1;
        base_ = 2;
        digits_ = text;
    }
}

} // namespace Orn_Hdl
