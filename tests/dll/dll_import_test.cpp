// Links karvel.dll through its import library, as a host does, and uses exported classes across
// the DLL boundary (allocation on one side, release on the other).
#include <gtest/gtest.h>

#include "convert/dor_shape.h"
#include "convert/vel_hole_polygon_to_primitive.h"
#include "movie/vfw_math_movie.h"
#include "primitives/vel_math_primitive.h"
#include "tests/support/recording_karvel.h"

TEST(KarvelDll, PrimitiveBuiltInsideTheDllIsCopiedAndFreedByTheHost)
{
    CVelPrimitive primitive;
    ASSERT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(4, 4), 4, primitive), 0);
    CVelPrimitive copy(primitive);
    ASSERT_EQ(copy.groups.GetSize(), 1);
    EXPECT_EQ(copy.groups[0].vertices.GetSize(), 20);
    EXPECT_EQ(copy.groups[0].vertices[19].position.y, 4.0);
}

// A host's own modeller, derived from the exported interface: the camera wrappers inside the DLL
// call back into the host's GetCamera and SetCamera through the virtual table.
TEST(KarvelDll, CameraWrappersCallBackIntoAHostModeller)
{
    RecordingKarvel host;
    host.camera.eye = DorVector3(10, 0, 0);
    host.camera.target = DorVector3(0, 0, 0);
    CVelKarvel& modeller = host;
    modeller.RoundDolly(0, 90);
    EXPECT_EQ(host.getCameraCalls, 1);
    EXPECT_EQ(host.setCameraCalls, 1);
    EXPECT_EQ(host.camera.eye.y, 10.0);
    EXPECT_EQ(modeller.GetCullMode(), 1);
}

TEST(KarvelDll, ShapeBuiltByTheHostIsConvertedInsideTheDll)
{
    CDorExtruded box(CDorPolygon({DorVector3(0, 0, 0), DorVector3(1, 0, 0), DorVector3(1, 1, 0), DorVector3(0, 1, 0)}),
                     DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&box);
    RecordingKarvel host;
    _DorPosition* entity = host.AddShape(shape);
    ASSERT_EQ(host.entities.count(entity), 1u);
    const CVelPrimitive& primitive = host.entities[entity];
    ASSERT_EQ(primitive.groups.GetSize(), 6);  // the kind check recognises the host's object
    EXPECT_EQ(primitive.groups[5].vertices[0].normal.z, 1.0);
}

TEST(KarvelDll, HoledShapeBuiltByTheHostIsConvertedInsideTheDll)
{
    CDorHolePolygon face({DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(4, 4, 0), DorVector3(0, 4, 0)});
    face.AddHole(CDorPolygon({DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)}));
    CDorHoleExtruded block(face, DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&block);
    RecordingKarvel host;
    _DorPosition* entity = host.AddShape(shape);
    const CVelPrimitive& primitive = host.entities[entity];
    ASSERT_EQ(primitive.groups.GetSize(), 4 + 3 + 2);
    EXPECT_EQ(primitive.groups[8].triangles.GetSize(), 7);

    CDorArray<DorVector3, DorVector3&> vertices;
    CDorArray<int, int> indices;
    CVelHolePolygonToPrimitive().TriangulateHolePolygon(&face, vertices, indices);
    EXPECT_EQ(vertices.GetSize(), 7);
    EXPECT_EQ(indices.GetSize(), 21);
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
