#pragma once
/// @file
/// The classes in which a host describes what it wants drawn. A CDorShape lists geometries; each
/// geometry is a polygon, a holed polygon, an extrusion or a holed extrusion. Their fields are
/// public and their order and widths are part of the binary interface: hosts fill them, the
/// converters read them. Coordinates are model units.
///
/// Ownership: the host builds and owns every shape and geometry; the library takes them by
/// pointer or reference for one call, never stores or frees them, and the shape never owns its
/// geometries. The one write into host input is on purpose: converting a solid extrusion (holed
/// or not) may reverse the point order of its profiles' outlines in place (point 0 stays), so
/// that both run counter-clockwise about the direction from bottom to top.
///
/// Outline orientation: seen from the side into which a polygon's Newell normal points, its
/// outline runs counter-clockwise; that side is the polygon's front. Outlines are closed
/// implicitly; never repeat the first point. Points are expected to be coplanar.
///
/// Only extrusions become groups at shape level: a bare polygon in a shape produces nothing; a
/// flat polygon is drawn as an extrusion's cap.
#include <initializer_list>

#include "../model/dor_list.h"
#include "../model/dor_types.h"
#include "../model/export.h"

/// The values of CDorGeometry::kind. The converters act on extrusions only.
enum DorGeometryKind {
    DorKindPolygon = 5,
    DorKindHolePolygon = 6,
    DorKindExtruded = 7,
    DorKindHoleExtruded = 8
};

/// The values of CDorGeometry::style: filled triangles with normals, or outline lines. Any other
/// value makes a geometry produce nothing, silently.
enum DorGeometryStyle { DorStyleSolid = 0, DorStyleWire = 1 };

/// The common head of every geometry: what it is and how it looks.
class KARVEL_API CDorGeometry {
public:
    int tag;  ///< Free for the host; the library never reads it.
    int kind;  ///< DorGeometryKind.
    _DorMaterial material;  ///< Copied into every group made from this geometry.
    int style;  ///< DorGeometryStyle.
    /// Model units per texture repeat along U; never tested for 0 (0 gives infinite coordinates).
    double textureScaleU;
    double textureScaleV;  ///< The same along V.
    unsigned int texture;  ///< Name from CVelKarvel::AddTexture; 0 = untextured. Non-zero makes solid groups textured.

    /// Nothing to free: the geometry owns only its own arrays.
    virtual ~CDorGeometry() {}

    /// Sets material.
    void SetMaterial(const _DorMaterial& m) { material = m; }
    /// Sets style (DorGeometryStyle).
    void SetStyle(int s) { style = s; }
    /// Sets the texture name and its repeat lengths in model units.
    void SetTexture(unsigned int name, double scaleU = 1.0, double scaleV = 1.0)
    {
        texture = name;
        textureScaleU = scaleU;
        textureScaleV = scaleV;
    }

protected:
    /// Solid, untextured, the converted groups' own default (yellow) material, texture scales 1.
    explicit CDorGeometry(int kind_);
};

/// A flat, simple polygon without holes (kind 5). Drawn only as an extrusion's cap.
class KARVEL_API CDorPolygon : public CDorGeometry {
public:
    // NOTE: aligned so that it starts at the same offset under every compiler: GCC would put it
    // in the base's tail padding on 32-bit targets, MSVC never does.
    /// The outline, counter-clockwise about the front side's normal.
    alignas(8) CDorArray<DorVector3, DorVector3&> points;
    DorVector3 textureAxis;    ///< Texture U runs along it; zero = the plane's own axes.
    DorVector3 textureOrigin;  ///< Shifts the texture; ignored while textureAxis is zero.

    /// No points.
    CDorPolygon();
    /// The outline from count points of the host's array (copied).
    CDorPolygon(const DorVector3* outline, int count);
    /// The outline from a list: `CDorPolygon square({{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 1, 0}});`
    CDorPolygon(std::initializer_list<DorVector3> outline);

    /// Replaces the outline with count points of the host's array (copied).
    void SetPoints(const DorVector3* outline, int count);
    /// Appends a point; returns its index.
    int AddPoint(const DorVector3& p);
    /// A copy moved by offset, with the same head and texture vectors (a zero textureAxis stays zero).
    CDorPolygon Translated(const DorVector3& offset) const;
};

/// A polygon with holes (kind 6). Its first members match CDorPolygon's; the holed converters read
/// only holeTextureAxis and holeTextureOrigin for the texture. Holes are expected inside the
/// outline and in its plane; nothing checks this.
class KARVEL_API CDorHolePolygon : public CDorGeometry {
public:
    alignas(8) CDorArray<DorVector3, DorVector3&> points;  ///< The outer outline; aligned as in CDorPolygon.
    DorVector3 textureAxis;    ///< Not read by the holed converters.
    DorVector3 textureOrigin;  ///< Not read by the holed converters.
    CDorArray<CDorPolygon, CDorPolygon&> holes;  ///< Only each hole's points are read.
    DorVector3 holeTextureAxis;    ///< A point whose direction in the face's frame turns the texture; zero = no turn.
    DorVector3 holeTextureOrigin;  ///< A point that shifts the texture.

    /// No points, no holes.
    CDorHolePolygon();
    /// The outline (points, head and texture vectors) of a plain polygon, no holes.
    explicit CDorHolePolygon(const CDorPolygon& outline);
    /// The outline from a list, no holes.
    CDorHolePolygon(std::initializer_list<DorVector3> outline);

    /// Replaces the outline with count points of the host's array (copied).
    void SetPoints(const DorVector3* outline, int count);
    /// Appends a copy of hole; returns its index.
    int AddHole(const CDorPolygon& hole);
    /// A hole from count points of the host's array (copied); returns its index.
    int AddHole(const DorVector3* loop, int count);
    /// A copy moved by offset, holes and texture points included.
    CDorHolePolygon Translated(const DorVector3& offset) const;
};

/// A prism-like solid between two profiles joined point i to point i (kind 7). The head's style,
/// material and texture are the side walls'; each cap keeps its own profile's. The profiles need
/// the same number of points, else the extrusion produces nothing; they need not be translates of
/// each other (tapered and skewed solids are fine). Walls face outward when the profiles run
/// counter-clockwise about the direction from bottom to top, which solid conversion enforces by
/// reordering them in place.
class KARVEL_API CDorExtruded : public CDorGeometry {
public:
    CDorPolygon bottom;  ///< Bottom profile, a complete polygon with its own head for the cap.
    CDorPolygon top;     ///< Top profile, likewise.
    int bottomCap;  ///< Non-zero: close the bottom, facing away from top (solid style only).
    int topCap;     ///< Non-zero: close the top (solid style only).
    DorVector3 textureAxis;  ///< Up direction of the walls' texture; zero = each wall's own frame.

    /// No points, both caps on.
    CDorExtruded();
    /// Copies of both profiles, both caps on.
    CDorExtruded(const CDorPolygon& bottom_, const CDorPolygon& top_);
    /// A prism: top is bottom moved by height (model units); both caps on.
    CDorExtruded(const CDorPolygon& bottom_, const DorVector3& height);

    /// Gives both caps the walls' style, material and texture.
    void MatchCapsToWalls();
};

/// An extrusion of a profile with holes (kind 8), arranged as CDorExtruded. Hole h of bottom is
/// joined to hole h of top, point i to point i; a pair whose counts differ, or that is empty, gets
/// no walls.
///
/// In solid style only the last such hole pair gets walls, and hole loops are never reordered: a
/// hole's walls face into the hole only when its loops run the same way as the outline
/// (counter-clockwise about the direction from bottom to top). A hole running the other way gets
/// walls facing into the material, which back-face culling hides, so it shows no walls at all.
class KARVEL_API CDorHoleExtruded : public CDorGeometry {
public:
    CDorHolePolygon bottom;  ///< Bottom profile, with its own head for the cap.
    CDorHolePolygon top;     ///< Top profile, likewise; needs at least the bottom's holes.
    int bottomCap;  ///< Non-zero: close the bottom, facing away from top (solid style only).
    int topCap;     ///< Non-zero: close the top (solid style only).
    DorVector3 textureAxis;  ///< Up direction of the walls' texture; zero = each wall's own frame.

    /// No points, both caps on.
    CDorHoleExtruded();
    /// Copies of both profiles, both caps on.
    CDorHoleExtruded(const CDorHolePolygon& bottom_, const CDorHolePolygon& top_);
    /// A prism: top is bottom (holes included) moved by height; both caps on.
    CDorHoleExtruded(const CDorHolePolygon& bottom_, const DorVector3& height);

    /// Gives both caps the walls' style, material and texture.
    void MatchCapsToWalls();
};

/// An ordered list of geometries; their groups come out in this order. Null entries are skipped.
class KARVEL_API CDorShape {
public:
    CDorList geometries;  ///< Of CDorGeometry*, not owned.

    /// An empty shape.
    CDorShape() {}
    /// Frees the list, not the geometries.
    virtual ~CDorShape() {}

    /// Appends geometry (kept by pointer: it must outlive every conversion of the shape).
    _DorPosition* Add(CDorGeometry* geometry) { return geometries.AddTail(geometry); }
    /// Empties the list; the geometries are not touched.
    void RemoveAll() { geometries.RemoveAll(); }
    /// Geometries in the list.
    int GetCount() const { return geometries.GetCount(); }
};
