#include <gtest/gtest.h>

#include "scene.h"
#include "scene_model.h"
#include "support/recording_karvel.h"

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
        textureWidths.push_back(bitmap.info.width);
        return refuseTextures ? 0 : 6 + static_cast<unsigned int>(textureWidths.size());
    }
    void SetLight(int index, DorLight light) override { lights.push_back({index, light}); }
    void SetBkColor(DorColorValue& colour) override { background = colour; }
};

// The shipped house: a textured floor among plain walls, axis lines and a ground grid.
class HouseScene : public ::testing::Test {
protected:
    Scene scene;
    SceneKarvel modeller;
    void SetUp() override
    {
        std::string error;
        ASSERT_TRUE(LoadSceneFile(std::string(KARVEL_SOURCE_DIR) + "/examples/scenes/house.json", scene, error)) << error;
    }
};
}  // namespace

// Every group of the floor, walls and caps alike, carries the texture name the modeller gave, or
// none when it refused the texture.
TEST_F(HouseScene, EveryEntityIsAddedUnderItsNameWithItsTexture)
{
    for (bool refuse : {false, true}) {
        modeller.refuseTextures = refuse;
        modeller.entities.clear();
        SceneNames names;
        AddSceneEntities(modeller, scene, AddSceneTextures(modeller, scene), names);
        ASSERT_TRUE(names.size() == scene.entities.size() && modeller.entities.size() == names.size());
        for (auto& entry : names) {
            const CVelPrimitive& p = modeller.entities.at(const_cast<_DorPosition*>(entry.first));
            const bool textured = entry.second == "tiled floor" && !refuse;
            EXPECT_TRUE(entry.second != "tiled floor" || p.groups.GetSize() == 6);  // four walls and two caps
            for (int g = 0; g < p.groups.GetSize(); ++g)
                EXPECT_TRUE(p.groups[g].texture == (textured ? 7u : 0u) && (p.groups[g].RenderKind == VelRenderTextured) == textured)
                    << entry.second << " group " << g;
        }
    }
    EXPECT_EQ(modeller.textureWidths, (std::vector<int>{32, 32}));
}

TEST_F(HouseScene, ViewKeepsTheWindowsAspectRatio)
{
    modeller.camera.aspect = 1.6;
    ApplySceneView(modeller, scene);
    EXPECT_TRUE(modeller.camera.eye.x == -5.0 && modeller.camera.fovy == 40.0 && modeller.camera.aspect == 1.6);
    ASSERT_EQ(modeller.lights.size(), 1u);
    EXPECT_TRUE(modeller.lights[0].first == 1 && modeller.lights[0].second.direction.x == -0.5);
    EXPECT_TRUE(modeller.background.r == 0.62f && modeller.background.a == 1.0f);
}
