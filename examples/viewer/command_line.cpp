#include "command_line.h"

#include <cstdlib>

namespace {
// NOTE: Wine widens top-level windows narrower than about 160 pixels, which would change the
// picture's size; 4096 keeps a capture's DIB section well within what drivers allocate.
const int MinWidth = 160, MinHeight = 120, MaxSize = 4096;

// A whole decimal number from low to high, nothing else in the text.
bool ParseInt(const std::string& text, int low, int high, int& out)
{
    if (text.empty() || text.size() > 9)
        return false;
    for (char c : text)
        if (c < '0' || c > '9')
            return false;
    long value = std::strtol(text.c_str(), nullptr, 10);
    if (value < low || value > high)
        return false;
    out = static_cast<int>(value);
    return true;
}

// "A<sep>B" with both parts whole numbers in range.
bool ParsePair(const std::string& text, char sep, int lowA, int lowB, int high, int& a, int& b)
{
    size_t at = text.find(sep);
    return at != std::string::npos && ParseInt(text.substr(0, at), lowA, high, a) &&
           ParseInt(text.substr(at + 1), lowB, high, b);
}

bool EndsWith(const std::string& text, const char* suffix)
{
    std::string s(suffix);
    if (text.size() < s.size())
        return false;
    for (size_t i = 0; i < s.size(); ++i) {
        char c = text[text.size() - s.size() + i];
        if ((c >= 'A' && c <= 'Z' ? c - 'A' + 'a' : c) != s[i])
            return false;
    }
    return true;
}
}  // namespace

bool ParseCommandLine(const std::vector<std::string>& args, ViewerOptions& options, std::string& error)
{
    bool framesGiven = false, fpsGiven = false;
    std::string pickText;
    for (size_t i = 0; i < args.size(); ++i) {
        const std::string& arg = args[i];
        if (arg == "--help" || arg == "-h") {
            options.help = true;
            return true;
        }
        bool takesValue = arg == "--snapshot" || arg == "--movie" || arg == "--frames" || arg == "--fps" ||
                          arg == "--pick" || arg == "--size";
        if (!takesValue) {
            if (!arg.empty() && arg[0] == '-') {
                error = "unknown option " + arg;
                return false;
            }
            if (!options.scene.empty()) {
                error = "one scene file expected, found a second: " + arg;
                return false;
            }
            options.scene = arg;
            continue;
        }
        if (i + 1 >= args.size()) {
            error = arg + " expects a value";
            return false;
        }
        const std::string& value = args[++i];
        if (arg == "--snapshot") {
            options.snapshot = value;
            if (!EndsWith(value, ".png")) {
                error = "--snapshot expects a .png file, found " + value;
                return false;
            }
        } else if (arg == "--movie") {
            options.movie = value;
            if (!EndsWith(value, ".avi")) {
                error = "--movie expects an .avi file, found " + value;
                return false;
            }
        } else if (arg == "--frames") {
            framesGiven = true;
            if (!ParseInt(value, 1, 100000, options.frames)) {
                error = "--frames expects a whole number from 1 to 100000, found " + value;
                return false;
            }
        } else if (arg == "--fps") {
            fpsGiven = true;
            if (!ParseInt(value, 1, 120, options.fps)) {
                error = "--fps expects a whole number from 1 to 120, found " + value;
                return false;
            }
        } else if (arg == "--size") {
            if (!ParsePair(value, 'x', MinWidth, MinHeight, MaxSize, options.width, options.height)) {
                error = "--size expects WxH with W from " + std::to_string(MinWidth) + " and H from " +
                        std::to_string(MinHeight) + " to " + std::to_string(MaxSize) + ", found " + value;
                return false;
            }
        } else {
            pickText = value;
        }
    }
    if (options.scene.empty()) {
        error = "a scene file expected";
        return false;
    }
    if ((framesGiven || fpsGiven) && options.movie.empty()) {
        error = "--frames and --fps belong to --movie";
        return false;
    }
    // The pick is checked last: it must lie inside the window of the final size.
    if (!pickText.empty()) {
        options.pick = true;
        if (!ParsePair(pickText, ',', 0, 0, MaxSize, options.pickX, options.pickY) ||
            options.pickX >= options.width || options.pickY >= options.height) {
            error = "--pick expects X,Y inside the " + std::to_string(options.width) + "x" +
                    std::to_string(options.height) + " window, found " + pickText;
            return false;
        }
    }
    return true;
}

const char* ViewerUsage()
{
    return "usage: karvel_viewer SCENE.json [--size WxH]\n"
           "                    [--snapshot FILE.png] [--movie FILE.avi [--frames N] [--fps F]] [--pick X,Y]\n"
           "Without --snapshot, --movie or --pick the scene opens in a window:\n"
           "  left drag orbits, right drag pans, wheel flies, shift+drag zooms to a rectangle (Esc resets),\n"
           "  click picks, double-click approaches, F fits all, S saves a snapshot, M starts/stops a movie.\n"
           "With them the viewer renders at --size (default 800x600) without interaction and exits:\n"
           "  --snapshot writes a PNG picture, --movie an uncompressed orbit about the model\n"
           "  (default 72 frames at 24 fps), --pick prints the entities under the pixel, nearest first,\n"
           "  and the 3-D point there.\n";
}
