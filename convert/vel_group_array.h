#pragma once
/// @file
/// CVelGroupArray, the array into which every converter appends its groups.
#include "../model/vel_primitive.h"

/// The caller-owned array into which every converter writes its groups.
typedef CDorArray<CVelTrianglePolys, CVelTrianglePolys&> CVelGroupArray;
