#include "disc_checks.h"

#include <algorithm>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <map>
#include <set>
#include <string_view>
#include <system_error>

#include "actions/command_lines.h"
#include "disc_files.h"
#include "graphics/bmp_file.h"
#include "install_language.h"
#include "locale/picture_ids.h"
#include "locale/string_offsets.h"
#include "menu/screen_layout.h"
#include "pe_image.h"

namespace fs = std::filesystem;

namespace {

// The launcher refuses background files larger than this; no launcher file comes near it.
constexpr std::uintmax_t kLargestFile = 64 * 1024 * 1024;
constexpr std::uintmax_t kLargestProfile = 1024 * 1024;
constexpr std::uintmax_t kLargestProgram = 256 * 1024 * 1024;

constexpr char kNoListMenu[] =
    "the launcher shows the US English main menu without a language list";
constexpr char kNotOnDisc[] =
    "the launcher says \"Autoplay will only run from The Vemo installation CD.  Exiting now.\", "
    "offers to install and never shows its menu";

std::string Printed(const char* format, ...) __attribute__((format(printf, 1, 2)));
std::string Printed(const char* format, ...) {
    char text[256];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    return text;
}

// A launcher path below the disc folder: a folder from the command tables and a file in it.
std::string Joined(const std::wstring& folder, const std::wstring& file) {
    std::string path = Utf8(folder);
    if (!path.empty() && path.back() != '\\') path += '\\';
    return path + Utf8(file);
}

std::string Listed(const std::vector<std::string>& names) {
    std::string text;
    for (std::size_t i = 0; i < names.size(); ++i) {
        if (i > 0) text += i + 1 == names.size() ? " and " : ", ";
        text += names[i];
    }
    return text;
}

std::string MenuName(const ShownLanguage& language) {
    std::string name = std::string("the ") + LanguageName(language.base) + " menu";
    if (language.pickedAs != kNoLanguage) {
        name += std::string(" (after installing in ") + LanguageName(language.pickedAs) + ")";
    }
    return name;
}

std::string EditionLanguages(std::uint32_t edition) {
    std::vector<std::string> names;
    for (const ShownLanguage& language : LanguagesShownBy(edition)) {
        if (language.pickedAs == kNoLanguage) names.push_back(LanguageName(language.base));
    }
    return Listed(names);
}

class Checker {
  public:
    Checker(fs::path root, std::vector<Finding>& findings)
        : root_(std::move(root)), findings_(findings) {}

    std::optional<fs::path> Find(const std::string& windowsPath) const {
        return ResolveDiscPath(root_, windowsPath);
    }
    bool Opens(const std::string& windowsPath) const {
        auto path = Find(windowsPath);
        return path && OpensForReading(*path);
    }
    std::optional<std::vector<std::uint8_t>> Read(const std::string& windowsPath,
                                                  std::uintmax_t limit) const {
        auto path = Find(windowsPath);
        return path ? ReadWholeFile(*path, limit) : std::nullopt;
    }
    void Add(Severity severity, std::string path, std::string problem, std::string effect) {
        findings_.push_back({severity, std::move(path), std::move(problem), std::move(effect)});
    }
    void RequireFile(const std::string& windowsPath, const std::string& effect) {
        if (!Opens(windowsPath)) Add(Severity::Error, windowsPath, "missing", effect);
    }

  private:
    fs::path root_;
    std::vector<Finding>& findings_;
};

// The edition the launcher reads, the way it reads it; the files are then checked against
// `wanted` when given, else against that.
std::uint32_t CheckEditionFile(Checker& checker, std::optional<std::uint32_t> wanted) {
    const std::string name = "ORVAK.INI";
    auto text = checker.Read(name, kLargestProfile);
    std::string problem;
    std::int64_t value = 0;
    if (!text) {
        problem = "missing";
    } else {
        ProfileValue found = FindProfileValue(
            {reinterpret_cast<const char*>(text->data()), text->size()}, "SKU", "SKU");
        if (!found.sectionFound) {
            problem = "no [SKU] section";
        } else if (!found.value) {
            problem = "no SKU key in [SKU]";
        } else {
            value = ProfileInteger(*found.value);
            if (value < 1 || value > 6) {
                problem = "SKU=" + *found.value + " is not an edition (1 to 6)";
            }
        }
    }
    // The launcher's number is unsigned; every value but 1 to 6 makes the same launcher.
    const auto discSku = static_cast<std::uint32_t>(
        value >= 0 && value <= std::numeric_limits<std::uint32_t>::max() ? value : 0);
    if (!problem.empty()) {
        checker.Add(Severity::Error, name, problem, kNoListMenu);
    } else if (wanted && *wanted != discSku) {
        checker.Add(Severity::Error, name,
                    Printed("says edition %u, not %u", static_cast<unsigned>(discSku),
                            static_cast<unsigned>(*wanted)),
                    "the launcher offers edition " + std::to_string(discSku) + "'s languages (" +
                        EditionLanguages(discSku) + ")");
    }
    return wanted.value_or(discSku);
}

std::optional<std::string> ShapeProblem(const DibHeaderFields& header, PictureShape wanted) {
    std::vector<std::string> wrong;
    const std::int64_t height = std::abs(std::int64_t{header.height});
    if (header.width != wanted.width || height != wanted.height) {
        wrong.push_back(Printed("%d x %lld pixels, not %d x %d", header.width,
                                static_cast<long long>(height), wanted.width, wanted.height));
    }
    if (header.bitCount != wanted.bitCount) {
        wrong.push_back(Printed("%u-bit, not %u-bit", header.bitCount, wanted.bitCount));
    }
    if (wrong.empty()) return std::nullopt;
    return wrong.size() == 1 ? wrong[0] : wrong[0] + "; " + wrong[1];
}

// What is wrong with a background file, or nothing.
std::optional<std::string> BackgroundProblem(const Checker& checker, const std::string& path) {
    if (!checker.Find(path)) return "missing";
    auto bytes = checker.Read(path, kLargestFile);
    if (!bytes) return "unreadable or larger than 64 MB";
    auto header = WholeBmpFileHeader(bytes->data(), bytes->size());
    if (!header) return "not a whole bitmap file (truncated or damaged)";
    return ShapeProblem(*header, kBackgroundShape);
}

void CheckBackgrounds(Checker& checker, const std::vector<ShownLanguage>& shown) {
    std::map<LanguageBase, std::optional<std::string>> problems;
    const LanguageInfo* firstWhole = nullptr;
    for (const LanguageInfo& language : Languages()) {
        problems[language.base] = BackgroundProblem(checker, Utf8(language.backgroundFile));
        if (!firstWhole && !problems[language.base]) firstWhole = &language;
    }
    for (const ShownLanguage& language : shown) {
        const auto& problem = problems[language.base];
        if (!problem) continue;
        const std::string effect = firstWhole
                                       ? MenuName(language) + " shows the " +
                                             LanguageName(firstWhole->base) + " background instead"
                                       : kNotOnDisc;
        checker.Add(Severity::Error, Utf8(FindLanguage(language.base)->backgroundFile), *problem,
                    effect);
    }
}

struct ExpectedPicture {
    std::uint16_t id;
    PictureShape shape;
    std::string effect;
};

const char* StateName(int state) {
    static constexpr const char* kNames[kIconStates] = {"normal", "pressed", "focused", "latched"};
    return kNames[state];
}

std::vector<ExpectedPicture> LauncherPictures() {
    std::vector<ExpectedPicture> pictures;
    std::set<std::uint16_t> listed;
    auto add = [&](std::uint16_t id, PictureShape shape, std::string effect) {
        if (id != 0 && listed.insert(id).second) pictures.push_back({id, shape, std::move(effect)});
    };
    add(kLanguageListBackgroundId, kBackgroundShape,
        "the language list is drawn over a language background instead of its own picture");
    add(kAboutPictureId, kAboutPictureShape, "the About box shows no picture");
    add(kOpaqueMaskId, kOpaqueMaskShape, "fold-out panels and plate buttons are not drawn");
    static constexpr const char* kPanels[] = {"Play", "information", "games"};
    for (std::size_t panel = 0; panel < kPanelResources.size(); ++panel) {
        add(kPanelResources[panel].id, kPanelResources[panel].shape,
            std::string("the ") + kPanels[panel] + " panel opens without its backdrop");
    }
    for (std::int32_t key = 0; key < kPlateKeys; ++key) {
        const char* where = key < kFirstListPlate ? "a fold-out panel button" : "a language button";
        // The focused face is the normal picture again.
        add(kPlateResources[key][0], PlateShape(key),
            Printed("%s (plate %d) is blank when normal or focused", where, key));
        add(kPlateResources[key][1], PlateShape(key),
            Printed("%s (plate %d) is blank when pressed", where, key));
    }
    for (std::int32_t key = 0; key < kLoadedIconKeys; ++key) {
        const IconResources& icon = kIconResources[key];
        const PictureShape mask{icon.shape.width, icon.shape.height, 8};
        for (int state = 0; state < kIconStates; ++state) {
            const std::string effect =
                Printed("a main-menu button (picture %d) is blank or misdrawn when %s", key,
                        StateName(state));
            add(icon.picture[state], icon.shape, effect);
            add(icon.mask[state], mask, effect);
        }
    }
    return pictures;
}

void CheckPictures(Checker& checker, const std::vector<std::uint8_t>& file, const PeImage& image) {
    for (const ExpectedPicture& picture : LauncherPictures()) {
        auto found = image.resources.find({NumberedType(kResourceBitmap), picture.id});
        std::optional<std::string> problem;
        if (found == image.resources.end()) {
            problem = "missing";
        } else if (auto header = WholePackedDibHeader(file.data() + found->second.offset,
                                                      found->second.size)) {
            problem = ShapeProblem(*header, picture.shape);
        } else {
            problem = "not a whole bitmap";
        }
        if (problem) {
            checker.Add(Severity::Error, "AutoPlay.exe",
                        Printed("bitmap %u: %s", picture.id, problem->c_str()), picture.effect);
        }
    }
}

std::optional<std::string> PaletteProblem(const std::vector<std::uint8_t>& file,
                                          const PeImage& image) {
    constexpr unsigned kEntries = 256;
    constexpr unsigned kSize = 24 + 4 * kEntries;
    auto found = image.resources.find({"IDR_PALETTE", kPaletteId});
    if (found == image.resources.end()) return "missing";
    const std::uint8_t* data = file.data() + found->second.offset;
    if (found->second.size < kSize) {
        return std::to_string(found->second.size) + " bytes, not " + std::to_string(kSize);
    }
    if (std::memcmp(data, "RIFF", 4) != 0 || std::memcmp(data + 8, "PAL ", 4) != 0) {
        return "not a RIFF \"PAL \" file";
    }
    std::uint16_t version;
    std::uint16_t count;
    std::memcpy(&version, data + 20, 2);
    std::memcpy(&count, data + 22, 2);
    if (version != 0x0300) return Printed("version 0x%04x, not 0x0300", version);
    if (count != kEntries) return Printed("%u entries, not %u", count, kEntries);
    return std::nullopt;
}

void CheckStrings(Checker& checker, const std::vector<std::uint8_t>& file, const PeImage& image) {
    for (const LanguageInfo& language : Languages()) {
        std::vector<std::uint32_t> missing;
        for (std::uint32_t offset : kAllStringOffsets) {
            auto text = FindResourceString(file, image, language.base + offset);
            if (!text || text->empty()) missing.push_back(language.base + offset);
        }
        const std::string name = LanguageName(language.base);
        if (missing.size() == kAllStringOffsets.size()) {
            checker.Add(Severity::Error, "AutoPlay.exe",
                        "all " + std::to_string(missing.size()) + " " + name + " strings missing",
                        "the " + name + " screens have no captions, labels or messages");
            continue;
        }
        for (std::uint32_t id : missing) {
            checker.Add(Severity::Error, "AutoPlay.exe",
                        Printed("string %u (%s) missing", id, name.c_str()),
                        "an empty text in its place on the " + name + " screens");
        }
    }
}

void CheckLauncher(Checker& checker) {
    const std::string name = "AutoPlay.exe";
    auto file = checker.Read(name, kLargestProgram);
    if (!file) {
        checker.Add(Severity::Error, name, "missing", "nothing starts from the disc");
        return;
    }
    auto image = ReadPeImage(*file);
    if (!image) {
        checker.Add(Severity::Error, name, "not a Windows program", "Windows will not start it");
        return;
    }
    if (image->machine == kMachineAmd64) {
        checker.Add(Severity::Error, name, "a 64-bit (x86-64) program, not 32-bit",
                    "it will not start on a 32-bit Windows");
    } else if (image->machine != kMachineI386 || image->pe32Plus) {
        checker.Add(Severity::Error, name,
                    Printed("built for machine 0x%04x, not 32-bit x86", image->machine),
                    "it will not start on a 32-bit x86 Windows");
    }
    CheckPictures(checker, *file, *image);
    if (auto problem = PaletteProblem(*file, *image)) {
        checker.Add(Severity::Warning, name,
                    Printed("palette %u (IDR_PALETTE): %s", kPaletteId, problem->c_str()),
                    "wrong colours on 256-colour displays");
    }
    CheckStrings(checker, *file, *image);
}

void CheckCommandFiles(Checker& checker, std::uint32_t edition,
                       const std::vector<ShownLanguage>& shown) {
    const bool supportTool = EditionHasSupportTool(edition);
    const std::vector<MainButtonLayout> mainPage = MainPageButtons(edition, 0, shown.front().base);
    const bool gamesPanel = std::any_of(
        mainPage.begin(), mainPage.end(),
        [](const MainButtonLayout& button) { return button.role == MainButtonRole::MoreGames; });

    checker.RequireFile(Joined(SetupFolder(L""), kInstallerProgram), "Install does nothing");
    std::vector<std::string> needDisc1 = {
        "Install", "Readme", supportTool ? "the support tool" : "Help", "Registration"};
    if (gamesPanel) needDisc1.push_back("the demos");
    const std::string askDisc1 =
        Listed(needDisc1) + " each ask \"Insert Disc 1\" until the user cancels";
    checker.RequireFile(Utf8(FirstDiscFile(L"")), askDisc1);
    checker.RequireFile(Utf8(SecondDiscFile(L"")), askDisc1);

    // The help page differs by language; the support tool is one for all.
    std::map<std::string, std::vector<std::string>> supportUsers;
    for (const ShownLanguage& language : shown) {
        const ShellTarget target = SupportTarget(L"", edition, language.base);
        supportUsers[Joined(target.folder, target.file)].push_back(LanguageName(language.base));
    }
    for (const auto& [path, languages] : supportUsers) {
        checker.RequireFile(path, supportTool
                                      ? "the support tool button does nothing"
                                      : "the Help button does nothing in the " + Listed(languages) +
                                            (languages.size() > 1 ? " menus" : " menu"));
    }
    const ShellTarget registration = RegistrationTarget(L"");
    checker.RequireFile(Joined(registration.folder, registration.file),
                        "the Registration button does nothing");

    for (const ShownLanguage& language : shown) {
        checker.RequireFile(Utf8(ReadmePath(L"", language.base)),
                            "Readme in " + MenuName(language) +
                                ": Notepad opens and reports that the file cannot be found");
    }
    if (!gamesPanel) return;
    for (const PanelButtonLayout& button : GamesPanelButtons()) {
        const ShellTarget demo = DemoTarget(L"", button.id);
        checker.RequireFile(Joined(demo.folder, demo.file), "its button says \"Sorry.  The demo " +
                                                                Utf8(demo.file) +
                                                                " can't be found on this CD.\"");
    }
}

}  // namespace

const char* LanguageName(LanguageBase base) {
    static constexpr std::pair<LanguageBase, const char*> kNames[] = {
        {kUsEnglish, "US English"},
        {kFrench, "French"},
        {kGerman, "German"},
        {kSwedish, "Swedish"},
        {kDutch, "Dutch"},
        {kPortuguese, "Brazilian Portuguese"},
        {kSpanish, "Spanish"},
        {kItalian, "Italian"},
        {kPolish, "Polish"},
        {kJapanese, "Japanese"},
        {kTraditionalChinese, "Traditional Chinese"},
        {kSimplifiedChinese, "Simplified Chinese"},
        {kThai, "Thai"},
        {kKorean, "Korean"},
        {kUkEnglish, "UK English"},
        {kNorwegian, "Norwegian"},
        {kFinnish, "Finnish"},
        {kDanish, "Danish"}};
    for (const auto& [named, name] : kNames) {
        if (named == base) return name;
    }
    return "unknown";
}

std::vector<ShownLanguage> LanguagesShownBy(std::uint32_t edition) {
    std::vector<ShownLanguage> shown;
    auto add = [&shown](LanguageBase base, LanguageBase pickedAs) {
        if (std::none_of(shown.begin(), shown.end(),
                         [base](const ShownLanguage& language) { return language.base == base; })) {
            shown.push_back({base, pickedAs});
        }
    };
    const LanguageListLayout list = LanguageListFor(edition);
    if (list.buttons.empty()) add(list.settledLanguage, kNoLanguage);
    for (const LanguageButtonLayout& button : list.buttons) add(button.base, kNoLanguage);

    // Once the product is installed the launcher opens in the language the installer
    // recorded, which the launcher's installer argument does not always name exactly.
    const std::size_t offered = shown.size();
    for (std::size_t i = 0; i < offered; ++i) {
        const LanguageBase picked = shown[i].base;
        const InstallLanguage recorded = InstallLanguageFor(InstallerLangIdFor(picked));
        const LanguageBase base = recorded.otherName
                                      ? LanguageBaseForOtherName(recorded.otherName)
                                      : LanguageBaseForProductName(recorded.productName);
        // Edition 2 takes an English product back to its language list instead.
        if (edition == 2 && !recorded.otherName && (base == kUsEnglish || base == kUkEnglish)) {
            continue;
        }
        add(base, picked);
    }
    return shown;
}

std::optional<DiscReport> CheckDisc(const fs::path& folder, std::optional<std::uint32_t> edition) {
    std::error_code error;
    if (!fs::is_directory(folder, error)) return std::nullopt;
    const fs::directory_iterator listing(folder, error);
    if (error) return std::nullopt;
    DiscReport report;
    report.editionGiven = edition.has_value();
    Checker checker(folder, report.findings);
    report.edition = CheckEditionFile(checker, edition);
    const std::vector<ShownLanguage> shown = LanguagesShownBy(report.edition);
    CheckLauncher(checker);
    CheckBackgrounds(checker, shown);
    CheckCommandFiles(checker, report.edition, shown);
    return report;
}
