#include "Orn_Hdl/Commands.h"

#include "Containers/Hash.h"
#include "HdlCmd/Catalogue.h"
#include "HdlModel/Failure.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Design.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"

#include <memory>
#include <string>
#include <utility>

namespace Orn_Hdl {

namespace {

/// The leading words of a line, with their hash. The phrases of the language fit into the object.
class PhraseKey {
public:
    void Append(std::string_view text) {
        for (const char c : text) {
            hash_.AddUpper(c);
        }
        if (long_.empty() && size_ + text.size() <= sizeof short_) {
            size_ += text.copy(short_ + size_, text.size());
            return;
        }
        if (long_.empty()) {
            long_.assign(short_, size_);
        }
        long_.append(text);
    }
    std::string_view GetView() const noexcept {
        return long_.empty() ? std::string_view(short_, size_) : std::string_view(long_);
    }
    std::uint32_t GetHash() const noexcept { return hash_.GetValue(); }

private:
    char short_[64];
    std::size_t size_ = 0;
    std::string long_;
    NameHash hash_;
};

} // namespace

Command::~Command() = default;

void* Command::operator new(std::size_t size) {
    return Port::Pool::Allocate(size, Port::Pool::Commands);
}

void Command::operator delete(void* memory) noexcept {
    Port::Pool::Free(memory);
}

CommandFactory::CommandFactory() : creators_(std::make_shared<IStringPtrMap<CommandCreator>>()) {
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
    creators_->Add(words.Concatenate(" ").GetView(), creator);
}

CommandCreator CommandFactory::GetCommandCreator(const StringArray& tokens) const {
    // The key grows word by word and its hash with it; beyond the longest phrase nothing can match.
    const std::size_t longest = creators_->GetLongestName();
    CommandCreator found = nullptr;
    PhraseKey key;
    for (int i = 0; i < tokens.GetSize(); ++i) {
        const std::string_view token = tokens.GetView(i);
        if (key.GetView().size() + token.size() + (i > 0 ? 1 : 0) > longest) {
            break;
        }
        if (i > 0) {
            key.Append(" ");
        }
        key.Append(token);
        if (const CommandCreator creator = creators_->GetHashed(key.GetHash(), key.GetView())) {
            found = creator;
        }
    }
    return found;
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
    PtrArray<Command*> done;
};

CommandManager::CommandManager() : implementation_(std::make_unique<Implementation>()) {}

CommandManager::~CommandManager() {
    Clear();
}

bool CommandManager::CreateAndExecute(const StringArray& tokens, Model* model,
                                      CommandFactory* factory) {
    std::unique_ptr<Command> command(factory == nullptr ? nullptr
                                                        : factory->CreateCommand(model, tokens));
    if (command == nullptr) {
        Fail(CommandUnit, __LINE__, "Command not find.\n");
    }
    if (!command->Parse(tokens)) {
        Fail(CommandUnit, __LINE__, "%s: Invalid Arguments.\n", {Port::ViewOf(command->GetName())});
    }
    command->Execute();
    implementation_->done.Add(command.get());
    command.release();
    return true;
}

void CommandManager::AddDoneCommand(Command* command) {
    if (command != nullptr && !implementation_->done.Contains(command)) {
        implementation_->done.Add(command);
    }
}

int CommandManager::GetDoneCommandCount() const noexcept {
    return implementation_->done.GetSize();
}

void CommandManager::Clear() {
    // Taken out first: a command that ends may look at the manager.
    PtrArray<Command*> done;
    std::swap(done, implementation_->done);
    for (Command* command : Iterator<Command*>(&done)) {
        delete command;
    }
}

} // namespace Orn_Hdl
