#include "sample_disc_win.h"

#include <gtest/gtest.h>
#include <windows.h>

#include "test_support_win.h"

namespace {

// Copies `from` into the new folder `to`, both with trailing backslashes; false on any failure.
bool CopyTree(const std::wstring& from, const std::wstring& to) {
    if (!CreateDirectoryW(to.c_str(), nullptr) && GetLastError() != ERROR_ALREADY_EXISTS) {
        return false;
    }
    WIN32_FIND_DATAW entry;
    HANDLE search = FindFirstFileW((from + L"*").c_str(), &entry);
    if (search == INVALID_HANDLE_VALUE) return false;
    bool copied = true;
    do {
        std::wstring name = entry.cFileName;
        if (name == L"." || name == L"..") continue;
        if (entry.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) {
            copied = CopyTree(from + name + L"\\", to + name + L"\\") && copied;
        } else {
            copied = CopyFileW((from + name).c_str(), (to + name).c_str(), FALSE) && copied;
        }
    } while (FindNextFileW(search, &entry));
    FindClose(search);
    return copied;
}

std::wstring BuiltDisc() {
    std::wstring relative = TestProgramFolder() + L"..\\disc\\";
    wchar_t full[MAX_PATH * 2] = {};
    DWORD length = GetFullPathNameW(relative.c_str(), MAX_PATH * 2, full, nullptr);
    return length > 0 && length < MAX_PATH * 2 ? std::wstring(full) : relative;
}

}  // namespace

SampleDisc::SampleDisc(const std::wstring& name) {
    wchar_t base[MAX_PATH];
    GetTempPathW(MAX_PATH, base);
    static unsigned counter = 0;
    root_ = std::wstring(base) + name + L"-" + std::to_wstring(GetCurrentProcessId()) + L"-" +
            std::to_wstring(++counter) + L"\\";
    RemoveTree(root_);
    std::wstring built = BuiltDisc();
    EXPECT_NE(GetFileAttributesW((built + L"AutoPlay.exe").c_str()), INVALID_FILE_ATTRIBUTES)
        << "the sample disc has not been built";
    EXPECT_TRUE(CopyTree(built, root_)) << "the sample disc could not be copied";
}

SampleDisc::~SampleDisc() {
    for (int attempt = 0; attempt < 50; ++attempt) {
        RemoveTree(root_);
        if (GetFileAttributesW(root_.c_str()) == INVALID_FILE_ATTRIBUTES) return;
        Sleep(100);
    }
}

bool SampleDisc::Has(const std::wstring& relativePath) const {
    return GetFileAttributesW(Path(relativePath).c_str()) != INVALID_FILE_ATTRIBUTES;
}

void SampleDisc::SetEdition(int sku) const {
    std::string ini = "[SKU]\r\nSKU=" + std::to_string(sku) + "\r\n";
    HANDLE file = CreateFileW(Path(L"ORVAK.INI").c_str(), GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    ASSERT_NE(file, INVALID_HANDLE_VALUE);
    DWORD written = 0;
    WriteFile(file, ini.data(), static_cast<DWORD>(ini.size()), &written, nullptr);
    CloseHandle(file);
    EXPECT_EQ(written, ini.size());
}

void SampleDisc::Remove(const std::wstring& relativePath) const {
    std::wstring path = Path(relativePath);
    DWORD attributes = GetFileAttributesW(path.c_str());
    ASSERT_NE(attributes, INVALID_FILE_ATTRIBUTES) << "nothing to remove";
    if (attributes & FILE_ATTRIBUTE_DIRECTORY) {
        RemoveTree(path);
    } else {
        SetFileAttributesW(path.c_str(), FILE_ATTRIBUTE_NORMAL);
        DeleteFileW(path.c_str());
    }
    EXPECT_FALSE(Has(relativePath));
}
