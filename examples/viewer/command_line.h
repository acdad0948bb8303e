#pragma once
// The viewer's command line: a scene file, and for batch use any of a snapshot, an orbit movie
// and a pick, all made at one window size.
#include <string>
#include <vector>

struct ViewerOptions {
    std::string scene;
    std::string snapshot;  // PNG file; empty = none
    std::string movie;     // AVI file; empty = none
    int frames = 72;       // of the movie: one full orbit
    int fps = 24;
    bool pick = false;
    int pickX = 0, pickY = 0;  // window pixels, y downward
    int width = 800, height = 600;  // client area of the window and size of the pictures
    bool help = false;

    // Batch use runs without interaction and ends.
    bool Batch() const { return !snapshot.empty() || !movie.empty() || pick; }
};

// Parses the arguments after the program name. On failure returns false with a one-line
// message in error.
bool ParseCommandLine(const std::vector<std::string>& args, ViewerOptions& options, std::string& error);

// What --help prints.
const char* ViewerUsage();
