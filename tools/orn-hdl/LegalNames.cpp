#include "LegalNames.h"

#include "NameLine.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Port/File.h"

#include <set>
#include <string>

namespace Tool {

namespace {

using Orn_Hdl::Attribute;

class Table {
public:
    Table(const Orn_Hdl::Netlist& netlist, const Orn_Hdl::LegalNetlist& legal, Port::Stream& out)
        : netlist_(netlist), legal_(legal), out_(out) {}

    void WriteAll() {
        Write("module", netlist_);
        WriteAttributes(netlist_, "", "");
        for (const Orn_Hdl::Component* component : netlist_.GetComponentIterator()) {
            WriteComponent(*component);
        }
        for (const Orn_Hdl::Signal* signal : netlist_.GetSignalIterator()) {
            WriteSignal(*signal);
        }
        for (const Orn_Hdl::Instance* instance : netlist_.GetInstanceIterator()) {
            Write("cell", *instance);
            WriteAttributes(*instance, "", "");
        }
    }

private:
    void Write(const char* kind, const Orn_Hdl::Object& object) {
        WriteNameLine(out_, kind, object.GetNameView(), legal_.GetName(object));
    }

    void WriteComponent(const Orn_Hdl::Component& component) {
        const std::string newName = legal_.GetName(component);
        Write("component", component);
        for (const Orn_Hdl::Pin* pin : component.GetPinIterator()) {
            // A single bit of a bus becomes a pin without an index.
            const bool isBus = pin->GetPinType() == Orn_Hdl::PinTypeBus;
            const std::string_view old = pin->GetNameView();
            const std::string_view range =
                isBus ? old.substr(pin->GetBaseName().GetView().size()) : std::string_view();
            WriteNameLine(out_, "pin", JoinNames(component.GetNameView(), old),
                          JoinNames(newName, legal_.GetName(*pin).append(range)));
        }
        WriteAttributes(component, component.GetNameView(), newName);
    }

    void WriteSignal(const Orn_Hdl::Signal& signal) {
        if (!signal.IsNeededToDeclared()) {
            return;
        }
        const bool isBus = signal.GetSignalType() == Orn_Hdl::SignalTypeBus;
        const std::string_view old = signal.GetNameView();
        const std::string_view range = isBus ? old.substr(old.find('(')) : std::string_view();
        WriteNameLine(out_, signal.IsPort() ? "port" : "net", old,
                      legal_.GetName(signal).append(range));
        WriteAttributes(signal, "", "");
    }

    /// The generics of the module and of components are parameters; each other name that changes
    /// is told once.
    void WriteAttributes(const Orn_Hdl::AttributeHolder& holder, std::string_view oldOwner,
                         std::string_view newOwner) {
        for (const Attribute* attribute : holder.GetAttrIterator()) {
            const std::string_view old = attribute->GetNameView();
            const std::string name = legal_.GetName(*attribute);
            const bool isGeneric = attribute->GetGenericOption() != Attribute::GenericNone;
            if (isGeneric && !oldOwner.empty()) {
                WriteNameLine(out_, "parameter", JoinNames(oldOwner, old),
                              JoinNames(newOwner, name));
            } else if (name != old && told_.emplace(old).second) {
                WriteNameLine(out_, "attribute", old, name);
            }
        }
    }

    const Orn_Hdl::Netlist& netlist_;
    const Orn_Hdl::LegalNetlist& legal_;
    Port::Stream& out_;
    std::set<std::string, std::less<>> told_;
};

} // namespace

void WriteLegalNames(const Orn_Hdl::Netlist& netlist, const Orn_Hdl::LegalNetlist& legal,
                     Port::Stream& out) {
    Table(netlist, legal, out).WriteAll();
}

} // namespace Tool
