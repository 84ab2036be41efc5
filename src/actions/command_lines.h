// Paths and parameters of the programs the launcher starts, built in one place.
#ifndef AUTOPLAY_ACTIONS_COMMAND_LINES_H
#define AUTOPLAY_ACTIONS_COMMAND_LINES_H

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "locale/language_table.h"

// "-l" and the installer's language id in four lower-case hexadecimal digits.
std::wstring InstallerParameters(LanguageBase base);

// The installer's folder on the disc, and the installer in it.
std::wstring SetupFolder(std::wstring_view rootPath);
inline constexpr wchar_t kInstallerProgram[] = L"setup.exe";

// The two files that prove Disc 1 is in the drive.
std::wstring FirstDiscFile(std::wstring_view rootPath);
std::wstring SecondDiscFile(std::wstring_view rootPath);

// A program or document to open, and the folder to open it in.
struct ShellTarget {
    std::wstring folder;
    std::wstring file;
};

// The game, its high-resolution argument and the creator tool beside the game's folder.
inline constexpr wchar_t kGameProgram[] = L"Vemo.exe";
inline constexpr wchar_t kHighResolutionParameters[] = L"-r1024x768";
inline constexpr wchar_t kCreatorProgram[] = L"TheVemoCreator.exe";
std::wstring CreatorFolder(std::wstring_view installPath);
// The game's program in its folder, when that path fits the 260 characters Windows opens
// files by.
std::optional<std::wstring> GameProgramPath(std::wstring_view installPath);

// The support-information tool on editions that carry it (1 and 3); the help page (French,
// or the general one) on every other edition.
bool EditionHasSupportTool(std::uint32_t discSku);
ShellTarget SupportTarget(std::wstring_view rootPath, std::uint32_t discSku, LanguageBase base);
// The electronic registration program.
ShellTarget RegistrationTarget(std::wstring_view rootPath);

// The demo video of a demo command, in the disc's Demos folder; an empty file for other ids.
ShellTarget DemoTarget(std::wstring_view rootPath, std::uint32_t id);
// The demo commands, in the order of their ids (the last one no button carries).
inline constexpr std::uint32_t kDemoCommands[] = {601, 602, 603, 604};

// The language's readme on the disc, and Notepad's command line for it: the path is quoted, so
// a disc folder with spaces in its name still opens the right file.
std::wstring ReadmePath(std::wstring_view rootPath, LanguageBase base);
std::wstring NotepadCommandLine(std::wstring_view readmePath);

// A message with one "%s" (as the string sets write it) with `argument` in its place; "%%"
// stands for "%". Nothing else in the text is read as a format, so a stray "%" in a
// translation shows as written.
std::wstring FillPlaceholder(std::wstring_view format, std::wstring_view argument);

#endif
