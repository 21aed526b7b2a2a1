// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx convert: what the library reads from one file, written into another.
#include <algorithm>
#include <filesystem>
#include <iostream>
#include <map>
#include <memory>
#include <set>
#include <type_traits>

#include "Commands.h"
#include "Placement.h"
#include "Progress.h"
#include "Resampling.h"

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxWriteInfo.h"

namespace tool {
namespace {

using namespace Tarnell::Fbx;
namespace filesystem = std::filesystem;

/// The objects of one kind, and the pointers by which the facade writes them.
template <class Object>
struct Objects {
    std::unique_ptr<Object[]> array;
    std::vector<Object*> chosen;
};

class Convert {
public:
    explicit Convert(const ConvertOptions& options) : mOptions(options) {
        mInfo.setFileName(options.input);
        mInfo.setAnimationStackName("Take 001"); // any name will do; the first stack is read
        mInfo.setGlobalTransform(!options.local);
    }

    /// False with the reason in lastError().
    bool load() {
        if (!mSdk.initFbxSdkManager() || !mFbx.loadScene(mOptions.input, mSdk))
            return false;
        mSdk.getGlobalAnimationStackTime(mTime, 0.0F, /*useSampleFPS=*/false, 0.0F);
        if (mOptions.fps)
            mTime = rangeAt(mTime, *mOptions.fps);
        mInfo.setFrame(static_cast<float>(firstFrame()));
        return true;
    }

    bool read() {
        mProgress.say("reading " + mOptions.input);
        return (!wants("cameras") || readCameras()) &&
               (!wants("lights") || collect(mLights, &FbxSdk::getNumberOfLights, 64, &FbxSdk::getLights)) &&
               (!wants("nulls") || collect(mNulls, &FbxSdk::getNumberOfNulls, 0x4000, &FbxSdk::getNulls)) &&
               (!wants("meshes") || readMeshes()) && (!wants("transforms") || readTransforms()) && readMarkers();
    }

    bool write() {
        mProgress.say("writing " + mOptions.output);
        TnFbxWriteInfo info;
        info.setFileName(mOptions.output);
        info.setAnimationStackName("Take 001");
        info.setFileFormat(mOptions.ascii);
        info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(mOptions.version));
        info.setFPS(mTime.getFrameRate());
        info.setAnimateMeshVertices(cachesPoints());
        info.setMayaVertexCacheFormat(mOptions.cache == PointCache::maya);
        info.setStartFrame(static_cast<float>(firstFrame()));
        info.setEndFrame(static_cast<float>(mOptions.frames ? mOptions.frames->second : mTime.getEndFrame()));
        const bool written =
            mFbx.writeFile(info, mCameras.chosen, mLights.chosen, mTransforms.chosen, mNulls.chosen, mMeshes.chosen);
        mProgress.hide();
        return written;
    }

    /// Why reading failed.
    [[nodiscard]] const std::string& complaint() const { return mComplaint.empty() ? lastError() : mComplaint; }

    /// What was read, or could have been, and is not in the written file.
    [[nodiscard]] const std::vector<std::string>& losses() const { return mLosses; }

private:
    [[nodiscard]] bool wants(const char* kind) const {
        const auto& kinds = mOptions.kinds;
        return kinds.empty() || std::find(kinds.begin(), kinds.end(), kind) != kinds.end();
    }

    [[nodiscard]] bool cachesPoints() const { return mOptions.frames && mOptions.cache != PointCache::none; }
    [[nodiscard]] int firstFrame() const { return mOptions.frames ? mOptions.frames->first : mTime.getStartFrame(); }
    [[nodiscard]] int lastFrame() const { return cachesPoints() ? mOptions.frames->second : firstFrame(); }

    void lose(int count, const char* what) {
        if (count > 0)
            mLosses.push_back(std::string(what) + ": " + std::to_string(count));
    }

    template <class Object>
    bool readAll(std::unique_ptr<Object[]>& array, int& number, int (FbxSdk::*count)() const, int mask,
                 bool (FbxSdk::*fill)(TnFbxReadInfo&, Object*, int)) {
        number = mFbx.getNumberOfObjects((mSdk.*count)(), true, mask, "", mSdk);
        if (number < 1)
            return true;
        array.reset(new Object[static_cast<std::size_t>(number)]);
        return (mSdk.*fill)(mInfo, array.get(), number);
    }

    template <class Object>
    bool collect(Objects<Object>& objects, int (FbxSdk::*count)() const, int mask,
                 bool (FbxSdk::*fill)(TnFbxReadInfo&, Object*, int)) {
        int number = 0;
        if (!readAll(objects.array, number, count, mask, fill))
            return false;
        int turned = 0;
        for (int i = 0; i < number; ++i) {
            Object& object = objects.array[static_cast<std::size_t>(i)];
            objects.chosen.push_back(&object);
            turned += hasSkewOrPivot(object) ? 1 : 0;
            if (!mOptions.local && !std::is_same_v<Object, TnFbxCamera>)
                expressInXyz(object);
            if (mOptions.fps)
                resampleAll(object);
            forEachChannel(object, makeStatic);
        }
        lose(turned, "not written: skews and pivots of objects");
        return true;
    }

    template <class Visit>
    static void forEachChannel(TnFbxTransform& object, const Visit& visit) {
        for (int i = 0; i <= TnFbxTransform::kFbxTransformPivotZ; ++i)
            visit(*object.getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)));
    }
    template <class Visit>
    static void forEachChannel(TnFbxCamera& camera, const Visit& visit) {
        forEachChannel(static_cast<TnFbxTransform&>(camera), visit);
        for (int i = 0; i <= TnFbxCamera::kFbxCameraFilmOffsetY; ++i)
            visit(*camera.getCameraChannel(static_cast<TnFbxCamera::EFbxCameraChannelType>(i)));
    }
    template <class Visit>
    static void forEachChannel(TnFbxLight& light, const Visit& visit) {
        forEachChannel(static_cast<TnFbxTransform&>(light), visit);
        for (int i = 0; i <= TnFbxLight::kFbxLightConeAngle; ++i)
            visit(*light.getLightChannel(static_cast<TnFbxLight::EFbxLightChannelType>(i)));
    }

    /// The library's own sampling at another rate takes properties at the old times, so it is not used for channels.
    template <class Object>
    void resampleAll(Object& object) const {
        forEachChannel(object, [this](TnFbxChannel& channel) { resample(channel, *mOptions.fps); });
    }

    /// One sample instead of many, because a channel without samples keeps the memory of those it had.
    static void forgetSamples(TnFbxChannel& channel) { channel.setConstantValues(TnFbxTime(), channel.getValue()); }

    /// A long range in which a value does not change need not have a key for every frame of it.
    static void makeStatic(TnFbxChannel& channel) {
        constexpr int kFewFrames = 10'000;
        const TnFbxTime time = channel.getTime();
        const bool isLong = static_cast<long long>(time.getEndFrame()) - time.getStartFrame() >= kFewFrames;
        if (channel.getAnimated() && channel.isConstant() && isLong) {
            channel.setValue(channel.getAnimatedValue(static_cast<float>(time.getStartFrame())));
            channel.deleteAnimatedValues();
        }
    }

    static bool hasSkewOrPivot(const TnFbxTransform& object) {
        for (int i = TnFbxTransform::kFbxTransformSkewX; i <= TnFbxTransform::kFbxTransformPivotZ; ++i) {
            const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
            if (object.getTransformAnimated(channel) || object.getTransformValue(channel) != 0.0F)
                return true;
        }
        return false;
    }

    /// Every file gets producer cameras when it is written; those that were read are not written as cameras.
    bool readCameras() {
        if (!collect(mCameras, &FbxSdk::getNumberOfCameras, 32, &FbxSdk::getCameras))
            return false;
        auto& chosen = mCameras.chosen;
        chosen.erase(chosen.begin(), chosen.begin() + leadingViews(chosen));
        if (!mOptions.local)
            placeCameras();
        for (TnFbxCamera* camera : chosen)
            forEachChannel(*camera, makeStatic);
        const auto interested =
            std::count_if(chosen.begin(), chosen.end(), [](const TnFbxCamera* camera) { return hasInterest(*camera); });
        lose(static_cast<int>(interested), "not written: look-at points, up vectors and rolls of cameras");
        return true;
    }

    /// The views of the application come first, each once. A camera of the scene may have the name of one.
    static std::ptrdiff_t leadingViews(const std::vector<TnFbxCamera*>& cameras) {
        std::set<std::string> views = {"Producer Perspective", "Producer Top",   "Producer Bottom", "Producer Front",
                                       "Producer Back",        "Producer Right", "Producer Left"};
        const auto first = std::find_if(cameras.begin(), cameras.end(),
                                        [&](const TnFbxCamera* camera) { return views.erase(camera->getName()) == 0; });
        return first - cameras.begin();
    }

    /// A camera that follows a target keeps the rotation that the library computes from it.
    void placeCameras() {
        for (const auto& [camera, node] :
             nodesOf(mCameras, [](FbxNode& node) { return node.GetCamera() != nullptr; })) {
            if (!node->GetTarget())
                placeCamera(*camera, *node, mTime);
        }
    }

    /// The objects with the nodes that they were read from. Of several that have one name, the library reads the first
    /// in the tree first.
    template <class Object>
    std::vector<std::pair<Object*, FbxNode*>> nodesOf(const Objects<Object>& objects, bool (*isOfKind)(FbxNode&)) {
        std::multimap<std::string, FbxNode*> named;
        collectNodes(*mSdk.getScene()->GetRootNode(), isOfKind, named);
        std::vector<std::pair<Object*, FbxNode*>> found;
        for (Object* object : objects.chosen) {
            const auto [node, end] = named.equal_range(object->getName());
            if (node == end)
                continue;
            found.emplace_back(object, node->second);
            named.erase(node);
        }
        return found;
    }

    static void collectNodes(FbxNode& parent, bool (*isOfKind)(FbxNode&), std::multimap<std::string, FbxNode*>& named) {
        for (int i = 0; i < parent.GetChildCount(); ++i) {
            FbxNode& child = *parent.GetChild(i);
            if (isOfKind(child))
                named.emplace(child.GetName(), &child);
            collectNodes(child, isOfKind, named);
        }
    }

    static bool hasInterest(const TnFbxCamera& camera) {
        constexpr float kDefaults[] = {TnFbxCamera::kDefaultCameraLookAtPositionX,
                                       TnFbxCamera::kDefaultCameraLookAtPositionY,
                                       TnFbxCamera::kDefaultCameraLookAtPositionZ,
                                       TnFbxCamera::kDefaultCameraUpX,
                                       TnFbxCamera::kDefaultCameraUpY,
                                       TnFbxCamera::kDefaultCameraUpZ,
                                       TnFbxCamera::kDefaultCameraRoll};
        for (int i = TnFbxCamera::kFbxCameraLookAtPositionX; i <= TnFbxCamera::kFbxCameraRoll; ++i) {
            const auto channel = static_cast<TnFbxCamera::EFbxCameraChannelType>(i);
            if (camera.getAnimated(channel) || camera.getValue(channel) != kDefaults[i])
                return true;
        }
        return false;
    }

    /// Meshes at the first frame, with a set of points for each further one.
    bool readMeshes() {
        mInfo.setTransformPoints(false);
        if (!collect(mMeshes, &FbxSdk::getNumberOfMeshes, 4, &FbxSdk::getMeshes))
            return false;
        mInfo.setTransformPoints(true);
        leaveOutMeshesWithoutPolygons();
        const auto nodes = nodesOf(mMeshes, [](FbxNode& node) { return node.GetMesh() != nullptr; });
        mSdk.openClosePointCacheData(mSdk.getScene(), /*open=*/true);
        const MeshPlacement placement(mSdk, mOptions.local);
        for (const auto& [mesh, node] : nodes)
            placement.place(*mesh, *node, timeAt(mTime, firstFrame()));
        for (long long frame = firstFrame() + 1LL; frame <= lastFrame(); ++frame) {
            mProgress.say("reading meshes, frame " + std::to_string(frame) + " of " + std::to_string(lastFrame()));
            for (const auto& [mesh, node] : nodes)
                placement.addPoints(*mesh, *node, timeAt(mTime, frame));
        }
        mSdk.openClosePointCacheData(mSdk.getScene(), /*open=*/false);
        if (!cachesPoints()) {
            const auto moving = std::count_if(nodes.begin(), nodes.end(), [this](const auto& pair) {
                return moves(*pair.first) || mSdk.getDeformation(pair.second->GetMesh());
            });
            lose(static_cast<int>(moving), "written as they stand at the first frame (see --frames): moving meshes");
        }
        for (TnFbxMesh* mesh : mMeshes.chosen)
            forEachChannel(*mesh, forgetSamples); // their points are written in the world
        return true;
    }

    /// Of curves and loose edges the library reads the transform only, which can be written as one.
    void leaveOutMeshesWithoutPolygons() {
        auto& chosen = mMeshes.chosen;
        const auto left = std::remove_if(chosen.begin(), chosen.end(),
                                         [](const TnFbxMesh* mesh) { return mesh->getNumberOfPolygons() < 1; });
        lose(static_cast<int>(chosen.end() - left), "not written: meshes without polygons");
        chosen.erase(left, chosen.end());
    }

    static bool moves(const TnFbxMesh& mesh) {
        for (int i = 0; i <= TnFbxTransform::kFbxTransformScaleZ; ++i) {
            const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
            const TnFbxTime time = mesh.getTransformTime(channel);
            if (!mesh.getTransformAnimated(channel))
                continue;
            for (long long frame = time.getStartFrame(); frame <= time.getEndFrame(); ++frame)
                if (mesh.getTransformValueAt(channel, static_cast<float>(frame)) != mesh.getTransformValue(channel))
                    return true;
        }
        return false;
    }

    /// Of all transforms those that are no nulls or meshes which are written already.
    bool readTransforms() {
        if (!collect(mTransforms, &FbxSdk::getNumberOfTransforms, 0x4005, &FbxSdk::getTransforms))
            return false;
        std::multiset<std::string> written;
        for (const TnFbxNull* null : mNulls.chosen)
            written.insert(null->getName());
        for (const TnFbxMesh* mesh : mMeshes.chosen)
            written.insert(mesh->getName());
        auto& chosen = mTransforms.chosen;
        const auto known = [&written](TnFbxTransform* transform) {
            const auto found = written.find(transform->getName());
            if (found == written.end())
                return false;
            written.erase(found);
            forEachChannel(*transform, forgetSamples);
            return true;
        };
        chosen.erase(std::remove_if(chosen.begin(), chosen.end(), known), chosen.end());
        return true;
    }

    bool readMarkers() {
        const int markers = mFbx.getNumberOfObjects(mSdk.getNumberOfMarkers(), true, 1, "", mSdk);
        lose(markers,
             wants("transforms") ? "written as nulls, without look, size and colour: markers" : "not written: markers");
        return true;
    }

    const ConvertOptions& mOptions;
    TnFbxReadInfo mInfo;
    TnFbxTime mTime;
    Tarnell::Fbx::Fbx mFbx;
    FbxSdk mSdk;
    Progress mProgress;
    Objects<TnFbxCamera> mCameras;
    Objects<TnFbxLight> mLights;
    Objects<TnFbxNull> mNulls;
    Objects<TnFbxTransform> mTransforms;
    Objects<TnFbxMesh> mMeshes;
    std::vector<std::string> mLosses;
    std::string mComplaint;
};

/// Where the library puts the point caches of a file.
filesystem::path cacheFolder(const filesystem::path& file) {
    return file.parent_path() / (file.stem().string() + "_fpc");
}

/// Why the output may not be written; empty when it may.
std::string refusal(const ConvertOptions& options) {
    std::error_code ignored;
    if (filesystem::equivalent(options.input, options.output, ignored))
        return "is the file that is read";
    if (options.force)
        return {};
    if (filesystem::exists(options.output, ignored))
        return "exists; --force overwrites it";
    const filesystem::path caches = cacheFolder(options.output);
    if (options.frames && options.cache != PointCache::none && filesystem::exists(caches, ignored))
        return "its point caches exist in " + caches.string() + "; --force overwrites them";
    return {};
}

} // namespace

int convert(const ConvertOptions& options) {
    const std::string refused = refusal(options);
    if (!refused.empty()) {
        printError(options.output, refused);
        return kWrongUsage;
    }
    Convert conversion(options);
    if (!conversion.load() || !conversion.read()) {
        printError(options.input, conversion.complaint());
        return kUnreadable;
    }
    return guarded(options.output, [&]() -> int {
        const bool written = conversion.write();
        for (const std::string& loss : conversion.losses())
            printError(options.input, loss);
        for (const std::string& warning : lastWarnings())
            printError(options.output, warning);
        const bool lossless = conversion.losses().empty() && lastWarnings().empty();
        if (written)
            return options.strict && !lossless ? kLosses : kSuccess;
        printError(options.output, lastError());
        return kUnreadable;
    });
}

} // namespace tool
