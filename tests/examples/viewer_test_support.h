#pragma once
// Files for the viewer's loader tests: BMP images built byte by byte and a scratch folder.
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace viewer_test {

// Little-endian, as BMP headers store their fields.
inline void PutU16(std::vector<unsigned char>& b, size_t at, uint32_t v) { b[at] = v & 0xFF, b[at + 1] = (v >> 8) & 0xFF; }
inline void PutU32(std::vector<unsigned char>& b, size_t at, uint32_t v) { PutU16(b, at, v), PutU16(b, at + 2, v >> 16); }

// A BMP file whose pixel (x, y), counted from the bottom row, has blue x, green y, red 200
// (and alpha 255 at 32 bits). A negative height stores the rows top-down, as BMP allows.
inline std::vector<unsigned char> BmpFile(int width, int height, int bitCount)
{
    const int rows = height < 0 ? -height : height, rowBytes = ((width * bitCount + 31) / 32) * 4;
    std::vector<unsigned char> b(54 + static_cast<size_t>(rowBytes) * rows, 0);
    PutU16(b, 0, 'B' | 'M' << 8);
    PutU32(b, 2, static_cast<uint32_t>(b.size()));
    PutU32(b, 10, 54);
    PutU32(b, 14, 40);
    PutU32(b, 18, static_cast<uint32_t>(width));
    PutU32(b, 22, static_cast<uint32_t>(height));
    PutU32(b, 26, 1 | static_cast<uint32_t>(bitCount) << 16);  // planes, bits per pixel
    for (int y = 0; y < rows; ++y)
        for (int x = 0; x < width; ++x) {
            unsigned char* p = &b[54 + static_cast<size_t>(height < 0 ? rows - 1 - y : y) * rowBytes + static_cast<size_t>(x) * (bitCount / 8)];
            p[0] = static_cast<unsigned char>(x), p[1] = static_cast<unsigned char>(y), p[2] = 200;
            if (bitCount == 32)
                p[3] = 255;
        }
    return b;
}

// A fresh folder under the system's temporary folder, removed with the object.
class ScratchDir {
public:
    explicit ScratchDir(const std::string& name) : path_(std::filesystem::temp_directory_path() / ("karvel_" + name))
    {
        std::filesystem::remove_all(path_);
        std::filesystem::create_directories(path_);
    }
    ~ScratchDir()
    {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    // Path("") is the folder with a trailing separator, as the loader resolves names against it.
    std::string Path(const std::string& file) const { return (path_ / file).string(); }
    template <class Bytes>  // a std::string or a std::vector<unsigned char>
    void Write(const std::string& file, const Bytes& bytes) const
    {
        std::ofstream(Path(file), std::ios::binary).write(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    }

private:
    std::filesystem::path path_;
};

}  // namespace viewer_test
