// What is known of design units before one architecture is read.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Place.h"

#include <cstdint>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

/// The library and use clauses in front of a design unit.
struct Clauses {
    std::vector<std::string> libraries;
    std::vector<std::string> uses;
    /// The semicolon in front of the clauses; line 0 if there is none.
    Place formerEnd;
};

struct Architecture {
    /// Where a component or an entity is instantiated for the first time.
    struct Use {
        std::string name;
        Place place;
        /// Whether the instance names an entity, not a component.
        bool isEntity = false;
    };

    std::string name;
    std::string entity;
    Place place;
    Heads components{true};
    std::vector<Use> uses;
    Clauses clauses;
};

/// The text under which an object is found by a name of the file: names that differ in letter case
/// alone have the same.
std::string KeyOf(const std::string& name);

struct Configuration {
    std::string name;
    std::string entity;
    /// The architecture that it configures.
    std::string architecture;
    /// Whether it is hidden from synthesis.
    bool isHidden = false;
    /// Why no model can have it, and where; empty when one can, or when it changes nothing.
    std::string problem;
    Place problemPlace;
    /// The components that it binds, as `KeyOf` gives their names.
    std::set<std::string> components;
};

/// The design units of all files.
struct Design {
    Heads entities{true};
    /// The components that packages declare, and those of netlists.
    Heads components{true};
    std::vector<std::unique_ptr<Architecture>> architectures;
    std::vector<Configuration> configurations;
    std::map<const ModuleHead*, Clauses> clausesOfEntities;
    /// The architecture in which the file ends; null if there is none.
    const Architecture* unfinished = nullptr;

    /// The last architecture of an entity, or the one of that name when there is one; null if there
    /// is none.
    const Architecture* FindArchitecture(const ModuleHead& entity, const std::string& name) const;
    /// The head that an instance of a component refers to; null if there is none.
    ModuleHead* FindComponent(const Architecture& architecture, std::string_view name) const;
    /// The head that an instance of an entity refers to; null if there is none.
    ModuleHead* FindEntity(std::string_view name) const;
};

} // namespace Orn_Hdl::Readers::Vhdl
