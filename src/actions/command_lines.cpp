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
