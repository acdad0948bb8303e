#include <gtest/gtest.h>

#include "scene.h"
#include "scene_model.h"
#include "support/recording_karvel.h"
#include "viewer_test_support.h"

namespace {
const std::string kSource = KARVEL_SOURCE_DIR;
}  // namespace

// Each kind of mistake names the file, the place and what was expected, with what was found.
TEST(SceneFile, MistakesAreNamedWithThePlaceAndWhatWasExpected)
{
    viewer_test::ScratchDir dir("scene_file_test");
    dir.Write("odd.bmp", viewer_test::BmpFile(3, 5));
    const std::string w = R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]])";
    const std::string scene = R"({"camera": {"eye": [10, -10, 5], "target": [0, 0, 0]}, "entities": [)";
    // message: without the leading "test.json: "
    const struct { std::string text, message; } cases[] = {
        {"{\n  \"camera\": {\"eye\": [0, 0, 1],,\n}", "line 2, column "},  // then what JSON expected there
        {"{\"camera\": {\"eye\": [1e400", "line 1, column 25: expected valid JSON (number overflow parsing '1e400')"},
        {scene + w + "}]}", "entities[0] (\"w\"): expected \"extrude\" (the vector from the profile to the top face) or \"top\" (the top profile)"},
        {scene + R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,"a"],[0,1,0]], "extrude": [0,0,1]}]})",
         "entities[0] (\"w\").profile[1][2]: expected a number, found the string \"a\""},
        {scene + w + R"(, "extrude": [0,0,1]},)" + w + R"(, "extrude": [0,0,1]}]})", "entities[1] (\"w\").name: expected a name not used before (entities[0] has it)"},
        {scene + w + R"(, "extrud": [0,0,1]}]})", "entities[0] (\"w\").extrud: expected one of the keys \"name\", \"type\", \"profile\", \"holes\", \"extrude\", \"top\", \"caps\", \"style\", \"material\", \"texture\""},
        {scene + w + R"(, "extrude": [0,0,1], "texture": {"file": "odd.bmp"}}]})",
         "entities[0] (\"w\").texture.file: expected a texture whose width x height is a power of two up to 512 x 512 (\"" + dir.Path("odd.bmp") + "\" is 3 x 5)"},
    };
    for (const auto& c : cases) {
        Scene fresh;
        std::string error;
        EXPECT_FALSE(ParseScene(c.text, "test.json", dir.Path(""), fresh, error)) << c.text;
        EXPECT_EQ(error.substr(0, c.message.size() + 11), "test.json: " + c.message) << c.text;
    }
    Scene fresh;
    std::string error;
    EXPECT_FALSE(LoadSceneFile(dir.Path("absent.json"), fresh, error));
    EXPECT_EQ(error, dir.Path("absent.json") + ": expected a readable scene file");
}

// Hands out texture name 7, keeps lights and background.
class SceneKarvel : public RecordingKarvel {
public:
    std::vector<int> lights;
    DorColorValue background;
    unsigned int AddTexture(_DorBitmap&) override { return 7; }
    void SetLight(int index, DorLight) override { lights.push_back(index); }
    void SetBkColor(DorColorValue& colour) override { background = colour; }
};

// The scenes shipped with the viewer load and every entity reaches the modeller as groups with
// vertices; the house's floor wears its texture; the view keeps the window's aspect ratio.
TEST(SceneFile, ShippedScenesLoadConvertAndReachAModeller)
{
    for (const char* file : {"house.json", "part.json"}) {
        Scene scene;
        std::string error;
        ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/" + file, scene, error)) << error;
        SceneKarvel k;
        SceneNames names;
        AddSceneEntities(k, scene, AddSceneTextures(k, scene), names);
        ASSERT_TRUE(names.size() == scene.entities.size() && k.entities.size() == names.size());
        for (auto& entry : names) {
            const CVelPrimitive& p = k.entities.at(const_cast<_DorPosition*>(entry.first));
            for (int g = 0; g < p.groups.GetSize(); ++g)
                EXPECT_TRUE(p.groups[g].vertices.GetSize() > 0 && (p.groups[g].texture == 7u) == (entry.second == "tiled floor"))
                    << entry.second;
        }
        k.camera.aspect = 1.6;
        ApplySceneView(k, scene);
        const bool house = file[0] == 'h', houseView = k.camera.eye.x == -5.0 && k.background.r == 0.62f && k.lights == std::vector<int>{1};
        EXPECT_TRUE(k.camera.aspect == 1.6 && (!house || houseView));
    }
}
