#include <gtest/gtest.h>

#include <stdexcept>

#include "scene.h"
#include "scene_model.h"
#include "support/recording_karvel.h"
#include "viewer_test_support.h"

namespace {
// Hands out texture names from 7 on (0 = refused), keeps lights and background.
class SceneKarvel : public RecordingKarvel {
public:
    bool refuseTextures = false;
    std::vector<int> textureWidths;
    std::vector<std::pair<int, DorLight>> lights;
    DorColorValue background;

    unsigned int AddTexture(_DorBitmap& bitmap) override
    {
        if (refuseTextures)
            return 0;
        textureWidths.push_back(bitmap.info.width);
        return 6 + static_cast<unsigned int>(textureWidths.size());
    }
    void SetLight(int index, DorLight light) override { lights.push_back({index, light}); }
    void SetBkColor(DorColorValue& colour) override { background = colour; }
};

// A textured box, a plain grid and a line, with a light and a grey background.
class TexturedBoxScene : public ::testing::Test {
protected:
    viewer_test::ScratchDir dir{"scene_model_test"};
    Scene scene;
    SceneKarvel modeller;
    SceneNames names;

    void SetUp() override
    {
        dir.Write("tiles.bmp", viewer_test::BmpFile(8, 8, 24));
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
        throw std::runtime_error("no entity " + name);
    }
};
}  // namespace

// Walls and caps carry the texture name the modeller gave, or none when it refused the texture.
TEST_F(TexturedBoxScene, EveryEntityIsAddedUnderItsNameWithItsTexture)
{
    for (bool refuse : {false, true}) {
        modeller.refuseTextures = refuse;
        modeller.entities.clear();
        names.clear();
        AddSceneEntities(modeller, scene, AddSceneTextures(modeller, scene), names);
        ASSERT_TRUE(names.size() == 3u && modeller.entities.size() == 3u);
        const CVelPrimitive& box = EntityNamed("box");
        ASSERT_EQ(box.groups.GetSize(), 6);  // four walls and two caps
        for (int g = 0; g < box.groups.GetSize(); ++g) {
            EXPECT_EQ(box.groups[g].texture, refuse ? 0u : 7u) << g;
            EXPECT_EQ(box.groups[g].RenderKind, refuse ? VelRenderLit : VelRenderTextured) << g;
        }
        EXPECT_TRUE(EntityNamed("ground").groups[0].GroupType == VelGroupLines && EntityNamed("ground").groups[0].texture == 0u);
        EXPECT_EQ(EntityNamed("axis").groups[0].vertices.GetSize(), 2);
    }
    EXPECT_EQ(modeller.textureWidths, std::vector<int>{8});
}

TEST_F(TexturedBoxScene, ViewKeepsTheWindowsAspectRatio)
{
    modeller.camera.aspect = 1.6;
    ApplySceneView(modeller, scene);
    EXPECT_TRUE(modeller.camera.eye.x == 5.0 && modeller.camera.fovy == 40.0 && modeller.camera.aspect == 1.6);
    ASSERT_EQ(modeller.lights.size(), 1u);
    EXPECT_TRUE(modeller.lights[0].first == 1 && modeller.lights[0].second.direction.x == 1.0);
    EXPECT_TRUE(modeller.background.r == 0.5f && modeller.background.a == 1.0f);
}
