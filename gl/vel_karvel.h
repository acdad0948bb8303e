#pragma once
/// @file
/// CVelKarvel, the modeller interface through which a host drives the library.
///
/// Conventions of every modeller operation:
/// - Thread: every call comes on the thread that called Initialize (or SetCurrent) last, while
/// the modeller's context is current there; nothing but Initialize, SetCurrent and ToBitmap
/// makes a context current. OpenGL contexts are bound to a thread and the library takes no
/// locks. With two modellers on one thread, switch between them with SetCurrent; an operation
/// on a modeller whose context is not current draws into whichever context is.
/// - Units: model units (double) for geometry, cameras, lights and offsets; degrees for angles;
/// window pixels with y counted from the top for cursor positions (x, y and DorVector2 points).
/// - Failure: an int result (1 success, 0 failure) where there is one, otherwise the call
/// silently does nothing; a refused camera move leaves the camera untouched. The library
/// throws no exceptions of its own (allocation failure aside) and writes no log.
/// - Ownership: the host owns everything it passes in (shapes, primitives, bitmaps, records) and
/// keeps it after the call; the modeller copies what it keeps. Pointers the modeller returns
/// (GetFreeProperty, GetTextureList) point into its own storage: valid until the entity or the
/// texture list goes, never freed by the host.
/// - Handles: entities are addressed by the _DorPosition* returned by AddPrimitive/AddShape. A
/// handle that is not live in this modeller (null, removed, emptied by RemoveShapeAll or Finalize,
/// another modeller's, never issued) is refused by every operation that takes one, without being
/// dereferenced: the operation does nothing or returns its failure value (GetDrawMode -1,
/// GetFreeProperty null). Node addresses are reused, so a removed entity's handle can become
/// live again as the handle of a later entity, and then addresses that entity: drop handles
/// when their entities go.
/// - Misuse: where the modeller can refuse a call without changing a documented result it does
/// (the failure value, state untouched); the reference of each operation says what it refuses.
/// SetCheckedMode reports misuse while a host is in development.
/// - Drawing: nothing redraws by itself except DrawModel and the glides (AnimationCamera,
/// KarvelAllmodelView, KarvelAllmodelView_vp); after a change, the host calls DrawModel.
/// - Operations that need a live modeller (camera, lights, viewport, cull mode, drawing,
/// picking, capture) do nothing before the first Initialize and after Finalize; getters then
/// leave their output untouched. The entity store, the texture list, the background colour and
/// the offset work at any time.
///
/// The order of the virtual operations is part of the binary interface: never reorder or insert.
/// The /* n */ comments number declarations, not virtual table slots. Compilers lay slots out
/// differently: Microsoft's puts overloads in reverse declaration order (Initialize(HDC&) comes
/// before Initialize(HDC&, _VelViewport)) and gives the destructor one slot, GCC's two.
/// scripts/msabi/CVelKarvel.vftable pins Microsoft's layout and scripts/check-msabi.sh checks it.
/// The descriptions below are those of the OpenGL modeller, CVelGLKarvel, the one
/// implementation; "Base:" says what CVelKarvel itself does for a modeller that does not
/// override the operation.
#include "../camera/vel_camera.h"
#include "../model/dor_types.h"
#include "../model/export.h"
#include "../model/platform.h"
#include "../model/vel_primitive.h"

class CDorShape;

/// Receives one report of checked mode (CVelKarvel::SetCheckedMode): a line starting "karvel: ",
/// valid during the call, and the context the host gave.
typedef void (*VelMisuseCallback)(const char* message, void* context);

/// One hit of CVelKarvel::HitTest.
struct _VelSelect {
    _DorPosition* position;  ///< The hit entity.
    double depth;            ///< Its minimum window depth, 0 (near plane) .. 1 (far plane).
};

/// The abstract modeller: a model of entities drawn into one window through OpenGL. A host
/// constructs a CVelGLKarvel per view, calls Initialize with the view's DC, adds shapes and
/// primitives, moves the camera and calls DrawModel. See the file's conventions (thread, units,
/// failure, ownership).
class KARVEL_API CVelKarvel {
public:
    /// @{
    /// The interface holds no data: construction and copies do nothing.
    CVelKarvel() {}
    CVelKarvel(const CVelKarvel&) {}
    CVelKarvel& operator=(const CVelKarvel&) { return *this; }
    ///@}

    /// Nothing to free in the interface.
    /* 0 */ virtual ~CVelKarvel();
    /// Initialize(HDC&) with viewport (window pixels, OpenGL's bottom-up y) applied instead of the
    /// one the new context starts with; it also becomes the viewport ResetViewport returns to.
    /* 1 */ virtual int Initialize(HDC& dc, _VelViewport viewport) = 0;
    /// Makes the modeller render into dc: chooses and sets a double-buffered RGBA pixel format (24
    /// colour and 24 depth bits), creates the OpenGL context, makes it current on this thread and
    /// sets up the fixed state. The texture list is uploaded and the camera's aspect follows the
    /// viewport. Give the window its own DC (CS_OWNDC) and keep it: the modeller keeps rendering
    /// into it.
    ///
    /// The first call (or the first after Finalize) empties the model: add entities after it.
    /// Textures survive. A later call moves a live modeller to dc keeping model, textures, camera
    /// and lights (as SetCurrent does).
    ///
    /// Returns 1 as implemented, even when the pixel format or the context could not be made: check
    /// GetCurrent() != NULL to know that a context exists (both forms, on the first call and on a
    /// move; this result is kept as it is, not refused). Pure in the base.
    /* 2 */ virtual int Initialize(HDC& dc) = 0;
    /// Destroys every entity (textures are kept), drops camera, lights and viewport, and releases
    /// and deletes the context. Safe to call repeatedly and before Initialize; the destructor calls
    /// it. Every handle is invalid afterwards. Pure in the base.
    /* 3 */ virtual void Finalize() = 0;
    /// Moves a live modeller to another window's dc: when dc is not the calling thread's current
    /// DC, re-initialises on it with the current viewport, keeping model, textures, camera and
    /// lights, and returns the DC that was current before. Returns dc and does nothing when dc is
    /// already current or the modeller was never initialised. Base: returns dc.
    /* 4 */ virtual HDC SetCurrent(HDC& dc);
    /// The calling thread's current DC (wglGetCurrentDC), or null without a context. Base: null.
    /* 5 */ virtual HDC GetCurrent();
    /// Removes and deletes the entity and sets position to null; a handle that is not live is
    /// refused (left as it is, nothing removed). Pure in the base.
    /* 6 */ virtual void RemoveShapeAt(_DorPosition*& position) = 0;
    /// Removes and deletes every entity; textures are kept. Every handle is invalid afterwards.
    /// Pure in the base.
    /* 7 */ virtual void RemoveShapeAll() = 0;
    /// Moves the entity to the end of the drawing order (drawn last: how transparent entities go
    /// after opaque ones) and writes its handle back; always use the handle as written back. A
    /// handle that is not live is refused and left as it is. Base: nothing.
    /* 8 */ virtual void MoveDepthToTail(_DorPosition*& position);
    /// Moves the entity to the start of the drawing order (drawn first); as MoveDepthToTail. Base:
    /// nothing.
    /* 9 */ virtual void MoveDepthToHead(_DorPosition*& position);
    /// The entity's list of integers for the host's own use (the library never reads it), owned by
    /// the entity and valid until it is removed; null for a handle that is not live. Pure in the
    /// base.
    /* 10 */ virtual CDorArray<long, long>* GetFreeProperty(_DorPosition*& position) = 0;
    /// Writes into centre (x, y, z; model units) the centre of the axis-aligned box of the stored
    /// vertex positions; (0, 0, 0) for an empty box. Entities whose DrawMode has value 1 (hidden)
    /// or 4 set are left out; filter leaves out groups: 1 points, 2 separate lines (line strips
    /// still count), 4 every group, 8 transparent groups (diffuse alpha below 1). Base: nothing.
    /* 11 */ virtual void GetCenterPoint(DorVector3& centre, int filter);
    /// The model offset (model units): the whole scene is drawn, picked and un-projected translated
    /// by -offset. Base: nothing.
    /* 12 */ virtual void SetOffset(DorVector3& offset);
    /// Fills hits with the pickable entities (DrawMode value 2 set; hidden ones count too) under a
    /// 5 x 5 pixel square around x, y (window pixels, y from the top), nearest first. hits is sized
    /// to the hit count; with no hit it is left untouched. Renders into the back buffer, so call it
    /// between frames: nothing shows until the next DrawModel. More than about 128 hits overflow
    /// the selection buffer and give none. dc is not used. Base: nothing.
    /* 13 */ virtual void HitTest(HDC dc, int x, int y, CDorArray<_VelSelect, _VelSelect&>& hits);
    /// Writes into point the model point under x, y (window pixels, y from the top) at the window
    /// depth given in depth: 0 the near plane, 1 the far plane. depth is an input and is only read
    /// (take it from a HitTest hit); the library reads no depth buffer. point is left as it was
    /// when the point cannot be un-projected. dc is not used. Base: nothing.
    /* 14 */ virtual void GetDepthToPoint3(HDC dc, int x, int y, double& depth, DorVector3& point);
    /// Draws one frame on dc and swaps buffers: clears to the background colour, sets camera and
    /// lights, draws every visible entity (DrawMode value 1 clear) in list order, with culling of
    /// back faces. Not sorted by depth: a transparent group (diffuse alpha below 1) is drawn
    /// without depth writes, so draw transparent entities last (MoveDepthToTail). Call it on
    /// WM_PAINT and after every change. Base: nothing.
    /* 15 */ virtual void DrawModel(HDC& dc);
    /// Hook called at the start of every context start-up and capture, for a derived modeller to
    /// adjust the device; does nothing here. Base: nothing.
    /* 16 */ virtual void DeviceSetting();
    /// Copies the background colour (default opaque black) into colour. Base: nothing.
    /* 17 */ virtual void GetBkColor(DorColorValue& colour);
    /// Sets the background colour; frames clear to its red, green and blue (alpha ignored). Needs
    /// no context. Base: nothing.
    /* 18 */ virtual void SetBkColor(DorColorValue& colour);
    /// Renders the whole view once into bitmap, 24 bits, |left - right| x |top - bottom| pixels of
    /// rect (window pixels; only the size is used, the whole view is scaled to it). bitmap's
    /// previous contents are replaced; the host owns it. The context visits a memory bitmap and is
    /// then created again on the window's DC: textures are uploaded again and both viewports are
    /// reset to the window's, so a ViewportZoom is undone and not captured. A size of 0, or one the
    /// OpenGL implementation cannot render, gives an empty bitmap (width and height 0, no pixels)
    /// and leaves the context alone. Call it while the modeller's window DC is current. Base:
    /// nothing.
    /* 19 */ virtual void ToBitmap(_DorBitmap& bitmap, _DORRECT& rect);
    /// 0 culls back faces; any other value turns on two-sided lighting (entities stay culled).
    /// Base: nothing.
    /* 20 */ virtual void SetCullMode(int mode);
    /// The cull mode; 0 without a context. Base: 1.
    /* 21 */ virtual int GetCullMode();
    /// Copies the modeller's camera into camera. Base: nothing.
    /* 22 */ virtual void GetCamera(_VelCamera& camera);
    /// Stores camera; ignored whole when its eye and target are closer than 0.0001. Issues no
    /// OpenGL call. Base: nothing.
    /* 23 */ virtual void SetCamera(const _VelCamera& camera);
    /// Fit-all: keeps the direction of view and places the camera so that the box of what
    /// GetCenterPoint(filter) counts fills the view, its bounding sphere touching the narrower
    /// field of view. An empty model leaves the camera alone. Base: nothing.
    /* 24 */ virtual void SetCameraForAllView_Low(int filter);
    /// Fit-all as SetCameraForAllView_Low, tighter: the box's projected corners touch the edge of
    /// the view. Base: nothing.
    /* 25 */ virtual void SetCameraForAllView_Hi(int filter);
    /// CVelMathCamera::PanTilt on the modeller's camera. Same for every modeller.
    /* 26 */ virtual void PanTilt(double pan, double tilt);
    /// CVelMathCamera::Dolly on the modeller's camera. Same for every modeller.
    /* 27 */ virtual void Dolly(double forward, double left, double up, int eyeOnly);
    /// CVelMathCamera::Fly on the modeller's camera. Same for every modeller.
    /* 28 */ virtual void Fly(double forward, double right, double up, int eyeOnly);
    /// CVelMathCamera::RoundDolly (degrees: elevation first) on the modeller's camera. Same for
    /// every modeller.
    /* 29 */ virtual void RoundDolly(double elevation, double azimuth);
    /// Rubber-band zoom: enlarges and shifts the viewport so that the rectangle from corner0
    /// (top-left) to corner1 (bottom-right), in window pixels with y down, fills the window; the
    /// camera does not move. Returns 1, or 0 with nothing changed (a rectangle without width or
    /// height, or more than 5 times magnification). ResetViewport followed by SetViewport undoes
    /// every zoom. Same for every modeller.
    /* 30 */ virtual int ViewportZoom(DorVector2 corner0, DorVector2 corner1);
    /// Click-to-approach at point (window pixels, y down). With useDepth non-zero and a pickable
    /// entity under point, the eye moves forward along the view so that things at the picked depth
    /// grow by viewport height / height (pixels); the target stays. Otherwise the view turns toward
    /// half the pointed offset from the centre, the eye staying. Same for every modeller.
    /* 31 */ virtual void ApproachCamera(DorVector2 point, double height, int useDepth);
    /// Copies the viewport in force into viewport. Base: nothing.
    /* 32 */ virtual void GetViewport(_VelViewport& viewport);
    /// Applies viewport (window pixels, OpenGL's bottom-up y) at once and sets the camera's aspect
    /// to its width / height. Base: nothing.
    /* 33 */ virtual void SetViewport(_VelViewport& viewport);
    /// Returns the viewport record to the one the context started with, undoing ViewportZoom. Only
    /// the record: the OpenGL viewport and the camera's aspect change at the next SetViewport or
    /// Initialize, so a host calls SetViewport(GetViewport()) after it (KarvelAllmodelView_vp
    /// does). Base: nothing.
    /* 34 */ virtual void ResetViewport();
    /// Copies light index (0..7) into light: position in model units, direction as the unit vector
    /// it shines along. Other indices leave light untouched. Base: nothing.
    /* 35 */ virtual void GetLight(int index, DorLight& light);
    /// Sets light index (0..7); other indices do nothing. The direction is normalised; it takes
    /// effect at the next frame. Light 0 (on by default) follows the camera: every frame puts it at
    /// the eye shining along the view, so only its colours, kind, switch and attenuation can be
    /// set. Base: nothing.
    /* 36 */ virtual void SetLight(int index, DorLight light);
    /// Copies primitive into a new entity at the end of the drawing order and returns its handle.
    /// The host keeps (and destroys) its own primitive. Base: null.
    /* 37 */ virtual _DorPosition* AddPrimitive(CVelPrimitive& primitive);
    /// Updates the entity at position from primitive, the parts that flags select (VelChangeFlag;
    /// 31 = all): 1 geometry, 2 material and render kind, 4 group type, indices and line width, 8
    /// texture, 16 DrawMode. Groups match by index; with flag 1 and another group count the entity
    /// is converted anew. A handle that is not live is refused. Base: nothing.
    /* 38 */ virtual void ChangePrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags);
    /// Rebuilds primitive from the entity (its groups are replaced; pass a fresh one): the parts
    /// flags select (as ChangePrimitive), the others at their defaults; flag 16 copies DrawMode.
    /// Values come back from single precision. A handle that is not live is refused, primitive
    /// left as it was. Base: nothing.
    /* 39 */ virtual void GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags);
    /// Stores a copy of bitmap as a texture and returns its name (1, 2, ...: its place in the
    /// list), or 0 when refused: 1, 24 or 32 bits per pixel, width x height a power of two from 2
    /// to 262,144 pixels (512 x 512; 2 x 8 is fine), every pixel row present. The image reaches
    /// OpenGL at the next Initialize or SetCurrent only, so add textures before Initialize. Base:
    /// 0.
    /* 40 */ virtual unsigned int AddTexture(_DorBitmap& bitmap);
    /// Replaces texture name with a copy of bitmap under the rules of AddTexture but up to 65,536
    /// pixels (256 x 256); returns 1, or 0 when refused or name is unknown. Takes effect at the
    /// next Initialize or SetCurrent. Base: 0.
    /* 41 */ virtual int ChangeTexture(unsigned int name, _DorBitmap& bitmap);
    /// Empties the texture list; the next AddTexture returns 1 again. Base: nothing.
    /* 42 */ virtual void RemoveAllTexture();
    /// The texture list itself, owned by the modeller: read it, do not keep the pointer across
    /// RemoveAllTexture. Base: null.
    /* 43 */ virtual CDorArray<_DorBitmap, _DorBitmap&>* GetTextureList();

    // Built on the virtual operations above, so they work for any modeller.
    /// Converts shape (CVelShapeToPrimitive) and adds it as one entity: AddPrimitive of the result.
    /// Only extrusions produce groups; solid extrusions may reorder their profiles' points in
    /// place. The host keeps the shape. Refuses (null, nothing added) a shape with a NaN or
    /// infinite point or texture vector in one of its extrusions.
    _DorPosition* AddShape(CDorShape& shape);
    /// Converts shape and replaces the whole entity with it (ChangePrimitive, flags 31). A shape
    /// that AddShape refuses leaves the entity as it was.
    void ChangeShape(_DorPosition* position, CDorShape& shape);
    /// Appends the groups of shape to primitive, without touching the model. A shape that
    /// AddShape refuses leaves primitive as it was.
    void ShapeToPrimitive(const CDorShape& shape, CVelPrimitive& primitive);
    /// Gives every group of the entity material; a handle that is not live is refused.
    void ChangeMaterial(_DorPosition* position, _DorMaterial& material);
    /// Transforms the entity's vertices by matrix (row vectors, translation in row 3) through
    /// GetPrimitive/ChangePrimitive: normals go through the full matrix, translation included, then
    /// are renormalised. CVelGLKarvel::MoveShape (same name, not virtual) turns normals without
    /// translation: call it on the CVelGLKarvel to get that. A handle that is not live is refused.
    void MoveShape(_DorPosition* position, DorMatrix4x4& matrix);
    /// The entity's DrawMode (value 1 hidden, 2 pickable), or -1 for a handle that is not live.
    long GetDrawMode(_DorPosition*& position);
    /// Sets the entity's DrawMode; a handle that is not live is refused.
    void SetDrawMode(_DorPosition*& position, long mode);
    /// The nearest pickable entity under x, y (HitTest's first hit), or null.
    _DorPosition* HitTestS(HDC dc, int x, int y);
    /// GetDepthToPoint3 with more precision on target: a first estimate at depth (an input), then a
    /// second pick with the clip range narrowed to 1000 model units either side of it; point gets
    /// the un-projection at target's hit depth, or the first estimate when target is not under x,
    /// y. The camera is restored afterwards.
    void GetDepthToPoint3_Hi(HDC dc, _DorPosition* target, int x, int y, double& depth, DorVector3& point);
    /// Glides the camera from `from` to `to` over duration milliseconds, drawing on dc
    /// (CVelMathCamera::AnimationCamera_Sec): blocks this thread and stops a frame short of `to`.
    void AnimationCamera(_VelCamera from, _VelCamera to, double duration, HDC dc);
    /// Fit-all with a glide: the camera that SetCameraForAllView_Hi(filter) computes is reached
    /// over duration milliseconds of AnimationCamera on dc, then set exactly and drawn once more.
    /// When the fit leaves the camera as it is (an empty model) nothing is drawn. A camera that
    /// holds inf or NaN is never glided from: the fit, if it finds one, is set and drawn once;
    /// otherwise nothing is drawn.
    void KarvelAllmodelView(HDC dc, int filter, double duration);
    /// The same after returning to the reset viewport (applied, with the camera's aspect ratio),
    /// which undoes every ViewportZoom.
    void KarvelAllmodelView_vp(HDC dc, int filter, double duration);

    /// Checked mode, for hosts in development: off by default (on from the start in a library
    /// built with -DKARVEL_CHECKED=ON). While on, every misuse the library can see is reported as
    /// one line through OutputDebugStringA and to callback (when not null) with context: a change
    /// of the model, the camera or the viewport, drawing, picking or capture from a thread other
    /// than the one that initialised the modeller; drawing, picking or capture while no context
    /// or another one than the modeller's is current; a handle that is not live
    /// in the modeller; a shape with a non-finite coordinate, or a non-finite camera given to
    /// SetCamera; a texture that will not reach OpenGL (added or changed while live, so waiting
    /// for the next Initialize, or refused by the upload). Every result is the same on and off.
    /// Process-wide: set it before the modellers are used. on 0 turns it off.
    static void SetCheckedMode(int on, VelMisuseCallback callback, void* context);
};
