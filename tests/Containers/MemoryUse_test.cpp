// Designs have hundreds of thousands of empty containers, which must not allocate memory.
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers.h"
#include "Support/CountedAllocations.h"

#include <gtest/gtest.h>

#include <cstddef>

namespace {

using namespace Orn_Hdl;

/// The number of blocks that an action takes.
template <class Action> std::size_t Count(Action action) {
    return Support::CountAllocations(action).blocks;
}

TEST(ContainerMemory, IsCounted) {
    EXPECT_GE(Count([] {
                  StringArray array;
                  array.Add("a text that is too long for its object");
              }),
              1u);
}

TEST(ContainerMemory, AnEmptyMapTakesNoMemory) {
    EXPECT_EQ(Count([] {
                  IStringPtrMap<int*> map;
                  EXPECT_EQ(map.Get("a"), nullptr);
                  map.Remove("a");
                  map.Empty();
                  const IStringPtrMap<int*> copy(map);
                  EXPECT_TRUE(copy.IsEmpty());
              }),
              0u);
}

TEST(ContainerMemory, AnEmptyArrayTakesNoMemory) {
    EXPECT_EQ(Count([] {
                  PtrArray<int*> array;
                  EXPECT_EQ(array.GetIndex(nullptr), -1);
                  array.Empty();
                  const PtrArray<int*> copy(array);
                  EXPECT_TRUE(copy.IsEmpty());
                  const OwnPtrArray<int*> owner;
                  EXPECT_TRUE(owner.IsEmpty());
                  const StringArray texts;
                  EXPECT_TRUE(texts.IsEmpty());
              }),
              0u);
}

TEST(ContainerMemory, AHolderWithoutAttributesTakesNoMemory) {
    EXPECT_EQ(Count([] {
                  const AttributeHolder holder;
                  EXPECT_EQ(holder.GetAttr("a"), nullptr);
                  EXPECT_TRUE(holder.GetAttrIterator().IsAtEnd());
                  const AttributeHolder copy(holder);
                  EXPECT_FALSE(copy.HasAttrs());
              }),
              0u);
}

TEST(ContainerMemory, AnEmptySetTakesLittleMemory) {
    // At most one allocation a table, so that the buckets come with the first name.
    EXPECT_LE(Count([] {
                  StringSet set;
                  EXPECT_FALSE(set.IContains("a"));
                  set.Empty();
              }),
              2u);
}

TEST(ContainerMemory, SplittingALineTakesAHandfulHoweverManyWordsItHas) {
    const char* line = "ADD INSTANCE AND2 U1 and some more words to make it \"as long\" as it gets";
    StringArray array;
    EXPECT_LE(Count([&] { array.ParseCommandLine(line); }), 12u);
    array.Empty();
    EXPECT_EQ(Count([&] { array.ParseCommandLine(line); }), 0u) << "the memory is used again";
    EXPECT_EQ(array.GetSize(), 15);
}

TEST(ContainerMemory, ATextThatIsSetAgainAndAgainTakesTheRoomOfOne) {
    const Port::String longer(std::string(1000, 'x'));
    const Port::String other(std::string(900, 'y'));
    StringArray array;
    array.Add("first");
    array.Add(longer);
    array.SetAt(3, "last");
    const auto taken = Support::CountAllocations([&] {
        for (int i = 0; i < 10000; ++i) {
            array.SetAt(1, longer);
            array.SetAt(1, "s");
            array.SetAt(2, other);
            array.SetAt(2, "");
        }
    });
    EXPECT_LT(taken.largest, 10000u);
    EXPECT_LT(taken.blocks, 20000u) << "less than one for each text that finds no room";
    EXPECT_EQ(array.Concatenate("|"), "first|s||last");
}

} // namespace
