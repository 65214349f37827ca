#include "check/WriteGate.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "check/Checker.h"
#include "check/Report.h"

#include <algorithm>

namespace Tool::Checking {

using Orn_Hdl::Check;

bool WriteGate::Allows(const Orn_Hdl::StringArray& words, std::uint64_t line) {
    if (!Checker::IsWrite(words)) {
        return true;
    }
    const bool isVerilog = Port::EqualIgnoringCase(words.GetView(1), "VERILOG");
    return Allows(isVerilog ? Orn_Hdl::Language::Verilog : Orn_Hdl::Language::Vhdl, line);
}

bool WriteGate::Allows(Orn_Hdl::Language language, std::uint64_t line) {
    const Check::Targets targets =
        language == Orn_Hdl::Language::Verilog ? Check::Targets::Verilog() : Check::Targets::Vhdl();
    std::vector<Check::Finding> errors =
        Check::Run(*model_.GetNetlist(), *model_.GetOptions(), targets);
    errors.erase(std::remove_if(errors.begin(), errors.end(),
                                [](const Check::Finding& finding) {
                                    return finding.GetSeverity() != Check::Severity::Error;
                                }),
                 errors.end());
    return !Tell(errors, line);
}

bool WriteGate::Tell(const std::vector<Check::Finding>& errors, std::uint64_t line) {
    std::vector<Located> findings;
    for (const Check::Finding& finding : errors) {
        Located& located = findings.emplace_back();
        located.finding = finding;
        located.file = file_;
        located.checkedAt = line;
        located.isObstacle = true;
    }
    if (findings.empty()) {
        return false;
    }
    // Standard input is read once; its findings stand at the line that writes.
    if (file_ != "-") {
        Locate(file_.c_str(), findings);
    }
    for (Located& located : findings) {
        located.line = located.line == 0 ? line : located.line;
    }
    std::string text = Format(findings, CheckFormat::Text);
    text.pop_back();
    PrintError(text);
    return true;
}

} // namespace Tool::Checking
