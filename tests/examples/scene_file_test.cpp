#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include "convert/vel_shape_to_primitive.h"
#include "model/dor_math.h"
#include "scene.h"
#include "viewer_test_support.h"

namespace {
const std::string kSource = KARVEL_SOURCE_DIR;

// The faces run counter-clockwise about the extrusion and the top is the profile moved by `by`.
template <class Polygon>  // plain or holed
void ExpectOutwardAndMoved(const Polygon& bottom, const Polygon& top, const DorVector3& by)
{
    ASSERT_EQ(top.points.GetSize(), bottom.points.GetSize());
    EXPECT_GT(DorDot(DorNewellNormal(bottom.points.GetData(), bottom.points.GetSize()), by), 0.0);
    for (int i = 0; i < bottom.points.GetSize(); ++i)
        EXPECT_LE(DorLength(top.points[i] - bottom.points[i] - by), 1e-12) << i;
}
}  // namespace

// A slab given clockwise about its extrusion is turned round keeping point 0; a wall's holes run
// the outline's way round and move to the top with it; a colour gives the ambient; each texture
// file is read once and shared.
TEST(SceneFile, EntitiesLightsAndCameraAreRead)
{
    viewer_test::ScratchDir dir("scene_file_test");
    dir.Write("tiles.bmp", viewer_test::BmpFile(16, 16, 24));
    Scene scene;
    std::string error;
    ASSERT_TRUE(ParseScene(R"({"background": [0.2, 0.3, 0.4], "camera": {"eye": [1, 2, 3], "target": [4, 5, 6], "fovy": 30, "far": 80},
        "lights": [{"index": 3, "type": "positional", "position": [1, 1, 9], "enabled": false, "attenuation": 0.1}],
        "entities": [
          {"name": "slab", "type": "extrusion", "style": "wire", "caps": {"bottom": false}, "material": {"color": [1, 0, 0]},
           "profile": [[0, 0, 0], [1, 0, 0], [1, 0, 1], [0, 0, 1]], "extrude": [0, 2, 0],
           "texture": {"file": "tiles.bmp", "scale": [2, 0.5], "axis": [0, 0, 1], "capAxis": [1, 0, 0]}},
          {"name": "wall", "type": "extrusion", "profile": [[0, 0, 0], [6, 0, 0], [6, 0, 3], [0, 0, 3]], "extrude": [0, 0.25, 0],
           "holes": [[[1, 0, 0.1], [1, 0, 2.1], [2, 0, 2.1], [2, 0, 0.1]], [[3, 0, 1], [5, 0, 1], [5, 0, 2], [3, 0, 2]]],
           "material": {"color": [0, 0, 1, 0.5], "ambient": [0.1, 0.2, 0.3]}, "texture": {"file": "tiles.bmp"}},
          {"name": "x axis", "type": "line", "from": [0, 0, 0], "to": [5, 0, 0], "material": {"color": [1, 0, 0]}, "width": 3}]})",
                           "test.json", dir.Base(), scene, error)) << error;
    EXPECT_TRUE(scene.background.g == 0.3f && scene.camera.eye.y == 2.0 && scene.camera.fovy == 30.0 && scene.camera.zFar == 80.0);
    const SceneLight& light = scene.lights.at(0);
    EXPECT_TRUE(light.index == 3 && light.light.type == 0 && light.light.enabled == 0 && light.light.attenuation == 0.1f);

    const CDorExtruded& slab = dynamic_cast<const CDorExtruded&>(*scene.entities[0]->geometry);
    ExpectOutwardAndMoved(slab.bottom, slab.top, DorVector3(0, 2, 0));
    EXPECT_TRUE(slab.bottom.points[0].x == 0 && slab.bottom.points[1].z == 1);  // (0, 0, 1) now follows point 0
    EXPECT_TRUE(slab.bottomCap == 0 && slab.topCap == 1 && slab.style == DorStyleWire && slab.top.style == DorStyleWire);
    EXPECT_TRUE(slab.material.diffuse.r == 1.0f && slab.material.ambient.r == 0.4f && slab.top.material.diffuse.g == 0.0f);
    // The caps' texture axis is a point beside each cap's first point, moving with the profile.
    EXPECT_TRUE(slab.textureScaleU == 2.0 && slab.top.textureScaleV == 0.5 && slab.textureAxis.z == 1.0);
    EXPECT_TRUE(DorLength(slab.bottom.textureAxis - DorVector3(1, 0, 0)) + DorLength(slab.top.textureAxis - DorVector3(1, 2, 0)) < 1e-12);
    const CDorHoleExtruded& wall = dynamic_cast<const CDorHoleExtruded&>(*scene.entities[1]->geometry);
    ExpectOutwardAndMoved(wall.bottom, wall.top, DorVector3(0, 0.25, 0));
    ASSERT_TRUE(wall.bottom.holes.GetSize() == 2 && wall.top.holes.GetSize() == 2);
    for (int h = 0; h < 2; ++h)
        ExpectOutwardAndMoved(wall.bottom.holes[h], wall.top.holes[h], DorVector3(0, 0.25, 0));
    EXPECT_TRUE(wall.material.diffuse.a == 0.5f && wall.material.ambient.g == 0.2f);
    EXPECT_TRUE(scene.textures.size() == 1u && scene.entities[1]->texture == 0 && scene.entities[2]->texture == -1);
    const CVelTrianglePolys& line = scene.entities[2]->primitive.groups[0];
    EXPECT_TRUE(line.GroupType == VelGroupLines && line.vertices[1].position.x == 5.0 && line.lineWidth == 3.0f);
    EXPECT_TRUE(line.material.ambient.r == 1.0f && line.material.diffuse.r == 0.8f);  // lines show their ambient colour
}

// Each kind of mistake names the file, the place and what was expected, with what was found.
TEST(SceneFile, MistakesAreNamedWithThePlaceAndWhatWasExpected)
{
    viewer_test::ScratchDir dir("scene_file_test");
    dir.Write("odd.bmp", viewer_test::BmpFile(3, 5, 24));
    const std::string w = R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]])";
    const std::string scene = R"({"camera": {"eye": [10, -10, 5], "target": [0, 0, 0]}, "entities": [)";
    const struct {
        std::string text, message;  // message without the leading "test.json: "
    } cases[] = {
        {R"({"entities": []})", "top level: expected \"camera\" (the camera object)"},
        {scene + w + "}]}", "entities[0] (\"w\"): expected \"extrude\" (the vector from the profile to the top face) or \"top\" (the top profile)"},
        {scene + R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,"a"],[0,1,0]], "extrude": [0,0,1]}]})",
         "entities[0] (\"w\").profile[1][2]: expected a number, found the string \"a\""},
        {scene + R"({"name": "g", "type": "grid", "from": [0, 0], "to": [1, 1], "divisions": 2.5}]})",
         "entities[0] (\"g\").divisions: expected a whole number from 1 to 10000, found the number 2.5"},
        {scene + w + R"(, "extrude": [0,0,1]},)" + w + R"(, "extrude": [0,0,1]}]})", "entities[1] (\"w\").name: expected a name not used before (entities[0] has it)"},
        {scene + w + R"(, "extrud": [0,0,1]}]})", "entities[0] (\"w\").extrud: expected one of the keys \"name\", \"type\", \"profile\", \"holes\", \"extrude\", \"top\", \"caps\", \"style\", \"material\", \"texture\""},
        {scene + w + R"(, "extrude": [0,0,1], "texture": {"file": "odd.bmp"}}]})",
         "entities[0] (\"w\").texture.file: expected a texture whose width x height is a power of two up to 512 x 512 (\"" + dir.Path("odd.bmp") + "\" is 3 x 5)"},
    };
    for (const auto& c : cases) {
        Scene fresh;
        std::string error;
        EXPECT_FALSE(ParseScene(c.text, "test.json", dir.Base(), fresh, error)) << c.text;
        EXPECT_EQ(error, "test.json: " + c.message) << c.text;
    }
    Scene fresh;
    std::string error;
    EXPECT_FALSE(ParseScene("{\n  \"camera\": {\"eye\": [0, 0, 1],,\n}", "test.json", dir.Base(), fresh, error));
    EXPECT_TRUE(error.rfind("test.json: line 2, column ", 0) == 0 && error.find("expected valid JSON") != std::string::npos) << error;
    EXPECT_FALSE(LoadSceneFile(dir.Path("absent.json"), fresh, error));
    EXPECT_EQ(error, dir.Path("absent.json") + ": expected a readable scene file");
}

// The scenes shipped with the viewer, and the complete example of the format's documentation, load
// and every entity converts to groups that all have vertices.
TEST(SceneFile, ShippedScenesAndTheDocumentedExampleLoadAndConvert)
{
    Scene scenes[3];
    std::string error;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/house.json", scenes[0], error)) << error;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/part.json", scenes[1], error)) << error;
    std::ifstream doc(kSource + "/docs/scene-format.md");
    std::string text((std::istreambuf_iterator<char>(doc)), std::istreambuf_iterator<char>());
    size_t begin = text.find("```json\n") + 8;
    ASSERT_GT(begin, 8u);
    ASSERT_TRUE(ParseScene(text.substr(begin, text.find("```", begin) - begin), "scene-format.md", kSource + "/examples/scenes/", scenes[2], error)) << error;
    EXPECT_TRUE(scenes[0].textures.size() == 1u && scenes[2].entities.size() == 5u);
    int holed = 0;
    for (Scene& scene : scenes)
        for (auto& entity : scene.entities) {
            holed += &scene == &scenes[0] && dynamic_cast<CDorHoleExtruded*>(entity->geometry.get()) != nullptr;
            CVelPrimitive primitive = entity->primitive;
            CDorShape shape;
            if (entity->geometry) {
                shape.Add(entity->geometry.get());
                CVelShapeToPrimitive().ConvertShape(shape, primitive);
            }
            EXPECT_GT(primitive.groups.GetSize(), 0) << entity->name;
            for (int g = 0; g < primitive.groups.GetSize(); ++g)
                EXPECT_GT(primitive.groups[g].vertices.GetSize(), 0) << entity->name << " group " << g;
        }
    EXPECT_EQ(holed, 4);  // the house's four walls, each with an opening
}
