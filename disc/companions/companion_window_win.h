// The one window every companion program of the sample disc shows: a heading in the
// program's colour, a sentence on what it is, and a few facts (its command line, its
// folder). Painting goes through one function, so a test can render it into a bitmap.
#ifndef AUTOPLAY_DISC_COMPANION_WINDOW_WIN_H
#define AUTOPLAY_DISC_COMPANION_WINDOW_WIN_H

#include <windows.h>

#include <string>
#include <vector>

struct CompanionFact {
    std::wstring label;
    std::wstring value;
};

struct CompanionPage {
    const wchar_t* className;
    const wchar_t* title;    // window caption
    const wchar_t* heading;  // large, on the coloured band
    const wchar_t* purpose;  // one sentence under the band
    COLORREF accent;
    std::vector<CompanionFact> facts;
};

constexpr int kCompanionClientWidth = 560;
constexpr int kCompanionClientHeight = 300;

// "Command line" (or `emptyCommandLine` when there is none) and "Working folder".
std::vector<CompanionFact> StartFacts(const wchar_t* commandLine, const wchar_t* emptyCommandLine);

// Paints the whole of `area`.
void PaintCompanionPage(HDC dc, const RECT& area, const CompanionPage& page);

// Shows the page in a window of its own, centred, until the user closes it (Esc closes it
// too). Returns the program's exit code: 0, or 1 when the window could not be made.
int RunCompanionWindow(HINSTANCE instance, const CompanionPage& page, int showCommand);

#endif
