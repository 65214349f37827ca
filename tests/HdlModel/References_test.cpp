// Signals that name others: as alias, as member of a compound, as something else among the slices
// of a bus. Whichever is destroyed first, the other names it no more.
#include "Orn_Hdl/Model.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <memory>

namespace {

using namespace Orn_Hdl;

using Kept = std::unique_ptr<Signal>;

int CountOf(const Iterator<Signal*>& list, const Signal* signal) {
    int count = 0;
    for (const Signal* each : list) {
        count += each == signal ? 1 : 0;
    }
    return count;
}

/// A signal that names others in each way that its class has.
struct Alias {
    using Class = ScalarSignal;
    static std::unique_ptr<Class> Make() { return std::make_unique<Class>("N"); }
    static void Name(Class& by, Signal& named) { by.Connect(&named); }
    static void Drop(Class& by, Signal& named) { by.Disconnect(&named); }
    static Iterator<Signal*> Get(const Class& by) { return by.GetSignalIterator(); }
};
struct AliasOfBus {
    using Class = Bus;
    static std::unique_ptr<Class> Make() { return std::make_unique<Class>("D(7:0)"); }
    static void Name(Class& by, Signal& named) { by.Connect(&named); }
    static void Drop(Class& by, Signal& named) { by.Disconnect(&named); }
    static Iterator<Signal*> Get(const Class& by) { return by.GetSignalIterator(); }
};
struct Slice {
    using Class = Bus;
    static std::unique_ptr<Class> Make() { return std::make_unique<Class>("D(7:0)"); }
    static void Name(Class& by, Signal& named) { by.AddBusSlice(&named); }
    static void Drop(Class& by, Signal& named) { by.RemoveBusSlice(&named); }
    static Iterator<Signal*> Get(const Class& by) { return by.GetBusSliceIterator(); }
};
struct Member {
    using Class = CompoundBus;
    static std::unique_ptr<Class> Make() { return std::make_unique<Class>("A,B"); }
    static void Name(Class& by, Signal& named) {
        if (CountOf(by.GetBusMemberIterator(), &named) == 0) {
            by.AddBusMember(&named);
        }
    }
    static void Drop(Class& by, Signal& named) {
        static ScalarSignal other("other");
        for (int i = 0; i < by.GetSize(); ++i) {
            if (by.GetAt(i) == &named) {
                by.SetAt(i, &other);
            }
        }
    }
    static Iterator<Signal*> Get(const Class& by) { return by.GetBusMemberIterator(); }
};

template <class Way> class References : public testing::Test {
protected:
    std::unique_ptr<typename Way::Class> by_ = Way::Make();
    Kept named_ = std::make_unique<ScalarSignal>("A");

    int GetCount() const { return CountOf(Way::Get(*by_), named_.get()); }
    bool IsEmpty() const { return Way::Get(*by_).IsAtEnd(); }
};

using Ways = testing::Types<Alias, AliasOfBus, Slice, Member>;
TYPED_TEST_SUITE(References, Ways);

TYPED_TEST(References, NameASignalOnce) {
    TypeParam::Name(*this->by_, *this->named_);
    TypeParam::Name(*this->by_, *this->named_);
    EXPECT_EQ(this->GetCount(), 1);
}

TYPED_TEST(References, LoseTheDestroyedSignal) {
    TypeParam::Name(*this->by_, *this->named_);
    this->named_.reset();
    EXPECT_TRUE(this->IsEmpty());
}

TYPED_TEST(References, AreDestroyedFirst) {
    TypeParam::Name(*this->by_, *this->named_);
    this->by_ = TypeParam::Make();
    EXPECT_TRUE(this->IsEmpty());
    TypeParam::Name(*this->by_, *this->named_);
    this->named_.reset();
    EXPECT_TRUE(this->IsEmpty());
}

TYPED_TEST(References, ThatWereDroppedCanBeMadeAgain) {
    TypeParam::Name(*this->by_, *this->named_);
    TypeParam::Drop(*this->by_, *this->named_);
    EXPECT_EQ(this->GetCount(), 0);
    TypeParam::Name(*this->by_, *this->named_);
    EXPECT_EQ(this->GetCount(), 1);
    const Signal* const destroyed = this->named_.get();
    this->named_.reset();
    EXPECT_EQ(CountOf(TypeParam::Get(*this->by_), destroyed), 0);
}

TYPED_TEST(References, OfManySignalsAreToldOneByOne) {
    const auto second = TypeParam::Make();
    TypeParam::Name(*this->by_, *this->named_);
    TypeParam::Name(*second, *this->named_);
    TypeParam::Drop(*this->by_, *this->named_);
    EXPECT_EQ(CountOf(TypeParam::Get(*second), this->named_.get()), 1);
    this->named_.reset();
    EXPECT_TRUE(TypeParam::Get(*second).IsAtEnd());
}

TEST(BusParts, KnowTheirPresentBusOnly) {
    auto first = std::make_unique<Bus>("D(7:0)");
    auto second = std::make_unique<Bus>("E(7:0)");
    BusSlice slice("D(3:0)", first.get());
    BusIndex bit("D(4)", first.get());
    for (BusPart* part : {static_cast<BusPart*>(&slice), static_cast<BusPart*>(&bit)}) {
        EXPECT_EQ(part->GetParentBus(), first.get());
        second->AddBusSlice(part);
        EXPECT_EQ(part->GetParentBus(), second.get());
        EXPECT_EQ(CountOf(first->GetBusSliceIterator(), part), 0);
        second->SetPortPolarity(Polarity("out"));
        EXPECT_EQ(part->GetPortPolarity(), Polarity("out"));
        // A bus that does not list the part does not drop it.
        first->RemoveBusSlice(part);
        EXPECT_EQ(part->GetParentBus(), second.get());
    }
    first.reset();
    second.reset();
    EXPECT_EQ(slice.GetParentBus(), nullptr);
    EXPECT_EQ(bit.GetParentBus(), nullptr);
    EXPECT_FALSE(slice.GetPortPolarity().IsValid());
}

TEST(References, ACompoundThatRepeatsAMemberForgetsItAltogether) {
    auto member = std::make_unique<ScalarSignal>("A");
    ScalarSignal other("B");
    CompoundBus compound("C");
    CompoundBus second("D");
    for (Signal* signal : std::initializer_list<Signal*>{member.get(), &other, member.get()}) {
        compound.AddBusMember(signal);
        second.AddBusMember(signal);
    }
    member.reset();
    ASSERT_EQ(compound.GetSize(), 1);
    EXPECT_EQ(compound.GetAt(0), &other);
    ASSERT_EQ(second.GetSize(), 1);
    EXPECT_EQ(second.GetAt(0), &other);
}

TEST(References, AWidenedBusIsReplacedWhereverACompoundRepeatsIt) {
    Model model(nullptr);
    model.AddComponent("C");
    model.AddPin("A", Polarity(Polarity::Input), "C", "");
    model.AddInstance("u", "C");
    model.ConnectSignalToPin("d(1:0),x,d(1:0)", "u", "A");
    const Signal* const repeated = model.GetSignal("d(1:0),x,d(1:0)");
    model.ConnectSignalToPin("d(2:0)", "u", "A");
    const auto* const compound = dynamic_cast<const CompoundBus*>(repeated);
    ASSERT_NE(compound, nullptr);
    Signal* const slice = model.GetSignal("d(1:0)");
    EXPECT_NE(dynamic_cast<BusSlice*>(slice), nullptr);
    EXPECT_EQ(compound->GetAt(0), slice);
    EXPECT_EQ(compound->GetAt(1), model.GetSignal("x"));
    EXPECT_EQ(compound->GetAt(2), slice);
}

} // namespace
