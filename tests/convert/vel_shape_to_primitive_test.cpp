#include "convert/vel_shape_to_primitive.h"
#include "geometry_checks.h"

namespace {
// Two boxes told apart by their walls' shininess: the first makes 6 groups, the second 4.
class TwoBoxes : public ::testing::Test {
protected:
    void SetUp() override
    {
        first.material.shininess = 1;
        second.material.shininess = 2;
        second.bottomCap = second.topCap = 0;
    }
    CVelPrimitive Convert(std::initializer_list<CDorGeometry*> geometries)
    {
        CDorShape shape;
        for (CDorGeometry* g : geometries)
            shape.Add(g);
        CVelPrimitive primitive;
        CVelShapeToPrimitive().ConvertShape(shape, primitive);
        return primitive;
    }
    CDorExtruded first = CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
    CDorExtruded second = CDorExtruded(Polygon(Square(3, 0, 1)), DorVector3(0, 0, 2));
};
}  // namespace

TEST_F(TwoBoxes, GroupsComeInListOrderAndNullEntriesAreSkipped)
{
    CVelPrimitive primitive = Convert({&first, nullptr, &second});
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 4);
    EXPECT_EQ(primitive.groups[0].material.shininess, 1.0f);
    EXPECT_EQ(primitive.groups[6].material.shininess, 2.0f);
    EXPECT_EQ(primitive.groups[6].vertices[0].position.x, 3.0);
    EXPECT_EQ(primitive.DrawMode, 2);
    second.SetStyle(DorStyleWire);
    primitive = Convert({&first, &second});
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 6);
    EXPECT_EQ(primitive.groups[6].GroupType, VelGroupLines);
    EXPECT_EQ(primitive.groups[11].GroupType, VelGroupLineStrip);
}

// An unknown style, a bare polygon and a geometry claiming a kind it is not convert to nothing.
TEST_F(TwoBoxes, OnlyTheGeometriesItCannotConvertAreDropped)
{
    first.SetStyle(5);
    CDorPolygon square(first.bottom), liar(square);
    CDorHolePolygon holed(square);
    liar.kind = DorKindExtruded;
    CVelPrimitive primitive = Convert({&first, &square, &holed, &liar, &second});
    ASSERT_EQ(primitive.groups.GetSize(), 4);
    EXPECT_EQ(primitive.groups[0].material.shininess, 2.0f);
}

TEST_F(TwoBoxes, ConvertingAppendsDeepCopiesAndKeepsDrawMode)
{
    CDorShape shape;
    shape.Add(&second);
    CVelPrimitive primitive;
    primitive.DrawMode = 3;
    CVelShapeToPrimitive converter;
    converter.ConvertShape(shape, primitive);
    converter.ConvertShape(shape, primitive);
    converter.ConvertShape(CDorShape(), primitive);
    ASSERT_EQ(primitive.groups.GetSize(), 8);
    EXPECT_EQ(primitive.DrawMode, 3);
    primitive.groups[0].vertices[0].position.x = 99;
    EXPECT_EQ(primitive.groups[4].vertices[0].position.x, 3.0);
    CVelGroupArray groups;
    converter.ConvertGeometry(&second, groups);
    converter.ConvertGeometry(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 4);
}
