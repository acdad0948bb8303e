// The viewer program as a user runs it: its exit code, what it prints, the files it writes and
// how its window answers the mouse and keys. Each test starts karvel_viewer.exe as a process.
#include <gtest/gtest.h>
#include <windows.h>

#include <algorithm>
#include <numeric>
#include <regex>

#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

#include "examples/viewer_test_support.h"

namespace {
std::string Quoted(const std::string& path) { return "\"" + path + "\""; }

// The viewer started with its standard output and error in a pipe, working in folder (this
// program's when empty). A window it opens is driven with the messages a user's mouse and
// keyboard would send; each is handled before the next one is sent.
class Viewer {
public:
    explicit Viewer(const std::string& arguments, const std::string& folder = "")
    {
        SECURITY_ATTRIBUTES inherit = {sizeof(inherit), nullptr, TRUE};
        HANDLE writeEnd = nullptr;
        CreatePipe(&output_, &writeEnd, &inherit, 0);
        SetHandleInformation(output_, HANDLE_FLAG_INHERIT, 0);
        STARTUPINFOA startup = {};
        startup.cb = sizeof(startup);
        startup.dwFlags = STARTF_USESTDHANDLES;
        startup.hStdOutput = startup.hStdError = writeEnd;
        std::string command = Quoted(KARVEL_VIEWER_EXE) + " " + arguments;
        CreateProcessA(nullptr, &command[0], nullptr, nullptr, TRUE, 0, nullptr, folder.empty() ? nullptr : folder.c_str(),
                       &startup, &process_);
        CloseHandle(writeEnd);
    }
    ~Viewer()
    {
        if (process_.hProcess && WaitForSingleObject(process_.hProcess, 0) == WAIT_TIMEOUT)
            TerminateProcess(process_.hProcess, 3);
        CloseHandle(process_.hProcess);
        CloseHandle(process_.hThread);
        CloseHandle(output_);
    }
    // Waits up to a minute for the end: the exit code (~0 when none), and what was printed.
    // NOTE: under Wine a service that the viewer starts may inherit the pipe's write end and keep
    // it open, so the output ends when the process does, not when the pipe closes.
    DWORD Finish(std::string& output)
    {
        char buffer[4096];
        DWORD code = ~0u, got = 0, waiting = 0;
        for (int tries = 0, exited = 0; !exited && tries < 1200; ++tries) {
            exited = WaitForSingleObject(process_.hProcess, 50) == WAIT_OBJECT_0;
            while (PeekNamedPipe(output_, nullptr, 0, nullptr, &waiting, nullptr) && waiting > 0 &&
                   ReadFile(output_, buffer, sizeof buffer, &got, nullptr))
                output.append(buffer, got);
        }
        GetExitCodeProcess(process_.hProcess, &code);
        return code;
    }

    // Waits for the viewer's window, the only one a test opens.
    bool Open()
    {
        for (int tries = 0; tries < 200 && !(frame && IsWindowVisible(frame)); ++tries, Sleep(50))
            frame = FindWindowA("KarvelViewerFrame", nullptr);
        view = FindWindowExA(frame, nullptr, "KarvelViewerView", nullptr);
        if (!view) {  // NOTE: under Wine the viewer shows its view as a popup owned by the frame
            view = FindWindowA("KarvelViewerView", nullptr);
            if (view && GetWindow(view, GW_OWNER) != frame)
                view = nullptr;
        }
        status = FindWindowExA(frame, nullptr, "msctls_statusbar32", nullptr);
        return view && status;
    }
    void Mouse(UINT message, WPARAM keys, int x, int y) { SendMessageA(view, message, keys, MAKELPARAM(x, y)); }
    void Key(WPARAM key) { SendMessageA(view, WM_KEYDOWN, key, 0); }
    // Along y, in 10-pixel moves, as a hand would drag; a click when toX is within 10 of fromX.
    void Drag(UINT down, UINT up, WPARAM button, int fromX, int toX, int y)
    {
        Mouse(down, button, fromX, y);
        for (int x = fromX + 10; x <= toX; x += 10)
            Mouse(WM_MOUSEMOVE, button, x, y);
        Mouse(up, 0, toX, y);
    }
    std::string Status()
    {
        char text[512] = {};
        SendMessageA(status, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text));
        return text;
    }

    HWND frame = nullptr, view = nullptr, status = nullptr;

private:
    PROCESS_INFORMATION process_ = {};
    HANDLE output_ = nullptr;
};

// A PNG file's pixels, rows from the top.
struct Picture {
    int width = 0, height = 0, channels = 0;
    std::vector<unsigned char> rgb;

    explicit Picture(const std::string& png)
    {
        unsigned char* pixels = stbi_load(png.c_str(), &width, &height, &channels, 3);
        rgb.assign(pixels, pixels + (pixels ? width * height * 3 : 0));
        stbi_image_free(pixels);
    }
    // Red, green and blue at x, y; black outside a picture that could not be read.
    const unsigned char* At(int x, int y) const
    {
        static const unsigned char none[3] = {};
        return x < width && y < height ? &rgb[(y * width + x) * 3] : none;
    }
};

// A red box in front of a grey plate on a blue background, seen straight from -y: the box
// covers the middle of the picture, the plate a wider band behind it.
const char* kBoxScene = R"({"background": [0, 0, 1],
  "camera": {"eye": [0, -10, 0], "target": [0, 0, 0], "fovy": 40, "near": 1, "far": 100},
  "entities": [
    {"name": "red box", "type": "extrusion", "profile": [[-1, -1, -1], [1, -1, -1], [1, 1, -1], [-1, 1, -1]],
     "extrude": [0, 0, 2], "material": {"color": [1, 0, 0]}},
    {"name": "back plate", "type": "extrusion", "profile": [[-2.5, 3, -2], [2.5, 3, -2], [2.5, 3.5, -2], [-2.5, 3.5, -2]],
     "extrude": [0, 0, 4], "material": {"color": [0.6, 0.6, 0.6]}}]})";

class ViewerRun : public ::testing::Test {
protected:
    viewer_test::ScratchDir dir{"viewer_batch_test"};
    std::string scene = dir.Path("box.json");

    void SetUp() override { dir.Write("box.json", std::string(kBoxScene)); }
};
}  // namespace

// One run does all three batch steps on the box scene, so the viewer starts only once.
TEST_F(ViewerRun, BatchSnapshotPickAndMovie)
{
    std::string png = dir.Path("box.png"), avi = dir.Path("orbit.avi"), output;
    Viewer run(Quoted(scene) + " --snapshot " + Quoted(png) + " --pick 160,120 --movie " + Quoted(avi) +
               " --frames 4 --fps 2 --size 320x240");
    ASSERT_EQ(run.Finish(output), 0u) << output;

    Picture picture(png);
    EXPECT_EQ(picture.width * picture.height, 320 * 240) << output;
    const unsigned char* middle = picture.At(160, 120);  // the box's lit front, a white highlight on red
    EXPECT_GT(middle[0], 120);
    EXPECT_GT(middle[0], 2 * std::max(middle[1], middle[2]));
    EXPECT_EQ(picture.At(5, 5)[0] + picture.At(5, 5)[1] + (255 - picture.At(5, 5)[2]), 0);  // background

    EXPECT_NE(output.find("2. back plate", output.find("1. red box")), std::string::npos) << output;
    std::smatch point;
    ASSERT_TRUE(std::regex_search(output, point, std::regex(R"(point \(([-0-9.]+), ([-0-9.]+), ([-0-9.]+)\))"))) << output;
    EXPECT_NEAR(std::stod(point[1]), 0.0, 0.05);
    EXPECT_NEAR(std::stod(point[2]), -1.0, 0.05);  // on the box's front face
    EXPECT_NEAR(std::stod(point[3]), 0.0, 0.05);

    EXPECT_NE(output.find("frame 4/4"), std::string::npos) << output;
    WIN32_FILE_ATTRIBUTE_DATA movie = {};  // four frames and the headers; the format is checked apart
    GetFileAttributesExA(avi.c_str(), GetFileExInfoStandard, &movie);
    EXPECT_EQ(movie.nFileSizeLow / (320 * 3 * 240), 4u);
}

// A user's session: snapshots, clicks that pick and highlight, an orbit, a pan, a fit, and
// closing.
TEST_F(ViewerRun, WindowAnswersTheMouseAndKeys)
{
    Viewer viewer(Quoted(scene) + " --size 320x240", dir.Path(""));
    ASSERT_TRUE(viewer.Open());
    int snapshots = 0;
    auto snapshot = [&] {
        viewer.Key('S');
        return Picture(dir.Path("karvel-snapshot-" + std::to_string(++snapshots) + ".png"));
    };
    Picture before = snapshot();
    ASSERT_EQ(before.width, 320);
    EXPECT_GT(before.At(160, 120)[0], 120);
    EXPECT_NE(viewer.Status().find("karvel-snapshot-1.png"), std::string::npos) << viewer.Status();

    viewer.Drag(WM_LBUTTONDOWN, WM_LBUTTONUP, MK_LBUTTON, 160, 161, 120);  // a pixel's slip is still a click
    EXPECT_EQ(viewer.Status().rfind("red box at (", 0), 0u) << viewer.Status();
    EXPECT_GT(snapshot().At(140, 130)[1], before.At(140, 130)[1] + 40);  // the warm highlight adds green
    viewer.Drag(WM_LBUTTONDOWN, WM_LBUTTONUP, MK_LBUTTON, 5, 5, 5);  // a click on the background: the highlight goes
    EXPECT_EQ(viewer.Status(), "Nothing here");

    viewer.Drag(WM_LBUTTONDOWN, WM_LBUTTONUP, MK_LBUTTON, 100, 200, 120);
    Picture orbited = snapshot();  // the box seen from another side
    ASSERT_EQ(orbited.rgb.size(), before.rgb.size());
    EXPECT_GT(std::inner_product(orbited.rgb.begin(), orbited.rgb.end(), before.rgb.begin(), 0, std::plus<>(),
                                 std::not_equal_to<>()), 1000);

    viewer.Drag(WM_RBUTTONDOWN, WM_RBUTTONUP, MK_RBUTTON, 160, 300, 120);  // pan the model out of the middle
    Picture panned = snapshot();
    EXPECT_EQ(panned.At(160, 120)[2], 255) << "the middle shows the background after the pan";
    EXPECT_GT(panned.At(300, 120)[0], 120) << "the box followed the cursor";
    viewer.Key('F');  // fit all brings it back
    EXPECT_GT(snapshot().At(160, 120)[0], 120);
    SendMessageA(viewer.frame, WM_CLOSE, 0, 0);
    std::string output;
    EXPECT_EQ(viewer.Finish(output), 0u) << output;
}
