// A copy of a design that is written legally.
#pragma once

#include "Legal/Plan.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string>
#include <string_view>
#include <unordered_map>

namespace Orn_Hdl::Legal {

/// Copies what is written of a design, with the changes of a plan, for one language.
class Copier {
public:
    Copier(const Netlist& from, const Plan& plan, Language language, Netlist& to)
        : from_(from), plan_(plan), names_(plan.GetNames()), language_(language), to_(to) {}

    void CopyAll();

private:
    void CopyDesign();
    void CopyComponents();
    void CopyDeclaredSignals();
    void CopyParts();
    void CopyCompounds();
    Signal* CopyCompound(const CompoundBus& compound);
    void CopyConstants();
    void CopyAliases();
    void CopyInstances();
    void CopyPins(const Instance& instance, Instance& copy);
    void WireLatePins(const Instance& instance, Instance& copy);
    void WireToOwnSignal(Pin& pin, const std::string& name);

    std::string NameOf(const Object& object) const;
    std::string RenamedPin(const Pin& pin) const;
    std::string NameOfPart(const BusPart& part) const;
    void CopyComment(const Object& object, Object& copy) const;
    void CopyAttributes(const AttributeHolder& holder, AttributeHolder& copy) const;
    void CopyAttribute(const Attribute& attribute, AttributeHolder& copy) const;
    Signal* MakeDeclared(const Signal& like, const std::string& base);
    /// What stands for a signal inside the design; null for none.
    Signal* Find(const Signal* signal) const;

    const Netlist& from_;
    const Plan& plan_;
    const NewNames& names_;
    const Language language_;
    Netlist& to_;
    std::unordered_map<const Component*, Component*> components_;
    /// What stands for a signal inside the design: of a port that is used against its direction,
    /// its internal signal.
    std::unordered_map<const Signal*, Signal*> signals_;
};

} // namespace Orn_Hdl::Legal
