// The pins of the instances: what they are wired to, its width and its direction.

#include "Check/Bits.h"
#include "Check/Context.h"
#include "HdlModel/Netlist/SignalsAhead.h"
#include "Writers/Text.h"

#include <unordered_set>

namespace Orn_Hdl::Checking {

namespace {

/// How many instances ahead their signals are asked for.
constexpr int SignalLead = 6;

bool IsInput(int direction) {
    return direction == Polarity::Input;
}

bool IsOutput(int direction) {
    return direction == Polarity::Output;
}

std::string Bits(std::int64_t width) {
    return std::to_string(width) + (width == 1 ? " bit" : " bits");
}

std::int64_t WidthOf(const Pin& pin) {
    Names::BusName range;
    const bool isBus = pin.GetPinType() == PinTypeBus && Names::ParseBus(pin.GetNameView(), range);
    return isBus ? range.GetBits() : 1;
}

std::string NameOf(const Instance& instance, const Pin& pin) {
    std::string name(instance.GetNameView());
    return name.append(".").append(pin.GetNameView());
}

/// One walk over all instances and their pins.
class Walk {
public:
    explicit Walk(Context& context) : context_(context), open_(context.netlist.GetSignal("open")) {}

    void CheckAll();

private:
    void CheckInstance(const Instance& instance);
    void CheckLatePins(const Instance& instance, const Component& component);
    void CheckPin(const Instance& instance, const Pin& pin);
    void CheckUnwired(const Instance& instance, const Pin& pin);
    void CheckOpen(const Instance& instance, const Pin& pin);
    void CheckWidth(const Instance& instance, const Pin& pin, const Signal& signal);
    void CheckMembers(const Instance& instance, const Pin& pin, const CompoundBus& compound);
    void CheckParts(const Instance& instance, const Pin& pin, const Signal& signal);
    void CheckRange(const Instance& instance, const Pin& pin, const Run& run);
    void NoteDirection(const Instance& instance, const Pin& pin, const Signal& port);
    void NoteUse(Use& use, int direction) const;
    Finding* Add(RuleId rule, const Verdicts& verdicts, const Instance& instance, const Pin& pin);

    Context& context_;
    const Signal* const open_;
    std::unordered_set<const Signal*> readOutputs_;
    std::unordered_set<const Signal*> drivenInputs_;
};

Finding* Walk::Add(RuleId rule, const Verdicts& verdicts, const Instance& instance,
                   const Pin& pin) {
    Finding* const finding = context_.Add(rule, verdicts, ConnectionOf(instance, pin));
    if (finding != nullptr) {
        finding->objects = {&instance, &pin};
    }
    return finding;
}

void Walk::CheckAll() {
    SignalsAhead ahead(context_.netlist, SignalLead);
    for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
        ahead.Step();
        CheckInstance(*instance);
    }
}

void Walk::CheckInstance(const Instance& instance) {
    context_.survey.Look(instance);
    int pinCount = 0;
    for (const Pin* pin : instance.GetPinIterator()) {
        ++pinCount;
        CheckPin(instance, *pin);
    }
    const Component* const component = instance.GetComponent();
    if (component == nullptr) {
        return;
    }
    UsedComponent& used = context_.used[component];
    if (used.firstInstance == nullptr) {
        used.firstInstance = &instance;
        for ([[maybe_unused]] const Pin* pin : component->GetPinIterator()) {
            ++used.pinCount;
        }
    }
    used.hasPlainInstance = used.hasPlainInstance || !instance.HasAttrs();
    if (pinCount != used.pinCount) {
        CheckLatePins(instance, *component);
    }
}

void Walk::CheckLatePins(const Instance& instance, const Component& component) {
    for (const Pin* pin : component.GetPinIterator()) {
        if (instance.GetPin(pin->GetNameView()) != nullptr) {
            continue;
        }
        const bool isInput = IsInput(pin->GetPolarity().GetValue());
        const Verdicts verdicts = isInput ? GetRule(RuleId::LatePin).verdicts : Verdicts("......w");
        if (Finding* finding =
                context_.Add(RuleId::LatePin, verdicts,
                             Named(Kind::Pin, component.GetNameView(), pin->GetNameView()))) {
            finding->objects = {&instance, pin};
            finding->message = "the instance " + Quoted(instance.GetNameView()) + " has no pin " +
                               Quoted(pin->GetNameView()) + ", which its component got later";
            finding->other = Named(Kind::Instance, instance.GetNameView());
        }
    }
}

void Walk::CheckPin(const Instance& instance, const Pin& pin) {
    const Signal* const signal = pin.GetSignal();
    if (signal == nullptr) {
        CheckUnwired(instance, pin);
        return;
    }
    if (signal == open_ && open_->GetSignalType() == SignalTypeScalar) {
        CheckOpen(instance, pin);
        return;
    }
    if (signal->GetSignalType() == SignalTypeScalar) {
        NoteUse(context_.uses.OfScalar(signal), pin.GetPolarity().GetValue());
        if (static_cast<const ScalarSignal*>(signal)->IsPort()) {
            NoteDirection(instance, pin, *signal);
        }
        if (pin.GetPinType() == PinTypeBus) {
            CheckWidth(instance, pin, *signal);
        }
        return;
    }
    CheckParts(instance, pin, *signal);
    CheckWidth(instance, pin, *signal);
    if (signal->GetSignalType() == SignalTypeCompoundBus) {
        CheckMembers(instance, pin, static_cast<const CompoundBus&>(*signal));
    }
}

void Walk::CheckUnwired(const Instance& instance, const Pin& pin) {
    if (!IsInput(pin.GetPolarity().GetValue())) {
        return;
    }
    const bool isTied = !context_.options.vhdl.openPin && pin.GetPinType() != PinTypeBusIndex;
    const Verdicts verdicts = isTied ? Verdicts(".....w") : GetRule(RuleId::OpenInput).verdicts;
    if (Finding* finding = context_.Add(RuleId::OpenInput, verdicts,
                                        Named(Kind::Instance, instance.GetNameView()))) {
        finding->objects = {&instance, &pin};
        finding->message = "nothing is wired to the input pin " + Quoted(NameOf(instance, pin));
    }
}

/// The pin is wired to the signal that stands for no signal.
void Walk::CheckOpen(const Instance& instance, const Pin& pin) {
    if (pin.GetPinType() == PinTypeBus) {
        if (Finding* finding =
                Add(RuleId::OpenBit, GetRule(RuleId::OpenBit).verdicts, instance, pin)) {
            finding->message =
                "the bus pin " + Quoted(NameOf(instance, pin)) + " is wired to the signal open";
        }
    }
    if (IsInput(pin.GetPolarity().GetValue())) {
        if (Finding* finding =
                Add(RuleId::OpenInput, GetRule(RuleId::OpenInput).verdicts, instance, pin)) {
            finding->message =
                "the input pin " + Quoted(NameOf(instance, pin)) + " is wired to the signal open";
        }
    }
}

void Walk::CheckWidth(const Instance& instance, const Pin& pin, const Signal& signal) {
    const std::int64_t pinWidth = WidthOf(pin);
    const std::int64_t signalWidth = signal.GetWidth();
    if (pinWidth == signalWidth) {
        return;
    }
    if (Finding* finding =
            Add(RuleId::PinWidth, GetRule(RuleId::PinWidth).verdicts, instance, pin)) {
        finding->objects.push_back(&signal);
        finding->message = "the pin " + Quoted(NameOf(instance, pin)) + " has " + Bits(pinWidth) +
                           ", the signal " + Quoted(signal.GetNameView()) + " has " +
                           Bits(signalWidth);
        finding->notes = {
            "Verilog pads or cuts the signal at the left; VHDL has no such connection"};
    }
}

void Walk::CheckMembers(const Instance& instance, const Pin& pin, const CompoundBus& compound) {
    for (const Signal* member : compound.GetBusMemberIterator()) {
        if (member == open_ || Names::IsNamed(member->GetNameView(), "open")) {
            if (Finding* finding =
                    Add(RuleId::OpenMember, GetRule(RuleId::OpenMember).verdicts, instance, pin)) {
                finding->message = "a part of " + Quoted(compound.GetNameView()) + " on the pin " +
                                   Quoted(NameOf(instance, pin)) + " is open";
            }
            return;
        }
    }
}

/// Looks at each part of what a pin is wired to.
void Walk::CheckParts(const Instance& instance, const Pin& pin, const Signal& signal) {
    const int direction = pin.GetPolarity().GetValue();
    ForEachRun(signal, [&](const Run& run) {
        if (run.isOutside) {
            CheckRange(instance, pin, run);
        }
        context_.uses.ForEach(run, [&](Use& use) { NoteUse(use, direction); });
        if (run.declared->IsPort()) {
            NoteDirection(instance, pin, *run.declared);
        }
    });
}

void Walk::CheckRange(const Instance& instance, const Pin& pin, const Run& run) {
    const bool drives = !IsInput(pin.GetPolarity().GetValue());
    const bool isBit = run.reference->GetSignalType() == SignalTypeBusIndex;
    const bool isRejected = isBit || run.isFarOutside || run.isBeyondRight;
    const Verdicts verdicts(!drives ? "wwwrrwwwr" : isRejected ? "rrrrrrwrr" : "wwwrrwwrr");
    if (Finding* finding = Add(RuleId::SliceOutside, verdicts, instance, pin)) {
        finding->objects.push_back(run.reference);
        finding->message = Quoted(run.reference->GetNameView()) + " lies outside the bus " +
                           Quoted(run.declared->GetNameView());
        finding->other = SignalCause(Names::BaseName(run.declared->GetNameView()));
    }
}

void Walk::NoteUse(Use& use, int direction) const {
    if (!IsOutput(direction)) {
        use.AddRead();
    }
    if (IsOutput(direction)) {
        use.AddDriver();
    } else if (!IsInput(direction)) {
        use.AddMaybeDriven();
    }
}

void Walk::NoteDirection(const Instance& instance, const Pin& pin, const Signal& port) {
    const int ofPin = pin.GetPolarity().GetValue();
    const int ofPort = port.GetPortPolarity().GetValue();
    if (IsOutput(ofPort) && !IsOutput(ofPin)) {
        if (readOutputs_.insert(&port).second) {
            context_.readOutputs.push_back({&port, &instance, &pin});
        }
    } else if (IsInput(ofPort) && !IsInput(ofPin)) {
        if (drivenInputs_.insert(&port).second) {
            context_.drivenInputs.push_back({&port, &instance, &pin});
        }
    }
}

/// Ports that are used against their direction get a dummy signal, unless its name is taken.
class DummyForesight {
public:
    explicit DummyForesight(Context& context) : context_(context) {}

    void Foresee() {
        for (const Misused& misused : context_.readOutputs) {
            ForeseeOne(misused, true);
        }
        for (const Misused& misused : context_.drivenInputs) {
            ForeseeOne(misused, false);
            ReportDrivenInput(misused);
        }
        ForeseeWired();
    }

private:
    bool CanBeMade(const Signal& port, const std::string& name) const;
    bool Make(const Signal& port);
    void ForeseeOne(const Misused& misused, bool isOutput);
    void ForeseeWired();
    void ReportDrivenInput(const Misused& misused);

    Context& context_;
};

bool DummyForesight::CanBeMade(const Signal& port, const std::string& name) const {
    const bool isBus = port.GetSignalType() == SignalTypeBus;
    return context_.netlist.GetSignal(std::string_view(name)) == nullptr &&
           (!isBus || context_.netlist.GetParentBus(name.c_str()) == nullptr);
}

/// \return false when the port has no dummy signal and gets none.
bool DummyForesight::Make(const Signal& port) {
    if (context_.netlist.GetDummySignal(&port) != nullptr) {
        return true;
    }
    const std::string name(port.GetDummySignalName().GetView());
    if (!CanBeMade(port, name)) {
        return false;
    }
    context_.dummies.emplace(Lower(Names::BaseName(name)), &port);
    return true;
}

void DummyForesight::ForeseeOne(const Misused& misused, bool isOutput) {
    if (Make(*misused.port)) {
        return;
    }
    // VHDL-2008 reads outputs; nothing lets an input be driven.
    const Verdicts verdicts =
        isOutput ? GetRule(RuleId::DummyTaken).verdicts : Verdicts("...rr.rwr");
    if (Finding* finding = context_.Add(RuleId::DummyTaken, verdicts,
                                        ConnectionOf(*misused.instance, *misused.pin))) {
        const std::string_view name = misused.port->GetNameView();
        finding->objects = {misused.port, misused.instance, misused.pin};
        finding->message = "the pin " + Quoted(NameOf(*misused.instance, *misused.pin)) +
                           (isOutput ? " reads the output port " : " drives the input port ") +
                           Quoted(name) + ", which gets no dummy signal";
        finding->notes = {"the name " + Quoted(misused.port->GetDummySignalName().GetView()) +
                          ", or its base name, is taken"};
        finding->other = SignalCause(Names::BaseName(misused.port->GetDummySignalName().GetView()));
    }
}

/// Output ports that several pins drive get a dummy signal too; it can take the name of something
/// else.
void DummyForesight::ForeseeWired() {
    for (const Signal* signal : context_.survey.GetSignals()) {
        const bool isOutput = signal->GetPortPolarity().GetValue() == Polarity::Output;
        if (isOutput && signal->HasMultiDriver()) {
            ForEachRun(*signal, [this](const Run& run) { Make(*run.declared); });
        }
    }
}

void DummyForesight::ReportDrivenInput(const Misused& misused) {
    if (misused.pin->GetPolarity().GetValue() != Polarity::Output) {
        return;
    }
    if (Finding* finding =
            context_.Add(RuleId::DrivenInput, ConnectionOf(*misused.instance, *misused.pin))) {
        finding->objects = {misused.port, misused.instance, misused.pin};
        finding->message = "the output pin " + Quoted(NameOf(*misused.instance, *misused.pin)) +
                           " drives the input port " + Quoted(misused.port->GetNameView());
        finding->other = SignalCause(Names::BaseName(misused.port->GetNameView()));
    }
}

} // namespace

void CheckConnections(Context& context) {
    Walk(context).CheckAll();
    DummyForesight(context).Foresee();
}

} // namespace Orn_Hdl::Checking
