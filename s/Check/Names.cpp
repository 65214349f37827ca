// The spelling of every name that is written.

#include "HdlModel/Names/Names.h"
#include "Check/Context.h"
#include "Check/Identifier.h"
#include "Check/NameCheck.h"
#include "Check/ReservedWords.h"
#include "Writers/Text.h"

#include <algorithm>
#include <limits>

namespace Orn_Hdl::Checking {

namespace {

using VerilogOption = HdlOptions::VerilogOption;

constexpr std::size_t LongestInGhdl = 1023;
/// A longer module cannot be named as the top of the design.
constexpr std::size_t LongestTopInVerilator = 127;
constexpr std::size_t LongestInIcarus = 16000;
constexpr std::size_t LongestInStandard = 1024;

void AddFinding(Context& context, RuleId rule, const Verdicts& verdicts, const NameUse& use,
                std::string_view what) {
    Verdicts counted = verdicts;
    if (use.isHiddenFromYosys) {
        counted.Set(Check::Target::Yosys, Check::Verdict::Accepts);
    }
    if (Finding* finding = context.Add(rule, counted, use.MakeCause())) {
        if (use.object != nullptr) {
            finding->objects = {use.object};
        }
        finding->message = std::string("the name ") + Quoted(use.name.substr(0, 80)) + " of " +
                           std::string(use.what) + std::string(what);
    }
}

Verdicts Both(const NameUse& use, std::string_view letters) {
    Check::Targets languages = use.isInVerilog ? Check::Targets::Verilog() : Check::Targets();
    Verdicts verdicts(letters);
    if (use.isInVerilog && use.isInVhdl) {
        return verdicts;
    }
    if (use.isInVhdl) {
        languages = Check::Targets::Vhdl();
    }
    verdicts.Restrict(languages);
    return verdicts;
}

void CheckLength(Context& context, const NameUse& use) {
    const std::size_t length = use.name.size();
    if (length <= LongestTopInVerilator) {
        return;
    }
    Verdicts verdicts(length > LongestInGhdl ? "........r" : "");
    if (use.kind == Kind::DesignName) {
        verdicts.Worsen(Verdicts("......r"));
    }
    if (length > LongestInStandard) {
        verdicts.Worsen(Verdicts("www"));
    }
    if (length > LongestInIcarus) {
        verdicts.Worsen(Verdicts(".....r"));
    }
    Verdicts counted = Both(use, "rrrrrrrrr");
    for (const Check::Target target : Check::GetTargets()) {
        if (counted.Get(target) == Check::Verdict::Accepts) {
            verdicts.Set(target, Check::Verdict::Accepts);
        }
    }
    AddFinding(context, RuleId::NameLength, verdicts, use,
               " has " + std::to_string(length) + " characters");
}

void CheckSpelling(Context& context, const NameUse& use) {
    const Identifier identifier(use.name);
    const bool badInVerilog = use.isInVerilog && !identifier.isVerilog;
    const bool badInVhdl = use.isInVhdl && !identifier.isVhdl;
    if (badInVerilog || badInVhdl) {
        // Yosys takes a name with a dot.
        const bool hasDot = use.name.find('.') != std::string_view::npos;
        Verdicts verdicts(!badInVerilog ? "" : hasDot ? "rrr..rrw" : "rrr..rrr");
        verdicts.Worsen(Verdicts(badInVhdl ? "...rr...r" : ""));
        AddFinding(context, RuleId::IllegalName, verdicts, use,
                   badInVerilog && badInVhdl ? " is no identifier"
                   : badInVhdl               ? " is no identifier of VHDL"
                                             : " is no identifier of Verilog");
    } else if (use.isInVhdl && !identifier.hasProperUnderscores) {
        AddFinding(context, RuleId::Underscores, GetRule(RuleId::Underscores).verdicts, use,
                   " has an underscore at an end, or two in a row");
    }
}

void CheckReserved(Context& context, const NameUse& use) {
    const std::string_view vhdlName = use.isInVhdl ? use.name : std::string_view();
    const bool isChanged = use.nameCase != VerilogOption::DEFSULT;
    const std::string changed = isChanged ? Spell(use.name, use.nameCase) : std::string();
    const std::string_view verilogName = !use.isInVerilog ? std::string_view()
                                         : isChanged      ? std::string_view(changed)
                                                          : use.name;
    const Verdicts verdicts = FindReserved(verilogName, vhdlName);
    if (!(verdicts == Verdicts())) {
        AddFinding(context, RuleId::ReservedWord, verdicts, use, " is a reserved word");
    }
}

/// Whether the writers write another index, the greatest or least of 32 bits.
bool IsCut(std::string_view text, int index) {
    const bool isLimit =
        index == std::numeric_limits<int>::max() || index == std::numeric_limits<int>::min();
    if (!isLimit) {
        return false;
    }
    text.remove_prefix(!text.empty() && (text.front() == '+' || text.front() == '-') ? 1 : 0);
    text.remove_prefix(std::min(text.find_first_not_of('0'), text.size()));
    return text != (index < 0 ? "2147483648" : "2147483647");
}

/// The names of the design's objects.
class NameWalk {
public:
    explicit NameWalk(Context& context) : context_(context), options_(context.options) {}

    void CheckAll() {
        CheckModule();
        CheckSignals();
        CheckInstances();
        CheckComponents();
    }

private:
    void CheckModule();
    void CheckSignals();
    bool CheckIndices(const Names::BusName& range, const Cause& cause, const Object& object);
    void CheckRange(const Signal& signal);
    void CheckInstances();
    void CheckComponents();
    void CheckPins(const Component& component);

    Context& context_;
    const HdlOptions& options_;
};

void NameWalk::CheckModule() {
    NameUse use;
    use.name = context_.netlist.GetNameView();
    use.what = "the design";
    use.kind = Kind::DesignName;
    use.object = &context_.netlist;
    CheckName(context_, use);
}

void NameWalk::CheckSignals() {
    NameUse use;
    use.kind = Kind::Signal;
    use.nameCase = options_.verilog.signalCase;
    for (const Signal* signal : context_.survey.GetSignals()) {
        if (!signal->IsNeededToDeclared() || signal->GetNameView().empty()) {
            continue;
        }
        const bool isBus = signal->GetSignalType() == SignalTypeBus;
        Names::BusName range;
        const bool hasRange = isBus && Names::ParseBus(signal->GetNameView(), range);
        use.name = hasRange ? range.base : signal->GetNameView();
        use.what = signal->IsPort() ? "a port" : "a signal";
        use.object = signal;
        use.isInVhdl = !Writers::IsOpen(signal->GetNameView());
        CheckName(context_, use);
        if (hasRange) {
            CheckRange(*signal);
        }
    }
}

/// \return whether there is an index of more than 32 bits.
bool NameWalk::CheckIndices(const Names::BusName& range, const Cause& cause, const Object& object) {
    if (!IsCut(range.left, range.leftIndex) && !IsCut(range.right, range.rightIndex)) {
        return false;
    }
    if (Finding* finding = context_.Add(RuleId::WideBus, Verdicts("mmmmmmmrm"), cause)) {
        finding->objects = {&object};
        finding->message =
            "the bus " + Quoted(object.GetNameView()) + " has an index of more than 32 bits";
    }
    return true;
}

void NameWalk::CheckRange(const Signal& signal) {
    constexpr std::int64_t MostInStandard = 65536;
    constexpr std::int64_t MostInYosys = 16000000;
    constexpr std::int64_t MostInVerilator = 1000000000;
    constexpr int GreatestIndex = std::numeric_limits<int>::max() - 64;
    Names::BusName range;
    if (!Names::ParseBus(signal.GetNameView(), range)) {
        return;
    }
    if (CheckIndices(range, SignalCause(range.base), signal)) {
        return;
    }
    const std::int64_t bits = range.GetBits();
    const bool isHigh = range.leftIndex > GreatestIndex || range.rightIndex > GreatestIndex;
    if (bits <= MostInStandard && !isHigh) {
        return;
    }
    Verdicts verdicts("www..w.w");
    if (bits > MostInYosys || isHigh) {
        verdicts.Worsen(Verdicts(".......r"));
    }
    if (bits > MostInVerilator) {
        verdicts.Worsen(Verdicts("wwwww.r.w"));
    }
    if (Finding* finding = context_.Add(RuleId::WideBus, verdicts, SignalCause(range.base))) {
        finding->objects = {&signal};
        finding->message =
            "the bus " + Quoted(signal.GetNameView()) + " has " + std::to_string(bits) + " bits";
    }
}

void NameWalk::CheckInstances() {
    NameUse use;
    use.kind = Kind::Instance;
    use.what = "an instance";
    use.nameCase = options_.verilog.instanceCase;
    for (const Instance* instance : context_.survey.GetInstances()) {
        use.name = instance->GetNameView();
        use.object = instance;
        CheckName(context_, use);
    }
}

void NameWalk::CheckComponents() {
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        if (context_.used.count(component) == 0) {
            continue;
        }
        NameUse use;
        use.kind = Kind::Component;
        use.what = "a component";
        use.nameCase = options_.verilog.componentCase;
        use.name = component->GetNameView();
        use.object = component;
        CheckName(context_, use);
        CheckPins(*component);
    }
}

void NameWalk::CheckPins(const Component& component) {
    std::unordered_map<std::string, const Pin*> bases;
    for (const Pin* pin : component.GetPinIterator()) {
        const std::string_view base = Writers::GetBaseName(*pin);
        NameUse use;
        use.kind = Kind::Pin;
        use.what = "a pin";
        use.name = base;
        use.object = pin;
        use.first = component.GetNameView();
        use.second = pin->GetNameView();
        CheckName(context_, use);
        const auto [other, isNew] = bases.emplace(Lower(base), pin);
        const Cause cause = Named(Kind::Pin, component.GetNameView(), pin->GetNameView());
        if (!isNew) {
            const bool isSame = Writers::GetBaseName(*other->second) == base;
            if (Finding* finding = context_.Add(
                    RuleId::PinTwice, Verdicts(isSame ? "rrrrrrr.r" : "...rr...r"), cause)) {
                finding->objects = {pin, other->second};
                finding->message = "the pins " + Quoted(other->second->GetNameView()) + " and " +
                                   Quoted(pin->GetNameView()) + " of " +
                                   Quoted(component.GetNameView()) + " are written as one";
                finding->other =
                    Named(Kind::Pin, component.GetNameView(), other->second->GetNameView());
            }
        }
        Names::BusName range;
        if (Names::ParseBus(pin->GetNameView(), range)) {
            CheckIndices(range, cause, *pin);
        }
        if (pin->GetPinType() == PinTypeBusIndex) {
            if (Finding* finding = context_.Add(RuleId::BitPin, cause)) {
                finding->objects = {pin};
                finding->message = "the pin " + Quoted(pin->GetNameView()) + " of " +
                                   Quoted(component.GetNameView()) + " is a single bit";
            }
        }
    }
}

} // namespace

Cause NameUse::MakeCause() const {
    return first.empty() && second.empty() ? Named(kind, name) : Named(kind, first, second);
}

void CheckName(Context& context, const NameUse& use) {
    CheckLength(context, use);
    CheckSpelling(context, use);
    CheckReserved(context, use);
}

void CheckNames(Context& context) {
    NameWalk(context).CheckAll();
}

} // namespace Orn_Hdl::Checking
