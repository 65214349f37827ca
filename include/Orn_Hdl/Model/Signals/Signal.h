/// \file
/// `Signal`, the base of everything that a pin can be wired to.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringSet.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <memory>

namespace Orn_Hdl {

class SignalVisitor;

/// Codes of the signal classes.
enum SignalType {
    SignalTypeScalar = 50,
    SignalTypeBus = 51,
    SignalTypeBusSlice = 52,
    SignalTypeBusIndex = 53,
    SignalTypeCompoundBus = 54
};

/// Anything that a pin can be wired to. Its name carries its shape: N, D(7:0), D(3:0) as a slice of
/// D(7:0), D(2), or the compound A,D(3:0). A signal with a port polarity is a port of the netlist.
class ORN_HDL_API Signal : public Object, public AttributeHolder {
public:
    Signal(const Signal&) = delete;
    Signal& operator=(const Signal&) = delete;
    /// The netlist drops the signal, whoever destroys it. Every pin that points at the signal
    /// becomes open, and all other signals drop it from their aliases, slices and members.
    ~Signal() override;

    void AcceptObject(ObjectVisitor& visitor) override;
    /// The class, a `SignalType`.
    virtual int GetSignalType() const = 0;
    /// Makes the signal a port of that direction, or no port when it is invalid.
    virtual void SetPortPolarity(const Polarity& polarity) = 0;
    /// Calls the visit operation of this signal's class, then `VisitSignal`.
    virtual void AcceptSignal(SignalVisitor& visitor) = 0;
    /// The direction; invalid when the signal is no port.
    virtual Polarity GetPortPolarity() const = 0;
    /// The number of bits, at most INT_MAX; 0 for a range that does not parse.
    virtual int GetWidth() const = 0;
    /// Whether the signal is a port.
    virtual bool IsPort() const = 0;
    /// Whether the writers declare the signal: only scalar signals and buses.
    virtual bool IsNeededToDeclared() const = 0;
    /// The name of this signal's dummy signal, which the writers add to a netlist when a port is
    /// used against its direction.
    virtual Port::StringBase<char> GetDummySignalName() const = 0;

    /// Lists a pin and points it at this signal. Null is ignored, and a pin that is listed and
    /// points here stays as it is. A signal at which the pin pointed before still lists it. If
    /// allocation fails, nothing changes.
    /// \param pin not owned.
    void Connect(Pin* pin);
    /// Lists another signal as an alias of this one, once; the other does not list this one. Null
    /// and this signal itself are ignored. If allocation fails, nothing changes.
    /// \param other not owned.
    void Connect(Signal* other);
    /// Connects nothing.
    void Connect(std::nullptr_t) noexcept {}
    /// Takes a pin out of the list; a pin that points at this signal becomes open. Null, and a pin
    /// that is neither listed nor points here, are ignored.
    void Disconnect(Pin* pin);
    /// Takes another signal out of the aliases. Null and a signal that is no alias are ignored.
    void Disconnect(Signal* other);
    /// Disconnects nothing.
    void Disconnect(std::nullptr_t) noexcept {}
    /// Opens every pin that points here, and empties the lists of pins and aliases.
    void DisconnectAll();
    /// Connects to this signal the listed pins of another one that still point at that one, and
    /// lists its aliases here too. Null and this signal itself are ignored.
    void CloneConnection(Signal* other);

    /// Ties the signal to a constant, of which it keeps a copy.
    void AssignConstantValue(const BitVectorValue& value);
    /// Ties the signal to a constant that is given as a bit-vector literal; null is read as "".
    void AssignConstantValue(const char* value);
    /// The constant, with an empty text when there is none.
    const BitVectorValue& GetConstantValue() const noexcept;

    /// The listed pins, in the order in which they were connected.
    Iterator<Pin*> GetPinIterator() const noexcept { return Iterator<Pin*>(&pins_); }
    /// The listed aliases, in the order in which they were connected.
    Iterator<Signal*> GetSignalIterator() const noexcept;

    /// Whether more than one listed output pin points at this signal.
    bool HasMultiDriver() const noexcept;
    /// Adds this signal's base names to a set: of a scalar signal its name, of a bus, slice or bit
    /// the name before "(", of a compound those of its members, then its own name.
    virtual void GetBaseName(StringSet& names) const = 0;

protected:
    /// A signal without pins; a null name is read as "".
    explicit Signal(const char* name);

    /// Unlinks the signal from all pins and signals, before it is destroyed.
    virtual void LeaveAll() noexcept;
    /// Takes a signal that is about to be destroyed out of the aliases, slices or members of this
    /// one.
    virtual void Forget(Signal* signal) noexcept;
    /// Puts a signal in the place of another one among the aliases, slices or members of this one.
    virtual void ReplaceReference(Signal* from, Signal* to);

private:
    friend class PinLinks;
    friend class References;
    struct Links;

    static constexpr unsigned DyingFlag = 0x10;

    Links& MakeLinks();

    /// Most nets have a driver and a load or two: their pins are listed in the signal itself.
    SmallPtrArray<Pin*, 3> pins_;
    std::unique_ptr<Links> links_;
};

} // namespace Orn_Hdl
