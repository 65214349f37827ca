#include "Verilog/Dialects.h"

#include "Port/Ascii.h"

namespace Orn_Hdl {

namespace {

/// Whether the number of each type is the index of its row.
constexpr bool IsInOrder() {
    for (std::size_t i = 0; i < std::size(Dialects); ++i) {
        if (Dialects[i].type != static_cast<int>(i)) {
            return false;
        }
    }
    return true;
}
static_assert(IsInOrder());

} // namespace

void HdlOptions::VerilogOption::SetSynthesisType(const char* text) {
    synthesisType = Dialects->type;
    for (const Dialect& dialect : Dialects) {
        if (Port::EqualIgnoringCase(dialect.name, Port::ViewOf(text))) {
            synthesisType = dialect.type;
        }
    }
}

bool HdlOptions::VerilogOption::IsSemiColonWrittenBeforeAttr() const noexcept {
    return DialectOf(synthesisType).isSemicolonFirst;
}

} // namespace Orn_Hdl
