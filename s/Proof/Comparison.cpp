#include "Proof/Comparison.h"

#include "HdlModel/Objects/ObjectKey.h"
#include "Port/Ascii.h"
#include "Proof/Meaning.h"

#include <algorithm>
#include <memory>
#include <utility>

namespace Orn_Hdl::Proving {

using Readers::Place;
using Readers::Quoted;
using std::string_view;

namespace {

/// How many instances ahead of the present one their signals are prefetched.
constexpr int Lead = 4;

std::string BaseOf(const Signal& signal) {
    return std::string(ReadRun(signal.GetNameView()).base);
}

Cause CauseOf(const Signal& signal) {
    return {Kind::Signal, BaseOf(signal), ""};
}

Cause CauseOf(const Instance& instance) {
    return {Kind::Instance, std::string(instance.GetNameView()), ""};
}

/// The name of a pin without its range.
string_view BaseOf(const Pin& pin) {
    const string_view name = pin.GetNameView();
    return pin.GetPinType() == PinTypeScalar ? name : name.substr(0, name.find('('));
}

std::string ShowRange(std::int64_t left, std::int64_t right) {
    return "[" + std::to_string(left) + ":" + std::to_string(right) + "]";
}

std::string Show(const std::optional<Readers::Range>& range) {
    return range ? ShowRange(range->left, range->right) : std::string("one bit");
}

std::string Show(const Run& run) {
    return run.isScalar ? std::string("one bit") : ShowRange(run.left, run.right);
}

/// The range that a signal is declared with.
Run DeclaredRun(const Signal& signal) {
    return signal.GetSignalType() == SignalTypeBus ? ReadRun(signal.GetNameView()) : Run();
}

bool IsRange(const std::optional<Readers::Range>& range, const Run& run) {
    return range ? !run.isScalar && range->left == run.left && range->right == run.right
                 : run.isScalar;
}

std::string ShowDirection(int direction) {
    switch (direction) {
    case Polarity::Input:
        return "an input";
    case Polarity::Output:
        return "an output";
    case Polarity::BiDirectional:
        return "a bidirectional port";
    default:
        return "no port";
    }
}

/// Whether a pin is connected to nothing: without a signal, or to one that means none.
bool IsOpen(const Pin& pin) {
    const Signal* const signal = pin.GetSignal();
    return signal == nullptr || signal->GetNameView().empty() ||
           Port::EqualIgnoringCase(signal->GetNameView(), "open");
}

} // namespace

Comparison::Comparison(const Netlist& design, const HdlOptions& options, Language language,
                       Findings& findings)
    : design_(design), options_(options), language_(language), findings_(findings),
      shared_(design, language), assignments_(design, language, options.dontCares, findings),
      parameters_(design, options, language, findings), signals_(design.GetSignalIterator()),
      instances_(design.GetInstanceIterator()), ahead_(design, Lead) {}

/// The name that the reader finds for one of the design.
string_view Comparison::NameInFile(string_view name) const noexcept {
    return language_ == Language::Verilog ? NameInVerilog(name) : name;
}

bool Comparison::IsNothing(const Signal& signal) const noexcept {
    return Proving::IsNothing(signal.GetNameView(), language_);
}

/// Whether the declaration of a signal bears the name.
bool Comparison::IsDeclaredAs(const Signal& signal, string_view name) const noexcept {
    const string_view full = signal.GetNameView();
    return NameInFile(full) == name ||
           (signal.GetSignalType() == SignalTypeBus && ReadRun(full).base == name);
}

void Comparison::TakeModule(string_view name, const Place& place) {
    place_ = place;
    if (name != NameInFile(design_.GetNameView())) {
        findings_.Add("the module is " + Quoted(name) + ", the design " +
                          Quoted(design_.GetNameView()),
                      place, {Kind::DesignName, "", ""});
    }
}

/// What is to be declared next; null at the end of the ports, and at the end of all.
const Signal* Comparison::NextDeclared() {
    for (; !signals_.IsAtEnd(); signals_.Next()) {
        const Signal* const signal = signals_.GetCurrent();
        if (signal->IsNeededToDeclared() && signal->IsPort() == isAmongPorts_ &&
            !IsNothing(*signal)) {
            return signal;
        }
    }
    return nullptr;
}

void Comparison::ReportUndeclared(const Signal& signal, const Place& place) {
    findings_.Add(std::string(signal.IsPort() ? "the port " : "the signal ") +
                      Quoted(signal.GetNameView()) + " is not declared where it should be",
                  place, CauseOf(signal));
}

/// Reports what is left out up to a signal, which is yet to come.
void Comparison::SkipTo(const Signal& signal, const Place& place) {
    for (const Signal* next = NextDeclared(); next != &signal; next = NextDeclared()) {
        ReportUndeclared(*next, place);
        signals_.Next();
    }
}

/// Reports what is left out of the present group: ports, or signals inside.
void Comparison::EndDeclarations(const Place& place) {
    while (const Signal* const next = NextDeclared()) {
        ReportUndeclared(*next, place);
        signals_.Next();
    }
}

Signal* Comparison::Declare(const std::string& name, const std::optional<Readers::Range>& range,
                            int direction, const Place& place) {
    place_ = place;
    if (isAmongPorts_ && !Polarity::IsValidValue(direction)) {
        EndDeclarations(place);
        isAmongPorts_ = false;
        signals_ = design_.GetSignalIterator();
    }
    const Signal* const next = NextDeclared();
    const bool isNext = next != nullptr && IsDeclaredAs(*next, name) && !shared_.Contains(name);
    // The signals are the netlist's, which nobody changes here.
    Signal* const own = isNext ? const_cast<Signal*>(next) : FindInDesign(name);
    if (own == nullptr || !own->IsNeededToDeclared() || own->IsPort() != isAmongPorts_) {
        findings_.Add(Quoted(name) + " is declared as " + ShowDirection(direction) +
                          ", the design has no such signal",
                      place, next == nullptr ? Cause() : CauseOf(*next));
        return DeclareStranger(name, range);
    }
    if (own != next) {
        Iterator<Signal*> ahead = signals_;
        while (!ahead.IsAtEnd() && ahead.GetCurrent() != own) {
            ahead.Next();
        }
        if (ahead.IsAtEnd()) {
            findings_.Add(Quoted(name) + " is declared out of order, or twice", place,
                          CauseOf(*own));
            return DeclareStranger(name, range);
        }
        SkipTo(*own, place);
    }
    signals_.Next();
    if (ObjectKey::Get(*own) != own->GetNameView()) {
        renamed_.emplace(name, own);
    }
    parameters_.AddSignal(*own);
    return CheckDeclared(*own, range, direction, place) ? own : DeclareStranger(name, range);
}

bool Comparison::CheckDeclared(const Signal& signal, const std::optional<Readers::Range>& range,
                               int direction, const Place& place) {
    const int meant = signal.GetPortPolarity().GetValue();
    if (isAmongPorts_ && direction != meant) {
        findings_.Add(Quoted(signal.GetNameView()) + " is " + ShowDirection(direction) +
                          ", in the design " + ShowDirection(meant),
                      place, CauseOf(signal));
    }
    const Run run = DeclaredRun(signal);
    if (IsRange(range, run)) {
        return true;
    }
    findings_.Add(Quoted(BaseOf(signal)) + " is declared as " + Show(range) +
                      ", in the design as " + Show(run),
                  place, CauseOf(signal));
    return false;
}

Signal* Comparison::DeclareStranger(const std::string& name,
                                    const std::optional<Readers::Range>& range) {
    std::unique_ptr<Signal> signal;
    if (range) {
        const std::string text =
            name + "(" + std::to_string(range->left) + ":" + std::to_string(range->right) + ")";
        signal = std::make_unique<Bus>(text.c_str());
    } else {
        signal = std::make_unique<ScalarSignal>(name.c_str());
    }
    Signal* const added = signal.get();
    strangers_.Add(signal.release());
    hasStrangers_ = true;
    // The netlist owns it now.
    // cppcheck-suppress returnDanglingLifetime
    return added;
}

/// The signal of the design that has the name in the netlist: exactly, letter case counts.
Signal* Comparison::FindInDesign(string_view name) const {
    if (!renamed_.empty()) {
        const auto found = renamed_.find(std::string(name));
        if (found != renamed_.end()) {
            return found->second;
        }
    }
    const auto find = [this](string_view spelled) -> Signal* {
        Signal* const signal = design_.GetSignal(spelled);
        if (signal != nullptr && signal->GetNameView() == spelled) {
            return signal;
        }
        Bus* const bus = design_.GetParentBus(std::string(spelled).c_str());
        return bus != nullptr && BaseOf(*bus) == spelled ? bus : nullptr;
    };
    if (Signal* const signal = find(name)) {
        return signal;
    }
    return language_ == Language::Verilog ? find("\\" + std::string(name) + " ") : nullptr;
}

Signal* Comparison::FindSignal(string_view name) {
    if (expected_ != nullptr && expected_->GetNameView() == name) {
        return const_cast<Signal*>(expected_);
    }
    if (hasStrangers_) {
        Signal* const signal = strangers_.GetSignal(name);
        Bus* const bus = strangers_.GetParentBus(std::string(name).c_str());
        if (signal != nullptr && signal->GetNameView() == name) {
            return signal;
        }
        if (bus != nullptr && BaseOf(*bus) == name) {
            return bus;
        }
    }
    return FindInDesign(name);
}

/// Reports the instances that are left out up to one that is yet to come.
void Comparison::SkipTo(const Instance& instance, const Place& place) {
    for (; instances_.GetCurrent() != &instance; instances_.Next()) {
        const Instance& left = *instances_.GetCurrent();
        findings_.Add("the instance " + Quoted(left.GetNameView()) + " is not where it should be",
                      place, CauseOf(left));
    }
}

/// The first of several components whose names differ in letter case alone is the one declared.
void Comparison::TakeComponent(const Readers::ModuleHead& head, const Place& place) {
    place_ = place;
    const Component* const component = design_.GetComponent(string_view(head.name));
    if (component == nullptr || component->GetNameView() != head.name) {
        findings_.Add("the component " + Quoted(head.name) + " is none of the design", place, {});
        return;
    }
    declared_.insert(component);
    ComparePorts(*component, head, place);
    parameters_.BeginComponent(*component, head, place);
}

void Comparison::ComparePorts(const Component& component, const Readers::ModuleHead& head,
                              const Place& place) {
    const auto report = [&](const std::string& what, const Pin& pin, const Place& where) {
        findings_.Add(
            "the pin " + Quoted(pin.GetNameView()) + " of the component " + Quoted(head.name) +
                " " + what,
            where,
            {Kind::Pin, std::string(component.GetNameView()), std::string(pin.GetNameView())});
    };
    std::size_t next = 0;
    for (const Pin* pin : component.GetPinIterator()) {
        if (next == head.ports.size()) {
            report("is not declared", *pin, place);
            return;
        }
        const Readers::PortHead& port = head.ports[next++];
        const Run run = pin->GetPinType() == PinTypeBus ? ReadRun(pin->GetNameView()) : Run();
        if (!port.problem.empty()) {
            report("cannot be declared like this: " + port.problem, *pin, port.place);
        } else if (port.name != BaseOf(*pin)) {
            report("is declared as " + Quoted(port.name), *pin, port.place);
        } else if (!IsRange(port.range, run)) {
            report("is declared as " + Show(port.range), *pin, port.place);
        } else if (port.direction != pin->GetPolarity().GetValue()) {
            report("is declared as " + ShowDirection(port.direction), *pin, port.place);
        }
    }
    if (next < head.ports.size()) {
        findings_.Add("the component " + Quoted(head.name) + " has no pin " +
                          Quoted(head.ports[next].name) + " in the design",
                      head.ports[next].place,
                      {Kind::Component, std::string(component.GetNameView()), ""});
    }
}

/// What the configuration binds: the instances of each component that is no primitive.
void Comparison::FindBound() {
    hasBound_ = true;
    for (const Instance* instance : design_.GetInstanceIterator()) {
        const Component* const component = instance->GetComponent();
        const Attribute* const level = component == nullptr ? nullptr : component->GetAttr("Level");
        if (component != nullptr &&
            (level == nullptr ||
             !Port::EqualIgnoringCase(level->GetValueString().GetView(), "HALVEX"))) {
            bound_[component].push_back(instance);
        }
    }
}

void Comparison::TakeBinding(const std::vector<std::string>& instances,
                             const std::string& component, const Place& place) {
    place_ = place;
    if (!hasBound_) {
        FindBound();
    }
    const auto bound = bound_.find(design_.GetComponent(string_view(component)));
    const bool isSame =
        bound != bound_.end() && bound->first->GetNameView() == component &&
        std::equal(instances.begin(), instances.end(), bound->second.begin(), bound->second.end(),
                   [](const std::string& label, const Instance* instance) {
                       return instance->GetNameView() == label;
                   });
    if (!isSame) {
        findings_.Add("the configuration binds other instances to " + Quoted(component) +
                          " than the design has",
                      place, {Kind::Component, component, ""});
    }
    if (bound != bound_.end()) {
        bound_.erase(bound);
    }
}

/// Reports components that instances have and that are not declared.
void Comparison::EndComponents() {
    if (language_ == Language::Verilog) {
        return;
    }
    for (const Component* component : used_) {
        if (component != nullptr && !options_.vhdl.suppressComponent &&
            declared_.count(component) == 0) {
            findings_.Add("the component " + Quoted(component->GetNameView()) + " is not declared",
                          place_, {Kind::Component, std::string(component->GetNameView()), ""});
        }
    }
    if (options_.vhdl.suppressComponent && !declared_.empty()) {
        findings_.Add("components are declared, against an option", place_,
                      {Kind::Option, "SUPPRESS COMPONENT", ""});
    }
    if (!hasBound_) {
        FindBound();
    }
    if (!options_.vhdl.suppressConfiguration && !bound_.empty()) {
        findings_.Add("the configuration does not bind the instances of " +
                          Quoted(bound_.begin()->first->GetNameView()),
                      place_, {});
    }
}

void Comparison::BeginInstance(string_view name, const Readers::ModuleHead& head,
                               const Place& place) {
    EndInstance();
    parameters_.EndInstance(place_);
    place_ = place;
    ahead_.Step();
    const auto isNamed = [this, name](const Instance& instance) {
        return NameInFile(instance.GetNameView()) == name;
    };
    const Instance* next = instances_.GetCurrent();
    if (next == nullptr || !isNamed(*next)) {
        Iterator<Instance*> ahead = instances_;
        while (!ahead.IsAtEnd() && !isNamed(*ahead.GetCurrent())) {
            ahead.Next();
        }
        if (ahead.IsAtEnd()) {
            findings_.Add("the instance " + Quoted(name) +
                              " is none of the design, or out of order",
                          place, next == nullptr ? Cause() : CauseOf(*next));
            return;
        }
        next = ahead.GetCurrent();
        SkipTo(*next, place);
    }
    instances_.Next();
    CheckInstance(*next, head, place);
}

void Comparison::CheckInstance(const Instance& instance, const Readers::ModuleHead& head,
                               const Place& place) {
    instance_ = &instance;
    parameters_.BeginInstance(instance);
    pins_.clear();
    for (const Pin* pin : instance.GetPinIterator()) {
        pins_.push_back(pin);
    }
    isConnected_.assign(pins_.size(), false);
    nextPin_ = 0;
    expected_ = pins_.empty() ? nullptr : pins_.front()->GetSignal();
    const Component* const component = instance.GetComponent();
    const string_view type = component == nullptr ? string_view() : component->GetNameView();
    if (language_ == Language::Vhdl) {
        used_.insert(component);
    }
    if (NameInFile(type) != head.name) {
        findings_.Add(Quoted(instance.GetNameView()) + " is an instance of " + Quoted(head.name) +
                          ", in the design of " + Quoted(type),
                      place, CauseOf(instance));
    }
    // Another object of the name is what the name means elsewhere.
    if (shared_.Contains(NameInFile(instance.GetNameView()))) {
        findings_.Add("the name of the instance " + Quoted(instance.GetNameView()) +
                          " is that of another object, too",
                      place, CauseOf(instance));
    }
}

/// Reports what should be connected and is not.
void Comparison::EndInstance() {
    expected_ = nullptr;
    if (instance_ == nullptr) {
        return;
    }
    for (std::size_t i = 0; i < pins_.size(); ++i) {
        if (!isConnected_[i] && !IsOpen(*pins_[i])) {
            ReportConnection(*pins_[i], "is open", place_);
        }
    }
    parameters_.EndInstance(place_);
    instance_ = nullptr;
}

/// The pin that a port is; the number of pins when there is none. Pins come in the design's order.
std::size_t Comparison::FindPin(string_view port) {
    for (std::size_t i = 0; i < pins_.size(); ++i) {
        const std::size_t index = (nextPin_ + i) % pins_.size();
        if (NameInFile(BaseOf(*pins_[index])) == port) {
            return index;
        }
    }
    return pins_.size();
}

void Comparison::ReportConnection(const Pin& pin, const std::string& found, const Place& place) {
    const Signal* const signal = pin.GetSignal();
    findings_.Add(
        "the pin " + Quoted(pin.GetNameView()) + " of " + Quoted(instance_->GetNameView()) + " " +
            found + ", in the design " +
            (IsOpen(pin) ? "it is open" : "to " + Quoted(signal->GetNameView())),
        place,
        {Kind::Connection, std::string(instance_->GetNameView()), std::string(pin.GetNameView())});
}

bool Comparison::AreSame(const Signal& signal, const Readers::Members& members) {
    if (members.size() == 1 && members.front() == &signal) {
        return true;
    }
    runs_.clear();
    for (const Signal* member : members) {
        AppendRuns(*member, runs_);
    }
    bits_.Set(signal);
    return bits_.Take(runs_) && bits_.IsEmpty();
}

void Comparison::Connect(const Readers::PortHead& port, const Readers::Members& members,
                         const Place& place) {
    place_ = place;
    if (instance_ == nullptr) {
        return;
    }
    const std::size_t index = FindPin(port.name);
    if (index == pins_.size()) {
        findings_.Add(Quoted(instance_->GetNameView()) + " has no pin " + Quoted(port.name) +
                          " in the design",
                      place, CauseOf(*instance_));
        return;
    }
    const Pin& pin = *pins_[index];
    isConnected_[index] = true;
    nextPin_ = index + 1;
    expected_ = nextPin_ < pins_.size() ? pins_[nextPin_]->GetSignal() : nullptr;
    if (IsOpen(pin) || !AreSame(*pin.GetSignal(), members)) {
        runs_.clear();
        for (const Signal* member : members) {
            AppendRuns(*member, runs_);
        }
        ReportConnection(pin, "is connected to " + Quoted(TextOf(runs_)), place);
    }
}

void Comparison::ConnectConstant(const Readers::PortHead& port, const Place& place) {
    place_ = place;
    const std::size_t index = instance_ == nullptr ? pins_.size() : FindPin(port.name);
    if (index < pins_.size()) {
        isConnected_[index] = true;
        ReportConnection(*pins_[index], "is connected to a constant", place);
    }
}

void Comparison::Assign(const Readers::Members& target, const Readers::Members& source,
                        const Place& place) {
    place_ = place;
    assignments_.Assign(target, source, place);
}

void Comparison::Tie(const Readers::Members& target, const std::string& bits, const Place& place) {
    place_ = place;
    assignments_.Tie(target, bits, place);
}

void Comparison::TakeParameter(const Readers::Owner& owner, const std::string& name,
                               const Readers::Value& value, bool isHidden, const Place& place) {
    place_ = place;
    if (owner.kind == Readers::Owner::Instance) {
        parameters_.TakeOfInstance(name, value, isHidden, place);
    } else {
        parameters_.TakeOfModule(name, value, isHidden, place);
    }
}

void Comparison::TakeAttribute(const Readers::Owner& owner, const std::string& name,
                               const Readers::Value& value, bool isDeclared, const Place& place) {
    place_ = place;
    switch (owner.kind) {
    case Readers::Owner::Component:
    case Readers::Owner::Instance:
        parameters_.TakeAttribute(owner, name, value, isDeclared, place);
        break;
    case Readers::Owner::Signal:
        parameters_.TakeAttribute(*owner.signal, name, value, isDeclared, place);
        break;
    default:
        findings_.Add("the module has the attribute " + Quoted(name) + ", which no design gives it",
                      place, {Kind::DesignName, "", ""});
    }
}

void Comparison::End() {
    EndInstance();
    EndDeclarations(place_);
    if (isAmongPorts_) {
        isAmongPorts_ = false;
        signals_ = design_.GetSignalIterator();
        EndDeclarations(place_);
    }
    assignments_.End(place_);
    parameters_.End(place_);
    EndComponents();
    for (; !instances_.IsAtEnd(); instances_.Next()) {
        const Instance& left = *instances_.GetCurrent();
        findings_.Add("the instance " + Quoted(left.GetNameView()) + " is not in the netlist",
                      place_, CauseOf(left));
    }
}

} // namespace Orn_Hdl::Proving
