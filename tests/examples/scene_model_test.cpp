#include <gtest/gtest.h>

#include "scene.h"
#include "scene_model.h"
#include "support/recording_karvel.h"
#include "viewer_test_support.h"

using viewer_test::BmpFile;
using viewer_test::ScratchDir;

namespace {
// Hands out texture names from firstName on (0 = refused), keeps lights and background.
class SceneKarvel : public RecordingKarvel {
public:
    unsigned int firstName = 7;
    bool refuseTextures = false;
    std::vector<int> textureWidths;
    std::vector<std::pair<int, DorLight>> lights;
    DorColorValue background;

    unsigned int AddTexture(_DorBitmap& bitmap) override
    {
        if (refuseTextures)
            return 0;
        textureWidths.push_back(bitmap.info.width);
        return firstName + static_cast<unsigned int>(textureWidths.size()) - 1;
    }
    void SetLight(int index, DorLight light) override { lights.push_back({index, light}); }
    void SetBkColor(DorColorValue& colour) override { background = colour; }
};

// A textured box, a plain grid and a line, with a light and a grey background.
class TexturedBoxScene : public ::testing::Test {
protected:
    ScratchDir dir{"scene_model_test"};
    Scene scene;
    SceneKarvel modeller;
    SceneNames names;

    void SetUp() override
    {
        dir.Write("tiles.bmp", BmpFile(8, 8, 24));
        dir.Write("scene.json", std::string(R"({"background": [0.5, 0.5, 0.5],
            "camera": {"eye": [5, -5, 5], "target": [0, 0, 0], "fovy": 40},
            "lights": [{"index": 1, "type": "directional", "direction": [1, 1, -1]}],
            "entities": [
              {"name": "box", "type": "extrusion", "profile": [[0,0,0],[1,0,0],[1,1,0],[0,1,0]],
               "extrude": [0, 0, 1], "texture": {"file": "tiles.bmp"}},
              {"name": "ground", "type": "grid", "from": [-2, -2], "to": [2, 2], "divisions": 4},
              {"name": "axis", "type": "line", "from": [0, 0, 0], "to": [0, 0, 3]}]})"));
        std::string error;
        ASSERT_TRUE(LoadSceneFile(dir.Path("scene.json"), scene, error)) << error;
    }

    const CVelPrimitive& EntityNamed(const std::string& name)
    {
        for (auto& entry : names)
            if (entry.second == name)
                return modeller.entities.at(const_cast<_DorPosition*>(entry.first));
        ADD_FAILURE() << "no entity " << name;
        return modeller.entities.begin()->second;
    }
};
}  // namespace

TEST_F(TexturedBoxScene, EveryEntityIsAddedUnderItsNameWithItsTexture)
{
    AddSceneEntities(modeller, scene, AddSceneTextures(modeller, scene), names);
    ASSERT_EQ(names.size(), 3u);
    ASSERT_EQ(modeller.entities.size(), 3u);
    EXPECT_EQ(EntityNamed("box").groups.GetSize(), 6);  // four walls and two caps
    EXPECT_EQ(EntityNamed("ground").groups[0].GroupType, VelGroupLines);
    EXPECT_EQ(EntityNamed("axis").groups[0].vertices.GetSize(), 2);
    // Walls and caps carry the texture name the modeller gave.
    ASSERT_EQ(modeller.textureWidths, std::vector<int>{8});
    const CVelPrimitive& box = EntityNamed("box");
    for (int g = 0; g < box.groups.GetSize(); ++g) {
        EXPECT_EQ(box.groups[g].texture, 7u) << g;
        EXPECT_EQ(box.groups[g].RenderKind, VelRenderTextured) << g;
    }
    EXPECT_EQ(EntityNamed("ground").groups[0].texture, 0u);
}

TEST_F(TexturedBoxScene, ARefusedTextureLeavesTheBoxPlain)
{
    modeller.refuseTextures = true;
    AddSceneEntities(modeller, scene, AddSceneTextures(modeller, scene), names);
    const CVelPrimitive& box = EntityNamed("box");
    ASSERT_EQ(box.groups.GetSize(), 6);
    for (int g = 0; g < box.groups.GetSize(); ++g)
        EXPECT_EQ(box.groups[g].RenderKind, VelRenderLit) << g;
}

TEST_F(TexturedBoxScene, ViewKeepsTheWindowsAspectRatio)
{
    modeller.camera.aspect = 1.6;
    ApplySceneView(modeller, scene);
    EXPECT_DOUBLE_EQ(modeller.camera.eye.x, 5.0);
    EXPECT_DOUBLE_EQ(modeller.camera.fovy, 40.0);
    EXPECT_DOUBLE_EQ(modeller.camera.aspect, 1.6);
    ASSERT_EQ(modeller.lights.size(), 1u);
    EXPECT_EQ(modeller.lights[0].first, 1);
    EXPECT_DOUBLE_EQ(modeller.lights[0].second.direction.x, 1.0);
    EXPECT_FLOAT_EQ(modeller.background.r, 0.5f);
    EXPECT_FLOAT_EQ(modeller.background.a, 1.0f);
}
