#pragma once
// What the AVI recorders write, decided apart from the AVIFile calls: the stream header, the
// accepted frame depths and the stream format block, the frames a started recorder takes, and
// the compression flags derived from the user's compressor choice.
#include <cstdint>

#include "model/dor_types.h"

constexpr uint32_t VelFourCC(char a, char b, char c, char d)
{
    return uint32_t(uint8_t(a)) | uint32_t(uint8_t(b)) << 8 | uint32_t(uint8_t(c)) << 16 |
           uint32_t(uint8_t(d)) << 24;
}

// Field for field the Video for Windows AVISTREAMINFOA.
struct VelAviStreamInfo {
    uint32_t fccType;
    uint32_t fccHandler;
    uint32_t flags;
    uint32_t caps;
    uint16_t priority;
    uint16_t language;
    uint32_t scale;
    uint32_t rate;
    uint32_t start;
    uint32_t length;
    uint32_t initialFrames;
    uint32_t suggestedBufferSize;
    uint32_t quality;
    uint32_t sampleSize;
    int32_t frameLeft, frameTop, frameRight, frameBottom;
    uint32_t editCount;
    uint32_t formatChangeCount;
    char name[64];
};

// The values of AVICOMPRESSOPTIONS::dwFlags that the compressed recorder uses.
enum : uint32_t { kVelCompressDataRate = 0x2, kVelCompressKeyFrames = 0x4 };

// An uncompressed video stream of rate frames per second and the given length in frames, framed
// to the header's size. Only name's first character names the stream: hosts depend on that.
VelAviStreamInfo VelMovieStreamInfo(const DorBitmapInfoHeader& format, int rate, const char* name, int length);

// The stream format for frames like this one: the information header, followed by the frame's
// palette for 1, 8 and 16 bits. Returns false for any other depth than 1, 8, 16, 24 and 32.
bool VelMovieFormatBlock(const _DorBitmap& frame, CDorArray<unsigned char, unsigned char>& block);

// Whether a recorder may start on frame: never while it records (the file being written is kept
// whole), and only on a frame with pixels (width above 0, height not 0; negative is top-down).
bool VelMovieMayStart(int started, const DorBitmapInfoHeader& frame);

// A recording takes only frames of the width, height and depth it started with.
bool VelMovieFrameFits(const DorBitmapInfoHeader& format, const _DorBitmap& frame);

// A data rate wins over a key-frame interval; neither set means no flags.
uint32_t VelMovieCompressFlags(long dataRate, long keyFrameEvery);
