#include <gtest/gtest.h>

#include <climits>

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

// An eighth of the size clamped to 4..1024 unless a step is set; a step short of the request
// allocates exactly; shrinking keeps the storage and growing back zero-fills.
TEST(DorArray, GrowthStepShrinkAndZeroFill)
{
    const struct { int first, growBy, second, expectedMax; } rows[] = {
        {10, -1, 11, 14}, {80, -1, 81, 90}, {16000, -1, 16001, 17024}, {10, 2, 30, 30}, {30, 2, 31, 32}, {0, -1, 0, 0}};
    for (const auto& r : rows) {
        CDorArray<int, int> a;
        a.SetSize(r.first, r.growBy);
        a.SetSize(r.second);
        EXPECT_EQ(a.maxSize, r.expectedMax) << r.first << " then " << r.second;
        EXPECT_EQ(a.data == nullptr, r.second == 0);
    }
    CDorArray<int, int> a;
    for (int i = 0; i < 8; ++i)
        a.Add(100 + i);
    const int capacity = a.maxSize;
    a.SetSize(2);
    a.SetSize(5);
    EXPECT_EQ(a.maxSize, capacity);
    EXPECT_TRUE(a[1] == 101 && a[2] == 0 && a[4] == 0);  // the old 102 must not reappear
    // Growth near the top of an int is capped, not overflowed; an index no int can count is refused.
    EXPECT_EQ((CDorArray<int, int>::GrownCapacity(INT_MAX - 10, INT_MAX - 10, 0, INT_MAX - 9)), INT_MAX);
    EXPECT_EQ((CDorArray<int, int>::GrownCapacity(100, INT_MAX - 1, 5, INT_MAX)), INT_MAX);
    EXPECT_THROW(a.SetAtGrow(INT_MAX, 1), std::bad_alloc);
    EXPECT_TRUE(a.GetSize() == 5 && a.maxSize == capacity);
#ifndef NDEBUG
    EXPECT_DEATH(a[5], "");
    EXPECT_DEATH(a.SetAtGrow(-1, 0), "");
#endif
}

TEST(DorArray, ElementsLiveOnceAcrossRelocationAndAddSurvivesItsOwnElement)
{
    Tracked::alive = 0;
    {
        CDorArray<Tracked, const Tracked&> a;
        a.SetSize(3);
        a[2].value = 99;
        a.SetSize(500);  // several relocations, bitwise
        EXPECT_TRUE(Tracked::alive == 500 && a[2].value == 99 && a[499].marker == 42);
        a.SetSize(10);
        a.SetAtGrow(20, a[2]);  // the gap is constructed too
        EXPECT_TRUE(Tracked::alive == 21 && a[15].marker == 42 && a[20].value == 99);
    }
    EXPECT_EQ(Tracked::alive, 0);
    CDorArray<double, const double&> d;
    EXPECT_EQ(d.Add(2.5), 0);
    for (int i = 1; i <= 200; ++i)
        ASSERT_EQ(d.Add(d[i - 1]), i);  // the source lives in storage that Add relocates
    EXPECT_EQ(d[200], 2.5);
}

// Assignment copies the elements into the destination's own capacity, not the source's step.
// (That copies are deep, every test that copies a record shows.)
TEST(DorArray, AssignmentKeepsTheDestinationsCapacity)
{
    CDorArray<int, int> src, dst;
    src.SetSize(3, 50);
    src[2] = 3;
    dst.SetSize(20);
    dst = src;
    EXPECT_TRUE(dst.GetSize() == 3 && dst.maxSize == 20 && dst.growBy == 0 && dst[2] == 3);
}
