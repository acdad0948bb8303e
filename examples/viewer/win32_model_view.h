#pragma once
// The modeller in a window, held the way a host holds it: the window's own DC, the scene's
// model, and the entities' names for picks. Shared by the
// interactive window and the batch runs.
#include <windows.h>

#include <vector>

#include "gl/vel_gl_karvel.h"
#include "scene.h"
#include "scene_model.h"
#include "viewer_controls.h"

// Window procedure hook of a view window: the owner that gets its messages, or none.
typedef LRESULT (*ViewMessageHandler)(void* owner, HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);

// Creates a view window with its own DC: a child of parent when given (with ownedPopup, a hidden
// popup that parent owns instead), else a hidden top-level window with that exact client size.
// Its messages go to handler(owner, ...) when set.
HWND CreateViewWindow(HWND parent, int width, int height, ViewMessageHandler handler, void* owner,
                      bool ownedPopup = false);

class ModelView {
public:
    explicit ModelView(HWND window);
    ~ModelView();
    ModelView(const ModelView&) = delete;
    ModelView& operator=(const ModelView&) = delete;

    // Starts the modeller on the window's DC with the scene's textures, adds its entities and
    // sets its view. False when no OpenGL context could be made.
    bool Start(Scene& scene);
    void Draw();
    // The entities under the pixel, nearest first; point is the 3-D point on the nearest and
    // nearest its handle (null when nothing is there).
    std::vector<PickedEntity> Pick(int x, int y, DorVector3& point, _DorPosition*& nearest);
    // Renders the whole view, unzoomed, at width x height into a 24-bit bitmap; false when no
    // picture of that size came back. The window keeps its zoom.
    bool Capture(int width, int height, _DorBitmap& bitmap);
    // After the window changed size: restarts the context, so that the viewport, the aspect
    // ratio and picking follow the new client area. Zooms are reset.
    void FollowWindowSize();

    CVelGLKarvel modeller;
    HWND hwnd;
    HDC dc;
    SceneNames names;
};
