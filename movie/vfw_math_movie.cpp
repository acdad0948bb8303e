#include "movie/vfw_math_movie.h"

#include <cstddef>
#include <cstdio>
#include <cstring>

#include "model/dor_layout_check.h"
#include "movie/gdi_frame.h"
#include "movie/vel_movie_format.h"

static_assert(sizeof(VelAviStreamInfo) == sizeof(AVISTREAMINFOA), "stream info differs from AVIFile's");
static_assert(offsetof(VelAviStreamInfo, frameLeft) == offsetof(AVISTREAMINFOA, rcFrame), "stream info differs");
static_assert(offsetof(VelAviStreamInfo, name) == offsetof(AVISTREAMINFOA, szName), "stream info differs");

// The recorders' fields are part of the binary interface: hosts allocate the recorders.
KARVEL_FIELD(CVelMathMovie, format, KARVEL_PICK(4, 8));
KARVEL_FIELD(CVelMathMovie, file, KARVEL_PICK(44, 48));
KARVEL_FIELD(CVelMathMovie, stream, KARVEL_PICK(48, 56));
KARVEL_FIELD(CVelMathMovie, compressedStream, KARVEL_PICK(52, 64));
KARVEL_FIELD(CVelMathMovie, frame, KARVEL_PICK(56, 72));
KARVEL_FIELD(CVelMathMovie, started, KARVEL_PICK(60, 76));
KARVEL_FIELD(CVelMathMovie, compressor, KARVEL_PICK(64, 80));
KARVEL_FIELD(CVelMathMovie_NoComp, file, KARVEL_PICK(44, 48));
KARVEL_FIELD(CVelMathMovie_NoComp, stream, KARVEL_PICK(48, 56));
KARVEL_FIELD(CVelMathMovie_NoComp, frame, KARVEL_PICK(52, 64));
KARVEL_FIELD(CVelMathMovie_NoComp, started, KARVEL_PICK(56, 68));

static_assert(kVelCompressDataRate == AVICOMPRESSF_DATARATE && kVelCompressKeyFrames == AVICOMPRESSF_KEYFRAMES,
              "compression flags differ from AVIFile's");

namespace {

typedef CDorArray<unsigned char, unsigned char> ByteArray;

// fopen first, so that a path in a missing folder fails before the AVI library is opened; the
// file is left created and empty until the recorder opens it or Abandon removes it.
bool CreateEmptyFile(const char* path)
{
    std::FILE* f = path ? std::fopen(path, "wb") : nullptr;
    if (!f)
        return false;
    std::fclose(f);
    return true;
}

// A Start that fails after creating the file removes it: no empty movie is left behind.
int Abandon(const char* path)
{
    std::remove(path);
    return 0;
}

// The stream header and the format block for frames like bitmap, with the header copied into
// format. Returns false for a depth the recorders do not take.
bool DescribeStream(const _DorBitmap& bitmap, int rate, const char* name, int length, AVISTREAMINFOA& info,
                    BITMAPINFOHEADER& format, ByteArray& block)
{
    VelAviStreamInfo portable = VelMovieStreamInfo(bitmap.info, rate, name, length);
    std::memcpy(&info, &portable, sizeof(info));
    std::memcpy(&format, &bitmap.info, sizeof(format));
    return VelMovieFormatBlock(bitmap, block);
}

// Opens the AVI file and creates its video stream; leaves both null when either fails.
bool OpenFileAndStream(const char* path, AVISTREAMINFOA& info, PAVIFILE& file, PAVISTREAM& stream)
{
    file = nullptr;
    stream = nullptr;
    if (AVIFileOpenA(&file, path, OF_WRITE | OF_CREATE | OF_SHARE_DENY_NONE, nullptr) != AVIERR_OK) {
        file = nullptr;
        return false;
    }
    if (AVIFileCreateStreamA(file, &stream, &info) != AVIERR_OK) {
        AVIFileRelease(file);
        file = nullptr;
        stream = nullptr;
        return false;
    }
    return true;
}

void ReleaseStream(PAVISTREAM& stream)
{
    if (stream)
        AVIStreamRelease(stream);
    stream = nullptr;
}

void ReleaseFile(PAVIFILE& file)
{
    if (file)
        AVIFileRelease(file);
    file = nullptr;
}

bool SetFormat(PAVISTREAM stream, ByteArray& block)
{
    return AVIStreamSetFormat(stream, 0, block.GetData(), block.GetSize()) == AVIERR_OK;
}

// Writes bitmap as key frame number frame and advances it; a frame of another size or depth, or
// a recorder that has not started, writes nothing.
int WriteFrame(PAVISTREAM target, const BITMAPINFOHEADER& format, int& frame, int started, _DorBitmap& bitmap)
{
    DorBitmapInfoHeader header;
    std::memcpy(&header, &format, sizeof(header));
    if (!started || !VelMovieFrameFits(header, bitmap))
        return 0;
    if (AVIStreamWrite(target, frame, 1, bitmap.bits.GetData(), bitmap.bits.GetSize(), AVIIF_KEYFRAME, nullptr,
                       nullptr) != AVIERR_OK)
        return 0;
    ++frame;
    return 1;
}

// The system's compressor dialog, offered the frames' format (header and palette). False when
// the user cancels.
bool ChooseCompressor(ByteArray& block, COMPVARS& compressor)
{
    std::memset(&compressor, 0, sizeof(compressor));
    compressor.cbSize = sizeof(COMPVARS);
    compressor.dwFlags = ICMF_COMPVARS_VALID;
    compressor.fccHandler = VelFourCC('D', 'I', 'B', ' ');
    compressor.lQ = ICQUALITY_DEFAULT;
    return ICCompressorChoose(nullptr, ICMF_CHOOSE_KEYFRAME | ICMF_CHOOSE_DATARATE, block.GetData(), nullptr,
                              &compressor, nullptr) != FALSE;
}

AVICOMPRESSOPTIONS CompressOptions(const COMPVARS& compressor)
{
    AVICOMPRESSOPTIONS options;
    std::memset(&options, 0, sizeof(options));
    options.fccType = streamtypeVIDEO;
    options.fccHandler = compressor.fccHandler;
    options.dwKeyFrameEvery = static_cast<DWORD>(compressor.lKey);
    options.dwQuality = static_cast<DWORD>(compressor.lQ);
    options.dwBytesPerSecond = static_cast<DWORD>(compressor.lDataRate);
    options.dwFlags = VelMovieCompressFlags(compressor.lDataRate, compressor.lKey);
    options.lpParms = compressor.lpState;
    options.cbParms = static_cast<DWORD>(compressor.cbState);
    return options;
}

template <class Recorder>
int StartWithGdiBitmap(Recorder& recorder, HBITMAP bitmap, const char* path, int rate, const char* name, int length)
{
    _DorBitmap copy;
    return VelReadGdiBitmap(bitmap, copy) ? recorder.Start(copy, path, rate, name, length) : 0;
}

template <class Recorder>
int AddGdiBitmap(Recorder& recorder, HBITMAP bitmap)
{
    _DorBitmap copy;
    return VelReadGdiBitmap(bitmap, copy) ? recorder.Add(copy) : 0;
}

}  // namespace

// --- compressed recorder ---

CVelMathMovie::CVelMathMovie()
    : file(nullptr), stream(nullptr), compressedStream(nullptr), frame(0), started(0)
{
    std::memset(&format, 0, sizeof(format));
    std::memset(&compressor, 0, sizeof(compressor));
}

CVelMathMovie::~CVelMathMovie()
{
    if (started)
        End();
}

int CVelMathMovie::Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length)
{
    if (!VelMovieMayStart(started, bitmap.info) || !CreateEmptyFile(path))
        return 0;
    frame = 0;
    AVISTREAMINFOA info;
    ByteArray block;
    if (!DescribeStream(bitmap, rate, name, length, info, format, block))
        return Abandon(path);

    AVIFileInit();
    if (!ChooseCompressor(block, compressor)) {
        AVIFileExit();
        return Abandon(path);
    }
    AVICOMPRESSOPTIONS options = CompressOptions(compressor);
    info.fccHandler = compressor.fccHandler;
    compressedStream = nullptr;
    bool open = OpenFileAndStream(path, info, file, stream) &&
                AVIMakeCompressedStream(&compressedStream, stream, &options, nullptr) == AVIERR_OK &&
                SetFormat(compressedStream, block);
    if (!open) {
        End();  // releases whatever was made, the compressor and the AVI library
        return Abandon(path);
    }
    frame = 0;
    started = 1;
    return 1;
}

int CVelMathMovie::Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length)
{
    return StartWithGdiBitmap(*this, bitmap, path, rate, name, length);
}

int CVelMathMovie::Add(_DorBitmap& bitmap)
{
    return WriteFrame(compressedStream, format, frame, started, bitmap);
}

int CVelMathMovie::Add(HBITMAP bitmap)
{
    return AddGdiBitmap(*this, bitmap);
}

void CVelMathMovie::End()
{
    ReleaseStream(compressedStream);
    ReleaseStream(stream);
    ReleaseFile(file);
    ICCompressorFree(&compressor);
    AVIFileExit();
    started = 0;
}

int CVelMathMovie::IsStart()
{
    return started;
}

// --- uncompressed recorder ---

CVelMathMovie_NoComp::CVelMathMovie_NoComp() : file(nullptr), stream(nullptr), frame(0), started(0)
{
    std::memset(&format, 0, sizeof(format));
}

CVelMathMovie_NoComp::~CVelMathMovie_NoComp()
{
    if (started)
        End();
}

int CVelMathMovie_NoComp::Start(_DorBitmap& bitmap, const char* path, int rate, const char* name, int length)
{
    if (!VelMovieMayStart(started, bitmap.info) || !CreateEmptyFile(path))
        return 0;
    frame = 0;
    AVISTREAMINFOA info;
    ByteArray block;
    if (!DescribeStream(bitmap, rate, name, length, info, format, block))
        return Abandon(path);

    AVIFileInit();
    if (!OpenFileAndStream(path, info, file, stream) || !SetFormat(stream, block)) {
        End();  // releases whatever was made and the AVI library
        return Abandon(path);
    }
    frame = 0;
    started = 1;
    return 1;
}

int CVelMathMovie_NoComp::Start(HBITMAP bitmap, const char* path, int rate, const char* name, int length)
{
    return StartWithGdiBitmap(*this, bitmap, path, rate, name, length);
}

int CVelMathMovie_NoComp::Add(_DorBitmap& bitmap)
{
    return WriteFrame(stream, format, frame, started, bitmap);
}

int CVelMathMovie_NoComp::Add(HBITMAP bitmap)
{
    return AddGdiBitmap(*this, bitmap);
}

void CVelMathMovie_NoComp::End()
{
    ReleaseStream(stream);
    ReleaseFile(file);
    AVIFileExit();
    started = 0;
}

int CVelMathMovie_NoComp::IsStart()
{
    return started;
}
