#include "Orn_Hdl/Options.h"

#include "Port/Ascii.h"

#include <iterator>

namespace Orn_Hdl {

void HdlOptions::VerilogOption::SetSynthesisType(const char* text) {
    constexpr const char* Names[] = {"QSN",      "EXEMPLAR",    "SYNPLICITY",
                                     "SYNOPSYS", "VERILOG2001", "PRECISION"};
    synthesisType = QSN;
    for (int i = 0; i < static_cast<int>(std::size(Names)); ++i) {
        if (Port::EqualIgnoringCase(Names[i], Port::ViewOf(text))) {
            synthesisType = i;
        }
    }
}

HdlOptions::VerilogOption::CaseType HdlOptions::VerilogOption::GetCaseType(const char* text) {
    const std::string_view name = Port::ViewOf(text);
    if (Port::EqualIgnoringCase(name, "UPPERCASE")) {
        return UPPERCASE;
    }
    return Port::EqualIgnoringCase(name, "LOWERCASE") ? LOWERCASE : DEFSULT;
}

} // namespace Orn_Hdl
