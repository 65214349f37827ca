// The journal of the lines that a manager has done.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

using namespace Orn_Hdl;

namespace {

/// The words of each done line, joined by a bar.
std::vector<std::string> GetDoneLines(const CommandManager& manager) {
    std::vector<std::string> lines;
    manager.ForEachDoneLine([&lines](const StringArray& words) {
        lines.emplace_back(words.Concatenate("|").GetView());
    });
    return lines;
}

class Done final : public Command {
public:
    using Command::Command;
    static Command* Create(Model* model, const StringArray& /*tokens*/) { return new Done(model); }
    bool Parse(const StringArray& /*tokens*/) override { return true; }
    void Execute() override {}
    const char* GetName() const override { return "Make Done"; }
};

class DoneLines : public testing::Test {
protected:
    std::vector<std::string> Get() { return GetDoneLines(*model_.GetCommandManager()); }

    Engine engine_;
    Model& model_ = [this]() -> Model& {
        engine_.CreateAndAddModel("top", "");
        return *engine_.GetModel("top");
    }();
};

} // namespace

TEST_F(DoneLines, HaveTheirWordsAndThePhraseAsRegistered) {
    for (const char* line : {"add component AND2", "ADD PIN AND2 I Input", "NOOP",
                             "noop  a \"\" 'b  c'", "set purpose the whole of it"}) {
        model_.ExecuteLine(line);
    }
    EXPECT_THROW(model_.ExecuteLine("ADD COMPONENT and2"), Exception);
    EXPECT_EQ(Get(), (std::vector<std::string>{"ADD|COMPONENT|AND2", "ADD|PIN|AND2|I|Input", "NOOP",
                                               "NOOP|a||b  c", "Set|Purpose|the|whole|of|it"}));
}

TEST_F(DoneLines, KeepAQuotedPhraseAsItStands) {
    StringArray words;
    words.Add("add signal");
    words.Add("ignored");
    words.Add("a");
    model_.Execute(words);
    EXPECT_EQ(Get(), std::vector<std::string>{"add signal|ignored|a"});
}

TEST_F(DoneLines, MayBeLongAndMany) {
    std::vector<std::string> lines;
    for (std::size_t i = 0; i < 3000; ++i) {
        lines.push_back("NOOP|" + std::string(i, 'x') + "|" + std::to_string(i));
    }
    lines.push_back("NOOP|" + std::string(1'000'000, 'y'));
    std::string many = "NOOP";
    for (int i = 0; i < 300; ++i) {
        many.append("|w");
    }
    lines.push_back(many);
    for (const std::string& line : lines) {
        StringArray words;
        words.Parse(line, "|", false, nullptr);
        model_.Execute(words);
    }
    EXPECT_EQ(Get(), lines);
    EXPECT_EQ(static_cast<std::size_t>(model_.GetCommandManager()->GetDoneCommandCount()),
              lines.size());
}

TEST_F(DoneLines, OfCommandsThatAreObjects) {
    model_.GetCommandFactory()->AddCommandCreator("Make Done", Done::Create);
    model_.GetCommandFactory()->AddCommandCreator("NOOP", Done::Create);
    model_.ExecuteLine("make done twice");
    model_.ExecuteLine("noop it");
    model_.GetCommandManager()->AddDoneCommand(new Done(&model_));
    EXPECT_EQ(Get(), (std::vector<std::string>{"make|done|twice", "noop|it", "Make|Done"}));
    model_.GetCommandManager()->Clear();
    EXPECT_EQ(Get(), std::vector<std::string>{});
}

TEST_F(DoneLines, OfALineWithinALineComeFirst) {
    struct Nesting : Command {
        using Command::Command;
        static Command* Create(Model* model, const StringArray& /*tokens*/) {
            return new Nesting(model);
        }
        bool Parse(const StringArray& /*tokens*/) override { return true; }
        void Execute() override { GetModel()->ExecuteLine("ADD SIGNAL inner"); }
        const char* GetName() const override { return "NEST"; }
    };
    model_.GetCommandFactory()->AddCommandCreator("NEST", Nesting::Create);
    model_.ExecuteLine("NEST");
    EXPECT_EQ(Get(), (std::vector<std::string>{"ADD|SIGNAL|inner", "NEST"}));
}

TEST_F(DoneLines, AreWalkedAsTheyWereWhenTheWalkBegan) {
    CommandManager& manager = *model_.GetCommandManager();
    model_.ExecuteLine("NOOP 1");
    model_.ExecuteLine("NOOP 2");
    std::vector<std::string> met;
    manager.ForEachDoneLine([&](const StringArray& words) {
        met.emplace_back(words.Concatenate(" ").GetView());
        model_.ExecuteLine("NOOP more");
    });
    EXPECT_EQ(met, (std::vector<std::string>{"NOOP 1", "NOOP 2"}));
    EXPECT_EQ(manager.GetDoneCommandCount(), 4);

    met.clear();
    manager.ForEachDoneLine([&](const StringArray& words) {
        met.emplace_back(words.Concatenate(" ").GetView());
        manager.Clear();
        model_.ExecuteLine("NOOP anew");
    });
    EXPECT_EQ(met, (std::vector<std::string>{"NOOP 1", "NOOP 2", "NOOP more", "NOOP more"}));

    auto ending = std::make_unique<CommandManager>();
    StringArray words("NOOP", " ", true, nullptr);
    ending->CreateAndExecute(words, &model_, model_.GetCommandFactory());
    ending->CreateAndExecute(words, &model_, model_.GetCommandFactory());
    int count = 0;
    ending->ForEachDoneLine([&](const StringArray& /*words*/) {
        ending.reset();
        ++count;
    });
    EXPECT_EQ(count, 2);
}
