#include "geometry_checks.h"
#include "model/vel_primitive.h"

TEST(ShapeClasses, KindsAndDefaultsAHostCanRelyOn)
{
    CDorPolygon polygon;
    CDorHolePolygon holed;
    CDorExtruded extruded;
    EXPECT_EQ(extruded.kind, 7);
    EXPECT_EQ(CDorHoleExtruded().kind, 8);
    EXPECT_EQ(std::set<int>({polygon.kind, holed.kind, 7, 8}).size(), 4u);
    EXPECT_EQ(polygon.style, DorStyleSolid);
    EXPECT_EQ(polygon.texture, 0u);
    EXPECT_EQ(polygon.textureScaleU, 1.0);
    EXPECT_EQ(polygon.points.GetSize(), 0);
    EXPECT_EQ(extruded.bottomCap, 1);
    EXPECT_EQ(extruded.topCap, 1);
    EXPECT_EQ(polygon.material.shininess, CVelTrianglePolys().material.shininess);
}

// Points and given texture points move up; a texture point not given stays not given.
TEST(ShapeClasses, PrismFromOneProfile)
{
    CDorPolygon base({DorVector3(0, 0, 0), DorVector3(2, 0, 0), DorVector3(0, 2, 0)});
    base.textureOrigin = DorVector3(1, 1, 0);
    CDorExtruded prism(base, DorVector3(0, 0, 5));
    ASSERT_EQ(prism.top.points.GetSize(), 3);
    EXPECT_TRUE(SamePoint(prism.top.points[1], DorVector3(2, 0, 5)));
    EXPECT_TRUE(SamePoint(prism.bottom.points[1], DorVector3(2, 0, 0)));
    EXPECT_TRUE(SamePoint(prism.top.textureOrigin, DorVector3(1, 1, 5)));
    EXPECT_TRUE(SamePoint(prism.top.textureAxis, DorVector3(0, 0, 0)));
}

TEST(ShapeClasses, CopiesAreDeepAndShapesDoNotOwnTheirGeometries)
{
    CDorHoleExtruded solid(HolePolygon(Square(0, 0, 4), {{DorVector3(1, 1, 0), DorVector3(2, 1, 0), DorVector3(2, 2, 0)}}), DorVector3(0, 0, 1));
    CDorHoleExtruded copy(solid), assigned;
    copy.bottom.holes[0].points[0].x = copy.bottom.points[0].x = 99;
    EXPECT_EQ(solid.bottom.holes[0].points[0].x, 1.0);
    EXPECT_EQ(solid.bottom.points[0].x, 0.0);
    ASSERT_EQ(solid.top.holes.GetSize(), 1);
    EXPECT_EQ(solid.top.holes[0].points[2].z, 1.0);
    assigned = solid;
    EXPECT_EQ(assigned.top.holes[0].points.GetSize(), 3);

    CDorExtruded a, b;
    CDorShape shape;
    shape.Add(&a);
    shape.Add(&b);
    CDorShape listed(shape);
    shape.RemoveAll();
    ASSERT_EQ(listed.GetCount(), 2);
    _DorPosition* at = listed.geometries.GetHeadPosition();
    EXPECT_EQ(CDorList::GetAt(at), static_cast<CDorGeometry*>(&a));
    EXPECT_EQ(CDorList::GetAt(CDorList::GetNextPosition(at)), static_cast<CDorGeometry*>(&b));
}

TEST(ShapeClasses, MatchCapsToWallsCopiesTheWallsLook)
{
    CDorExtruded box(Polygon(LShape()), DorVector3(0, 0, 1));
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
