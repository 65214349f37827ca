/// \file
/// `Netlist`, the one flat design level that a model writes out.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringSet.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Port/Ascii.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

class NameListener;

/// The module or entity: name, source file name, notes (its comment), attributes, and the
/// components, instances and signals, which it owns. Names of components, instances and signals are
/// found ignoring letter case.
class ORN_HDL_API Netlist : public Object, public AttributeHolder {
public:
    /// \param name null gives "hdlNetlist".
    explicit Netlist(const Port::TextArgument& name = nullptr);
    Netlist(const Netlist&) = delete;
    Netlist& operator=(const Netlist&) = delete;
    /// Takes over the name, comment, attributes and objects of another netlist, which is then an
    /// empty one with the default name. Pointers to the objects stay valid.
    /// \throws std::bad_alloc, nothing changed, when allocation fails.
    Netlist(Netlist&& other); // NOLINT(performance-noexcept-move-constructor)
    /// Destroys the objects of this netlist and takes over the name, comment, attributes and
    /// objects of another one, which is then an empty one with the default name.
    /// \throws std::bad_alloc, nothing changed, when allocation fails.
    Netlist& operator=(Netlist&& other); // NOLINT(performance-noexcept-move-constructor)
    /// Destroys everything that the netlist owns.
    ~Netlist() override;

    void AcceptObject(ObjectVisitor& visitor) override;
    /// Stores the name as it stands; null is read as "".
    void SetName(const char* name) override;
    using Object::SetName;
    /// Remembers from which file the design comes.
    void SetSourceFileName(const char* name);
    /// The file from which the design comes; empty when it is not known.
    Port::StringBase<char> GetSourceFileName() const;

    /// Takes ownership of a signal and appends it. Null is ignored, and so is a signal that has an
    /// owner. A signal of a name that is taken is held too, and found by that name from then on.
    void Add(Signal* signal);
    /// Takes ownership of an instance and appends it. Null is ignored, and so is an instance that
    /// has an owner. An instance of a name that is taken is held too, and found by that name from
    /// then on.
    void Add(Instance* instance);
    /// Takes ownership of a component and appends it. Null is ignored, and so is a component that
    /// has an owner. A component of a name that is taken is held too, and found by that name from
    /// then on.
    void Add(Component* component);
    /// Adds nothing.
    void Add(std::nullptr_t) noexcept {}
    /// Destroys a signal, as `delete` does. Pins wired to it become open. A signal that this
    /// netlist does not hold stays untouched.
    void Remove(Signal* signal);
    /// Destroys an instance, as `delete` does. Its pins leave all signals. An instance that this
    /// netlist does not hold stays untouched.
    void Remove(Instance* instance);
    /// Destroys a component, as `delete` does. Its instances keep their pins and have no component.
    /// A component that this netlist does not hold stays untouched.
    void Remove(Component* component);
    /// Removes nothing.
    void Remove(std::nullptr_t) noexcept {}
    /// Takes a signal out without destroying it. Its pins, aliases and slices stay connected.
    /// \return the signal, which the caller owns; null when this netlist does not hold it.
    std::unique_ptr<Signal> DetachSignal(Signal* signal) noexcept;
    /// Takes an instance out without destroying it. Its pins stay connected.
    /// \return the instance, which the caller owns; null when this netlist does not hold it.
    std::unique_ptr<Instance> DetachInstance(Instance* instance) noexcept;
    /// Takes a component out without destroying it. Its instances keep it.
    /// \return the component, which the caller owns; null when this netlist does not hold it.
    std::unique_ptr<Component> DetachComponent(Component* component) noexcept;
    /// Destroys a pin of a component, and the pin of that name of each of its instances in this
    /// netlist. Nulls, and a pin that the component does not own, are ignored.
    void RemovePin(Component* component, Pin* pin) noexcept;

    /// The signal of that name, normalised; null when there is none.
    Signal* GetSignal(const char* name) const noexcept { return GetSignal(Port::ViewOf(name)); }
    /// The instance of that name, normalised; null when there is none.
    Instance* GetInstance(const char* name) const noexcept {
        return GetInstance(Port::ViewOf(name));
    }
    /// The component of that name, normalised; null when there is none.
    Component* GetComponent(const char* name) const noexcept {
        return GetComponent(Port::ViewOf(name));
    }
    /// The signal of that name, of known length, normalised; null when there is none.
    Signal* GetSignal(std::string_view name) const noexcept;
    /// The instance of that name, of known length, normalised; null when there is none.
    Instance* GetInstance(std::string_view name) const noexcept;
    /// The component of that name, of known length, normalised; null when there is none.
    Component* GetComponent(std::string_view name) const noexcept;
    /// Whether a component, an instance or a signal has that name, normalised.
    bool IsNameUsed(std::string_view name) const noexcept;
    /// The bus with the base name of a text: D, D(3) and D(7:0) all give the bus D.
    Bus* GetParentBus(const char* name) const;

    /// The signals, in order of addition until `SortNetlist`. If the present element of a walk is
    /// removed, the one after it becomes the present one. A walk during which objects are removed
    /// and others added may leave some out; so may one during which the netlist is sorted.
    Iterator<Signal*> GetSignalIterator() const noexcept;
    /// The instances, in order of addition until `SortNetlist`. Removal during a walk has the
    /// effect that it has for signals.
    Iterator<Instance*> GetInstanceIterator() const noexcept;
    /// The components, in order of addition until `SortNetlist`. Removal during a walk has the
    /// effect that it has for signals.
    Iterator<Component*> GetComponentIterator() const noexcept;
    /// Replaces the list by the instances of a component, in order; null has none.
    void GetInstances(const Component* component, PtrArray<Instance*>& instances) const;
    /// Replaces the list by the instances of the component of that name, in order.
    void GetInstances(const char* componentName, PtrArray<Instance*>& instances) const;
    /// Empties the list.
    void GetInstances(std::nullptr_t, PtrArray<Instance*>& instances) const { instances.Empty(); }

    /// Sorts signals by port polarity and name, components and instances by name, and the pins of
    /// each instance by polarity and name; names in natural order (U2 before U10), all stably.
    void SortNetlist();
    /// Wires every open scalar or bus input pin to a signal of its own.
    void ConnectOpenPinToDummy();
    /// Gives every component of the level HALVEX that has no BOX_TYPE the attribute BOX_TYPE with
    /// the value BLACK_BOX.
    void SetBoxTypeAttribute();
    /// Makes dummy signals for input ports that are driven inside.
    void CreateVerilogDummySignals();
    /// Makes dummy signals for output ports that are read inside or have several drivers, and for
    /// input ports that are driven inside.
    void CreateVhdlDummySignals();
    /// The dummy signal that `CreateVerilogDummySignals` or `CreateVhdlDummySignals` has made for a
    /// signal, owned by the netlist; null if there is none.
    const Signal* GetDummySignal(const Signal* signal) const noexcept;

    /// The length of the longest name of the pins; nulls are skipped, and the iterator handed in is
    /// not moved.
    static int GetLongestPinName(const Iterator<Pin*>& pins);
    /// The length of the longest name of the signals that are ports; nulls are skipped, and the
    /// iterator handed in is not moved.
    static int GetLongestPortName(const Iterator<Signal*>& signals);
    /// The length of the longest name of the signals that need declaring; nulls are skipped, and
    /// the iterator handed in is not moved.
    static int GetLongestSignalName(const Iterator<Signal*>& signals);
    /// The length of the longest name of a holder's attributes; 0 for null.
    static int GetLongestAttrName(const AttributeHolder* holder);
    /// The length of the longest name of the attributes of a netlist, its signals, components and
    /// instances; 0 for null.
    static int GetLongestAttrName(const Netlist* netlist);
    /// 0.
    static int GetLongestAttrName(std::nullptr_t) noexcept { return 0; }

private:
    friend class Model;
    friend class NetlistOwner;
    friend class NetlistSorting;
    friend class Renaming;
    friend class ModelRegistry;
    friend class ReadAhead;
    friend class RememberedDummies;
    friend class Removals;
    struct Implementation;

    /// Exchanges everything with another netlist but who is told of a new name.
    void Swap(Netlist& other) noexcept;
    /// Whether this netlist owns a component, an instance or a signal.
    bool Holds(const AttributeHolder& object) const noexcept;
    /// Makes room for new names of that many objects.
    ORN_HDL_LOCAL void MakeRoomForNames(std::size_t count);
    /// Gives a held object another name, under which it is found from then on. There must be room
    /// for it.
    void Rename(Object& object, ObjectName& name) noexcept;
    /// Who is told of a new name; not owned, null for nobody.
    void SetNameListener(NameListener* listener) noexcept;

    /// Puts `wider` in the place of a narrower bus of the same base name, which is destroyed;
    /// everything that named it names `slice` from then on.
    void ReplaceBus(Bus* narrower, std::unique_ptr<Bus> wider, std::unique_ptr<BusSlice> slice);

    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
