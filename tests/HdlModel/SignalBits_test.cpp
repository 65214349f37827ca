#include "HdlModel/Signals/SignalBits.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Names::Range;
using Texts = std::vector<std::string>;

constexpr std::int64_t All = INT64_MAX;

Texts BitsOf(const Signal& signal, std::int64_t most = All) {
    Texts bits;
    const auto add = [&bits](std::string_view bit) { bits.emplace_back(bit); };
    const std::int64_t calls = SignalBits::ForEach(signal, most, add);
    EXPECT_EQ(calls, static_cast<std::int64_t>(bits.size()));
    return bits;
}

TEST(Range, TellsItsDirection) {
    EXPECT_TRUE((Range{7, 0}.IsDownTo()));
    EXPECT_FALSE((Range{0, 7}.IsDownTo()));
    EXPECT_FALSE((Range{3, 3}.IsDownTo()));
    EXPECT_TRUE((Range{3, 3}.IsOneBit()));
    EXPECT_FALSE((Range{1, -1}.IsOneBit()));
}

TEST(Range, CountsItsBitsExactly) {
    EXPECT_EQ((Range{7, 0}.GetBits()), 8);
    EXPECT_EQ((Range{-1, 2}.GetBits()), 4);
    EXPECT_EQ((Range{5, 5}.GetBits()), 1);
    EXPECT_EQ((Range{INT_MIN, INT_MAX}.GetBits()), 4294967296);
    EXPECT_EQ((Range{INT_MIN, INT_MAX}.GetWidth()), INT_MAX);
    EXPECT_TRUE((Range{1048575, 0}.IsExpandable()));
    EXPECT_FALSE((Range{0, 1048576}.IsExpandable()));
}

TEST(Range, CountsIndicesFromTheLeft) {
    EXPECT_EQ((Range{7, 0}.IndexAt(2)), 5);
    EXPECT_EQ((Range{0, 7}.IndexAt(2)), 2);
    EXPECT_EQ((Range{1, -1}.IndexAt(2)), -1);
    EXPECT_EQ((Range{INT_MIN, INT_MAX}.IndexAt(4294967295)), INT_MAX);
    EXPECT_EQ((Range{INT_MAX, INT_MIN}.IndexAt(4294967295)), INT_MIN);
}

TEST(SignalBits, OfAScalarAndOfABitAreItself) {
    const ScalarSignal scalar("N");
    const BusIndex bit("D(+2)", nullptr);
    for (const Signal* signal :
         {static_cast<const Signal*>(&scalar), static_cast<const Signal*>(&bit)}) {
        EXPECT_TRUE(SignalBits::IsSingle(*signal));
        EXPECT_EQ(SignalBits::Count(*signal), 1);
        EXPECT_EQ(BitsOf(*signal), Texts{std::string(signal->GetNameView())});
    }
}

TEST(SignalBits, OfABusRunInItsDirection) {
    EXPECT_EQ(BitsOf(Bus("D(2:0)")), (Texts{"D(2)", "D(1)", "D(0)"}));
    EXPECT_EQ(BitsOf(BusSlice("D(0:2)", nullptr)), (Texts{"D(0)", "D(1)", "D(2)"}));
    const Bus narrow("D(3:3)");
    EXPECT_FALSE(SignalBits::IsSingle(narrow));
    EXPECT_EQ(SignalBits::Count(narrow), 1);
    EXPECT_EQ(BitsOf(narrow), Texts{"D(3)"});
}

TEST(SignalBits, OfACompoundAreThoseOfItsMembers) {
    ScalarSignal a("A");
    Bus bus("D(1:0)");
    BusSlice slice("E(0:1)", nullptr);
    CompoundBus inner("D(1:0),A");
    inner.AddBusMember(&bus);
    inner.AddBusMember(&a);
    CompoundBus outer("A,D(1:0),A,E(0:1)");
    outer.AddBusMember(&a);
    outer.AddBusMember(&inner);
    outer.AddBusMember(&slice);
    EXPECT_FALSE(SignalBits::IsSingle(outer));
    EXPECT_EQ(SignalBits::Count(outer), 6);
    EXPECT_EQ(BitsOf(outer), (Texts{"A", "D(1)", "D(0)", "A", "E(0)", "E(1)"}));
    EXPECT_EQ(SignalBits::Count(CompoundBus("none")), 0);
    EXPECT_EQ(BitsOf(CompoundBus("none")), Texts());
}

TEST(SignalBits, StopAtTheBound) {
    ScalarSignal a("A");
    Bus bus("D(1048575:0)");
    CompoundBus compound("A,D,A");
    for (Signal* member : {static_cast<Signal*>(&a), static_cast<Signal*>(&bus)}) {
        compound.AddBusMember(member);
    }
    EXPECT_EQ(SignalBits::Count(compound), 1048577);
    EXPECT_EQ(BitsOf(compound, 3), (Texts{"A", "D(1048575)", "D(1048574)"}));
    EXPECT_EQ(BitsOf(compound, 1), Texts{"A"});
    EXPECT_EQ(BitsOf(compound, 0), Texts());
    EXPECT_EQ(BitsOf(compound, -1), Texts());
    EXPECT_EQ(BitsOf(bus, -1), Texts());
}

TEST(SignalBits, AreNotCountedWhenAPartCannotBeListed) {
    Bus tooWide("D(1048576:0)");
    Bus nameless("D");
    EXPECT_EQ(SignalBits::Count(tooWide), std::nullopt);
    EXPECT_EQ(SignalBits::Count(nameless), std::nullopt);
    EXPECT_EQ(BitsOf(nameless), Texts());
    for (Bus* member : {&tooWide, &nameless}) {
        ScalarSignal a("A");
        CompoundBus inner("A,D");
        inner.AddBusMember(&a);
        inner.AddBusMember(member);
        CompoundBus outer("A,A,D");
        outer.AddBusMember(&a);
        outer.AddBusMember(&inner);
        EXPECT_EQ(SignalBits::Count(outer), std::nullopt);
    }
}

} // namespace
