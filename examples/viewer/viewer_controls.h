#pragma once
// How the viewer turns mouse and keyboard input into camera moves, and what it prints about a
// pick: plain decisions, kept apart from the window code. Window pixels have y downward.
#include <string>
#include <vector>

#include "gl/vel_karvel.h"

// Drags shorter than this many pixels in x and y count as clicks.
const int ViewerClickSlop = 3;

bool IsClick(int fromX, int fromY, int toX, int toY);

// Left drag: the model turns with the mouse, so the eye circles the other way. Degrees for
// RoundDolly(elevation, azimuth).
struct OrbitStep {
    double elevation, azimuth;
};
OrbitStep OrbitForDrag(int dx, int dy);

// Right drag: the point under the cursor at the target's distance follows the cursor. Model
// units for Fly(0, right, up, 0).
struct PanStep {
    double right, up;
};
PanStep PanForDrag(int dx, int dy, const _VelCamera& camera, int viewHeight);

// Wheel: one notch (120 units, positive away from the user) flies a tenth of the distance to
// the target forward. Model units for Fly(forward, 0, 0, 0).
double FlyForWheel(int wheelDelta, const _VelCamera& camera);

// The rubber band as ViewportZoom wants it: top-left corner, then bottom-right, whichever way
// it was dragged.
void ZoomCorners(int x0, int y0, int x1, int y1, DorVector2& topLeft, DorVector2& bottomRight);

// The azimuth step of an orbit movie of frames frames: one full turn.
double OrbitFrameAzimuth(int frames);

// Whether recording frame `done` of total completes another tenth of the movie: when the
// progress goes to a log rather than a terminal, only those frames get a line.
bool ProgressLineDue(int done, int total);

// A bright, warm version of a material for the picked entity; alpha is kept so a transparent
// entity stays transparent.
_DorMaterial HighlightMaterial(const _DorMaterial& material);

// One entity under a pick: its name and window depth.
struct PickedEntity {
    std::string name;
    double depth;
};

// The lines --pick prints: the entities nearest first, then the 3-D point on the nearest.
std::vector<std::string> DescribePick(int x, int y, const std::vector<PickedEntity>& hits, const DorVector3& point);

// The status bar text after a click.
std::string DescribeClick(const std::vector<PickedEntity>& hits, const DorVector3& point);
