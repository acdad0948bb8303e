#pragma once
/// @file
/// CVelGLKarvel, the OpenGL modeller.
//
// The store operations are in vel_gl_karvel.cpp, context lifecycle in wgl_karvel.cpp, the frame
// in gl_draw.cpp.
#include "../gl/vel_gl_context.h"
#include "../gl/vel_gl_render_state.h"
#include "../gl/vel_gl_store.h"
#include "../gl/vel_karvel.h"

/// The OpenGL modeller, the one implementation of CVelKarvel: it renders its entity store into
/// one device context at a time through OpenGL 1.1. Every call comes on the thread that
/// initialised it, while its context is current (nothing but Initialize, SetCurrent and ToBitmap
/// makes a context current). Construct one per view.
///
/// Lifecycle: constructed (the store works, nothing is drawn, camera, light, viewport and cull
/// operations do nothing) -> Initialize -> live -> Finalize (or the destructor) -> constructed
/// with an empty model. The texture list survives every step. The first Initialize empties the
/// model: add entities after it, textures before it.
///
/// The data members are public for the library's own layout and tests; hosts use the
/// operations (the classes of the members are not exported from the DLL).
class KARVEL_API CVelGLKarvel : public CVelKarvel {
public:
    CVelGLStructure model;  ///< The entities, the texture list and the offset; owned.
    CVelGLRenderState* renderState;  ///< Null until the first Initialize and after Finalize; owned.
    CVelGLContext context;  ///< The OpenGL context and the background colour.
    double modelScale;  ///< 1; camera, light positions and offset are kept multiplied by it.

    /// Constructed: an empty model, no context; no OpenGL call is made.
    CVelGLKarvel();
    /// A copy takes the model, textures, background and scale, and starts uninitialised.
    CVelGLKarvel(const CVelGLKarvel& other);
    /// Finalizes this modeller, then takes other's model, textures, background and scale;
    /// uninitialised afterwards.
    CVelGLKarvel& operator=(const CVelGLKarvel& other);
    /// Finalize: deletes the entities, the render state and the context; frees the textures.
    ~CVelGLKarvel() override;

    int Initialize(HDC& dc, _VelViewport viewport) override;
    int Initialize(HDC& dc) override;
    void Finalize() override;
    HDC SetCurrent(HDC& dc) override;
    HDC GetCurrent() override;
    void RemoveShapeAt(_DorPosition*& position) override;
    void RemoveShapeAll() override;
    void MoveDepthToTail(_DorPosition*& position) override;
    void MoveDepthToHead(_DorPosition*& position) override;
    CDorArray<long, long>* GetFreeProperty(_DorPosition*& position) override;
    void GetCenterPoint(DorVector3& centre, int filter) override;
    void SetOffset(DorVector3& offset) override;
    // Picking (gl_pick.cpp): the pickable entities under a 5 x 5 pixel square around x, y (y from
    // the top), nearest first; hidden ones count too. It renders into the back buffer, so
    // nothing shows until the next frame.
    void HitTest(HDC dc, int x, int y, CDorArray<_VelSelect, _VelSelect&>& hits) override;
    // The model point under x, y at window depth 0 (near plane) .. 1 (far plane).
    void GetDepthToPoint3(HDC dc, int x, int y, double& depth, DorVector3& point) override;
    void DrawModel(HDC& dc) override;
    void DeviceSetting() override;
    void GetBkColor(DorColorValue& colour) override;
    void SetBkColor(DorColorValue& colour) override;
    // Capture (wgl_capture.cpp): the whole view rendered once at the rectangle's size (its
    // position is not used) into a 24-bit bitmap. The context visits a memory bitmap and is then
    // created again on the window, which also resets both viewports to the window's. A size of
    // zero, or one the GL implementation cannot render, gives an empty bitmap (width and height
    // 0, no pixels) and leaves the context alone.
    void ToBitmap(_DorBitmap& bitmap, _DORRECT& rect) override;
    void SetCullMode(int mode) override;
    int GetCullMode() override;
    void GetCamera(_VelCamera& camera) override;
    void SetCamera(const _VelCamera& camera) override;
    // Fit-all: the camera keeps its direction of view and is placed to show the bounding box of
    // what GetCenterPoint(filter) counts: _Low fits the box's sphere (CVelMathCamera::
    // FitViewToSphere), _Hi the box's projected corners (FitViewToBox). An empty model, or no
    // render state, leaves the camera alone. Nothing is drawn.
    void SetCameraForAllView_Low(int filter) override;
    void SetCameraForAllView_Hi(int filter) override;
    void GetViewport(_VelViewport& viewport) override;
    void SetViewport(_VelViewport& viewport) override;
    void ResetViewport() override;
    void GetLight(int index, DorLight& light) override;
    void SetLight(int index, DorLight light) override;
    _DorPosition* AddPrimitive(CVelPrimitive& primitive) override;
    void ChangePrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags) override;
    void GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags) override;
    unsigned int AddTexture(_DorBitmap& bitmap) override;
    int ChangeTexture(unsigned int name, _DorBitmap& bitmap) override;
    void RemoveAllTexture() override;
    CDorArray<_DorBitmap, _DorBitmap&>* GetTextureList() override;

    /// Transforms the entity's stored vertices by matrix in place (row vectors, translation in
    /// row 3, model units): normals turn without translation and are renormalised. Hides
    /// CVelKarvel::MoveShape, which also translates normals. A handle that is not live is refused.
    void MoveShape(_DorPosition* position, DorMatrix4x4& matrix);
    /// The entity's DrawMode, or -1 for a handle that is not live.
    long GetDrawMode(_DorPosition*& position);
    /// Sets the entity's DrawMode (value 1 hidden, 2 pickable); a handle that is not live is refused.
    void SetDrawMode(_DorPosition*& position, long mode);

protected:
    // Pieces of a frame, for every pass that renders the model (drawing, picking, capture).
    // All of them need the render state and the context current.
    /// Context start-up: device hook, lights, fixed state, both viewports read back.
    void StartUpContext();
    /// Generates texture names 1..n for the texture list and uploads the images.
    void UploadTextures();
    /// Sets the camera's aspect ratio from the viewport in force (kept for a height of 0).
    void FollowViewportAspect();
    /// Camera projection and view, the model offset, lights, line and colour resets, cull mode.
    void SetUpScene();
    /// The camera's view less the model offset, on a fresh modelview matrix.
    void LoadViewingTransform();
    /// Two-sided mode turns culling off and lights both sides; otherwise back faces are culled.
    void ApplyCullMode();
    /// Culling on and the vertex and normal arrays enabled, as every entity pass needs.
    void BeginEntityPass();
    /// Draws the entity's groups in order.
    void DrawEntity(const CVelGLEntity& entity);
    /// Draws one group with its material, line width, texture and depth-write rule.
    void DrawGroup(const CVelGLTrianglePolygons& group);

private:
    // Checked mode: reports operation when called from another thread than the initialising one
    // (no report before Initialize); CheckDrawing also when the modeller's context is not the
    // current one.
    void CheckThread(const char* operation) const;
    void CheckDrawing(const char* operation) const;
    // The re-creation of the context on dc shared by both Initialize forms; viewport may be null.
    int InitializeOn(HDC dc, const _VelViewport* viewport);
    void DrawArrays(const CVelGLTrianglePolygons& group);
    void DrawImmediate(const CVelGLTrianglePolygons& group);
};
