// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ConvertLosses.h"

#include <algorithm>
#include <array>
#include <memory>
#include <set>
#include <string_view>

#include <fbxsdk/extensions/FileFacts.h>
#include <fbxsdk/extensions/RecordFile.h>

#include "PropertyValues.h"
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

bool has(const FbxMesh& mesh, FbxLayerElement::EType type) { return mesh.GetLayerCount(type) > 0; }

bool isHidden(FbxNode& node) { return node.Visibility.Get() == 0.0 || isAnimated(node.Visibility); }

/// Properties of lights that are written with the values of a new light.
struct LightExtra {
    const char* what;
    std::vector<const char*> properties;
    int count = 0;
};

/// Which of them the lights of a scene use.
class LightExtras {
public:
    explicit LightExtras(FbxScene& scene) : mUntouched(FbxLight::Create(scene.GetFbxManager(), "")) {}
    ~LightExtras() { mUntouched->Destroy(); }
    LightExtras(const LightExtras&) = delete;
    LightExtras& operator=(const LightExtras&) = delete;

    void add(const FbxLight& light) {
        for (LightExtra& extra : mExtras)
            extra.count += std::any_of(extra.properties.begin(), extra.properties.end(),
                                       [&](const char* name) { return isChanged(light, name); })
                               ? 1
                               : 0;
        mSwitchedOff += light.CastLight.Get() ? 0 : 1;
    }
    void report(Losses& losses) const {
        for (const LightExtra& extra : mExtras)
            losses.add(extra.count, extra.what);
        losses.add(mSwitchedOff, "written as switched on: lights that are switched off");
    }

private:
    bool isChanged(const FbxLight& light, const char* name) const {
        const FbxProperty property = light.FindProperty(name);
        return property.IsValid() &&
               (valueText(property) != valueText(mUntouched->FindProperty(name)) || isAnimated(property));
    }

    FbxLight* mUntouched;
    std::array<LightExtra, 6> mExtras = {
        {{"not written: shadows of lights", {"CastShadows", "ShadowColor"}},
         {"not written: barn doors of lights", {"EnableBarnDoor"}},
         {"not written: inner cones of lights", {"InnerAngle"}},
         {"not written: ranges of lights", {"EnableNearAttenuation", "EnableFarAttenuation", "DecayStart"}},
         {"not written: images projected by lights", {"FileName"}},
         {"not written: volumetric light, ground projection and fog of lights",
          {"DrawVolumetricLight", "DrawGroundProjection", "Fog"}}}};
    int mSwitchedOff = 0;
};

/// The kind as which a node with the attribute is written, when it is selected.
const char* kindOf(Attribute::EType type) {
    switch (type) {
    case Attribute::eMesh:
    case Attribute::eNurbs:
    case Attribute::ePatch:
    case Attribute::eNurbsSurface:
    case Attribute::eTrimNurbsSurface:
        return "meshes";
    case Attribute::eCamera:
    case Attribute::eCameraStereo:
        return "cameras";
    case Attribute::eLight:
        return "lights";
    case Attribute::eNull:
        return "nulls";
    default:
        return "transforms";
    }
}

/// The counts for the nodes of a scene.
struct NodeCounts {
    NodeCounts(FbxScene& scene, const Losses& losses) : extras(scene), asked(losses) {}

    LightExtras extras;
    int parents = 0, hidden = 0, ownProperties = 0, shared = 0;
    int surfaces = 0, others = 0;
    int zooms = 0, gateFits = 0, resolutions = 0, imageShifts = 0, depthsOfField = 0, lights = 0;
    int furtherCaches = 0;
    int furtherUVs = 0, furtherNormals = 0, furtherColours = 0, tangents = 0, smoothing = 0, creases = 0;

    void add(FbxNode& node) {
        FbxNodeAttribute* attribute = node.GetNodeAttribute();
        const bool isOfKind = asked.wants(kindOf(attribute ? attribute->GetAttributeType() : Attribute::eNull));
        if (!isOfKind && !asked.wants("transforms"))
            return;
        const FbxNode* parent = node.GetParent();
        parents += parent && parent->GetParent() && !isSkewHelper(*parent) ? 1 : 0;
        hidden += isHidden(node) ? 1 : 0;
        ownProperties += extensions::hasUserDefinedProperties(node) ? 1 : 0;
        if (attribute && isOfKind) {
            shared += seen.insert(attribute).second || attribute->Is<FbxMesh>() ? 0 : 1;
            add(*attribute);
        }
    }

private:
    const Losses& asked;
    std::set<const FbxNodeAttribute*> seen;

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
            extras.add(static_cast<FbxLight&>(attribute));
            break;
        case Attribute::eNurbs:
        case Attribute::ePatch:
        case Attribute::eNurbsSurface:
        case Attribute::eTrimNurbsSurface:
            ++surfaces;
            break;
        case Attribute::eNull:
        case Attribute::eMarker:
        case Attribute::eSkeleton:
            break; // counted separately
        default:
            ++others;
        }
    }

    void add(const FbxCamera& camera) {
        const bool hasResolution =
            extensions::isStated(camera.AspectWidth) || extensions::isStated(camera.AspectHeight);
        resolutions += hasResolution ? 1 : 0;
        const auto isOther = [&camera](const char* name, double usual) {
            const FbxProperty property = camera.FindProperty(name);
            return property.IsValid() && property.Get<FbxDouble>() != usual;
        };
        const bool shifts = isOther("OpticalCenterX", 0.0) || isOther("OpticalCenterY", 0.0) ||
                            isOther("FilmTranslateX", 0.0) || isOther("FilmTranslateY", 0.0) ||
                            isOther("FilmRollValue", 0.0) || isOther("PreScale", 1.0);
        imageShifts += shifts ? 1 : 0;
        depthsOfField += isOther("UseDepthOfField", 0.0) ? 1 : 0;
        gateFits += camera.GateFit.Get() != FbxCamera::eFitNone ? 1 : 0;
        zooms += camera.ProjectionType.Get() == FbxCamera::eOrthogonal ? 1 : 0;
    }

    void addSets(const FbxMesh& mesh) {
        furtherUVs += further(mesh, FbxLayerElement::eUV);
        furtherNormals += further(mesh, FbxLayerElement::eNormal);
        furtherColours += further(mesh, FbxLayerElement::eVertexColor);
        tangents += has(mesh, FbxLayerElement::eTangent) || has(mesh, FbxLayerElement::eBiNormal) ? 1 : 0;
        smoothing += has(mesh, FbxLayerElement::eSmoothing) ? 1 : 0;
        creases += has(mesh, FbxLayerElement::eEdgeCrease) || has(mesh, FbxLayerElement::eVertexCrease) ||
                           has(mesh, FbxLayerElement::eHole)
                       ? 1
                       : 0;
        furtherCaches += std::max(mesh.GetDeformerCount(FbxDeformer::eVertexCache) - 1, 0);
    }
};

} // namespace

bool Losses::wants(const char* kind) const {
    return mKinds.empty() || std::find(mKinds.begin(), mKinds.end(), kind) != mKinds.end();
}

void Losses::add(int count, const std::string& what) {
    if (count > 0)
        mSentences.push_back(what + ": " + std::to_string(count));
}

void Losses::addScene(FbxScene& scene) {
    NodeCounts nodes(scene, *this);
    for (const TreeNode& entry : nodesInOrder(scene))
        if (entry.node->GetParent() && !isProducer(*entry.node) && !isSkewHelper(*entry.node))
            nodes.add(*entry.node);
    add(nodes.parents, "written below the root with their world transforms: objects with a parent");
    add(nodes.shared, "written as a copy for each node: cameras, lights and nulls that several nodes share");
    if (wants("meshes")) {
        add(countOf<FbxSurfaceMaterial>(scene), "not written: materials");
        add(countOf<FbxTexture>(scene), "not written: textures");
        add(countOf<FbxSkin>(scene), "not written: skins");
        add(countOf<FbxBlendShape>(scene), "not written: blend shapes");
    }
    add(countOf<FbxAnimStack>(scene) - 1, "not written: further animation stacks");
    add(nodes.furtherUVs, "not written: further sets of texture coordinates");
    add(nodes.furtherNormals, "not written: further sets of normals");
    add(nodes.furtherColours, "not written: further sets of colours");
    add(nodes.tangents, "not written: tangents and binormals of meshes");
    add(nodes.smoothing, "not written: smoothing of meshes");
    add(nodes.creases, "not written: creases and holes of meshes");
    add(nodes.furtherCaches, "not written: further caches of meshes, such as those of normals");
    add(nodes.zooms, "not written: zooms of orthographic cameras");
    add(nodes.gateFits, "not written: gate fits of cameras");
    add(nodes.resolutions, "not written: resolutions of cameras");
    add(nodes.imageShifts, "not written: optical centres, film translations, film rolls and pre-scales of cameras");
    add(nodes.depthsOfField, "not written: depth of field of cameras");
    add(nodes.lights, "written as point lights: area and volume lights");
    nodes.extras.report(*this);
    add(nodes.surfaces, "written as meshes: surfaces");
    add(nodes.others, "written as nulls: curves, lines and other attributes");
    add(nodes.hidden, "written as visible: objects that are hidden or whose visibility is animated");
    add(nodes.ownProperties, "not written: user properties");
}

namespace {

/// Whether an object of the file, a geometry or in older files a model, is to be subdivided.
bool isSubdivided(const extensions::FileRecord& object) {
    for (auto child = object.firstChild(); child; child = child.nextSibling())
        if (child.name() == "Smoothness" && child.value(0).integer > 0)
            return true;
    return false;
}

} // namespace

void Losses::addRecords(const std::string& file) {
    struct Kind {
        std::string_view record;
        const char* what;
        int count;
    };
    Kind kinds[] = {{"Constraint", "not written: constraints", 0},
                    {"Pose", "not written: poses", 0},
                    {"Character", "not written: characters", 0}};
    int subdivided = 0;
    FbxStatus status;
    const auto records = extensions::RecordFile::open(file.c_str(), status);
    if (!records)
        return; // the scene was read from it
    for (auto section = records->first(); section; section = section.nextSibling()) {
        for (auto object = section.name() == "Objects" ? section.firstChild() : extensions::FileRecord(); object;
             object = object.nextSibling()) {
            for (Kind& kind : kinds)
                kind.count += object.name() == kind.record ? 1 : 0;
            const bool isGeometry = object.name() == "Geometry" || object.name() == "Model";
            subdivided += isGeometry && wants("meshes") && isSubdivided(object) ? 1 : 0;
        }
    }
    for (const Kind& kind : kinds)
        add(kind.count, kind.what);
    add(subdivided, "not written: subdivision of meshes");
}

} // namespace tool
