// Who holds an attribute, and what is asked of every attribute.
#pragma once

#include "Check/Context.h"
#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Attributes.h"
#include "Writers/Generics.h"

#include <string>
#include <string_view>

namespace Orn_Hdl::Checking {

/// Who holds an attribute.
struct Holder {
    const AttributeHolder* attributes = nullptr;
    const Object* object = nullptr;
    Kind kind = Kind::ModuleAttribute;

    std::string_view GetName() const {
        return kind == Kind::ModuleAttribute   ? std::string_view()
               : kind == Kind::SignalAttribute ? Names::BaseName(object->GetNameView())
                                               : object->GetNameView();
    }
    Cause CauseOf(const Attribute& attribute) const {
        return Named(kind,
                     kind == Kind::ModuleAttribute ? std::string_view() : object->GetNameView(),
                     attribute.GetNameView());
    }
    std::string Describe(const Attribute& attribute) const {
        std::string text = "the attribute " + Quoted(attribute.GetNameView()) + " of ";
        return text += kind == Kind::ModuleAttribute ? "the design" : Quoted(GetName());
    }
};

using Writers::IsGeneric;

inline bool IsSynthesis(const Attribute& attribute) {
    return attribute.GetSynAttrOption() != Attribute::SynAttrNone;
}

/// The name of the attribute's type in VHDL, in small letters.
std::string TypeOf(const Attribute& attribute);

/// Adds a finding about an attribute. \return null when no target that counts minds.
Finding* AddFinding(Context& context, RuleId rule, const Verdicts& verdicts, const Holder& holder,
                    const Attribute& attribute);

} // namespace Orn_Hdl::Checking
