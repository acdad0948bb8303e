#pragma once
// Face pieces shared by the plain and the holed polygon converters (internal, not exported).
#include "model/vel_primitive.h"

// The loop's unit Newell normal (left as summed when shorter than 0.0001), negated when
// reverse is 1: the face seen from its back.
DorVector3 VelFaceNormal(const CDorArray<DorVector3, DorVector3&>& loop, int reverse);

// Makes group an indexed triangle face over the points, every normal the face's; each index
// triple is wound the other way round when reverse is 1.
void VelFillIndexedFace(const CDorArray<DorVector3, DorVector3&>& points, const CDorArray<int, int>& indices,
                        const DorVector3& normal, int reverse, CVelTrianglePolys& group);

// Planar texture coordinates for every vertex of a non-empty group, in the frame of the plane
// through vertex 0 with vertex 0's normal, divided by the scales. A non-zero axis turns the
// texture and the origin shifts it; both are taken through the plane frame as points,
// translation included, and the origin is added, not subtracted: hosts place their textures by
// these rules.
void VelSetPlanarTexCoords(CVelTrianglePolys& group, const DorVector3& axis, const DorVector3& origin, double scaleU,
                           double scaleV);
