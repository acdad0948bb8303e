#include "camera/vel_clock.h"

#include <chrono>

unsigned int VelClockMilliseconds()
{
    auto now = std::chrono::steady_clock::now().time_since_epoch();
    return static_cast<unsigned int>(std::chrono::duration_cast<std::chrono::milliseconds>(now).count());
}
