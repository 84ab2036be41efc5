// The host-built disc check on the shipped sample disc and damaged copies of it. It needs the
// built discs, so the MinGW build's tests run it, naming them in DISCCHECK_* variables.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <cstring>
#include <functional>

#include "pe_image.h"
#include "test_files.h"

namespace fs = std::filesystem;

namespace {

std::string Environment(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

struct ToolRun {
    int exitCode = -1;
    std::vector<std::string> lines;
};

ToolRun RunTool(const std::string& arguments) {
    ToolRun run;
    const std::string command = "'" + Environment("DISCCHECK") + "' " + arguments + " 2>&1";
    FILE* output = popen(command.c_str(), "r");
    if (!output) return run;
    for (char line[4096]; std::fgets(line, sizeof line, output);) {
        run.lines.emplace_back(line, std::strcspn(line, "\n"));
    }
    const int status = pclose(output);
    run.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return run;
}

std::string Quoted(const fs::path& path) {
    return "'" + path.string() + "'";
}

// A copy of the 32-bit sample disc in `folder`, of the given edition.
fs::path CopyOfDisc(const TempFolder& folder, int edition) {
    const fs::path disc = folder.Path() / "disc";
    fs::copy(Environment("DISCCHECK_DISC"), disc, fs::copy_options::recursive);
    WriteFile(disc / "ORVAK.INI", "[SKU]\r\nSKU=" + std::to_string(edition) + "\r\n");
    return disc;
}

void Patch(std::vector<std::uint8_t>& bytes, std::size_t at,
           const std::vector<std::uint8_t>& with) {
    std::copy(with.begin(), with.end(), bytes.begin() + static_cast<std::ptrdiff_t>(at));
}

// Rewrites the program in place: `change` gets its bytes and where its resources are.
void Rewrite(const fs::path& program,
             const std::function<void(std::vector<std::uint8_t>&, const PeImage&)>& change) {
    std::ifstream file(program, std::ios::binary);
    std::vector<std::uint8_t> bytes{std::istreambuf_iterator<char>(file), {}};
    file.close();
    const auto image = ReadPeImage(bytes);
    ASSERT_TRUE(image);
    change(bytes, *image);
    WriteFile(program, bytes);
}

// Renumbers bitmap `id` in the program's resource directory, so that the program lacks it.
void RemoveBitmap(std::vector<std::uint8_t>& bytes, const PeImage& image, std::uint16_t id) {
    Patch(bytes, image.resources.at({NumberedType(kResourceBitmap), id}).idEntry,
          {0xF0, 0x7F, 0, 0});
}

// Rewrites the string block that holds `id` with that string empty.
void EmptyString(std::vector<std::uint8_t>& bytes, const PeImage& image, std::uint32_t id) {
    const ResourceBytes block = image.resources.at(
        {NumberedType(kResourceString), static_cast<std::uint16_t>(id / 16 + 1)});
    std::vector<std::uint8_t> rewritten;
    for (std::uint32_t entry = id / 16 * 16; entry < id / 16 * 16 + 16; ++entry) {
        const std::u16string text = entry == id ? u"" : *FindResourceString(bytes, image, entry);
        rewritten.push_back(static_cast<std::uint8_t>(text.size() & 0xFF));
        rewritten.push_back(static_cast<std::uint8_t>(text.size() >> 8));
        for (char16_t unit : text) {
            rewritten.push_back(static_cast<std::uint8_t>(unit & 0xFF));
            rewritten.push_back(static_cast<std::uint8_t>(unit >> 8));
        }
    }
    rewritten.resize(block.size, 0);
    Patch(bytes, block.offset, rewritten);
}

class SampleDisc : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(fs::is_regular_file(Environment("DISCCHECK"))) << "DISCCHECK: the tool";
        ASSERT_TRUE(fs::is_directory(Environment("DISCCHECK_DISC"))) << "DISCCHECK_DISC";
        ASSERT_TRUE(fs::is_regular_file(Environment("DISCCHECK_64BIT_LAUNCHER")));
    }
};

TEST_F(SampleDisc, EveryEditionIsClean) {
    const ToolRun json = RunTool("--json " + Quoted(Environment("DISCCHECK_DISC")));
    EXPECT_EQ(json.exitCode, 0);
    EXPECT_NE(std::find(json.lines.begin(), json.lines.end(), "  \"errors\": 0,"),
              json.lines.end());
    TempFolder folder;
    const fs::path disc = CopyOfDisc(folder, 1);
    for (int edition = 1; edition <= 6; ++edition) {
        SCOPED_TRACE(edition);
        WriteFile(disc / "ORVAK.INI", "[SKU]\nSKU=" + std::to_string(edition) + "\n");
        const ToolRun run = RunTool(Quoted(disc));
        EXPECT_EQ(run.exitCode, 0);
        EXPECT_EQ(run.lines, std::vector<std::string>{"disccheck: " + disc.string() + ", edition " +
                                                      std::to_string(edition) +
                                                      " (ORVAK.INI): no problems found"});
    }
}

// Missing files and off-size or 8-bit backgrounds are the unit tests' (disccheck_test.cpp).
TEST_F(SampleDisc, EachDamageIsReportedByItsLine) {
    const struct {
        const char* what;
        int edition;
        std::function<void(const fs::path&)> damage;
        std::string line;  // the start of the one finding
    } rows[] = {
        {"truncated background", 1,
         [](const fs::path& disc) { fs::resize_file(disc / "Launcher/AutoPlayBack.bmp", 400000); },
         "error    Launcher\\AutoPlayBack.bmp: not a whole bitmap file (truncated or damaged) -> "
         "the US English menu shows the French background instead"},
        {"edition 7", 7, [](const fs::path&) {},
         "error    ORVAK.INI: SKU=7 is not an edition (1 to 6) -> the launcher shows the US "
         "English main menu without a language list"},
        {"no ORVAK.INI", 1, [](const fs::path& disc) { fs::remove(disc / "ORVAK.INI"); },
         "error    ORVAK.INI: missing -> the launcher shows the US English main menu without a "
         "language list"},
        {"Trivex on edition 1", 1,
         [](const fs::path& disc) { fs::remove(disc / "Support/Trivex.exe"); },
         "error    Support\\Trivex.exe: missing -> the support tool button does nothing"},
        {"help page on edition 2", 2,
         [](const fs::path& disc) { fs::remove(disc / "Support/ix help/IX_Help_Select.htm"); },
         "error    support\\ix help\\IX_Help_Select.htm: missing -> the Help button does nothing "
         "in the Polish, German, Italian, Swedish, Dutch, Spanish, Brazilian Portuguese, UK "
         "English, Norwegian, Finnish and Danish menus"},
        {"64-bit launcher", 1,
         [](const fs::path& disc) {
             fs::copy_file(Environment("DISCCHECK_64BIT_LAUNCHER"), disc / "AutoPlay.exe",
                           fs::copy_options::overwrite_existing);
         },
         "error    AutoPlay.exe: a 64-bit (x86-64) program, not 32-bit -> it will not start on a "
         "32-bit Windows"},
        {"launcher without a bitmap", 1,
         [](const fs::path& disc) {
             Rewrite(disc / "AutoPlay.exe",
                     [](auto& bytes, auto& image) { RemoveBitmap(bytes, image, 380); });
         },
         "error    AutoPlay.exe: bitmap 380: missing -> a main-menu button (picture 11) is blank "
         "or misdrawn when normal"},
        {"launcher without a string", 1,
         [](const fs::path& disc) {
             Rewrite(disc / "AutoPlay.exe",
                     [](auto& bytes, auto& image) { EmptyString(bytes, image, 7073); });
         },
         "error    AutoPlay.exe: string 7073 (Spanish) missing -> an empty text in its place on "
         "the Spanish screens"},
        {"launcher with an old palette", 1,
         [](const fs::path& disc) {
             Rewrite(disc / "AutoPlay.exe", [](auto& bytes, const PeImage& image) {
                 Patch(bytes, image.resources.at({"IDR_PALETTE", 247}).offset + 20, {0x00, 0x02});
             });
         },
         "warning  AutoPlay.exe: palette 247 (IDR_PALETTE): version 0x0200, not 0x0300 -> wrong "
         "colours on 256-colour displays"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.what);
        TempFolder folder;
        const fs::path disc = CopyOfDisc(folder, row.edition);
        row.damage(disc);
        const ToolRun run = RunTool(Quoted(disc));
        EXPECT_EQ(run.exitCode, 1);
        ASSERT_EQ(run.lines.size(), 2u) << testing::PrintToString(run.lines);
        EXPECT_EQ(run.lines[0].substr(0, row.line.size()), row.line);
        const std::string counts =
            row.line.rfind("error", 0) == 0 ? "1 error, 0 warnings" : "0 errors, 1 warning";
        EXPECT_EQ(run.lines[1].substr(run.lines[1].find("(ORVAK.INI): ")),
                  "(ORVAK.INI): " + counts);
    }
}

TEST_F(SampleDisc, UnreadableFoldersExitWithTwo) {
    TempFolder folder;
    WriteFile(folder.Path() / "file", std::string("x"));
    for (const fs::path& path : {folder.Path() / "missing", folder.Path() / "file"}) {
        SCOPED_TRACE(path);
        const ToolRun run = RunTool(Quoted(path));
        EXPECT_EQ(run.exitCode, 2);
        EXPECT_EQ(run.lines,
                  std::vector<std::string>{"disccheck: cannot read the folder " + path.string()});
    }
}

}  // namespace
