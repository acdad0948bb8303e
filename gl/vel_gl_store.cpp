#include "gl/vel_gl_store.h"

#include <unordered_set>

#include "gl/vel_misuse.h"
#include "model/dor_math.h"

class CVelGLLiveHandles {
public:
    std::unordered_set<const _DorPosition*> handles;
};

namespace {
int KnownRenderKind(int kind) { return kind == VelRenderVertexColour || kind == VelRenderTextured ? kind : VelRenderLit; }

int ModeOfGroupType(int groupType)
{
    static const int modes[] = {VelGLPoints,    VelGLLines,         VelGLLineStrip, VelGLTriangles,
                                VelGLTriangleStrip, VelGLTriangleFan, VelGLTriangles};
    return modes[groupType];
}

int GroupTypeOfMode(int glMode, int indexed)
{
    if (indexed)
        return VelGroupIndexed;
    switch (glMode) {
    case VelGLPoints: return VelGroupPoints;
    case VelGLLines: return VelGroupLines;
    case VelGLLineStrip: return VelGroupLineStrip;
    case VelGLTriangles: return VelGroupTriangles;
    case VelGLTriangleFan: return VelGroupTriangleFan;
    default: return VelGroupTriangleStrip;
    }
}

int Smaller(int a, int b) { return a < b ? a : b; }

bool IsPowerOfTwoFrom2(unsigned int n) { return n >= 2 && (n & (n - 1)) == 0; }
}  // namespace

CVelGLTrianglePolygons::CVelGLTrianglePolygons()
    : vertexCount(0), elementCount(0), glMode(VelGLModeNone), indexed(0), RenderKind(VelRenderLit),
      lineWidth(1.0f), texture(0), OverlayFlag(0)
{
}

void CVelGLTrianglePolygons::Convert(const CVelTrianglePolys& group, double scale)
{
    vertexCount = group.vertices.GetSize();
    positions.SetSize(3 * vertexCount);
    normals.SetSize(3 * vertexCount);
    colours.SetSize(4 * vertexCount);
    WriteGeometry(group, vertexCount, scale);
    ChangeMaterial(group);
    ChangeTopology(group);
    texcoords.SetSize(2 * vertexCount);
    ChangeTexture(group);
}

void CVelGLTrianglePolygons::WriteGeometry(const CVelTrianglePolys& group, int count, double scale)
{
    const _VelVertex* v = group.vertices.GetData();
    float* p = positions.GetData();
    float* n = normals.GetData();
    float* c = colours.GetData();
    for (int i = 0; i < count; ++i, ++v, p += 3, n += 3, c += 4) {
        n[0] = static_cast<float>(v->normal.x);
        n[1] = static_cast<float>(v->normal.y);
        n[2] = static_cast<float>(v->normal.z);
        p[0] = static_cast<float>(v->position.x * scale);
        p[1] = static_cast<float>(v->position.y * scale);
        p[2] = static_cast<float>(v->position.z * scale);
        c[0] = v->colour.r;
        c[1] = v->colour.g;
        c[2] = v->colour.b;
        c[3] = v->colour.a;
    }
    OverlayFlag = group.OverlayFlag;
}

void CVelGLTrianglePolygons::RewriteGeometry(const CVelTrianglePolys& group, double scale)
{
    WriteGeometry(group, Smaller(vertexCount, group.vertices.GetSize()), scale);
}

void CVelGLTrianglePolygons::ChangeMaterial(const CVelTrianglePolys& group)
{
    material = group.material;
    RenderKind = KnownRenderKind(group.RenderKind);
}

void CVelGLTrianglePolygons::ChangeTopology(const CVelTrianglePolys& group)
{
    lineWidth = group.lineWidth;
    indexed = 0;
    int count = 0;
    if (!VelDrawnElementCount(group.GroupType, group.vertices.GetSize(), group.triangles.GetSize(), count))
        return;
    glMode = ModeOfGroupType(group.GroupType);
    elementCount = count;
    if (group.GroupType != VelGroupIndexed) {
        indices.SetSize(0);
        return;
    }
    indexed = 1;
    indices.SetSize(3 * count);
    const _VelTriangleIndex* t = group.triangles.GetData();
    unsigned int* out = indices.GetData();
    for (int i = 0; i < count; ++i, ++t, out += 3) {
        out[0] = static_cast<unsigned int>(t->a);
        out[1] = static_cast<unsigned int>(t->b);
        out[2] = static_cast<unsigned int>(t->c);
    }
}

void CVelGLTrianglePolygons::ChangeTexture(const CVelTrianglePolys& group)
{
    texture = group.texture;
    int count = Smaller(vertexCount, group.vertices.GetSize());
    const _VelVertex* v = group.vertices.GetData();
    float* st = texcoords.GetData();
    for (int i = 0; i < count; ++i, ++v, st += 2) {
        st[0] = static_cast<float>(v->texcoord.x);
        st[1] = static_cast<float>(v->texcoord.y);
    }
}

void CVelGLTrianglePolygons::Restore(CVelTrianglePolys& group, long flags, double scale) const
{
    if (flags & (VelChangeGeometry | VelChangeTexture))
        group.vertices.SetSize(vertexCount);
    _VelVertex* v = group.vertices.GetData();
    if (flags & VelChangeGeometry) {
        for (int i = 0; i < vertexCount; ++i) {
            v[i].position = DorVector3(positions[3 * i] / scale, positions[3 * i + 1] / scale,
                                       positions[3 * i + 2] / scale);
            v[i].normal = DorVector3(normals[3 * i], normals[3 * i + 1], normals[3 * i + 2]);
            v[i].colour = DorColorValue(colours[4 * i], colours[4 * i + 1], colours[4 * i + 2], colours[4 * i + 3]);
        }
        group.OverlayFlag = OverlayFlag;
    }
    if (flags & VelChangeMaterial) {
        group.material = material;
        group.RenderKind = RenderKind;
    }
    if (flags & VelChangeTopology) {
        group.GroupType = GroupTypeOfMode(glMode, indexed);
        group.lineWidth = lineWidth;
        int triangles = indexed ? indices.GetSize() / 3 : 0;
        group.triangles.SetSize(triangles);
        for (int i = 0; i < triangles; ++i)
            group.triangles[i] = _VelTriangleIndex(static_cast<int>(indices[3 * i]), static_cast<int>(indices[3 * i + 1]),
                                                   static_cast<int>(indices[3 * i + 2]));
    }
    if (flags & VelChangeTexture) {
        group.texture = texture;
        for (int i = 0; i < vertexCount; ++i)
            v[i].texcoord = DorVector2(texcoords[2 * i], texcoords[2 * i + 1]);
    }
}

void CVelGLTrianglePolygons::Transform(const DorMatrix4x4& matrix, double scale)
{
    DorVector3 shift = DorVector3(matrix.m[3][0], matrix.m[3][1], matrix.m[3][2]) * scale;
    for (int i = 0; i < vertexCount; ++i) {
        float* p = &positions[3 * i];
        DorVector3 moved = DorTransformDirection(DorVector3(p[0], p[1], p[2]), matrix) + shift;
        p[0] = static_cast<float>(moved.x);
        p[1] = static_cast<float>(moved.y);
        p[2] = static_cast<float>(moved.z);
        float* n = &normals[3 * i];
        DorVector3 turned = DorTransformDirection(DorVector3(n[0], n[1], n[2]), matrix);
        DorNormalize(turned);
        n[0] = static_cast<float>(turned.x);
        n[1] = static_cast<float>(turned.y);
        n[2] = static_cast<float>(turned.z);
    }
}

void CVelGLEntity::Convert(const CVelPrimitive& primitive, double scale)
{
    int count = primitive.groups.GetSize();
    groups.SetSize(count);
    for (int i = 0; i < count; ++i)
        groups[i].Convert(primitive.groups[i], scale);
}

CVelGLStructure::CVelGLStructure() : entities(10), live(new CVelGLLiveHandles) {}

CVelGLStructure::CVelGLStructure(const CVelGLStructure& other)
    : entities(10), textures(other.textures), offset(other.offset), live(new CVelGLLiveHandles)
{
    CopyEntitiesFrom(other);
}

CVelGLStructure& CVelGLStructure::operator=(const CVelGLStructure& other)
{
    if (this != &other) {
        Destroy();
        CopyEntitiesFrom(other);
        textures = other.textures;
        offset = other.offset;
    }
    return *this;
}

CVelGLStructure::~CVelGLStructure()
{
    Destroy();
    RemoveAllTexture();
    delete live;
}

_DorPosition* CVelGLStructure::Listed(_DorPosition* position)
{
    live->handles.insert(position);
    return position;
}

void CVelGLStructure::CopyEntitiesFrom(const CVelGLStructure& other)
{
    for (_DorPosition* p = other.entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p))
        if (const CVelGLEntity* entity = ListedEntity(p))
            Listed(entities.AddTail(new CVelGLEntity(*entity)));
}

void CVelGLStructure::Destroy()
{
    for (_DorPosition* p = entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p))
        delete ListedEntity(p);
    entities.RemoveAll();
    live->handles.clear();
}

bool CVelGLStructure::IsLive(const _DorPosition* position) const
{
    return position && live->handles.count(position) != 0;
}

CVelGLEntity* CVelGLStructure::EntityAt(_DorPosition* position) const
{
    if (IsLive(position))
        return ListedEntity(position);
    if (position)
        VelReportMisuse("a handle that is not live in this modeller (removed, emptied, another's or never issued)");
    return nullptr;
}

_DorPosition* CVelGLStructure::AddPrimitive(const CVelPrimitive& primitive, const CVelGLScope& scope)
{
    CVelGLEntity* entity = new CVelGLEntity;
    entity->Convert(primitive, scope.vertexScale);
    entity->DrawMode = primitive.DrawMode;
    return Listed(entities.AddTail(entity));
}

void CVelGLStructure::ChangePrimitive(_DorPosition* position, const CVelPrimitive& primitive, long flags,
                                      const CVelGLScope& scope)
{
    CVelGLEntity* entity = EntityAt(position);
    if (!entity)
        return;
    double scale = scope.vertexScale;
    if (flags & VelChangeGeometry) {
        if (entity->groups.GetSize() != primitive.groups.GetSize()) {
            entity->groups.SetSize(0);
            entity->Convert(primitive, scale);
        } else {
            for (int i = 0; i < entity->groups.GetSize(); ++i) {
                CVelGLTrianglePolygons& stored = entity->groups[i];
                const CVelTrianglePolys& group = primitive.groups[i];
                // NOTE: the in-place path is taken only when the stored count is three times the
                // new one; hosts rely on every other change being a full conversion.
                if (stored.vertexCount == 3 * group.vertices.GetSize())
                    stored.RewriteGeometry(group, scale);
                else
                    stored.Convert(group, scale);
            }
        }
    }
    int matched = Smaller(entity->groups.GetSize(), primitive.groups.GetSize());
    for (int i = 0; i < matched; ++i) {
        CVelGLTrianglePolygons& stored = entity->groups[i];
        const CVelTrianglePolys& group = primitive.groups[i];
        if (flags & VelChangeMaterial)
            stored.ChangeMaterial(group);
        if (flags & VelChangeTopology)
            stored.ChangeTopology(group);
        if (flags & VelChangeTexture)
            stored.ChangeTexture(group);
    }
    if (flags & VelChangeDrawMode)
        entity->DrawMode = primitive.DrawMode;
}

void CVelGLStructure::GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags,
                                   const CVelGLScope& scope) const
{
    const CVelGLEntity* entity = EntityAt(position);
    if (!entity)
        return;
    primitive.DeleteAll();
    int count = entity->groups.GetSize();
    primitive.groups.SetSize(count);
    for (int i = 0; i < count; ++i)
        entity->groups[i].Restore(primitive.groups[i], flags, scope.vertexScale);
    if (flags & VelChangeDrawMode)
        primitive.DrawMode = entity->DrawMode;
}

void CVelGLStructure::RemoveAt(_DorPosition*& position)
{
    CVelGLEntity* entity = EntityAt(position);
    if (!entity)
        return;
    live->handles.erase(position);
    entities.RemoveAt(position);
    delete entity;
    position = nullptr;
}

void CVelGLStructure::MoveToHead(_DorPosition*& position)
{
    if (!EntityAt(position))
        return;
    live->handles.erase(position);
    entities.MoveToHead(position);
    Listed(position);
}

void CVelGLStructure::MoveToTail(_DorPosition*& position)
{
    if (!EntityAt(position))
        return;
    live->handles.erase(position);
    entities.MoveToTail(position);
    Listed(position);
}

void CVelGLStructure::MoveEntity(_DorPosition* position, const DorMatrix4x4& matrix, const CVelGLScope& scope)
{
    CVelGLEntity* entity = EntityAt(position);
    if (!entity)
        return;
    for (int i = 0; i < entity->groups.GetSize(); ++i)
        entity->groups[i].Transform(matrix, scope.vertexScale);
}

namespace {
// Whether GetCenterPoint's filter bits leave the group out of the box.
bool FilteredOut(const CVelGLTrianglePolygons& group, int filter)
{
    if ((filter & 1) && group.glMode == VelGLPoints)
        return true;
    // NOTE: tests GL_LINES and GL_LINE_LOOP, so line strips still count; hosts expect that.
    if ((filter & 2) && (group.glMode == VelGLLines || group.glMode == VelGLLineLoop))
        return true;
    if (filter & 4)
        return true;
    return (filter & 8) && group.material.diffuse.a < 1.0f;
}

// An axis-aligned box that the first point sets and later points widen.
struct Box {
    float low[3] = {0, 0, 0};
    float high[3] = {0, 0, 0};
    bool empty = true;

    void Enter(const float* p)
    {
        for (int k = 0; k < 3; ++k) {
            if (empty || p[k] < low[k])
                low[k] = p[k];
            if (empty || p[k] > high[k])
                high[k] = p[k];
        }
        empty = false;
    }
};
}  // namespace

// The box of every position that GetCenterPoint's entity and group filters let through.
static Box BoxOfModel(const CDorList& entities, int filter)
{
    Box box;
    for (_DorPosition* p = entities.GetHeadPosition(); p; p = CDorList::GetNextPosition(p)) {
        const CVelGLEntity* entity = CVelGLStructure::ListedEntity(p);
        if (!entity || (entity->DrawMode & 1) || (entity->DrawMode & 4))
            continue;
        for (int g = 0; g < entity->groups.GetSize(); ++g) {
            const CVelGLTrianglePolygons& group = entity->groups[g];
            if (FilteredOut(group, filter))
                continue;
            for (int i = 0; i < group.vertexCount; ++i)
                box.Enter(&group.positions[3 * i]);
        }
    }
    return box;
}

void CVelGLStructure::GetCenterPoint(DorVector3& centre, int filter, double modelScale) const
{
    Box box = BoxOfModel(entities, filter);
    centre.x = (static_cast<double>(box.low[0]) + box.high[0]) * 0.5 / modelScale;
    centre.y = (static_cast<double>(box.low[1]) + box.high[1]) * 0.5 / modelScale;
    centre.z = (static_cast<double>(box.low[2]) + box.high[2]) * 0.5 / modelScale;
}

bool CVelGLStructure::GetBoundingBox(DorVector3& low, DorVector3& high, int filter, double modelScale) const
{
    Box box = BoxOfModel(entities, filter);
    if (box.empty)
        return false;
    low = DorVector3(box.low[0] / modelScale, box.low[1] / modelScale, box.low[2] / modelScale);
    high = DorVector3(box.high[0] / modelScale, box.high[1] / modelScale, box.high[2] / modelScale);
    return true;
}

bool VelTexturePixelsPresent(const _DorBitmap& bitmap)
{
    long long rows = bitmap.info.height < 0 ? -static_cast<long long>(bitmap.info.height) : bitmap.info.height;
    long long rowBytes = ((static_cast<long long>(bitmap.info.width) * bitmap.info.bitCount + 31) / 32) * 4;
    return bitmap.info.width >= 0 && rowBytes * rows <= bitmap.bits.GetSize();
}

bool VelTextureAcceptable(const _DorBitmap& bitmap, unsigned int maxPixels)
{
    int bits = bitmap.info.bitCount;
    if (bits != 1 && bits != 24 && bits != 32)
        return false;
    unsigned int pixels = static_cast<unsigned int>(bitmap.info.width) * static_cast<unsigned int>(bitmap.info.height);
    return pixels <= maxPixels && IsPowerOfTwoFrom2(pixels) && VelTexturePixelsPresent(bitmap);
}

bool VelIndicesInRange(const unsigned int* indices, int count, int vertexCount)
{
    unsigned int limit = vertexCount > 0 ? static_cast<unsigned int>(vertexCount) : 0u;
    unsigned int highest = 0;
    for (int i = 0; i < count; ++i)
        highest = indices[i] > highest ? indices[i] : highest;
    return count == 0 || highest < limit;
}

unsigned int CVelGLStructure::AddTexture(const _DorBitmap& bitmap)
{
    if (!VelTextureAcceptable(bitmap, VelAddTextureLimit))
        return 0;
    int index = textures.GetSize();
    textures.SetSize(index + 1);
    textures[index] = bitmap;
    return static_cast<unsigned int>(index + 1);
}

int CVelGLStructure::ChangeTexture(unsigned int name, const _DorBitmap& bitmap)
{
    if (name == 0 || name > static_cast<unsigned int>(textures.GetSize()))
        return 0;
    if (!VelTextureAcceptable(bitmap, VelChangeTextureLimit))
        return 0;
    textures[static_cast<int>(name - 1)] = bitmap;
    return 1;
}

void CVelGLStructure::RemoveAllTexture() { textures.SetSize(0); }
