// What every topic of a check looks at and adds to.
#pragma once

#include "Check/Rules.h"
#include "Check/Survey.h"
#include "Check/Uses.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace Orn_Hdl::Checking {

using Finding = Check::Finding;
using Cause = Check::Cause;
using Kind = Check::Cause::Kind;
using Verdicts = Check::Verdicts;
using CaseType = HdlOptions::VerilogOption::CaseType;

/// A component that has instances; only these are written.
struct UsedComponent {
    int pinCount = 0;
    const Instance* firstInstance = nullptr;
    /// Whether an instance has no attributes, and so those of the component.
    bool hasPlainInstance = false;
};

/// A port that pins use against its direction, and the first pin that does.
struct Misused {
    const Signal* port = nullptr;
    const Instance* instance = nullptr;
    const Pin* pin = nullptr;
};

/// The design under check, what is known of it so far, and what was found.
class Context {
public:
    Context(const Netlist& design, const HdlOptions& optionsInForce, Check::Targets wanted,
            bool mended = false);

    const Netlist& netlist;
    const HdlOptions& options;
    /// Whether any target reads the language.
    const bool verilog;
    const bool vhdl;
    /// Whether the design was made to be written legally: the values hold the escapes of the
    /// language, and an empty list of ports is left out.
    const bool isMended;

    /// What most topics look at. The walk over the instances completes it.
    Survey survey;
    /// \{
    /// Gathered by the walk over the instances.
    std::unordered_map<const Component*, UsedComponent> used;
    /// How the nets are used.
    Uses uses;
    /// Output ports that pins read, and input ports that pins drive, each once.
    std::vector<Misused> readOutputs;
    std::vector<Misused> drivenInputs;
    /// \}
    /// The ports that a write would make a dummy signal for, by the dummy signal's name in small
    /// letters and without a range.
    std::unordered_map<std::string, const Signal*> dummies;

    /// \{
    /// Gathered by the look at the attributes: the names that VHDL declares, in small letters, and
    /// the names of the types and values that it uses.
    std::unordered_map<std::string, Cause> declaredAttributes;
    std::unordered_set<std::string> usedTypes;
    /// \}

    /// Adds a finding. \return null when no target that counts minds; the message and what else
    /// there is to say are the caller's to fill in.
    Finding* Add(RuleId rule, const Verdicts& verdicts, Cause cause);
    /// Adds a finding with the verdicts that the rule has in general.
    Finding* Add(RuleId rule, Cause cause) {
        return Add(rule, GetRule(rule).verdicts, std::move(cause));
    }
    /// Checks every topic.
    void CheckAll();
    /// Everything that was added, without repetitions.
    std::vector<Finding> TakeFindings();

private:
    const Check::Targets targets_;
    std::vector<Finding> findings_;
};

/// A text between quotes.
std::string Quoted(std::string_view text);
/// ASCII letters small.
std::string Lower(std::string_view text);
/// A name as the Verilog writer spells it.
std::string Spell(std::string_view name, CaseType nameCase);

inline Cause SignalCause(std::string_view base) {
    return {Kind::Signal, std::string(base), ""};
}
inline Cause Named(Kind kind, std::string_view first, std::string_view second = {}) {
    return {kind, std::string(first), std::string(second)};
}
inline Cause ConnectionOf(const Instance& instance, const Pin& pin) {
    return Named(Kind::Connection, instance.GetNameView(), pin.GetNameView());
}

/// Reported with "the other half of the clash": the cause that a declared thing has.
Cause CauseOf(const Object& object);

/// \{
/// The topics, in the order in which they are checked.
void CheckConnections(Context& context);
void CheckAssignments(Context& context);
void CheckNames(Context& context);
void CheckAttributes(Context& context);
void CheckScopes(Context& context);
void CheckClauses(Context& context);
/// \}

} // namespace Orn_Hdl::Checking
