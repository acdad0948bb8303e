#pragma once
// The array into which every converter appends its groups.
#include "../model/vel_primitive.h"

typedef CDorArray<CVelTrianglePolys, CVelTrianglePolys&> CVelGroupArray;
