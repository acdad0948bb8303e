// Selection records to hits: decoding, depth scaling, the comb sort's order.
#include <gtest/gtest.h>

#include <vector>

#include "gl/vel_pick.h"

namespace {
_DorPosition* Handle(int i) { return reinterpret_cast<_DorPosition*>(static_cast<size_t>(0x1000 + 16 * i)); }

// A selection buffer as the pick pass leaves it: one record per (name, minimum depth).
std::vector<unsigned int> Records(const std::vector<std::pair<unsigned int, unsigned int>>& hits)
{
    std::vector<unsigned int> words;
    for (const auto& h : hits) {
        words.push_back(1);
        words.push_back(h.second);
        words.push_back(h.second + 100);
        words.push_back(h.first);
    }
    words.resize(VelSelectBufferWords);
    return words;
}

std::vector<_VelSelect> Sorted(std::vector<_VelSelect> hits)
{
    VelSortHits(hits.data(), static_cast<int>(hits.size()));
    return hits;
}
}  // namespace

TEST(SelectDepth, SpansZeroToOneInSinglePrecision)
{
    EXPECT_EQ(VelSelectDepth(0), 0.0);
    EXPECT_EQ(VelSelectDepth(0x80000000u), 0.5);
    EXPECT_EQ(VelSelectDepth(0xFFFFFFFFu), 1.0);  // rounds up in single precision
    // Two depths a few units apart in the last bits come out equal, as hosts have always seen.
    EXPECT_EQ(VelSelectDepth(0xF0000001u), VelSelectDepth(0xF0000003u));
}

TEST(DecodeHits, NamesBecomeTheHandlesTheyIndex)
{
    _DorPosition* names[] = {Handle(0), Handle(1), Handle(2)};
    std::vector<unsigned int> buffer = Records({{2, 0x40000000u}, {0, 0x80000000u}});
    CDorArray<_VelSelect, _VelSelect&> hits;
    VelDecodeHits(buffer.data(), VelSelectBufferWords, 2, names, 3, hits);
    ASSERT_EQ(hits.GetSize(), 2);
    EXPECT_EQ(hits[0].position, Handle(2));
    EXPECT_EQ(hits[0].depth, 0.25);
    EXPECT_EQ(hits[1].position, Handle(0));
    EXPECT_EQ(hits[1].depth, 0.5);
}

TEST(DecodeHits, NoHitAndOverflowLeaveTheArrayAlone)
{
    _DorPosition* names[] = {Handle(0)};
    std::vector<unsigned int> buffer = Records({{0, 7}});
    CDorArray<_VelSelect, _VelSelect&> hits;
    _VelSelect sentinel = {Handle(9), 0.75};
    hits.Add(sentinel);
    for (int count : {0, -1}) {
        VelDecodeHits(buffer.data(), VelSelectBufferWords, count, names, 1, hits);
        ASSERT_EQ(hits.GetSize(), 1);
        EXPECT_EQ(hits[0].position, Handle(9));
        EXPECT_EQ(hits[0].depth, 0.75);
    }
}

TEST(DecodeHits, NeverReadsPastTheBufferOrTheNames)
{
    _DorPosition* names[] = {Handle(0), Handle(1)};
    std::vector<unsigned int> buffer = Records({{0, 10}, {5, 20}, {1, 30}});
    CDorArray<_VelSelect, _VelSelect&> hits;
    // A claimed count beyond what 12 words hold reads 3 records; name 5 was never pushed.
    VelDecodeHits(buffer.data(), 12, 1000, names, 2, hits);
    ASSERT_EQ(hits.GetSize(), 2);
    EXPECT_EQ(hits[0].position, Handle(0));
    EXPECT_EQ(hits[1].position, Handle(1));
}

TEST(SortHits, AscendingDepth)
{
    std::vector<_VelSelect> hits;
    const double depths[] = {0.9, 0.1, 0.5, 0.3, 0.7, 0.2, 0.8, 0.4, 0.6, 0.05, 0.95, 0.15, 0.0};
    for (int i = 0; i < 13; ++i)
        hits.push_back(_VelSelect{Handle(i), depths[i]});
    std::vector<_VelSelect> sorted = Sorted(hits);
    for (size_t i = 1; i < sorted.size(); ++i)
        EXPECT_LE(sorted[i - 1].depth, sorted[i].depth);
    EXPECT_EQ(sorted.front().position, Handle(12));
    EXPECT_EQ(sorted.back().position, Handle(10));
}

TEST(SortHits, EqualDepthsAreNeverSwappedWithEachOther)
{
    std::vector<_VelSelect> same;
    for (int i = 0; i < 7; ++i)
        same.push_back(_VelSelect{Handle(i), 0.5});
    std::vector<_VelSelect> kept = Sorted(same);
    for (int i = 0; i < 7; ++i)
        EXPECT_EQ(kept[static_cast<size_t>(i)].position, Handle(i));

    // The first pass (gap 3 * 10 / 13 = 2) swaps the outer two; the equal pair then stays
    // reversed, which a stable sort would not give.
    std::vector<_VelSelect> three = {{Handle(0), 0.5}, {Handle(1), 0.5}, {Handle(2), 0.1}};
    std::vector<_VelSelect> combed = Sorted(three);
    EXPECT_EQ(combed[0].position, Handle(2));
    EXPECT_EQ(combed[1].position, Handle(1));
    EXPECT_EQ(combed[2].position, Handle(0));
}

TEST(SortHits, EmptyAndSingleAreUntouched)
{
    VelSortHits(nullptr, 0);
    _VelSelect one = {Handle(3), 0.4};
    VelSortHits(&one, 1);
    EXPECT_EQ(one.position, Handle(3));
}
