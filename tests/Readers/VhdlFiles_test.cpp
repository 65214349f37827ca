// Which units of which files the VHDL reader reads, and what of them a model keeps.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using Orn_Hdl::Attribute;
using Support::VhdlTextReader;

std::string ArchitectureOf(const std::string& entity, const std::string& name,
                           const std::string& statements, const std::string& declarations = "") {
    return "architecture " + name + " of " + entity + " is " + declarations + " begin " +
           statements + " end " + name + ";\n";
}

std::vector<std::string> TextsOf(const Orn_Hdl::StringArray& array) {
    std::vector<std::string> texts;
    for (int i = 0; i < array.GetSize(); ++i) {
        texts.emplace_back(array.GetView(i));
    }
    return texts;
}

/// The lines of an object's comment with "/" between them.
std::string CommentOf(const Orn_Hdl::Object* object) {
    std::string text;
    for (const std::string& line :
         Support::SplitLines(std::string(object->GetComment().GetView()))) {
        text += (text.empty() || line.empty() ? "" : "/") + line;
    }
    return text;
}

TEST(VhdlFiles, TheEntityThatNoOtherInstantiatesIsRead) {
    VhdlTextReader text;
    text.Read("entity leaf is port (a : in bit); end;\n" + ArchitectureOf("leaf", "a", "") +
              "entity top is end;\n" +
              ArchitectureOf("top", "a",
                             "u : leaf port map (s); v : entity work.LEAF port map (s);",
                             "component leaf port (a : in bit); end component; signal s : bit;"));
    EXPECT_EQ(text.model.GetNetlist()->GetNameView(), "top");
    EXPECT_EQ(text.model.GetInstance("v")->GetComponent(),
              text.model.GetInstance("u")->GetComponent());
}

TEST(VhdlFiles, TheTopAndItsArchitectureCanBeChosen) {
    const std::string file = "entity e is end;\n" +
                             ArchitectureOf("e", "one", "", "signal s1 : bit;") +
                             ArchitectureOf("e", "two", "", "signal s2 : bit;") +
                             "entity f is end;\n" + ArchitectureOf("f", "one", "");
    VhdlTextReader text;
    text.reader.SetTop("E");
    text.Read(file);
    EXPECT_NE(text.model.GetSignal("s2"), nullptr);
    text.reader.SetTop("e(ONE)");
    text.Read(file);
    EXPECT_NE(text.model.GetSignal("s1"), nullptr);
    EXPECT_EQ(text.model.GetSignal("s2"), nullptr);
    text.reader.SetTop("e(three)");
    const std::string failure = text.GetFailure(file);
    EXPECT_EQ(failure.substr(0, failure.find('\n')),
              "top.vhd:1:8: error: the entity \"e\" has no architecture \"three\" in this file");
}

TEST(VhdlFiles, AnArchitectureMayNameItsEntityInOtherLetterCase) {
    VhdlTextReader text;
    text.Read("entity top is port (a : in bit); end;\n" + ArchitectureOf("TOP", "rtl", ""));
    EXPECT_NE(text.model.GetSignal("a"), nullptr);
}

TEST(VhdlFiles, AGenericThatIsATypeMayBeTheLast) {
    VhdlTextReader text;
    text.Put("box.vhd", "package boxes is component BOX generic (N : integer := 1; type T); "
                        "port (I : in bit); end component; end package;\n");
    text.reader.AddLibrary(text.GetPath("box.vhd").c_str());
    text.Read("entity top is port (a : in bit); end;\n" +
              ArchitectureOf("top", "rtl", "u : BOX port map (a);"));
    EXPECT_NE(text.model.GetInstance("u"), nullptr);
}

TEST(VhdlFiles, OtherGenericsThanThosePortsDependOnCanBeGiven) {
    VhdlTextReader text;
    text.Put("box.vhd", "entity BOX is generic (W : integer := 4; NAME : string := \"x\"); "
                        "port (I : in bit_vector(W - 1 downto 0)); end;\n");
    text.reader.AddLibrary(text.GetPath("box.vhd").c_str());
    const auto design = [](const std::string& generics) {
        return "entity top is port (a : in bit_vector(3 downto 0)); end;\n" +
               ArchitectureOf("top", "rtl",
                              "u : entity work.BOX generic map (" + generics + ") port map (a);");
    };
    text.Read(design("W => 4, NAME => \"y\""));
    EXPECT_EQ(text.model.GetInstance("u")->GetAttr("NAME")->GetValueString(), "y");
    EXPECT_NE(text.GetFailure(design("W => 5")).find("depends on this generic"), std::string::npos);
}

TEST(VhdlFiles, WhatBehavesElsewhereIsPassedOver) {
    VhdlTextReader text;
    text.Put("lib.vhd", R"(
package p is
  type state is (idle, run);
  type r is record a : bit; end record;
  function f(a : bit; b : bit := '1') return bit;
  procedure g(signal a : in bit);
  constant c : integer;
  component CELL port (A : in bit; Q : out bit); end component;
end p;
package body p is
  function f(a : bit; b : bit := '1') return bit is
    variable v : bit;
  begin
    if a = '1' then return b; end if;
    for i in 0 to 3 loop v := a; end loop;
    case v is when '0' => null; when others => null; end case;
    return ';';
  end f;
  procedure g(signal a : in bit) is begin null; end;
end package body;
entity BOX is
  port (A : in bit; Q : out bit);
begin
  assert A = '0';
end BOX;
architecture rtl of BOX is
  signal n : bit := '0';
begin
  process (A) begin
    if A'event and A = '1' then n <= A; end if;
  end process;
  g1 : for i in 0 to 1 generate
    x : CELL port map (A, n);
  end generate;
  k : block begin Q <= n; end block;
end rtl;
)");
    text.reader.AddLibrary(text.GetPath("lib.vhd").c_str());
    text.Read("use work.p.all; entity t is end;" +
              ArchitectureOf("t", "a", "u : CELL port map (s, t); v : BOX port map (t, open);",
                             "signal s, t : bit;"));
    EXPECT_NE(text.model.GetComponent("BOX"), nullptr);
    EXPECT_EQ(text.model.GetComponent("INV"), nullptr);
}

TEST(VhdlFiles, ClausesAreKept) {
    VhdlTextReader text;
    const auto& options = text.model.GetOptions()->vhdl;
    text.Read(
        "library ieee, CELLS; use ieee.std_logic_1164.all, CELLS.parts.all;\nentity t is end;\n"
        "library ieee; use IEEE.numeric_std.all;\n" +
        ArchitectureOf("t", "a", "", "use work.p.x;"));
    EXPECT_EQ(TextsOf(options.libraries), (std::vector<std::string>{"ieee", "CELLS"}));
    EXPECT_EQ(TextsOf(options.useClauses),
              (std::vector<std::string>{"ieee.std_logic_1164.all", "CELLS.parts.all",
                                        "IEEE.numeric_std.all", "work.p.x"}));
    EXPECT_FALSE(options.useDefaultLibrary);
    EXPECT_TRUE(options.suppressConfiguration);
    text.Read("library ieee; use ieee.std_logic_1164.ALL; use ieee.numeric_std.ALL;\n"
              "library KESTRA; use KESTRA.Vcomponents.ALL; library mine;\nentity t is end;\n" +
              ArchitectureOf("t", "a", "") + "configuration CFG_t of t is for a end for; end;");
    EXPECT_EQ(TextsOf(options.libraries), (std::vector<std::string>{"mine"}));
    EXPECT_EQ(TextsOf(options.useClauses), std::vector<std::string>());
    EXPECT_TRUE(options.useDefaultLibrary);
    EXPECT_FALSE(options.suppressConfiguration);
    text.Read("entity t is end;\n" + ArchitectureOf("t", "a", ""));
    EXPECT_EQ(TextsOf(options.libraries), (std::vector<std::string>{"ieee"}));
    EXPECT_EQ(TextsOf(options.useClauses), (std::vector<std::string>{"ieee.std_logic_1164.all"}));
}

TEST(VhdlFiles, ComponentDeclarationsAreKept) {
    VhdlTextReader text;
    const auto& options = text.model.GetOptions()->vhdl;
    text.Read("entity t is end;\n" + ArchitectureOf("t", "a", "u : INV;"));
    EXPECT_TRUE(options.suppressComponent);
    text.Read("entity t is end;\n" + ArchitectureOf("t", "a", "u : entity work.UP;"));
    EXPECT_FALSE(options.suppressComponent);
    text.Read("entity t is end;\n" +
              ArchitectureOf("t", "a", "u : B;", "component B end component;"));
    EXPECT_FALSE(options.suppressComponent);
}

TEST(VhdlFiles, ConfigurationsThatChangeNothingAreRead) {
    VhdlTextReader text;
    EXPECT_EQ(text.GetFailure("entity t is end;\n" +
                              ArchitectureOf("t", "a", "u : B; v : B;",
                                             "component B end component;\n"
                                             "for u : B use entity work.B(rtl); end for;") +
                              "configuration CFG_t of t is for a\n"
                              "for u : B use configuration WORK.CFG_B; end for;\n"
                              "for others : B use entity work.B(x); for x for all : C use open;\n"
                              "end for; end for; end for;\nend for; end configuration CFG_t;"),
              "");
}

TEST(VhdlFiles, CellsOfThePrimitiveLibraryAreThoseThatTheConfigurationLeavesOut) {
    VhdlTextReader text;
    text.Read("entity t is end;\n" +
              ArchitectureOf("t", "a", "u : B; v : C;",
                             "attribute BOX_TYPE : string; component B end component;\n"
                             "attribute BOX_TYPE of B : component is \"BLACK_BOX\";\n"
                             "component C end component;\n"
                             "attribute BOX_TYPE of C : component is \"BLACK_BOX\";") +
              "configuration CFG_t of t is for a\n"
              "for v : C use configuration WORK.CFG_C; end for;\nend for; end CFG_t;");
    ASSERT_NE(text.model.GetComponent("B")->GetAttr("LEVEL"), nullptr);
    EXPECT_EQ(text.model.GetComponent("B")->GetAttr("LEVEL")->GetValueString(),
              Port::String("HALVEX"));
    EXPECT_EQ(text.model.GetComponent("C")->GetAttr("LEVEL"), nullptr);
}

TEST(VhdlFiles, CommentsAreKeptWhenAsked) {
    VhdlTextReader text;
    text.reader.KeepComments(true);
    text.Read(
        "-- of the design\nlibrary ieee; -- and its types\nentity t is port (\n"
        "-- an input\na : in bit;\nc : in bit -- not of what precedes\n); end;\n"
        "architecture x of t is\n-- a net\n-- of two lines\nsignal s : bit;\n/* a cell\n   of "
        "its own */\ncomponent B end component;\nbegin\n-- placed\nu : B -- inside\n;\nend;\n");
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "of the design/and its types");
    EXPECT_EQ(CommentOf(text.model.GetSignal("a")), "an input");
    EXPECT_EQ(CommentOf(text.model.GetSignal("c")), "");
    EXPECT_EQ(CommentOf(text.model.GetSignal("s")), "a net/of two lines");
    EXPECT_EQ(CommentOf(text.model.GetComponent("B")), "a cell/of its own");
    EXPECT_EQ(CommentOf(text.model.GetInstance("u")), "placed");
    text.reader.KeepComments(false);
    text.Read("-- of the design\nentity t is end;\n" + ArchitectureOf("t", "a", ""));
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "");
}

TEST(VhdlFiles, TheBannerOfAWrittenFileIsNoComment) {
    VhdlTextReader text;
    text.Read("entity t is end;\n" + ArchitectureOf("t", "a", ""));
    text.model.GetNetlist()->AddComment("mine");
    text.model.GetOptions()->purpose = "a purpose";
    text.model.GetOptions()->writeHeader = true;
    text.model.AddPort("A", Orn_Hdl::Polarity::Input);
    Orn_Hdl::TextMemOutStream stream;
    Orn_Hdl::VhdlNetlister(stream).WriteNetlist(text.model.GetNetlist(), text.model.GetOptions());
    const std::string written(stream.GetValue().GetView());
    EXPECT_NE(written.find("a purpose"), std::string::npos);
    text.reader.KeepComments(true);
    text.Read(written);
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "mine");
}

TEST(VhdlFiles, GenericsOfAnEntityAndWhatIsHiddenFromSynthesis) {
    VhdlTextReader text;
    text.Read("entity t is generic (N : integer := 2 ** 3;\n-- synopsys translate_off\n"
              "S : string := \"x\"\n-- synopsys translate_on\n); end;\n" +
              ArchitectureOf("t", "a",
                             "u : REG\n-- pragma translate_off\ngeneric map (W => 5)\n"
                             "-- pragma translate_on\nport map ('0', X\"1\", open);"));
    const Attribute* const n = text.model.GetNetlist()->GetAttr("N");
    ASSERT_NE(n, nullptr);
    EXPECT_EQ(n->GetValueString(), Port::String("8"));
    EXPECT_EQ(n->GetGenericOption(), Attribute::GenericSyn);
    EXPECT_EQ(text.model.GetNetlist()->GetAttr("S")->GetGenericOption(), Attribute::GenericNoSyn);
    EXPECT_EQ(text.model.GetInstance("u")->GetAttr("W")->GetGenericOption(),
              Attribute::GenericNoSyn);
    EXPECT_EQ(text.model.GetInstance("u")->GetAttr("INIT"), nullptr);
}

TEST(VhdlFiles, AnAttributeThatTheFileDoesNotDeclare) {
    VhdlTextReader text;
    text.Read("entity t is end;\n" +
              ArchitectureOf("t", "a", "u : REG generic map (W => 5) port map ('0', X\"1\", open);",
                             "attribute LOC of u : label is \"P1\"; attribute K : string;\n"
                             "attribute K of u : label is \"v\";"));
    const auto* const instance = text.model.GetInstance("u");
    EXPECT_EQ(instance->GetAttr("LOC")->GetSynAttrOption(), Attribute::SynAttrAssignNoDec);
    EXPECT_EQ(instance->GetAttr("K")->GetSynAttrOption(), Attribute::SynAttrAssign);
    text.reader.KeepAttributes(false);
    text.Read("entity t is end;\n" +
              ArchitectureOf("t", "a", "u : INV;", "attribute LOC of u : label is \"P1\";"));
    EXPECT_FALSE(text.model.GetInstance("u")->HasAttrs());
}

TEST(VhdlFiles, LiteralNamesStay) {
    VhdlTextReader text;
    text.reader.SetNames(Orn_Hdl::VhdlReader::Names::Literal);
    text.Read("entity \\t.1\\ is end;\n" +
              ArchitectureOf("\\t.1\\", "a", "\\a/b\\ <= \\A/B\\; \\signal\\ <= signal1;",
                             "signal \\a/b\\, \\A/B\\, \\signal\\, Signal1 : bit;"));
    EXPECT_EQ(text.model.GetNetlist()->GetNameView(), "t.1");
    for (const char* name : {"a/b", "A_B", "signal", "Signal1"}) {
        EXPECT_NE(text.model.GetSignal(name), nullptr) << name;
    }
    ASSERT_EQ(text.reader.GetRenamings().size(), 2U);
    EXPECT_EQ(text.reader.GetRenamings()[0].name, "\\A/B\\");
    EXPECT_EQ(text.reader.GetRenamings()[1].name, "\\signal\\");
}

TEST(VhdlFiles, TheComponentsOfANetlistAreALibrary) {
    VhdlTextReader first;
    first.Read("entity t is end;\n" +
               ArchitectureOf("t", "a", "u : REG port map ('0', X\"1\", open);"));
    VhdlTextReader text;
    Orn_Hdl::VhdlReader reader;
    reader.AddLibrary(*first.model.GetNetlist());
    text.Put("top.vhd", "entity t is end;\n" +
                            ArchitectureOf("t", "a",
                                           "u : reg generic map (INIT => \"00000001\", NAME => "
                                           "\"1\") port map ('0', X\"1\", open);"));
    reader.Read(text.GetFileName().c_str(), text.model);
    const auto* const instance = text.model.GetInstance("u");
    EXPECT_EQ(instance->GetAttr("INIT")->GetValueType(), Attribute::BitVector);
    EXPECT_EQ(instance->GetAttr("NAME")->GetValueType(), Attribute::String);
}

} // namespace
