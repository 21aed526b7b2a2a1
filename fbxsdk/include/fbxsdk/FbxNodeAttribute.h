// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;

/// The base of node attributes: cameras, lights, geometry, … One attribute may belong to several nodes. Also the class
/// of attributes of a kind without a class in the platform; their properties are kept.
class FBXSDK_DLL FbxNodeAttribute : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxNodeAttribute, FbxObject)

public:
    /// What kind of attribute it is. The numbers are part of the API.
    enum EType {
        eUnknown = 0,      ///< none of the others
        eNull,             ///< FbxNull
        eMarker,           ///< FbxMarker, of any type
        eSkeleton,         ///< FbxSkeleton
        eMesh,             ///< FbxMesh
        eNurbs,            ///< FbxNurbs
        ePatch,            ///< FbxPatch
        eCamera,           ///< FbxCamera
        eCameraStereo,     ///< FbxCameraStereo
        eCameraSwitcher,   ///< FbxCameraSwitcher
        eLight,            ///< FbxLight
        eOpticalReference, ///< FbxOpticalReference
        eOpticalMarker,    ///< of the API; no class here has it
        eNurbsCurve,       ///< FbxNurbsCurve
        eTrimNurbsSurface, ///< FbxTrimNurbsSurface
        eBoundary,         ///< FbxBoundary
        eNurbsSurface,     ///< FbxNurbsSurface
        eShape,            ///< FbxShape
        eLODGroup,         ///< FbxLODGroup
        eSubDiv,           ///< FbxSubDiv
        eCachedEffect,     ///< FbxCachedEffect
        eLine              ///< FbxLine
    };

    static const char* const sColor;       ///< The name of the property Color.
    static const FbxDouble3 sDefaultColor; ///< (0.8, 0.8, 0.8); lights have (1, 1, 1).

    FbxPropertyT<FbxDouble3> Color; ///< red, green, blue, 0 to 1; for display; of lights their colour

    [[nodiscard]] virtual EType GetAttributeType() const; ///< eUnknown for an attribute without a class of its own.

    /// How many nodes have the attribute; more than one for instances.
    [[nodiscard]] int GetNodeCount() const;
    /// The node at that index in order of connection; null out of range.
    [[nodiscard]] FbxNode* GetNode(int pIndex = 0) const;

protected:
    /// Keeps the list of nodes consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    std::vector<FbxNode*> mNodes;
};

FBXSDK_NAMESPACE_END
