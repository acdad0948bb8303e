#include "gl/vel_misuse.h"

#include <windows.h>

void VelDebugOutput(const char* line) { OutputDebugStringA(line); }

unsigned long VelThreadId() { return GetCurrentThreadId(); }
