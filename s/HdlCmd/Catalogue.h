// The command language as data: one table, from which the factory registers the commands and the
// documentation is made.
#pragma once

#include "HdlCmd/Arguments.h"
#include "Orn_Hdl/Commands.h"

#include <span>
#include <string_view>

namespace Orn_Hdl {

/// Does a command's work on a model.
using CommandExecution = void (*)(Model& model, const Arguments& arguments);

/// One phrase: what a user sees of it, how its line is read, and what it does.
struct CommandEntry {
    CommandInfo info;
    /// Reads the arguments of a line. \return false if they are missing or invalid.
    bool (*parse)(const StringArray& tokens, Arguments& arguments);
    CommandExecution execute;
};

/// An entry and the function that makes its commands.
struct RegisteredCommand {
    const CommandEntry& entry;
    CommandCreator create;
    /// How many words the phrase has.
    int words;
};

/// Every phrase of the language, in the order of registration.
std::span<const RegisteredCommand> GetRegisteredCommands() noexcept;

/// The phrase of the first command that does its work by a function; empty if there is none.
std::string_view GetPhrase(CommandExecution execute) noexcept;

/// The model itself; throws "Missing Model.\n" if there is none.
Model& RequireModel(Model* model);

} // namespace Orn_Hdl
