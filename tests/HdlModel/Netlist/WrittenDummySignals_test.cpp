// Dummy signals as they are written: how the ports are wired through them, and that writing again,
// in either language and after more commands, makes none twice.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/NetlistText.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>
#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;
using Support::Inverters;
using Support::LinesThatBegin;

namespace {

using Lines = std::vector<std::string>;

/// What matters of a written netlist: its nets and how they are wired.
struct Written {
    explicit Written(const std::string& netlist)
        : wires(LinesThatBegin(netlist, "wire ")), assigns(LinesThatBegin(netlist, "assign ")),
          instances(LinesThatBegin(netlist, "INV ")), text(netlist) {
        // Pins stand on one line here, so a line is a whole instance.
        for (std::string& line : instances) {
            line = line.substr(4);
        }
    }

    Lines wires;
    Lines assigns;
    Lines instances;
    std::string text;
};

class WrittenDummySignals : public testing::Test {
protected:
    void Run(const std::string& lines) { script_.Run(lines); }
    Written Write() {
        script_.GetOptions().onePortPerLine = false;
        return Written(script_.Verilog());
    }
    Signal* GetSignal(const char* name) { return script_.GetModel().GetSignal(name); }

    EngineScript script_;
};

/// Whether no line occurs twice.
bool AreDistinct(const Lines& lines) {
    return std::set<std::string>(lines.begin(), lines.end()).size() == lines.size();
}

Lines Sorted(Lines lines) {
    std::sort(lines.begin(), lines.end());
    return lines;
}

} // namespace

// When one is made

TEST_F(WrittenDummySignals, AnOutputPortThatIsOnlyDrivenNeedsNone) {
    Run("ADD PORT A Input\nADD PORT Y Output\n" + Inverters({"U1 A Y"}));
    const Written written = Write();
    EXPECT_TRUE(written.wires.empty());
    EXPECT_TRUE(written.assigns.empty());
}

TEST_F(WrittenDummySignals, AnOutputPortThatIsReadGetsOne) {
    Run("ADD PORT Y Output\n" + Inverters({"U1 A Y", "U2 Y B"}));
    const Written written = Write();
    EXPECT_EQ(written.wires, (Lines{"wire A;", "wire B;", "wire Y_DUMMY;"}));
    EXPECT_EQ(written.assigns, (Lines{"assign Y = Y_DUMMY;"}));
    EXPECT_EQ(written.instances, (Lines{"U1 (.I(A), .O(Y_DUMMY));", "U2 (.I(Y_DUMMY), .O(B));"}));
}

TEST_F(WrittenDummySignals, AnInputPortThatIsDrivenGetsOneThatItDrives) {
    Run("ADD PORT A Input\n" + Inverters({"U1 B A", "U2 A C"}));
    const Written written = Write();
    EXPECT_EQ(written.wires, (Lines{"wire B;", "wire C;", "wire A_DUMMY;"}));
    EXPECT_EQ(written.assigns, (Lines{"assign A_DUMMY = A;"}));
    EXPECT_EQ(written.instances, (Lines{"U1 (.I(B), .O(A_DUMMY));", "U2 (.I(A_DUMMY), .O(C));"}));
}

TEST_F(WrittenDummySignals, ADriverThatWasMovedAwayDoesNotCount) {
    Run("ADD PORT Y Output\n" + Inverters({"U1 A Y", "U2 A Y"}) + "CONNECT SIGNAL Z U2.O");
    EXPECT_TRUE(Write().assigns.empty());
}

TEST_F(WrittenDummySignals, ABitThatIsReadGivesTheWholeBusOne) {
    Run("ADD PORT Q(3:0) Output\n" + Inverters({"U1 A Q(0)", "U2 Q(0) Q(1)"}) +
        "CONNECT SIGNAL Q(3:2) C,D");
    const Written written = Write();
    EXPECT_EQ(written.wires, (Lines{"wire A;", "wire C;", "wire D;", "wire [3:0] Q_DUMMY;"}));
    EXPECT_EQ(Sorted(written.assigns),
              (Lines{"assign Q[3:0] = Q_DUMMY[3:0];", "assign Q_DUMMY[3:2] = {C, D};"}));
    EXPECT_EQ(written.instances,
              (Lines{"U1 (.I(A), .O(Q_DUMMY[0]));", "U2 (.I(Q_DUMMY[0]), .O(Q_DUMMY[1]));"}));
}

TEST_F(WrittenDummySignals, ABitOfTwoDriversGivesTheWholeBusOne) {
    Run("ADD PORT Q(3:0) Output\n" + Inverters({"U1 A Q(0)", "U2 A Q(0)", "U3 A Q(1)"}));
    EXPECT_EQ(Write().instances,
              (Lines{"U1 (.I(A), .O(Q_DUMMY[0]));", "U2 (.I(A), .O(Q_DUMMY[0]));",
                     "U3 (.I(A), .O(Q_DUMMY[1]));"}));
}

TEST_F(WrittenDummySignals, AreMadeInTheOrderOfTheSetOfNames) {
    // Three names of one hash value: of a bucket the first stands first, the others in reverse.
    Run("ADD PORT Az Output\nADD PORT BY Output\nADD PORT C8 Output\nADD PORT Y Output\n"
        "ADD PORT Q Output\n" +
        Inverters({"U1 Az N", "U2 BY N", "U3 C8 N", "U4 Y N", "U5 Q N"}));
    const Lines all = Write().wires;
    const auto position = [&](const char* line) {
        return std::find(all.begin(), all.end(), line) - all.begin();
    };
    EXPECT_LT(position("wire Az_DUMMY;"), position("wire C8_DUMMY;"));
    EXPECT_LT(position("wire C8_DUMMY;"), position("wire BY_DUMMY;"));
    EXPECT_LT(position("wire Q_DUMMY;"), position("wire Y_DUMMY;"));
    EXPECT_EQ(all.size(), 6u);
}

// When none can be made

TEST_F(WrittenDummySignals, APortThatIsNamedLikeOneIsLeftAlone) {
    Run("ADD PORT Y_dummy Output\nADD PORT Q_DUMMY(1:0) Output\n" +
        Inverters({"U1 A Y_dummy", "U2 Y_dummy B", "U3 A Q_DUMMY(0)", "U4 Q_DUMMY(0) B"}));
    const Written written = Write();
    EXPECT_TRUE(written.assigns.empty());
    EXPECT_EQ(written.wires, (Lines{"wire A;", "wire B;"}));
}

// What it takes over

TEST_F(WrittenDummySignals, OfABusTakesThoseOfItsBitsAndSlices) {
    Run("ADD PORT Q(3:0) Output\n" + Inverters({"U1 Q(3) B"}) +
        "CONNECT SIGNAL Q(0) N\nASSIGN CONSTANT Q(2:1) 2:B:10\nCONNECT SIGNAL Q(3) M");
    EXPECT_EQ(Sorted(Write().assigns),
              (Lines{"assign Q[3:0] = Q_DUMMY[3:0];", "assign Q_DUMMY[0] = N;",
                     "assign Q_DUMMY[2:1] = 2'b10;", "assign Q_DUMMY[3] = M;"}));
}

TEST_F(WrittenDummySignals, HasNoAttributeCommentOrPolarity) {
    Run("ADD PORT Y Output\nADD SIGNAL COMMENT Y of the port\nADD SIGNAL ATTRIBUTE Y LOC P1\n"
        "SET SIGNAL ATTRIBUTE OPTION Y LOC -SYNATTR=ASSIGN\n" +
        Inverters({"U1 Y B"}));
    const std::string text = Write().text;
    EXPECT_EQ(LinesThatBegin(text, "// "),
              (Lines{"// of the port", "// synthesis attribute LOC of Y is \"P1\""}));
    EXPECT_FALSE(GetSignal("Y_DUMMY")->IsPort());
}

// Writing again

TEST_F(WrittenDummySignals, NothingIsMadeTwice) {
    Run("ADD PORT Y Output\nADD PORT Q(3:0) Output\nADD PORT A Input\n" +
        Inverters({"U1 N Y", "U2 Y Q(0)", "U3 Q(0) A", "U4 A Q(1)", "U5 N Q(1)"}) +
        "CONNECT SIGNAL Y,Q(1:0) X");
    const Written first = Write();
    for (int i = 0; i < 3; ++i) {
        script_.Vhdl();
        const Written again = Write();
        EXPECT_EQ(Sorted(again.wires), Sorted(first.wires));
        EXPECT_EQ(Sorted(again.assigns), Sorted(first.assigns));
        EXPECT_EQ(Sorted(again.instances), Sorted(first.instances));
    }
    EXPECT_TRUE(AreDistinct(first.wires));
    EXPECT_TRUE(AreDistinct(first.assigns));
}

TEST_F(WrittenDummySignals, AreSortedInByTheNextWrite) {
    const std::string design = "ADD PORT A Output\n" + Inverters({"U1 n A", "U2 A zz"});
    for (const bool vhdl : {false, true}) {
        EngineScript script(design);
        const auto write = [&] { return vhdl ? script.Vhdl() : script.Verilog(); };
        const auto signals = [&](const std::string& text) {
            Lines names;
            for (const std::string& line : LinesThatBegin(text, vhdl ? "signal " : "wire ")) {
                const std::size_t start = line.find(' ') + 1;
                names.push_back(line.substr(start, line.find_first_of(" ;", start) - start));
            }
            return names;
        };
        const std::string first = write();
        const std::string second = write();
        EXPECT_EQ(signals(first), (Lines{"n", "zz", "A_DUMMY"}));
        EXPECT_EQ(signals(second), (Lines{"A_DUMMY", "n", "zz"}));
        EXPECT_EQ(Support::SortedLines(second), Support::SortedLines(first));
        EXPECT_EQ(write(), second) << "nothing is left to be sorted in";
    }
}

TEST_F(WrittenDummySignals, ALaterBitOfTheBusGetsItsOwn) {
    Run("ADD PORT Q(3:0) Output\n" + Inverters({"U1 A Q(0)", "U2 Q(0) B"}));
    Write();
    Run("ADD INSTANCE INV U3\nCONNECT SIGNAL B U3.I\nCONNECT SIGNAL Q(1) U3.O\n"
        "CONNECT SIGNAL Q(3:2) C,D");
    const Written written = Write();
    EXPECT_EQ(written.instances,
              (Lines{"U1 (.I(A), .O(Q_DUMMY[0]));", "U2 (.I(Q_DUMMY[0]), .O(B));",
                     "U3 (.I(B), .O(Q_DUMMY[1]));"}));
    EXPECT_EQ(Sorted(written.assigns),
              (Lines{"assign Q[3:0] = Q_DUMMY[3:0];", "assign Q_DUMMY[3:2] = {C, D};"}));
}

TEST_F(WrittenDummySignals, AWidenedPortIsStillWrittenOnce) {
    Run("ADD PORT Q(1:0) Output\n" + Inverters({"U1 A Q(0)", "U2 Q(0) B"}));
    Write();
    Run("CONNECT SIGNAL Q(3:0) X");
    for (int i = 0; i < 2; ++i) {
        const Written written = Write();
        EXPECT_TRUE(AreDistinct(written.wires)) << written.text;
        EXPECT_TRUE(AreDistinct(written.assigns)) << written.text;
        EXPECT_EQ(LinesThatBegin(written.text, "output"), (Lines{"output [3:0] Q;"}));
    }
}

TEST_F(WrittenDummySignals, ARenamedOneIsNotMadeAgain) {
    Run("ADD PORT Y Output\nADD PORT Q(1:0) Output\n" +
        Inverters({"U1 A Y", "U2 Y B", "U3 A Q(0)", "U4 Q(0) B"}) + "LOWERCASE signal");
    Write();
    for (int i = 0; i < 2; ++i) {
        const Written written = Write();
        EXPECT_EQ(Sorted(written.wires),
                  (Lines{"wire [1:0] q_dummy;", "wire a;", "wire b;", "wire y_dummy;"}));
        EXPECT_EQ(Sorted(written.assigns),
                  (Lines{"assign q[1:0] = q_dummy[1:0];", "assign y = y_dummy;"}));
        Run(i == 0 ? "UPPERCASE siganl\nLOWERCASE signal" : "NOOP");
        script_.Vhdl();
    }
}

TEST_F(WrittenDummySignals, TwoWritersAgreeOnThem) {
    Run("ADD PORT Y Output\nADD PORT Q(1:0) Output\n" +
        Inverters({"U1 A Y", "U2 Y B", "U3 A Q(0)", "U4 Q(0) B"}));
    const std::string vhdl = script_.Vhdl();
    EXPECT_EQ(LinesThatBegin(vhdl, "signal "),
              (Lines{"signal A            : std_logic;", "signal B            : std_logic;",
                     "signal Q_DUMMY      : std_logic_vector (1 downto 0);",
                     "signal Y_DUMMY      : std_logic;"}));
    EXPECT_EQ(LinesThatBegin(vhdl, "Y <="), (Lines{"Y <= Y_DUMMY;"}));
    EXPECT_EQ(LinesThatBegin(vhdl, "Q("), (Lines{"Q(1 downto 0) <= Q_DUMMY(1 downto 0);"}));
    EXPECT_EQ(Sorted(Write().assigns),
              (Lines{"assign Q[1:0] = Q_DUMMY[1:0];", "assign Y = Y_DUMMY;"}));
}
