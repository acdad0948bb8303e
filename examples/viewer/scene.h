#pragma once
// A scene as the sample viewer reads it from a JSON file (the format is in docs/scene-format.md):
// named entities (extrusions with or without holes, lines, grids), the textures they use,
// lights, background and camera. Loading yields either the whole scene or one message that
// names the file, the place in it and what was expected; nothing half-loaded reaches a modeller.
#include <memory>
#include <string>
#include <vector>

#include "camera/vel_camera.h"
#include "convert/dor_shape.h"
#include "model/vel_primitive.h"

struct SceneTexture {
    std::string path;  // as opened: resolved against the scene file's folder
    _DorBitmap bitmap;
};

struct SceneEntity {
    std::string name;
    std::unique_ptr<CDorGeometry> geometry;  // an extrusion, plain or holed; null for lines and grids
    CVelPrimitive primitive;                 // lines and grids
    int texture = -1;                        // index into Scene::textures; -1 = untextured
};

struct SceneLight {
    int index;  // 0..7; light 0 follows the camera
    DorLight light;
};

struct Scene {
    std::vector<std::unique_ptr<SceneEntity>> entities;
    std::vector<std::unique_ptr<SceneTexture>> textures;  // one per distinct file
    std::vector<SceneLight> lights;
    DorColorValue background = DorColorValue(0.0f, 0.0f, 0.0f, 1.0f);
    _VelCamera camera = {};  // aspect is left to the window
};

// Parses scene text. fileName names the file in the message; texture files are resolved
// against baseDir. On failure returns false, error holds "FILE: PLACE: expected WHAT" and
// scene is unspecified; text that is not JSON, or holds a number no double holds (1e400), gives
// "FILE: line L, column C: expected valid JSON (WHY)". Nothing is thrown.
bool ParseScene(const std::string& text, const std::string& fileName, const std::string& baseDir, Scene& scene,
                std::string& error);

// Reads and parses a scene file; its textures are resolved against the file's folder.
bool LoadSceneFile(const std::string& path, Scene& scene, std::string& error);
