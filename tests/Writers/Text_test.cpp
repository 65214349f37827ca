#include "Writers/Text.h"

#include "Orn_Hdl/Model/Component.h"
#include "Writers/OneLine.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace {

using namespace Orn_Hdl;
using namespace Orn_Hdl::Writers;

std::string Written(const TextMemOutStream& out) {
    return std::string(out.GetValue().GetView());
}

TEST(IsOpen, OnlyOfNoNameAndTheWordInAnyCase) {
    for (const char* name : {"", "open", "OPEN", "oPeN"}) {
        EXPECT_TRUE(IsOpen(name)) << name;
    }
    for (const char* name : {"opens", "ope", " open", "open ", "o", "open(0)"}) {
        EXPECT_FALSE(IsOpen(name)) << name;
    }
}

TEST(GetBaseName, OfAPinLosesItsRange) {
    EXPECT_EQ(Writers::GetBaseName(ScalarPin("A", Polarity("in"))), "A");
    EXPECT_EQ(Writers::GetBaseName(BusPin("D(3:0)", Polarity("in"))), "D");
    EXPECT_EQ(Writers::GetBaseName(BusIndexPin("D(3)", Polarity("in"))), "D");
}

TEST(GetUnquotedValue, IsOneLineWithoutItsQuotes) {
    EXPECT_EQ(GetUnquotedValue(AttributeString("a", "plain")), "plain");
    EXPECT_EQ(GetUnquotedValue(AttributeString("a", "\"quoted\"")), "quoted");
    EXPECT_EQ(GetUnquotedValue(AttributeString("a", "two\nlines")), "two lines");
    EXPECT_EQ(GetUnquotedValue(AttributeString("a", "")), "");
}

TEST(GetSingleBit, IsZeroAfterALastDigitZeroOnly) {
    for (const char* value : {"0", "10", "2:B:10", "8:H:F0"}) {
        EXPECT_EQ(GetSingleBit(BitVectorValue(value)), "0") << value;
    }
    for (const char* value : {"1", "01", "8:H:0F", "X", "2:B:01", ""}) {
        EXPECT_EQ(GetSingleBit(BitVectorValue(value)), "1") << value;
    }
}

TEST(Put, WritesTextsAndNumbersAsTheyStand) {
    TextMemOutStream out;
    Put(out, "a", 7, std::string_view("b"), std::string("c"));
    PutLine(out, -1, "d");
    Put(out);
    EXPECT_EQ(Written(out), "a7bc-1d\n");
}

TEST(WriteBlanks, WritesAnyNumber) {
    for (const std::size_t count : {0u, 1u, 255u, 256u, 257u, 1000u}) {
        TextMemOutStream out;
        WriteBlanks(out, count);
        EXPECT_EQ(Written(out), std::string(count, ' '));
    }
}

TEST(WriteComment, PutsThePrefixBeforeEachLineThatHasText) {
    const struct {
        const char* comment;
        const char* written;
    } cases[] = {{"", ""},
                 {"one", "// one\n"},
                 {"one\n", "// one\n"},
                 {"one\ntwo", "// one\n// two\n"},
                 {"\n\none\n\n\ntwo\n\n", "// one\n// two\n"},
                 {"a\rb\vc\fd", "// a b c d\n"}};
    for (const auto& each : cases) {
        Component component("C");
        component.AddComment(each.comment);
        TextMemOutStream out;
        WriteComment(out, Language::Verilog, component);
        EXPECT_EQ(Written(out), each.written);
    }
}

TEST(OneLine, ReplacesExactlyTheFourCharactersThatEndALine) {
    for (int c = 0; c < 256; ++c) {
        const std::string text{'a', static_cast<char>(c), 'b'};
        const bool endsLine = c == '\n' || c == '\v' || c == '\f' || c == '\r';
        EXPECT_EQ(OneLine(text).GetView(), endsLine ? "a b" : text) << c;
        EXPECT_EQ(OneLine(text, '.').GetView(), endsLine ? "a.b" : text) << c;
    }
}

TEST(OneLine, DoesNotCopyATextOfOneLine) {
    const std::string text = "a text of one line";
    EXPECT_EQ(OneLine(text).GetView().data(), text.data());
}

} // namespace
