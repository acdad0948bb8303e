#include <gtest/gtest.h>

#include "model/dor_array.h"

namespace {
// Counts constructions and destructions, and remembers whether its storage was zero on entry.
struct Tracked {
    static int alive;
    int value;
    int marker;
    Tracked() : value(7), marker(42) { ++alive; }
    Tracked(const Tracked& o) : value(o.value), marker(o.marker) { ++alive; }
    Tracked& operator=(const Tracked& o)
    {
        value = o.value;
        return *this;
    }
    ~Tracked() { --alive; }
};
int Tracked::alive = 0;
}  // namespace

TEST(DorArrayGrowth, AutomaticStepIsAnEighthClampedTo4And1024)
{
    CDorArray<int, int> small;
    small.SetSize(10);
    small.SetSize(11);
    EXPECT_EQ(small.maxSize, 14);  // 10/8 = 1, clamped up to 4

    CDorArray<int, int> large;
    large.SetSize(16000);
    large.SetSize(16001);
    EXPECT_EQ(large.maxSize, 17024);  // 2000, clamped down to 1024

    CDorArray<int, int> middle;
    middle.SetSize(80);
    middle.SetSize(81);
    EXPECT_EQ(middle.maxSize, 90);
}

TEST(DorArrayGrowth, ExplicitStepSmallerThanRequestAllocatesExactly)
{
    CDorArray<int, int> a;
    a.SetSize(10, 2);
    a.SetSize(30);
    EXPECT_EQ(a.maxSize, 30);
    EXPECT_EQ(a.growBy, 2);
    a.SetSize(31);
    EXPECT_EQ(a.maxSize, 32);
}

TEST(DorArrayGrowth, SetSizeZeroWithoutStorageAllocatesNothing)
{
    CDorArray<int, int> a;
    a.SetSize(0);
    EXPECT_EQ(a.data, nullptr);
    EXPECT_EQ(a.GetSize(), 0);
    EXPECT_EQ(a.maxSize, 0);
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
}

TEST(DorArrayElements, ConstructedAndDestroyedExactlyOnceAcrossRelocation)
{
    Tracked::alive = 0;
    {
        CDorArray<Tracked, const Tracked&> a;
        a.SetSize(3);
        EXPECT_EQ(Tracked::alive, 3);
        a[2].value = 99;
        a.SetSize(500);  // several relocations, bitwise
        EXPECT_EQ(Tracked::alive, 500);
        EXPECT_EQ(a[2].value, 99);
        EXPECT_EQ(a[499].marker, 42);
        a.SetSize(10);
        EXPECT_EQ(Tracked::alive, 10);
    }
    EXPECT_EQ(Tracked::alive, 0);
}

TEST(DorArrayElements, AddReturnsIndexAndSurvivesAddingItsOwnElement)
{
    CDorArray<Tracked, const Tracked&> a;
    Tracked t;
    t.value = 5;
    EXPECT_EQ(a.Add(t), 0);
    for (int i = 1; i < 200; ++i)
        EXPECT_EQ(a.Add(a[0]), i);  // the source lives in storage that Add relocates
    EXPECT_EQ(a[199].value, 5);

    CDorArray<double, const double&> d;
    d.Add(2.5);
    for (int i = 0; i < 100; ++i)
        d.Add(d[d.GetSize() - 1]);
    EXPECT_EQ(d[100], 2.5);
}

TEST(DorArrayCopy, CopiesElementsKeepsDestinationCapacityNotGrowthStep)
{
    CDorArray<int, int> src;
    src.SetSize(3, 50);
    src[0] = 1;
    src[2] = 3;
    CDorArray<int, int> dst;
    dst.SetSize(20);
    dst = src;
    EXPECT_EQ(dst.GetSize(), 3);
    EXPECT_EQ(dst.maxSize, 20);
    EXPECT_EQ(dst.growBy, 0);
    EXPECT_EQ(dst[2], 3);

    CDorArray<int, int> constructed(src);
    EXPECT_EQ(constructed.GetSize(), 3);
    EXPECT_EQ(constructed[0], 1);
    EXPECT_NE(constructed.data, src.data);
}
