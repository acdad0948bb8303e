// Links karvel.dll through its import library, as a host does, and uses exported classes across
// the DLL boundary (allocation on one side, release on the other).
#include <gtest/gtest.h>

#include "movie/vfw_math_movie.h"
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

TEST(KarvelDll, RecordersAreExported)
{
    _DorBitmap frame;
    frame.info.width = frame.info.height = 4;
    frame.bits.SetSize(48);
    CVelMathMovie_NoComp plain;
    CVelMathMovie compressed;
    EXPECT_EQ(plain.Start(frame, "Z:\\no\\such\\folder\\movie.avi", 10, "m", 1), 0);
    EXPECT_EQ(compressed.Start(frame, "Z:\\no\\such\\folder\\movie.avi", 10, "m", 1), 0);
    EXPECT_EQ(plain.IsStart() + compressed.IsStart(), 0);
}
