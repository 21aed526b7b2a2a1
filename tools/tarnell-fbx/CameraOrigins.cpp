// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "CameraOrigins.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>

#include "PropertyValues.h"
#include "SceneFacts.h"

namespace tool {
namespace {

std::string withMinus(std::string text) { return !text.empty() && text.front() == '-' ? "−" + text.substr(1) : text; }

const FbxCamera& cameraOf(const CameraFacts& facts) { return *facts.node->GetCamera(); }

bool isNamed(const FbxProperty& property, std::initializer_list<const char*> names) {
    const std::string name = property.GetName().Buffer();
    return std::any_of(names.begin(), names.end(), [&](const char* each) { return name == each; });
}

bool drivesLens(const CameraFacts& facts, const FbxProperty& property) {
    switch (facts.driver) {
    case LensDriver::focalLength:
        return isNamed(property, {"FocalLength"});
    case LensDriver::horizontalAngle:
    case LensDriver::verticalAngle:
        return isNamed(property, {"FieldOfView"});
    case LensDriver::twoAngles:
        return isNamed(property, {"FieldOfViewX", "FieldOfViewY"});
    }
    return false;
}

bool isZero(const Vector3& vector) { return vector == Vector3{}; }

/// Rotates about X, then Y, then Z, as pre- and post-rotations do.
FbxAMatrix turnOf(const Vector3& angles) {
    FbxAMatrix turn;
    turn.SetR(FbxVector4(angles[0], angles[1], angles[2]));
    return turn;
}

/// With the digits of a float; `props` prints all of them.
std::string shortText(double number) { return significant(number + 0.0, 7); }

std::string shortText(const FbxProperty& property) {
    switch (property.GetPropertyDataType().GetType()) {
    case eFbxDouble:
        return shortText(property.Get<FbxDouble>());
    case eFbxDouble3: {
        const auto vector = property.Get<FbxDouble3>();
        return '(' + shortText(vector[0]) + ", " + shortText(vector[1]) + ", " + shortText(vector[2]) + ')';
    }
    default:
        return valueText(property);
    }
}

std::string withUnit(const FbxProperty& property, const char* unit) {
    return std::string(property.GetName().Buffer()) + ' ' + shortText(property) + unit;
}

// ---- Values without effect ----

class IdleList {
public:
    explicit IdleList(const CameraFacts& facts) : mFacts(facts), mCamera(cameraOf(facts)) {}

    std::vector<IdleValue> take() {
        addLens();
        addFilm();
        addAim();
        addTurns();
        return std::move(mValues);
    }

private:
    void add(const FbxProperty& property, std::string reason) {
        const std::string value = valueText(property);
        const bool isReal = property.GetPropertyDataType().GetType() == eFbxDouble;
        mValues.push_back({property.GetHierarchicalName().Buffer(), value, std::move(reason),
                           isReal ? rounded(property.Get<FbxDouble>(), 4) : shortText(property)});
    }
    void addUnless(double expected, const char* name, const std::string& reason) {
        const FbxProperty property = mCamera.FindProperty(name);
        if (property.IsValid() && property.Get<FbxDouble>() != expected)
            add(property, reason);
    }

    void addLens() {
        const std::string reason = std::string("the lens is driven by ") + driverText(mFacts.driver);
        const FbxProperty all[] = {mCamera.FieldOfView, mCamera.FieldOfViewX, mCamera.FieldOfViewY,
                                   mCamera.FocalLength};
        for (const FbxProperty& property : all)
            if (mFacts.orthographic)
                add(property, "orthographic cameras have no lens");
            else if (!drivesLens(mFacts, property))
                add(property, reason);
    }

    void addFilm() {
        if (mFacts.driver == LensDriver::twoAngles)
            add(mCamera.FilmHeight, "the film height follows from the film width and the two angles");
        const double width = mCamera.FilmWidth.Get(), height = mCamera.FilmHeight.Get();
        constexpr double kTolerance = 1e-3;
        if (std::abs(mCamera.FilmAspectRatio.Get() - width / height) > kTolerance)
            add(mCamera.FilmAspectRatio, "width and height of the film are " + rounded(width / height, 4) + ":1");
        const auto format = filmFormat(mCamera.FilmFormat.Get<FbxInt>());
        if (format && knownGate({width, height}) != format->name)
            add(mCamera.FilmFormat, std::string(format->name) + " would be " + filmText(format->film));
        const std::string unused =
            "it shifts or scales the image in the application that wrote the file, but is not applied here";
        for (const char* name :
             {"OpticalCenterX", "OpticalCenterY", "FilmTranslateX", "FilmTranslateY", "FilmRollValue"})
            addUnless(0.0, name, unused);
        addUnless(1.0, "PreScale", unused);
        if (!mFacts.orthographic)
            addUnless(1.0, "OrthoZoom", "the camera is perspective");
    }

    void addAim() {
        if (!mFacts.hasTarget)
            addUnless(0.0, "Roll", "the node rotates the camera; Roll applies to cameras with a target");
        else if (mFacts.node->LclRotation.Get() != FbxDouble3(0.0, 0.0, 0.0))
            add(mFacts.node->LclRotation, "the target determines the rotation of the camera");
    }

    void addTurns() {
        if (mFacts.rotationActive)
            return;
        for (const auto& [name, turn] :
             {std::pair("PreRotation", &mFacts.preRotation), std::pair("PostRotation", &mFacts.postRotation)})
            if (!isZero(*turn))
                mValues.push_back({name, vectorText(*turn, 6), "RotationActive is off", vectorText(*turn, 3)});
    }

    const CameraFacts& mFacts;
    const FbxCamera& mCamera;
    std::vector<IdleValue> mValues;
};

// ---- The origin of numbers ----

class OriginList {
public:
    OriginList(const CameraFacts& facts, const CameraMoment& moment, const SceneFile& file)
        : mFacts(facts), mMoment(moment), mFile(file), mCamera(cameraOf(facts)) {}

    std::vector<Origin> take() {
        if (!mFacts.orthographic)
            addLens();
        addFilm();
        addAngles();
        addPicture();
        addPlanes();
        addPlace();
        addDirection();
        return std::move(mList);
    }

private:
    void add(const char* what, std::string text) { mList.push_back({what, std::move(text)}); }

    std::string formula(const char* property, double degrees, double inches) const {
        return std::string(property) + ' ' + rounded(degrees, 6) + "° over " +
               inDecimals(inches * kMillimetresPerInch, 3) +
               " mm of film: " + inDecimals(inches * kMillimetresPerInch, 3) + " / (2 · tan(" +
               inDecimals(degrees / 2.0, 3) + "°)) = " + significant(mMoment.focalLength, 6) + " mm";
    }

    void addLens() {
        const std::string mode = withUnit(mCamera.ApertureMode, ": ");
        switch (mFacts.driver) {
        case LensDriver::focalLength:
            return add("Focal length",
                       stated(mCamera.FocalLength, " mm") + ", unchanged; " + mode + "the focal length drives");
        case LensDriver::horizontalAngle:
            return add("Focal length", formula("FieldOfView", mMoment.fovX, mMoment.film.width) + "; " + mode +
                                           "the horizontal angle drives");
        case LensDriver::verticalAngle:
            return add("Focal length", formula("FieldOfView", mMoment.fovY, mMoment.film.height) + "; " + mode +
                                           "the vertical angle drives");
        case LensDriver::twoAngles:
            return add("Focal length", formula("FieldOfViewX", mMoment.fovX, mMoment.film.width) + "; " + mode +
                                           "both angles drive, and FieldOfViewY determines the film height");
        }
    }

    /// Where there are keys the property itself is of little interest.
    std::string stated(const FbxProperty& property, const char* unit) const {
        const std::string name = property.GetHierarchicalName().Buffer();
        const bool keyed = std::any_of(mFacts.channels.begin(), mFacts.channels.end(), [&](const CameraChannel& each) {
            return each.property.compare(0, name.size(), name) == 0 &&
                   (each.property.size() == name.size() || each.property[name.size()] == '.');
        });
        return keyed ? std::string(property.GetName().Buffer()) + " (keyed; static value " + shortText(property) +
                           unit + ")"
                     : withUnit(property, unit);
    }

    void addFilm() {
        add("Film back", stated(mCamera.FilmWidth, " in") + " × FilmSqueezeRatio " + shortText(mFacts.squeeze) + ", " +
                             stated(mCamera.FilmHeight, " in") + "; × 25.4 mm per inch");
        if (mMoment.offsetX != 0.0 || mMoment.offsetY != 0.0)
            add("Film offset", stated(mCamera.FilmOffsetX, " in") + ", " + stated(mCamera.FilmOffsetY, " in"));
    }

    void addAngles() {
        if (mFacts.orthographic) {
            const std::string rule = mFacts.ortho->isBlenders
                                         ? ", which Blender writes as the width, × the camera's scale " +
                                               rounded(std::abs(mFacts.scale[0]), 6)
                                         : std::string(" × 30, the width at zoom 1 in Maya's files");
            return add("Ortho width", withUnit(mCamera.OrthoZoom, "") + rule + ", × " + rounded(unit(), 6) + " cm");
        }
        const auto angle = [this](double inches, double degrees) {
            return "2 · atan(" + inDecimals(inches * kMillimetresPerInch, 3) + " / (2 · " +
                   significant(mMoment.focalLength, 6) + ")) = " + inDecimals(degrees, 3) + "°";
        };
        add("FOV of film", angle(mMoment.film.width, mMoment.fovX) + ", " + angle(mMoment.film.height, mMoment.fovY));
    }

    void addPicture() {
        if (mFacts.pictureAspect <= 0.0)
            return add("Picture", "the file states no resolution: the picture has the shape of the film");
        std::string text = withUnit(mCamera.AspectWidth, "") + " : " + withUnit(mCamera.AspectHeight, "") +
                           " × PixelAspectRatio " + shortText(mFacts.pixelAspect) + " (" + aspectModeText() +
                           ") = " + rounded(mFacts.pictureAspect, 4) + ":1";
        if (!mFacts.orthographic) // which have a width of their own
            text += "; the film is " + rounded(mMoment.film.aspect(), 4) + ":1; " + withUnit(mCamera.GateFit, "") +
                    ": " + fitText();
        add("Picture", std::move(text));
    }

    std::string aspectModeText() const {
        constexpr std::array<const char*, 5> kTexts = {
            "AspectRatioMode 0: the size of a window", "AspectRatioMode 1: an aspect ratio",
            "AspectRatioMode 2: a resolution", "AspectRatioMode 3: the height is relative to the width",
            "AspectRatioMode 4: the width is relative to the height"};
        const auto mode = static_cast<std::size_t>(mFacts.aspectMode);
        return mode < kTexts.size() ? kTexts[mode] : "AspectRatioMode " + std::to_string(mFacts.aspectMode);
    }

    std::string fitText() const {
        const bool keepsWidth = mMoment.picture.width == mMoment.film.width;
        const bool keepsHeight = mMoment.picture.height == mMoment.film.height;
        const std::string name = gateFitName(mFacts.gateFit);
        if (mFacts.gateFit == GateFit::none)
            return "none, the whole film is used";
        if (keepsWidth && keepsHeight)
            return name + ", picture and film have the same aspect ratio";
        return name +
               (keepsWidth ? ", the width of the film is kept and the picture covers "
                           : ", the height of the film is kept and the picture covers ") +
               filmText(mMoment.picture) + " of the film plane";
    }

    void addPlanes() {
        add("Clip planes",
            withUnit(mCamera.NearPlane, "") + ", " + withUnit(mCamera.FarPlane, "") + " in the file's unit, × " +
                rounded(unit(), 6) + " cm" +
                (autoPlanes() ? "; AutoComputeClipPanes is on: the application may use other planes" : ""));
    }

    bool autoPlanes() const {
        const FbxProperty property = mCamera.FindProperty("AutoComputeClipPanes");
        return property.IsValid() && property.Get<FbxBool>();
    }

    void addPlace() {
        const Axes axes = axesOf(mFile.scene().GetGlobalSettings().GetAxisSystem());
        std::string text = stated(mFacts.node->LclTranslation, "");
        const FbxNode* parent = mFacts.node->GetParent();
        if (parent && parent->GetParent())
            text += " below \"" + std::string(parent->GetName()) + "\" and its ancestors";
        text += "; × " + rounded(unit(), 6) + " cm (" + unitName(unit()) + "); from " + axes.up + " up, " +
                axes.toViewer + " to the viewer" +
                (axes.up == "+Y" && axes.toViewer == "+Z" ? ", unchanged" : ", converted to +Y up");
        add("World", std::move(text));
    }

    void addDirection() {
        if (mFacts.hasTarget)
            return add("Direction", "aimed at \"" + mFacts.target + "\"; the rotation of the node is ignored");
        std::string text = "cameras in FBX files look along +X of their node; PreRotation " +
                           vectorText(mFacts.preRotation, 3) + " before and PostRotation " +
                           vectorText(mFacts.postRotation, 3) + " after the rotation are " +
                           (mFacts.rotationActive ? "in force" : "not in force (RotationActive is off)") +
                           ": rotation 0 looks along " + mFacts.restDirection;
        add("Direction", std::move(text));
        EFbxRotationOrder order = eEulerXYZ;
        mFacts.node->GetRotationOrder(FbxNode::eSourcePivot, order);
        constexpr std::array<const char*, 7> kOrders = {"XYZ", "XZY", "YZX", "YXZ", "ZXY", "ZYX", "spheric XYZ"};
        add("Rotation", stated(mFacts.node->LclRotation, " in degrees") + ", rotation order " +
                            (mFacts.rotationActive ? kOrders[static_cast<std::size_t>(order)] : "XYZ"));
    }

    double unit() const { return mFile.scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor(); }

    const CameraFacts& mFacts;
    const CameraMoment& mMoment;
    const SceneFile& mFile;
    const FbxCamera& mCamera;
    std::vector<Origin> mList;
};

} // namespace

bool isInForce(const CameraFacts& facts, const FbxProperty& property) {
    if (isNamed(property, {"FocalLength", "FieldOfView", "FieldOfViewX", "FieldOfViewY"}))
        return !facts.orthographic && drivesLens(facts, property);
    if (isNamed(property, {"FilmHeight"}))
        return facts.driver != LensDriver::twoAngles;
    if (isNamed(property, {"Lcl Rotation"}))
        return !facts.hasTarget;
    if (isNamed(property, {"Roll"}))
        return facts.hasTarget;
    return !isNamed(property, {"Position", "InterestPosition"}) &&
           (facts.hasTarget || !isNamed(property, {"UpVector"}));
}

std::string restDirection(const CameraFacts& facts) {
    FbxVector4 looks(1.0, 0.0, 0.0);
    if (facts.rotationActive)
        looks = turnOf(facts.preRotation).MultT(turnOf(facts.postRotation).Inverse().MultT(looks));
    constexpr double kTolerance = 1e-6;
    for (int axis = 0; axis < 3; ++axis)
        if (std::abs(std::abs(looks[axis]) - 1.0) < kTolerance)
            return std::string(looks[axis] < 0.0 ? "−" : "+") + "XYZ"[axis];
    return vectorText({looks[0], looks[1], looks[2]}, 3);
}

std::vector<IdleValue> idleValues(const CameraFacts& facts) { return IdleList(facts).take(); }

std::vector<Origin> originsOf(const CameraFacts& facts, const CameraMoment& moment, const SceneFile& file) {
    return OriginList(facts, moment, file).take();
}

std::string inDecimals(double number, int decimals) {
    char text[64];
    std::snprintf(text, sizeof text, "%.*f", decimals, number);
    return withMinus(text);
}

std::string rounded(double number, int decimals) {
    const double power = std::pow(10.0, decimals);
    const double near = std::round(number * power) / power;
    // + 0.0: avoids negative zero.
    return withMinus(numberText(std::isfinite(near) ? near + 0.0 : number));
}

std::string significant(double number, int digits) {
    char text[64];
    constexpr double kUsual = 1e15;
    if (std::abs(number) >= std::pow(10.0, digits) && std::abs(number) < kUsual)
        std::snprintf(text, sizeof text, "%.0f", number); // not 2e+05
    else
        std::snprintf(text, sizeof text, "%.*g", digits, number);
    return withMinus(text);
}

std::string vectorText(const Vector3& vector, int decimals) {
    return '(' + rounded(vector[0], decimals) + ", " + rounded(vector[1], decimals) + ", " +
           rounded(vector[2], decimals) + ')';
}

std::string filmText(const FilmSize& film) {
    return significant(film.width, 6) + " × " + significant(film.height, 6) + " in";
}

} // namespace tool
