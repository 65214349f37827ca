#include "import/CellComponents.h"

#include "import/CellLibrary.h"

#include "Orn_Hdl/Model/Netlist.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <memory>
#include <string>

namespace Tool::Import {

namespace {

/// Whether a component can have the port.
bool IsKnown(const ModulePort& port) {
    const bool isBus = port.bits.count != 1 || port.range.offset != 0;
    return port.direction != Direction::Unspecified && port.bits.count != 0 &&
           (!isBus || (port.range.offset >= 0 && port.range.offset + port.bits.count - 1 <=
                                                     std::numeric_limits<std::int32_t>::max()));
}

int GetPolarity(Direction direction) {
    return direction == Direction::Input    ? Orn_Hdl::Polarity::Input
           : direction == Direction::Output ? Orn_Hdl::Polarity::Output
                                            : Orn_Hdl::Polarity::BiDirectional;
}

std::string GetPinName(const ModulePort& port) {
    std::string name(port.name);
    if (port.bits.count == 1 && port.range.offset == 0) {
        return name;
    }
    const std::string low = std::to_string(port.range.offset);
    const std::string high = std::to_string(port.range.offset + port.bits.count - 1);
    name.append("(").append(port.range.upto ? low : high);
    return name.append(":").append(port.range.upto ? high : low).append(")");
}

} // namespace

void AddComponents(const CellLibrary& library, Orn_Hdl::Netlist& netlist) {
    library.ForEach([&netlist](const Module& module) {
        const auto isWanting = [](const ModulePort& port) {
            return !port.isPower && !IsKnown(port);
        };
        if (std::any_of(module.ports.begin(), module.ports.end(), isWanting)) {
            return;
        }
        auto component = std::make_unique<Orn_Hdl::Component>(module.name);
        for (const ModulePort& port : module.ports) {
            if (!port.isPower) {
                component->AddPin(GetPinName(port), Orn_Hdl::Polarity(GetPolarity(port.direction)),
                                  "");
            }
        }
        netlist.Add(component.release());
    });
}

} // namespace Tool::Import
