// The viewer program as a user runs it in batch mode: its exit code, what it prints and the
// files it writes. Each test starts karvel_viewer.exe as a separate process.
#include <gtest/gtest.h>
#include <windows.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <regex>

#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

#include "examples/viewer_test_support.h"

using viewer_test::BmpFile;
using viewer_test::ScratchDir;

namespace {
struct ViewerRun {
    DWORD exitCode;
    std::string output;  // standard output and error together
};

ViewerRun RunViewer(const std::string& arguments)
{
    SECURITY_ATTRIBUTES inherit = {sizeof(inherit), nullptr, TRUE};
    HANDLE readEnd = nullptr, writeEnd = nullptr;
    CreatePipe(&readEnd, &writeEnd, &inherit, 0);
    SetHandleInformation(readEnd, HANDLE_FLAG_INHERIT, 0);
    STARTUPINFOA startup = {};
    startup.cb = sizeof(startup);
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = startup.hStdError = writeEnd;
    startup.hStdInput = GetStdHandle(STD_INPUT_HANDLE);
    PROCESS_INFORMATION process = {};
    std::string command = std::string("\"") + KARVEL_VIEWER_EXE + "\" " + arguments;
    ViewerRun run = {~0u, ""};
    BOOL started = CreateProcessA(nullptr, &command[0], nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &process);
    CloseHandle(writeEnd);
    if (!started) {
        CloseHandle(readEnd);
        run.output = "could not start " + command;
        return run;
    }
    char buffer[4096];
    DWORD got = 0;
    while (ReadFile(readEnd, buffer, sizeof buffer, &got, nullptr) && got > 0)
        run.output.append(buffer, got);
    WaitForSingleObject(process.hProcess, INFINITE);
    GetExitCodeProcess(process.hProcess, &run.exitCode);
    CloseHandle(process.hProcess);
    CloseHandle(process.hThread);
    CloseHandle(readEnd);
    return run;
}

std::string Quoted(const std::string& path) { return "\"" + path + "\""; }

// The viewer opened in a window by a test, its files written into folder; the test drives it
// with the messages a user's mouse and keyboard would send.
class OpenViewer {
public:
    OpenViewer(const std::string& arguments, const std::string& folder)
    {
        STARTUPINFOA startup = {};
        startup.cb = sizeof(startup);
        std::string command = std::string("\"") + KARVEL_VIEWER_EXE + "\" " + arguments;
        if (!CreateProcessA(nullptr, &command[0], nullptr, nullptr, FALSE, 0, nullptr, folder.c_str(), &startup,
                            &process_))
            return;
        for (int tries = 0; tries < 200 && !(frame && IsWindowVisible(frame)); ++tries) {
            Sleep(50);
            frame = FindWindowA("KarvelViewerFrame", nullptr);  // the only viewer window this test opens
        }
        view = FindWindowExA(frame, nullptr, "KarvelViewerView", nullptr);
        status = FindWindowExA(frame, nullptr, "msctls_statusbar32", nullptr);
    }
    ~OpenViewer()
    {
        if (!process_.hProcess)
            return;
        if (WaitForSingleObject(process_.hProcess, 0) == WAIT_TIMEOUT)
            TerminateProcess(process_.hProcess, 3);
        CloseHandle(process_.hProcess);
        CloseHandle(process_.hThread);
    }

    // Sent, not posted: each message is handled before the next one is sent.
    void Mouse(UINT message, WPARAM keys, int x, int y) { SendMessageA(view, message, keys, MAKELPARAM(x, y)); }
    void Key(WPARAM key) { SendMessageA(view, WM_KEYDOWN, key, 0); }
    void Click(int x, int y) { Drag(WM_LBUTTONDOWN, WM_LBUTTONUP, MK_LBUTTON, x, x, y); }
    // Along y, in 10-pixel moves, as a hand would drag.
    void Drag(UINT down, UINT up, WPARAM button, int fromX, int toX, int y)
    {
        Mouse(down, button, fromX, y);
        for (int x = fromX + 10; x <= toX; x += 10)
            Mouse(WM_MOUSEMOVE, button, x, y);
        Mouse(up, 0, toX, y);
    }
    std::string StatusText()
    {
        char text[512] = {};
        SendMessageA(status, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text));
        return text;
    }
    DWORD Close()
    {
        SendMessageA(frame, WM_CLOSE, 0, 0);
        DWORD code = ~0u;
        if (WaitForSingleObject(process_.hProcess, 20000) == WAIT_OBJECT_0)
            GetExitCodeProcess(process_.hProcess, &code);
        return code;
    }

    HWND frame = nullptr, view = nullptr, status = nullptr;

private:
    PROCESS_INFORMATION process_ = {};
};

struct Picture {
    int width = 0, height = 0;
    std::vector<unsigned char> rgb;

    explicit Picture(const std::string& png)
    {
        int channels = 0;
        unsigned char* pixels = stbi_load(png.c_str(), &width, &height, &channels, 3);
        if (pixels)
            rgb.assign(pixels, pixels + width * height * 3);
        stbi_image_free(pixels);
    }
    const unsigned char* At(int x, int y) const { return &rgb[(y * width + x) * 3]; }
};

bool Exists(const std::string& path) { return GetFileAttributesA(path.c_str()) != INVALID_FILE_ATTRIBUTES; }

// A red box in front of a grey plate on a blue background, seen straight from -y: the box
// covers the middle of the picture, the plate a wider band behind it.
const char* kBoxScene = R"({"background": [0, 0, 1],
  "camera": {"eye": [0, -10, 0], "target": [0, 0, 0], "fovy": 40, "near": 1, "far": 100},
  "entities": [
    {"name": "red box", "type": "extrusion", "profile": [[-1, -1, -1], [1, -1, -1], [1, 1, -1], [-1, 1, -1]],
     "extrude": [0, 0, 2], "material": {"color": [1, 0, 0]}},
    {"name": "back plate", "type": "extrusion", "profile": [[-2.5, 3, -2], [2.5, 3, -2], [2.5, 3.5, -2], [-2.5, 3.5, -2]],
     "extrude": [0, 0, 4], "material": {"color": [0.6, 0.6, 0.6]}}]})";

class ViewerBatch : public ::testing::Test {
protected:
    ScratchDir dir{"viewer_batch_test"};
    std::string scene = dir.Path("box.json");

    void SetUp() override { dir.Write("box.json", std::string(kBoxScene)); }
};
}  // namespace

// One run does all three batch steps on the box scene, so the viewer starts only once.
TEST_F(ViewerBatch, SnapshotPickAndMovieInOneRun)
{
    std::string png = dir.Path("box.png"), avi = dir.Path("orbit.avi");
    ViewerRun run = RunViewer(Quoted(scene) + " --snapshot " + Quoted(png) + " --pick 160,120 --movie " + Quoted(avi) +
                              " --frames 4 --fps 2 --size 320x240");
    ASSERT_EQ(run.exitCode, 0u) << run.output;

    Picture picture(png);
    ASSERT_FALSE(picture.rgb.empty()) << run.output;
    EXPECT_EQ(picture.width, 320);
    EXPECT_EQ(picture.height, 240);
    const unsigned char* middle = picture.At(160, 120);  // the box's lit front, a white highlight on red
    EXPECT_GT(middle[0], 120) << int(middle[0]) << "," << int(middle[1]) << "," << int(middle[2]);
    EXPECT_GT(middle[0], 2 * middle[1]);
    EXPECT_GT(middle[0], 2 * middle[2]);
    const unsigned char* corner = picture.At(5, 5);  // background
    EXPECT_EQ(corner[0], 0);
    EXPECT_EQ(corner[1], 0);
    EXPECT_EQ(corner[2], 255);

    size_t box = run.output.find("1. red box");
    ASSERT_NE(box, std::string::npos) << run.output;
    EXPECT_NE(run.output.find("2. back plate", box), std::string::npos) << run.output;
    std::smatch point;
    ASSERT_TRUE(std::regex_search(run.output, point, std::regex(R"(point \(([-0-9.]+), ([-0-9.]+), ([-0-9.]+)\))")))
        << run.output;
    EXPECT_NEAR(std::stod(point[1]), 0.0, 0.05);
    EXPECT_NEAR(std::stod(point[2]), -1.0, 0.05);  // on the box's front face
    EXPECT_NEAR(std::stod(point[3]), 0.0, 0.05);

    EXPECT_NE(run.output.find("frame 4/4"), std::string::npos) << run.output;
    std::ifstream file(avi, std::ios::binary);
    std::string bytes((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
    ASSERT_GT(bytes.size(), 12u);
    EXPECT_EQ(bytes.substr(0, 4), "RIFF");
    EXPECT_EQ(bytes.substr(8, 4), "AVI ");
    size_t frameBytes = 320 * 3 * 240;
    EXPECT_GE(bytes.size(), 4 * frameBytes);
    EXPECT_LT(bytes.size(), 5 * frameBytes);
}

TEST_F(ViewerBatch, SceneErrorsStopWithOneMessageAndNoPicture)
{
    dir.Write("bad.bmp", std::string("no picture"));
    const char* kView = R"({"camera": {"eye": [0, -5, 0], "target": [0, 0, 0]})";
    struct Case {
        const char* file;
        std::string text, message;
    } cases[] = {
        {"syntax.json", "{\"camera\": }", ": line 1, column 12: expected valid JSON"},
        {"missing.json", kView + std::string("}"), ": top level: expected \"entities\" (an array of entities)"},
        {"type.json", R"({"camera": {"eye": [0, -5, 0], "target": [0, 0, "far"]}, "entities": []})",
         ": camera.target[2]: expected a number, found the string \"far\""},
        {"texture.json", kView + std::string(R"(, "entities": [{"name": "t", "type": "extrusion",
            "profile": [[0,0,0],[1,0,0],[0,1,0]], "extrude": [0,0,1], "texture": {"file": "bad.bmp"}}]})"),
         ": entities[0] (\"t\").texture.file: expected a BMP file"},
    };
    std::string png = dir.Path("never.png");
    for (const Case& c : cases) {
        dir.Write(c.file, c.text);
        ViewerRun run = RunViewer(Quoted(dir.Path(c.file)) + " --snapshot " + Quoted(png));
        EXPECT_EQ(run.exitCode, 1u) << c.file;
        EXPECT_EQ(run.output.find(dir.Path(c.file) + c.message), 0u) << c.file << ": " << run.output;
        EXPECT_EQ(std::count(run.output.begin(), run.output.end(), '\n'), 1) << run.output;
        EXPECT_FALSE(Exists(png)) << c.file;
    }
}

TEST_F(ViewerBatch, CommandLineMistakesShowTheUsage)
{
    ViewerRun run = RunViewer(Quoted(scene) + " --size 10x10");
    EXPECT_EQ(run.exitCode, 2u);
    EXPECT_NE(run.output.find("--size expects WxH"), std::string::npos) << run.output;
    EXPECT_NE(run.output.find("usage: karvel_viewer"), std::string::npos) << run.output;
}

// A user's session: snapshots, clicks that pick and highlight, a rubber-band zoom and its reset,
// an orbit, a pan, a fit, and closing.
TEST_F(ViewerBatch, WindowAnswersTheMouseAndKeys)
{
    OpenViewer viewer(Quoted(scene) + " --size 320x240", dir.Path(""));
    ASSERT_NE(viewer.view, nullptr);
    ASSERT_NE(viewer.status, nullptr);

    viewer.Key('S');
    Picture before(dir.Path("karvel-snapshot-1.png"));
    ASSERT_EQ(before.width, 320);
    EXPECT_GT(before.At(160, 120)[0], 120);
    EXPECT_NE(viewer.StatusText().find("karvel-snapshot-1.png"), std::string::npos) << viewer.StatusText();

    viewer.Mouse(WM_LBUTTONDOWN, MK_LBUTTON, 160, 120);
    viewer.Mouse(WM_LBUTTONUP, 0, 161, 120);
    EXPECT_EQ(viewer.StatusText().rfind("red box at (", 0), 0u) << viewer.StatusText();
    viewer.Key('S');
    Picture highlighted(dir.Path("karvel-snapshot-2.png"));
    ASSERT_EQ(highlighted.width, 320);
    // The warm highlight adds green to the red box.
    EXPECT_GT(highlighted.At(140, 130)[1], before.At(140, 130)[1] + 40)
        << int(before.At(140, 130)[1]) << " -> " << int(highlighted.At(140, 130)[1]);
    viewer.Click(5, 5);  // on the background: the highlight goes
    EXPECT_EQ(viewer.StatusText(), "Nothing here");

    // Shift-drag a rectangle right of the box: four times larger, the box's right edge comes
    // under (80, 120), where there was only background. Esc takes the zoom back.
    viewer.Click(80, 120);
    EXPECT_EQ(viewer.StatusText(), "Nothing here");
    viewer.Mouse(WM_LBUTTONDOWN, MK_LBUTTON | MK_SHIFT, 160, 90);
    for (int step = 1; step <= 8; ++step)
        viewer.Mouse(WM_MOUSEMOVE, MK_LBUTTON | MK_SHIFT, 160 + 10 * step, 90 + 60 * step / 8);
    viewer.Mouse(WM_LBUTTONUP, MK_SHIFT, 240, 150);
    viewer.Click(80, 120);
    EXPECT_EQ(viewer.StatusText().rfind("red box at (", 0), 0u) << viewer.StatusText();
    viewer.Key(VK_ESCAPE);
    viewer.Click(80, 120);
    EXPECT_EQ(viewer.StatusText(), "Nothing here");
    viewer.Click(5, 5);

    viewer.Drag(WM_LBUTTONDOWN, WM_LBUTTONUP, MK_LBUTTON, 100, 200, 120);
    viewer.Key('S');
    Picture after(dir.Path("karvel-snapshot-3.png"));
    ASSERT_EQ(after.rgb.size(), before.rgb.size());
    size_t changed = 0;
    for (size_t i = 0; i < after.rgb.size(); ++i)
        changed += after.rgb[i] != before.rgb[i];
    EXPECT_GT(changed, 1000u);  // the box was seen from another side

    viewer.Drag(WM_RBUTTONDOWN, WM_RBUTTONUP, MK_RBUTTON, 160, 300, 120);  // pan the model out of the middle
    viewer.Key('S');
    Picture panned(dir.Path("karvel-snapshot-4.png"));
    ASSERT_EQ(panned.width, 320);
    EXPECT_EQ(panned.At(160, 120)[2], 255) << "the middle shows the background after the pan";
    EXPECT_GT(panned.At(300, 120)[0], 120) << "the box followed the cursor";

    viewer.Key('F');  // fit all brings it back
    viewer.Key('S');
    Picture fitted(dir.Path("karvel-snapshot-5.png"));
    ASSERT_EQ(fitted.width, 320);
    EXPECT_GT(fitted.At(160, 120)[0], 120);
    EXPECT_EQ(viewer.Close(), 0u);
}
