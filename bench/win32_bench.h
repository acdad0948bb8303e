#pragma once
// A minimal benchmark harness for code that must run under Windows (drawing, picking, capture,
// recording): Google Benchmark is not available to the cross compiler. Each case runs a few
// warm-up calls, then `runs` timed calls; the median and the fastest are printed.
#include <windows.h>

#include <algorithm>
#include <cstdio>
#include <functional>
#include <vector>

struct Win32BenchResult {
    double medianMs;
    double minMs;
};

inline Win32BenchResult Win32Bench(const char* name, int runs, const std::function<void()>& body,
                                   int warmups = 1)
{
    LARGE_INTEGER frequency;
    QueryPerformanceFrequency(&frequency);
    for (int i = 0; i < warmups; ++i)
        body();
    std::vector<double> ms;
    for (int i = 0; i < runs; ++i) {
        LARGE_INTEGER t0, t1;
        QueryPerformanceCounter(&t0);
        body();
        QueryPerformanceCounter(&t1);
        ms.push_back(1000.0 * double(t1.QuadPart - t0.QuadPart) / double(frequency.QuadPart));
    }
    std::sort(ms.begin(), ms.end());
    Win32BenchResult r = {ms[ms.size() / 2], ms.front()};
    std::printf("%-48s median %10.3f ms   min %10.3f ms   (%d runs)\n", name, r.medianMs, r.minMs, runs);
    std::fflush(stdout);
    return r;
}
