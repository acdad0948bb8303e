#include <gtest/gtest.h>

#include <chrono>
#include <limits>
#include <thread>
#include <vector>

#include "camera/vel_math_camera.h"
#include "support/recording_karvel.h"

// The eye travels 10 units along x, the target 10 along z; every frame takes about 1 ms.
class GlideAcrossTen : public ::testing::Test {
protected:
    RecordingKarvel modeller;
    _VelCamera from = modeller.camera, to = Camera(DorVector3(10, 0, 0), DorVector3(0, 10, 10), 80.0);
    std::vector<_VelCamera> frames;
    void SetUp() override
    {
        modeller.onDraw = [this] {
            frames.push_back(modeller.camera);
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        };
    }
};

TEST_F(GlideAcrossTen, DrawsForTheWholeDurationAndStopsShortOfTo)
{
    const auto start = std::chrono::steady_clock::now();
    CVelMathCamera::AnimationCamera_Sec(&modeller, from, to, 60.0, nullptr);
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(58));  // whole-ms clock
    ASSERT_GE(frames.size(), 2u);
    EXPECT_EQ(modeller.setCameraCalls, static_cast<int>(frames.size()));
    double previous = -1.0;
    for (const _VelCamera& frame : frames) {
        // Eye and target move the same eased fraction along their own lines; the rest stays.
        double f = frame.eye.x / 10.0;
        EXPECT_NEAR(frame.target.z / 10.0, f, 1e-12);
        EXPECT_TRUE(frame.eye.y == 0 && frame.target.y == 10 && frame.fovy == from.fovy);
        EXPECT_TRUE(f >= previous && f < 1.0);  // ease-out never goes back
        previous = f;
    }
    EXPECT_GT(previous, 0.75);
}

TEST_F(GlideAcrossTen, BadDurationsDrawNothingAndNonFiniteFramesAreNeverSet)
{
    for (double duration : {0.0, -5.0, std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity()})
        CVelMathCamera::AnimationCamera_Sec(&modeller, from, to, duration, nullptr);
    EXPECT_EQ(modeller.drawCalls, 0);
    to.eye.x = std::numeric_limits<double>::infinity();
    modeller.AnimationCamera(from, to, 10.0, nullptr);  // the member glides its own modeller
    EXPECT_GT(modeller.drawCalls, 0);
    EXPECT_EQ(modeller.setCameraCalls, 0);
}
