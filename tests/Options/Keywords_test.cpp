#include "Orn_Hdl/Engine.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>

#include <cctype>
#include <set>
#include <string>

namespace {

using Orn_Hdl::Engine;
using Orn_Hdl::StringArray;
using Support::Names;

/// The reserved words of IEEE 1076-1993.
const char* const VhdlWords =
    "abs access after alias all and architecture array assert attribute begin block body buffer "
    "bus case component configuration constant disconnect downto else elsif end entity exit file "
    "for function generate generic group guarded if impure in inertial inout is label library "
    "linkage literal loop map mod nand new next nor not null of on open or others out package "
    "port postponed procedure process pure range record register reject rem report return rol "
    "ror select severity shared signal sla sll sra srl subtype then to transport type unaffected "
    "units until use variable wait when while with xnor xor";

/// The keywords of IEEE 1364-1995 without "force".
const char* const VerilogWords =
    "always and assign begin buf bufif0 bufif1 case casex casez cmos deassign default defparam "
    "disable edge else end endcase endfunction endmodule endprimitive endspecify endtable endtask "
    "event for forever fork function highz0 highz1 if ifnone initial inout input integer join "
    "large macromodule medium module nand negedge nmos nor not notif0 notif1 or output parameter "
    "pmos posedge primitive pull0 pull1 pulldown pullup rcmos real realtime reg release repeat "
    "rnmos rpmos rtran rtranif0 rtranif1 scalared small specify specparam strong0 strong1 supply0 "
    "supply1 table task time tran tranif0 tranif1 tri tri0 tri1 triand trior trireg vectored wait "
    "wand weak0 weak1 while wire wor xnor xor";

Names Split(const char* words) {
    return Support::NamesOf(StringArray(words, " ", true, nullptr));
}

std::string Upper(std::string word) {
    for (char& c : word) {
        c = static_cast<char>(std::toupper(c));
    }
    return word;
}

TEST(VhdlKeywords, AreNinetySevenWordsInAnyCase) {
    const Names words = Split(VhdlWords);
    EXPECT_EQ(words.size(), 97u);
    for (const std::string& word : words) {
        EXPECT_TRUE(Engine::IsVhdlKeyword(word.c_str())) << word;
        EXPECT_TRUE(Engine::IsVhdlKeyword(Upper(word).c_str())) << word;
    }
    EXPECT_TRUE(Engine::IsVhdlKeyword("ENTITY"));
    EXPECT_TRUE(Engine::IsVhdlKeyword("Signal"));
}

TEST(VerilogKeywords, AreAHundredAndOneWordsInLowerCase) {
    const Names words = Split(VerilogWords);
    EXPECT_EQ(words.size(), 101u);
    for (const std::string& word : words) {
        EXPECT_TRUE(Engine::IsVerilogKeyword(word.c_str())) << word;
        EXPECT_FALSE(Engine::IsVerilogKeyword(Upper(word).c_str())) << word;
    }
    EXPECT_FALSE(Engine::IsVerilogKeyword("Module"));
    EXPECT_FALSE(Engine::IsVerilogKeyword("WIRE"));
}

TEST(VerilogKeywords, ForceIsNone) {
    EXPECT_FALSE(Engine::IsVerilogKeyword("force"));
}

TEST(Keywords, NothingElseIsOne) {
    for (const char* word : {"", " ", "abs ", "protected", "context", "logic", "generate_",
                             "std_logic", "signed", "automatic"}) {
        EXPECT_FALSE(Engine::IsVhdlKeyword(word)) << word;
        EXPECT_FALSE(Engine::IsVerilogKeyword(word)) << word;
    }
    EXPECT_FALSE(Engine::IsVhdlKeyword(nullptr));
    EXPECT_FALSE(Engine::IsVerilogKeyword(nullptr));
    EXPECT_FALSE(Engine::IsVerilogKeyword("generate"));
    EXPECT_FALSE(Engine::IsVhdlKeyword("assign"));
}

TEST(Keywords, OfAllTextsOfThreeLettersOnlyTheReservedOnesAreKeywords) {
    const Names vhdlNames = Split(VhdlWords);
    const Names verilogNames = Split(VerilogWords);
    const std::set<std::string> vhdl(vhdlNames.begin(), vhdlNames.end());
    const std::set<std::string> verilog(verilogNames.begin(), verilogNames.end());
    Support::ForEachText("abcdefghijklmnopqrstuvwxyz01", 3, [&](const std::string& word) {
        ASSERT_EQ(Engine::IsVhdlKeyword(word.c_str()), vhdl.count(word) != 0) << word;
        ASSERT_EQ(Engine::IsVerilogKeyword(word.c_str()), verilog.count(word) != 0) << word;
    });
}

} // namespace
