// Links karvel.dll through its import library, as a host does, and uses exported classes across
// the DLL boundary (allocation on one side, release on the other).
#include <gtest/gtest.h>

#include "convert/vel_shape_to_primitive.h"
#include "primitives/vel_math_primitive.h"

TEST(KarvelDll, PrimitiveBuiltInsideTheDllIsCopiedAndFreedByTheHost)
{
    CVelPrimitive primitive;
    ASSERT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(4, 4), 4, primitive), 0);
    CVelPrimitive copy(primitive);
    ASSERT_EQ(copy.groups.GetSize(), 1);
    EXPECT_EQ(copy.groups[0].vertices.GetSize(), 20);
    EXPECT_EQ(copy.groups[0].vertices[19].position.y, 4.0);
}

TEST(KarvelDll, ShapeBuiltByTheHostIsConvertedInsideTheDll)
{
    CDorExtruded box(CDorPolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)}),
                     DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&box);
    CVelPrimitive primitive;
    CVelShapeToPrimitive().ConvertShape(shape, primitive);
    ASSERT_EQ(primitive.groups.GetSize(), 6);  // the kind check recognises the host's object
    EXPECT_EQ(primitive.groups[5].vertices[0].normal.z, 1.0);
}
