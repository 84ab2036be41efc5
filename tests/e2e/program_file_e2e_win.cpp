// AutoPlay.exe as it goes on the disc, read the way Windows reads it. The other build's program
// is read too when it has been built (build/i686 beside build/x86_64).
#include <gtest/gtest.h>
// imagehlp.h needs windows.h before it.
// clang-format off
#include <windows.h>
#include <imagehlp.h>
// clang-format on

#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "test_support_win.h"

namespace {

struct BuiltProgram {
    std::wstring build;
    std::wstring path;
};

// This build's sample disc, which every test here needs, and the other build's when there.
std::vector<BuiltProgram> BuiltPrograms() {
    const std::wstring own = sizeof(void*) == 8 ? L"x86_64" : L"i686";
    const std::wstring other = sizeof(void*) == 8 ? L"i686" : L"x86_64";
    std::vector<BuiltProgram> programs = {
        {own, TestProgramFolder() + L"..\\disc\\AutoPlay.exe"},
        {other, TestProgramFolder() + L"..\\..\\" + other + L"\\disc\\AutoPlay.exe"}};
    EXPECT_NE(GetFileAttributesW(programs[0].path.c_str()), INVALID_FILE_ATTRIBUTES);
    if (GetFileAttributesW(programs[1].path.c_str()) == INVALID_FILE_ATTRIBUTES) {
        std::printf("No %ls build beside this one: its AutoPlay.exe is not read.\n", other.c_str());
        programs.pop_back();
    }
    return programs;
}

std::string Narrow(const std::wstring& text) {
    return std::string(text.begin(), text.end());
}

TEST(ProgramFile, RunsFromSwapOnRemovableAndNetworkMediaWithAValidChecksum) {
    for (const BuiltProgram& program : BuiltPrograms()) {
        SCOPED_TRACE(Narrow(program.build));
        char header[4096] = {};
        std::ifstream(std::filesystem::path(program.path), std::ios::binary)
            .read(header, sizeof(header));
        DWORD pe = 0;
        std::memcpy(&pe, header + 0x3C, sizeof(pe));
        ASSERT_LT(pe + 4 + sizeof(IMAGE_FILE_HEADER), sizeof(header));
        IMAGE_FILE_HEADER file{};
        std::memcpy(&file, header + pe + 4, sizeof(file));
        const WORD runFromSwap = IMAGE_FILE_REMOVABLE_RUN_FROM_SWAP | IMAGE_FILE_NET_RUN_FROM_SWAP;
        EXPECT_EQ(file.Characteristics & runFromSwap, runFromSwap);
        EXPECT_TRUE(file.Characteristics & IMAGE_FILE_EXECUTABLE_IMAGE);
        // The linker's checksum was brought up to date after the flags were set.
        DWORD stored = 0, computed = 0;
        ASSERT_EQ(MapFileAndCheckSumW(program.path.c_str(), &stored, &computed),
                  static_cast<DWORD>(CHECKSUM_SUCCESS));
        EXPECT_NE(stored, 0u);
        EXPECT_EQ(stored, computed);
    }
}

}  // namespace
