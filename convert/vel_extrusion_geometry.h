#pragma once
// Wall geometry shared by the plain and the holed extrusions (internal, not exported).
// A wall i joins profile points i and i+1 of bottom (b) and top (t); outward means away from the
// solid when the profiles run counter-clockwise about the bottom-to-top direction.
#include <vector>

#include "convert/dor_shape.h"
#include "model/vel_primitive.h"

typedef CDorArray<DorVector3, DorVector3&> DorPointArray;

// Top centroid minus bottom centroid, normalised when at least 0.0001 long.
DorVector3 VelExtrusionDirection(const DorPointArray& bottom, const DorPointArray& top);

// Rewrites a profile of at least three points so that it runs counter-clockwise about the
// extrusion direction: point 0 stays, points 1..n-1 are reversed. A direction with x and z both
// exactly 0 (along y, or none) is replaced by the profile's own normal, which never reverses it.
void VelOrientProfile(DorPointArray& profile, const DorVector3& direction);

// The profile with point 0 appended again.
std::vector<DorVector3> VelClosedLoop(const DorPointArray& profile);

// Unit Newell normal of the loop a, b, c, d (left as summed when shorter than 0.0001).
DorVector3 VelQuadNormal(const DorVector3& a, const DorVector3& b, const DorVector3& c, const DorVector3& d);

// The normalised cross products at the corners of the wall quad, in record order top i,
// bottom i, top i+1, bottom i+1. All four equal the outward normal of a planar wall.
void VelWallCornerNormals(const DorVector3& ti, const DorVector3& bi, const DorVector3& ti1, const DorVector3& bi1,
                          DorVector3 normals[4]);

// Maps a wall into texture space: the plane projection of the wall anchored at anchor, then
// turned so that axis runs along U. A zero axis keeps the wall's own frame.
DorMatrix4x4 VelWallTextureFrame(const DorVector3& wallNormal, const DorVector3& anchor, const DorVector3& axis);

// A flat-shaded wall: the quad's records in strip order, every normal the unit Newell normal of
// the loop quad[0], quad[1], quad[3], quad[2], the head's material and texture. Texture
// coordinates (when withTexCoords) come from the wall's texture frame anchored at anchor.
void VelFillSolidWall(const CDorGeometry& head, const DorVector3& textureAxis, const DorVector3 quad[4],
                      const DorVector3& anchor, bool withTexCoords, CVelTrianglePolys& wall);

// The lines of the solid between two loops of the same count m >= 1, into groups[0..m+1]:
// group k holds the side edges at k and at k+1 (top k, bottom k, top k+1, bottom k+1, each with
// its corner normal, negated when sidesFaceIn), then the bottom loop (normals away from top for a
// loop counter-clockwise about bottom-to-top) and the top loop, each closed on its first point.
void VelFillWireFrame(const CDorGeometry& head, const DorPointArray& bottom, const DorPointArray& top,
                      bool sidesFaceIn, CVelTrianglePolys* groups);
