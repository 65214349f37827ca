#include "HdlModel/Names/NameIndex.h"

namespace Orn_Hdl {

std::uint32_t HashAnyName(std::string_view name) noexcept {
    return HashByEights(name, [](std::uint64_t text) { return FoldEightNameChars(text); });
}

} // namespace Orn_Hdl
