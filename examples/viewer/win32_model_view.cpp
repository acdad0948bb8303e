#include "win32_model_view.h"

namespace {
const char* ViewClassName = "KarvelViewerView";

struct ViewHook {
    ViewMessageHandler handler;
    void* owner;
};

LRESULT CALLBACK ViewProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    if (message == WM_NCCREATE) {
        auto* create = reinterpret_cast<CREATESTRUCTA*>(lParam);
        SetWindowLongPtrA(hwnd, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(create->lpCreateParams));
    }
    auto* hook = reinterpret_cast<ViewHook*>(GetWindowLongPtrA(hwnd, GWLP_USERDATA));
    if (message == WM_NCDESTROY) {
        SetWindowLongPtrA(hwnd, GWLP_USERDATA, 0);
        delete hook;
        return DefWindowProcA(hwnd, message, wParam, lParam);
    }
    if (hook && hook->handler)
        return hook->handler(hook->owner, hwnd, message, wParam, lParam);
    return DefWindowProcA(hwnd, message, wParam, lParam);
}

void RegisterViewClass()
{
    static bool registered = false;
    if (registered)
        return;
    WNDCLASSA wc = {};
    // An own DC: the modeller keeps rendering into the DC it was started on.
    wc.style = CS_OWNDC | CS_DBLCLKS;
    wc.lpfnWndProc = ViewProc;
    wc.hInstance = GetModuleHandleA(nullptr);
    wc.hCursor = LoadCursor(nullptr, IDC_CROSS);
    wc.lpszClassName = ViewClassName;
    RegisterClassA(&wc);
    registered = true;
}
}  // namespace

HWND CreateViewWindow(HWND parent, int width, int height, ViewMessageHandler handler, void* owner, bool ownedPopup)
{
    RegisterViewClass();
    auto* hook = new ViewHook{handler, owner};
    DWORD kind = !parent ? WS_OVERLAPPEDWINDOW : ownedPopup ? WS_POPUP : WS_CHILD | WS_VISIBLE;
    DWORD style = WS_CLIPCHILDREN | WS_CLIPSIBLINGS | kind;
    RECT r = {0, 0, width, height};
    AdjustWindowRect(&r, style, FALSE);
    HWND hwnd = CreateWindowA(ViewClassName, "karvel viewer", style, 0, 0, r.right - r.left, r.bottom - r.top, parent,
                              nullptr, GetModuleHandleA(nullptr), hook);
    if (!hwnd)
        delete hook;
    return hwnd;
}

ModelView::ModelView(HWND window) : hwnd(window), dc(GetDC(window)) {}

ModelView::~ModelView()
{
    modeller.Finalize();
    ReleaseDC(hwnd, dc);
}

bool ModelView::Start(Scene& scene)
{
    std::vector<unsigned int> textureNames = AddSceneTextures(modeller, scene);
    modeller.Initialize(dc);
    // NOTE: Initialize reports success even when no context could be made; only the current
    // context tells.
    if (!modeller.GetCurrent())
        return false;
    AddSceneEntities(modeller, scene, textureNames, names);
    ApplySceneView(modeller, scene);
    return true;
}

void ModelView::Draw() { modeller.DrawModel(dc); }

std::vector<PickedEntity> ModelView::Pick(int x, int y, DorVector3& point, _DorPosition*& nearest)
{
    CDorArray<_VelSelect, _VelSelect&> hits;
    modeller.HitTest(dc, x, y, hits);
    std::vector<PickedEntity> picked;
    for (int i = 0; i < hits.GetSize(); ++i) {
        auto name = names.find(hits[i].position);
        picked.push_back({name != names.end() ? name->second : "(unnamed)", hits[i].depth});
    }
    nearest = hits.GetSize() > 0 ? hits[0].position : nullptr;
    if (nearest) {
        double depth = hits[0].depth;
        modeller.GetDepthToPoint3_Hi(dc, nearest, x, y, depth, point);
    }
    // NOTE: picking leaves the back buffer cleared; redraw so the window shows the model again.
    Draw();
    return picked;
}

bool ModelView::Capture(int width, int height, _DorBitmap& bitmap)
{
    // NOTE: the capture restarts the window's context, which resets the viewport; a zoomed view
    // gets its zoom back afterwards (the picture itself always shows the whole view).
    _VelViewport viewport = {0, 0, 0, 0};
    modeller.GetViewport(viewport);
    _DORRECT rect = {0, 0, width, height};
    modeller.ToBitmap(bitmap, rect);
    modeller.SetViewport(viewport);
    return bitmap.info.width == width && bitmap.info.height == height && bitmap.info.bitCount == 24 &&
           bitmap.bits.GetSize() >= DorBitmapRowBytes(width, 24) * height;
}

void ModelView::FollowWindowSize() { modeller.Initialize(dc); }
