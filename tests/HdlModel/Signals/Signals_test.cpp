#include "Orn_Hdl/Model.h"

#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers.h"
#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Bi;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

Names BaseNamesOf(const Signal& signal) {
    StringSet names;
    signal.GetBaseName(names);
    Names list = NamesOf(names);
    std::sort(list.begin(), list.end());
    return list;
}

TEST(Signal, ListsAPinOnce) {
    ScalarSignal signal("N");
    ScalarPin pin("A", In);
    signal.Connect(&pin);
    signal.Connect(&pin);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names{"A"});
    EXPECT_EQ(pin.GetSignal(), &signal);
}

TEST(Signal, ConnectKeepsTheOrder) {
    ScalarSignal signal("N");
    ScalarPin a("A", In);
    ScalarPin b("B", In);
    ScalarPin c("C", In);
    signal.Connect(&b);
    signal.Connect(&a);
    signal.Connect(&c);
    signal.Connect(&b);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), (Names{"B", "A", "C"}));
}

TEST(Signal, ConnectOfNullDoesNothing) {
    ScalarSignal signal("N");
    signal.Connect(static_cast<Pin*>(nullptr));
    signal.Connect(static_cast<Signal*>(nullptr));
    signal.Disconnect(static_cast<Pin*>(nullptr));
    signal.Disconnect(static_cast<Signal*>(nullptr));
    signal.CloneConnection(nullptr);
    signal.DisconnectAll();
    EXPECT_TRUE(signal.GetPinIterator().IsAtEnd());
    EXPECT_TRUE(signal.GetSignalIterator().IsAtEnd());
}

TEST(Signal, AnIteratorSeesAliasesThatAreConnectedLater) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    auto at = a.GetSignalIterator();
    const auto start = at;
    EXPECT_TRUE(at.IsAtEnd());
    a.Connect(&b);
    EXPECT_EQ(at.GetCurrent(), &b);
    EXPECT_EQ(NamesOf(start), Names{"B"});
    a.Disconnect(&b);
    EXPECT_TRUE(at.IsAtEnd());
}

TEST(Signal, APinThatMovesOnStaysListedByTheFormerSignal) {
    ScalarSignal first("N1");
    ScalarSignal second("N2");
    ScalarPin pin("A", In);
    first.Connect(&pin);
    second.Connect(&pin);
    EXPECT_EQ(pin.GetSignal(), &second);
    EXPECT_EQ(NamesOf(first.GetPinIterator()), Names{"A"});
    EXPECT_EQ(NamesOf(second.GetPinIterator()), Names{"A"});
}

TEST(Signal, AListedPinThatPointsElsewhereIsPointedHereAgain) {
    ScalarSignal first("N1");
    ScalarSignal second("N2");
    ScalarPin pin("A", In);
    first.Connect(&pin);
    second.Connect(&pin);
    first.Connect(&pin);
    EXPECT_EQ(pin.GetSignal(), &first);
    EXPECT_EQ(NamesOf(first.GetPinIterator()), Names{"A"});
    EXPECT_EQ(NamesOf(second.GetPinIterator()), Names{"A"});
    pin.Disconnect();
    second.Connect(&pin);
    EXPECT_EQ(pin.GetSignal(), &second);
    EXPECT_EQ(NamesOf(second.GetPinIterator()), Names{"A"});
}

TEST(Signal, APinThatOnlyPointsHereIsListedByConnect) {
    ScalarSignal signal("N");
    ScalarPin pin("A", In);
    pin.Connect(&signal);
    signal.Connect(&pin);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names{"A"});
}

TEST(Signal, AliasesAreOneWay) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    a.Connect(&b);
    a.Connect(&b);
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names{"B"});
    EXPECT_EQ(NamesOf(b.GetSignalIterator()), Names());
    b.Connect(&a);
    EXPECT_EQ(NamesOf(b.GetSignalIterator()), Names{"A"});
}

TEST(Signal, IsNoAliasOfItself) {
    ScalarSignal a("A");
    a.Connect(&a);
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names());
}

TEST(Signal, DisconnectOpensThePin) {
    ScalarSignal signal("N");
    ScalarPin a("A", In);
    ScalarPin b("B", In);
    signal.Connect(&a);
    signal.Connect(&b);
    signal.Disconnect(&a);
    EXPECT_EQ(a.GetSignal(), nullptr);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names{"B"});
    signal.Disconnect(&a);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names{"B"});
}

TEST(Signal, DisconnectLeavesAPinThatPointsElsewhere) {
    ScalarSignal first("N1");
    ScalarSignal second("N2");
    ScalarPin pin("A", In);
    first.Connect(&pin);
    second.Connect(&pin);
    first.Disconnect(&pin);
    EXPECT_EQ(pin.GetSignal(), &second);
    EXPECT_EQ(NamesOf(first.GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(second.GetPinIterator()), Names{"A"});
    ScalarSignal third("N3");
    third.Disconnect(&pin);
    EXPECT_EQ(pin.GetSignal(), &second);
}

TEST(Signal, DisconnectOpensAPinThatItDoesNotList) {
    ScalarSignal signal("N");
    ScalarPin pin("A", In);
    pin.Connect(&signal);
    signal.Disconnect(&pin);
    EXPECT_EQ(pin.GetSignal(), nullptr);
}

TEST(Signal, DisconnectsAnAlias) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    ScalarSignal c("C");
    a.Connect(&b);
    a.Connect(&c);
    a.Disconnect(&b);
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names{"C"});
    a.Disconnect(&b);
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names{"C"});
}

TEST(Signal, DisconnectAllOpensThePinsThatPointHere) {
    ScalarSignal signal("N");
    ScalarSignal other("M");
    ScalarPin listed("A", In);
    ScalarPin unlisted("B", In);
    ScalarPin moved("C", In);
    signal.Connect(&listed);
    signal.Connect(&moved);
    signal.Connect(&other);
    unlisted.Connect(&signal);
    other.Connect(&moved);
    signal.DisconnectAll();
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(signal.GetSignalIterator()), Names());
    EXPECT_EQ(listed.GetSignal(), nullptr);
    EXPECT_EQ(unlisted.GetSignal(), nullptr);
    EXPECT_EQ(moved.GetSignal(), &other);
}

TEST(Signal, CloneConnectionTakesThePinsThatStillPointThereAndTheAliases) {
    ScalarSignal other("O");
    ScalarSignal mine("M");
    ScalarSignal alias("X");
    ScalarSignal away("Y");
    ScalarPin still("A", In);
    ScalarPin gone("B", In);
    ScalarPin open("C", In);
    ScalarPin unlisted("D", In);
    other.Connect(&still);
    other.Connect(&gone);
    other.Connect(&open);
    unlisted.Connect(&other);
    other.Connect(&alias);
    other.Connect(&mine);
    away.Connect(&gone);
    open.Disconnect();
    mine.CloneConnection(&other);
    EXPECT_EQ(NamesOf(mine.GetPinIterator()), Names{"A"});
    EXPECT_EQ(NamesOf(mine.GetSignalIterator()), Names{"X"}) << "no alias of itself";
    EXPECT_EQ(still.GetSignal(), &mine);
    EXPECT_EQ(gone.GetSignal(), &away);
    EXPECT_EQ(open.GetSignal(), nullptr);
    EXPECT_EQ(unlisted.GetSignal(), &other);
    EXPECT_EQ(NamesOf(other.GetPinIterator()), (Names{"A", "B", "C"})) << "its lists stay";
    EXPECT_EQ(NamesOf(other.GetSignalIterator()), (Names{"X", "M"}));
}

TEST(Signal, CloneConnectionOfItselfChangesNothing) {
    ScalarSignal signal("N");
    ScalarSignal alias("X");
    ScalarPin pin("A", In);
    signal.Connect(&pin);
    signal.Connect(&alias);
    signal.CloneConnection(&signal);
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names{"A"});
    EXPECT_EQ(NamesOf(signal.GetSignalIterator()), Names{"X"});
    EXPECT_EQ(pin.GetSignal(), &signal);
}

TEST(Signal, HasSeveralDriversWhenMoreThanOneListedOutputPointsHere) {
    ScalarSignal signal("N");
    ScalarSignal other("M");
    ScalarPin a("A", Out);
    ScalarPin b("B", Out);
    ScalarPin c("C", Bi);
    ScalarPin d("D", In);
    ScalarPin e("E", Polarity());
    for (Pin* pin : {&a, &c, &d, &e}) {
        signal.Connect(pin);
    }
    EXPECT_FALSE(signal.HasMultiDriver());
    b.Connect(&signal);
    EXPECT_FALSE(signal.HasMultiDriver()) << "B is not listed";
    signal.Connect(&b);
    EXPECT_TRUE(signal.HasMultiDriver());
    other.Connect(&a);
    EXPECT_FALSE(signal.HasMultiDriver()) << "A points elsewhere";
    signal.Connect(&a);
    EXPECT_TRUE(signal.HasMultiDriver());
    b.SetPolarity(Bi);
    EXPECT_FALSE(signal.HasMultiDriver());
}

TEST(Signal, HoldsAConstant) {
    ScalarSignal signal("N");
    EXPECT_EQ(signal.GetConstantValue().GetValue(), "");
    signal.AssignConstantValue("8:H:A5");
    EXPECT_EQ(signal.GetConstantValue().GetValue(), "A5");
    EXPECT_EQ(signal.GetConstantValue().GetBase(), 16);
    EXPECT_EQ(signal.GetConstantValue().GetLength(), 8);
    ScalarSignal other("M");
    other.AssignConstantValue(signal.GetConstantValue());
    signal.AssignConstantValue(static_cast<const char*>(nullptr));
    EXPECT_EQ(signal.GetConstantValue().GetValue(), "");
    EXPECT_EQ(other.GetConstantValue().GetValue(), "A5");
    EXPECT_TRUE(other.GetConstantValue().HasBaseAndLength());
}

TEST(Signal, WidthsFollowTheName) {
    EXPECT_EQ(ScalarSignal("N").GetWidth(), 1);
    EXPECT_EQ(Bus("D(7:0)").GetWidth(), 8);
    EXPECT_EQ(Bus("D(0:7)").GetWidth(), 8);
    EXPECT_EQ(Bus("D(3:3)").GetWidth(), 1);
    EXPECT_EQ(Bus("D").GetWidth(), 0);
    EXPECT_EQ(Bus("D(-1:3)").GetWidth(), 0) << "its - has become a :";
    EXPECT_EQ(BusSlice("D(5:2)", nullptr).GetWidth(), 4);
    EXPECT_EQ(BusSlice("D(5)", nullptr).GetWidth(), 0);
    EXPECT_EQ(BusIndex("D(5)", nullptr).GetWidth(), 1);
    EXPECT_EQ(BusIndex("D", nullptr).GetWidth(), 1);
    EXPECT_EQ(Bus("D(2147483647:0)").GetWidth(), INT_MAX);
    EXPECT_EQ(Bus("D(0:99999999999999)").GetWidth(), INT_MAX);
    EXPECT_EQ(Bus("D(2147483646:0)").GetWidth(), INT_MAX);
    EXPECT_EQ(Bus("D(2147483645:0)").GetWidth(), INT_MAX - 1);
}

TEST(Bus, KnowsItsIndicesAndDirection) {
    const Bus bus("D[07-+0]");
    Port::String left;
    Port::String right;
    EXPECT_EQ(bus.GetName(), "D(07:+0)");
    EXPECT_TRUE(bus.GetIndex(left, right));
    EXPECT_EQ(left, "07");
    EXPECT_EQ(right, "+0");
    int leftNumber = 0;
    int rightNumber = 0;
    EXPECT_TRUE(bus.GetIndex(leftNumber, rightNumber));
    EXPECT_EQ(leftNumber, 7);
    EXPECT_EQ(rightNumber, 0);
    EXPECT_TRUE(bus.IsDownTo());
    EXPECT_EQ(bus.GetBaseName(), "D");
    EXPECT_FALSE(Bus("D(0:7)").IsDownTo());
    EXPECT_FALSE(Bus("D(3:3)").IsDownTo());
    const Bus none("D");
    leftNumber = 77;
    EXPECT_FALSE(none.GetIndex(leftNumber, rightNumber));
    EXPECT_FALSE(none.GetIndex(left, right));
    EXPECT_EQ(leftNumber, 77);
    EXPECT_FALSE(none.IsDownTo());
    EXPECT_EQ(none.GetBaseName(), "D");
}

TEST(Bus, KnowsItsSlicesAndBits) {
    Bus bus("D(7:0)");
    BusSlice slice("D(3:0)", &bus);
    BusIndex bit("D(5)", &bus);
    EXPECT_EQ(NamesOf(bus.GetBusSliceIterator()), (Names{"D(3:0)", "D(5)"}));
    EXPECT_EQ(slice.GetParentBus(), &bus);
    EXPECT_EQ(bit.GetParentBus(), &bus);
    bus.AddBusSlice(&slice);
    bus.AddBusSlice(nullptr);
    EXPECT_EQ(NamesOf(bus.GetBusSliceIterator()), (Names{"D(3:0)", "D(5)"}));
    bus.RemoveBusSlice(&slice);
    bus.RemoveBusSlice(&slice);
    bus.RemoveBusSlice(nullptr);
    EXPECT_EQ(NamesOf(bus.GetBusSliceIterator()), Names{"D(5)"});
    EXPECT_EQ(slice.GetParentBus(), nullptr);
    bus.EmptyBusSlice();
    EXPECT_TRUE(bus.GetBusSliceIterator().IsAtEnd());
    EXPECT_EQ(bit.GetParentBus(), nullptr);
}

TEST(Bus, TakesASliceFromItsFormerParent) {
    Bus first("D(7:0)");
    Bus second("D(15:0)");
    BusSlice slice("D(3:0)", &first);
    second.AddBusSlice(&slice);
    EXPECT_EQ(slice.GetParentBus(), &second);
    EXPECT_EQ(NamesOf(second.GetBusSliceIterator()), Names{"D(3:0)"});
    EXPECT_TRUE(first.GetBusSliceIterator().IsAtEnd());
}

TEST(Bus, SurvivesStrangeSlices) {
    Bus bus("D(7:0)");
    Bus other("E(7:0)");
    ScalarSignal scalar("N");
    CompoundBus compound("N,D(3)");
    bus.AddBusSlice(&bus);
    bus.AddBusSlice(&other);
    bus.AddBusSlice(&scalar);
    bus.AddBusSlice(&compound);
    bus.RemoveBusSlice(&other);
    other.AddBusSlice(&bus);
    EXPECT_EQ(bus.GetWidth(), 8);
    EXPECT_EQ(bus.GetPortPolarity(), Polarity());
}

TEST(BusSlice, KnowsItsNameAndDirection) {
    Bus down("D(7:0)");
    Bus up("E(0:7)");
    const BusSlice slice("D(3:+0)", &down);
    Port::String left;
    Port::String right;
    EXPECT_TRUE(slice.GetIndex(left, right));
    EXPECT_EQ(left, "3");
    EXPECT_EQ(right, "+0");
    EXPECT_EQ(slice.GetBaseName(), "D");
    EXPECT_TRUE(slice.IsDownTo());
    EXPECT_FALSE(BusSlice("E(0:3)", &up).IsDownTo());
    EXPECT_FALSE(BusSlice("E(3:3)", &up).IsDownTo());
}

TEST(BusSlice, ComparesItsDirectionWithItsParents) {
    Bus down("D(7:0)");
    Bus up("E(0:7)");
    Bus single("F(3:3)");
    EXPECT_TRUE(BusSlice("D(3:0)", &down).IsSameDirectionAsParent());
    EXPECT_FALSE(BusSlice("D(0:3)", &down).IsSameDirectionAsParent());
    EXPECT_TRUE(BusSlice("E(0:3)", &up).IsSameDirectionAsParent());
    EXPECT_FALSE(BusSlice("E(3:0)", &up).IsSameDirectionAsParent());
    EXPECT_FALSE(BusSlice("D(3:3)", &down).IsSameDirectionAsParent()) << "one bit";
    EXPECT_FALSE(BusSlice("E(3:3)", &up).IsSameDirectionAsParent()) << "one bit";
    EXPECT_FALSE(BusSlice("F(3:3)", &single).IsSameDirectionAsParent()) << "one bit";
    EXPECT_TRUE(BusSlice("D(0:3)", nullptr).IsSameDirectionAsParent());
    EXPECT_TRUE(BusSlice("D(3:3)", nullptr).IsSameDirectionAsParent());
}

TEST(BusIndex, KnowsItsIndex) {
    const BusIndex bit("D[+05]", nullptr);
    EXPECT_EQ(bit.GetIndex(), "+05");
    EXPECT_EQ(bit.GetBaseName(), "D");
    EXPECT_EQ(BusIndex("D", nullptr).GetIndex(), "");
    EXPECT_EQ(BusIndex("D", nullptr).GetBaseName(), "D");
}

TEST(PortPolarity, OfScalarsAndBusesIsTheirOwn) {
    ScalarSignal scalar("N");
    Bus bus("D(7:0)");
    for (Signal* signal : {static_cast<Signal*>(&scalar), static_cast<Signal*>(&bus)}) {
        EXPECT_EQ(signal->GetPortPolarity(), Polarity());
        EXPECT_FALSE(signal->IsPort());
        EXPECT_TRUE(signal->IsNeededToDeclared());
        for (const Polarity& polarity : {In, Out, Bi}) {
            signal->SetPortPolarity(polarity);
            EXPECT_EQ(signal->GetPortPolarity(), polarity);
            EXPECT_TRUE(signal->IsPort());
        }
        for (const int value : {3, -2, INT_MAX, -1}) {
            signal->SetPortPolarity(Polarity(value));
            EXPECT_FALSE(signal->IsPort()) << value;
        }
    }
}

TEST(PortPolarity, OfASliceIsItsParents) {
    Bus bus("D(7:0)");
    BusSlice slice("D(3:0)", &bus);
    slice.SetPortPolarity(In);
    EXPECT_EQ(slice.GetPortPolarity(), Polarity());
    EXPECT_EQ(bus.GetPortPolarity(), Polarity()) << "setting does nothing";
    bus.SetPortPolarity(Out);
    EXPECT_EQ(slice.GetPortPolarity(), Out);
    EXPECT_FALSE(slice.IsPort());
    EXPECT_FALSE(slice.IsNeededToDeclared());
    bus.RemoveBusSlice(&slice);
    EXPECT_EQ(slice.GetPortPolarity(), Polarity());
}

TEST(PortPolarity, OfABitIsItsParentsOrItsOwn) {
    Bus bus("D(7:0)");
    BusIndex bit("D(3)", &bus);
    bit.SetPortPolarity(In);
    EXPECT_EQ(bit.GetPortPolarity(), Polarity());
    EXPECT_FALSE(bit.IsPort());
    bus.SetPortPolarity(Out);
    EXPECT_EQ(bit.GetPortPolarity(), Out);
    EXPECT_TRUE(bit.IsPort());
    EXPECT_FALSE(bit.IsNeededToDeclared());
    bus.RemoveBusSlice(&bit);
    EXPECT_EQ(bit.GetPortPolarity(), In);
    EXPECT_TRUE(bit.IsPort());
    bit.SetPortPolarity(Polarity(7));
    EXPECT_FALSE(bit.IsPort());
}

TEST(PortPolarity, OfACompoundIsWhatItsMembersShare) {
    ScalarSignal a("A");
    Bus bus("D(3:0)");
    BusIndex bit("D(3)", &bus);
    CompoundBus compound("A,D(3:0),D(3)");
    EXPECT_EQ(compound.GetPortPolarity(), Polarity());
    compound.AddBusMember(&a);
    a.SetPortPolarity(In);
    EXPECT_EQ(compound.GetPortPolarity(), In);
    compound.AddBusMember(&bus);
    EXPECT_EQ(compound.GetPortPolarity(), Polarity());
    bus.SetPortPolarity(In);
    compound.AddBusMember(&bit);
    EXPECT_EQ(compound.GetPortPolarity(), In);
    bus.SetPortPolarity(Out);
    EXPECT_EQ(compound.GetPortPolarity(), Polarity());
    EXPECT_FALSE(compound.IsPort());
    EXPECT_FALSE(compound.IsNeededToDeclared());
}

TEST(PortPolarity, SetOnACompoundReachesEachMember) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    Bus bus("D(3:0)");
    CompoundBus inner("A,D(3:0)");
    inner.AddBusMember(&a);
    inner.AddBusMember(&bus);
    CompoundBus outer("outer");
    outer.AddBusMember(&inner);
    outer.AddBusMember(&b);
    outer.SetPortPolarity(Bi);
    EXPECT_EQ(a.GetPortPolarity(), Bi);
    EXPECT_EQ(bus.GetPortPolarity(), Bi);
    EXPECT_EQ(b.GetPortPolarity(), Bi);
    EXPECT_EQ(outer.GetPortPolarity(), Bi);
    EXPECT_FALSE(outer.IsPort());
}

TEST(CompoundBus, AddsUpItsMembers) {
    ScalarSignal a("A");
    Bus bus("D(3:0)");
    PtrArray<Signal*> members;
    members.Add(&a);
    members.Add(nullptr);
    members.Add(&bus);
    CompoundBus compound("A,D[3:0]", members);
    EXPECT_EQ(compound.GetName(), "A,D(3:0)");
    EXPECT_EQ(compound.GetSize(), 2) << "nulls are skipped";
    EXPECT_EQ(compound.GetWidth(), 5);
    EXPECT_EQ(compound.GetDummySignalName(), "A_DUMMY,D_DUMMY(3:0)");
    EXPECT_EQ(compound.GetAt(0), &a);
    EXPECT_EQ(compound.GetAt(1), &bus);
    EXPECT_EQ(compound.GetAt(2), nullptr);
    EXPECT_EQ(compound.GetAt(-1), nullptr);
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"A", "D(3:0)"}));
    compound.AddBusMember(&a);
    EXPECT_EQ(compound.GetWidth(), 6);
}

TEST(CompoundBus, WithoutMembersHasWidthZero) {
    const CompoundBus compound("A,B");
    EXPECT_EQ(compound.GetWidth(), 0);
    EXPECT_EQ(compound.GetDummySignalName(), "");
    EXPECT_EQ(compound.GetSize(), 0);
}

TEST(CompoundBus, WidthIsClampedToTheGreatestInt) {
    Bus giant("D(2147483647:0)");
    CompoundBus compound("c");
    for (int i = 0; i < 5; ++i) {
        compound.AddBusMember(&giant);
    }
    EXPECT_EQ(compound.GetWidth(), INT_MAX);
}

TEST(CompoundBus, ReplacesMembersInPlace) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    ScalarSignal c("C");
    CompoundBus compound("A,B");
    compound.AddBusMember(&a);
    compound.AddBusMember(&b);
    compound.SetAt(0, &c);
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"C", "B"}));
    compound.SetAt(1, nullptr);
    compound.SetAt(-1, &a);
    compound.SetAt(2, &a);
    compound.SetAt(INT_MAX, &a);
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), (Names{"C", "B"}));
}

TEST(CompoundBus, NeverContainsItself) {
    ScalarSignal a("A");
    CompoundBus inner("inner");
    CompoundBus middle("middle");
    CompoundBus outer("outer");
    inner.AddBusMember(&inner);
    inner.AddBusMember(nullptr);
    inner.AddBusMember(&a);
    middle.AddBusMember(&inner);
    outer.AddBusMember(&middle);
    inner.AddBusMember(&outer);
    inner.AddBusMember(&middle);
    inner.SetAt(0, &outer);
    inner.SetAt(0, &inner);
    EXPECT_EQ(NamesOf(inner.GetBusMemberIterator()), Names{"A"});
    EXPECT_EQ(outer.GetWidth(), 1);
    outer.AddBusMember(&inner);
    EXPECT_EQ(outer.GetWidth(), 2) << "the same member twice is no circle";
}

/// Compounds, each of which is a member of the one before.
class NestedCompounds : public testing::Test {
protected:
    CompoundBus& AddCompound() {
        compounds_.push_back(
            std::make_unique<CompoundBus>(("c" + std::to_string(compounds_.size())).c_str()));
        return *compounds_.back();
    }

    ScalarSignal leaf_{"leaf"};
    std::vector<std::unique_ptr<CompoundBus>> compounds_;
};

TEST_F(NestedCompounds, FromTheInnermostOut) {
    CompoundBus* inner = &AddCompound();
    inner->AddBusMember(&leaf_);
    for (int level = 1; level < CompoundBus::MostLevels; ++level) {
        CompoundBus& outer = AddCompound();
        outer.AddBusMember(inner);
        ASSERT_EQ(outer.GetSize(), 1) << level;
        inner = &outer;
    }
    EXPECT_EQ(inner->GetWidth(), 1);
    CompoundBus& tooDeep = AddCompound();
    tooDeep.AddBusMember(inner);
    EXPECT_EQ(tooDeep.GetSize(), 0);
    tooDeep.AddBusMember(&leaf_);
    tooDeep.SetAt(0, inner);
    EXPECT_EQ(tooDeep.GetAt(0), &leaf_);
    inner->SetPortPolarity(Polarity("in"));
    EXPECT_EQ(inner->GetPortPolarity(), Polarity("in"));
    EXPECT_EQ(inner->GetDummySignalName(), "leaf_DUMMY");
    StringSet names;
    inner->GetBaseName(names);
    EXPECT_TRUE(names.Contains("leaf"));
    EXPECT_TRUE(names.Contains("c0"));
    EXPECT_TRUE(names.Contains("c999"));
}

TEST_F(NestedCompounds, FromTheOutermostIn) {
    CompoundBus& outermost = AddCompound();
    CompoundBus* outer = &outermost;
    for (int level = 1; level < CompoundBus::MostLevels; ++level) {
        CompoundBus& inner = AddCompound();
        outer->AddBusMember(&inner);
        ASSERT_EQ(outer->GetSize(), 1) << level;
        outer = &inner;
    }
    CompoundBus& tooDeep = AddCompound();
    tooDeep.AddBusMember(&leaf_);
    outer->AddBusMember(&tooDeep);
    EXPECT_EQ(outer->GetSize(), 0);
    outer->AddBusMember(&leaf_);
    EXPECT_EQ(outermost.GetWidth(), 1);
    // What ends makes room.
    compounds_[1].reset();
    outer->AddBusMember(&tooDeep);
    EXPECT_EQ(outer->GetSize(), 2);
}

TEST_F(NestedCompounds, AliasesOfACompoundDoNotHoldIt) {
    CompoundBus* inner = &AddCompound();
    inner->AddBusMember(&leaf_);
    for (int level = 1; level < CompoundBus::MostLevels; ++level) {
        CompoundBus& outer = AddCompound();
        outer.AddBusMember(inner);
        inner = &outer;
    }
    CompoundBus& compound = AddCompound();
    CompoundBus& compoundAlias = AddCompound();
    ScalarSignal scalarAlias("s");
    compoundAlias.Connect(&compound);
    scalarAlias.Connect(&compound);
    compound.AddBusMember(inner);
    EXPECT_EQ(compound.GetSize(), 0) << "too deep, whatever the compound is connected to";
    compound.AddBusMember(compounds_.front().get());
    EXPECT_EQ(compound.GetSize(), 1);
}

TEST_F(NestedCompounds, OfManyOccurrencesAreRefused) {
    CompoundBus* inner = &AddCompound();
    inner->AddBusMember(&leaf_);
    int doublings = 0;
    for (; doublings < 64; ++doublings) {
        CompoundBus& outer = AddCompound();
        outer.AddBusMember(inner);
        outer.AddBusMember(inner);
        if (outer.GetSize() < 2) {
            break;
        }
        inner = &outer;
    }
    EXPECT_EQ(doublings, 10) << "the last contains 2046 compounds";
    EXPECT_EQ(inner->GetWidth(), 1 << 10);
    // One more in the innermost is 1024 more in the last, and fits once.
    for (int i = 0; i < 3; ++i) {
        compounds_[0]->AddBusMember(&AddCompound());
    }
    EXPECT_EQ(compounds_[0]->GetSize(), 2);
    // Other members do not count.
    compounds_[0]->AddBusMember(&leaf_);
    EXPECT_EQ(inner->GetWidth(), 2 << 10);
}

TEST_F(NestedCompounds, SideBySide) {
    CompoundBus& outer = AddCompound();
    for (int i = 0; i <= CompoundBus::MostCompounds; ++i) {
        outer.AddBusMember(&AddCompound());
    }
    EXPECT_EQ(outer.GetSize(), CompoundBus::MostCompounds);
}

TEST_F(NestedCompounds, NeverOverflowTheStack) {
    // Of five thousand that are to be nested, each thousand is.
    Netlist netlist("top");
    auto* const component = new Component("C");
    component->AddPin("I", Polarity("in"), "");
    netlist.Add(component);
    auto* inner = new CompoundBus("c0");
    netlist.Add(inner);
    for (int i = 1; i < 5000; ++i) {
        auto* const outer = new CompoundBus(("c" + std::to_string(i)).c_str());
        netlist.Add(outer);
        outer->AddBusMember(inner);
        inner = outer;
    }
    auto* const leaf = new ScalarSignal("leaf");
    leaf->SetPortPolarity(Polarity("out"));
    netlist.Add(leaf);
    static_cast<CompoundBus*>(netlist.GetSignal("c0"))->AddBusMember(leaf);
    auto* const instance = new Instance("U", component);
    netlist.Add(instance);
    netlist.GetSignal("c999")->Connect(instance->GetPin("I"));
    netlist.GetSignal("c999")->Connect(netlist.GetSignal("c500"));
    for (int i = 0; i < 2; ++i) {
        TextMemOutStream out;
        VerilogNetlister(out).WriteNetlist(&netlist, HdlOptions());
        HdlOptions options;
        VhdlNetlister(out).WriteNetlist(&netlist, &options);
        EXPECT_GE(out.GetValue().GetIndexOfString("I=>leaf"), 0);
    }
}

TEST(BaseNames, OfEachKindOfSignal) {
    ScalarSignal scalar("A");
    Bus bus("D(3:0)");
    BusSlice slice("E(1:0)", nullptr);
    BusIndex bit("F(1)", nullptr);
    ScalarSignal odd("G(x)");
    CompoundBus compound("A,D(3:0),F(1)");
    compound.AddBusMember(&scalar);
    compound.AddBusMember(&bus);
    compound.AddBusMember(&bit);
    EXPECT_EQ(BaseNamesOf(scalar), Names{"A"});
    EXPECT_EQ(BaseNamesOf(odd), Names{"G(x)"}) << "a scalar adds its whole name";
    EXPECT_EQ(BaseNamesOf(bus), Names{"D"});
    EXPECT_EQ(BaseNamesOf(slice), Names{"E"});
    EXPECT_EQ(BaseNamesOf(bit), Names{"F"});
    EXPECT_EQ(BaseNamesOf(compound), (Names{"A", "A,D(3:0),F(1)", "D", "F"}));
}

TEST(DummySignalName, OfEachKindOfSignal) {
    EXPECT_EQ(ScalarSignal("X").GetDummySignalName(), "X_DUMMY");
    EXPECT_EQ(ScalarSignal("X_dummy").GetDummySignalName(), "X_dummy");
    EXPECT_EQ(ScalarSignal("_DUMMY").GetDummySignalName(), "_DUMMY");
    EXPECT_EQ(ScalarSignal("DUMMY").GetDummySignalName(), "DUMMY_DUMMY");
    EXPECT_EQ(ScalarSignal("X_DUMMYx").GetDummySignalName(), "X_DUMMYx_DUMMY");
    EXPECT_EQ(Bus("D(+7:00)").GetDummySignalName(), "D_DUMMY(+7:00)");
    EXPECT_EQ(Bus("D_Dummy(7:0)").GetDummySignalName(), "D_Dummy(7:0)");
    EXPECT_EQ(BusSlice("D(3:0)", nullptr).GetDummySignalName(), "D_DUMMY(3:0)");
    EXPECT_EQ(BusSlice("D_DUMMY(3:0)", nullptr).GetDummySignalName(), "D_DUMMY_DUMMY(3:0)");
    EXPECT_EQ(BusIndex("D(3)", nullptr).GetDummySignalName(), "D_DUMMY(3)");
    EXPECT_EQ(BusIndex("D_DUMMY(3)", nullptr).GetDummySignalName(), "D_DUMMY_DUMMY(3)");
}

void Dress(Signal& signal) {
    signal.SetPortPolarity(Out);
    signal.AddComment("comment");
    signal.AddAttr(new AttributeString("a", "b"));
    signal.AssignConstantValue("1");
}

void ExpectNaked(const Signal& signal, const char* name) {
    EXPECT_EQ(signal.GetName(), name);
    EXPECT_FALSE(signal.IsPort());
    EXPECT_EQ(signal.GetComment(), "");
    EXPECT_FALSE(signal.HasAttrs());
    EXPECT_EQ(signal.GetConstantValue().GetValue(), "");
    EXPECT_TRUE(signal.GetPinIterator().IsAtEnd());
    EXPECT_TRUE(signal.GetSignalIterator().IsAtEnd());
}

TEST(CreateDummySignal, MakesASignalOfTheSameClassThatIsNoPort) {
    ScalarSignal scalar("X");
    Bus bus("D(7:0)");
    CompoundBus compound("X,D(7:0)");
    compound.AddBusMember(&scalar);
    compound.AddBusMember(&bus);
    ScalarPin pin("P", Out);
    for (Signal* signal : {static_cast<Signal*>(&scalar), static_cast<Signal*>(&bus),
                           static_cast<Signal*>(&compound)}) {
        Dress(*signal);
        signal->Connect(&pin);
    }
    const std::unique_ptr<ScalarSignal> scalarDummy(scalar.CreateDummySignal());
    ExpectNaked(*scalarDummy, "X_DUMMY");
    const std::unique_ptr<Bus> busDummy(bus.CreateDummySignal());
    ExpectNaked(*busDummy, "D_DUMMY(7:0)");
    EXPECT_TRUE(busDummy->GetBusSliceIterator().IsAtEnd());
    const std::unique_ptr<CompoundBus> compoundDummy(compound.CreateDummySignal());
    ExpectNaked(*compoundDummy, "X_DUMMY,D_DUMMY(7:0)");
    EXPECT_EQ(compoundDummy->GetSize(), 0);
}

TEST(CreateDummySignal, OfASliceOrBitBelongsToTheGivenParent) {
    Bus bus("D(7:0)");
    BusSlice slice("D(3:0)", &bus);
    BusIndex bit("D(5)", &bus);
    Dress(bus);
    Dress(slice);
    Dress(bit);
    Bus parent("D_DUMMY(7:0)");
    const std::unique_ptr<BusSlice> sliceDummy(slice.CreateDummySignal(&parent));
    const std::unique_ptr<BusIndex> bitDummy(bit.CreateDummySignal(&parent));
    ExpectNaked(*sliceDummy, "D_DUMMY(3:0)");
    ExpectNaked(*bitDummy, "D_DUMMY(5)");
    EXPECT_EQ(sliceDummy->GetParentBus(), &parent);
    EXPECT_EQ(bitDummy->GetParentBus(), &parent);
    EXPECT_EQ(NamesOf(parent.GetBusSliceIterator()), (Names{"D_DUMMY(3:0)", "D_DUMMY(5)"}));
    const std::unique_ptr<BusSlice> orphan(slice.CreateDummySignal(nullptr));
    EXPECT_EQ(orphan->GetParentBus(), nullptr);
}

TEST(Signal, AMillionPinsConnectInReasonableTime) {
    std::vector<std::unique_ptr<ScalarPin>> pins;
    ScalarSignal signal("N");
    ScalarSignal other("M");
    for (int i = 0; i < 1000000; ++i) {
        pins.push_back(std::make_unique<ScalarPin>("A", In));
        signal.Connect(pins.back().get());
        signal.Connect(pins.back().get());
    }
    other.CloneConnection(&signal);
    EXPECT_EQ(pins.back()->GetSignal(), &other);
    other.DisconnectAll();
    signal.DisconnectAll();
    EXPECT_EQ(pins.back()->GetSignal(), nullptr);
}

} // namespace
