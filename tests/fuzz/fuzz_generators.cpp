// The line and grid generators, and the entity list (CDorList) against a standard one, in one run
// of mixed steps. A grid appends 4 (divisions + 1) vertices at z = 0, finite for moderate corners,
// or refuses with -1 and leaves the primitive alone. (The array's growth has its own tests.)
#include <climits>
#include <deque>

#include "fuzz_reader.h"
#include "model/dor_list.h"
#include "primitives/vel_math_primitive.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    FuzzReader r(data, size);
    CVelPrimitive primitive;
    int elements[8];
    CDorList list(r.Int(-1, 4));
    std::deque<std::pair<_DorPosition*, void*>> order;
    for (int k = r.Int(0, 32); k > 0; --k) {
        const int before = primitive.groups.GetSize();
        void* element = &elements[r.Int(0, 7)];
        const size_t at = order.empty() ? 0 : r.Int(0, static_cast<int>(order.size()) - 1);
        switch (r.Int(0, 6)) {
        case 0: FUZZ_CHECK(CVelMathPrimitive::MakeLine(r.Point(), r.Point(), primitive) == before); break;
        case 1: {
            DorVector2 c0(r.Number(), r.Number()), c1(r.Number(), r.Number());
            // Counts the memory cannot hold are only asked for where they must be refused.
            const int n = r.Int(0, 3) ? r.Int(-3, 300) : r.Int(INT_MAX / 4, INT_MAX);
            const bool refused = n == 0 || n < -1 || n >= INT_MAX / 4;
            const int index = CVelMathPrimitive::MakeGrid(c0, c1, n, primitive);
            FUZZ_CHECK(index == (refused ? -1 : before) && primitive.groups.GetSize() == before + !refused);
            for (int v = 0; !refused && v < 4 * (n + 1); ++v) {
                const CVelTrianglePolys& grid = primitive.groups[index];
                FUZZ_CHECK(grid.GroupType == VelGroupLines && grid.vertices.GetSize() == 4 * (n + 1));
                FUZZ_CHECK(grid.vertices[v].position.z == 0.0 && (r.wild || Finite(grid.vertices[v].position)));
            }
            break;
        }
        case 2: order.emplace_back(list.AddTail(element), element); break;
        case 3: order.emplace_front(list.AddHead(element), element); break;
        case 4: if (!order.empty()) list.RemoveAt(order[at].first), order.erase(order.begin() + at); break;
        case 5:
            if (!order.empty()) {
                auto entry = order[at];
                order.erase(order.begin() + at);
                if (r.Int(0, 1)) list.MoveToHead(entry.first), order.push_front(entry);
                else list.MoveToTail(entry.first), order.push_back(entry);
            }
            break;
        default: if (r.Int(0, 3) == 0) list.RemoveAll(), order.clear();
        }
        FUZZ_CHECK(list.GetCount() == static_cast<int>(order.size()));
        _DorPosition* p = list.GetHeadPosition();
        for (const auto& entry : order) {
            FUZZ_CHECK(p == entry.first && CDorList::GetAt(p) == entry.second);
            p = CDorList::GetNextPosition(p);
        }
        FUZZ_CHECK(p == nullptr && list.GetTailPosition() == (order.empty() ? nullptr : order.back().first));
    }
    return 0;
}
