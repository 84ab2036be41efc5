// The launcher used without a mouse: Tab and the arrows walk its buttons in reading order,
// Enter and Space press the focused one, Escape closes an open panel and nothing more.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "launcher_driver_win.h"

namespace {

// The user returns to the launcher (after a program it started took the front).
void ComeBack(HWND window) {
    SetForegroundWindow(window);
    WaitUntil([&] { return GetForegroundWindow() == window; });
}

class Keyboard : public LauncherTest {
  protected:
    // From here on only keys are used.
    bool StartWithKeys() {
        if (!Start(L"-l0409")) return false;
        ComeBack(window);
        return true;
    }

    int FocusedId() const {
        HWND focus = FocusInThreadOf(window);
        return focus && GetParent(focus) == window ? GetDlgCtrlID(focus) : 0;
    }

    // Presses Tab until the button with this id has the focus (at most a round of stops).
    bool TabTo(int id) const {
        for (int i = 0; i < 12 && FocusedId() != id; ++i) PressKey(VK_TAB);
        return FocusedId() == id;
    }

    // A program the launcher started shows its window; the user closes it and comes back.
    bool CloseProgramWindow(const wchar_t* className) const {
        const bool closed = CloseWindowOf(className);
        ComeBack(window);
        return closed;
    }
};

TEST_F(Keyboard, TabAndTheArrowsWalkTheButtonsInReadingOrderWithTheirHoverFace) {
    ASSERT_TRUE(StartWithKeys());
    EXPECT_EQ(FocusedId(), 0) << "no button has the focus before a key is pressed";
    const std::vector<int> order = {101, 107, 103, 108, 1000, 110};
    for (int id : order) {
        PressKey(VK_TAB);
        EXPECT_EQ(FocusedId(), id);
    }
    PressKey(VK_TAB);
    EXPECT_EQ(FocusedId(), 101) << "Tab goes round";
    PressKey(VK_TAB, VK_SHIFT);
    EXPECT_EQ(FocusedId(), 110) << "Shift+Tab goes back";
    PressKey(VK_UP);
    EXPECT_EQ(FocusedId(), 1000);
    PressKey(VK_LEFT);
    EXPECT_EQ(FocusedId(), 108);
    PressKey(VK_DOWN);
    EXPECT_EQ(FocusedId(), 1000);
    PressKey(VK_RIGHT);
    EXPECT_EQ(FocusedId(), 110);

    // The focused button wears the hover face, and loses it with the focus.
    const RECT exitFace{405, 411, 459, 465};
    const Screenshot focused = SettledShot(window);
    PressKey(VK_TAB);
    const Screenshot unfocused = SettledShot(window);
    EXPECT_GT(focused.DifferingPixels(unfocused, exitFace), 200);

    // Escape with no panel open changes nothing and never ends the launcher.
    PressKey(VK_ESCAPE);
    EXPECT_FALSE(launcher.WaitForExit(500).has_value());
    EXPECT_EQ(FocusedId(), 101);
}

TEST_F(Keyboard, EveryButtonOfTheMainPageAndOfAPanelCanBePressed) {
    ASSERT_TRUE(StartWithKeys());

    // Install: the disc's installer asks first; the user declines.
    ASSERT_TRUE(TabTo(101));
    PressKey(VK_RETURN);
    auto question = WaitForMessageBoxTitled(L"The Vemo Vodizuri Virezazida Setup");
    ASSERT_TRUE(question) << "Enter did not start the installer";
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    ComeBack(window);

    // The web site: a browser, or the launcher's message that there is none.
    ASSERT_TRUE(TabTo(107));
    const std::size_t linesBefore = log.Lines().size();
    PressKey(VK_RETURN);
    std::optional<MessageBoxSeen> noBrowser;
    WaitUntil([&] {
        noBrowser = WaitForMessageBox(launcher.Id(), 100);
        return noBrowser.has_value() || log.Lines().size() > linesBefore;
    });
    if (noBrowser) {
        PressKey(VK_RETURN);  // the message box has the focus
        EXPECT_TRUE(WaitUntil([&] { return !IsWindow(noBrowser->window); }));
    }
    ComeBack(window);

    // More Games opens its panel; Escape closes it and leaves the focus on its button.
    ASSERT_TRUE(TabTo(103));
    PressKey(VK_RETURN);
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 601) != nullptr; }));
    EXPECT_EQ(FocusedId(), 103);
    PressKey(VK_ESCAPE);
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 601) == nullptr; }));
    EXPECT_EQ(FocusedId(), 103);

    // More Information opens its panel; Tab reaches its plates after the main page.
    ASSERT_TRUE(TabTo(108));
    PressKey(VK_RETURN);
    ASSERT_TRUE(WaitUntil([&] { return VisibleButton(window, 303) != nullptr; }));
    ASSERT_TRUE(TabTo(303));
    PressKey(VK_RETURN);
    EXPECT_TRUE(CloseProgramWindow(L"KelpaWindow")) << "Enter did not start registration";
    ASSERT_TRUE(TabTo(302));
    PressKey(VK_SPACE);
    EXPECT_TRUE(CloseProgramWindow(L"TrivexWindow")) << "Space did not start the support tool";
    ASSERT_TRUE(TabTo(301));
    PressKey(VK_RETURN);
    EXPECT_TRUE(CloseProgramWindow(L"Notepad")) << "Enter did not open the readme";
    auto lines = log.Lines();
    std::vector<std::wstring> started;
    for (const auto& line : lines) started.push_back(line[0]);
    EXPECT_NE(std::find(started.begin(), started.end(), L"Kelpa.exe"), started.end());
    EXPECT_NE(std::find(started.begin(), started.end(), L"Trivex.exe"), started.end());
    PressKey(VK_ESCAPE);
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 303) == nullptr; }));

    // About: the box opens and Enter closes it.
    ASSERT_TRUE(TabTo(1000));
    PressKey(VK_RETURN);
    auto about = WaitForMessageBox(launcher.Id());
    ASSERT_TRUE(about) << "Enter did not open the About box";
    PressKey(VK_RETURN);
    EXPECT_TRUE(WaitUntil([&] { return !IsWindow(about->window); }));
    ComeBack(window);

    // Exit ends the launcher.
    ASSERT_TRUE(TabTo(110));
    PressKey(VK_RETURN);
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
}

}  // namespace
