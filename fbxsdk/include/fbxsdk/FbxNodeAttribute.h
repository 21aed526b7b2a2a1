// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The base of what can stand on a node: cameras, lights, geometry, …
#pragma once

#include <vector>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;

/// Also the class of attributes of a kind that the platform has no class for; their properties are kept.
class FBXSDK_DLL FbxNodeAttribute : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxNodeAttribute, FbxObject)

public:
    enum EType {
        eUnknown = 0,
        eNull,
        eMarker,
        eSkeleton,
        eMesh,
        eNurbs,
        ePatch,
        eCamera,
        eCameraStereo,
        eCameraSwitcher,
        eLight,
        eOpticalReference,
        eOpticalMarker,
        eNurbsCurve,
        eTrimNurbsSurface,
        eBoundary,
        eNurbsSurface,
        eShape,
        eLODGroup,
        eSubDiv,
        eCachedEffect,
        eLine
    };

    static const char* const sColor;
    static const FbxDouble3 sDefaultColor;

    FbxPropertyT<FbxDouble3> Color; ///< 0 to 1

    [[nodiscard]] virtual EType GetAttributeType() const;

    /// How many nodes the attribute stands on; more than one for instances.
    [[nodiscard]] int GetNodeCount() const;
    /// In order of connection; null out of range.
    [[nodiscard]] FbxNode* GetNode(int pIndex = 0) const;

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxNode*> mNodes;
};

FBXSDK_NAMESPACE_END
