// Command files, line by line, and the phrases that their lines begin with.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <cstdint>
#include <fcntl.h>
#include <string>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>
#include <vector>

using namespace Orn_Hdl;
using Lines = std::vector<std::vector<std::string>>;

namespace {

std::vector<std::string> ToVector(const StringArray& words) {
    std::vector<std::string> texts;
    for (int i = 0; i < words.GetSize(); ++i) {
        texts.emplace_back(words.GetView(i));
    }
    return texts;
}

Lines ReadLines(CommandReader& reader) {
    Lines lines;
    while (const StringArray* words = reader.Next()) {
        lines.push_back(ToVector(*words));
    }
    return lines;
}

class CommandReaderTest : public testing::Test {
protected:
    Lines Read(std::string_view text) {
        Support::WriteWholeFile(name_, text);
        EXPECT_TRUE(reader_.Open(name_.c_str()));
        return ReadLines(reader_);
    }

    Support::TemporaryFolder folder_;
    const std::string name_ = folder_ / "lines.cmd";
    CommandFactory factory_;
    Model model_{&factory_};
    CommandReader reader_{model_};
};

} // namespace

TEST_F(CommandReaderTest, GivesTheWordsOfEachLine) {
    EXPECT_EQ(Read("ADD SIGNAL  a\n\nNOOP\r\nADD NOTES \"two words\" 'x'\n"),
              (Lines{{"ADD", "SIGNAL", "a"}, {}, {"NOOP"}, {"ADD", "NOTES", "two words", "x"}}));
}

TEST_F(CommandReaderTest, TheLastLineNeedsNoLineEnd) {
    EXPECT_EQ(Read("NOOP\nADD SIGNAL a"), (Lines{{"NOOP"}, {"ADD", "SIGNAL", "a"}}));
    EXPECT_EQ(Read(""), Lines());
    EXPECT_EQ(Read("\n"), Lines{{}});
}

TEST_F(CommandReaderTest, ALineEndsAtItsFirstNul) {
    EXPECT_EQ(Read(std::string_view("ADD SIGNAL a\0b c\nNOOP", 21)),
              (Lines{{"ADD", "SIGNAL", "a"}, {"NOOP"}}));
}

TEST_F(CommandReaderTest, TellsHowFarItIs) {
    const struct {
        std::string_view text;
        std::vector<std::uint64_t> positions;
    } files[] = {{"NOOP\n\nADD SIGNAL a\n", {0, 5, 6, 19}},
                 {"NOOP\r\n\r\nADD SIGNAL a\r\n", {0, 6, 8, 22}},
                 {"NOOP\nADD SIGNAL a", {0, 5, 17}},
                 {"NOOP\r\nADD SIGNAL a\r", {0, 6, 19}},
                 {"\r", {0, 1}},
                 {"\n", {0, 1}},
                 {"", {0}}};
    for (const auto& file : files) {
        Support::WriteWholeFile(name_, file.text);
        ASSERT_TRUE(reader_.Open(name_.c_str()));
        std::vector<std::uint64_t> positions{reader_.GetPosition()};
        while (reader_.Next() != nullptr) {
            positions.push_back(reader_.GetPosition());
        }
        EXPECT_EQ(positions, file.positions) << testing::PrintToString(file.text);
        EXPECT_EQ(reader_.GetError(), 0);
    }
}

TEST_F(CommandReaderTest, OpensAnotherFileInTheMiddleOfOne) {
    Support::WriteWholeFile(name_, "A\nB\nC\n");
    ASSERT_TRUE(reader_.Open(name_.c_str()));
    ASSERT_NE(reader_.Next(), nullptr);
    const std::string other = folder_ / "other.cmd";
    Support::WriteWholeFile(other, "D\n");
    ASSERT_TRUE(reader_.Open(other.c_str()));
    EXPECT_EQ(ReadLines(reader_), Lines{{"D"}});
    EXPECT_EQ(reader_.GetPosition(), 2u);
}

TEST_F(CommandReaderTest, LinesOfMegabytesStandBesideShortOnes) {
    std::string text;
    Lines expected;
    for (int i = 0; i < 40; ++i) {
        const std::string word(i % 7 == 0 ? 2000000 : 3, static_cast<char>('a' + i % 26));
        text += "NOOP " + word + "\n";
        expected.push_back({"NOOP", word});
    }
    EXPECT_TRUE(Read(text) == expected);
}

TEST_F(CommandReaderTest, WhatCannotBeOpenedHasNoLines) {
    EXPECT_EQ(reader_.Next(), nullptr);
    EXPECT_FALSE(reader_.Open((folder_ / "absent").c_str()));
    EXPECT_NE(reader_.GetError(), 0);
    EXPECT_EQ(reader_.Next(), nullptr);
    EXPECT_FALSE(reader_.Open(folder_.GetPath().c_str()));
    EXPECT_FALSE(reader_.Open(nullptr));
    EXPECT_EQ(reader_.Next(), nullptr);
}

TEST_F(CommandReaderTest, GivesALineAsSoonAsItHasCome) {
    // Whoever writes the second line waits for what the first one does.
    ASSERT_EQ(mkfifo(name_.c_str(), 0600), 0);
    const int writer = open(name_.c_str(), O_RDWR | O_CLOEXEC);
    ASSERT_GE(writer, 0);
    ASSERT_EQ(write(writer, "ONE\nTW", 6), 6);
    ASSERT_TRUE(reader_.Open(name_.c_str()));
    const StringArray* words = reader_.Next();
    ASSERT_NE(words, nullptr);
    EXPECT_EQ(ToVector(*words), std::vector<std::string>{"ONE"});
    ASSERT_EQ(write(writer, "O\n", 2), 2);
    words = reader_.Next();
    ASSERT_NE(words, nullptr);
    EXPECT_EQ(ToVector(*words), std::vector<std::string>{"TWO"});
    close(writer);
    EXPECT_EQ(reader_.Next(), nullptr);
}

TEST_F(CommandReaderTest, ReplaysALargeDesign) {
    // Large enough for the names to be fetched ahead, and longer than what is read at a time.
    constexpr int Count = 30000;
    std::string text = "ADD COMPONENT INV\nADD PIN INV A INPUT\n";
    for (int i = 0; i < Count; ++i) {
        const std::string number = std::to_string(i);
        text += "ADD INSTANCE INV u" + number + "\n";
        text += "CONNECT SIGNAL n" + std::to_string(i / 2) + " u" + number + ".A\n";
        text += i % 1000 == 0 ? "\nNOOP a b\n" : "";
    }
    Support::WriteWholeFile(name_, text);
    ASSERT_TRUE(model_.Read(name_.c_str()));
    EXPECT_EQ(model_.GetCommandManager()->GetDoneCommandCount(), 2 + 2 * Count + Count / 1000);
    for (int i = 0; i < Count; ++i) {
        const Instance* instance = model_.GetInstance(("U" + std::to_string(i)).c_str());
        ASSERT_NE(instance, nullptr);
        const Signal* signal = instance->GetPin("A")->GetSignal();
        ASSERT_NE(signal, nullptr);
        ASSERT_EQ(signal->GetName().GetView(), "n" + std::to_string(i / 2));
    }
}

RC_GTEST_FIXTURE_PROP(CommandReaderTest, SplitsAsALineByItself, ()) {
    const auto lines = *rc::gen::container<std::vector<std::string>>(
        rc::gen::container<std::string>(rc::gen::elementOf(std::string("ab \"'\\$%&(.\t\x80"))));
    std::string text;
    Lines expected;
    for (const std::string& line : lines) {
        text += line + "\n";
        expected.push_back(ToVector(StringArray(line.c_str(), " ", true, "\"\"''")));
    }
    RC_ASSERT(Read(text) == expected);
}

namespace {

template <int Number> Command* Create(Model* /*model*/, const StringArray& /*tokens*/) {
    return nullptr;
}

constexpr CommandCreator Creators[] = {&Create<0>, &Create<1>, &Create<2>, &Create<3>,
                                       &Create<4>, &Create<5>, &Create<6>, &Create<7>};

std::string Upper(std::string text) {
    for (char& c : text) {
        c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
    }
    return text;
}

/// Words, some of them of one start or one end, some with blanks in them.
rc::Gen<std::string> Words() {
    return rc::gen::element<std::string>("xadd", "XADD", "pin", "Pin", "xadd pin", "", " ", "p",
                                         "x-y", "X_Y", "x-Y", "abcdefgh", "abcdefghi",
                                         "ABCDEFGHIJKLMNOP", "abcdefghijklmnopq",
                                         "abcdefghXjklmnopq", "abcdefghijklmnopr", "\xc3\xa4");
}

} // namespace

RC_GTEST_PROP(Phrases, TheLongestOneThatIsTheStartOfTheLineWins, ()) {
    CommandFactory factory;
    std::vector<std::pair<std::string, CommandCreator>> phrases;
    for (const CommandCreator creator : Creators) {
        StringArray words;
        for (const std::string& word : *rc::gen::container<std::vector<std::string>>(3, Words())) {
            words.Add(word.c_str());
        }
        factory.AddCommandCreator(words, creator);
        phrases.emplace_back(Upper(std::string(words.Concatenate(" ").GetView())), creator);
    }
    StringArray line;
    for (const std::string& word : *rc::gen::container<std::vector<std::string>>(Words())) {
        line.Add(word.c_str());
    }
    CommandCreator expected = nullptr;
    std::string start;
    for (int i = 0; i < line.GetSize(); ++i) {
        start += (i > 0 ? " " : "") + Upper(std::string(line.GetView(i)));
        for (const auto& [phrase, creator] : phrases) {
            // Of two equal phrases the later one counts.
            expected = phrase == start ? creator : expected;
        }
    }
    RC_ASSERT(factory.GetCommandCreator(line) == expected);
}
