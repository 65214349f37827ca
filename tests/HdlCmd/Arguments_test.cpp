// The texts that a command keeps of its line, behind it in memory or in a block of their own.

#include "HdlCmd/Arguments.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <new>
#include <string>
#include <vector>

using namespace Orn_Hdl;

namespace {

enum class Flag { First, Second };

/// Arguments with some room, and behind that bytes which nobody may change.
class Guarded {
public:
    explicit Guarded(std::size_t room)
        : end_(sizeof(Arguments) + room), memory_(end_ + GuardSize, Guard) {
        arguments_ = ::new (static_cast<void*>(memory_.data())) Arguments(room);
    }
    Guarded(const Guarded&) = delete;
    Guarded& operator=(const Guarded&) = delete;
    ~Guarded() { arguments_->~Arguments(); }

    Arguments* operator->() const { return arguments_; }
    bool IsInRoom(const char* text) const {
        return text > memory_.data() && text < memory_.data() + end_;
    }
    bool IsIntact() const {
        return std::all_of(memory_.begin() + static_cast<std::ptrdiff_t>(end_), memory_.end(),
                           [](char c) { return c == Guard; });
    }

private:
    static constexpr char Guard = 0x55;
    static constexpr std::size_t GuardSize = 64;

    std::size_t end_;
    std::vector<char> memory_;
    Arguments* arguments_;
};

std::string Text(std::size_t size) {
    return std::string(size, 'x');
}

} // namespace

TEST(CommandArguments, StandInTheRoomOfTheirLine) {
    for (std::size_t size = 0; size <= 40; ++size) {
        for (const std::size_t count : {1U, 2U, 3U}) {
            StringArray words("SET IT", " ", true, nullptr);
            for (std::size_t i = 0; i < count; ++i) {
                words.Add(Port::String(Text(size)));
            }
            const std::size_t room = Arguments::RoomFor(words, std::string("SET IT").size());
            // Twelve bytes are the least.
            EXPECT_EQ(room, std::max<std::size_t>(12, count * (size + 1)));
            const Guarded arguments(room);
            const auto text = [&](std::size_t i) {
                return words.GetView(static_cast<int>(i < count ? i + 2 : 99));
            };
            switch (count) {
            case 1:
                arguments->Set({text(0)});
                break;
            case 2:
                arguments->Set({text(0), text(1)});
                break;
            default:
                arguments->Set({text(0), text(1), text(2)});
            }
            for (std::size_t i = 0; i < count; ++i) {
                EXPECT_EQ(arguments->Get(static_cast<int>(i)), text(i)) << size;
                EXPECT_TRUE(arguments.IsInRoom(arguments->Get(static_cast<int>(i)))) << size;
            }
            EXPECT_TRUE(arguments.IsIntact()) << size;
        }
    }
}

TEST(CommandArguments, ThatFindNoRoomGetABlock) {
    for (std::size_t room = 12; room <= 40; ++room) {
        for (std::size_t size = 0; size <= 80; ++size) {
            const Guarded arguments(room);
            const std::string text = Text(size);
            arguments->Set({text, "y"});
            EXPECT_EQ(arguments->Get(0), text);
            EXPECT_STREQ(arguments->Get(1), "y");
            EXPECT_EQ(arguments.IsInRoom(arguments->Get(0)), size + 3 <= room) << room;
            EXPECT_TRUE(arguments.IsIntact()) << room << " " << size;
        }
    }
}

TEST(CommandArguments, CanBeSetAgain) {
    const Guarded arguments(12);
    arguments->Set({Text(500), "second"});
    arguments->Set({"a"});
    EXPECT_STREQ(arguments->Get(0), "a");
    EXPECT_STREQ(arguments->Get(1), "");
    EXPECT_TRUE(arguments.IsInRoom(arguments->Get(0)));
    arguments->Set({Text(1000)});
    EXPECT_EQ(arguments->Get(0), Text(1000));
    EXPECT_TRUE(arguments.IsIntact());
}

TEST(CommandArguments, ThatAreMissingReadAsEmpty) {
    const Guarded arguments(12);
    EXPECT_STREQ(arguments->Get(0), "");
    arguments->Set({"a", ""});
    for (const int index : {-1, 1, 2, 1000}) {
        EXPECT_STREQ(arguments->Get(index), "") << index;
    }
}

TEST(CommandArguments, HaveFlagsUntilTheyAreSetAgain) {
    const Guarded arguments(12);
    EXPECT_FALSE(arguments->Has(Flag::First));
    arguments->Raise(Flag::Second);
    EXPECT_FALSE(arguments->Has(Flag::First));
    EXPECT_TRUE(arguments->Has(Flag::Second));
    arguments->Raise(Flag::First);
    EXPECT_TRUE(arguments->Has(Flag::First));
    EXPECT_TRUE(arguments->Has(Flag::Second));
    arguments->Set({"a"});
    EXPECT_FALSE(arguments->Has(Flag::First));
    EXPECT_FALSE(arguments->Has(Flag::Second));
}
