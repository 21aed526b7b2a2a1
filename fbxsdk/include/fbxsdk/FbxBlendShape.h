// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformation toward other shapes of the same points.
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxBlendShapeChannel;
class FbxGeometry;

/// Channels are the blend shape's source objects of that class, in order of connection.
class FBXSDK_DLL FbxBlendShape : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxBlendShape, FbxDeformer)

public:
    [[nodiscard]] EDeformerType GetDeformerType() const override;

    /// Null when the blend shape deforms nothing.
    [[nodiscard]] FbxGeometry* GetGeometry();
    bool SetGeometry(FbxGeometry* pGeometry);

    /// False for null and when the channel is there already.
    bool AddBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel);
    /// Returns the channel, or null when it is none of the blend shape.
    FbxBlendShapeChannel* RemoveBlendShapeChannel(FbxBlendShapeChannel* pBlendShapeChannel);
    [[nodiscard]] int GetBlendShapeChannelCount() const { return static_cast<int>(mChannels.size()); }
    /// Null out of range.
    [[nodiscard]] FbxBlendShapeChannel* GetBlendShapeChannel(int pIndex);
    [[nodiscard]] const FbxBlendShapeChannel* GetBlendShapeChannel(int pIndex) const;

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxBlendShapeChannel*> mChannels;
};

FBXSDK_NAMESPACE_END
