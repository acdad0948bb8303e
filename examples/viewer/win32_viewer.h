#pragma once
// The viewer's two ways of running a loaded scene. Both return the process exit code.
#include "command_line.h"
#include "scene.h"

// Renders, records and picks as the options say, printing what it did, without interaction.
int RunBatch(const ViewerOptions& options, Scene& scene);

// Opens the scene in a window and runs until the window is closed.
int RunInteractive(const ViewerOptions& options, Scene& scene);
