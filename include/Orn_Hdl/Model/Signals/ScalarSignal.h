/// \file
/// `ScalarSignal`, a net of one bit.
#pragma once

#include "Orn_Hdl/Model/Signals/Signal.h"
#include "Port/Export.h"

namespace Orn_Hdl {

/// A net of one bit.
class ORN_HDL_API ScalarSignal final : public Signal {
public:
    /// A signal that is no port; a null name is read as "".
    explicit ScalarSignal(const Port::TextArgument& name) : Signal(name) {}

    int GetSignalType() const override { return SignalTypeScalar; }
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override { return Polarity(GetDirection()); }
    int GetWidth() const override { return 1; }
    bool IsPort() const override { return Polarity::IsValidValue(GetDirection()); }
    bool IsNeededToDeclared() const override { return true; }
    /// The name with "_DUMMY" behind it, unless it ends so.
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new scalar signal with the dummy name; the caller owns it.
    ScalarSignal* CreateDummySignal() const;
};

} // namespace Orn_Hdl
