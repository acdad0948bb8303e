#include <gtest/gtest.h>

#include "convert/vel_shape_to_primitive.h"
#include "convert_test_support.h"

using namespace convert_test;

namespace {
// Two boxes told apart by their walls' shininess: the first makes 6 groups, the second 4.
class TwoBoxes : public ::testing::Test {
protected:
    void SetUp() override
    {
        CDorPolygon square({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)});
        first = CDorExtruded(square, DorVector3(0, 0, 1));
        first.material.shininess = 1;
        second = CDorExtruded(square.Translated(DorVector3(3, 0, 0)), DorVector3(0, 0, 2));
        second.material.shininess = 2;
        second.bottomCap = second.topCap = 0;
    }
    CVelPrimitive Convert(const CDorShape& shape)
    {
        CVelPrimitive primitive;
        CVelShapeToPrimitive().ConvertShape(shape, primitive);
        return primitive;
    }
    CDorExtruded first, second;
};
}  // namespace

TEST_F(TwoBoxes, GroupsComeInListOrderAndNullEntriesAreSkipped)
{
    CDorShape shape;
    shape.Add(&first);
    shape.Add(nullptr);
    shape.Add(&second);
    CVelPrimitive primitive = Convert(shape);
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 4);
    EXPECT_EQ(primitive.groups[0].material.shininess, 1.0f);
    EXPECT_EQ(primitive.groups[6].material.shininess, 2.0f);
    EXPECT_EQ(primitive.groups[6].vertices[0].position.x, 3.0);
    EXPECT_EQ(primitive.groups[4].GroupType, VelGroupIndexed);  // the first box's caps
    EXPECT_EQ(primitive.DrawMode, 2);
}

TEST_F(TwoBoxes, AnUnknownStyleDropsOnlyThatGeometry)
{
    first.SetStyle(5);
    CDorShape shape;
    shape.Add(&first);
    shape.Add(&second);
    CVelPrimitive primitive = Convert(shape);
    ASSERT_EQ(primitive.groups.GetSize(), 4);
    EXPECT_EQ(primitive.groups[0].material.shininess, 2.0f);
}

TEST_F(TwoBoxes, ConvertingTwiceAppendsAndKeepsDrawMode)
{
    CDorShape shape;
    shape.Add(&second);
    CVelPrimitive primitive;
    primitive.DrawMode = 3;
    CVelShapeToPrimitive converter;
    converter.ConvertShape(shape, primitive);
    converter.ConvertShape(shape, primitive);
    ASSERT_EQ(primitive.groups.GetSize(), 8);
    EXPECT_EQ(primitive.DrawMode, 3);
    primitive.groups[0].vertices[0].position.x = 99;  // deep copies: the groups share nothing
    EXPECT_EQ(primitive.groups[4].vertices[0].position.x, 3.0);
}

TEST_F(TwoBoxes, EmptyShapeLeavesThePrimitiveAlone)
{
    CVelPrimitive primitive;
    primitive.groups.SetSize(1);
    CVelShapeToPrimitive().ConvertShape(CDorShape(), primitive);
    EXPECT_EQ(primitive.groups.GetSize(), 1);
}

TEST_F(TwoBoxes, BarePolygonsAndMislabelledGeometriesProduceNothing)
{
    CDorPolygon square(first.bottom);
    CDorHolePolygon holed(square);
    CDorPolygon liar(square);
    liar.kind = DorKindExtruded;  // not really an extrusion
    CDorShape shape;
    shape.Add(&square);
    shape.Add(&holed);
    shape.Add(&liar);
    EXPECT_EQ(Convert(shape).groups.GetSize(), 0);
}

TEST_F(TwoBoxes, ConvertGeometryHandsOutTheExtrusionsOwnGroups)
{
    CVelGroupArray groups;
    CVelShapeToPrimitive converter;
    converter.ConvertGeometry(&second, groups);
    EXPECT_EQ(groups.GetSize(), 4);
    converter.ConvertGeometry(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 4);
}

TEST_F(TwoBoxes, WireAndSolidInOneShape)
{
    second.SetStyle(DorStyleWire);
    CDorShape shape;
    shape.Add(&first);
    shape.Add(&second);
    CVelPrimitive primitive = Convert(shape);
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 6);
    EXPECT_EQ(primitive.groups[6].GroupType, VelGroupLines);
    EXPECT_EQ(primitive.groups[11].GroupType, VelGroupLineStrip);
}
