#include "shell_associations_win.h"

#include <gtest/gtest.h>
#include <windows.h>

#include "test_support_win.h"

namespace {

// HKEY_CLASSES_ROOT merges these two; both are set aside.
struct ClassesRoot {
    HKEY hive;
    const wchar_t* tag;
};
const ClassesRoot kRoots[] = {{HKEY_LOCAL_MACHINE, L"Machine"}, {HKEY_CURRENT_USER, L"User"}};
const wchar_t kClasses[] = L"Software\\Classes\\";
const wchar_t kSetAside[] = L"Software\\AutoPlay tests\\Set aside\\";
const wchar_t* const kNames[] = {
    L"http", L"https", L".htm", L".mpg", L"AutoPlayTests.htm", L"AutoPlayTests.mpg"};

bool KeyExists(HKEY hive, const std::wstring& path) {
    HKEY key = nullptr;
    if (RegOpenKeyExW(hive, path.c_str(), 0, KEY_READ, &key) != ERROR_SUCCESS) return false;
    RegCloseKey(key);
    return true;
}

void DeleteKey(HKEY hive, const std::wstring& path) {
    if (RegDeleteTreeW(hive, path.c_str()) == ERROR_SUCCESS) RegDeleteKeyW(hive, path.c_str());
}

// Copies a key with everything below it to a new place; false when `from` does not exist.
bool CopyKey(HKEY hive, const std::wstring& from, const std::wstring& to) {
    HKEY source = nullptr;
    if (RegOpenKeyExW(hive, from.c_str(), 0, KEY_READ, &source) != ERROR_SUCCESS) return false;
    HKEY target = nullptr;
    LONG created =
        RegCreateKeyExW(hive, to.c_str(), 0, nullptr, 0, KEY_ALL_ACCESS, nullptr, &target, nullptr);
    EXPECT_EQ(created, ERROR_SUCCESS);
    if (created == ERROR_SUCCESS) {
        EXPECT_EQ(RegCopyTreeW(source, nullptr, target), ERROR_SUCCESS);
        RegCloseKey(target);
    }
    RegCloseKey(source);
    return created == ERROR_SUCCESS;
}

void SetText(const std::wstring& keyPath, const wchar_t* name, const std::wstring& text) {
    const std::wstring path = kClasses + keyPath;
    ASSERT_EQ(RegSetKeyValueW(HKEY_LOCAL_MACHINE, path.c_str(), name, REG_SZ, text.c_str(),
                              static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t))),
              ERROR_SUCCESS);
}

std::wstring OpenCommand(const std::wstring& program) {
    return L"\"" + program + L"\" \"%1\"";
}

}  // namespace

ShellAssociations::ShellAssociations() {
    for (const ClassesRoot& root : kRoots) {
        for (const wchar_t* name : kNames) {
            const std::wstring live = kClasses + std::wstring(name);
            const std::wstring aside = kSetAside + std::wstring(root.tag) + L"\\" + name;
            DeleteKey(root.hive, aside);
            if (CopyKey(root.hive, live, aside)) DeleteKey(root.hive, live);
            EXPECT_FALSE(KeyExists(root.hive, live)) << "could not set aside the shell's " << name;
        }
    }
}

ShellAssociations::~ShellAssociations() {
    for (const ClassesRoot& root : kRoots) {
        for (const wchar_t* name : kNames) {
            const std::wstring live = kClasses + std::wstring(name);
            const std::wstring aside = kSetAside + std::wstring(root.tag) + L"\\" + name;
            DeleteKey(root.hive, live);
            if (CopyKey(root.hive, aside, live)) DeleteKey(root.hive, aside);
        }
    }
    DeleteKey(HKEY_CURRENT_USER, L"Software\\AutoPlay tests");
    DeleteKey(HKEY_LOCAL_MACHINE, L"Software\\AutoPlay tests");
}

void ShellAssociations::OpenWebAddressesWith(const std::wstring& program) const {
    for (const wchar_t* protocol : {L"http", L"https"}) {
        SetText(protocol, nullptr, L"URL:" + std::wstring(protocol));
        SetText(protocol, L"URL Protocol", L"");
        SetText(std::wstring(protocol) + L"\\shell\\open\\command", nullptr, OpenCommand(program));
    }
}

void ShellAssociations::OpenFilesWith(const wchar_t* extension, const std::wstring& program) const {
    const std::wstring kind = L"AutoPlayTests" + std::wstring(extension);
    SetText(extension, nullptr, kind);
    SetText(kind + L"\\shell\\open\\command", nullptr, OpenCommand(program));
}

void ShellAssociations::OpenEverythingWithViewer() const {
    OpenWebAddressesWith(ViewerProgram());
    OpenFilesWith(L".htm", ViewerProgram());
    OpenFilesWith(L".mpg", ViewerProgram());
}

void ShellAssociations::ForgetWebAddresses() const {
    for (const wchar_t* protocol : {L"http", L"https"}) {
        DeleteKey(HKEY_LOCAL_MACHINE, kClasses + std::wstring(protocol));
    }
}

void ShellAssociations::ForgetFiles(const wchar_t* extension) const {
    DeleteKey(HKEY_LOCAL_MACHINE, kClasses + std::wstring(extension));
    DeleteKey(HKEY_LOCAL_MACHINE, kClasses + (L"AutoPlayTests" + std::wstring(extension)));
}

std::wstring ViewerProgram() {
    return TestProgramFolder() + L"viewer.exe";
}
