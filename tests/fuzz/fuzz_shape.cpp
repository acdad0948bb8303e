// Shapes of every geometry kind, solid, wire and other styles, plain and holed, through the
// dispatcher; bare polygons also through the polygon converters. Every index lies inside its
// group's vertices, and moderate finite input gives finite positions, normals and texture
// coordinates.
#include <memory>
#include <vector>

#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_polygon_to_primitive.h"
#include "convert/vel_shape_to_primitive.h"
#include "fuzz_reader.h"

namespace {
template <class Loop>
void FillLoop(FuzzReader& r, Loop& loop, int count)
{
    for (int i = 0; i < count; ++i) {
        DorVector3 p = r.Point();
        loop.points.Add(p);
    }
}

void Dress(FuzzReader& r, CDorGeometry& g)
{
    g.style = r.in.PickValueInArray({0, 0, 1, 1, 2});
    g.texture = r.Int(0, 1);
    g.textureScaleU = r.Int(0, 1) ? r.Number() : 0.5;
    g.textureScaleV = r.Int(0, 1) ? r.Number() : 2.0;
    // A scale of 0 gives infinite coordinates by definition; a tiny one overflows them.
    r.wild = r.wild || !(std::fabs(g.textureScaleU) >= 1e-6 && std::fabs(g.textureScaleV) >= 1e-6);
}

void CheckGroups(const FuzzReader& r, const CVelGroupArray& groups)
{
    for (int g = 0; g < groups.GetSize(); ++g) {
        const CVelTrianglePolys& group = groups[g];
        const int n = group.vertices.GetSize();
        for (int t = 0; t < group.triangles.GetSize(); ++t) {
            const _VelTriangleIndex& i = group.triangles[t];
            FUZZ_CHECK(i.a >= 0 && i.a < n && i.b >= 0 && i.b < n && i.c >= 0 && i.c < n);
        }
        for (int v = 0; v < n && !r.wild; ++v) {
            const _VelVertex& x = group.vertices[v];
            FUZZ_CHECK(Finite(x.position) && Finite(x.normal) && std::isfinite(x.texcoord.x) && std::isfinite(x.texcoord.y));
        }
    }
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    FuzzReader r(data, size);
    CDorShape shape;
    std::vector<std::unique_ptr<CDorGeometry>> owned;
    bool onlyBare = true;
    for (int k = r.Int(1, 3); k > 0; --k) {
        const int kind = r.Int(0, 4), count = r.Int(0, 9);
        if (kind == 0) {
            auto e = std::make_unique<CDorExtruded>();
            FillLoop(r, e->bottom, count);
            if (r.Int(0, 1))
                e->top = e->bottom.Translated(r.Point());
            else
                FillLoop(r, e->top, count + r.Int(-1, 1));
            e->bottom.style = r.Int(0, 1);
            owned.push_back(std::move(e));
        } else if (kind == 1) {
            auto e = std::make_unique<CDorHoleExtruded>();
            FillLoop(r, e->bottom, count);
            for (int h = r.Int(0, 3); h > 0; --h) {
                CDorPolygon hole;
                FillLoop(r, hole, r.Int(0, 7));
                e->bottom.AddHole(hole);
            }
            e->top = e->bottom.Translated(r.Point());
            if (r.Int(0, 3) == 0 && e->top.holes.GetSize() > 0)
                e->top.holes[0].AddPoint(r.Point());
            owned.push_back(std::move(e));
        } else if (kind == 2 || kind == 3) {
            auto p = std::make_unique<CDorPolygon>();
            FillLoop(r, *p, count);
            p->textureAxis = r.Point();
            p->textureOrigin = r.Point();
            owned.push_back(std::move(p));
        } else {
            owned.push_back(nullptr);
        }
        if (CDorGeometry* g = owned.back().get()) {
            Dress(r, *g);
            onlyBare = onlyBare && g->kind != DorKindExtruded && g->kind != DorKindHoleExtruded;
            if (auto* e = dynamic_cast<CDorExtruded*>(g)) {
                e->bottomCap = r.Int(0, 1);
                e->topCap = r.Int(0, 1);
                e->textureAxis = r.Point();
            } else if (auto* e = dynamic_cast<CDorHoleExtruded*>(g)) {
                e->bottomCap = r.Int(0, 1);
                e->topCap = r.Int(0, 1);
                e->bottom.holeTextureAxis = e->top.holeTextureAxis = r.Point();
            }
        }
        shape.Add(owned.back().get());
    }

    CVelPrimitive primitive;
    CVelShapeToPrimitive().ConvertShape(shape, primitive);
    CheckGroups(r, primitive.groups);
    FUZZ_CHECK(!onlyBare || primitive.groups.GetSize() == 0);

    for (auto& g : owned) {
        CVelGroupArray groups;
        if (auto* p = dynamic_cast<CDorPolygon*>(g.get())) {
            CVelPolygonToPrimitive().ConvertPolygon(p, groups, r.Int(0, 2));
            CDorHolePolygon holed(*p);
            holed.AddHole(p->Translated(DorVector3(0.25, 0.25, 0)));
            CVelHolePolygonToPrimitive().ConvertHolePolygon(&holed, groups, r.Int(0, 2));
        }
        CheckGroups(r, groups);
    }
    return 0;
}
