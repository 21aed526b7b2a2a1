// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writes the inputs of the benchmarks into a folder. Everything is generated from one seed: the same program writes the
// files everywhere.
//
//     generate_inputs FOLDER [SCALE]     SCALE 0.01 makes small ones, to try the programs
#include "FbxEmitter.h"

#include <array>
#include <bit>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <memory>
#include <random>
#include <vector>

namespace bench {
namespace {

constexpr std::uint64_t kSeed = 20240506;
constexpr std::int64_t kTicksPerSecond = 46186158000;
constexpr int kFramesPerSecond = 24;
constexpr int kTimeMode24 = 11;

constexpr int kBigMeshPolygonVertices = 2'000'000;
constexpr int kManyMeshes = 200;
constexpr int kManyMeshesPolygonVertices = 10'000;
constexpr int kCameras = 10;
constexpr int kAnimatedNodes = 500;
constexpr int kFrames = 2'000;
constexpr int kFramesPerKey = 5;
constexpr int kChainLength = 10;
constexpr int kRigNodes = 156;
constexpr int kRigControls = 5; // of a node: scalar properties with a curve each
constexpr int kRigKeys = 33;

/// The same numbers with every standard library, which its distributions do not guarantee.
class Random {
public:
    /// In [−1, 1).
    double next() {
        constexpr double kTwoTo63 = 9223372036854775808.0;
        return static_cast<double>(mEngine()) / kTwoTo63 - 1.0;
    }

private:
    std::mt19937_64 mEngine{kSeed};
};

/// Collects connections while objects are written, and assigns ids.
struct Scene {
    FbxEmitter& out;
    Random random{};
    std::int64_t lastId = 1000;
    struct Connection {
        std::int64_t source, destination;
        std::string property;
    };
    std::vector<Connection> connections{};

    std::int64_t newId() { return ++lastId; }
    void connect(std::int64_t source, std::int64_t destination, std::string property = "") {
        connections.push_back({source, destination, std::move(property)});
    }
};

// ---- Records ----

void integerProperty(FbxEmitter& out, std::string_view name, std::string_view type, std::string_view subtype,
                     int value) {
    out.begin("P").text(name).text(type).text(subtype).text("").integer(value).end();
}

void vectorProperty(FbxEmitter& out, std::string_view name, std::string_view flags, double x, double y, double z) {
    out.begin("P").text(name).text(name).text("").text(flags).real(x).real(y).real(z).end();
}

void writeHead(FbxEmitter& out) {
    out.begin("FBXHeaderExtension").block();
    out.begin("FBXHeaderVersion").integer(1003).end();
    out.begin("FBXVersion").integer(7400).end();
    out.begin("Creator").text("generate_inputs").end();
    out.end();

    out.begin("GlobalSettings").block();
    out.begin("Version").integer(1000).end();
    out.begin("Properties70").block();
    integerProperty(out, "UpAxis", "int", "Integer", 1);
    integerProperty(out, "UpAxisSign", "int", "Integer", 1);
    integerProperty(out, "FrontAxis", "int", "Integer", 2);
    integerProperty(out, "FrontAxisSign", "int", "Integer", 1);
    integerProperty(out, "CoordAxis", "int", "Integer", 0);
    integerProperty(out, "CoordAxisSign", "int", "Integer", 1);
    out.begin("P").text("UnitScaleFactor").text("double").text("Number").text("").real(1).end();
    integerProperty(out, "TimeMode", "enum", "", kTimeMode24);
    out.end();
    out.end();
}

void writeConnections(Scene& scene) {
    FbxEmitter& out = scene.out;
    out.begin("Connections").block();
    for (const Scene::Connection& connection : scene.connections) {
        const bool toProperty = !connection.property.empty();
        out.begin("C").text(toProperty ? "OP" : "OO").id(connection.source).id(connection.destination);
        if (toProperty)
            out.text(connection.property);
        out.end();
    }
    out.end();
}

std::int64_t writeModel(Scene& scene, const std::string& name, std::string_view kind, std::int64_t parent,
                        const std::array<double, 3>& translation) {
    const std::int64_t id = scene.newId();
    FbxEmitter& out = scene.out;
    out.begin("Model").id(id).name(name, "Model").text(kind).block();
    out.begin("Version").integer(232).end();
    out.begin("Properties70").block();
    integerProperty(out, "InheritType", "enum", "", 1);
    vectorProperty(out, "Lcl Translation", "A", translation[0], translation[1], translation[2]);
    out.end();
    out.end();
    scene.connect(id, parent);
    return id;
}

// ---- Meshes: a square grid of quads with heights, a normal per polygon vertex and texture coordinates ----

struct Grid {
    std::vector<double> points, normals, uvs;
    std::vector<std::int32_t> polygonVertices, uvIndices;
};

Grid makeGrid(int polygonVertices, Random& random) {
    const int side = static_cast<int>(std::ceil(std::sqrt(polygonVertices / 4.0)));
    Grid grid;
    for (int row = 0; row <= side; ++row) {
        for (int column = 0; column <= side; ++column) {
            grid.points.insert(grid.points.end(),
                               {column + 0.25 * random.next(), random.next(), row + 0.25 * random.next()});
            grid.uvs.insert(grid.uvs.end(), {column / static_cast<double>(side), row / static_cast<double>(side)});
        }
    }
    const auto corner = [&](int row, int column) { return row * (side + 1) + column; };
    for (int row = 0; row < side; ++row) {
        for (int column = 0; column < side; ++column) {
            const std::array<std::int32_t, 4> quad = {corner(row, column), corner(row + 1, column),
                                                      corner(row + 1, column + 1), corner(row, column + 1)};
            grid.uvIndices.insert(grid.uvIndices.end(), quad.begin(), quad.end());
            grid.polygonVertices.insert(grid.polygonVertices.end(), quad.begin(), quad.end());
            grid.polygonVertices.back() = ~grid.polygonVertices.back(); // marks the polygon's end
            for (std::size_t i = 0; i < quad.size(); ++i) {
                const double x = 0.3 * random.next(), z = 0.3 * random.next();
                grid.normals.insert(grid.normals.end(), {x, std::sqrt(1 - x * x - z * z), z});
            }
        }
    }
    return grid;
}

void writeLayerElement(FbxEmitter& out, std::string_view record, std::string_view mapping, std::string_view reference) {
    out.begin(record).integer(0).block();
    out.begin("Version").integer(101).end();
    out.begin("Name").text("").end();
    out.begin("MappingInformationType").text(mapping).end();
    out.begin("ReferenceInformationType").text(reference).end();
}

void writeLayer(FbxEmitter& out) {
    out.begin("Layer").integer(0).block();
    out.begin("Version").integer(100).end();
    for (const std::string_view type : {"LayerElementNormal", "LayerElementUV"}) {
        out.begin("LayerElement").block();
        out.begin("Type").text(type).end();
        out.begin("TypedIndex").integer(0).end();
        out.end();
    }
    out.end();
}

void writeMesh(Scene& scene, const std::string& name, int polygonVertices) {
    const Grid grid = makeGrid(polygonVertices, scene.random);
    const std::int64_t id = scene.newId();
    FbxEmitter& out = scene.out;
    out.begin("Geometry").id(id).name(name, "Geometry").text("Mesh").block();
    out.begin("Vertices").array(grid.points).end();
    out.begin("PolygonVertexIndex").array(grid.polygonVertices).end();
    out.begin("GeometryVersion").integer(124).end();
    writeLayerElement(out, "LayerElementNormal", "ByPolygonVertex", "Direct");
    out.begin("Normals").array(grid.normals).end();
    out.end();
    writeLayerElement(out, "LayerElementUV", "ByPolygonVertex", "IndexToDirect");
    out.begin("UV").array(grid.uvs).end();
    out.begin("UVIndex").array(grid.uvIndices).end();
    out.end();
    writeLayer(out);
    out.end();
    scene.connect(id, writeModel(scene, name, "Mesh", 0, {0, 0, 0}));
}

void writeCamera(Scene& scene, const std::string& name) {
    const std::int64_t id = scene.newId();
    FbxEmitter& out = scene.out;
    out.begin("NodeAttribute").id(id).name(name, "NodeAttribute").text("Camera").block();
    out.begin("Properties70").block();
    out.begin("P").text("FocalLength").text("Number").text("").text("A").real(35 + 10 * scene.random.next()).end();
    out.end();
    out.begin("TypeFlags").text("Camera").end();
    out.end();
    scene.connect(
        id, writeModel(scene, name, "Camera", 0, {scene.random.next(), scene.random.next(), scene.random.next()}));
}

void writeMeshFile(const std::filesystem::path& path, Encoding encoding, int meshes, int polygonVertices) {
    const std::unique_ptr<FbxEmitter> out = makeEmitter(encoding);
    Scene scene{.out = *out};
    writeHead(*out);
    out->begin("Objects").block();
    for (int i = 0; i < meshes; ++i)
        writeMesh(scene, "mesh" + std::to_string(i), polygonVertices);
    for (int i = 0; i < kCameras; ++i)
        writeCamera(scene, "camera" + std::to_string(i));
    out->end();
    writeConnections(scene);
    out->save(path);
}

// ---- Animation: chains of ten nodes side by side, all rotating and moving ----

void writeStack(Scene& scene, std::int64_t layer, std::int64_t ticks) {
    FbxEmitter& out = scene.out;
    const std::int64_t stack = scene.newId();
    out.begin("AnimationStack").id(stack).name("Take 001", "AnimStack").text("").block();
    out.begin("Properties70").block();
    for (const std::string_view name : {"LocalStop", "ReferenceStop"})
        out.begin("P").text(name).text("KTime").text("Time").text("").id(ticks).end();
    out.end();
    out.end();
    out.begin("AnimationLayer").id(layer).name("BaseLayer", "AnimLayer").text("").block().end();
    scene.connect(layer, stack);
}

/// A slow wave with user tangents, one key every few frames.
void writeCurve(Scene& scene, std::int64_t curveNode, const std::string& channel, double amplitude, int frames,
                int framesPerKey = kFramesPerKey) {
    constexpr std::int32_t kCubicUser = 0x408;
    constexpr std::int32_t kDefaultWeights = 218434821; // two weights of 1/3
    const double turnsPerSecond = 0.5 + 0.25 * scene.random.next();
    const double phase = scene.random.next();
    constexpr double kTwoPi = 6.283185307179586;
    std::vector<std::int64_t> times;
    std::vector<float> values;
    std::vector<std::int32_t> flags, attributes, references;
    for (int frame = 0; frame <= frames; frame += framesPerKey) {
        const double seconds = frame / static_cast<double>(kFramesPerSecond);
        const double nextSeconds = (frame + framesPerKey) / static_cast<double>(kFramesPerSecond);
        const auto slopeAt = [&](double t) {
            return static_cast<float>(amplitude * kTwoPi * turnsPerSecond *
                                      std::cos(kTwoPi * (turnsPerSecond * t + phase)));
        };
        times.push_back(frame * (kTicksPerSecond / kFramesPerSecond));
        values.push_back(static_cast<float>(amplitude * std::sin(kTwoPi * (turnsPerSecond * seconds + phase))));
        flags.push_back(kCubicUser);
        attributes.insert(attributes.end(), {std::bit_cast<std::int32_t>(slopeAt(seconds)),
                                             std::bit_cast<std::int32_t>(slopeAt(nextSeconds)), kDefaultWeights, 0});
        references.push_back(1);
    }
    std::vector<float> attributeFloats;
    for (const std::int32_t bits : attributes)
        attributeFloats.push_back(std::bit_cast<float>(bits));

    const std::int64_t id = scene.newId();
    FbxEmitter& out = scene.out;
    out.begin("AnimationCurve").id(id).name("", "AnimCurve").text("").block();
    out.begin("Default").real(0).end();
    out.begin("KeyVer").integer(4008).end();
    out.begin("KeyTime").array(times).end();
    out.begin("KeyValueFloat").array(values).end();
    out.begin("KeyAttrFlags").array(flags).end();
    out.begin("KeyAttrDataFloat").array(attributeFloats).end();
    out.begin("KeyAttrRefCount").array(references).end();
    out.end();
    scene.connect(id, curveNode, channel);
}

const std::vector<std::string> kVectorChannels = {"d|X", "d|Y", "d|Z"};

std::int64_t writeCurveNode(Scene& scene, std::int64_t layer, std::int64_t model, const std::string& property,
                            const std::string& name, const std::vector<std::string>& channels) {
    const std::int64_t id = scene.newId();
    FbxEmitter& out = scene.out;
    out.begin("AnimationCurveNode").id(id).name(name, "AnimCurveNode").text("").block();
    out.begin("Properties70").block();
    for (const std::string& channel : channels)
        out.begin("P").text(channel).text("Number").text("").text("A").real(0).end();
    out.end();
    out.end();
    scene.connect(id, layer);
    scene.connect(id, model, property);
    return id;
}

void writeAnimatedProperty(Scene& scene, std::int64_t layer, std::int64_t model, const std::string& property,
                           const std::string& name, double amplitude, int frames, int framesPerKey = kFramesPerKey) {
    const std::int64_t id = writeCurveNode(scene, layer, model, property, name, kVectorChannels);
    for (const std::string& channel : kVectorChannels)
        writeCurve(scene, id, channel, amplitude, frames, framesPerKey);
}

void writeAnimationFile(const std::filesystem::path& path, int nodes, int frames) {
    constexpr double kTranslation = 20, kDegrees = 60;
    const std::unique_ptr<FbxEmitter> out = makeEmitter(Encoding::binaryCompressed);
    Scene scene{.out = *out};
    writeHead(*out);
    out->begin("Objects").block();
    const std::int64_t layer = scene.newId();
    writeStack(scene, layer, frames * (kTicksPerSecond / kFramesPerSecond));
    std::int64_t parent = 0;
    for (int i = 0; i < nodes; ++i) {
        if (i % kChainLength == 0)
            parent = 0;
        const std::int64_t model = writeModel(scene, "node" + std::to_string(i), "Null", parent, {0, 0, 0});
        writeAnimatedProperty(scene, layer, model, "Lcl Translation", "T", kTranslation, frames);
        writeAnimatedProperty(scene, layer, model, "Lcl Rotation", "R", kDegrees, frames);
        parent = model;
    }
    out->end();
    writeConnections(scene);
    out->save(path);
}

/// A character's rig: many nodes with all nine channels and some controls of their own, and few keys on each curve.
void writeRigFile(const std::filesystem::path& path, int nodes, int keys) {
    constexpr double kTranslation = 2, kDegrees = 40, kScale = 0.1, kControl = 1;
    const int frames = (keys - 1) * kFramesPerKey;
    const std::unique_ptr<FbxEmitter> out = makeEmitter(Encoding::binaryCompressed);
    Scene scene{.out = *out};
    writeHead(*out);
    out->begin("Objects").block();
    const std::int64_t layer = scene.newId();
    writeStack(scene, layer, frames * (kTicksPerSecond / kFramesPerSecond));
    std::vector<std::int64_t> models;
    for (int i = 0; i < nodes; ++i) {
        const std::int64_t parent = i == 0 ? 0 : models[static_cast<std::size_t>((i - 1) / 2)];
        models.push_back(writeModel(scene, "joint" + std::to_string(i), "Null", parent, {0, 0, 0}));
        const std::int64_t model = models.back();
        writeAnimatedProperty(scene, layer, model, "Lcl Translation", "T", kTranslation, frames);
        writeAnimatedProperty(scene, layer, model, "Lcl Rotation", "R", kDegrees, frames);
        writeAnimatedProperty(scene, layer, model, "Lcl Scaling", "S", kScale, frames);
        for (int control = 0; control < kRigControls; ++control) {
            const std::string name = "control" + std::to_string(control);
            const std::string channel = "d|" + name;
            writeCurve(scene, writeCurveNode(scene, layer, model, name, name, {channel}), channel, kControl, frames);
        }
    }
    out->end();
    writeConnections(scene);
    out->save(path);
}

void writeAll(const std::filesystem::path& folder, double scale) {
    const auto scaled = [&](int value) { return std::max(kChainLength, static_cast<int>(value * scale)); };
    std::filesystem::create_directories(folder);
    writeMeshFile(folder / "big_mesh_raw.fbx", Encoding::binaryRaw, 1, scaled(kBigMeshPolygonVertices));
    writeMeshFile(folder / "big_mesh_compressed.fbx", Encoding::binaryCompressed, 1, scaled(kBigMeshPolygonVertices));
    writeMeshFile(folder / "big_mesh_ascii.fbx", Encoding::ascii, 1, scaled(kBigMeshPolygonVertices));
    writeMeshFile(folder / "many_meshes.fbx", Encoding::binaryCompressed, scaled(kManyMeshes),
                  kManyMeshesPolygonVertices);
    writeAnimationFile(folder / "animation.fbx", scaled(kAnimatedNodes), scaled(kFrames));
    writeRigFile(folder / "rig.fbx", scaled(kRigNodes), kRigKeys);
}

} // namespace
} // namespace bench

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        std::fputs("usage: generate_inputs FOLDER [SCALE]\n", stderr);
        return 2;
    }
    try {
        bench::writeAll(argv[1], argc == 3 ? std::strtod(argv[2], nullptr) : 1.0);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "generate_inputs: %s\n", error.what());
        return 1;
    }
    return 0;
}
