#pragma once
// CVelKarvel: the modeller interface through which a host drives the library. The order of the
// virtual operations is part of the binary interface: never reorder or insert.
// The /* n */ comments number declarations, not virtual table slots. Compilers lay slots out
// differently: Microsoft's puts overloads in reverse declaration order (Initialize(HDC&) comes
// before Initialize(HDC&, _VelViewport)) and gives the destructor one slot, GCC's two.
// scripts/msabi/CVelKarvel.vftable pins Microsoft's layout and scripts/check-msabi.sh checks it.
// Every operation runs on the thread that initialised the modeller (OpenGL contexts are bound to
// a thread); the library takes no locks.
#include "camera/vel_camera.h"
#include "model/dor_types.h"
#include "model/export.h"
#include "model/platform.h"
#include "model/vel_primitive.h"

class CDorShape;

// One hit of HitTest.
struct _VelSelect {
    _DorPosition* position;  // the hit entity
    double depth;            // minimum window depth, 0 (near) .. 1 (far)
};

class KARVEL_API CVelKarvel {
public:
    CVelKarvel() {}
    CVelKarvel(const CVelKarvel&) {}
    CVelKarvel& operator=(const CVelKarvel&) { return *this; }

    /* 0 */ virtual ~CVelKarvel();
    /* 1 */ virtual int Initialize(HDC& dc, _VelViewport viewport) = 0;
    /* 2 */ virtual int Initialize(HDC& dc) = 0;
    /* 3 */ virtual void Finalize() = 0;
    /* 4 */ virtual HDC SetCurrent(HDC& dc);
    /* 5 */ virtual HDC GetCurrent();
    /* 6 */ virtual void RemoveShapeAt(_DorPosition*& position) = 0;
    /* 7 */ virtual void RemoveShapeAll() = 0;
    /* 8 */ virtual void MoveDepthToTail(_DorPosition*& position);
    /* 9 */ virtual void MoveDepthToHead(_DorPosition*& position);
    /* 10 */ virtual CDorArray<long, long>* GetFreeProperty(_DorPosition*& position) = 0;
    /* 11 */ virtual void GetCenterPoint(DorVector3& centre, int filter);
    /* 12 */ virtual void SetOffset(DorVector3& offset);
    /* 13 */ virtual void HitTest(HDC dc, int x, int y, CDorArray<_VelSelect, _VelSelect&>& hits);
    /* 14 */ virtual void GetDepthToPoint3(HDC dc, int x, int y, double& depth, DorVector3& point);
    /* 15 */ virtual void DrawModel(HDC& dc);
    /* 16 */ virtual void DeviceSetting();
    /* 17 */ virtual void GetBkColor(DorColorValue& colour);
    /* 18 */ virtual void SetBkColor(DorColorValue& colour);
    /* 19 */ virtual void ToBitmap(_DorBitmap& bitmap, _DORRECT& rect);
    /* 20 */ virtual void SetCullMode(int mode);
    /* 21 */ virtual int GetCullMode();
    /* 22 */ virtual void GetCamera(_VelCamera& camera);
    /* 23 */ virtual void SetCamera(const _VelCamera& camera);
    /* 24 */ virtual void SetCameraForAllView_Low(int filter);
    /* 25 */ virtual void SetCameraForAllView_Hi(int filter);
    /* 26 */ virtual void PanTilt(double pan, double tilt);
    /* 27 */ virtual void Dolly(double forward, double left, double up, int eyeOnly);
    /* 28 */ virtual void Fly(double forward, double right, double up, int eyeOnly);
    /* 29 */ virtual void RoundDolly(double elevation, double azimuth);
    /* 30 */ virtual int ViewportZoom(DorVector2 corner0, DorVector2 corner1);
    /* 31 */ virtual void ApproachCamera(DorVector2 point, double height, int useDepth);
    /* 32 */ virtual void GetViewport(_VelViewport& viewport);
    /* 33 */ virtual void SetViewport(_VelViewport& viewport);
    /* 34 */ virtual void ResetViewport();
    /* 35 */ virtual void GetLight(int index, DorLight& light);
    /* 36 */ virtual void SetLight(int index, DorLight light);
    /* 37 */ virtual _DorPosition* AddPrimitive(CVelPrimitive& primitive);
    /* 38 */ virtual void ChangePrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags);
    /* 39 */ virtual void GetPrimitive(_DorPosition* position, CVelPrimitive& primitive, long flags);
    /* 40 */ virtual unsigned int AddTexture(_DorBitmap& bitmap);
    /* 41 */ virtual int ChangeTexture(unsigned int name, _DorBitmap& bitmap);
    /* 42 */ virtual void RemoveAllTexture();
    /* 43 */ virtual CDorArray<_DorBitmap, _DorBitmap&>* GetTextureList();

    // Built on the virtual operations above, so they work for any modeller.
    _DorPosition* AddShape(CDorShape& shape);
    void ChangeShape(_DorPosition* position, CDorShape& shape);
    void ShapeToPrimitive(const CDorShape& shape, CVelPrimitive& primitive);
    void ChangeMaterial(_DorPosition* position, _DorMaterial& material);
    void MoveShape(_DorPosition* position, DorMatrix4x4& matrix);
    long GetDrawMode(_DorPosition*& position);
    void SetDrawMode(_DorPosition*& position, long mode);
    _DorPosition* HitTestS(HDC dc, int x, int y);
    void GetDepthToPoint3_Hi(HDC dc, _DorPosition* target, int x, int y, double& depth, DorVector3& point);
    // Glides the camera from `from` to `to` over duration milliseconds, drawing on dc.
    void AnimationCamera(_VelCamera from, _VelCamera to, double duration, HDC dc);
    // Fit-all with a glide: the camera that SetCameraForAllView_Hi(filter) computes is reached
    // over duration milliseconds of AnimationCamera on dc, then set exactly and drawn once more.
    // When the fit leaves the camera as it is (an empty model) nothing is drawn.
    void KarvelAllmodelView(HDC dc, int filter, double duration);
    // The same after returning to the reset viewport (applied, with the camera's aspect ratio),
    // which undoes every ViewportZoom.
    void KarvelAllmodelView_vp(HDC dc, int filter, double duration);
};
