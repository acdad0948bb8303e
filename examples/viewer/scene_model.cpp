#include "scene_model.h"

#include <vector>

namespace {
// The walls carry the texture name and so do both caps, as the scene file describes them.
void NameTexture(CDorGeometry& geometry, unsigned int name)
{
    geometry.texture = name;
    if (auto* extruded = dynamic_cast<CDorExtruded*>(&geometry)) {
        extruded->bottom.texture = extruded->top.texture = name;
    } else if (auto* holed = dynamic_cast<CDorHoleExtruded*>(&geometry)) {
        holed->bottom.texture = holed->top.texture = name;
    }
}
}  // namespace

std::vector<unsigned int> AddSceneTextures(CVelKarvel& modeller, Scene& scene)
{
    std::vector<unsigned int> textureNames;
    for (auto& texture : scene.textures)
        textureNames.push_back(modeller.AddTexture(texture->bitmap));
    return textureNames;
}

void AddSceneEntities(CVelKarvel& modeller, Scene& scene, const std::vector<unsigned int>& textureNames,
                      SceneNames& names)
{
    for (auto& entity : scene.entities) {
        _DorPosition* position;
        if (entity->geometry) {
            if (entity->texture >= 0 && static_cast<size_t>(entity->texture) < textureNames.size())
                NameTexture(*entity->geometry, textureNames[static_cast<size_t>(entity->texture)]);
            CDorShape shape;
            shape.Add(entity->geometry.get());
            position = modeller.AddShape(shape);
        } else {
            position = modeller.AddPrimitive(entity->primitive);
        }
        if (position)
            names[position] = entity->name;
    }
}

void ApplySceneView(CVelKarvel& modeller, const Scene& scene)
{
    _VelCamera camera = scene.camera;
    _VelCamera current = camera;
    modeller.GetCamera(current);
    camera.aspect = current.aspect;
    modeller.SetCamera(camera);
    for (const SceneLight& light : scene.lights)
        modeller.SetLight(light.index, light.light);
    DorColorValue background = scene.background;
    modeller.SetBkColor(background);
}
