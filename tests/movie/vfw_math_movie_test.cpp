// Records movies into temporary files and reads them back chunk by chunk, as a player does:
// frame count, size, rate, the stream's name, the format block and the pixels of every frame.
// NOTE: 64-bit Wine's AVIFileOpenA cannot read these files back (it fails with AVIERR_BADFORMAT
// looking for the main header), so the RIFF chunks are parsed here instead.
#include <gtest/gtest.h>
#include <windows.h>
#include <vfw.h>

#include <algorithm>
#include <atomic>
#include <cstdio>
#include <cstring>
#include <string>
#include <thread>
#include <vector>

#include "model/dor_bitmap.h"
#include "movie/vfw_math_movie.h"
#include "support/gdi_test_bitmap.h"

namespace {

typedef std::vector<unsigned char> Bytes;

Bytes Pixels(const _DorBitmap& b)
{
    return Bytes(b.bits.GetData(), b.bits.GetData() + b.bits.GetSize());
}

// A frame whose every byte depends on its position and on seed, so that frames differ from
// each other and a shifted or truncated frame shows.
_DorBitmap PatternFrame(int width, int height, int bitCount, int seed)
{
    _DorBitmap b;
    DorBitmapAllocate(b, width, height, bitCount);
    for (int i = 0; i < b.bits.GetSize(); ++i)
        b.bits[i] = static_cast<unsigned char>(i * 7 + seed * 31);
    for (int i = 0; i < b.palette.GetSize(); ++i)
        b.palette[i] = DorRgbQuad{uint8_t(i), uint8_t(255 - i), uint8_t(i ^ 0x5A), 0};
    return b;
}

// What a player finds in an AVI file, read from its RIFF chunks.
struct AviContents {
    bool riff = false;  // a RIFF 'AVI ' form
    uint32_t totalFrames = 0;  // main header
    uint32_t fccType = 0, fccHandler = 0, scale = 0, rate = 0, length = 0;  // stream header
    int frameWidth = 0, frameHeight = 0;
    Bytes format;
    std::string name;
    std::vector<Bytes> frames;  // the movie's video chunks in file order
    std::vector<uint32_t> indexFlags;
};

uint32_t U32(const Bytes& d, size_t at)
{
    uint32_t v;
    std::memcpy(&v, d.data() + at, 4);
    return v;
}

int16_t I16(const Bytes& d, size_t at)
{
    int16_t v;
    std::memcpy(&v, d.data() + at, 2);
    return v;
}

bool Is(const Bytes& d, size_t at, const char* id)
{
    return std::memcmp(d.data() + at, id, 4) == 0;
}

void ReadChunks(const Bytes& d, size_t at, size_t end, AviContents& out)
{
    while (at + 8 <= end) {
        size_t size = U32(d, at + 4);
        size_t body = at + 8;
        if (size > end - body)
            return;  // truncated: what was read so far stands
        if (Is(d, at, "LIST") && size >= 4) {
            ReadChunks(d, body + 4, body + size, out);
        } else if (Is(d, at, "avih") && size >= 20) {
            out.totalFrames = U32(d, body + 16);
        } else if (Is(d, at, "strh") && size >= 56) {
            out.fccType = U32(d, body);
            out.fccHandler = U32(d, body + 4);
            out.scale = U32(d, body + 20);
            out.rate = U32(d, body + 24);
            out.length = U32(d, body + 32);
            out.frameWidth = I16(d, body + 52) - I16(d, body + 48);
            out.frameHeight = I16(d, body + 54) - I16(d, body + 50);
        } else if (Is(d, at, "strf")) {
            out.format.assign(d.begin() + body, d.begin() + body + size);
        } else if (Is(d, at, "strn")) {
            out.name.assign(reinterpret_cast<const char*>(d.data() + body), strnlen(reinterpret_cast<const char*>(d.data() + body), size));
        } else if (Is(d, at, "00db") || Is(d, at, "00dc")) {
            out.frames.emplace_back(d.begin() + body, d.begin() + body + size);
        } else if (Is(d, at, "idx1")) {
            for (size_t e = body; e + 16 <= body + size; e += 16)
                out.indexFlags.push_back(U32(d, e + 4));
        }
        at = body + size + (size & 1);
    }
}

AviContents ReadAvi(const std::string& path)
{
    AviContents out;
    Bytes d;
    if (std::FILE* f = std::fopen(path.c_str(), "rb")) {
        unsigned char buffer[65536];
        for (size_t n; (n = std::fread(buffer, 1, sizeof(buffer), f)) > 0;)
            d.insert(d.end(), buffer, buffer + n);
        std::fclose(f);
    }
    if (d.size() < 12 || !Is(d, 0, "RIFF") || !Is(d, 8, "AVI "))
        return out;
    out.riff = true;
    ReadChunks(d, 12, std::min<size_t>(d.size(), 8 + size_t(U32(d, 4))), out);
    return out;
}

// Answers the compressor dialog that this thread is about to show: a helper thread waits for
// the dialog and presses one of its buttons, as a user would.
class DialogAnswer {
public:
    explicit DialogAnswer(int button) : owner_(GetCurrentThreadId()), button_(button), thread_([this] { Wait(); }) {}
    ~DialogAnswer()
    {
        stop_ = true;
        thread_.join();
    }
    bool Answered() const { return answered_; }

private:
    static BOOL CALLBACK FindDialog(HWND hwnd, LPARAM found)
    {
        char name[16] = {};
        GetClassNameA(hwnd, name, sizeof(name));
        if (std::strcmp(name, "#32770") != 0 || !IsWindowVisible(hwnd))
            return TRUE;
        *reinterpret_cast<HWND*>(found) = hwnd;
        return FALSE;
    }

    void Wait()
    {
        for (int waited = 0; waited < 10000 && !stop_; waited += 20) {
            HWND dialog = nullptr;
            EnumThreadWindows(owner_, FindDialog, reinterpret_cast<LPARAM>(&dialog));
            if (dialog) {
                if (HWND list = FindWindowExA(dialog, nullptr, "ComboBox", nullptr))
                    SendMessageA(list, CB_SETCURSEL, 0, 0);  // the first choice: full frames, uncompressed
                PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(button_, BN_CLICKED),
                             reinterpret_cast<LPARAM>(GetDlgItem(dialog, button_)));
                answered_ = true;
                return;
            }
            Sleep(20);
        }
    }

    DWORD owner_;
    int button_;
    std::atomic<bool> stop_{false};
    std::atomic<bool> answered_{false};
    std::thread thread_;  // last: starts once the rest is set
};

// A fresh path in the temporary folder, removed again after the test.
class MovieFile : public ::testing::Test {
protected:
    void SetUp() override
    {
        char folder[MAX_PATH];
        GetTempPathA(MAX_PATH, folder);
        const ::testing::TestInfo* test = ::testing::UnitTest::GetInstance()->current_test_info();
        path = std::string(folder) + "karvel_" + test->name() + ".avi";
        DeleteFileA(path.c_str());
    }
    void TearDown() override { DeleteFileA(path.c_str()); }

    bool Exists() const { return GetFileAttributesA(path.c_str()) != INVALID_FILE_ATTRIBUTES; }

    // Records the frames uncompressed, the first one starting the movie.
    void Record(std::vector<_DorBitmap>& frames, int rate, const char* name)
    {
        CVelMathMovie_NoComp movie;
        ASSERT_EQ(movie.Start(frames[0], path.c_str(), rate, name, static_cast<int>(frames.size())), 1);
        for (_DorBitmap& f : frames)
            ASSERT_EQ(movie.Add(f), 1);
        movie.End();
    }

    void ExpectFrames(const AviContents& avi, const std::vector<_DorBitmap>& frames)
    {
        ASSERT_TRUE(avi.riff);
        EXPECT_EQ(avi.fccType, mmioFOURCC('v', 'i', 'd', 's'));
        EXPECT_EQ(avi.totalFrames, frames.size());
        EXPECT_EQ(avi.length, frames.size());
        ASSERT_EQ(avi.frames.size(), frames.size());
        ASSERT_EQ(avi.indexFlags.size(), frames.size());
        for (size_t i = 0; i < frames.size(); ++i) {
            EXPECT_TRUE(avi.frames[i] == Pixels(frames[i])) << "frame " << i;
            EXPECT_TRUE(avi.indexFlags[i] & AVIIF_KEYFRAME) << "frame " << i;
        }
    }

    std::string path;
};

}  // namespace

TEST_F(MovieFile, TrueColourFramesReadBackWithSizeRateAndOneCharacterName)
{
    for (int bits : {24, 32}) {
        std::vector<_DorBitmap> frames;
        for (int i = 0; i < 3; ++i)
            frames.push_back(PatternFrame(37, 21, bits, i));  // odd width: padded 24-bit rows
        Record(frames, 15, "Camera");
        AviContents avi = ReadAvi(path);
        ExpectFrames(avi, frames);
        EXPECT_EQ(avi.rate / avi.scale, 15u) << bits;
        EXPECT_EQ(avi.fccHandler, mmioFOURCC('D', 'I', 'B', ' '));
        EXPECT_EQ(avi.name, "C");
        EXPECT_EQ(avi.frameWidth, 37);
        EXPECT_EQ(avi.frameHeight, 21);
        ASSERT_EQ(avi.format.size(), sizeof(BITMAPINFOHEADER)) << bits;
        const BITMAPINFOHEADER* header = reinterpret_cast<const BITMAPINFOHEADER*>(avi.format.data());
        EXPECT_EQ(header->biWidth, 37);
        EXPECT_EQ(header->biHeight, 21);
        EXPECT_EQ(header->biBitCount, bits);
    }
}

TEST_F(MovieFile, PalettedFramesCarryTheirPaletteInTheStreamFormat)
{
    std::vector<_DorBitmap> frames = {PatternFrame(16, 9, 8, 1), PatternFrame(16, 9, 8, 2)};
    Record(frames, 30, "p");
    AviContents avi = ReadAvi(path);
    ExpectFrames(avi, frames);
    ASSERT_EQ(avi.format.size(), sizeof(BITMAPINFOHEADER) + 256 * sizeof(RGBQUAD));
    EXPECT_EQ(std::memcmp(avi.format.data() + sizeof(BITMAPINFOHEADER), frames[0].palette.GetData(), 1024), 0);
}

TEST_F(MovieFile, StartOnAMissingFolderFailsAndCreatesNothing)
{
    std::string missing = path + ".folder\\movie.avi";
    _DorBitmap frame = PatternFrame(8, 8, 24, 0);
    CVelMathMovie_NoComp plain;
    EXPECT_EQ(plain.Start(frame, missing.c_str(), 10, "m", 1), 0);
    EXPECT_EQ(plain.IsStart(), 0);
    CVelMathMovie compressed;  // fails before any dialog could appear
    EXPECT_EQ(compressed.Start(frame, missing.c_str(), 10, "m", 1), 0);
    EXPECT_EQ(compressed.IsStart(), 0);
    EXPECT_EQ(GetFileAttributesA(missing.c_str()), INVALID_FILE_ATTRIBUTES);
}

TEST_F(MovieFile, OnlyTheDepthsAPlayerShowsStartARecording)
{
    for (int bits : {1, 2, 4, 8, 15, 16, 24, 32}) {
        _DorBitmap frame;
        frame.info.width = 8;
        frame.info.height = 4;
        frame.info.bitCount = static_cast<uint16_t>(bits);
        frame.bits.SetSize(DorBitmapRowBytes(8, bits) * 4);
        bool accepted = bits == 1 || bits == 8 || bits == 16 || bits == 24 || bits == 32;
        CVelMathMovie_NoComp movie;
        EXPECT_EQ(movie.Start(frame, path.c_str(), 10, "d", 1), accepted ? 1 : 0) << bits << " bits";
        EXPECT_EQ(movie.IsStart(), accepted ? 1 : 0) << bits << " bits";
        if (accepted) {
            EXPECT_EQ(movie.Add(frame), 1) << bits << " bits";
        }
    }
}

TEST_F(MovieFile, FrameOfAnotherShapeIsRefusedWithoutLeavingAGap)
{
    std::vector<_DorBitmap> kept = {PatternFrame(20, 10, 24, 1), PatternFrame(20, 10, 24, 2)};
    _DorBitmap wider = PatternFrame(21, 10, 24, 3);
    _DorBitmap taller = PatternFrame(20, 11, 24, 4);
    _DorBitmap deeper = PatternFrame(20, 10, 32, 5);
    CVelMathMovie_NoComp movie;
    ASSERT_EQ(movie.Start(kept[0], path.c_str(), 10, "g", 2), 1);
    EXPECT_EQ(movie.Add(kept[0]), 1);
    EXPECT_EQ(movie.Add(wider), 0);
    EXPECT_EQ(movie.Add(taller), 0);
    EXPECT_EQ(movie.Add(deeper), 0);
    EXPECT_EQ(movie.frame, 1);
    EXPECT_EQ(movie.Add(kept[1]), 1);
    movie.End();
    ExpectFrames(ReadAvi(path), kept);
}

TEST_F(MovieFile, IsStartFollowsTheLifecycle)
{
    _DorBitmap frame = PatternFrame(8, 8, 24, 0);
    CVelMathMovie_NoComp movie;
    EXPECT_EQ(movie.IsStart(), 0);
    EXPECT_EQ(movie.Add(frame), 0);  // not started: nothing to write to
    ASSERT_EQ(movie.Start(frame, path.c_str(), 10, "l", 1), 1);
    EXPECT_EQ(movie.IsStart(), 1);
    EXPECT_EQ(movie.frame, 0);
    movie.End();
    EXPECT_EQ(movie.IsStart(), 0);
    EXPECT_EQ(movie.Add(frame), 0);
    // A second recording with the same recorder starts from frame 0 again.
    std::vector<_DorBitmap> frames = {PatternFrame(8, 8, 24, 7)};
    ASSERT_EQ(movie.Start(frames[0], path.c_str(), 10, "l", 1), 1);
    EXPECT_EQ(movie.Add(frames[0]), 1);
    movie.End();
    ExpectFrames(ReadAvi(path), frames);
}

TEST_F(MovieFile, RecorderDestroyedWhileRecordingClosesItsFile)
{
    std::vector<_DorBitmap> frames = {PatternFrame(12, 6, 24, 1), PatternFrame(12, 6, 24, 2)};
    {
        CVelMathMovie_NoComp movie;
        ASSERT_EQ(movie.Start(frames[0], path.c_str(), 10, "d", 2), 1);
        ASSERT_EQ(movie.Add(frames[0]), 1);
        ASSERT_EQ(movie.Add(frames[1]), 1);
    }
    ExpectFrames(ReadAvi(path), frames);
    EXPECT_TRUE(DeleteFileA(path.c_str()));  // nothing holds it open any more
}

TEST_F(MovieFile, CancelledCompressorDialogLeavesTheRecorderIdle)
{
    _DorBitmap frame = PatternFrame(16, 16, 24, 0);
    CVelMathMovie movie;
    int started;
    {
        DialogAnswer cancel(IDCANCEL);
        started = movie.Start(frame, path.c_str(), 25, "x", 1);
        ASSERT_TRUE(cancel.Answered());
    }
    EXPECT_EQ(started, 0);
    EXPECT_EQ(movie.IsStart(), 0);
    EXPECT_EQ(movie.Add(frame), 0);
    ASSERT_TRUE(Exists());  // created before the dialog, and left empty
    EXPECT_FALSE(ReadAvi(path).riff);
}

TEST_F(MovieFile, FullFramesChosenInTheDialogWritesAReadableMovie)
{
    std::vector<_DorBitmap> frames = {PatternFrame(30, 20, 24, 1), PatternFrame(30, 20, 24, 2),
                                      PatternFrame(30, 20, 24, 3)};
    CVelMathMovie movie;
    {
        DialogAnswer confirm(IDOK);
        ASSERT_EQ(movie.Start(frames[0], path.c_str(), 12, "Zoom", 3), 1);
        ASSERT_TRUE(confirm.Answered());
    }
    EXPECT_EQ(movie.IsStart(), 1);
    EXPECT_EQ(movie.compressor.fccHandler, mmioFOURCC('D', 'I', 'B', ' '));
    _DorBitmap wider = PatternFrame(31, 20, 24, 9);
    for (_DorBitmap& f : frames) {
        EXPECT_EQ(movie.Add(f), 1);
        EXPECT_EQ(movie.Add(wider), 0);
    }
    EXPECT_EQ(movie.frame, 3);
    movie.End();
    EXPECT_EQ(movie.IsStart(), 0);
    AviContents avi = ReadAvi(path);
    ExpectFrames(avi, frames);
    EXPECT_EQ(avi.rate / avi.scale, 12u);
    EXPECT_EQ(avi.name, "Z");
    EXPECT_EQ(avi.fccHandler, mmioFOURCC('D', 'I', 'B', ' '));
}

TEST_F(MovieFile, CompressedRecorderDestroyedWhileRecordingClosesItsFile)
{
    std::vector<_DorBitmap> frames = {PatternFrame(8, 8, 32, 1)};
    {
        CVelMathMovie movie;
        DialogAnswer confirm(IDOK);
        ASSERT_EQ(movie.Start(frames[0], path.c_str(), 5, "d", 1), 1);
        ASSERT_EQ(movie.Add(frames[0]), 1);
    }
    ExpectFrames(ReadAvi(path), frames);
    EXPECT_TRUE(DeleteFileA(path.c_str()));
}

TEST_F(MovieFile, GdiBitmapsAreRecordedAtTheirOwnSizeAndDepth)
{
    // Rows without padding: GDI does not keep what a frame holds past the pixels of a row.
    std::vector<_DorBitmap> frames = {PatternFrame(28, 14, 8, 1), PatternFrame(28, 14, 8, 2)};
    HBITMAP first = CreateDibSectionOf(frames[0]);
    HBITMAP second = CreateDibSectionOf(frames[1]);
    HBITMAP wider = CreateDibSectionOf(PatternFrame(29, 14, 8, 3));
    HBITMAP deeper = CreateDibSectionOf(PatternFrame(28, 14, 24, 4));
    CVelMathMovie_NoComp movie;
    ASSERT_EQ(movie.Start(first, path.c_str(), 20, "g", 2), 1);
    EXPECT_EQ(movie.Add(first), 1);
    EXPECT_EQ(movie.Add(wider), 0);
    EXPECT_EQ(movie.Add(deeper), 0);
    EXPECT_EQ(movie.Add(static_cast<HBITMAP>(nullptr)), 0);
    EXPECT_EQ(movie.Add(second), 1);
    movie.End();
    for (HBITMAP b : {first, second, wider, deeper})
        DeleteObject(b);

    AviContents avi = ReadAvi(path);
    ExpectFrames(avi, frames);
    ASSERT_EQ(avi.format.size(), sizeof(BITMAPINFOHEADER) + 256 * sizeof(RGBQUAD));
    EXPECT_EQ(std::memcmp(avi.format.data() + sizeof(BITMAPINFOHEADER), frames[0].palette.GetData(), 1024), 0);
}

TEST_F(MovieFile, NoGdiBitmapStartsNothing)
{
    CVelMathMovie_NoComp movie;
    EXPECT_EQ(movie.Start(static_cast<HBITMAP>(nullptr), path.c_str(), 20, "n", 1), 0);
    EXPECT_EQ(movie.IsStart(), 0);
}
