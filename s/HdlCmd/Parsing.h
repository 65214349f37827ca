// How the lines of the command language are read: by fixed positions, counted from the first word
// of the phrase.
#pragma once

#include "HdlCmd/Arguments.h"
#include "Orn_Hdl/Containers/StringArray.h"

#include <string>
#include <string_view>

namespace Orn_Hdl {

/// The flag of the commands that set an option to true or false.
enum class OptionFlag { On };

/// The flag of CONNECT SIGNAL and ASSIGN CONSTANT: the line names a pin, not a signal.
enum class TargetFlag { Pin };

/// The flags of the write commands.
enum class WriteFlag { Append, WithoutHeader };

/// Which options a SET ... ATTRIBUTE OPTION command was given.
enum class AttributeOptionFlag { Generic, SynAttr };

/// The kinds of names whose letter case UPPERCASE and LOWERCASE choose.
enum class NameKind { Instance, Signal, Component };

/// What has the attributes that a command is about: the module, which takes no name, an object with
/// a name of its own, or a pin, which its line names as "owner.pin".
enum class AttributeOwner { Module, Object, Pin };

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
