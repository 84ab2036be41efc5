// The disc check's parts: resources, paths, the edition file, languages and the findings.
#include <gtest/gtest.h>

#include <algorithm>
#include <map>

#include "disc_checks.h"
#include "disc_files.h"
#include "graphics/bmp_file.h"
#include "pe_image.h"
#include "report.h"
#include "test_files.h"

namespace fs = std::filesystem;

namespace {

struct TestResource {
    std::string type;  // "#<n>" or a name
    std::uint16_t id;
    std::uint16_t language;
    std::vector<std::uint8_t> data;
};

void Put16(std::vector<std::uint8_t>& bytes, std::size_t at, std::size_t value) {
    std::memcpy(&bytes[at], &value, 2);
}
void Put32(std::vector<std::uint8_t>& bytes, std::size_t at, std::size_t value) {
    std::memcpy(&bytes[at], &value, 4);
}

// A program image whose one section (RVA 0x1000, file offset 0x200) holds these resources.
std::vector<std::uint8_t> ProgramImage(const std::vector<TestResource>& resources,
                                       std::uint16_t machine = kMachineI386,
                                       bool pe32Plus = false) {
    constexpr std::uint32_t kSectionRva = 0x1000;
    std::map<std::string, std::map<std::uint16_t, std::vector<const TestResource*>>> tree;
    for (const TestResource& resource : resources) {
        tree[resource.type][resource.id].push_back(&resource);
    }
    std::vector<std::uint8_t> section;
    auto reserve = [&section](std::size_t size) {
        const std::size_t at = section.size();
        section.resize(at + (size + 3) / 4 * 4);
        return at;
    };
    // A directory's header; returns where its entries start. Named entries come first.
    auto directory = [&](std::size_t entries, std::size_t named) {
        const std::size_t at = reserve(16 + 8 * entries);
        Put16(section, at + 12, named);
        Put16(section, at + 14, entries - named);
        return at + 16;
    };
    auto entry = [&](std::size_t& at, std::size_t name, std::size_t target) {
        Put32(section, at, name);
        Put32(section, at + 4, target);
        at += 8;
    };
    std::size_t typeEntry =
        directory(tree.size(),
                  static_cast<std::size_t>(std::count_if(
                      tree.begin(), tree.end(), [](auto& type) { return type.first[0] != '#'; })));
    for (const auto& [type, ids] : tree) {
        std::size_t name = 0;
        if (type[0] == '#') {
            name = std::stoul(type.substr(1));
        } else {
            const std::size_t at = reserve(2 + 2 * type.size());
            Put16(section, at, type.size());
            for (std::size_t i = 0; i < type.size(); ++i) Put16(section, at + 2 + 2 * i, type[i]);
            name = 0x80000000u | at;
        }
        std::size_t idEntry = directory(ids.size(), 0);
        entry(typeEntry, name, 0x80000000u | (idEntry - 16));
        for (const auto& [id, languages] : ids) {
            std::size_t languageEntry = directory(languages.size(), 0);
            entry(idEntry, id, 0x80000000u | (languageEntry - 16));
            for (const TestResource* language : languages) {
                const std::size_t dataEntry = reserve(16);
                const std::size_t data = reserve(language->data.size());
                std::copy(language->data.begin(), language->data.end(),
                          section.begin() + static_cast<std::ptrdiff_t>(data));
                entry(languageEntry, language->language, dataEntry);
                Put32(section, dataEntry, kSectionRva + data);
                Put32(section, dataEntry + 4, language->data.size());
            }
        }
    }

    const std::size_t optionalSize = pe32Plus ? 240 : 224;
    std::vector<std::uint8_t> image(0x200);
    std::memcpy(&image[0], "MZ", 2);
    Put32(image, 0x3C, 0x40);
    std::memcpy(&image[0x40], "PE\0\0", 4);
    Put16(image, 0x44, machine);
    Put16(image, 0x46, 1);
    Put16(image, 0x54, optionalSize);
    Put16(image, 0x58, pe32Plus ? 0x20B : 0x10B);
    const std::size_t count = 0x58 + (pe32Plus ? 108 : 92);  // then the data directories
    Put32(image, count, 16);
    Put32(image, count + 4 + 2 * 8, kSectionRva);
    Put32(image, count + 4 + 2 * 8 + 4, section.size());
    const std::size_t header = 0x58 + optionalSize;
    std::memcpy(&image[header], ".rsrc", 5);
    for (std::size_t at : {header + 8, header + 16}) Put32(image, at, section.size());
    Put32(image, header + 12, kSectionRva);
    Put32(image, header + 20, 0x200);
    image.insert(image.end(), section.begin(), section.end());
    return image;
}

// A string block: sixteen counted UTF-16 strings, these at the front, the rest empty.
std::vector<std::uint8_t> StringBlock(const std::vector<std::u16string>& strings) {
    std::vector<std::uint8_t> block;
    for (std::size_t i = 0; i < 16; ++i) {
        const std::u16string text = i < strings.size() ? strings[i] : u"";
        block.push_back(static_cast<std::uint8_t>(text.size()));
        block.push_back(0);
        for (char16_t unit : text) {
            block.push_back(static_cast<std::uint8_t>(unit & 0xFF));
            block.push_back(static_cast<std::uint8_t>(unit >> 8));
        }
    }
    return block;
}

std::vector<TestResource> SampleResources() {
    return {
        {"#2", 380, 1031, {1}},
        {"#2", 380, 1033, {2, 2}},
        {"#2", 381, 1031, {3, 3, 3}},
        {"#2", 382, 1033, {4}},
        {"#2", 382, 1040, {5, 5}},
        // Strings 7072 to 7087: "", "Dansk", "", ...
        {"#6", 7072 / 16 + 1, 1033, StringBlock({u"", u"Dansk"})},
    };
}

TEST(PeImage, FindsResourcesByTypeIdAndLanguageAndStringsAsLoadStringDoes) {
    const std::pair<std::uint32_t, std::optional<std::u16string>> strings[] = {
        {7073, u"Dansk"}, {7072, u""}, {7087, u""}, {7088, std::nullopt}, {7071, std::nullopt}};
    for (const auto& [machine, pe32Plus] :
         {std::pair{kMachineI386, false}, std::pair{kMachineAmd64, true}}) {
        SCOPED_TRACE(pe32Plus ? "64-bit" : "32-bit");
        const auto file = ProgramImage(SampleResources(), machine, pe32Plus);
        const auto image = ReadPeImage(file);
        ASSERT_TRUE(image);
        EXPECT_EQ(image->machine, machine);
        EXPECT_EQ(image->pe32Plus, pe32Plus);
        // US English wins wherever it is; otherwise the one language there is.
        EXPECT_EQ(image->resources.at({"#2", 380}).size, 2u);
        EXPECT_EQ(image->resources.at({"#2", 381}).size, 3u);
        EXPECT_EQ(image->resources.at({"#2", 382}).size, 1u);
        EXPECT_EQ(image->resources.count({"#2", 383}), 0u);
        for (const auto& [id, text] : strings) {
            EXPECT_EQ(FindResourceString(file, *image, id), text) << "string " << id;
        }
    }
    const auto named = ProgramImage({{"idr_Palette", 247, 1033, {9, 9, 9, 9}}});
    const auto image = ReadPeImage(named);
    ASSERT_TRUE(image);
    EXPECT_EQ(image->resources.at({"IDR_PALETTE", 247}).size, 4u);
    // A block that ends inside its strings holds only those before the cut.
    auto cut = SampleResources();
    cut[5].data.resize(2 + 2 + 5 * 2 - 1);
    const auto cutFile = ProgramImage(cut);
    const auto cutImage = ReadPeImage(cutFile);
    ASSERT_TRUE(cutImage);
    EXPECT_EQ(FindResourceString(cutFile, *cutImage, 7072), std::u16string());
    EXPECT_EQ(FindResourceString(cutFile, *cutImage, 7073), std::nullopt);
}

TEST(PeImage, DamagedImagesLoseResourcesWithoutReadingOutside) {
    const auto whole = ProgramImage(SampleResources());
    const std::size_t resourceCount = ReadPeImage(whole)->resources.size();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        SCOPED_TRACE(length);
        const std::vector<std::uint8_t> cut(whole.begin(),
                                            whole.begin() + static_cast<std::ptrdiff_t>(length));
        const auto image = ReadPeImage(cut);
        if (length < 0x200) {
            EXPECT_FALSE(image && !image->resources.empty());
        } else {
            ASSERT_TRUE(image);
            EXPECT_LE(image->resources.size(), resourceCount);
        }
    }
    const struct {
        const char* what;
        std::size_t at;
        std::uint32_t value;
        bool readable;
    } corruptions[] = {
        {"header pointer past the end", 0x3C, 0xFFFFFFF0u, false},
        {"no PE signature", 0x40, 0x00004551u, false},
        {"unknown optional header", 0x58, 0x0107, false},
        {"section table past the end", 0x54, 0xFFF0, false},
        {"resource directory past the section", 0x58 + 96 + 16, 0x7FFFFFF0u, true},
        {"section data past the end", 0x58 + 224 + 20, 0xFFFFFF00u, true},
    };
    for (const auto& corruption : corruptions) {
        SCOPED_TRACE(corruption.what);
        auto file = whole;
        Put32(file, corruption.at, corruption.value);
        const auto image = ReadPeImage(file);
        EXPECT_EQ(image.has_value(), corruption.readable);
        if (image) {
            EXPECT_TRUE(image->resources.empty());
        }
    }
}

// Packed bitmaps as resources hold them: the file without its 14-byte file header.
std::vector<std::uint8_t> PackedDib(std::int32_t width, std::int32_t height, std::uint16_t depth) {
    auto file = BmpFile(width, height, depth);
    return {file.begin() + 14, file.end()};
}

TEST(PackedDib, HeaderOfWholeBlocksOnly) {
    const struct {
        const char* what;
        std::vector<std::uint8_t> block;
        std::int32_t width, height;
        std::uint16_t depth;
    } rows[] = {
        {"24-bit picture", PackedDib(85, 96, 24), 85, 96, 24},
        {"8-bit mask with its grey table", PackedDib(350, 350, 8), 350, 350, 8},
        {"top-down rows", PackedDib(54, -54, 24), 54, -54, 24},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.what);
        const auto header = WholePackedDibHeader(row.block.data(), row.block.size());
        ASSERT_TRUE(header);
        EXPECT_EQ(header->width, row.width);
        EXPECT_EQ(header->height, row.height);
        EXPECT_EQ(header->bitCount, row.depth);
        for (std::size_t length : {std::size_t{0}, std::size_t{39}, row.block.size() - 1}) {
            SCOPED_TRACE(length);
            EXPECT_FALSE(WholePackedDibHeader(row.block.data(), length));
        }
    }
    // An RLE8 mask is whole when its compressed image fits.
    auto rle = PackedDib(8, 2, 8);
    rle.resize(40 + 1024);
    const std::uint8_t image[] = {8, 255, 0, 0, 8, 255, 0, 1};
    rle.insert(rle.end(), std::begin(image), std::end(image));
    Put32(rle, 16, 1);
    Put32(rle, 20, sizeof image);
    EXPECT_TRUE(WholePackedDibHeader(rle.data(), rle.size()));
    EXPECT_FALSE(WholePackedDibHeader(rle.data(), rle.size() - 1));
}

TEST(DiscPath, ComponentsMatchWithoutRegardToCase) {
    TempFolder disc;
    for (const char* file : {"Support/ix help/fr-fr/IX_Help_Fr.htm", "Support/readme.txt",
                             "Demos/a.mpg", "Demos/A.MPG"}) {
        WriteFile(disc.Path() / file, std::string("x"));
    }
    const struct {
        const char* windowsPath;
        const char* found;  // null: nothing
    } rows[] = {
        {"support\\IX HELP\\FR-fr\\ix_help_fr.HTM", "Support/ix help/fr-fr/IX_Help_Fr.htm"},
        {"Support/readme.txt", "Support/readme.txt"},
        {"SUPPORT\\\\ix help\\", "Support/ix help"},
        {"Demos\\a.mpg", "Demos/a.mpg"},  // the exact name first,
        {"Demos\\A.MPG", "Demos/A.MPG"},
        {"demos\\A.mpg", "Demos/A.MPG"},  // else the first in name order
        {"Support\\readme.txt\\more", nullptr},
        {"Support\\Leeme.txt", nullptr},
        {"Setup\\data2.cab", nullptr},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.windowsPath);
        const auto found = ResolveDiscPath(disc.Path(), row.windowsPath);
        if (!row.found) {
            EXPECT_FALSE(found);
        } else {
            ASSERT_TRUE(found);
            EXPECT_EQ(found->lexically_relative(disc.Path()), fs::path(row.found));
        }
    }
}

TEST(EditionFile, ReadAsTheProfileReaderReadsIt) {
    const struct {
        const char* text;
        bool section;
        std::optional<std::int64_t> edition;
    } rows[] = {
        {"[SKU]\r\nSKU=3\r\n", true, 3},
        {"\xEF\xBB\xBF [ sku ]\n  Sku =  4  \n", true, 4},
        {"[Other]\nSKU=2\n[SKU]\nSKU=\"5\"\nSKU=1\n", true, 5},
        {"[SKU]\nSKU=2x\n", true, 2},
        {"[SKU]\nSKU=\n", true, 0},
        {"[SKU]\nSKU=-1\n", true, -1},
        {"[SKU]\nEdition=2\n", true, std::nullopt},
        {"[Other]\nSKU=2\n", false, std::nullopt},
        {"SKU=2\n", false, std::nullopt},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.text);
        const ProfileValue value = FindProfileValue(row.text, "SKU", "SKU");
        EXPECT_EQ(value.sectionFound, row.section);
        ASSERT_EQ(value.value.has_value(), row.edition.has_value());
        if (value.value) {
            EXPECT_EQ(ProfileInteger(*value.value), *row.edition);
        }
    }
}

// Editions 1, 2 and 6 show in the files they need: below, and on the sample disc.
TEST(DiscChecks, LanguagesAnEditionShows) {
    const std::pair<std::uint32_t, std::vector<LanguageBase>> rows[] = {
        {0, {kUsEnglish}},
        {5, {kJapanese}},
        {3, {kTraditionalChinese, kThai, kKorean, kUsEnglish}}};
    for (const auto& [edition, expected] : rows) {
        SCOPED_TRACE(edition);
        std::vector<LanguageBase> shown;
        for (const ShownLanguage& language : LanguagesShownBy(edition)) {
            EXPECT_EQ(language.pickedAs, kNoLanguage);
            shown.push_back(language.base);
        }
        EXPECT_EQ(shown, expected);
    }
}

// Each file of edition 1 is checked alone on the sample disc; edition 6 brings in the US
// English menu for UK English and the help page.
TEST(DiscChecks, AnEmptyDiscNeedsEveryFileOfItsEdition) {
    TempFolder disc;
    WriteFile(disc.Path() / "ORVAK.INI", std::string("[SKU]\r\nSKU=6\r\n"));
    const auto report = CheckDisc(disc.Path(), std::nullopt);
    ASSERT_TRUE(report);
    EXPECT_EQ(report->edition, 6u);
    std::vector<std::string> paths;
    for (const Finding& finding : report->findings) paths.push_back(finding.path);
    EXPECT_EQ(paths,
              (std::vector<std::string>{
                  "AutoPlay.exe", "Launcher\\AutoPlayBackNO.bmp", "Launcher\\AutoPlayBackFI.bmp",
                  "Launcher\\AutoPlayBackDN.bmp", "Launcher\\AutoPlayBackUk.bmp",
                  "Launcher\\AutoPlayBack.bmp", "Setup\\setup.exe", "Setup\\Tolven8.iff",
                  "Setup\\data2.cab", "support\\ix help\\IX_Help_Select.htm", "Support\\Kelpa.exe",
                  "support\\readmeNO.txt", "support\\readmeFI.txt", "support\\readmeDN.txt",
                  "support\\readmeUK.txt", "support\\readme.txt", "Demos\\vemo2.mpg",
                  "Demos\\vemo2duskaro.mpg", "Demos\\vemo2lorrel.mpg"}));
    EXPECT_TRUE(std::all_of(report->findings.begin(), report->findings.end(), [](auto& finding) {
        return finding.severity == Severity::Error && finding.problem == "missing";
    }));
}

TEST(DiscChecks, BadBackgroundsFallBackToTheFirstWholeOne) {
    TempFolder disc;
    const fs::path launcher = disc.Path() / "launcher";  // any case, as on Windows
    WriteFile(disc.Path() / "ORVAK.INI", std::string("[SKU]\nSKU=6\n"));
    // One damage at a time is the sample disc's; here several, and the fallback's order.
    WriteFile(launcher / "AutoPlayBackNO.bmp", BmpFile(640, 480, 24));
    WriteFile(launcher / "AutoPlayBackFI.bmp", BmpFile(640, 480, 8));
    WriteFile(launcher / "AutoPlayBackDN.bmp", BmpFile(320, 240, 32));

    auto backgroundLines = [&disc] {
        std::vector<std::string> lines;
        const auto report = CheckDisc(disc.Path(), std::nullopt);
        for (const Finding& finding : report->findings) {
            if (finding.path.rfind("Launcher\\", 0) == 0) {
                lines.push_back(finding.path + ": " + finding.problem + " -> " + finding.effect);
            }
        }
        return lines;
    };
    EXPECT_EQ(
        backgroundLines(),
        (std::vector<std::string>{
            "Launcher\\AutoPlayBackFI.bmp: 8-bit, not 24-bit -> the Finnish menu shows the "
            "Norwegian background instead",
            "Launcher\\AutoPlayBackDN.bmp: 320 x 240 pixels, not 640 x 480; 32-bit, not 24-bit -> "
            "the Danish menu shows the Norwegian background instead",
            "Launcher\\AutoPlayBackUk.bmp: missing -> the UK English menu shows the Norwegian "
            "background instead",
            "Launcher\\AutoPlayBack.bmp: missing -> the US English menu (after installing in UK "
            "English) shows the Norwegian background instead"}));

    // A background of a language the edition never shows still keeps the launcher going.
    fs::remove(launcher / "AutoPlayBackNO.bmp");
    WriteFile(launcher / "AutoPlayBackTh.bmp", BmpFile(640, 480, 24));
    EXPECT_EQ(backgroundLines().front(),
              "Launcher\\AutoPlayBackNO.bmp: missing -> the Norwegian menu shows the Thai "
              "background instead");
    fs::remove(launcher / "AutoPlayBackTh.bmp");
    for (const std::string& line : backgroundLines()) {
        SCOPED_TRACE(line);
        EXPECT_NE(line.find("Autoplay will only run from The Vemo installation CD."),
                  std::string::npos);
    }
}

TEST(Report, LinesJsonAndExitCodes) {
    DiscReport report;
    report.edition = 3;
    report.editionGiven = true;
    EXPECT_EQ(ExitCodeFor(report), 0);
    EXPECT_EQ(TextReport("disc", report),
              "disccheck: disc, edition 3 (--edition): no problems found\n");
    report.findings = {{Severity::Error, "Support\\Kelpa.exe", "missing", "nothing \"happens\""},
                       {Severity::Warning, "AutoPlay.exe", "odd\tpalette\x01", "colours"}};
    EXPECT_EQ(ExitCodeFor(report), 1);
    EXPECT_EQ(TextReport("disc", report),
              "error    Support\\Kelpa.exe: missing -> nothing \"happens\"\n"
              "warning  AutoPlay.exe: odd\tpalette\x01 -> colours\n"
              "disccheck: disc, edition 3 (--edition): 1 error, 1 warning\n");
    const std::string json = JsonReport("C:\\disc", report);
    for (const char* part :
         {"\"folder\": \"C:\\\\disc\"", "\"edition\": 3", "\"errors\": 1",
          "\"path\": \"Support\\\\Kelpa.exe\"", "\"effect\": \"nothing \\\"happens\\\"\"",
          "\"problem\": \"odd\\tpalette\\u0001\""}) {
        SCOPED_TRACE(part);
        EXPECT_NE(json.find(part), std::string::npos);
    }
}

}  // namespace
