// How the lines of the command language are read: by fixed positions, counted from the first word
// of the phrase.
#pragma once

#include "HdlCmd/Arguments.h"
#include "Orn_Hdl/Containers/StringArray.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {

/// Bits of `Arguments::HasFlag`.
enum ArgumentFlag : unsigned {
    /// A flag command was not given "false".
    FlagOn = 1,
    /// The connection or constant is that of a pin.
    OnAPin = 1,
    /// A write command was given "-APPEND", "-NOHEADER".
    AppendToFile = 1,
    WithoutHeader = 2,
    /// An option of that kind was given.
    GenericGiven = 1,
    SynAttrGiven = 2
};

/// The kinds of names that UPPERCASE and LOWERCASE know, as flags.
enum NameKind : unsigned { InstanceNames = 1, SignalNames = 2, ComponentNames = 4 };

/// On what an attribute command acts; the value is the number of name texts that this takes.
enum AttributeOwner { OnModule = 0, OnObject = 1, OnPin = 2 };

bool ParseNothing(const StringArray& tokens, Arguments& arguments);
bool ParsePin(const StringArray& tokens, Arguments& arguments);
bool ParsePort(const StringArray& tokens, Arguments& arguments);
bool ParseSignal(const StringArray& tokens, Arguments& arguments);
bool ParseConnection(const StringArray& tokens, Arguments& arguments);
bool ParseConstant(const StringArray& tokens, Arguments& arguments);
bool ParseWrite(const StringArray& tokens, Arguments& arguments);
bool ParseUppercase(const StringArray& tokens, Arguments& arguments);
bool ParseLowercase(const StringArray& tokens, Arguments& arguments);
bool ParseOwnerComment(const StringArray& tokens, Arguments& arguments);
bool ParsePinComment(const StringArray& tokens, Arguments& arguments);

bool ParseFlagAt(const StringArray& tokens, int position, Arguments& arguments);
bool ParseAddAttributeOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);
bool ParseAttributeTextOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);
bool ParseAttributeOptionsOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);

/// One text, which must not be empty.
template <int Position> bool ParseText(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(Position)});
    return !tokens.GetView(Position).empty();
}

/// The texts at some positions of a line that has at least `Least` words.
template <int Least, int... Positions>
bool ParseTexts(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(Positions)...});
    return tokens.GetSize() >= Least;
}

/// The words from a position on, joined by one blank.
template <int Least, int First> bool ParseJoined(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.JoinFrom(First)});
    return tokens.GetSize() >= Least;
}

template <int Position> bool ParseFlag(const StringArray& tokens, Arguments& arguments) {
    return ParseFlagAt(tokens, Position, arguments);
}

template <AttributeOwner Owner>
bool ParseAddAttribute(const StringArray& tokens, Arguments& arguments) {
    return ParseAddAttributeOf(tokens, Owner, arguments);
}

template <AttributeOwner Owner>
bool ParseAttributeText(const StringArray& tokens, Arguments& arguments) {
    return ParseAttributeTextOf(tokens, Owner, arguments);
}

template <AttributeOwner Owner>
bool ParseAttributeOptions(const StringArray& tokens, Arguments& arguments) {
    return ParseAttributeOptionsOf(tokens, Owner, arguments);
}

} // namespace Orn_Hdl
