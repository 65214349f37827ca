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

static_assert(alignof(Model) > 1, "the lowest bit of its address is free");

Command::~Command() = default;

CommandFactory::CommandFactory() : phrases_(std::make_shared<PhraseTable>()) {
    for (const RegisteredCommand& command : GetRegisteredCommands()) {
        AddCommandCreator(command.info.phrase, command.create);
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
            entries.push_back(command.info);
        }
        return entries;
    }();
    return catalogue;
}

struct CommandManager::Implementation {
    struct Call;

    /// Takes a command into the done ones, or deletes it if the manager is being destroyed.
    void Keep(std::unique_ptr<Command> command) {
        if (isEnding) {
            return;
        }
        if (done == nullptr) {
            done = std::make_unique<PtrArray<Command*>>();
        }
        done->Add(command.get());
        command.release();
    }

    /// Null while there are none.
    std::unique_ptr<PtrArray<Command*>> done;
    /// The innermost of the calls that carry out a command, since a command may run another.
    Call* innermost = nullptr;
    bool isEnding = false;
};

/// A call of `CreateAndExecute` that is under way. Its command may destroy the manager.
struct CommandManager::Implementation::Call {
    explicit Call(Implementation& own) noexcept : manager(&own), outer(own.innermost) {
        own.innermost = this;
    }
    Call(const Call&) = delete;
    Call& operator=(const Call&) = delete;
    ~Call() {
        if (manager != nullptr) {
            manager->innermost = outer;
        }
    }

    /// Null when the manager has been destroyed.
    Implementation* manager;
    Call* outer;
};

CommandManager::CommandManager() : implementation_(std::make_unique<Implementation>()) {}

CommandManager::~CommandManager() {
    End();
    for (auto* call = implementation_->innermost; call != nullptr; call = call->outer) {
        call->manager = nullptr;
    }
}

void CommandManager::End() noexcept {
    implementation_->isEnding = true;
    Clear();
}

bool CommandManager::CreateAndExecute(const StringArray& tokens, Model* model,
                                      CommandFactory* factory) {
    // The command may destroy this manager and its model, or remove the model from the engine.
    const Model::Use use(model);
    const Implementation::Call call(*implementation_);
    std::unique_ptr<Command> command(factory == nullptr ? nullptr
                                                        : factory->CreateCommand(model, tokens));
    if (command == nullptr) {
        Fail(CommandUnit, __LINE__, "Command not find.\n");
    }
    command->MarkOwned();
    if (!command->Parse(tokens)) {
        Fail(CommandUnit, __LINE__, "%s: Invalid Arguments.\n", {Port::ViewOf(command->GetName())});
    }
    command->Execute();
    if (!use.HasModel() && command->GetModel() == model) {
        command->SetModel(nullptr);
    }
    if (call.manager != nullptr) {
        call.manager->Keep(std::move(command));
    }
    return true;
}

void CommandManager::AddDoneCommand(Command* command) {
    if (command == nullptr || command->IsOwned()) {
        return;
    }
    command->MarkOwned();
    implementation_->Keep(std::unique_ptr<Command>(command));
}

int CommandManager::GetDoneCommandCount() const noexcept {
    return implementation_->done == nullptr ? 0 : implementation_->done->GetSize();
}

void CommandManager::Clear() {
    // Taken out first: a command that is destroyed may look at the manager.
    const std::unique_ptr<PtrArray<Command*>> done = std::move(implementation_->done);
    for (Command* command : Iterator<Command*>(done.get())) {
        delete command;
    }
}

} // namespace Orn_Hdl
