// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <utility>
#include <vector>

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxBlendShape;
class FbxShape;

/// One weight of a blend shape and the target shapes that it passes through. Targets are the channel's source shapes,
/// in order of connection.
class FBXSDK_DLL FbxBlendShapeChannel : public FbxSubDeformer {
    FBXSDK_OBJECT_DECLARE(FbxBlendShapeChannel, FbxSubDeformer)

public:
    FbxPropertyT<FbxDouble> DeformPercent; ///< percent; 0, animatable

    [[nodiscard]] EType GetSubDeformerType() const override; ///< eBlendShapeChannel.

    /// The blend shape that the channel is part of; null when it is in none.
    [[nodiscard]] FbxBlendShape* GetBlendShapeDeformer();
    /// Makes it part of that blend shape and no other; null removes it. False when it cannot be connected.
    bool SetBlendShapeDeformer(FbxBlendShape* pBlendShape);

    /// The percentage is the one at which the target is fully reached. False for null and when the shape is already a
    /// target.
    bool AddTargetShape(FbxShape* pShape, double pFullDeformPercent = 100);
    /// Returns the shape, or null when it is no target of the channel.
    FbxShape* RemoveTargetShape(FbxShape* pShape);
    /// How many targets there are.
    [[nodiscard]] int GetTargetShapeCount() const { return static_cast<int>(mTargets.size()); }
    /// The target at that index; null out of range.
    [[nodiscard]] FbxShape* GetTargetShape(int pIndex);
    /// The same for a const channel.
    [[nodiscard]] const FbxShape* GetTargetShape(int pIndex) const;
    /// The index of the target; -1 when it is no target of the channel.
    [[nodiscard]] int GetTargetShapeIndex(const FbxShape* pShape) const;

    /// The full percentages, at least one per target; null when there are none. Those that were never set divide 100
    /// evenly: k targets have 100/k, 200/k, … 100. Valid until targets or their number change.
    [[nodiscard]] double* GetTargetShapeFullWeights();
    /// How many percentages there are; new ones are 0. Negative counts as 0.
    void SetFullWeightsCount(int pCount);

    /// For the scene reader: the percentages as the file has them.
    void setFullWeights(std::vector<double> pFullWeights) { mFullWeights = std::move(pFullWeights); }

protected:
    /// Keeps the list of targets, and their percentages, consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    FBXSDK_LOCAL void completeFullWeights(std::size_t pCount);

    std::vector<FbxShape*> mTargets;
    std::vector<double> mFullWeights;
};

FBXSDK_NAMESPACE_END
