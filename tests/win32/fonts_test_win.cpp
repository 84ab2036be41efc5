// The faces the launcher asks for by name are Windows fonts; the test prefix maps them to
// free fonts of the same scripts (tests/wine/fonts.reg). Each must resolve to the intended
// font and hold the glyphs of its language's own name.
#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <type_traits>
#include <vector>

#include "platform/handles_win.h"
#include "test_support_win.h"

namespace {

std::uint16_t BigEndian16(const std::vector<BYTE>& data, std::size_t at) {
    return static_cast<std::uint16_t>(data[at] << 8 | data[at + 1]);
}

// The family name stored in the selected font's own 'name' table: the typographic family
// (name 16) when there is one, else the family (name 1); Windows-platform UTF-16 records.
std::wstring FontFileFamily(HDC dc) {
    const DWORD kNameTable = 'n' | 'a' << 8 | 'm' << 16 | 'e' << 24;
    DWORD size = GetFontData(dc, kNameTable, 0, nullptr, 0);
    if (size == GDI_ERROR || size < 6) return L"";
    std::vector<BYTE> data(size);
    if (GetFontData(dc, kNameTable, 0, data.data(), size) != size) return L"";
    std::size_t count = BigEndian16(data, 2);
    std::size_t strings = BigEndian16(data, 4);
    std::wstring family;
    for (std::size_t record = 0; record < count && 6 + record * 12 + 12 <= size; ++record) {
        std::size_t at = 6 + record * 12;
        std::uint16_t platform = BigEndian16(data, at);
        std::uint16_t nameId = BigEndian16(data, at + 6);
        std::size_t length = BigEndian16(data, at + 8);
        std::size_t offset = strings + BigEndian16(data, at + 10);
        if (platform != 3 || (nameId != 1 && nameId != 16) || offset + length > size) continue;
        std::wstring name;
        for (std::size_t i = 0; i + 1 < length; i += 2) {
            name += static_cast<wchar_t>(BigEndian16(data, offset + i));
        }
        if (nameId == 16 || family.empty()) family = name;
    }
    return family;
}

TEST(WineFonts, EveryFaceTheLauncherNamesResolvesToAFontOfItsScript) {
    if (!RunningOnWine()) GTEST_SKIP() << "Windows has these fonts itself";
    struct Row {
        const wchar_t* face;
        BYTE charset;
        const wchar_t* sample;  // the language's own name, as the language list shows it
        const wchar_t* family;  // of the free font behind the face
    };
    const Row rows[] = {
        {L"Comic Sans MS", ANSI_CHARSET, L"Français Português(BR)", L"Comic Neue"},
        {L"Comic Sans MS", EASTEUROPE_CHARSET, L"Polski Dziękujemy", L"Comic Neue"},
        {L"ＭＳ Ｐゴシック", SHIFTJIS_CHARSET, L"日本語", L"Noto Sans CJK JP"},
        {L"MS PGothic", SHIFTJIS_CHARSET, L"日本語", L"Noto Sans CJK JP"},
        {L"宋体", GB2312_CHARSET, L"简体中文版", L"Noto Sans CJK SC"},
        {L"SimSun", GB2312_CHARSET, L"简体中文版", L"Noto Sans CJK SC"},
        {L"新細明體", CHINESEBIG5_CHARSET, L"繁體中文", L"Noto Sans CJK TC"},
        {L"PMingLiU", CHINESEBIG5_CHARSET, L"繁體中文", L"Noto Sans CJK TC"},
        {L"GulimChe", HANGUL_CHARSET, L"한국어", L"Noto Sans CJK KR"},
        {L"Angsana New", THAI_CHARSET, L"ไทย", L"Garuda"},
        {L"Angsana New [Thai]", THAI_CHARSET, L"ไทย", L"Garuda"},
    };
    std::unique_ptr<std::remove_pointer_t<HDC>, decltype(&DeleteDC)> dc(CreateCompatibleDC(nullptr),
                                                                        &DeleteDC);
    ASSERT_TRUE(dc);
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << row.face << " in character set " << int{row.charset});
        UniqueGdiObject font(CreateFontW(-16, 0, 0, 0, FW_BOLD, FALSE, FALSE, FALSE, row.charset,
                                         OUT_TT_PRECIS, CLIP_DEFAULT_PRECIS, ANTIALIASED_QUALITY, 0,
                                         row.face));
        ASSERT_TRUE(font);
        // Restored before the font goes, so it is never deleted while selected.
        int saved = SaveDC(dc.get());
        SelectObject(dc.get(), font.Get());

        wchar_t face[LF_FACESIZE] = {};
        GetTextFaceW(dc.get(), LF_FACESIZE, face);
        EXPECT_EQ(std::wstring(face), row.face) << "the font mapper chose another face";
        EXPECT_EQ(FontFileFamily(dc.get()), row.family);
        EXPECT_EQ(GetTextCharset(dc.get()), row.charset);

        std::wstring sample = row.sample;
        std::vector<WORD> glyphs(sample.size());
        EXPECT_NE(GetGlyphIndicesW(dc.get(), sample.c_str(), static_cast<int>(sample.size()),
                                   glyphs.data(), GGI_MARK_NONEXISTING_GLYPHS),
                  GDI_ERROR);
        for (std::size_t i = 0; i < glyphs.size(); ++i) {
            EXPECT_NE(glyphs[i], 0xFFFF) << "no glyph for character " << i << " of the sample";
        }
        RestoreDC(dc.get(), saved);
    }
}

}  // namespace
