#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <limits>
#include <thread>
#include <vector>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"

// The eye travels 10 units along x, the target 10 along z, each frame taking about 1 ms: both
// move the same eased fraction along their own lines, never back and never all the way, for the
// whole duration; the rest of the camera stays. Bad durations draw nothing; non-finite frames are
// drawn but never set.
TEST(CameraGlide, EasesOutOverTheWholeDuration)
{
    RecordingKarvel k;
    const _VelCamera from = k.camera, to = Camera(DorVector3(10, 0, 0), DorVector3(0, 10, 10), 80.0);
    std::vector<_VelCamera> frames;
    k.onDraw = [&] {
        frames.push_back(k.camera);
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    };
    for (double duration : {0.0, -5.0, std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity()})
        CVelMathCamera::AnimationCamera_Sec(&k, from, to, duration, nullptr);
    EXPECT_EQ(k.drawCalls, 0);
    const auto start = std::chrono::steady_clock::now();
    CVelMathCamera::AnimationCamera_Sec(&k, from, to, 60.0, nullptr);
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(58));  // whole-ms clock
    ASSERT_GE(frames.size(), 2u);
    EXPECT_EQ(k.setCameraCalls, static_cast<int>(frames.size()));
    double previous = -1.0;
    for (const _VelCamera& frame : frames) {
        const double f = frame.eye.x / 10.0;
        EXPECT_TRUE(std::fabs(frame.target.z / 10.0 - f) < 1e-12 && frame.eye.y == 0 && frame.target.y == 10 && frame.fovy == from.fovy);
        EXPECT_TRUE(f >= previous && f < 1.0) << f;
        previous = f;
    }
    EXPECT_GT(previous, 0.75);
    _VelCamera infinite = to;
    infinite.eye.x = std::numeric_limits<double>::infinity();
    const int set = k.setCameraCalls;
    k.AnimationCamera(from, infinite, 10.0, nullptr);  // the member glides its own modeller
    EXPECT_TRUE(k.drawCalls > set && k.setCameraCalls == set);
}
