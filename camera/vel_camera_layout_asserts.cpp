// The camera records' field order and widths are the library's binary interface: hosts
// built against one release must be able to load another. Any change here is a breaking change.
#include "camera/vel_camera.h"
#include "model/dor_layout_check.h"

KARVEL_FIELD(_VelCamera, eye, 0);
KARVEL_FIELD(_VelCamera, target, 32);
KARVEL_FIELD(_VelCamera, fovy, 64);
KARVEL_FIELD(_VelCamera, zNear, 72);
KARVEL_FIELD(_VelCamera, zFar, 80);
KARVEL_FIELD(_VelCamera, aspect, 88);
KARVEL_SIZE(_VelCamera, 96);

KARVEL_FIELD(_VelViewport, x, 0);
KARVEL_FIELD(_VelViewport, y, 4);
KARVEL_FIELD(_VelViewport, width, 8);
KARVEL_FIELD(_VelViewport, height, 12);
KARVEL_SIZE(_VelViewport, 16);
