// A walk over a JSON text finds the same whether the text is scanned ahead in another thread or
// not.
#include "Support/Sanitized.h"
#include "import/JsonWalker.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <initializer_list>
#include <stdexcept>
#include <string>
#include <string_view>

namespace {

using namespace Tool::Import;
using Settings = TokenBatches::Settings;

constexpr std::size_t WholeText = std::size_t(1) << 30;
/// Small batches, so that many places of a text are the end of one.
constexpr Settings AllSettings[] = {{1, 1, 1}, {1, 3, 10}, {2, 4, 1000}, {0, 2, 7}};

#if defined(ORN_HDL_SANITIZED)
constexpr std::size_t Step = 3;
#else
constexpr std::size_t Step = 1;
#endif

/// A text that arrives in pieces of one size, and may be followed by an exception.
class Pieces final : public TextSource {
public:
    Pieces(std::string_view text, std::size_t size, bool isDamaged = false)
        : text_(text), size_(size), isDamaged_(isDamaged) {}

    std::size_t Read(char* to, std::size_t count) override {
        const std::size_t size = text_.copy(to, std::min(count, size_));
        text_.remove_prefix(size);
        if (size == 0 && isDamaged_) {
            throw std::runtime_error("damaged");
        }
        return size;
    }

private:
    std::string_view text_;
    const std::size_t size_;
    const bool isDamaged_;
};

/// Takes values as what their keys ask for, and writes down what comes.
class Record {
public:
    explicit Record(JsonWalker& walker) : walker_(walker) {}

    std::string Make() {
        try {
            walker_.Walk([this] { AddObject(); });
        } catch (const Error& error) {
            const TextPlace& place = error.GetPlace();
            text_.append("! ").append(error.what());
            text_.append(" @").append(std::to_string(place.line)).append(":");
            text_.append(std::to_string(place.column)).append(":").append(place.source);
        } catch (const std::runtime_error& error) {
            text_.append("!! ").append(error.what());
        }
        return text_;
    }

private:
    void AddObject() {
        walker_.ForEachField([this](std::string_view key) {
            text_.append(key).append("=");
            if (key == "twice") {
                walker_.Fail("the key is wrong");
            }
            AddValue(key.substr(0, 1));
        });
        text_ += ';';
    }

    void AddValue(std::string_view kind) {
        if (kind == "o") {
            AddObject();
        } else if (kind == "a") {
            walker_.ForEachElement([this] {
                text_.append(walker_.IsNumber() ? std::to_string(walker_.ReadInteger())
                                                : std::string(walker_.ReadText()));
                text_ += ',';
            });
        } else if (kind == "t") {
            text_ += walker_.ReadText();
        } else if (kind == "n") {
            text_ += std::to_string(walker_.ReadInteger());
        } else {
            walker_.Skip();
        }
        text_ += ' ';
    }

    JsonWalker& walker_;
    std::string text_;
};

/// What a walk finds without and with batches, which is the same.
std::string Walk(std::string_view text, std::size_t piece = WholeText, bool isDamaged = false) {
    Pieces source(text, piece, isDamaged);
    JsonWalker direct(source);
    std::string expected = Record(direct).Make();
    for (const Settings& settings : AllSettings) {
        Pieces again(text, piece, isDamaged);
        JsonWalker ahead(again, settings);
        EXPECT_EQ(Record(ahead).Make(), expected)
            << settings.workers << ' ' << settings.batches << ' ' << settings.bytes << ": " << text;
    }
    return expected;
}

constexpr std::string_view Example =
    R"( {"o": {"n": -12, "a": [1, "x" ,300]}, "t": "a\"\\ \u00e9", "s": [true, null, 1.5e-3, {},)"
    "\r\n {\"\": []}], \"n\":0,\n \t \"a\":[ ]  } \n";

TEST(TokenBatches, GiveWhatTheTextSays) {
    EXPECT_EQ(Walk(Example), "o=n=-12 a=1,x,300, ; t=a\"\\ \u00e9 s= n=0 a= ;");
    for (const std::size_t piece : std::initializer_list<std::size_t>{1, 2, 7}) {
        Walk(Example, piece);
    }
}

TEST(TokenBatches, GiveLongTextsAndManyBatches) {
    const std::string longText(2000000, 'x');
    std::string text = "{\"t\": \"" + longText + "\", \"a\": [0";
    std::string found = "t=" + longText + " a=0,";
    for (int i = 1; i < 2000; ++i) {
        const std::string word(static_cast<std::size_t>(i) % 300, 'y');
        text += ", \"" + word + '"';
        found += word + ',';
    }
    EXPECT_EQ(Walk(text + "]}"), found + " ;");
}

TEST(TokenBatches, TellOfEveryCut) {
    for (std::size_t size = 0; size < Example.size(); size += Step) {
        Walk(Example.substr(0, size));
        Walk(Example.substr(0, size), WholeText, true);
    }
}

TEST(TokenBatches, TellOfEveryWrongByte) {
    for (std::size_t at = 0; at < Example.size(); at += Step) {
        for (const char c : std::string_view("\0\"{],a\xff", 7)) {
            std::string text(Example);
            text[at] = c;
            Walk(text);
        }
    }
}

TEST(TokenBatches, TellTheFirstOfTwoErrors) {
    EXPECT_NE(Walk("{\"twice\" ?}").find("! twice: invalid JSON"), std::string::npos);
    EXPECT_NE(Walk("{\"twice\": ?}").find("! twice: the key is wrong"), std::string::npos);
    EXPECT_NE(Walk("{\"o\": \"not closed").find("! o: an object is expected"), std::string::npos);
    EXPECT_NE(Walk("{\"a\": [1 2]}").find("! a: invalid"), std::string::npos);
    EXPECT_NE(Walk("{\"a\": [1, ?]}").find("! a[1]: invalid"), std::string::npos);
    EXPECT_NE(Walk("{\"a\": [?]}").find("! a[0]: invalid"), std::string::npos);
    EXPECT_NE(Walk("{} {").find("nothing may follow"), std::string::npos);
    EXPECT_NE(Walk("{\"n\": 1.5, ").find("! n: an integer is expected"), std::string::npos);
}

TEST(TokenBatches, EndWhenTheWalkDoes) {
    std::string deep = "{\"s\": ";
    for (int i = 0; i < 100000; ++i) {
        deep += '[';
    }
    EXPECT_NE(Walk(deep).find("nested too deeply"), std::string::npos);
    EXPECT_NE(Walk("{\"n\": \"\"" + std::string(100000, ' ') + "}").find("! n: an integer"),
              std::string::npos);
}

TEST(TokenBatches, ThrowWhatTheSourceThrowsBehindWhatWasScanned) {
    EXPECT_EQ(Walk("{\"n\": 1, \"t\": \"x\",", WholeText, true), "n=1 t=x !! damaged");
    EXPECT_EQ(Walk("{\"n\": \"x\",", WholeText, true), "n=! n: an integer is expected @0:0:");
    EXPECT_EQ(Walk("{\"n\": 1}", WholeText, true), "n=1 ;!! damaged");
}

} // namespace
