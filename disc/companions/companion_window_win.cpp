#include "companion_window_win.h"

#include "platform/handles_win.h"

namespace {

constexpr int kBandHeight = 76;
constexpr int kMargin = 28;
constexpr int kLabelWidth = 130;
constexpr int kRowHeight = 26;
constexpr wchar_t kFace[] = L"Tahoma";
constexpr COLORREF kText = RGB(40, 44, 52);
constexpr COLORREF kQuietText = RGB(118, 124, 134);

COLORREF Mix(COLORREF from, COLORREF to, int toPercent) {
    auto channel = [toPercent](int a, int b) {
        return (a * (100 - toPercent) + b * toPercent) / 100;
    };
    return RGB(channel(GetRValue(from), GetRValue(to)), channel(GetGValue(from), GetGValue(to)),
               channel(GetBValue(from), GetBValue(to)));
}

UniqueGdiObject MakeFont(int height, int weight) {
    return UniqueGdiObject(CreateFontW(-height, 0, 0, 0, weight, FALSE, FALSE, FALSE,
                                       DEFAULT_CHARSET, OUT_TT_PRECIS, CLIP_DEFAULT_PRECIS,
                                       CLEARTYPE_QUALITY, DEFAULT_PITCH | FF_SWISS, kFace));
}

void Fill(HDC dc, const RECT& rect, COLORREF colour) {
    UniqueGdiObject brush(CreateSolidBrush(colour));
    FillRect(dc, &rect, static_cast<HBRUSH>(brush.Get()));
}

// A soft wash from a tint of the accent at the top to white, in bands: GradientFill would
// need another library for a background nobody studies.
void PaintBackground(HDC dc, const RECT& area, COLORREF accent) {
    constexpr int kBands = 32;
    COLORREF top = Mix(accent, RGB(255, 255, 255), 88);
    int height = area.bottom - area.top;
    for (int band = 0; band < kBands; ++band) {
        RECT rect = area;
        rect.top = area.top + height * band / kBands;
        rect.bottom = area.top + height * (band + 1) / kBands;
        Fill(dc, rect, Mix(top, RGB(255, 255, 255), band * 100 / (kBands - 1)));
    }
}

void PaintBand(HDC dc, const RECT& area, const CompanionPage& page, HGDIOBJ headingFont) {
    RECT band{area.left, area.top, area.right, area.top + kBandHeight};
    Fill(dc, band, page.accent);
    // Two rings on the right edge give the band some life without any picture files.
    UniqueGdiObject ring(CreatePen(PS_SOLID, 10, Mix(page.accent, RGB(255, 255, 255), 18)));
    int saved = SaveDC(dc);
    SelectObject(dc, ring.Get());
    SelectObject(dc, GetStockObject(NULL_BRUSH));
    IntersectClipRect(dc, band.left, band.top, band.right, band.bottom);
    Ellipse(dc, band.right - 150, band.top - 40, band.right - 30, band.bottom + 40);
    Ellipse(dc, band.right - 95, band.top + 8, band.right + 25, band.bottom + 88);
    RestoreDC(dc, saved);  // puts the pen back before it is deleted, and the clip

    SelectObject(dc, headingFont);
    SetTextColor(dc, RGB(255, 255, 255));
    RECT text{band.left + kMargin, band.top, band.right - kMargin, band.bottom};
    DrawTextW(dc, page.heading, -1, &text, DT_SINGLELINE | DT_VCENTER | DT_END_ELLIPSIS);
}

}  // namespace

std::vector<CompanionFact> StartFacts(const wchar_t* commandLine, const wchar_t* emptyCommandLine) {
    wchar_t folder[MAX_PATH * 2] = {};
    GetCurrentDirectoryW(MAX_PATH * 2, folder);
    bool hasCommandLine = commandLine && commandLine[0] != L'\0';
    return {{L"Command line", hasCommandLine ? commandLine : emptyCommandLine},
            {L"Working folder", folder}};
}

void PaintCompanionPage(HDC dc, const RECT& area, const CompanionPage& page) {
    // Fonts are declared before the saved state, so they are deselected before they go.
    UniqueGdiObject headingFont = MakeFont(26, FW_BOLD);
    UniqueGdiObject bodyFont = MakeFont(15, FW_NORMAL);
    UniqueGdiObject labelFont = MakeFont(14, FW_BOLD);
    UniqueGdiObject smallFont = MakeFont(12, FW_NORMAL);
    int saved = SaveDC(dc);
    SetBkMode(dc, TRANSPARENT);

    PaintBackground(dc, area, page.accent);
    PaintBand(dc, area, page, headingFont.Get());

    SelectObject(dc, bodyFont.Get());
    SetTextColor(dc, kText);
    RECT purpose{area.left + kMargin, area.top + kBandHeight + 18, area.right - kMargin,
                 area.top + kBandHeight + 62};
    DrawTextW(dc, page.purpose, -1, &purpose, DT_WORDBREAK | DT_END_ELLIPSIS);

    int y = purpose.bottom + 12;
    for (const CompanionFact& fact : page.facts) {
        RECT label{area.left + kMargin, y, area.left + kMargin + kLabelWidth, y + kRowHeight};
        SelectObject(dc, labelFont.Get());
        SetTextColor(dc, Mix(page.accent, RGB(0, 0, 0), 25));
        DrawTextW(dc, fact.label.c_str(), -1, &label, DT_SINGLELINE | DT_VCENTER | DT_END_ELLIPSIS);

        RECT value{label.right, y, area.right - kMargin, y + kRowHeight};
        SelectObject(dc, bodyFont.Get());
        SetTextColor(dc, kText);
        // Long folders lose their middle, so the drive and the last folder stay readable.
        DrawTextW(dc, fact.value.c_str(), -1, &value,
                  DT_SINGLELINE | DT_VCENTER | DT_PATH_ELLIPSIS | DT_NOPREFIX);
        y += kRowHeight;
    }

    SelectObject(dc, smallFont.Get());
    SetTextColor(dc, kQuietText);
    RECT footer{area.left + kMargin, area.bottom - 30, area.right - kMargin, area.bottom - 10};
    DrawTextW(dc, L"A program of the sample disc. Press Esc to close it.", -1, &footer,
              DT_SINGLELINE | DT_VCENTER | DT_RIGHT);
    RestoreDC(dc, saved);
}

namespace {

LRESULT CALLBACK CompanionWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_NCCREATE) {
        auto* create = reinterpret_cast<CREATESTRUCTW*>(lParam);
        SetWindowLongPtrW(window, GWLP_USERDATA,
                          reinterpret_cast<LONG_PTR>(create->lpCreateParams));
    }
    auto* page = reinterpret_cast<const CompanionPage*>(GetWindowLongPtrW(window, GWLP_USERDATA));
    switch (message) {
        case WM_ERASEBKGND:
            return 1;  // the paint covers every pixel; erasing first would only flicker
        case WM_PAINT: {
            PAINTSTRUCT paint;
            HDC dc = BeginPaint(window, &paint);
            RECT client;
            GetClientRect(window, &client);
            if (page) PaintCompanionPage(dc, client, *page);
            EndPaint(window, &paint);
            return 0;
        }
        case WM_PRINTCLIENT: {
            RECT client;
            GetClientRect(window, &client);
            if (page) PaintCompanionPage(reinterpret_cast<HDC>(wParam), client, *page);
            return 0;
        }
        case WM_KEYDOWN:
            if (wParam == VK_ESCAPE) {
                PostMessageW(window, WM_CLOSE, 0, 0);
                return 0;
            }
            break;
        case WM_DESTROY:
            PostQuitMessage(0);
            return 0;
        default:
            break;
    }
    return DefWindowProcW(window, message, wParam, lParam);
}

}  // namespace

int RunCompanionWindow(HINSTANCE instance, const CompanionPage& page, int showCommand) {
    WNDCLASSEXW windowClass{};
    windowClass.cbSize = sizeof(windowClass);
    windowClass.lpfnWndProc = CompanionWindowProc;
    windowClass.hInstance = instance;
    windowClass.hIcon = LoadIconW(nullptr, IDI_APPLICATION);
    windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
    windowClass.lpszClassName = page.className;
    if (!RegisterClassExW(&windowClass)) return 1;

    constexpr DWORD kStyle = WS_OVERLAPPED | WS_CAPTION | WS_SYSMENU | WS_MINIMIZEBOX;
    RECT frame{0, 0, kCompanionClientWidth, kCompanionClientHeight};
    AdjustWindowRectEx(&frame, kStyle, FALSE, 0);
    int width = frame.right - frame.left;
    int height = frame.bottom - frame.top;
    HWND window = CreateWindowExW(0, page.className, page.title, kStyle,
                                  (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
                                  (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height,
                                  nullptr, nullptr, instance, const_cast<CompanionPage*>(&page));
    if (!window) return 1;
    ShowWindow(window, showCommand);
    UpdateWindow(window);

    MSG message;
    while (GetMessageW(&message, nullptr, 0, 0) > 0) {
        TranslateMessage(&message);
        DispatchMessageW(&message);
    }
    return 0;
}
