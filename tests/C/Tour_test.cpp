// The interface as a source in C uses it.
#include "C/tour.h"

#include <gtest/gtest.h>

namespace {

TEST(CTour, ASourceInCUsesTheLibrary) {
    char result[100] = "";
    EXPECT_EQ(RunTour(result, sizeof(result)), 0);
    EXPECT_STREQ(result, "2 signals; Identifier \"A\" already defined.\n");
}

} // namespace
