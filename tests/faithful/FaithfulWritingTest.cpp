// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A faithful read returns what was written faithfully: every kind and channel, in every version and encoding.
#include "FaithfulFile.h"

#include "FbxFaithful.h"

#include "TnFbxError.h"

#include <cmath>
#include <filesystem>
#include <string>
#include <tuple>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using Transform = TnFbxTransform;
using Camera = TnFbxCamera;

constexpr float kTelevision = 24000.0f / 1001.0f;

void expectSameChannel(const TnFbxChannel& expected, const TnFbxChannel& actual, const std::string& name,
                       float tolerance) {
    EXPECT_NEAR(expected.getValue(), actual.getValue(), tolerance) << name;
    ASSERT_EQ(expected.getAnimated(), actual.getAnimated()) << name;
    if (!expected.getAnimated())
        return;
    const TnFbxTime wanted = expected.getTime(), found = actual.getTime();
    EXPECT_EQ(wanted.getStartFrame(), found.getStartFrame()) << name;
    EXPECT_EQ(wanted.getEndFrame(), found.getEndFrame()) << name;
    EXPECT_FLOAT_EQ(wanted.getFrameRate(), found.getFrameRate()) << name;
    for (int frame = wanted.getStartFrame(); frame <= wanted.getEndFrame(); ++frame) {
        EXPECT_NEAR(expected.getAnimatedValue(static_cast<float>(frame)),
                    actual.getAnimatedValue(static_cast<float>(frame)), tolerance)
            << name << " at " << frame;
    }
}

void expectSameTransform(Transform& expected, Transform& actual, float tolerance = 1e-4f) {
    EXPECT_EQ(expected.getName(), actual.getName());
    EXPECT_EQ(expected.getTransformRotationOrder(), actual.getTransformRotationOrder());
    for (int i = 0; i <= Transform::kFbxTransformPivotZ; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(i);
        expectSameChannel(*expected.getTransformChannel(channel), *actual.getTransformChannel(channel),
                          expected.getName() + "." + Transform::getTransformChannelName(channel), tolerance);
    }
}

/// Samples of 1001 to 1005 that bend, and their static value: that of the first frame, which reads use.
template <class Object, class Channel>
void animate(Object& object, Channel channel, float from, float step) {
    TnFbxTime time;
    time.setTime(1001.0f, 1001, 1005, kTelevision);
    const std::vector<float> samples = {from, from + step, from + 3.0f * step, from + 3.0f * step, from + 2.0f * step};
    if constexpr (std::is_same_v<Channel, Transform::EFbxTransformChannelType>) {
        object.setTransformValue(channel, from);
        object.setTransformValueAt(channel, time, samples);
    } else {
        object.setValue(channel, from);
        object.setValueAt(channel, time, samples);
    }
}

void placeSomewhere(Transform& object, bool animated) {
    object.setTransformRotationOrder(Transform::kFbxRotationOrderYZX);
    const float values[] = {1.5f, -20.0f, 3.0f, 30.0f, -400.0f, 50.0f, 2.0f, 0.5f, 1.25f};
    for (int i = 0; i < 9; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(i);
        object.setTransformValue(channel, values[i]);
        if (animated)
            animate(object, channel, values[i], 0.25f);
    }
}

class EveryVersion : public testing::TestWithParam<std::tuple<Version, bool, bool>> {
protected:
    EveryVersion() : file(std::get<0>(GetParam()), std::get<1>(GetParam())), animated(std::get<2>(GetParam())) {
        file.info.setFPS(kTelevision);
        file.info.setStartFrame(1001.0f);
        file.info.setEndFrame(1005.0f);
    }
    template <class Object>
    FacadeRead<Object> readAtStart() const {
        TnFbxReadInfo info = file.readInfo();
        info.setFrame(1001.0f);
        return FacadeRead<Object>(info);
    }

    FaithfulFile file;
    bool animated;
};

TEST_P(EveryVersion, BringsNullsAndTransformsBack) {
    TnFbxNull null;
    null.setName("null");
    null.setNullSize(7.5f);
    null.setNullLookType(TnFbxNull::kFbxNullLookNone);
    placeSomewhere(null, animated);
    Transform transform;
    transform.setName("bone");
    placeSomewhere(transform, animated);
    file.write({{}, {}, {&transform}, {&null}, {}});
    EXPECT_EQ(file.warningText(), "");

    auto nulls = readAtStart<TnFbxNull>();
    expectSameTransform(null, nulls["null"]);
    EXPECT_EQ(nulls["null"].getNullSize(), 7.5f);
    EXPECT_EQ(nulls["null"].getNullLookType(), TnFbxNull::kFbxNullLookNone);
    auto transforms = readAtStart<Transform>();
    EXPECT_EQ(transforms.names(), (std::vector<std::string>{"bone", "null"}));
    expectSameTransform(transform, transforms["bone"]);
}

TEST_P(EveryVersion, BringsSkewsBack) {
    Transform object;
    object.setName("askew");
    placeSomewhere(object, animated);
    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(Transform::kFbxTransformSkewX + i);
        object.setTransformValue(channel, 0.5f - 0.25f * static_cast<float>(i));
        if (animated)
            animate(object, channel, 0.5f - 0.25f * static_cast<float>(i), 0.1f);
    }
    file.write({{}, {}, {&object}, {}, {}});
    // Angles within a turn: the node's own are not those of the object.
    object.setTransformValue(Transform::kFbxTransformRotationY, -40.0f);
    if (animated)
        animate(object, Transform::kFbxTransformRotationY, -40.0f, 0.25f);
    auto read = readAtStart<Transform>();
    EXPECT_EQ(read.names(), (std::vector<std::string>{"askew skew", "askew"}));
    expectSameTransform(object, read["askew"], 2e-4f);
}

TEST_P(EveryVersion, BringsLightsBack) {
    for (const auto type : {TnFbxLight::kFbxLightPoint, TnFbxLight::kFbxLightDirectional, TnFbxLight::kFbxLightSpot}) {
        TnFbxLight light;
        light.setName("light");
        light.setLightType(type);
        light.setDecayType(TnFbxLight::kFbxLightDecayLinear);
        placeSomewhere(light, animated);
        const float values[] = {0.25f, 0.5f, 0.75f, 1.0f, 0.3f, 35.0f};
        for (int i = 0; i < 6; ++i) {
            const auto channel = static_cast<TnFbxLight::EFbxLightChannelType>(i);
            light.setValue(channel, values[i]);
            if (animated && channel != TnFbxLight::kFbxLightAlpha)
                animate(light, channel, values[i], 0.0625f);
        }
        file.write({{}, {&light}, {}, {}, {}});
        EXPECT_EQ(file.warningText(), "");

        auto lights = readAtStart<TnFbxLight>();
        TnFbxLight& read = lights["light"];
        expectSameTransform(light, read);
        EXPECT_EQ(read.getLightType(), type);
        EXPECT_EQ(read.getDecayType(), TnFbxLight::kFbxLightDecayLinear);
        for (int i = 0; i < 6; ++i) {
            const auto channel = static_cast<TnFbxLight::EFbxLightChannelType>(i);
            expectSameChannel(*light.getLightChannel(channel), *read.getLightChannel(channel),
                              TnFbxLight::getChannelName(channel), 1e-5f);
        }
    }
}

double radians(double degrees) { return degrees * 0.017453292519943295769; }

/// Lens, film and angles that are consistent at every frame, so that each of them can be read back.
void setLens(Camera& camera, Camera::EFbxCameraApertureMode mode, bool animated) {
    camera.setApertureMode(mode);
    camera.setValue(Camera::kFbxCameraApertureWidth, 1.0f);
    camera.setValue(Camera::kFbxCameraApertureHeight, 0.5f);
    const auto angle = [](double inches, float focalLength) {
        return static_cast<float>(2.0 * std::atan(inches * 12.7 / static_cast<double>(focalLength)) / radians(1.0));
    };
    const bool vertical = mode == Camera::kFbxApertureVertical;
    const std::vector<float> focalLengths = animated ? std::vector<float>{35, 40, 50, 50, 45} : std::vector<float>{35};
    std::vector<float> both, x, y;
    for (const float focalLength : focalLengths) {
        x.push_back(angle(1.0, focalLength));
        y.push_back(angle(0.5, focalLength));
        both.push_back(vertical ? y.back() : x.back());
    }
    TnFbxTime time;
    time.setTime(1001.0f, 1001, 1005, kTelevision);
    const auto set = [&](Camera::EFbxCameraChannelType channel, const std::vector<float>& values) {
        camera.setValue(channel, values[0]);
        if (animated)
            camera.setValueAt(channel, time, values);
    };
    set(Camera::kFbxCameraFocalLength, focalLengths);
    set(Camera::kFbxCameraFieldOfView, both);
    set(Camera::kFbxCameraFieldOfViewX, x);
    set(Camera::kFbxCameraFieldOfViewY, y);
}

TEST_P(EveryVersion, BringsCamerasBack) {
    for (int mode = 0; mode < 4; ++mode) {
        Camera camera;
        camera.setName("shotCam");
        placeSomewhere(camera, animated);
        setLens(camera, static_cast<Camera::EFbxCameraApertureMode>(mode), animated);
        const std::pair<Camera::EFbxCameraChannelType, float> values[] = {
            {Camera::kFbxCameraLookAtPositionX, 3.0f}, {Camera::kFbxCameraLookAtPositionY, -4.0f},
            {Camera::kFbxCameraLookAtPositionZ, 5.0f}, {Camera::kFbxCameraUpPositionX, 0.25f},
            {Camera::kFbxCameraUpPositionY, 0.5f},     {Camera::kFbxCameraUpPositionZ, 0.125f},
            {Camera::kFbxCameraRoll, 12.0f},           {Camera::kFbxCameraNearPlane, 0.5f},
            {Camera::kFbxCameraFarPlane, 5000.0f},     {Camera::kFbxCameraFilmOffsetX, 0.1f},
            {Camera::kFbxCameraFilmOffsetY, -0.2f}};
        for (const auto& [channel, value] : values) {
            camera.setValue(channel, value);
            if (animated)
                animate(camera, channel, value, 0.5f);
        }
        file.write({{&camera}, {}, {}, {}, {}});
        EXPECT_EQ(file.warningText(), "");

        auto cameras = readAtStart<Camera>();
        EXPECT_EQ(cameras.names(), std::vector<std::string>{"shotCam"});
        Camera& read = cameras["shotCam"];
        expectSameTransform(camera, read);
        EXPECT_EQ(static_cast<int>(read.getApertureMode()), mode);
        EXPECT_EQ(read.getProjectionType(), Camera::kFbxCameraPerspective);
        for (int i = 0; i <= Camera::kFbxCameraFilmOffsetY; ++i) {
            const auto channel = static_cast<Camera::EFbxCameraChannelType>(i);
            expectSameChannel(*camera.getCameraChannel(channel), *read.getCameraChannel(channel),
                              std::string(Camera::getChannelName(channel)) + " in mode " + std::to_string(mode), 1e-4f);
        }
    }
}

TEST_P(EveryVersion, BringsMeshesBack) {
    auto mesh = polygonMesh("mesh", 4);
    placeSomewhere(*mesh, animated);
    mesh->setValidNormals(true);
    mesh->setValidUVs(true);
    mesh->setValidColours(true);
    for (int i = 0; i < 4; ++i) {
        const auto number = static_cast<float>(i);
        mesh->setNormal(i, 0.0f, 0.6f, 0.8f);
        mesh->setUV(i, 0.25f * number, 0.5f);
        mesh->setColour(i, 0.25f * number, 0.5f, 0.75f, 0.125f);
    }
    file.write({{}, {}, {}, {}, {mesh.get()}});
    EXPECT_EQ(file.warningText(), "");

    auto meshes = readAtStart<TnFbxMesh>();
    TnFbxMesh& read = meshes["mesh"];
    expectSameTransform(*mesh, read);
    EXPECT_EQ(pointsOf(read), pointsOf(*mesh));
    ASSERT_EQ(read.getNumberOfPolygonVertices(), 4);
    EXPECT_TRUE(read.getValidNormals() && read.getValidUVs() && read.getValidColours());
    for (int i = 0; i < 4; ++i) {
        float x = 0, y = 0, z = 0, w = 0;
        read.getNormal(i, x, y, z);
        EXPECT_NEAR(y, 0.6f, 1e-6f);
        read.getUV(i, x, y);
        EXPECT_EQ(x, 0.25f * static_cast<float>(i));
        read.getColour(i, x, y, z, w);
        EXPECT_EQ(x, 0.25f * static_cast<float>(i));
        EXPECT_EQ(w, 0.125f);
    }
}

TEST_P(EveryVersion, BringsMovingPointsBack) {
    for (const bool maya : {true, false}) {
        auto mesh = movingMesh("mesh", 5);
        placeSomewhere(*mesh, animated);
        file.info.setMayaVertexCacheFormat(maya);
        file.write({{}, {}, {}, {}, {mesh.get()}});
        EXPECT_EQ(file.warningText(), "");
        for (int frame = 1001; frame <= 1005; ++frame) {
            TnFbxReadInfo info = file.readInfo();
            info.setFrame(static_cast<float>(frame));
            const Samples points = pointsOf(FacadeRead<TnFbxMesh>(info)["mesh"]);
            // Maya caches count in 6000ths of a second, of which a frame of television has 250.25.
            EXPECT_NEAR(points[5], static_cast<float>(frame - 1001), maya ? 3e-3f : 1e-5f) << frame;
        }
    }
}

std::string caseName(const testing::TestParamInfo<EveryVersion::ParamType>& info) {
    constexpr const char* kYears[] = {"2010", "2011", "2012", "2013", "2014", "2016"};
    return std::string("Of") + kYears[std::get<0>(info.param)] + (std::get<1>(info.param) ? "Ascii" : "Binary") +
           (std::get<2>(info.param) ? "Animated" : "Still");
}
INSTANTIATE_TEST_SUITE_P(
    FaithfulWriting, EveryVersion,
    testing::Combine(testing::Values(TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2011,
                                     TnFbxWriteInfo::kFbxVersion2012, TnFbxWriteInfo::kFbxVersion2013,
                                     TnFbxWriteInfo::kFbxVersion2014, TnFbxWriteInfo::kFbxVersion2016),
                     testing::Bool(), testing::Bool()),
    caseName);

// ---- The file around the objects ----

std::vector<std::string> stacksOf(const FaithfulFile& file) {
    std::vector<std::string> stacks, nodes;
    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(file.info.getFileName().c_str(), 0x4000, stacks, nodes));
    return stacks;
}

TEST(FaithfulWriting, NamesTheStackAsAsked) {
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2016}) {
        FaithfulFile file(version);
        file.info.setAnimationStackName("shot 010 | comp");
        TnFbxNull null;
        null.setName("null");
        animate(null, Transform::kFbxTransformPositionX, 0.0f, 1.0f);
        file.write({{}, {}, {}, {&null}, {}});
        EXPECT_EQ(stacksOf(file), std::vector<std::string>{"shot 010 | comp"});
    }
}

TEST(FaithfulWriting, KeepsTheRateAndTheSpan) {
    constexpr float kRates[] = {23.976f, 24.0f,  25.0f, 29.97f, 30.0f,       48.0f, 50.0f, 59.94f, 60.0f,  119.88f,
                                120.0f,  100.0f, 12.0f, 15.0f,  kTelevision, 72.0f, 96.0f, 12.5f,  1000.0f};
    for (int version = 0; version < 6; ++version) {
        for (const bool ascii : {false, true}) {
            for (const float rate : kRates) {
                FaithfulFile file(static_cast<Version>(version), ascii);
                file.info.setFPS(rate);
                file.info.setStartFrame(1001.0f);
                file.info.setEndFrame(1010.0f);
                TnFbxNull null;
                null.setName("null");
                TnFbxTime time;
                time.setTime(1003.0f, 1003, 1004, rate);
                null.setTransformValueAt(Transform::kFbxTransformPositionX, time, {1.0f, 2.0f});
                file.write({{}, {}, {}, {&null}, {}});
                EXPECT_EQ(file.warningText(), "");
                const TnFbxTime read =
                    file.read<TnFbxNull>()["null"].getTransformTime(Transform::kFbxTransformPositionX);
                EXPECT_NEAR(read.getFrameRate(), rate, 2e-4f) << version;
                EXPECT_EQ(read.getStartFrame(), 1001) << rate << " in " << version;
                EXPECT_EQ(read.getEndFrame(), 1010) << rate << " in " << version;
            }
        }
    }
}

TEST(FaithfulWriting, CountsTelevisionRatesByTheirFractions) {
    FaithfulFile file;
    file.info.setFPS(29.97f);
    TnFbxNull null;
    null.setName("null");
    TnFbxTime time;
    time.setTime(0.0f, 30000, 30001, 29.97f);
    null.setTransformValueAt(Transform::kFbxTransformPositionX, time, {1.0f, 2.0f});
    file.write({{}, {}, {}, {&null}, {}});
    float start = 0.0f, end = 0.0f;
    ASSERT_TRUE(Fbx().getAnimationFrameRange(file.info.getFileName().c_str(), start, end));
    EXPECT_NEAR(start, 1001.0f, 1e-3f);
}

TEST(FaithfulWriting, HasNothingThatWasNotRequested) {
    for (int version = 0; version < 6; ++version) {
        FaithfulFile file(static_cast<Version>(version), /*ascii*/ true);
        TnFbxNull null;
        null.setName("null");
        file.write({{}, {}, {}, {&null}, {}});
        const std::string text = file.bytes();
        EXPECT_EQ(text.find("\"Model::Producer"), std::string::npos) << version;
        EXPECT_EQ(text.find("\"Model::Camera Switcher"), std::string::npos) << version;
        EXPECT_EQ(text.find("\"CameraSwitcher\""), std::string::npos) << version;
        EXPECT_EQ(text.find("FogEnable: 1"), std::string::npos) << version;
        EXPECT_EQ(text.find("0.5,0.2"), std::string::npos) << version; // an orange
    }
}

TEST(FaithfulWriting, GivesANewCameraAFilmOfMillimetres) {
    FaithfulFile file;
    Camera camera;
    camera.setName("camera");
    file.write({{&camera}, {}, {}, {}, {}});
    auto read = file.read<Camera>();
    EXPECT_NEAR(read["camera"].getValue(Camera::kFbxCameraApertureWidth), 24.576f / 25.4f, 1e-6f);
    EXPECT_NEAR(read["camera"].getValue(Camera::kFbxCameraApertureHeight), 18.672f / 25.4f, 1e-6f);
    EXPECT_EQ(read["camera"].getValue(Camera::kFbxCameraFocalLength), 50.0f);
}

TEST(FaithfulWriting, TurnsACameraWithoutARotationTowardItsPoint) {
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2016}) {
        FaithfulFile file(version);
        Camera camera;
        camera.setName("camera");
        camera.setTransformValue(Transform::kFbxTransformPositionZ, 10.0f);
        camera.setValue(Camera::kFbxCameraLookAtPositionX, 10.0f);
        camera.setValue(Camera::kFbxCameraLookAtPositionZ, 10.0f);
        camera.setValue(Camera::kFbxCameraRoll, 20.0f);
        file.write({{&camera}, {}, {}, {}, {}});
        EXPECT_NE(file.warningText().find("rotation that aims it at the point"), std::string::npos);

        auto read = file.read<Camera>();
        EXPECT_EQ(read["camera"].getValue(Camera::kFbxCameraLookAtPositionX), 10.0f);
        EXPECT_EQ(read["camera"].getValue(Camera::kFbxCameraRoll), 20.0f);
        float angles[3] = {};
        camera.calculateCameraRotationAt(angles[0], angles[1], angles[2], 0.0f); // in the order of new objects
        EXPECT_THAT(rotationOf(read["camera"]),
                    testing::Pointwise(testing::FloatNear(1e-3f), {angles[0], angles[1], angles[2]}));
    }
}

TEST(FaithfulWriting, LeavesARotationThatIsSetAlone) {
    FaithfulFile file;
    Camera camera;
    camera.setName("camera");
    camera.setTransformValue(Transform::kFbxTransformRotationY, 45.0f);
    camera.setValue(Camera::kFbxCameraLookAtPositionX, 10.0f);
    file.write({{&camera}, {}, {}, {}, {}});
    EXPECT_EQ(file.warningText(), "");
    EXPECT_THAT(rotationOf(file.read<Camera>()["camera"]), isNear({0.0f, 45.0f, 0.0f}));
    EXPECT_EQ(file.read<Transform>().count, 1);
}

TEST(FaithfulWriting, DoesNotRollTwiceWhatATargetTurned) {
    FaithfulFile first, second;
    Camera camera;
    camera.setName("camera");
    camera.setValue(Camera::kFbxCameraLookAtPositionX, 10.0f);
    camera.setValue(Camera::kFbxCameraRoll, 20.0f);
    first.write({{&camera}, {}, {}, {}, {}});
    auto read = first.read<Camera>();
    second.write({{&read["camera"]}, {}, {}, {}, {}});
    EXPECT_EQ(second.warningText(), "");
    auto again = second.read<Camera>();
    EXPECT_THAT(rotationOf(again["camera"]), isNear(rotationOf(read["camera"])));
    EXPECT_EQ(again["camera"].getValue(Camera::kFbxCameraRoll), 20.0f);
    EXPECT_EQ(second.read<Transform>().names(), (std::vector<std::string>{"camera", "camera target"}));
}

TEST(FaithfulWriting, WritesWhatAReadPlacedWhereItWas) {
    FaithfulFile first, second;
    auto mesh = polygonMesh("mesh", 4);
    placeSomewhere(*mesh, false);
    mesh->setTransformValue(Transform::kFbxTransformScaleX, -2.0f); // a mirror
    mesh->setValidNormals(true);
    for (int i = 0; i < 4; ++i)
        mesh->setNormal(i, 0.0f, 0.6f, 0.8f);
    first.write({{}, {}, {}, {}, {mesh.get()}});
    FacadeRead<TnFbxMesh> placed(faithfulRead(first.info.getFileName()));
    second.write({{}, {}, {}, {}, {&placed["mesh"]}});
    FacadeRead<TnFbxMesh> again(faithfulRead(second.info.getFileName()));
    EXPECT_THAT(pointsOf(again["mesh"]), testing::Pointwise(testing::FloatNear(1e-4f), pointsOf(placed["mesh"])));
    auto own = second.read<TnFbxMesh>();
    EXPECT_THAT(pointsOf(own["mesh"]), testing::Pointwise(testing::FloatNear(1e-4f), pointsOf(*mesh)));
    expectSameTransform(*mesh, own["mesh"]);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(again["mesh"].getPointIndex(i), placed["mesh"].getPointIndex(i));
        EXPECT_EQ(own["mesh"].getPointIndex(i), mesh->getPointIndex(i));
        float a[3] = {}, b[3] = {};
        again["mesh"].getNormal(i, a[0], a[1], a[2]);
        placed["mesh"].getNormal(i, b[0], b[1], b[2]);
        EXPECT_NEAR(a[0], b[0], 1e-5f);
        EXPECT_NEAR(a[2], b[2], 1e-5f);
    }
}

TEST(FaithfulWriting, WritesMeshesThatShareTheirArraysAsOne) {
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2016}) {
        FaithfulFile file(version);
        auto first = polygonMesh("first", 4);
        TnFbxMesh second(*first), changed(*first);
        second.setName("second");
        second.setTransformValue(Transform::kFbxTransformPositionX, 5.0f);
        changed.setName("changed");
        changed.setControlPoint(0, 77.0f, 0.0f, 0.0f);
        file.write({{}, {}, {}, {}, {first.get(), &second, &changed}});
        EXPECT_EQ(file.warningText(), "");

        FbxFaithful reader;
        ASSERT_TRUE(reader.load(file.readInfo())) << lastError();
        fbxsdk::FbxScene& scene = *reader.getScene();
        EXPECT_EQ(scene.GetSrcObjectCount(fbxsdk::FbxCriteria::ObjectType(fbxsdk::FbxMesh::ClassId)), 2);
        EXPECT_EQ(scene.GetRootNode()->GetChild(1)->GetMesh(), scene.GetRootNode()->GetChild(0)->GetMesh());
        auto read = file.read<TnFbxMesh>();
        ASSERT_EQ(read.names(), (std::vector<std::string>{"first", "second", "changed"}));
        EXPECT_EQ(pointsOf(read["second"]), pointsOf(*first));
        EXPECT_EQ(pointsOf(read["changed"]), pointsOf(changed));
        expectSameTransform(second, read["second"]);
    }
}

TEST(FaithfulWriting, GivesMeshesOfOneNameTheirOwnCaches) {
    FaithfulFile file;
    file.info.setStartFrame(1.0f);
    file.info.setEndFrame(3.0f);
    auto a = movingMesh("mesh", 3), b = movingMesh("mesh", 3), c = movingMesh("Mesh", 3);
    b->setControlPoint(0, 77.0f, 0.0f, 0.0f);
    file.write({{}, {}, {}, {}, {a.get(), b.get(), c.get()}});
    EXPECT_EQ(file.warningText(), "");
    TnFbxReadInfo info = file.readInfo();
    info.setFrame(1.0f);
    FacadeRead<TnFbxMesh> read(info);
    ASSERT_EQ(read.count, 3);
    EXPECT_EQ(pointsOf(read.objects[0])[0], 0.0f);
    EXPECT_EQ(pointsOf(read.objects[1])[0], 77.0f);
    EXPECT_EQ(pointsOf(read.objects[2])[0], 0.0f);
}

TEST(FaithfulWriting, GivesAStillMeshNoCache) {
    FaithfulFile file;
    file.info.setStartFrame(1.0f);
    file.info.setEndFrame(3.0f);
    auto still = polygonMesh("still");
    auto moving = movingMesh("moving", 2);
    file.write({{}, {}, {}, {}, {still.get(), moving.get()}});
    EXPECT_NE(file.warningText().find("moving: it does not have one set of control points"), std::string::npos);
    EXPECT_FALSE(
        std::filesystem::exists(file.info.getFileName().substr(0, file.info.getFileName().size() - 4) + "_fpc"));
    EXPECT_EQ(file.read<TnFbxMesh>().count, 2);
}

TEST(FaithfulWriting, WritesMeshesWithoutPolygons) {
    FaithfulFile source;
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2016}) {
        FaithfulFile file(version);
        TnFbxMesh mesh;
        mesh.setName("nothing");
        file.write({{}, {}, {}, {}, {&mesh}});
        EXPECT_EQ(file.read<TnFbxMesh>().names(), std::vector<std::string>{"nothing"});
    }
}

TEST(FaithfulWriting, DistinguishesObjectsOfOneNameInTheOldestVersion) {
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2011}) {
        FaithfulFile file(version);
        TnFbxNull a, b;
        a.setName("same");
        b.setName("same");
        animate(a, Transform::kFbxTransformPositionX, 1.0f, 1.0f);
        animate(b, Transform::kFbxTransformPositionX, 100.0f, 1.0f);
        file.write({{}, {}, {}, {&a, &b}, {}});
        TnFbxReadInfo info = file.readInfo();
        info.setFrame(1001.0f);
        info.setUseSampleFPS(true);
        info.setSampleFPS(kTelevision);
        FacadeRead<TnFbxNull> read(info);
        ASSERT_EQ(read.count, 2);
        EXPECT_NEAR(positionOf(read.objects[0])[0], 1.0f, 1e-4f);
        EXPECT_NEAR(positionOf(read.objects[1])[0], 100.0f, 1e-4f);
        const bool oldest = version == TnFbxWriteInfo::kFbxVersion2010;
        EXPECT_EQ(read.objects[0].getName() != read.objects[1].getName(), oldest);
        EXPECT_EQ(file.warningText().find("are numbered") != std::string::npos, oldest) << file.warningText();
    }
}

TEST(FaithfulWriting, ReportsWhatFilesCannotExpress) {
    FaithfulFile file;
    TnFbxLight light;
    light.setName("light");
    light.setValue(TnFbxLight::kFbxLightAlpha, 0.5f);
    light.setTransformValue(Transform::kFbxTransformPivotX, 1.0f);
    file.write({{}, {&light}, {}, {}, {}});
    EXPECT_NE(file.warningText().find("alpha"), std::string::npos);
    EXPECT_NE(file.warningText().find("pivots"), std::string::npos);
}

TEST(FaithfulWriting, WritesTheRequestedKindsOnly) {
    FaithfulFile file;
    TnFbxNull null;
    null.setName("null");
    Camera camera;
    camera.setName("camera");
    file.info.setWriteCameras(false);
    file.write({{&camera, nullptr}, {}, {}, {nullptr, &null}, {}});
    EXPECT_EQ(file.read<Transform>().names(), std::vector<std::string>{"null"});
}

} // namespace
} // namespace Tarnell::Fbx::test
