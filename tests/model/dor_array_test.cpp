#include <gtest/gtest.h>

#include "model/dor_array.h"

namespace {
// Counts live objects; `marker` shows whether the constructor ran on relocated storage.
struct Tracked {
    static int alive;
    int value = 7, marker = 42;
    Tracked() { ++alive; }
    Tracked(const Tracked& o) : value(o.value), marker(o.marker) { ++alive; }
    Tracked& operator=(const Tracked& o) = default;
    ~Tracked() { --alive; }
};
int Tracked::alive = 0;
}  // namespace

TEST(DorArrayGrowth, StepIsAnEighthClampedTo4And1024UnlessSetExplicitly)
{
    const struct {
        int first, growBy, second, expectedMax;
    } rows[] = {
        {10, -1, 11, 14},         // 10/8 = 1, clamped up to 4
        {80, -1, 81, 90},         // 10
        {16000, -1, 16001, 17024},  // 2000, clamped down to 1024
        {10, 2, 30, 30},          // a step smaller than the request allocates exactly
        {30, 2, 31, 32},
        {0, -1, 0, 0},            // nothing to hold, nothing allocated
    };
    for (const auto& r : rows) {
        CDorArray<int, int> a;
        a.SetSize(r.first, r.growBy);
        a.SetSize(r.second);
        EXPECT_EQ(a.maxSize, r.expectedMax) << r.first << " then " << r.second;
    }
    CDorArray<int, int> none;
    none.SetSize(0);
    EXPECT_EQ(none.data, nullptr);
}

TEST(DorArrayGrowth, ShrinkKeepsStorageAndGrowingBackZeroFills)
{
    CDorArray<int, int> a;
    for (int i = 0; i < 8; ++i)
        a.Add(100 + i);
    int capacity = a.maxSize;
    a.SetSize(2);
    EXPECT_EQ(a.maxSize, capacity);
    a.SetSize(5);
    EXPECT_EQ(a[1], 101);
    EXPECT_EQ(a[2], 0);  // the old 102 must not reappear
    EXPECT_EQ(a[4], 0);
#ifndef NDEBUG
    EXPECT_DEATH(a[5], "");
#endif
}

TEST(DorArrayElements, ConstructedAndDestroyedOnceAcrossRelocationAndAddSurvivesItsOwnElement)
{
    Tracked::alive = 0;
    {
        CDorArray<Tracked, const Tracked&> a;
        a.SetSize(3);
        a[2].value = 99;
        a.SetSize(500);  // several relocations, bitwise
        EXPECT_EQ(Tracked::alive, 500);
        EXPECT_EQ(a[2].value, 99);
        EXPECT_EQ(a[499].marker, 42);
        a.SetSize(10);
        EXPECT_EQ(Tracked::alive, 10);
    }
    EXPECT_EQ(Tracked::alive, 0);
    CDorArray<double, const double&> d;
    EXPECT_EQ(d.Add(2.5), 0);
    for (int i = 1; i <= 200; ++i)
        EXPECT_EQ(d.Add(d[i - 1]), i);  // the source lives in storage that Add relocates
    EXPECT_EQ(d[200], 2.5);
}

TEST(DorArrayCopy, CopiesElementsKeepsDestinationCapacityNotGrowthStep)
{
    CDorArray<int, int> src;
    src.SetSize(3, 50);
    src[2] = 3;
    CDorArray<int, int> dst;
    dst.SetSize(20);
    dst = src;
    EXPECT_EQ(dst.GetSize(), 3);
    EXPECT_EQ(dst.maxSize, 20);
    EXPECT_EQ(dst.growBy, 0);
    EXPECT_EQ(dst[2], 3);
    CDorArray<int, int> constructed(src);
    EXPECT_EQ(constructed[2], 3);
    EXPECT_NE(constructed.data, src.data);
}
