// The command language as data: an entry a phrase, from which the factory registers the commands
// and the documentation is made.
#pragma once

#include "HdlCmd/Arguments.h"
#include "Orn_Hdl/Commands.h"
#include "Port/Pool.h"

#include <new>
#include <string>
#include <vector>

namespace Orn_Hdl {

/// One phrase: what a user sees of it, how its line is read, and what it does.
struct CommandEntry {
    CommandInfo info;
    /// Reads the arguments of a line. \return false when they are missing or invalid.
    bool (*parse)(const StringArray& tokens, Arguments& arguments);
    /// Does the command's work on a model.
    void (*execute)(Model& model, const Arguments& arguments);
};

struct RegisteredCommand {
    const CommandEntry* entry;
    CommandCreator create;
};

/// Every phrase, in the order of registration.
const std::vector<RegisteredCommand>& GetRegisteredCommands();

/// The model itself; throws "Missing Model.\n" when there is none.
Model& RequireModel(Model* model);

/// A command of the language: all that makes it special stands in its entry.
template <const CommandEntry& Entry> class CatalogueCommand final : public Command {
public:
    static Command* Create(Model* model, const StringArray& tokens) {
        const std::size_t room =
            Arguments::RoomFor(tokens, std::char_traits<char>::length(Entry.info.phrase));
        // The arguments are the last member, with nothing between them and the base.
        void* const memory = Port::Pool::AllocatePacked(sizeof(Command) + sizeof(Arguments) + room,
                                                        Port::Pool::Commands);
        return ::new (memory) CatalogueCommand(model, room);
    }

    bool Parse(const StringArray& tokens) override { return Entry.parse(tokens, arguments_); }
    void Execute() override { Entry.execute(RequireModel(GetModel()), arguments_); }
    const char* GetName() const override { return Entry.info.phrase; }

private:
    CatalogueCommand(Model* model, std::size_t room) noexcept : Command(model), arguments_(room) {}

    Arguments arguments_;
};

} // namespace Orn_Hdl
