#pragma once
/// @file
/// Render primitive records: what every shape becomes before it is drawn. A primitive is a list
/// of groups; a group is one material and one run of points, lines or triangles in double
/// precision, in model units. The records own all their storage and copies are deep: a primitive
/// handed to the modeller is copied, and the host keeps and destroys its own.
#include "../model/dor_types.h"
#include "../model/export.h"

/// One vertex of a group. A new vertex has zero position and normal, white colour and (0, 0)
/// texture coordinates.
struct _VelVertex {
    DorVector3 position;   ///< Model units.
    DorVector3 normal;     ///< For lighting; not normalised by the records.
    DorColorValue colour;  ///< Used by per-vertex colour groups only.
    DorVector2 texcoord;   ///< x = s, y = t; used by textured groups only.
};

/// One triangle of an indexed group: three indices into the group's vertices.
struct _VelTriangleIndex {
    ///@{
    int a, b, c;  ///< Corners in winding order.
    ///@}

    /// (0, 0, 0).
    _VelTriangleIndex() : a(0), b(0), c(0) {}
    /// (a_, b_, c_).
    _VelTriangleIndex(int a_, int b_, int c_) : a(a_), b(b_), c(c_) {}
};

/// How a group's vertex list is read (CVelTrianglePolys::GroupType). Other values draw nothing.
enum VelGroupType {
    VelGroupPoints = 0,         ///< Separate points: n elements.
    VelGroupLines = 1,          ///< Separate segments, vertices in pairs: n / 2, truncated.
    VelGroupLineStrip = 2,      ///< One connected strip: n - 1.
    VelGroupTriangles = 3,      ///< Separate triangles, vertices in threes: n / 3, truncated.
    VelGroupTriangleStrip = 4,  ///< Triangle strip: n - 2.
    VelGroupTriangleFan = 5,    ///< Triangle fan: n - 2.
    VelGroupIndexed = 6         ///< The entries of `triangles` index the vertex pool.
};

/// How a group is coloured (CVelTrianglePolys::RenderKind): lit with the group's material; each
/// vertex's colour applied as its ambient colour; or the group's texture applied with the texture
/// coordinates. Other values draw as lit.
enum VelRenderKind { VelRenderLit = 0, VelRenderVertexColour = 1, VelRenderTextured = 2 };

/// @cond KARVEL_INTERNAL
// The number of elements drawn for a group; false for a type outside 0..6, which leaves the
// drawn count undefined. Counts at or below zero draw nothing.
bool VelDrawnElementCount(int groupType, int vertexCount, int triangleCount, int& count);
/// @endcond

/// One group of a primitive: one material and one run of points, lines or triangles.
class KARVEL_API CVelTrianglePolys {
public:
    int GroupType;  ///< VelGroupType; default 4, triangle strip.
    /// Default a yellow: diffuse (0.8, 0.8, 0, 1), ambient (0.4, 0.4, 0, 1), specular (1, 1, 0, 1),
    /// shininess 80.
    _DorMaterial material;
    CDorArray<_VelVertex, _VelVertex&> vertices;  ///< The vertex list, read by GroupType.
    /// Group type 6 only; a group with an index past its vertices is not drawn.
    CDorArray<_VelTriangleIndex, _VelTriangleIndex&> triangles;
    int RenderKind;   ///< VelRenderKind; other values draw as lit.
    float lineWidth;  ///< Line width and point size in pixels; default 1.
    unsigned int texture;  ///< Name from CVelKarvel::AddTexture; 0 = none.
    int OverlayFlag;  ///< 1: drawn unlit in its ambient colour over the scene, one model unit per pixel, y down.

    /// Type 4, the default yellow material, no vertices, line width 1.
    CVelTrianglePolys();
    /// Deep copy. The destination keeps its spare capacity; growth steps are not copied.
    CVelTrianglePolys(const CVelTrianglePolys& other);
    /// @copydoc CVelTrianglePolys(const CVelTrianglePolys&)
    CVelTrianglePolys& operator=(const CVelTrianglePolys& other);
    /// Frees both arrays.
    virtual ~CVelTrianglePolys();

    /// Frees both arrays and resets type, render kind and texture; material, line width and
    /// overlay flag are kept.
    void RemoveAll();
};

/// A render primitive: groups in drawing order and the flags of the entity it becomes.
class KARVEL_API CVelPrimitive {
public:
    CDorArray<CVelTrianglePolys, CVelTrianglePolys&> groups;  ///< In drawing order.
    long DrawMode;  ///< Bit 0 (1) hidden, bit 1 (2) pickable; other bits carried along. Default 2.

    /// No groups, DrawMode 2 (visible and pickable).
    CVelPrimitive();
    /// Deep copy of every group and DrawMode.
    CVelPrimitive(const CVelPrimitive& other);
    /// Deep copy: surplus groups are destroyed, missing ones added, each assigned.
    CVelPrimitive& operator=(const CVelPrimitive& other);
    /// Destroys every group.
    virtual ~CVelPrimitive();

    /// Destroys every group and frees the group storage; DrawMode is kept.
    void DeleteAll();
};
