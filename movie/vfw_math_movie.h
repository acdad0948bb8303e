#pragma once
/// @file
/// AVI recorders: Start with the first frame, Add once per frame, End. CVelMathMovie compresses
/// through the codec the user picks in the system's compressor dialog; CVelMathMovie_NoComp
/// writes the frames as they are. Frames are _DorBitmap records of one size and depth (1, 8, 16,
/// 24 or 32 bits), or GDI bitmaps, which are read at their own size and depth; the recorder
/// copies what it writes and never keeps a frame. Every frame is a key frame.
///
/// Failures are a 0 result and nothing else: a path that cannot be created, an unsupported bit
/// count, a cancelled compressor dialog, a failing AVIFile call, a frame of another size or
/// depth, Add before Start. Start refuses, touching nothing, while the recorder is recording (the
/// file being written stays whole: End it first) and for a frame without pixels (width or height
/// 0). A Start that fails later leaves the recorder idle, the AVI library closed and no file at
/// path (one that was there is lost: Start overwrites from the moment it creates the file). Windows only. A recorder is used from one thread at a
/// time (the compressor dialog is modal on the calling thread). An MFC host gets the CBitmap
/// overloads by including its MFC headers first.
#include <windows.h>
#include <vfw.h>

#include "../model/dor_types.h"
#include "../model/export.h"

/// The compressing recorder: the user picks the codec in the system's dialog at Start.
class KARVEL_API CVelMathMovie {
public:
    /// Idle: nothing open, frame 0.
    CVelMathMovie();
    /// Ends a recording still running.
    virtual ~CVelMathMovie();

    /// Creates (or truncates) the AVI file at path for frames like bitmap, after the user has
    /// chosen a compressor. rate is in frames per second, length is the stream length in frames
    /// written to the stream header; of name only the first character is used. Writes no frame:
    /// Add the first one too. Returns 1 started, or 0: refused (while
    /// recording, a frame without pixels) or failed, leaving no file at path.
    int Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length);
    /// @copydoc Start(_DorBitmap&, const char*, int, const char*, int)
    int Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length);
    /// Writes bitmap as the next key frame. Returns 1, or 0 (nothing written, the recorder
    /// still usable) when not started or when the frame's width, height or depth differs from
    /// Start's.
    int Add(_DorBitmap& bitmap);
    /// @copydoc Add(_DorBitmap&)
    int Add(HBITMAP bitmap);
    /// Closes the streams and the file, frees the compressor and the AVI library; idle again.
    /// Call it only while recording (IsStart): it does not check, as it never has, and an idle
    /// End releases the AVI library once more than it was opened.
    void End();
    /// 1 between a successful Start and End, else 0.
    int IsStart();
#if defined(__AFXWIN_H__)
    /// @copydoc Start(_DorBitmap&, const char*, int, const char*, int)
    int Start(CBitmap& bitmap, const char* path, int rate, const char* name, int length)
    {
        return Start(static_cast<HBITMAP>(bitmap.GetSafeHandle()), path, rate, name, length);
    }
    /// @copydoc Add(_DorBitmap&)
    int Add(CBitmap& bitmap) { return Add(static_cast<HBITMAP>(bitmap.GetSafeHandle())); }
#endif

    BITMAPINFOHEADER format;  ///< Of the frames, from the bitmap given to Start.
    PAVIFILE file;            ///< The open AVI file.
    PAVISTREAM stream;        ///< The video stream in it.
    PAVISTREAM compressedStream;  ///< Laid over stream.
    int frame;    ///< Index of the next frame to write.
    int started;  ///< 1 between a successful Start and End.
    COMPVARS compressor;  ///< Chosen in the dialog.
};

/// The uncompressed recorder: the frames are written as they are, without a dialog.
class KARVEL_API CVelMathMovie_NoComp {
public:
    /// Idle: nothing open, frame 0.
    CVelMathMovie_NoComp();
    /// Ends a recording still running.
    virtual ~CVelMathMovie_NoComp();

    /// Creates (or truncates) the AVI file at path for frames like bitmap. rate is in frames per
    /// second, length is the stream length in frames written to the stream header; of name only
    /// the first character is used. Writes no frame: Add the first one too. Returns 1 started,
    /// or 0: refused (while recording, a frame without pixels) or failed, leaving no file at path.
    int Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length);
    /// @copydoc Start(_DorBitmap&, const char*, int, const char*, int)
    int Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length);
    /// Writes bitmap as the next key frame. Returns 1, or 0 (nothing written, the recorder
    /// still usable) when not started or when the frame's width, height or depth differs from
    /// Start's.
    int Add(_DorBitmap& bitmap);
    /// @copydoc Add(_DorBitmap&)
    int Add(HBITMAP bitmap);
    /// Closes the stream and the file and the AVI library; idle again. Call it only while
    /// recording, as CVelMathMovie::End.
    void End();
    /// 1 between a successful Start and End, else 0.
    int IsStart();
#if defined(__AFXWIN_H__)
    /// @copydoc Start(_DorBitmap&, const char*, int, const char*, int)
    int Start(CBitmap& bitmap, const char* path, int rate, const char* name, int length)
    {
        return Start(static_cast<HBITMAP>(bitmap.GetSafeHandle()), path, rate, name, length);
    }
    /// @copydoc Add(_DorBitmap&)
    int Add(CBitmap& bitmap) { return Add(static_cast<HBITMAP>(bitmap.GetSafeHandle())); }
#endif

    BITMAPINFOHEADER format;  ///< Of the frames, from the bitmap given to Start.
    PAVIFILE file;            ///< The open AVI file.
    PAVISTREAM stream;        ///< The video stream in it.
    int frame;    ///< Index of the next frame to write.
    int started;  ///< 1 between a successful Start and End.
};
