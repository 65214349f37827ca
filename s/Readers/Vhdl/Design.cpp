#include "Readers/Vhdl/Design.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace Orn_Hdl::Readers::Vhdl {

std::string KeyOf(const std::string& name) {
    std::string key(name);
    if (!IsExtended(name)) {
        std::transform(key.begin(), key.end(), key.begin(), Port::ToLower);
    }
    return key;
}

const Architecture* Design::FindArchitecture(const ModuleHead& entity,
                                             const std::string& name) const {
    const Architecture* last = nullptr;
    for (const auto& architecture : architectures) {
        if (IsSameName(architecture->entity, entity.name, true) &&
            (name.empty() || IsSameName(architecture->name, name, true))) {
            last = architecture.get();
        }
    }
    return last;
}

ModuleHead* Design::FindComponent(const Architecture& architecture, std::string_view name) const {
    if (ModuleHead* const local = architecture.components.Find(name)) {
        return local;
    }
    ModuleHead* const component = components.Find(name);
    return component != nullptr ? component : entities.Find(name);
}

ModuleHead* Design::FindEntity(std::string_view name) const {
    ModuleHead* const entity = entities.Find(name);
    return entity != nullptr ? entity : components.Find(name);
}

} // namespace Orn_Hdl::Readers::Vhdl
