// karvel_viewer: the library's sample host. It loads a scene file completely before any window
// opens, so a scene with an error stops with one message and never shows half-drawn.
#include <cstdio>
#include <string>
#include <vector>

#include "command_line.h"
#include "scene.h"
#include "win32_viewer.h"

int main(int argc, char** argv)
{
    std::vector<std::string> args(argv + 1, argv + argc);
    ViewerOptions options;
    std::string error;
    if (!ParseCommandLine(args, options, error)) {
        std::fprintf(stderr, "karvel_viewer: %s\n%s", error.c_str(), ViewerUsage());
        return 2;
    }
    if (options.help) {
        std::printf("%s", ViewerUsage());
        return 0;
    }
    Scene scene;
    if (!LoadSceneFile(options.scene, scene, error)) {
        std::fprintf(stderr, "%s\n", error.c_str());
        return 1;
    }
    return options.Batch() ? RunBatch(options, scene) : RunInteractive(options, scene);
}
