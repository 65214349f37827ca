#include "Orn_Hdl/Model/Signals/ScalarSignal.h"

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Signals/SignalVisitor.h"

namespace Orn_Hdl {

void ScalarSignal::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitScalarSignal(this);
    visitor.VisitSignal(this);
}

Port::StringBase<char> ScalarSignal::GetDummySignalName() const {
    return Names::IsDummy(GetNameView()) ? std::string(GetNameView())
                                         : Names::DummyOf(GetNameView());
}

void ScalarSignal::GetBaseName(StringSet& names) const {
    names.Add(GetNameView());
}

ScalarSignal* ScalarSignal::CreateDummySignal() const {
    return new ScalarSignal(GetDummySignalName().CStr());
}

} // namespace Orn_Hdl
