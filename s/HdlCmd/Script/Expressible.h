// Whether commands can make the objects of a netlist. What they cannot make comes from calls.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"

#include <string>
#include <string_view>
#include <unordered_set>

namespace Orn_Hdl::Script {

/// Looks at the objects of a netlist one by one. Each operation throws for an object that no
/// command can make.
class Expressible {
public:
    explicit Expressible(const Netlist& netlist) noexcept : netlist_(netlist) {}

    void Check(const Component& component);
    void Check(const Instance& instance);
    /// A scalar signal or a bus.
    void CheckDeclared(const Signal& signal);
    void CheckPart(const Bus& bus, const Signal& part);
    /// Whether a slice or bit has a bus that lists it.
    void CheckHasBus(const Signal& part);
    /// \param name by which a script names the compound.
    void CheckCompound(const CompoundBus& compound, std::string_view name);
    /// A signal that another object names.
    void CheckHeld(const Signal& signal) const;
    /// A pin that points at a signal that does not list it.
    void CheckUnlisted(const Instance& instance, const Pin& pin) const;

private:
    /// Signals are declared, or come from the use of their names.
    enum Kind { KindComponent, KindInstance, KindDeclared, KindUsed };

    void CheckName(Kind kind, const Object& object, const Object* found);

    const Netlist& netlist_;
    /// The names of objects that the netlist finds by other names.
    std::unordered_set<std::string> otherNames_;
};

} // namespace Orn_Hdl::Script
