#include "app/milestone.h"

#include <gtest/gtest.h>

using namespace qm;

TEST(Milestone, TenTwentyAndEveryFiftieth)
{
    for (int64_t n : {10, 20, 50, 100, 150, 1000})
        EXPECT_TRUE(ismilestone(n)) << n;
    for (int64_t n : {-50, 0, 9, 11, 30, 40, 49, 51, 101})
        EXPECT_FALSE(ismilestone(n)) << n;
}
