#pragma once
// Files for the viewer's tests: a BMP image built byte by byte and a scratch folder.
#include <cstdint>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace viewer_test {

// A black 24-bit bottom-up BMP file.
inline std::vector<unsigned char> BmpFile(int width, int height)
{
    std::vector<unsigned char> b(54 + static_cast<size_t>((width * 3 + 3) / 4 * 4) * height, 0);
    const uint32_t header[] = {static_cast<uint32_t>(b.size()), 0, 54, 40, static_cast<uint32_t>(width), static_cast<uint32_t>(height), 1 | 24 << 16};
    b[0] = 'B', b[1] = 'M';
    std::memcpy(&b[2], header, sizeof header);  // little-endian, as BMP stores its fields
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
