#include "geometry_checks.h"

// A prism's top is its profile moved up (the extrusion tests check its points), given texture
// points too; a texture point not given stays not given.
TEST(ShapeClasses, PrismTopsMoveTheGivenTexturePoints)
{
    CDorHolePolygon base = HolePolygon({DorVector3(0, 0, 0), DorVector3(4, 0, 0), DorVector3(0, 4, 0)}, {Square(1, 1, 1)});
    base.textureOrigin = base.holeTextureAxis = DorVector3(1, 1, 0);
    CDorHoleExtruded solid(base, DorVector3(0, 0, 5));
    CDorExtruded plain(CDorPolygon(base.points.GetData(), 3), DorVector3(0, 0, 5));
    EXPECT_TRUE(SamePoint(solid.top.textureOrigin, DorVector3(1, 1, 5)) && SamePoint(solid.top.holeTextureAxis, DorVector3(1, 1, 5)));
    EXPECT_TRUE(SamePoint(solid.top.textureAxis, DorVector3()) && SamePoint(solid.top.holeTextureOrigin, DorVector3(0, 0, 5)));
    EXPECT_TRUE(SamePoint(plain.top.textureAxis, DorVector3()) && SamePoint(plain.top.textureOrigin, DorVector3(0, 0, 5)));
}

TEST(ShapeClasses, MatchCapsToWallsCopiesTheWallsLook)
{
    CDorExtruded box(Polygon(LShape()), DorVector3(0, 0, 1));
    CDorHoleExtruded holed(HolePolygon(LShape(), {}), DorVector3(0, 0, 1));
    for (CDorGeometry* head : std::vector<CDorGeometry*>{&box, &holed}) {
        head->material.shininess = 7;
        head->SetTexture(3, 2.0, 4.0);
        head->SetStyle(DorStyleWire);
    }
    box.MatchCapsToWalls();
    holed.MatchCapsToWalls();
    for (const CDorGeometry* cap : std::vector<const CDorGeometry*>{&box.bottom, &box.top, &holed.bottom, &holed.top})
        EXPECT_TRUE(cap->material.shininess == 7.0f && cap->texture == 3u && cap->textureScaleU == 2.0 && cap->textureScaleV == 4.0 &&
                    cap->style == DorStyleWire && (cap->kind == DorKindPolygon || cap->kind == DorKindHolePolygon));
}
