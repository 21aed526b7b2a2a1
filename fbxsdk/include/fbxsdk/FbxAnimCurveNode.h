// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The joint between a property and the curves of its components on one layer.
#pragma once

#include <string>
#include <unordered_map>
#include <vector>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurve;
class FbxTimeSpan;

class FBXSDK_DLL FbxAnimCurveNode : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxAnimCurveNode, FbxObject)

public:
    /// A curve node with the channels that the property's type has: X, Y, Z for three numbers, one of the property's
    /// name for a single one. Not connected yet. Null for a property without numbers.
    static FbxAnimCurveNode* CreateTypedCurveNode(FbxProperty& pProperty, FbxScene* pScene);

    [[nodiscard]] unsigned int GetChannelsCount() const;
    [[nodiscard]] int GetChannelIndex(const char* pChannelName) const; ///< -1 when unknown
    [[nodiscard]] FbxString GetChannelName(int pChannelId) const;
    template <class T>
    [[nodiscard]] T GetChannelValue(unsigned int pChannelId, T pInitValue) const {
        return pChannelId < GetChannelsCount() ? static_cast<T>(channelValue(pChannelId)) : pInitValue;
    }
    template <class T>
    void SetChannelValue(unsigned int pChannelId, T pValue) {
        setChannelValue(pChannelId, static_cast<double>(pValue));
    }
    [[nodiscard]] int GetCurveCount(unsigned int pChannelId, const char* pCurveNodeName = nullptr) const;
    [[nodiscard]] FbxAnimCurve* GetCurve(unsigned int pChannelId, unsigned int pId = 0,
                                         const char* pCurveNodeName = nullptr) const;
    FbxAnimCurve* CreateCurve(const char* pCurveNodeName, unsigned int pChannelId = 0U);
    FbxAnimCurve* CreateCurve(const char* pCurveNodeName, const char* pChannelName);
    bool ConnectToChannel(FbxAnimCurve* pCurve, unsigned int pChannelId, bool pInFront = false);
    bool ConnectToChannel(FbxAnimCurve* pCurve, const char* pChannelName, bool pInFront = false);
    bool DisconnectFromChannel(FbxAnimCurve* pCurve, unsigned int pChannelId);
    /// True when any channel has a curve with keys.
    [[nodiscard]] bool IsAnimated(bool pRecurse = false) const;
    /// Widens nothing: sets the span to that of all keys. False when there are none.
    bool GetAnimationInterval(FbxTimeSpan& pTimeInterval) const;

    /// Adds a channel; false when the name is taken.
    bool addChannel(const char* pName, double pValue);
    /// Brings the channels into the order of a vector's components, whatever order a file had them in; those that are
    /// missing are made with the component's value.
    void arrangeChannels(const std::vector<double>& pComponents);
    [[nodiscard]] double channelValue(unsigned int pChannelId) const;
    void setChannelValue(unsigned int pChannelId, double pValue);
    /// In how many of the channels the curve stands.
    [[nodiscard]] int usesOf(const FbxAnimCurve& pCurve) const;

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    struct Channel {
        std::string name;
        double value = 0.0;
        std::vector<FbxAnimCurve*> curves;
    };
    std::vector<Channel> mChannels;
    /// Index by name, once there are many and until their order changes.
    mutable std::unordered_map<std::string, int> mChannelIndex;
    std::unordered_map<const FbxObject*, int> mUses; ///< of each curve, in how many channels it stands
};

FBXSDK_NAMESPACE_END
