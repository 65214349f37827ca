#include "Port/Pooled.h"

#include "Support/Sanitized.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <new>
#include <stdexcept>

namespace {

struct Small : Port::Pooled<Port::Pool::DesignObjects> {
    explicit Small(int number) : value(number) {
        if (number < 0) {
            throw std::invalid_argument("negative");
        }
    }
    int value;
};

struct alignas(64) Aligned : Port::Pooled<Port::Pool::Commands> {
    int value = 7;
};

struct alignas(16) Wide : Port::Pooled<Port::Pool::DesignObjects> {
    int value = 7;
};

bool IsAligned(const void* address, std::size_t alignment) {
    return reinterpret_cast<std::uintptr_t>(address) % alignment == 0;
}

static_assert(sizeof(Small) == sizeof(int), "the base takes no room");

TEST(Pooled, MakesObjects) {
    const std::unique_ptr<Small> one(new Small(1));
    const std::unique_ptr<Small> two(new (std::nothrow) Small(2));
    ASSERT_NE(two, nullptr);
    EXPECT_EQ(one->value + two->value, 3);
}

TEST(Pooled, GivesMemoryBackWhenAConstructorThrows) {
    EXPECT_THROW(new Small(-1), std::invalid_argument);
    EXPECT_THROW(new (std::nothrow) Small(-1), std::invalid_argument);
    alignas(Small) unsigned char place[sizeof(Small)];
    EXPECT_THROW(new (place) Small(-1), std::invalid_argument);
}

TEST(Pooled, KeepsALargerAlignment) {
    const std::unique_ptr<Aligned> one(new Aligned);
    const std::unique_ptr<Aligned> two(new (std::nothrow) Aligned);
    EXPECT_TRUE(IsAligned(one.get(), 64));
    EXPECT_TRUE(IsAligned(two.get(), 64));
    EXPECT_EQ(one->value + two->value, 14);
}

TEST(Pooled, AlignsWhatFollowsASmallerObject) {
    for (int i = 0; i < 4; ++i) {
        const std::unique_ptr<Small> small(new Small(i));
        const std::unique_ptr<Wide> wide(new Wide);
        EXPECT_TRUE(IsAligned(wide.get(), 16));
    }
}

TEST(Pooled, BuildsInAGivenPlace) {
    alignas(Small) unsigned char place[sizeof(Small)];
    Small* const object = new (place) Small(5);
    EXPECT_EQ(static_cast<void*>(object), static_cast<void*>(place));
    EXPECT_EQ(object->value, 5);
}

/// More than any address space holds, asked for by a size and not by a type.
constexpr std::size_t TooMuch = SIZE_MAX / 4;

TEST(Pooled, ReportsThatAllocationFailed) {
#if defined(ORN_HDL_SANITIZED)
    GTEST_SKIP() << "a sanitizer ends the program at a request of this size";
#endif
    EXPECT_THROW(Small::operator new(TooMuch), std::bad_alloc);
    EXPECT_EQ(Small::operator new(TooMuch, std::nothrow), nullptr);
}

} // namespace
