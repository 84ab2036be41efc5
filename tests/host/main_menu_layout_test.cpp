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

}  // namespace
