#pragma once
// Handing a loaded scene to a modeller, as any host would: textures and entities first (the
// textures reach OpenGL when a context starts), then camera, lights and background on the live
// modeller.
#include <map>
#include <string>

#include "gl/vel_karvel.h"
#include "scene.h"

// Entity names by handle, to tell the user what a pick hit.
typedef std::map<const _DorPosition*, std::string> SceneNames;

// Adds the scene's textures and entities; call before Initialize. A texture the modeller
// refuses leaves its entities untextured.
void AddSceneModel(CVelKarvel& modeller, Scene& scene, SceneNames& names);

// Sets the scene's camera (keeping the modeller's aspect ratio), lights and background; the
// modeller must be live.
void ApplySceneView(CVelKarvel& modeller, const Scene& scene);
