// Designs hold hundreds of thousands of containers that stay empty: these must take no memory.
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdlib>
#include <new>

// GCC sees malloc through the operator below, and then free in the place of delete.
#pragma GCC diagnostic ignored "-Wmismatched-new-delete"

namespace {

std::size_t allocations = 0;

} // namespace

void* operator new(std::size_t size) {
    ++allocations;
    if (void* memory = std::malloc(size == 0 ? 1 : size)) {
        return memory;
    }
    throw std::bad_alloc();
}

void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    ++allocations;
    return std::malloc(size == 0 ? 1 : size);
}

void operator delete(void* memory) noexcept {
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}

void operator delete(void* memory, const std::nothrow_t&) noexcept {
    std::free(memory);
}

namespace {

using namespace Orn_Hdl;

/// The number of allocations that an action takes.
template <class Action> std::size_t Count(Action action) {
    const std::size_t before = allocations;
    action();
    return allocations - before;
}

TEST(Allocation, IsCounted) {
    EXPECT_GE(Count([] {
                  StringArray array;
                  array.Add("a text that is too long for its object");
              }),
              1u);
}

TEST(Allocation, AnEmptyMapTakesNoMemory) {
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

TEST(Allocation, AnEmptyArrayTakesNoMemory) {
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

TEST(Allocation, AHolderWithoutAttributesTakesNoMemory) {
    EXPECT_EQ(Count([] {
                  const AttributeHolder holder;
                  EXPECT_EQ(holder.GetAttr("a"), nullptr);
                  EXPECT_TRUE(holder.GetAttrIterator().IsAtEnd());
                  const AttributeHolder copy(holder);
                  EXPECT_FALSE(copy.HasAttrs());
              }),
              0u);
}

TEST(Allocation, AnEmptySetTakesLittleMemory) {
    // At most one allocation a table, so that the buckets come with the first name.
    EXPECT_LE(Count([] {
                  StringSet set;
                  EXPECT_FALSE(set.IContains("a"));
                  set.Empty();
              }),
              2u);
}

TEST(Allocation, SplittingALineTakesAHandfulHoweverManyWordsItHas) {
    const char* line = "ADD INSTANCE AND2 U1 and some more words to make it \"as long\" as it gets";
    StringArray array;
    EXPECT_LE(Count([&] { array.ParseCommandLine(line); }), 12u);
    array.Empty();
    EXPECT_EQ(Count([&] { array.ParseCommandLine(line); }), 0u) << "the memory is used again";
    EXPECT_EQ(array.GetSize(), 15);
}

} // namespace
