#include "support/win32_test_window.h"

TestWindow::TestWindow(int clientWidth, int clientHeight)
{
    static const char* const className = [] {
        WNDCLASSA wc = {};
        wc.style = CS_OWNDC | CS_HREDRAW | CS_VREDRAW;
        wc.lpfnWndProc = DefWindowProcA;
        wc.hInstance = GetModuleHandleA(nullptr);
        wc.lpszClassName = "KarvelTestWindow";
        RegisterClassA(&wc);
        return wc.lpszClassName;
    }();
    RECT r = {0, 0, clientWidth, clientHeight};
    DWORD style = WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN | WS_CLIPSIBLINGS;
    AdjustWindowRect(&r, style, FALSE);
    hwnd = CreateWindowA(className, "karvel test", style, 0, 0, r.right - r.left, r.bottom - r.top, nullptr, nullptr,
                         GetModuleHandleA(nullptr), nullptr);
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
    for (MSG msg; PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE);)
        DispatchMessageA(&msg);
}
