#include "Orn_Hdl/Options.h"

#include "Port/Ascii.h"

namespace Orn_Hdl {

// The functions that depend on the table of dialects are in Verilog/Dialects.cpp.

HdlOptions::VerilogOption::CaseType HdlOptions::VerilogOption::GetCaseType(const char* text) {
    const std::string_view name = Port::ViewOf(text);
    if (Port::EqualIgnoringCase(name, "UPPERCASE")) {
        return UPPERCASE;
    }
    return Port::EqualIgnoringCase(name, "LOWERCASE") ? LOWERCASE : DEFSULT;
}

} // namespace Orn_Hdl
