#pragma once
/// @file
/// CVelGLContext, a modeller's OpenGL rendering context.
#include "../model/dor_types.h"
#include "../model/platform.h"

/// The OpenGL rendering context of a modeller on one device context, and the background colour
/// its frames are cleared to. It owns the context: one owner, released on destruction. Windows
/// only in effect; call it on the modeller's thread.
class CVelGLContext {
public:
    DorColorValue background;  ///< Opaque black unless the host sets it.
    HGLRC handle;              ///< Null when there is no context.

    /// Black, no context.
    CVelGLContext() : background(0, 0, 0, 1), handle(nullptr) {}
    /// A copy takes the colour only: a rendering context has one owner.
    CVelGLContext(const CVelGLContext& other) : background(other.background), handle(nullptr) {}
    /// Takes the colour only; the context held stays.
    CVelGLContext& operator=(const CVelGLContext& other)
    {
        background = other.background;
        return *this;
    }
    /// Releases the context held.
    virtual ~CVelGLContext();

    /// Chooses and sets the window pixel format on dc, then creates the context and makes it
    /// current. Any context held before is released first. Returns 1, or 0 when the pixel format
    /// cannot be chosen, set or described.
    int Create(HDC dc);
    /// The same on a memory DC holding a 32-bit DIB section: a single-buffered bitmap format,
    /// chosen, described and then set (the order capture has always used). Returns 1, or 0 with
    /// no context created when a step fails.
    int CreateOnBitmap(HDC memoryDC);
    /// Makes no context current and deletes the one held, if any.
    void Release();

private:
    // Creates the context on a DC whose pixel format is set and makes it current.
    int MakeCurrentOn(HDC dc);
};
