#include "Containers/PackedLists.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>
#include <string_view>

namespace {

using Orn_Hdl::PackedLists;
using Orn_Hdl::StringArray;
using Support::Names;
using Support::NamesOf;

/// With memory for a line.
StringArray MakeRoomy() {
    StringArray words;
    words.ParseCommandLine(std::string(50, 'a') + " a a a a a a a a a a a a a a a a a a a a a a");
    return words;
}

/// Splits the first line of a text as it is done for lines of all kinds.
Names SplitFirst(std::string_view text, std::size_t& bytes) {
    const std::size_t size = text.find('\n');
    bytes = size + 1;
    std::string_view line = text.substr(0, size);
    if (!line.empty() && line.back() == '\r') {
        line.remove_suffix(1);
    }
    StringArray words;
    words.ParseCommandLine(line);
    return NamesOf(words);
}

/// Whether a line is split as a usual one, and if so, rightly.
void Check(const std::string& line) {
    // Long enough for the last step.
    const std::string text = line + "\nNEXT 'LINE";
    StringArray words = MakeRoomy();
    const std::size_t taken = PackedLists::SplitUsualLine(text, words);
    const std::string first = text.substr(0, text.find('\n'));
    if (first.find_first_of(std::string_view("\"'\0", 3)) != std::string::npos) {
        ASSERT_EQ(taken, 0U) << text;
        return;
    }
    std::size_t bytes = 0;
    const Names expected = SplitFirst(text, bytes);
    ASSERT_EQ(taken, bytes) << text;
    ASSERT_EQ(NamesOf(words), expected) << text;
}

TEST(UsualLine, IsSplitLikeAnyOther) {
    for (const std::string before : {"", "a", "abc", "abcdefg", "ab de"}) {
        Support::ForEachText(std::string_view("a \"'\r\n\0&", 8), 5,
                             [&before](const std::string& text) { Check(before + text); });
    }
}

RC_GTEST_PROP(UsualLine, OfAnyLengthIsSplitLikeAnyOther, ()) {
    const auto line = *rc::gen::container<std::string>(
        rc::gen::elementOf(std::string("abcdefgh  !#$%&(.\t\r\x80\xa0")));
    const std::string text = line + "\n        ";
    StringArray words = MakeRoomy();
    const std::size_t taken = PackedLists::SplitUsualLine(text, words);
    std::size_t bytes = 0;
    const Names expected = SplitFirst(text, bytes);
    if (taken == 0) {
        // The list had no room.
        RC_ASSERT(line.size() > 50U || expected.size() > 20U);
    } else {
        RC_ASSERT(taken == bytes);
        RC_ASSERT(NamesOf(words) == expected);
    }
}

TEST(UsualLine, NeedsALineEnd) {
    StringArray words = MakeRoomy();
    for (const std::string_view text : {"", "a", "abcdefgh", "ADD SIGNAL a some more"}) {
        EXPECT_EQ(PackedLists::SplitUsualLine(text, words), 0U) << text;
    }
    EXPECT_EQ(PackedLists::SplitUsualLine(std::string_view(), words), 0U);
}

TEST(UsualLine, TakesNoMemory) {
    StringArray none;
    EXPECT_EQ(PackedLists::SplitUsualLine("abc def ghi jkl\n        ", none), 0U);
    StringArray words = MakeRoomy();
    const std::string longWord(1000, 'a');
    EXPECT_EQ(PackedLists::SplitUsualLine(longWord + "\n        ", words), 0U);
    // A list is of use afterwards.
    EXPECT_EQ(PackedLists::SplitUsualLine("abc def\n        ", words), 8U);
    EXPECT_EQ(NamesOf(words), (Names{"abc", "def"}));
}

} // namespace
