// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers of cameras, from the library; their properties, from the file.
#include "CameraFacts.h"

#include <algorithm>
#include <cmath>
#include <unordered_map>

#include <fbxsdk/extensions/FileFacts.h>

#include "CameraOrigins.h"
#include "Curves.h"
#include "Placing.h"
#include "SceneFacts.h"
#include "SceneQueries.h"
#include "TnFbxCamera.h"

namespace tool {

using Tarnell::Fbx::TnFbxCamera;

namespace {

/// The nodes that a faithful read has as cameras, in its order.
std::vector<FbxNode*> cameraNodes(FbxScene& scene) {
    std::vector<FbxNode*> nodes;
    for (const TreeNode& each : nodesInOrder(scene))
        if (!each.isDetached && each.node->GetCamera() && !isProducer(*each.node))
            nodes.push_back(each.node);
    return nodes;
}

Vector3 unitVector(const FbxVector4& vector) {
    const double length = lengthOf(vector);
    return {vector[0] / length, vector[1] / length, vector[2] / length};
}

bool anyAnimated(const TnFbxCamera& camera, std::initializer_list<TnFbxCamera::EFbxCameraChannelType> channels) {
    return std::any_of(
        channels.begin(), channels.end(), [&](auto channel) { return camera.getAnimated(channel); });
}

bool anyMoves(const TnFbxCamera& camera) {
    for (int i = TnFbxCamera::kFbxTransformPositionX; i <= TnFbxCamera::kFbxTransformRotationZ; ++i)
        if (camera.getTransformAnimated(static_cast<TnFbxCamera::EFbxTransformChannelType>(i)))
            return true;
    return false;
}

LensDriver driverOf(const FbxCamera& camera) {
    switch (camera.ApertureMode.Get()) {
    case FbxCamera::eHorizAndVert:
        return LensDriver::twoAngles;
    case FbxCamera::eHorizontal:
        return LensDriver::horizontalAngle;
    case FbxCamera::eVertical:
        return LensDriver::verticalAngle;
    case FbxCamera::eFocalLength:
        break;
    }
    return LensDriver::focalLength;
}

/// Width by height of the picture's pixels as displayed; 0 where the file has no resolution. In the modes with a
/// ratio one of the two numbers is relative to the other.
double pictureAspect(const FbxCamera& camera) {
    const double width = camera.AspectWidth.Get(), height = camera.AspectHeight.Get();
    double aspect = width / height;
    if (camera.AspectRatioMode.Get() == FbxCamera::eFixedWidth)
        aspect = 1.0 / height;
    if (camera.AspectRatioMode.Get() == FbxCamera::eFixedHeight)
        aspect = width;
    aspect *= camera.PixelAspectRatio.Get();
    return std::isfinite(aspect) && aspect > 0.0 ? aspect : 0.0;
}

bool writtenByBlender(const SceneFile& file) {
    return std::string(file.importer().GetFileHeaderInfo()->mCreator.Buffer()).find("Blender") != std::string::npos;
}

void addChannels(const FbxObject& object, FbxAnimStack* take, double rate, const CameraFacts& facts,
                 std::vector<CameraChannel>& channels) {
    for (const FbxProperty& property : propertiesOf(object)) {
        for (const Channel& channel : channelsOf(property, take)) {
            if (channel.curves.empty())
                continue;
            CameraChannel added{object.GetName(), channel.fullName(), isInForce(facts, property), 0, 0, 0, 0, 0};
            for (const LayerCurve& each : channel.curves) {
                for (int i = 0; i < each.curve->KeyGetCount(); ++i) {
                    const double frame = each.curve->KeyGetTime(i).GetSecondDouble() * rate;
                    const auto value = static_cast<double>(each.curve->KeyGetValue(i));
                    const bool isFirst = added.keys++ == 0;
                    added.firstFrame = isFirst ? frame : std::min(added.firstFrame, frame);
                    added.lastFrame = isFirst ? frame : std::max(added.lastFrame, frame);
                    added.low = isFirst ? value : std::min(added.low, value);
                    added.high = isFirst ? value : std::max(added.high, value);
                }
            }
            channels.push_back(std::move(added));
        }
    }
}

} // namespace

class CameraGathering {
public:
    CameraGathering(const SceneFile& opened, FbxAnimStack* take, const TakeFacts& facts)
        : mOpened(opened), mTake(take), mFacts(facts) {}

    CameraFacts gather(FbxNode& node, std::shared_ptr<const TnFbxCamera> values) const {
        CameraFacts facts;
        facts.name = node.GetName();
        facts.node = &node;
        facts.mFrameRate = mFacts.frameRate;
        facts.mValues = std::move(values);
        const FbxCamera& camera = *node.GetCamera();
        facts.stereo = camera.GetAttributeType() == FbxNodeAttribute::eCameraStereo;
        addPicture(camera, facts);
        addPlace(node, facts);
        const CameraMoment first = facts.at(static_cast<double>(mFacts.firstFrame));
        facts.gate = knownGate({first.film.width / facts.squeeze, first.film.height});
        if (facts.orthographic)
            addOrtho(camera, facts);
        addChannels(node, mTake, mFacts.frameRate, facts, facts.channels);
        addChannels(camera, mTake, mFacts.frameRate, facts, facts.channels);
        facts.idle = idleValues(facts);
        facts.origins = originsOf(facts, first, mOpened);
        return facts;
    }

private:
    static void addPicture(const FbxCamera& camera, CameraFacts& facts) {
        const TnFbxCamera& values = *facts.mValues;
        facts.orthographic = values.getProjectionType() == TnFbxCamera::kFbxCameraOrthographic;
        facts.driver = driverOf(camera);
        facts.squeeze = camera.FilmSqueezeRatio.Get();
        facts.resolution = {camera.AspectWidth.Get(), camera.AspectHeight.Get()};
        facts.resolutionStated = extensions::isStated(camera.AspectWidth) || extensions::isStated(camera.AspectHeight);
        facts.pixelAspect = camera.PixelAspectRatio.Get();
        facts.aspectMode = camera.AspectRatioMode.Get<FbxInt>();
        facts.pictureAspect = pictureAspect(camera);
        facts.gateFit = gateFitOf(camera.GateFit.Get<FbxInt>());
        facts.lensChanges =
            anyAnimated(values, {TnFbxCamera::kFbxCameraFocalLength, TnFbxCamera::kFbxCameraApertureWidth,
                                 TnFbxCamera::kFbxCameraApertureHeight, TnFbxCamera::kFbxCameraFilmOffsetX,
                                 TnFbxCamera::kFbxCameraFilmOffsetY});
    }

    void addPlace(FbxNode& node, CameraFacts& facts) const {
        facts.moves = anyMoves(*facts.mValues);
        const FbxAMatrix place = placeAt(*facts.mValues, static_cast<double>(mFacts.firstFrame));
        for (int axis = 0; axis < 3; ++axis)
            facts.scale[static_cast<std::size_t>(axis)] = lengthOf(place.GetRow(axis)) / unit();
        if (facts.mValues->getTransformValue(TnFbxCamera::kFbxTransformScaleX) < 0.0F)
            facts.scale[0] = -facts.scale[0];
        const FbxNode* target = node.GetTarget();
        facts.hasTarget = target != nullptr;
        facts.target = target ? target->GetName() : "";
        addRest(node, facts);
        if (const FbxNode* above = keyedFrom(node.GetParent()))
            facts.movedBy = above->GetName();
    }

    /// The node or its nearest ancestor with keys for its transform. Results for the nodes in between are cached: trees
    /// may have any depth.
    const FbxNode* keyedFrom(FbxNode* node) const {
        std::vector<const FbxNode*> way;
        const FbxNode* keyed = nullptr;
        for (FbxNode* at = node; at && !keyed; at = at->GetParent()) {
            const auto known = mKeyedFrom.find(at);
            if (known != mKeyedFrom.end()) {
                keyed = known->second;
                break;
            }
            way.push_back(at);
            const FbxProperty place[] = {at->LclTranslation, at->LclRotation, at->LclScaling};
            if (std::any_of(std::begin(place), std::end(place),
                            [this](const FbxProperty& property) { return keyCount(property, mTake) > 0; }))
                keyed = at;
        }
        for (const FbxNode* each : way)
            mKeyedFrom[each] = keyed;
        return keyed;
    }

    static void addRest(const FbxNode& node, CameraFacts& facts) {
        const FbxVector4 before = node.GetPreRotation(FbxNode::eSourcePivot);
        const FbxVector4 after = node.GetPostRotation(FbxNode::eSourcePivot);
        facts.preRotation = {before[0], before[1], before[2]};
        facts.postRotation = {after[0], after[1], after[2]};
        facts.rotationActive = node.GetRotationActive();
        facts.restDirection = restDirection(facts);
    }

    void addOrtho(const FbxCamera& camera, CameraFacts& facts) const {
        OrthoFacts ortho;
        ortho.zoom = camera.OrthoZoom.Get();
        ortho.isBlenders = writtenByBlender(mOpened);
        // A width of 30 at zoom 1.
        constexpr double kWidthOfOne = 30.0;
        ortho.width = ortho.zoom * unit() * (ortho.isBlenders ? std::abs(facts.scale[0]) : kWidthOfOne);
        facts.ortho = ortho;
    }

    /// Of the file, centimetres.
    double unit() const { return mOpened.scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor(); }

    const SceneFile& mOpened;
    FbxAnimStack* mTake;
    const TakeFacts& mFacts;
    mutable std::unordered_map<const FbxNode*, const FbxNode*> mKeyedFrom;
};

double CameraMoment::interestDistance() const {
    return std::hypot(interest[0] - position[0], interest[1] - position[1], interest[2] - position[2]);
}

double CameraMoment::interestAngle() const {
    constexpr double kDegrees = 57.295779513082320877;
    const double away = interestDistance();
    double along = 0.0;
    for (std::size_t axis = 0; axis < 3; ++axis)
        along += (interest[axis] - position[axis]) * direction[axis];
    return away > 0.0 ? std::acos(std::clamp(along / away, -1.0, 1.0)) * kDegrees : 0.0;
}

CameraMoment CameraFacts::at(double frame) const {
    const auto value = [&](TnFbxCamera::EFbxCameraChannelType channel) {
        return static_cast<double>(mValues->getValueAt(channel, static_cast<float>(frame)));
    };
    CameraMoment moment;
    moment.frame = frame;
    moment.seconds = frame / mFrameRate;
    moment.focalLength = value(TnFbxCamera::kFbxCameraFocalLength);
    moment.film = {value(TnFbxCamera::kFbxCameraApertureWidth), value(TnFbxCamera::kFbxCameraApertureHeight)};
    moment.fovX = value(TnFbxCamera::kFbxCameraFieldOfViewX);
    moment.fovY = value(TnFbxCamera::kFbxCameraFieldOfViewY);
    moment.picture = pictureAspect > 0.0 ? pictureGate(moment.film, pictureAspect, gateFit) : moment.film;
    moment.pictureFovX = angleOver(moment.picture.width, moment.focalLength);
    moment.pictureFovY = angleOver(moment.picture.height, moment.focalLength);
    moment.offsetX = value(TnFbxCamera::kFbxCameraFilmOffsetX);
    moment.offsetY = value(TnFbxCamera::kFbxCameraFilmOffsetY);
    moment.nearPlane = value(TnFbxCamera::kFbxCameraNearPlane);
    moment.farPlane = value(TnFbxCamera::kFbxCameraFarPlane);
    moment.roll = value(TnFbxCamera::kFbxCameraRoll);
    moment.interest = {value(TnFbxCamera::kFbxCameraLookAtPositionX), value(TnFbxCamera::kFbxCameraLookAtPositionY),
                       value(TnFbxCamera::kFbxCameraLookAtPositionZ)};
    const FbxAMatrix place = placeAt(*mValues, frame);
    const FbxVector4 position = place.GetT();
    moment.position = {position[0], position[1], position[2]};
    const Vector3 back = unitVector(place.GetRow(2));
    moment.direction = {-back[0], -back[1], -back[2]};
    moment.up = unitVector(place.GetRow(1));
    return moment;
}

CameraList camerasOf(const std::string& file, const SceneFile& opened, const std::string& takeName) {
    return CameraReader(file, opened).read(takeName);
}

FaithfulObjects<TnFbxCamera> CameraReader::readObjects(const Tarnell::Fbx::TnFbxReadInfo& info) {
    FaithfulObjects<TnFbxCamera> result;
    const auto check = [&result](bool done) {
        if (!done)
            throw Unreadable(Tarnell::Fbx::lastError());
        const std::vector<std::string>& warnings = Tarnell::Fbx::lastWarnings();
        result.warnings.insert(result.warnings.end(), warnings.begin(), warnings.end());
    };
    check(mValues.getScene() ? mValues.select(info) : mValues.load(info));
    TnFbxCamera* objects = nullptr;
    int count = 0;
    const bool done = mValues.readAll(&objects, count);
    result.objects.reset(objects);
    result.count = static_cast<std::size_t>(count);
    check(done);
    return result;
}

CameraList CameraReader::read(const std::string& takeName) {
    FbxAnimStack* take = mOpened.chooseTake(takeName);
    FbxScene& scene = mOpened.scene();
    CameraList list;
    list.take = takeFacts(mOpened, take);
    list.unit = scene.GetGlobalSettings().GetSystemUnit().GetScaleFactor();
    const Axes axes = axesOf(scene.GetGlobalSettings().GetAxisSystem());
    list.axes =
        axes.up + " up, " + axes.toViewer + " to the viewer, " + (axes.rightHanded ? "right" : "left") + "-handed";
    const std::vector<FbxNode*> nodes = cameraNodes(scene);
    if (nodes.empty())
        return list;
    Tarnell::Fbx::TnFbxReadInfo info = faithfulInfo(mFile, takeName);
    info.setFrame(static_cast<float>(list.take.firstFrame));
    auto read = readObjects(info);
    list.warnings = std::move(read.warnings);
    const CameraGathering gathering(mOpened, take, list.take);
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        if (i >= read.count || read.objects.get()[i].getName() != nodes[i]->GetName())
            throw Unreadable("the file was changed while it was read");
        list.cameras.push_back(
            gathering.gather(*nodes[i], std::shared_ptr<const TnFbxCamera>(read.objects, read.objects.get() + i)));
    }
    return list;
}

const char* driverText(LensDriver driver) {
    constexpr const char* kTexts[] = {"focal length", "horizontal angle", "vertical angle", "both angles"};
    return kTexts[static_cast<std::size_t>(driver)];
}

} // namespace tool
