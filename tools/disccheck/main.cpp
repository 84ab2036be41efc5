// disccheck [--edition N] [--json] FOLDER: what the launcher would find wrong in a disc folder.
#include <cstdio>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "disc_checks.h"
#include "report.h"

namespace {

constexpr int kCannotRead = 2;

constexpr char kUsage[] =
    "usage: disccheck [--edition N] [--json] FOLDER\n"
    "  Reports what the launcher would find wrong in a disc folder: ORVAK.INI, the\n"
    "  backgrounds, AutoPlay.exe's pictures, palette and strings, the installer, support,\n"
    "  readme and demo files. Names are matched without regard to case, as on Windows.\n"
    "  --edition N  check the files for edition N (1-6) and report an ORVAK.INI that\n"
    "               says another\n"
    "  --json       print the findings as JSON\n"
    "  Exit code: 0 nothing wrong, 1 something wrong, 2 folder unreadable or bad usage.\n";

int Usage(const char* complaint) {
    if (complaint) std::fprintf(stderr, "disccheck: %s\n", complaint);
    std::fputs(kUsage, stderr);
    return kCannotRead;
}

// Arguments in UTF-8.
int Run(const std::vector<std::string>& arguments) {
    std::optional<std::uint32_t> edition;
    bool json = false;
    std::string folderName;
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        const std::string& argument = arguments[i];
        if (argument == "--json") {
            json = true;
        } else if (argument == "--edition") {
            if (++i == arguments.size() || arguments[i].size() != 1 || arguments[i][0] < '1' ||
                arguments[i][0] > '6') {
                return Usage("--edition takes an edition from 1 to 6");
            }
            edition = static_cast<std::uint32_t>(arguments[i][0] - '0');
        } else if (argument == "--help" || argument == "-h") {
            return Usage(nullptr);
        } else if (!argument.empty() && argument[0] == '-') {
            return Usage(("unknown option " + argument).c_str());
        } else if (folderName.empty()) {
            folderName = argument;
        } else {
            return Usage("one folder at a time");
        }
    }
    if (folderName.empty()) return Usage("no folder given");

    const auto report = CheckDisc(std::filesystem::u8path(folderName), edition);
    if (!report) {
        std::fprintf(stderr, "disccheck: cannot read the folder %s\n", folderName.c_str());
        return kCannotRead;
    }
    const std::string text =
        json ? JsonReport(folderName, *report) : TextReport(folderName, *report);
    std::fwrite(text.data(), 1, text.size(), stdout);
    return ExitCodeFor(*report);
}

}  // namespace

#ifdef _WIN32
// Wide arguments, so that a folder name in any language reaches the file system intact.
int wmain(int argc, wchar_t** argv) {
    std::vector<std::string> arguments;
    for (int i = 1; i < argc; ++i) arguments.push_back(std::filesystem::path(argv[i]).u8string());
    return Run(arguments);
}
#else
int main(int argc, char** argv) {
    return Run(std::vector<std::string>(argv + 1, argv + argc));
}
#endif
