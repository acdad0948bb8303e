#include <gtest/gtest.h>

#include "command_line.h"

// Options come in any order, a pick is checked against the final size, help needs no scene; each
// mistake is explained.
TEST(ViewerCommandLine, OptionsInAnyOrderAndMistakesExplained)
{
    ViewerOptions o, window;
    std::string error;
    ASSERT_TRUE(ParseCommandLine({"--size", "320x240", "--movie", "out/orbit.AVI", "--frames", "12", "--fps", "6", "scene.json",
                                  "--snapshot", "a.png", "--pick", "319,0"}, o, error)) << error;
    EXPECT_TRUE(o.Batch() && o.scene == "scene.json" && o.width == 320 && o.height == 240 && o.movie == "out/orbit.AVI");
    EXPECT_TRUE(o.frames == 12 && o.fps == 6 && o.snapshot == "a.png" && o.pick && o.pickX == 319 && o.pickY == 0);
    ASSERT_TRUE(ParseCommandLine({"house.json"}, window, error));
    EXPECT_TRUE(!window.Batch() && window.width == 800 && window.height == 600);
    const std::string size = "--size expects WxH with W from 160 and H from 120 to 4096, found ";
    const struct {
        std::vector<std::string> args;
        std::string error;  // empty: accepted
    } cases[] = {
        {{"--help"}, ""},
        {{"s.json", "--pick", "500,100", "--size", "640x480"}, ""},
        {{}, "a scene file expected"},
        {{"a.json", "b.json"}, "one scene file expected, found a second: b.json"},
        {{"a.json", "--snapshot", "a.jpg"}, "--snapshot expects a .png file, found a.jpg"},
        {{"a.json", "--movie", "a.mp4"}, "--movie expects an .avi file, found a.mp4"},
        {{"a.json", "--movie", "a.avi", "--frames", "0"}, "--frames expects a whole number from 1 to 100000, found 0"},
        {{"a.json", "--movie", "a.avi", "--fps", "24.5"}, "--fps expects a whole number from 1 to 120, found 24.5"},
        {{"a.json", "--frames", "10"}, "--frames and --fps belong to --movie"},
        {{"a.json", "--size", "159x120"}, size + "159x120"},
        {{"a.json", "--size", "99999999999x480"}, size + "99999999999x480"},
        {{"a.json", "--pick", "500,100", "--size", "320x240"}, "--pick expects X,Y inside the 320x240 window, found 500,100"},
        {{"a.json", "--pick", "800,0"}, "--pick expects X,Y inside the 800x600 window, found 800,0"},
        {{"a.json", "--zoom"}, "unknown option --zoom"},
    };
    for (const auto& c : cases) {
        ViewerOptions fresh;
        std::string message;
        EXPECT_EQ(ParseCommandLine(c.args, fresh, message), c.error.empty()) << c.error;
        EXPECT_EQ(message, c.error);
    }
}
