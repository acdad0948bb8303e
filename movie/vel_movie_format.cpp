#include "movie/vel_movie_format.h"

#include <cstring>

VelAviStreamInfo VelMovieStreamInfo(const DorBitmapInfoHeader& format, int rate, const char* name, int length)
{
    VelAviStreamInfo info;
    std::memset(&info, 0, sizeof(info));
    info.fccType = VelFourCC('v', 'i', 'd', 's');
    info.fccHandler = VelFourCC('D', 'I', 'B', ' ');
    info.scale = 1;
    info.rate = static_cast<uint32_t>(rate);
    info.length = static_cast<uint32_t>(length);
    info.quality = 0xFFFFFFFFu;  // the codec's default quality
    info.frameRight = format.width;
    info.frameBottom = format.height;
    if (name)
        info.name[0] = name[0];
    return info;
}

bool VelMovieFormatBlock(const _DorBitmap& frame, CDorArray<unsigned char, unsigned char>& block)
{
    int entries;
    switch (frame.info.bitCount) {
    case 1:
    case 8:
    case 16:
        entries = frame.palette.GetSize();
        break;
    case 24:
    case 32:
        entries = 0;
        break;
    default:
        return false;
    }
    const int headerBytes = static_cast<int>(sizeof(DorBitmapInfoHeader));
    block.SetSize(headerBytes + entries * static_cast<int>(sizeof(DorRgbQuad)));
    std::memcpy(block.GetData(), &frame.info, headerBytes);
    if (entries > 0)
        std::memcpy(block.GetData() + headerBytes, frame.palette.GetData(), entries * sizeof(DorRgbQuad));
    return true;
}

bool VelMovieMayStart(int started, const DorBitmapInfoHeader& frame)
{
    return !started && frame.width > 0 && frame.height != 0;
}

bool VelMovieFrameFits(const DorBitmapInfoHeader& format, const _DorBitmap& frame)
{
    return frame.info.width == format.width && frame.info.height == format.height &&
           frame.info.bitCount == format.bitCount;
}

uint32_t VelMovieCompressFlags(long dataRate, long keyFrameEvery)
{
    if (dataRate >= 1)
        return kVelCompressDataRate;
    if (keyFrameEvery >= 1)
        return kVelCompressKeyFrames;
    return 0;
}
