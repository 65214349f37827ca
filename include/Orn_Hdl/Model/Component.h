/// \file
/// Components (cell types) and instances (their placements).
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

struct ComponentAnchor;
class PinIndex;

/// The pins of a component or an instance, in order. Long lists are searched through an index.
class ORN_HDL_API PinList : public PtrArray<Pin*> {
public:
    PinList() noexcept;
    PinList(const PinList&) = delete;
    PinList& operator=(const PinList&) = delete;
    ~PinList() override;

    /// The first pin of that name, normalised and letter case ignored; null when there is none.
    Pin* GetPin(const char* name) const;
    /// The first pin of that name, of known length, normalised and letter case ignored; null when
    /// there is none.
    Pin* GetPin(std::string_view name) const;
    /// Sorts by polarity value, then by name in natural order, stably.
    void SortByPolarityAndName();

private:
    friend class PinBlock;
    friend class PinIndex;
    friend class PinRenaming;

    static constexpr int LongestUnindexed = 16;

    Pin* FindOneByOne(std::string_view name) const noexcept;
    /// The pin that was made at a place of the list; null for a place that the list does not have.
    /// The pins of an instance keep their places when they are sorted or removed.
    Pin* GetAtPlace(std::uint32_t place) const noexcept;
    /// Enters the last pin into the index, which is made when the list gets long.
    void IndexLast() noexcept;
    /// Makes the index anew if the list is long.
    void IndexAll() noexcept;
    /// Enters the pin at a place into the index, if there is one.
    void Enter(std::uint32_t place) noexcept;
    /// Makes sure that no other list uses the index. \return whether there is an index.
    bool MakeOwnIndex() noexcept;
    /// Lets the list be searched pin by pin.
    void DropIndex() noexcept;

    /// Null for a short list, and for one whose index could not be allocated.
    PinIndex* index_ = nullptr;
};

/// A cell type: a name and an ordered list of pins, which it owns.
class ORN_HDL_API Component : public Object, public AttributeHolder {
public:
    /// A component without pins; a null name is read as "".
    explicit Component(const Port::TextArgument& name);
    Component(const Component&) = delete;
    Component& operator=(const Component&) = delete;
    /// The netlist drops the component, whoever destroys it. Its instances keep their pins and then
    /// have no component.
    ~Component() override;

    void AcceptObject(ObjectVisitor& visitor) override;

    /// Appends a pin of the class that the name's form asks for. A name that is taken is not
    /// refused here. Instances made before do not get the pin.
    /// \param name null is read as "".
    /// \param defaultValue taken when its text is not empty.
    void AddPin(const Port::TextArgument& name, const Polarity& polarity,
                const BitVectorValue& defaultValue);
    /// Appends a pin whose default value is given as a bit-vector literal; null is read as "". A
    /// name that is taken is not refused here. Instances made before do not get the pin.
    /// \param name null is read as "".
    void AddPin(const Port::TextArgument& name, const Polarity& polarity,
                const Port::TextArgument& defaultValue);
    /// Appends a clone of a pin.
    void AddPin(const Pin& pin);
    /// Destroys a pin of this component, as `delete` does. Instances keep their pins:
    /// `Netlist::RemovePin` removes those too. Null, and a pin of another owner, are ignored.
    void RemovePin(Pin* pin) noexcept;
    /// The pin of that name; null when there is none.
    Pin* GetPin(const char* name) const { return pins_.GetPin(name); }
    /// The pin of that name, of known length; null when there is none.
    Pin* GetPin(std::string_view name) const { return pins_.GetPin(name); }
    /// The pins, in order.
    Iterator<Pin*> GetPinIterator() const noexcept { return Iterator<Pin*>(&pins_); }

private:
    friend class Instance;
    friend class PinBlock;

    PinList pins_;
    ComponentAnchor* anchor_;
};

/// A placement of a component, with its own copies of the component's pins.
class ORN_HDL_API Instance : public Object, public AttributeHolder {
public:
    /// \param component not owned; null gives an instance without pins.
    Instance(const Port::TextArgument& name, const Component* component);
    Instance(const Instance&) = delete;
    Instance& operator=(const Instance&) = delete;
    /// The netlist drops the instance, whoever destroys it, and its pins leave all signals.
    ~Instance() override;

    void AcceptObject(ObjectVisitor& visitor) override;

    /// The component; null when there is none, or none any more.
    Component* GetComponent() const noexcept;
    /// The component's name; empty when there is no component.
    Port::StringBase<char> GetComponentName() const;
    /// The component's attribute of that name; null when there is none.
    Attribute* GetComponentAttr(const char* name) const;

    /// The pin of that name; null when there is none.
    Pin* GetPin(const char* name) const { return pins_.GetPin(name); }
    /// The pin of that name, of known length; null when there is none.
    Pin* GetPin(std::string_view name) const { return pins_.GetPin(name); }
    /// The pins, in order.
    Iterator<Pin*> GetPinIterator() const noexcept { return Iterator<Pin*>(&pins_); }
    /// Destroys a pin of this instance, as `delete` does. Its memory is freed with the instance.
    /// Null, and a pin of another owner, are ignored.
    void RemovePin(Pin* pin) noexcept;
    /// Sorts the pins by polarity value, then by name in natural order.
    void SortPinName() { pins_.SortByPolarityAndName(); }

    /// Appends the pins that are wired to no signal.
    /// \param inputsOnly whether to take input pins only.
    /// \return whether the list has elements then.
    bool GetOpenPin(PtrArray<Pin*>& pins, bool inputsOnly) const;
    /// Appends the input and bidirectional pins whose signal, or a member of it, is an output port.
    void GetOutPortConnectedToInPin(PtrArray<Pin*>& pins) const;
    /// Appends the output and bidirectional pins whose signal, or a member of it, is an input port.
    void GetInPortConnectedToOutPin(PtrArray<Pin*>& pins) const;

private:
    void GetPinsOnPort(int pinPolarity, int portPolarity, PtrArray<Pin*>& pins) const;

    ComponentAnchor* anchor_;
    PinList pins_;
};

} // namespace Orn_Hdl
