// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One weight of a blend shape and the target shapes that it leads through.
#pragma once

#include <utility>
#include <vector>

#include <fbxsdk/FbxDeformer.h>

FBXSDK_NAMESPACE_BEGIN

class FbxBlendShape;
class FbxShape;

/// Targets are the channel's source shapes, in order of connection.
class FBXSDK_DLL FbxBlendShapeChannel : public FbxSubDeformer {
    FBXSDK_OBJECT_DECLARE(FbxBlendShapeChannel, FbxSubDeformer)

public:
    FbxPropertyT<FbxDouble> DeformPercent; ///< percent

    [[nodiscard]] EType GetSubDeformerType() const override;

    /// Null when the channel is in none.
    [[nodiscard]] FbxBlendShape* GetBlendShapeDeformer();
    bool SetBlendShapeDeformer(FbxBlendShape* pBlendShape);

    /// The percentage is the one at which the target is fully reached. False for null and when the shape is there
    /// already.
    bool AddTargetShape(FbxShape* pShape, double pFullDeformPercent = 100);
    /// Returns the shape, or null when it is none of the channel's.
    FbxShape* RemoveTargetShape(FbxShape* pShape);
    [[nodiscard]] int GetTargetShapeCount() const { return static_cast<int>(mTargets.size()); }
    /// Null out of range.
    [[nodiscard]] FbxShape* GetTargetShape(int pIndex);
    [[nodiscard]] const FbxShape* GetTargetShape(int pIndex) const;
    /// -1 when it is none of the channel's.
    [[nodiscard]] int GetTargetShapeIndex(const FbxShape* pShape) const;

    /// The full percentages, at least one per target; null when there are none. Those that were never given divide 100
    /// evenly: k targets have 100/k, 200/k, … 100. Good until targets or their number change.
    [[nodiscard]] double* GetTargetShapeFullWeights();
    void SetFullWeightsCount(int pCount);

    /// For the scene reader: the percentages as the file has them.
    void setFullWeights(std::vector<double> pFullWeights) { mFullWeights = std::move(pFullWeights); }

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    void completeFullWeights(std::size_t pCount);

    std::vector<FbxShape*> mTargets;
    std::vector<double> mFullWeights;
};

FBXSDK_NAMESPACE_END
