#pragma once
/// @file
/// The modeller's entity store: every primitive a host adds, kept as OpenGL-ready single-precision
/// arrays in an ordered list whose node addresses are the entity handles. Nothing here needs an
/// OpenGL context; drawing reads these records as they stand. The records are reachable through
/// CVelGLKarvel::model; hosts change them through the modeller's operations.
///
/// Flags of ChangePrimitive/GetPrimitive (VelChange*) select the parts of a primitive that are
/// written or read back; groups are matched by index.
#include "../model/dor_list.h"
#include "../model/dor_types.h"
#include "../model/vel_primitive.h"

class CVelGLRenderState;
class CVelGLLiveHandles;

/// The OpenGL primitive mode of a group, with the values of GL_POINTS to GL_TRIANGLE_FAN.
/// VelGLModeNone marks a group whose type was never one that OpenGL can draw.
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

/// The flags of CVelKarvel::ChangePrimitive and CVelKarvel::GetPrimitive: the parts of each group
/// (and of the entity) written or read back. With VelChangeGeometry and another group count the
/// whole primitive is converted anew.
enum VelChangeFlag {
    VelChangeGeometry = 1,   ///< Positions, normals, colours, overlay flag.
    VelChangeMaterial = 2,   ///< Material and render kind.
    VelChangeTopology = 4,   ///< Group type, element count, indices, line width.
    VelChangeTexture = 8,    ///< Texture name and coordinates.
    VelChangeDrawMode = 16,  ///< Hidden / pickable.
    VelChangeAll = 31        ///< Every part.
};

/// What an operation converting primitives works in: the vertex scale applied on the way in
/// (always 1.0) and the render state it belongs to. It makes no context current.
class CVelGLScope {
public:
    double vertexScale;  ///< Multiplies positions on the way in; always 1.0.
    CVelGLRenderState* renderState;  ///< The modeller's render state, or null; not owned.

    /// Scale 1.0 in state.
    explicit CVelGLScope(CVelGLRenderState* state = nullptr) : vertexScale(1.0), renderState(state) {}
    /// Nothing to free.
    virtual ~CVelGLScope() {}
};

/// The OpenGL copy of one CVelTrianglePolys. The float arrays always hold vertexCount vertices.
class CVelGLTrianglePolygons {
public:
    CDorArray<float, float> positions;  ///< x, y, z per vertex, model units times the vertex scale.
    CDorArray<float, float> normals;    ///< x, y, z per vertex.
    CDorArray<float, float> colours;    ///< r, g, b, a per vertex.
    CDorArray<unsigned int, unsigned int> indices;  ///< 3 per triangle, indexed groups only.
    _DorMaterial material;  ///< The group's material, word for word.
    int vertexCount;   ///< The group's vertex count.
    int elementCount;  ///< Drawn elements by the group type.
    int glMode;        ///< VelGLMode.
    int indexed;       ///< 1: drawn with glDrawElements.
    int RenderKind;    ///< VelRenderKind.
    float lineWidth;   ///< Line width and point size in pixels.
    CDorArray<float, float> texcoords;  ///< s, t per vertex.
    unsigned int texture;  ///< Texture name; 0 = none.
    int OverlayFlag;   ///< 1: drawn flat in pixel units over the scene.

    /// An empty group.
    CVelGLTrianglePolygons();
    /// Frees the arrays.
    virtual ~CVelGLTrianglePolygons() {}

    /// Replaces everything with the converted group.
    void Convert(const CVelTrianglePolys& group, double scale);
    /// Rewrites positions, normals and colours of the stored vertices from the group (as many as
    /// both hold) and takes its overlay flag; the vertex count stays.
    void RewriteGeometry(const CVelTrianglePolys& group, double scale);
    /// Material and render kind from the group.
    void ChangeMaterial(const CVelTrianglePolys& group);
    /// Mode, element count, indexed flag, indices and line width; an unknown group type keeps
    /// the mode and element count.
    void ChangeTopology(const CVelTrianglePolys& group);
    /// Texture name and the coordinates of the stored vertices (as many as the group holds).
    void ChangeTexture(const CVelTrianglePolys& group);
    /// Fills the parts of group that flags select; the others keep their defaults.
    void Restore(CVelTrianglePolys& group, long flags, double scale) const;
    /// Applies matrix to positions (translation times scale) and to normals (rotation only,
    /// renormalised), in double precision.
    void Transform(const DorMatrix4x4& matrix, double scale);

private:
    void WriteGeometry(const CVelTrianglePolys& group, int count, double scale);
};

/// One entity of the model: the OpenGL copy of a primitive.
class CVelGLEntity {
public:
    CDorArray<CVelGLTrianglePolygons, CVelGLTrianglePolygons&> groups;  ///< In drawing order.
    long DrawMode;  ///< Value 1 hidden, 2 pickable.
    CDorArray<long, long> freeProperty;  ///< The host's; never read by the library.

    /// No groups, visible and pickable.
    CVelGLEntity() : DrawMode(2) {}
    /// Frees the groups.
    virtual ~CVelGLEntity() {}

    /// Sizes the groups to the primitive's and converts every one.
    void Convert(const CVelPrimitive& primitive, double scale);
};

/// The modeller's model: the entity list, the texture list and the offset. CVelGLKarvel's
/// operations of the same names work through it.
///
/// Every handle taken is first looked up among the live ones (a hashed set, O(1)), so a handle
/// that is not live here (removed, emptied by Destroy, another model's, never issued) is refused
/// without being dereferenced. Node addresses are reused: a removed entity's handle becomes live
/// again when a later entity gets its node, and then addresses that entity.
class CVelGLStructure {
public:
    CDorList entities;  ///< Of CVelGLEntity*, owned; the list order is the drawing order.
    CDorArray<_DorBitmap, _DorBitmap&> textures;  ///< Texture name i + 1 is element i.
    DorVector3 offset;  ///< The scene is drawn translated by -offset (times the model scale).
    /// The handles of the entities in the list; owned. Behind a pointer so that the size of the
    /// modeller does not depend on the host's standard library.
    CVelGLLiveHandles* live;

    /// Empty, entity nodes allocated 10 at a time.
    CVelGLStructure();
    /// Deep copies of other's entities (new handles), textures and offset.
    CVelGLStructure(const CVelGLStructure& other);
    /// @copydoc CVelGLStructure(const CVelGLStructure&)
    CVelGLStructure& operator=(const CVelGLStructure& other);
    /// Deletes every entity and texture.
    virtual ~CVelGLStructure();

    /// Deletes every entity; textures stay.
    void Destroy();

    /// Whether position is the handle of an entity of this model (null is not).
    bool IsLive(const _DorPosition* position) const;
    /// The entity behind a handle; null for a handle that is not live here.
    CVelGLEntity* EntityAt(_DorPosition* position) const;
    /// The entity behind a handle from this model's own list walk (head to tail).
    static CVelGLEntity* ListedEntity(_DorPosition* position)
    {
        return static_cast<CVelGLEntity*>(CDorList::GetAt(position));
    }

    /// CVelKarvel::AddPrimitive.
    _DorPosition* AddPrimitive(const CVelPrimitive& primitive, const CVelGLScope& scope);
    /// CVelKarvel::ChangePrimitive.
    void ChangePrimitive(_DorPosition* position, const CVelPrimitive& primitive, long flags,
                         const CVelGLScope& scope);
    /// CVelKarvel::GetPrimitive.
    void GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags,
                      const CVelGLScope& scope) const;
    /// CVelKarvel::RemoveShapeAt.
    void RemoveAt(_DorPosition*& position);
    /// CVelKarvel::MoveDepthToHead.
    void MoveToHead(_DorPosition*& position);
    /// CVelKarvel::MoveDepthToTail.
    void MoveToTail(_DorPosition*& position);
    /// CVelGLKarvel::MoveShape.
    void MoveEntity(_DorPosition* position, const DorMatrix4x4& matrix, const CVelGLScope& scope);

    /// Centre of the bounding box of the stored positions of the entities and groups that
    /// filter lets through, divided by modelScale; (0, 0, 0) when nothing enters the box.
    void GetCenterPoint(DorVector3& centre, int filter, double modelScale) const;
    /// That box itself, divided by modelScale; false (outputs untouched) when nothing enters it.
    bool GetBoundingBox(DorVector3& low, DorVector3& high, int filter, double modelScale) const;

    /// CVelKarvel::AddTexture.
    unsigned int AddTexture(const _DorBitmap& bitmap);
    /// CVelKarvel::ChangeTexture.
    int ChangeTexture(unsigned int name, const _DorBitmap& bitmap);
    /// CVelKarvel::RemoveAllTexture.
    void RemoveAllTexture();

private:
    void CopyEntitiesFrom(const CVelGLStructure& other);
    _DorPosition* Listed(_DorPosition* position);
};

/// Pixel-count limit of CVelKarvel::AddTexture: up to 512 x 512 pixels.
const unsigned int VelAddTextureLimit = 0x40000;
/// Pixel-count limit of CVelKarvel::ChangeTexture: only up to 256 x 256.
const unsigned int VelChangeTextureLimit = 0x10000;

/// @cond KARVEL_INTERNAL
// Whether bitmap can become a texture: 1, 24 or 32 bits per pixel, a pixel count (width x height
// as an unsigned product) that is a power of two from 2 to maxPixels, and pixel rows that are
// all present in bits.
bool VelTextureAcceptable(const _DorBitmap& bitmap, unsigned int maxPixels);
// Whether bits holds every pixel row that the header of bitmap describes.
bool VelTexturePixelsPresent(const _DorBitmap& bitmap);

// Whether every one of count indices names one of vertexCount vertices.
bool VelIndicesInRange(const unsigned int* indices, int count, int vertexCount);
/// @endcond
