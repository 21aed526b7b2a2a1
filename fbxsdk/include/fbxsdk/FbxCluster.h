// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The control points that follow one node, and how strongly.
#pragma once

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;

/// Indices and weights that stand in a file are read on the first access; the indices are not checked against the
/// geometry.
class FBXSDK_DLL FbxCluster : public FbxSubDeformer {
    FBXSDK_OBJECT_DECLARE(FbxCluster, FbxSubDeformer)

public:
    /// How the weights of a point count: brought to a sum of 1; each added on to what the point was; taken as they are,
    /// with what is missing to 1 staying undeformed.
    enum ELinkMode { eNormalize, eAdditive, eTotalOne };

    [[nodiscard]] EType GetSubDeformerType() const override;

    void SetLinkMode(ELinkMode pMode) { mLinkMode = pMode; }
    [[nodiscard]] ELinkMode GetLinkMode() const { return mLinkMode; }

    /// The node that the points follow: the cluster's first source node. Null when there is none.
    void SetLink(const FbxNode* pNode);
    [[nodiscard]] FbxNode* GetLink() { return mLink; }
    [[nodiscard]] const FbxNode* GetLink() const { return mLink; }
    /// The node that additive weights are relative to; null when there is none.
    void SetAssociateModel(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetAssociateModel() const;

    void AddControlPointIndex(int pIndex, double pWeight);
    [[nodiscard]] int GetControlPointIndicesCount() const;
    // As many as the count says; null when there are none.
    [[nodiscard]] int* GetControlPointIndices() const;
    [[nodiscard]] double* GetControlPointWeights() const;

    // Global transforms at the time of binding: of the deformed geometry's node, of the link, of the associate model.
    // The identity when never set.
    void SetTransformMatrix(const FbxAMatrix& pMatrix) { mTransform = pMatrix; }
    FbxAMatrix& GetTransformMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransform; }
    void SetTransformLinkMatrix(const FbxAMatrix& pMatrix) { mTransformLink = pMatrix; }
    FbxAMatrix& GetTransformLinkMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransformLink; }
    void SetTransformAssociateModelMatrix(const FbxAMatrix& pMatrix) { mTransformAssociateModel = pMatrix; }
    FbxAMatrix& GetTransformAssociateModelMatrix(FbxAMatrix& pMatrix) const {
        return pMatrix = mTransformAssociateModel;
    }
    void SetTransformParentMatrix(const FbxAMatrix& pMatrix);
    FbxAMatrix& GetTransformParentMatrix(FbxAMatrix& pMatrix) const { return pMatrix = mTransformParent; }
    [[nodiscard]] bool IsTransformParentSet() const { return mTransformParentSet; }

    /// The platform's own view: of indices and weights the first ones count, as many as there are of both.
    [[nodiscard]] detail::PlainArray<int>& indices() { return mIndices; }
    [[nodiscard]] detail::PlainArray<double>& weights() { return mWeights; }

protected:
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
