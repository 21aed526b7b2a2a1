// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformation by the movement of other nodes.
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxPlainArray.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCluster;
class FbxGeometry;

/// Clusters are the skin's source objects of that class, in order of connection.
class FBXSDK_DLL FbxSkin : public FbxDeformer {
    FBXSDK_OBJECT_DECLARE(FbxSkin, FbxDeformer)

public:
    enum EType { eRigid, eLinear, eDualQuaternion, eBlend };

    [[nodiscard]] EDeformerType GetDeformerType() const override;

    /// False for null and when the cluster is there already.
    bool AddCluster(FbxCluster* pCluster);
    /// Returns the cluster, or null when it is none of the skin.
    FbxCluster* RemoveCluster(FbxCluster* pCluster);
    [[nodiscard]] int GetClusterCount() const { return static_cast<int>(mClusters.size()); }
    /// Null out of range.
    [[nodiscard]] FbxCluster* GetCluster(int pIndex);
    [[nodiscard]] const FbxCluster* GetCluster(int pIndex) const;

    /// Null when the skin deforms nothing.
    [[nodiscard]] FbxGeometry* GetGeometry();
    bool SetGeometry(FbxGeometry* pGeometry);

    void SetSkinningType(EType pType) { mSkinningType = pType; }
    [[nodiscard]] EType GetSkinningType() const { return mSkinningType; }
    /// Percent.
    void SetDeformAccuracy(double pDeformAccuracy) { mDeformAccuracy = pDeformAccuracy; }
    [[nodiscard]] double GetDeformAccuracy() const { return mDeformAccuracy; }

    // Of eBlend: how much of the dual quaternions a point takes, 0 for all linear; nothing is said of other points.
    void AddControlPointIndex(int pIndex, double pBlendWeight = 0);
    [[nodiscard]] int GetControlPointIndicesCount() const { return mIndices.count(); }
    // As many as the count says; null when there are none. The indices are not checked against the geometry.
    [[nodiscard]] int* GetControlPointIndices() const;
    [[nodiscard]] double* GetControlPointBlendWeights() const;

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxCluster*> mClusters;
    EType mSkinningType = eRigid;
    double mDeformAccuracy = 50.0;
    mutable detail::PlainArray<int> mIndices;
    mutable detail::PlainArray<double> mBlendWeights;
};

FBXSDK_NAMESPACE_END
