// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The cameras of a file as data for the commands to print. Numbers come from a faithful read of the library, in
// centimetres and with Y up; their origin is determined by the file's own properties.
#pragma once

#include <array>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "FaithfulRead.h"
#include "FbxFaithful.h"
#include "Optics.h"
#include "SceneFile.h"
#include "TakeFacts.h"
#include "TnFbxCamera.h"

namespace tool {

using Vector3 = std::array<double, 3>;

/// A camera at one frame.
struct CameraMoment {
    double frame = 0.0, seconds = 0.0;
    double focalLength = 0.0;                    ///< millimetres
    FilmSize film;                               ///< inches, the width with the squeeze in it
    double fovX = 0.0, fovY = 0.0;               ///< of the film, degrees
    FilmSize picture;                            ///< the part of the film plane in the picture, inches
    double pictureFovX = 0.0, pictureFovY = 0.0; ///< degrees
    double offsetX = 0.0, offsetY = 0.0;         ///< of the film, inches
    double nearPlane = 0.0, farPlane = 0.0;      ///< centimetres
    double roll = 0.0;                           ///< degrees
    Vector3 position{};                          ///< in the world, centimetres, Y up
    Vector3 direction{}, up{};                   ///< in the world, unit length
    Vector3 interest{};                          ///< the target's position, or the point of interest

    [[nodiscard]] double interestDistance() const; ///< centimetres
    /// The angle between the viewing direction and the direction to the point; 0 at the point itself.
    [[nodiscard]] double interestAngle() const; ///< degrees
    /// To a degree.
    [[nodiscard]] bool looksAtInterest() const { return interestAngle() <= 1.0; }
};

/// A number that keys drive.
struct CameraChannel {
    std::string object, property; ///< "camera1", "Lcl Translation.X"
    bool inForce = true;          ///< whether the visible result depends on it
    int keys = 0;
    double firstFrame = 0.0, lastFrame = 0.0; ///< of its keys
    double low = 0.0, high = 0.0;             ///< of its keys
};

/// A value of the file without effect.
struct IdleValue {
    std::string property, value, reason;
    std::string shortValue; ///< rounded, for display
};

/// The origin of a number, one sentence each.
struct Origin {
    std::string what, text;
};

enum class LensDriver { focalLength, horizontalAngle, verticalAngle, twoAngles };

struct OrthoFacts {
    double zoom = 1.0;       ///< as the file has it
    double width = 0.0;      ///< the visible width, centimetres
    bool isBlenders = false; ///< the zoom is the width itself, in the camera's own scale
};

/// The data of a camera that does not depend on the frame.
class CameraFacts {
public:
    std::string name;
    FbxNode* node = nullptr; ///< of the opened file
    bool orthographic = false, stereo = false;
    LensDriver driver = LensDriver::focalLength;
    bool moves = false;       ///< its position or direction in the world changes
    bool lensChanges = false; ///< focal length, film or offset change
    std::string gate;         ///< name of the film back; empty when it has none
    double squeeze = 1.0;
    std::optional<OrthoFacts> ortho;
    std::array<double, 2> resolution{}; ///< as the file has it; zeros when it has none
    double pixelAspect = 1.0;
    int aspectMode = 0;
    bool resolutionStated = false; ///< false: the resolution is the default of the format
    double pictureAspect = 0.0;    ///< 0 where the file has no resolution: the picture is the film
    GateFit gateFit = GateFit::none;
    Vector3 scale{1.0, 1.0, 1.0}; ///< of the camera in the file's world
    std::string target;           ///< name of the node that it looks at
    bool hasTarget = false;
    Vector3 preRotation{}, postRotation{}; ///< degrees
    bool rotationActive = false;           ///< whether those are active
    std::string restDirection;             ///< the viewing direction at rotation 0 in the parent's space: "−Z"
    std::optional<std::string> movedBy;    ///< the nearest ancestor that is keyed
    std::vector<CameraChannel> channels;
    std::vector<IdleValue> idle;
    std::vector<Origin> origins;

    /// Everything that may change. Frames outside of the take are clamped to it.
    [[nodiscard]] CameraMoment at(double frame) const;

private:
    friend class CameraGathering;
    std::shared_ptr<const Tarnell::Fbx::TnFbxCamera> mValues;
    double mFrameRate = 24.0;
};

struct CameraList {
    TakeFacts take;
    double unit = 1.0; ///< of the file, centimetres
    std::string axes;  ///< of the file
    std::vector<CameraFacts> cameras;
    std::vector<std::string> warnings; ///< warnings of the library
};

/// The file's cameras, parents before their children, without those of the application's views. Reads the file once
/// more, through the library. Throws Unreadable.
CameraList camerasOf(const std::string& file, const SceneFile& opened, const std::string& takeName);

/// The same for several takes: the file is read once.
class CameraReader {
public:
    CameraReader(std::string file, const SceneFile& opened) : mFile(std::move(file)), mOpened(opened) {}
    CameraList read(const std::string& takeName);

private:
    FaithfulObjects<Tarnell::Fbx::TnFbxCamera> readObjects(const Tarnell::Fbx::TnFbxReadInfo& info);

    std::string mFile;
    const SceneFile& mOpened;
    Tarnell::Fbx::FbxFaithful mValues;
};

const char* driverText(LensDriver driver);

} // namespace tool
