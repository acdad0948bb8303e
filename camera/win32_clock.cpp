#include "camera/vel_clock.h"

#include <windows.h>
#include <mmsystem.h>

unsigned int VelClockMilliseconds() { return timeGetTime(); }
