#include "Orn_Hdl/Options.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Streams.h"
#include "Port/Version.h"
#include "Support/Environment.h"
#include "Support/Names.h"
#include "Support/ShortTexts.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <climits>
#include <ctime>
#include <memory>
#include <regex>
#include <string>

namespace {

using Orn_Hdl::AttributeString;
using Orn_Hdl::Component;
using Orn_Hdl::HdlOptions;
using Orn_Hdl::HdlUtilities;
using Orn_Hdl::Instance;
using Orn_Hdl::TextFileOutStream;
using Orn_Hdl::TextMemOutStream;
using Support::Names;
using Support::NamesOf;
using Support::Text;

TEST(CurrentTimeString, IsTheLocalTimeInTwoDigitsEach) {
    const Support::EnvironmentVariable noEpoch("SOURCE_DATE_EPOCH", nullptr);
    const Support::EnvironmentVariable timeZone("TZ", "AAA+7:30");
    const std::time_t before = std::time(nullptr);
    const std::string shown = Text(HdlUtilities::CurrentTimeString());
    const std::time_t after = std::time(nullptr);
    bool found = false;
    for (std::time_t instant = before; instant <= after; ++instant) {
        std::tm fields{};
        localtime_r(&instant, &fields);
        char text[64];
        std::strftime(text, sizeof text, "%m/%d/%Y %H:%M:%S", &fields);
        found = found || shown == text;
    }
    EXPECT_TRUE(found) << shown;
}

TEST(CurrentTimeString, IsTheInstantOfSourceDateEpochInUtc) {
    const Support::EnvironmentVariable timeZone("TZ", "AAA+7:30");
    const Support::EnvironmentVariable epoch("SOURCE_DATE_EPOCH", "951868861");
    EXPECT_EQ(HdlUtilities::CurrentTimeString(), "03/01/2000 00:01:01");
}

TEST(GetVersion, IsTheVersionOfTheBuild) {
    EXPECT_EQ(HdlUtilities::GetVersion(), Port::Version::getValue("version"));
    EXPECT_NE(HdlUtilities::GetVersion(), "");
}

TEST(ConvertBase, GivesALetterForEveryBase) {
    EXPECT_EQ(HdlUtilities::ConvertVhdlBase(2), "b");
    EXPECT_EQ(HdlUtilities::ConvertVhdlBase(8), "o");
    EXPECT_EQ(HdlUtilities::ConvertVerilogBase(2), "b");
    EXPECT_EQ(HdlUtilities::ConvertVerilogBase(8), "o");
    for (const int base : {16, 10, 0, -1, 1, 3, INT_MAX, INT_MIN}) {
        EXPECT_EQ(HdlUtilities::ConvertVhdlBase(base), "x") << base;
        EXPECT_EQ(HdlUtilities::ConvertVerilogBase(base), "h") << base;
    }
}

TEST(AddDummySuffix, StandsBeforeTheRange) {
    EXPECT_EQ(HdlUtilities::AddDummySuffix("D(7)x"), "D_DUMMY(7)");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("A(3)"), "A_DUMMY(3)");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("D(7:0)"), "D_DUMMY(7:0)");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("D(7)(6)"), "D_DUMMY(7)");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("D((7))"), "D_DUMMY((7)");
}

TEST(AddDummySuffix, StandsAtTheEndOfANameWithoutARange) {
    EXPECT_EQ(HdlUtilities::AddDummySuffix("clk"), "clk_DUMMY");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("a("), "a(_DUMMY");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("a)"), "a)_DUMMY");
    EXPECT_EQ(HdlUtilities::AddDummySuffix("D[7]"), "D[7]_DUMMY");
    EXPECT_EQ(HdlUtilities::AddDummySuffix(""), "_DUMMY");
    EXPECT_EQ(HdlUtilities::AddDummySuffix(nullptr), "_DUMMY");
}

TEST(IsGeneratedName, KnowsTheSuffixesInAnyLetterCase) {
    for (const char* name : {"a_DUMMY", "_dummy", "a_DUMMY(3)", "u1_I_CONST_SIGNAL",
                             "u_Const_Signal(7:0)", "u1_I_openSignal", "U1_I_OPENSIGNAL(1:0)"}) {
        EXPECT_TRUE(HdlUtilities::IsGeneratedName(name)) << name;
    }
    for (const char* name : {"", "DUMMY", "a_DUMMY_", "a_DUMMYx", "CONST_SIGNAL", "u1_openSignals",
                             "a(3)_DUMMY", "(_DUMMY)"}) {
        EXPECT_FALSE(HdlUtilities::IsGeneratedName(name)) << name;
    }
    EXPECT_FALSE(HdlUtilities::IsGeneratedName(nullptr));
}

TEST(AddDummySuffix, TakesAnyText) {
    Support::ForEachText("a()", 6, [](const std::string& text) {
        const std::string result = Text(HdlUtilities::AddDummySuffix(text.c_str()));
        ASSERT_NE(result.find("_DUMMY"), std::string::npos) << text;
    });
}

TEST(RemoveQuotes, TakesOffTheQuotesOfAnEnclosedText) {
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\"a b\""), "a b");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("'a b'"), "a b");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\"\""), "");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("''"), "");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\""), "");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("'"), "");
}

TEST(RemoveQuotes, KeepsTheInnerQuotesOfTheOtherKind) {
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\"'a'\""), "'a'");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("'\"a\"'"), "\"a\"");
}

TEST(RemoveQuotes, TakesOffEveryQuoteOfItsKind) {
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\"\"\"a\"\""), "a");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("''a'b'''"), "a'b");
    EXPECT_EQ(HdlUtilities::RemoveQuotes("\"\"\"\""), "");
}

TEST(RemoveQuotes, LeavesOtherTextsAlone) {
    for (const char* text :
         {"", "a", "\"a", "a\"", "'a", "a'", "\"a'", "'a\"", "a\"b\"c", " \"a\""}) {
        EXPECT_EQ(HdlUtilities::RemoveQuotes(text), text);
    }
    EXPECT_EQ(HdlUtilities::RemoveQuotes(nullptr), "");
}

/// The rule for quotes again.
std::string RemoveQuotesSlowly(const std::string& text) {
    for (const char* quote : {"\"", "'"}) {
        if (text.starts_with(quote) && text.ends_with(quote)) {
            const std::size_t first = text.find_first_not_of(quote);
            return first == std::string::npos
                       ? ""
                       : text.substr(first, text.find_last_not_of(quote) - first + 1);
        }
    }
    return text;
}

TEST(RemoveQuotes, FollowsItsRuleOnAllShortTexts) {
    Support::ForEachText("a\"' ", 6, [](const std::string& text) {
        ASSERT_EQ(HdlUtilities::RemoveQuotes(text.c_str()), RemoveQuotesSlowly(text).c_str())
            << text;
    });
}

TEST(GetAttrNames, AreTheInstancesThenTheComponents) {
    auto component = std::make_unique<Component>("AND2");
    component->AddAttr(new AttributeString("LEVEL", "1"));
    component->AddAttr(new AttributeString("loc", "2"));
    component->AddAttr(new AttributeString("INIT", "3"));
    Instance instance("U1", component.get());
    instance.AddAttr(new AttributeString("RLOC", "4"));
    instance.AddAttr(new AttributeString("LOC", "5"));
    EXPECT_EQ(NamesOf(HdlUtilities::GetAttrNames(&instance)),
              (Names{"RLOC", "LOC", "LEVEL", "INIT"}));
    component.reset();
    EXPECT_EQ(NamesOf(HdlUtilities::GetAttrNames(&instance)), (Names{"RLOC", "LOC"}));
}

TEST(GetAttrNames, OfNothingIsEmpty) {
    EXPECT_TRUE(HdlUtilities::GetAttrNames(nullptr).IsEmpty());
    const Instance instance("U1", nullptr);
    EXPECT_TRUE(HdlUtilities::GetAttrNames(&instance).IsEmpty());
}

HdlOptions MakeHeaderOptions() {
    HdlOptions options;
    options.application = "the application";
    options.command = "the command";
    options.device = "the device";
    options.purpose = "the purpose";
    options.reference = "the reference";
    return options;
}

TEST(WriteHeader, PutsEveryTextInItsPlace) {
    TextMemOutStream out;
    HdlUtilities::WriteHeader("the design", true, MakeHeaderOptions(), out);
    const std::string text = Text(out.GetValue());
    for (const char* line :
         {"\n--Command: the command\n", "\n--Design Name: the design\n", "\n--Device: the device\n",
          "\n--Purpose:\n--    the purpose \n", "\n--Reference\n--    the reference \n"}) {
        EXPECT_NE(text.find(line), std::string::npos) << line << " in\n" << text;
    }
    EXPECT_NE(text.find("Application : the application\n"), std::string::npos) << text;
    EXPECT_TRUE(std::regex_search(text, std::regex("Filename : *\n"))) << text;
}

TEST(WriteHeader, UsesVerilogCommentsWhenAsked) {
    TextMemOutStream out;
    HdlUtilities::WriteHeader("top", false, HdlOptions(), out);
    const std::string text = Text(out.GetValue());
    EXPECT_EQ(text.rfind("//", 0), 0u);
    EXPECT_EQ(text.find("\n--"), std::string::npos);
}

TEST(WriteHeader, ShowsTheNameOfAFileStreamAsItIs) {
    const Support::TemporaryFolder folder;
    const std::string name = folder.GetPath() + "/./top.vhd";
    {
        TextFileOutStream out(name.c_str(), false);
        HdlUtilities::WriteHeader("top", true, MakeHeaderOptions(), out);
    }
    const std::string text = Support::ReadWholeFile(name);
    EXPECT_NE(text.find("Filename : " + name + "\n"), std::string::npos) << text;
}

} // namespace
