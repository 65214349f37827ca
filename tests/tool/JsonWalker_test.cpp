// The walk over a JSON text, which must not depend on the pieces in which the text arrives.
#include "import/JsonWalker.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <initializer_list>
#include <string>
#include <string_view>

namespace {

using namespace Tool::Import;

/// A text that arrives in pieces of one size.
class Pieces final : public TextSource {
public:
    Pieces(std::string_view text, std::size_t size) : text_(text), size_(size) {}

    std::size_t Read(char* to, std::size_t count) override {
        const std::size_t size = text_.copy(to, std::min(count, size_));
        text_.remove_prefix(size);
        return size;
    }

private:
    std::string_view text_;
    std::size_t size_;
};

/// What a walk over a text finds, in one line, and the error that ends it.
class Record {
public:
    explicit Record(TextSource& source) : walker_(source) {}

    std::string Make() {
        try {
            walker_.Walk([this] { AddObject(); });
        } catch (const Error& error) {
            const TextPlace& place = error.GetPlace();
            text_.append("! ").append(error.what());
            text_.append(" @").append(std::to_string(place.line)).append(":");
            text_.append(std::to_string(place.column)).append(":").append(place.source);
        }
        return text_;
    }

private:
    void AddObject() {
        text_ += '{';
        walker_.ForEachField([this](std::string_view key) {
            text_.append(key).append("=");
            AddValue(key);
        });
        text_ += '}';
    }

    /// The first letter of a key tells what its value is taken for.
    void AddValue(std::string_view key) {
        switch (key.empty() ? '\0' : key.front()) {
        case 'o':
            AddObject();
            break;
        case 'a':
            text_ += '[';
            walker_.ForEachElement(
                [this] { text_.append(std::to_string(walker_.ReadInteger())).append(","); });
            text_ += ']';
            break;
        case 't':
            text_.append("\"").append(walker_.ReadText()).append("\"");
            break;
        case 'n':
            text_ += std::to_string(walker_.ReadInteger());
            break;
        default:
            walker_.Skip();
        }
        text_ += ' ';
    }

    JsonWalker walker_;
    std::string text_;
};

std::string Walk(std::string_view text, std::size_t piece) {
    Pieces source(text, piece);
    return Record(source).Make();
}

/// What a walk finds, which is the same for pieces of any size.
std::string Walk(std::string_view text) {
    std::string whole = Walk(text, std::max<std::size_t>(text.size(), 1));
    for (const std::size_t piece : std::initializer_list<std::size_t>{1, 2, 3, 7, 64}) {
        EXPECT_EQ(Walk(text, piece), whole) << "in pieces of " << piece << " bytes: " << text;
    }
    return whole;
}

constexpr std::string_view Example =
    R"( {"o": {"n": -12, "a": [1, 20 ,300]}, "t": "a\"\\\/\b\f\n\r\té\u00e9\uD83D\uDE00 ",)"
    "\r\n  \"skipped\": [true, false, null, 1.5e-3, 0.0, {\"\": []}, \"\\u0000\"], \"n\":0,\n"
    "             \t \"a\":[ ]  } \n";

TEST(JsonWalker, FindsWhatTheTextSays) {
    EXPECT_EQ(Walk(Example), "{o={n=-12 a=[1,20,300,] } t=\"a\"\\/\b\f\n\r\té\u00e9\U0001F600 \" "
                             "skipped= n=0 a=[] }");
}

TEST(JsonWalker, TellsOfEveryCut) {
    for (std::size_t size = 0; size + 3 < Example.size(); ++size) {
        EXPECT_NE(Walk(Example.substr(0, size)).find("! "), std::string::npos) << size;
    }
}

TEST(JsonWalker, SurvivesEveryWrongByte) {
    for (std::size_t at = 0; at < Example.size(); ++at) {
        for (const char c : std::string_view("\0\"\\{}[],:0a\n\xff ", 14)) {
            std::string text(Example);
            text[at] = c;
            Walk(text);
        }
    }
}

TEST(JsonWalker, TellsThePlaceOfAnError) {
    EXPECT_EQ(Walk(""), "! invalid JSON: the file is empty @0:0:");
    EXPECT_EQ(Walk("\n x"), "! invalid JSON: the file does not begin with \"{\" @2:1: x");
    EXPECT_EQ(Walk("{\"x\": 1,\n\n \"y\" 2}\r\n"),
              "{x= ! y: invalid JSON: a comma, colon, quote or bracket is missing or superfluous "
              "@3:5: \"y\" 2}");
    EXPECT_EQ(Walk("{\"o\": {\"a\": [1,\n "),
              "{o={a=[1,! o.a[1]: invalid JSON: the file ends too early @1:15:{\"o\": {\"a\": [1,");
    EXPECT_EQ(Walk("{\"x\": \"\xed\xa0\x80\"}"),
              "{x=! invalid JSON: a byte that is not UTF-8 @1:7:{\"x\": \"\xed\xa0\x80\"}");
    EXPECT_EQ(Walk("{\"x\": \"a\nb\"}"), "{x=! x: invalid JSON: a line end or another control "
                                         "character in a text @1:8:{\"x\": \"a");
}

TEST(JsonWalker, RefusesWrongEscapesAndNumbers) {
    for (const std::string wrong : {R"("\x")", R"("\u12")", R"("\u12g4")", R"("\ud800")",
                                    R"("\udc00\ud800")", R"("\ud800\u0041")", "01", "-", "1.", ".5",
                                    "1e", "1e+", "+1", "--1", "truth", "nul", "True"}) {
        EXPECT_NE(Walk("{\"x\": " + wrong + "}").find("! x: invalid JSON: "), std::string::npos)
            << wrong;
    }
}

TEST(JsonWalker, ReadsIntegersThatFit) {
    EXPECT_EQ(Walk("{\"n\": 9223372036854775807}"), "{n=9223372036854775807 }");
    EXPECT_EQ(Walk("{\"n\": -9223372036854775808}"), "{n=-9223372036854775808 }");
    for (const std::string wrong : {"9223372036854775808", "1.0", "1e2"}) {
        EXPECT_NE(Walk("{\"n\": " + wrong + "}").find("! n: an integer is expected"),
                  std::string::npos);
    }
}

TEST(JsonWalker, KnowsThePlaceFarBehindInTheText) {
    constexpr std::size_t Lines = 100000;
    std::string text = "{\n";
    for (std::size_t i = 0; i < Lines; ++i) {
        text += "  \"x\": \"" + std::to_string(i) + "\",\n";
    }
    text += "  \"y\": oops }\n";
    const std::string found = Walk(text, text.size());
    EXPECT_EQ(
        found.substr(found.find("! ")),
        "! y: invalid JSON: a word that is not true, false or null @100002:7:  \"y\": oops }");
}

TEST(JsonWalker, ReadsATextThatIsLongerThanAPiece) {
    const std::string longText(1000000, 'x');
    EXPECT_EQ(Walk("{\"t\": \"" + longText + "\"}", 1 << 20), "{t=\"" + longText + "\" }");
    // The line of an error there is too long to be shown; its column is known.
    const std::string found = Walk("{\"t\": \"" + longText + "\" 1}", 1 << 20);
    EXPECT_EQ(found.substr(found.find("! ")), "! invalid JSON: a comma, colon, quote or bracket is "
                                              "missing or superfluous @1:1000009:");
}

} // namespace
