// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes: their data, and their points.
#include "MeshPoints.h"
#include "Rows.h"
#include "Tolerances.h"

namespace conformance {
namespace {

using namespace fbxsdk;

constexpr long long kIndexFactors = 97; // of the sums in references

FbxMesh* meshOf(const SceneNode* entry) { return entry ? entry->node->GetMesh() : nullptr; }

struct LayerContent {
    bool normals = false, uvs = false, colours = false;
};

LayerContent layerContent(FbxMesh& mesh) {
    LayerContent content;
    for (int i = 0; i < mesh.GetLayerCount(); ++i) {
        FbxLayer* layer = mesh.GetLayer(i);
        content.normals |= layer->GetNormals() != nullptr;
        content.uvs |= layer->GetUVs() != nullptr;
        content.colours |= layer->GetVertexColors() != nullptr;
    }
    return content;
}

ReferenceMesh describe(FbxMesh& mesh) {
    ReferenceMesh result;
    result.points = mesh.GetControlPointsCount();
    result.polygons = mesh.GetPolygonCount();
    result.polygonVertices = mesh.GetPolygonVertexCount();
    result.skins = mesh.GetDeformerCount(FbxDeformer::eSkin);
    result.blendShapes = mesh.GetDeformerCount(FbxDeformer::eBlendShape);
    result.caches = mesh.GetDeformerCount(FbxDeformer::eVertexCache);
    const LayerContent layers = layerContent(mesh);
    result.normals = layers.normals;
    result.uvs = layers.uvs;
    result.colours = layers.colours;
    for (int i = 0; i < mesh.GetPolygonCount(); ++i)
        result.sizeSum += mesh.GetPolygonSize(i) * (i % kIndexFactors + 1);
    const int* indices = mesh.GetPolygonVertices();
    for (int i = 0; i < mesh.GetPolygonVertexCount(); ++i)
        result.indexSum += indices[i] * (i % kIndexFactors + 1);
    return result;
}

struct CountRow {
    const char* name;
    long long ReferenceMesh::*member;
};

constexpr CountRow kCounts[] = {
    {"points", &ReferenceMesh::points},
    {"polygons", &ReferenceMesh::polygons},
    {"polygon vertices", &ReferenceMesh::polygonVertices},
    {"sum of sizes", &ReferenceMesh::sizeSum},
    {"sum of indices", &ReferenceMesh::indexSum},
    {"skins", &ReferenceMesh::skins},
    {"blend shapes", &ReferenceMesh::blendShapes},
    {"caches", &ReferenceMesh::caches},
};

struct FlagRow {
    const char* name;
    bool ReferenceMesh::*member;
};

constexpr FlagRow kFlags[] = {
    {"normals", &ReferenceMesh::normals},
    {"texture coordinates", &ReferenceMesh::uvs},
    {"colours", &ReferenceMesh::colours},
};

/// Every `step`-th point against the reference's run of coordinates.
bool samePoints(const std::vector<Point>& actual, const std::vector<double>& expected, std::size_t step,
                std::size_t& firstDifference) {
    double largest = 0;
    for (const double coordinate : expected)
        largest = std::fmax(largest, std::abs(coordinate));
    for (std::size_t i = 0; i < expected.size(); ++i) {
        const std::size_t point = i / 3 * step;
        if (point >= actual.size() || !closeTo(actual[point][i % 3], expected[i], kEvaluatedTolerance, largest)) {
            firstDifference = i / 3;
            return false;
        }
    }
    return true;
}

void comparePoints(LoadedFile& file, std::size_t nodeIndex, Findings& findings) {
    const Reference& reference = file.reference();
    const ReferenceNode& node = reference.nodes[nodeIndex];
    const SceneNode* entry = file.nodeOf(nodeIndex);
    FbxMesh* mesh = meshOf(entry);
    const auto step = static_cast<std::size_t>(node.mesh->sampleStep);
    for (std::size_t f = 0; f < node.mesh->worldPoints.size(); ++f) {
        const std::vector<double>& expected = node.mesh->worldPoints[f];
        std::vector<Point> actual;
        if (mesh)
            actual = worldPoints(file, *entry->node, *mesh, timeOfSeconds(reference.seconds(f)));
        std::size_t sample = 0;
        findings.compare(mesh && samePoints(actual, expected, step, sample), [&] {
            const std::size_t point = sample * step;
            return "\"" + node.name + "\" point " + std::to_string(point) + " at frame " +
                   printed(reference.frames[f]) + ": " +
                   (point < actual.size() ? printed(actual[point].data(), 3) : "nothing") + " instead of " +
                   (expected.empty() ? "nothing" : printed(&expected[3 * sample], 3));
        });
    }
}

} // namespace

void checkMeshTopology(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const ReferenceNode& node = file.reference().nodes[i];
        if (!node.mesh)
            continue;
        FbxMesh* mesh = meshOf(file.nodeOf(i));
        const ReferenceMesh actual = mesh ? describe(*mesh) : ReferenceMesh{};
        const ReferenceMesh& expected = *node.mesh;
        for (const CountRow& row : kCounts) {
            const bool same = closeTo(static_cast<double>(actual.*row.member),
                                      static_cast<double>(expected.*row.member), kCountTolerance);
            findings.compare(mesh && same, [&] {
                return "\"" + node.name + "\" " + row.name + ": " + std::to_string(actual.*row.member) +
                       " instead of " + std::to_string(expected.*row.member);
            });
        }
        for (const FlagRow& row : kFlags) {
            findings.compare(
                mesh && actual.*row.member == expected.*row.member,
                [&] { return "\"" + node.name + "\" has " + (actual.*row.member ? "" : "no ") + row.name; });
        }
    }
}

void checkWorldPoints(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const std::optional<ReferenceMesh>& mesh = file.reference().nodes[i].mesh;
        if (mesh && mesh->skins + mesh->blendShapes + mesh->caches == 0)
            comparePoints(file, i, findings);
    }
}

void checkDeformedPoints(LoadedFile& file, Findings& findings) {
    const OpenCaches open(file);
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const std::optional<ReferenceMesh>& mesh = file.reference().nodes[i].mesh;
        if (mesh && mesh->skins + mesh->caches > 0)
            comparePoints(file, i, findings);
    }
}

} // namespace conformance
