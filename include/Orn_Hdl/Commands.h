/// \file
/// The command language: commands, the factory that finds them by phrase, and the manager that runs
/// and keeps them.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Export.h"
#include "Port/Pooled.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <vector>

namespace Orn_Hdl {

class Model;
class PhraseTable;

/// One command on one model: it is created, parses the words of its line, and is executed. Programs
/// derive from it to add commands of their own, see `CommandFactory::AddCommandCreator`.
class ORN_HDL_API Command : public Port::Pooled<Port::Pool::Commands> {
public:
    /// Creates a command that has not been parsed.
    /// \param model the model to act on; not owned, may be null. It must outlive the command, or be
    ///        replaced by `SetModel`, where the command uses its model in its destructor.
    explicit Command(Model* model) noexcept { SetModel(model); }
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;
    virtual ~Command();
    /// Reads the arguments of the command.
    /// \param tokens the words of the whole line, those of the phrase included; not kept.
    /// \return false if arguments are missing or invalid.
    virtual bool Parse(const StringArray& tokens) = 0;
    /// Applies the parsed command to its model.
    /// \throws Exception "Missing Model.\n" if the model is null, and what the model's operation
    ///         throws.
    virtual void Execute() = 0;
    /// The phrase that selects the command, in its registered spelling; valid as long as the
    /// command.
    virtual const char* GetName() const = 0;

    /// The model to act on, null if there is none.
    Model* GetModel() const noexcept {
        return reinterpret_cast<Model*>(modelAndMark_ & ~OwnedMark);
    }
    /// Sets the model to act on; not owned, may be null.
    void SetModel(Model* model) noexcept {
        modelAndMark_ = reinterpret_cast<std::uintptr_t>(model) | (modelAndMark_ & OwnedMark);
    }

private:
    friend class CommandManager;

    static constexpr std::uintptr_t OwnedMark = 1;

    /// Whether a manager runs or keeps the command, and so owns it.
    bool IsOwned() const noexcept { return (modelAndMark_ & OwnedMark) != 0; }
    void MarkOwned() noexcept { modelAndMark_ |= OwnedMark; }

    /// The model's address, whose lowest bit is free for the mark: a program may keep commands by
    /// the million.
    std::uintptr_t modelAndMark_ = 0;
};

/// Creates a command for a model, which may be null. The words of its line are given for a creator
/// that chooses by them; parsing is a step of its own. The caller owns the command.
using CommandCreator = Command* (*)(Model* model, const StringArray& tokens);

/// What a user needs to know of one phrase of the command language.
struct CommandInfo {
    /// The words that select the command, with one blank between neighbours.
    const char* phrase;
    /// The arguments after the phrase: `<required>`, `[optional]`, "..." for several words.
    const char* arguments;
    /// What the command does, in one line.
    const char* help;
};

/// Finds commands by their phrase, in any letter case. An engine has one factory, in which a
/// program can register phrases of its own. Copies of a factory share one table of phrases.
class ORN_HDL_API CommandFactory {
public:
    /// Registers every phrase of the command language.
    CommandFactory();
    /// Shares the other factory's table: what is registered in either is found in both.
    CommandFactory(const CommandFactory& other);
    /// Gives up the own table and shares the other factory's.
    CommandFactory& operator=(const CommandFactory& other);
    ~CommandFactory();

    /// Registers a phrase, or gives a registered phrase another creator.
    /// \param phrase words separated by blanks; quotes are characters like others.
    /// \param creator makes the commands of the phrase.
    void AddCommandCreator(const char* phrase, CommandCreator creator);
    /// Registers the phrase that the words make when they are joined by one blank, or gives it
    /// another creator if it is registered.
    void AddCommandCreator(const StringArray& words, CommandCreator creator);
    /// Looks up the longest registered phrase that the words of a line begin with.
    /// \return its creator; null if there is none.
    CommandCreator GetCommandCreator(const StringArray& tokens) const;
    /// Splits a line and looks up the longest registered phrase that it begins with.
    /// \return its creator; null if there is none, or if the text is null.
    CommandCreator GetCommandCreator(const char* text) const;
    /// Creates the command of a line that has been split, without parsing it.
    /// \param model the command's model; may be null.
    /// \return the command, which the caller owns; null if no phrase matches.
    Command* CreateCommand(Model* model, const StringArray& tokens) const;
    /// Splits a line and creates its command, without parsing it.
    /// \param model the command's model; may be null.
    /// \return the command, which the caller owns; null if no phrase matches, or if the text is
    ///         null.
    Command* CreateCommand(Model* model, const char* text) const;
    /// Creates a model whose commands this factory makes; the factory must outlive it.
    /// \return the model, which the caller owns.
    Model* CreateModel();

    /// The phrases of the command language, in the order of registration; without those that
    /// programs register. Valid until the program ends.
    static const std::vector<CommandInfo>& GetCatalogue();

private:
    friend class CommandManager;

    std::shared_ptr<PhraseTable> phrases_;
};

/// Runs commands and keeps a journal of those that succeeded. Of a command of the language it keeps
/// the words, of a command that a program has registered the object too, which it owns. A command
/// may run further commands with its manager, and may destroy its manager or its model: the command
/// is then deleted when it has been executed, and what the manager kept before with the manager.
class ORN_HDL_API CommandManager {
public:
    CommandManager();
    CommandManager(const CommandManager&) = delete;
    CommandManager& operator=(const CommandManager&) = delete;
    /// Deletes every done command, the first one first. A command that runs others in its
    /// destructor may do so, but they are not kept.
    ~CommandManager();

    /// Creates, parses, executes and keeps the command of a line.
    /// \param tokens the words of the line.
    /// \param model the model to act on; not owned, may be null. A command that destroys it has a
    ///        null model afterwards.
    /// \param factory makes the command; not owned, may be null.
    /// \return true.
    /// \throws Exception "Command not find.\n" if no phrase matches or `factory` is null,
    ///         "PHRASE: Invalid Arguments.\n" if the arguments do not parse, or whatever the
    ///         command throws; the command is then deleted.
    bool CreateAndExecute(const StringArray& tokens, Model* model, CommandFactory* factory);
    /// Keeps a command and takes ownership of it, also if allocation fails. Null is ignored, and so
    /// is a command that this or another manager keeps, or is carrying out and will keep.
    void AddDoneCommand(Command* command);
    /// How many done commands are kept.
    int GetDoneCommandCount() const noexcept;
    /// Calls `use` with the words of each done line, the first one first. Phrases of the command
    /// language are spelled as registered. A command that was given to `AddDoneCommand` has the
    /// words of its name.
    /// \param use may do anything with the manager. What is done meanwhile is left out.
    void ForEachDoneLine(const std::function<void(const StringArray& words)>& use) const;
    /// Deletes every done command, the first one first.
    void Clear();

private:
    friend class Model;
    struct Implementation;

    /// Deletes every done command; what is done from now on is not kept.
    void End() noexcept;

    std::unique_ptr<Implementation> implementation_;
};

/// Reads the lines of a command file for a model, split into words. What has come in of the file is
/// split some lines ahead, so that in a large design the things that a line names are at hand when
/// it is executed. With `HdlOptions::threads`, a regular file of more than 256 kB is read and split
/// in a thread of the reader's own.
///
/// \code
/// CommandReader reader(model);
/// if (reader.Open("counter.cmd")) {
///     while (const StringArray* words = reader.Next()) {
///         model.Execute(*words);
///     }
/// }
/// \endcode
class ORN_HDL_API CommandReader {
public:
    /// \param model not owned, must outlive the reader.
    explicit CommandReader(Model& model);
    CommandReader(const CommandReader&) = delete;
    CommandReader& operator=(const CommandReader&) = delete;
    ~CommandReader();

    /// Opens a file. \return false when it cannot be opened; a directory never can.
    bool Open(const char* fileName);
    /// The words of the next line, none for an empty line; valid until the next call. Null at the
    /// end of the file or on a failure.
    /// \throws std::bad_alloc if a line ahead finds no memory; the reader then goes on behind it.
    const StringArray* Next();
    /// How many bytes the lines that `Next` has given take in the file.
    std::uint64_t GetPosition() const noexcept;
    /// The system's error number of the first failure; 0 when there was none.
    int GetError() const noexcept;

private:
    struct ORN_HDL_LOCAL Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
