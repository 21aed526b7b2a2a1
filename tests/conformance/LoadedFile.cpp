// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Loads a file the way the library does, but stops before the conversion to read the stored values.
#include "LoadedFile.h"

#include "Utf8.h"

#include <array>
#include <cmath>
#include <map>
#include <span>

namespace conformance {
namespace {

using namespace fbxsdk;

struct TransformProperty {
    const char* name;
    FbxPropertyT<FbxDouble3> FbxNode::*property;
};

constexpr TransformProperty kTransformProperties[] = {
    {"Lcl Translation", &FbxNode::LclTranslation},
    {"Lcl Rotation", &FbxNode::LclRotation},
    {"Lcl Scaling", &FbxNode::LclScaling},
};
constexpr const char* kComponents[] = {"X", "Y", "Z"};

constexpr const char* kCameraNumbers[] = {
    "FilmWidth",    "FilmHeight", "FilmOffsetX", "FilmOffsetY", "FocalLength",  "FieldOfView",         "FieldOfViewX",
    "FieldOfViewY", "NearPlane",  "FarPlane",    "Roll",        "ApertureMode", "CameraProjectionType"};
constexpr const char* kCameraVectors[] = {"Position", "InterestPosition", "UpVector"};
constexpr const char* kLightNumbers[] = {"Intensity", "LightType", "DecayType", "OuterAngle"};
constexpr const char* kLightVectors[] = {"Color"};

using ProducerCamera = FbxCamera* (FbxGlobalCameraSettings::*)() const;
constexpr ProducerCamera kProducerCameras[] = {
    &FbxGlobalCameraSettings::GetCameraProducerPerspective, &FbxGlobalCameraSettings::GetCameraProducerTop,
    &FbxGlobalCameraSettings::GetCameraProducerBottom,      &FbxGlobalCameraSettings::GetCameraProducerFront,
    &FbxGlobalCameraSettings::GetCameraProducerBack,        &FbxGlobalCameraSettings::GetCameraProducerRight,
    &FbxGlobalCameraSettings::GetCameraProducerLeft,
};

const FbxCriteria& layerCriterion() {
    static const FbxCriteria criterion = FbxCriteria::ObjectType(FbxAnimLayer::ClassId);
    return criterion;
}

/// The sum of the keyed curves of all layers at each time; empty when there is none.
std::vector<double> sumOverLayers(FbxAnimStack& stack, FbxProperty property, const char* component,
                                  const std::vector<FbxTime>& times) {
    std::vector<double> sums;
    for (int i = 0; i < stack.GetSrcObjectCount(layerCriterion()); ++i) {
        auto* layer = FbxCast<FbxAnimLayer>(stack.GetSrcObject(layerCriterion(), i));
        FbxAnimCurve* curve = property.GetCurve(layer, property.GetNameAsCStr(), component, false);
        if (curve == nullptr || curve->KeyGetCount() < 1)
            continue;
        sums.resize(times.size(), 0.0);
        for (std::size_t t = 0; t < times.size(); ++t)
            sums[t] += static_cast<double>(curve->Evaluate(times[t]));
    }
    return sums;
}

NamedNumbers storedValues(const FbxNodeAttribute& attribute, std::span<const char* const> numbers,
                          std::span<const char* const> vectors) {
    NamedNumbers values;
    for (const char* name : numbers) {
        const FbxProperty property = attribute.FindProperty(name);
        if (property.IsValid())
            values[name] = {property.Get<FbxDouble>()};
    }
    for (const char* name : vectors) {
        const FbxProperty property = attribute.FindProperty(name);
        if (!property.IsValid())
            continue;
        const FbxDouble3 vector = property.Get<FbxDouble3>();
        values[name] = {vector[0], vector[1], vector[2]};
    }
    return values;
}

/// Names from the root down, each with the number of equally named siblings before it: the same node in both trees.
class PathNames {
public:
    std::string add(const std::string& parentPath, const std::string& name) {
        const std::string path = parentPath + "\n" + name;
        return path + "\n" + std::to_string(mSeen[path]++);
    }

private:
    std::map<std::string, int> mSeen;
};

} // namespace

LoadedFile::LoadedFile(const CorpusFile& file, const Reference& reference) : mFile(file), mReference(reference) {
    mNodeOfReference.resize(reference.nodes.size(), nullptr);
    mLoaded = mSdk.initializeSdkObjects(&mManager, &mScene) && mSdk.loadScene(mManager, mScene, file.path.string());
    if (!mLoaded) {
        mScene = nullptr;
        return;
    }
    mScene->SetCurrentAnimationStack(firstStack());
    collectNodes(*mScene->GetRootNode(), -1);
    collectProducerCameras();
    for (SceneNode& node : mNodes)
        readStoredValues(node);
    for (SceneNode& node : mProducers)
        readStoredValues(node);
    markMovedNodes();
    normalise();
    matchReference();
}

LoadedFile::LoadedFile(const CorpusFile& file, const Reference& reference, const FlatPlaces& places)
    : LoadedFile(file, reference) {
    mWholeFrames = true;
    if (mLoaded)
        matchPlaces(places);
}

LoadedFile::~LoadedFile() { mSdk.destroySdkObjects(&mManager); }

FbxAnimStack* LoadedFile::firstStack() const {
    return FbxCast<FbxAnimStack>(mScene->GetSrcObject(FbxCriteria::ObjectType(FbxAnimStack::ClassId), 0));
}

void LoadedFile::collectNodes(FbxNode& parent, int parentIndex) {
    for (int i = 0; i < parent.GetChildCount(); ++i) {
        FbxNode* child = parent.GetChild(i);
        const int index = static_cast<int>(mNodes.size());
        mNodes.push_back({child, withoutInvalidUtf8(child->GetName()), parentIndex, {}, {}, {}, false});
        collectNodes(*child, index);
    }
}

void LoadedFile::collectProducerCameras() {
    FbxGlobalCameraSettings& settings = mScene->GlobalCameraSettings();
    const auto add = [&](FbxNodeAttribute* attribute) {
        FbxNode* node = attribute == nullptr ? nullptr : attribute->GetNode();
        if (node != nullptr)
            mProducers.push_back({node, withoutInvalidUtf8(node->GetName()), -1, {}, {}, {}, false});
    };
    for (const ProducerCamera camera : kProducerCameras)
        add((settings.*camera)());
    add(settings.GetCameraSwitcher());
}

void LoadedFile::readStoredValues(SceneNode& entry) const {
    std::vector<FbxTime> times;
    for (std::size_t i = 0; i < mReference.frames.size(); ++i)
        times.push_back(timeOfSeconds(mReference.seconds(i)));

    FbxNode& node = *entry.node;
    if (FbxAnimStack* stack = firstStack()) {
        for (const TransformProperty& row : kTransformProperties) {
            for (const char* component : kComponents) {
                std::vector<double> sums = sumOverLayers(*stack, node.*row.property, component, times);
                if (!sums.empty())
                    entry.curves[std::string(row.name) + " " + component] = std::move(sums);
            }
        }
    }
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (attribute == nullptr)
        return;
    if (attribute->Is<FbxCamera>())
        entry.camera = storedValues(*attribute, kCameraNumbers, kCameraVectors);
    if (attribute->Is<FbxLight>())
        entry.light = storedValues(*attribute, kLightNumbers, kLightVectors);
}

/// The conversion changes the first level, and below it the chains of nodes that ignore their parent's scale.
void LoadedFile::markMovedNodes() {
    const FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    const bool rescaled = settings.GetSystemUnit() != FbxSystemUnit(1.0);
    const bool turned = settings.GetAxisSystem() !=
                        FbxAxisSystem(FbxAxisSystem::eYAxis, FbxAxisSystem::eParityOdd, FbxAxisSystem::eRightHanded);
    for (SceneNode& entry : mNodes) {
        FbxTransform::EInheritType inherit{};
        entry.node->GetTransformationInheritType(inherit);
        const bool follows = entry.parent >= 0 && inherit == FbxTransform::eInheritRrs &&
                             mNodes[static_cast<std::size_t>(entry.parent)].conversionMoves;
        entry.conversionMoves = (rescaled || turned) && (entry.parent < 0 || follows);
    }
}

void LoadedFile::normalise() {
    FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    if (settings.GetSystemUnit().GetScaleFactor() - 1.0 != 0.0)
        FbxSystemUnit(1.0, 1.0).ConvertScene(mScene, FbxSystemUnit::DefaultConversionOptions);
    const FbxAxisSystem target(FbxAxisSystem::eYAxis, FbxAxisSystem::eParityOdd, FbxAxisSystem::eRightHanded);
    if (settings.GetAxisSystem() != target)
        target.ConvertScene(mScene);
}

void LoadedFile::matchReference() {
    std::map<std::string, const SceneNode*> byPath;
    PathNames names;
    std::vector<std::string> paths;
    for (const SceneNode& entry : mNodes) {
        const std::string parent = entry.parent < 0 ? "" : paths[static_cast<std::size_t>(entry.parent)];
        paths.push_back(names.add(parent, entry.name));
        byPath[paths.back()] = &entry;
    }

    PathNames referenceNames;
    std::vector<std::string> referencePaths;
    for (std::size_t i = 0; i < mReference.nodes.size(); ++i) {
        const ReferenceNode& node = mReference.nodes[i];
        const std::string parent = node.parent < 0 ? "" : referencePaths[static_cast<std::size_t>(node.parent)];
        referencePaths.push_back(referenceNames.add(parent, node.name));
        if (const auto found = byPath.find(referencePaths.back()); found != byPath.end()) {
            mNodeOfReference[i] = found->second;
        } else if (node.parent < 0) {
            for (const SceneNode& producer : mProducers)
                if (node.name == producer.name)
                    mNodeOfReference[i] = &producer;
        }
    }
}

void LoadedFile::matchPlaces(const FlatPlaces& places) {
    std::array<std::vector<const SceneNode*>, kFlatGroups> groups;
    for (const SceneNode& entry : mNodes) {
        const bool skews = entry.node->GetChildCount() > 0; // is the parent of a node for its skew
        if (!skews)
            groups[static_cast<std::size_t>(flatGroupOf(*entry.node, /*converted*/ true))].push_back(&entry);
    }
    for (std::size_t i = 0; i < mNodeOfReference.size(); ++i) {
        mNodeOfReference[i] = nullptr;
        if (!places[i])
            continue;
        const auto& group = groups[static_cast<std::size_t>(places[i]->group)];
        const auto index = static_cast<std::size_t>(places[i]->index);
        mNodeOfReference[i] = index < group.size() ? group[index] : nullptr;
    }
}

FlatGroup flatGroupOf(const FbxNode& node, bool converted) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (attribute == nullptr)
        return converted ? FlatGroup::transforms : FlatGroup::nulls;
    switch (attribute->GetAttributeType()) {
    case FbxNodeAttribute::eCamera:
    case FbxNodeAttribute::eCameraStereo:
        return FlatGroup::cameras;
    case FbxNodeAttribute::eLight:
        return FlatGroup::lights;
    case FbxNodeAttribute::eNull:
        return FlatGroup::nulls;
    case FbxNodeAttribute::eMesh:
    case FbxNodeAttribute::eNurbs:
    case FbxNodeAttribute::ePatch:
        return FlatGroup::meshes;
    default:
        return FlatGroup::transforms;
    }
}

bool isWholeFrame(double frame) { return frame == std::floor(frame); }

bool LoadedFile::besideTree(std::size_t index) const {
    const SceneNode* node = mNodeOfReference[index];
    return node != nullptr && !mProducers.empty() && node >= mProducers.data() &&
           node < mProducers.data() + mProducers.size();
}

FbxTime timeOfSeconds(double seconds) {
    FbxTime time;
    time.SetSecondDouble(seconds);
    return time;
}

FbxAMatrix worldMatrix(FbxNode& node, const FbxTime& time) {
    return node.EvaluateGlobalTransform(time, FbxNode::eSourcePivot, false, false);
}

FbxAMatrix geometricMatrix(const FbxNode& node) {
    FbxAMatrix matrix;
    matrix.SetTRS(node.GetGeometricTranslation(FbxNode::eSourcePivot), node.GetGeometricRotation(FbxNode::eSourcePivot),
                  node.GetGeometricScaling(FbxNode::eSourcePivot));
    return matrix;
}

Matrix12 asMatrix12(const FbxAMatrix& matrix) {
    Matrix12 numbers{};
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            numbers[static_cast<std::size_t>(3 * row + column)] = matrix.Get(row, column);
    return numbers;
}

} // namespace conformance
