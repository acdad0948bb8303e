// Checked mode on a live modeller: each misuse the library can see is reported to the host's
// callback, once, and nothing is reported with the mode off.
#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include "convert/dor_shape.h"
#include "support/gl_live_modeller.h"

namespace {
void Collect(const char* message, void* reports) { static_cast<std::vector<std::string>*>(reports)->push_back(message); }
}  // namespace

TEST_F(LiveModeller, CheckedModeReportsEachMisuseOnce)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    _DorPosition* removed = Add(Rectangle(0, 0, 1, 1, 0, Matte(1, 0, 0)));
    _DorPosition* alias = removed;
    karvel.RemoveShapeAt(alias);
    CDorExtruded box(CDorPolygon({{0, 0, 0}, {1, 0, 0}, {1, 1, nan}, {0, 1, 0}}), DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&box);
    _VelCamera camera;
    karvel.GetCamera(camera);
    _DorBitmap oneBit;
    DorBitmapAllocate(oneBit, 8, 8, 1);
    CVelGLKarvel other;
    CDorArray<_VelSelect, _VelSelect&> hits;
    const struct {
        std::vector<const char*> reports;
        std::function<void()> misuse;
    } rows[] = {
        {{"not live"}, [&] { karvel.SetDrawMode(removed, 0); }},
        {{"non-finite coordinate"}, [&] { karvel.AddShape(shape); }},
        {{"non-finite camera"}, [&] { karvel.SetCamera(_VelCamera{camera.eye, camera.target, nan, 1, 100, 1}), LookAlongY(karvel); }},
        {{"SetCamera called from a thread other"}, [&] { std::thread([&] { LookAlongY(karvel); }).join(); }},
        {{"AddTexture while live", "texture 2 gets no image"}, [&] { karvel.AddTexture(oneBit), karvel.Initialize(window.dc); }},
        {{"DrawModel while the modeller's context is not current"}, [&] { other.Initialize(window.dc), karvel.DrawModel(window.dc); }},
        {{"HitTest while the modeller's context is not current"}, [&] { other.Finalize(), karvel.HitTest(window.dc, 1, 1, hits); }},
    };
    for (int on : {1, 0}) {
        std::vector<std::string> reports;
        CVelKarvel::SetCheckedMode(on, Collect, &reports);
        for (const auto& row : rows) {
            reports.clear();
            row.misuse();
            EXPECT_EQ(reports.size(), on ? row.reports.size() : 0u) << row.reports[0] << (reports.empty() ? "" : ": " + reports[0]);
            for (size_t i = 0; i < reports.size() && i < row.reports.size(); ++i)
                EXPECT_NE(reports[i].find(row.reports[i]), std::string::npos) << reports[i];
        }
        karvel.Initialize(window.dc);
    }
    CVelKarvel::SetCheckedMode(0, nullptr, nullptr);
}
