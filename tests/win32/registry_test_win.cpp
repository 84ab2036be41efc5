// The registry wrappers keep to the product's view: on 64-bit Windows (and in Wine's 64-bit
// prefix) the 32-bit view of HKLM\Software is a tree of its own, Software\Wow6432Node.
#include <gtest/gtest.h>

#include "platform/registry_win.h"
#include "test_support_win.h"

namespace {

constexpr wchar_t kKey[] = L"Software\\Orvak\\Registry Test";

bool Exists(const wchar_t* path, REGSAM view) {
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_LOCAL_MACHINE, path, 0, KEY_READ | view, &key) != ERROR_SUCCESS) {
        return false;
    }
    RegCloseKey(key);
    return true;
}

TEST(Registry, KeysAreOpenedCreatedAndDeletedInTheThirtyTwoBitView) {
    DeleteMachineKey(kKey);  // left by an earlier run that failed half way
    ScopedMachineKey only64(kKey, KEY_WOW64_64KEY);
    EXPECT_FALSE(OpenKeyForReading(HKEY_LOCAL_MACHINE, kKey)) << "a key of the 64-bit view";

    ASSERT_TRUE(CreateKeyForWriting(HKEY_LOCAL_MACHINE, L"Software\\Orvak\\Registry Test\\Below"));
    EXPECT_TRUE(Exists(kKey, KEY_WOW64_32KEY));
    EXPECT_TRUE(OpenKeyForReading(HKEY_LOCAL_MACHINE, kKey));

    EXPECT_TRUE(DeleteKeyTree(HKEY_LOCAL_MACHINE, kKey));
    EXPECT_FALSE(Exists(kKey, KEY_WOW64_32KEY)) << "the key and the one below it are gone";
    EXPECT_TRUE(Exists(kKey, KEY_WOW64_64KEY)) << "the 64-bit view's key stays";
    EXPECT_TRUE(DeleteKeyTree(HKEY_LOCAL_MACHINE, kKey)) << "a key already gone is fine";
}

}  // namespace
