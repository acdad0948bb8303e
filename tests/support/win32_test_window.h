#pragma once
// A real, visible top-level window with a client area of an exact size, for tests that need a
// device context. Windows only.
#include <windows.h>

class TestWindow {
public:
    TestWindow(int clientWidth, int clientHeight)
    {
        WNDCLASSA wc = {};
        wc.style = CS_OWNDC | CS_HREDRAW | CS_VREDRAW;
        wc.lpfnWndProc = DefWindowProcA;
        wc.hInstance = GetModuleHandleA(nullptr);
        wc.lpszClassName = "KarvelTestWindow";
        RegisterClassA(&wc);  // only the first window's registration succeeds; the class stays
        RECT r = {0, 0, clientWidth, clientHeight};
        const DWORD style = WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN | WS_CLIPSIBLINGS;
        AdjustWindowRect(&r, style, FALSE);
        hwnd = CreateWindowA(wc.lpszClassName, "karvel test", style, 0, 0, r.right - r.left, r.bottom - r.top, nullptr, nullptr,
                             GetModuleHandleA(nullptr), nullptr);
        ShowWindow(hwnd, SW_SHOW);
        UpdateWindow(hwnd);
        PumpMessages();
        dc = GetDC(hwnd);
    }
    ~TestWindow()
    {
        ReleaseDC(hwnd, dc);
        DestroyWindow(hwnd);
        PumpMessages();
    }
    TestWindow(const TestWindow&) = delete;
    TestWindow& operator=(const TestWindow&) = delete;

    HWND hwnd;
    HDC dc;  // the window's own DC (CS_OWNDC), valid for the window's life

private:
    // Dispatches whatever messages are queued for this thread.
    static void PumpMessages()
    {
        for (MSG msg; PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE);)
            DispatchMessageA(&msg);
    }
};
