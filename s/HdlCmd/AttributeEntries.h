// The entries of the attribute commands: each of four operations for each of six kinds of objects
// that have attributes.
#pragma once

#include "HdlCmd/Catalogue.h"
#include "HdlCmd/Executing.h"
#include "HdlCmd/Parsing.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace Orn_Hdl {

/// A text as a template argument.
template <std::size_t Size> struct FixedText {
    static constexpr std::size_t Length = Size - 1;

    /// Not explicit, so that a template argument can be a literal.
    constexpr FixedText(const char (&literal)[Size]) { std::copy_n(literal, Size, characters); }

    char characters[Size] = {};
};

/// Texts joined while compiling.
template <FixedText... Parts>
constexpr auto JoinedTexts = [] {
    std::array<char, (Parts.Length + ... + 1)> joined{};
    char* place = joined.data();
    ((place = std::copy_n(Parts.characters, Parts.Length, place)), ...);
    return joined;
}();

/// A kind of object that has attributes: how the arguments of a command name the object, what its
/// help calls it, how its name is read, and what the help adds to the commands for values and
/// types, and to the command for options.
template <FixedText Argument, FixedText Noun, AttributeOwner Owner, FixedText Remark,
          FixedText OptionRemark>
struct AttributeOwnerTraits {
    static constexpr auto ArgumentText = Argument;
    static constexpr auto NounText = Noun;
    static constexpr AttributeOwner OwnerKind = Owner;
    static constexpr auto RemarkText = Remark;
    static constexpr auto OptionRemarkText = OptionRemark;
};

/// What the help says where a command has no effect on the output.
constexpr FixedText NoEffect = " It has no effect on the output.";

using OfModule = AttributeOwnerTraits<"", "the module", AttributeOwner::Module, "",
                                      " -SYNATTR=... has no effect on the output.">;
using OfComponent =
    AttributeOwnerTraits<"<component> ", "a component", AttributeOwner::Object, "", "">;
using OfInstance =
    AttributeOwnerTraits<"<instance> ", "an instance", AttributeOwner::Object, "", "">;
using OfSignal = AttributeOwnerTraits<"<signal> ", "a signal", AttributeOwner::Object, "",
                                      " -GENERIC=... has no effect on the output.">;
using OfComponentPin = AttributeOwnerTraits<"<component.pin> ", "a pin of a component",
                                            AttributeOwner::Pin, NoEffect, NoEffect>;
using OfInstancePin = AttributeOwnerTraits<"<instance.pin> ", "a pin of an instance",
                                           AttributeOwner::Pin, NoEffect, NoEffect>;

/// The entry of a command that adds an attribute or sets its value.
template <class Owner, auto Operation> constexpr CommandEntry AddAttribute(const char* phrase) {
    return {{phrase,
             JoinedTexts<Owner::ArgumentText, "[-TYPE=<type>] <attribute> [value]">.data(),
             JoinedTexts<"Adds an attribute to ",
                         Owner::NounText,
                         ", or sets its value. The type is String, Integer, Float, Boolean, Bit, "
                         "BitVector or User.",
                         Owner::RemarkText>.data()},
            ParseAddAttribute<Owner::OwnerKind>,
            Apply<Operation>};
}

/// The entry of a command that sets the value of an attribute.
template <class Owner, auto Operation>
constexpr CommandEntry SetAttributeValue(const char* phrase) {
    return {
        {phrase, JoinedTexts<Owner::ArgumentText, "<attribute> <value>">.data(),
         JoinedTexts<"Sets the value of an attribute of ", Owner::NounText, ".", Owner::RemarkText>.data()},
        ParseAttributeText<Owner::OwnerKind>,
        Apply<Operation>};
}

/// The entry of a command that names the type of an attribute of type User.
template <class Owner, auto Operation>
constexpr CommandEntry SetAttributeUserType(const char* phrase) {
    return {
        {phrase, JoinedTexts<Owner::ArgumentText, "<attribute> <type>">.data(),
         JoinedTexts<"Names the type of an attribute of type User of ", Owner::NounText, ".",
                     Owner::RemarkText>.data()},
        ParseAttributeText<Owner::OwnerKind>,
        Apply<Operation>};
}

/// The entry of a command that sets how an attribute is written.
template <class Owner, auto SetGeneric, auto SetSynAttr>
constexpr CommandEntry SetAttributeOption(const char* phrase) {
    return {{phrase,
             JoinedTexts<Owner::ArgumentText, "<attribute> <option> [option]">.data(),
             JoinedTexts<"Sets how an attribute of ",
                         Owner::NounText,
                         " is written: -GENERIC=NONE|SYN|NOSYN, "
                         "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC.",
                         Owner::OptionRemarkText>.data()},
            ParseAttributeOptions<Owner::OwnerKind>,
            ApplyOptions<SetGeneric, SetSynAttr>};
}

} // namespace Orn_Hdl
