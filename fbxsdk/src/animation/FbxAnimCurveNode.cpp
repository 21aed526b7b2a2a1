// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curve nodes: named channels, each with a value and the curves that drive it.
#include <fbxsdk/FbxAnimCurveNode.h>

#include <algorithm>
#include <iterator>

#include <fbxsdk/FbxAnimCurve.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxAnimCurveNode, FbxObject, std::span<const detail::PropertyRow>{})

FbxAnimCurveNode::FbxAnimCurveNode(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}

FbxAnimCurveNode::~FbxAnimCurveNode() = default;

namespace {

/// Up to this many channels are searched one by one; more get an index.
constexpr std::size_t kSearchedChannels = 8;

} // namespace

unsigned int FbxAnimCurveNode::GetChannelsCount() const { return static_cast<unsigned int>(mChannels.size()); }

int FbxAnimCurveNode::GetChannelIndex(const char* pChannelName) const {
    if (!pChannelName)
        return -1;
    if (mChannels.size() > kSearchedChannels) {
        for (std::size_t i = mChannelIndex.size(); i < mChannels.size(); ++i) // names are unique
            mChannelIndex.emplace(mChannels[i].name, static_cast<int>(i));
        const auto known = mChannelIndex.find(pChannelName);
        return known == mChannelIndex.end() ? -1 : known->second;
    }
    const auto found = std::find_if(mChannels.begin(), mChannels.end(),
                                    [&](const Channel& channel) { return channel.name == pChannelName; });
    return found == mChannels.end() ? -1 : static_cast<int>(found - mChannels.begin());
}

FbxString FbxAnimCurveNode::GetChannelName(int pChannelId) const {
    if (pChannelId < 0 || static_cast<std::size_t>(pChannelId) >= mChannels.size())
        return {};
    return FbxString(mChannels[static_cast<std::size_t>(pChannelId)].name.c_str());
}

int FbxAnimCurveNode::GetCurveCount(unsigned int pChannelId, const char* pCurveNodeName) const {
    if (pChannelId >= mChannels.size() || (pCurveNodeName && std::string_view(pCurveNodeName) != GetName()))
        return 0;
    return static_cast<int>(mChannels[pChannelId].curves.size());
}

FbxAnimCurve* FbxAnimCurveNode::GetCurve(unsigned int pChannelId, unsigned int pId, const char* pCurveNodeName) const {
    const int count = GetCurveCount(pChannelId, pCurveNodeName);
    return pId < static_cast<unsigned int>(count) ? mChannels[pChannelId].curves[pId] : nullptr;
}

FbxAnimCurve* FbxAnimCurveNode::CreateCurve(const char* pCurveNodeName, unsigned int pChannelId) {
    if (pChannelId >= mChannels.size())
        return nullptr;
    FbxObject* const scene = data().membership ? &data().membership->scene : nullptr;
    FbxAnimCurve* curve =
        scene ? FbxAnimCurve::Create(scene, pCurveNodeName) : FbxAnimCurve::Create(GetFbxManager(), pCurveNodeName);
    ConnectToChannel(curve, pChannelId);
    return curve;
}

FbxAnimCurve* FbxAnimCurveNode::CreateCurve(const char* pCurveNodeName, const char* pChannelName) {
    const int channel = GetChannelIndex(pChannelName);
    return channel < 0 ? nullptr : CreateCurve(pCurveNodeName, static_cast<unsigned int>(channel));
}

bool FbxAnimCurveNode::ConnectToChannel(FbxAnimCurve* pCurve, unsigned int pChannelId, bool pInFront) {
    if (!pCurve || pChannelId >= mChannels.size())
        return false;
    auto& curves = mChannels[pChannelId].curves;
    if (usesOf(*pCurve) > 0 && std::find(curves.begin(), curves.end(), pCurve) != curves.end())
        return false;
    int& uses = mUses[pCurve];
    curves.insert(pInFront ? curves.begin() : curves.end(), pCurve);
    ++uses;
    if (!IsConnectedSrcObject(pCurve))
        ConnectSrcObject(pCurve);
    ++GetFbxManager()->data().revision;
    return true;
}

bool FbxAnimCurveNode::ConnectToChannel(FbxAnimCurve* pCurve, const char* pChannelName, bool pInFront) {
    const int channel = GetChannelIndex(pChannelName);
    return channel >= 0 && ConnectToChannel(pCurve, static_cast<unsigned int>(channel), pInFront);
}

bool FbxAnimCurveNode::DisconnectFromChannel(FbxAnimCurve* pCurve, unsigned int pChannelId) {
    if (pChannelId >= mChannels.size() || std::erase(mChannels[pChannelId].curves, pCurve) == 0)
        return false;
    if (--mUses[pCurve] == 0)
        DisconnectSrcObject(pCurve);
    ++GetFbxManager()->data().revision;
    return true;
}

bool FbxAnimCurveNode::IsAnimated(bool) const {
    return std::any_of(
        mChannels.begin(), mChannels.end(),
        [](const Channel& channel) {
            return std::any_of(
                channel.curves.begin(), channel.curves.end(),
                [](const FbxAnimCurve* curve) { return curve->KeyGetCount() > 0; });
        });
}

bool FbxAnimCurveNode::GetAnimationInterval(FbxTimeSpan& pTimeInterval) const {
    bool found = false;
    for (const Channel& channel : mChannels) {
        for (const FbxAnimCurve* curve : channel.curves) {
            FbxTimeSpan span;
            if (!curve->GetTimeInterval(span))
                continue;
            if (!found)
                pTimeInterval = span;
            if (span.GetStart() < pTimeInterval.GetStart())
                pTimeInterval.SetStart(span.GetStart());
            if (span.GetStop() > pTimeInterval.GetStop())
                pTimeInterval.SetStop(span.GetStop());
            found = true;
        }
    }
    return found;
}

bool FbxAnimCurveNode::addChannel(const char* pName, double pValue) {
    if (!pName || GetChannelIndex(pName) >= 0)
        return false;
    mChannels.push_back({pName, pValue, {}});
    ++GetFbxManager()->data().revision;
    return true;
}

void FbxAnimCurveNode::arrangeChannels(const std::vector<double>& pComponents) {
    constexpr const char* kNames[][2] = {{"X", "R"}, {"Y", "G"}, {"Z", "B"}, {"W", "A"}};
    for (std::size_t i = 0; i < std::min(pComponents.size(), std::size(kNames)); ++i) {
        addChannel(GetChannelIndex(kNames[i][1]) < 0 ? kNames[i][0] : kNames[i][1], pComponents[i]);
        const auto isComponent = [&](const Channel& channel) {
            return channel.name == kNames[i][0] || channel.name == kNames[i][1];
        };
        const auto place = mChannels.begin() + static_cast<std::ptrdiff_t>(i);
        const auto found = std::find_if(place, mChannels.end(), isComponent);
        if (found != mChannels.end())
            std::rotate(place, found, std::next(found));
    }
    mChannelIndex.clear();
    ++GetFbxManager()->data().revision;
}

int FbxAnimCurveNode::usesOf(const FbxAnimCurve& pCurve) const {
    const auto found = mUses.find(&pCurve);
    return found == mUses.end() ? 0 : found->second;
}

double FbxAnimCurveNode::channelValue(unsigned int pChannelId) const {
    return pChannelId < mChannels.size() ? mChannels[pChannelId].value : 0.0;
}

void FbxAnimCurveNode::setChannelValue(unsigned int pChannelId, double pValue) {
    if (pChannelId >= mChannels.size())
        return;
    mChannels[pChannelId].value = pValue;
    ++GetFbxManager()->data().revision;
}

void FbxAnimCurveNode::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    FbxObject::connectionChanged(pSource, pDestination, pConnected);
    if (pConnected || &pDestination != this)
        return;
    // A curve that is disconnected (or destroyed) must not stay in a channel. It may be past its own destructor's body,
    // so it is compared by address only.
    if (mUses.erase(&pSource) == 0)
        return;
    for (Channel& channel : mChannels) {
        std::erase_if(
            channel.curves,
            [&](const FbxAnimCurve* curve) { return static_cast<const FbxObject*>(curve) == &pSource; });
    }
}

FBXSDK_NAMESPACE_END
