// The command language: every phrase, the words it needs, and the lines it refuses.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <memory>
#include <ostream>
#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;

namespace {

struct Phrase {
    const char* phrase;
    /// The arguments of the shortest line that parses.
    const char* arguments;
    /// Whether a line that lacks the last of these words is refused.
    bool needsThemAll = true;
};

void PrintTo(const Phrase& phrase, std::ostream* out) {
    *out << phrase.phrase;
}

const std::vector<Phrase>& Phrases() {
    static const std::vector<Phrase> phrases = {
        {"NOOP", "", false},
        {"SET NETLIST NAME", "top"},
        {"SET SOURCE FILE", "top.src"},
        {"ADD COMPONENT", "AND2"},
        {"ADD PIN", "AND2 I0 Input"},
        {"ADD INSTANCE", "AND2 U1"},
        {"ADD PORT", "A Input"},
        {"ADD SIGNAL", "N"},
        {"CONNECT SIGNAL", "N U1.I0"},
        {"ASSIGN CONSTANT", "N 1"},
        {"WRITE VERILOG", "top.v"},
        {"ADD INCLUDE", "cells.vh"},
        {"SET SYNTHESIS", "EXEMPLAR"},
        {"UPPERCASE", "siganl"},
        {"LOWERCASE", "signal"},
        {"WRITE VHDL", "top.vhd"},
        {"FLATTEN BUS", "", false},
        {"SUPPRESS CONFIGURATION", "", false},
        {"SUPPRESS COMPONENT", "", false},
        {"USE DEFAULT LIBRARY", "", false},
        {"ADD LIBRARY", "cells"},
        {"ADD USE LIBRARY", "cells.all.all"},
        {"ADD NOTES", "text"},
        {"SET PORT ONEPERLINE", "", false},
        {"ADD MODULE COMMENT", "text"},
        {"ADD COMPONENT COMMENT", "AND2 text"},
        {"ADD INSTANCE COMMENT", "U1 text"},
        {"ADD SIGNAL COMMENT", "N text"},
        {"ADD COMPONENT PIN COMMENT", "AND2.I0 text"},
        {"ADD INSTANCE PIN COMMENT", "U1.I0 text"},
        {"ADD MODULE ATTRIBUTE", "LOC"},
        {"ADD COMPONENT ATTRIBUTE", "AND2 LOC"},
        {"ADD INSTANCE ATTRIBUTE", "U1 LOC"},
        {"ADD SIGNAL ATTRIBUTE", "N LOC"},
        {"ADD COMPONENT PIN ATTRIBUTE", "AND2.I0 LOC"},
        {"ADD INSTANCE PIN ATTRIBUTE", "U1.I0 LOC"},
        {"SET MODULE ATTRIBUTE VALUE", "LOC P1"},
        {"SET COMPONENT ATTRIBUTE VALUE", "AND2 LOC P1"},
        {"SET INSTANCE ATTRIBUTE VALUE", "U1 LOC P1"},
        {"SET SIGNAL ATTRIBUTE VALUE", "N LOC P1"},
        {"SET COMPONENT PIN ATTRIBUTE VALUE", "AND2.I0 LOC P1"},
        {"SET INSTANCE PIN ATTRIBUTE VALUE", "U1.I0 LOC P1"},
        {"SET MODULE ATTRIBUTE USERTYPE", "LOC type"},
        {"SET COMPONENT ATTRIBUTE USERTYPE", "AND2 LOC type"},
        {"SET INSTANCE ATTRIBUTE USERTYPE", "U1 LOC type"},
        {"SET SIGNAL ATTRIBUTE USERTYPE", "N LOC type"},
        {"SET COMPONENT PIN ATTRIBUTE USERTYPE", "AND2.I0 LOC type"},
        {"SET INSTANCE PIN ATTRIBUTE USERTYPE", "U1.I0 LOC type"},
        {"SET MODULE ATTRIBUTE OPTION", "LOC -GENERIC=SYN"},
        {"SET COMPONENT ATTRIBUTE OPTION", "AND2 LOC -SYNATTR=ASSIGN"},
        {"SET INSTANCE ATTRIBUTE OPTION", "U1 LOC -GENERIC=SYN"},
        {"SET SIGNAL ATTRIBUTE OPTION", "N LOC -SYNATTR=ASSIGN"},
        {"SET COMPONENT PIN ATTRIBUTE OPTION", "AND2.I0 LOC -GENERIC=SYN"},
        {"SET INSTANCE PIN ATTRIBUTE OPTION", "U1.I0 LOC -SYNATTR=ASSIGN"},
        {"Use AttrType", "", false},
        {"Set Application", "tool"},
        {"Set Command", "run"},
        {"Set Device", "device"},
        {"Set Purpose", "purpose"},
        {"Set Reference", "reference"},
        {"Set Open Pin", "", false},
    };
    return phrases;
}

StringArray Words(const std::string& line) {
    return StringArray(line.c_str(), " ", true, "\"\"''");
}

StringArray WithoutLast(const StringArray& words) {
    StringArray shorter;
    for (int i = 0; i + 1 < words.GetSize(); ++i) {
        shorter.Add(words.GetAt(i));
    }
    return shorter;
}

std::string InvalidArguments(const char* phrase) {
    return std::string(phrase) + ": Invalid Arguments.\n";
}

class EveryPhrase : public testing::TestWithParam<Phrase> {
protected:
    bool Parses(const StringArray& words) {
        const std::unique_ptr<Command> command(factory_.CreateCommand(&model_, words));
        EXPECT_NE(command, nullptr);
        return command != nullptr && command->Parse(words);
    }

    CommandFactory factory_;
    Model model_{&factory_};
    const Phrase& phrase_ = GetParam();
    const StringArray words_ = Words(std::string(phrase_.phrase) + " " + phrase_.arguments);
};

} // namespace

TEST(Catalogue, HoldsSixtyOnePhrasesInOrder) {
    const std::vector<CommandInfo>& catalogue = CommandFactory::GetCatalogue();
    ASSERT_EQ(Phrases().size(), 61u);
    ASSERT_EQ(catalogue.size(), 61u);
    for (std::size_t i = 0; i < catalogue.size(); ++i) {
        EXPECT_STREQ(catalogue[i].phrase, Phrases()[i].phrase);
        EXPECT_STRNE(catalogue[i].help, "") << catalogue[i].phrase;
        EXPECT_NE(catalogue[i].arguments, nullptr) << catalogue[i].phrase;
    }
}

TEST_P(EveryPhrase, IsFoundInAnyLetterCase) {
    std::string upper = phrase_.phrase;
    std::string lower = phrase_.phrase;
    for (std::size_t i = 0; i < upper.size(); ++i) {
        upper[i] = Port::ToUpper(upper[i]);
        lower[i] = Port::ToLower(lower[i]);
    }
    const CommandCreator creator = factory_.GetCommandCreator(phrase_.phrase);
    ASSERT_NE(creator, nullptr);
    EXPECT_EQ(factory_.GetCommandCreator(upper.c_str()), creator);
    EXPECT_EQ(factory_.GetCommandCreator(lower.c_str()), creator);
}

TEST_P(EveryPhrase, GivesACommandOfThatName) {
    const std::unique_ptr<Command> command(factory_.CreateCommand(&model_, phrase_.phrase));
    ASSERT_NE(command, nullptr);
    EXPECT_STREQ(command->GetName(), phrase_.phrase);
    EXPECT_EQ(command->GetModel(), &model_);
}

TEST_P(EveryPhrase, ParsesItsShortestLineAndLongerOnes) {
    EXPECT_TRUE(Parses(words_));
    StringArray longer = words_;
    // An option command looks at one more word, so the further words are options, too.
    for (int i = 0; i < 3; ++i) {
        longer.Add("-GENERIC=SYN");
    }
    const bool isSignal = std::string(phrase_.phrase) == "ADD SIGNAL";
    EXPECT_EQ(Parses(longer), !isSignal);
}

TEST_P(EveryPhrase, RefusesALineThatIsTooShort) {
    if (!phrase_.needsThemAll) {
        EXPECT_TRUE(Parses(words_));
        return;
    }
    const int phraseSize = Words(phrase_.phrase).GetSize();
    for (StringArray words = WithoutLast(words_); words.GetSize() >= phraseSize;
         words = WithoutLast(words)) {
        EXPECT_FALSE(Parses(words)) << words.Concatenate(" ").GetView();
    }
}

TEST_P(EveryPhrase, NamesItselfAsRegisteredWhenItRefuses) {
    if (!phrase_.needsThemAll) {
        return;
    }
    std::string line = phrase_.phrase;
    for (char& c : line) {
        c = Port::ToLower(c);
    }
    try {
        model_.Execute(line.c_str());
        FAIL() << line;
    } catch (const Exception& exception) {
        EXPECT_EQ(exception.getLocalized(), InvalidArguments(phrase_.phrase));
        EXPECT_EQ(exception.GetModule(), "DesignEntry");
        EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlCmd");
        EXPECT_EQ(exception.GetRevision(), "$Revision: 1.19 $");
    }
    EXPECT_EQ(model_.GetCommandManager()->GetDoneCommandCount(), 0);
}

TEST_P(EveryPhrase, NeedsAModel) {
    if (std::string(phrase_.phrase) == "NOOP") {
        return;
    }
    const std::unique_ptr<Command> command(factory_.CreateCommand(nullptr, words_));
    ASSERT_NE(command, nullptr);
    ASSERT_TRUE(command->Parse(words_));
    try {
        command->Execute();
        FAIL();
    } catch (const Exception& exception) {
        EXPECT_EQ(exception.getLocalized(), "Missing Model.\n");
        EXPECT_EQ(exception.GetModule(), "DesignEntry");
        EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlCmd");
    }
}

INSTANTIATE_TEST_SUITE_P(Catalogue, EveryPhrase, testing::ValuesIn(Phrases()));

// Lines with enough words that are rejected nevertheless

TEST(CommandArguments, OfTheWrongKindAreRefused) {
    const struct {
        const char* line;
        const char* phrase;
    } cases[] = {
        {"SET NETLIST NAME \"\" x", "SET NETLIST NAME"},
        {"SET SOURCE FILE \"\" x", "SET SOURCE FILE"},
        {"ADD COMPONENT \"\" x", "ADD COMPONENT"},
        {"ADD PIN AND2 I0 sideways", "ADD PIN"},
        {"ADD PIN AND2 I0 \"\" 1", "ADD PIN"},
        {"ADD PIN AND2 I0 inputs", "ADD PIN"},
        {"ADD PORT A x", "ADD PORT"},
        {"ADD PORT A \"\" x", "ADD PORT"},
        {"ADD SIGNAL N x", "ADD SIGNAL"},
        {"ADD SIGNAL N \"\" x", "ADD SIGNAL"},
        {"ADD INCLUDE \"\" x", "ADD INCLUDE"},
        {"SET SYNTHESIS \"\" x", "SET SYNTHESIS"},
        {"UPPERCASE signal", "UPPERCASE"},
        {"UPPERCASE SIGNAL", "UPPERCASE"},
        {"UPPERCASE instances", "UPPERCASE"},
        {"LOWERCASE siganl", "LOWERCASE"},
        {"LOWERCASE pin", "LOWERCASE"},
        {"ADD LIBRARY \"\" x", "ADD LIBRARY"},
        {"ADD USE LIBRARY \"\" x", "ADD USE LIBRARY"},
        {"ADD COMPONENT PIN COMMENT AND2 text text", "ADD COMPONENT PIN COMMENT"},
        {"ADD INSTANCE PIN COMMENT U1 text text", "ADD INSTANCE PIN COMMENT"},
        {"ADD COMPONENT PIN ATTRIBUTE AND2 LOC P1", "ADD COMPONENT PIN ATTRIBUTE"},
        {"ADD INSTANCE PIN ATTRIBUTE U1 LOC P1", "ADD INSTANCE PIN ATTRIBUTE"},
        {"SET COMPONENT PIN ATTRIBUTE VALUE AND2 LOC P1", "SET COMPONENT PIN ATTRIBUTE VALUE"},
        {"SET INSTANCE PIN ATTRIBUTE VALUE U1 LOC P1", "SET INSTANCE PIN ATTRIBUTE VALUE"},
        {"SET COMPONENT PIN ATTRIBUTE USERTYPE AND2 LOC t", "SET COMPONENT PIN ATTRIBUTE USERTYPE"},
        {"SET INSTANCE PIN ATTRIBUTE USERTYPE U1 LOC t", "SET INSTANCE PIN ATTRIBUTE USERTYPE"},
        {"SET COMPONENT PIN ATTRIBUTE OPTION AND2 LOC -GENERIC=SYN",
         "SET COMPONENT PIN ATTRIBUTE OPTION"},
        {"SET INSTANCE PIN ATTRIBUTE OPTION U1 LOC -GENERIC=SYN",
         "SET INSTANCE PIN ATTRIBUTE OPTION"},
        {"ADD MODULE ATTRIBUTE -TYPE=Bit", "ADD MODULE ATTRIBUTE"},
        {"ADD COMPONENT ATTRIBUTE AND2 -TYPE=Bit", "ADD COMPONENT ATTRIBUTE"},
        {"ADD INSTANCE ATTRIBUTE U1 -type=", "ADD INSTANCE ATTRIBUTE"},
        {"ADD SIGNAL ATTRIBUTE N -Type=Bit", "ADD SIGNAL ATTRIBUTE"},
        {"ADD COMPONENT PIN ATTRIBUTE AND2.I0 -TYPE=Bit", "ADD COMPONENT PIN ATTRIBUTE"},
        {"ADD INSTANCE PIN ATTRIBUTE U1.I0 -TYPE=Bit", "ADD INSTANCE PIN ATTRIBUTE"},
        {"SET MODULE ATTRIBUTE OPTION LOC SYN", "SET MODULE ATTRIBUTE OPTION"},
        {"SET MODULE ATTRIBUTE OPTION LOC -GENERIC", "SET MODULE ATTRIBUTE OPTION"},
        {"SET MODULE ATTRIBUTE OPTION LOC x-GENERIC=SYN", "SET MODULE ATTRIBUTE OPTION"},
        {"SET MODULE ATTRIBUTE OPTION LOC -GENERIC=SYN x", "SET MODULE ATTRIBUTE OPTION"},
        {"SET MODULE ATTRIBUTE OPTION LOC -GENERIC=SYN \"\" x", "SET MODULE ATTRIBUTE OPTION"},
        {"SET COMPONENT ATTRIBUTE OPTION AND2 LOC ASSIGN", "SET COMPONENT ATTRIBUTE OPTION"},
        {"SET INSTANCE ATTRIBUTE OPTION U1 LOC -SYN=ASSIGN", "SET INSTANCE ATTRIBUTE OPTION"},
        {"SET SIGNAL ATTRIBUTE OPTION N LOC -SYNATTR ASSIGN", "SET SIGNAL ATTRIBUTE OPTION"},
        {"WRITE VERILOG \"\" ", "WRITE VERILOG"},
        {"WRITE VERILOG -APPEND \"\" ", "WRITE VERILOG"},
        {"WRITE VHDL -APPEND -NOHEADER \"\" ", "WRITE VHDL"},
        {"WRITE VERILOG \"\" a b c d", "WRITE VERILOG"},
        {"Set Application \"\" x", "Set Application"},
        {"Set Device \"\" x", "Set Device"},
    };
    for (const auto& c : cases) {
        EngineScript script;
        EXPECT_EQ(script.GetFailure(c.line), InvalidArguments(c.phrase)) << c.line;
        EXPECT_EQ(script.GetDoneCount(), 0) << c.line;
    }
}
