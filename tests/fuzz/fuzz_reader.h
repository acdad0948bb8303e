#pragma once
// What every fuzz target shares: numbers decoded from the fuzz bytes, and the check that stops
// the run on a broken promise.
#include <fuzzer/FuzzedDataProvider.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>

#include "model/dor_types.h"

#define FUZZ_CHECK(condition)                                                             \
    do {                                                                                  \
        if (!(condition)) {                                                               \
            std::fprintf(stderr, "%s:%d: broken: %s\n", __FILE__, __LINE__, #condition);  \
            std::abort();                                                                 \
        }                                                                                 \
    } while (0)

// Mostly small whole numbers (which make collinear and repeated points) and moderate reals; now
// and then a value past what the finite-output promises cover, which sets wild.
struct FuzzReader {
    FuzzedDataProvider in;
    bool wild = false;

    FuzzReader(const uint8_t* data, size_t size) : in(data, size) {}

    int Int(int low, int high) { return in.ConsumeIntegralInRange(low, high); }
    double Number()
    {
        const double special[] = {NAN, INFINITY, -INFINITY, 1e300, -1e300, std::numeric_limits<double>::max(), 1e-300};
        switch (Int(0, 7)) {
        case 0: case 1: case 2: case 3: return Int(-8, 8);
        case 4: case 5: return in.ConsumeFloatingPointInRange(-1000.0, 1000.0);
        case 6: wild = true; return in.PickValueInArray(special);
        default: {
            double v = in.ConsumeFloatingPoint<double>();
            wild = wild || !(std::fabs(v) <= 1e6);
            return v;
        }
        }
    }
    DorVector3 Point()
    {
        double x = Number(), y = Number();
        return DorVector3(x, y, Number());
    }
};

inline bool Finite(const DorVector3& v) { return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z); }
