// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCluster;
class FbxGeometry;

/// Deformation by moving nodes. Clusters are the skin's source objects of that class, in order of connection.
class FBXSDK_DLL FbxSkin : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxSkin, FbxDeformer)

public:
    /// How the clusters of a point are blended.
    enum EType {
        eRigid,          ///< each point follows one cluster; the default
        eLinear,         ///< by the sum of their matrices
        eDualQuaternion, ///< by dual quaternions, which keep the volume
        eBlend           ///< between both, by the weights of AddControlPointIndex
    };

    [[nodiscard]] EDeformerType GetDeformerType() const override; ///< eSkin.

    /// False for null and when the cluster is already part of it.
    bool AddCluster(FbxCluster* pCluster);
    /// Returns the cluster, or null when it is not the skin's.
    FbxCluster* RemoveCluster(FbxCluster* pCluster);
    /// How many clusters there are.
    [[nodiscard]] int GetClusterCount() const { return static_cast<int>(mClusters.size()); }
    /// The cluster at that index; null out of range.
    [[nodiscard]] FbxCluster* GetCluster(int pIndex);
    /// The same for a const skin.
    [[nodiscard]] const FbxCluster* GetCluster(int pIndex) const;

    /// The geometry that it deforms; null when there is none.
    [[nodiscard]] FbxGeometry* GetGeometry();
    /// Makes it deform that geometry and no other; null removes it from its geometry. False when it cannot be
    /// connected.
    bool SetGeometry(FbxGeometry* pGeometry);

    void SetSkinningType(EType pType) { mSkinningType = pType; } ///< Any value is stored.
    /// eRigid by default and for files that do not state it.
    [[nodiscard]] EType GetSkinningType() const { return mSkinningType; }
    /// Percent, for applications; not checked.
    void SetDeformAccuracy(double pDeformAccuracy) { mDeformAccuracy = pDeformAccuracy; }
    [[nodiscard]] double GetDeformAccuracy() const { return mDeformAccuracy; } ///< 50 by default.

    /// Of eBlend: the share of the dual quaternions at a point, 0 for all linear; other points are unaffected.
    void AddControlPointIndex(int pIndex, double pBlendWeight = 0);
    /// How many points have such a weight.
    [[nodiscard]] int GetControlPointIndicesCount() const { return mIndices.count(); }
    /// As many as the count says, not checked against the geometry; null when there are none. Valid until the count
    /// changes.
    [[nodiscard]] int* GetControlPointIndices() const;
    /// One for each of the indices; null when there are none. Valid until the count changes.
    [[nodiscard]] double* GetControlPointBlendWeights() const;

protected:
    /// Keeps the list of clusters consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxCluster*> mClusters;
    EType mSkinningType = eRigid;
    double mDeformAccuracy = 50.0;
    mutable detail::PlainArray<int> mIndices;
    mutable detail::PlainArray<double> mBlendWeights;
};

FBXSDK_NAMESPACE_END
