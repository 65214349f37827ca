// From a line of text to a done command: splitting, phrase look-up, parsing, execution, keeping.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>
#include <new>
#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::FailureOf;

namespace {

/// What the commands of these tests did and saw; each test begins with an empty log.
std::vector<std::string> log;
int aliveCommands = 0;
/// What a command with the argument "act" does.
std::function<void(Command&)> action;

std::string Join(const StringArray& tokens) {
    return std::string(tokens.Concatenate("|").GetView());
}

/// Notes its life in the log and fails where its first argument says so.
class LoggedCommand : public Command {
public:
    LoggedCommand(Model* model, const char* name) : Command(model), name_(name) { ++aliveCommands; }
    ~LoggedCommand() override {
        --aliveCommands;
        log.push_back(std::string("delete ") + argument_);
    }
    bool Parse(const StringArray& tokens) override {
        log.push_back("parse " + Join(tokens));
        argument_ = std::string(tokens.GetAt(1).GetView());
        if (argument_ == "throw-in-parse") {
            ThrowException();
        }
        return argument_ != "refuse";
    }
    void Execute() override {
        log.push_back("execute " + argument_);
        if (argument_ == "act") {
            action(*this);
        }
        if (argument_ == "throw-in-execute") {
            ThrowException();
        }
        if (argument_ == "run-out-of-memory") {
            throw std::bad_alloc();
        }
    }
    const char* GetName() const override { return name_; }

    static Command* Create(Model* model, const StringArray&) {
        return new LoggedCommand(model, "Logged Phrase");
    }

private:
    static void ThrowException() {
        Exception exception("Module", "unit", "revision", 7);
        exception.setDescription("as described\n");
        throw exception;
    }

    const char* name_;
    std::string argument_;
};

StringArray Words(const char* text) {
    return StringArray(text, " ", true, "\"\"''");
}

class CommandLine : public testing::Test {
protected:
    CommandLine() {
        log.clear();
        aliveCommands = 0;
        action = nullptr;
        factory_.AddCommandCreator("LOGGED", &LoggedCommand::Create);
    }

    std::string GetFailure(const char* line) {
        return FailureOf([&] { model_.Execute(line); });
    }
    int GetDoneCount() { return model_.GetCommandManager()->GetDoneCommandCount(); }

    CommandFactory factory_;
    Model model_{&factory_};
};

} // namespace

// Splitting

TEST_F(CommandLine, TokensReachTheCommandAsTheQuotesSay) {
    const struct {
        const char* line;
        const char* tokens;
    } cases[] = {
        {"LOGGED a b", "LOGGED|a|b"},
        {"   LOGGED   a    b   ", "LOGGED|a|b"},
        {"LOGGED \"a  b\" c", "LOGGED|a  b|c"},
        {"LOGGED 'a  b' c", "LOGGED|a  b|c"},
        {"LOGGED \"\" c", "LOGGED||c"},
        {"LOGGED '' c", "LOGGED||c"},
        {"LOGGED a \"\"", "LOGGED|a"},
        {"LOGGED a \"\" ", "LOGGED|a|"},
        {"LOGGED it's", "LOGGED|it's"},
        {"LOGGED a\"b c\"", "LOGGED|a\"b|c\""},
        {"LOGGED \"ab\"cd ef\"", "LOGGED|abcd ef"},
        {"LOGGED \"a\\\"b\"", "LOGGED|a\"b"},
        {"LOGGED \"a\\nb\"", "LOGGED|a\\nb"},
        {"LOGGED \"a\\\\\" b", "LOGGED|a\\\" b"},
        {"LOGGED \"a'b\" 'c\"d'", "LOGGED|a'b|c\"d"},
        {"LOGGED \"never closed  x", "LOGGED|never closed  x"},
        {"LOGGED a\tb", "LOGGED|a\tb"},
        {"\"LOGGED\" a", "LOGGED|a"},
        {"LOGGED # no comment", "LOGGED|#|no|comment"},
        {"LOGGED a\\", "LOGGED|a\\"},
    };
    for (const auto& c : cases) {
        log.clear();
        EXPECT_EQ(GetFailure(c.line), "") << c.line;
        ASSERT_FALSE(log.empty()) << c.line;
        EXPECT_EQ(log[0], std::string("parse ") + c.tokens) << c.line;
    }
}

TEST_F(CommandLine, BlankLinesDoNothing) {
    EXPECT_TRUE(model_.Execute(static_cast<const char*>(nullptr)));
    EXPECT_TRUE(model_.Execute(""));
    EXPECT_TRUE(model_.Execute("      "));
    EXPECT_TRUE(model_.Execute("\"\""));
    EXPECT_TRUE(model_.Execute(StringArray()));
    EXPECT_EQ(GetDoneCount(), 0);
}

TEST_F(CommandLine, TabsAreNoSeparators) {
    EXPECT_EQ(GetFailure("add\tcomponent X"), "Command not find.\n");
    EXPECT_EQ(GetFailure("ADD COMPONENT\tX"), "Command not find.\n");
    EXPECT_EQ(GetFailure("ADD COMPONENT X\tY"), "");
    EXPECT_NE(model_.GetComponent("X\tY"), nullptr);
}

TEST_F(CommandLine, EndsAtItsFirstNul) {
    EXPECT_TRUE(model_.ExecuteLine(std::string_view("ADD SIGNAL N\0M", 14)));
    EXPECT_NE(model_.GetSignal("N"), nullptr);
    EXPECT_TRUE(model_.ExecuteLine(std::string_view("\0MAKE COFFEE", 12)));
}

TEST_F(CommandLine, AnArgumentEndsAtItsFirstNul) {
    StringArray words = Words("CONNECT SIGNAL");
    for (const std::string_view name : {std::string_view("N\0x", 3), std::string_view("M\0", 2)}) {
        words.Add(Port::String(name));
    }
    EXPECT_TRUE(model_.Execute(words));
    const Signal* const n = model_.GetSignal("N");
    const Signal* const m = model_.GetSignal("M");
    ASSERT_NE(n, nullptr);
    ASSERT_NE(m, nullptr);
    EXPECT_EQ(n->GetName(), "N");
    EXPECT_EQ(m->GetName(), "M");
    EXPECT_EQ(model_.GetSignal("x"), nullptr);

    words = Words("ADD SIGNAL COMMENT N");
    words.Add(Port::String(std::string_view("te\0xt", 5)));
    words.Add("more");
    EXPECT_TRUE(model_.Execute(words));
    EXPECT_EQ(n->GetComment(), "te\n");

    for (std::size_t size = 1; size <= 40; ++size) {
        for (std::size_t end = 0; end <= size; ++end) {
            std::string text = std::string(size, '\xff').append("x");
            text[end] = '\0';
            text.resize(size);
            words = Words("Set Purpose");
            words.Add(Port::String(text));
            EXPECT_TRUE(model_.Execute(words));
            ASSERT_EQ(model_.GetOptions()->purpose, std::string(end, '\xff')) << size;
        }
    }
}

TEST_F(CommandLine, WordsCanBeGivenReady) {
    StringArray words;
    words.Add("add");
    words.Add("SIGNAL");
    words.Add("two words");
    EXPECT_TRUE(model_.Execute(words));
    EXPECT_NE(model_.GetSignal("two words"), nullptr);
    EXPECT_EQ(GetDoneCount(), 1);
}

// Phrase look-up

TEST_F(CommandLine, PhrasesIgnoreCase) {
    for (const char* line : {"add component a", "ADD COMPONENT b", "Add Component c"}) {
        EXPECT_EQ(GetFailure(line), "") << line;
    }
    EXPECT_EQ(GetFailure("set application tool"), "");
    EXPECT_EQ(model_.GetOptions()->application, "tool");
}

TEST_F(CommandLine, TheLongestPhraseWins) {
    EXPECT_EQ(GetFailure("ADD COMPONENT AND2"), "");
    EXPECT_EQ(GetFailure("ADD COMPONENT COMMENT AND2 text"), "");
    EXPECT_EQ(model_.GetComponent("AND2")->GetComment(), "text\n");
    // "COMMENT" extends the phrase, so a component of that name cannot be made this way.
    EXPECT_EQ(GetFailure("ADD COMPONENT COMMENT"), "ADD COMPONENT COMMENT: Invalid Arguments.\n");
    EXPECT_EQ(GetFailure("ADD COMPONENT PIN COMMENT"),
              "ADD COMPONENT PIN COMMENT: Invalid Arguments.\n");
    EXPECT_EQ(model_.GetComponent("COMMENT"), nullptr);
    EXPECT_EQ(GetFailure("ADD COMPONENT PIN"), "");
    EXPECT_NE(model_.GetComponent("PIN"), nullptr);
}

TEST_F(CommandLine, ALongPhraseIsFoundPastUnknownPrefixes) {
    EXPECT_EQ(GetFailure("SET COMPONENT PIN ATTRIBUTE VALUE"),
              "SET COMPONENT PIN ATTRIBUTE VALUE: Invalid Arguments.\n");
    EXPECT_EQ(GetFailure("SET COMPONENT PIN ATTRIBUTE"), "Command not find.\n");
}

TEST_F(CommandLine, ArgumentsOfAnyNumberArePartOfTheLookUp) {
    factory_.AddCommandCreator("LOGGED a b c d e f g h", [](Model* model, const StringArray&) {
        return static_cast<Command*>(new LoggedCommand(model, "Long Phrase"));
    });
    std::unique_ptr<Command> longest(factory_.CreateCommand(&model_, "logged A b C d E f G h x"));
    std::unique_ptr<Command> shorter(factory_.CreateCommand(&model_, "LOGGED a b c d e f g x h"));
    ASSERT_NE(longest, nullptr);
    ASSERT_NE(shorter, nullptr);
    EXPECT_STREQ(longest->GetName(), "Long Phrase");
    EXPECT_STREQ(shorter->GetName(), "Logged Phrase");
}

TEST_F(CommandLine, AQuotedPhraseIsThePhrase) {
    // The key is the words joined by one blank, and here one word holds that blank already.
    EXPECT_NE(factory_.GetCommandCreator("\"ADD COMPONENT\" X"), nullptr);
    EXPECT_EQ(GetFailure("\"ADD COMPONENT\" X"), "ADD COMPONENT: Invalid Arguments.\n");
    EXPECT_EQ(GetFailure("\"ADD COMPONENT\" X Y"), "");
    EXPECT_NE(model_.GetComponent("Y"), nullptr);
    EXPECT_EQ(factory_.GetCommandCreator("\"ADD  COMPONENT\" X"), nullptr);
}

TEST_F(CommandLine, UnknownPhrasesHaveNoCreator) {
    for (const char* line : {"", "ADD", "COMPONENT ADD", "ADDCOMPONENT", "X NOOP"}) {
        EXPECT_EQ(factory_.GetCommandCreator(line), nullptr) << line;
        EXPECT_EQ(factory_.CreateCommand(&model_, line), nullptr) << line;
    }
    EXPECT_EQ(factory_.GetCommandCreator(static_cast<const char*>(nullptr)), nullptr);
    EXPECT_EQ(factory_.GetCommandCreator(StringArray()), nullptr);
    EXPECT_EQ(factory_.CreateCommand(&model_, StringArray()), nullptr);
}

// The factory

TEST_F(CommandLine, RegisteredWordsAreJoinedByOneBlank) {
    factory_.AddCommandCreator("  MAKE    TEA ", &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator("make tea now"), &LoggedCommand::Create);
    factory_.AddCommandCreator("'QUOTED WORDS'", &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator("QUOTED WORDS"), nullptr);
    EXPECT_EQ(factory_.GetCommandCreator("x'QUOTED WORDS'"), nullptr);

    StringArray words;
    words.Add("BREW");
    words.Add("GREEN TEA");
    factory_.AddCommandCreator(words, &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator(words), &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator("brew green tea"), &LoggedCommand::Create);
}

TEST_F(CommandLine, APhraseThatIsPresentGetsTheNewCreator) {
    factory_.AddCommandCreator("noop", &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator("NOOP"), &LoggedCommand::Create);
}

TEST_F(CommandLine, PhrasesThatBeginAlikeAreToldApart) {
    factory_.AddCommandCreator("ABCD LONGWORDS1", &LoggedCommand::Create);
    for (const char* line : {"abcd longwords1", "ABCD LONGWORDS1 x"}) {
        EXPECT_NE(factory_.GetCommandCreator(line), nullptr) << line;
    }
    for (const char* line : {"ABCDABCD LONGWORDS1", "ABCD LONGWORDS2", "ABCD LONGWORD",
                             "ABCD LONGWORDS", "ABCD LONGWORDS12", "ABC LONGWORDS1", "A LONGWORDS1",
                             "BCDA LONGWORDS1", "'' LONGWORDS1"}) {
        EXPECT_EQ(factory_.GetCommandCreator(line), nullptr) << line;
    }
}

TEST_F(CommandLine, CopiesOfAFactoryShareItsPhrases) {
    CommandFactory assigned;
    assigned = factory_;
    CommandFactory copied(factory_);
    EXPECT_EQ(assigned.GetCommandCreator("LOGGED"), &LoggedCommand::Create);
    assigned.AddCommandCreator("SHARED", &LoggedCommand::Create);
    EXPECT_EQ(factory_.GetCommandCreator("SHARED"), &LoggedCommand::Create);
    EXPECT_EQ(copied.GetCommandCreator("SHARED"), &LoggedCommand::Create);
    EXPECT_EQ(CommandFactory().GetCommandCreator("LOGGED"), nullptr);
}

TEST_F(CommandLine, TheFactoryMakesModelsBoundToIt) {
    const std::unique_ptr<Model> model(factory_.CreateModel());
    ASSERT_NE(model, nullptr);
    EXPECT_EQ(model->GetCommandFactory(), &factory_);
    EXPECT_EQ(model->GetName(), "hdlNetlist");
    EXPECT_FALSE(model->IsModified());
    EXPECT_TRUE(model->Execute("LOGGED a"));
}

TEST_F(CommandLine, ACreatedCommandIsNotParsed) {
    const std::unique_ptr<Command> command(factory_.CreateCommand(&model_, Words("LOGGED a")));
    ASSERT_NE(command, nullptr);
    EXPECT_EQ(command->GetModel(), &model_);
    EXPECT_TRUE(log.empty());
    command->SetModel(nullptr);
    EXPECT_EQ(command->GetModel(), nullptr);
}

TEST_F(CommandLine, WithoutAFactoryNoCommandIsFound) {
    Model model(nullptr);
    EXPECT_EQ(FailureOf([&] { model.Execute("NOOP"); }), "Command not find.\n");
    EXPECT_TRUE(model.Execute(""));
    CommandManager manager;
    EXPECT_EQ(FailureOf([&] { manager.CreateAndExecute(Words("NOOP"), &model, nullptr); }),
              "Command not find.\n");
}

// The manager

TEST_F(CommandLine, ADoneCommandIsKept) {
    EXPECT_TRUE(model_.Execute("LOGGED a"));
    EXPECT_TRUE(model_.Execute("NOOP"));
    EXPECT_EQ(GetDoneCount(), 2);
    EXPECT_EQ(log, (std::vector<std::string>{"parse LOGGED|a", "execute a"}));
    EXPECT_EQ(aliveCommands, 1);
}

TEST_F(CommandLine, AFailedCommandIsDeleted) {
    EXPECT_EQ(GetFailure("LOGGED refuse"), "Logged Phrase: Invalid Arguments.\n");
    EXPECT_EQ(log, (std::vector<std::string>{"parse LOGGED|refuse", "delete refuse"}));
    EXPECT_EQ(GetFailure("LOGGED throw-in-parse"), "as described\n");
    EXPECT_EQ(GetFailure("LOGGED throw-in-execute"), "as described\n");
    EXPECT_EQ(aliveCommands, 0);
    EXPECT_EQ(GetDoneCount(), 0);
}

TEST_F(CommandLine, OtherFailuresPassThrough) {
    EXPECT_THROW(model_.Execute("LOGGED run-out-of-memory"), std::bad_alloc);
    EXPECT_EQ(aliveCommands, 0);
    EXPECT_EQ(GetDoneCount(), 0);
}

TEST_F(CommandLine, ThePassedOnExceptionKeepsItsPlace) {
    try {
        model_.Execute("LOGGED throw-in-execute");
        FAIL();
    } catch (const Exception& exception) {
        EXPECT_EQ(exception.GetModule(), "Module");
        EXPECT_EQ(exception.GetSourceUnit(), "unit");
        EXPECT_EQ(exception.GetRevision(), "revision");
        EXPECT_EQ(exception.GetLine(), 7);
    }
}

TEST_F(CommandLine, ClearDeletesTheFirstCommandFirst) {
    CommandManager manager;
    for (const char* line : {"LOGGED a", "LOGGED b", "LOGGED c"}) {
        EXPECT_TRUE(manager.CreateAndExecute(Words(line), &model_, &factory_));
    }
    EXPECT_EQ(manager.GetDoneCommandCount(), 3);
    log.clear();
    manager.Clear();
    EXPECT_EQ(log, (std::vector<std::string>{"delete a", "delete b", "delete c"}));
    EXPECT_EQ(manager.GetDoneCommandCount(), 0);
    manager.Clear();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, TheManagersEndDeletesItsCommands) {
    {
        CommandManager manager;
        manager.CreateAndExecute(Words("LOGGED a"), &model_, &factory_);
        manager.AddDoneCommand(LoggedCommand::Create(&model_, StringArray()));
        manager.AddDoneCommand(nullptr);
        EXPECT_EQ(manager.GetDoneCommandCount(), 2);
        EXPECT_EQ(aliveCommands, 2);
    }
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandMayBeOfAClassOfAnyAlignment) {
    struct alignas(16) Aligned : LoggedCommand {
        using LoggedCommand::LoggedCommand;
    };
    struct alignas(256) FarAligned : LoggedCommand {
        using LoggedCommand::LoggedCommand;
    };
    for (int i = 0; i < 20; ++i) {
        const auto odd = std::make_unique<LoggedCommand>(&model_, "odd");
        const auto aligned = std::make_unique<Aligned>(&model_, "aligned");
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(aligned.get()) % 16, 0U);
        const auto farAligned = std::make_unique<FarAligned>(&model_, "far aligned");
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(farAligned.get()) % 256, 0U);
    }
    alignas(LoggedCommand) unsigned char place[sizeof(LoggedCommand)];
    Command* const inPlace = new (place) LoggedCommand(&model_, "in place");
    inPlace->~Command();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandThatKeepsItselfIsKeptOnce) {
    action = [this](Command& command) {
        model_.GetCommandManager()->AddDoneCommand(&command);
        EXPECT_TRUE(model_.Execute("LOGGED inner"));
        model_.GetCommandManager()->AddDoneCommand(&command);
    };
    EXPECT_TRUE(model_.Execute("LOGGED act"));
    EXPECT_EQ(GetDoneCount(), 2);
    EXPECT_EQ(aliveCommands, 2);
    log.clear();
    model_.GetCommandManager()->Clear();
    EXPECT_EQ(log, (std::vector<std::string>{"delete inner", "delete act"}));
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandThatKeepsItselfAndFailsIsDeleted) {
    action = [this](Command& command) {
        model_.GetCommandManager()->AddDoneCommand(&command);
        model_.Execute("LOGGED throw-in-execute");
    };
    EXPECT_EQ(GetFailure("LOGGED act"), "as described\n");
    EXPECT_EQ(GetDoneCount(), 0);
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, AnInnerCommandMayKeepTheOuterOne) {
    Command* outer = nullptr;
    action = [&](Command& command) {
        if (outer == nullptr) {
            outer = &command;
            EXPECT_TRUE(model_.Execute("LOGGED act"));
        }
        model_.GetCommandManager()->AddDoneCommand(outer);
    };
    EXPECT_TRUE(model_.Execute("LOGGED act"));
    EXPECT_EQ(GetDoneCount(), 2);
    EXPECT_EQ(aliveCommands, 2);
    model_.GetCommandManager()->Clear();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandMayClearTheDoneOnes) {
    action = [this](Command& command) {
        model_.GetCommandManager()->AddDoneCommand(&command);
        model_.GetCommandManager()->Clear();
        EXPECT_EQ(GetDoneCount(), 0);
        EXPECT_EQ(aliveCommands, 1) << "the one that is being carried out stays";
        model_.GetCommandManager()->AddDoneCommand(LoggedCommand::Create(nullptr, StringArray()));
        model_.Execute("LOGGED inner");
    };
    EXPECT_TRUE(model_.Execute("LOGGED a"));
    EXPECT_TRUE(model_.Execute("LOGGED act"));
    EXPECT_EQ(GetDoneCount(), 3);
    EXPECT_EQ(aliveCommands, 3);
    EXPECT_TRUE(model_.Execute("LOGGED b"));
    EXPECT_EQ(GetDoneCount(), 4);
    model_.GetCommandManager()->Clear();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ADoneCommandIsKeptOnce) {
    CommandManager manager;
    Command* const command = LoggedCommand::Create(&model_, StringArray());
    manager.AddDoneCommand(command);
    manager.AddDoneCommand(command);
    EXPECT_EQ(manager.GetDoneCommandCount(), 1);
    manager.Clear();
    EXPECT_EQ(log, std::vector<std::string>{"delete "});

    manager.CreateAndExecute(Words("LOGGED a"), &model_, &factory_);
    EXPECT_EQ(manager.GetDoneCommandCount(), 1);
    log.clear();
    manager.Clear();
    EXPECT_EQ(log, std::vector<std::string>{"delete a"});
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandGivenToTwoManagersStaysWithTheFirst) {
    CommandManager first;
    CommandManager second;
    Command* const command = LoggedCommand::Create(&model_, StringArray());
    first.AddDoneCommand(command);
    second.AddDoneCommand(command);
    EXPECT_EQ(first.GetDoneCommandCount(), 1);
    EXPECT_EQ(second.GetDoneCommandCount(), 0);

    action = [&](Command& running) { second.AddDoneCommand(&running); };
    first.CreateAndExecute(Words("LOGGED act"), &model_, &factory_);
    EXPECT_EQ(first.GetDoneCommandCount(), 2);
    EXPECT_EQ(second.GetDoneCommandCount(), 0);
    EXPECT_EQ(command->GetModel(), &model_);
    command->SetModel(nullptr);
    second.AddDoneCommand(command);
    EXPECT_EQ(second.GetDoneCommandCount(), 0) << "another model makes it nobody else's";

    EXPECT_EQ(aliveCommands, 2);
    first.Clear();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, AManagerMayBeDestroyedWithinItsCommand) {
    auto manager = std::make_unique<CommandManager>();
    EXPECT_TRUE(manager->CreateAndExecute(Words("LOGGED a"), &model_, &factory_));
    action = [&](Command&) {
        manager.reset();
        EXPECT_EQ(aliveCommands, 1) << "the one that is being carried out stays";
    };
    EXPECT_TRUE(manager->CreateAndExecute(Words("LOGGED act"), &model_, &factory_));
    EXPECT_EQ(aliveCommands, 0);

    manager = std::make_unique<CommandManager>();
    bool isInner = false;
    action = [&](Command&) {
        if (isInner) {
            manager.reset();
            return;
        }
        isInner = true;
        manager->CreateAndExecute(Words("LOGGED act"), &model_, &factory_);
        EXPECT_EQ(manager, nullptr);
        EXPECT_EQ(aliveCommands, 1);
        model_.Execute("LOGGED throw-in-execute");
    };
    EXPECT_EQ(
        FailureOf([&] { manager->CreateAndExecute(Words("LOGGED act"), &model_, &factory_); }),
        "as described\n");
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, AManagerThatIsBeingDestroyedKeepsNoMoreCommands) {
    /// Runs and keeps further commands when it is destroyed.
    struct Parting : LoggedCommand {
        Parting(Model* model, CommandManager& owner, CommandFactory& commands)
            : LoggedCommand(model, "parting"), manager(owner), factory(commands) {}
        ~Parting() override {
            manager.CreateAndExecute(Words("LOGGED last"), GetModel(), &factory);
            manager.AddDoneCommand(LoggedCommand::Create(GetModel(), StringArray()));
        }
        CommandManager& manager;
        CommandFactory& factory;
    };
    {
        CommandManager manager;
        manager.AddDoneCommand(new Parting(&model_, manager, factory_));
    }
    EXPECT_EQ(aliveCommands, 0);
    EXPECT_EQ(log, (std::vector<std::string>{"parse LOGGED|last", "execute last", "delete last",
                                             "delete ", "delete "}));

    auto model = std::make_unique<Model>(&factory_);
    model->GetCommandManager()->AddDoneCommand(
        new Parting(model.get(), *model->GetCommandManager(), factory_));
    model.reset();
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, AModelMayBeDestroyedWithinItsCommand) {
    std::unique_ptr<Model> model;
    action = [&](Command&) {
        model.reset();
        EXPECT_EQ(aliveCommands, 1) << "the one that is being carried out stays";
    };
    const std::function<bool()> runs[] = {
        [&] { return model->Execute("LOGGED act"); },
        [&] { return model->ExecuteLine("LOGGED act"); },
        [&] { return model->Execute(Words("LOGGED act")); },
        [&] {
            return model->GetCommandManager()->CreateAndExecute(Words("LOGGED act"), model.get(),
                                                                &factory_);
        },
    };
    for (const auto& run : runs) {
        model = std::make_unique<Model>(&factory_);
        model->Execute("LOGGED a");
        EXPECT_TRUE(run());
        EXPECT_EQ(model, nullptr);
        EXPECT_EQ(aliveCommands, 0);
    }
}

TEST_F(CommandLine, AModelMayBeDestroyedWithinACommandThatFails) {
    auto model = std::make_unique<Model>(&factory_);
    action = [&](Command&) {
        model.reset();
        model_.Execute("LOGGED throw-in-execute");
    };
    EXPECT_EQ(FailureOf([&] { model->Execute("LOGGED act"); }), "as described\n");
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, AModelMayBeDestroyedWithinALineWithinALine) {
    auto model = std::make_unique<Model>(&factory_);
    int depth = 0;
    action = [&](Command&) {
        if (++depth < 3) {
            model->Execute("LOGGED act");
        } else {
            model.reset();
        }
    };
    EXPECT_TRUE(model->Execute("LOGGED act"));
    EXPECT_EQ(depth, 3);
    EXPECT_EQ(aliveCommands, 0);
}

TEST_F(CommandLine, ACommandKeptByAnotherManagerForgetsAModelThatItDestroyed) {
    auto model = std::make_unique<Model>(&factory_);
    CommandManager manager;
    const Command* kept = nullptr;
    action = [&](Command& command) {
        kept = &command;
        model.reset();
    };
    EXPECT_TRUE(manager.CreateAndExecute(Words("LOGGED act"), model.get(), &factory_));
    EXPECT_EQ(manager.GetDoneCommandCount(), 1);
    EXPECT_EQ(kept->GetModel(), nullptr);
}

TEST_F(CommandLine, AGuardMayDestroyTheModelThatAsksIt) {
    const Support::TemporaryFolder folder;
    struct Guard : OutputGuard {
        explicit Guard(std::unique_ptr<Model>& asking) : model(asking) {}
        Port::StringBase<char> WhyNot(const char* /*fileName*/) override {
            model.reset();
            return {};
        }
        std::unique_ptr<Model>& model;
    };
    for (const char* phrase : {"WRITE VERILOG ", "WRITE VHDL "}) {
        auto model = std::make_unique<Model>(&factory_);
        Guard guard(model);
        model->SetOutputGuard(&guard);
        const std::string file = folder / "top";
        EXPECT_TRUE(model->Execute((phrase + file).c_str()));
        EXPECT_EQ(model, nullptr);
        EXPECT_FALSE(std::filesystem::exists(file));
    }
}

TEST_F(CommandLine, ThousandsOfCommandsAreKept) {
    for (int i = 0; i < 20000; ++i) {
        model_.Execute("NOOP");
    }
    EXPECT_EQ(GetDoneCount(), 20000);
}

// The modified flag

TEST_F(CommandLine, OnlyChangesOfTheDesignSetTheModifiedFlag) {
    const auto isModifiedBy = [&](const char* line) {
        model_.SetModifiedFlag(false);
        EXPECT_EQ(GetFailure(line), "") << line;
        return model_.IsModified();
    };
    for (const char* line : {"ADD COMPONENT AND2",
                             "ADD PIN AND2 I0 Input",
                             "ADD PIN AND2 D(3:0) Input",
                             "ADD INSTANCE AND2 U1",
                             "ADD PORT A Input",
                             "ADD SIGNAL N",
                             "CONNECT SIGNAL N U1.I0",
                             "CONNECT SIGNAL N A",
                             "ASSIGN CONSTANT N 1",
                             "ASSIGN CONSTANT U1.D(3:0) 4:B:1010",
                             "ADD NOTES text",
                             "ADD MODULE COMMENT text",
                             "ADD COMPONENT COMMENT AND2 text",
                             "ADD INSTANCE COMMENT U1 text",
                             "ADD SIGNAL COMMENT N text",
                             "ADD COMPONENT PIN COMMENT AND2.I0 text",
                             "ADD INSTANCE PIN COMMENT U1.I0 text",
                             "ADD MODULE ATTRIBUTE -TYPE=User X v",
                             "ADD MODULE ATTRIBUTE X w",
                             "ADD COMPONENT ATTRIBUTE AND2 -TYPE=User X v",
                             "ADD INSTANCE ATTRIBUTE U1 X v",
                             "ADD SIGNAL ATTRIBUTE N X v",
                             "ADD COMPONENT PIN ATTRIBUTE AND2.I0 X v",
                             "ADD INSTANCE PIN ATTRIBUTE U1.I0 X v",
                             "SET MODULE ATTRIBUTE VALUE X w",
                             "SET MODULE ATTRIBUTE USERTYPE X t",
                             "SET COMPONENT ATTRIBUTE VALUE AND2 X w",
                             "SET INSTANCE ATTRIBUTE VALUE U1 X w",
                             "SET SIGNAL ATTRIBUTE VALUE N X w",
                             "SET COMPONENT PIN ATTRIBUTE VALUE AND2.I0 X w",
                             "SET INSTANCE PIN ATTRIBUTE VALUE U1.I0 X w",
                             "SET MODULE ATTRIBUTE OPTION X -GENERIC=SYN",
                             "SET INSTANCE ATTRIBUTE OPTION U1 X -SYNATTR=ASSIGN"}) {
        EXPECT_TRUE(isModifiedBy(line)) << line;
    }
    const Support::TemporaryFolder folder;
    const std::string verilog = "WRITE VERILOG " + (folder / "a.v");
    const std::string vhdl = "WRITE VHDL " + (folder / "a.vhd");
    for (const char* line : {"",
                             "NOOP",
                             "SET NETLIST NAME top",
                             "SET SOURCE FILE top.src",
                             "ADD INCLUDE a.vh",
                             "SET SYNTHESIS SYNPLICITY",
                             "UPPERCASE instance",
                             "LOWERCASE signal",
                             "FLATTEN BUS",
                             "SUPPRESS CONFIGURATION",
                             "SUPPRESS COMPONENT",
                             "USE DEFAULT LIBRARY true",
                             "ADD LIBRARY lib",
                             "ADD USE LIBRARY lib.all",
                             "SET PORT ONEPERLINE",
                             "Use AttrType",
                             "Set Application a",
                             "Set Command a",
                             "Set Device a",
                             "Set Purpose a",
                             "Set Reference a",
                             "Set Open Pin true",
                             verilog.c_str(),
                             vhdl.c_str()}) {
        EXPECT_FALSE(isModifiedBy(line)) << line;
    }
}

// Command files

class CommandFile : public CommandLine {
protected:
    bool Read(const std::string& text) {
        Support::WriteWholeFile(file_, text);
        return model_.Read(file_.c_str());
    }

    Support::TemporaryFolder folder_;
    std::string file_ = folder_ / "design.cmd";
};

TEST_F(CommandFile, EveryLineIsACommand) {
    EXPECT_TRUE(Read("ADD SIGNAL A\n\n   \nADD SIGNAL B\n"));
    EXPECT_NE(model_.GetSignal("A"), nullptr);
    EXPECT_NE(model_.GetSignal("B"), nullptr);
    EXPECT_EQ(GetDoneCount(), 2);
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(CommandFile, TheLastLineNeedsNoLineEnd) {
    EXPECT_TRUE(Read("ADD SIGNAL A\nADD SIGNAL B"));
    EXPECT_NE(model_.GetSignal("B"), nullptr);
}

TEST_F(CommandFile, OneCarriageReturnBelongsToTheLineEnd) {
    EXPECT_TRUE(Read("ADD SIGNAL A\r\n\r\nADD SIGNAL B\r\r\nADD SIGNAL C\r"));
    EXPECT_NE(model_.GetSignal("A"), nullptr);
    EXPECT_NE(model_.GetSignal("B\r"), nullptr);
    EXPECT_NE(model_.GetSignal("C"), nullptr);
    EXPECT_EQ(GetDoneCount(), 3);
}

TEST_F(CommandFile, EmptyFilesAreFine) {
    model_.SetModifiedFlag(true);
    EXPECT_TRUE(Read(""));
    EXPECT_FALSE(model_.IsModified());
    EXPECT_TRUE(Read("\n"));
    EXPECT_TRUE(Read("\r\n"));
    EXPECT_EQ(GetDoneCount(), 0);
}

TEST_F(CommandFile, IsClosedOnEveryPath) {
    const int before = Support::CountOpenFiles();
    EXPECT_TRUE(Read("ADD COMPONENT A\n"));
    EXPECT_THROW(Read("ADD COMPONENT B\nADD COMPONENT B\nADD COMPONENT C\n"), Exception);
    EXPECT_EQ(Support::CountOpenFiles(), before);
    EXPECT_NE(model_.GetComponent("B"), nullptr) << "the lines before the failure stay done";
    EXPECT_EQ(model_.GetComponent("C"), nullptr);
}

TEST_F(CommandFile, AnExceptionStopsTheReplayAndKeepsTheFlag) {
    EXPECT_EQ(FailureOf([&] { Read("ADD SIGNAL A\nUNKNOWN\nADD SIGNAL B\n"); }),
              "Command not find.\n");
    EXPECT_NE(model_.GetSignal("A"), nullptr);
    EXPECT_EQ(model_.GetSignal("B"), nullptr);
    EXPECT_TRUE(model_.IsModified());
    EXPECT_EQ(GetDoneCount(), 1);

    model_.SetModifiedFlag(false);
    EXPECT_EQ(FailureOf([&] { Read("# a comment\n"); }), "Command not find.\n");
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(CommandFile, AFileThatCannotBeOpenedClearsTheFlag) {
    const std::string missing = folder_ / "missing.cmd";
    const std::string folder = folder_.GetPath();
    for (const char* name :
         {static_cast<const char*>(nullptr), "", missing.c_str(), folder.c_str(), "/dev/null/x"}) {
        model_.SetModifiedFlag(true);
        EXPECT_FALSE(model_.Read(name));
        EXPECT_FALSE(model_.IsModified());
    }
}

TEST_F(CommandFile, ACommandThatDestroysTheModelIsTheLastOfItsFile) {
    Support::WriteWholeFile(file_, "LOGGED a\nLOGGED act\nLOGGED b\n");
    auto model = std::make_unique<Model>(&factory_);
    action = [&](Command&) { model.reset(); };
    EXPECT_TRUE(model->Read(file_.c_str()));
    EXPECT_EQ(model, nullptr);
    EXPECT_EQ(log, (std::vector<std::string>{"parse LOGGED|a", "execute a", "parse LOGGED|act",
                                             "execute act", "delete a", "delete act"}));
}

TEST_F(CommandFile, ReadClosesTheFileOnEveryPath) {
    Support::WriteWholeFile(file_, "NOOP\n");
    model_.Read(file_.c_str());
    const int before = Support::CountOpenFiles();
    for (int i = 0; i < 20; ++i) {
        Read("NOOP\nADD SIGNAL A" + std::to_string(i));
        FailureOf([&] { Read("NOOP\nUNKNOWN\nNOOP\n"); });
        model_.Read(folder_.GetPath().c_str());
    }
    EXPECT_EQ(Support::CountOpenFiles(), before);
}

TEST_F(CommandFile, LongLinesAndManyLinesAreRead) {
    const std::string longName(300000, 'n');
    std::string text = "ADD SIGNAL " + longName + "\n";
    for (int i = 0; i < 30000; ++i) {
        text += "NOOP\n";
    }
    EXPECT_TRUE(Read(text));
    EXPECT_NE(model_.GetSignal(longName.c_str()), nullptr);
    EXPECT_EQ(GetDoneCount(), 30001);
}

TEST_F(CommandFile, WriteMakesNoFile) {
    model_.SetModifiedFlag(true);
    EXPECT_TRUE(model_.Write(file_.c_str()));
    EXPECT_FALSE(model_.IsModified());
    EXPECT_FALSE(std::filesystem::exists(file_));
    EXPECT_TRUE(model_.Write(nullptr));
}
