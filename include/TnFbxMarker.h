// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A marker: an animated transform plus a display shape, its size and its colour.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxExport.h"
#include "TnFbxTime.h"
#include "TnFbxTransform.h"

#include <array>
#include <vector>

namespace Tarnell::Fbx {

namespace detail {
struct MarkerChannels;
}

/// A marker. Its channels are reached only through the members below; no channel object is handed out.
class TARNELL_FBX_API TnFbxMarker : public TnFbxTransform {
public:
    /// The channels: colour components from 0 to 1.
    enum EFbxMarkerChannelType : int { kFbxMarkerRed, kFbxMarkerGreen, kFbxMarkerBlue, kFbxMarkerAlpha };

    /// The display shape, numbered as the first four of FBX; its others read as cubes.
    enum EFbxMarkerLookType : int {
        kFbxMarkerLookCube,
        kFbxMarkerLookHardCross,
        kFbxMarkerLookLightCross,
        kFbxMarkerLookSphere
    };

    static constexpr float kDefaultMarkerRed = 1.0f;
    static constexpr float kDefaultMarkerGreen = 1.0f;
    static constexpr float kDefaultMarkerBlue = 1.0f;
    static constexpr float kDefaultMarkerAlpha = 1.0f;
    static constexpr float kDefaultMarkerSize = 1.0f;

    /// A default transform, opaque white, a cube of size 1.
    TnFbxMarker();
    TnFbxMarker(const TnFbxMarker& other) = default;
    ~TnFbxMarker() override;

    /// Copies the colour channels, the size and the look; the target keeps its own transform and name.
    TnFbxMarker& operator=(const TnFbxMarker& other);

    /// The marker part of a new marker; the transform stays as it is. Always true.
    bool initMarker();

    /// The same, but with every static value 0; always true.
    bool deleteMarker();

    /// The static value of a channel, and all its samples at once (`TnFbxChannel::setAnimatedValues`, with its result).
    /// False when there is no such channel; nothing changes then.
    bool setValue(EFbxMarkerChannelType channel, float value);
    bool setValueAt(EFbxMarkerChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxMarkerChannelType channel, TnFbxTime time, std::vector<float>&& values);

    /// What a channel holds. Where there is no such channel: 0, 0, false and a default time record.
    float getValue(EFbxMarkerChannelType channel) const;
    float getValueAt(EFbxMarkerChannelType channel, float frame) const;
    bool getAnimated(EFbxMarkerChannelType channel) const;
    TnFbxTime getTime(EFbxMarkerChannelType channel) const;

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getChannelName(EFbxMarkerChannelType channel);

    /// Stored without a check; always true.
    bool setMarkerSize(float size);
    float getMarkerSize() const; ///< Display size, scene units.
    bool setMarkerLookType(EFbxMarkerLookType lookType);
    EFbxMarkerLookType getMarkerLookType() const;

private:
    friend struct detail::MarkerChannels; // for the library: hosts reach channels through the operations above

    struct Properties {
        float size = kDefaultMarkerSize;
        EFbxMarkerLookType lookType = kFbxMarkerLookCube;
    };

    Properties mProperties;
    std::array<TnFbxChannel, kFbxMarkerAlpha + 1> mChannels;
};

} // namespace Tarnell::Fbx
