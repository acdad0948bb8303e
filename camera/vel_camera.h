#pragma once
/// @file
/// Camera and viewport records, plain values.
#include "../model/dor_types.h"

/// A perspective camera: it looks from eye to target with the world's +Z as up (the picture's
/// up is +Z tilted to stand at right angles to the view). Lengths are model units. A modeller
/// never stores a camera whose eye and target are closer than 0.0001: CVelKarvel::SetCamera
/// ignores it whole. A fresh modeller's camera looks from (100, -100, 100) at the origin, fovy
/// 45, zNear 1, zFar 10000.
struct _VelCamera {
    DorVector3 eye;     ///< The viewpoint.
    DorVector3 target;  ///< The point looked at; its distance from eye is what the moves keep or change.
    double fovy;        ///< Vertical field of view in degrees, 0..180 exclusive.
    double zNear;       ///< Near clipping distance, greater than 0.
    double zFar;        ///< Far clipping distance, greater than zNear.
    double aspect;      ///< Viewport width / height; the modeller keeps it following its viewport.
};

/// A viewport in window pixels, in the order glViewport takes them: x and y are its lower-left
/// corner counted from the window's lower-left (y up, unlike cursor positions).
struct _VelViewport {
    ///@{
    int x, y, width, height;  ///< Lower-left corner and size.
    ///@}
};
