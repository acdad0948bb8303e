// The camera maths on any camera: moves, zoom, approach, both fits and the glides, the fit-all
// glide among them. A finite camera of moderate size stays finite; a fit to a box that is not
// finite leaves the camera as it was; the fit-all glide never animates from a camera that holds a
// non-finite number.
#include "camera/vel_camera_motion.h"
#include "camera/vel_math_camera.h"
#include "fuzz_reader.h"
#include "support/recording_karvel.h"

namespace {
_VelCamera ReadCamera(FuzzReader& r)
{
    return {r.Point(), r.Point(), r.Int(0, 3) ? r.Int(1, 179) : r.Number(), r.Int(0, 1) ? 0.1 : r.Number(),
            r.Int(0, 1) ? 1000.0 : r.Number(), r.Int(0, 1) ? 1.5 : r.Number()};
}

// SetCameraForAllView_Hi as the GL modeller does it, on a box of the fuzzer's; every camera set on
// the way, glide steps included, is finite.
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
        case 4:
            CVelMathCamera::ApproachCamera(camera, DorVector2{r.Number(), r.Number()}, r.Number(), r.Number(), r.Int(0, 1) ? 0.0 : r.Number());
            break;
        case 5:
        case 6: {
            const DorVector3 low = r.Point(), high = r.Point();
            (op == 5 ? CVelMathCamera::FitViewToSphere : CVelMathCamera::FitViewToBox)(camera, low, high);
            FUZZ_CHECK(Finite(low) && Finite(high) || SameCameraBits(camera, before));
            break;
        }
        case 7: {
            _VelViewport viewport = {r.Int(-9, 9), r.Int(-9, 9), r.Int(1, 2000), r.Int(1, 2000)};
            const int width = viewport.width;
            const DorVector2 c0{r.Number(), r.Number()}, c1{r.Number(), r.Number()};
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
            const bool glideFinite = VelCameraIsFinite(VelGlideCamera(camera, to, duration, elapsed));
            FUZZ_CHECK(glideFinite || !(finite && !r.wild && duration > 0.0 && elapsed < duration));
            camera = VelOrbitCamera(camera, r.Int(-720, 720), elapsed);
            break;
        }
        default: {
            FitKarvel karvel;
            karvel.camera = camera;
            karvel.low = r.Point();
            karvel.high = r.Point();
            karvel.KarvelAllmodelView(nullptr, 0, r.in.PickValueInArray<double>({0.0, 1.0, 2.0, -1.0, NAN, INFINITY}));
            FUZZ_CHECK(finite || karvel.drawCalls <= (VelCameraIsFinite(karvel.camera) ? 1 : 0));
            camera = karvel.camera;
        }
        }
        FUZZ_CHECK(!finite || VelCameraIsFinite(camera));
    }
    return 0;
}
