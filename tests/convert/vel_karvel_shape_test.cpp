#include <gtest/gtest.h>

#include "convert_test_support.h"
#include "tests/support/recording_karvel.h"

using namespace convert_test;

namespace {
// A unit box with both caps in a shape of its own.
class BoxShape : public ::testing::Test {
protected:
    void SetUp() override
    {
        box = CDorExtruded(Polygon(RegularPolygon(4)), DorVector3(0, 0, 1));
        shape.Add(&box);
    }
    CDorExtruded box;
    CDorShape shape;
    RecordingKarvel modeller;
};
}  // namespace

TEST_F(BoxShape, AddShapeStoresTheConvertedGroupsAsANewEntity)
{
    _DorPosition* first = modeller.AddShape(shape);
    _DorPosition* second = modeller.AddShape(shape);
    EXPECT_NE(first, second);
    ASSERT_EQ(modeller.entities.count(first), 1u);
    const CVelPrimitive& stored = modeller.entities[first];
    ASSERT_EQ(stored.groups.GetSize(), 6);
    EXPECT_EQ(stored.DrawMode, 2);
    EXPECT_EQ(stored.groups[4].GroupType, VelGroupIndexed);
}

TEST_F(BoxShape, ChangeShapeReconvertsWithEveryFlag)
{
    _DorPosition* entity = modeller.AddShape(shape);
    box = CDorExtruded(Polygon(RegularPolygon(4)), DorVector3(0, 0, 7));
    modeller.ChangeShape(entity, shape);
    EXPECT_EQ(modeller.lastChangeFlags, 31);
    const CVelPrimitive& stored = modeller.entities[entity];
    EXPECT_EQ(stored.groups[5].vertices[0].position.z, 7.0);  // the top cap moved up
}

TEST_F(BoxShape, ShapeToPrimitiveAppendsToThePrimitiveGiven)
{
    CVelPrimitive primitive;
    primitive.groups.SetSize(2);
    modeller.ShapeToPrimitive(shape, primitive);
    EXPECT_EQ(primitive.groups.GetSize(), 8);
    EXPECT_TRUE(modeller.entities.empty());
}

TEST_F(BoxShape, AnEmptyShapeStillMakesAnEntity)
{
    CDorShape empty;
    _DorPosition* entity = modeller.AddShape(empty);
    ASSERT_EQ(modeller.entities.count(entity), 1u);
    EXPECT_EQ(modeller.entities[entity].groups.GetSize(), 0);
}
