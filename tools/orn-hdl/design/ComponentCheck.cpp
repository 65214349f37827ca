#include "design/ComponentCheck.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "diagnostics/NameKey.h"
#include "explain/Additions.h"

#include <map>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>

namespace Tool {

namespace {

using Explain::ObjectKind;
using std::string_view;

/// Of so many differences the places are looked for, which takes a pass over each file.
constexpr std::uint64_t MostPlaces = 20;

std::string Quoted(string_view name) {
    return "\"" + std::string(name) + "\"";
}

std::string CountBits(int width) {
    return std::to_string(width) + (width == 1 ? " bit" : " bits");
}

string_view GetBase(string_view name) {
    return name.substr(0, name.find('('));
}

/// A pin's name without its range, as the model compares it.
std::string GetBaseKey(string_view name) {
    return GetNameKey(GetBase(name));
}

/// One component, and the model that it is of.
class ComponentComparison {
public:
    ComponentComparison(const Orn_Hdl::Component& component, const ModelOfFile& user,
                        const ModelOfFile& used, Reporter& reporter)
        : component_(component), user_(user), used_(used), reporter_(reporter) {}

    void Compare();

private:
    void ComparePin(const Orn_Hdl::Pin& pin, const Orn_Hdl::Signal& port);
    void Report(const Orn_Hdl::Pin* pin, const Orn_Hdl::Signal* port, std::string message);
    Place FindPlace(CommandLines& lines, ObjectKind kind, string_view name,
                    string_view owner) const;

    const Orn_Hdl::Component& component_;
    const ModelOfFile& user_;
    const ModelOfFile& used_;
    Reporter& reporter_;
};

void ComponentComparison::Compare() {
    std::map<std::string, const Orn_Hdl::Signal*> ports;
    for (const Orn_Hdl::Signal* signal : used_.model->GetNetlist()->GetSignalIterator()) {
        if (signal->IsPort() && signal->IsNeededToDeclared()) {
            ports.emplace(GetBaseKey(signal->GetNameView()), signal);
        }
    }
    std::set<const Orn_Hdl::Signal*> connected;
    for (const Orn_Hdl::Pin* pin : component_.GetPinIterator()) {
        const auto port = ports.find(GetBaseKey(pin->GetNameView()));
        if (port == ports.end()) {
            Report(pin, nullptr,
                   "the pin " + Quoted(pin->GetNameView()) + " is no port of the design " +
                       Quoted(component_.GetNameView()));
            continue;
        }
        ComparePin(*pin, *port->second);
        connected.insert(port->second);
    }
    for (const auto& [key, port] : ports) {
        if (connected.count(port) != 0) {
            continue;
        }
        Report(nullptr, port,
               "the component " + Quoted(component_.GetNameView()) + " has no pin for the port " +
                   Quoted(port->GetNameView()));
    }
}

void ComponentComparison::ComparePin(const Orn_Hdl::Pin& pin, const Orn_Hdl::Signal& port) {
    const std::string names = "the pin " + Quoted(pin.GetNameView()) + " of the component " +
                              Quoted(component_.GetNameView()) + " is ";
    const Orn_Hdl::Polarity own = pin.GetPolarity();
    const Orn_Hdl::Polarity other = port.GetPortPolarity();
    if (own.GetValue() != other.GetValue()) {
        Report(&pin, &port,
               names + own.GetValueName() + ", but the port is " + other.GetValueName());
        return;
    }
    if (pin.GetPinType() == Orn_Hdl::PinTypeBusIndex) {
        return; // One bit of the port.
    }
    const bool isBus = pin.GetPinType() == Orn_Hdl::PinTypeBus;
    const int width = isBus ? static_cast<const Orn_Hdl::BusPin&>(pin).GetWidth() : 1;
    if (width != port.GetWidth()) {
        Report(&pin, &port,
               names + CountBits(width) + " wide, but the port has " + CountBits(port.GetWidth()));
    } else if (isBus != (port.GetSignalType() == Orn_Hdl::SignalTypeBus)) {
        Report(&pin, &port,
               names +
                   (isBus ? "a bus, but the port is a scalar" : "a scalar, but the port is a bus"));
    }
}

void ComponentComparison::Report(const Orn_Hdl::Pin* pin, const Orn_Hdl::Signal* port,
                                 std::string message) {
    Diagnostic diagnostic;
    diagnostic.message = std::move(message);
    const string_view component = component_.GetNameView();
    diagnostic.place =
        pin != nullptr ? FindPlace(*user_.lines, ObjectKind::Pin, pin->GetNameView(), component)
                       : FindPlace(*user_.lines, ObjectKind::Component, component, string_view());
    if (port != nullptr) {
        diagnostic.notes.push_back(
            {"the port of " + Quoted(component),
             FindPlace(*used_.lines, ObjectKind::Signal, port->GetNameView(), string_view())});
    } else {
        diagnostic.notes.push_back(
            {"the design " + Quoted(component) + " comes from " + used_.lines->GetName()});
    }
    reporter_.Report(std::move(diagnostic));
}

/// The line that adds something; the file alone if it is not found.
Place ComponentComparison::FindPlace(CommandLines& lines, ObjectKind kind, string_view name,
                                     string_view owner) const {
    std::optional<Explain::Addition> addition;
    if (reporter_.GetErrorCount() < MostPlaces && CanReadAgain(lines.GetSystemName())) {
        SourceLines source(lines.GetSystemName());
        addition = Explain::FindAddition(source, kind, name, owner);
    }
    if (addition) {
        return lines.GetPlace(addition->line, addition->mark);
    }
    Place place;
    place.file = lines.GetName();
    return place;
}

} // namespace

bool CheckComponents(const std::vector<ModelOfFile>& models, const ModelLinks& links,
                     Reporter& reporter) {
    const std::uint64_t before = reporter.GetErrorCount();
    for (const ModelOfFile& user : models) {
        for (const Orn_Hdl::Component* component :
             user.model->GetNetlist()->GetComponentIterator()) {
            if (const std::optional<std::size_t> used = links.Find(component->GetNameView())) {
                ComponentComparison(*component, user, models[*used], reporter).Compare();
            }
        }
    }
    return reporter.GetErrorCount() == before;
}

} // namespace Tool
