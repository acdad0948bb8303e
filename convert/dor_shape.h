#pragma once
// The classes in which a host describes what it wants drawn. A CDorShape lists geometries; each
// geometry is a polygon, a holed polygon, an extrusion or a holed extrusion. Their fields are
// public and their order and widths are part of the binary interface: hosts fill them, the
// converters read them. The shape never owns its geometries.
//
// Outline orientation: seen from the side into which a polygon's Newell normal points, its
// outline runs counter-clockwise. Outlines are closed implicitly; never repeat the first point.
#include <initializer_list>

#include "../model/dor_list.h"
#include "../model/dor_types.h"
#include "../model/export.h"

// The values of CDorGeometry::kind. The converters act on extrusions only.
enum DorGeometryKind {
    DorKindPolygon = 5,
    DorKindHolePolygon = 6,
    DorKindExtruded = 7,
    DorKindHoleExtruded = 8
};

// The values of CDorGeometry::style; any other value makes a geometry produce nothing.
enum DorGeometryStyle { DorStyleSolid = 0, DorStyleWire = 1 };

class KARVEL_API CDorGeometry {
public:
    int tag;  // free for the host; the library never reads it
    int kind;  // DorGeometryKind
    _DorMaterial material;
    int style;  // DorGeometryStyle
    double textureScaleU;  // model units per texture repeat
    double textureScaleV;
    unsigned int texture;  // name from AddTexture; 0 = untextured

    virtual ~CDorGeometry() {}

    void SetMaterial(const _DorMaterial& m) { material = m; }
    void SetStyle(int s) { style = s; }
    void SetTexture(unsigned int name, double scaleU = 1.0, double scaleV = 1.0)
    {
        texture = name;
        textureScaleU = scaleU;
        textureScaleV = scaleV;
    }

protected:
    // Solid, untextured, the converted groups' own default material, texture scales 1.
    explicit CDorGeometry(int kind_);
};

class KARVEL_API CDorPolygon : public CDorGeometry {
public:
    // NOTE: aligned so that it starts at the same offset under every compiler: GCC would put it
    // in the base's tail padding on 32-bit targets, MSVC never does.
    alignas(8) CDorArray<DorVector3, DorVector3&> points;
    DorVector3 textureAxis;    // texture U runs along it; zero = the plane's own axes
    DorVector3 textureOrigin;  // shifts the texture

    CDorPolygon();
    CDorPolygon(const DorVector3* outline, int count);
    // CDorPolygon square({{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 1, 0}});
    CDorPolygon(std::initializer_list<DorVector3> outline);

    void SetPoints(const DorVector3* outline, int count);
    int AddPoint(const DorVector3& p);
    // A copy moved by offset, with the same head and texture vectors.
    CDorPolygon Translated(const DorVector3& offset) const;
};

// A polygon with holes. Its first members match CDorPolygon's; the holed converters read only
// holeTextureAxis and holeTextureOrigin for the texture.
class KARVEL_API CDorHolePolygon : public CDorGeometry {
public:
    alignas(8) CDorArray<DorVector3, DorVector3&> points;  // the outer outline; aligned as in CDorPolygon
    DorVector3 textureAxis;    // not read by the holed converters
    DorVector3 textureOrigin;  // not read by the holed converters
    CDorArray<CDorPolygon, CDorPolygon&> holes;  // only each hole's points are read
    DorVector3 holeTextureAxis;    // a point whose direction in the face's frame turns the texture
    DorVector3 holeTextureOrigin;  // a point that shifts the texture

    CDorHolePolygon();
    explicit CDorHolePolygon(const CDorPolygon& outline);
    CDorHolePolygon(std::initializer_list<DorVector3> outline);

    void SetPoints(const DorVector3* outline, int count);
    int AddHole(const CDorPolygon& hole);
    // A hole from a host's own point array; returns its index.
    int AddHole(const DorVector3* loop, int count);
    // A copy moved by offset, holes and texture points included.
    CDorHolePolygon Translated(const DorVector3& offset) const;
};

// A prism-like solid between two profiles joined point i to point i. The head's style, material
// and texture are the side walls'; each cap keeps its own profile's.
class KARVEL_API CDorExtruded : public CDorGeometry {
public:
    CDorPolygon bottom;
    CDorPolygon top;
    int bottomCap;  // non-zero: close the bottom, facing away from top
    int topCap;
    DorVector3 textureAxis;  // up direction of the walls' texture; zero = each wall's own frame

    CDorExtruded();
    // Both caps on.
    CDorExtruded(const CDorPolygon& bottom_, const CDorPolygon& top_);
    // A prism: top is bottom moved by height.
    CDorExtruded(const CDorPolygon& bottom_, const DorVector3& height);

    // Gives both caps the walls' style, material and texture.
    void MatchCapsToWalls();
};

class KARVEL_API CDorHoleExtruded : public CDorGeometry {
public:
    CDorHolePolygon bottom;
    CDorHolePolygon top;
    int bottomCap;
    int topCap;
    DorVector3 textureAxis;

    CDorHoleExtruded();
    CDorHoleExtruded(const CDorHolePolygon& bottom_, const CDorHolePolygon& top_);
    CDorHoleExtruded(const CDorHolePolygon& bottom_, const DorVector3& height);

    void MatchCapsToWalls();
};

// An ordered list of geometries; groups come out in this order. Null entries are skipped.
class KARVEL_API CDorShape {
public:
    CDorList geometries;  // of CDorGeometry*, not owned

    CDorShape() {}
    virtual ~CDorShape() {}

    _DorPosition* Add(CDorGeometry* geometry) { return geometries.AddTail(geometry); }
    void RemoveAll() { geometries.RemoveAll(); }
    int GetCount() const { return geometries.GetCount(); }
};
