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
        kFbxTransformPositionX,
        kFbxTransformPositionY,
        kFbxTransformPositionZ,
        kFbxTransformRotationX,
        kFbxTransformRotationY,
        kFbxTransformRotationZ,
        kFbxTransformScaleX,
        kFbxTransformScaleY,
        kFbxTransformScaleZ,
        kFbxTransformSkewX,
        kFbxTransformSkewY,
        kFbxTransformSkewZ,
        kFbxTransformPivotX,
        kFbxTransformPivotY,
        kFbxTransformPivotZ
    };

    /// The order in which the three Euler rotations are applied. The numbers are the library's own: FBX numbers YZX
    /// before YXZ.
    enum EFbxTransformRotationOrder : int {
        kFbxRotationOrderXYZ,
        kFbxRotationOrderXZY,
        kFbxRotationOrderYXZ,
        kFbxRotationOrderYZX,
        kFbxRotationOrderZXY,
        kFbxRotationOrderZYX
    };

    /// The order of the scale, rotation and translation stages. Kept for the host; the library does not interpret it.
    enum EFbxTransformTransformOrder : int { kFbxTransformOrderDefault };

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

    /// No name, every channel at its default, rotation order ZXY.
    TnFbxTransform();
    TnFbxTransform(const TnFbxTransform& other) = default;
    ~TnFbxTransform() override;

    /// Copies the channels and the orders; the target keeps its own name.
    TnFbxTransform& operator=(const TnFbxTransform& other);

    /// The state of a new transform, except that the name stays; always true.
    bool initTransform();

    /// The same, but with every static value 0, those of the scale included; always true.
    bool deleteTransform();

    /// The static value of a channel, and all its samples at once (`TnFbxChannel::setAnimatedValues`, with its result).
    /// False when there is no such channel; nothing changes then. A single sample is set through
    /// `getTransformChannel`.
    bool setTransformValue(EFbxTransformChannelType channel, float value);
    bool setTransformValueAt(EFbxTransformChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveTransformValuesAt(EFbxTransformChannelType channel, TnFbxTime time, std::vector<float>&& values);

    /// What a channel holds. Where there is no such channel: 0, 0, false and a default time record.
    float getTransformValue(EFbxTransformChannelType channel) const;
    float getTransformValueAt(EFbxTransformChannelType channel, float frame) const;
    bool getTransformAnimated(EFbxTransformChannelType channel) const;
    TnFbxTime getTransformTime(EFbxTransformChannelType channel) const;

    /// The channel itself, owned by the transform; null when there is no such channel.
    TnFbxChannel* getTransformChannel(EFbxTransformChannelType channel);

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getTransformChannelName(EFbxTransformChannelType channel);

    /// Stored without a check; always true.
    bool setTransformRotationOrder(EFbxTransformRotationOrder order);
    EFbxTransformRotationOrder getTransformRotationOrder() const;
    bool setTransformTransformOrder(EFbxTransformTransformOrder order);
    EFbxTransformTransformOrder getTransformTransformOrder() const;

private:
    struct Properties {
        EFbxTransformRotationOrder rotationOrder = kFbxRotationOrderZXY;
        EFbxTransformTransformOrder transformOrder = kFbxTransformOrderDefault;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxTransformPivotZ + 1> mChannels;
};

} // namespace Tarnell::Fbx
