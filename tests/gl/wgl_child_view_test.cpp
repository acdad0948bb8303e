// The modeller in a child view of a frame, beside a status bar, as hosts embed it.
// NOTE: under Wine 8 a GL child window renders but is never shown on screen, so every check reads
// the child's own back buffer straight after the swap (PixelAt), never the screen.
#include <gtest/gtest.h>
#include <windows.h>
#include <commctrl.h>
#include <GL/gl.h>

#include "support/gl_live_modeller.h"

namespace {
// Where the camera of LookAlongY puts model point (x, 0, z) in the view: column, row.
const int kSquare[2] = {kWidth / 2 + 4 * kHeight / 20, kHeight / 2 - 3 * kHeight / 20};
const int kMirror[2] = {kWidth - kSquare[0], kHeight - kSquare[1]};
}  // namespace

// A red square up and right of the centre (x 2..6, z 1..5) on a blue background, in a view
// placed away from the frame's corner so that frame and view coordinates differ.
class ChildView : public ::testing::Test {
protected:
    void SetUp() override
    {
        InitCommonControls();
        status = CreateWindowExA(0, STATUSCLASSNAMEA, "ready", WS_CHILD | WS_VISIBLE, 0, 0, 0, 0, frame.hwnd,
                                 nullptr, GetModuleHandleA(nullptr), nullptr);
        // The frame's window class: CS_OWNDC, as a view needs.
        view = CreateWindowA("KarvelTestWindow", "view", WS_CHILD | WS_VISIBLE | WS_CLIPSIBLINGS, 16, 8, kWidth,
                             kHeight, frame.hwnd, nullptr, GetModuleHandleA(nullptr), nullptr);
        dc = GetDC(view);
        TestWindow::PumpMessages();
        ASSERT_EQ(karvel.Initialize(dc), 1);
        LookAlongY(karvel);
        DorColorValue blue(0, 0, 1, 1);
        karvel.SetBkColor(blue);
        CVelPrimitive red = Rectangle(2, 1, 6, 5, 0, Matte(1, 0, 0));
        square = karvel.AddPrimitive(red);
    }

    void TearDown() override
    {
        karvel.Finalize();
        ReleaseDC(view, dc);
        DestroyWindow(view);
        DestroyWindow(status);
    }

    // The view was drawn with the context on the view's own DC, over the view's client area.
    void ExpectDrawnInView()
    {
        karvel.DrawModel(dc);
        EXPECT_EQ(WindowFromDC(wglGetCurrentDC()), view);
        GLint viewport[4];
        glGetIntegerv(GL_VIEWPORT, viewport);
        EXPECT_TRUE(viewport[2] == kWidth && viewport[3] == kHeight);
        Rgb inside = PixelAt(kSquare[0], kSquare[1]), outside = PixelAt(kMirror[0], kMirror[1]);
        EXPECT_TRUE(inside.r > 150 && inside.b < 30 && outside.r < 30 && outside.b > 150);
    }

    TestWindow frame{kWidth + 32, kHeight + 48};
    HWND status = nullptr, view = nullptr;
    HDC dc = nullptr;
    CVelGLKarvel karvel;
    _DorPosition* square = nullptr;
};

// Draws, picks and captures in the view; the capture works on its own context and
// then returns to the view's.
TEST_F(ChildView, DrawsPicksAndCapturesInTheView)
{
    ExpectDrawnInView();
    CDorArray<_VelSelect, _VelSelect&> hits;
    karvel.HitTest(dc, kMirror[0], kMirror[1], hits);
    EXPECT_EQ(hits.GetSize(), 0);
    karvel.HitTest(dc, kSquare[0], kSquare[1], hits);
    ASSERT_EQ(hits.GetSize(), 1);
    EXPECT_EQ(hits[0].position, square);
    _DORRECT rect = {0, 0, kWidth, kHeight};
    _DorBitmap bitmap;
    karvel.ToBitmap(bitmap, rect);
    ASSERT_TRUE(bitmap.info.width == kWidth && bitmap.info.height == kHeight);
    const unsigned char* red = bitmap.bits.GetData() + (kHeight - 1 - kSquare[1]) * DorBitmapRowBytes(kWidth, 24) + 3 * kSquare[0];
    EXPECT_TRUE(red[2] > 150 && red[0] < 30);  // bottom-up rows of BGR
    ExpectDrawnInView();
}
