// Stand-ins for the Windows services of checked mode: there is no debugger output to write to.
#include "gl/vel_misuse.h"

#include <functional>
#include <thread>

void VelDebugOutput(const char*) {}

unsigned long VelThreadId() { return static_cast<unsigned long>(std::hash<std::thread::id>()(std::this_thread::get_id())); }
