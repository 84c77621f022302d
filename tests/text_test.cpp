#include "platform/text.h"

#include <gtest/gtest.h>

TEST(Text, NthFieldBasics) {
    EXPECT_EQ(NthField("a", "x", 1), "a");
}
