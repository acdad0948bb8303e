#pragma once
// AVI recorders: Start with the first frame, Add once per frame, End. CVelMathMovie compresses
// through the codec the user picks in the system's compressor dialog; CVelMathMovie_NoComp
// writes the frames as they are. Frames are _DorBitmap records of one size and depth (1, 8, 16,
// 24 or 32 bits), or GDI bitmaps, which are read at their own size and depth. Every frame is a
// key frame. Failures are a 0 result; a failed Start leaves the recorder idle and the AVI
// library closed. Windows only; an MFC host gets the CBitmap overloads by including its MFC
// headers first.
#include <windows.h>
#include <vfw.h>

#include "../model/dor_types.h"
#include "../model/export.h"

class KARVEL_API CVelMathMovie {
public:
    CVelMathMovie();
    virtual ~CVelMathMovie();

    // rate is in frames per second, length is the stream length in frames written to the stream
    // header; of name only the first character is used.
    int Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length);
    int Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length);
    int Add(_DorBitmap& bitmap);
    int Add(HBITMAP bitmap);
    void End();
    int IsStart();
#if defined(__AFXWIN_H__)
    int Start(CBitmap& bitmap, const char* path, int rate, const char* name, int length)
    {
        return Start(static_cast<HBITMAP>(bitmap.GetSafeHandle()), path, rate, name, length);
    }
    int Add(CBitmap& bitmap) { return Add(static_cast<HBITMAP>(bitmap.GetSafeHandle())); }
#endif

    BITMAPINFOHEADER format;  // of the frames, from the bitmap given to Start
    PAVIFILE file;
    PAVISTREAM stream;
    PAVISTREAM compressedStream;  // laid over stream
    int frame;    // index of the next frame to write
    int started;  // 1 between a successful Start and End
    COMPVARS compressor;  // chosen in the dialog
};

class KARVEL_API CVelMathMovie_NoComp {
public:
    CVelMathMovie_NoComp();
    virtual ~CVelMathMovie_NoComp();

    int Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length);
    int Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length);
    int Add(_DorBitmap& bitmap);
    int Add(HBITMAP bitmap);
    void End();
    int IsStart();
#if defined(__AFXWIN_H__)
    int Start(CBitmap& bitmap, const char* path, int rate, const char* name, int length)
    {
        return Start(static_cast<HBITMAP>(bitmap.GetSafeHandle()), path, rate, name, length);
    }
    int Add(CBitmap& bitmap) { return Add(static_cast<HBITMAP>(bitmap.GetSafeHandle())); }
#endif

    BITMAPINFOHEADER format;
    PAVIFILE file;
    PAVISTREAM stream;
    int frame;
    int started;
};
