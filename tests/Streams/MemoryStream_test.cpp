#include "Orn_Hdl/Streams.h"

#include <gtest/gtest.h>

#include <climits>
#include <locale>
#include <string>
#include <type_traits>
#include <vector>

namespace {

using Orn_Hdl::OutStream;
using Orn_Hdl::StreamDst;
using Orn_Hdl::TextMemOutStream;

TEST(MemoryStream, CollectsTextsNumbersAndLineEnds) {
    TextMemOutStream out;
    out << "a" << Port::String("b") << std::string_view("c") << 42 << OutStream::NewLine << -7
        << OutStream::Flush << "\n";
    EXPECT_EQ(out.GetValue(), "abc42\n-7\n");
}

TEST(MemoryStream, StartsAsAsked) {
    EXPECT_EQ(TextMemOutStream("start").GetValue(), "start");
    EXPECT_EQ(TextMemOutStream(nullptr).GetValue(), "");
    EXPECT_EQ(TextMemOutStream().GetValue(), "");
    TextMemOutStream out("start");
    out << "ed";
    EXPECT_EQ(out.GetValue(), "started");
}

TEST(MemoryStream, ReplacesItsText) {
    TextMemOutStream out("a");
    out << "b";
    out.SetValue("new");
    out << "er";
    EXPECT_EQ(out.GetValue(), "newer");
    out.SetValue(nullptr);
    EXPECT_EQ(out.GetValue(), "");
}

TEST(MemoryStream, NeitherIndentsNorBreaksLines) {
    TextMemOutStream out;
    out.Indent();
    out.Indent();
    std::string expected;
    for (int i = 0; i < 50; ++i) {
        out << "word, ";
        expected += "word, ";
    }
    out << OutStream::NewLine << "next";
    EXPECT_EQ(out.GetValue(), (expected + "\nnext").c_str());
}

TEST(MemoryStream, ANullTextWritesNothing) {
    TextMemOutStream out;
    out << static_cast<const char*>(nullptr) << "" << Port::String();
    EXPECT_EQ(out.GetValue(), "");
}

TEST(MemoryStream, WritesNumbersAsTheyAreInEveryLocale) {
    struct Grouping : std::numpunct<char> {
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };
    const std::locale former = std::locale::global(std::locale(std::locale(), new Grouping));
    TextMemOutStream out;
    out << INT_MAX << " " << INT_MIN << " " << 0;
    std::locale::global(former);
    EXPECT_EQ(out.GetValue(), "2147483647 -2147483648 0");
}

TEST(MemoryStream, AnEmptyLineIsALineEnd) {
    TextMemOutStream out;
    out.Indent();
    out << "a";
    out << OutStream::NewLine;
    out.WriteEmptyLine();
    EXPECT_EQ(out.GetValue(), "a\n\n");
}

/// A destination of a client: it implements only what it must.
class Recorder : public StreamDst {
public:
    Recorder(std::vector<std::string>& calls, bool& alive) : calls_(calls), alive_(alive) {
        alive_ = true;
    }
    ~Recorder() override { alive_ = false; }
    void Write(const char* text) override {
        calls_.push_back(text == nullptr ? "<null>" : "text " + std::string(text));
    }
    void Write(int number) override { calls_.push_back("number " + std::to_string(number)); }

private:
    std::vector<std::string>& calls_;
    bool& alive_;
};

TEST(OutStream, OwnsItsDestination) {
    std::vector<std::string> calls;
    bool alive = false;
    {
        OutStream out(new Recorder(calls, alive));
        EXPECT_TRUE(alive);
    }
    EXPECT_FALSE(alive);
}

TEST(OutStream, ForwardsToADestinationOfAClient) {
    std::vector<std::string> calls;
    bool alive = false;
    OutStream out(new Recorder(calls, alive));
    const std::string whole = "abcdef";
    out << "text" << 5 << OutStream::NewLine << OutStream::Flush
        << std::string_view(whole).substr(1, 2);
    EXPECT_EQ(calls, (std::vector<std::string>{"text text", "number 5", "text \n", "text bc"}));
}

TEST(OutStream, ANullTextReachesNoDestination) {
    std::vector<std::string> calls;
    bool alive = false;
    OutStream out(new Recorder(calls, alive));
    out << static_cast<const char*>(nullptr);
    for (const std::string& call : calls) {
        EXPECT_NE(call, "<null>");
    }
}

TEST(OutStream, WithoutADestinationDropsEverything) {
    OutStream out(nullptr);
    OutStream* const same = &(out << "a" << 1 << OutStream::NewLine << OutStream::Flush);
    EXPECT_EQ(same, &out) << "operators can be chained";
    EXPECT_EQ(&(out << Port::String("b")), &out);
    EXPECT_NO_THROW(out.Indent());
    EXPECT_NO_THROW(out.Unindent());
    EXPECT_NO_THROW(out.WriteEmptyLine());
}

TEST(OutStream, CannotBeCopied) {
    EXPECT_FALSE(std::is_copy_constructible_v<OutStream>);
    EXPECT_FALSE(std::is_copy_constructible_v<TextMemOutStream>);
}

/// Lets a test copy destinations.
class Copyable : public StreamDst {
public:
    Copyable() = default;
    Copyable(const Copyable&) = default;
    Copyable& operator=(const Copyable&) = default;
    void Write(const char*) override {}
    void Write(int) override {}
};

TEST(StreamDst, IndentLevelNeverFallsBelowZero) {
    Copyable destination;
    EXPECT_EQ(destination.GetIndentLevel(), 0);
    destination.Unindent();
    EXPECT_EQ(destination.GetIndentLevel(), 0);
    destination.Indent();
    destination.Indent();
    destination.Unindent();
    EXPECT_EQ(destination.GetIndentLevel(), 1);
}

TEST(StreamDst, ACopyHasTheSameIndentLevel) {
    Copyable destination;
    destination.Indent();
    Copyable copy(destination);
    EXPECT_EQ(copy.GetIndentLevel(), 1);
    copy.Indent();
    destination = copy;
    EXPECT_EQ(destination.GetIndentLevel(), 2);
}

TEST(MemoryStream, TakesTextsInEveryForm) {
    TextMemOutStream out(std::string("a") + std::string(1, '\0'));
    EXPECT_EQ(out.GetValue(), std::string_view("a\0", 2));
    out.SetValue(std::string_view("bcd").substr(0, 1));
    EXPECT_EQ(out.GetValue(), "b");
    out.SetValue(out.GetValue() + 'c');
    EXPECT_EQ(out.GetValue(), "bc");
    out.SetValue(nullptr);
    EXPECT_EQ(out.GetValue(), "");
    EXPECT_EQ(TextMemOutStream(nullptr).GetValue(), "");
    EXPECT_EQ(TextMemOutStream(Port::String("d")).GetValue(), "d");
}

} // namespace
