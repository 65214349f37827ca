#include "HdlModel/Names/NameIndex.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <set>
#include <string>
#include <string_view>

namespace {

using Orn_Hdl::HashName;

std::uint64_t Load(const std::string& text) {
    return Orn_Hdl::EightBytes::Load(text.data());
}

TEST(NameHash, FoldsEightCharactersAsOneByOne) {
    for (const std::string around : {"aZ09_$z~", "\x80\xff\x7f \x01`@^", "aa[a<a-a"}) {
        for (std::size_t place = 0; place < around.size(); ++place) {
            for (int c = 0; c < 256; ++c) {
                std::string text = around;
                text[place] = static_cast<char>(c);
                std::string folded;
                for (const char each : text) {
                    folded += static_cast<char>(Orn_Hdl::FoldedNameChar(each));
                }
                ASSERT_EQ(Orn_Hdl::FoldEightNameChars(Load(text)), Load(folded)) << text;
            }
        }
    }
}

TEST(NameHash, IsOneForNamesThatALookUpTakesForEqual) {
    EXPECT_EQ(HashName("d[3-0]"), HashName("D(3:0)"));
    EXPECT_EQ(HashName("a_long_bus<31>"), HashName("A_Long_Bus{31}"));
    EXPECT_EQ(HashName("a_long_bus_of_more_than_two_steps[7]"),
              HashName("A_LONG_BUS_OF_MORE_THAN_TWO_STEPS(7)"));
}

TEST(NameHash, IsOneForEverySpelling) {
    // Short and long names, the unusual characters at every place.
    for (std::size_t size = 1; size < 40; ++size) {
        for (std::size_t place = 0; place < size; ++place) {
            for (const std::string_view alike : {"([{<", ")]}>", ":-", "xX"}) {
                std::string name(size, 'a');
                name[place] = alike.front();
                std::string capitals(size, 'A');
                const std::uint32_t hash = HashName(name);
                for (const char c : alike) {
                    capitals[place] = c;
                    ASSERT_EQ(HashName(capitals), hash) << capitals;
                }
            }
        }
    }
}

/// How many hashes there are of all names of two characters, eleven long.
std::size_t CountHashes(char a, char b) {
    std::set<std::uint32_t> hashes;
    for (unsigned i = 0; i < 2048; ++i) {
        std::string name;
        for (unsigned bit = 1; bit < 2048; bit *= 2) {
            name += (i & bit) == 0 ? a : b;
        }
        hashes.insert(HashName(name));
    }
    return hashes.size();
}

TEST(NameHash, SetsNamesApartByEveryCharacter) {
    constexpr std::size_t AlmostAll = 2040;
    EXPECT_GE(CountHashes('a', 'B'), AlmostAll);
    EXPECT_GE(CountHashes('_', '$'), AlmostAll);
    EXPECT_GE(CountHashes('/', '.'), AlmostAll);
    EXPECT_GE(CountHashes('(', ')'), AlmostAll);
    EXPECT_GE(CountHashes('-', '['), AlmostAll);
    EXPECT_GE(CountHashes('\\', '|'), AlmostAll);
    EXPECT_GE(CountHashes('\x0d', '\xad'), AlmostAll);
    EXPECT_EQ(CountHashes('[', '{'), 1U);
}

} // namespace
