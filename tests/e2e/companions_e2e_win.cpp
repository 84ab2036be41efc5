// The sample disc's game, creator tool, support tool and registration program: each starts
// with the window the launcher and the user expect, records how it was started, and ends
// normally when closed.
#include <gtest/gtest.h>

#include "e2e_support_win.h"
#include "sample_disc_win.h"

namespace {

TEST(Companions, EachOpensItsWindowLogsItsStartAndClosesNormally) {
    struct Row {
        const wchar_t* folder;  // on the disc
        const wchar_t* program;
        const wchar_t* arguments;
        const wchar_t* className;
        const wchar_t* title;
        UINT closeWith;  // WM_CLOSE, or the Esc key
    };
    const Row rows[] = {
        {L"Setup\\Program", L"Vemo.exe", L"-r1024x768", L"Brask", L"The Vemo", WM_CLOSE},
        {L"Setup\\Program", L"Vemo.exe", L"", L"Brask", L"The Vemo", WM_KEYDOWN},
        {L"Setup\\Program", L"TheVemoCreator.exe", L"", L"VemoCreatorWindow", L"The Vemo Creator",
         WM_CLOSE},
        {L"Support", L"Trivex.exe", L"", L"TrivexWindow", L"Trivex Support Information", WM_CLOSE},
        {L"Support", L"Kelpa.exe", L"", L"KelpaWindow", L"Kelpa Electronic Registration",
         WM_KEYDOWN},
    };
    SampleDisc disc;
    CompanionLog log;
    std::size_t started = 0;
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << row.program << " " << row.arguments);
        TestProcess program;
        std::wstring folder = disc.Path(row.folder);
        ASSERT_TRUE(program.Start(folder + L"\\" + row.program, row.arguments, folder));
        ++started;
        HWND window = WaitForWindow(program.Id(), row.className);
        ASSERT_TRUE(window) << "no window of its class";
        wchar_t title[128] = {};
        GetWindowTextW(window, title, 128);
        EXPECT_STREQ(title, row.title);

        auto lines = log.WaitForLines(started);
        ASSERT_EQ(lines.size(), started);
        EXPECT_EQ(lines.back(), (std::vector<std::wstring>{row.program, row.arguments, folder}));

        if (row.closeWith == WM_KEYDOWN) {
            PostMessageW(window, WM_KEYDOWN, VK_ESCAPE, 0);
        } else {
            PostMessageW(window, WM_CLOSE, 0, 0);
        }
        EXPECT_EQ(program.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    }
}

}  // namespace
