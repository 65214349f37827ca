#include "check/WriteGate.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"
#include "check/Checker.h"
#include "check/Report.h"
#include "diagnostics/CommandLines.h"
#include "diagnostics/Reporter.h"

#include <algorithm>
#include <utility>
#include <vector>

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
        located.checkedAt = line;
        located.isObstacle = true;
    }
    if (findings.empty()) {
        return false;
    }
    // A pipe is read once; its findings stand at the line that writes.
    if (CanReadAgain(lines_.GetSystemName())) {
        Locate(lines_.GetSystemName().c_str(), findings);
    }
    for (Reported& reported : MakeReports(findings, lines_)) {
        reporter_.Report(std::move(reported.diagnostic));
    }
    return true;
}

} // namespace Tool::Checking
