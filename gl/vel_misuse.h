#pragma once
// Checked mode (CVelKarvel::SetCheckedMode): reports of the misuse the library can see. Off by
// default; a reporting call never changes what the operation does.
#include "gl/vel_karvel.h"

// Whether checked mode is on.
bool VelCheckedMode();
// In checked mode, writes "karvel: " and what to the debugger's output and hands the same line
// to the host's callback; otherwise does nothing.
void VelReportMisuse(const char* what);
// In checked mode, reports operation when the calling thread is not owner (VelThreadId of the
// thread that initialised the modeller).
void VelCheckThread(unsigned long owner, const char* operation);

// Platform: writes one line to the debugger's output (OutputDebugStringA on Windows, nothing
// elsewhere).
void VelDebugOutput(const char* line);
// Platform: the calling thread's identifier.
unsigned long VelThreadId();
