// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading for a report. Values come from the faithful facade, one call for each kind; the tree and data that no value
// object can hold come from the platform.
#include "ReportScene.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>
#include <filesystem>
#include <system_error>

#include <fbxsdk/extensions/FileFacts.h>

#include "TnFbxMesh.h"

namespace tool {

using namespace Tarnell::Fbx;

namespace {

/// A browser opens pages of this many numbers at once, and rotates their scenes smoothly.
constexpr std::size_t kMostSamples = 3'000'000;
constexpr int kMostFrames = 100'000;
constexpr std::size_t kMostTriangles = 250'000;
constexpr std::size_t kMostMovingPoints = 600'000;
/// Transforms of nodes that are evaluated for one kind of object: a few seconds.
constexpr double kMostEvaluations = 4e6;
/// Every sampled time of deforming points reads the file once more.
constexpr int kMostMoments = 250;
constexpr std::uintmax_t kMostBytesReadAgain = std::uintmax_t{256} << 20U;

/// The attribute by which the library sorts nodes into its kinds.
FbxNodeAttribute::EType typeOf(const FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eNull;
}

bool isCamera(FbxNodeAttribute::EType type) {
    return type == FbxNodeAttribute::eCamera || type == FbxNodeAttribute::eCameraStereo;
}

bool isMesh(FbxNodeAttribute::EType type) {
    return type == FbxNodeAttribute::eMesh || type == FbxNodeAttribute::eNurbs || type == FbxNodeAttribute::ePatch;
}

bool hasMovingPoints(FbxScene& scene) {
    const std::vector<FbxObject*> objects = extensions::objectsOf(scene);
    return std::any_of(objects.begin(), objects.end(), [](FbxObject* object) { return object->Is<FbxDeformer>(); });
}

/// The samples of one channel, if there are any.
template <class Each>
void eachChannel(const ReportNode& node, const Each& each) {
    for (int i = TnFbxTransform::kFbxTransformPositionX; i <= TnFbxTransform::kFbxTransformSkewZ; ++i)
        each(*node.transform->getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)));
    for (int i = 0; node.camera && i <= TnFbxCamera::kFbxCameraFilmOffsetY; ++i)
        each(*node.camera->getCameraChannel(static_cast<TnFbxCamera::EFbxCameraChannelType>(i)));
    for (int i = 0; node.light && i <= TnFbxLight::kFbxLightConeAngle; ++i)
        each(*node.light->getLightChannel(static_cast<TnFbxLight::EFbxLightChannelType>(i)));
}

std::string counted(std::size_t count, const char* one, const char* many) {
    return std::to_string(count) + ' ' + (count == 1 ? one : many);
}

/// The smallest power of two from a number on: dividing a frame, and most rates, by one is exact, and so the time of
/// a frame is the same at each of these rates.
int powerOfTwoFrom(long long number) {
    return static_cast<int>(std::bit_ceil(static_cast<unsigned>(std::clamp(number, 1LL, 1LL << 30))));
}
bool isExact(double rate) { return static_cast<double>(static_cast<float>(rate)) == rate; }

/// That many indices below `count`, evenly spread, including the first and the last.
std::vector<int> spread(int wanted, int count) {
    std::vector<int> places;
    places.reserve(static_cast<std::size_t>(wanted));
    for (int i = 0; i < wanted; ++i)
        places.push_back(wanted < 2 ? 0 : static_cast<int>(static_cast<long long>(i) * (count - 1) / (wanted - 1)));
    return places;
}

std::vector<Point> chosen(const TnFbxMesh& mesh, const std::vector<std::uint32_t>& kept) {
    std::vector<Point> points(kept.size());
    for (std::size_t i = 0; i < kept.size(); ++i)
        mesh.getControlPoint(static_cast<int>(kept[i]), points[i][0], points[i][1], points[i][2]);
    return points;
}

bool areSame(const std::vector<Point>& a, const std::vector<Point>& b) {
    return a.size() == b.size() && (a.empty() || std::memcmp(a.data(), b.data(), a.size() * sizeof(Point)) == 0);
}

} // namespace

ReportScene::ReportScene(const std::string& file, const ReportWishes& wishes) : mFile(file), mOpened(file) {
    chooseFrames(wishes);
    mInfo = faithfulInfo(file, wishes.take);
    mInfo.setTransformPoints(false); // the transforms of their nodes move them
    readEvery(mSampleStep, mFrames.first);
    mTransforms = read<TnFbxTransform>(&Tarnell::Fbx::Fbx::getTransforms);
    mCameras = read<TnFbxCamera>(&Tarnell::Fbx::Fbx::getCameras);
    mLights = read<TnFbxLight>(&Tarnell::Fbx::Fbx::getLights);
    readOneMoment(mFrames.first);
    mNulls = read<TnFbxNull>(&Tarnell::Fbx::Fbx::getNulls);
    linkNodes();
    gatherCameras(wishes.take);
    boundFrames(wishes);
    readShapes();
}

/// The frames of the take, before any is read.
void ReportScene::chooseFrames(const ReportWishes& wishes) {
    FbxAnimStack* stack = mOpened.chooseTake(wishes.take);
    const TakeFacts take = takeFacts(mOpened, stack);
    mTake = take.name;
    mFrames.rate = take.frameRate;
    constexpr long long kMost = 1'000'000'000;
    mFrames.first = static_cast<int>(std::clamp(take.firstFrame, -kMost, kMost));
    mFrames.count = static_cast<int>(std::clamp(take.lastFrame, -kMost, kMost)) - mFrames.first + 1;
    const double nodes = std::max(1, mOpened.scene().GetNodeCount());
    mSampleStep =
        powerOfTwoFrom(static_cast<long long>(std::min(std::ceil(mFrames.count * nodes / kMostEvaluations), 1e9)));
}

/// Selects frames among those that were read: the requested ones, limited to what a page can hold.
void ReportScene::boundFrames(const ReportWishes& wishes) {
    std::size_t moving = 0;
    long long first = mFrames.first, last = first + mFrames.count - 1;
    for (const ReportNode& node : mNodes) {
        eachChannel(
            node,
            [&](const TnFbxChannel& channel) {
                if (!channel.getAnimated())
                    return;
                ++moving;
                first = static_cast<long long>(channel.getTime().getStartFrame()) * mSampleStep; // the same for all
                last = static_cast<long long>(channel.getTime().getEndFrame()) * mSampleStep;
            });
    }
    const long long all = last - first + 1;
    if (wishes.frames) {
        if (wishes.frames->first > last || wishes.frames->second < first)
            throw Unreadable("there are no frames " + std::to_string(wishes.frames->first) + " to " +
                             std::to_string(wishes.frames->second) + "; the frames are " + std::to_string(first) +
                             " to " + std::to_string(last));
        first = std::max<long long>(first, wishes.frames->first);
        last = std::min<long long>(last, wishes.frames->second);
        // between two samples there is none
        first += (mSampleStep - (first % mSampleStep + mSampleStep) % mSampleStep) % mSampleStep;
        first = std::min(first, last);
    }
    // Takes may exceed the range of frame numbers. A multiple of the step, as the samples are.
    const long long furthest = 2'000'000'000 / mSampleStep * mSampleStep;
    if (first < -furthest || last > furthest)
        note("Frames beyond " + std::to_string(furthest) + " are left out.");
    first = std::clamp(first, -furthest, furthest);
    last = std::clamp(last, first, furthest);
    const long long samples = (last - first) / mSampleStep + 1;
    const auto frames = static_cast<std::size_t>(samples);
    const std::size_t numbers = std::max(frames * moving * kMostFrames, frames * kMostSamples);
    const auto stride = static_cast<int>((numbers - 1) / (kMostSamples * kMostFrames) + 1);
    mFrames.first = static_cast<int>(first);
    mFrames.step = mSampleStep * stride;
    mFrames.count = static_cast<int>((last - first) / mFrames.step + 1);
    if (mFrames.step > 1)
        note("Of the " + std::to_string(all) + " frames the report shows every " + std::to_string(mFrames.step) +
             "th, to limit the size of the page (--frames selects a part).");
}

template <class Object>
ReportScene::Objects<Object> ReportScene::read(Reader<Object> reader) {
    FaithfulObjects<Object> read = readFaithfully<Object>(mInfo, reader);
    for (const std::string& warning : read.warnings)
        if (mKnownWarnings.insert(warning).second)
            mWarnings.push_back(warning);
    return {std::move(read.objects), read.count};
}

void ReportScene::readOneMoment(int frame) {
    readEvery(isExact(mFrames.rate) ? powerOfTwoFrom(static_cast<long long>(mFrames.count) * mFrames.step)
                                    : mSampleStep,
              frame);
}

void ReportScene::readEvery(int step, int frame) {
    mInfo.setUseSampleFPS(step > 1);
    mInfo.setSampleFPS(static_cast<float>(mFrames.rate / step));
    mInfo.setFrame(static_cast<float>(frame) / static_cast<float>(step));
}

/// The next object of a kind, which belongs to the node.
template <class Object>
Object* ReportScene::next(Objects<Object>& objects, const FbxNode& node) {
    if (objects.next == objects.count || objects.array.get()[objects.next].getName() != node.GetName())
        throw Unreadable(std::string("the objects that were read do not match the nodes: ") + node.GetName());
    return objects.array.get() + objects.next++;
}

void ReportScene::linkNodes() {
    int meshes = 0;
    for (const TreeNode& tree : nodesInOrder(mOpened.scene())) {
        if (tree.isDetached) // views of applications; they come last
            continue;
        ReportNode node{tree};
        const FbxNodeAttribute::EType type = typeOf(*tree.node);
        node.transform = next(mTransforms, *tree.node);
        if (isCamera(type))
            node.transform = node.camera = next(mCameras, *tree.node);
        else if (type == FbxNodeAttribute::eLight)
            node.transform = node.light = next(mLights, *tree.node);
        else if (type == FbxNodeAttribute::eNull)
            node.null = next(mNulls, *tree.node);
        else if (isMesh(type))
            node.mesh = meshes++;
        mNodes.push_back(node);
    }
}

void ReportScene::gatherCameras(const std::string& take) {
    if (mCameras.count == 0)
        return;
    try {
        CameraList list = camerasOf(mFile, mOpened, take);
        for (CameraFacts& facts : list.cameras)
            mCameraFacts.emplace(facts.node, std::move(facts));
    } catch (const Unreadable& error) { // of clips that are read in part only
        mWarnings.emplace_back(error.what());
    }
}

const CameraFacts* ReportScene::factsOf(const FbxNode& node) const {
    const auto found = mCameraFacts.find(&node);
    return found == mCameraFacts.end() ? nullptr : &found->second;
}

/// Triangles, a share for each mesh in proportion to its own.
void ReportScene::thinShapes(const Objects<TnFbxMesh>& meshes) {
    std::size_t triangles = 0, thinned = 0;
    int dropped = 0;
    for (std::size_t i = 0; i < meshes.count; ++i) {
        mShapes.push_back({triangulated(meshes.array.get()[i]), {}});
        triangles += mShapes.back().mesh.triangleCount;
        dropped += mShapes.back().mesh.droppedPolygons;
    }
    for (std::size_t i = 0; i < mShapes.size(); ++i) {
        ReportShape& shape = mShapes[i];
        const double share = static_cast<double>(shape.mesh.triangleCount) / static_cast<double>(triangles);
        if (triangles > kMostTriangles)
            thin(shape.mesh, pointsOf(meshes.array.get()[i]), static_cast<std::size_t>(share * kMostTriangles));
        shape.sets.push_back(chosen(meshes.array.get()[i], shape.mesh.kept));
        thinned += shape.mesh.isThinned() ? 1U : 0U;
    }
    if (thinned > 0)
        note(counted(thinned, "mesh is", "meshes are") + " simplified: of " + std::to_string(triangles) +
             " triangles in the file, the page draws about " + std::to_string(kMostTriangles) +
             ". Drawn points keep their positions.");
    if (dropped > 0)
        note(counted(static_cast<std::size_t>(dropped), "polygon is", "polygons are") +
             " not drawn: they refer to points that do not exist or are not finite.");
}

void ReportScene::readShapes() {
    readOneMoment(mFrames.first);
    thinShapes(read<TnFbxMesh>(&Tarnell::Fbx::Fbx::getMeshes));
    mShapeFrames = {0};
    std::size_t points = 1;
    for (const ReportShape& shape : mShapes)
        points += shape.mesh.kept.size();
    if (mShapes.empty() || mFrames.count < 2 || !hasMovingPoints(mOpened.scene()))
        return;
    std::error_code unknown;
    const std::uintmax_t bytes = std::filesystem::file_size(mFile, unknown);
    const auto affordable =
        static_cast<int>(unknown ? 2 : std::min<std::uintmax_t>(kMostBytesReadAgain / (bytes + 1), kMostMoments));
    const auto carried = static_cast<int>(std::min<std::size_t>(kMostMovingPoints / points, kMostMoments));
    readMovingPoints(
        spread(std::clamp(std::min(affordable, carried), 2, std::min(mFrames.count, kMostMoments)), mFrames.count));
}

void ReportScene::readMovingPoints(const std::vector<int>& wanted) {
    for (std::size_t moment = 1; moment < wanted.size(); ++moment) {
        readOneMoment(mFrames.at(wanted[moment]));
        const Objects<TnFbxMesh> meshes = read<TnFbxMesh>(&Tarnell::Fbx::Fbx::getMeshes);
        for (std::size_t i = 0; i < mShapes.size() && i < meshes.count; ++i)
            mShapes[i].sets.push_back(chosen(meshes.array.get()[i], mShapes[i].mesh.kept));
    }
    bool moving = false;
    for (ReportShape& shape : mShapes) {
        const bool moves = std::any_of(shape.sets.begin(), shape.sets.end(),
                                       [&](const auto& set) { return !areSame(set, shape.sets.front()); });
        shape.sets.resize(moves ? shape.sets.size() : 1);
        moving = moving || moves;
    }
    if (!moving)
        return;
    mShapeFrames = wanted;
    if (wanted.size() < static_cast<std::size_t>(mFrames.count))
        note("Deforming meshes are exact at " + std::to_string(wanted.size()) + " of " + std::to_string(mFrames.count) +
             " frames; between these, points are interpolated linearly.");
}

} // namespace tool
