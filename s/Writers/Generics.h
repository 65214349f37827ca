// The attributes that become parameters or generics.
#pragma once

#include "Options/EffectiveAttrs.h"
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"

namespace Orn_Hdl::Writers {

/// Whether an attribute becomes a parameter or generic.
inline bool IsGeneric(const Attribute& attribute) noexcept {
    return attribute.GetGenericOption() != Attribute::GenericNone;
}

/// The attributes whose generic option is "SYN" and those for which it is "NOSYN".
struct GenericAttrs {
    PtrArray<Attribute*> syn;
    PtrArray<Attribute*> nosyn;

    GenericAttrs() = default;
    explicit GenericAttrs(const Iterator<Attribute*>& attributes) { Split(attributes); }

    bool IsEmpty() const noexcept { return syn.IsEmpty() && nosyn.IsEmpty(); }
    /// Replaces both lists by the attributes in `attributes`.
    void Split(const Iterator<Attribute*>& attributes);
    /// The first attribute named exactly "INIT", where "SYN" takes precedence over "NOSYN"; null if
    /// there is none.
    Attribute* FindInit() const;
};

using Orn_Hdl::GetEffectiveAttrs;

/// Whether the instances in the netlist get the module's own parameter or generic INIT instead of
/// their own values: the netlist has such an attribute, and its name has a mark of the language.
bool PassesInit(Language language, const Netlist& netlist);

} // namespace Orn_Hdl::Writers
