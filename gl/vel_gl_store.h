#pragma once
// The modeller's entity store: every primitive a host adds, kept as OpenGL-ready single-precision
// arrays in an ordered list whose node addresses are the entity handles. Nothing here needs an
// OpenGL context; drawing reads these records as they stand.
//
// Flags of ChangePrimitive/GetPrimitive (VelChange*) select the parts of a primitive that are
// written or read back; groups are matched by index.
#include "../model/dor_list.h"
#include "../model/dor_types.h"
#include "../model/vel_primitive.h"

class CVelGLRenderState;

// The OpenGL primitive mode of a group, with the values of GL_POINTS .. GL_TRIANGLE_FAN.
// VelGLModeNone marks a group whose type was never one that OpenGL can draw.
enum VelGLMode {
    VelGLModeNone = -1,
    VelGLPoints = 0,
    VelGLLines = 1,
    VelGLLineLoop = 2,
    VelGLLineStrip = 3,
    VelGLTriangles = 4,
    VelGLTriangleStrip = 5,
    VelGLTriangleFan = 6
};

enum VelChangeFlag {
    VelChangeGeometry = 1,   // positions, normals, colours, overlay flag
    VelChangeMaterial = 2,   // material and render kind
    VelChangeTopology = 4,   // group type, element count, indices, line width
    VelChangeTexture = 8,    // texture name and coordinates
    VelChangeDrawMode = 16,  // hidden / pickable
    VelChangeAll = 31
};

// What an operation converting primitives works in: the vertex scale applied on the way in
// (always 1.0) and the render state it belongs to. It makes no context current.
class CVelGLScope {
public:
    double vertexScale;
    CVelGLRenderState* renderState;

    explicit CVelGLScope(CVelGLRenderState* state = nullptr) : vertexScale(1.0), renderState(state) {}
    virtual ~CVelGLScope() {}
};

// The OpenGL copy of one CVelTrianglePolys. The float arrays always hold vertexCount vertices.
class CVelGLTrianglePolygons {
public:
    CDorArray<float, float> positions;  // x, y, z per vertex
    CDorArray<float, float> normals;    // x, y, z per vertex
    CDorArray<float, float> colours;    // r, g, b, a per vertex
    CDorArray<unsigned int, unsigned int> indices;  // 3 per triangle, indexed groups only
    _DorMaterial material;
    int vertexCount;
    int elementCount;  // drawn elements by the group type
    int glMode;        // VelGLMode
    int indexed;       // 1: drawn with glDrawElements
    int RenderKind;    // VelRenderKind
    float lineWidth;
    CDorArray<float, float> texcoords;  // s, t per vertex
    unsigned int texture;
    int OverlayFlag;

    CVelGLTrianglePolygons();
    virtual ~CVelGLTrianglePolygons() {}

    // Replaces everything with the converted group.
    void Convert(const CVelTrianglePolys& group, double scale);
    // Rewrites positions, normals and colours of the stored vertices from the group (as many as
    // both hold) and takes its overlay flag; the vertex count stays.
    void RewriteGeometry(const CVelTrianglePolys& group, double scale);
    void ChangeMaterial(const CVelTrianglePolys& group);
    // Mode, element count, indexed flag, indices and line width; an unknown group type keeps
    // the mode and element count.
    void ChangeTopology(const CVelTrianglePolys& group);
    // Texture name and the coordinates of the stored vertices (as many as the group holds).
    void ChangeTexture(const CVelTrianglePolys& group);
    // Fills the parts of group that flags select; the others keep their defaults.
    void Restore(CVelTrianglePolys& group, long flags, double scale) const;
    // Applies matrix to positions (translation times scale) and to normals (rotation only,
    // renormalised), in double precision.
    void Transform(const DorMatrix4x4& matrix, double scale);

private:
    void WriteGeometry(const CVelTrianglePolys& group, int count, double scale);
};

class CVelGLEntity {
public:
    CDorArray<CVelGLTrianglePolygons, CVelGLTrianglePolygons&> groups;
    long DrawMode;  // bit 0 hidden, bit 1 pickable
    CDorArray<long, long> freeProperty;  // the host's; never read by the library

    CVelGLEntity() : DrawMode(2) {}
    virtual ~CVelGLEntity() {}

    // Sizes the groups to the primitive's and converts every one.
    void Convert(const CVelPrimitive& primitive, double scale);
};

class CVelGLStructure {
public:
    CDorList entities;  // of CVelGLEntity*, owned
    CDorArray<_DorBitmap, _DorBitmap&> textures;  // texture name i + 1 is element i
    DorVector3 offset;  // the scene is drawn translated by -offset

    CVelGLStructure();
    CVelGLStructure(const CVelGLStructure& other);
    CVelGLStructure& operator=(const CVelGLStructure& other);
    virtual ~CVelGLStructure();

    // Deletes every entity; textures stay.
    void Destroy();

    // The entity behind a handle; null for a null handle or a node without entity.
    static CVelGLEntity* EntityAt(_DorPosition* position);

    _DorPosition* AddPrimitive(const CVelPrimitive& primitive, const CVelGLScope& scope);
    void ChangePrimitive(_DorPosition* position, const CVelPrimitive& primitive, long flags,
                         const CVelGLScope& scope);
    void GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags,
                      const CVelGLScope& scope) const;
    void RemoveAt(_DorPosition*& position);
    void MoveToHead(_DorPosition*& position);
    void MoveToTail(_DorPosition*& position);
    void MoveEntity(_DorPosition* position, const DorMatrix4x4& matrix, const CVelGLScope& scope);

    // Centre of the bounding box of the stored positions of the entities and groups that
    // filter lets through, divided by modelScale; (0, 0, 0) when nothing enters the box.
    void GetCenterPoint(DorVector3& centre, int filter, double modelScale) const;
    // That box itself, divided by modelScale; false (outputs untouched) when nothing enters it.
    bool GetBoundingBox(DorVector3& low, DorVector3& high, int filter, double modelScale) const;

    unsigned int AddTexture(const _DorBitmap& bitmap);
    int ChangeTexture(unsigned int name, const _DorBitmap& bitmap);
    void RemoveAllTexture();

private:
    void CopyEntitiesFrom(const CVelGLStructure& other);
};

// Pixel-count limits of the texture list: AddTexture takes up to 512 x 512 pixels,
// ChangeTexture only up to 256 x 256.
const unsigned int VelAddTextureLimit = 0x40000;
const unsigned int VelChangeTextureLimit = 0x10000;

// Whether bitmap can become a texture: 1, 24 or 32 bits per pixel, a pixel count (width x height
// as an unsigned product) that is a power of two from 2 to maxPixels, and pixel rows that are
// all present in bits.
bool VelTextureAcceptable(const _DorBitmap& bitmap, unsigned int maxPixels);
// Whether bits holds every pixel row that the header of bitmap describes.
bool VelTexturePixelsPresent(const _DorBitmap& bitmap);

// Whether every one of count indices names one of vertexCount vertices.
bool VelIndicesInRange(const unsigned int* indices, int count, int vertexCount);
