#pragma once
// A real, visible top-level window with a client area of an exact size, for tests that need a
// device context. Windows only.
#include <windows.h>

class TestWindow {
public:
    TestWindow(int clientWidth, int clientHeight);
    ~TestWindow();
    TestWindow(const TestWindow&) = delete;
    TestWindow& operator=(const TestWindow&) = delete;

    // Dispatches whatever messages are queued for this thread.
    static void PumpMessages();

    HWND hwnd;
    HDC dc;  // the window's own DC (CS_OWNDC), valid for the window's life
};
