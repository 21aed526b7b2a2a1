// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ConvertLosses.h"

#include <algorithm>
#include <memory>
#include <set>
#include <string_view>

#include <fbxsdk/extensions/RecordFile.h>

#include "SceneQueries.h"

namespace tool {
namespace {

using Attribute = FbxNodeAttribute;

template <class Object>
int countOf(const FbxScene& scene) {
    return scene.GetSrcObjectCount(FbxCriteria::ObjectType(Object::ClassId));
}

/// How many sets of a kind a mesh has beyond the first.
int further(const FbxMesh& mesh, FbxLayerElement::EType type) { return std::max(mesh.GetLayerCount(type) - 1, 0); }

bool isHidden(FbxNode& node) { return node.Visibility.Get() == 0.0 || isAnimated(node.Visibility); }

bool hasOwnProperties(const FbxObject& object) {
    const std::vector<FbxProperty> properties = propertiesOf(object);
    return std::any_of(properties.begin(), properties.end(),
                       [](const FbxProperty& property) { return property.GetFlag(FbxPropertyFlags::eUserDefined); });
}

/// What is counted of the nodes of a scene.
struct NodeCounts {
    int parents = 0, hidden = 0, ownProperties = 0;
    int surfaces = 0, others = 0;
    int zooms = 0, gateFits = 0, lights = 0;
    int furtherCaches = 0;
    int furtherUVs = 0, furtherNormals = 0, furtherColours = 0;

    void add(FbxNode& node) {
        parents += node.GetParent() && node.GetParent()->GetParent() ? 1 : 0;
        hidden += isHidden(node) ? 1 : 0;
        ownProperties += hasOwnProperties(node) ? 1 : 0;
        if (FbxNodeAttribute* attribute = node.GetNodeAttribute())
            add(*attribute);
    }

private:
    void add(FbxNodeAttribute& attribute) {
        switch (attribute.GetAttributeType()) {
        case Attribute::eMesh:
            addSets(static_cast<FbxMesh&>(attribute));
            break;
        case Attribute::eCamera:
        case Attribute::eCameraStereo:
            add(static_cast<FbxCamera&>(attribute));
            break;
        case Attribute::eLight:
            lights += static_cast<FbxLight&>(attribute).LightType.Get() > FbxLight::eSpot ? 1 : 0;
            break;
        case Attribute::eNurbs:
        case Attribute::ePatch:
            ++surfaces;
            break;
        case Attribute::eNull:
        case Attribute::eMarker:
        case Attribute::eSkeleton:
            break; // counted apart
        default:
            ++others;
        }
    }

    void add(const FbxCamera& camera) {
        gateFits += camera.GateFit.Get() != FbxCamera::eFitNone ? 1 : 0;
        zooms += camera.ProjectionType.Get() == FbxCamera::eOrthogonal ? 1 : 0;
    }

    void addSets(const FbxMesh& mesh) {
        furtherUVs += further(mesh, FbxLayerElement::eUV);
        furtherNormals += further(mesh, FbxLayerElement::eNormal);
        furtherColours += further(mesh, FbxLayerElement::eVertexColor);
        furtherCaches += std::max(mesh.GetDeformerCount(FbxDeformer::eVertexCache) - 1, 0);
    }
};

bool isProducer(FbxScene& scene, const FbxNode& node) {
    const auto* camera = FbxCast<FbxCamera>(node.GetNodeAttribute());
    return camera && scene.GlobalCameraSettings().IsProducerCamera(camera);
}

} // namespace

void Losses::add(int count, const std::string& what) {
    if (count > 0)
        mSentences.push_back(what + ": " + std::to_string(count));
}

void Losses::addScene(FbxScene& scene) {
    NodeCounts nodes;
    for (const TreeNode& entry : nodesInOrder(scene)) {
        if (entry.node->GetParent() && !isProducer(scene, *entry.node))
            nodes.add(*entry.node);
    }
    add(nodes.parents, "written below the root, where they are in the world: objects below others");
    add(countOf<FbxSurfaceMaterial>(scene), "not written: materials");
    add(countOf<FbxTexture>(scene), "not written: textures");
    add(countOf<FbxSkin>(scene), "not written: skins");
    add(countOf<FbxBlendShape>(scene), "not written: blend shapes");
    add(countOf<FbxAnimStack>(scene) - 1, "not written: further animation stacks");
    add(nodes.furtherUVs, "not written: further sets of texture coordinates");
    add(nodes.furtherNormals, "not written: further sets of normals");
    add(nodes.furtherColours, "not written: further sets of colours");
    add(nodes.furtherCaches, "not written: caches of normals and further ones of meshes");
    add(nodes.zooms, "not written: zooms of orthographic cameras");
    add(nodes.gateFits, "not written: gate fits of cameras");
    add(nodes.lights, "written as point lights: area and volume lights");
    add(nodes.surfaces, "written as meshes: surfaces");
    add(nodes.others, "written as nulls: curves, lines and other attributes");
    add(nodes.hidden, "written as visible: objects that are hidden or whose visibility is animated");
    add(nodes.ownProperties, "not written: properties that users added to objects");
}

void Losses::addRecords(const std::string& file) {
    struct Kind {
        std::string_view record;
        const char* what;
        int count;
    };
    Kind kinds[] = {{"Constraint", "not written: constraints", 0},
                    {"Pose", "not written: poses", 0},
                    {"Character", "not written: characters", 0}};
    FbxStatus status;
    const auto records = extensions::RecordFile::open(file.c_str(), status);
    if (!records)
        return; // the scene was read from it
    for (auto section = records->first(); section; section = section.nextSibling()) {
        for (auto object = section.name() == "Objects" ? section.firstChild() : extensions::FileRecord(); object;
             object = object.nextSibling()) {
            for (Kind& kind : kinds)
                kind.count += object.name() == kind.record ? 1 : 0;
        }
    }
    for (const Kind& kind : kinds)
        add(kind.count, kind.what);
}

} // namespace tool
