#include <gtest/gtest.h>

#include "convert/dor_shape.h"
#include "model/vel_primitive.h"

namespace {
bool SamePoint(const DorVector3& a, const DorVector3& b) { return a.x == b.x && a.y == b.y && a.z == b.z; }
}  // namespace

TEST(ShapeClasses, KindsAndDefaultsAHostCanRelyOn)
{
    CDorPolygon polygon;
    CDorHolePolygon holed;
    CDorExtruded extruded;
    CDorHoleExtruded holeExtruded;
    EXPECT_EQ(extruded.kind, 7);
    EXPECT_EQ(holeExtruded.kind, 8);
    EXPECT_NE(polygon.kind, 7);
    EXPECT_NE(polygon.kind, 8);
    EXPECT_NE(holed.kind, 7);
    EXPECT_NE(holed.kind, 8);
    EXPECT_NE(polygon.kind, holed.kind);
    EXPECT_EQ(polygon.style, DorStyleSolid);
    EXPECT_EQ(polygon.texture, 0u);
    EXPECT_EQ(polygon.textureScaleU, 1.0);
    EXPECT_EQ(polygon.points.GetSize(), 0);
    EXPECT_EQ(extruded.bottomCap, 1);
    EXPECT_EQ(extruded.topCap, 1);
    EXPECT_EQ(polygon.material.shininess, CVelTrianglePolys().material.shininess);
}

TEST(ShapeClasses, PrismFromOneProfileMovesPointsAndGivenTexturePoints)
{
    CDorPolygon base({DorVector3(0, 0, 0), DorVector3(2, 0, 0), DorVector3(0, 2, 0)});
    base.textureOrigin = DorVector3(1, 1, 0);
    CDorExtruded prism(base, DorVector3(0, 0, 5));
    ASSERT_EQ(prism.top.points.GetSize(), 3);
    EXPECT_TRUE(SamePoint(prism.top.points[1], DorVector3(2, 0, 5)));
    EXPECT_TRUE(SamePoint(prism.bottom.points[1], DorVector3(2, 0, 0)));
    EXPECT_TRUE(SamePoint(prism.top.textureOrigin, DorVector3(1, 1, 5)));
    EXPECT_TRUE(SamePoint(prism.top.textureAxis, DorVector3(0, 0, 0)));  // not given stays not given
}

TEST(ShapeClasses, CopiesAreDeep)
{
    CDorHolePolygon outline({DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(4, 4, 0), DorVector3(0, 4, 0)});
    outline.AddHole(CDorPolygon({DorVector3(1, 1, 0), DorVector3(2, 1, 0), DorVector3(2, 2, 0)}));
    CDorHoleExtruded solid(outline, DorVector3(0, 0, 1));
    CDorHoleExtruded copy(solid);
    copy.bottom.holes[0].points[0].x = 99;
    copy.bottom.points[0].x = 99;
    EXPECT_EQ(solid.bottom.holes[0].points[0].x, 1.0);
    EXPECT_EQ(solid.bottom.points[0].x, 0.0);
    ASSERT_EQ(solid.top.holes.GetSize(), 1);
    EXPECT_EQ(solid.top.holes[0].points[2].z, 1.0);
    CDorHoleExtruded assigned;
    assigned = solid;
    EXPECT_EQ(assigned.top.holes[0].points.GetSize(), 3);
}

TEST(ShapeClasses, MatchCapsToWallsCopiesTheWallsLook)
{
    CDorExtruded box(CDorPolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(0, 1, 0)}), DorVector3(0, 0, 1));
    box.material.shininess = 7;
    box.SetTexture(3, 2.0, 4.0);
    box.SetStyle(DorStyleWire);
    box.MatchCapsToWalls();
    for (const CDorPolygon* cap : {&box.bottom, &box.top}) {
        EXPECT_EQ(cap->material.shininess, 7.0f);
        EXPECT_EQ(cap->texture, 3u);
        EXPECT_EQ(cap->textureScaleV, 4.0);
        EXPECT_EQ(cap->style, DorStyleWire);
        EXPECT_EQ(cap->kind, DorKindPolygon);
    }
}

TEST(ShapeClasses, ShapeListsGeometriesInOrderWithoutOwningThem)
{
    CDorExtruded a, b;
    CDorShape shape;
    shape.Add(&a);
    shape.Add(&b);
    CDorShape copy(shape);
    ASSERT_EQ(copy.GetCount(), 2);
    _DorPosition* at = copy.geometries.GetHeadPosition();
    EXPECT_EQ(CDorList::GetAt(at), static_cast<CDorGeometry*>(&a));
    EXPECT_EQ(CDorList::GetAt(CDorList::GetNextPosition(at)), static_cast<CDorGeometry*>(&b));
    shape.RemoveAll();
    EXPECT_EQ(copy.GetCount(), 2);
}
