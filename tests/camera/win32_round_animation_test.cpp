// The timed orbit on a real window: it turns the eye about the target until the host says stop.
#include <gtest/gtest.h>

#include <cmath>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"
#include "support/win32_test_window.h"

namespace {
double Azimuth(const _VelCamera& c) { return std::atan2(c.eye.y - c.target.y, c.eye.x - c.target.x) * 180 / DorPi; }
}  // namespace

// The host clears the flag from inside a frame (here the tenth); a quit ends the orbit and is
// posted again for the host; no window or no modeller ends it at once.
TEST(RoundAnimation, TurnsAboutTheTargetUntilTheFlagIsClearedAndStopsAtAQuit)
{
    TestWindow window(64, 64);
    RecordingKarvel karvel;
    const _VelCamera start = karvel.camera = Camera(DorVector3(0, -10, 5), DorVector3(0, 0, 0));
    int running = 1;
    karvel.onDraw = [&] { running = karvel.drawCalls < 10; };
    const DWORD begin = GetTickCount();
    CVelMathCamera::RoundAnimationStart(&karvel, running, window.hwnd, 90);
    const DWORD spent = GetTickCount() - begin;
    const double turned = Azimuth(karvel.camera) - Azimuth(start);  // counter-clockwise, at 90 degrees a second
    EXPECT_EQ(karvel.drawCalls, 10);
    EXPECT_GT(turned, 90 * 0.016 * 8);  // nine frames of at least 16 ms each have passed
    EXPECT_LT(turned, 90 * (spent + 50) / 1000.0);
    EXPECT_NEAR(karvel.camera.eye.z, start.eye.z, 1e-9);  // about the target's vertical

    running = 1;
    PostQuitMessage(7);
    CVelMathCamera::RoundAnimationStart(&karvel, running, window.hwnd, 90);
    MSG msg;
    ASSERT_TRUE(PeekMessageA(&msg, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(msg.wParam, 7u);
    CVelMathCamera::RoundAnimationStart(&karvel, running, nullptr, 90);
    CVelMathCamera::RoundAnimationStart(nullptr, running, window.hwnd, 90);
    EXPECT_EQ(karvel.drawCalls, 11);  // the frame before the quit was seen
}
