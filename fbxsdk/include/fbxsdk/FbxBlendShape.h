// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxBlendShapeChannel;
class FbxGeometry;

/// Deformation toward other shapes of the same points. Channels are the blend shape's source objects of that class, in
/// order of connection.
class FBXSDK_DLL FbxBlendShape : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxBlendShape, FbxDeformer)

public:
    [[nodiscard]] EDeformerType GetDeformerType() const override; ///< eBlendShape.

    /// The geometry that it deforms; null when there is none.
    [[nodiscard]] FbxGeometry* GetGeometry();
    /// Makes it deform that geometry and no other; null removes it from its geometry. False when it cannot be
    /// connected.
    bool SetGeometry(FbxGeometry* pGeometry);

    /// False for null and when the channel is already part of it.
    bool AddBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel);
    /// Returns the channel, or null when it is not the blend shape's.
    FbxBlendShapeChannel* RemoveBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel);
    /// How many channels there are.
    [[nodiscard]] int GetBlendShapeChannelCount() const { return static_cast<int>(mChannels.size()); }
    /// The channel at that index; null out of range.
    [[nodiscard]] FbxBlendShapeChannel* GetBlendShapeChannel(int pIndex);
    /// The same for a const blend shape.
    [[nodiscard]] const FbxBlendShapeChannel* GetBlendShapeChannel(int pIndex) const;

protected:
    /// Keeps the list of channels consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxBlendShapeChannel*> mChannels;
};

FBXSDK_NAMESPACE_END
