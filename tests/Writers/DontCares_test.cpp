// Constants with don't cares in both languages: as they are written, checked, proven and read back.
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Orn_Hdl/Proof.h"
#include "Orn_Hdl/Readers.h"
#include "Support/NetlistText.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Orn_Hdl {
namespace {

using Lines = std::vector<std::string>;

/// A model without constants, to which each test adds some.
class DontCaresTest : public ::testing::Test {
protected:
    DontCaresTest() : model_(&factory_) {
        Do(model_, {"SET NETLIST NAME top", "SUPPRESS CONFIGURATION true", "ADD PORT a input"});
        model_.GetOptions()->writeHeader = false;
        model_.GetOptions()->dontCares = true;
    }

    static void Do(Model& model, const std::vector<const char*>& lines) {
        for (const char* line : lines) {
            model.Execute(line);
        }
    }
    void Do(const std::vector<const char*>& lines) { Do(model_, lines); }

    std::string Path(Language language) const {
        return folder_ / (language == Language::Vhdl ? "top.vhd" : "top.v");
    }
    /// Writes a netlist into a file. \return its assignments.
    Lines Write(Language language) { return Write(model_, language); }
    Lines Write(Model& model, Language language) const {
        TextMemOutStream out;
        if (language == Language::Vhdl) {
            VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
        } else {
            VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        }
        const std::string text(out.GetValue().GetView());
        Support::WriteWholeFile(Path(language), text);
        if (language == Language::Verilog) {
            return Support::LinesThatBegin(text, "assign ");
        }
        Lines found;
        for (const std::string& line : Support::SplitLines(text)) {
            const std::size_t first = line.find_first_not_of(' ');
            if (line.find(" <= ") != std::string::npos) {
                found.push_back(line.substr(first));
            }
        }
        return found;
    }
    /// What the proof finds in the file that was written last.
    Lines Prove(Language language, Model& model) const {
        Lines messages;
        for (const Proof::Difference& difference : Proof::Compare(
                 Path(language).c_str(), language, *model.GetNetlist(), *model.GetOptions())) {
            messages.push_back(difference.message);
        }
        return messages;
    }
    Lines Check() {
        Lines rules;
        for (const Check::Finding& finding :
             Check::Run(*model_.GetNetlist(), *model_.GetOptions())) {
            rules.emplace_back(std::string(finding.rule->name) + ": " + finding.message);
        }
        return rules;
    }
    /// Writes both netlists, which have these assignments and mean what the design does.
    void Expect(const Lines& verilog, const Lines& vhdl) {
        EXPECT_EQ(Write(Language::Verilog), verilog);
        EXPECT_EQ(Prove(Language::Verilog, model_), Lines());
        EXPECT_EQ(Write(Language::Vhdl), vhdl);
        EXPECT_EQ(Prove(Language::Vhdl, model_), Lines());
    }
    /// Reads the file that was written last, and writes it again.
    template <class Reader> Lines ReadBack(Language language) {
        Model model(&factory_);
        Reader reader;
        reader.KeepDontCares(true);
        reader.AddLibrary(*model_.GetNetlist());
        reader.Read(Path(language).c_str(), model);
        EXPECT_TRUE(model.GetOptions()->dontCares);
        model.GetOptions()->writeHeader = false;
        const Lines written = Write(model, language);
        EXPECT_EQ(Prove(language, model), Lines());
        return written;
    }

    CommandFactory factory_;
    Model model_;
    Support::TemporaryFolder folder_;
};

TEST_F(DontCaresTest, ConstantsOfOneBit) {
    Do({"ADD PORT y output", "ADD PORT q(3:0) output", "ASSIGN CONSTANT y -",
        "ASSIGN CONSTANT q(3) 1:B:-", "ASSIGN CONSTANT q(2) 0", "ASSIGN CONSTANT q(1) 1",
        "ASSIGN CONSTANT q(0) 01-"});
    Expect({"assign q[0] = 1'bx;", "assign q[1] = 1;", "assign q[2] = 0;", "assign q[3] = 1'bx;",
            "assign y = 1'bx;"},
           {"q(0) <= '-';", "q(1) <= '1';", "q(2) <= '0';", "q(3) <= '-';", "y <= '-';"});
}

TEST_F(DontCaresTest, ConstantsOfBuses) {
    Do({"ADD PORT b(7:0) output", "ADD PORT h(7:0) output", "ADD PORT o(5:0) output",
        "ADD PORT p(3:0) output", "ADD PORT w(0:0) output", "ASSIGN CONSTANT b(7:0) 8:B:1010_----",
        "ASSIGN CONSTANT h(7:0) 8:H:-F", "ASSIGN CONSTANT o(5:0) 6:O:-5",
        "ASSIGN CONSTANT p(3:0) 10-1", "ASSIGN CONSTANT w(0:0) -"});
    Expect({"assign b = 8'b1010_xxxx;", "assign h = 8'hxF;", "assign o = 6'ox5;",
            "assign p = 4'b10x1;", "assign w = 1'bx;"},
           {"b(7 downto 0) <= \"1010----\";", "h(7 downto 0) <= \"----1111\";",
            "o(5 downto 0) <= \"---101\";", "p(3 downto 0) <= \"10-1\";",
            "w(0 downto 0) <= \"-\";"});
    EXPECT_EQ(Check(), Lines());
}

TEST_F(DontCaresTest, ConstantsOfPartsOfBuses) {
    Do({"ADD PORT d(7:0) output", "ADD PORT u(0:7) output", "ASSIGN CONSTANT d(7:4) 4:B:0--1",
        "ASSIGN CONSTANT d(3:3) -", "ASSIGN CONSTANT d(0:2) -01", "ASSIGN CONSTANT u(0:3) 4:H:-",
        "ASSIGN CONSTANT u(4) -", "ASSIGN CONSTANT u(5:5) 1:B:-", "ASSIGN CONSTANT u(6:7) 1-"});
    const Lines verilog = Write(Language::Verilog);
    for (const char* line :
         {"assign d[7:4] = 4'b0xx1;", "assign d[3:3] = 1'bx;",
          "assign {d[0], d[1], d[2]} = 3'bx01;", "assign u[0:3] = 4'hx;", "assign u[4] = 1'bx;",
          "assign u[5:5] = 1'bx;", "assign u[6:7] = 2'b1x;"}) {
        EXPECT_EQ(std::count(verilog.begin(), verilog.end(), line), 1) << line;
    }
    EXPECT_EQ(verilog.size(), 7U);
    EXPECT_EQ(Prove(Language::Verilog, model_), Lines());
    const Lines vhdl = Write(Language::Vhdl);
    for (const char* line :
         {"d(7 downto 4) <= \"0--1\";", "d(3 downto 3) <= \"-\";", "d(0) <= '-';", "d(1) <= '0';",
          "d(2) <= '1';", "u(0 to 3) <= \"----\";", "u(4) <= '-';", "u(5) <= '-';",
          "u(6 to 7) <= \"1-\";"}) {
        EXPECT_EQ(std::count(vhdl.begin(), vhdl.end(), line), 1) << line;
    }
    EXPECT_EQ(vhdl.size(), 9U);
    EXPECT_EQ(Prove(Language::Vhdl, model_), Lines());
}

TEST_F(DontCaresTest, ConstantsOfCompounds) {
    Do({"ADD SIGNAL x", "ADD SIGNAL y(1:0)", "ASSIGN CONSTANT x,y(1:0) 3:B:-1-"});
    Expect({"assign {x, y[1:0]} = 3'bx1x;"}, {"x <= '-';", "y(1) <= '1';", "y(0) <= '-';"});
}

TEST_F(DontCaresTest, ConstantsOfPins) {
    Do({"ADD COMPONENT G", "ADD PIN G i input", "ADD PIN G v(2:0) input", "ADD INSTANCE G u",
        "CONNECT SIGNAL a u.i", "ASSIGN CONSTANT u.v(2:0) 3:B:--0"});
    Expect({"assign u_v_CONST_SIGNAL = 3'bxx0;"}, {"u_v_CONST_SIGNAL(2 downto 0) <= \"--0\";"});
}

TEST_F(DontCaresTest, WithoutTheOptionDigitsStandAsTheyAre) {
    Do({"ADD PORT y output", "ADD PORT b(3:0) output", "ADD PORT p(3:0) output",
        "ASSIGN CONSTANT y -", "ASSIGN CONSTANT b(3:0) 4:B:1--0", "ASSIGN CONSTANT p(3:0) 10-1"});
    model_.GetOptions()->dontCares = false;
    EXPECT_EQ(Write(Language::Verilog),
              (Lines{"assign b = 4'b1--0;", "assign p = 10-1;", "assign y = 1;"}));
    EXPECT_EQ(Write(Language::Vhdl),
              (Lines{"b(3 downto 0) <= b\"1--0\";", "p(3 downto 0) <= \"10-1\";", "y <= '1';"}));
    EXPECT_NE(Prove(Language::Vhdl, model_), Lines());
}

/// A text that is no number but for its "-" has no don't care.
TEST_F(DontCaresTest, OtherTextsStandAsTheyAre) {
    Do({"ADD PORT p(3:0) output", "ADD PORT q(3:0) output", "ASSIGN CONSTANT p(3:0) -5",
        "ASSIGN CONSTANT q(3:0) 4:B:1-2-"});
    EXPECT_EQ(Write(Language::Verilog), (Lines{"assign p = -5;", "assign q = 4'b1-2-;"}));
    EXPECT_EQ(Write(Language::Vhdl),
              (Lines{"p(3 downto 0) <= \"-5\";", "q(3 downto 0) <= b\"1-2-\";"}));
}

TEST_F(DontCaresTest, LegalNetlistMendsTheWidth) {
    Do({"ADD PORT p(7:0) output", "ASSIGN CONSTANT p(7:0) 8:H:-"});
    EXPECT_EQ(Check(), Lines{"constant-width: the constant \"-\" has 4 bits in VHDL, \"p(7:0)\" "
                             "has 8"});
    model_.GetOptions()->legal = true;
    EXPECT_EQ(Write(Language::Verilog), Lines{"assign p = 8'bxxxxxxxx;"});
    EXPECT_EQ(Write(Language::Vhdl), Lines{"p(7 downto 0) <= \"--------\";"});
}

TEST_F(DontCaresTest, ProofTellsThemFromOtherConstants) {
    Do({"ADD PORT p(3:0) output", "ASSIGN CONSTANT p(3:0) 4:B:10--"});
    Write(Language::Verilog);
    Write(Language::Vhdl);
    Do({"ASSIGN CONSTANT p(3:0) 4:B:100-"});
    EXPECT_EQ(Prove(Language::Verilog, model_),
              Lines{"the netlist has p[3:0] = 10xx, the design p(3:0) = 100x"});
    EXPECT_EQ(Prove(Language::Vhdl, model_),
              Lines{"the netlist has p[3:0] = 10--, the design p(3:0) = 100-"});
    // A bit of which VHDL says that it is unknown is not one that does not matter.
    Support::WriteWholeFile(Path(Language::Vhdl),
                            "library ieee; use ieee.std_logic_1164.all;\n"
                            "entity top is port (a : in std_logic; p : out std_logic_vector(3 "
                            "downto 0)); end;\narchitecture BEHAVIORAL of top is begin\n"
                            "p <= \"100X\"; end;\n");
    EXPECT_NE(Prove(Language::Vhdl, model_), Lines());
}

TEST_F(DontCaresTest, ReadersKeepThem) {
    Do({"ADD COMPONENT G", "ADD PIN G i(1:0) input", "ADD INSTANCE G u", "ADD SIGNAL c",
        "ASSIGN CONSTANT c -", "CONNECT SIGNAL c,a u.i(1:0)", "ADD PORT h(7:0) output",
        "ASSIGN CONSTANT h(7:0) 8:H:-F", "ADD PORT y output", "ASSIGN CONSTANT y -"});
    const Lines verilog = Write(Language::Verilog);
    EXPECT_EQ(ReadBack<VerilogReader>(Language::Verilog), verilog);
    const Lines vhdl = Write(Language::Vhdl);
    EXPECT_EQ(ReadBack<VhdlReader>(Language::Vhdl), vhdl);
}

TEST_F(DontCaresTest, ReadersTakeEveryForm) {
    Support::WriteWholeFile(Path(Language::Verilog),
                            "module G(input [3:0] i); endmodule\n"
                            "module top(input a, output y, output [7:0] q);\n"
                            "assign y = 1'bX; assign q[7:4] = 4'hx; assign q[3:0] = {2'bx1, "
                            "2'd0};\nG u(.i({a, 1'bx, 2'b0x}));\nendmodule\n");
    EXPECT_EQ(ReadBack<VerilogReader>(Language::Verilog),
              (Lines{"assign const_x = 1'bx;", "assign const_0 = 0;", "assign q[3:0] = 4'bx100;",
                     "assign q[7:4] = 4'hx;", "assign y = 1'bx;"}));
    Support::WriteWholeFile(
        Path(Language::Vhdl),
        "library ieee; use ieee.std_logic_1164.all;\n"
        "entity top is port (y : out std_logic; q : out std_logic_vector(3 downto 0)); end;\n"
        "architecture b of top is begin\ny <= 'X'; q <= ('1', '-', others => 'X'); end;\n");
    EXPECT_EQ(ReadBack<VhdlReader>(Language::Vhdl),
              (Lines{"q(3 downto 0) <= \"1---\";", "y <= '-';"}));
}

TEST_F(DontCaresTest, ReadersRefuseThemWhenNobodyAsks) {
    Do({"ADD PORT y output", "ASSIGN CONSTANT y -"});
    Write(Language::Verilog);
    Write(Language::Vhdl);
    Model model(&factory_);
    EXPECT_THROW(VerilogReader().Read(Path(Language::Verilog).c_str(), model), Exception);
    EXPECT_THROW(VhdlReader().Read(Path(Language::Vhdl).c_str(), model), Exception);
    EXPECT_FALSE(model.GetOptions()->dontCares);
    // A bit of high impedance is no don't care.
    Support::WriteWholeFile(Path(Language::Verilog),
                            "module top(output y); assign y = 1'bz; endmodule\n");
    VerilogReader reader;
    reader.KeepDontCares(true);
    EXPECT_THROW(reader.Read(Path(Language::Verilog).c_str(), model), Exception);
}

} // namespace
} // namespace Orn_Hdl
