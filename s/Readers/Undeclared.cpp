#include "Readers/Undeclared.h"

#include "Orn_Hdl/Model/Netlist.h"
#include "Readers/Directions.h"

#include <algorithm>
#include <string>
#include <unordered_map>

namespace Orn_Hdl::Readers {

namespace {

void AppendItem(std::string& list, std::string_view item) {
    list.append(list.empty() ? "" : ", ").append(item);
}

/// The pins of a module that keep it from being a component; empty when there are none.
/// \param untold what its directions lack; null for nothing.
std::string ListPins(const ModuleHead& head, const UntoldDirections* untold) {
    std::string list;
    if (untold != nullptr) {
        for (const std::string& pin : untold->open) {
            AppendItem(list, pin);
        }
        for (const std::string& pin : untold->contradictory) {
            AppendItem(list, pin + " in both directions");
        }
    }
    for (const PortHead& port : head.ports) {
        if (!port.hasWidth) {
            AppendItem(list, port.name + " of unknown width");
        }
    }
    return list;
}

} // namespace

void SettleUndeclared(const Files& files, const Heads& heads, Netlist& netlist) {
    const auto isUndeclared = [](const auto& head) {
        return !head->isDeclared && head->component != nullptr;
    };
    if (std::none_of(heads.GetAll().begin(), heads.GetAll().end(), isUndeclared)) {
        return;
    }
    std::unordered_map<const Component*, UntoldDirections> untold;
    for (UntoldDirections& each : InferDirections(netlist)) {
        untold.emplace(each.component, std::move(each));
    }
    std::string modules;
    const Place* first = nullptr;
    for (const auto& head : heads.GetAll()) {
        if (!isUndeclared(head)) {
            continue;
        }
        const auto found = untold.find(head->component);
        const std::string pins = ListPins(*head, found == untold.end() ? nullptr : &found->second);
        if (!pins.empty()) {
            AppendItem(modules, Quoted(head->name) + " (" + pins + ")");
            first = first == nullptr ? &head->place : first;
        }
    }
    if (first != nullptr) {
        FailAt(files, *first,
               "modules that are not declared, with ports whose direction does not follow from "
               "the design: " +
                   modules + ": a library file has to declare them");
    }
}

} // namespace Orn_Hdl::Readers
