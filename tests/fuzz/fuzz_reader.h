#pragma once
// What every fuzz target shares: numbers decoded from the fuzz bytes, and the check that stops
// the run on a broken promise.
#include <fuzzer/FuzzedDataProvider.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "model/dor_types.h"

#define FUZZ_CHECK(condition) \
    ((condition) ? void() : (std::fprintf(stderr, "%s:%d: broken: %s\n", __FILE__, __LINE__, #condition), std::abort()))

// Mostly small whole numbers (which make collinear and repeated points) and moderate reals; now
// and then a value past what the finite-output promises cover, which sets wild.
struct FuzzReader {
    FuzzedDataProvider in;
    bool wild = false;

    FuzzReader(const uint8_t* data, size_t size) : in(data, size) {}

    int Int(int low, int high) { return in.ConsumeIntegralInRange(low, high); }
    double Number()
    {
        const int how = Int(0, 7);
        if (how < 4)
            return Int(-8, 8);
        if (how < 6)
            return in.ConsumeFloatingPointInRange(-1000.0, 1000.0);
        const double v = how == 6 ? in.PickValueInArray<double>({NAN, INFINITY, -INFINITY, 1e-300}) : in.ConsumeFloatingPoint<double>();
        wild = wild || how == 6 || !(std::fabs(v) <= 1e6);
        return v;
    }
    DorVector3 Point() { return DorVector3{Number(), Number(), Number()}; }  // braces: read in order
};

inline bool Finite(const DorVector3& v) { return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z); }
