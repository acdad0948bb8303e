#include <gtest/gtest.h>

#include <cmath>

#include "model/dor_math.h"
#include "scene.h"
#include "viewer_test_support.h"

using viewer_test::BmpFile;
using viewer_test::ScratchDir;

namespace {
const char* kCamera = R"("camera": {"eye": [10, -10, 5], "target": [0, 0, 0]})";

std::string SceneWith(const std::string& entities, const std::string& more = "")
{
    return std::string("{") + kCamera + more + ", \"entities\": [" + entities + "]}";
}

// A scene file in its own folder, with textures beside it.
class SceneFileTest : public ::testing::Test {
protected:
    ScratchDir dir{"scene_file_test"};
    Scene scene;
    std::string error;

    bool Parse(const std::string& text) { return ParseScene(text, "test.json", dir.Base(), scene, error); }

    // The message of a scene that must be refused.
    std::string Refusal(const std::string& text)
    {
        Scene fresh;
        std::string message;
        EXPECT_FALSE(ParseScene(text, "test.json", dir.Base(), fresh, message)) << text;
        return message;
    }
};

const char* kWall = R"({"name": "wall", "type": "extrusion",
    "profile": [[0, 0, 0], [4, 0, 0], [4, 0, 3], [0, 0, 3]], "extrude": [0, 0.2, 0]})";

// A triangular prism named name, with the extra members given.
std::string Prism(const std::string& name, const std::string& more)
{
    return R"({"name": ")" + name + R"(", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]], "extrude": [0,0,1], )" +
           more + "}";
}

double Distance(const DorVector3& a, const DorVector3& b) { return DorLength(a - b); }
}  // namespace

TEST_F(SceneFileTest, CameraBackgroundAndLightsAreRead)
{
    ASSERT_TRUE(Parse(R"({"background": [0.2, 0.3, 0.4],
        "camera": {"eye": [1, 2, 3], "target": [4, 5, 6], "fovy": 30, "near": 0.5, "far": 80},
        "lights": [{"index": 2, "type": "directional", "direction": [0, 0, -2], "diffuse": [0.5, 0.5, 0.5]},
                   {"index": 3, "type": "positional", "position": [1, 1, 9], "enabled": false, "attenuation": 0.1}],
        "entities": []})"))
        << error;
    EXPECT_FLOAT_EQ(scene.background.g, 0.3f);
    EXPECT_FLOAT_EQ(scene.background.a, 1.0f);
    EXPECT_DOUBLE_EQ(scene.camera.eye.y, 2.0);
    EXPECT_DOUBLE_EQ(scene.camera.fovy, 30.0);
    EXPECT_DOUBLE_EQ(scene.camera.zFar, 80.0);
    ASSERT_EQ(scene.lights.size(), 2u);
    EXPECT_EQ(scene.lights[0].index, 2);
    EXPECT_EQ(scene.lights[0].light.type, 1);  // the record's directional value
    EXPECT_EQ(scene.lights[0].light.enabled, 1);
    EXPECT_DOUBLE_EQ(scene.lights[0].light.direction.z, -2.0);
    EXPECT_EQ(scene.lights[1].light.type, 0);  // positional
    EXPECT_EQ(scene.lights[1].light.enabled, 0);
    EXPECT_FLOAT_EQ(scene.lights[1].light.attenuation, 0.1f);
}

TEST_F(SceneFileTest, CameraDefaultsGiveAUsableFrustum)
{
    ASSERT_TRUE(Parse(SceneWith(""))) << error;
    EXPECT_GT(scene.camera.fovy, 0.0);
    EXPECT_LT(scene.camera.fovy, 180.0);
    EXPECT_GT(scene.camera.zNear, 0.0);
    EXPECT_GT(scene.camera.zFar, scene.camera.zNear);
}

TEST_F(SceneFileTest, ExtrusionTopIsTheProfileMovedAndCapsFollowTheWalls)
{
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "slab", "type": "extrusion", "style": "wire",
        "profile": [[0, 0, 0], [2, 0, 0], [2, 1, 0], [0, 1, 0]], "extrude": [0, 0, 0.5],
        "caps": {"bottom": false}, "material": {"color": [1, 0, 0]}})")))
        << error;
    ASSERT_EQ(scene.entities.size(), 1u);
    auto* slab = dynamic_cast<CDorExtruded*>(scene.entities[0]->geometry.get());
    ASSERT_NE(slab, nullptr);
    ASSERT_EQ(slab->top.points.GetSize(), 4);
    for (int i = 0; i < 4; ++i)
        EXPECT_NEAR(Distance(slab->top.points[i], slab->bottom.points[i] + DorVector3(0, 0, 0.5)), 0.0, 1e-12);
    EXPECT_EQ(slab->bottomCap, 0);
    EXPECT_EQ(slab->topCap, 1);
    EXPECT_EQ(slab->style, DorStyleWire);
    EXPECT_EQ(slab->top.style, DorStyleWire);
    EXPECT_FLOAT_EQ(slab->material.diffuse.r, 1.0f);
    EXPECT_FLOAT_EQ(slab->material.ambient.r, 0.4f);
    EXPECT_FLOAT_EQ(slab->material.diffuse.g, 0.0f);
    EXPECT_FLOAT_EQ(slab->top.material.diffuse.r, 1.0f);
    EXPECT_EQ(scene.entities[0]->texture, -1);
}

TEST_F(SceneFileTest, MaterialPartsOverrideTheColour)
{
    ASSERT_TRUE(Parse(SceneWith(Prism("m", R"("material": {"color": [0, 0, 1, 0.5], "ambient": [0.1, 0.2, 0.3], "shininess": 100})"))))
        << error;
    const _DorMaterial& m = scene.entities[0]->geometry->material;
    EXPECT_FLOAT_EQ(m.diffuse.b, 1.0f);
    EXPECT_FLOAT_EQ(m.diffuse.a, 0.5f);  // transparent
    EXPECT_FLOAT_EQ(m.ambient.g, 0.2f);
    EXPECT_FLOAT_EQ(m.shininess, 100.0f);
}

// The converters leave a profile extruded straight along y as it comes; the loader turns it
// so the walls face outward, keeping point 0 and the pairing of bottom and top points.
TEST_F(SceneFileTest, ProfilesRunCounterClockwiseAboutTheExtrusion)
{
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "along y", "type": "extrusion",
            "profile": [[0, 0, 0], [1, 0, 0], [1, 0, 1], [0, 0, 1]], "extrude": [0, 2, 0]},
        {"name": "tapered", "type": "extrusion", "profile": [[0, 0, 0], [4, 0, 0], [4, 0, 4], [0, 0, 4]],
            "top": [[1, 3, 1], [3, 3, 1], [3, 3, 3], [1, 3, 3]]})")))
        << error;
    for (int e = 0; e < 2; ++e) {
        const CDorExtruded& solid = dynamic_cast<const CDorExtruded&>(*scene.entities[e]->geometry);
        DorVector3 direction = solid.top.points[0] - solid.bottom.points[0];
        EXPECT_GT(DorDot(DorNewellNormal(solid.bottom.points.GetData(), 4), direction), 0.0) << e;
        EXPECT_GT(DorDot(DorNewellNormal(solid.top.points.GetData(), 4), direction), 0.0) << e;
        EXPECT_DOUBLE_EQ(solid.bottom.points[0].x, 0.0) << e;
        EXPECT_DOUBLE_EQ(solid.bottom.points[0].z, 0.0) << e;
    }
    const CDorExtruded& tapered = dynamic_cast<const CDorExtruded&>(*scene.entities[1]->geometry);
    EXPECT_DOUBLE_EQ(tapered.bottom.points[1].z, 4.0);  // (0, 0, 4) now follows point 0 ...
    EXPECT_DOUBLE_EQ(tapered.top.points[1].x, 1.0);     // ... and its top partner (1, 3, 3) still pairs with it
    EXPECT_DOUBLE_EQ(tapered.top.points[1].z, 3.0);
}

// A wall standing in the x-z plane with a door given clockwise and a window given
// counter-clockwise (seen from -y): both end up running the outline's way round.
class SceneWallWithOpenings : public SceneFileTest {
protected:
    CDorHoleExtruded* wall = nullptr;

    void SetUp() override
    {
        ASSERT_TRUE(Parse(SceneWith(R"({"name": "front", "type": "extrusion",
            "profile": [[0, 0, 0], [6, 0, 0], [6, 0, 3], [0, 0, 3]],
            "holes": [[[1, 0, 0.1], [1, 0, 2.1], [2, 0, 2.1], [2, 0, 0.1]],
                      [[3, 0, 1], [5, 0, 1], [5, 0, 2], [3, 0, 2]]],
            "extrude": [0, 0.25, 0]})")))
            << error;
        wall = dynamic_cast<CDorHoleExtruded*>(scene.entities[0]->geometry.get());
        ASSERT_NE(wall, nullptr);
    }
};

// The top holes are the bottom holes moved by the extrusion.
TEST_F(SceneWallWithOpenings, HolesRunTheOutlinesWayRoundAndMoveToTheTop)
{
    DorVector3 outline = DorNewellNormal(wall->bottom.points.GetData(), wall->bottom.points.GetSize());
    ASSERT_EQ(wall->bottom.holes.GetSize(), 2);
    for (int h = 0; h < 2; ++h) {
        const CDorPolygon& hole = wall->bottom.holes[h];
        ASSERT_EQ(hole.points.GetSize(), 4);
        EXPECT_GT(DorDot(DorNewellNormal(hole.points.GetData(), 4), outline), 0.0) << h;
    }
    ASSERT_EQ(wall->top.holes.GetSize(), 2);
    for (int h = 0; h < 2; ++h)
        for (int i = 0; i < 4; ++i)
            EXPECT_NEAR(Distance(wall->top.holes[h].points[i], wall->bottom.holes[h].points[i] + DorVector3(0, 0.25, 0)),
                        0.0, 1e-12);
}

TEST_F(SceneFileTest, CircleProfilesAreEvenPolygonsCounterClockwise)
{
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "boss", "type": "extrusion",
        "profile": {"center": [1, 2, 3], "radius": 0.5, "segments": 24}, "extrude": [0, 0, 1]})")))
        << error;
    const CDorExtruded& boss = dynamic_cast<const CDorExtruded&>(*scene.entities[0]->geometry);
    ASSERT_EQ(boss.bottom.points.GetSize(), 24);
    for (int i = 0; i < 24; ++i) {
        EXPECT_NEAR(Distance(boss.bottom.points[i], DorVector3(1, 2, 3)), 0.5, 1e-12) << i;
        EXPECT_NEAR(Distance(boss.bottom.points[i], boss.bottom.points[(i + 1) % 24]), 2 * 0.5 * std::sin(DorPi / 24), 1e-12);
    }
    EXPECT_GT(DorNewellNormal(boss.bottom.points.GetData(), 24).z, 0.0);
}

TEST_F(SceneFileTest, LinesAndGridsBecomePrimitivesWithTheirLook)
{
    ASSERT_TRUE(Parse(SceneWith(R"({"name": "x axis", "type": "line", "from": [0, 0, 0], "to": [5, 0, 0],
            "material": {"color": [1, 0, 0]}, "width": 3},
        {"name": "ground", "type": "grid", "from": [-5, -5], "to": [5, 5], "divisions": 10})")))
        << error;
    ASSERT_EQ(scene.entities.size(), 2u);
    const SceneEntity& axis = *scene.entities[0];
    EXPECT_EQ(axis.geometry, nullptr);
    ASSERT_EQ(axis.primitive.groups.GetSize(), 1);
    const CVelTrianglePolys& line = axis.primitive.groups[0];
    EXPECT_EQ(line.GroupType, VelGroupLines);
    ASSERT_EQ(line.vertices.GetSize(), 2);
    EXPECT_DOUBLE_EQ(line.vertices[1].position.x, 5.0);
    EXPECT_FLOAT_EQ(line.material.ambient.r, 1.0f);  // lines show their ambient colour
    EXPECT_FLOAT_EQ(line.material.diffuse.r, 0.8f);
    EXPECT_FLOAT_EQ(line.material.diffuse.g, 0.0f);
    EXPECT_FLOAT_EQ(line.lineWidth, 3.0f);

    const CVelTrianglePolys& grid = scene.entities[1]->primitive.groups[0];
    EXPECT_EQ(grid.vertices.GetSize(), 4 * 11);
    EXPECT_FLOAT_EQ(grid.lineWidth, 1.0f);
    EXPECT_EQ(scene.entities[1]->primitive.DrawMode, 2);  // pickable, visible
}

TEST_F(SceneFileTest, TexturesAreReadOnceAndSharedByName)
{
    dir.Write("tiles.bmp", BmpFile(16, 16, 24));
    dir.Write("wood.bmp", BmpFile(8, 4, 32));
    ASSERT_TRUE(Parse(SceneWith(
        Prism("a", R"("texture": {"file": "tiles.bmp", "scale": [2, 0.5], "axis": [0, 0, 1], "capAxis": [1, 0, 0]})") + "," +
        Prism("b", R"("texture": {"file": "wood.bmp"})") + "," + Prism("c", R"("texture": {"file": "tiles.bmp"})"))))
        << error;
    ASSERT_EQ(scene.textures.size(), 2u);
    EXPECT_EQ(scene.textures[0]->bitmap.info.width, 16);
    EXPECT_EQ(scene.textures[1]->bitmap.info.bitCount, 32);
    EXPECT_EQ(scene.entities[0]->texture, 0);
    EXPECT_EQ(scene.entities[1]->texture, 1);
    EXPECT_EQ(scene.entities[2]->texture, 0);

    const CDorExtruded& a = dynamic_cast<const CDorExtruded&>(*scene.entities[0]->geometry);
    EXPECT_DOUBLE_EQ(a.textureScaleU, 2.0);
    EXPECT_DOUBLE_EQ(a.top.textureScaleV, 0.5);
    EXPECT_DOUBLE_EQ(a.textureAxis.z, 1.0);
    // The caps' axis is a point beside each cap's first point.
    EXPECT_DOUBLE_EQ(a.bottom.textureAxis.x, 1.0);
    EXPECT_DOUBLE_EQ(a.bottom.textureAxis.z, 0.0);
    EXPECT_DOUBLE_EQ(a.top.textureAxis.z, 1.0);
}

TEST_F(SceneFileTest, AMissingSceneFileIsNamed)
{
    EXPECT_FALSE(LoadSceneFile(dir.Path("absent.json"), scene, error));
    EXPECT_EQ(error, dir.Path("absent.json") + ": expected a readable scene file");
}

// Each kind of mistake names the file, the place and what was expected, with what was found.
TEST_F(SceneFileTest, MistakesAreNamedWithThePlaceAndWhatWasExpected)
{
    const std::string triangle = R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[0,1,0]])";
    const std::string grid = R"({"name": "g", "type": "grid", "from": [0, 0], "to": [1, 1])";
    const std::string tooFew = "expected a profile: an array of at least 3 points [x, y, z], or a circle object, found an array of 2";
    const std::string divisions = "(\"g\").divisions: expected a whole number from 1 to 10000, found the number ";
    struct Case {
        std::string text, message;  // message without the leading "test.json: "
    } cases[] = {
        // missing fields
        {R"({"entities": []})", "top level: expected \"camera\" (the camera object)"},
        {R"({"camera": {"eye": [0,0,1]}, "entities": []})", "camera: expected \"target\" (a point [x, y, z])"},
        {SceneWith(R"({"name": "w", "type": "extrusion", "extrude": [0,0,1]})"),
         "entities[0] (\"w\"): expected \"profile\" (an array of at least 3 points [x, y, z])"},
        {SceneWith(R"({"type": "line"})"), "entities[0]: expected \"name\" (the entity's name)"},
        {SceneWith(triangle + "}"), "entities[0] (\"w\"): expected \"extrude\" (the vector from the profile to the top "
                                    "face) or \"top\" (the top profile)"},
        {SceneWith(grid + "}"), "entities[0] (\"g\"): expected \"divisions\" (a whole number from 1)"},
        // wrong types and ranges
        {SceneWith(R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,"a"],[0,1,0]], "extrude": [0,0,1]})"),
         "entities[0] (\"w\").profile[1][2]: expected a number, found the string \"a\""},
        {SceneWith(R"({"name": "w", "type": "extrusion", "profile": [[0,0,0],[1,0,0]], "extrude": [0,0,1]})"),
         "entities[0] (\"w\").profile: " + tooFew},
        {SceneWith(R"({"name": "w", "type": "cone"})"),
         "entities[0] (\"w\").type: expected \"extrusion\" or \"line\" or \"grid\", found the string \"cone\""},
        {SceneWith("", R"(, "background": [1, 0.5, 2])"), "background[2]: expected a number from 0 to 1, found the number 2"},
        {SceneWith(grid + ", \"divisions\": 2.5}"), "entities[0] " + divisions + "2.5"},
        {SceneWith(grid + ", \"divisions\": 18446744073709551615}"), "entities[0] " + divisions + "18446744073709551615"},
        {SceneWith(R"({"name": "l", "type": "line", "from": [0, 0, 0], "to": [1, 0, 0], "width": 0})"),
         "entities[0] (\"l\").width: expected a line width in pixels from 1 to 10, found the number 0"},
        {R"([1, 2])", "top level: expected a scene object, found an array of 2"},
        // inconsistent scenes
        {SceneWith(std::string(kWall) + "," + kWall),
         "entities[1] (\"wall\").name: expected a name not used before (entities[0] has it)"},
        {SceneWith(triangle + R"(, "top": [[0,0,1],[1,0,1]]})"), "entities[0] (\"w\").top: " + tooFew},
        {SceneWith(triangle + R"(, "top": [[0,0,1],[1,0,1],[1,1,1],[0,1,1]]})"),
         "entities[0] (\"w\").top: expected as many points as the profile (3), found 4"},
        {SceneWith(triangle + R"(, "extrude": [0, 0, 0]})"),
         "entities[0] (\"w\").extrude: expected a direction [x, y, z] at least 0.0001 long, found an array of 3"},
        {R"({"camera": {"eye": [1, 1, 1], "target": [1, 1, 1]}, "entities": []})",
         "camera.target: expected a point at least 0.0001 away from the eye"},
        {SceneWith(kWall, R"(, "lights": [{"index": 1, "type": "directional", "direction": [0,0,-1]},
            {"index": 1, "type": "positional", "position": [0,0,5]}])"),
         "lights[1].index: expected a light index not given before"},
        {SceneWith(triangle + R"(, "extrud": [0,0,1]})"),
         "entities[0] (\"w\").extrud: expected one of the keys \"name\", \"type\", \"profile\", \"holes\", \"extrude\", "
         "\"top\", \"caps\", \"style\", \"material\", \"texture\""},
    };
    for (const Case& c : cases)
        EXPECT_EQ(Refusal(c.text), "test.json: " + c.message) << c.text;

    std::string syntax = Refusal("{\n  \"camera\": {\"eye\": [0, 0, 1],,\n}");
    EXPECT_EQ(syntax.rfind("test.json: line 2, column ", 0), 0u) << syntax;
    EXPECT_NE(syntax.find("expected valid JSON"), std::string::npos) << syntax;
    EXPECT_NE(Refusal("").find("expected valid JSON"), std::string::npos);
}

TEST_F(SceneFileTest, UnreadableTexturesAreNamed)
{
    dir.Write("text.bmp", std::string("not a picture"));
    dir.Write("odd.bmp", BmpFile(3, 5, 24));
    dir.Write("big.bmp", BmpFile(1024, 512, 24));
    struct Case {
        std::string file, message;
    } cases[] = {
        {"absent.bmp", "a readable BMP file, but \"" + dir.Path("absent.bmp") + "\" cannot be read"},
        {"text.bmp", "a BMP file (it starts with \"BM\" and a 40-byte information header) (\"" + dir.Path("text.bmp") + "\")"},
        {"odd.bmp", "a texture whose width x height is a power of two up to 512 x 512 (\"" + dir.Path("odd.bmp") + "\" is 3 x 5)"},
        {"big.bmp", "a texture whose width x height is a power of two up to 512 x 512 (\"" + dir.Path("big.bmp") +
                        "\" is 1024 x 512)"},
    };
    for (const Case& c : cases)
        EXPECT_EQ(Refusal(SceneWith(Prism("t", R"("texture": {"file": ")" + c.file + "\"}"))),
                  "test.json: entities[0] (\"t\").texture.file: expected " + c.message);
}
