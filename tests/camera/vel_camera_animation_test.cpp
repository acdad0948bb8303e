#include <gtest/gtest.h>

#include <chrono>
#include <limits>
#include <thread>
#include <vector>

#include "camera/vel_clock.h"
#include "camera/vel_math_camera.h"
#include "model/dor_math.h"
#include "support/recording_karvel.h"

namespace {
// The fraction of the way from `from` to `to` at which p lies, checking that it is on the line.
double FractionAlong(const DorVector3& from, const DorVector3& to, const DorVector3& p)
{
    DorVector3 delta = to - from;
    double f = DorDot(p - from, delta) / DorDot(delta, delta);
    EXPECT_NEAR(DorLength(from + delta * f - p), 0.0, 1e-9);
    return f;
}
}  // namespace

class GlideAcrossTen : public ::testing::Test {
protected:
    // The eye travels 10 units along x, the target 10 along z; every frame takes about 1 ms.
    RecordingKarvel modeller;
    _VelCamera from = modeller.camera;
    _VelCamera to = modeller.camera;
    std::vector<_VelCamera> frames;
    void SetUp() override
    {
        to.eye = DorVector3(10, 0, 0);
        to.target = DorVector3(0, 10, 10);
        to.fovy = 80.0;
        to.aspect = 2.0;
        modeller.onDraw = [this] {
            frames.push_back(modeller.camera);
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        };
    }
    double Glide(double duration)
    {
        auto start = std::chrono::steady_clock::now();
        CVelMathCamera::AnimationCamera_Sec(&modeller, from, to, duration, nullptr);
        return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
    }
};

TEST_F(GlideAcrossTen, DrawsForTheWholeDurationAndStopsShortOfTo)
{
    double took = Glide(60.0);
    EXPECT_GE(took, 58.0);  // the clock counts whole milliseconds
    ASSERT_GE(frames.size(), 2u);
    EXPECT_EQ(modeller.drawCalls, static_cast<int>(frames.size()));
    EXPECT_EQ(modeller.setCameraCalls, modeller.drawCalls);

    double previous = -1.0;
    for (const _VelCamera& frame : frames) {
        double f = FractionAlong(from.eye, to.eye, frame.eye);
        EXPECT_NEAR(FractionAlong(from.target, to.target, frame.target), f, 1e-12);
        EXPECT_GE(f, 0.0);
        EXPECT_LT(f, 1.0);
        EXPECT_GE(f, previous);  // ease-out never goes back
        previous = f;
        EXPECT_EQ(frame.fovy, from.fovy);  // the rest of `from` throughout
        EXPECT_EQ(frame.aspect, from.aspect);
    }
    EXPECT_GT(previous, 0.75);  // the last frame is close to `to`
    EXPECT_LT(modeller.camera.eye.x, 10.0);
}

TEST_F(GlideAcrossTen, EqualEndsStillDrawForTheWholeDuration)
{
    to = from;
    double took = Glide(30.0);
    EXPECT_GE(took, 28.0);
    EXPECT_GT(modeller.drawCalls, 1);
    EXPECT_EQ(frames.back().eye.x, from.eye.x);
}

TEST_F(GlideAcrossTen, ZeroNegativeOrNonFiniteDurationsDrawNothing)
{
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    for (double duration : {0.0, -5.0, nan, inf})
        Glide(duration);
    EXPECT_EQ(modeller.drawCalls, 0);
    EXPECT_EQ(modeller.setCameraCalls, 0);
}

TEST_F(GlideAcrossTen, NonFiniteFramesAreDrawnButNeverSet)
{
    to.eye.x = std::numeric_limits<double>::infinity();
    Glide(10.0);
    EXPECT_GT(modeller.drawCalls, 0);
    EXPECT_EQ(modeller.setCameraCalls, 0);
}

TEST_F(GlideAcrossTen, MemberGlidesItsOwnModeller)
{
    modeller.AnimationCamera(from, to, 15.0, nullptr);
    EXPECT_GT(modeller.drawCalls, 0);
    EXPECT_GT(modeller.camera.eye.x, 0.0);
}

TEST(AnimationClock, CountsMillisecondsForward)
{
    unsigned int before = VelClockMilliseconds();
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    unsigned int passed = VelClockMilliseconds() - before;
    EXPECT_GE(passed, 19u);
    EXPECT_LT(passed, 2000u);
}
