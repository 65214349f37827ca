// Diagnostics: words and their places, lines that are read again, text, suggestions.
#include "diagnostics/CommandLines.h"
#include "diagnostics/Nearest.h"
#include "diagnostics/Reporter.h"
#include "diagnostics/SourceLines.h"
#include "diagnostics/TextFormat.h"
#include "diagnostics/Utf8.h"
#include "diagnostics/WordPlaces.h"
#include "explain/Additions.h"

#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace {

using namespace Tool;
using Orn_Hdl::StringArray;

/// Calls `check` with every text up to a length over an alphabet.
void ForEachText(std::string_view alphabet, std::size_t longest,
                 const std::function<void(const std::string&)>& check) {
    std::vector<std::string> texts = {""};
    for (std::size_t length = 0; length <= longest; ++length) {
        std::vector<std::string> longer;
        for (const std::string& text : texts) {
            check(text);
            for (const char c : alphabet) {
                longer.push_back(text + c);
            }
        }
        texts = std::move(longer);
    }
}

StringArray Split(std::string_view line) {
    StringArray words;
    words.ParseCommandLine(line);
    return words;
}

TEST(WordPlaces, AreThoseOfTheLibrarysWords) {
    ForEachText("a '\"\\", 7, [](const std::string& line) {
        const StringArray words = Split(line);
        const std::vector<WordPlace> places = FindWords(line);
        ASSERT_EQ(static_cast<int>(places.size()), words.GetSize()) << line;
        for (std::size_t i = 0; i < places.size(); ++i) {
            const WordPlace& place = places[i];
            EXPECT_EQ(place.text, words.GetView(static_cast<int>(i))) << line;
            EXPECT_LE(place.columns.first + place.columns.count, line.size()) << line;
            if (place.isPlain) {
                EXPECT_EQ(line.substr(place.textFirst, place.text.size()), place.text) << line;
            }
        }
    });
}

TEST(WordPlaces, WordsAreJoinedToALineThatIsSplitIntoThem) {
    for (const char* line : {"ADD PIN A B", "a \"b c\" d", "'it\"s it' \"\" x", "\"it's it\" 'x y'",
                             "'\"'", "'a\\' b'"}) {
        const StringArray words = Split(line);
        const std::string joined = JoinWords(words);
        EXPECT_EQ(Split(joined).Concatenate("|"), words.Concatenate("|")) << line;
    }
}

TEST(WordPlaces, Columns) {
    const std::vector<WordPlace> words = FindWords(" ADD  'a b' u1.A \"x\\\"y\"");
    const auto text = [&](const Mark& mark) {
        const Columns columns = GetColumns(mark, words);
        return std::to_string(columns.first) + "+" + std::to_string(columns.count);
    };
    EXPECT_EQ(text(Mark::Word(0)), "1+3");
    EXPECT_EQ(text(Mark::Word(1)), "6+5");
    EXPECT_EQ(text(Mark::Words(0, 1)), "1+10");
    EXPECT_EQ(text(Mark::Part(1, 2)), "9+1");
    EXPECT_EQ(text(Mark::Part(2, 0, 2)), "12+2");
    EXPECT_EQ(text(Mark::Part(2, 3)), "15+1");
    EXPECT_EQ(text(Mark::Part(3, 1)), "17+6") << "a word with a backslash is marked as a whole";
    EXPECT_EQ(text(Mark::Word(4)), "23+1") << "behind the last word";
    EXPECT_EQ(text(Mark::Word(9)), "23+1");
    EXPECT_EQ(GetColumns(Mark::Word(0), {}).count, 0U);
}

class Files : public testing::Test {
protected:
    std::string Write(const std::string& text) {
        Support::WriteWholeFile(name_, text);
        return name_;
    }

    Support::TemporaryFolder folder_;
    const std::string name_ = folder_ / "design.cmd";
};

TEST_F(Files, LinesInAnyOrder) {
    SourceLines lines(Write("one\ntwo\r\n\nfour"));
    std::string_view text;
    for (const auto& [line, expected] : std::vector<std::pair<std::uint64_t, std::string>>{
             {1, "one"}, {4, "four"}, {2, "two"}, {2, "two"}, {3, ""}, {1, "one"}}) {
        ASSERT_TRUE(lines.Get(line, text)) << line;
        EXPECT_EQ(text, expected);
    }
    EXPECT_FALSE(lines.Get(0, text));
    EXPECT_FALSE(lines.Get(5, text));
    EXPECT_TRUE(lines.Get(1, text)) << "after a line that is not there";
}

TEST_F(Files, ThatCannotBeReadAgain) {
    std::string_view text;
    EXPECT_FALSE(SourceLines(folder_ / "none").Get(1, text));
    EXPECT_FALSE(SourceLines(folder_ / ".").Get(1, text));
    EXPECT_FALSE(SourceLines("/dev/null").Get(1, text));
}

TEST_F(Files, PlacesOfLines) {
    CommandLines lines("shown", Write("NOOP\nADD  PIN a\n"));
    const Place place = lines.GetPlace(2, Split("ADD PIN a"), Mark::Word(2));
    EXPECT_EQ(place.file, "shown");
    EXPECT_EQ(place.source, "ADD  PIN a");
    EXPECT_EQ(place.columns.first, 9U);
    EXPECT_TRUE(place.isExact);
    // The file has been changed since.
    const Place changed = lines.GetPlace(2, Split("ADD PORT a"), Mark::Word(2));
    EXPECT_EQ(changed.source, "ADD PORT a");
    EXPECT_EQ(changed.columns.first, 9U);
    EXPECT_FALSE(changed.isExact);
    EXPECT_FALSE(lines.GetPlace(7, Split("ADD PORT a"), {}).isExact);
}

TEST_F(Files, LinesThatAddSomething) {
    using namespace Tool::Explain;
    SourceLines lines(Write("NOOP ADD COMPONENT AND2\n"         // 1
                            "add component 'And2'\n"            // 2
                            "ADD COMPONENT COMMENT AND3 x\n"    // 3
                            "ADD PIN AND2 D[3:0] input\n"       // 4
                            "ADD PIN AND3 Q input\n"            // 5
                            "ADD INSTANCE AND2 u1\n"            // 6
                            "CONNECT SIGNAL x,y(1) u1.D(3:0)\n" // 7
                            "ADD PORT y(7:0) input\n"           // 8
                            "ASSIGN CONSTANT u1.Q 1\n"          // 9
                            "CONNECT SIGNAL z q\n"));           // 10
    const auto find = [&](ObjectKind kind, const char* name, const char* owner = "") {
        const auto found = FindAddition(lines, kind, name, owner);
        return found ? found->line : 0;
    };
    EXPECT_EQ(find(ObjectKind::Component, "AND2"), 2U);
    EXPECT_EQ(find(ObjectKind::Component, "AND3"), 0U);
    EXPECT_EQ(find(ObjectKind::Pin, "d(3-0)", "and2"), 4U);
    EXPECT_EQ(find(ObjectKind::Pin, "Q", "AND2"), 0U);
    EXPECT_EQ(find(ObjectKind::Instance, "U1"), 6U);
    EXPECT_EQ(find(ObjectKind::Signal, "x"), 7U);
    EXPECT_EQ(find(ObjectKind::Signal, "y(7:0)"), 8U);
    EXPECT_EQ(find(ObjectKind::Signal, "q"), 10U);
    EXPECT_EQ(find(ObjectKind::Signal, "u1"), 0U);
    EXPECT_TRUE(FindAddition(lines, ObjectKind::Signal, "z")->isFirstUse);
    EXPECT_FALSE(FindAddition(lines, ObjectKind::Signal, "y(7:0)")->isFirstUse);
}

std::string Format(const std::string& source, Columns columns) {
    Diagnostic diagnostic;
    diagnostic.place = Place{"f", 7, source, columns};
    diagnostic.message = "wrong";
    return FormatText(diagnostic, false);
}

TEST(TextFormat, MarksCharactersNotBytes) {
    EXPECT_EQ(Format("\xc3\xa4\xe2\x82\xac ab", Columns{0, 5}), "f:7: error: wrong\n"
                                                                "    7 | \xc3\xa4\xe2\x82\xac ab\n"
                                                                "      | ^~\n");
    EXPECT_EQ(Format("\xe4\xf6 ab", Columns{3, 2}), "f:7: error: wrong\n"
                                                    "    7 | \xe4\xf6 ab\n"
                                                    "      |    ^~\n");
}

TEST(TextFormat, ControlCharactersDoNotMoveTheCursor) {
    EXPECT_EQ(Format("a\tb\x1b[2J\r", Columns{2, 1}), "f:7: error: wrong\n"
                                                      "    7 | a b?[2J?\n"
                                                      "      |   ^\n");
}

TEST(TextFormat, LongLinesAreCutAroundTheMark) {
    const std::string filler(1000, 'x');
    EXPECT_EQ(Format(filler + "ab" + filler, Columns{1000, 2}),
              "f:7: error: wrong\n    7 | ..." + std::string(40, 'x') + "ab" +
                  std::string(118, 'x') + "...\n      |    " + std::string(40, ' ') + "^~\n");
    EXPECT_EQ(Format(filler, Columns{0, 1000}), "f:7: error: wrong\n    7 | " +
                                                    std::string(160, 'x') + "...\n      | ^" +
                                                    std::string(159, '~') + "\n");
    // A mark behind the last character.
    EXPECT_EQ(Format(filler, Columns{1000, 1}), "f:7: error: wrong\n    7 | ..." +
                                                    std::string(40, 'x') + "\n      |    " +
                                                    std::string(40, ' ') + "^\n");
}

TEST(TextFormat, NoMarkIsOutsideOfItsLine) {
    for (std::size_t size = 0; size < 400; size += 7) {
        std::string line;
        while (line.size() < size) {
            line += "\xe2\x82\xac";
        }
        for (std::size_t first = 0; first <= size + 3; ++first) {
            const std::string text = Format(line, Columns{first, 5});
            if (line.empty()) {
                EXPECT_EQ(text, "f:7: error: wrong\n");
                continue;
            }
            const std::size_t mark =
                text.rfind("^~") == std::string::npos ? text.rfind('^') : text.rfind("^~");
            const std::size_t start = text.rfind("      | ") + 8;
            const std::size_t shown = text.find("    7 | ") + 8;
            const std::string source = text.substr(shown, text.find('\n', shown) - shown);
            EXPECT_LE(mark - start, CountCharacters(source)) << size << " " << first;
        }
    }
}

TEST(TextFormat, Counts) {
    EXPECT_EQ(FormatCounts(0, 0), "0 errors");
    EXPECT_EQ(FormatCounts(1, 0), "1 error");
    EXPECT_EQ(FormatCounts(2, 1), "2 errors, 1 warning");
    EXPECT_EQ(FormatCounts(0, 3), "3 warnings");
}

TEST(NearestWord, ChoosesTheNearest) {
    EXPECT_EQ(GetNearest("colck", {"clk", "clock", "block"}), "clock");
    EXPECT_EQ(GetNearest("CLOCKED", {"clocks", "clocked2"}), "clocked2");
    EXPECT_EQ(GetNearest("clock2", {"clock3", "clock1"}), "clock3") << "the first of two";
    EXPECT_EQ(GetNearest("a", {"b"}), "") << "a third of one character is none";
    EXPECT_EQ(GetNearest("u9", {"u12", "u1"}), "u1");
    EXPECT_EQ(GetNearest("abcdef", {"uvwxyz", "abc"}), "");
    EXPECT_EQ(GetNearest("", {"a", ""}), "");
}

/// The table of distances without any shortcut.
std::size_t Distance(const std::string& a, const std::string& b) {
    std::vector<std::vector<std::size_t>> table(a.size() + 1,
                                                std::vector<std::size_t>(b.size() + 1));
    for (std::size_t i = 0; i <= a.size(); ++i) {
        for (std::size_t j = 0; j <= b.size(); ++j) {
            if (i == 0 || j == 0) {
                table[i][j] = i + j;
                continue;
            }
            table[i][j] = std::min({table[i - 1][j] + 1, table[i][j - 1] + 1,
                                    table[i - 1][j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1)});
            if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1]) {
                table[i][j] = std::min(table[i][j], table[i - 2][j - 2] + 1);
            }
        }
    }
    return table[a.size()][b.size()];
}

TEST(NearestWord, KnowsEveryDistanceWithinItsLimit) {
    for (const std::string word : {"abcab", "aabbcc", "cabca", "abcabcab"}) {
        const std::size_t limit = (word.size() + 1) / 3;
        ForEachText("abc", 7, [&](const std::string& candidate) {
            NearestWord nearest(word);
            nearest.Consider(candidate);
            const std::size_t distance = Distance(word, candidate);
            EXPECT_EQ(nearest.Get() == candidate && !candidate.empty(),
                      distance <= limit && !candidate.empty())
                << word << " " << candidate;
            if (distance <= limit) {
                EXPECT_EQ(nearest.GetDistance(), distance) << word << " " << candidate;
            }
        });
    }
}

} // namespace
