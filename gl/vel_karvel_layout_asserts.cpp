// The hit record's field order and widths are the library's binary interface: hosts built
// against one release must be able to load another. Any change here is a breaking change.
#include "gl/vel_karvel.h"
#include "model/dor_layout_check.h"

KARVEL_FIELD(_VelSelect, position, 0);
KARVEL_FIELD(_VelSelect, depth, 8);
KARVEL_SIZE(_VelSelect, 16);
