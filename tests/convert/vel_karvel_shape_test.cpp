#include "geometry_checks.h"
#include "tests/support/recording_karvel.h"

namespace {
// A 4 x 3 wall, 0.2 thick along y, with a 1 x 1 window and a 1 x 2 door cut through it; beside
// it, a unit box without holes.
class WallWithOpeningsAndBox : public ::testing::Test {
protected:
    void SetUp() override
    {
        Loop outline = {DorVector3(0, 0, 0), DorVector3(0, 0, 3), DorVector3(4, 0, 3), DorVector3(4, 0, 0)};
        Loop window = {DorVector3(1, 0, 1), DorVector3(1, 0, 2), DorVector3(2, 0, 2), DorVector3(2, 0, 1)};
        Loop door = {DorVector3(2.5, 0, 0.5), DorVector3(2.5, 0, 2.5), DorVector3(3.5, 0, 2.5), DorVector3(3.5, 0, 0.5)};
        wall = CDorHoleExtruded(HolePolygon(outline, {window, door}), DorVector3(0, 0.2, 0));
        shape.Add(&wall);
        shape.Add(&box);
    }
    CDorHoleExtruded wall;
    CDorExtruded box = CDorExtruded(Polygon(Square(5, 0, 1)), DorVector3(0, 0, 1));
    CDorShape shape;
    RecordingKarvel modeller;
};
}  // namespace

TEST_F(WallWithOpeningsAndBox, AddShapeStoresTheConvertedGroupsAsANewEntity)
{
    _DorPosition* entity = modeller.AddShape(shape);
    EXPECT_NE(modeller.AddShape(shape), entity);
    ASSERT_EQ(modeller.entities.count(entity), 1u);
    const CVelPrimitive& stored = modeller.entities[entity];
    // Outline walls, the door's walls (the last hole's), both caps; then the box.
    ASSERT_EQ(stored.groups.GetSize(), 4 + 4 + 2 + 6);
    EXPECT_EQ(stored.DrawMode, 2);
    EXPECT_EQ(stored.groups[4].vertices[0].position.x, 2.5);
    EXPECT_EQ(stored.groups[8].GroupType, VelGroupIndexed);
    EXPECT_EQ(stored.groups[8].vertices.GetSize(), 12);
    EXPECT_EQ(stored.groups[8].triangles.GetSize(), 12 + 2 * 2 - 2);  // every region triangulated
    EXPECT_EQ(stored.groups[9].vertices[0].position.y, 0.2);
    EXPECT_EQ(stored.groups[14].GroupType, VelGroupIndexed);
    CDorShape empty;
    _DorPosition* nothing = modeller.AddShape(empty);
    ASSERT_EQ(modeller.entities.count(nothing), 1u);
    EXPECT_EQ(modeller.entities[nothing].groups.GetSize(), 0);
}

TEST_F(WallWithOpeningsAndBox, ChangeShapeReconvertsWithEveryFlag)
{
    _DorPosition* entity = modeller.AddShape(shape);
    box = CDorExtruded(Polygon(Square(5, 0, 1)), DorVector3(0, 0, 7));
    modeller.ChangeShape(entity, shape);
    EXPECT_EQ(modeller.lastChangeFlags, 31);
    EXPECT_EQ(modeller.entities[entity].groups[15].vertices[0].position.z, 7.0);  // the box's top cap moved up
}

TEST_F(WallWithOpeningsAndBox, ShapeToPrimitiveAppendsAndWireKeepsEveryHole)
{
    wall.style = DorStyleWire;
    CVelPrimitive primitive;
    primitive.groups.SetSize(2);
    modeller.ShapeToPrimitive(shape, primitive);
    EXPECT_EQ(primitive.groups.GetSize(), 2 + 6 + 6 + 6 + 6);
    EXPECT_TRUE(modeller.entities.empty());
}
