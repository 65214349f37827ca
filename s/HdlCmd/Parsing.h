// How the lines of the command language are read. Each function takes the words of a line, those of
// the phrase included, sets the arguments of the command, and returns false if words are missing or
// invalid. Positions count from 0, the first word of the phrase.
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

/// The words of UPPERCASE and LOWERCASE for the kinds of names. The misspelling is part of the
/// command language.
namespace NameKindWords {
constexpr std::string_view Instance = "instance";
constexpr std::string_view Component = "component";
constexpr std::string_view SignalInUppercase = "siganl";
constexpr std::string_view SignalInLowercase = "signal";
} // namespace NameKindWords

/// What the options of the attribute commands begin with.
namespace AttributeOptionPrefixes {
constexpr std::string_view Type = "-TYPE=";
constexpr std::string_view Generic = "-GENERIC=";
constexpr std::string_view SynAttr = "-SYNATTR=";
} // namespace AttributeOptionPrefixes

/// What has the attributes that a command is about: the module, which takes no name, an object with
/// a name of its own, or a pin, which its line names as "owner.pin".
enum class AttributeOwner { Module, Object, Pin };

/// Takes any line.
bool ParseNothing(const StringArray& tokens, Arguments& arguments);
/// ADD PIN: sets pin, direction, component and default value.
bool ParsePin(const StringArray& tokens, Arguments& arguments);
/// ADD PORT: sets name and direction.
bool ParsePort(const StringArray& tokens, Arguments& arguments);
/// ADD SIGNAL: sets the name; a direction is checked and dropped.
bool ParseSignal(const StringArray& tokens, Arguments& arguments);
/// CONNECT SIGNAL: sets the signal, then another signal, or instance and pin and `TargetFlag::Pin`.
bool ParseConnection(const StringArray& tokens, Arguments& arguments);
/// ASSIGN CONSTANT: sets a signal, or instance and pin and `TargetFlag::Pin`, then the value.
bool ParseConstant(const StringArray& tokens, Arguments& arguments);
/// The write commands: sets the file name and `WriteFlag`s. Options count in lines of four or five
/// words only; in others the word after the phrase is the file name.
bool ParseWrite(const StringArray& tokens, Arguments& arguments);
/// UPPERCASE: raises a `NameKind`.
bool ParseUppercase(const StringArray& tokens, Arguments& arguments);
/// LOWERCASE: raises a `NameKind`.
bool ParseLowercase(const StringArray& tokens, Arguments& arguments);
/// A comment on an object: sets its name and the joined text.
bool ParseOwnerComment(const StringArray& tokens, Arguments& arguments);
/// A comment on a pin: sets owner, pin and the joined text.
bool ParsePinComment(const StringArray& tokens, Arguments& arguments);

/// Raises `OptionFlag::On` unless the word at the position is "false".
bool ParseFlagAt(const StringArray& tokens, int position, Arguments& arguments);
/// ADD ... ATTRIBUTE: sets the names of the owner, then attribute, value and type.
bool ParseAddAttributeOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);
/// SET ... ATTRIBUTE VALUE and USERTYPE: sets the names of the owner, then attribute and text.
bool ParseAttributeTextOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);
/// SET ... ATTRIBUTE OPTION: sets the names of the owner, then attribute, generic value and
/// synthesis-attribute value, and raises an `AttributeOptionFlag` for each that was given.
bool ParseAttributeOptionsOf(const StringArray& tokens, AttributeOwner owner, Arguments& arguments);

/// Sets the text at one position, which must not be empty.
template <int Position> bool ParseText(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(Position)});
    return !tokens.GetView(Position).empty();
}

/// Sets the texts at some positions of a line that has at least `Least` words.
template <int Least, int... Positions>
bool ParseTexts(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.GetView(Positions)...});
    return tokens.GetSize() >= Least;
}

/// Sets one text: the words from a position on, joined by one blank, of a line that has at least
/// `Least` words.
template <int Least, int First> bool ParseJoined(const StringArray& tokens, Arguments& arguments) {
    arguments.Set({tokens.JoinFrom(First)});
    return tokens.GetSize() >= Least;
}

/// `ParseFlagAt` for a fixed position.
template <int Position> bool ParseFlag(const StringArray& tokens, Arguments& arguments) {
    return ParseFlagAt(tokens, Position, arguments);
}

/// `ParseAddAttributeOf` for one kind of owner.
template <AttributeOwner Owner>
bool ParseAddAttribute(const StringArray& tokens, Arguments& arguments) {
    return ParseAddAttributeOf(tokens, Owner, arguments);
}

/// `ParseAttributeTextOf` for one kind of owner.
template <AttributeOwner Owner>
bool ParseAttributeText(const StringArray& tokens, Arguments& arguments) {
    return ParseAttributeTextOf(tokens, Owner, arguments);
}

/// `ParseAttributeOptionsOf` for one kind of owner.
template <AttributeOwner Owner>
bool ParseAttributeOptions(const StringArray& tokens, Arguments& arguments) {
    return ParseAttributeOptionsOf(tokens, Owner, arguments);
}

} // namespace Orn_Hdl
