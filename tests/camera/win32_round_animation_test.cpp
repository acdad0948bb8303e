// The timed orbit on a live modeller: it turns the eye about the target until the host says stop.
#include <gtest/gtest.h>

#include <cmath>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/gl_live_modeller.h"

namespace {
int* orbitFlag = nullptr;

// A thread timer's callback, dispatched from inside the orbit: the host clearing the flag. A
// late tick after the test must not write through a stale pointer.
void CALLBACK StopOrbit(HWND, UINT, UINT_PTR, DWORD)
{
    if (orbitFlag)
        *orbitFlag = 0;
}

double Azimuth(const _VelCamera& c) { return std::atan2(c.eye.y - c.target.y, c.eye.x - c.target.x) * 180 / DorPi; }
}  // namespace

TEST_F(LiveModeller, OrbitTurnsAboutTheTargetUntilTheFlagIsClearedAndStopsAtAQuit)
{
    _VelCamera start, camera;
    karvel.GetCamera(start);
    start.eye = DorVector3(0, -10, 5);
    karvel.SetCamera(start);
    int running = 1;
    orbitFlag = &running;
    UINT_PTR timer = SetTimer(nullptr, 0, 300, StopOrbit);
    DWORD begin = GetTickCount();
    CVelMathCamera::RoundAnimationStart(&karvel, running, window.hwnd, 90);
    DWORD spent = GetTickCount() - begin;
    KillTimer(nullptr, timer);
    orbitFlag = nullptr;
    EXPECT_GE(spent, 250u);
    EXPECT_LT(spent, 3000u);
    karvel.GetCamera(camera);
    double turned = Azimuth(camera) - Azimuth(start);  // 90 degrees a second for ~0.3 s
    EXPECT_GT(turned, 10);
    EXPECT_LT(turned, 90);
    EXPECT_NEAR(camera.eye.z, start.eye.z, 1e-9);  // about the target's vertical

    // A quit ends it and is posted again for the host; no window ends it at once.
    running = 1;
    PostQuitMessage(7);
    CVelMathCamera::RoundAnimationStart(&karvel, running, window.hwnd, 90);
    MSG msg;
    ASSERT_TRUE(PeekMessageA(&msg, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(msg.wParam, 7u);
    CVelMathCamera::RoundAnimationStart(&karvel, running, nullptr, 90);
    CVelMathCamera::RoundAnimationStart(nullptr, running, window.hwnd, 90);
}
