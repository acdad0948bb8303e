// The line and grid generators, and the containers behind every record (CDorArray, CDorList)
// against standard ones. A grid appends 4 (divisions + 1) vertices at z = 0, finite for moderate
// corners, or refuses with -1 and leaves the primitive alone; an array index no int can reach
// fails as an allocation does.
#include <algorithm>
#include <climits>
#include <deque>
#include <new>
#include <vector>

#include "fuzz_reader.h"
#include "model/dor_list.h"
#include "primitives/vel_math_primitive.h"

namespace {
void Generators(FuzzReader& r)
{
    CVelPrimitive primitive;
    for (int k = r.Int(0, 3); k > 0; --k) {
        const int before = primitive.groups.GetSize();
        if (r.Int(0, 1)) {
            FUZZ_CHECK(CVelMathPrimitive::MakeLine(r.Point(), r.Point(), primitive) == before);
            continue;
        }
        DorVector2 c0(r.Number(), r.Number()), c1(r.Number(), r.Number());
        // Counts the memory cannot hold are only asked for where they must be refused.
        const int n = r.Int(0, 3) ? r.Int(-3, 300) : r.Int(INT_MAX / 4, INT_MAX);
        const int index = CVelMathPrimitive::MakeGrid(c0, c1, n, primitive);
        if (n == 0 || n < -1 || n >= INT_MAX / 4) {
            FUZZ_CHECK(index == -1 && primitive.groups.GetSize() == before);
            continue;
        }
        FUZZ_CHECK(index == before && primitive.groups.GetSize() == before + 1);
        const CVelTrianglePolys& grid = primitive.groups[index];
        FUZZ_CHECK(grid.GroupType == VelGroupLines && grid.vertices.GetSize() == 4 * (n + 1));
        for (int v = 0; v < grid.vertices.GetSize(); ++v)
            FUZZ_CHECK(grid.vertices[v].position.z == 0.0 && (r.wild || Finite(grid.vertices[v].position)));
    }
}

void Array(FuzzReader& r)
{
    CDorArray<int> array;  // elements taken by reference: the source may move as it grows
    std::vector<int> model;
    for (int k = r.Int(0, 24); k > 0; --k) {
        const int value = r.Int(INT_MIN, INT_MAX);
        switch (r.Int(0, 3)) {
        case 0: {
            const int n = r.Int(-2, 64);
            array.SetSize(n, r.Int(-1, 8));
            model.resize(n < 0 ? 0 : n);
            break;
        }
        case 1: FUZZ_CHECK(array.Add(value) == static_cast<int>(model.size())); model.push_back(value); break;
        case 2: {
            const int index = r.Int(0, 3) ? r.Int(0, 64) : INT_MAX;
            const bool own = !model.empty() && r.Int(0, 1);  // the last element, which growth moves
            const int stored = own ? model.back() : value;
            try {
                array.SetAtGrow(index, own ? array[array.GetSize() - 1] : value);
            } catch (const std::bad_alloc&) {
                FUZZ_CHECK(index == INT_MAX);  // refused before anything changed
                break;
            }
            model.resize(std::max<size_t>(model.size(), index + 1u), 0);
            model[index] = stored;
            break;
        }
        default: { CDorArray<int> copy(array); array = copy; }
        }
        FUZZ_CHECK(array.GetSize() == static_cast<int>(model.size()) && array.maxSize >= array.size);
        for (size_t i = 0; i < model.size(); ++i)
            FUZZ_CHECK(array[static_cast<int>(i)] == model[i]);
    }
}

void List(FuzzReader& r)
{
    int elements[8];
    CDorList list(r.Int(-1, 4));
    std::deque<std::pair<_DorPosition*, void*>> model;
    for (int k = r.Int(0, 32); k > 0; --k) {
        void* element = &elements[r.Int(0, 7)];
        const size_t at = model.empty() ? 0 : r.Int(0, static_cast<int>(model.size()) - 1);
        switch (r.Int(0, 5)) {
        case 0: model.emplace_back(list.AddTail(element), element); break;
        case 1: model.emplace_front(list.AddHead(element), element); break;
        case 2: if (!model.empty()) list.RemoveAt(model[at].first), model.erase(model.begin() + at); break;
        case 3:
        case 4:
            if (!model.empty()) {
                auto entry = model[at];
                model.erase(model.begin() + at);
                if (r.Int(0, 1)) list.MoveToHead(entry.first), model.push_front(entry);
                else list.MoveToTail(entry.first), model.push_back(entry);
            }
            break;
        default: if (r.Int(0, 3) == 0) list.RemoveAll(), model.clear();
        }
        FUZZ_CHECK(list.GetCount() == static_cast<int>(model.size()));
        _DorPosition* p = list.GetHeadPosition();
        for (const auto& entry : model) {
            FUZZ_CHECK(p == entry.first && CDorList::GetAt(p) == entry.second);
            p = CDorList::GetNextPosition(p);
        }
        FUZZ_CHECK(p == nullptr && list.GetTailPosition() == (model.empty() ? nullptr : model.back().first));
    }
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    FuzzReader r(data, size);
    switch (r.Int(0, 2)) {
    case 0: Generators(r); break;
    case 1: Array(r); break;
    default: List(r);
    }
    return 0;
}
