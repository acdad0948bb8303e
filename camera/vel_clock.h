#pragma once
// The animation clock: milliseconds from an arbitrary origin, wrapping at 2^32. On Windows it is
// timeGetTime (win32_clock.cpp); elsewhere a monotonic clock (std_clock.cpp).

// Differences of two readings are meaningful as unsigned 32-bit values, across a wrap too.
unsigned int VelClockMilliseconds();
