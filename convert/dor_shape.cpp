#include "convert/dor_shape.h"

#include "model/dor_math.h"
#include "model/vel_primitive.h"

namespace {
void CopyPoints(CDorArray<DorVector3, DorVector3&>& to, const DorVector3* from, int count)
{
    to.SetSize(count > 0 ? count : 0);
    for (int i = 0; i < count; ++i)
        to[i] = from[i];
}

void TranslatePoints(CDorArray<DorVector3, DorVector3&>& points, const DorVector3& offset)
{
    for (int i = 0; i < points.GetSize(); ++i)
        points[i] = points[i] + offset;
}

// A zero vector means "not given" and stays zero.
DorVector3 TranslateGivenPoint(const DorVector3& p, const DorVector3& offset)
{
    if (p.x == 0.0 && p.y == 0.0 && p.z == 0.0)
        return p;
    return p + offset;
}

void CopyAppearance(const CDorGeometry& from, CDorGeometry& to)
{
    to.material = from.material;
    to.style = from.style;
    to.texture = from.texture;
    to.textureScaleU = from.textureScaleU;
    to.textureScaleV = from.textureScaleV;
}
}  // namespace

CDorGeometry::CDorGeometry(int kind_)
    : tag(0), kind(kind_), material(CVelTrianglePolys().material), style(DorStyleSolid), textureScaleU(1.0),
      textureScaleV(1.0), texture(0)
{
}

CDorPolygon::CDorPolygon() : CDorGeometry(DorKindPolygon) {}

CDorPolygon::CDorPolygon(const DorVector3* outline, int count) : CDorGeometry(DorKindPolygon)
{
    SetPoints(outline, count);
}

CDorPolygon::CDorPolygon(std::initializer_list<DorVector3> outline) : CDorGeometry(DorKindPolygon)
{
    SetPoints(outline.begin(), static_cast<int>(outline.size()));
}

void CDorPolygon::SetPoints(const DorVector3* outline, int count) { CopyPoints(points, outline, count); }

int CDorPolygon::AddPoint(const DorVector3& p)
{
    DorVector3 copy(p);
    return points.Add(copy);
}

CDorPolygon CDorPolygon::Translated(const DorVector3& offset) const
{
    CDorPolygon moved(*this);
    TranslatePoints(moved.points, offset);
    moved.textureAxis = TranslateGivenPoint(textureAxis, offset);
    moved.textureOrigin = textureOrigin + offset;
    return moved;
}

CDorHolePolygon::CDorHolePolygon() : CDorGeometry(DorKindHolePolygon) {}

CDorHolePolygon::CDorHolePolygon(const CDorPolygon& outline) : CDorGeometry(DorKindHolePolygon)
{
    CopyAppearance(outline, *this);
    points = outline.points;
    textureAxis = outline.textureAxis;
    textureOrigin = outline.textureOrigin;
}

CDorHolePolygon::CDorHolePolygon(std::initializer_list<DorVector3> outline) : CDorGeometry(DorKindHolePolygon)
{
    SetPoints(outline.begin(), static_cast<int>(outline.size()));
}

void CDorHolePolygon::SetPoints(const DorVector3* outline, int count) { CopyPoints(points, outline, count); }

int CDorHolePolygon::AddHole(const CDorPolygon& hole)
{
    CDorPolygon copy(hole);
    return holes.Add(copy);
}

int CDorHolePolygon::AddHole(const DorVector3* loop, int count) { return AddHole(CDorPolygon(loop, count)); }

CDorHolePolygon CDorHolePolygon::Translated(const DorVector3& offset) const
{
    CDorHolePolygon moved(*this);
    TranslatePoints(moved.points, offset);
    for (int h = 0; h < moved.holes.GetSize(); ++h)
        TranslatePoints(moved.holes[h].points, offset);
    moved.textureAxis = TranslateGivenPoint(textureAxis, offset);
    moved.textureOrigin = textureOrigin + offset;
    moved.holeTextureAxis = TranslateGivenPoint(holeTextureAxis, offset);
    moved.holeTextureOrigin = holeTextureOrigin + offset;
    return moved;
}

CDorExtruded::CDorExtruded() : CDorGeometry(DorKindExtruded), bottomCap(1), topCap(1) {}

CDorExtruded::CDorExtruded(const CDorPolygon& bottom_, const CDorPolygon& top_)
    : CDorGeometry(DorKindExtruded), bottom(bottom_), top(top_), bottomCap(1), topCap(1)
{
}

CDorExtruded::CDorExtruded(const CDorPolygon& bottom_, const DorVector3& height)
    : CDorExtruded(bottom_, bottom_.Translated(height))
{
}

void CDorExtruded::MatchCapsToWalls()
{
    CopyAppearance(*this, bottom);
    CopyAppearance(*this, top);
}

CDorHoleExtruded::CDorHoleExtruded() : CDorGeometry(DorKindHoleExtruded), bottomCap(1), topCap(1) {}

CDorHoleExtruded::CDorHoleExtruded(const CDorHolePolygon& bottom_, const CDorHolePolygon& top_)
    : CDorGeometry(DorKindHoleExtruded), bottom(bottom_), top(top_), bottomCap(1), topCap(1)
{
}

CDorHoleExtruded::CDorHoleExtruded(const CDorHolePolygon& bottom_, const DorVector3& height)
    : CDorHoleExtruded(bottom_, bottom_.Translated(height))
{
}

void CDorHoleExtruded::MatchCapsToWalls()
{
    CopyAppearance(*this, bottom);
    CopyAppearance(*this, top);
}
