// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The curves that drive a property in one take.
#pragma once

#include <string>
#include <unordered_map>
#include <vector>

#include <fbxsdk.h>

namespace tool {

struct LayerCurve {
    FbxAnimLayer* layer;
    FbxAnimCurve* curve;
};

/// One number of a property, and the curves that drive it.
struct Channel {
    FbxProperty property;
    int component = 0;              ///< of the property's value
    std::string name;               ///< "X"; empty where the property is one number
    std::vector<LayerCurve> curves; ///< with keys, from the base layer up

    /// "Lcl Translation.X"
    [[nodiscard]] std::string fullName() const;
    [[nodiscard]] double valueAt(FbxTime time);
    [[nodiscard]] double staticValue() const;
};

/// A property's channels, also those that are not driven. Without a take none is driven.
std::vector<Channel> channelsOf(const FbxProperty& property, FbxAnimStack* take);

/// The takes that layers belong to, and their index in these.
class TakeLayers {
public:
    explicit TakeLayers(const std::vector<FbxAnimStack*>& takes);

    struct Place {
        std::size_t take; ///< index
        int layer;        ///< from the base layer up
    };
    [[nodiscard]] const std::vector<Place>& placesOf(const FbxAnimLayer& layer) const;

private:
    std::unordered_map<const FbxAnimLayer*, std::vector<Place>> mPlaces;
};

/// A channel as one take drives it.
struct TakeChannel {
    std::size_t take; ///< index
    Channel channel;
};

/// The channels of a property that have keys, take by take, in one pass over its curve nodes.
std::vector<TakeChannel> keyedChannels(const FbxProperty& property, const TakeLayers& layers);

/// How many keys all curves of the property have in the take.
int keyCount(const FbxProperty& property, FbxAnimStack* take);

} // namespace tool
