// Links karvel.dll through its import library, as a host does, and uses exported classes across
// the DLL boundary (allocation on one side, release on the other).
#include <gtest/gtest.h>

#include "convert/dor_shape.h"
#include "tests/support/recording_karvel.h"

// A host's own modeller, derived from the exported interface: the members inside the DLL call
// back into it through the virtual table, and it keeps the primitives they build from its shapes.
TEST(KarvelDll, MembersCallBackIntoAHostModellerAndItKeepsTheirPrimitives)
{
    RecordingKarvel host;
    host.camera = Camera(DorVector3(10, 0, 0), DorVector3(0, 0, 0));
    static_cast<CVelKarvel&>(host).RoundDolly(0, 90);
    EXPECT_TRUE(host.getCameraCalls == 1 && host.setCameraCalls == 1 && host.camera.eye.y == 10.0);
    CDorHolePolygon face({DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(4, 4, 0), DorVector3(0, 4, 0)});
    face.AddHole(CDorPolygon({DorVector3(1, 1, 0), DorVector3(3, 1, 0), DorVector3(2, 3, 0)}));
    CDorHoleExtruded block(face, DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&block);
    const CVelPrimitive copy = host.entities[host.AddShape(shape)];
    EXPECT_TRUE(copy.groups.GetSize() == 4 + 3 + 2 && copy.groups[8].triangles.GetSize() == 7);  // the kind check knows the host's object
}
