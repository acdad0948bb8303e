#pragma once
// Camera and viewport records. A camera looks from eye to target with the world's +Z as up;
// fovy is the vertical field of view in degrees; lengths are model units.
#include "../model/dor_types.h"

struct _VelCamera {
    DorVector3 eye;
    DorVector3 target;
    double fovy;
    double zNear;
    double zFar;
    double aspect;  // viewport width / height
};

// In window pixels, in the order glViewport takes them.
struct _VelViewport {
    int x, y, width, height;
};
