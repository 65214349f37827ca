#include "import/DesignUnits.h"

#include "import/JsonPath.h"
#include "import/ReadableName.h"
#include "import/SignalReferences.h"

#include <algorithm>
#include <cstddef>

namespace Tool::Import {

DesignUnits::DesignUnits(const ImportedDesign& design, const Hierarchy& hierarchy,
                         const NameRules& rules, Warnings& warnings)
    : hierarchy_(hierarchy), names_(rules), typeNames_(design.types.size()) {
    NameUnits(design, warnings);
}

void DesignUnits::NameUnits(const ImportedDesign& design, Warnings& warnings) {
    for (const Module* module : hierarchy_.GetModules()) {
        units_[module].name = names_.ClaimSame(module->name);
    }
    for (std::uint32_t type = 0; type < typeNames_.size(); ++type) {
        if (hierarchy_.Find(type) == nullptr) {
            typeNames_[type] = names_.ClaimSame(design.types[type].name);
        }
    }
    for (const Module* module : hierarchy_.GetModules()) {
        std::string& name = units_[module].name;
        if (!name.empty()) {
            continue;
        }
        name = names_.ClaimSimilar(MakeReadableName(*module), 'm');
        if (!IsCopyOfModule(module->name)) {
            const NameRules& rules = names_.GetRules();
            warnings.Add(JsonPath("modules").AddKey(module->name),
                         (rules.IsLegal(module->name)
                              ? "another module has the name " + Quote(module->name)
                              : Quote(module->name) + rules.GetComplaint()) +
                             "; the netlist is renamed to " + name);
        }
    }
}

const DesignUnit* DesignUnits::Find(std::uint32_t type) const {
    const Module* const module = hierarchy_.Find(type);
    return module == nullptr ? nullptr : &units_.at(module);
}

void DesignUnits::SetPorts(const Module& module, const BitOwners& owners) {
    std::vector<ImportedPin>& pins = units_.at(&module).pins;
    for (std::size_t p = 0; p < module.ports.size(); ++p) {
        const ImportedSignal& signal = owners.GetSignals()[p];
        ImportedPin& pin = pins.emplace_back();
        pin.oldName = module.ports[p].name;
        pin.baseName = signal.name;
        pin.name = GetFullName(signal);
        pin.direction = module.ports[p].direction;
        pin.width = signal.width;
        pin.scalar = signal.IsScalar();
    }
}

bool DesignUnits::SharedComponent::Matches(const ImportedComponent& component) const {
    return std::all_of(component.pins.begin(), component.pins.end(), [this](const auto& pin) {
        const auto own = pins.find(pin.oldName);
        return own == pins.end() ||
               (own->second.name == pin.name && own->second.direction == pin.direction);
    });
}

std::string DesignUnits::NameComponent(const ImportedComponent& component) {
    std::vector<SharedComponent>& shared = components_[component.type];
    auto found = std::find_if(shared.begin(), shared.end(), [&](const SharedComponent& other) {
        return other.module != module_ && other.Matches(component);
    });
    if (found == shared.end()) {
        std::string name = shared.empty() ? typeNames_[component.type] : std::string();
        if (name.empty()) {
            name = names_.ClaimSimilar(component.oldName, 'c');
        }
        found = shared.insert(shared.end(), SharedComponent{std::move(name), {}, 0});
    }
    found->module = module_;
    for (const ImportedPin& pin : component.pins) {
        found->pins.emplace(pin.oldName, pin);
    }
    return found->name;
}

} // namespace Tool::Import
