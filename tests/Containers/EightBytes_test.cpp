#include "Containers/EightBytes.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <numeric>
#include <string>

using namespace Orn_Hdl;

namespace {

/// Every character at every place among others.
template <class Check> void ForEachText(const Check& check) {
    for (const std::string around : {"aZ09_(z~", "\x80\xff\x7f \x01{[@", "aaaaaaaa"}) {
        for (std::size_t place = 0; place < around.size(); ++place) {
            for (int c = 0; c < 256; ++c) {
                std::string text = around;
                text[place] = static_cast<char>(c);
                check(text);
            }
        }
    }
}

std::uint64_t Load(const std::string& text) {
    return EightBytes::Load(text.data());
}

} // namespace

TEST(EightBytes, MarksARange) {
    ForEachText([](const std::string& text) {
        std::uint64_t expected = 0;
        std::size_t first = 8;
        for (std::size_t i = 8; i > 0; --i) {
            const unsigned char c = static_cast<unsigned char>(text[i - 1]);
            if (c >= ' ' && c <= '\'') {
                expected |= std::uint64_t(0x80) << (8 * (i - 1));
                first = i - 1;
            }
        }
        const std::uint64_t marks = EightBytes::MarkRange(Load(text), ' ', '\'');
        ASSERT_EQ(marks, expected);
        if (marks != 0) {
            ASSERT_EQ(EightBytes::FirstMarked(marks), first);
        }
    });
}

TEST(EightBytes, TurnsLettersIntoUpperCase) {
    ForEachText([](std::string text) {
        const std::uint64_t upper = EightBytes::ToUpper(Load(text));
        for (char& c : text) {
            c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
        }
        ASSERT_EQ(upper, Load(text));
    });
}

TEST(EightBytes, LoadsEveryCharacterOfAShortText) {
    for (std::size_t size = 0; size < 8; ++size) {
        const std::string text(size, 'a');
        const std::uint64_t whole = EightBytes::LoadShort(text.data(), size);
        for (std::size_t i = 0; i < size; ++i) {
            std::string other = text;
            other[i] = 'b';
            EXPECT_NE(EightBytes::LoadShort(other.data(), size), whole) << size << " " << i;
        }
    }
}

TEST(EightBytes, CopiesEveryCharacterAndNoOther) {
    for (std::size_t size = 0; size < 40; ++size) {
        std::string text(size, ' ');
        std::iota(text.begin(), text.end(), '0');
        std::string copy(size + 2, '.');
        const char* const end = EightBytes::Copy(text.data(), size, copy.data() + 1);
        EXPECT_EQ(copy, "." + text + ".");
        EXPECT_EQ(end, copy.data() + 1 + size);
    }
}

TEST(EightBytes, ComparesEveryCharacter) {
    for (std::size_t size = 0; size < 40; ++size) {
        const std::string text(size, 'a');
        EXPECT_TRUE(EightBytes::Equal(text.data(), std::string(text).data(), size)) << size;
        for (std::size_t i = 0; i < size; ++i) {
            std::string other = text;
            other[i] = 'A';
            EXPECT_FALSE(EightBytes::Equal(text.data(), other.data(), size)) << size << " " << i;
        }
    }
}
