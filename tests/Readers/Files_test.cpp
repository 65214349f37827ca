// Which module of which file is read: tops, libraries, included files and macros.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Orn_Hdl::VerilogReader;
using Support::TextReader;

std::string NameOf(TextReader& text) {
    return std::string(text.model.GetName().GetView());
}

TEST(VerilogTop, IsTheOnlyModuleThatNoOtherInstantiates) {
    TextReader text;
    text.Read("module a(input x); endmodule module b; wire w; a u(w); endmodule");
    EXPECT_EQ(NameOf(text), "b");
    EXPECT_NE(text.model.GetComponent("a"), nullptr);
    text.Read("module b; wire w; a u(w); endmodule module a(input x); endmodule");
    EXPECT_EQ(NameOf(text), "b");
}

TEST(VerilogTop, CanBeChosen) {
    TextReader text;
    const std::string both = "module a(input x); INV u(x); endmodule module b; a v(); endmodule";
    text.reader.SetTop("a");
    text.Read(both);
    EXPECT_EQ(NameOf(text), "a");
    EXPECT_NE(text.model.GetInstance("u"), nullptr);
    text.reader.SetTop(nullptr);
    text.Read(both);
    EXPECT_EQ(NameOf(text), "b");
    text.reader.SetTop("AND2");
    text.Read(both);
    EXPECT_EQ(NameOf(text), "AND2");
}

TEST(VerilogTop, KeepsNothingOfTheFormerDesign) {
    TextReader text;
    text.model.AddSignal("old");
    text.Read("module m(input a); endmodule");
    EXPECT_EQ(text.model.GetSignal("old"), nullptr);
    EXPECT_TRUE(text.model.IsModified());
    EXPECT_EQ(std::string(text.model.GetSourceFileName().GetView()), text.GetFileName());
}

TEST(VerilogLibrary, YieldsToTheFileAndToFormerLibraries) {
    TextReader text;
    text.Put("other.v", "module INV(input A); endmodule module NEW(input A); endmodule");
    text.reader.AddLibrary((text.GetFolder() + "/other.v").c_str());
    text.Read("module AND2(input A); endmodule module m; INV u(); AND2 v(); NEW w(); endmodule");
    EXPECT_NE(text.model.GetInstance("u")->GetPin("O"), nullptr);
    EXPECT_EQ(text.model.GetInstance("v")->GetPin("O"), nullptr);
    EXPECT_NE(text.model.GetInstance("w")->GetPin("A"), nullptr);
}

TEST(VerilogLibrary, CanBeANetlist) {
    TextReader text;
    Support::EngineScript script;
    script.Run("ADD COMPONENT BOX\nADD PIN BOX A Input\nADD PIN BOX D(7:0) Output\n"
               "ADD PIN BOX E(0:3) BiDirectional\nADD COMPONENT INV\nADD PIN INV X Input\n");
    text.reader.AddLibrary(script.GetNetlist());
    text.Read("module m; wire [7:0] w; BOX #(.ANY(1)) b(.A(w[0]), .D(w)); INV i(); endmodule");
    const Orn_Hdl::Component* const box = text.model.GetComponent("BOX");
    ASSERT_NE(box, nullptr);
    EXPECT_NE(box->GetPin("E(0:3)"), nullptr);
    EXPECT_EQ(std::string(box->GetPin("D(7:0)")->GetPolarityName()), "Output");
    EXPECT_NE(text.model.GetComponent("INV")->GetPin("I"), nullptr);
}

TEST(VerilogLibrary, HoldsTheModulesOfIncludedFiles) {
    TextReader text;
    text.Put("more.v", "module MORE(input A); endmodule\n`define HALF [3:0]\n");
    text.Read("`include \"more.v\"\nmodule m; wire `HALF w; MORE u(w[1]); endmodule");
    EXPECT_EQ(NameOf(text), "m");
    EXPECT_NE(text.model.GetSignal("w(3:0)"), nullptr);
    EXPECT_EQ(text.GetFailure("`include \"more.v\"\nmodule m; MORE u(.B()); endmodule"),
              "top.v:2:19: error: the module \"MORE\" has no port \"B\"\n"
              "module m; MORE u(.B()); endmodule\n                  ^\n");
}

TEST(VerilogIncludes, AreLookedForInFolders) {
    TextReader text;
    Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "far.v", "module FAR(input A); endmodule\nmodule ^");
    text.reader.AddIncludeFolder(folder.GetPath().c_str());
    const std::string failure = text.GetFailure("`include \"far.v\"\nmodule m; FAR u(); endmodule");
    EXPECT_EQ(failure.substr(0, failure.find('\n')),
              folder / "far.v" + std::string(":2:8: error: the name of a module is expected here, "
                                             "not \"^\""));
}

TEST(VerilogIncludes, CanBeKept) {
    TextReader text;
    text.reader.SetIncludes(VerilogReader::Includes::Keep);
    text.Read("`include \"a.v\"\n`include \"b/c.v\"\nmodule m; endmodule");
    const Orn_Hdl::StringArray& files = text.model.GetOptions()->verilog.includePaths;
    ASSERT_EQ(files.GetSize(), 2);
    EXPECT_EQ(std::string(files.GetView(0)), "a.v");
    EXPECT_EQ(std::string(files.GetView(1)), "b/c.v");
    EXPECT_EQ(text.GetFailure("module m; `include \"a.v\"\nendmodule"),
              "top.v:1:11: error: an `include inside of a module cannot be kept\n"
              "module m; `include \"a.v\"\n          ^\n");
}

TEST(VerilogMacros, AreReplaced) {
    TextReader text;
    text.reader.Define("FROM_OUTSIDE", "wire e;");
    text.Read("`define WIDTH 8 // bits\n`define RANGE [`WIDTH-1: \\\n 0]\n`define NOTHING\n"
              "module m `NOTHING ; wire `RANGE a; `FROM_OUTSIDE\n`undef NOTHING\n"
              "`ifdef NOTHING wire b; `else wire c; `endif `ifndef WIDTH wire d; `endif\n"
              "endmodule");
    EXPECT_NE(text.model.GetSignal("a(7:0)"), nullptr);
    EXPECT_EQ(text.model.GetSignal("b"), nullptr);
    EXPECT_NE(text.model.GetSignal("c"), nullptr);
    EXPECT_EQ(text.model.GetSignal("d"), nullptr);
    EXPECT_NE(text.model.GetSignal("e"), nullptr);
}

TEST(VerilogMacros, ACommentIsABlankInTheirText) {
    TextReader text;
    text.Read("`define NET wire/* of one bit */n; \nmodule top;\n`NET\nendmodule\n");
    EXPECT_NE(text.model.GetSignal("n"), nullptr);
}

TEST(VerilogMacros, ChooseOneBranch) {
    for (const char* defined : {"A", "B", "C", "D"}) {
        SCOPED_TRACE(defined);
        TextReader text;
        text.reader.Define(defined, "");
        text.Read("module m;\n`ifdef A\nwire a;\n`elsif B\nwire b; `ifdef X wire x; `else wire y;\n"
                  "`endif\n`elsif C\nwire c;\n`else\n`ifdef D\nwire d; `endif /* `endif */ \n"
                  "// `endif\n`endif\nendmodule");
        for (const char* name : {"a", "b", "c", "d"}) {
            EXPECT_EQ(text.model.GetSignal(name) != nullptr,
                      Port::EqualIgnoringCase(name, defined));
        }
        EXPECT_EQ(text.model.GetSignal("y") != nullptr, defined[0] == 'B');
    }
}

TEST(VerilogNames, StayAsTheyAreWhenAskedFor) {
    TextReader text;
    text.reader.SetNames(VerilogReader::Names::Literal);
    text.Read(
        "module m; wire \\a.b , \\c[3] , \\wire , d$e; wire [1:0] \\f.g , h$i; INV \\u/1 ();\n"
        "endmodule");
    for (const char* name : {"a.b", "wire", "d$e", "c_3", "f_g(1:0)", "h_i(1:0)"}) {
        EXPECT_NE(text.model.GetSignal(name), nullptr) << name;
    }
    EXPECT_NE(text.model.GetInstance("u/1"), nullptr);
    ASSERT_EQ(text.reader.GetRenamings().size(), 3U);
    EXPECT_EQ(text.reader.GetRenamings()[0].name, "c[3]");
    EXPECT_EQ(text.reader.GetRenamings()[0].newName, "c_3");
}

TEST(VerilogNames, AreReplacedWithoutClashes) {
    TextReader text;
    text.Read(
        "module m; wire a_b, \\a.b , \\a/b , A_B, \\7 , open, \\\xc3\xa4 ; assign \\a.b = a_b;\n"
        "assign \\a/b = \\a.b ; assign A_B = \\a/b ; endmodule");
    std::string written = text.Write();
    for (const char* line : {"assign a_b_2 = a_b;", "assign a_b_3 = a_b_2;",
                             "assign A_B_4 = a_b_3;", "wire n7;", "wire open_2;", "wire n;"}) {
        EXPECT_NE(written.find(line), std::string::npos) << line << "\n" << written;
    }
}

TEST(VerilogNames, OfNetsThatConstantsMakeGiveWay) {
    TextReader text;
    text.Read("module m; wire [1:0] v; wire x, y, const_1; assign v = {x, 1'b0}; wire const_0;\n"
              "assign const_0 = x; assign v[0] = {1'b1}; INV u(1'b1); wire u_I_CONST_SIGNAL;\n"
              "assign u_I_CONST_SIGNAL = y; endmodule");
    const std::string written = text.Write();
    for (const char* line : {"assign v[1:0] = {x, const_0};", "assign const_0_2 = x;",
                             "assign u_I_CONST_SIGNAL = 1;", "assign u_I_CONST_SIGNAL_2 = y;"}) {
        EXPECT_NE(written.find(line), std::string::npos) << line << "\n" << written;
    }
}

TEST(VerilogNames, ANameThatAnotherOneWasReplacedByCanBeDeclared) {
    TextReader text;
    text.Read("module m; wire \\a.b ; wire a_b; assign a_b = \\a.b ; endmodule");
    EXPECT_NE(text.Write().find("assign a_b_2 = a_b;"), std::string::npos);
    EXPECT_NE(text.GetFailure("module m; wire \\a.b , c; assign c = a_b; endmodule"), "");
}

} // namespace
