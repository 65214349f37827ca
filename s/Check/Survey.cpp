#include "Check/Survey.h"

#include "Check/Identifier.h"
#include "Check/ReservedWords.h"
#include "Check/Rules.h"
#include "HdlModel/Names/GeneratedNames.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Signals.h"

#include <string_view>

namespace Orn_Hdl::Checking {

namespace {

using CaseType = HdlOptions::VerilogOption::CaseType;

/// A name of more characters may be too long.
constexpr std::size_t LongestPlain = 127;

/// Whether no target can object to a name. Other letters could make a reserved word of it.
bool IsPlain(std::string_view name, CaseType nameCase) {
    if (name.size() > LongestPlain || nameCase != HdlOptions::VerilogOption::DEFSULT) {
        return false;
    }
    const Identifier identifier(name);
    return identifier.isVerilog && identifier.isVhdl && identifier.hasProperUnderscores &&
           FindReserved(name, name) == Check::Verdicts();
}

} // namespace

void Survey::Look(const Signal& signal) {
    const bool isPlain = signal.GetSignalType() == SignalTypeScalar && !signal.IsPort() &&
                         !signal.HasAttrs() && signal.GetConstantValue().GetValue().IsEmpty() &&
                         signal.GetSignalIterator().IsAtEnd() && signal.GetCommentView().empty() &&
                         IsPlain(signal.GetNameView(), options_.verilog.signalCase) &&
                         !Names::IsGenerated(signal.GetNameView());
    if (!isPlain) {
        signals_.push_back(&signal);
    }
}

void Survey::Look(const Instance& instance) {
    const Component* const component = instance.GetComponent();
    const bool isPlain = !instance.HasAttrs() && instance.GetCommentView().empty() &&
                         (component == nullptr || !component->HasAttrs()) &&
                         IsPlain(instance.GetNameView(), options_.verilog.instanceCase);
    if (!isPlain) {
        instances_.push_back(&instance);
    }
}

} // namespace Orn_Hdl::Checking
