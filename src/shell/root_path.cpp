#include "shell/root_path.h"

std::optional<std::wstring> FolderWithTrailingBackslash(std::wstring_view programPath,
                                                        std::size_t capacity) {
    std::size_t slash = programPath.rfind(L'\\');
    if (slash == std::wstring_view::npos) return std::nullopt;
    std::size_t length = slash + 1;
    if (length + 1 > capacity) return std::nullopt;
    return std::wstring(programPath.substr(0, length));
}

std::optional<std::wstring> PathInFolder(std::wstring_view folder, std::wstring_view fileName,
                                         std::size_t capacity) {
    if (folder.size() + fileName.size() + 1 > capacity) return std::nullopt;
    std::wstring path(folder);
    path += fileName;
    return path;
}

wchar_t DriveLetterOfDirectory(std::wstring_view directory) {
    if (directory.size() >= 2 && directory[1] == L':') {
        wchar_t letter = directory[0];
        if (letter >= L'a' && letter <= L'z') letter = static_cast<wchar_t>(letter - L'a' + L'A');
        return letter;
    }
    return L'@';
}
