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
    explicit Netlist(const char* name = nullptr);
    Netlist(const Netlist&) = delete;
    Netlist& operator=(const Netlist&) = delete;
    ~Netlist() override;

    void AcceptObject(ObjectVisitor& visitor) override;
    /// Stores the name as it stands; null is read as "".
    void SetName(const char* name) override;
    /// Remembers from which file the design comes.
    void SetSourceFileName(const char* name);
    /// The file from which the design comes; empty when it is not known.
    Port::StringBase<char> GetSourceFileName() const;

    /// Takes ownership and appends. Null is ignored, and so is an object that has an owner. An
    /// object of a name that is taken is held too, and found by that name from then on.
    void Add(Signal* signal);
    void Add(Instance* instance);
    void Add(Component* component);
    /// Destroys an object. One that this netlist does not hold stays untouched. Pins wired to a
    /// removed signal become open; instances of a removed component have no component.
    void Remove(Signal* signal);
    void Remove(Instance* instance);
    void Remove(Component* component);

    /// \{
    /// Look-ups by name, normalised; null when there is none.
    Signal* GetSignal(const char* name) const noexcept { return GetSignal(Port::ViewOf(name)); }
    Instance* GetInstance(const char* name) const noexcept {
        return GetInstance(Port::ViewOf(name));
    }
    Component* GetComponent(const char* name) const noexcept {
        return GetComponent(Port::ViewOf(name));
    }
    Signal* GetSignal(std::string_view name) const noexcept;
    Instance* GetInstance(std::string_view name) const noexcept;
    Component* GetComponent(std::string_view name) const noexcept;
    /// \}
    /// Whether a component, an instance or a signal has that name, normalised.
    bool IsNameUsed(std::string_view name) const noexcept;
    /// The bus with the base name of a text: D, D(3) and D(7:0) all give the bus D.
    Bus* GetParentBus(const char* name) const;

    /// \{
    /// What the netlist owns, in order of addition until `SortNetlist`.
    Iterator<Signal*> GetSignalIterator() const noexcept;
    Iterator<Instance*> GetInstanceIterator() const noexcept;
    Iterator<Component*> GetComponentIterator() const noexcept;
    /// \}
    /// Replaces the list by the instances of a component, in order.
    void GetInstances(const Component* component, PtrArray<Instance*>& instances) const;
    void GetInstances(const char* componentName, PtrArray<Instance*>& instances) const;

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
    /// The stand-in that one of these has made for the signal; null when there is none.
    const Signal* GetStandIn(const Signal* signal) const noexcept;

    /// The length of the longest name; the iterator handed in is not moved.
    static int GetLongestPinName(const Iterator<Pin*>& pins);
    /// Over the signals that are ports.
    static int GetLongestPortName(const Iterator<Signal*>& signals);
    /// Over the signals that need declaring.
    static int GetLongestSignalName(const Iterator<Signal*>& signals);
    /// Over the attributes of one holder.
    static int GetLongestAttrName(const AttributeHolder* holder);
    /// Over the attributes of the netlist, its signals, components and instances.
    static int GetLongestAttrName(const Netlist* netlist);

private:
    friend class Model;
    friend class ModelRegistry;
    friend class ReadAhead;
    struct Implementation;

    /// Who is told of a new name; not owned, null for nobody.
    void SetNameListener(NameListener* listener) noexcept;

    /// Puts `wider` in the place of a narrower bus of the same base name, which is destroyed;
    /// everything that named it names `slice` from then on.
    void ReplaceBus(Bus* narrower, std::unique_ptr<Bus> wider, std::unique_ptr<BusSlice> slice);

    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
