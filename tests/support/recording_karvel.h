#pragma once
// A test-double modeller for the interface's own members: it stores a camera, a viewport and
// whole primitives, answers picks from a scripted hit list, and counts what the interface asks
// of it. Portable: no context, no drawing.
#include <functional>
#include <map>
#include <vector>

#include "gl/vel_karvel.h"
#include "model/dor_math.h"

class RecordingKarvel : public CVelKarvel {
public:
    RecordingKarvel()
    {
        camera.eye = DorVector3(0, 0, 0);
        camera.target = DorVector3(0, 10, 0);
        camera.fovy = 45.0;
        camera.zNear = 1.0;
        camera.zFar = 1000.0;
        camera.aspect = 4.0 / 3.0;
    }

    // What GetCamera / GetViewport hand out and Set* overwrite (no validation: the double shows
    // exactly what the interface wrote).
    _VelCamera camera;
    _VelViewport viewport = {0, 0, 400, 300};
    HDC current = nullptr;  // GetCurrent

    // Picking: HitTest returns `hits` as they stand; GetDepthToPoint3 answers
    // depthOrigin + depthStep * depth.
    std::vector<_VelSelect> hits;
    DorVector3 depthOrigin, depthStep;

    int getCameraCalls = 0, setCameraCalls = 0, setViewportCalls = 0, drawCalls = 0;
    int hitTestCalls = 0, depthCalls = 0;
    std::vector<_VelCamera> camerasAtHitTest;
    std::vector<double> depthsAsked;
    std::function<void()> onDraw;  // runs inside every DrawModel

    // The entity store: whole primitives under fake handles; flags of the last Get/Change.
    std::map<_DorPosition*, CVelPrimitive> entities;
    long lastGetFlags = 0, lastChangeFlags = 0;

    _DorPosition* HandleOf(int slot) { return reinterpret_cast<_DorPosition*>(&slots[slot]); }

    int Initialize(HDC&, _VelViewport) override { return 1; }
    int Initialize(HDC&) override { return 1; }
    void Finalize() override {}
    HDC GetCurrent() override { return current; }
    void RemoveShapeAt(_DorPosition*& position) override
    {
        entities.erase(position);
        position = nullptr;
    }
    void RemoveShapeAll() override { entities.clear(); }
    CDorArray<long, long>* GetFreeProperty(_DorPosition*&) override { return nullptr; }

    void GetCamera(_VelCamera& out) override
    {
        ++getCameraCalls;
        out = camera;
    }
    void SetCamera(const _VelCamera& in) override
    {
        ++setCameraCalls;
        camera = in;
    }
    void GetViewport(_VelViewport& out) override { out = viewport; }
    void SetViewport(_VelViewport& in) override
    {
        ++setViewportCalls;
        viewport = in;
    }
    void DrawModel(HDC&) override
    {
        ++drawCalls;
        if (onDraw)
            onDraw();
    }

    void HitTest(HDC, int, int, CDorArray<_VelSelect, _VelSelect&>& out) override
    {
        ++hitTestCalls;
        camerasAtHitTest.push_back(camera);
        if (hits.empty())
            return;
        out.SetSize(static_cast<int>(hits.size()));
        for (size_t i = 0; i < hits.size(); ++i)
            out[static_cast<int>(i)] = hits[i];
    }
    void GetDepthToPoint3(HDC, int, int, double& depth, DorVector3& point) override
    {
        ++depthCalls;
        depthsAsked.push_back(depth);
        point = depthOrigin + depthStep * depth;
    }

    _DorPosition* AddPrimitive(CVelPrimitive& primitive) override
    {
        _DorPosition* handle = HandleOf(static_cast<int>(entities.size()));
        entities[handle] = primitive;
        return handle;
    }
    // Flag bits as the OpenGL modeller reads them: 1 vertices, 2 materials, 16 DrawMode.
    void GetPrimitive(_DorPosition* position, CVelPrimitive& out, long flags) override
    {
        lastGetFlags = flags;
        auto found = entities.find(position);
        if (found == entities.end())
            return;
        const CVelPrimitive& stored = found->second;
        out.DeleteAll();
        out.groups.SetSize(stored.groups.GetSize());
        for (int g = 0; g < stored.groups.GetSize(); ++g) {
            if (flags & 1)
                out.groups[g].vertices = stored.groups[g].vertices;
            if (flags & 2)
                out.groups[g].material = stored.groups[g].material;
        }
        if (flags & 16)
            out.DrawMode = stored.DrawMode;
    }
    void ChangePrimitive(_DorPosition* position, CVelPrimitive& in, long flags) override
    {
        lastChangeFlags = flags;
        auto found = entities.find(position);
        if (found == entities.end())
            return;
        CVelPrimitive& stored = found->second;
        for (int g = 0; g < stored.groups.GetSize() && g < in.groups.GetSize(); ++g) {
            if (flags & 1)
                stored.groups[g].vertices = in.groups[g].vertices;
            if (flags & 2)
                stored.groups[g].material = in.groups[g].material;
        }
        if (flags & 16)
            stored.DrawMode = in.DrawMode;
    }

private:
    char slots[64] = {};
};
