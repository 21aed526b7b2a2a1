// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <string>
#include <unordered_map>
#include <vector>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurve;
class FbxTimeSpan;

/// Joins curves and one property on one layer: a channel for each component, with a value of its own and the
/// curves that drive it. It is a source of the property and a member of the layer; a property has at most one per
/// layer.
class FBXSDK_DLL FbxAnimCurveNode : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxAnimCurveNode, FbxObject)

public:
    /// A curve node with the channels that the property's type has: X, Y, Z for three numbers, one of the property's
    /// name for a single one; their values are the property's. Not connected yet. It is created in the scene, or in the
    /// manager when that is null. Null for an invalid property and one without numbers.
    static FbxAnimCurveNode* CreateTypedCurveNode(FbxProperty& pProperty, FbxScene* pScene);

    [[nodiscard]] unsigned int GetChannelsCount() const; ///< As many as the property has components.
    /// Of the channel with exactly that name; -1 when unknown.
    [[nodiscard]] int GetChannelIndex(const char* pChannelName) const;
    /// "X", "Y", … or the property's name; empty out of range.
    [[nodiscard]] FbxString GetChannelName(int pChannelId) const;
    /// The channel's value where no curve drives it, converted to T; pInitValue out of range.
    template <class T>
    [[nodiscard]] T GetChannelValue(unsigned int pChannelId, T pInitValue) const {
        return pChannelId < GetChannelsCount() ? static_cast<T>(channelValue(pChannelId)) : pInitValue;
    }
    /// Sets the channel's value; no effect out of range.
    template <class T>
    void SetChannelValue(unsigned int pChannelId, T pValue) {
        setChannelValue(pChannelId, static_cast<double>(pValue));
    }
    /// How many curves drive the channel; 0 out of range and when a name is given that is not the curve node's.
    [[nodiscard]] int GetCurveCount(unsigned int pChannelId, const char* pCurveNodeName = nullptr) const;
    /// The channel's curve of that number; the first one counts in evaluation. Null where GetCurveCount has none.
    [[nodiscard]] FbxAnimCurve* GetCurve(unsigned int pChannelId, unsigned int pId = 0,
                                         const char* pCurveNodeName = nullptr) const;
    /// Creates a curve of that name in the curve node's scene, or manager, as the channel's last one; null out of
    /// range.
    FbxAnimCurve* CreateCurve(const char* pCurveNodeName, unsigned int pChannelId = 0U);
    /// The same for the channel of that name; null when it is unknown.
    FbxAnimCurve* CreateCurve(const char* pCurveNodeName, const char* pChannelName);
    /// Makes the curve drive the channel, after those that do. False for null, out of range and when it does
    /// already.
    bool ConnectToChannel(FbxAnimCurve* pCurve, unsigned int pChannelId, bool pInFront = false);
    /// The same for the channel of that name; false when it is unknown.
    bool ConnectToChannel(FbxAnimCurve* pCurve, const char* pChannelName, bool pInFront = false);
    /// The curve is not destroyed. False out of range and when the curve does not drive the channel.
    bool DisconnectFromChannel(FbxAnimCurve* pCurve, unsigned int pChannelId);
    /// True when any channel has a curve with keys. The argument has no effect.
    [[nodiscard]] bool IsAnimated(bool pRecurse = false) const;
    /// Sets the span to that of all keys, whatever it was. False when there are none.
    bool GetAnimationInterval(FbxTimeSpan& pTimeInterval) const;

    /// Adds a channel; false when the name is taken.
    bool addChannel(const char* pName, double pValue);
    /// Brings the channels into the order of a vector's components, whatever order a file had them in; those that are
    /// missing are created with the component's value.
    void arrangeChannels(const std::vector<double>& pComponents);
    [[nodiscard]] double channelValue(unsigned int pChannelId) const; ///< 0 out of range.
    void setChannelValue(unsigned int pChannelId, double pValue);     ///< No effect out of range.
    /// How many of the channels the curve drives.
    [[nodiscard]] int usesOf(const FbxAnimCurve& pCurve) const;

protected:
    /// Removes a disconnected curve from its channels.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    struct Channel {
        std::string name;
        double value = 0.0;
        std::vector<FbxAnimCurve*> curves;
    };
    std::vector<Channel> mChannels;
    /// Index by name, built once there are many channels and until their order changes.
    mutable std::unordered_map<std::string, int> mChannelIndex;
    std::unordered_map<const FbxObject*, int> mUses; ///< of each curve, how many channels it drives
};

FBXSDK_NAMESPACE_END
