#include "gl/vel_misuse.h"

#include <atomic>
#include <string>

namespace {
#ifdef KARVEL_CHECKED
std::atomic<bool> checked{true};
#else
std::atomic<bool> checked{false};
#endif
// Set before the modellers are used (as documented), so read without a lock.
VelMisuseCallback hostCallback = nullptr;
void* hostContext = nullptr;
}  // namespace

void CVelKarvel::SetCheckedMode(int on, VelMisuseCallback callback, void* context)
{
    hostCallback = callback;
    hostContext = context;
    checked = on != 0;
}

bool VelCheckedMode() { return checked; }

void VelReportMisuse(const char* what)
{
    if (!checked)
        return;
    std::string line = std::string("karvel: ") + what;
    VelDebugOutput((line + "\n").c_str());
    if (hostCallback)
        hostCallback(line.c_str(), hostContext);
}

void VelCheckThread(unsigned long owner, const char* operation)
{
    if (checked && VelThreadId() != owner)
        VelReportMisuse((std::string(operation) + " called from a thread other than the one that initialised the modeller").c_str());
}
