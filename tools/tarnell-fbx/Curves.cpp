// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From properties to curves.
#include "Curves.h"

#include "PropertyValues.h"

namespace tool {

std::string Channel::fullName() const {
    const std::string base = property.GetHierarchicalName().Buffer();
    return name.empty() ? base : base + '.' + name;
}

double Channel::valueAt(FbxTime time) {
    return componentCount(property) == 1 ? property.EvaluateValue<FbxDouble>(time)
                                         : property.EvaluateValue<FbxDouble4>(time)[component];
}

double Channel::staticValue() const {
    return componentCount(property) == 1 ? property.Get<FbxDouble>() : property.Get<FbxDouble4>()[component];
}

std::vector<Channel> channelsOf(const FbxProperty& property, FbxAnimStack* take) {
    constexpr const char* kNames[] = {"X", "Y", "Z", "W"};
    std::vector<Channel> channels;
    const int components = componentCount(property);
    channels.reserve(static_cast<std::size_t>(components));
    for (int i = 0; i < components; ++i)
        channels.push_back({property, i, components == 1 ? "" : kNames[i], {}});
    FbxProperty driven = property;
    if (driven.GetSrcObjectCount<FbxAnimCurveNode>() == 0)
        return channels; // most have none: avoids a look-up on every layer
    for (int i = 0; take && i < take->GetMemberCount<FbxAnimLayer>(); ++i) {
        auto* layer = take->GetMember<FbxAnimLayer>(i);
        const FbxAnimCurveNode* node = driven.GetCurveNode(layer);
        for (std::size_t c = 0; node && c < channels.size() && c < node->GetChannelsCount(); ++c) {
            FbxAnimCurve* curve = node->GetCurve(static_cast<unsigned int>(c));
            if (curve && curve->KeyGetCount() > 0)
                channels[c].curves.push_back({layer, curve});
        }
    }
    return channels;
}

int keyCount(const FbxProperty& property, FbxAnimStack* take) {
    int keys = 0;
    for (const Channel& channel : channelsOf(property, take)) {
        for (const LayerCurve& each : channel.curves)
            keys += each.curve->KeyGetCount();
    }
    return keys;
}

} // namespace tool
