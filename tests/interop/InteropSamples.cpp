// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writes the files that the peers open, and next to them what a peer must find in each: computed here from the values
// that are written, without the library.
//   interop_samples FOLDER compatible|faithful
// Faithful files have meshes with a transform of their own, too, which others omit.
#include <Fbx.h>
#include <TnFbxCamera.h>
#include <TnFbxError.h>
#include <TnFbxLight.h>
#include <TnFbxMesh.h>
#include <TnFbxNull.h>
#include <TnFbxWriteInfo.h>

#include <nlohmann/json.hpp>

#include <array>
#include <cmath>
#include <cstdio>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

using namespace Tarnell::Fbx;
using nlohmann::json;

namespace {

constexpr int kFirst = 1001, kLast = 1010;
constexpr float kRate = 24.0F;
constexpr double kMillimetresPerInch = 25.4;

using Vector = std::array<double, 3>;
using Triple = std::array<float, 3>;
/// A value for each frame, the first frame being 0.
using Path = std::function<Triple(float step)>;

TnFbxTime range() {
    TnFbxTime time;
    time.setTime(static_cast<float>(kFirst), kFirst, kLast, kRate);
    return time;
}

using Channel = TnFbxTransform::EFbxTransformChannelType;

void animate(TnFbxTransform& object, Channel first, const Path& path) {
    for (int axis = 0; axis < 3; ++axis) {
        std::vector<float> values;
        for (int frame = kFirst; frame <= kLast; ++frame)
            values.push_back(path(static_cast<float>(frame - kFirst))[static_cast<std::size_t>(axis)]);
        const auto channel = static_cast<Channel>(first + axis);
        object.setTransformValue(channel, values.front());
        object.setTransformValueAt(channel, range(), values);
    }
}

/// Rotates about one axis, in degrees; y is the axis of the second index, and so on.
Vector turned(const Vector& v, int axis, double degrees) {
    const double angle = degrees * std::acos(-1.0) / 180, c = std::cos(angle), s = std::sin(angle);
    const auto i = static_cast<std::size_t>((axis + 1) % 3), j = static_cast<std::size_t>((axis + 2) % 3);
    Vector result = v;
    result[i] = c * v[i] - s * v[j];
    result[j] = s * v[i] + c * v[j];
    return result;
}

/// The first axis of the order is applied first.
Vector rotated(Vector v, const Triple& degrees, const std::array<int, 3>& order) {
    for (const int axis : order)
        v = turned(v, axis, static_cast<double>(degrees[static_cast<std::size_t>(axis)]));
    return v;
}

constexpr std::array<int, 3> kOrderXyz = {0, 1, 2}, kOrderZxy = {2, 0, 1}, kOrderYzx = {1, 2, 0};

/// The expected values of one object: its position at each frame, and its direction.
json placed(const std::string& name, const std::string& kind, const Path& position, const Path& rotation,
            const std::array<int, 3>& order) {
    json object = {{"name", name}, {"kind", kind}};
    for (int frame = kFirst; frame <= kLast; ++frame) {
        const Triple p = position(static_cast<float>(frame - kFirst));
        const std::string key = std::to_string(frame);
        object["positions"][key] = Vector{p[0], p[1], p[2]};
        object["directions"][key] = rotated({0, 0, -1}, rotation(static_cast<float>(frame - kFirst)), order);
    }
    return object;
}

/// The content of one file.
struct Sample {
    TnFbxCamera camera;
    std::vector<TnFbxLight> lights = std::vector<TnFbxLight>(3);
    TnFbxNull null;
    TnFbxTransform transform;
    std::vector<TnFbxMesh> meshes = std::vector<TnFbxMesh>(2);
    json expected;
};

void addCamera(Sample& sample) {
    TnFbxCamera& camera = sample.camera;
    camera.setName("shotCam");
    const Path position = [](float k) { return Triple{1.5F * k, 2.25F, 12.0F - 0.5F * k}; };
    const Path rotation = [](float k) { return Triple{-10.0F + k, 30.0F + 4.0F * k, 2.0F * k}; };
    animate(camera, Channel::kFbxTransformPositionX, position);
    animate(camera, Channel::kFbxTransformRotationX, rotation);
    camera.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderZXY);
    std::vector<float> lens;
    json focal;
    for (int k = 0; k <= kLast - kFirst; ++k) {
        lens.push_back(35.0F + 1.5F * static_cast<float>(k));
        focal[std::to_string(kFirst + k)] = lens.back();
    }
    constexpr float kWidth = 1.5F, kHeight = 0.75F, kOffset = 0.125F;
    camera.setApertureMode(TnFbxCamera::kFbxApertureFocalLength);
    camera.setValue(TnFbxCamera::kFbxCameraFocalLength, lens.front());
    camera.setValueAt(TnFbxCamera::kFbxCameraFocalLength, range(), lens);
    camera.setValue(TnFbxCamera::kFbxCameraApertureWidth, kWidth);
    camera.setValue(TnFbxCamera::kFbxCameraApertureHeight, kHeight);
    camera.setValue(TnFbxCamera::kFbxCameraFilmOffsetX, kOffset);
    json object = placed("shotCam", "camera", position, rotation, kOrderZxy);
    object["focalLengths"] = focal;
    object["filmWidth"] = static_cast<double>(kWidth) * kMillimetresPerInch;
    object["filmHeight"] = static_cast<double>(kHeight) * kMillimetresPerInch;
    object["filmOffset"] = static_cast<double>(kOffset) * kMillimetresPerInch;
    sample.expected["objects"].push_back(object);
}

void addLight(Sample& sample, TnFbxLight& light, const char* name, TnFbxLight::EFbxLightType type, const char* typeName,
              const Triple& colour, float intensity) {
    light.setName(name);
    light.setLightType(type);
    // Along all axes: three.js misplaces spot and directional lights along those without keys.
    const Path position = [type](float k) {
        return Triple{-4.0F - 0.125F * k, 6.0F + 0.25F * k, 3.0F * static_cast<float>(type) + 0.5F * k};
    };
    const Path rotation = [](float k) { return Triple{-45.0F, 15.0F - 2.0F * k, 10.0F}; };
    animate(light, Channel::kFbxTransformPositionX, position);
    animate(light, Channel::kFbxTransformRotationX, rotation);
    light.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    light.setValue(TnFbxLight::kFbxLightRed, colour[0]);
    light.setValue(TnFbxLight::kFbxLightGreen, colour[1]);
    light.setValue(TnFbxLight::kFbxLightBlue, colour[2]);
    light.setValue(TnFbxLight::kFbxLightIntensity, intensity);
    light.setValue(TnFbxLight::kFbxLightConeAngle, 50.0F);
    json object = placed(name, "light", position, rotation, kOrderXyz);
    if (type == TnFbxLight::kFbxLightPoint)
        object.erase("directions");
    object["type"] = typeName;
    object["colour"] = colour;
    object["intensity"] = intensity;
    if (type == TnFbxLight::kFbxLightSpot)
        object["coneAngle"] = 50.0;
    sample.expected["objects"].push_back(object);
}

void addNulls(Sample& sample) {
    const Path position = [](float k) { return Triple{-1.0F * k, 0.5F, 0.125F * k}; };
    const Path rotation = [](float k) { return Triple{5.0F * k, -20.0F, 40.0F + k}; };
    sample.null.setName("locator");
    sample.transform.setName("tracker 01");
    sample.null.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderYZX);
    sample.transform.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderZXY); // as new objects have it
    for (TnFbxTransform* object : {static_cast<TnFbxTransform*>(&sample.null), &sample.transform}) {
        animate(*object, Channel::kFbxTransformPositionX, position);
        animate(*object, Channel::kFbxTransformRotationX, rotation);
        const auto& order = object == &sample.null ? kOrderYzx : kOrderZxy;
        sample.expected["objects"].push_back(placed(object->getName(), "null", position, rotation, order));
    }
}

/// A box of six quads, with normals, texture coordinates and colours.
void addBox(Sample& sample, TnFbxMesh& mesh, const char* name, int sets) {
    constexpr int kFaces[6][4] = {{0, 2, 3, 1}, {4, 5, 7, 6}, {0, 1, 5, 4}, {2, 6, 7, 3}, {0, 4, 6, 2}, {1, 3, 7, 5}};
    constexpr float kNormals[6][3] = {{0, 0, -1}, {0, 0, 1}, {0, -1, 0}, {0, 1, 0}, {-1, 0, 0}, {1, 0, 0}};
    constexpr float kCorners[4][2] = {{0, 0}, {1, 0}, {1, 1}, {0, 1}};
    mesh.setName(name);
    mesh.allocateGeometryData(6, 8, 24); // with the first set of points
    const auto corner = [](int i, int step) {
        const float wave = 0.25F * static_cast<float>(step);
        return Triple{i & 1 ? 1.0F : -1.0F, (i & 2 ? 2.0F : -0.5F) + wave, i & 4 ? 3.0F : -3.0F};
    };
    json animated, points;
    for (int set = 0; set < sets; ++set) {
        if (set > 0)
            mesh.addControlPointSet();
        for (int i = 0; i < 8; ++i) {
            const Triple p = corner(i, set);
            if (set == 0)
                mesh.setControlPoint(i, p[0], p[1], p[2]);
            else
                mesh.addControlPoint(p[0], p[1], p[2]);
            animated[std::to_string(kFirst + set)].push_back(p);
            if (set == 0)
                points.push_back(p);
        }
    }
    for (int face = 0; face < 6; ++face) {
        mesh.setPolygonVertexSize(face, 4);
        for (int k = 0; k < 4; ++k) {
            const int vertex = 4 * face + k;
            mesh.setPointIndex(vertex, kFaces[face][k]);
            mesh.setNormal(vertex, kNormals[face][0], kNormals[face][1], kNormals[face][2]);
            mesh.setUV(vertex, kCorners[k][0], kCorners[k][1]);
            mesh.setColour(vertex, kCorners[k][0], kCorners[k][1], 0.5F, 1.0F);
        }
    }
    mesh.setValidNormals(true);
    mesh.setValidUVs(true);
    mesh.setValidColours(true);
    json uvs;
    for (int vertex = 0; vertex < 24; ++vertex)
        uvs.push_back({kCorners[vertex % 4][0], kCorners[vertex % 4][1]});
    json object = {{"name", name},  {"kind", "mesh"},        {"points", points},
                   {"polygons", 6}, {"polygonVertices", 24}, {"uvs", uvs}};
    if (sets > 1)
        object["cached"] = animated;
    sample.expected["objects"].push_back(object);
}

/// Makes a mesh move, rotate and be scaled, and computes where its points are then.
void place(Sample& sample, TnFbxMesh& mesh, const Path& position, const Path& rotation, const Triple& scale) {
    animate(mesh, Channel::kFbxTransformPositionX, position);
    animate(mesh, Channel::kFbxTransformRotationX, rotation);
    mesh.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderYZX);
    for (int axis = 0; axis < 3; ++axis)
        mesh.setTransformValue(static_cast<Channel>(Channel::kFbxTransformScaleX + axis),
                               scale[static_cast<std::size_t>(axis)]);
    json& object = sample.expected["objects"].back();
    const json points = object["points"];
    for (int frame = kFirst; frame <= kLast; ++frame) {
        const auto step = static_cast<float>(frame - kFirst);
        const Triple shift = position(step);
        json placed = json::array();
        for (const json& point : points) {
            Vector at{};
            for (std::size_t axis = 0; axis < 3; ++axis)
                at[axis] = point[axis].get<double>() * static_cast<double>(scale[axis]);
            at = rotated(at, rotation(step), kOrderYzx);
            for (std::size_t axis = 0; axis < 3; ++axis)
                at[axis] += static_cast<double>(shift[axis]);
            placed.push_back(at);
        }
        object["placed"][std::to_string(frame)] = placed;
    }
    object["points"] = object["placed"][std::to_string(kFirst)];
}

void addPlacedBoxes(Sample& sample) {
    const Path position = [](float k) { return Triple{4.0F + 0.75F * k, -2.0F, 1.0F - k}; };
    const Path rotation = [](float k) { return Triple{20.0F, 35.0F - 6.0F * k, 10.0F + 3.0F * k}; };
    sample.meshes.resize(4);
    addBox(sample, sample.meshes[2], "placed", 1);
    place(sample, sample.meshes[2], position, rotation, {2.0F, 0.5F, 1.25F});
    addBox(sample, sample.meshes[3], "mirrored", 1);
    place(sample, sample.meshes[3], position, rotation, {-1.0F, 1.0F, 1.5F});
}

Sample makeSample(bool faithful) {
    Sample sample;
    addCamera(sample);
    addLight(sample, sample.lights[0], "bulb", TnFbxLight::kFbxLightPoint, "point", {1.0F, 0.5F, 0.25F}, 1.0F);
    addLight(sample, sample.lights[1], "sun", TnFbxLight::kFbxLightDirectional, "directional", {0.25F, 0.75F, 1.0F},
             0.5F);
    addLight(sample, sample.lights[2], "key", TnFbxLight::kFbxLightSpot, "spot", {0.5F, 1.0F, 0.125F}, 2.0F);
    addNulls(sample);
    addBox(sample, sample.meshes[0], "box", 1);
    addBox(sample, sample.meshes[1], "waving", kLast - kFirst + 1);
    if (faithful)
        addPlacedBoxes(sample);
    return sample;
}

template <class Object>
std::vector<Object*> pointers(std::vector<Object>& objects) {
    std::vector<Object*> result;
    for (Object& object : objects)
        result.push_back(&object);
    return result;
}

const char* stackName(bool faithful) { return faithful ? "shot 010" : "Take 001"; }

struct Layout {
    const char* year;
    TnFbxWriteInfo::eCompatibilityVersion version;
    int fileVersion;
};
constexpr Layout kLayouts[] = {
    {"2010", TnFbxWriteInfo::kFbxVersion2010, 6100}, {"2011", TnFbxWriteInfo::kFbxVersion2011, 7100},
    {"2012", TnFbxWriteInfo::kFbxVersion2012, 7200}, {"2013", TnFbxWriteInfo::kFbxVersion2013, 7300},
    {"2014", TnFbxWriteInfo::kFbxVersion2014, 7400}, {"2016", TnFbxWriteInfo::kFbxVersion2016, 7500}};

bool write(const std::string& folder, const Layout& layout, bool ascii, bool faithful, Sample& sample, json& files) {
    const std::string name = std::string("sample_") + layout.year + (ascii ? "_ascii" : "_binary");
    TnFbxWriteInfo info;
    info.setFileName(folder + "/" + name + ".fbx");
    info.setAnimationStackName(stackName(faithful));
    if (faithful) {
        info.setFidelity(kFbxFidelityFaithful);
        info.setComputeCameraRotation(false); // the rotations determine the cameras' directions
    }
    info.setFileFormat(ascii);
    info.setFPS(kRate);
    info.setStartFrame(kFirst);
    info.setEndFrame(kLast);
    // Point caches that another program can check are written next to the binary files.
    info.setMayaVertexCacheFormat(ascii);
    info.setCompatibilityVersion(layout.version);
    const Fbx fbx;
    if (!fbx.writeFile(info, {&sample.camera}, pointers(sample.lights), {&sample.transform}, {&sample.null},
                       pointers(sample.meshes))) {
        std::fprintf(stderr, "%s: %s\n", info.getFileName().c_str(), lastError().c_str());
        return false;
    }
    files.push_back({{"file", name + ".fbx"}, {"version", layout.fileVersion}, {"ascii", ascii}});
    return true;
}

} // namespace

int main(int argumentCount, char** arguments) {
    const std::string fidelity = argumentCount == 3 ? arguments[2] : "";
    if (fidelity != "compatible" && fidelity != "faithful") {
        std::fprintf(stderr, "usage: interop_samples FOLDER compatible|faithful\n");
        return 2;
    }
    const std::string folder = arguments[1];
    const bool faithful = fidelity == "faithful";
    Sample sample = makeSample(faithful);
    json files = json::array();
    for (const Layout& layout : kLayouts)
        for (const bool ascii : {false, true})
            if (!write(folder, layout, ascii, faithful, sample, files))
                return 1;
    sample.expected["files"] = files;
    sample.expected["frames"] = {kFirst, kLast};
    sample.expected["rate"] = kRate;
    sample.expected["stacks"] = {stackName(faithful)};
    std::ofstream(folder + "/expected.json") << sample.expected.dump(1) << '\n';
    return 0;
}
