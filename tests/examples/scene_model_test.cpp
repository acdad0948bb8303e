#include <gtest/gtest.h>

#include "scene.h"
#include "scene_model.h"
#include "support/recording_karvel.h"

namespace {
// Hands out texture names from 7 on (0 = refused), keeps lights and background.
class SceneKarvel : public RecordingKarvel {
public:
    bool refuseTextures = false;
    std::vector<std::pair<int, DorLight>> lights;
    DorColorValue background;
    unsigned int AddTexture(_DorBitmap& bitmap) override { return refuseTextures || bitmap.info.width != 32 ? 0 : 7; }
    void SetLight(int index, DorLight light) override { lights.push_back({index, light}); }
    void SetBkColor(DorColorValue& colour) override { background = colour; }
};
}  // namespace

// The shipped house: a textured floor among plain walls, axis lines and a ground grid. Every group
// of the floor, walls and caps alike, carries the texture name the modeller gave, or none when it
// refused the texture; the view keeps the window's aspect ratio.
TEST(SceneModel, EntitiesTakeTheirNamesAndTexturesAndTheViewKeepsTheAspect)
{
    Scene scene;
    std::string error;
    ASSERT_TRUE(LoadSceneFile(std::string(KARVEL_SOURCE_DIR) + "/examples/scenes/house.json", scene, error)) << error;
    for (bool refuse : {false, true}) {
        SceneKarvel k;
        k.refuseTextures = refuse;
        SceneNames names;
        AddSceneEntities(k, scene, AddSceneTextures(k, scene), names);
        ASSERT_TRUE(names.size() == scene.entities.size() && k.entities.size() == names.size());
        for (auto& entry : names) {
            const CVelPrimitive& p = k.entities.at(const_cast<_DorPosition*>(entry.first));
            const bool textured = entry.second == "tiled floor" && !refuse;
            EXPECT_TRUE(entry.second != "tiled floor" || p.groups.GetSize() == 6);  // four walls and two caps
            for (int g = 0; g < p.groups.GetSize(); ++g)
                EXPECT_TRUE(p.groups[g].texture == (textured ? 7u : 0u) && (p.groups[g].RenderKind == VelRenderTextured) == textured)
                    << entry.second << " group " << g;
        }
        k.camera.aspect = 1.6;
        ApplySceneView(k, scene);
        EXPECT_TRUE(k.camera.eye.x == -5.0 && k.camera.fovy == 40.0 && k.camera.aspect == 1.6 && k.background.r == 0.62f);
        EXPECT_TRUE(k.lights.size() == 1u && k.lights[0].first == 1 && k.lights[0].second.direction.x == -0.5);
    }
}
