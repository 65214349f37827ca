#include "Orn_Hdl/Check.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <string>
#include <vector>

namespace Orn_Hdl {
namespace {

using Finding = Check::Finding;
using Findings = std::vector<Finding>;
using Verdict = Check::Verdict;

/// A design of one inverter between two ports, without findings.
class CheckTest : public ::testing::Test {
protected:
    CheckTest() : model_(&factory_) {
        Do({"SET NETLIST NAME top", "SUPPRESS CONFIGURATION true", "ADD COMPONENT INV",
            "ADD PIN INV I input", "ADD PIN INV O output", "ADD PORT A input", "ADD PORT Y output",
            "ADD INSTANCE INV U1", "CONNECT SIGNAL A U1.I", "CONNECT SIGNAL Y U1.O"});
    }

    void Do(const std::vector<const char*>& lines) {
        for (const char* line : lines) {
            model_.Execute(line);
        }
    }
    Findings Run(Check::Targets targets = Check::Targets::All()) {
        return Check::Run(*model_.GetNetlist(), *model_.GetOptions(), targets);
    }
    /// The only finding of a rule.
    Finding Find(const std::string& rule) {
        const Findings all = Run();
        const auto isMeant = [&](const Finding& each) { return each.rule->name == rule; };
        EXPECT_EQ(std::count_if(all.begin(), all.end(), isMeant), 1) << rule;
        const auto found = std::find_if(all.begin(), all.end(), isMeant);
        return found == all.end() ? Finding() : *found;
    }
    std::string Write(bool verilog) {
        TextMemOutStream out;
        model_.GetOptions()->writeHeader = false;
        if (verilog) {
            VerilogNetlister(out).WriteNetlist(model_.GetNetlist(), *model_.GetOptions());
        } else {
            VhdlNetlister(out).WriteNetlist(model_.GetNetlist(), model_.GetOptions());
        }
        return std::string(out.GetValue().GetView());
    }

    CommandFactory factory_;
    Model model_;
};

TEST_F(CheckTest, SoundDesignHasNoFindings) {
    EXPECT_TRUE(Run().empty());
}

TEST_F(CheckTest, YosysDoesNotReadWhatIsHiddenFromSynthesis) {
    Do({"ADD MODULE ATTRIBUTE NOTE \"7\\\" wide\"",
        "SET MODULE ATTRIBUTE OPTION NOTE -GENERIC=NOSYN"});
    const Finding finding = Find("quote-in-value");
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Yosys), Verdict::Accepts);
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Icarus), Verdict::Rejects);
}

TEST_F(CheckTest, AnExtendedNameMayHoldABackslashTwice) {
    Do({"ADD SIGNAL \\a\\\\b\\", "CONNECT SIGNAL \\a\\\\b\\ A"});
    const Finding name = Find("illegal-name");
    EXPECT_EQ(name.verdicts.Get(Check::Target::Vhdl93), Verdict::Accepts);
    EXPECT_EQ(name.verdicts.Get(Check::Target::Verilog2005), Verdict::Rejects);
}

TEST_F(CheckTest, EmptyNetlistIsChecked) {
    const Netlist netlist;
    const HdlOptions options;
    const Findings findings = Check::Run(netlist, options);
    ASSERT_EQ(findings.size(), 1U);
    EXPECT_EQ(findings[0].rule->name, "no-ports");
}

TEST_F(CheckTest, FindingNamesObjectsTargetsAndCause) {
    Do({"ADD PORT wire input"});
    const Finding finding = Find("reserved-word");
    EXPECT_EQ(finding.GetSeverity(), Check::Severity::Error);
    EXPECT_EQ(finding.objects, (std::vector<const Object*>{model_.GetSignal("wire")}));
    EXPECT_EQ(finding.cause.kind, Check::Cause::Kind::Signal);
    EXPECT_EQ(finding.cause.first, "wire");
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Icarus), Verdict::Rejects);
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Ghdl), Verdict::Accepts);
}

TEST_F(CheckTest, OnlyTheTargetsAskedForCount) {
    Do({"ADD PORT signal input"});
    EXPECT_TRUE(Run(Check::Targets::Verilog()).empty());
    EXPECT_EQ(Run(Check::Targets::Vhdl()).size(), 1U);
    EXPECT_TRUE(Run(Check::Targets()).empty());
}

TEST_F(CheckTest, LetterCaseOfTheVerilogNamesCounts) {
    Do({"ADD PORT WIRE input"});
    EXPECT_TRUE(Run().empty());
    Do({"LOWERCASE SIGNAL"});
    EXPECT_EQ(Find("reserved-word").verdicts.Get(Check::Target::Yosys), Verdict::Rejects);
}

TEST_F(CheckTest, DigitsThatMeanTwoThingsAreMisread) {
    Do({"ASSIGN CONSTANT D(3:0) 1010"});
    const Finding finding = Find("constant-digits");
    EXPECT_EQ(finding.verdicts.GetWorst(), Verdict::Misreads);
    EXPECT_EQ(finding.GetSeverity(), Check::Severity::Error);
    ASSERT_EQ(finding.notes.size(), 1U);
    EXPECT_EQ(finding.notes[0], "Verilog reads the bits 0010, VHDL reads 1010");
}

TEST_F(CheckTest, DigitsThatMeanOneThingAreNot) {
    Do({"ASSIGN CONSTANT D(3:0) 0001", "ASSIGN CONSTANT E(2:0) 010"});
    for (const Finding& finding : Run()) {
        EXPECT_EQ(finding.GetSeverity(), Check::Severity::Warning) << finding.message;
    }
}

TEST_F(CheckTest, UnderscoresAndBlanksAmongDigitsAreNoBits) {
    Do({"ASSIGN CONSTANT D(7:0) 8:H:A_5", "ADD SIGNAL E(7:0)"});
    model_.GetSignal("E(7:0)")->AssignConstantValue("8:H: A5");
    for (const Finding& finding : Run()) {
        EXPECT_NE(finding.rule->name, "constant-length") << finding.message;
    }
}

TEST_F(CheckTest, AVectorOfVhdlIsAsLongAsItsDigits) {
    Do({"ADD COMPONENT ATTRIBUTE INV -TYPE=BitVector W 4:H:A", "USE ATTRTYPE true",
        "SET COMPONENT ATTRIBUTE OPTION INV W -GENERIC=SYN"});
    const auto isMisread = [this](const char* value) {
        model_.GetComponent("INV")->GetAttr("W")->SetValue(value);
        for (const Finding& finding : Run(Check::Targets::Vhdl())) {
            if (finding.rule->name == "constant-length") {
                EXPECT_EQ(finding.cause.first, "INV");
                EXPECT_EQ(finding.cause.second, "W");
                EXPECT_EQ(finding.verdicts.GetWorst(), Verdict::Misreads);
                return true;
            }
        }
        return false;
    };
    for (const char* value : {"4:H:A5", "6:H:05", "8:H:5", "-4:B:1010", "0:B:1"}) {
        EXPECT_TRUE(isMisread(value)) << value;
    }
    for (const char* value : {"4:H:A", "8:H:A5", "6:O:17", "8:B:1010_1010", "1010"}) {
        EXPECT_FALSE(isMisread(value)) << value;
    }
    // A text is written as it stands.
    Do({"SET COMPONENT ATTRIBUTE OPTION INV W -GENERIC=NONE",
        "SET COMPONENT ATTRIBUTE OPTION INV W -SYNATTR=ASSIGN"});
    EXPECT_TRUE(isMisread("4:H:A5"));
    model_.GetOptions()->vhdl.useAttrType = false;
    EXPECT_FALSE(isMisread("4:H:A5"));
}

TEST_F(CheckTest, AnIndexOfMoreThan32BitsIsWrittenAsAnotherOne) {
    const auto findMessage = [this](const std::string& command, const char* bus) {
        Do({(command + bus + " input").c_str()});
        for (const Finding& finding : Run()) {
            if (finding.rule->name == "wide-bus" && finding.objects.front()->GetName() == bus) {
                const bool isMisread =
                    finding.verdicts.Get(Check::Target::Vhdl93) == Verdict::Misreads;
                return (isMisread ? "misread: " : "") + finding.message;
            }
        }
        return std::string();
    };
    EXPECT_EQ(findMessage("ADD PORT ", "W(2147483648:2147483640)"),
              "misread: the bus \"W(2147483648:2147483640)\" has an index of more than 32 bits");
    EXPECT_EQ(findMessage("ADD PORT ", "N(02147483647:2147483640)"),
              "the bus \"N(02147483647:2147483640)\" has 8 bits");
    EXPECT_EQ(findMessage("ADD PORT ", "M(-3:4)"), "");
    EXPECT_EQ(findMessage("ADD PIN INV ", "P(0:4294967296)"),
              "misread: the bus \"P(0:4294967296)\" has an index of more than 32 bits");
}

TEST_F(CheckTest, VhdlRejectsAnAliasThatLiesOutsideItsBus) {
    Do({"ADD PORT B(3:0) input", "ADD SIGNAL N", "CONNECT SIGNAL N B(7)"});
    const Finding finding = Find("slice-outside");
    EXPECT_EQ(finding.message, "\"B(7)\" lies outside the bus \"B(3:0)\"");
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Vhdl93), Verdict::Rejects);
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Ghdl), Verdict::Rejects);
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Icarus), Verdict::Warns);
}

TEST_F(CheckTest, ABusHidesALibraryOfItsName) {
    Do({"ADD PORT work(1:0) input"});
    const Finding finding = Find("hidden-library");
    EXPECT_EQ(finding.message, "the port \"work(1:0)\" hides the library of that name");
    EXPECT_EQ(finding.cause.first, "work");
}

TEST_F(CheckTest, ASignalOfAnOpenPinMayMeetABusOfItsName) {
    Do({"ADD COMPONENT REG", "ADD PIN REG D(3:0) input", "ADD INSTANCE REG U2",
        "ADD SIGNAL U2_D_openSignal(7:4)", "SET OPEN PIN false"});
    Write(false);
    const Signal* const made = model_.GetSignal("U2_D_openSignal(3:0)");
    ASSERT_NE(made, nullptr);
    const Finding finding = Find("name-clash");
    EXPECT_EQ(finding.objects,
              (std::vector<const Object*>{model_.GetSignal("U2_D_openSignal(7:4)"), made}));
    EXPECT_EQ(finding.verdicts.Get(Check::Target::Vhdl93), Verdict::Rejects);
}

TEST_F(CheckTest, AValueOfAUserTypeIsALiteralOfIt) {
    Do({"ADD COMPONENT ATTRIBUTE INV -TYPE=User W x",
        "SET COMPONENT ATTRIBUTE OPTION INV W -GENERIC=SYN"});
    const auto isWrong = [this](const char* type, const char* value) {
        Do({("SET COMPONENT ATTRIBUTE USERTYPE INV W " + std::string(type)).c_str()});
        model_.GetComponent("INV")->GetAttr("W")->SetValue(value);
        const Findings found = Run(Check::Targets::Vhdl());
        return std::any_of(found.begin(), found.end(), [](const Finding& finding) {
            return finding.rule->name == "user-value";
        });
    };
    EXPECT_TRUE(isWrong("bit_vector", "\"text\""));
    EXPECT_TRUE(isWrong("bit_vector", "\"0X\""));
    EXPECT_FALSE(isWrong("bit_vector", "\"0110\""));
    EXPECT_TRUE(isWrong("std_logic_vector", "\"0x\""));
    EXPECT_FALSE(isWrong("std_logic_vector", "\"0XZ-\""));
    EXPECT_TRUE(isWrong("std_logic", "'x'"));
    EXPECT_FALSE(isWrong("std_logic", "'X'"));
    EXPECT_FALSE(isWrong("character", "'x'"));
}

TEST_F(CheckTest, OnlyAUseClauseMayDeclareATypeThatHasAName) {
    Do({"ADD COMPONENT ATTRIBUTE INV -TYPE=User W x",
        "SET COMPONENT ATTRIBUTE OPTION INV W -GENERIC=SYN"});
    const auto judge = [this](const char* type) {
        model_.SetComponentUserType("INV", "W", type);
        return Find("user-type").verdicts.Get(Check::Target::Vhdl93);
    };
    EXPECT_EQ(judge("colour"), Verdict::Rejects);
    EXPECT_EQ(judge(""), Verdict::Rejects);
    Do({"ADD USE LIBRARY work.colours.all"});
    EXPECT_EQ(judge("colour"), Verdict::Warns);
    EXPECT_EQ(judge(""), Verdict::Rejects);
}

TEST_F(CheckTest, CommentsHideWhatFollowsFromSynthesis) {
    Do({"ADD NOTES synthesis translate_off"});
    EXPECT_EQ(Find("directive-comment").verdicts.Get(Check::Target::Ghdl), Verdict::Misreads);
    Do({"ADD NOTES pragma translate_off"});
    const Findings found = Run(Check::Targets::Vhdl());
    EXPECT_EQ(std::count_if(
                  found.begin(), found.end(),
                  [](const Finding& finding) { return finding.rule->name == "directive-comment"; }),
              2);
}

TEST_F(CheckTest, ChangesNothing) {
    Do({"CONNECT SIGNAL Y U1.I", "ADD PORT B(3:0) input", "CONNECT SIGNAL B(7) U1.I",
        "ADD INSTANCE INV U2", "ADD SIGNAL open", "CONNECT SIGNAL open U2.I", "SET OPEN PIN false",
        "ADD COMPONENT ATTRIBUTE INV LEVEL HALVEX"});
    const auto count = [this] {
        int signals = 0;
        for ([[maybe_unused]] const Signal* signal : model_.GetNetlist()->GetSignalIterator()) {
            ++signals;
        }
        return signals;
    };
    const int before = count();
    const Findings once = Run();
    const Findings twice = Run();
    EXPECT_EQ(count(), before);
    EXPECT_EQ(model_.GetComponent("INV")->GetAttr("BOX_TYPE"), nullptr);
    ASSERT_EQ(once.size(), twice.size());
    for (std::size_t i = 0; i < once.size(); ++i) {
        EXPECT_EQ(once[i].message, twice[i].message);
    }
}

TEST_F(CheckTest, WritesAreTheSameWithAndWithoutACheck) {
    const std::string verilog = Write(true);
    Run();
    EXPECT_EQ(Write(true), verilog);
    const std::string vhdl = Write(false);
    Run();
    EXPECT_EQ(Write(false), vhdl);
}

TEST_F(CheckTest, DummySignalsAreForeseen) {
    Do({"ADD INSTANCE INV U2", "CONNECT SIGNAL Y U2.I"});
    EXPECT_TRUE(Run().empty());
    Write(false);
    EXPECT_TRUE(Run().empty());
    EXPECT_NE(model_.GetNetlist()->GetDummySignal(model_.GetSignal("Y")), nullptr);
}

TEST_F(CheckTest, DummySignalThatCannotBeMadeIsFound) {
    Do({"ADD INSTANCE INV U2", "CONNECT SIGNAL Y U2.I", "ADD SIGNAL Y_DUMMY"});
    EXPECT_EQ(Find("dummy-taken").verdicts.Get(Check::Target::Vhdl93), Verdict::Rejects);
    EXPECT_EQ(Find("dummy-taken").verdicts.Get(Check::Target::Vhdl2008), Verdict::Accepts);
}

TEST_F(CheckTest, LongAndOddNamesDoNoHarm) {
    Do({"ADD PORT a%b input", "ADD PORT \\x input", "ADD PORT D(99999999999:0) input",
        "ASSIGN CONSTANT E(2147483647:0) 1", "ADD PORT \"(\" input", "ADD PORT \",\" input"});
    model_.AddSignal(std::string(1000000, 'n').c_str());
    EXPECT_FALSE(Run().empty());
}

TEST_F(CheckTest, ObjectsThatOnlyProgramsMakeDoNoHarm) {
    Netlist& netlist = *model_.GetNetlist();
    netlist.Add(new Bus("nobus"));
    netlist.Add(new BusIndex("Z(3)", nullptr));
    netlist.Add(new BusSlice("Z(3:0)", nullptr));
    netlist.Add(new CompoundBus("none"));
    netlist.Add(new Instance("lonely", nullptr));
    netlist.Add(new ScalarSignal(""));
    model_.GetInstance("U1")->GetPin("I")->Connect(model_.GetSignal("Z(3)"));
    netlist.GetSignal("none")->AssignConstantValue("4:B:1010");
    netlist.Remove(model_.GetComponent("INV"));
    EXPECT_FALSE(Run().empty());
}

TEST(CheckRules, NamesAreUniqueAndFound) {
    std::set<std::string_view> names;
    for (const Check::Rule& rule : Check::GetRules()) {
        EXPECT_TRUE(names.insert(rule.name).second) << rule.name;
        EXPECT_EQ(Check::FindRule(rule.name)->name, rule.name);
        EXPECT_FALSE(rule.what.empty() || rule.why.empty() || rule.example.empty() ||
                     rule.help.empty());
        EXPECT_NE(rule.verdicts.GetWorst(), Verdict::Accepts) << rule.name;
    }
    EXPECT_EQ(Check::FindRule("no such rule"), nullptr);
}

TEST(CheckTargets, HaveNames) {
    for (const Check::Target target : Check::GetTargets()) {
        Check::Target found = {};
        EXPECT_TRUE(Check::FindTarget(Check::GetName(target), found));
        EXPECT_EQ(found, target);
        EXPECT_NE(Check::Targets::Verilog().Has(target), Check::Targets::Vhdl().Has(target));
        EXPECT_TRUE(Check::Targets::All().Has(target));
    }
    Check::Target found = {};
    EXPECT_FALSE(Check::FindTarget("ada", found));
}

TEST_F(CheckTest, ADesignMayHaveANameAsLongAsATargetTakes) {
    constexpr std::size_t Longest = 127;
    model_.SetName(std::string(Longest, 'n').c_str());
    EXPECT_TRUE(Run().empty());
    model_.SetName(std::string(Longest + 1, 'n').c_str());
    EXPECT_EQ(Find("name-length").verdicts.Get(Check::Target::Verilator), Verdict::Rejects);
}

} // namespace
} // namespace Orn_Hdl
