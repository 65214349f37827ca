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

} // namespace
