// Functions for comments and attributes. The first three arguments address their holder.
#include "Objects.h"

namespace Python {

namespace {

using Orn_Hdl::Attribute;

Ref GetComment(ModelState& state, Arguments& arguments) {
    return MakeText(FindHolder(state, arguments).object.GetCommentView());
}

Ref AddComment(ModelState& state, Arguments& arguments) {
    FindHolder(state, arguments).object.AddComment(arguments.GetText(3));
    state.Get().SetModifiedFlag(true);
    return Ref::None();
}

/// A value as the commands spell it.
std::string SpellValue(const Attribute& attribute) {
    if (const auto* const vector = dynamic_cast<const Orn_Hdl::AttributeBitVector*>(&attribute)) {
        return SpellBitVector(vector->GetBitVectorValue());
    }
    return std::string(attribute.GetValueString().GetView());
}

/// Name, type, value, generic option, synthesis option, user type.
Ref Describe(const Attribute& attribute) {
    const auto* const user = dynamic_cast<const Orn_Hdl::AttributeUser*>(&attribute);
    return MakeTuple(MakeText(attribute.GetNameView()), MakeText(attribute.GetValueTypeName()),
                     MakeText(SpellValue(attribute)), MakeText(attribute.GetGeneric()),
                     MakeText(attribute.GetSynAttr()),
                     MakeText(user == nullptr ? Port::String() : user->GetUserType()));
}

Ref GetAttributeNames(ModelState& state, Arguments& arguments) {
    Ref list = MakeList();
    for (const Attribute* attribute : FindHolder(state, arguments).attributes.GetAttrIterator()) {
        Append(list, MakeText(attribute->GetNameView()));
    }
    return list;
}

Ref GetAttribute(ModelState& state, Arguments& arguments) {
    const Attribute* const attribute =
        FindHolder(state, arguments).attributes.GetAttr(arguments.GetText(3));
    return attribute == nullptr ? Ref::None() : Describe(*attribute);
}

/// Name, value, type.
Ref AddAttribute(ModelState& state, Arguments& arguments) {
    const Holder holder = FindHolder(state, arguments);
    state.Get().AddAttr(&holder.attributes, arguments.GetText(3), arguments.GetText(4),
                        arguments.GetText(5));
    return Ref::None();
}

Ref RemoveAttribute(ModelState& state, Arguments& arguments) {
    const Holder holder = FindHolder(state, arguments);
    Attribute* const attribute = holder.attributes.GetAttr(arguments.GetText(3));
    if (attribute == nullptr) {
        throw Failure{"library",
                      "Attribute \"" + std::string(arguments.GetText(3)) + "\" not found.\n"};
    }
    holder.attributes.RemoveAttr(attribute);
    state.Get().SetModifiedFlag(true);
    return Ref::None();
}

using Setter = bool (Orn_Hdl::Model::*)(Orn_Hdl::AttributeHolder*, const Port::TextArgument&,
                                        const Port::TextArgument&);

/// Name, value.
template <Setter Set> Ref SetPart(ModelState& state, Arguments& arguments) {
    const Holder holder = FindHolder(state, arguments);
    (state.Get().*Set)(&holder.attributes, arguments.GetText(3), arguments.GetText(4));
    return Ref::None();
}

} // namespace

const std::vector<PyMethodDef> AttributeMethods = {
    Row<GetComment, 3>("comment"),
    Row<AddComment, 4>("add_comment"),
    Row<GetAttributeNames, 3>("attributes"),
    Row<GetAttribute, 4>("attribute"),
    Row<AddAttribute, 6>("add_attribute"),
    Row<RemoveAttribute, 4>("remove_attribute"),
    Row<SetPart<&Orn_Hdl::Model::SetAttrValue>, 5>("set_attribute_value"),
    Row<SetPart<&Orn_Hdl::Model::SetGenericAttrValue>, 5>("set_attribute_generic"),
    Row<SetPart<&Orn_Hdl::Model::SetSynAttrValue>, 5>("set_attribute_synthesis"),
    Row<SetPart<&Orn_Hdl::Model::SetUserType>, 5>("set_attribute_user_type"),
};

} // namespace Python
