// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Geometry that can be deformed.
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxGeometryBase.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurve;
class FbxAnimLayer;

/// Deformers are the geometry's source objects of that class, in order of connection.
class FBXSDK_DLL FbxGeometry : public FbxGeometryBase {
    FBXSDK_ABSTRACT_DECLARE(FbxGeometry, FbxGeometryBase)

public:
    /// The deformer's index, also when it is there already; -1 for null.
    int AddDeformer(FbxDeformer* pDeformer);
    /// The removed deformer; null out of range.
    FbxDeformer* RemoveDeformer(int pIndex, FbxStatus* pStatus = nullptr);
    [[nodiscard]] int GetDeformerCount() const { return static_cast<int>(mDeformers.size()); }
    /// Null out of range.
    [[nodiscard]] FbxDeformer* GetDeformer(int pIndex, FbxStatus* pStatus = nullptr) const;
    // The same among the deformers of one type.
    [[nodiscard]] int GetDeformerCount(FbxDeformer::EDeformerType pType) const;
    [[nodiscard]] FbxDeformer* GetDeformer(int pIndex, FbxDeformer::EDeformerType pType,
                                           FbxStatus* pStatus = nullptr) const;

    /// All target shapes of all channels of all blend shapes.
    [[nodiscard]] int GetShapeCount() const;
    /// The curve of a channel's DeformPercent on the layer; null when there is none, also for bad indices.
    FbxAnimCurve* GetShapeChannel(int pBlendShapeIndex, int pBlendShapeChannelIndex, FbxAnimLayer* pLayer,
                                  bool pCreateAsNeeded = false, FbxStatus* pStatus = nullptr);

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxDeformer*> mDeformers;
};

FBXSDK_NAMESPACE_END
