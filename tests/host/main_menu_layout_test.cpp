#include "graphics/main_menu_layout.h"

#include <gtest/gtest.h>

namespace {

std::vector<std::uint32_t> Offsets(const std::vector<CaptionPlacement>& captions) {
    std::vector<std::uint32_t> offsets;
    for (const CaptionPlacement& caption : captions) offsets.push_back(caption.stringOffset);
    return offsets;
}

TEST(MainMenuCaptions, FollowInstallationEditionAndLanguage) {
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 1, kUsEnglish)),
              (std::vector<std::uint32_t>{1, 7, 3, 8, 10}));
    EXPECT_EQ(Offsets(MainMenuCaptions(true, 1, 1, kUsEnglish)),
              (std::vector<std::uint32_t>{2, 7, 3, 8, 10}));
    // Edition 2 has no More Games button, so no caption for it.
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 2, 2, kUsEnglish)),
              (std::vector<std::uint32_t>{1, 7, 8, 10}));
    // Editions above 3 show Readme, except the Polish edition 4.
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 4, kGerman))[3], 12u);
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 4, kPolish))[3], 8u);
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 5, kPolish))[3], 12u);
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 9, kJapanese))[3], 12u);
    EXPECT_EQ(Offsets(MainMenuCaptions(false, 1, 3, kJapanese))[3], 8u);
}

TEST(MainMenuCaptions, EndAtTheirPoints) {
    auto captions = MainMenuCaptions(false, 1, 1, kUsEnglish);
    const int points[][2] = {{187, 237}, {262, 278}, {329, 332}, {370, 391}, {398, 443}};
    ASSERT_EQ(captions.size(), 5u);
    for (std::size_t i = 0; i < captions.size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(captions[i].right, points[i][0]);
        EXPECT_EQ(captions[i].bottom, points[i][1]);
    }
}

TEST(PanelPlacement, EachPanelHasItsPlaceAndNoneOtherwise) {
    auto play = PanelPlacementFor(0);
    ASSERT_TRUE(play);
    EXPECT_EQ(play->x, 271);
    EXPECT_EQ(play->y, 55);
    EXPECT_EQ(play->width, 240);
    EXPECT_EQ(play->height, 149);
    auto info = PanelPlacementFor(1);
    ASSERT_TRUE(info);
    EXPECT_EQ(info->x + info->width, 640);
    EXPECT_EQ(info->y + info->height, 323);
    auto games = PanelPlacementFor(2);
    ASSERT_TRUE(games);
    EXPECT_EQ(games->y, 54);
    EXPECT_EQ(games->height, 252);
    EXPECT_FALSE(PanelPlacementFor(3));
    EXPECT_FALSE(PanelPlacementFor(7));
}

}  // namespace
