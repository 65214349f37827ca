#include "check/Checker.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers.h"
#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <utility>

namespace Tool::Checking {

using Orn_Hdl::Check;
using Orn_Hdl::HdlOptions;
using Orn_Hdl::StringArray;

namespace {

bool ChangesNames(const HdlOptions& options) {
    const HdlOptions::VerilogOption& verilog = options.verilog;
    return verilog.signalCase != HdlOptions::VerilogOption::DEFSULT ||
           verilog.instanceCase != HdlOptions::VerilogOption::DEFSULT ||
           verilog.componentCase != HdlOptions::VerilogOption::DEFSULT;
}

} // namespace

bool Checker::IsWrite(const StringArray& words) {
    if (!IsWord(words, 0, "WRITE") || !(IsWord(words, 1, "VERILOG") || IsWord(words, 1, "VHDL"))) {
        return false;
    }
    // Four or five words are options and then the file's name; of any other count the third is it.
    const int count = words.GetSize();
    return !words.GetView(count == 4 ? 3 : count == 5 ? 4 : 2).empty();
}

void Checker::CheckWrite(const StringArray& words, std::uint64_t line,
                         std::vector<Located>& findings) {
    isChecked_ = true;
    const bool isVerilog = IsWord(words, 1, "VERILOG");
    // Two writes in a row see the same design, unless the first one changes it.
    if ((pendingVerilog_ && ChangesNames(*model_.GetOptions())) ||
        (pendingVhdl_ && !model_.GetOptions()->vhdl.openPin)) {
        WriteIntoNothing();
    }
    (isVerilog ? pendingVerilog_ : pendingVhdl_) = true;
    Add(targets_ & (isVerilog ? Check::Targets::Verilog() : Check::Targets::Vhdl()), line,
        findings);
}

void Checker::CheckAll(std::uint64_t line, std::vector<Located>& findings) {
    Add(targets_, line, findings);
}

void Checker::BeforeCommand(const StringArray& words) {
    const bool changesNothing = words.GetSize() == 0 || IsWord(words, 0, "NOOP");
    if (changesNothing) {
        return;
    }
    isChecked_ = false;
    if (pendingVerilog_ || pendingVhdl_) {
        WriteIntoNothing();
    }
}

/// A write sorts the design, makes dummy signals and changes the letter case of names, and all of
/// that stays.
void Checker::WriteIntoNothing() {
    Orn_Hdl::OutStream nothing(nullptr);
    if (std::exchange(pendingVerilog_, false)) {
        Orn_Hdl::VerilogNetlister(nothing).WriteNetlist(model_.GetNetlist(), *model_.GetOptions());
    }
    if (std::exchange(pendingVhdl_, false)) {
        Orn_Hdl::VhdlNetlister(nothing).WriteNetlist(model_.GetNetlist(), model_.GetOptions());
    }
}

void Checker::Add(Check::Targets targets, std::uint64_t line, std::vector<Located>& findings) {
    for (Check::Finding& finding :
         Check::Run(*model_.GetNetlist(), *model_.GetOptions(), targets)) {
        std::string key(finding.rule->name);
        key.append("\n").append(finding.message).append("\n").append(finding.cause.first);
        key.append("\n").append(finding.cause.second);
        // What both languages mind is told once, with the targets of both.
        const auto [told, isNew] = told_.emplace(std::move(key), findings.size());
        if (!isNew) {
            findings[told->second].finding.verdicts.Worsen(finding.verdicts);
            continue;
        }
        // The objects may be gone when the finding is told.
        finding.objects.clear();
        Located& located = findings.emplace_back();
        located.finding = std::move(finding);
        located.checkedAt = line;
    }
}

} // namespace Tool::Checking
