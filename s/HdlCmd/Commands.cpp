#include "Orn_Hdl/Commands.h"

#include "Exception/Failure.h"
#include "HdlCmd/Arguments.h"
#include "HdlCmd/Catalogue.h"
#include "HdlCmd/Journal.h"
#include "HdlCmd/PhraseTable.h"
#include "HdlModel/ModelUse.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <memory>
#include <string>
#include <utility>

namespace Orn_Hdl {

static_assert(alignof(Model) > 1, "the lowest bit of its address is free");

Command::~Command() = default;

CommandFactory::CommandFactory() : phrases_(std::make_shared<PhraseTable>()) {
    for (const RegisteredCommand& command : GetRegisteredCommands()) {
        phrases_->Add(command.entry.info.phrase, command.create, &command);
    }
}

CommandFactory::CommandFactory(const CommandFactory& other) = default;
CommandFactory& CommandFactory::operator=(const CommandFactory& other) = default;
CommandFactory::~CommandFactory() = default;

void CommandFactory::AddCommandCreator(const char* phrase, CommandCreator creator) {
    AddCommandCreator(StringArray(phrase, " ", true, nullptr), creator);
}

void CommandFactory::AddCommandCreator(const StringArray& words, CommandCreator creator) {
    phrases_->Add(words.Concatenate(" ").GetView(), creator, nullptr);
}

CommandCreator CommandFactory::GetCommandCreator(const StringArray& tokens) const {
    return phrases_->Find(tokens).creator;
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
            entries.push_back(command.entry.info);
        }
        return entries;
    }();
    return catalogue;
}

namespace {

[[noreturn]] void FailNotFound() {
    Fail(CommandUnit, __LINE__, "Command not find.\n");
}

[[noreturn]] void FailInvalidArguments(const char* phrase) {
    Fail(CommandUnit, __LINE__, "%s: Invalid Arguments.\n", {Port::ViewOf(phrase)});
}

} // namespace

struct CommandManager::Implementation {
    struct Call;

    /// What carrying out a line of the language needs. Its memory is used for the next line.
    struct Scratch {
        Arguments arguments;
        std::string line;
    };

    /// Keeps a packed line, and the command that is an object; deletes the command if the manager
    /// is being destroyed.
    void Keep(std::string_view line, std::unique_ptr<Command> command = nullptr) {
        if (isEnding) {
            return;
        }
        if (journal == nullptr) {
            journal = std::make_shared<Journal>();
        }
        if (command == nullptr) {
            journal->Add(line);
            return;
        }
        if (done == nullptr) {
            done = std::make_unique<PtrArray<Command*>>();
        }
        done->Add(command.get());
        try {
            journal->Add(line);
        } catch (...) {
            done->RemoveAt(done->GetSize() - 1);
            throw;
        }
        command.release();
    }

    void ExecuteOwn(const PhraseTable::Match& match, const StringArray& words, Model* model);
    void ExecuteObject(const PhraseTable::Match& match, const StringArray& words, Model* model);

    /// The words of all done commands, which a walk over them shares; null while there are none.
    std::shared_ptr<Journal> journal;
    /// The done commands that are objects; null while there are none.
    std::unique_ptr<PtrArray<Command*>> done;
    /// Null while a line is carried out.
    std::unique_ptr<Scratch> scratch;
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
    const PhraseTable::Match match =
        factory == nullptr ? PhraseTable::Match() : factory->phrases_->Find(tokens);
    if (match.creator == nullptr) {
        FailNotFound();
    }
    if (match.own != nullptr) {
        implementation_->ExecuteOwn(match, tokens, model);
    } else {
        implementation_->ExecuteObject(match, tokens, model);
    }
    return true;
}

/// Carries out a command of the language, of which no object is made.
void CommandManager::Implementation::ExecuteOwn(const PhraseTable::Match& match,
                                                const StringArray& words, Model* model) {
    constexpr std::size_t MostKept = 4096;
    // The command may destroy this manager and its model, or remove the model from the engine.
    const Model::Use use(model);
    const Call call(*this);
    // The command may run another line, so the memory is taken out while it is in use.
    auto own = scratch == nullptr ? std::make_unique<Scratch>() : std::move(scratch);
    const CommandEntry& entry = match.own->entry;
    if (!entry.parse(words, own->arguments)) {
        FailInvalidArguments(entry.info.phrase);
    }
    const std::string_view line = Journal::Pack(words, match, own->line);
    entry.execute(RequireModel(model), own->arguments);
    if (call.manager != nullptr) {
        call.manager->Keep(line);
        if (own->line.size() <= MostKept) {
            call.manager->scratch = std::move(own);
        }
    }
}

void CommandManager::Implementation::ExecuteObject(const PhraseTable::Match& match,
                                                   const StringArray& words, Model* model) {
    const Model::Use use(model);
    const Call call(*this);
    std::unique_ptr<Command> command(match.creator(model, words));
    if (command == nullptr) {
        FailNotFound();
    }
    command->MarkOwned();
    std::string room;
    const std::string_view line = Journal::Pack(words, match, room);
    if (!command->Parse(words)) {
        FailInvalidArguments(command->GetName());
    }
    command->Execute();
    if (!use.HasModel() && command->GetModel() == model) {
        command->SetModel(nullptr);
    }
    if (call.manager != nullptr) {
        call.manager->Keep(line, std::move(command));
    }
}

void CommandManager::AddDoneCommand(Command* command) {
    if (command == nullptr || command->IsOwned()) {
        return;
    }
    command->MarkOwned();
    std::unique_ptr<Command> kept(command);
    std::string room;
    const std::string_view line =
        Journal::Pack(StringArray(kept->GetName(), " ", true, nullptr), PhraseTable::Match(), room);
    implementation_->Keep(line, std::move(kept));
}

int CommandManager::GetDoneCommandCount() const noexcept {
    return implementation_->journal == nullptr ? 0 : implementation_->journal->GetSize();
}

void CommandManager::ForEachDoneLine(
    const std::function<void(const StringArray& words)>& use) const {
    const std::shared_ptr<const Journal> journal = implementation_->journal;
    if (journal == nullptr) {
        return;
    }
    StringArray words;
    Journal::Place place;
    for (int i = journal->GetSize(); i > 0 && journal->Next(place, words); --i) {
        use(words);
    }
}

void CommandManager::Clear() {
    implementation_->journal.reset();
    // Taken out first: a command that is destroyed may look at the manager.
    const std::unique_ptr<PtrArray<Command*>> done = std::move(implementation_->done);
    for (Command* command : Iterator<Command*>(done.get())) {
        delete command;
    }
}

} // namespace Orn_Hdl
