// Selection records to hits: decoding, depth scaling, the comb sort's order.
#include <gtest/gtest.h>

#include <vector>

#include "gl/vel_pick.h"

namespace {
_DorPosition* Handle(int i) { return reinterpret_cast<_DorPosition*>(static_cast<size_t>(0x1000 + 16 * i)); }

// Hits as (handle index, depth) pairs, for comparing whole lists.
std::vector<std::pair<int, double>> Listed(const _VelSelect* hits, int count)
{
    std::vector<std::pair<int, double>> out;
    for (int i = 0; i < count; ++i)
        out.push_back({static_cast<int>((reinterpret_cast<size_t>(hits[i].position) - 0x1000) / 16), hits[i].depth});
    return out;
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

// Records of (count 1, minimum depth, maximum depth, name); names index the handles pushed.
TEST(DecodeHits, NamesBecomeHandlesWithinTheBufferAndTheNames)
{
    _DorPosition* names[] = {Handle(0), Handle(1), Handle(2)};
    std::vector<unsigned int> buffer = {1, 0x40000000u, 0, 2, 1, 0x80000000u, 0, 0, 1, 0, 0, 7, 1, 0, 0, 1};
    buffer.resize(VelSelectBufferWords);
    CDorArray<_VelSelect, _VelSelect&> hits;
    _VelSelect sentinel = {Handle(9), 0.75};
    hits.Add(sentinel);
    for (int count : {0, -1})  // no hit, overflow: the array is left alone
        VelDecodeHits(buffer.data(), VelSelectBufferWords, count, names, 3, hits);
    EXPECT_EQ(Listed(hits.GetData(), hits.GetSize()), (std::vector<std::pair<int, double>>{{9, 0.75}}));
    VelDecodeHits(buffer.data(), VelSelectBufferWords, 2, names, 3, hits);
    EXPECT_EQ(Listed(hits.GetData(), hits.GetSize()), (std::vector<std::pair<int, double>>{{2, 0.25}, {0, 0.5}}));
    // A claimed count beyond what 12 words hold reads 3 records; name 7 was never pushed.
    VelDecodeHits(buffer.data(), 12, 1000, names, 3, hits);
    EXPECT_EQ(Listed(hits.GetData(), hits.GetSize()), (std::vector<std::pair<int, double>>{{2, 0.25}, {0, 0.5}}));
}

TEST(SortHits, AscendingDepthButNotStable)
{
    const double depths[] = {0.9, 0.1, 0.5, 0.3, 0.7, 0.2, 0.8, 0.4, 0.6, 0.05, 0.95, 0.15, 0.0};
    std::vector<_VelSelect> hits, same;
    for (int i = 0; i < 13; ++i) {
        hits.push_back(_VelSelect{Handle(i), depths[i]});
        same.push_back(_VelSelect{Handle(i), 0.5});
    }
    VelSortHits(hits.data(), 13);
    for (size_t i = 1; i < hits.size(); ++i)
        EXPECT_LE(hits[i - 1].depth, hits[i].depth);
    EXPECT_TRUE(hits.front().position == Handle(12) && hits.back().position == Handle(10));
    VelSortHits(same.data(), 13);  // equal depths are never swapped with each other
    for (int i = 0; i < 13; ++i)
        EXPECT_EQ(same[i].position, Handle(i));

    // The first pass (gap 3 * 10 / 13 = 2) swaps the outer two; the equal pair then stays
    // reversed, which a stable sort would not give.
    std::vector<_VelSelect> three = {{Handle(0), 0.5}, {Handle(1), 0.5}, {Handle(2), 0.1}};
    VelSortHits(three.data(), 3);
    EXPECT_EQ(Listed(three.data(), 3), (std::vector<std::pair<int, double>>{{2, 0.1}, {1, 0.5}, {0, 0.5}}));
    VelSortHits(nullptr, 0);
}
