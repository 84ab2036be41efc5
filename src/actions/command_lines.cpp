#include "actions/command_lines.h"

#include <cwchar>

std::wstring InstallerParameters(LanguageBase base) {
    wchar_t text[8];
    std::swprintf(text, sizeof(text) / sizeof(text[0]), L"-l%04x",
                  static_cast<unsigned>(InstallerLangIdFor(base)));
    return text;
}

std::wstring SetupFolder(std::wstring_view rootPath) {
    return std::wstring(rootPath) + L"Setup";
}

std::wstring FirstDiscFile(std::wstring_view rootPath) {
    return std::wstring(rootPath) + L"Setup\\Tolven8.iff";
}

std::wstring SecondDiscFile(std::wstring_view rootPath) {
    return std::wstring(rootPath) + L"Setup\\data2.cab";
}

std::wstring CreatorFolder(std::wstring_view installPath) {
    return std::wstring(installPath) + L"\\..\\The Vemo Creator";
}

std::optional<std::wstring> GameProgramPath(std::wstring_view installPath) {
    constexpr std::size_t kPathCapacity = 260;
    std::wstring path = std::wstring(installPath) + L"\\" + kGameProgram;
    if (path.size() + 1 > kPathCapacity) return std::nullopt;
    return path;
}

bool EditionHasSupportTool(std::uint32_t discSku) { return discSku == 1 || discSku == 3; }

ShellTarget SupportTarget(std::wstring_view rootPath, std::uint32_t discSku, LanguageBase base) {
    const std::wstring root(rootPath);
    if (EditionHasSupportTool(discSku)) return {root + L"Support", L"Trivex.exe"};
    if (base == kFrench) return {root + L"support\\ix help\\fr-fr", L"IX_Help_Fr.htm"};
    return {root + L"support\\ix help", L"IX_Help_Select.htm"};
}

ShellTarget RegistrationTarget(std::wstring_view rootPath) {
    return {std::wstring(rootPath) + L"Support\\", L"Kelpa.exe"};
}

ShellTarget DemoTarget(std::wstring_view rootPath, std::uint32_t id) {
    const wchar_t* file = L"";
    switch (id) {
        case 601:
            file = L"vemo2.mpg";
            break;
        case 602:
            file = L"vemo2duskaro.mpg";
            break;
        case 603:
            file = L"vemo2lorrel.mpg";
            break;
        case 604:
            file = L"vemo2console.mpg";
            break;
        default:
            break;
    }
    return {std::wstring(rootPath) + L"Demos", file};
}

std::wstring ReadmePath(std::wstring_view rootPath, LanguageBase base) {
    return std::wstring(rootPath) + ReadmeFileFor(base);
}

std::wstring NotepadCommandLine(std::wstring_view readmePath) {
    return L"notepad.exe \"" + std::wstring(readmePath) + L"\"";
}

std::wstring FillPlaceholder(std::wstring_view format, std::wstring_view argument) {
    std::wstring text;
    bool filled = false;
    for (std::size_t i = 0; i < format.size(); ++i) {
        if (format[i] == L'%' && i + 1 < format.size()) {
            if (format[i + 1] == L'%') {
                text += L'%';
                ++i;
                continue;
            }
            if (format[i + 1] == L's' && !filled) {
                text += argument;
                filled = true;
                ++i;
                continue;
            }
        }
        text += format[i];
    }
    return text;
}
