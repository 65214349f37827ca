// Modules that no file declares: their ports and the ports' directions follow from the design.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Orn_Hdl::Component;
using Orn_Hdl::Pin;
using Orn_Hdl::VerilogReader;
using Support::TextReader;

/// The pins of a component with their directions, "A in, B out".
std::string PinsOf(const TextReader& reader, const char* component) {
    std::string text;
    const Component* const found = reader.model.GetNetlist()->GetComponent(component);
    if (found == nullptr) {
        return "none";
    }
    for (const Pin* pin : found->GetPinIterator()) {
        text.append(text.empty() ? "" : ", ").append(pin->GetNameView());
        text.append(pin->GetPolarity() == Orn_Hdl::Polarity::Input ? " in" : " out");
    }
    return text;
}

class Undeclared : public testing::Test {
protected:
    Undeclared() { reader_.reader.SetUndeclared(VerilogReader::Undeclared::Infer); }

    /// What the message says of the modules; the whole message when it is another one.
    std::string GetUntold(const std::string& text) {
        const std::string failure = reader_.GetFailure(text);
        const std::string begin = "does not follow from the design: ";
        const std::size_t at = failure.find(begin);
        if (at == std::string::npos) {
            return failure;
        }
        const std::size_t from = at + begin.size();
        return failure.substr(from, failure.find(": a library") - from);
    }

    TextReader reader_;
};

TEST_F(Undeclared, HaveTheirPinsFromPortsAndEachOther) {
    reader_.Read("module m(input a, b, output y); wire n, o;\n"
                 "G1 u1(.A(a), .B(b), .Y(n)); G2 u2(.I(n), .O(o)); G2 u3(.O(y), .I(o)); endmodule");
    EXPECT_EQ(PinsOf(reader_, "G1"), "A in, B in, Y out");
    EXPECT_EQ(PinsOf(reader_, "G2"), "I in, O out");
}

TEST_F(Undeclared, HaveTheirPinsFromPartsOfBuses) {
    reader_.Read("module m(input [3:0] d, output [0:3] q); wire [7:0] n; wire w;\n"
                 "HALF u1(.I(d[3:2]), .O(n[7:4])); HALF u2(.I(d[1:0]), .O({n[3:1], w}));\n"
                 "JOIN u3(.A(n[7:1]), .B({2{w}}), .Q(q)); JOIN u4(.B(d[1:0])); INV u5(.I(w));\n"
                 "endmodule");
    EXPECT_EQ(PinsOf(reader_, "HALF"), "I(1:0) in, O(3:0) out");
    EXPECT_EQ(PinsOf(reader_, "JOIN"), "A(6:0) in, B(1:0) in, Q(3:0) out");
}

TEST_F(Undeclared, HaveTheirPinsFromKnownCells) {
    reader_.Read(
        "module m; wire a, b; INV u1(.O(a)); INV u2(.I(b)); G u3(.P(a), .Q(b)); endmodule");
    EXPECT_EQ(PinsOf(reader_, "G"), "P in, Q out");
}

TEST_F(Undeclared, HaveTheirPinsFromConstantsAndAliases) {
    reader_.Read("module m(output y); wire a, b; supply1 one; assign y = b; assign a = one;\n"
                 "G u(.A(1'b0), .B(4'h5), .C(one), .D(a), .Z(b)); endmodule");
    EXPECT_EQ(PinsOf(reader_, "G"), "A in, B(3:0) in, C in, D in, Z out");
}

TEST_F(Undeclared, GetWidthsFromTheFirstConnectionThatHasOne) {
    reader_.Read("module m #(parameter W = 1)(input [7:0] d, input c); localparam L = 5;\n"
                 "wire [L:0] w = d[L:0];\n"
                 "G u1(.A(), .B(3), .C(d[2 +: 3]), .D(w), .E((c)));\n"
                 "G u2(.A(c), .B(d[4 -: 2]), .C({c, 2'b01})); endmodule");
    EXPECT_EQ(PinsOf(reader_, "G"), "A in, B(1:0) in, C(2:0) in, D(5:0) in, E in");
}

TEST_F(Undeclared, AreConnectedByNameAlone) {
    EXPECT_EQ(reader_.GetFailure("module m(input a);\nG u(a); endmodule"),
              "top.v:2:5: error: the module \"G\" is not declared, and a connection by position "
              "does not name its port: a library file has to declare it\n"
              "G u(a); endmodule\n    ^\n");
    reader_.Read("module m(input a);\nG u(.a); H v(); endmodule");
    EXPECT_EQ(PinsOf(reader_, "G"), "a in");
    EXPECT_EQ(PinsOf(reader_, "H"), "");
}

TEST_F(Undeclared, AreTheSameInAllInstances) {
    EXPECT_EQ(
        reader_.GetFailure("module m(input [1:0] a);\nG u(.I(a));\nG v(.I(a[0])); endmodule"),
        "top.v:3:6: error: the port \"I\" of \"G\" has 2 bits in an earlier connection, and 1 "
        "are connected to it\nG v(.I(a[0])); endmodule\n     ^\n");
}

TEST_F(Undeclared, AreListedWhenTheyStayOpen) {
    EXPECT_EQ(
        reader_.GetFailure("module m(input a);\nwire n;\nG u(.I(a), .P(n)); INV v();\n"
                           "H w(.Q(n)); endmodule"),
        "top.v:3:1: error: modules that are not declared, with ports whose direction does not "
        "follow from the design: \"G\" (P), \"H\" (Q): a library file has to declare them\n"
        "G u(.I(a), .P(n)); INV v();\n^\n");
    // Nothing reads the net.
    EXPECT_EQ(GetUntold("module m; wire n; G u(.O(n)); endmodule"), "\"G\" (O)");
    // A bidirectional port may drive, or not.
    EXPECT_EQ(GetUntold("module m(inout p, output q); G u(.O(p), .Q(q)); endmodule"), "\"G\" (O)");
    EXPECT_EQ(GetUntold("module m(inout p); wire n; UP u(.P(n)); G v(.O(n)); endmodule"),
              "\"G\" (O)");
    // Two pins, of which one drives.
    EXPECT_EQ(GetUntold("module m(output q); G u(.A(q), .B(q)); endmodule"), "\"G\" (A, B)");
    EXPECT_EQ(GetUntold("module m(input a); G u(.A(), .B(3), .C(a)); endmodule"),
              "\"G\" (A, A of unknown width, B of unknown width)");
}

TEST_F(Undeclared, AreListedWhenTheyContradictThemselves) {
    // An input here, what drives a port there.
    EXPECT_EQ(GetUntold("module m(input a, output q); G u(.P(a)); G v(.P(q)); endmodule"),
              "\"G\" (P in both directions)");
    EXPECT_EQ(GetUntold("module m(input a, output q); G v(.P(q)); G u(.P(a)); endmodule"),
              "\"G\" (P in both directions)");
    // Two outputs on one net.
    EXPECT_EQ(GetUntold("module m(output p, q); wire n; INV i(.I(n)); G u(.O(p)); G v(.O(n));\n"
                        "G w(.O(n)); endmodule"),
              "\"G\" (O in both directions)");
    // A bit of a bus alone.
    EXPECT_EQ(GetUntold("module m(output [1:0] q, output x); G u(.O(q)); H v(.Z(q[1]));\n"
                        "H w(.Z(x)); endmodule"),
              "\"H\" (Z in both directions)");
}

TEST_F(Undeclared, AreNoneOfOtherFiles) {
    reader_.Put("lib.v", "module G(input I, inout P); endmodule");
    reader_.reader.AddLibrary((reader_.GetFolder() + "/lib.v").c_str());
    reader_.Read("module m(inout p); wire n; G u(n, p); endmodule");
    EXPECT_EQ(reader_.model.GetNetlist()->GetComponent("G")->GetPin("P")->GetPolarity(),
              Orn_Hdl::Polarity::BiDirectional);
}

TEST_F(Undeclared, DeclareTheirParameters) {
    reader_.Read("module m(input a); G #(.N(3), .S(\"x\"), .B(4'h9)) u(.I(a)); endmodule");
    const Component& component = *reader_.model.GetNetlist()->GetComponent("G");
    EXPECT_EQ(component.GetAttr("N")->GetValueString(), "0");
    EXPECT_EQ(component.GetAttr("S")->GetValueString(), "");
    EXPECT_EQ(component.GetAttr("B")->GetValueString(), "0000");
}

TEST_F(Undeclared, LeaveParametersToTheirModulesWhereNothingSetsThem) {
    reader_.Read("module m(input a); G #(.N(3)) u(.I(a)); G v(.I(a)); endmodule");
    const std::string text = reader_.Write();
    EXPECT_NE(text.find("defparam u.N = 3;"), std::string::npos) << text;
    EXPECT_EQ(text.find("defparam v"), std::string::npos) << text;
}

TEST_F(Undeclared, LeaveOtherMistakesToTheirPlaces) {
    EXPECT_EQ(reader_.GetFailure("module m(input a); G u(.I(a[9:])); endmodule").substr(0, 36),
              "top.v:1:27: error: \"a\" is a net of o");
    EXPECT_NE(reader_.GetFailure("module m(input a); G u(.I(a)"), "");
    EXPECT_NE(reader_.GetFailure("module m(input a); G #( u(.I(a)); endmodule"), "");
    EXPECT_NE(reader_.GetFailure("module m(input a); G u(.*); endmodule"), "");
    EXPECT_NE(reader_.GetFailure("module m(input a); G u[3:0](.I(a)); endmodule"), "");
    EXPECT_NE(reader_.GetFailure("module m(input a); G u(.I({2{{a}})); endmodule"), "");
}

} // namespace
