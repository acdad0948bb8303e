// Interactive use: a frame window holding the view and a status bar. The view reacts as a CAD
// user expects; every camera move goes through the modeller's own operations and is followed
// by a redraw, since the modeller never redraws by itself.
#include <windows.h>
#include <windowsx.h>
#include <commctrl.h>

#include <cstdio>
#include <memory>

#include "movie/vfw_math_movie.h"
#include "png_file.h"
#include "win32_model_view.h"
#include "win32_viewer.h"

namespace {
const char* FrameClassName = "KarvelViewerFrame";
const UINT_PTR RecordTimer = 1;
const UINT RecordIntervalMs = 100;
const int RecordFps = 10;
const double GlideMs = 600.0;

// NOTE: Wine (8.0) renders a GL child window but never shows it: the view stays black. It does
// show an owned popup, so there the view is one, kept over the frame's client area.
bool RunsOnWine()
{
    HMODULE ntdll = GetModuleHandleA("ntdll.dll");
    return ntdll && GetProcAddress(ntdll, "wine_get_version");
}

class ViewerWindow {
public:
    explicit ViewerWindow(Scene& scene) : scene_(scene) {}

    bool Create(int width, int height, const std::string& title);
    int Run();

private:
    enum class Drag { None, Orbit, Pan, Zoom };

    Scene& scene_;
    HWND frame_ = nullptr;
    HWND status_ = nullptr;
    bool popupView_ = RunsOnWine();
    std::unique_ptr<ModelView> view_;
    Drag drag_ = Drag::None;
    bool dragged_ = false;  // moved beyond a click
    POINT start_ = {}, last_ = {};
    RECT band_ = {};  // the rubber band on screen; empty when none is drawn
    _DorPosition* highlighted_ = nullptr;
    CVelPrimitive savedMaterials_;  // of the highlighted entity
    CVelMathMovie_NoComp recorder_;
    SIZE recordSize_ = {};
    std::string moviePath_;
    int snapshots_ = 0, movies_ = 0, recorded_ = 0;

    static LRESULT CALLBACK FrameProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
    static LRESULT ViewMessage(void* owner, HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT OnViewMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam);

    void Status(const std::string& text)
    {
        SendMessageA(status_, SB_SETTEXTA, 0, reinterpret_cast<LPARAM>(text.c_str()));
    }
    void LayOut();
    SIZE ViewSize() const;
    _VelCamera Camera()
    {
        _VelCamera camera = {};
        view_->modeller.GetCamera(camera);
        return camera;
    }

    void BeginDrag(Drag drag, int x, int y);
    void DragTo(int x, int y);
    void EndDrag(int x, int y);
    void ShowBand(const RECT& band);
    void PickAt(int x, int y);
    void Highlight(_DorPosition* position);
    void ApproachAt(int x, int y);
    void ResetZoom();
    void FitAll();
    void SaveSnapshot();
    void ToggleRecording();
    void RecordFrame();
};

LRESULT CALLBACK ViewerWindow::FrameProc(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    if (message == WM_NCCREATE)
        SetWindowLongPtrA(hwnd, GWLP_USERDATA,
                          reinterpret_cast<LONG_PTR>(reinterpret_cast<CREATESTRUCTA*>(lParam)->lpCreateParams));
    auto* self = reinterpret_cast<ViewerWindow*>(GetWindowLongPtrA(hwnd, GWLP_USERDATA));
    if (self && self->view_) {
        switch (message) {
        case WM_SIZE:
            self->LayOut();
            return 0;
        case WM_MOVE:
            if (self->popupView_)
                self->LayOut();
            return 0;
        case WM_SETFOCUS:
            SetFocus(self->view_->hwnd);
            return 0;
        case WM_CLOSE:
            if (self->recorder_.IsStart())
                self->ToggleRecording();
            // An owned popup view is destroyed before its owner: the context goes first.
            self->view_.reset();
            break;
        case WM_DESTROY:
            // The context goes while its window still exists (children are destroyed after this).
            self->view_.reset();
            break;
        }
    }
    if (message == WM_DESTROY) {
        PostQuitMessage(0);
        return 0;
    }
    return DefWindowProcA(hwnd, message, wParam, lParam);
}

LRESULT ViewerWindow::ViewMessage(void* owner, HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    return static_cast<ViewerWindow*>(owner)->OnViewMessage(hwnd, message, wParam, lParam);
}

bool ViewerWindow::Create(int width, int height, const std::string& title)
{
    INITCOMMONCONTROLSEX controls = {sizeof(controls), ICC_BAR_CLASSES};
    InitCommonControlsEx(&controls);
    WNDCLASSA wc = {};
    wc.lpfnWndProc = FrameProc;
    wc.hInstance = GetModuleHandleA(nullptr);
    wc.hCursor = LoadCursor(nullptr, IDC_ARROW);
    wc.hbrBackground = reinterpret_cast<HBRUSH>(COLOR_BTNFACE + 1);
    wc.lpszClassName = FrameClassName;
    RegisterClassA(&wc);

    DWORD style = WS_OVERLAPPEDWINDOW | WS_CLIPCHILDREN;
    frame_ = CreateWindowA(FrameClassName, title.c_str(), style, CW_USEDEFAULT, CW_USEDEFAULT, width, height, nullptr,
                           nullptr, wc.hInstance, this);
    if (!frame_)
        return false;
    status_ = CreateWindowA(STATUSCLASSNAMEA, "", WS_CHILD | WS_VISIBLE | SBARS_SIZEGRIP, 0, 0, 0, 0, frame_, nullptr,
                            wc.hInstance, nullptr);
    // The frame is sized so that the view's client area is the requested size.
    RECT bar;
    GetWindowRect(status_, &bar);
    RECT outer = {0, 0, width, height + (bar.bottom - bar.top)};
    AdjustWindowRect(&outer, style, FALSE);
    SetWindowPos(frame_, nullptr, 0, 0, outer.right - outer.left, outer.bottom - outer.top, SWP_NOMOVE | SWP_NOZORDER);

    HWND viewWindow = CreateViewWindow(frame_, width, height, &ViewerWindow::ViewMessage, this, popupView_);
    if (!viewWindow)
        return false;
    view_ = std::make_unique<ModelView>(viewWindow);
    LayOut();
    if (!view_->Start(scene_))
        return false;
    ShowWindow(frame_, SW_SHOW);
    ShowWindow(viewWindow, SW_SHOW);
    SetFocus(viewWindow);
    Status("Left drag orbits, right drag pans, wheel flies, shift+drag zooms (Esc resets), click picks, "
           "double-click approaches, F fits all, S snapshot, M movie");
    return true;
}

int ViewerWindow::Run()
{
    MSG msg;
    while (GetMessageA(&msg, nullptr, 0, 0) > 0) {
        TranslateMessage(&msg);
        DispatchMessageA(&msg);
    }
    return 0;
}

SIZE ViewerWindow::ViewSize() const
{
    RECT client;
    GetClientRect(view_->hwnd, &client);
    return SIZE{client.right, client.bottom};
}

void ViewerWindow::LayOut()
{
    SendMessageA(status_, WM_SIZE, 0, 0);
    RECT client, bar;
    GetClientRect(frame_, &client);
    GetWindowRect(status_, &bar);
    int height = client.bottom - (bar.bottom - bar.top);
    POINT origin = {0, 0};
    if (popupView_)
        ClientToScreen(frame_, &origin);  // a popup is placed in screen coordinates
    MoveWindow(view_->hwnd, origin.x, origin.y, client.right, height > 1 ? height : 1, TRUE);
}

LRESULT ViewerWindow::OnViewMessage(HWND hwnd, UINT message, WPARAM wParam, LPARAM lParam)
{
    // Before the view is set up and after it is gone the window is a plain one.
    if (!view_)
        return DefWindowProcA(hwnd, message, wParam, lParam);
    int x = GET_X_LPARAM(lParam), y = GET_Y_LPARAM(lParam);
    switch (message) {
    case WM_PAINT: {
        PAINTSTRUCT paint;
        BeginPaint(hwnd, &paint);
        EndPaint(hwnd, &paint);
        view_->Draw();
        return 0;
    }
    case WM_ERASEBKGND:
        return 1;  // OpenGL paints every pixel
    case WM_SIZE:
        if (view_->modeller.GetCurrent()) {
            view_->FollowWindowSize();
            InvalidateRect(hwnd, nullptr, FALSE);
        }
        return 0;
    case WM_LBUTTONDOWN:
        SetFocus(hwnd);
        BeginDrag(wParam & MK_SHIFT ? Drag::Zoom : Drag::Orbit, x, y);
        return 0;
    case WM_RBUTTONDOWN:
        SetFocus(hwnd);
        BeginDrag(Drag::Pan, x, y);
        return 0;
    case WM_MOUSEMOVE:
        DragTo(x, y);
        return 0;
    case WM_LBUTTONUP:
    case WM_RBUTTONUP:
        EndDrag(x, y);
        return 0;
    case WM_CAPTURECHANGED:
        if (drag_ != Drag::None) {
            ShowBand(RECT{});
            drag_ = Drag::None;
        }
        return 0;
    case WM_LBUTTONDBLCLK:
        ApproachAt(x, y);
        return 0;
    case WM_MOUSEWHEEL:
        view_->modeller.Fly(FlyForWheel(GET_WHEEL_DELTA_WPARAM(wParam), Camera()), 0.0, 0.0, 0);
        view_->Draw();
        return 0;
    case WM_KEYDOWN:
        switch (wParam) {
        case VK_ESCAPE: ResetZoom(); break;
        case 'F': FitAll(); break;
        case 'S': SaveSnapshot(); break;
        case 'M': ToggleRecording(); break;
        }
        return 0;
    case WM_TIMER:
        if (wParam == RecordTimer)
            RecordFrame();
        return 0;
    }
    return DefWindowProcA(hwnd, message, wParam, lParam);
}

void ViewerWindow::BeginDrag(Drag drag, int x, int y)
{
    drag_ = drag;
    dragged_ = false;
    start_ = last_ = POINT{x, y};
    SetCapture(view_->hwnd);
}

void ViewerWindow::DragTo(int x, int y)
{
    if (drag_ == Drag::None)
        return;
    if (!dragged_ && IsClick(start_.x, start_.y, x, y))
        return;
    dragged_ = true;
    int dx = x - last_.x, dy = y - last_.y;
    last_ = POINT{x, y};
    if (drag_ == Drag::Zoom) {
        ShowBand(RECT{start_.x < x ? start_.x : x, start_.y < y ? start_.y : y, start_.x < x ? x : start_.x,
                      start_.y < y ? y : start_.y});
        return;
    }
    if (drag_ == Drag::Orbit) {
        OrbitStep step = OrbitForDrag(dx, dy);
        view_->modeller.RoundDolly(step.elevation, step.azimuth);
    } else {
        PanStep step = PanForDrag(dx, dy, Camera(), ViewSize().cy);
        view_->modeller.Fly(0.0, step.right, step.up, 0);
    }
    view_->Draw();
}

void ViewerWindow::EndDrag(int x, int y)
{
    Drag drag = drag_;
    bool dragged = dragged_;
    drag_ = Drag::None;
    ReleaseCapture();
    ShowBand(RECT{});
    if (drag == Drag::Zoom && dragged) {
        DorVector2 topLeft, bottomRight;
        ZoomCorners(start_.x, start_.y, x, y, topLeft, bottomRight);
        if (!view_->modeller.ViewportZoom(topLeft, bottomRight))
            Status("Zoom refused: drag a larger rectangle (at most 5 times per zoom)");
        view_->Draw();
    } else if (drag == Drag::Orbit && !dragged) {
        PickAt(x, y);
    }
}

// NOTE: the band is drawn with XOR straight onto the window: drawing it twice erases it, and
// the next frame of the model paints over whatever is left.
void ViewerWindow::ShowBand(const RECT& band)
{
    HDC dc = view_->dc;
    if (!IsRectEmpty(&band_))
        DrawFocusRect(dc, &band_);
    band_ = band;
    if (!IsRectEmpty(&band_))
        DrawFocusRect(dc, &band_);
}

void ViewerWindow::PickAt(int x, int y)
{
    DorVector3 point;
    _DorPosition* nearest = nullptr;
    std::vector<PickedEntity> hits = view_->Pick(x, y, point, nearest);
    Highlight(nearest);
    view_->Draw();
    Status(DescribeClick(hits, point));
}

void ViewerWindow::Highlight(_DorPosition* position)
{
    if (highlighted_)
        view_->modeller.ChangePrimitive(highlighted_, savedMaterials_, VelChangeMaterial);
    highlighted_ = position;
    if (!position)
        return;
    savedMaterials_ = CVelPrimitive();
    view_->modeller.GetPrimitive(position, savedMaterials_, VelChangeMaterial);
    CVelPrimitive lit(savedMaterials_);
    for (int g = 0; g < lit.groups.GetSize(); ++g)
        lit.groups[g].material = HighlightMaterial(lit.groups[g].material);
    view_->modeller.ChangePrimitive(position, lit, VelChangeMaterial);
}

void ViewerWindow::ApproachAt(int x, int y)
{
    // Halfway to the point under the cursor; with nothing there the view turns toward it.
    view_->modeller.ApproachCamera(DorVector2(x, y), ViewSize().cy * 0.5, 1);
    view_->Draw();
}

void ViewerWindow::ResetZoom()
{
    // NOTE: ResetViewport only records the viewport; SetViewport applies it and the aspect ratio.
    view_->modeller.ResetViewport();
    _VelViewport viewport = {};
    view_->modeller.GetViewport(viewport);
    view_->modeller.SetViewport(viewport);
    view_->Draw();
}

void ViewerWindow::FitAll()
{
    // Zooms are undone first, so the whole model fits the whole window.
    view_->modeller.KarvelAllmodelView_vp(view_->dc, 0, GlideMs);
    view_->Draw();
}

void ViewerWindow::SaveSnapshot()
{
    SIZE size = ViewSize();
    _DorBitmap bitmap;
    std::string path = "karvel-snapshot-" + std::to_string(++snapshots_) + ".png";
    if (view_->Capture(size.cx, size.cy, bitmap) && WritePng(path, bitmap))
        Status("Saved " + path);
    else
        Status("Snapshot failed: no picture could be captured or written");
    view_->Draw();
}

void ViewerWindow::ToggleRecording()
{
    if (recorder_.IsStart()) {
        KillTimer(view_->hwnd, RecordTimer);
        recorder_.End();
        Status("Saved " + moviePath_ + " (" + std::to_string(recorded_) + " frames)");
        return;
    }
    SIZE size = ViewSize();
    _DorBitmap bitmap;
    moviePath_ = "karvel-movie-" + std::to_string(++movies_) + ".avi";
    if (!view_->Capture(size.cx, size.cy, bitmap) ||
        !recorder_.Start(bitmap, moviePath_.c_str(), RecordFps, "karvel", 0) || !recorder_.Add(bitmap)) {
        recorder_.End();
        Status("Recording failed: no picture could be captured or the file cannot be written");
        return;
    }
    recordSize_ = size;
    recorded_ = 1;
    SetTimer(view_->hwnd, RecordTimer, RecordIntervalMs, nullptr);
    Status("Recording " + moviePath_ + " (M stops)");
    view_->Draw();
}

// Frames keep the size recording started with, whatever the window does meanwhile.
void ViewerWindow::RecordFrame()
{
    _DorBitmap bitmap;
    if (view_->Capture(recordSize_.cx, recordSize_.cy, bitmap) && recorder_.Add(bitmap))
        ++recorded_;
    view_->Draw();
}
}  // namespace

int RunInteractive(const ViewerOptions& options, Scene& scene)
{
    ViewerWindow window(scene);
    if (!window.Create(options.width, options.height, "karvel viewer - " + options.scene)) {
        std::fprintf(stderr, "karvel_viewer: cannot open the window or its OpenGL context\n");
        return 1;
    }
    return window.Run();
}
