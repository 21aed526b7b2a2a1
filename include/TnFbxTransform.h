// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The animated transform of a scene node, and the base of every concrete scene object.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxExport.h"
#include "TnFbxObject.h"
#include "TnFbxTime.h"

#include <array>
#include <vector>

namespace Tarnell::Fbx {

/// Position, rotation, scale, skew and pivot as fifteen channels, with the orders in which they apply.
class TARNELL_FBX_API TnFbxTransform : public TnFbxObject {
public:
    /// The channels. Rotations are in degrees.
    enum EFbxTransformChannelType : int {
        kFbxTransformPositionX, ///< Scene units; centimetres in what was read.
        kFbxTransformPositionY, ///< Scene units; centimetres in what was read.
        kFbxTransformPositionZ, ///< Scene units; centimetres in what was read.
        kFbxTransformRotationX, ///< Degrees, about the axis.
        kFbxTransformRotationY, ///< Degrees, about the axis.
        kFbxTransformRotationZ, ///< Degrees, about the axis.
        kFbxTransformScaleX,    ///< A factor; 1 leaves the size as it is.
        kFbxTransformScaleY,    ///< A factor; 1 leaves the size as it is.
        kFbxTransformScaleZ,    ///< A factor; 1 leaves the size as it is.
        kFbxTransformSkewX,     ///< How much of Y is added to X.
        kFbxTransformSkewY,     ///< How much of Z is added to X.
        kFbxTransformSkewZ,     ///< How much of Z is added to Y.
        kFbxTransformPivotX,    ///< Scene units; 0 in what was read faithfully.
        kFbxTransformPivotY,    ///< Scene units; 0 in what was read faithfully.
        kFbxTransformPivotZ     ///< Scene units; 0 in what was read faithfully.
    };

    /// The order in which the three Euler rotations are applied. The numbers are the library's own: FBX numbers YZX
    /// before YXZ.
    enum EFbxTransformRotationOrder : int {
        kFbxRotationOrderXYZ, ///< About X first, then Y, then Z.
        kFbxRotationOrderXZY, ///< About X first, then Z, then Y.
        kFbxRotationOrderYXZ, ///< About Y first, then X, then Z.
        kFbxRotationOrderYZX, ///< About Y first, then Z, then X.
        kFbxRotationOrderZXY, ///< About Z first, then X, then Y. The default.
        kFbxRotationOrderZYX  ///< About Z first, then Y, then X.
    };

    /// The order of the scale, rotation and translation stages. Kept for the host; the library does not interpret it.
    enum EFbxTransformTransformOrder : int {
        kFbxTransformOrderDefault ///< The only one.
    };

    /// The static value of the channel of that name in a new transform.
    /// @{
    static constexpr float kDefaultTransformPositionX = 0.0f;
    static constexpr float kDefaultTransformPositionY = 0.0f;
    static constexpr float kDefaultTransformPositionZ = 0.0f;
    static constexpr float kDefaultTransformRotationX = 0.0f;
    static constexpr float kDefaultTransformRotationY = 0.0f;
    static constexpr float kDefaultTransformRotationZ = 0.0f;
    static constexpr float kDefaultTransformScaleX = 1.0f;
    static constexpr float kDefaultTransformScaleY = 1.0f;
    static constexpr float kDefaultTransformScaleZ = 1.0f;
    static constexpr float kDefaultTransformSkewX = 0.0f;
    static constexpr float kDefaultTransformSkewY = 0.0f;
    static constexpr float kDefaultTransformSkewZ = 0.0f;
    static constexpr float kDefaultTransformPivotX = 0.0f;
    static constexpr float kDefaultTransformPivotY = 0.0f;
    static constexpr float kDefaultTransformPivotZ = 0.0f;
    /// @}

    /// No name, every channel at its default, rotation order ZXY.
    TnFbxTransform();
    TnFbxTransform(const TnFbxTransform& other) = default;
    ~TnFbxTransform() override;

    /// Copies the channels and the orders; the target keeps its own name.
    TnFbxTransform& operator=(const TnFbxTransform& other);

    /// Restores the state of a new transform, except that the name stays; always true.
    bool initTransform();

    /// The same, but with every static value 0, those of the scale included; always true.
    bool deleteTransform();

    /// Sets the static value of a channel. False when there is no such channel.
    bool setTransformValue(EFbxTransformChannelType channel, float value);

    /// Replaces all samples of a channel, as `TnFbxChannel::setAnimatedValues` and `moveAnimatedValues` do, with their
    /// result. False also when there is no such channel; nothing changes then. A single sample is set through
    /// `getTransformChannel`.
    /// @{
    bool setTransformValueAt(EFbxTransformChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveTransformValuesAt(EFbxTransformChannelType channel, TnFbxTime time, std::vector<float>&& values);
    /// @}

    /// The static value of a channel; 0 when there is no such channel.
    float getTransformValue(EFbxTransformChannelType channel) const;
    /// The value at a frame, as `TnFbxChannel::getAnimatedValue` gives it; 0 when there is no such channel.
    float getTransformValueAt(EFbxTransformChannelType channel, float frame) const;
    /// Whether a channel has samples; false when there is no such channel.
    bool getTransformAnimated(EFbxTransformChannelType channel) const;
    /// A copy of the time record of a channel; a default one when there is no such channel.
    TnFbxTime getTransformTime(EFbxTransformChannelType channel) const;

    /// The channel itself, owned by the transform; null when there is no such channel.
    TnFbxChannel* getTransformChannel(EFbxTransformChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getTransformChannelName(EFbxTransformChannelType channel);

    /// Stored without a check; always true.
    /// @{
    bool setTransformRotationOrder(EFbxTransformRotationOrder order);
    bool setTransformTransformOrder(EFbxTransformTransformOrder order);
    /// @}
    EFbxTransformRotationOrder getTransformRotationOrder() const;   ///< Default ZXY.
    EFbxTransformTransformOrder getTransformTransformOrder() const; ///< Kept for the host.

private:
    struct Properties {
        EFbxTransformRotationOrder rotationOrder = kFbxRotationOrderZXY;
        EFbxTransformTransformOrder transformOrder = kFbxTransformOrderDefault;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxTransformPivotZ + 1> mChannels;
};

} // namespace Tarnell::Fbx
