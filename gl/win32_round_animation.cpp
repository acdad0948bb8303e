// The timed orbit: frames drawn on the window while its thread's messages keep flowing. The static
// lives with the modeller because it drives one; the orbit itself is camera maths.
#include <windows.h>
#include <mmsystem.h>

#include "camera/vel_camera_motion.h"
#include "camera/vel_math_camera.h"
#include "gl/vel_karvel.h"

namespace {
const DWORD kFrameMilliseconds = 16;

// Dispatches what is queued; false when WM_QUIT arrived (posted again for the host's loop).
bool PumpMessages()
{
    MSG msg;
    while (PeekMessageA(&msg, nullptr, 0, 0, PM_REMOVE)) {
        if (msg.message == WM_QUIT) {
            PostQuitMessage(static_cast<int>(msg.wParam));
            return false;
        }
        TranslateMessage(&msg);
        DispatchMessageA(&msg);
    }
    return true;
}
}  // namespace

void CVelMathCamera::RoundAnimationStart(CVelKarvel* modeler, int& running, HWND window, int degreesPerSecond)
{
    if (modeler == nullptr)
        return;
    _VelCamera start{};
    modeler->GetCamera(start);
    const DWORD begin = timeGetTime();
    while (running && IsWindow(window)) {
        const DWORD frameStart = timeGetTime();
        modeler->SetCamera(VelOrbitCamera(start, degreesPerSecond, frameStart - begin));
        HDC dc = GetDC(window);
        modeler->DrawModel(dc);
        ReleaseDC(window, dc);
        if (!PumpMessages())
            break;
        const DWORD spent = timeGetTime() - frameStart;
        if (spent < kFrameMilliseconds)
            Sleep(kFrameMilliseconds - spent);
    }
}
