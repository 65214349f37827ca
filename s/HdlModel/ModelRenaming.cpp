// Renaming the components, instances and signals of a model.
#include "HdlModel/ModelFailures.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/Renaming.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

namespace Orn_Hdl {

using Port::ViewOf;

namespace {

void Apply(Model& model, Renaming& renaming, const char* newName) {
    if (const std::string* const taken = renaming.FindTaken()) {
        // Of the name that was asked for, the spelling of the caller is told.
        const bool isAskedFor = *taken == Names::NormalizedText(ViewOf(newName)).GetView();
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n",
                    {isAskedFor ? ViewOf(newName) : std::string_view(*taken)});
    }
    renaming.Apply();
    model.SetModifiedFlag(true);
}

/// Whether a signal can bear a name: its form tells what it is, and a bus keeps its range.
bool CanBear(const Signal& signal, std::string_view name) {
    Names::BusName wanted;
    const bool isBusName = Names::ParseBus(name, wanted);
    if (As<ScalarSignal>(&signal) != nullptr) {
        return !isBusName;
    }
    Names::BusName present;
    return As<Bus>(&signal) != nullptr && isBusName &&
           Names::ParseBus(signal.GetNameView(), present) &&
           present.leftIndex == wanted.leftIndex && present.rightIndex == wanted.rightIndex;
}

} // namespace

bool Model::RenameComponent(const Port::TextArgument& name, const Port::TextArgument& newName) {
    RequireName(__LINE__, newName);
    Component* const component = GetComponent(name);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(name)});
    }
    Renaming renaming(*GetNetlist());
    renaming.Add(*component, newName.GetView());
    Apply(*this, renaming, newName);
    return true;
}

bool Model::RenameInstance(const Port::TextArgument& name, const Port::TextArgument& newName) {
    RequireName(__LINE__, newName);
    Instance* const instance = GetInstance(name);
    if (instance == nullptr) {
        FailNotFound(__LINE__, name);
    }
    Renaming renaming(*GetNetlist());
    renaming.Add(*instance, newName.GetView());
    Apply(*this, renaming, newName);
    return true;
}

bool Model::RenameSignal(const Port::TextArgument& name, const Port::TextArgument& newName) {
    RequireName(__LINE__, newName);
    Signal* const signal = GetSignal(name);
    if (signal == nullptr) {
        FailSignalNotFound(__LINE__, name);
    }
    if (!CanBear(*signal, Names::NormalizedText(ViewOf(newName)).GetView())) {
        FailInModel(__LINE__, "Invalid Name.\n");
    }
    const Bus* const namesake = GetNetlist()->GetParentBus(newName);
    if (As<Bus>(signal) != nullptr && namesake != nullptr && namesake != signal) {
        FailInModel(__LINE__, "Signal \"%s\" already declared.\n", {newName.GetView()});
    }
    Renaming renaming(*GetNetlist());
    renaming.AddWithParts(*signal, newName.GetView());
    Apply(*this, renaming, newName);
    return true;
}

} // namespace Orn_Hdl
