// Shapes of every geometry kind, solid, wire and other styles, plain and holed, null entries,
// through the dispatcher, where bare polygons give no groups; the bare ones also through the
// polygon converters. Every index lies inside its group's vertices, and moderate finite input
// gives finite positions, normals and texture coordinates.
#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_polygon_to_primitive.h"
#include "convert/vel_shape_to_primitive.h"
#include "fuzz_reader.h"

namespace {
CDorPolygon Loop(FuzzReader& r, int count)
{
    CDorPolygon p;
    while (count-- > 0)
        p.AddPoint(r.Point());
    p.style = r.Int(0, 1);  // a profile's style is its cap's
    p.textureAxis = r.Point();
    p.textureOrigin = r.Point();
    return p;
}

CDorHolePolygon Holed(FuzzReader& r, int count)
{
    const CDorPolygon outline = Loop(r, count);
    CDorHolePolygon p(outline);
    for (int h = r.Int(0, 3); h > 0; --h)
        p.AddHole(r.Int(0, 1) ? Loop(r, r.Int(0, 7)) : outline.Translated(r.Point()));
    p.holeTextureAxis = r.Point();
    p.holeTextureOrigin = r.Point();
    return p;
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    FuzzReader r(data, size);
    CDorExtruded extruded[3];
    CDorHoleExtruded holeExtruded[3];
    CDorPolygon polygons[3];
    CDorHolePolygon holed[3];
    CDorShape shape;
    bool onlyBare = true;
    for (int k = r.Int(0, 2); k >= 0; --k) {
        const int count = r.Int(0, 9);
        CDorGeometry* g = nullptr;
        extruded[k].bottomCap = holeExtruded[k].bottomCap = r.Int(0, 1);
        extruded[k].topCap = holeExtruded[k].topCap = r.Int(0, 1);
        extruded[k].textureAxis = holeExtruded[k].textureAxis = r.Point();
        switch (r.Int(0, 4)) {
        case 0:
            extruded[k].bottom = Loop(r, count);
            extruded[k].top = r.Int(0, 1) ? extruded[k].bottom.Translated(r.Point()) : Loop(r, count + r.Int(-1, 1));
            g = &extruded[k];
            break;
        case 1:
            holeExtruded[k].bottom = Holed(r, count);
            holeExtruded[k].top = holeExtruded[k].bottom.Translated(r.Point());
            if (r.Int(0, 3) == 0 && holeExtruded[k].top.holes.GetSize() > 0)  // a top hole unlike its bottom one
                holeExtruded[k].top.holes[0].AddPoint(r.Point());
            g = &holeExtruded[k];
            break;
        case 2: g = &(polygons[k] = Loop(r, count)); break;
        case 3: g = &(holed[k] = Holed(r, count)); break;
        }
        if (g) {
            g->style = r.Int(0, 2);
            g->texture = r.Int(0, 1);
            g->textureScaleU = r.Int(0, 1) ? r.Number() : 0.5;
            g->textureScaleV = r.Int(0, 1) ? r.Number() : 2.0;
            // A scale of 0 gives infinite coordinates by definition; a tiny one overflows them.
            r.wild = r.wild || !(std::fabs(g->textureScaleU) >= 1e-6 && std::fabs(g->textureScaleV) >= 1e-6);
            onlyBare = onlyBare && (g->kind == DorKindPolygon || g->kind == DorKindHolePolygon);
        }
        shape.Add(g);
    }
    CVelPrimitive primitive;
    CVelGroupArray& groups = primitive.groups;
    CVelShapeToPrimitive().ConvertShape(shape, primitive);
    FUZZ_CHECK(!onlyBare || groups.GetSize() == 0);
    for (int k = 0; k < 3; ++k) {
        CVelPolygonToPrimitive().ConvertPolygon(&polygons[k], groups, r.Int(0, 2));
        CVelHolePolygonToPrimitive().ConvertHolePolygon(&holed[k], groups, r.Int(0, 2));
    }

    for (int g = 0; g < groups.GetSize(); ++g) {
        const int n = groups[g].vertices.GetSize();
        for (int t = 0; t < groups[g].triangles.GetSize(); ++t) {
            const _VelTriangleIndex& i = groups[g].triangles[t];
            FUZZ_CHECK(i.a >= 0 && i.a < n && i.b >= 0 && i.b < n && i.c >= 0 && i.c < n);
        }
        for (int v = 0; v < n && !r.wild; ++v) {
            const _VelVertex& x = groups[g].vertices[v];
            FUZZ_CHECK(Finite(x.position) && Finite(x.normal) && std::isfinite(x.texcoord.x) && std::isfinite(x.texcoord.y));
        }
    }
    return 0;
}
