// The glide's clock on Windows is the multimedia timer itself.
#include <gtest/gtest.h>

#include <windows.h>
#include <mmsystem.h>

#include "camera/vel_clock.h"

TEST(Win32AnimationClock, ReadsTheMultimediaTimer)
{
    DWORD before = timeGetTime();
    unsigned int ours = VelClockMilliseconds();
    DWORD after = timeGetTime();
    EXPECT_LE(static_cast<unsigned int>(ours - before), static_cast<unsigned int>(after - before));
}
