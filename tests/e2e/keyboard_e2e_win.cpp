// The launcher without a mouse: Tab and the arrows walk, Enter and Space press, Escape closes.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "launcher_driver_win.h"

namespace {

class Keyboard : public LauncherTest {
  protected:
    // From here on only keys are used.
    bool StartWithKeys() {
        shell.OpenEverythingWithViewer();
        if (!Start(L"-l0409")) return false;
        ComeBack();
        return true;
    }

    // The user returns to the launcher after a program it started took the front.
    void ComeBack() const {
        SetForegroundWindow(window);
        WaitUntil([&] { return GetForegroundWindow() == window; });
    }

    int FocusedId() const {
        HWND focus = FocusInThreadOf(window);
        return focus && GetParent(focus) == window ? GetDlgCtrlID(focus) : 0;
    }

    // Tabs to the button (at most a round of stops) and presses it with `key`.
    bool PressWithKey(int id, WORD key = VK_RETURN) const {
        for (int i = 0; i < 12 && FocusedId() != id; ++i) PressKey(VK_TAB);
        if (FocusedId() != id) return false;
        PressKey(key);
        return true;
    }

    // A program the launcher started shows its window; the user closes it and comes back.
    bool CloseProgramWindow(const wchar_t* className) const {
        const bool closed = CloseWindowOf(className);
        ComeBack();
        return closed;
    }

    ShellAssociations shell;
};

TEST_F(Keyboard, TabAndTheArrowsWalkTheButtonsInReadingOrderWithTheirHoverFace) {
    ASSERT_TRUE(StartWithKeys());
    EXPECT_EQ(FocusedId(), 0) << "no button has the focus before a key is pressed";
    // Tab goes round, Shift+Tab back, the arrows step as Tab and Shift+Tab do.
    const struct {
        WORD key;
        WORD modifier;
        int focused;
    } steps[] = {{VK_TAB, 0, 101},  {VK_TAB, 0, 107},  {VK_TAB, 0, 103},   {VK_TAB, 0, 108},
                 {VK_TAB, 0, 1000}, {VK_TAB, 0, 110},  {VK_TAB, 0, 101},   {VK_TAB, VK_SHIFT, 110},
                 {VK_UP, 0, 1000},  {VK_LEFT, 0, 108}, {VK_DOWN, 0, 1000}, {VK_RIGHT, 0, 110}};
    for (const auto& step : steps) {
        PressKey(step.key, step.modifier);
        EXPECT_EQ(FocusedId(), step.focused) << "after key " << step.key << " to " << step.focused;
    }

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
    ASSERT_TRUE(PressWithKey(101));
    log.ExpectNext(L"setup.exe", L"-l0009", disc.Path(L"Setup"));
    auto question = WaitForMessageBox(0, L"The Vemo Vodizuri Virezazida Setup");
    ASSERT_TRUE(question) << "Enter did not start the installer";
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    ComeBack();

    ASSERT_TRUE(PressWithKey(107));
    log.ExpectNext(L"viewer.exe", L"\"http://www.vemo.example\"", disc.Root());
    ComeBack();

    // More Games opens its panel; Escape closes it and leaves the focus on its button.
    ASSERT_TRUE(PressWithKey(103));
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 601) != nullptr; }));
    EXPECT_EQ(FocusedId(), 103);
    PressKey(VK_ESCAPE);
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 601) == nullptr; }));
    EXPECT_EQ(FocusedId(), 103);

    // More Information opens its panel; Tab reaches its plates after the main page.
    ASSERT_TRUE(PressWithKey(108));
    ASSERT_TRUE(WaitUntil([&] { return VisibleButton(window, 303) != nullptr; }));
    ASSERT_TRUE(PressWithKey(303));
    log.ExpectNext(L"Kelpa.exe", L"", disc.Path(L"Support"));
    EXPECT_TRUE(CloseProgramWindow(L"KelpaWindow"));
    ASSERT_TRUE(PressWithKey(302, VK_SPACE));
    log.ExpectNext(L"Trivex.exe", L"", disc.Path(L"Support"));
    EXPECT_TRUE(CloseProgramWindow(L"TrivexWindow"));
    ASSERT_TRUE(PressWithKey(301));
    EXPECT_TRUE(CloseProgramWindow(L"Notepad")) << "Enter did not open the readme";
    PressKey(VK_ESCAPE);
    EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 303) == nullptr; }));

    // About: the box opens and Enter closes it.
    ASSERT_TRUE(PressWithKey(1000));
    auto about = WaitForMessageBox(launcher.Id());
    ASSERT_TRUE(about) << "Enter did not open the About box";
    PressKey(VK_RETURN);
    EXPECT_TRUE(WaitUntil([&] { return !IsWindow(about->window); }));
    ComeBack();

    // Exit ends the launcher.
    ASSERT_TRUE(PressWithKey(110));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
}

}  // namespace
