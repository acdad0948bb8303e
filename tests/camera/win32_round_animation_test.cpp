// The timed orbit on a live modeller: it turns the eye about the target until the host says stop.
#include <gtest/gtest.h>

#include <cmath>

#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/gl_live_modeller.h"

namespace {
CVelKarvel* orbiting = nullptr;
int* orbitFlag = nullptr;
double startAzimuth = 0;
DWORD orbitBegin = 0;

double Azimuth(const _VelCamera& c) { return std::atan2(c.eye.y - c.target.y, c.eye.x - c.target.x) * 180 / DorPi; }

// A thread timer's callback, dispatched from inside the orbit: the host clearing the flag once the
// eye has visibly turned, however slowly the frames come. A late tick after the test must not
// write through a stale pointer.
void CALLBACK StopOrbit(HWND, UINT, UINT_PTR, DWORD)
{
    if (!orbitFlag)
        return;
    _VelCamera c;
    orbiting->GetCamera(c);
    if (Azimuth(c) - startAzimuth > 10 || GetTickCount() - orbitBegin > 10000)  // or give up
        *orbitFlag = 0;
}
}  // namespace

TEST_F(LiveModeller, OrbitTurnsAboutTheTargetUntilTheFlagIsClearedAndStopsAtAQuit)
{
    _VelCamera start, camera;
    karvel.GetCamera(start);
    start.eye = DorVector3(0, -10, 5);
    karvel.SetCamera(start);
    int running = 1;
    orbiting = &karvel, orbitFlag = &running, startAzimuth = Azimuth(start);
    UINT_PTR timer = SetTimer(nullptr, 0, 20, StopOrbit);
    DWORD begin = orbitBegin = GetTickCount();
    CVelMathCamera::RoundAnimationStart(&karvel, running, window.hwnd, 90);
    DWORD spent = GetTickCount() - begin;
    KillTimer(nullptr, timer);
    orbitFlag = nullptr;
    karvel.GetCamera(camera);
    double turned = Azimuth(camera) - Azimuth(start);  // counter-clockwise, at 90 degrees a second
    EXPECT_GT(turned, 10);
    EXPECT_LT(turned, 90 * (spent + 50) / 1000.0);
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
