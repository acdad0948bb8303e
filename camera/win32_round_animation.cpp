// The timed orbit: frames drawn on the window while its thread's messages keep flowing.
#include <windows.h>
#include <mmsystem.h>

#include <cmath>

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

// The start camera turned about its target by the angle reached after elapsed milliseconds.
_VelCamera OrbitAt(const _VelCamera& start, int degreesPerSecond, DWORD elapsed)
{
    _VelCamera camera = start;
    double degrees = std::fmod(degreesPerSecond * (elapsed / 1000.0), 360.0);
    CVelMathCamera::RoundDolly(camera, 0.0, degrees);
    return camera;
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
        modeler->SetCamera(OrbitAt(start, degreesPerSecond, frameStart - begin));
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
