// The launcher used without a mouse: Tab and the arrows walk its buttons in reading order,
// Enter and Space press the focused one, Escape closes an open panel and nothing more.
#include <gtest/gtest.h>

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
    void SetUp() override {
        LauncherTest::SetUp();
        shell.OpenEverythingWithViewer();
    }

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

    ShellAssociations shell;
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
    log.ExpectNext(L"setup.exe", L"-l0009", disc.Path(L"Setup"));
    auto question = WaitForMessageBoxTitled(L"The Vemo Vodizuri Virezazida Setup");
    ASSERT_TRUE(question) << "Enter did not start the installer";
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    ComeBack(window);

    ASSERT_TRUE(TabTo(107));
    PressKey(VK_RETURN);
    log.ExpectNext(L"viewer.exe", L"\"http://www.vemo.example\"", disc.Root());
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
    log.ExpectNext(L"Kelpa.exe", L"", disc.Path(L"Support"));
    EXPECT_TRUE(CloseProgramWindow(L"KelpaWindow"));
    ASSERT_TRUE(TabTo(302));
    PressKey(VK_SPACE);
    log.ExpectNext(L"Trivex.exe", L"", disc.Path(L"Support"));
    EXPECT_TRUE(CloseProgramWindow(L"TrivexWindow"));
    ASSERT_TRUE(TabTo(301));
    PressKey(VK_RETURN);
    EXPECT_TRUE(CloseProgramWindow(L"Notepad")) << "Enter did not open the readme";
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
