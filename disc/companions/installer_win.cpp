#include "installer_win.h"

#include "locale/config_win.h"
#include "platform/handles_win.h"
#include "platform/registry_win.h"

namespace {

constexpr wchar_t kMakerFolder[] = L"Orvak";
constexpr wchar_t kGameFolder[] = L"The Vemo";
constexpr wchar_t kCreatorFolder[] = L"The Vemo Creator";
constexpr wchar_t kGameProgram[] = L"Vemo.exe";
constexpr wchar_t kCreatorProgram[] = L"TheVemoCreator.exe";
constexpr wchar_t kVersion[] = L"1.0";

std::wstring FolderOf(const std::wstring& path) {
    std::size_t slash = path.find_last_of(L'\\');
    return slash == std::wstring::npos ? std::wstring() : path.substr(0, slash);
}

std::wstring OwnProgramPath() {
    std::wstring path(MAX_PATH, L'\0');
    for (;;) {
        DWORD length = GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size()));
        if (length == 0) return std::wstring();
        if (length < path.size()) {
            path.resize(length);
            return path;
        }
        path.resize(path.size() * 2);
    }
}

std::optional<std::wstring> EnvironmentValue(const wchar_t* name) {
    DWORD size = GetEnvironmentVariableW(name, nullptr, 0);
    if (size == 0) return std::nullopt;
    std::wstring value(size, L'\0');
    DWORD length = GetEnvironmentVariableW(name, value.data(), size);
    if (length == 0 || length >= size) return std::nullopt;
    value.resize(length);
    return value;
}

std::optional<std::wstring> MakerFolder() {
    std::optional<std::wstring> programFiles = EnvironmentValue(L"ProgramFiles");
    if (!programFiles || programFiles->empty()) return std::nullopt;
    if (programFiles->back() == L'\\') programFiles->pop_back();
    return *programFiles + L"\\" + kMakerFolder;
}

bool MakeFolder(const std::wstring& folder) {
    return CreateDirectoryW(folder.c_str(), nullptr) || GetLastError() == ERROR_ALREADY_EXISTS;
}

// A file that is not there counts as removed.
bool RemoveFile(const std::wstring& path) {
    return DeleteFileW(path.c_str()) || GetFileAttributesW(path.c_str()) == INVALID_FILE_ATTRIBUTES;
}

bool SetText(HKEY key, const wchar_t* name, const std::wstring& text) {
    DWORD bytes = static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t));
    return RegSetValueExW(key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.c_str()),
                          bytes) == ERROR_SUCCESS;
}

bool SetDword(HKEY key, const wchar_t* name, DWORD value) {
    return RegSetValueExW(key, name, 0, REG_DWORD, reinterpret_cast<const BYTE*>(&value),
                          sizeof(value)) == ERROR_SUCCESS;
}

bool WriteProductKey(const InstallPlan& plan) {
    RegistryKey key = CreateKeyForWriting(HKEY_LOCAL_MACHINE, kProductKeyPath);
    if (!key) return false;
    bool written = SetText(key.Get(), L"Version", kVersion) &&
                   SetDword(key.Get(), L"EP8Installed", 1) &&
                   SetText(key.Get(), L"VEMO_DATA", plan.gameFolder) &&
                   SetText(key.Get(), L"VEMO_LANGUAGE", plan.language.productName) &&
                   SetDword(key.Get(), L"VEMO_SKU", plan.discSku);
    if (!written) return false;
    if (plan.language.otherName) {
        return SetText(key.Get(), L"VEMO_OTHERLANGUAGE", plan.language.otherName);
    }
    // A Nordic name left by an earlier installation would outrank the new language.
    LONG result = RegDeleteValueW(key.Get(), L"VEMO_OTHERLANGUAGE");
    return result == ERROR_SUCCESS || result == ERROR_FILE_NOT_FOUND;
}

bool WriteUninstallEntry(const InstallPlan& plan) {
    RegistryKey key = CreateKeyForWriting(HKEY_LOCAL_MACHINE, kUninstallKeyPath);
    if (!key) return false;
    return SetText(key.Get(), L"DisplayName", kProductTitle) &&
           SetText(key.Get(), L"DisplayVersion", kVersion) &&
           SetText(key.Get(), L"Publisher", kMakerFolder) &&
           SetText(key.Get(), L"InstallLocation", plan.gameFolder) &&
           SetText(key.Get(), L"UninstallString", L"\"" + plan.setupProgram + L"\" -u") &&
           SetDword(key.Get(), L"NoModify", 1) && SetDword(key.Get(), L"NoRepair", 1);
}

// Removes the programs and folders of an installation in `gameFolder`; folders that hold
// anything else stay.
bool RemovePrograms(const std::wstring& gameFolder) {
    std::wstring creatorFolder = FolderOf(gameFolder) + L"\\" + kCreatorFolder;
    bool removed = RemoveFile(gameFolder + L"\\" + kGameProgram) &&
                   RemoveFile(creatorFolder + L"\\" + kCreatorProgram);
    RemoveDirectoryW(gameFolder.c_str());
    RemoveDirectoryW(creatorFolder.c_str());
    if (std::optional<std::wstring> maker = MakerFolder()) RemoveDirectoryW(maker->c_str());
    return removed;
}

std::optional<std::wstring> InstalledGameFolder() {
    RegistryKey key = OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath);
    wchar_t folder[MAX_PATH] = {};
    DWORD bytes = sizeof(folder);
    // RegGetValueW checks the type and terminates the text.
    if (!key ||
        RegGetValueW(key.Get(), nullptr, L"VEMO_DATA", RRF_RT_REG_SZ, nullptr, folder, &bytes) !=
            ERROR_SUCCESS ||
        folder[0] == L'\0') {
        return std::nullopt;
    }
    return std::wstring(folder);
}

}  // namespace

std::optional<InstallPlan> PlanInstallation(std::uint16_t langId) {
    std::optional<std::wstring> maker = MakerFolder();
    std::wstring setupProgram = OwnProgramPath();
    if (!maker || setupProgram.empty()) return std::nullopt;
    std::wstring setupFolder = FolderOf(setupProgram);
    std::wstring discIni = FolderOf(setupFolder) + L"\\" + kDiscIniName;

    InstallPlan plan;
    plan.setupProgram = setupProgram;
    plan.sourceFolder = setupFolder + L"\\Program\\";
    plan.gameFolder = *maker + L"\\" + kGameFolder;
    plan.creatorFolder = *maker + L"\\" + kCreatorFolder;
    plan.language = InstallLanguageFor(langId);
    plan.discSku = GetPrivateProfileIntW(L"SKU", L"SKU", 0, discIni.c_str());
    return plan;
}

bool Install(const InstallPlan& plan, std::wstring& error) {
    std::wstring maker = FolderOf(plan.gameFolder);
    if (!MakeFolder(maker) || !MakeFolder(plan.gameFolder) || !MakeFolder(plan.creatorFolder)) {
        error = L"Setup could not make the folder " + plan.gameFolder + L".";
    } else if (!CopyFileW((plan.sourceFolder + kGameProgram).c_str(),
                          (plan.gameFolder + L"\\" + kGameProgram).c_str(), FALSE)) {
        error = L"Setup could not copy " + std::wstring(kGameProgram) + L" from " +
                plan.sourceFolder + L".";
    } else if (!CopyFileW((plan.sourceFolder + kCreatorProgram).c_str(),
                          (plan.creatorFolder + L"\\" + kCreatorProgram).c_str(), FALSE)) {
        error = L"Setup could not copy " + std::wstring(kCreatorProgram) + L" from " +
                plan.sourceFolder + L".";
    } else if (!WriteProductKey(plan) || !WriteUninstallEntry(plan)) {
        error = L"Setup could not write the settings of " + std::wstring(kProductTitle) +
                L" to the registry. Setup needs an administrator account.";
    } else {
        return true;
    }
    // A half installation would make the launcher offer Play for a game that cannot start.
    DeleteKeyTree(HKEY_LOCAL_MACHINE, kProductKeyPath);
    DeleteKeyTree(HKEY_LOCAL_MACHINE, kUninstallKeyPath);
    RemovePrograms(plan.gameFolder);
    return false;
}

bool IsInstalled() {
    return OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath) ||
           OpenKeyForReading(HKEY_LOCAL_MACHINE, kUninstallKeyPath);
}

bool Uninstall(std::wstring& error) {
    std::optional<std::wstring> gameFolder = InstalledGameFolder();
    if (!gameFolder) {
        std::optional<std::wstring> maker = MakerFolder();
        if (maker) gameFolder = *maker + L"\\" + kGameFolder;
    }
    if (gameFolder && !RemovePrograms(*gameFolder)) {
        error = L"Setup could not remove the programs from " + *gameFolder +
                L". Close The Vemo and The Vemo Creator, then try again.";
        return false;
    }
    if (!DeleteKeyTree(HKEY_LOCAL_MACHINE, kProductKeyPath) ||
        !DeleteKeyTree(HKEY_LOCAL_MACHINE, kUninstallKeyPath)) {
        error = L"Setup could not remove the settings of " + std::wstring(kProductTitle) +
                L" from the registry.";
        return false;
    }
    return true;
}
