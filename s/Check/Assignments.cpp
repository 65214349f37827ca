// Aliases, constants, and how often each net is driven.

#include "Check/Bits.h"
#include "Check/Context.h"
#include "Check/Digits.h"
#include "Check/Identifier.h"
#include "Writers/SignalLists.h"
#include "Writers/Text.h"

#include <algorithm>
#include <unordered_set>

namespace Orn_Hdl::Checking {

namespace {

using Writers::RunsAgainstParent;

/// Whether the signal is a scalar signal or a bit of a bus; a bus of one bit is neither.
bool IsSingleBit(const Signal& signal) {
    const int type = signal.GetSignalType();
    return type == SignalTypeScalar || type == SignalTypeBusIndex;
}

bool HasDirection(const Signal& signal, int direction) {
    return signal.GetPortPolarity().GetValue() == direction;
}

/// Whether only the signal's bits can stand in an assignment of VHDL.
bool IsCompoundOrAgainst(const Signal& signal) {
    return signal.GetSignalType() == SignalTypeCompoundBus || RunsAgainstParent(signal);
}

/// Whether the VHDL writer writes an alias of the signal bit by bit.
bool IsAliasedByBits(const Signal& signal) {
    return (!IsSingleBit(signal) && signal.GetWidth() == 1) || IsCompoundOrAgainst(signal);
}

/// Whether the signal is a slice of one bit of a bus that counts upwards: VHDL gets the bit.
bool IsBitOfUpwardBus(const Signal& signal) {
    if (signal.GetSignalType() != SignalTypeBusSlice || signal.GetWidth() != 1) {
        return false;
    }
    const Bus* const parent = static_cast<const BusSlice&>(signal).GetParentBus();
    return parent != nullptr && parent->GetWidth() > 1 && !parent->IsDownTo();
}

/// Whether VHDL gets a constant of the signal bit by bit, if at all.
bool IsTiedByBits(const Signal& signal) {
    return IsCompoundOrAgainst(signal) || IsBitOfUpwardBus(signal);
}

/// Whether VHDL gets the constant of what is written bit by bit.
bool IsWrittenByBits(const Signal& signal, const Digits& digits) {
    const auto width = static_cast<std::size_t>(std::max(signal.GetWidth(), 0));
    if (digits.hasDontCare) {
        const BitText bits = digits.ReadVhdl();
        return bits && bits->size() == width && bits->find_first_not_of("01-") == std::string::npos;
    }
    return digits.base == 2 && digits.digits.size() == width &&
           digits.digits.find_first_not_of("01") == std::string::npos;
}

/// The verdicts on something that Verilog gets, and perhaps VHDL.
Verdicts OnlyWritten(Verdicts verdicts, bool isInVhdl) {
    if (!isInVhdl) {
        verdicts.Restrict(Check::Targets::Verilog());
    }
    return verdicts;
}

/// The aliases and constants of all signals.
class Assignments {
public:
    explicit Assignments(Context& context) : context_(context) {}

    void CheckAll();

private:
    void CheckSignal(const Signal& signal);
    void CheckAlias(const Signal& signal, const Signal& alias);
    void CheckAliasWidth(const Signal& signal, const Signal& alias);
    void CheckOutputRead(const Signal& signal, const Signal& alias);
    void CheckConstant(const Signal& signal);
    void CheckDigits(const Signal& signal, const Digits& digits);
    void CheckLength(const Signal& signal, const Digits& digits);
    void CheckVhdlConstant(const Signal& signal, const Digits& digits);
    void CheckMeaning(const Signal& signal, const Digits& digits);
    void CheckTarget(const Signal& signal, const Cause& cause, std::string_view what,
                     bool isInVhdl);
    void CheckRange(const Run& run, bool isWritten, bool isInVhdl, const Cause& cause);
    void CheckOpen(const Signal& signal);
    void CheckLoop(const Signal& signal);
    Finding* AddForConstant(RuleId rule, const Verdicts& verdicts, const Signal& signal);

    static Cause ConstantCause(const Signal& signal) {
        return Named(Kind::Constant, signal.GetNameView());
    }
    static Cause AliasCause(const Signal& signal, const Signal& alias) {
        return Named(Kind::Alias, signal.GetNameView(), alias.GetNameView());
    }

    Context& context_;
};

void Assignments::CheckAll() {
    for (const Signal* signal : context_.survey.GetSignals()) {
        CheckSignal(*signal);
    }
}

void Assignments::CheckSignal(const Signal& signal) {
    const bool hasConstant = !signal.GetConstantValue().GetValue().IsEmpty();
    const Iterator<Signal*> aliases = signal.GetSignalIterator();
    if (!hasConstant && aliases.IsAtEnd()) {
        if (signal.IsPort() && Names::IsNamed(signal.GetNameView(), "open")) {
            CheckOpen(signal);
        }
        return;
    }
    if (Names::IsNamed(signal.GetNameView(), "open")) {
        CheckOpen(signal);
    }
    if (hasConstant) {
        const Digits digits(signal.GetConstantValue(), context_.options.dontCares);
        CheckTarget(signal, ConstantCause(signal), "a constant",
                    !IsTiedByBits(signal) || IsWrittenByBits(signal, digits));
        CheckConstant(signal);
    }
    for (const Signal* alias : aliases) {
        CheckTarget(signal, AliasCause(signal, *alias), "an alias", true);
        CheckAlias(signal, *alias);
    }
    CheckLoop(signal);
}

/// What an assignment writes to.
void Assignments::CheckTarget(const Signal& signal, const Cause& cause, std::string_view what,
                              bool isInVhdl) {
    ForEachRun(signal, [&](const Run& run) {
        if (run.isOutside) {
            CheckRange(run, true, isInVhdl, cause);
        }
        context_.uses.ForEach(run, [](Use& use) { use.AddDriver(); });
        if (!HasDirection(*run.declared, Polarity::Input)) {
            return;
        }
        if (Finding* finding = context_.Add(
                RuleId::AssignedInput,
                OnlyWritten(GetRule(RuleId::AssignedInput).verdicts, isInVhdl), cause)) {
            finding->objects = {run.declared};
            finding->message = std::string(what) + " assigns the input port " +
                               Quoted(run.declared->GetNameView());
            finding->other = SignalCause(Names::BaseName(run.declared->GetNameView()));
        }
    });
}

void Assignments::CheckRange(const Run& run, bool isWritten, bool isInVhdl, const Cause& cause) {
    const bool isBit = run.reference->GetSignalType() == SignalTypeBusIndex;
    const bool isRejected =
        isWritten && (isBit || run.isBeyondRight || RunsAgainstParent(*run.reference));
    const Verdicts verdicts =
        OnlyWritten(Verdicts(isRejected ? "rrrrrrwwr" : "wwwrrwwwr"), isInVhdl);
    if (Finding* finding = context_.Add(RuleId::SliceOutside, verdicts, cause)) {
        finding->objects = {run.reference, run.declared};
        finding->message = Quoted(run.reference->GetNameView()) + " lies outside the bus " +
                           Quoted(run.declared->GetNameView());
        finding->other = SignalCause(Names::BaseName(run.declared->GetNameView()));
    }
}

void Assignments::CheckAlias(const Signal& signal, const Signal& alias) {
    ForEachRun(alias, [&](const Run& run) {
        if (run.isOutside) {
            CheckRange(run, false, true, AliasCause(signal, alias));
        }
        context_.uses.ForEach(run, [](Use& use) { use.AddRead(); });
    });
    CheckAliasWidth(signal, alias);
    if (!Writers::IsOpen(signal.GetNameView()) && !Writers::IsOpen(alias.GetNameView())) {
        CheckOutputRead(signal, alias);
    }
}

void Assignments::CheckAliasWidth(const Signal& signal, const Signal& alias) {
    const int left = signal.GetWidth();
    const int right = alias.GetWidth();
    const bool byBits = IsAliasedByBits(signal) || IsAliasedByBits(alias);
    const bool isOpen =
        Writers::IsOpen(signal.GetNameView()) || Writers::IsOpen(alias.GetNameView());
    if (left == right) {
        return;
    }
    const RuleId rule = byBits || isOpen ? RuleId::AliasBits : RuleId::AliasWidth;
    const Verdicts verdicts = isOpen ? Verdicts("......w") : GetRule(rule).verdicts;
    if (Finding* finding = context_.Add(rule, verdicts, AliasCause(signal, alias))) {
        finding->objects = {&signal, &alias};
        finding->message = Quoted(signal.GetNameView()) + " has the width " + std::to_string(left) +
                           ", its alias " + Quoted(alias.GetNameView()) + " has " +
                           std::to_string(right);
        if (byBits) {
            finding->notes = {"Verilog assigns from the right and pads with 0, VHDL assigns " +
                              std::to_string(std::min(left, right)) + " from the left"};
        }
    }
}

/// The alias names the port itself also where a dummy signal is made; a compound gets the dummy
/// signal.
void Assignments::CheckOutputRead(const Signal& signal, const Signal& alias) {
    const bool isCompound = alias.GetSignalType() == SignalTypeCompoundBus;
    ForEachRun(alias, [&](const Run& run) {
        if (!HasDirection(*run.declared, Polarity::Output)) {
            return;
        }
        const std::string dummy =
            Lower(Names::BaseName(run.declared->GetDummySignalName().GetView()));
        if (isCompound && context_.dummies.count(dummy) != 0) {
            return;
        }
        if (Finding* finding = context_.Add(RuleId::OutputRead, AliasCause(signal, alias))) {
            finding->objects = {&signal, run.declared};
            finding->message =
                "an alias reads the output port " + Quoted(run.declared->GetNameView());
            finding->other = SignalCause(Names::BaseName(run.declared->GetNameView()));
        }
    });
}

Finding* Assignments::AddForConstant(RuleId rule, const Verdicts& verdicts, const Signal& signal) {
    Finding* const finding = context_.Add(rule, verdicts, ConstantCause(signal));
    if (finding != nullptr) {
        finding->objects = {&signal};
    }
    return finding;
}

void Assignments::CheckConstant(const Signal& signal) {
    if (IsSingleBit(signal)) {
        return;
    }
    const Digits digits(signal.GetConstantValue(), context_.options.dontCares);
    CheckDigits(signal, digits);
    CheckLength(signal, digits);
    CheckVhdlConstant(signal, digits);
    CheckMeaning(signal, digits);
}

/// Characters that are no digits.
void Assignments::CheckDigits(const Signal& signal, const Digits& digits) {
    Verdicts verdicts;
    if (!digits.IsVerilogNumber()) {
        // Yosys takes a name for a net that it declares.
        const bool isName = !digits.hasLength && Identifier(digits.digits).isVerilog;
        // Verilator takes an underscore before the digits.
        const bool isVerilators = digits.hasLength && digits.HasLeadingUnderscore();
        verdicts.Worsen(Verdicts(isName ? "rrr..rrw" : isVerilators ? "rrr..rwr" : "rrr..rrr"));
    }
    if (digits.HasHighImpedance()) {
        verdicts.Worsen(Verdicts(".......w"));
    }
    if (!IsTiedByBits(signal)) {
        if (!digits.IsVhdlString(false)) {
            verdicts.Worsen(Verdicts("...r....r"));
        }
        if (!digits.IsVhdlString(true)) {
            verdicts.Worsen(Verdicts("....r...r"));
        }
    }
    if (Finding* finding = AddForConstant(RuleId::ConstantCharacter, verdicts, signal)) {
        finding->message = "the constant " + Quoted(digits.digits) + " of " +
                           Quoted(signal.GetNameView()) +
                           " has a character that is no digit everywhere";
    }
}

/// The length that stands before the digits.
void Assignments::CheckLength(const Signal& signal, const Digits& digits) {
    Verdicts verdicts;
    std::string text;
    if (!digits.IsVerilogNumber()) {
        return;
    }
    if (!digits.hasLength) {
        if (digits.GetNeededBits() > 32) {
            verdicts = Verdicts("wwwwwwrww");
            text = "is a decimal number of more than 32 bits in Verilog";
        }
    } else if (digits.length == 0) {
        verdicts = Verdicts("rrrmmr.rm");
        text = "has the length 0";
    } else if (digits.length < 0) {
        verdicts = Verdicts("mmmmmmmmm");
        text = "has a length below 0, which Verilog reads as a sign";
    } else if (digits.GetNeededBits() > static_cast<std::size_t>(digits.length)) {
        verdicts = Verdicts("wwwwwwrww");
        text = "has more digits than its length says";
    } else if (digits.length != signal.GetWidth()) {
        verdicts = Verdicts("......w");
        text = "has the length " + std::to_string(digits.length) + ", its signal has " +
               std::to_string(signal.GetWidth());
    }
    if (Finding* finding = AddForConstant(RuleId::ConstantLength, verdicts, signal)) {
        finding->message = "the constant " + Quoted(digits.digits) + " of " +
                           Quoted(signal.GetNameView()) + " " + text;
    }
}

void Assignments::CheckVhdlConstant(const Signal& signal, const Digits& digits) {
    const std::size_t width = static_cast<std::size_t>(std::max(signal.GetWidth(), 0));
    if (IsTiedByBits(signal)) {
        if (!IsWrittenByBits(signal, digits)) {
            if (Finding* finding = AddForConstant(
                    RuleId::ConstantLeftOut, GetRule(RuleId::ConstantLeftOut).verdicts, signal)) {
                finding->message = "VHDL gets no constant for " + Quoted(signal.GetNameView()) +
                                   ", whose value " + Quoted(digits.digits) +
                                   " is not one binary digit a bit";
            }
        }
        return;
    }
    if (digits.GetVhdlLength() != width) {
        if (Finding* finding =
                AddForConstant(RuleId::ConstantWidth, Verdicts("...rr...r"), signal)) {
            finding->message = "the constant " + Quoted(digits.digits) + " has " +
                               std::to_string(digits.GetVhdlLength()) + " bits in VHDL, " +
                               Quoted(signal.GetNameView()) + " has " + std::to_string(width);
        }
    }
}

/// Whether both languages read the same bits.
void Assignments::CheckMeaning(const Signal& signal, const Digits& digits) {
    const std::size_t width = static_cast<std::size_t>(std::max(signal.GetWidth(), 0));
    if (width > static_cast<std::size_t>(Names::MostExpandedBits)) {
        return;
    }
    const BitText verilog = digits.ReadVerilog(width);
    if (!verilog) {
        return;
    }
    const std::string vhdl = digits.ReadVhdl().value_or("");
    const bool differs = *verilog != vhdl;
    const RuleId rule = digits.hasLength ? RuleId::ConstantLength : RuleId::ConstantDigits;
    Verdicts verdicts;
    if (differs && (!digits.hasLength || vhdl.size() == width)) {
        verdicts = Verdicts("mmm..mmm.");
    } else if (!digits.hasLength && digits.GetNeededBits() > width) {
        verdicts = Verdicts("......w");
    }
    if (Finding* finding = AddForConstant(rule, verdicts, signal)) {
        finding->message = "the constant " + Quoted(digits.digits) + " of " +
                           Quoted(signal.GetNameView()) +
                           (digits.hasLength ? " is cut to its length in Verilog"
                                             : " is a decimal number in Verilog");
        finding->notes = {"Verilog reads the bits " + *verilog + ", VHDL reads " +
                          (vhdl.empty() ? "none" : vhdl)};
    }
}

/// The signal that VHDL knows as no signal, used as any other.
void Assignments::CheckOpen(const Signal& signal) {
    if (Finding* finding = context_.Add(RuleId::OpenSignal, SignalCause(signal.GetNameView()))) {
        finding->objects = {&signal};
        finding->message =
            "the signal " + Quoted(signal.GetNameView()) +
            (signal.IsPort() ? " is a port, which VHDL does not get"
                             : " has a constant or an alias, which VHDL does not get");
    }
}

/// A chain of first aliases that leads back, which most loops are.
void Assignments::CheckLoop(const Signal& signal) {
    constexpr int MostSteps = 64;
    const Signal* at = &signal;
    for (int step = 0; step < MostSteps; ++step) {
        const Iterator<Signal*> aliases = at->GetSignalIterator();
        if (aliases.IsAtEnd()) {
            return;
        }
        at = aliases.GetCurrent();
        if (at == &signal) {
            if (Finding* finding =
                    context_.Add(RuleId::AliasLoop,
                                 AliasCause(signal, *signal.GetSignalIterator().GetCurrent()))) {
                finding->objects = {&signal};
                finding->message =
                    "the aliases of " + Quoted(signal.GetNameView()) + " lead back to it";
            }
            return;
        }
    }
}

/// Nets with two drivers or none.
class Drivers {
public:
    explicit Drivers(Context& context) : context_(context) {}

    void CheckAll() {
        for (const Signal* signal : context_.netlist.GetSignalIterator()) {
            if (signal->IsNeededToDeclared() && !signal->GetNameView().empty()) {
                CheckSignal(*signal);
            }
        }
        LocateDrivers();
    }

private:
    void CheckSignal(const Signal& signal);
    void LocateDrivers();
    void ReportTwoDrivers(const Signal& signal, const Instance& instance, const Pin& pin);

    Context& context_;
    std::unordered_set<const Signal*> drivenTwice_;
};

void Drivers::CheckSignal(const Signal& signal) {
    const int direction = signal.GetPortPolarity().GetValue();
    if (direction == Polarity::Input) {
        return;
    }
    if (context_.uses.IsDrivenTwice(signal)) {
        drivenTwice_.insert(&signal);
    }
    const bool isUndriven =
        direction != Polarity::BiDirectional &&
        (context_.uses.IsUndriven(signal) ||
         (direction == Polarity::Output && context_.uses.IsAnyUndriven(signal)));
    if (!isUndriven) {
        return;
    }
    const std::string_view base = Names::BaseName(signal.GetNameView());
    if (Finding* finding = context_.Add(RuleId::Undriven, SignalCause(base))) {
        finding->objects = {&signal};
        finding->message = "nothing drives " + Quoted(signal.GetNameView()) +
                           (signal.GetSignalType() == SignalTypeBus ? ", or some bits of it" : "");
    }
}

/// The last driver of each net that has two; found by one more walk, which few designs need.
void Drivers::LocateDrivers() {
    if (drivenTwice_.empty()) {
        return;
    }
    std::unordered_map<const Signal*, std::pair<const Instance*, const Pin*>> last;
    for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
        for (const Pin* pin : instance->GetPinIterator()) {
            if (pin->GetSignal() == nullptr || pin->GetPolarity().GetValue() != Polarity::Output) {
                continue;
            }
            ForEachRun(*pin->GetSignal(), [&](const Run& run) {
                if (drivenTwice_.count(run.declared) != 0) {
                    last[run.declared] = {instance, pin};
                }
            });
        }
    }
    for (const Signal* signal : context_.netlist.GetSignalIterator()) {
        if (drivenTwice_.count(signal) == 0) {
            continue;
        }
        const auto found = last.find(signal);
        Cause cause = SignalCause(Names::BaseName(signal->GetNameView()));
        if (found != last.end()) {
            cause = ConnectionOf(*found->second.first, *found->second.second);
        }
        if (Finding* finding = context_.Add(RuleId::TwoDrivers, cause)) {
            finding->objects = {signal};
            finding->message =
                Quoted(signal->GetNameView()) + (signal->GetSignalType() == SignalTypeBus
                                                     ? ", or a bit of it, has two drivers"
                                                     : " has two drivers");
        }
    }
}

} // namespace

void CheckAssignments(Context& context) {
    Assignments(context).CheckAll();
    Drivers(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
