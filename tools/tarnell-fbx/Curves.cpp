// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From properties to curves.
#include "Curves.h"

#include <algorithm>
#include <utility>

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

namespace {

/// Without curves.
std::vector<Channel> stillChannels(const FbxProperty& property) {
    constexpr const char* kNames[] = {"X", "Y", "Z", "W"};
    std::vector<Channel> channels;
    const int components = componentCount(property);
    channels.reserve(static_cast<std::size_t>(components));
    for (int i = 0; i < components; ++i)
        channels.push_back({property, i, components == 1 ? "" : kNames[i], {}});
    return channels;
}

void addCurves(const FbxAnimCurveNode& node, FbxAnimLayer* layer, std::vector<Channel>& channels) {
    for (std::size_t c = 0; c < channels.size() && c < node.GetChannelsCount(); ++c) {
        FbxAnimCurve* curve = node.GetCurve(static_cast<unsigned int>(c));
        if (curve && curve->KeyGetCount() > 0)
            channels[c].curves.push_back({layer, curve});
    }
}

/// The curve node of a property on a layer of a take.
struct PlacedNode {
    TakeLayers::Place place;
    FbxAnimLayer* layer;
    const FbxAnimCurveNode* node;
};

/// In the order of takes and layers; of several on one layer the first.
std::vector<PlacedNode> placedNodes(const FbxProperty& property, const TakeLayers& layers) {
    std::vector<PlacedNode> nodes;
    for (int i = 0; i < property.GetSrcObjectCount<FbxAnimCurveNode>(); ++i) {
        const auto* node = property.GetSrcObject<FbxAnimCurveNode>(i);
        for (int l = 0; l < node->GetDstObjectCount<FbxAnimLayer>(); ++l) {
            auto* layer = node->GetDstObject<FbxAnimLayer>(l);
            for (const TakeLayers::Place& place : layers.placesOf(*layer))
                nodes.push_back({place, layer, node});
        }
    }
    const auto key = [](const PlacedNode& each) { return std::pair(each.place.take, each.place.layer); };
    std::stable_sort(
        nodes.begin(), nodes.end(), [&](const PlacedNode& a, const PlacedNode& b) { return key(a) < key(b); });
    const auto isSame = [&](const PlacedNode& a, const PlacedNode& b) { return key(a) == key(b); };
    nodes.erase(std::unique(nodes.begin(), nodes.end(), isSame), nodes.end());
    return nodes;
}

} // namespace

std::vector<Channel> channelsOf(const FbxProperty& property, FbxAnimStack* take) {
    std::vector<Channel> channels = stillChannels(property);
    FbxProperty driven = property;
    if (driven.GetSrcObjectCount<FbxAnimCurveNode>() == 0)
        return channels; // most have none: avoids a look-up on every layer
    for (int i = 0; take && i < take->GetMemberCount<FbxAnimLayer>(); ++i) {
        auto* layer = take->GetMember<FbxAnimLayer>(i);
        if (const FbxAnimCurveNode* node = driven.GetCurveNode(layer))
            addCurves(*node, layer, channels);
    }
    return channels;
}

TakeLayers::TakeLayers(const std::vector<FbxAnimStack*>& takes) {
    for (std::size_t take = 0; take < takes.size(); ++take)
        for (int i = 0; i < takes[take]->GetMemberCount<FbxAnimLayer>(); ++i)
            mPlaces[takes[take]->GetMember<FbxAnimLayer>(i)].push_back({take, i});
}

const std::vector<TakeLayers::Place>& TakeLayers::placesOf(const FbxAnimLayer& layer) const {
    static const std::vector<Place> kNone;
    const auto found = mPlaces.find(&layer);
    return found == mPlaces.end() ? kNone : found->second;
}

std::vector<TakeChannel> keyedChannels(const FbxProperty& property, const TakeLayers& layers) {
    std::vector<TakeChannel> keyed;
    if (property.GetSrcObjectCount<FbxAnimCurveNode>() == 0)
        return keyed; // most are so
    const std::vector<PlacedNode> nodes = placedNodes(property, layers);
    for (auto node = nodes.begin(); node != nodes.end();) {
        const std::size_t take = node->place.take;
        std::vector<Channel> channels = stillChannels(property);
        for (; node != nodes.end() && node->place.take == take; ++node)
            addCurves(*node->node, node->layer, channels);
        for (Channel& channel : channels)
            if (!channel.curves.empty())
                keyed.push_back({take, std::move(channel)});
    }
    return keyed;
}

int keyCount(const FbxProperty& property, FbxAnimStack* take) {
    int keys = 0;
    for (const Channel& channel : channelsOf(property, take))
        for (const LayerCurve& each : channel.curves)
            keys += each.curve->KeyGetCount();
    return keys;
}

} // namespace tool
