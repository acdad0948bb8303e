// The scenes shipped with the viewer, and the complete example of the scene format's
// documentation, load and turn into geometry.
#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include "convert/vel_shape_to_primitive.h"
#include "scene.h"

namespace {
const std::string kSource = KARVEL_SOURCE_DIR;

// Every extrusion yields its groups: walls for each profile edge and the caps asked for.
void ExpectEveryEntityHasGeometry(Scene& scene, const std::string& file)
{
    for (auto& entity : scene.entities) {
        CVelPrimitive primitive;
        if (entity->geometry) {
            CDorShape shape;
            shape.Add(entity->geometry.get());
            CVelShapeToPrimitive().ConvertShape(shape, primitive);
        } else {
            primitive = entity->primitive;
        }
        EXPECT_GT(primitive.groups.GetSize(), 0) << file << ": " << entity->name;
        for (int g = 0; g < primitive.groups.GetSize(); ++g)
            EXPECT_GT(primitive.groups[g].vertices.GetSize(), 0) << file << ": " << entity->name << " group " << g;
    }
}
}  // namespace

TEST(SampleScenes, HouseAndPartLoadAndConvert)
{
    Scene scene;
    std::string error;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/house.json", scene, error)) << error;
    ASSERT_EQ(scene.textures.size(), 1u);
    EXPECT_EQ(scene.textures[0]->bitmap.info.width, 32);
    int holed = 0;
    for (auto& entity : scene.entities)
        holed += dynamic_cast<CDorHoleExtruded*>(entity->geometry.get()) != nullptr;
    EXPECT_EQ(holed, 4);  // four walls, each with an opening
    ExpectEveryEntityHasGeometry(scene, "house.json");

    Scene part;
    ASSERT_TRUE(LoadSceneFile(kSource + "/examples/scenes/part.json", part, error)) << error;
    ExpectEveryEntityHasGeometry(part, "part.json");
}

TEST(SampleScenes, DocumentedExampleLoads)
{
    std::ifstream doc(kSource + "/docs/scene-format.md");
    std::string text((std::istreambuf_iterator<char>(doc)), std::istreambuf_iterator<char>());
    size_t begin = text.find("```json\n");
    ASSERT_NE(begin, std::string::npos);
    begin += 8;
    size_t end = text.find("```", begin);
    Scene scene;
    std::string error;
    ASSERT_TRUE(ParseScene(text.substr(begin, end - begin), "scene-format.md", kSource + "/examples/scenes/", scene, error))
        << error;
    EXPECT_EQ(scene.entities.size(), 5u);
    ExpectEveryEntityHasGeometry(scene, "scene-format.md");
}
