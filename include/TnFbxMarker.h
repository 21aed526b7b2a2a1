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

/// A marker. Its channels are accessible only through the members below; no channel object is returned.
class TARNELL_FBX_API TnFbxMarker : public TnFbxTransform {
public:
    /// The channels: the components of the colour.
    enum EFbxMarkerChannelType : int {
        kFbxMarkerRed,   ///< From 0 to 1.
        kFbxMarkerGreen, ///< From 0 to 1.
        kFbxMarkerBlue,  ///< From 0 to 1.
        kFbxMarkerAlpha  ///< From 0 (transparent) to 1 (opaque).
    };

    /// The display shape, numbered as the first four of FBX; its others read as cubes.
    enum EFbxMarkerLookType : int {
        kFbxMarkerLookCube,       ///< A cube. The default.
        kFbxMarkerLookHardCross,  ///< A cross of beams.
        kFbxMarkerLookLightCross, ///< A cross of lines.
        kFbxMarkerLookSphere      ///< A sphere.
    };

    /// The static value of the channel, or the size, of a new marker.
    /// @{
    static constexpr float kDefaultMarkerRed = 1.0f;
    static constexpr float kDefaultMarkerGreen = 1.0f;
    static constexpr float kDefaultMarkerBlue = 1.0f;
    static constexpr float kDefaultMarkerAlpha = 1.0f;
    static constexpr float kDefaultMarkerSize = 1.0f;
    /// @}

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

    /// Sets the static value of a channel. False when there is no such channel.
    bool setValue(EFbxMarkerChannelType channel, float value);

    /// Replaces all samples of a channel, as `TnFbxChannel::setAnimatedValues` and `moveAnimatedValues` do, with their
    /// result. False also when there is no such channel; nothing changes then.
    /// @{
    bool setValueAt(EFbxMarkerChannelType channel, TnFbxTime time, const std::vector<float>& values);
    bool moveValuesAt(EFbxMarkerChannelType channel, TnFbxTime time, std::vector<float>&& values);
    /// @}

    /// The static value of a channel; 0 when there is no such channel.
    float getValue(EFbxMarkerChannelType channel) const;
    /// The value at a frame, as `TnFbxChannel::getAnimatedValue` gives it; 0 when there is no such channel.
    float getValueAt(EFbxMarkerChannelType channel, float frame) const;
    /// Whether a channel has samples; false when there is no such channel.
    bool getAnimated(EFbxMarkerChannelType channel) const;
    /// A copy of the time record of a channel; a default one when there is no such channel.
    TnFbxTime getTime(EFbxMarkerChannelType channel) const;

    /// The channel's printable name, a constant; null when there is no such channel.
    static const char* getChannelName(EFbxMarkerChannelType channel);

    /// Stored without a check; always true.
    /// @{
    bool setMarkerSize(float size);
    bool setMarkerLookType(EFbxMarkerLookType lookType);
    /// @}
    float getMarkerSize() const;                  ///< Display size, scene units. Default 1.
    EFbxMarkerLookType getMarkerLookType() const; ///< Default cube.

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
