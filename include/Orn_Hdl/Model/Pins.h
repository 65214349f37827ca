/// \file
/// Pins, their direction, and `PinVisitor`.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Object.h"
#include "Port/Export.h"
#include "Port/String.h"
#include "Port/TextView.h"

#include <optional>
#include <string_view>

namespace Orn_Hdl {

class BusIndexPin;
class BusPin;
class PinVisitor;
class ScalarPin;

/// The direction of a port or pin: input, output, bidirectional, or invalid.
class ORN_HDL_API Polarity {
public:
    /// The directions; ports sort in this order.
    enum Value { Invalid = -1, Input = 0, Output = 1, BiDirectional = 2 };

    /// Invalid.
    Polarity() noexcept = default;
    /// The direction of that value, which is not checked.
    explicit Polarity(int value) noexcept : value_(value) {}
    /// The direction of that value.
    Polarity(Value value) noexcept : value_(value) {}
    /// The direction that a text names, as `GetValue` reads it. Any other text, "inout" among them,
    /// gives an invalid one; `Parse` tells, and knows that word.
    explicit Polarity(const char* text) noexcept : value_(GetValue(text)) {}

    /// The direction whose name begins with the text, letter case ignored, tried in the order
    /// Input, Output, BiDirectional: "in", "O" and "bidir" are directions; "" and "inputs" are not.
    static int GetValue(const char* text) noexcept;
    /// The direction that a text names: what `GetValue` reads, and "inout" in any letter case.
    /// \return nothing for any other text.
    static std::optional<Polarity> Parse(Port::TextView text) noexcept;
    /// Whether a value is a direction.
    static bool IsValidValue(int value) noexcept {
        return value >= Input && value <= BiDirectional;
    }

    /// The value, a `Value` unless another one was set.
    int GetValue() const noexcept { return value_; }
    /// Sets the value, which is not checked.
    void SetValue(int value) noexcept { value_ = value; }
    /// Sets the value from a text, as `GetValue` reads it.
    void SetValue(const char* text) noexcept { value_ = GetValue(text); }
    /// Whether this is a direction.
    bool IsValid() const noexcept { return IsValidValue(value_); }
    /// "Input", "Output" or "BiDirectional"; "Output" for a value that is no direction.
    const char* GetValueName() const noexcept;

    /// Whether both have the same value.
    friend bool operator==(const Polarity& a, const Polarity& b) noexcept {
        return a.value_ == b.value_;
    }
    /// Whether the values differ.
    friend bool operator!=(const Polarity& a, const Polarity& b) noexcept { return !(a == b); }
    /// Whether the value of `a` is less than that of `b`; an invalid one comes first.
    friend bool operator<(const Polarity& a, const Polarity& b) noexcept {
        return a.value_ < b.value_;
    }

private:
    int value_ = Invalid;
};

/// Codes of the pin classes.
enum PinType { PinTypeScalar = 1, PinTypeBus = 2, PinTypeBusIndex = 3 };

/// A terminal of a component, or an instance's own copy of one. It points at the signal to which it
/// is wired; an open pin points at none.
class ORN_HDL_API Pin : public Object, public AttributeHolder {
public:
    /// Takes the pin out of its component or instance, and out of the list of every signal.
    ~Pin() override;
    /// `ObjectTypePin`, whatever was copied into the pin.
    int GetObjectType() const override;
    void AcceptObject(ObjectVisitor& visitor) override;
    /// Stores a name, normalised; null is read as "".
    void SetName(const char* name) override;
    using Object::SetName;
    /// The class, a `PinType`.
    virtual int GetPinType() const = 0;
    /// A new pin of the same class with the same name, polarity and default value; the caller owns
    /// it.
    virtual Pin* ClonePin() const = 0;
    /// Calls the visit operation of this pin's class, and only that.
    virtual void AcceptPin(PinVisitor& visitor) = 0;
    /// The name, of a bus pin or bus bit pin without its range or index.
    virtual Port::StringBase<char> GetBaseName() const = 0;

    /// Points the pin at a signal, or opens it when that is null. The signal's list of pins stays
    /// as it is: `Signal::Connect` links both ways. If allocation fails, nothing changes.
    /// \param signal not owned.
    void Connect(Signal* signal);
    /// Opens the pin. A signal that lists it goes on doing so. If allocation fails, nothing
    /// changes.
    void Disconnect() { Connect(nullptr); }
    /// The signal that the pin points at; null when it is open.
    Signal* GetSignal() const noexcept { return signal_; }

    /// Sets the direction.
    void SetPolarity(const Polarity& polarity) { SetDirection(polarity.GetValue()); }
    /// The direction.
    Polarity GetPolarity() const noexcept { return Polarity(GetDirection()); }
    /// The name of the direction, as `Polarity::GetValueName` gives it.
    const char* GetPolarityName() const noexcept { return GetPolarity().GetValueName(); }

    /// Stores a copy of a default value, which copies of the pin get too; the writers write none.
    void SetDefaultValue(const BitVectorValue& value);
    /// Stores the default value that a bit-vector literal gives; null is read as "".
    void SetDefaultValue(const char* value);
    /// The default value, with an empty text when there is none.
    const BitVectorValue& GetDefaultValue() const noexcept;

    /// Makes a pin of the class that the name's form asks for; the caller owns it.
    static Pin* Create(const char* name, const Polarity& polarity);

protected:
    /// An open pin; a null name is read as "".
    Pin(const char* name, const Polarity& polarity);
    /// An open pin with the name, polarity and default value of another one; its attributes and its
    /// comment are not copied.
    Pin(const Pin& other);
    /// Copies name, polarity and default value; signal, attributes and comment stay as they are.
    Pin& operator=(const Pin& other);

private:
    friend class PinBlock;
    friend class PinLinks;

    /// Makes a copy of this pin at `place`, which has room for any pin.
    virtual Pin* CloneInto(void* place) const = 0;

    static constexpr unsigned ListedFlag = 0x10;

    Signal* signal_ = nullptr;
};

/// A pin of one bit.
class ORN_HDL_API ScalarPin : public Pin {
public:
    /// An open pin; a null name is read as "".
    ScalarPin(const char* name, const Polarity& polarity) : Pin(name, polarity) {}
    ScalarPin(const ScalarPin&) = default;
    ScalarPin& operator=(const ScalarPin&) = default;
    int GetPinType() const override { return PinTypeScalar; }
    Pin* ClonePin() const override;
    void AcceptPin(PinVisitor& visitor) override;
    Port::StringBase<char> GetBaseName() const override { return GetNameView(); }

private:
    Pin* CloneInto(void* place) const override;
};

/// A pin with a range, such as D(7:0).
class ORN_HDL_API BusPin : public Pin {
public:
    /// An open pin; a null name is read as "".
    BusPin(const char* name, const Polarity& polarity) : Pin(name, polarity) {}
    BusPin(const BusPin&) = default;
    BusPin& operator=(const BusPin&) = default;
    int GetPinType() const override { return PinTypeBus; }
    Pin* ClonePin() const override;
    void AcceptPin(PinVisitor& visitor) override;
    Port::StringBase<char> GetBaseName() const override;
    /// The texts of both indices. \return false, both untouched, when the name is no bus name.
    bool GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const;
    /// Whether the range is descending; that of D(3:3) is not.
    bool IsDownTo() const noexcept;
    /// The number of bits, at most INT_MAX; 0 when the name is no bus name.
    int GetWidth() const noexcept;

private:
    Pin* CloneInto(void* place) const override;
};

/// A pin for one bit of a bus, such as D(3).
class ORN_HDL_API BusIndexPin : public Pin {
public:
    /// An open pin; a null name is read as "".
    BusIndexPin(const char* name, const Polarity& polarity) : Pin(name, polarity) {}
    BusIndexPin(const BusIndexPin&) = default;
    BusIndexPin& operator=(const BusIndexPin&) = default;
    int GetPinType() const override { return PinTypeBusIndex; }
    Pin* ClonePin() const override;
    void AcceptPin(PinVisitor& visitor) override;
    Port::StringBase<char> GetBaseName() const override;
    /// The text of the index; empty when the name is no bit name.
    Port::StringBase<char> GetIndex() const;

private:
    Pin* CloneInto(void* place) const override;
};

/// Visits pins by class; every operation of the base does nothing. `VisitPin` is there for callers:
/// `AcceptPin` never calls it.
class ORN_HDL_API PinVisitor {
public:
    PinVisitor() = default;
    PinVisitor(const PinVisitor&) = default;
    PinVisitor& operator=(const PinVisitor&) = default;
    virtual ~PinVisitor();
    /// For callers that treat pins of all classes alike.
    virtual void VisitPin(Pin* pin);
    /// Called for a pin of one bit.
    virtual void VisitScalarPin(ScalarPin* pin);
    /// Called for a pin with a range.
    virtual void VisitBusPin(BusPin* pin);
    /// Called for a pin of one bit of a bus.
    virtual void VisitBusIndexPin(BusIndexPin* pin);
};

/// Forms the name of the signal that carries a pin's constant: the instance's name, the pin's base
/// name and "CONST_SIGNAL", joined by "_", then the pin's range or index.
class ORN_HDL_API PinConstantSignalVisitor : public PinVisitor {
public:
    /// For pins of an instance of that name.
    explicit PinConstantSignalVisitor(const char* instanceName) : instanceName_(instanceName) {}
    /// Forms the name for a pin of one bit; null changes nothing.
    void VisitScalarPin(ScalarPin* pin) override;
    /// Forms the name for a pin with a range; null changes nothing.
    void VisitBusPin(BusPin* pin) override;
    /// Forms the name for a pin of one bit of a bus; null changes nothing.
    void VisitBusIndexPin(BusIndexPin* pin) override;
    /// The name that the last visit formed.
    const Port::StringBase<char>& GetName() const noexcept { return name_; }

private:
    void SetResult(std::string_view baseName, std::string_view index);

    Port::StringBase<char> instanceName_;
    Port::StringBase<char> name_;
};

} // namespace Orn_Hdl
