// The CBitmap overloads as an MFC host compiles them: MFC's own headers come first and define
// __AFXWIN_H__. MFC does not exist for this compiler, so a stand-in with the one member the
// overloads use takes its place.
#include <windows.h>

#define __AFXWIN_H__
class CBitmap {
public:
    explicit CBitmap(HBITMAP handle) : handle_(handle) {}
    HGDIOBJ GetSafeHandle() const { return handle_; }

private:
    HBITMAP handle_;
};

#include <gtest/gtest.h>

#include <string>

#include "model/dor_bitmap.h"
#include "movie/vfw_math_movie.h"
#include "support/gdi_test_bitmap.h"

TEST(MovieCBitmap, OverloadsRecordTheBitmapBehindTheHandle)
{
    char folder[MAX_PATH];
    GetTempPathA(MAX_PATH, folder);
    std::string path = std::string(folder) + "karvel_cbitmap.avi";
    _DorBitmap pixels;
    DorBitmapAllocate(pixels, 24, 10, 24);
    HBITMAP dib = CreateDibSectionOf(pixels);
    CBitmap frame(dib), none(nullptr);

    CVelMathMovie_NoComp movie;
    EXPECT_EQ(movie.Start(none, path.c_str(), 10, "c", 1), 0);
    ASSERT_EQ(movie.Start(frame, path.c_str(), 10, "c", 1), 1);
    EXPECT_EQ(movie.format.biWidth, 24);
    EXPECT_EQ(movie.format.biBitCount, 24);
    EXPECT_EQ(movie.Add(frame), 1);
    EXPECT_EQ(movie.Add(none), 0);
    EXPECT_EQ(movie.frame, 1);
    movie.End();
    DeleteObject(dib);
    DeleteFileA(path.c_str());
}
