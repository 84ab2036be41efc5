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
    const PanelPlacement places[] = {{271, 55, 240, 149}, {403, 67, 237, 256}, {403, 54, 237, 252}};
    for (std::uint32_t panel = 0; panel < 3; ++panel) {
        SCOPED_TRACE(panel);
        const auto place = PanelPlacementFor(panel);
        ASSERT_TRUE(place);
        EXPECT_EQ(std::vector<int>({place->x, place->y, place->width, place->height}),
                  std::vector<int>({places[panel].x, places[panel].y, places[panel].width,
                                    places[panel].height}));
    }
    EXPECT_FALSE(PanelPlacementFor(3));
}

}  // namespace
