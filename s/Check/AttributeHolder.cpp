#include "Check/AttributeHolder.h"

namespace Orn_Hdl::Checking {

/// The name of the attribute's type in VHDL, in small letters.
std::string TypeOf(const Attribute& attribute) {
    switch (attribute.GetValueType()) {
    case Attribute::Integer:
        return "integer";
    case Attribute::Float:
        return "real";
    case Attribute::Boolean:
        return "boolean";
    case Attribute::Bit:
        return "bit";
    case Attribute::BitVector:
        return "bit_vector";
    case Attribute::User:
        return Lower(static_cast<const AttributeUser&>(attribute).GetUserType().GetView());
    default:
        return "string";
    }
}

Finding* AddFinding(Context& context, RuleId rule, const Verdicts& verdicts, const Holder& holder,
                    const Attribute& attribute) {
    Verdicts counted = verdicts;
    if (attribute.GetGenericOption() == Attribute::GenericNoSyn && rule != RuleId::CommentInValue &&
        rule != RuleId::HiddenGeneric) {
        // Yosys does not read what is kept from synthesis.
        counted.Set(Check::Target::Yosys, Check::Verdict::Accepts);
    }
    Finding* const finding = context.Add(rule, counted, holder.CauseOf(attribute));
    if (finding != nullptr) {
        finding->objects = {holder.object, &attribute};
    }
    return finding;
}

} // namespace Orn_Hdl::Checking
