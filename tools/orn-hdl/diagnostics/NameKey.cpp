#include "diagnostics/NameKey.h"

#include "Orn_Hdl/Model/Object.h"
#include "Port/String.h"

namespace Tool {

std::string GetNameKey(std::string_view name) {
    Port::StringBase<char> text(name);
    Orn_Hdl::Object::NormalizeName(text);
    text.MakeLower();
    return std::string(text.GetView());
}

} // namespace Tool
