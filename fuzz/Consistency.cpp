#include "Consistency.h"

#include "Check.h"
#include "Port/Ascii.h"

#include <cstddef>
#include <set>
#include <string>
#include <unordered_set>

namespace Fuzz {

namespace {

using namespace Orn_Hdl;

template <class T> using Alive = std::unordered_set<const T*>;

template <class T>
void CheckList(const Iterator<T*>& list, const Alive<T>& alive, bool unique, const char* what) {
    Alive<T> met;
    for (const T* element : list) {
        Check(element != nullptr, std::string(what) + ": no null");
        Check(alive.count(element) == 1, std::string(what) + ": alive");
        Check(met.insert(element).second || !unique, std::string(what) + ": once");
    }
}

template <class T> bool Contains(const Iterator<T*>& list, const T* wanted) {
    for (const T* element : list) {
        if (element == wanted) {
            return true;
        }
    }
    return false;
}

class Checker {
public:
    Checker(const Netlist& netlist, const std::vector<Signal*>& loose) : netlist_(netlist) {
        for (Signal* signal : netlist.GetSignalIterator()) {
            signals_.insert(signal);
        }
        signals_.insert(loose.begin(), loose.end());
        for (const Component* component : netlist.GetComponentIterator()) {
            components_.insert(component);
            AddPins(component->GetPinIterator());
        }
        for (const Instance* instance : netlist.GetInstanceIterator()) {
            AddPins(instance->GetPinIterator());
        }
    }

    void Run() {
        for (const Component* component : components_) {
            CheckPins(component->GetPinIterator());
        }
        for (const Instance* instance : netlist_.GetInstanceIterator()) {
            const Component* const component = instance->GetComponent();
            Check(component == nullptr || components_.count(component) == 1,
                  "an instance's component: alive");
            Check((component == nullptr) == instance->GetComponentName().IsEmpty() ||
                      (component != nullptr && component->GetNameView().empty()),
                  "an instance without a component has no component name");
            CheckPins(instance->GetPinIterator());
        }
        for (const Signal* signal : signals_) {
            CheckSignal(*signal);
        }
    }

private:
    void AddPins(const Iterator<Pin*>& pins) {
        for (const Pin* pin : pins) {
            Check(pins_.insert(pin).second, "a pin has one owner");
        }
    }

    void CheckPins(const Iterator<Pin*>& pins) const {
        for (const Pin* pin : pins) {
            Check(pin->GetSignal() == nullptr || signals_.count(pin->GetSignal()) == 1,
                  "a pin's signal: alive");
            pin->GetBaseName();
            pin->GetPolarityName();
        }
    }

    void CheckSignal(const Signal& signal) {
        CheckList(signal.GetPinIterator(), pins_, true, "a signal's pins");
        CheckList(signal.GetSignalIterator(), signals_, true, "a signal's aliases");
        Check(!Contains(signal.GetSignalIterator(), &signal), "a signal is no alias of itself");
        Check(signal.GetWidth() >= 0, "a width is not negative");
        signal.GetPortPolarity();
        signal.GetDummySignalName();
        signal.HasMultiDriver();
        signal.GetBaseName(names_);
        switch (signal.GetSignalType()) {
        case SignalTypeBus:
            return CheckBus(static_cast<const Bus&>(signal));
        case SignalTypeBusSlice:
            return CheckParent(signal, static_cast<const BusSlice&>(signal).GetParentBus());
        case SignalTypeBusIndex:
            return CheckParent(signal, static_cast<const BusIndex&>(signal).GetParentBus());
        case SignalTypeCompoundBus:
            return CheckCompound(static_cast<const CompoundBus&>(signal));
        default:
            return;
        }
    }

    void CheckBus(const Bus& bus) const {
        CheckList(bus.GetBusSliceIterator(), signals_, true, "a bus's parts");
        for (const Signal* part : bus.GetBusSliceIterator()) {
            if (part->GetSignalType() == SignalTypeBusSlice) {
                Check(static_cast<const BusSlice*>(part)->GetParentBus() == &bus,
                      "a bus is its slice's parent");
            } else if (part->GetSignalType() == SignalTypeBusIndex) {
                Check(static_cast<const BusIndex*>(part)->GetParentBus() == &bus,
                      "a bus is its bit's parent");
            }
        }
    }

    void CheckParent(const Signal& part, const Bus* parent) const {
        if (parent != nullptr) {
            Check(signals_.count(parent) == 1, "a parent bus: alive");
            Check(Contains(parent->GetBusSliceIterator(), &part), "a parent bus lists its part");
        }
    }

    void CheckCompound(const CompoundBus& compound) const {
        CheckList(compound.GetBusMemberIterator(), signals_, false, "a compound's members");
        // Down through the members, each compound once: the way never leads back.
        std::vector<const CompoundBus*> rest{&compound};
        std::set<const CompoundBus*> met;
        while (!rest.empty()) {
            const CompoundBus* const at = rest.back();
            rest.pop_back();
            for (const Signal* member : at->GetBusMemberIterator()) {
                Check(member != &compound, "a compound does not contain itself");
                if (member->GetSignalType() == SignalTypeCompoundBus) {
                    const auto* const inner = static_cast<const CompoundBus*>(member);
                    if (met.insert(inner).second) {
                        rest.push_back(inner);
                    }
                }
            }
        }
    }

    const Netlist& netlist_;
    Alive<Signal> signals_;
    Alive<Component> components_;
    Alive<Pin> pins_;
    StringSet names_;
};

template <class T, class Find> void CheckFound(const Iterator<T*>& objects, Find find) {
    for (const T* object : objects) {
        const T* const found = find(object->GetNameView());
        Check(found != nullptr, "what a netlist holds is found by its name");
        Check(Port::EqualIgnoringCase(found->GetNameView(), object->GetNameView()),
              "what is found has the wanted name");
    }
}

} // namespace

void CheckNetlist(const Netlist& netlist, const std::vector<Signal*>& loose) {
    Checker(netlist, loose).Run();
}

void CheckNames(const Netlist& netlist) {
    using std::string_view;
    CheckFound(netlist.GetSignalIterator(),
               [&](string_view name) { return netlist.GetSignal(name); });
    CheckFound(netlist.GetInstanceIterator(),
               [&](string_view name) { return netlist.GetInstance(name); });
    CheckFound(netlist.GetComponentIterator(),
               [&](string_view name) { return netlist.GetComponent(name); });
}

} // namespace Fuzz
