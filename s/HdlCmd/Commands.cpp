#include "Orn_Hdl/Commands.h"

#include "Exception/Failure.h"
#include "HdlCmd/Catalogue.h"
#include "HdlCmd/PhraseTable.h"
#include "HdlModel/ModelUse.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <memory>
#include <utility>

namespace Orn_Hdl {

Command::~Command() = default;

CommandFactory::CommandFactory() : phrases_(std::make_shared<PhraseTable>()) {
    for (const RegisteredCommand& command : GetRegisteredCommands()) {
        AddCommandCreator(command.entry->info.phrase, command.create);
    }
}

CommandFactory::CommandFactory(const CommandFactory& other) = default;
CommandFactory& CommandFactory::operator=(const CommandFactory& other) = default;
CommandFactory::~CommandFactory() = default;

void CommandFactory::AddCommandCreator(const char* phrase, CommandCreator creator) {
    AddCommandCreator(StringArray(phrase, " ", true, nullptr), creator);
}

void CommandFactory::AddCommandCreator(const StringArray& words, CommandCreator creator) {
    phrases_->Add(words.Concatenate(" ").GetView(), creator);
}

CommandCreator CommandFactory::GetCommandCreator(const StringArray& tokens) const {
    return phrases_->Find(tokens);
}

CommandCreator CommandFactory::GetCommandCreator(const char* text) const {
    StringArray tokens;
    tokens.ParseCommandLine(Port::ViewOf(text));
    return GetCommandCreator(tokens);
}

Command* CommandFactory::CreateCommand(Model* model, const StringArray& tokens) const {
    const CommandCreator creator = GetCommandCreator(tokens);
    return creator == nullptr ? nullptr : creator(model, tokens);
}

Command* CommandFactory::CreateCommand(Model* model, const char* text) const {
    StringArray tokens;
    tokens.ParseCommandLine(Port::ViewOf(text));
    return CreateCommand(model, tokens);
}

Model* CommandFactory::CreateModel() {
    return new Model(this);
}

const std::vector<CommandInfo>& CommandFactory::GetCatalogue() {
    static const std::vector<CommandInfo> catalogue = [] {
        std::vector<CommandInfo> entries;
        for (const RegisteredCommand& command : GetRegisteredCommands()) {
            entries.push_back(command.entry->info);
        }
        return entries;
    }();
    return catalogue;
}

struct CommandManager::Implementation {
    struct Running;

    /// Null while there are none.
    std::unique_ptr<PtrArray<Command*>> done;
    /// The innermost of the commands that are being carried out, since one may run another.
    const Running* innermost = nullptr;

    PtrArray<Command*>& GetDone() {
        if (done == nullptr) {
            done = std::make_unique<PtrArray<Command*>>();
        }
        return *done;
    }
};

/// A command from before it is parsed until it is kept or deleted.
struct CommandManager::Implementation::Running {
    explicit Running(Implementation& manager) noexcept : own(manager), outer(manager.innermost) {
        own.innermost = this;
    }
    Running(const Running&) = delete;
    Running& operator=(const Running&) = delete;
    ~Running() { own.innermost = outer; }

    Implementation& own;
    const Running* outer;
    const Command* command = nullptr;
};

CommandManager::CommandManager() : implementation_(std::make_unique<Implementation>()) {}

CommandManager::~CommandManager() {
    Clear();
}

bool CommandManager::CreateAndExecute(const StringArray& tokens, Model* model,
                                      CommandFactory* factory) {
    // The command may remove its model from the engine, and this manager is the model's.
    const Model::Use use(model);
    Implementation::Running running(*implementation_);
    std::unique_ptr<Command> command(factory == nullptr ? nullptr
                                                        : factory->CreateCommand(model, tokens));
    if (command == nullptr) {
        Fail(CommandUnit, __LINE__, "Command not find.\n");
    }
    running.command = command.get();
    if (!command->Parse(tokens)) {
        Fail(CommandUnit, __LINE__, "%s: Invalid Arguments.\n", {Port::ViewOf(command->GetName())});
    }
    command->Execute();
    implementation_->GetDone().Add(command.get());
    command.release();
    return true;
}

void CommandManager::AddDoneCommand(Command* command) {
    if (command == nullptr ||
        (implementation_->done != nullptr && implementation_->done->Contains(command))) {
        return;
    }
    for (const auto* running = implementation_->innermost; running != nullptr;
         running = running->outer) {
        if (running->command == command) {
            return;
        }
    }
    std::unique_ptr<Command> taken(command);
    implementation_->GetDone().Add(command);
    taken.release();
}

int CommandManager::GetDoneCommandCount() const noexcept {
    return implementation_->done == nullptr ? 0 : implementation_->done->GetSize();
}

void CommandManager::Clear() {
    // Taken out first: a command that ends may look at the manager.
    const std::unique_ptr<PtrArray<Command*>> done = std::move(implementation_->done);
    for (Command* command : Iterator<Command*>(done.get())) {
        delete command;
    }
}

} // namespace Orn_Hdl
