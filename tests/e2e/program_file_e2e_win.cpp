// AutoPlay.exe as it goes on the disc, read the way Windows reads it; the other build's too when
// it has been built (build/i686 beside build/x86_64).
#include <gtest/gtest.h>
// imagehlp.h needs windows.h before it.
// clang-format off
#include <windows.h>
#include <imagehlp.h>
// clang-format on

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
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

TEST(ProgramFile, RunsFromSwapOnRemovableAndNetworkMediaWithAValidChecksum) {
    for (const BuiltProgram& program : BuiltPrograms()) {
        SCOPED_TRACE(program.build);
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

// The answer of QueryActCtxW about an activation context; `index` picks the assembly.
std::vector<char> Query(HANDLE context, ULONG what, DWORD index = 0) {
    std::vector<char> buffer(4096);
    SIZE_T written = 0;
    if (!QueryActCtxW(0, context, &index, what, buffer.data(), buffer.size(), &written)) {
        written = 0;
    }
    buffer.resize(written);
    return buffer;
}

// The operating systems that the compatibility section names. Windows 10 1903 added a 64-bit
// MaxVersionTested to each element (and with it 8-byte alignment), which MinGW's header lacks;
// the size of the answer tells which layout came back.
std::vector<GUID> SupportedOs(const std::vector<char>& info) {
    std::vector<GUID> systems;
    DWORD count = 0;
    if (info.size() < sizeof(count)) return systems;
    std::memcpy(&count, info.data(), sizeof(count));
    const bool withMaxVersion = info.size() >= 8 + count * std::size_t{32};
    const std::size_t first = withMaxVersion ? 8 : 4;
    const std::size_t stride = withMaxVersion ? 32 : sizeof(COMPATIBILITY_CONTEXT_ELEMENT);
    for (DWORD i = 0; i < count && first + (i + 1) * stride <= info.size(); ++i) {
        COMPATIBILITY_CONTEXT_ELEMENT element{};
        std::memcpy(&element, info.data() + first + i * stride, sizeof(element));
        if (element.Type == ACTCTX_COMPATIBILITY_ELEMENT_TYPE_OS) systems.push_back(element.Id);
    }
    return systems;
}

// Through an activation context, as Windows understands the manifest: a misspelt namespace or
// element would simply be ignored there.
TEST(ProgramFile, ManifestAsWindowsReadsIt) {
    const GUID systems[] = {
        {0xe2011457, 0x1546, 0x43c5, {0xa5, 0xfe, 0x00, 0x8d, 0xee, 0xe3, 0xd3, 0xf0}},  // Vista
        {0x35138b9a, 0x5d96, 0x4fbd, {0x8e, 0x2d, 0xa2, 0x44, 0x02, 0x25, 0xf9, 0x3a}},  // 7
        {0x4a2f28e3, 0x53b9, 0x4441, {0xba, 0x9c, 0xd6, 0x9d, 0x4a, 0x4a, 0x6e, 0x38}},  // 8
        {0x1f676c76, 0x80e1, 0x4239, {0x95, 0xbb, 0x83, 0xd0, 0xf6, 0xd0, 0xda, 0x78}},  // 8.1
        {0x8e0f7a12, 0xbfb3, 0x4fe8, {0xb9, 0xa5, 0x48, 0xfd, 0x50, 0xa1, 0x5a, 0x9a}},  // 10, 11
    };
    for (const BuiltProgram& program : BuiltPrograms()) {
        SCOPED_TRACE(program.build);
        auto open = [&](const wchar_t* manifest) {
            ACTCTXW request{};
            request.cbSize = sizeof(request);
            request.dwFlags = ACTCTX_FLAG_RESOURCE_NAME_VALID;
            request.lpSource = program.path.c_str();
            request.lpResourceName = manifest;
            return CreateActCtxW(&request);
        };
        // The assembly after the program's own: common controls 6 for the boxes only, never
        // for the whole process, whose first button would load the library at start-up.
        auto firstDependency = [](HANDLE context) {
            std::vector<char> details =
                Query(context, AssemblyDetailedInformationInActivationContext, 2);
            ACTIVATION_CONTEXT_ASSEMBLY_DETAILED_INFORMATION assembly{};
            if (details.size() < sizeof(assembly)) return std::wstring();
            std::memcpy(&assembly, details.data(), sizeof(assembly));
            return std::wstring(assembly.lpAssemblyEncodedAssemblyIdentity);
        };
        const HANDLE boxes = open(MAKEINTRESOURCEW(2));
        ASSERT_NE(boxes, INVALID_HANDLE_VALUE) << "no manifest for the boxes: " << GetLastError();
        const std::wstring identity = firstDependency(boxes);
        EXPECT_EQ(identity.find(L"Microsoft.Windows.Common-Controls,"), 0u) << identity;
        EXPECT_NE(identity.find(L"version=\"6."), std::wstring::npos) << identity;
        ReleaseActCtx(boxes);

        const HANDLE context = open(CREATEPROCESS_MANIFEST_RESOURCE_ID);
        ASSERT_NE(context, INVALID_HANDLE_VALUE)
            << "no manifest, or one Windows cannot read: " << GetLastError();
        EXPECT_EQ(firstDependency(context), L"");

        std::vector<char> runLevel = Query(context, RunlevelInformationInActivationContext);
        ACTIVATION_CONTEXT_RUN_LEVEL_INFORMATION level{};
        ASSERT_GE(runLevel.size(), sizeof(level));
        std::memcpy(&level, runLevel.data(), sizeof(level));
        EXPECT_EQ(level.RunLevel, ACTCTX_RUN_LEVEL_AS_INVOKER);
        EXPECT_EQ(level.UiAccess, 0u);

        std::vector<GUID> supported =
            SupportedOs(Query(context, CompatibilityInformationInActivationContext));
        EXPECT_EQ(supported.size(), std::size(systems));
        for (const GUID& system : systems) {
            EXPECT_NE(std::find(supported.begin(), supported.end(), system), supported.end())
                << "a system is missing: " << system.Data1;
        }

        // Not DPI aware, with GDI scaling: sized for the screen and drawn sharp (README).
        auto setting = [&](const wchar_t* nameSpace, const wchar_t* name) {
            wchar_t value[64] = {};
            SIZE_T written = 0;
            QueryActCtxSettingsW(0, context, nameSpace, name, value, 64, &written);
            return std::wstring(value);
        };
        EXPECT_EQ(setting(nullptr, L"dpiAware"), L"false");
        EXPECT_EQ(setting(L"http://schemas.microsoft.com/SMI/2017/WindowsSettings", L"gdiScaling"),
                  L"true");
        ReleaseActCtx(context);
    }
}

TEST(ProgramFile, VersionNamesTheMakerTheProductAndTheProjectVersion) {
    // The project's version as Windows writes a file version: four numbers, missing ones 0.
    unsigned version[4] = {};
    std::sscanf(AUTOPLAY_PROJECT_VERSION, "%u.%u.%u.%u", &version[0], &version[1], &version[2],
                &version[3]);
    const std::wstring versionText =
        std::to_wstring(version[0]) + L"." + std::to_wstring(version[1]) + L"." +
        std::to_wstring(version[2]) + L"." + std::to_wstring(version[3]);
    for (const BuiltProgram& program : BuiltPrograms()) {
        SCOPED_TRACE(program.build);
        DWORD size = GetFileVersionInfoSizeW(program.path.c_str(), nullptr);
        ASSERT_GT(size, 0u) << "no version resource";
        std::vector<char> block(size);
        ASSERT_TRUE(GetFileVersionInfoW(program.path.c_str(), 0, size, block.data()));

        VS_FIXEDFILEINFO* fixed = nullptr;
        UINT length = 0;
        ASSERT_TRUE(VerQueryValueW(block.data(), L"\\", reinterpret_cast<void**>(&fixed), &length));
        ASSERT_GE(length, sizeof(VS_FIXEDFILEINFO));
        EXPECT_EQ(fixed->dwFileVersionMS, static_cast<DWORD>(MAKELONG(version[1], version[0])));
        EXPECT_EQ(fixed->dwFileVersionLS, static_cast<DWORD>(MAKELONG(version[3], version[2])));
        EXPECT_EQ(fixed->dwProductVersionMS, fixed->dwFileVersionMS);
        EXPECT_EQ(fixed->dwProductVersionLS, fixed->dwFileVersionLS);

        for (const auto& [name, value] :
             {std::pair<const wchar_t*, std::wstring>{L"CompanyName", L"Orvak"},
              {L"ProductName", L"The Vemo Vodizuri Virezazida AutoPlay"},
              {L"FileVersion", versionText},
              {L"ProductVersion", versionText},
              {L"OriginalFilename", L"AutoPlay.exe"}}) {
            SCOPED_TRACE(name);
            wchar_t* text = nullptr;
            const std::wstring path = std::wstring(L"\\StringFileInfo\\040904B0\\") + name;
            ASSERT_TRUE(VerQueryValueW(block.data(), path.c_str(), reinterpret_cast<void**>(&text),
                                       &length));
            EXPECT_EQ(std::wstring(text), value);
        }
    }
}

}  // namespace
