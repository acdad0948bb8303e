#pragma once
// karvel: the one header a host includes, as <karvel/karvel.h>. It brings every exported class and
// the records they take; folders follow the library's layers (README, "Layout").
#include "model/dor_types.h"
#include "model/dor_list.h"
#include "model/vel_primitive.h"
#include "camera/vel_camera.h"
#include "camera/vel_math_camera.h"
#include "convert/dor_shape.h"
#include "convert/vel_shape_to_primitive.h"
#include "convert/vel_polygon_to_primitive.h"
#include "convert/vel_hole_polygon_to_primitive.h"
#include "convert/vel_extruded_to_primitive.h"
#include "convert/vel_hole_extruded_to_primitive.h"
#include "primitives/vel_math_primitive.h"
#include "gl/vel_karvel.h"
#include "gl/vel_gl_karvel.h"
#if defined(_WIN32)
#  include "movie/vfw_math_movie.h"
#endif
