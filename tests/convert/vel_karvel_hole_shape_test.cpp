#include <gtest/gtest.h>

#include "hole_test_support.h"
#include "tests/support/recording_karvel.h"

using namespace hole_test;

namespace {
// A 4 x 3 wall, 0.2 thick along y, with a 1 x 1 window and a 1 x 2 door cut through it; beside
// it, a box without holes.
class WallWithOpenings : public ::testing::Test {
protected:
    void SetUp() override
    {
        Loop outline = {DorVector3(0, 0, 0), DorVector3(0, 0, 3), DorVector3(4, 0, 3), DorVector3(4, 0, 0)};
        Loop window = {DorVector3(1, 0, 1), DorVector3(1, 0, 2), DorVector3(2, 0, 2), DorVector3(2, 0, 1)};
        Loop door = {DorVector3(2.5, 0, 0.5), DorVector3(2.5, 0, 2.5), DorVector3(3.5, 0, 2.5), DorVector3(3.5, 0, 0.5)};
        wall = CDorHoleExtruded(HolePolygon(outline, {window, door}), DorVector3(0, 0.2, 0));
        box = CDorExtruded(convert_test::Polygon(Square(5, 0, 1)), DorVector3(0, 0, 1));
        shape.Add(&wall);
        shape.Add(&box);
    }
    CDorHoleExtruded wall;
    CDorExtruded box;
    CDorShape shape;
    RecordingKarvel modeller;
};
}  // namespace

TEST_F(WallWithOpenings, AddShapeStoresTheHoledWallThenTheBox)
{
    _DorPosition* entity = modeller.AddShape(shape);
    ASSERT_EQ(modeller.entities.count(entity), 1u);
    const CVelPrimitive& stored = modeller.entities[entity];
    // Outline walls, the door's walls (the last hole's), both caps; then the box.
    ASSERT_EQ(stored.groups.GetSize(), 4 + 4 + 2 + 6);
    EXPECT_EQ(stored.groups[4].vertices[0].position.x, 2.5);
    const CVelTrianglePolys& front = stored.groups[8];
    EXPECT_EQ(front.GroupType, VelGroupIndexed);
    EXPECT_EQ(front.vertices.GetSize(), 12);
    EXPECT_EQ(front.triangles.GetSize(), 12 + 2 * 2 - 2);  // every region triangulated
    EXPECT_EQ(stored.groups[9].vertices[0].position.y, 0.2);
}

TEST_F(WallWithOpenings, WireWallKeepsEveryHole)
{
    wall.style = DorStyleWire;
    CVelPrimitive primitive;
    modeller.ShapeToPrimitive(shape, primitive);
    EXPECT_EQ(primitive.groups.GetSize(), 6 + 6 + 6 + 6);
}
