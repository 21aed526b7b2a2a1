// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;

/// The control points that follow one node, and how strongly. Indices and weights of a file are read on the
/// first access; the indices are not checked against the geometry.
class FBXSDK_DLL FbxCluster : public FbxSubDeformer {
    FBXSDK_OBJECT_DECLARE(FbxCluster, FbxSubDeformer)

public:
    /// How the weights of a point are applied.
    enum ELinkMode {
        eNormalize, ///< normalised to a sum of 1; the default
        eAdditive,  ///< each added to the point so far, relative to the associate model
        eTotalOne   ///< taken as they are; the remainder to 1 stays undeformed
    };

    [[nodiscard]] EType GetSubDeformerType() const override; ///< eCluster.

    void SetLinkMode(ELinkMode pMode) { mLinkMode = pMode; }          ///< Any value is stored.
    [[nodiscard]] ELinkMode GetLinkMode() const { return mLinkMode; } ///< eNormalize by default.

    /// Sets the node that the points follow, replacing any other; null removes it.
    void SetLink(const FbxNode* pNode);
    /// The node that the points follow: the cluster's first source node. Null when there is none.
    [[nodiscard]] FbxNode* GetLink() { return mLink; }
    /// The same for a const cluster.
    [[nodiscard]] const FbxNode* GetLink() const { return mLink; }
    /// Sets the node that additive weights are relative to, replacing any other; null removes it.
    void SetAssociateModel(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetAssociateModel() const; ///< Null when there is none.

    /// Appends a point and its weight; neither is checked, and a point may occur repeatedly.
    void AddControlPointIndex(int pIndex, double pWeight);
    [[nodiscard]] int GetControlPointIndicesCount() const; ///< How many points have a weight.
    /// The points, as many as the count says; null when there are none. Valid until the count changes.
    [[nodiscard]] int* GetControlPointIndices() const;
    /// Their weights, usually 0 to 1; null when there are none. Valid until the count changes.
    [[nodiscard]] double* GetControlPointWeights() const;

    /// The global transform of the deformed geometry's node at the time of binding.
    void SetTransformMatrix(const FbxAMatrix& pMatrix) { mTransform = pMatrix; }
    /// Sets pMatrix and returns it; the identity when never set. Files hold it relative to the link.
    FbxAMatrix& GetTransformMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransform; }
    /// The global transform of the link at the time of binding.
    void SetTransformLinkMatrix(const FbxAMatrix& pMatrix) { mTransformLink = pMatrix; }
    /// Sets pMatrix and returns it; the identity when never set.
    FbxAMatrix& GetTransformLinkMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransformLink; }
    /// The global transform of the associate model at the time of binding.
    void SetTransformAssociateModelMatrix(const FbxAMatrix& pMatrix) { mTransformAssociateModel = pMatrix; }
    /// Sets pMatrix and returns it; the identity when never set.
    FbxAMatrix& GetTransformAssociateModelMatrix(FbxAMatrix& pMatrix) const {
        return pMatrix = mTransformAssociateModel;
    }
    /// The global transform of the parent at the time of binding; kept in memory, not in files.
    void SetTransformParentMatrix(const FbxAMatrix& pMatrix);
    /// Sets pMatrix and returns it; the identity when never set.
    FbxAMatrix& GetTransformParentMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransformParent; }
    /// Whether SetTransformParentMatrix was called.
    [[nodiscard]] bool IsTransformParentSet() const { return mTransformParentSet; }

    /// The platform's own view: the first indices and weights, as many as there are of both.
    [[nodiscard]] detail::PlainArray<int>& indices() { return mIndices; }
    /// The same of the weights.
    [[nodiscard]] detail::PlainArray<double>& weights() { return mWeights; }

protected:
    /// Keeps the link consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    ELinkMode mLinkMode = eNormalize;
    FbxNode* mLink = nullptr;
    FbxAMatrix mTransform, mTransformLink, mTransformAssociateModel, mTransformParent;
    bool mTransformParentSet = false;
    detail::PlainArray<int> mIndices;
    detail::PlainArray<double> mWeights;
};

FBXSDK_NAMESPACE_END
