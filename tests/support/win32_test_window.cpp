#include "support/win32_test_window.h"

namespace {
const char* RegisterTestClass()
{
    static const char* name = nullptr;
    if (!name) {
        WNDCLASSA wc = {};
        wc.style = CS_OWNDC | CS_HREDRAW | CS_VREDRAW;
        wc.lpfnWndProc = DefWindowProcA;
        wc.hInstance = GetModuleHandleA(nullptr);
        wc.lpszClassName = "KarvelTestWindow";
        RegisterClassA(&wc);
        name = wc.lpszClassName;
    }
    return name;
}
}  // namespace

TestWindow::TestWindow(int clientWidth, int clientHeight)
{
    RECT r = {0, 0, clientWidth, clientHeight};
    DWORD style = WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN | WS_CLIPSIBLINGS;
    AdjustWindowRect(&r, style, FALSE);
    hwnd = CreateWindowA(RegisterTestClass(), "karvel test", style, 0, 0, r.right - r.left, r.bottom - r.top,
                         nullptr, nullptr, GetModuleHandleA(nullptr), nullptr);
    ShowWindow(hwnd, SW_SHOW);
    UpdateWindow(hwnd);
    PumpMessages();
    dc = GetDC(hwnd);
}

TestWindow::~TestWindow()
{
    ReleaseDC(hwnd, dc);
    DestroyWindow(hwnd);
    PumpMessages();
}

void TestWindow::PumpMessages()
{
    MSG msg;
    while (PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        TranslateMessage(&msg);
        DispatchMessageA(&msg);
    }
}
