#pragma once
// A test-double modeller for the interface's own members: it stores a camera, a viewport and
// whole primitives, answers picks from a scripted hit list, and records what the interface asks
// of it. Portable: no context, no drawing.
#include <functional>
#include <map>
#include <vector>

#include "gl/vel_karvel.h"
#include "model/dor_math.h"
#include "camera_bits.h"  // found beside this header, as the DLL test needs

class RecordingKarvel : public CVelKarvel {
public:
    // What GetCamera / GetViewport hand out and Set* overwrite, unvalidated.
    _VelCamera camera = Camera(DorVector3(0, 0, 0), DorVector3(0, 10, 0));
    _VelViewport viewport = {0, 0, 400, 300};
    HDC current = nullptr;  // GetCurrent
    // HitTest returns `hits`; GetDepthToPoint3 answers the origin.
    std::vector<_VelSelect> hits;
    std::function<void()> onDraw;  // runs inside every DrawModel

    int getCameraCalls = 0, setCameraCalls = 0, setViewportCalls = 0, drawCalls = 0;
    std::vector<_VelCamera> camerasAtHitTest;
    // Whole primitives under fake handles; flags of the last Get/Change.
    std::map<_DorPosition*, CVelPrimitive> entities;
    long lastGetFlags = 0, lastChangeFlags = 0;

    _DorPosition* HandleOf(int slot) { return reinterpret_cast<_DorPosition*>(&slots[slot]); }

    int Initialize(HDC&, _VelViewport) override { return 1; }
    int Initialize(HDC&) override { return 1; }
    void Finalize() override {}
    HDC GetCurrent() override { return current; }
    void RemoveShapeAt(_DorPosition*& position) override { entities.erase(position), position = nullptr; }
    void RemoveShapeAll() override { entities.clear(); }
    CDorArray<long, long>* GetFreeProperty(_DorPosition*&) override { return nullptr; }
    void GetCamera(_VelCamera& out) override { ++getCameraCalls, out = camera; }
    void SetCamera(const _VelCamera& in) override { ++setCameraCalls, camera = in; }
    void GetViewport(_VelViewport& out) override { out = viewport; }
    void SetViewport(_VelViewport& in) override { ++setViewportCalls, viewport = in; }
    void DrawModel(HDC&) override
    {
        ++drawCalls;
        if (onDraw)
            onDraw();
    }
    void HitTest(HDC, int, int, CDorArray<_VelSelect, _VelSelect&>& out) override
    {
        camerasAtHitTest.push_back(camera);
        for (_VelSelect hit : hits)
            out.Add(hit);
    }
    void GetDepthToPoint3(HDC, int, int, double&, DorVector3& point) override { point = DorVector3(); }
    _DorPosition* AddPrimitive(CVelPrimitive& primitive) override
    {
        _DorPosition* handle = HandleOf(static_cast<int>(entities.size()));
        entities[handle] = primitive;
        return handle;
    }
    // Reads back the whole primitive; a change of flag 16 (DrawMode) alone leaves the groups.
    void GetPrimitive(_DorPosition* position, CVelPrimitive& out, long flags) override
    {
        lastGetFlags = flags;
        if (entities.count(position))
            out = entities[position];
    }
    void ChangePrimitive(_DorPosition* position, CVelPrimitive& in, long flags) override
    {
        lastChangeFlags = flags;
        if (!entities.count(position))
            return;
        if (flags & 16)
            entities[position].DrawMode = in.DrawMode;
        if (flags & ~16L)
            entities[position].groups = in.groups;
    }

private:
    char slots[64] = {};
};
