#include <gtest/gtest.h>

#include <deque>
#include <random>
#include <vector>

#include "model/dor_list.h"

namespace {
std::vector<int> Contents(const CDorList& list)
{
    std::vector<int> out;
    for (_DorPosition* p = list.GetHeadPosition(); p; p = CDorList::GetNextPosition(p))
        out.push_back(*static_cast<int*>(CDorList::GetAt(p)));
    return out;
}
}  // namespace

// Handles are node addresses: a block hands its nodes out in order, other handles survive a
// removal, the last freed node is reused first and the last removal frees every block.
TEST(DorList, HandlesStayValidFreedNodesAreReusedFirstAndTheLastRemovalFreesTheBlocks)
{
    int v[25];
    CDorList list;
    _DorPosition* handle[25];
    for (int i = 0; i < 25; ++i) {  // spans three blocks of 10
        v[i] = i;
        handle[i] = list.AddTail(&v[i]);
    }
    EXPECT_EQ(reinterpret_cast<char*>(handle[1]) - reinterpret_cast<char*>(handle[0]), static_cast<long>(sizeof(CDorList::Node)));
    for (int i = 0; i < 25; i += 2)
        list.RemoveAt(handle[i]);
    list.RemoveAt(nullptr);
    EXPECT_EQ(list.GetCount(), 12);
    for (int i = 1; i < 25; i += 2)
        EXPECT_EQ(CDorList::GetAt(handle[i]), &v[i]);
    EXPECT_EQ(list.AddTail(&v[0]), handle[24]);
    for (int i = 0; i < 23; i += 2)
        list.RemoveAt(i ? handle[i - 1] : handle[24]);
    EXPECT_NE(list.blocks, nullptr);
    list.RemoveAt(handle[23]);
    EXPECT_TRUE(list.blocks == nullptr && list.freeList == nullptr && list.head == nullptr && list.tail == nullptr);
    list.AddTail(&v[3]);
    EXPECT_EQ(Contents(list), std::vector<int>{3});
}

// Random adds at either end, removals and moves keep the order a standard deque keeps, across
// blocks of every size and a reset now and then.
TEST(DorList, OrderUnderAddsRemovalsAndMovesFollowsADeque)
{
    std::mt19937 rng(3);
    int v[8] = {0, 1, 2, 3, 4, 5, 6, 7};
    for (int blockSize = -1; blockSize <= 4; ++blockSize) {
        CDorList list(blockSize);
        std::deque<_DorPosition*> order;
        for (int step = 0; step < 400; ++step) {
            const int op = rng() % 6, value = rng() % 8;
            auto at = order.empty() ? order.end() : order.begin() + rng() % order.size();
            _DorPosition* p = at == order.end() ? nullptr : *at;
            if (op == 0 || order.empty())
                order.push_back(list.AddTail(&v[value]));
            else if (op == 1)
                order.push_front(list.AddHead(&v[value]));
            else if (op == 5 && step % 50 == 0)
                list.RemoveAll(), order.clear();
            else {
                order.erase(at);
                if (op == 2)
                    list.RemoveAt(p);
                else if (op == 3)
                    list.MoveToHead(p), order.push_front(p);  // the handle written back
                else
                    list.MoveToTail(p), order.push_back(p);
            }
            ASSERT_EQ(list.GetCount(), static_cast<int>(order.size()));
            _DorPosition* q = list.GetHeadPosition();
            for (_DorPosition* expected : order) {
                ASSERT_EQ(q, expected) << "block size " << blockSize << ", step " << step;
                q = CDorList::GetNextPosition(q);
            }
            ASSERT_TRUE(q == nullptr && list.GetTailPosition() == (order.empty() ? nullptr : order.back()));
        }
    }
}

// The quirks: a copy keeps order, assignment takes the block size (at least 1), and moving the only
// node frees every block, so the handle written back is a new one.
TEST(DorList, CopiesKeepOrderAndMovingWritesTheHandleBack)
{
    int v[3] = {0, 1, 2};
    CDorList list;
    _DorPosition* h[3];
    for (int i = 0; i < 3; ++i)
        h[i] = list.AddTail(&v[i]);
    list.MoveToHead(h[2]);
    CDorList copy(list);
    EXPECT_EQ(Contents(copy), (std::vector<int>{2, 0, 1}));
    copy = CDorList(3);
    EXPECT_TRUE(copy.GetCount() == 0 && copy.blockSize == 3 && CDorList(0).blockSize == 1);
    CDorList single;
    _DorPosition* only = single.AddTail(&v[1]);
    single.MoveToHead(only);
    EXPECT_TRUE(single.GetHeadPosition() == only && CDorList::GetAt(only) == &v[1]);
}
