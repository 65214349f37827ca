#include "Orn_Hdl/LegalNetlist.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

namespace Orn_Hdl {
namespace {

/// A design of one inverter between two ports, which is legal.
class LegalNetlistTest : public ::testing::Test {
protected:
    LegalNetlistTest() : model_(&factory_) {
        Do({"SET NETLIST NAME top", "SUPPRESS CONFIGURATION true", "ADD COMPONENT INV",
            "ADD PIN INV I input", "ADD PIN INV O output", "ADD PORT A input", "ADD PORT Y output",
            "ADD INSTANCE INV U1", "CONNECT SIGNAL A U1.I", "CONNECT SIGNAL Y U1.O"});
        model_.GetOptions()->writeHeader = false;
    }

    void Do(const std::vector<const char*>& lines) { DoIn(model_, lines); }
    static void DoIn(Model& model, const std::vector<const char*>& lines) {
        for (const char* line : lines) {
            model.Execute(line);
        }
    }
    std::string Write(Language language) { return WriteOf(model_, language); }
    static std::string WriteOf(Model& model, Language language) {
        TextMemOutStream out;
        if (language == Language::Verilog) {
            VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        } else {
            VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
        }
        return std::string(out.GetValue().GetView());
    }
    std::string WriteLegally(Language language) {
        model_.GetOptions()->legal = true;
        const std::string text = Write(language);
        model_.GetOptions()->legal = false;
        return text;
    }
    /// Whether the text stands in the legal netlists of both languages.
    void ExpectInBoth(const char* verilog, const char* vhdl) {
        const std::string inVerilog = WriteLegally(Language::Verilog);
        const std::string inVhdl = WriteLegally(Language::Vhdl);
        EXPECT_NE(inVerilog.find(verilog), std::string::npos) << verilog << "\n" << inVerilog;
        EXPECT_NE(inVhdl.find(vhdl), std::string::npos) << vhdl << "\n" << inVhdl;
    }
    std::string NameOf(const Object* object) {
        return LegalNetlist(*model_.GetNetlist(), *model_.GetOptions()).GetName(*object);
    }
    std::string NameOfSignal(const char* name) { return NameOf(model_.GetSignal(name)); }
    static std::string Read(const std::string& file) {
        std::ifstream in(file);
        return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
    }
    std::vector<std::string> FindErrors() {
        std::vector<std::string> rules;
        const LegalNetlist legal(*model_.GetNetlist(), *model_.GetOptions());
        for (const Check::Finding& finding : legal.GetErrors()) {
            rules.emplace_back(finding.rule->name);
        }
        return rules;
    }

    CommandFactory factory_;
    Model model_;
};

TEST_F(LegalNetlistTest, LegalDesignIsWrittenAsItStands) {
    EXPECT_TRUE(LegalNetlist(*model_.GetNetlist(), *model_.GetOptions()).IsUnchanged());
    for (const Language language : Languages) {
        EXPECT_EQ(WriteLegally(language), Write(language));
    }
}

TEST_F(LegalNetlistTest, DesignStaysAsItIs) {
    Do({"ADD SIGNAL wire", "CONNECT SIGNAL wire A", "ADD PORT Z output", "CONNECT SIGNAL Z Y"});
    const std::string before = Write(Language::Verilog);
    WriteLegally(Language::Vhdl);
    WriteLegally(Language::Verilog);
    EXPECT_EQ(Write(Language::Verilog), before);
    EXPECT_EQ(model_.GetSignal("wire")->GetNameView(), "wire");
}

TEST_F(LegalNetlistTest, NamesChangeOnlyWhereTheyMust) {
    Do({"ADD PORT signal input", "ADD PORT a__b input", "ADD PORT 2x input", "ADD PORT A_1 input"});
    EXPECT_EQ(NameOfSignal("signal"), "signal_1");
    EXPECT_EQ(NameOfSignal("a__b"), "a_b");
    EXPECT_EQ(NameOfSignal("2x"), "p2x");
    EXPECT_EQ(NameOfSignal("A_1"), "A_1");
    EXPECT_EQ(NameOfSignal("A"), "A");
    ExpectInBoth("input signal_1;", "signal_1 : in ");
}

TEST_F(LegalNetlistTest, LegalNameIsNeverTaken) {
    Do({"ADD PORT a$b input", "ADD PORT a_b input", "ADD PORT A_B_1 input"});
    EXPECT_EQ(NameOfSignal("a_b"), "a_b");
    EXPECT_EQ(NameOfSignal("A_B_1"), "A_B_1");
    EXPECT_EQ(NameOfSignal("a$b"), "a_b_2");
}

TEST_F(LegalNetlistTest, OrderOfCommandsDoesNotShow) {
    const std::vector<const char*> names = {"a$b", "a_b_", "_a_b", "a__b", "process"};
    std::vector<std::string> expected;
    std::vector<std::size_t> order = {0, 1, 2, 3, 4};
    do {
        Model model(&factory_);
        DoIn(model, {"SET NETLIST NAME top", "ADD PORT P input"});
        for (const std::size_t index : order) {
            model.Execute(("ADD PORT " + std::string(names[index]) + " input").c_str());
        }
        const LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
        std::vector<std::string> given;
        for (const char* name : names) {
            given.push_back(legal.GetName(*model.GetSignal(name)));
        }
        if (expected.empty()) {
            expected = given;
            std::sort(given.begin(), given.end());
            EXPECT_EQ(std::adjacent_find(given.begin(), given.end()), given.end());
        } else {
            EXPECT_EQ(given, expected);
        }
    } while (std::next_permutation(order.begin(), order.end()));
}

TEST_F(LegalNetlistTest, OneOfTwoWithOneNameChanges) {
    Do({"ADD SIGNAL A(3:0)", "ADD SIGNAL U1(1:0)"});
    EXPECT_EQ(NameOfSignal("A"), "A");
    EXPECT_EQ(NameOfSignal("A(3:0)"), "A_1");
    EXPECT_EQ(NameOfSignal("U1(1:0)"), "U1");
    EXPECT_EQ(NameOf(model_.GetInstance("U1")), "U1_1");
    ExpectInBoth("wire [3:0] A_1;", "signal A_1 ");
}

TEST_F(LegalNetlistTest, LongNamesAreCut) {
    const std::string port = "n" + std::string(2000, 'x');
    const std::string design = "d" + std::string(200, 'x');
    model_.Execute(("ADD PORT " + port + " input").c_str());
    model_.Execute(("SET NETLIST NAME " + design).c_str());
    EXPECT_EQ(NameOfSignal(port.c_str()).size(), 1000U);
    EXPECT_EQ(NameOf(model_.GetNetlist()).size(), 120U);
}

TEST_F(LegalNetlistTest, NamesCanBeEscaped) {
    model_.GetOptions()->escapeNames = true;
    Do({"ADD PORT signal input", "ADD PORT A+B input", "ADD PORT wire(3:0) input"});
    ExpectInBoth("input signal;", "\\signal\\ ");
    ExpectInBoth("input \\A+B ;", "\\A+B\\ ");
    ExpectInBoth("input [3:0] wire_1;", "wire_1 ");
    EXPECT_EQ(NameOfSignal("A+B"), "A+B");
}

TEST_F(LegalNetlistTest, ConstantsGetTheirBits) {
    Do({"ADD PORT D(3:0) output", "ASSIGN CONSTANT D(3:0) 1010", "ADD PORT E(3:0) output",
        "ASSIGN CONSTANT E(3:0) 5", "ADD PORT F(3:0) output", "ASSIGN CONSTANT F(3:0) 1X0Z",
        "ADD PORT G(7:0) output", "ASSIGN CONSTANT G(7:0) 8:H:5"});
    ExpectInBoth("assign D = 4'b1010;", "D(3 downto 0) <= \"1010\";");
    ExpectInBoth("assign E = 4'b0101;", "E(3 downto 0) <= \"0101\";");
    ExpectInBoth("assign F = 4'b1x0z;", "F(3 downto 0) <= \"1X0Z\";");
    ExpectInBoth("assign G = 8'b00000101;", "G(7 downto 0) <= \"00000101\";");
}

TEST_F(LegalNetlistTest, GenericsGetAsManyBitsAsTheirLengthSays) {
    Do({"ADD COMPONENT ATTRIBUTE INV -TYPE=BitVector INIT 6:H:05",
        "SET COMPONENT ATTRIBUTE OPTION INV INIT -GENERIC=SYN"});
    ExpectInBoth("6'b000101", "INIT => b\"000101\"");
    model_.GetComponent("INV")->GetAttr("INIT")->SetValue("4:H:A5");
    EXPECT_EQ(FindErrors(), std::vector<std::string>{"constant-length"});
    model_.GetComponent("INV")->GetAttr("INIT")->SetValue("-4:H:5");
    EXPECT_EQ(FindErrors(), std::vector<std::string>{"constant-length"});
}

TEST_F(LegalNetlistTest, VectorsOfAttributesThatDoNotFitAreTexts) {
    Do({"USE ATTRTYPE true", "ADD SIGNAL ATTRIBUTE A -TYPE=BitVector TAG 4:H:A5",
        "SET SIGNAL ATTRIBUTE OPTION A TAG -SYNATTR=ASSIGN"});
    ExpectInBoth("TAG", "attribute TAG of A : signal is \"A5\"");
}

TEST_F(LegalNetlistTest, ConstantWithTwoMeaningsIsRefused) {
    Do({"ADD PORT D(7:0) output", "ASSIGN CONSTANT D(7:0) 10"});
    const std::vector<std::string> errors = FindErrors();
    EXPECT_NE(std::find(errors.begin(), errors.end(), "constant-width"), errors.end());
}

TEST_F(LegalNetlistTest, ConstantThatIsNoPlainNumberIsRefused) {
    Do({"ADD PORT D(7:0) output"});
    for (const char* value : {"-5", "1_9", "+7"}) {
        model_.AssignConstantToSignal("D(7:0)", value);
        const std::vector<std::string> errors = FindErrors();
        EXPECT_NE(std::find(errors.begin(), errors.end(), "constant-width"), errors.end()) << value;
    }
}

TEST_F(LegalNetlistTest, NothingIsWrittenOfWhatCannotBeMended) {
    Do({"ADD INSTANCE INV U2", "CONNECT SIGNAL A U2.I", "CONNECT SIGNAL Y U2.O"});
    EXPECT_EQ(FindErrors(), std::vector<std::string>{"two-drivers"});
    TextMemOutStream out;
    model_.GetOptions()->legal = true;
    try {
        VerilogNetlister(out).WriteNetlist(model_.GetNetlist(), *model_.GetOptions());
        FAIL() << "nothing is thrown";
    } catch (const Exception& exception) {
        EXPECT_EQ(exception.getLocalized().GetView(),
                  "No legal netlist can be written: \"Y\" has two drivers [two-drivers].\n");
    }
    EXPECT_TRUE(out.GetValue().IsEmpty());
}

TEST_F(LegalNetlistTest, OutputsAreReadThroughASignal) {
    Do({"ADD PORT Z output", "CONNECT SIGNAL Z Y", "ADD SIGNAL Y_DUMMY"});
    ExpectInBoth("assign Y = Y_DUMMY_1;", "Y <= Y_DUMMY_1;");
    ExpectInBoth("assign Z = Y_DUMMY_1;", "Z <= Y_DUMMY_1;");
    ExpectInBoth(".O(Y_DUMMY_1)", "O=>Y_DUMMY_1");
}

TEST_F(LegalNetlistTest, OpenInputsGetSignals) {
    Do({"ADD INSTANCE INV U2", "ADD PIN INV EN(1:0) input"});
    ExpectInBoth("wire U2_I_openSignal;", "I=>U2_I_openSignal");
    ExpectInBoth(".EN(U1_EN_openSignal[1:0])", "EN(1 downto 0)=>U1_EN_openSignal(1 downto 0)");
}

TEST_F(LegalNetlistTest, SignalNamedOpenIsASignalWhenItIsUsedAsOne) {
    Do({"ADD INSTANCE INV U2", "ASSIGN CONSTANT open 1", "CONNECT SIGNAL open U2.I"});
    ExpectInBoth("assign open_1 = 1;", "open_1 <= '1';");
    ExpectInBoth(".I(open_1)", "I=>open_1");
}

TEST_F(LegalNetlistTest, WidthsOfASignalNamedOpenCount) {
    Do({"CONNECT SIGNAL open A,A"});
    EXPECT_EQ(FindErrors(), std::vector<std::string>{"alias-bits"});
}

TEST_F(LegalNetlistTest, OpenPartsGetSignals) {
    Do({"ADD COMPONENT REG", "ADD PIN REG Q(1:0) output", "ADD INSTANCE REG U2",
        "ADD PORT Q output", "CONNECT SIGNAL open,Q U2.Q(1:0)"});
    ExpectInBoth("{openSignal, Q}", "Q(1)=>openSignal");
}

TEST_F(LegalNetlistTest, ValuesAreEscaped) {
    Do({"ADD MODULE ATTRIBUTE NOTE \"7\\\" wide\"", "SET MODULE ATTRIBUTE OPTION NOTE -GENERIC=SYN",
        "ADD MODULE ATTRIBUTE PATH a\\b", "SET MODULE ATTRIBUTE OPTION PATH -GENERIC=SYN",
        "ADD MODULE ATTRIBUTE TAB a\tb", "SET MODULE ATTRIBUTE OPTION TAB -GENERIC=SYN",
        "ADD MODULE ATTRIBUTE ENDS \"x\\\"\"", "SET MODULE ATTRIBUTE OPTION ENDS -GENERIC=SYN"});
    ExpectInBoth("ENDS = \"x\\\"\"", "ENDS : string :=  \"x\"\"\"");
    ExpectInBoth("NOTE = \"7\\\" wide\"", "NOTE : string :=  \"7\"\" wide\"");
    ExpectInBoth("PATH = \"a\\\\b\"", "PATH : string :=  \"a\\b\"");
    ExpectInBoth("TAB = \"a\tb\"", "TAB : string :=  \"a\" & character'val(9) & \"b\"");
}

TEST_F(LegalNetlistTest, CommentsEndWhereTheyShould) {
    Do({"SET SYNTHESIS SYNOPSYS", "ADD INSTANCE ATTRIBUTE U1 NOTE a*/b",
        "SET INSTANCE ATTRIBUTE OPTION U1 NOTE -SYNATTR=ASSIGN", "ADD NOTES verilator lint_off"});
    ExpectInBoth("NOTE \"a*\\/b\"", "is \"a*/b\"");
    ExpectInBoth("// \"verilator lint_off\"", "-- \"verilator lint_off\"");
}

TEST_F(LegalNetlistTest, GenericsOfAllInstancesAreDeclared) {
    Do({"ADD INSTANCE ATTRIBUTE U1 -TYPE=Integer W 5",
        "SET INSTANCE ATTRIBUTE OPTION U1 W -GENERIC=SYN"});
    ExpectInBoth("defparam U1.W = 5;", "generic( W : integer :=  5);");
    Do({"ADD INSTANCE INV U2", "CONNECT SIGNAL A U2.I"});
    EXPECT_EQ(FindErrors(), std::vector<std::string>{"undeclared-generic"});
}

TEST_F(LegalNetlistTest, DesignWithoutPorts) {
    Model model(&factory_);
    DoIn(model, {"SET NETLIST NAME bare", "SUPPRESS CONFIGURATION true", "ADD SIGNAL N"});
    model.GetOptions()->legal = true;
    const std::string text = WriteOf(model, Language::Vhdl);
    EXPECT_EQ(text.find("port"), std::string::npos) << text;
    EXPECT_NE(WriteOf(model, Language::Verilog).find("module bare();"), std::string::npos);
}

TEST_F(LegalNetlistTest, ClausesAreMended) {
    Do({"ADD LIBRARY 2x", "ADD USE LIBRARY ieee.numeric_std.all", "USE DEFAULT LIBRARY false"});
    const std::string text = WriteLegally(Language::Vhdl);
    EXPECT_EQ(text.find("2x"), std::string::npos);
    EXPECT_NE(text.find("library ieee;\nuse ieee.numeric_std.all;\nuse ieee.std_logic_1164.all;\n"),
              std::string::npos)
        << text;
}

TEST_F(LegalNetlistTest, LegalLibrariesStayWhenAnotherIsLeftOut) {
    Do({"ADD LIBRARY cells,2x", "ADD LIBRARY unisim"});
    const std::string text = WriteLegally(Language::Vhdl);
    EXPECT_NE(text.find("library cells;\nlibrary unisim;\n"), std::string::npos) << text;
    EXPECT_EQ(text.find("2x"), std::string::npos) << text;
}

TEST_F(LegalNetlistTest, LegalClausesStay) {
    // The default library comes with clauses of its own, and a clause may stand twice.
    Do({"ADD LIBRARY ieee,ieee", "ADD USE LIBRARY ieee.numeric_std.all", "ADD SIGNAL begin"});
    const std::string renamed = WriteLegally(Language::Vhdl);
    EXPECT_NE(renamed.find("library ieee,ieee;\n"), std::string::npos) << renamed;
    Do({"ADD LIBRARY 2x"});
    const std::string mended = WriteLegally(Language::Vhdl);
    EXPECT_NE(mended.find("library ieee;\nuse"), std::string::npos) << mended;
    EXPECT_EQ(mended.find("ieee,"), std::string::npos) << mended;
}

TEST_F(LegalNetlistTest, ANameThatCannotBeEscapedIsReplaced) {
    model_.GetOptions()->escapeNames = true;
    Do({"ADD SIGNAL x\x01y", "CONNECT SIGNAL x\x01y A"});
    EXPECT_EQ(NameOfSignal("x\x01y"), "x_y");
}

TEST_F(LegalNetlistTest, ANewNameIsNoneOfAComponent) {
    Do({"ADD COMPONENT begin_1", "ADD PIN begin_1 I input", "ADD INSTANCE begin_1 U2",
        "ADD SIGNAL begin", "CONNECT SIGNAL begin U2.I", "CONNECT SIGNAL begin A"});
    EXPECT_EQ(NameOfSignal("begin"), "begin_2");
}

TEST_F(LegalNetlistTest, AQuotedTextOfAUsersTypeLosesItsQuotes) {
    Do({"ADD INSTANCE ATTRIBUTE U1 -TYPE=User DELAY \"\\\"1 ns\\\"\"",
        "SET INSTANCE ATTRIBUTE USERTYPE U1 DELAY string",
        "SET INSTANCE ATTRIBUTE OPTION U1 DELAY -SYNATTR=ASSIGN", "ADD SIGNAL begin"});
    const std::string text = WriteLegally(Language::Vhdl);
    EXPECT_NE(text.find("attribute DELAY of U1 : label is \"1 ns\";"), std::string::npos) << text;
}

TEST_F(LegalNetlistTest, AQuotedGenericOfAUsersTypeIsQuotedOnceInEachLanguage) {
    Do({"ADD COMPONENT ATTRIBUTE INV -TYPE=User MODE \"\\\"slow\\\"\"",
        "SET COMPONENT ATTRIBUTE USERTYPE INV MODE string",
        "SET COMPONENT ATTRIBUTE OPTION INV MODE -GENERIC=SYN",
        "ADD INSTANCE ATTRIBUTE U1 -TYPE=User MODE \"\\\"fast\\\"\"",
        "SET INSTANCE ATTRIBUTE USERTYPE U1 MODE string",
        "SET INSTANCE ATTRIBUTE OPTION U1 MODE -GENERIC=SYN"});
    ExpectInBoth("defparam U1.MODE = \"fast\";", "generic map( MODE => \"fast\")");
}

TEST_F(LegalNetlistTest, WriteCommandLeavesTheFileAlone) {
    const std::string file = ::testing::TempDir() + "legal_refused.v";
    std::remove(file.c_str());
    model_.GetOptions()->legal = true;
    model_.Execute(("WRITE VERILOG " + file).c_str());
    Do({"ADD INSTANCE INV U2", "CONNECT SIGNAL A U2.I", "CONNECT SIGNAL Y U2.O"});
    const std::string before = Read(file);
    EXPECT_NE(before, "");
    EXPECT_THROW(model_.Execute(("WRITE VERILOG " + file).c_str()), Exception);
    EXPECT_EQ(Read(file), before);
    std::remove(file.c_str());
}

} // namespace
} // namespace Orn_Hdl
