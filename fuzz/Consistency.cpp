#include "Consistency.h"

#include "Check.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <set>
#include <string_view>
#include <vector>

namespace Fuzz {

namespace {

using namespace Orn_Hdl;

/// The objects of one class that exist. They are added first, then sorted; only then can they be
/// looked up.
template <class T> class Alive {
public:
    void Add(const T* object) { objects_.push_back(object); }
    void Sort() { std::sort(objects_.begin(), objects_.end()); }
    bool Contains(const T* object) const {
        return std::binary_search(objects_.begin(), objects_.end(), object);
    }
    bool HasNoneTwice() const {
        return std::adjacent_find(objects_.begin(), objects_.end()) == objects_.end();
    }
    const std::vector<const T*>& GetAll() const noexcept { return objects_; }

private:
    std::vector<const T*> objects_;
};

enum class Repetition { Forbidden, Allowed };

template <class T>
void CheckList(const Iterator<T*>& list, const Alive<T>& alive, Repetition repetition,
               const char* what) {
    Alive<T> met;
    for (const T* element : list) {
        Check(element != nullptr, "no null", what);
        Check(alive.Contains(element), "alive", what);
        met.Add(element);
    }
    met.Sort();
    Check(repetition == Repetition::Allowed || met.HasNoneTwice(), "once", what);
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
            signals_.Add(signal);
        }
        for (Signal* signal : loose) {
            signals_.Add(signal);
        }
        for (const Component* component : netlist.GetComponentIterator()) {
            components_.Add(component);
            AddPins(component->GetPinIterator());
        }
        for (const Instance* instance : netlist.GetInstanceIterator()) {
            AddPins(instance->GetPinIterator());
        }
        signals_.Sort();
        components_.Sort();
        pins_.Sort();
    }

    void Run() {
        Check(pins_.HasNoneTwice(), "a pin has one owner");
        for (const Component* component : components_.GetAll()) {
            CheckPins(component->GetPinIterator());
        }
        for (const Instance* instance : netlist_.GetInstanceIterator()) {
            const Component* const component = instance->GetComponent();
            Check(component == nullptr || components_.Contains(component),
                  "an instance's component: alive");
            Check((component == nullptr) == instance->GetComponentName().IsEmpty() ||
                      (component != nullptr && component->GetNameView().empty()),
                  "an instance without a component has no component name");
            CheckPins(instance->GetPinIterator());
        }
        for (const Signal* signal : signals_.GetAll()) {
            CheckSignal(*signal);
        }
    }

private:
    void AddPins(const Iterator<Pin*>& pins) {
        for (const Pin* pin : pins) {
            pins_.Add(pin);
        }
    }

    void CheckPins(const Iterator<Pin*>& pins) const {
        for (const Pin* pin : pins) {
            Check(pin->GetSignal() == nullptr || signals_.Contains(pin->GetSignal()),
                  "a pin's signal: alive");
            pin->GetBaseName();
            pin->GetPolarityName();
        }
    }

    void CheckSignal(const Signal& signal) {
        CheckList(signal.GetPinIterator(), pins_, Repetition::Forbidden, "a signal's pins");
        CheckList(signal.GetSignalIterator(), signals_, Repetition::Forbidden,
                  "a signal's aliases");
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
        CheckList(bus.GetBusSliceIterator(), signals_, Repetition::Forbidden, "a bus's parts");
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
            Check(signals_.Contains(parent), "a parent bus: alive");
            Check(Contains(parent->GetBusSliceIterator(), &part), "a parent bus lists its part");
        }
    }

    void CheckCompound(const CompoundBus& compound) const {
        CheckList(compound.GetBusMemberIterator(), signals_, Repetition::Allowed,
                  "a compound's members");
        // The members, their members, and so on; each compound is entered once.
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
