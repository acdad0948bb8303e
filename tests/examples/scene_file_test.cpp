#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <iterator>

#include "convert/vel_shape_to_primitive.h"
#include "model/dor_math.h"
#include "scene.h"
#include "viewer_test_support.h"

namespace {
const std::string kSource = KARVEL_SOURCE_DIR;
const char* kCamera = R"("camera": {"eye": [10, -10, 5], "target": [0, 0, 0]})";

std::string SceneWith(const std::string& entities, const std::string& more = "")
{
    return std::string("{") + kCamera + more + ", \"entities\": [" + entities + "]}";
}

// A triangular prism named name, with the extra members given.
std::string Prism(const std::string& name, const std::string& more)
{
    return R"({"name": ")" + name + R"(", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]], "extrude": [0,0,1], )" + more + "}";
}

// The extrusion's faces run counter-clockwise about it and its top is the profile moved by `by`.
template <class Polygon>  // plain or holed
void ExpectOutwardAndMoved(const Polygon& bottom, const Polygon& top, const DorVector3& by)
{
    const int n = bottom.points.GetSize();
    ASSERT_EQ(top.points.GetSize(), n);
    EXPECT_GT(DorDot(DorNewellNormal(bottom.points.GetData(), n), by), 0.0);
    EXPECT_GT(DorDot(DorNewellNormal(top.points.GetData(), n), by), 0.0);
    for (int i = 0; i < n; ++i)
        EXPECT_LE(DorLength(top.points[i] - bottom.points[i] - by), 1e-12) << i;
}

// Every entity converts to groups that all have vertices.
void ExpectEveryEntityHasGeometry(Scene& scene, const std::string& file)
{
    for (auto& entity : scene.entities) {
        CVelPrimitive primitive = entity->primitive;
        CDorShape shape;
        if (entity->geometry)
            shape.Add(entity->geometry.get()), CVelShapeToPrimitive().ConvertShape(shape, primitive);
        EXPECT_GT(primitive.groups.GetSize(), 0) << file << ": " << entity->name;
        for (int g = 0; g < primitive.groups.GetSize(); ++g)
            EXPECT_GT(primitive.groups[g].vertices.GetSize(), 0) << file << ": " << entity->name << " group " << g;
    }
}

class SceneFileTest : public ::testing::Test {
protected:
    viewer_test::ScratchDir dir{"scene_file_test"};
    Scene scene;
    std::string error;
    bool Parse(const std::string& text) { return ParseScene(text, "test.json", dir.Base(), scene, error); }
};
}  // namespace

TEST_F(SceneFileTest, CameraBackgroundAndLightsAreRead)
{
    ASSERT_TRUE(Parse(R"({"background": [0.2, 0.3, 0.4],
        "camera": {"eye": [1, 2, 3], "target": [4, 5, 6], "fovy": 30, "near": 0.5, "far": 80},
        "lights": [{"index": 2, "type": "directional", "direction": [0, 0, -2], "diffuse": [0.5, 0.5, 0.5]},
                   {"index": 3, "type": "positional", "position": [1, 1, 9], "enabled": false, "attenuation": 0.1}],
        "entities": []})")) << error;
    EXPECT_TRUE(scene.background.g == 0.3f && scene.background.a == 1.0f);
    EXPECT_TRUE(scene.camera.eye.y == 2.0 && scene.camera.fovy == 30.0 && scene.camera.zNear == 0.5 && scene.camera.zFar == 80.0);
    ASSERT_EQ(scene.lights.size(), 2u);
    const DorLight &directional = scene.lights[0].light, &positional = scene.lights[1].light;
    EXPECT_TRUE(scene.lights[0].index == 2 && directional.type == 1 && directional.enabled == 1 && directional.direction.z == -2.0);
    EXPECT_TRUE(positional.type == 0 && positional.enabled == 0 && positional.attenuation == 0.1f && positional.position.z == 9);
    ASSERT_TRUE(Parse(SceneWith(""))) << error;  // defaults give a usable frustum
    EXPECT_TRUE(scene.camera.fovy > 0 && scene.camera.fovy < 180 && scene.camera.zNear > 0 && scene.camera.zFar > scene.camera.zNear);
}

// A profile given clockwise about its extrusion is turned round, keeping point 0 and the pairing
// of bottom and top points; holes run the outline's way round and move to the top with it.
TEST_F(SceneFileTest, ExtrusionsFaceOutwardWithTheirTopsAndHolesMoved)
{
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "slab", "type": "extrusion", "style": "wire", "caps": {"bottom": false},
            "profile": [[0, 0, 0], [1, 0, 0], [1, 0, 1], [0, 0, 1]], "extrude": [0, 2, 0], "material": {"color": [1, 0, 0]}},
        {"name": "tapered", "type": "extrusion", "profile": [[0, 0, 0], [4, 0, 0], [4, 0, 4], [0, 0, 4]],
            "top": [[1, 3, 1], [3, 3, 1], [3, 3, 3], [1, 3, 3]]},
        {"name": "wall", "type": "extrusion", "profile": [[0, 0, 0], [6, 0, 0], [6, 0, 3], [0, 0, 3]],
            "holes": [[[1, 0, 0.1], [1, 0, 2.1], [2, 0, 2.1], [2, 0, 0.1]], [[3, 0, 1], [5, 0, 1], [5, 0, 2], [3, 0, 2]]],
            "extrude": [0, 0.25, 0], "material": {"color": [0, 0, 1, 0.5], "ambient": [0.1, 0.2, 0.3], "shininess": 100}},
        {"name": "boss", "type": "extrusion", "profile": {"center": [1, 2, 3], "radius": 0.5, "segments": 24}, "extrude": [0, 0, 1]})")))
        << error;
    const CDorExtruded& slab = dynamic_cast<const CDorExtruded&>(*scene.entities[0]->geometry);
    ExpectOutwardAndMoved(slab.bottom, slab.top, DorVector3(0, 2, 0));
    EXPECT_TRUE(slab.bottomCap == 0 && slab.topCap == 1 && slab.style == DorStyleWire && slab.top.style == DorStyleWire);
    EXPECT_TRUE(slab.material.diffuse.r == 1.0f && slab.material.ambient.r == 0.4f && slab.material.diffuse.g == 0.0f);
    EXPECT_TRUE(slab.top.material.diffuse.r == 1.0f && scene.entities[0]->texture == -1);

    const CDorExtruded& tapered = dynamic_cast<const CDorExtruded&>(*scene.entities[1]->geometry);
    EXPECT_GT(DorDot(DorNewellNormal(tapered.bottom.points.GetData(), 4), DorVector3(0, 1, 0)), 0.0);
    EXPECT_TRUE(tapered.bottom.points[0].x == 0 && tapered.bottom.points[1].z == 4.0);  // (0, 0, 4) now follows point 0 ...
    EXPECT_TRUE(tapered.top.points[1].x == 1.0 && tapered.top.points[1].z == 3.0);     // ... still paired with (1, 3, 3)

    const CDorHoleExtruded& wall = dynamic_cast<const CDorHoleExtruded&>(*scene.entities[2]->geometry);
    ExpectOutwardAndMoved(wall.bottom, wall.top, DorVector3(0, 0.25, 0));
    ASSERT_TRUE(wall.bottom.holes.GetSize() == 2 && wall.top.holes.GetSize() == 2);
    for (int h = 0; h < 2; ++h)
        ExpectOutwardAndMoved(wall.bottom.holes[h], wall.top.holes[h], DorVector3(0, 0.25, 0));
    const _DorMaterial& m = wall.material;
    EXPECT_TRUE(m.diffuse.b == 1.0f && m.diffuse.a == 0.5f && m.ambient.g == 0.2f && m.shininess == 100.0f);

    const CDorExtruded& boss = dynamic_cast<const CDorExtruded&>(*scene.entities[3]->geometry);
    ExpectOutwardAndMoved(boss.bottom, boss.top, DorVector3(0, 0, 1));
    for (int i = 0; i < 24; ++i) {
        EXPECT_NEAR(DorLength(boss.bottom.points[i] - DorVector3(1, 2, 3)), 0.5, 1e-12) << i;
        EXPECT_NEAR(DorLength(boss.bottom.points[i] - boss.bottom.points[(i + 1) % 24]), std::sin(DorPi / 24), 1e-12) << i;
    }
}

TEST_F(SceneFileTest, LinesGridsAndSharedTextures)
{
    dir.Write("tiles.bmp", viewer_test::BmpFile(16, 16, 24));
    dir.Write("wood.bmp", viewer_test::BmpFile(8, 4, 32));
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "x axis", "type": "line", "from": [0, 0, 0], "to": [5, 0, 0],
            "material": {"color": [1, 0, 0]}, "width": 3},
        {"name": "ground", "type": "grid", "from": [-5, -5], "to": [5, 5], "divisions": 10},)" +
        Prism("a", R"("texture": {"file": "tiles.bmp", "scale": [2, 0.5], "axis": [0, 0, 1], "capAxis": [1, 0, 0]})") + "," +
        Prism("b", R"("texture": {"file": "wood.bmp"})") + "," + Prism("c", R"("texture": {"file": "tiles.bmp"})"))))
        << error;
    const CVelTrianglePolys& line = scene.entities[0]->primitive.groups[0];
    EXPECT_TRUE(scene.entities[0]->geometry == nullptr && line.GroupType == VelGroupLines && line.vertices.GetSize() == 2);
    EXPECT_TRUE(line.vertices[1].position.x == 5.0 && line.lineWidth == 3.0f);
    EXPECT_TRUE(line.material.ambient.r == 1.0f && line.material.diffuse.r == 0.8f && line.material.diffuse.g == 0.0f);
    const CVelTrianglePolys& grid = scene.entities[1]->primitive.groups[0];
    EXPECT_TRUE(grid.vertices.GetSize() == 4 * 11 && grid.lineWidth == 1.0f && scene.entities[1]->primitive.DrawMode == 2);

    ASSERT_EQ(scene.textures.size(), 2u);
    EXPECT_TRUE(scene.textures[0]->bitmap.info.width == 16 && scene.textures[1]->bitmap.info.bitCount == 32);
    EXPECT_TRUE(scene.entities[2]->texture == 0 && scene.entities[3]->texture == 1 && scene.entities[4]->texture == 0);
    const CDorExtruded& a = dynamic_cast<const CDorExtruded&>(*scene.entities[2]->geometry);
    EXPECT_TRUE(a.textureScaleU == 2.0 && a.top.textureScaleV == 0.5 && a.textureAxis.z == 1.0);
    // The caps' axis is a point beside each cap's first point.
    EXPECT_TRUE(a.bottom.textureAxis.x == 1.0 && a.bottom.textureAxis.z == 0.0 && a.top.textureAxis.z == 1.0);
}

// Each kind of mistake names the file, the place and what was expected, with what was found.
TEST_F(SceneFileTest, MistakesAreNamedWithThePlaceAndWhatWasExpected)
{
    const std::string triangle = R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]])";
    const std::string grid = R"({"name": "g", "type": "grid", "from": [0, 0], "to": [1, 1], "divisions": )";
    dir.Write("odd.bmp", viewer_test::BmpFile(3, 5, 24));
    const struct {
        std::string text, message;  // message without the leading "test.json: "
    } cases[] = {
        {R"({"entities": []})", "top level: expected \"camera\" (the camera object)"},
        {SceneWith(R"({"type": "line"})"), "entities[0]: expected \"name\" (the entity's name)"},
        {SceneWith(triangle + "}"), "entities[0] (\"w\"): expected \"extrude\" (the vector from the profile to the top face) or \"top\" (the top profile)"},
        {SceneWith(R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,"a"],[0,1,0]], "extrude": [0,0,1]})"),
         "entities[0] (\"w\").profile[1][2]: expected a number, found the string \"a\""},
        {SceneWith(R"({"name": "w", "type": "cone"})"), "entities[0] (\"w\").type: expected \"extrusion\" or \"line\" or \"grid\", found the string \"cone\""},
        {SceneWith("", R"(, "background": [1, 0.5, 2])"), "background[2]: expected a number from 0 to 1, found the number 2"},
        {SceneWith(grid + "2.5}"), "entities[0] (\"g\").divisions: expected a whole number from 1 to 10000, found the number 2.5"},
        {SceneWith(triangle + R"(, "extrude": [0,0,1]},)" + triangle + R"(, "extrude": [0,0,1]})"), "entities[1] (\"w\").name: expected a name not used before (entities[0] has it)"},
        {SceneWith(triangle + R"(, "top": [[0,0,1],[1,0,1],[1,1,1],[0,1,1]]})"), "entities[0] (\"w\").top: expected as many points as the profile (3), found 4"},
        {SceneWith(triangle + R"(, "extrude": [0, 0, 0]})"), "entities[0] (\"w\").extrude: expected a direction [x, y, z] at least 0.0001 long, found an array of 3"},
        {R"({"camera": {"eye": [1, 1, 1], "target": [1, 1, 1]}, "entities": []})", "camera.target: expected a point at least 0.0001 away from the eye"},
        {SceneWith(triangle + R"(, "extrud": [0,0,1]})"), "entities[0] (\"w\").extrud: expected one of the keys \"name\", \"type\", \"profile\", \"holes\", \"extrude\", \"top\", \"caps\", \"style\", \"material\", \"texture\""},
        {SceneWith(Prism("t", R"("texture": {"file": "odd.bmp"})")), "entities[0] (\"t\").texture.file: expected a texture whose width x height is a power of two up to 512 x 512 (\"" + dir.Path("odd.bmp") + "\" is 3 x 5)"},
        {SceneWith(Prism("t", R"("texture": {"file": "absent.bmp"})")), "entities[0] (\"t\").texture.file: expected a readable BMP file, but \"" + dir.Path("absent.bmp") + "\" cannot be read"},
    };
    for (const auto& c : cases) {
        Scene fresh;
        EXPECT_FALSE(ParseScene(c.text, "test.json", dir.Base(), fresh, error)) << c.text;
        EXPECT_EQ(error, "test.json: " + c.message) << c.text;
    }
    EXPECT_FALSE(Parse("{\n  \"camera\": {\"eye\": [0, 0, 1],,\n}"));
    EXPECT_EQ(error.rfind("test.json: line 2, column ", 0), 0u) << error;
    EXPECT_NE(error.find("expected valid JSON"), std::string::npos) << error;
    EXPECT_FALSE(LoadSceneFile(dir.Path("absent.json"), scene, error));
    EXPECT_EQ(error, dir.Path("absent.json") + ": expected a readable scene file");
}

// The scenes shipped with the viewer, and the complete example of the scene format's documentation.
TEST(SampleScenes, ShippedScenesAndTheDocumentedExampleLoadAndConvert)
{
    Scene house, part, documented;
    std::string error;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/house.json", house, error)) << error;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/part.json", part, error)) << error;
    ASSERT_TRUE(house.textures.size() == 1u && house.textures[0]->bitmap.info.width == 32);
    int holed = 0;
    for (auto& entity : house.entities)
        holed += dynamic_cast<CDorHoleExtruded*>(entity->geometry.get()) != nullptr;
    EXPECT_EQ(holed, 4);  // four walls, each with an opening
    std::ifstream doc(kSource + "/docs/scene-format.md");
    std::string text((std::istreambuf_iterator<char>(doc)), std::istreambuf_iterator<char>());
    size_t begin = text.find("```json\n") + 8;
    ASSERT_GT(begin, 8u);
    ASSERT_TRUE(ParseScene(text.substr(begin, text.find("```", begin) - begin), "scene-format.md", kSource + "/examples/scenes/",
                           documented, error)) << error;
    EXPECT_EQ(documented.entities.size(), 5u);
    ExpectEveryEntityHasGeometry(house, "house.json");
    ExpectEveryEntityHasGeometry(part, "part.json");
    ExpectEveryEntityHasGeometry(documented, "scene-format.md");
}
