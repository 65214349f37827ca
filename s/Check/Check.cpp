#include "Orn_Hdl/Check.h"

#include "Check/Context.h"
#include "HdlModel/Names/Names.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <unordered_set>

namespace Orn_Hdl {

namespace {

constexpr std::string_view TargetNames[Check::TargetCount] = {
    "verilog-1995", "verilog-2005", "systemverilog-2017",
    "vhdl-93",      "vhdl-2008",    "icarus",
    "verilator",    "yosys",        "ghdl"};

} // namespace

Check::Verdict Check::Verdicts::GetWorst() const noexcept {
    return *std::max_element(verdicts_.begin(), verdicts_.end());
}

void Check::Verdicts::Restrict(Targets targets) noexcept {
    for (const Target target : Check::GetTargets()) {
        if (!targets.Has(target)) {
            Set(target, Verdict::Accepts);
        }
    }
}

void Check::Verdicts::Worsen(const Verdicts& other) noexcept {
    for (const Target target : Check::GetTargets()) {
        Set(target, std::max(Get(target), other.Get(target)));
    }
}

Check::Severity Check::Finding::GetSeverity() const noexcept {
    return verdicts.GetWorst() > Verdict::Warns ? Severity::Error : Severity::Warning;
}

std::vector<Check::Target> Check::Finding::GetTargets(Verdict verdict) const {
    std::vector<Target> targets;
    for (const Target target : Check::GetTargets()) {
        if (verdicts.Get(target) == verdict) {
            targets.push_back(target);
        }
    }
    return targets;
}

std::string_view Check::GetName(Target target) noexcept {
    return TargetNames[static_cast<std::size_t>(target)];
}

bool Check::FindTarget(std::string_view name, Target& target) noexcept {
    for (const Target each : GetTargets()) {
        if (Port::EqualIgnoringCase(GetName(each), name)) {
            target = each;
            return true;
        }
    }
    return false;
}

std::array<Check::Target, Check::TargetCount> Check::GetTargets() noexcept {
    std::array<Target, TargetCount> targets = {};
    for (std::size_t i = 0; i < TargetCount; ++i) {
        targets[i] = static_cast<Target>(i);
    }
    return targets;
}

std::vector<Check::Finding> Check::Run(const Netlist& netlist, const HdlOptions& options,
                                       Targets targets) {
    Checking::Context context(netlist, options, targets);
    context.CheckAll();
    return context.TakeFindings();
}

namespace Checking {

Context::Context(const Netlist& design, const HdlOptions& optionsInForce, Check::Targets wanted,
                 bool mended)
    : netlist(design), options(optionsInForce),
      verilog(!(wanted & Check::Targets::Verilog()).IsEmpty()),
      vhdl(!(wanted & Check::Targets::Vhdl()).IsEmpty()), isMended(mended), survey(optionsInForce),
      targets_(wanted) {}

void Context::CheckAll() {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        survey.Look(*signal);
    }
    CheckConnections(*this);
    CheckAssignments(*this);
    CheckNames(*this);
    CheckAttributes(*this);
    CheckScopes(*this);
    CheckClauses(*this);
}

Finding* Context::Add(RuleId rule, const Verdicts& verdicts, Cause cause) {
    Verdicts counted = verdicts;
    counted.Restrict(targets_);
    if (counted.GetWorst() == Check::Verdict::Accepts) {
        return nullptr;
    }
    Finding& finding = findings_.emplace_back();
    finding.rule = &GetRule(rule);
    finding.verdicts = counted;
    finding.cause = std::move(cause);
    return &finding;
}

std::vector<Finding> Context::TakeFindings() {
    std::unordered_set<std::string> met;
    std::vector<Finding> kept;
    for (Finding& finding : findings_) {
        std::string key(finding.rule->name);
        key.append("\n").append(finding.message).append("\n").append(finding.cause.first);
        key.append("\n").append(finding.cause.second);
        if (met.insert(std::move(key)).second) {
            kept.push_back(std::move(finding));
        }
    }
    findings_.clear();
    return kept;
}

std::string Quoted(std::string_view text) {
    return std::string("\"").append(text).append("\"");
}

std::string Lower(std::string_view text) {
    std::string small(text);
    for (char& c : small) {
        c = Port::ToLower(c);
    }
    return small;
}

std::string Spell(std::string_view name, CaseType nameCase) {
    std::string spelled(name);
    if (nameCase != HdlOptions::VerilogOption::DEFSULT) {
        const bool upper = nameCase == HdlOptions::VerilogOption::UPPERCASE;
        for (char& c : spelled) {
            c = upper ? Port::ToUpper(c) : Port::ToLower(c);
        }
    }
    return spelled;
}

Cause CauseOf(const Object& object) {
    switch (object.GetObjectType()) {
    case ObjectTypeComponent:
        return Named(Kind::Component, object.GetNameView());
    case ObjectTypeInstance:
        return Named(Kind::Instance, object.GetNameView());
    case ObjectTypeSignal:
        return SignalCause(Names::BaseName(object.GetNameView()));
    default:
        return Named(Kind::DesignName, object.GetNameView());
    }
}

} // namespace Checking

} // namespace Orn_Hdl
