// Selection records to hits: decoding, depth scaling, the comb sort's order.
#include <gtest/gtest.h>

#include <vector>

#include "gl/vel_pick.h"

namespace {
typedef std::vector<std::pair<size_t, double>> Hits;  // (handle, depth)

_DorPosition* Handle(size_t i) { return reinterpret_cast<_DorPosition*>(i); }

Hits Listed(const _VelSelect* hits, int count)
{
    Hits out;
    for (int i = 0; i < count; ++i)
        out.push_back({reinterpret_cast<size_t>(hits[i].position), hits[i].depth});
    return out;
}
}  // namespace

// Depths span 0..1 in single precision: two a few units apart in the last bits come out equal, as
// hosts have always seen. Records of (count 1, minimum depth, maximum depth, name) become hits of
// the handle their name indexes, never reading past the buffer or the names pushed. (No hit and
// overflow are checked on the live modeller.)
TEST(DecodeHits, NamesBecomeHandlesWithinTheBufferAndTheNames)
{
    EXPECT_TRUE(VelSelectDepth(0) == 0.0 && VelSelectDepth(0x80000000u) == 0.5 && VelSelectDepth(0xFFFFFFFFu) == 1.0 &&
                VelSelectDepth(0xF0000001u) == VelSelectDepth(0xF0000003u));
    _DorPosition* names[] = {Handle(16), Handle(32), Handle(48)};
    std::vector<unsigned int> buffer = {1, 0x40000000u, 0, 2, 1, 0x80000000u, 0, 0, 1, 0, 0, 7, 1, 0, 0, 1};
    buffer.resize(VelSelectBufferWords);
    CDorArray<_VelSelect, _VelSelect&> hits;
    for (int words : {VelSelectBufferWords, 12}) {  // 12 words hold 3 records; name 7 was never pushed
        VelDecodeHits(buffer.data(), words, words == 12 ? 1000 : 2, names, 3, hits);
        EXPECT_EQ(Listed(hits.GetData(), hits.GetSize()), (Hits{{48, 0.25}, {16, 0.5}})) << words;
    }
}

// Ascending depth, but not stable: the first pass over three (gap 3 * 10 / 13 = 2) swaps the outer
// two and leaves an equal pair reversed.
TEST(SortHits, AscendingDepthButNotStable)
{
    const double depths[] = {0.9, 0.1, 0.5, 0.3, 0.7, 0.2, 0.8, 0.4, 0.6, 0.05, 0.95, 0.15, 0.0};
    std::vector<_VelSelect> hits, three = {{Handle(0), 0.5}, {Handle(1), 0.5}, {Handle(2), 0.1}};
    for (size_t i = 0; i < 13; ++i)
        hits.push_back(_VelSelect{Handle(i), depths[i]});
    VelSortHits(hits.data(), 13);
    VelSortHits(three.data(), 3);
    for (size_t i = 1; i < 13; ++i)
        EXPECT_LT(hits[i - 1].depth, hits[i].depth) << i;
    EXPECT_EQ(Listed(three.data(), 3), (Hits{{2, 0.1}, {1, 0.5}, {0, 0.5}}));
}
