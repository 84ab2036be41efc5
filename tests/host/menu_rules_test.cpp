#include <gtest/gtest.h>

#include "menu/button_rules.h"

namespace {

TEST(ButtonState, FollowsTheLatchThenThePressThenTheFocus) {
    struct Row {
        std::uint32_t itemState;
        bool latched;
        ButtonState state;
    };
    const Row rows[] = {
        {0x0000, false, kNormal},  {0x0010, false, kFocused}, {0x0001, false, kPressed},
        {0x0011, false, kPressed}, {0x0011, true, kLatched},  {0x0000, true, kLatched},
        {0x0004, false, kNormal},  // disabled or other bits alone change nothing
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << std::hex << row.itemState << " latched " << row.latched);
        EXPECT_EQ(StateForItem(row.itemState, row.latched), row.state);
    }
}

TEST(HitCircle, ContainsOnlyPointsStrictlyInside) {
    const HitCircle circle{40, 50, 40};
    EXPECT_TRUE(InsideHitCircle(circle, 40, 50));
    EXPECT_TRUE(InsideHitCircle(circle, 79, 50));
    EXPECT_FALSE(InsideHitCircle(circle, 80, 50)) << "exactly the radius is outside";
    EXPECT_FALSE(InsideHitCircle(circle, 40, 10));
    EXPECT_TRUE(InsideHitCircle(circle, 40 + 28, 50 + 28));  // 39.6 away
    EXPECT_FALSE(InsideHitCircle(circle, 40 + 29, 50 + 29));
    // The circle a button has before it is given one holds only its own centre.
    const HitCircle none{-1000, -1000, 1};
    EXPECT_TRUE(InsideHitCircle(none, -1000, -1000));
    EXPECT_FALSE(InsideHitCircle(none, -999, -1000));
    EXPECT_FALSE(InsideHitCircle(none, 0, 0));
    // Far off the screen the squares would not fit 32 bits; still nothing is hit.
    EXPECT_FALSE(InsideHitCircle(circle, 2000000000, -2000000000));
}

// The main page and its panels are walked on the real launcher; the language list here.
TEST(KeyboardOrder, ReadsTheScreenRowByRowThenTheOpenPanel) {
    const std::vector<KeyboardStop> list = {
        {false, 84, 151}, {false, 300, 100}, {false, 300, 151}, {false, 84, 100}, {true, 84, 50}};
    EXPECT_EQ(KeyboardOrder(list), (std::vector<std::size_t>{3, 1, 0, 2, 4}));
}

TEST(KeyboardOrder, StepsWrapAroundAndStartFromEitherEnd) {
    EXPECT_EQ(StepInOrder(6, 0, 1), 1u);
    EXPECT_EQ(StepInOrder(6, 5, 1), 0u);
    EXPECT_EQ(StepInOrder(6, 0, -1), 5u);
    EXPECT_EQ(StepInOrder(6, 6, 1), 0u) << "nothing focused: forward starts at the first";
    EXPECT_EQ(StepInOrder(6, 6, -1), 5u) << "nothing focused: backward starts at the last";
    EXPECT_EQ(StepInOrder(1, 0, 1), 0u);
    EXPECT_EQ(StepInOrder(0, 0, 1), 0u);
}

}  // namespace
