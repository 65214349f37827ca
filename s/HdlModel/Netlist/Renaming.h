// Renaming what a netlist holds.
#pragma once

#include "HdlModel/Objects/ObjectName.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl {

/// Objects of a netlist with a new name for each. The names are collected and checked first, so
/// that either all objects are renamed or none.
class Renaming {
public:
    explicit Renaming(Netlist& netlist) noexcept : netlist_(netlist) {}

    /// \param name is normalised here.
    template <class T> void Add(T& object, std::string_view name) {
        Add(object, netlist_.Holds(object), name);
    }
    /// Adds a signal, its slices and bits when it is a bus, and the compounds named after these.
    void AddWithParts(Signal& signal, std::string_view name);

    /// The first new name that another object of the netlist has; null if there is none.
    const std::string* FindTaken() const;
    /// Renames the objects. If allocation fails, none of them is renamed.
    void Apply();

private:
    struct Entry {
        Object* object;
        bool isHeld;
        std::string name;
        ObjectName stored;
    };

    void Add(Object& object, bool isHeld, std::string_view name);
    void AddCompounds(const Signal& signal);
    std::string NewCompoundName(std::string_view name) const;

    Netlist& netlist_;
    std::vector<Entry> entries_;
    /// The entry of each old name, in upper case.
    std::unordered_map<std::string, std::size_t> byOldName_;
    std::unordered_set<const Object*> objects_;
};

} // namespace Orn_Hdl
