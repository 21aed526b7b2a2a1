// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Counting, naming and listing: the traversals of the node tree.
//
// The six kinds of objects differ by a row: which nodes they are, and which function reads one. The rest is common.
#include "FbxSdk.h"

#include "GlobalSampler.h"
#include "NodeMasks.h"
#include "PointCacheScope.h"
#include "ReadScope.h"
#include "access/FileWarnings.h"
#include "access/NodeGeometry.h"
#include "access/NodeWalk.h"
#include "access/TimeModeScope.h"
#include "calls/LastError.h"

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <memory>
#include <string>
#include <type_traits>
#include <utility>

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;
namespace NodeMask = detail::NodeMask;

namespace {

using Attribute = fbxsdk::FbxNodeAttribute;

// ---- The kind of a node: one bit per attribute type, and one for nodes without any ----

constexpr std::uint32_t bitOf(int attributeType) {
    return attributeType >= 0 && attributeType < 31 ? std::uint32_t{1} << attributeType : 0;
}
constexpr std::uint32_t kNoAttribute = std::uint32_t{1} << 31;

std::uint32_t typeBit(fbxsdk::FbxNode& node) {
    const Attribute* attribute = node.GetNodeAttribute();
    return attribute != nullptr ? bitOf(attribute->GetAttributeType()) : kNoAttribute;
}

/// The attribute types of the bits of the public mask. 0x400 selects nothing, and no bit selects stereo cameras.
struct MaskRow {
    long maskBit;
    std::uint32_t types;
};
constexpr MaskRow kMaskRows[] = {
    {NodeMask::kMarkers, bitOf(Attribute::eMarker)},
    {NodeMask::kSkeletons, bitOf(Attribute::eSkeleton)},
    {NodeMask::kMeshes, bitOf(Attribute::eMesh)},
    {NodeMask::kNurbs, bitOf(Attribute::eNurbs)},
    {NodeMask::kPatches, bitOf(Attribute::ePatch)},
    {NodeMask::kCameras, bitOf(Attribute::eCamera)},
    {NodeMask::kLights, bitOf(Attribute::eLight)},
    {NodeMask::kOpticalReferences, bitOf(Attribute::eOpticalReference)},
    {NodeMask::kOpticalMarkers, bitOf(Attribute::eOpticalMarker)},
    {NodeMask::kCameraSwitchers, bitOf(Attribute::eCameraSwitcher)},
    {NodeMask::kNurbsCurves, bitOf(Attribute::eNurbsCurve)},
    {NodeMask::kTrimmedSurfaces, bitOf(Attribute::eTrimNurbsSurface)},
    {NodeMask::kBoundaries, bitOf(Attribute::eBoundary)},
    {NodeMask::kNulls,
     kNoAttribute | bitOf(Attribute::eNull) | bitOf(Attribute::eNurbsSurface)}, // kept: surfaces with nulls
};

std::uint32_t selectedTypes(long mask) {
    std::uint32_t types = 0;
    for (const MaskRow& row : kMaskRows)
        types |= (mask & row.maskBit) != 0 ? row.types : 0;
    return types;
}

// ---- The producer cameras ----

struct ProducerRow {
    fbxsdk::FbxCamera* (fbxsdk::FbxGlobalCameraSettings::*camera)() const;
    const char* name;
};
constexpr ProducerRow kProducers[] = {
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerPerspective, "Producer Perspective"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerTop, "Producer Top"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerBottom, "Producer Bottom"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerFront, "Producer Front"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerBack, "Producer Back"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerRight, "Producer Right"},
    {&fbxsdk::FbxGlobalCameraSettings::GetCameraProducerLeft, "Producer Left"},
};

/// Creates the producer cameras unless the scene has one of them already, and returns its settings.
fbxsdk::FbxGlobalCameraSettings& ensureProducers(fbxsdk::FbxScene& scene) {
    fbxsdk::FbxGlobalCameraSettings& settings = scene.GlobalCameraSettings();
    if (std::none_of(std::begin(kProducers), std::end(kProducers),
                     [&settings](const ProducerRow& row) { return (settings.*row.camera)() != nullptr; }))
        settings.CreateProducerCameras();
    return settings;
}

// ---- The kinds of objects ----

/// How nodes are read, apart from the time.
struct ReadFlags {
    bool globalTransform = false;
    bool useSampleRate = false;
    float sampleRate = 0.0f;
    bool computeCameraRotation = false;
    bool transformPoints = false;
};

/// Which nodes are objects of a kind, and how one is read.
template <class Object>
struct Kind {
    std::uint32_t types;
    bool geometricOffset; // whether the node's geometric transform is used
    bool (*read)(FbxSdk& sdk, TnFbxTime& time, const ReadFlags& flags, fbxsdk::FbxNode& node, Object& object,
                 fbxsdk::FbxAMatrix& geometric);
};

/// Readers whose arguments are the common ones.
template <class Object,
          bool (FbxSdk::*kReader)(TnFbxTime&, bool, bool, float, fbxsdk::FbxNode*, Object&, fbxsdk::FbxAMatrix&)>
bool readPlain(FbxSdk& sdk, TnFbxTime& time, const ReadFlags& flags, fbxsdk::FbxNode& node, Object& object,
               fbxsdk::FbxAMatrix& geometric) {
    return (sdk.*kReader)(time, flags.globalTransform, flags.useSampleRate, flags.sampleRate, &node, object, geometric);
}

bool readCamera(FbxSdk& sdk, TnFbxTime& time, const ReadFlags& flags, fbxsdk::FbxNode& node, TnFbxCamera& camera,
                fbxsdk::FbxAMatrix& geometric) {
    return sdk.getCamera(time, flags.globalTransform, flags.useSampleRate, flags.sampleRate,
                         flags.computeCameraRotation, &node, camera, geometric);
}

bool readMesh(FbxSdk& sdk, TnFbxTime& time, const ReadFlags& flags, fbxsdk::FbxNode& node, TnFbxMesh& mesh,
              fbxsdk::FbxAMatrix& geometric) {
    return sdk.getMesh(time, flags.globalTransform, flags.useSampleRate, flags.sampleRate, &node, flags.transformPoints,
                       mesh, geometric);
}

template <class Object>
constexpr Kind<Object> kKind{};
template <>
constexpr Kind<TnFbxMesh> kKind<TnFbxMesh> = {bitOf(Attribute::eMesh), true, readMesh};
template <>
constexpr Kind<TnFbxCamera> kKind<TnFbxCamera> = {bitOf(Attribute::eCamera), false, readCamera};
template <>
constexpr Kind<TnFbxLight> kKind<TnFbxLight> = {bitOf(Attribute::eLight), true,
                                                readPlain<TnFbxLight, &FbxSdk::getLight>};
template <>
constexpr Kind<TnFbxMarker> kKind<TnFbxMarker> = {bitOf(Attribute::eMarker), true,
                                                  readPlain<TnFbxMarker, &FbxSdk::getMarker>};
template <>
constexpr Kind<TnFbxNull> kKind<TnFbxNull> = {kNoAttribute | bitOf(Attribute::eNull), true,
                                              readPlain<TnFbxNull, &FbxSdk::getNull>};
template <>
constexpr Kind<TnFbxTransform> kKind<TnFbxTransform> = {kNoAttribute | bitOf(Attribute::eNull) |
                                                            bitOf(Attribute::eMarker) | bitOf(Attribute::eMesh),
                                                        true, readPlain<TnFbxTransform, &FbxSdk::getTransform>};

/// The nodes that are counted as objects of the kind, but not read as such.
template <class Object>
constexpr std::uint32_t kCountedOnly = 0;
template <>
constexpr std::uint32_t kCountedOnly<TnFbxNull> = bitOf(Attribute::eNurbsSurface);
template <>
constexpr std::uint32_t kCountedOnly<TnFbxTransform> = bitOf(Attribute::eNurbsSurface);

/// Warns of elements that stay in their initial state, since surfaces have no reader; of one name or of all.
void warnOfSurfaces(const std::string& fileName, fbxsdk::FbxScene& scene, std::uint32_t types,
                    const std::string* objectName) {
    int count = 0;
    if (types != 0) {
        detail::walkBelow(
            scene.GetRootNode(),
            [&](fbxsdk::FbxNode& node) {
                const bool wanted = objectName == nullptr || *objectName == node.GetName();
                count += wanted && (typeBit(node) & types) != 0 ? 1 : 0;
                return true;
            });
    }
    if (count > 0 && objectName != nullptr) {
        detail::warnAbout(fileName, '"' + *objectName +
                                        "\" is a NURBS surface, which is counted but not read: the "
                                        "object returned for it has neither a name nor values");
    } else if (count > 0) {
        detail::warnAbout(fileName, std::to_string(count) + (count == 1 ? " NURBS surface is" : " NURBS surfaces are") +
                                        " counted but not read: as many objects "
                                        "at the end of the array have neither a name nor values");
    }
}

/// The state of one traversal: what to read and where to store it.
template <class Object>
struct Walk {
    using ObjectType = Object;

    TnFbxTime& time;
    ReadFlags flags;
    bool allObjects;
    const std::string& objectName;
    Object* objects;
    int capacity;
    int& index;                                      // the next free element
    bool& found;                                     // the requested object was read
    std::unique_ptr<detail::GlobalSampler>& globals; // of one subtree after the other; made when it is needed
};

template <class Object>
fbxsdk::FbxAMatrix geometricOffset(const fbxsdk::FbxNode& node) {
    return kKind<Object>.geometricOffset ? detail::geometricTransform(node) : fbxsdk::FbxAMatrix();
}

template <class Object>
void readNode(FbxSdk& sdk, const Walk<Object>& walk, fbxsdk::FbxNode& node, Object& object) {
    fbxsdk::FbxAMatrix geometric = geometricOffset<Object>(node);
    kKind<Object>.read(sdk, walk.time, walk.flags, node, object, geometric); // the object keeps what a failure left
}

/// Reads the node if it is of the kind and requested. False when the array has no element left for it.
template <class Object>
bool visitNode(FbxSdk& sdk, const Walk<Object>& walk, fbxsdk::FbxNode& node) {
    if ((typeBit(node) & kKind<Object>.types) == 0)
        return true;
    if (walk.index < 0 || walk.index >= walk.capacity)
        return fail(std::string("the array is too small for \"") + node.GetName() + '"');
    if (walk.allObjects) {
        readNode(sdk, walk, node, walk.objects[walk.index]);
        ++walk.index;
    } else if (walk.objectName == node.GetName()) {
        readNode(sdk, walk, node, walk.objects[0]);
        walk.found = true;
    }
    return true;
}

/// Cameras are placed by their local channels.
template <class Object>
constexpr bool kIsPlacedInWorld = !std::is_same_v<Object, TnFbxCamera>;

/// Adds everything that a traversal will read in the world to its sampler; without a sampler when that is nothing.
template <class Object>
void addGlobals(FbxSdk& sdk, const Walk<Object>& walk, fbxsdk::FbxNode* top) {
    if (!kIsPlacedInWorld<Object> || !walk.flags.globalTransform || walk.time.getStartFrame() > walk.time.getEndFrame())
        return;
    if (walk.globals == nullptr)
        walk.globals = std::make_unique<detail::GlobalSampler>(sdk, walk.time);
    walk.globals->clear();
    int room = walk.capacity - walk.index;
    detail::walkNodes(top, [&](fbxsdk::FbxNode& node) {
        const bool isRead =
            (typeBit(node) & kKind<Object>.types) != 0 && (walk.allObjects || walk.objectName == node.GetName());
        if (isRead)
            walk.globals->add(node, geometricOffset<Object>(node));
        return !isRead || (walk.allObjects && --room > 0);
    });
}

/// Moves a value to another place until the scope ends, also by an exception.
template <class Value>
class Lent {
public:
    Lent(Value& owner, Value& place) : mOwner(owner), mPlace(place) { mPlace = std::move(mOwner); }
    ~Lent() { mOwner = std::move(mPlace); }
    Lent(const Lent&) = delete;
    Lent& operator=(const Lent&) = delete;

private:
    Value& mOwner;
    Value& mPlace;
};

} // namespace

/// A node and its descendants, until the array is full or the requested object was found.
template <class Walk>
bool FbxSdk::walkSubtree(const Walk& walk, fbxsdk::FbxNode* top) {
    if (walk.objects == nullptr)
        return fail("no array to read into");
    const detail::ReadScope scope(*this);
    addGlobals(*this, walk, top);
    const Lent globals(walk.globals, mGlobals);
    if (mGlobals != nullptr)
        mGlobals->sample(*mSamples);
    bool hasRoom = true;
    const bool walked = detail::failOnFault(/*fileName: the fault names it*/ "", [&] {
        detail::walkNodes(top, [&](fbxsdk::FbxNode& node) {
            hasRoom = visitNode(*this, walk, node);
            return hasRoom && !walk.found;
        });
        return true;
    });
    return scope.finish(walked && hasRoom && succeed());
}

// ---- Counting ----

int FbxSdk::getNumberOfNodeTypes(int mask) const {
    int count = 0;
    if (mInitialized && mScene != nullptr) {
        const std::uint32_t types = selectedTypes(mask);
        detail::walkBelow(mScene->GetRootNode(), [&](fbxsdk::FbxNode& node) {
            count += (typeBit(node) & types) != 0 ? 1 : 0;
            return true;
        });
    }
    return count;
}

bool FbxSdk::getNumberOfNodeTypesRecursive(fbxsdk::FbxNode* node, int mask, int& count) const {
    const std::uint32_t types = selectedTypes(mask);
    return detail::walkNodes(node, [&](fbxsdk::FbxNode& visited) {
        count += (typeBit(visited) & types) != 0 ? 1 : 0;
        return true;
    });
}

int FbxSdk::getNumberOfMeshes() const { return getNumberOfNodeTypes(NodeMask::kMeshes); }
int FbxSdk::getNumberOfLights() const { return getNumberOfNodeTypes(NodeMask::kLights); }
int FbxSdk::getNumberOfMarkers() const { return getNumberOfNodeTypes(NodeMask::kMarkers); }
int FbxSdk::getNumberOfNulls() const { return getNumberOfNodeTypes(NodeMask::kNulls); }
int FbxSdk::getNumberOfTransforms() const { return getNumberOfNodeTypes(NodeMask::kTransforms); }

int FbxSdk::getNumberOfCameras() const {
    if (!mInitialized || mScene == nullptr)
        return 0;
    const fbxsdk::FbxGlobalCameraSettings& settings = ensureProducers(*mScene);
    const auto producerCount =
        std::count_if(std::begin(kProducers), std::end(kProducers),
                      [&settings](const ProducerRow& row) { return (settings.*row.camera)() != nullptr; });
    return static_cast<int>(producerCount) + getNumberOfNodeTypes(NodeMask::kCameras);
}

// ---- Naming ----

bool FbxSdk::getNodeNames(long mask, std::vector<std::string>& names) {
    names.clear();
    if (mScene == nullptr)
        return fail("no scene is loaded");
    if ((mask & NodeMask::kCameras) != 0) {
        const fbxsdk::FbxGlobalCameraSettings& settings = ensureProducers(*mScene);
        for (const ProducerRow& row : kProducers)
            if ((settings.*row.camera)() != nullptr)
                names.emplace_back(row.name);
    }
    fbxsdk::FbxNode* root = mScene->GetRootNode();
    for (int i = 0; root != nullptr && i < root->GetChildCount(); ++i)
        getNodeNamesRecursive(root->GetChild(i), mask, names);
    return succeed();
}

bool FbxSdk::getNodeNamesRecursive(fbxsdk::FbxNode* node, long mask, std::vector<std::string>& names) {
    const std::uint32_t types = selectedTypes(mask);
    return detail::walkNodes(node, [&](fbxsdk::FbxNode& visited) {
        if ((typeBit(visited) & types) != 0)
            names.emplace_back(visited.GetName());
        return true;
    });
}

// ---- Listing ----

template <class Object>
bool FbxSdk::readList(TnFbxReadInfo& info, Object* objects, int count) {
    const detail::CallScope call;
    if (objects == nullptr || count < 1)
        return fail("no array to read into");
    if (!mInitialized || mScene == nullptr)
        return fail("no scene is loaded");
    const detail::TimeModeScope timeMode(mScene);
    const detail::ReadScope scope(*this);
    TnFbxTime time;
    getGlobalAnimationStackTime(time, info.getFrame(), info.getUseSampleFPS(), info.getSampleFPS());
    int index = 0;
    if constexpr (std::is_same_v<Object, TnFbxCamera>) {
        if (!readProducerCameras(info, objects, count, index))
            return false;
    }

    const detail::PointCacheScope caches(*this, std::is_same_v<Object, TnFbxMesh> ? mScene : nullptr);
    bool found = false;
    const ReadFlags flags = {info.getGlobalTransform(), info.getUseSampleFPS(), info.getSampleFPS(),
                             info.getComputeCameraRotation(), info.getTransformPoints()};
    std::unique_ptr<detail::GlobalSampler> globals;
    const Walk<Object> walk = {time,  flags,  info.getAllObjects(), info.getObjectName(), objects, count, index,
                               found, globals};
    bool result = succeed();
    fbxsdk::FbxNode* root = mScene->GetRootNode();
    for (int i = 0; root != nullptr && result && !found && i < root->GetChildCount(); ++i)
        result = walkSubtree(walk, root->GetChild(i));
    if (result && !found) {
        warnOfSurfaces(mFileName, *mScene, kCountedOnly<Object>,
                       info.getAllObjects() ? nullptr : &info.getObjectName());
    }
    return scope.finish(result);
}

bool FbxSdk::getMeshes(TnFbxReadInfo& info, TnFbxMesh* meshes, int count) { return readList(info, meshes, count); }
bool FbxSdk::getCameras(TnFbxReadInfo& info, TnFbxCamera* cameras, int count) { return readList(info, cameras, count); }
bool FbxSdk::getLights(TnFbxReadInfo& info, TnFbxLight* lights, int count) { return readList(info, lights, count); }
bool FbxSdk::getMarkers(TnFbxReadInfo& info, TnFbxMarker* markers, int count) { return readList(info, markers, count); }
bool FbxSdk::getNulls(TnFbxReadInfo& info, TnFbxNull* nulls, int count) { return readList(info, nulls, count); }
bool FbxSdk::getTransforms(TnFbxReadInfo& info, TnFbxTransform* transforms, int count) {
    return readList(info, transforms, count);
}

/// False when the array ends before the producer cameras do, which an array of `getNumberOfCameras` elements never
/// does.
bool FbxSdk::readProducerCameras(TnFbxReadInfo& info, TnFbxCamera* cameras, int count, int& index) {
    const fbxsdk::FbxGlobalCameraSettings& settings = ensureProducers(*mScene);
    for (const ProducerRow& row : kProducers) {
        fbxsdk::FbxCamera* camera = (settings.*row.camera)();
        if (camera == nullptr)
            continue;
        if (index >= count)
            return fail(std::string("the array is too small for \"") + row.name + '"');
        getProducerCamera(camera, info, cameras, row.name, index);
    }
    return true;
}

bool FbxSdk::getProducerCamera(fbxsdk::FbxCamera* camera, TnFbxReadInfo& info, TnFbxCamera* cameras, const char* name,
                               int& index) {
    if (camera == nullptr || cameras == nullptr || name == nullptr)
        return fail("no producer camera, or no array to read it into");
    fbxsdk::FbxNode* node = camera->GetNode(0);
    if (node == nullptr)
        return fail(std::string("\"") + name + "\" is not attached to a node");
    if (info.getAllObjects()) {
        getProducerCamera(node, camera, cameras[index], name);
        ++index;
    } else if (info.getObjectName() == name) {
        getProducerCamera(node, camera, cameras[0], name); // kept: a camera of that name in the scene overwrites it
    }
    return succeed();
}

bool FbxSdk::getMeshesRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                bool allObjects, bool transformPoints, const std::string& objectName,
                                fbxsdk::FbxNode* node, int& index, TnFbxMesh* meshes, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, false, transformPoints};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(Walk<TnFbxMesh>{time, flags, allObjects, objectName, meshes, count, index, found, globals},
                       node);
}

bool FbxSdk::getCamerasRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                 bool computeCameraRotation, bool allObjects, const std::string& objectName,
                                 fbxsdk::FbxNode* node, int& index, TnFbxCamera* cameras, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, computeCameraRotation, false};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(Walk<TnFbxCamera>{time, flags, allObjects, objectName, cameras, count, index, found, globals},
                       node);
}

bool FbxSdk::getLightsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                bool allObjects, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                                TnFbxLight* lights, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, false, false};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(Walk<TnFbxLight>{time, flags, allObjects, objectName, lights, count, index, found, globals},
                       node);
}

bool FbxSdk::getMarkersRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                 bool allObjects, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                                 TnFbxMarker* markers, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, false, false};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(Walk<TnFbxMarker>{time, flags, allObjects, objectName, markers, count, index, found, globals},
                       node);
}

bool FbxSdk::getNullsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                               bool allObjects, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                               TnFbxNull* nulls, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, false, false};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(Walk<TnFbxNull>{time, flags, allObjects, objectName, nulls, count, index, found, globals}, node);
}

bool FbxSdk::getTransformsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                    bool allObjects, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                                    TnFbxTransform* transforms, int count, bool& found) {
    const ReadFlags flags = {globalTransform, useSampleFPS, sampleFPS, false, false};
    std::unique_ptr<detail::GlobalSampler> globals;
    return walkSubtree(
        Walk<TnFbxTransform>{time, flags, allObjects, objectName, transforms, count, index, found, globals}, node);
}

} // namespace Tarnell::Fbx
