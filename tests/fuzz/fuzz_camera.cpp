// The camera maths on any camera: moves, zoom, approach, fit-all and the glides. A finite camera
// of moderate size stays finite; a fit to a box that is not finite leaves the camera as it was;
// the fit-all glide never animates from a camera that holds a non-finite number.
#include <cstring>

#include "camera/vel_camera_motion.h"
#include "camera/vel_math_camera.h"
#include "fuzz_reader.h"
#include "support/recording_karvel.h"

namespace {
_VelCamera ReadCamera(FuzzReader& r)
{
    _VelCamera c;
    c.eye = r.Point();
    c.target = r.Point();
    c.fovy = r.Int(0, 3) ? r.Int(1, 179) : r.Number();
    c.zNear = r.Int(0, 1) ? 0.1 : r.Number();
    c.zFar = r.Int(0, 1) ? 1000.0 : r.Number();
    c.aspect = r.Int(0, 1) ? 1.5 : r.Number();
    return c;
}

bool Same(const _VelCamera& a, const _VelCamera& b)
{
    const double x[] = {a.eye.x, a.eye.y, a.eye.z, a.target.x, a.target.y, a.target.z, a.fovy, a.zNear, a.zFar, a.aspect};
    const double y[] = {b.eye.x, b.eye.y, b.eye.z, b.target.x, b.target.y, b.target.z, b.fovy, b.zNear, b.zFar, b.aspect};
    return std::memcmp(x, y, sizeof x) == 0;
}

// SetCameraForAllView_Hi as the GL modeller does it, on a box of the fuzzer's.
class FitKarvel : public RecordingKarvel {
public:
    DorVector3 low, high;
    void SetCamera(const _VelCamera& in) override
    {
        FUZZ_CHECK(VelCameraIsFinite(in));
        RecordingKarvel::SetCamera(in);
    }
    void SetCameraForAllView_Hi(int) override
    {
        _VelCamera fitted = camera;
        CVelMathCamera::FitViewToBox(fitted, low, high);
        if (VelCameraIsFinite(fitted))
            SetCamera(fitted);
    }
};
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    FuzzReader r(data, size);
    _VelCamera camera = ReadCamera(r);
    for (int k = r.Int(1, 6); k > 0; --k) {
        const bool finite = VelCameraIsFinite(camera);
        const _VelCamera before = camera;
        const int op = r.Int(0, 9);
        switch (op) {
        case 0: CVelMathCamera::PanTilt(camera, r.Number(), r.Number()); break;
        case 1: CVelMathCamera::Dolly(camera, r.Number(), r.Number(), r.Number(), r.Int(0, 1)); break;
        case 2: CVelMathCamera::Fly(camera, r.Number(), r.Number(), r.Number(), r.Int(0, 1)); break;
        case 3: CVelMathCamera::RoundDolly(camera, r.Number(), r.Number()); break;
        case 4: {
            DorVector2 point(r.Number(), r.Number());
            CVelMathCamera::ApproachCamera(camera, point, r.Number(), r.Number(), r.Int(0, 1) ? 0.0 : r.Number());
            break;
        }
        case 5:
        case 6: {
            const DorVector3 low = r.Point(), high = r.Point();
            (op == 5 ? CVelMathCamera::FitViewToSphere : CVelMathCamera::FitViewToBox)(camera, low, high);
            FUZZ_CHECK(Finite(low) && Finite(high) || Same(camera, before));
            break;
        }
        case 7: {
            const int width = r.Int(1, 2000);
            _VelViewport viewport = {r.Int(-9, 9), r.Int(-9, 9), width, r.Int(1, 2000)};
            DorVector2 c0(r.Number(), r.Number()), c1(r.Number(), r.Number());
            if (CVelMathCamera::ViewportZoom(camera, viewport, c0, c1))  // magnifies at most 5 times
                FUZZ_CHECK(viewport.width >= 0 && viewport.width <= 5 * width);
            DorMatrix4x4 m;
            CVelMathMatrix::GetPerspectiveMatrix(camera, r.Number(), m);
            break;
        }
        case 8: {
            const _VelCamera to = ReadCamera(r);
            const double duration = r.Number();
            const unsigned int elapsed = r.in.ConsumeIntegral<unsigned int>();
            const _VelCamera glide = VelGlideCamera(camera, to, duration, elapsed);
            FUZZ_CHECK(!(finite && !r.wild && duration > 0.0 && elapsed < duration) || VelCameraIsFinite(glide));
            camera = VelOrbitCamera(camera, r.Int(-720, 720), elapsed);
            break;
        }
        default: {
            FitKarvel karvel;
            karvel.camera = camera;
            karvel.low = r.Point();
            karvel.high = r.Point();
            const double durations[] = {0.0, 1.0, 2.0, -1.0, NAN, INFINITY};
            const double duration = r.in.PickValueInArray(durations);
            karvel.KarvelAllmodelView(nullptr, 0, duration);
            FUZZ_CHECK(VelCameraIsFinite(camera) || karvel.drawCalls <= (VelCameraIsFinite(karvel.camera) ? 1 : 0));
            camera = karvel.camera;
        }
        }
        FUZZ_CHECK(!finite || VelCameraIsFinite(camera));
    }
    return 0;
}
