// Names that the caller of a reader does not keep.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace {

using Orn_Hdl::VerilogReader;
using Support::TextReader;

/// KIND OLD NEW for each renaming, with ";" behind it.
std::string RenamingsOf(const TextReader& reader) {
    constexpr const char* Kinds[] = {"module", "component", "pin", "signal", "instance"};
    std::string text;
    for (const VerilogReader::Renaming& renaming : reader.reader.GetRenamings()) {
        text.append(Kinds[static_cast<int>(renaming.kind)]).append(" ");
        text.append(renaming.component).append(renaming.component.empty() ? "" : ".");
        text.append(renaming.name).append(" ").append(renaming.newName).append(";");
    }
    return text;
}

TEST(KeptNames, AreTheOnlyOnesThatStay) {
    TextReader reader;
    reader.reader.SetKeptNames([](std::string_view name) {
        return name != "top" && name != "signal" && name != "C" && name != "in" && name != "u" &&
               name != "in_2";
    });
    reader.Read("module C(input in, output [1:0] signal); endmodule\n"
                "module top(input signal, output [1:0] in); C u(.in(signal), .signal(in)); "
                "endmodule");
    EXPECT_EQ(RenamingsOf(reader),
              "module top top_2;pin C_2.in in_3;pin C_2.signal signal_2;component C C_2;"
              "signal signal signal_2;signal in in_3;instance u u_2;");
    EXPECT_NE(reader.model.GetInstance("u_2"), nullptr);
}

TEST(KeptNames, MayBeNone) {
    TextReader reader;
    reader.reader.SetKeptNames([](std::string_view) { return false; });
    reader.Read("module m(input a); INV u(.I(a)); endmodule");
    EXPECT_EQ(reader.model.GetNetlist()->GetSignal("a"), nullptr);
}

TEST(KeptNames, TellTheKindOfEachRenaming) {
    TextReader reader;
    reader.Read("module \\B.x (input \\i.x ); endmodule\n"
                "module \\m.x (input \\a.x ); \\B.x \\u.x (.\\i.x (\\a.x )); endmodule");
    EXPECT_EQ(RenamingsOf(reader), "module m.x m_x;pin B_x.i.x i_x;component B.x B_x;"
                                   "signal a.x a_x;instance u.x u_x;");
}

TEST(KeptNames, AreAskedForInVhdlToo) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(
        folder / "top.vhd",
        "entity top is port (reg : in bit); end;\n"
        "architecture s of top is component C port (I : in bit); end component;\n"
        "begin u : C port map (I => reg); end;\n");
    Orn_Hdl::CommandFactory factory;
    Orn_Hdl::Model model(&factory);
    Orn_Hdl::VhdlReader reader;
    reader.SetKeptNames([](std::string_view name) { return name != "reg"; });
    reader.Read((folder / "top.vhd").c_str(), model);
    EXPECT_EQ(model.GetSignal("reg"), nullptr);
    EXPECT_NE(model.GetSignal("reg_2"), nullptr);
}

TEST(ReadComponents, TakesEntitiesAndThePackagesComponents) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "cells.vhd",
                            "entity E is generic (N : integer := 3); port (A : inout bit); end;\n"
                            "package p is component C port (D : in bit_vector(0 to 3)); "
                            "end component; end;\n");
    Orn_Hdl::Netlist netlist;
    Orn_Hdl::VhdlReader::ReadComponents((folder / "cells.vhd").c_str(), netlist);
    ASSERT_NE(netlist.GetComponent("E"), nullptr);
    EXPECT_EQ(netlist.GetComponent("E")->GetPin("A")->GetPolarity(),
              Orn_Hdl::Polarity::BiDirectional);
    EXPECT_EQ(netlist.GetComponent("E")->GetAttr("N")->GetValueString(), "3");
    ASSERT_NE(netlist.GetComponent("C"), nullptr);
    EXPECT_NE(netlist.GetComponent("C")->GetPin("D(0:3)"), nullptr);
    const std::string missing = Support::FailureOf(
        [&netlist] { Orn_Hdl::VhdlReader::ReadComponents("/no/such/file.vhd", netlist); });
    EXPECT_NE(missing, "");
}

} // namespace
