/// \file
/// The command language: commands, the factory that finds them by phrase, and the manager that runs
/// and keeps them.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Export.h"
#include "Port/Pooled.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace Orn_Hdl {

class Model;
class PhraseTable;

/// One command on one model: parsed from the words of a line, then executed.
class ORN_HDL_API Command : public Port::Pooled<Port::Pool::Commands> {
public:
    /// \param model the model to act on; not owned, may be null.
    explicit Command(Model* model) noexcept { SetModel(model); }
    Command(const Command&) = delete;
    Command& operator=(const Command&) = delete;
    virtual ~Command();
    /// Reads the arguments from the words of the whole line, phrase included, by position.
    /// \return false when they are missing or invalid.
    virtual bool Parse(const StringArray& tokens) = 0;
    /// Applies the command to its model; throws `Exception` "Missing Model.\n" without one.
    virtual void Execute() = 0;
    /// The phrase that selects the command, in its registered spelling.
    virtual const char* GetName() const = 0;

    /// The model to act on.
    Model* GetModel() const noexcept {
        return reinterpret_cast<Model*>(modelAndMark_ & ~OwnedMark);
    }
    /// Sets the model to act on; not owned.
    void SetModel(Model* model) noexcept {
        modelAndMark_ = reinterpret_cast<std::uintptr_t>(model) | (modelAndMark_ & OwnedMark);
    }

private:
    friend class CommandManager;

    static constexpr std::uintptr_t OwnedMark = 1;

    /// Whether a manager runs or keeps the command, and so owns it.
    bool IsOwned() const noexcept { return (modelAndMark_ & OwnedMark) != 0; }
    void MarkOwned() noexcept { modelAndMark_ |= OwnedMark; }

    /// The model's address, whose lowest bit is free for the mark: a command is kept by the million
    /// and has no byte to spare.
    std::uintptr_t modelAndMark_ = 0;
};

/// Makes an unparsed command bound to a model; the caller owns it.
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

/// Finds commands by their phrase. An engine has one factory; a program can register phrases of its
/// own in it. Copies share one table.
class ORN_HDL_API CommandFactory {
public:
    /// Registers every phrase of the command language.
    CommandFactory();
    CommandFactory(const CommandFactory& other);
    CommandFactory& operator=(const CommandFactory& other);
    ~CommandFactory();

    /// Registers a phrase; its words are separated by blanks. A phrase that is present gets the new
    /// creator.
    void AddCommandCreator(const char* phrase, CommandCreator creator);
    void AddCommandCreator(const StringArray& words, CommandCreator creator);
    /// The creator of the longest registered phrase that the line begins with, letter case ignored;
    /// null when there is none.
    CommandCreator GetCommandCreator(const StringArray& tokens) const;
    CommandCreator GetCommandCreator(const char* text) const;
    /// A new command of that phrase, not parsed yet; the caller owns it. Null when there is none.
    Command* CreateCommand(Model* model, const StringArray& tokens) const;
    Command* CreateCommand(Model* model, const char* text) const;
    /// A new model bound to this factory, which must outlive it; the caller owns it.
    Model* CreateModel();

    /// The command language, in the order of registration.
    static const std::vector<CommandInfo>& GetCatalogue();

private:
    std::shared_ptr<PhraseTable> phrases_;
};

/// Runs commands and keeps the done ones, which it owns.
class ORN_HDL_API CommandManager {
public:
    CommandManager();
    CommandManager(const CommandManager&) = delete;
    CommandManager& operator=(const CommandManager&) = delete;
    ~CommandManager();

    /// Creates, parses, executes and keeps the command of a line.
    /// \return true.
    /// \throws Exception "Command not find.\n" when no phrase matches or `factory` is null,
    ///         "PHRASE: Invalid Arguments.\n" when the arguments do not parse, or whatever the
    ///         command throws; the command is then deleted.
    bool CreateAndExecute(const StringArray& tokens, Model* model, CommandFactory* factory);
    /// Keeps a command and takes ownership of it, also if allocation fails. Null is ignored, and so
    /// is a command that this or another manager keeps, or is carrying out and will keep.
    void AddDoneCommand(Command* command);
    /// How many done commands are kept.
    int GetDoneCommandCount() const noexcept;
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
/// it is executed.
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
    const StringArray* Next();
    /// How many bytes the lines that `Next` has given take in the file.
    std::uint64_t GetPosition() const noexcept;
    /// The system's error number of the first failure; 0 when there was none.
    int GetError() const noexcept;

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
