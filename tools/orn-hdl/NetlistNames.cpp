#include "NetlistNames.h"

#include "NameLine.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <map>
#include <string>
#include <tuple>
#include <unordered_map>

namespace Tool {

namespace {

using Orn_Hdl::ReaderRenaming;
using Kind = ReaderRenaming::Kind;
using std::string_view;

string_view WithoutRange(string_view name) {
    return name.substr(0, name.find('('));
}

class RenamingTable {
public:
    RenamingTable(const std::vector<ReaderRenaming>& renamings, const Orn_Hdl::LegalNetlist* legal,
                  Port::Stream& out)
        : legal_(legal), out_(out) {
        for (const ReaderRenaming& renaming : renamings) {
            auto& names =
                renaming.kind == Kind::Pin ? pinNames_[renaming.component] : names_[renaming.kind];
            names.emplace(renaming.newName, renaming.name);
        }
    }

    void WriteAll(const Orn_Hdl::Netlist& netlist);

private:
    using Names = std::unordered_map<string_view, string_view>;

    /// The name in the file of the name that the reader made.
    static string_view GetOld(const Names& names, string_view name) {
        const auto found = names.find(name);
        return found == names.end() ? name : found->second;
    }
    /// The name in the netlists, without a range.
    std::string GetNew(const Orn_Hdl::Object& object) const {
        return legal_ == nullptr ? std::string(WithoutRange(object.GetNameView()))
                                 : std::string(WithoutRange(legal_->GetName(object)));
    }
    void Write(const char* kind, Kind of, const Orn_Hdl::Object& object) {
        WriteNameLine(out_, kind, GetOld(names_[of], WithoutRange(object.GetNameView())),
                      GetNew(object));
    }
    void WriteComponent(const Orn_Hdl::Component& component);

    const Orn_Hdl::LegalNetlist* const legal_;
    Port::Stream& out_;
    std::map<Kind, Names> names_;
    /// By the component's name in the model.
    std::map<string_view, Names> pinNames_;
};

void RenamingTable::WriteComponent(const Orn_Hdl::Component& component) {
    Write("component", Kind::Component, component);
    const string_view oldOwner = GetOld(names_[Kind::Component], component.GetNameView());
    const std::string newOwner = GetNew(component);
    const Names& names = pinNames_[component.GetNameView()];
    for (const Orn_Hdl::Pin* pin : component.GetPinIterator()) {
        const string_view old = GetOld(names, WithoutRange(pin->GetNameView()));
        WriteNameLine(out_, "pin", JoinNames(oldOwner, old), JoinNames(newOwner, GetNew(*pin)));
    }
}

void RenamingTable::WriteAll(const Orn_Hdl::Netlist& netlist) {
    Write("module", Kind::Module, netlist);
    for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
        WriteComponent(*component);
    }
    for (const bool isPort : {true, false}) {
        for (const Orn_Hdl::Signal* signal : netlist.GetSignalIterator()) {
            if (signal->IsNeededToDeclared() && signal->IsPort() == isPort) {
                Write(isPort ? "port" : "net", Kind::Signal, *signal);
            }
        }
    }
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        Write("cell", Kind::Instance, *instance);
    }
}

} // namespace

const Orn_Hdl::Signal* FindDeclared(const Orn_Hdl::Netlist& netlist, string_view name) {
    const std::string text(name);
    const Orn_Hdl::Signal* const bus = netlist.GetParentBus(text.c_str());
    return bus != nullptr ? bus : netlist.GetSignal(string_view(text));
}

void WriteNetlistNames(const Orn_Hdl::Netlist& netlist,
                       const std::vector<ReaderRenaming>& renamings,
                       const Orn_Hdl::LegalNetlist* legal, Port::Stream& out) {
    RenamingTable(renamings, legal, out).WriteAll(netlist);
}

} // namespace Tool
