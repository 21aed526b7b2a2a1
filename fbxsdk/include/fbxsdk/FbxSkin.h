// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCluster;
class FbxGeometry;

/// Deformation by nodes that move. Clusters are the skin's source objects of that class, in order of connection.
class FBXSDK_DLL FbxSkin : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxSkin, FbxDeformer)

public:
    /// How the clusters of a point are mixed.
    enum EType {
        eRigid,          ///< each point follows one cluster; the default
        eLinear,         ///< by the sum of their matrices
        eDualQuaternion, ///< by dual quaternions, which keep the volume
        eBlend           ///< between both, by the weights of AddControlPointIndex
    };

    [[nodiscard]] EDeformerType GetDeformerType() const override; ///< eSkin.

    /// False for null and when the cluster is there already.
    bool AddCluster(FbxCluster* pCluster);
    /// Returns the cluster, or null when it is none of the skin.
    FbxCluster* RemoveCluster(FbxCluster* pCluster);
    /// How many clusters there are.
    [[nodiscard]] int GetClusterCount() const { return static_cast<int>(mClusters.size()); }
    /// The cluster at that place; null out of range.
    [[nodiscard]] FbxCluster* GetCluster(int pIndex);
    /// The same for a const skin.
    [[nodiscard]] const FbxCluster* GetCluster(int pIndex) const;

    /// The geometry that it deforms; null when there is none.
    [[nodiscard]] FbxGeometry* GetGeometry();
    /// Makes it deform that geometry and no other; null takes it away. False when it cannot be connected.
    bool SetGeometry(FbxGeometry* pGeometry);

    void SetSkinningType(EType pType) { mSkinningType = pType; } ///< Any value is stored.
    /// eRigid by default and for files that do not say.
    [[nodiscard]] EType GetSkinningType() const { return mSkinningType; }
    /// Percent, for applications; not checked.
    void SetDeformAccuracy(double pDeformAccuracy) { mDeformAccuracy = pDeformAccuracy; }
    [[nodiscard]] double GetDeformAccuracy() const { return mDeformAccuracy; } ///< 50 by default.

    /// Of eBlend: how much of the dual quaternions a point takes, 0 for all linear; nothing is said of other points.
    void AddControlPointIndex(int pIndex, double pBlendWeight = 0);
    /// How many points have such a weight.
    [[nodiscard]] int GetControlPointIndicesCount() const { return mIndices.count(); }
    /// As many as the count says, not checked against the geometry; null when there are none. Valid until the count
    /// changes.
    [[nodiscard]] int* GetControlPointIndices() const;
    /// One for each of the indices; null when there are none. Valid until the count changes.
    [[nodiscard]] double* GetControlPointBlendWeights() const;

protected:
    /// Keeps the list of clusters in step with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxCluster*> mClusters;
    EType mSkinningType = eRigid;
    double mDeformAccuracy = 50.0;
    mutable detail::PlainArray<int> mIndices;
    mutable detail::PlainArray<double> mBlendWeights;
};

FBXSDK_NAMESPACE_END
