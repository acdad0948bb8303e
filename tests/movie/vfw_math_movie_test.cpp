// Records movies into files and finds what they hold in the bytes written, as a player reads it.
// NOTE: 64-bit Wine's AVIFileOpenA cannot read these files back (it fails with AVIERR_BADFORMAT
// looking for the main header), so the chunks are looked up here instead.
#include <windows.h>

// An MFC host includes MFC first and so gets the CBitmap overloads. MFC does not exist for this
// compiler: a stand-in with the one member those overloads use takes its place.
#define __AFXWIN_H__
struct CBitmap {
    HBITMAP handle;
    HGDIOBJ GetSafeHandle() const { return handle; }
};

#include <gtest/gtest.h>
#include <vfw.h>

#include <algorithm>
#include <atomic>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <thread>
#include <vector>

#include "model/dor_bitmap.h"
#include "movie/vfw_math_movie.h"

namespace {
typedef std::vector<unsigned char> Bytes;

// Every byte depends on its position and on seed, so that a shifted, cut or swapped frame shows.
_DorBitmap Pattern(int width, int height, int bitCount, int seed)
{
    _DorBitmap b;
    DorBitmapAllocate(b, width, height, bitCount);
    for (int i = 0; i < b.bits.GetSize(); ++i)
        b.bits[i] = static_cast<unsigned char>(i * 7 + seed * 31);
    for (int i = 0; i < b.palette.GetSize(); ++i)
        b.palette[i] = DorRgbQuad{uint8_t(i), uint8_t(255 - i), uint8_t(i ^ 0x5A), 0};
    return b;
}

// A GDI bitmap with the frame's header, colour table and pixels; the caller deletes it.
HBITMAP DibSectionOf(const _DorBitmap& frame)
{
    struct {
        BITMAPINFOHEADER header;
        RGBQUAD colours[256];
    } info = {};
    std::memcpy(&info.header, &frame.info, sizeof(info.header));
    std::memcpy(info.colours, frame.palette.GetData(), frame.palette.GetSize() * sizeof(RGBQUAD));
    void* pixels = nullptr;
    HBITMAP dib = CreateDIBSection(nullptr, reinterpret_cast<BITMAPINFO*>(&info), DIB_RGB_COLORS, &pixels, nullptr, 0);
    std::memcpy(pixels, frame.bits.GetData(), frame.bits.GetSize());
    return dib;
}

// Reads past the end give 0, so that a damaged file fails the checks rather than the program.
uint32_t U32(const Bytes& d, size_t at)
{
    uint32_t v = 0;
    if (at + 4 <= d.size())
        std::memcpy(&v, &d[at], 4);
    return v;
}

// Where n bytes from p first occur in d at or after from; d's size when they do not.
size_t Find(const Bytes& d, const void* p, size_t n, size_t from)
{
    const unsigned char* bytes = static_cast<const unsigned char*>(p);
    return std::search(d.begin() + std::min(from, d.size()), d.end(), bytes, bytes + n) - d.begin();
}

// The file holds exactly these frames in order, each a chunk of its own and a key frame, and
// the first frame's header and palette as the stream format. The stream header's values are
// checked natively.
void ExpectMovie(const char* path, const std::vector<_DorBitmap>& frames)
{
    std::ifstream in(path, std::ios::binary);
    Bytes d((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    const _DorBitmap& first = frames[0];
    const size_t header = sizeof first.info, colours = 4 * first.palette.GetSize();
    size_t at = Find(d, "strf", 4, 0) + 8, index = Find(d, "idx1", 4, 0) + 8;
    EXPECT_TRUE(U32(d, at - 4) == header + colours && Find(d, &first.info, header, at) == at &&
                Find(d, first.palette.GetData(), colours, at + header) == at + header);
    ASSERT_EQ(U32(d, index - 4), 16 * frames.size());
    for (size_t i = 0; i < frames.size(); ++i, at += 8) {
        at = Find(d, frames[i].bits.GetData(), frames[i].bits.GetSize(), at);
        EXPECT_EQ(U32(d, at - 4), uint32_t(frames[i].bits.GetSize())) << "frame " << i;
        EXPECT_TRUE(U32(d, index + 16 * i + 4) & AVIIF_KEYFRAME) << "frame " << i;
    }
}

// Starts a recorder while a helper thread waits for the compressed one's dialog and, as a user
// would, picks the first choice (full frames, uncompressed) and presses button.
template <class Recorder>
int Start(Recorder& movie, _DorBitmap& first, const char* path, int length, int button = IDOK)
{
    DWORD owner = GetCurrentThreadId();
    std::atomic<bool> done{false};
    std::thread helper([&] {
        for (int waited = 0; waited < 10000 && !done; waited += 20, Sleep(20)) {
            HWND dialog = FindWindowA("#32770", nullptr);
            if (!dialog || GetWindowThreadProcessId(dialog, nullptr) != owner || !IsWindowVisible(dialog))
                continue;
            if (HWND list = FindWindowExA(dialog, nullptr, "ComboBox", nullptr))
                SendMessageA(list, CB_SETCURSEL, 0, 0);
            PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(button, BN_CLICKED), LPARAM(GetDlgItem(dialog, button)));
            return;
        }
    });
    int started = movie.Start(first, path, 15, "Camera", length);
    done = true;
    helper.join();
    return started;
}

// What both recorders do from Start to End. Start refuses a missing folder (before any dialog),
// an unplayable depth, a frame without pixels and a missing or deleted bitmap, leaving no file,
// and a second Start while recording, leaving the recording whole; a frame one pixel wider or no
// bitmap is refused without leaving a gap; a recorder starts again from frame 0, and one
// destroyed while recording closes its file.
template <class Recorder>
void ExpectLifecycle(const std::string& path)
{
    std::vector<_DorBitmap> kept = {Pattern(20, 10, 24, 1), Pattern(20, 10, 24, 2)};
    _DorBitmap wider = Pattern(21, 10, 24, 3), deep = Pattern(20, 10, 24, 4), empty = Pattern(0, 10, 24, 5);
    deep.info.bitCount = 15;
    HBITMAP deleted = DibSectionOf(wider);
    DeleteObject(deleted);
    CBitmap none{nullptr};
    {
        Recorder movie;
        EXPECT_EQ(movie.Start(kept[0], (path + ".folder\\m.avi").c_str(), 15, "m", 1) + movie.IsStart(), 0);
        EXPECT_EQ(movie.Start(deep, path.c_str(), 15, "m", 1) + movie.Start(none, path.c_str(), 15, "m", 1) +
                      movie.Start(deleted, path.c_str(), 15, "m", 1) + movie.Start(empty, path.c_str(), 15, "m", 1) +
                      movie.IsStart() + movie.Add(kept[0]),
                  0);
        EXPECT_EQ(GetFileAttributesA(path.c_str()), INVALID_FILE_ATTRIBUTES);
        ASSERT_EQ(Start(movie, kept[0], path.c_str(), 2), 1);
        EXPECT_EQ(movie.Start(kept[1], path.c_str(), 15, "m", 1) * 2 + movie.IsStart(), 1);
        EXPECT_EQ(movie.Add(kept[0]), 1);
        EXPECT_EQ(movie.Add(wider) + movie.Add(none) + movie.Add(static_cast<HBITMAP>(nullptr)), 0);
        EXPECT_EQ(movie.Add(kept[1]), 1);
        movie.End();
        EXPECT_EQ(movie.IsStart() + movie.Add(kept[0]), 0);
        ExpectMovie(path.c_str(), kept);
        ASSERT_EQ(Start(movie, kept[1], path.c_str(), 1), 1);
        EXPECT_EQ(movie.Add(kept[1]), 1);
        EXPECT_EQ(movie.frame, 1);  // counted from 0 again
    }
    ExpectMovie(path.c_str(), {kept[1]});
    EXPECT_TRUE(DeleteFileA(path.c_str()));  // nothing holds it open any more
}

// A file in the working folder named for the test, removed again after it.
class MovieFile : public ::testing::Test {
protected:
    ~MovieFile() override { DeleteFileA(path); }
    std::string name = std::string("karvel_") + testing::UnitTest::GetInstance()->current_test_info()->name() + ".avi";
    const char* path = name.c_str();
};
}  // namespace

TEST_F(MovieFile, FramesAndGdiBitmapsReadBackWithTheirPixelsAndFormat)
{
    // 37 pixels: padded rows. GDI keeps no row padding, so its bitmaps are 32 pixels wide.
    struct { int bits, width; bool gdi; } cases[] = {{24, 37, false}, {8, 37, false}, {32, 37, false},
                                                     {1, 32, true}, {8, 32, true}, {24, 32, true}};
    for (auto c : cases) {
        SCOPED_TRACE(testing::Message() << c.bits << " bits" << (c.gdi ? " from GDI" : ""));
        std::vector<_DorBitmap> frames = {Pattern(c.width, 9, c.bits, 0), Pattern(c.width, 9, c.bits, 1)};
        CBitmap gdi[] = {{DibSectionOf(frames[0])}, {DibSectionOf(frames[1])}};
        CVelMathMovie_NoComp movie;
        ASSERT_EQ(c.gdi ? movie.Start(gdi[0], path, 15, "Camera", 2) : movie.Start(frames[0], path, 15, "Camera", 2), 1);
        EXPECT_EQ(c.gdi ? movie.Add(gdi[0]) : movie.Add(frames[0]), 1);  // a CBitmap, then its handle
        EXPECT_EQ(c.gdi ? movie.Add(gdi[1].handle) : movie.Add(frames[1]), 1);
        movie.End();
        ExpectMovie(path, frames);
        for (CBitmap& b : gdi)
            DeleteObject(b.handle);
    }
}

TEST_F(MovieFile, UncompressedLifecycle)
{
    ExpectLifecycle<CVelMathMovie_NoComp>(name);
}

TEST_F(MovieFile, CancelledCompressorDialogLeavesTheRecorderIdleAndFullFramesThenRecord)
{
    _DorBitmap frame = Pattern(16, 16, 24, 0);
    CVelMathMovie movie;
    EXPECT_EQ(Start(movie, frame, path, 1, IDCANCEL), 0);
    EXPECT_EQ(movie.IsStart() + movie.Add(frame), 0);
    EXPECT_EQ(GetFileAttributesA(path), INVALID_FILE_ATTRIBUTES);  // created before the dialog, removed
    ExpectLifecycle<CVelMathMovie>(name);
}
