#include <gtest/gtest.h>

#include "command_line.h"

namespace {
struct Parsed {
    bool ok;
    ViewerOptions options;
    std::string error;
};

Parsed Parse(std::vector<std::string> args)
{
    Parsed p;
    p.ok = ParseCommandLine(args, p.options, p.error);
    return p;
}
}  // namespace

TEST(ViewerCommandLine, ASceneAloneOpensTheWindowAndHelpNeedsNone)
{
    Parsed p = Parse({"house.json"});
    ASSERT_TRUE(p.ok) << p.error;
    EXPECT_EQ(p.options.scene, "house.json");
    EXPECT_FALSE(p.options.Batch());
    EXPECT_EQ(p.options.width, 800);
    EXPECT_EQ(p.options.height, 600);

    Parsed help = Parse({"--help"});  // needs no scene
    ASSERT_TRUE(help.ok);
    EXPECT_TRUE(help.options.help);
    EXPECT_NE(std::string(ViewerUsage()).find("--snapshot FILE.png"), std::string::npos);
}

TEST(ViewerCommandLine, BatchOptionsInAnyOrder)
{
    EXPECT_TRUE(Parse({"s.json", "--size", "160x120"}).ok);
    EXPECT_TRUE(Parse({"s.json", "--pick", "500,100", "--size", "640x480"}).ok);  // checked against the final size
    Parsed p = Parse({"--size", "320x240", "--movie", "out/orbit.AVI", "--frames", "12", "--fps", "6", "scene.json",
                      "--snapshot", "a.png", "--pick", "319,0"});
    ASSERT_TRUE(p.ok) << p.error;
    EXPECT_TRUE(p.options.Batch());
    EXPECT_EQ(p.options.scene, "scene.json");
    EXPECT_EQ(p.options.width, 320);
    EXPECT_EQ(p.options.height, 240);
    EXPECT_EQ(p.options.movie, "out/orbit.AVI");
    EXPECT_EQ(p.options.frames, 12);
    EXPECT_EQ(p.options.fps, 6);
    EXPECT_EQ(p.options.snapshot, "a.png");
    EXPECT_TRUE(p.options.pick);
    EXPECT_EQ(p.options.pickX, 319);
    EXPECT_EQ(p.options.pickY, 0);
}

TEST(ViewerCommandLine, MistakesAreExplained)
{
    struct Case {
        std::vector<std::string> args;
        const char* error;
    };
    std::vector<Case> cases = {
        {{}, "a scene file expected"},
        {{"a.json", "b.json"}, "one scene file expected, found a second: b.json"},
        {{"a.json", "--snapshot"}, "--snapshot expects a value"},
        {{"a.json", "--snapshot", "a.jpg"}, "--snapshot expects a .png file, found a.jpg"},
        {{"a.json", "--movie", "a.mp4"}, "--movie expects an .avi file, found a.mp4"},
        {{"a.json", "--movie", "a.avi", "--frames", "0"}, "--frames expects a whole number from 1 to 100000, found 0"},
        {{"a.json", "--movie", "a.avi", "--fps", "24.5"}, "--fps expects a whole number from 1 to 120, found 24.5"},
        {{"a.json", "--frames", "10"}, "--frames and --fps belong to --movie"},
        {{"a.json", "--size", "159x120"}, "--size expects WxH with W from 160 and H from 120 to 4096, found 159x120"},
        {{"a.json", "--size", "160x119"}, "--size expects WxH with W from 160 and H from 120 to 4096, found 160x119"},
        {{"a.json", "--size", "640x"}, "--size expects WxH with W from 160 and H from 120 to 4096, found 640x"},
        {{"a.json", "--size", "99999999999x480"},
         "--size expects WxH with W from 160 and H from 120 to 4096, found 99999999999x480"},
        {{"a.json", "--pick", "10;10"}, "--pick expects X,Y inside the 800x600 window, found 10;10"},
        {{"a.json", "--pick", "500,100", "--size", "320x240"}, "--pick expects X,Y inside the 320x240 window, found 500,100"},
        {{"a.json", "--pick", "800,0"}, "--pick expects X,Y inside the 800x600 window, found 800,0"},
        {{"a.json", "--pick", "-1,5"}, "--pick expects X,Y inside the 800x600 window, found -1,5"},
        {{"a.json", "--zoom"}, "unknown option --zoom"},
    };
    for (const Case& c : cases) {
        Parsed p = Parse(c.args);
        EXPECT_FALSE(p.ok) << c.error;
        EXPECT_EQ(p.error, c.error);
    }
}
