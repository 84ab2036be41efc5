// The program's own resources beyond the catalogue's pictures: the About box and its picture,
// the palette, the sounds and the icon.
#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "test_support_win.h"

namespace {

constexpr WORD kUsEnglish = MAKELANGID(LANG_ENGLISH, SUBLANG_ENGLISH_US);

// The bytes of a resource of this module in US English; empty when it is missing.
std::string ResourceBytes(const wchar_t* type, const wchar_t* name) {
    HMODULE module = GetModuleHandleW(nullptr);
    HRSRC found = FindResourceExW(module, type, name, kUsEnglish);
    if (!found) return std::string();
    HGLOBAL loaded = LoadResource(module, found);
    const char* bytes = static_cast<const char*>(LockResource(loaded));
    return std::string(bytes, SizeofResource(module, found));
}

template <typename T>
T Read(const std::string& bytes, std::size_t at) {
    T value{};
    if (at + sizeof(T) <= bytes.size()) std::memcpy(&value, bytes.data() + at, sizeof(T));
    return value;
}

// A UTF-16 text, or an ordinal (0xFFFF then the number), at `at` in a dialog template.
std::wstring ReadSzOrOrdinal(const std::string& bytes, std::size_t& at) {
    if (Read<WORD>(bytes, at) == 0xFFFF) {
        std::wstring ordinal = L"#" + std::to_wstring(Read<WORD>(bytes, at + 2));
        at += 4;
        return ordinal;
    }
    std::wstring text;
    for (WORD c; (c = Read<WORD>(bytes, at)) != 0; at += 2) text += static_cast<wchar_t>(c);
    at += 2;
    return text;
}

TEST(Resources, AboutBoxTemplateIsThePictureAndAnOkButton) {
    std::string dialog = ResourceBytes(RT_DIALOG, L"AboutDlg");
    ASSERT_FALSE(dialog.empty()) << "no AboutDlg dialog in US English";
    const DWORD style = Read<DWORD>(dialog, 0);
    EXPECT_EQ(style, static_cast<DWORD>(WS_POPUP | WS_VISIBLE | WS_CAPTION | WS_SYSMENU | DS_CENTER |
                                        DS_MODALFRAME | DS_SETFONT));
    EXPECT_EQ(Read<DWORD>(dialog, 4), 0u) << "no extended style";
    EXPECT_EQ(Read<WORD>(dialog, 8), 2) << "two controls";
    EXPECT_EQ(Read<short>(dialog, 10), 6);
    EXPECT_EQ(Read<short>(dialog, 12), 21);
    EXPECT_EQ(Read<short>(dialog, 14), 348);
    EXPECT_EQ(Read<short>(dialog, 16), 362);
    std::size_t at = 18;
    EXPECT_EQ(ReadSzOrOrdinal(dialog, at), L"");  // menu
    EXPECT_EQ(ReadSzOrOrdinal(dialog, at), L"");  // class
    EXPECT_EQ(ReadSzOrOrdinal(dialog, at), L"");  // title
    EXPECT_EQ(Read<WORD>(dialog, at), 8);          // points
    at += 2;
    EXPECT_EQ(ReadSzOrOrdinal(dialog, at), L"MS Shell Dlg");

    struct Item {
        DWORD style;
        short x, y, cx, cy;
        WORD id;
        std::wstring windowClass, text;
    };
    auto readItem = [&](std::size_t& pos) {
        pos = (pos + 3) & ~std::size_t{3};
        Item item{Read<DWORD>(dialog, pos), Read<short>(dialog, pos + 8), Read<short>(dialog, pos + 10),
                  Read<short>(dialog, pos + 12), Read<short>(dialog, pos + 14),
                  Read<WORD>(dialog, pos + 16), L"", L""};
        pos += 18;
        item.windowClass = ReadSzOrOrdinal(dialog, pos);
        item.text = ReadSzOrOrdinal(dialog, pos);
        pos += 2 + Read<WORD>(dialog, pos);  // creation data
        return item;
    };
    Item ok = readItem(at);
    EXPECT_EQ(ok.style, static_cast<DWORD>(WS_CHILD | WS_VISIBLE | WS_TABSTOP | BS_DEFPUSHBUTTON));
    EXPECT_EQ(ok.id, IDOK);
    EXPECT_EQ(ok.text, L"&OK");
    EXPECT_EQ(ok.x, 155);
    EXPECT_EQ(ok.y, 335);
    EXPECT_EQ(ok.cx, 40);
    EXPECT_EQ(ok.cy, 14);
    Item picture = readItem(at);
    EXPECT_EQ(picture.style, static_cast<DWORD>(WS_CHILD | WS_VISIBLE | SS_BITMAP));
    EXPECT_EQ(picture.id, 0xFFFF);
    EXPECT_EQ(picture.text, L"#241");
    EXPECT_EQ(picture.x, 42);
    EXPECT_EQ(picture.y, 12);
}

TEST(Resources, AboutAndSparePicturesHaveTheirSize) {
    struct Row {
        WORD id;
        int width, height, depth;
    };
    for (Row row : {Row{241, 400, 488, 24}, Row{264, 162, 117, 8}}) {
        SCOPED_TRACE(row.id);
        HBITMAP picture = static_cast<HBITMAP>(LoadImageW(GetModuleHandleW(nullptr),
                                                          MAKEINTRESOURCEW(row.id), IMAGE_BITMAP,
                                                          0, 0, LR_CREATEDIBSECTION));
        ASSERT_TRUE(picture);
        DIBSECTION section{};
        ASSERT_EQ(GetObjectW(picture, sizeof(section), &section), static_cast<int>(sizeof(section)));
        EXPECT_EQ(section.dsBm.bmWidth, row.width);
        EXPECT_EQ(section.dsBm.bmHeight, row.height);
        EXPECT_EQ(section.dsBm.bmBitsPixel, row.depth);
        DeleteObject(picture);
    }
}

TEST(Resources, PaletteIsARiffPaletteWithItsFixedEntries) {
    std::string palette = ResourceBytes(L"IDR_PALETTE", MAKEINTRESOURCEW(247));
    ASSERT_EQ(palette.size(), 1048u);
    EXPECT_EQ(palette.substr(0, 4), "RIFF");
    EXPECT_EQ(Read<DWORD>(palette, 4), 1040u);
    EXPECT_EQ(palette.substr(8, 8), "PAL data");
    EXPECT_EQ(Read<DWORD>(palette, 16), 1028u);
    EXPECT_EQ(Read<WORD>(palette, 20), 0x0300);
    EXPECT_EQ(Read<WORD>(palette, 22), 256);
    auto entry = [&](int i) { return Read<DWORD>(palette, 24 + 4 * static_cast<std::size_t>(i)); };
    EXPECT_EQ(entry(0), 177u | 5u << 8 | 35u << 16);
    EXPECT_EQ(entry(1), 241u | 98u << 8 | 171u << 16);
    EXPECT_EQ(entry(11), 32u | 31u << 8 | 232u << 16);
    EXPECT_EQ(entry(255), 252u | 252u << 8 | 252u << 16);
}

TEST(Resources, SoundsAreWavesAndTheIconLoads) {
    for (WORD id : {113, 308}) {
        SCOPED_TRACE(id);
        std::string wave = ResourceBytes(L"WAVE", MAKEINTRESOURCEW(id));
        ASSERT_GT(wave.size(), 44u);
        EXPECT_EQ(wave.substr(0, 4), "RIFF");
        EXPECT_EQ(wave.substr(8, 4), "WAVE");
    }
    EXPECT_LT(ResourceBytes(L"WAVE", MAKEINTRESOURCEW(113)).size(),
              ResourceBytes(L"WAVE", MAKEINTRESOURCEW(308)).size())
        << "the click is shorter than the music";
    EXPECT_TRUE(LoadIconW(GetModuleHandleW(nullptr), MAKEINTRESOURCEW(101)));
}

}  // namespace
