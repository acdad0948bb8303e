#include <gtest/gtest.h>

#include "command_line.h"

// Options come in any order, a pick is checked against the final size; each mistake is explained.
TEST(ViewerCommandLine, OptionsInAnyOrderAndMistakesExplained)
{
    ViewerOptions o;
    std::string error;
    ASSERT_TRUE(ParseCommandLine({"--size", "320x240", "--movie", "out/orbit.AVI", "--frames", "12", "--fps", "6", "scene.json",
                                  "--snapshot", "a.png", "--pick", "319,0"}, o, error)) << error;
    EXPECT_TRUE(o.Batch() && o.scene == "scene.json" && o.width == 320 && o.height == 240 && o.movie == "out/orbit.AVI");
    EXPECT_TRUE(o.frames == 12 && o.fps == 6 && o.snapshot == "a.png" && o.pick && o.pickX == 319 && o.pickY == 0);
    const struct {
        std::vector<std::string> args;
        std::string error;  // empty: accepted
    } cases[] = {
        {{"s.json", "--pick", "500,100", "--size", "640x480"}, ""},
        {{}, "a scene file expected"},
        {{"a.json", "--frames", "10"}, "--frames and --fps belong to --movie"},
        {{"a.json", "--size", "99999999999x480"}, "--size expects WxH with W from 160 and H from 120 to 4096, found 99999999999x480"},
        {{"a.json", "--pick", "500,100", "--size", "320x240"}, "--pick expects X,Y inside the 320x240 window, found 500,100"},
        {{"a.json", "--zoom"}, "unknown option --zoom"},
    };
    for (const auto& c : cases) {
        ViewerOptions fresh;
        std::string message;
        EXPECT_EQ(ParseCommandLine(c.args, fresh, message), c.error.empty()) << c.error;
        EXPECT_EQ(message, c.error);
    }
}
