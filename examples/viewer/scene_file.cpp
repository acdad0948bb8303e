#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <map>

#include <nlohmann/json.hpp>

#include "bmp_file.h"
#include "model/dor_math.h"
#include "primitives/vel_math_primitive.h"
#include "scene.h"
#include "viewer_math.h"

using Json = nlohmann::json;

namespace {
// Thrown inside the parser only; ParseScene turns it into the one message.
struct SceneError {
    std::string place;
    std::string expected;
};

// What a wrong value turned out to be, for "expected X, found Y".
std::string Describe(const Json& value)
{
    switch (value.type()) {
    case Json::value_t::null: return "null";
    case Json::value_t::boolean: return value.get<bool>() ? "true" : "false";
    case Json::value_t::string: return "the string " + value.dump();
    case Json::value_t::array: return "an array of " + std::to_string(value.size());
    case Json::value_t::object: return "an object";
    default: return "the number " + value.dump();
    }
}

[[noreturn]] void Fail(const std::string& place, const std::string& expected) { throw SceneError{place, expected}; }

[[noreturn]] void FailFound(const std::string& place, const std::string& expected, const Json& found)
{
    Fail(place, expected + ", found " + Describe(found));
}

std::string Member(const std::string& place, const char* key) { return place.empty() ? key : place + "." + key; }
std::string Item(const std::string& place, size_t index) { return place + "[" + std::to_string(index) + "]"; }

void ExpectObject(const Json& value, const std::string& place, const std::string& what)
{
    if (!value.is_object())
        FailFound(place, what, value);
}

// A misspelt key would otherwise be ignored silently.
void CheckKeys(const Json& object, const std::string& place, std::initializer_list<const char*> allowed)
{
    for (auto it = object.begin(); it != object.end(); ++it) {
        bool known = false;
        std::string list;
        for (const char* key : allowed) {
            known = known || it.key() == key;
            list += list.empty() ? std::string("\"") + key + "\"" : std::string(", \"") + key + "\"";
        }
        if (!known)
            Fail(Member(place, it.key().c_str()), "one of the keys " + list);
    }
}

const Json* Find(const Json& object, const char* key)
{
    auto it = object.find(key);
    return it == object.end() ? nullptr : &*it;
}

const Json& Require(const Json& object, const char* key, const std::string& place, const std::string& what)
{
    const Json* value = Find(object, key);
    if (!value)
        Fail(place, std::string("\"") + key + "\" (" + what + ")");
    return *value;
}

double ReadNumber(const Json& value, const std::string& place, const std::string& what = "a number")
{
    if (!value.is_number() || !std::isfinite(value.get<double>()))
        FailFound(place, what, value);
    return value.get<double>();
}

// A number from low to high, both included.
double ReadBounded(const Json& value, const std::string& place, double low, double high, const std::string& what)
{
    double number = ReadNumber(value, place, what);
    if (number < low || number > high)
        FailFound(place, what, value);
    return number;
}

double ReadPositive(const Json& value, const std::string& place)
{
    double number = ReadNumber(value, place, "a number above 0");
    if (number <= 0.0)
        FailFound(place, "a number above 0", value);
    return number;
}

int ReadInteger(const Json& value, const std::string& place, int low, int high)
{
    std::string what = "a whole number from " + std::to_string(low) + " to " + std::to_string(high);
    if (!value.is_number_integer())
        FailFound(place, what, value);
    // Large positive numbers come as unsigned: compare them before narrowing.
    if (value.is_number_unsigned() && value.get<unsigned long long>() > static_cast<unsigned long long>(high))
        FailFound(place, what, value);
    long long number = value.get<long long>();
    if (number < low || number > high)
        FailFound(place, what, value);
    return static_cast<int>(number);
}

bool ReadBool(const Json& value, const std::string& place)
{
    if (!value.is_boolean())
        FailFound(place, "true or false", value);
    return value.get<bool>();
}

std::string ReadName(const Json& value, const std::string& place)
{
    if (!value.is_string() || value.get<std::string>().empty())
        FailFound(place, "a non-empty string", value);
    return value.get<std::string>();
}

// Returns the index of value among choices.
int ReadChoice(const Json& value, const std::string& place, std::initializer_list<const char*> choices)
{
    std::string list;
    int index = 0;
    for (const char* choice : choices) {
        if (value.is_string() && value.get<std::string>() == choice)
            return index;
        list += (index++ ? " or \"" : "\"") + std::string(choice) + "\"";
    }
    FailFound(place, list, value);
}

const Json& ReadArray(const Json& value, const std::string& place, size_t minSize, size_t maxSize,
                      const std::string& what)
{
    if (!value.is_array() || value.size() < minSize || value.size() > maxSize)
        FailFound(place, what, value);
    return value;
}

DorVector3 ReadPoint(const Json& value, const std::string& place)
{
    const char* what = "a point [x, y, z] of three numbers";
    const Json& xyz = ReadArray(value, place, 3, 3, what);
    return DorVector3(ReadNumber(xyz[0], Item(place, 0)), ReadNumber(xyz[1], Item(place, 1)),
                      ReadNumber(xyz[2], Item(place, 2)));
}

DorVector2 ReadPoint2(const Json& value, const std::string& place)
{
    const Json& xy = ReadArray(value, place, 2, 2, "a point [x, y] of two numbers");
    return DorVector2(ReadNumber(xy[0], Item(place, 0)), ReadNumber(xy[1], Item(place, 1)));
}

DorVector3 ReadDirection(const Json& value, const std::string& place)
{
    DorVector3 direction = ReadPoint(value, place);
    if (Length(direction) < 0.0001)
        FailFound(place, "a direction [x, y, z] at least 0.0001 long", value);
    return direction;
}

DorColorValue ReadColour(const Json& value, const std::string& place)
{
    const char* what = "a colour [r, g, b] or [r, g, b, a] of numbers from 0 to 1";
    const Json& rgba = ReadArray(value, place, 3, 4, what);
    float c[4] = {1.0f, 1.0f, 1.0f, 1.0f};
    for (size_t i = 0; i < rgba.size(); ++i) {
        c[i] = static_cast<float>(ReadBounded(rgba[i], Item(place, i), 0.0, 1.0, "a number from 0 to 1"));
    }
    return DorColorValue(c[0], c[1], c[2], c[3]);
}

// Replaces colour with the one under key, when the object has one.
void ReadOptionalColour(const Json& object, const char* key, const std::string& place, DorColorValue& colour)
{
    if (const Json* value = Find(object, key))
        colour = ReadColour(*value, Member(place, key));
}

DorColorValue Scaled(const DorColorValue& c, float s) { return DorColorValue(c.r * s, c.g * s, c.b * s, c.a); }

enum class Surface { Faces, Lines };

// "color" gives a plain material (diffuse c, ambient 0.4 c, a weak highlight); lines, which
// have no normals and show only their ambient colour, get the line generator's diffuse 0.8 c
// and ambient c. The other keys override single parts of it, or of base when no colour is given.
_DorMaterial ReadMaterial(const Json& value, const std::string& place, _DorMaterial base, Surface surface)
{
    ExpectObject(value, place, "a material object");
    CheckKeys(value, place, {"color", "diffuse", "ambient", "specular", "shininess"});
    if (const Json* colour = Find(value, "color")) {
        DorColorValue c = ReadColour(*colour, Member(place, "color"));
        bool lines = surface == Surface::Lines;
        base.diffuse = lines ? Scaled(c, 0.8f) : c;
        base.ambient = lines ? c : Scaled(c, 0.4f);
        base.specular = DorColorValue(0.3f, 0.3f, 0.3f, 1.0f);
        base.emission = DorColorValue(0.0f, 0.0f, 0.0f, 0.0f);
        base.shininess = 30.0f;
    }
    ReadOptionalColour(value, "diffuse", place, base.diffuse);
    ReadOptionalColour(value, "ambient", place, base.ambient);
    ReadOptionalColour(value, "specular", place, base.specular);
    if (const Json* s = Find(value, "shininess"))
        base.shininess = static_cast<float>(ReadBounded(*s, Member(place, "shininess"), 0.0, 128.0, "a number from 0 to 128"));
    return base;
}

const int MaxCircleSegments = 360;

// A circle in the plane z = centre.z, counter-clockwise seen from +z, starting on +x.
std::vector<DorVector3> ReadCircle(const Json& value, const std::string& place)
{
    CheckKeys(value, place, {"center", "radius", "segments"});
    DorVector3 centre = ReadPoint(Require(value, "center", place, "a point [x, y, z]"), Member(place, "center"));
    double radius = ReadPositive(Require(value, "radius", place, "a number above 0"), Member(place, "radius"));
    int segments = ReadInteger(Require(value, "segments", place, "a whole number from 3"), Member(place, "segments"),
                               3, MaxCircleSegments);
    std::vector<DorVector3> points;
    for (int i = 0; i < segments; ++i) {
        double angle = 2.0 * DorPi * i / segments;
        points.push_back(DorVector3(centre.x + radius * std::cos(angle), centre.y + radius * std::sin(angle), centre.z));
    }
    return points;
}

std::vector<DorVector3> ReadProfile(const Json& value, const std::string& place)
{
    const char* what = "a profile: an array of at least 3 points [x, y, z], or a circle object";
    if (value.is_object())
        return ReadCircle(value, place);
    const Json& list = ReadArray(value, place, 3, 100000, what);
    std::vector<DorVector3> points;
    for (size_t i = 0; i < list.size(); ++i)
        points.push_back(ReadPoint(list[i], Item(place, i)));
    return points;
}

// Points toward a viewer who sees the loop run counter-clockwise.
DorVector3 NewellNormal(const std::vector<DorVector3>& loop)
{
    DorVector3 n;
    for (size_t i = 0; i < loop.size(); ++i) {
        const DorVector3& a = loop[i];
        const DorVector3& b = loop[(i + 1) % loop.size()];
        n.x += (a.y - b.y) * (a.z + b.z);
        n.y += (a.z - b.z) * (a.x + b.x);
        n.z += (a.x - b.x) * (a.y + b.y);
    }
    return n;
}

// AddTexture's rule for the bitmaps DecodeBmp gives (24 or 32 bits, every row present): width x
// height a power of two from 2 to 512 x 512. Checked here so that a scene fails as it loads.
bool TextureSizeAccepted(const _DorBitmap& bitmap)
{
    unsigned int pixels = static_cast<unsigned int>(bitmap.info.width) * static_cast<unsigned int>(bitmap.info.height);
    return pixels >= 2 && pixels <= 512u * 512u && (pixels & (pixels - 1)) == 0;
}

// Point 0 stays, the others reverse: the converters' own reordering, which keeps the pairing
// of bottom and top points.
void Reverse(std::vector<DorVector3>& loop)
{
    if (loop.size() > 2)
        std::reverse(loop.begin() + 1, loop.end());
}

DorVector3 Centroid(const std::vector<DorVector3>& loop)
{
    DorVector3 sum;
    for (const DorVector3& p : loop)
        sum = sum + p;
    return sum * (1.0 / static_cast<double>(loop.size()));
}

// Walls face outward only when the profiles run counter-clockwise about the extrusion; the
// converters do not ensure it for an extrusion straight along y.
void RunCounterClockwiseAbout(const DorVector3& direction, std::vector<DorVector3>& bottom,
                              std::vector<DorVector3>& top)
{
    if (DorDot(NewellNormal(bottom), direction) < 0.0) {
        Reverse(bottom);
        Reverse(top);
    }
}

// A hole's walls face into the opening only when it runs the outline's way round.
void RunLikeOutline(std::vector<DorVector3>& hole, const std::vector<DorVector3>& outline)
{
    if (DorDot(NewellNormal(hole), NewellNormal(outline)) < 0.0) {
        std::vector<DorVector3> reversed(hole.rbegin(), hole.rend());
        hole.swap(reversed);
    }
}

// The caps' texture axis is a point: the top cap's moves with its profile. Zero stays "not given".
DorVector3 MovedWithProfile(const DorVector3& point, const CDorArray<DorVector3, DorVector3&>& from,
                            const CDorArray<DorVector3, DorVector3&>& to)
{
    if (point.x == 0.0 && point.y == 0.0 && point.z == 0.0)
        return point;
    return point + (to[0] - from[0]);
}

std::string DirectoryOf(const std::string& path)
{
    size_t slash = path.find_last_of("/\\");
    return slash == std::string::npos ? std::string() : path.substr(0, slash + 1);
}

bool IsAbsolute(const std::string& path)
{
    return (!path.empty() && (path[0] == '/' || path[0] == '\\')) || (path.size() > 1 && path[1] == ':');
}

class SceneReader {
public:
    SceneReader(const std::string& baseDir, Scene& scene) : baseDir_(baseDir), scene_(scene) {}

    void ReadScene(const Json& root)
    {
        ExpectObject(root, "top level", "a scene object");
        CheckKeys(root, "", {"background", "camera", "lights", "entities"});
        if (const Json* background = Find(root, "background"))
            scene_.background = ReadColour(*background, "background");
        ReadCamera(Require(root, "camera", "top level", "the camera object"), "camera");
        if (const Json* lights = Find(root, "lights")) {
            const Json& list = ReadArray(*lights, "lights", 0, 8, "an array of at most 8 lights");
            for (size_t i = 0; i < list.size(); ++i)
                ReadLight(list[i], Item("lights", i));
        }
        const Json& entities = ReadArray(Require(root, "entities", "top level", "an array of entities"), "entities", 0,
                                         1000000, "an array of entities");
        for (size_t i = 0; i < entities.size(); ++i)
            ReadEntity(entities[i], Item("entities", i));
    }

private:
    std::string baseDir_;
    Scene& scene_;
    std::map<std::string, std::string> entityPlaces_;  // name -> where it was first given
    std::map<std::string, int> textureIndex_;          // resolved path -> index

    void ReadCamera(const Json& value, const std::string& place)
    {
        ExpectObject(value, place, "a camera object");
        CheckKeys(value, place, {"eye", "target", "fovy", "near", "far"});
        _VelCamera& camera = scene_.camera;
        camera.eye = ReadPoint(Require(value, "eye", place, "a point [x, y, z]"), Member(place, "eye"));
        camera.target = ReadPoint(Require(value, "target", place, "a point [x, y, z]"), Member(place, "target"));
        if (Length(camera.target - camera.eye) < 0.0001)
            Fail(Member(place, "target"), "a point at least 0.0001 away from the eye");
        camera.fovy = 45.0;
        camera.zNear = 0.1;
        camera.zFar = 1000.0;
        camera.aspect = 1.0;
        if (const Json* fovy = Find(value, "fovy")) {
            camera.fovy = ReadNumber(*fovy, Member(place, "fovy"), "an angle in degrees between 0 and 180");
            if (camera.fovy <= 0.0 || camera.fovy >= 180.0)
                FailFound(Member(place, "fovy"), "an angle in degrees between 0 and 180", *fovy);
        }
        if (const Json* n = Find(value, "near"))
            camera.zNear = ReadPositive(*n, Member(place, "near"));
        if (const Json* f = Find(value, "far"))
            camera.zFar = ReadPositive(*f, Member(place, "far"));
        if (camera.zFar <= camera.zNear)
            Fail(Member(place, "far"), "a far distance beyond the near one (" + Json(camera.zNear).dump() + ")");
    }

    void ReadLight(const Json& value, const std::string& place)
    {
        ExpectObject(value, place, "a light object");
        CheckKeys(value, place,
                  {"index", "type", "direction", "position", "diffuse", "ambient", "specular", "attenuation", "enabled"});
        SceneLight entry;
        entry.index = ReadInteger(Require(value, "index", place, "a whole number from 0 to 7"), Member(place, "index"), 0, 7);
        for (const SceneLight& other : scene_.lights)
            if (other.index == entry.index)
                Fail(Member(place, "index"), "a light index not given before");
        DorLight& light = entry.light;
        bool directional =
            ReadChoice(Require(value, "type", place, "\"directional\" or \"positional\""), Member(place, "type"),
                       {"directional", "positional"}) == 0;
        light.type = directional ? 1 : 0;
        if (directional)
            light.direction = ReadDirection(Require(value, "direction", place, "the direction the light shines"),
                                            Member(place, "direction"));
        else
            light.position = ReadPoint(Require(value, "position", place, "a point [x, y, z]"), Member(place, "position"));
        light.diffuse = DorColorValue(1.0f, 1.0f, 1.0f, 1.0f);
        light.ambient = DorColorValue(0.1f, 0.1f, 0.1f, 1.0f);
        light.specular = DorColorValue(1.0f, 1.0f, 1.0f, 1.0f);
        light.attenuation = 0.00001f;
        light.enabled = 1;
        ReadOptionalColour(value, "diffuse", place, light.diffuse);
        ReadOptionalColour(value, "ambient", place, light.ambient);
        ReadOptionalColour(value, "specular", place, light.specular);
        if (const Json* a = Find(value, "attenuation"))
            light.attenuation = static_cast<float>(
                ReadBounded(*a, Member(place, "attenuation"), 0.0, 1e30, "a number of 0 or more"));
        if (const Json* e = Find(value, "enabled"))
            light.enabled = ReadBool(*e, Member(place, "enabled")) ? 1 : 0;
        scene_.lights.push_back(entry);
    }

    void ReadEntity(const Json& value, const std::string& indexPlace)
    {
        ExpectObject(value, indexPlace, "an entity object");
        auto entity = std::make_unique<SceneEntity>();
        entity->name = ReadName(Require(value, "name", indexPlace, "the entity's name"), Member(indexPlace, "name"));
        std::string place = indexPlace + " (\"" + entity->name + "\")";
        auto seen = entityPlaces_.find(entity->name);
        if (seen != entityPlaces_.end())
            Fail(Member(place, "name"), "a name not used before (" + seen->second + " has it)");
        entityPlaces_[entity->name] = indexPlace;

        int type = ReadChoice(Require(value, "type", place, "\"extrusion\", \"line\" or \"grid\""), Member(place, "type"),
                              {"extrusion", "line", "grid"});
        if (type == 0)
            ReadExtrusion(value, place, *entity);
        else if (type == 1)
            ReadLine(value, place, *entity);
        else
            ReadGrid(value, place, *entity);
        scene_.entities.push_back(std::move(entity));
    }

    void ReadExtrusion(const Json& value, const std::string& place, SceneEntity& entity)
    {
        CheckKeys(value, place, {"name", "type", "profile", "holes", "extrude", "top", "caps", "style", "material", "texture"});
        std::vector<DorVector3> profile =
            ReadProfile(Require(value, "profile", place, "an array of at least 3 points [x, y, z]"), Member(place, "profile"));
        std::vector<std::vector<DorVector3>> holes;
        if (const Json* list = Find(value, "holes")) {
            const Json& array = ReadArray(*list, Member(place, "holes"), 0, 100000, "an array of profiles");
            for (size_t h = 0; h < array.size(); ++h) {
                holes.push_back(ReadProfile(array[h], Item(Member(place, "holes"), h)));
            }
        }
        const Json* extrude = Find(value, "extrude");
        const Json* top = Find(value, "top");
        if (extrude && top)
            Fail(Member(place, "top"), "either \"extrude\" or \"top\", not both");
        if (!extrude && !top)
            Fail(place, "\"extrude\" (the vector from the profile to the top face) or \"top\" (the top profile)");
        if (top && !holes.empty())
            Fail(Member(place, "top"), "\"extrude\": a holed extrusion's top is its profile moved");

        DorVector3 offset;
        std::vector<DorVector3> topPoints;
        if (extrude) {
            offset = ReadDirection(*extrude, Member(place, "extrude"));
            for (const DorVector3& p : profile)
                topPoints.push_back(p + offset);
        } else {
            topPoints = ReadProfile(*top, Member(place, "top"));
            if (topPoints.size() != profile.size())
                Fail(Member(place, "top"), "as many points as the profile (" + std::to_string(profile.size()) +
                                               "), found " + std::to_string(topPoints.size()));
        }
        RunCounterClockwiseAbout(Centroid(topPoints) - Centroid(profile), profile, topPoints);
        for (std::vector<DorVector3>& hole : holes)
            RunLikeOutline(hole, profile);

        CDorPolygon bottom(profile.data(), static_cast<int>(profile.size()));
        if (holes.empty()) {
            CDorPolygon topProfile(topPoints.data(), static_cast<int>(topPoints.size()));
            Dress(value, place, std::make_unique<CDorExtruded>(bottom, topProfile), &CDorPolygon::textureAxis, entity);
        } else {
            CDorHolePolygon outline(bottom);
            for (const std::vector<DorVector3>& hole : holes)
                outline.AddHole(CDorPolygon(hole.data(), static_cast<int>(hole.size())));
            Dress(value, place, std::make_unique<CDorHoleExtruded>(outline, offset), &CDorHolePolygon::holeTextureAxis,
                  entity);
        }
    }

    // Caps and look of either kind of extrusion; capAxisField is the profiles' texture axis.
    template <class Extrusion, class Profile>
    void Dress(const Json& value, const std::string& place, std::unique_ptr<Extrusion> extruded,
               DorVector3 Profile::*capAxisField, SceneEntity& entity)
    {
        ReadCaps(value, place, extruded->bottomCap, extruded->topCap);
        DorVector3 capAxis;
        ReadAppearance(value, place, *extruded, entity, extruded->textureAxis, capAxis);
        extruded->MatchCapsToWalls();
        extruded->bottom.*capAxisField = capAxis;
        extruded->top.*capAxisField = MovedWithProfile(capAxis, extruded->bottom.points, extruded->top.points);
        entity.geometry = std::move(extruded);
    }

    void ReadCaps(const Json& value, const std::string& place, int& bottomCap, int& topCap)
    {
        const Json* caps = Find(value, "caps");
        if (!caps)
            return;
        std::string capsPlace = Member(place, "caps");
        ExpectObject(*caps, capsPlace, "an object {\"bottom\": true, \"top\": true}");
        CheckKeys(*caps, capsPlace, {"bottom", "top"});
        if (const Json* b = Find(*caps, "bottom"))
            bottomCap = ReadBool(*b, Member(capsPlace, "bottom")) ? 1 : 0;
        if (const Json* t = Find(*caps, "top"))
            topCap = ReadBool(*t, Member(capsPlace, "top")) ? 1 : 0;
    }

    // Style, material and texture of the walls; the caller hands them on to the caps. The texture
    // axes stay zero when not given.
    void ReadAppearance(const Json& value, const std::string& place, CDorGeometry& geometry, SceneEntity& entity,
                        DorVector3& wallAxis, DorVector3& capAxis)
    {
        if (const Json* style = Find(value, "style"))
            geometry.style = ReadChoice(*style, Member(place, "style"), {"solid", "wire"}) == 0 ? DorStyleSolid : DorStyleWire;
        if (const Json* material = Find(value, "material"))
            geometry.material = ReadMaterial(*material, Member(place, "material"), geometry.material, Surface::Faces);
        const Json* texture = Find(value, "texture");
        if (!texture)
            return;
        std::string texturePlace = Member(place, "texture");
        ExpectObject(*texture, texturePlace, "a texture object");
        CheckKeys(*texture, texturePlace, {"file", "scale", "axis", "capAxis"});
        std::string file = Member(texturePlace, "file");
        entity.texture = ReadTexture(ReadName(Require(*texture, "file", texturePlace, "a BMP file name"), file), file);
        if (const Json* scale = Find(*texture, "scale")) {
            std::string scalePlace = Member(texturePlace, "scale");
            const Json& uv = ReadArray(*scale, scalePlace, 2, 2, "[u, v]: model units per texture repeat");
            geometry.textureScaleU = ReadPositive(uv[0], Item(scalePlace, 0));
            geometry.textureScaleV = ReadPositive(uv[1], Item(scalePlace, 1));
        }
        if (const Json* a = Find(*texture, "axis"))
            wallAxis = ReadDirection(*a, Member(texturePlace, "axis"));
        if (const Json* a = Find(*texture, "capAxis"))
            capAxis = ReadPoint(*a, Member(texturePlace, "capAxis"));
    }

    // Each distinct file is read once; every entity that names it shares it.
    int ReadTexture(const std::string& name, const std::string& place)
    {
        std::string path = IsAbsolute(name) ? name : baseDir_ + name;
        auto known = textureIndex_.find(path);
        if (known != textureIndex_.end())
            return known->second;
        std::vector<unsigned char> bytes;
        if (!ReadFileBytes(path, bytes))
            Fail(place, "a readable BMP file, but \"" + path + "\" cannot be read");
        auto texture = std::make_unique<SceneTexture>();
        texture->path = path;
        std::string expected;
        if (!DecodeBmp(bytes, texture->bitmap, expected))
            Fail(place, expected + " (\"" + path + "\")");
        if (!TextureSizeAccepted(texture->bitmap))
            Fail(place, "a texture whose width x height is a power of two up to 512 x 512 (\"" + path + "\" is " +
                            std::to_string(texture->bitmap.info.width) + " x " + std::to_string(texture->bitmap.info.height) + ")");
        int index = static_cast<int>(scene_.textures.size());
        scene_.textures.push_back(std::move(texture));
        textureIndex_[path] = index;
        return index;
    }

    // Line and grid groups take the given material whole; without one they keep the generator's.
    void ReadLineLook(const Json& value, const std::string& place, CVelTrianglePolys& group)
    {
        if (const Json* material = Find(value, "material"))
            group.material = ReadMaterial(*material, Member(place, "material"), group.material, Surface::Lines);
        if (const Json* width = Find(value, "width"))
            group.lineWidth = static_cast<float>(
                ReadBounded(*width, Member(place, "width"), 1.0, 10.0, "a line width in pixels from 1 to 10"));
    }

    void ReadLine(const Json& value, const std::string& place, SceneEntity& entity)
    {
        CheckKeys(value, place, {"name", "type", "from", "to", "material", "width"});
        DorVector3 from = ReadPoint(Require(value, "from", place, "a point [x, y, z]"), Member(place, "from"));
        DorVector3 to = ReadPoint(Require(value, "to", place, "a point [x, y, z]"), Member(place, "to"));
        int group = CVelMathPrimitive::MakeLine(from, to, entity.primitive);
        ReadLineLook(value, place, entity.primitive.groups[group]);
    }

    void ReadGrid(const Json& value, const std::string& place, SceneEntity& entity)
    {
        CheckKeys(value, place, {"name", "type", "from", "to", "divisions", "material", "width"});
        DorVector2 from = ReadPoint2(Require(value, "from", place, "a corner [x, y]"), Member(place, "from"));
        DorVector2 to = ReadPoint2(Require(value, "to", place, "a corner [x, y]"), Member(place, "to"));
        int divisions = ReadInteger(Require(value, "divisions", place, "a whole number from 1"), Member(place, "divisions"),
                                    1, 10000);
        int group = CVelMathPrimitive::MakeGrid(from, to, divisions, entity.primitive);
        ReadLineLook(value, place, entity.primitive.groups[group]);
    }
};

// Where the text stops being JSON a double can hold (a syntax error, or a number such as 1e400
// that overflows), and nlohmann's words for it after the line and column they name.
class JsonProblem : public Json::json_sax_t {
public:
    size_t byte = 0;
    std::string problem;

    bool null() override { return true; }
    bool boolean(bool) override { return true; }
    bool number_integer(number_integer_t) override { return true; }
    bool number_unsigned(number_unsigned_t) override { return true; }
    bool number_float(number_float_t, const string_t&) override { return true; }
    bool string(string_t&) override { return true; }
    bool binary(binary_t&) override { return true; }
    bool start_object(size_t) override { return true; }
    bool key(string_t&) override { return true; }
    bool end_object() override { return true; }
    bool start_array(size_t) override { return true; }
    bool end_array() override { return true; }
    bool parse_error(size_t position, const std::string&, const Json::exception& e) override
    {
        byte = position;
        problem = e.what();
        size_t column = problem.find("column");
        size_t start = column == std::string::npos ? problem.find("] ") : problem.find(": ", column);
        if (start != std::string::npos)
            problem = problem.substr(start + 2);
        return false;
    }
};

std::string LineAndColumn(const std::string& text, size_t byte)
{
    size_t line = 1, column = 1;
    for (size_t i = 0; i + 1 < byte && i < text.size(); ++i) {
        if (text[i] == '\n') {
            ++line;
            column = 1;
        } else {
            ++column;
        }
    }
    return "line " + std::to_string(line) + ", column " + std::to_string(column);
}
}  // namespace

bool ParseScene(const std::string& text, const std::string& fileName, const std::string& baseDir, Scene& scene,
                std::string& error)
{
    Json root = Json::parse(text, nullptr, false);
    if (root.is_discarded()) {
        JsonProblem located;
        Json::sax_parse(text, &located);
        error = fileName + ": " + LineAndColumn(text, located.byte) + ": expected valid JSON (" + located.problem + ")";
        return false;
    }
    try {
        SceneReader(baseDir, scene).ReadScene(root);
    } catch (const SceneError& e) {
        error = fileName + ": " + (e.place.empty() ? "top level" : e.place) + ": expected " + e.expected;
        return false;
    }
    return true;
}

bool LoadSceneFile(const std::string& path, Scene& scene, std::string& error)
{
    std::vector<unsigned char> bytes;
    if (!ReadFileBytes(path, bytes)) {
        error = path + ": expected a readable scene file";
        return false;
    }
    return ParseScene(std::string(bytes.begin(), bytes.end()), path, DirectoryOf(path), scene, error);
}
