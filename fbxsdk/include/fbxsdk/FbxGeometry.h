// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxGeometryBase.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurve;
class FbxAnimLayer;

/// Geometry that can be deformed. Deformers are its source objects of that class, in order of connection.
class FBXSDK_DLL FbxGeometry : public FbxGeometryBase {
    FBXSDK_ABSTRACT_DECLARE(FbxGeometry, FbxGeometryBase)

public:
    /// Appends the deformer to the connections. The deformer's index, also when it is connected already; -1 for
    /// null.
    int AddDeformer(FbxDeformer* pDeformer);
    /// The removed deformer, which is not destroyed; null out of range, with a status.
    FbxDeformer* RemoveDeformer(int pIndex, FbxStatus* pStatus = nullptr);
    [[nodiscard]] int GetDeformerCount() const { return static_cast<int>(mDeformers.size()); } ///< Of all types.
    /// The deformer at that index; null out of range, with a status.
    [[nodiscard]] FbxDeformer* GetDeformer(int pIndex, FbxStatus* pStatus = nullptr) const;
    /// How many deformers of the type there are; 0 for eUnknown.
    [[nodiscard]] int GetDeformerCount(FbxDeformer::EDeformerType pType) const;
    /// The deformer at that index among those of the type; null out of range, with a status.
    [[nodiscard]] FbxDeformer* GetDeformer(int pIndex, FbxDeformer::EDeformerType pType,
                                           FbxStatus* pStatus = nullptr) const;

    /// The number of target shapes in all channels of all blend shapes.
    [[nodiscard]] int GetShapeCount() const;
    /// The curve of a channel's DeformPercent on the layer, in percent; null when there is none, also for bad indices,
    /// with a status. With pCreateAsNeeded a missing curve is created.
    FbxAnimCurve* GetShapeChannel(int pBlendShapeIndex, int pBlendShapeChannelIndex, FbxAnimLayer* pLayer,
                                  bool pCreateAsNeeded = false, FbxStatus* pStatus = nullptr);

protected:
    /// Keeps the list of deformers consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxDeformer*> mDeformers;
};

FBXSDK_NAMESPACE_END
