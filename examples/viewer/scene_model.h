#pragma once
// Handing a loaded scene to a modeller, as any host would: textures before Initialize (they
// reach OpenGL when a context starts), entities after it (its first call empties the model),
// then camera, lights and background on the live modeller.
#include <map>
#include <string>
#include <vector>

#include "gl/vel_karvel.h"
#include "scene.h"

// Entity names by handle, to tell the user what a pick hit.
typedef std::map<const _DorPosition*, std::string> SceneNames;

// Adds the scene's textures; returns the name the modeller gave each (0 = refused).
std::vector<unsigned int> AddSceneTextures(CVelKarvel& modeller, Scene& scene);

// Adds the scene's entities, textured with the names AddSceneTextures returned; an entity
// whose texture was refused stays untextured.
void AddSceneEntities(CVelKarvel& modeller, Scene& scene, const std::vector<unsigned int>& textureNames,
                      SceneNames& names);

// Sets the scene's camera (keeping the modeller's aspect ratio), lights and background; the
// modeller must be live.
void ApplySceneView(CVelKarvel& modeller, const Scene& scene);
