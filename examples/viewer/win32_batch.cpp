// Batch use: a hidden window of the requested size holds the context; pictures come from
// ToBitmap at that size.
#include <io.h>

#include <cstdio>

#include "movie/vfw_math_movie.h"
#include "png_file.h"
#include "viewer_controls.h"
#include "win32_model_view.h"
#include "win32_viewer.h"

namespace {
int Fail(const std::string& message)
{
    std::fprintf(stderr, "karvel_viewer: %s\n", message.c_str());
    return 1;
}

int WriteSnapshot(ModelView& view, const ViewerOptions& options)
{
    _DorBitmap bitmap;
    if (!view.Capture(options.width, options.height, bitmap))
        return Fail("the capture (ToBitmap) returned no " + std::to_string(options.width) + "x" +
                    std::to_string(options.height) + " picture");
    if (!WritePng(options.snapshot, bitmap))
        return Fail("cannot write " + options.snapshot);
    std::printf("snapshot %s (%dx%d)\n", options.snapshot.c_str(), options.width, options.height);
    return 0;
}

int PrintPick(ModelView& view, const ViewerOptions& options)
{
    DorVector3 point;
    _DorPosition* nearest = nullptr;
    std::vector<PickedEntity> hits = view.Pick(options.pickX, options.pickY, point, nearest);
    for (const std::string& line : DescribePick(options.pickX, options.pickY, hits, point))
        std::printf("%s\n", line.c_str());
    return 0;
}

// One turn about the camera's target, a frame per step, each captured and recorded.
int RecordOrbit(ModelView& view, const ViewerOptions& options)
{
    CVelMathMovie_NoComp recorder;
    const bool terminal = _isatty(_fileno(stdout)) != 0;
    for (int frame = 0; frame < options.frames; ++frame) {
        if (frame > 0)
            view.modeller.RoundDolly(0.0, OrbitFrameAzimuth(options.frames));
        _DorBitmap bitmap;
        if (!view.Capture(options.width, options.height, bitmap))
            return Fail("the capture (ToBitmap) of frame " + std::to_string(frame + 1) + " returned no picture");
        if (frame == 0 && !recorder.Start(bitmap, options.movie.c_str(), options.fps, "karvel", options.frames))
            return Fail("cannot start recording " + options.movie);
        if (!recorder.Add(bitmap))
            return Fail("cannot record frame " + std::to_string(frame + 1) + " into " + options.movie);
        // On a terminal the line updates in place; a log gets a line per tenth.
        if (terminal)
            std::printf("\rmovie %s: frame %d/%d", options.movie.c_str(), frame + 1, options.frames);
        else if (ProgressLineDue(frame + 1, options.frames))
            std::printf("movie %s: frame %d/%d\n", options.movie.c_str(), frame + 1, options.frames);
        std::fflush(stdout);
    }
    recorder.End();
    std::printf("%smovie %s (%d frames at %d fps, %dx%d)\n", terminal ? "\n" : "", options.movie.c_str(), options.frames,
                options.fps, options.width, options.height);
    return 0;
}

int RunSteps(ModelView& view, const ViewerOptions& options)
{
    if (!options.snapshot.empty() && WriteSnapshot(view, options) != 0)
        return 1;
    if (options.pick && PrintPick(view, options) != 0)
        return 1;
    if (!options.movie.empty() && RecordOrbit(view, options) != 0)
        return 1;
    return 0;
}
}  // namespace

int RunBatch(const ViewerOptions& options, Scene& scene)
{
    HWND window = CreateViewWindow(nullptr, options.width, options.height, nullptr, nullptr);
    if (!window)
        return Fail("cannot create a window");
    int status;
    {
        ModelView view(window);
        status = view.Start(scene) ? RunSteps(view, options) : Fail("no OpenGL context on the window");
    }
    DestroyWindow(window);
    return status;
}
