#include "Orn_Hdl/Model/Object.h"

#include "Orn_Hdl/Model.h"
#include "Support/Names.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace {

using Orn_Hdl::Object;
using Orn_Hdl::ObjectVisitor;

/// The plainest object.
class Thing : public Object {
public:
    explicit Thing(const char* name = "", Orn_Hdl::ObjectType type = Orn_Hdl::ObjectTypeComponent)
        : Object(type) {
        SetName(name);
    }
    Thing(const Thing&) = default;
    Thing& operator=(const Thing&) = default;
    void AcceptObject(ObjectVisitor&) override {}
};

TEST(Object, StoresItsNameNormalised) {
    Thing thing;
    EXPECT_EQ(thing.GetName(), "");
    thing.SetName("DATA[7-0]");
    EXPECT_EQ(thing.GetName(), "DATA(7:0)");
    thing.SetName("a-b{c}<d>");
    EXPECT_EQ(thing.GetName(), "a:b(c)(d)");
    thing.SetName(nullptr);
    EXPECT_EQ(thing.GetName(), "");
}

TEST(Object, IsNamedIgnoresCaseButDoesNotNormalise) {
    const Thing thing("DATA[7-0]");
    EXPECT_TRUE(thing.IsNamed("data(7:0)"));
    EXPECT_FALSE(thing.IsNamed("DATA[7-0]"));
    EXPECT_FALSE(thing.IsNamed("DATA(7:0"));
    EXPECT_FALSE(thing.IsNamed(nullptr));
    EXPECT_TRUE(Thing("").IsNamed(nullptr));
    EXPECT_TRUE(Thing("").IsNamed(""));
    EXPECT_FALSE(Thing("\xC4").IsNamed("\xE4"));
}

TEST(Object, CommentsAccumulateLineByLine) {
    Thing thing;
    EXPECT_EQ(thing.GetComment(), "");
    thing.AddComment("a");
    thing.AddComment("b");
    EXPECT_EQ(thing.GetComment(), "a\nb\n");
    thing.AddComment("");
    EXPECT_EQ(thing.GetComment(), "a\nb\n\n");
    thing.AddComment(nullptr);
    EXPECT_EQ(thing.GetComment(), "a\nb\n\n\n") << "null reads as the empty text";
    thing.AddComment("%s%n");
    EXPECT_EQ(thing.GetComment(), "a\nb\n\n\n%s%n\n");
}

TEST(Object, CopiesHaveNameCommentAndType) {
    Thing copy("other name");
    copy.AddComment("other comment");
    {
        Thing original("a name that is too long for its object", Orn_Hdl::ObjectTypeNetlist);
        original.AddComment("comment");
        const Thing constructed(original);
        EXPECT_TRUE(constructed == original);
        copy = original;
        original.SetName("changed");
        original.AddComment("more");
        EXPECT_TRUE(copy != original);
    }
    EXPECT_EQ(copy.GetName(), "a name that is too long for its object");
    EXPECT_EQ(copy.GetComment(), "comment\n");
    EXPECT_EQ(copy.GetObjectType(), 105);
}

TEST(Object, MayGetLongAndShortNamesInAnyOrder) {
    const std::string names[] = {std::string(30, 'a'), std::string(40, 'b'), "c",
                                 std::string(300, 'd')};
    Thing thing;
    Thing commented;
    commented.AddComment("comment");
    for (const std::string& former : names) {
        for (const std::string& name : names) {
            for (Thing* each : {&thing, &commented}) {
                each->SetName(former.c_str());
                each->SetName(name.c_str());
                EXPECT_EQ(each->GetNameView(), name);
            }
        }
    }
    EXPECT_EQ(commented.GetComment(), "comment\n");
}

TEST(Object, AssignmentToItselfChangesNothing) {
    Thing thing("a name that is too long for its object");
    thing.AddComment("comment");
    Thing& same = thing;
    thing = same;
    EXPECT_EQ(thing.GetName(), "a name that is too long for its object");
    EXPECT_EQ(thing.GetComment(), "comment\n");
}

TEST(Object, AssignmentFromAnObjectWithoutACommentTakesTheCommentAway) {
    Thing thing("a");
    thing.AddComment("comment");
    const Thing plain("a");
    thing = plain;
    EXPECT_EQ(thing.GetComment(), "");
    EXPECT_TRUE(thing == plain);
}

/// Things of a class that needs such an alignment, each in an odd place behind smaller ones.
template <std::size_t Alignment> void ExpectAligned() {
    struct alignas(Alignment) Aligned : Thing {
        char data[Alignment] = {};
    };
    std::vector<std::unique_ptr<Object>> things;
    for (int i = 0; i < 50; ++i) {
        things.push_back(std::make_unique<Orn_Hdl::Component>("C"));
        things.push_back(std::make_unique<Thing>());
        things.push_back(std::make_unique<Aligned>());
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(things.back().get()) % Alignment, 0U);
    }
}

TEST(Object, MayBeOfAClassOfAnyAlignment) {
    ExpectAligned<8>();
    ExpectAligned<16>();
    ExpectAligned<64>();
    ExpectAligned<4096>();
}

TEST(Object, IsEqualWhenNameCommentAndTypeAre) {
    Thing a("name");
    Thing b("name");
    EXPECT_TRUE(a == b);
    b.SetName("NAME");
    EXPECT_TRUE(a != b);
    b.SetName("name");
    b.AddComment("x");
    EXPECT_TRUE(a != b);
    a.AddComment("x");
    EXPECT_TRUE(a == b);
    EXPECT_TRUE(Thing("name", Orn_Hdl::ObjectTypeInstance) !=
                Thing("name", Orn_Hdl::ObjectTypeComponent));
}

RC_GTEST_PROP(Object, KeepsNamesOfEveryLengthThroughCopiesAndChanges, ()) {
    const auto lengths =
        *rc::gen::container<std::vector<std::size_t>>(rc::gen::element<std::size_t>(
            0, 1, 13, 14, 15, 16, 31, 127, 128, 253, 254, 255, 256, 70000));
    std::vector<Thing> things(3);
    std::vector<std::string> expected(3);
    for (std::size_t i = 0; i < lengths.size(); ++i) {
        const std::size_t from = i % 3;
        const std::size_t to = (i / 3) % 3;
        expected[from] = std::string(lengths[i], static_cast<char>('a' + i % 26));
        things[from].SetName(expected[from].c_str());
        things[to] = things[from];
        expected[to] = expected[from];
        for (std::size_t k = 0; k < 3; ++k) {
            RC_ASSERT(things[k].GetName().GetView() == expected[k]);
        }
    }
}

TEST(ObjectType, IsTheKindOfEachClass) {
    Orn_Hdl::Component component("C");
    EXPECT_EQ(Orn_Hdl::AttributeString("a", "b").GetObjectType(), 100);
    EXPECT_EQ(Orn_Hdl::AttributeBitVector("a", "b").GetObjectType(), 100);
    EXPECT_EQ(Orn_Hdl::ScalarSignal("a").GetObjectType(), 101);
    EXPECT_EQ(Orn_Hdl::Bus("a(1:0)").GetObjectType(), 101);
    EXPECT_EQ(Orn_Hdl::BusSlice("a(1:0)", nullptr).GetObjectType(), 101);
    EXPECT_EQ(Orn_Hdl::BusIndex("a(1)", nullptr).GetObjectType(), 101);
    EXPECT_EQ(Orn_Hdl::CompoundBus("a,b").GetObjectType(), 101);
    EXPECT_EQ(Orn_Hdl::ScalarPin("a", Orn_Hdl::Polarity()).GetObjectType(), 102);
    EXPECT_EQ(component.GetObjectType(), 103);
    EXPECT_EQ(Orn_Hdl::Instance("a", &component).GetObjectType(), 104);
    EXPECT_EQ(Orn_Hdl::Netlist("a").GetObjectType(), 105);
}

TEST(ObjectType, OfAnyPinIsAPinsWhateverWasCopiedIntoIt) {
    Orn_Hdl::ScalarPin pin("a", Orn_Hdl::Polarity("in"));
    Thing netlistLike("b", Orn_Hdl::ObjectTypeNetlist);
    static_cast<Object&>(pin).SetName("c");
    Orn_Hdl::BusPin bus("d(1:0)", Orn_Hdl::Polarity("out"));
    pin = Orn_Hdl::ScalarPin("e", Orn_Hdl::Polarity("out"));
    EXPECT_EQ(pin.GetObjectType(), 102);
    EXPECT_EQ(bus.GetObjectType(), 102);
    EXPECT_EQ(netlistLike.GetObjectType(), 105);
}

TEST(TypeCodes, AreDisjoint) {
    EXPECT_EQ(Orn_Hdl::ScalarSignal("a").GetSignalType(), 50);
    EXPECT_EQ(Orn_Hdl::Bus("a(1:0)").GetSignalType(), 51);
    EXPECT_EQ(Orn_Hdl::BusSlice("a(1:0)", nullptr).GetSignalType(), 52);
    EXPECT_EQ(Orn_Hdl::BusIndex("a(1)", nullptr).GetSignalType(), 53);
    EXPECT_EQ(Orn_Hdl::CompoundBus("a,b").GetSignalType(), 54);
    EXPECT_EQ(Orn_Hdl::ScalarPin("a", Orn_Hdl::Polarity()).GetPinType(), 1);
    EXPECT_EQ(Orn_Hdl::BusPin("a(1:0)", Orn_Hdl::Polarity()).GetPinType(), 2);
    EXPECT_EQ(Orn_Hdl::BusIndexPin("a(1)", Orn_Hdl::Polarity()).GetPinType(), 3);
}

} // namespace
