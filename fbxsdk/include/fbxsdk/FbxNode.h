// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A node of the scene's tree: its transform, its children, and what stands on it.
#pragma once

#include <memory>
#include <vector>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxEuler.h>
#include <fbxsdk/FbxNodeAttribute.h>
#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxTime.h>
#include <fbxsdk/FbxTransform.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimStack;
class FbxCamera;
class FbxGeometry;
class FbxLight;
class FbxMarker;
class FbxMesh;
class FbxNull;
class FbxSkeleton;
class FbxSurfaceMaterial;

namespace detail {
struct DestinationPivots;
struct NodeEvaluation;
struct NodePivots;
enum class PivotVector : unsigned char;
} // namespace detail

/// Children, attributes and materials are the node's source objects of those classes, in order of connection. A node
/// has at most one parent and is never below itself: a connection that would make it so is cut again at once, and a
/// node that is connected to a second parent leaves the first.
class FBXSDK_DLL FbxNode : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxNode, FbxObject)

public:
    enum EShadingMode { eHardShading, eWireFrame, eFlatShading, eLightShading, eTextureShading, eFullShading };
    /// The source set is what files hold and what is evaluated; the destination set is stored and no more.
    enum EPivotSet { eSourcePivot, eDestinationPivot };

    FbxPropertyT<FbxDouble3> LclTranslation;
    FbxPropertyT<FbxDouble3> LclRotation; ///< Euler angles, degrees
    FbxPropertyT<FbxDouble3> LclScaling;
    FbxPropertyT<FbxDouble> Visibility; ///< 0 hidden, 1 visible

    // Hierarchy.

    /// Appends the node, which leaves its former parent and keeps its local transform; a node that is a child already
    /// keeps its place. In a scene, what was in none joins the scene. False for null, the node itself and its
    /// ancestors.
    bool AddChild(FbxNode* pNode);
    /// Returns the node, or null when it is no child.
    FbxNode* RemoveChild(FbxNode* pNode);
    /// Of direct children, or of everything below the node.
    [[nodiscard]] int GetChildCount(bool pRecursive = false) const;
    /// Null out of range.
    [[nodiscard]] FbxNode* GetChild(int pIndex);
    [[nodiscard]] const FbxNode* GetChild(int pIndex) const;
    [[nodiscard]] FbxNode* GetParent() { return mParent; }
    [[nodiscard]] const FbxNode* GetParent() const { return mParent; }
    /// The first node of the name below this one, each node before its children; null when there is none. Names have no
    /// history here: the initial name is the name.
    [[nodiscard]] FbxNode* FindChild(const char* pName, bool pRecursive = true, bool pInitial = false);

    // Attributes.

    /// Replaces the default attribute, and returns the one that was; null removes it.
    FbxNodeAttribute* SetNodeAttribute(FbxNodeAttribute* pNodeAttribute);
    /// The default attribute: that of the property DefaultAttributeIndex when it names one, else the first.
    [[nodiscard]] FbxNodeAttribute* GetNodeAttribute();
    [[nodiscard]] const FbxNodeAttribute* GetNodeAttribute() const;
    [[nodiscard]] int GetNodeAttributeCount() const;
    [[nodiscard]] FbxNodeAttribute* GetNodeAttributeByIndex(int pIndex);
    [[nodiscard]] const FbxNodeAttribute* GetNodeAttributeByIndex(int pIndex) const;

    // The default attribute when it is of that class, else null.
    [[nodiscard]] FbxMesh* GetMesh();
    [[nodiscard]] FbxCamera* GetCamera();
    [[nodiscard]] FbxLight* GetLight();
    [[nodiscard]] FbxNull* GetNull();
    [[nodiscard]] FbxMarker* GetMarker();
    [[nodiscard]] FbxSkeleton* GetSkeleton();
    [[nodiscard]] FbxGeometry* GetGeometry();

    // Targets: the nodes that this one's X axis and up vector follow. Null when there is none.
    void SetTarget(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetTarget() const;
    void SetTargetUp(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetTargetUp() const;

    void SetShadingMode(EShadingMode pShadingMode) { mShadingMode = pShadingMode; }
    [[nodiscard]] EShadingMode GetShadingMode() const { return mShadingMode; }

    // Materials.

    /// The material's index, also when it is there already; -1 for null.
    int AddMaterial(FbxSurfaceMaterial* pMaterial);
    [[nodiscard]] int GetMaterialCount() const;
    /// Null out of range.
    [[nodiscard]] FbxSurfaceMaterial* GetMaterial(int pIndex) const;

    // Transform. Vectors come as (x, y, z, 1), the w of what is set is ignored. A reference stays valid until the same
    // value is asked for again. A number from a file that is no order or inherit type counts as the first.

    void SetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder pRotationOrder);
    void GetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder& pRotationOrder) const;
    /// Whether rotation order, pre- and post-rotation and rotation limits are in force.
    void SetRotationActive(bool pVal);
    [[nodiscard]] bool GetRotationActive() const;
    void SetRotationSpaceForLimitOnly(EPivotSet pPivotSet, bool pUseForLimitOnly);
    [[nodiscard]] bool GetRotationSpaceForLimitOnly(EPivotSet pPivotSet) const;
    void SetPreRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetPreRotation(EPivotSet pPivotSet) const;
    void SetPostRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetPostRotation(EPivotSet pPivotSet) const;
    void SetRotationOffset(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetRotationOffset(EPivotSet pPivotSet) const;
    void SetRotationPivot(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetRotationPivot(EPivotSet pPivotSet) const;
    void SetScalingOffset(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetScalingOffset(EPivotSet pPivotSet) const;
    void SetScalingPivot(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetScalingPivot(EPivotSet pPivotSet) const;

    // Of the node's attributes only; children do not inherit it, and the transform matrices do not contain it.
    void SetGeometricTranslation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricTranslation(EPivotSet pPivotSet) const;
    void SetGeometricRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricRotation(EPivotSet pPivotSet) const;
    void SetGeometricScaling(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricScaling(EPivotSet pPivotSet) const;

    void SetTransformationInheritType(FbxTransform::EInheritType pInheritType);
    void GetTransformationInheritType(FbxTransform::EInheritType& pInheritType) const;

    // Evaluation, over all layers of the scene's current stack; the static values at FBXSDK_TIME_INFINITE. The matrix
    // is the node's own until it is evaluated again. Targets do not enter, and nothing needs to be forced: changes are
    // seen.

    FbxAMatrix& EvaluateGlobalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE,
                                        FbxNode::EPivotSet pPivotSet = FbxNode::eSourcePivot, bool pApplyTarget = false,
                                        bool pForceEval = false);
    FbxAMatrix& EvaluateLocalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE,
                                       FbxNode::EPivotSet pPivotSet = FbxNode::eSourcePivot, bool pApplyTarget = false,
                                       bool pForceEval = false);
    /// Widens the interval by the keys of the node, its attributes and everything below it, on one layer of the stack
    /// (null: the scene's current one). False, and nothing changed, when there are no keys or no such layer.
    bool GetAnimationInterval(FbxTimeSpan& pInterval, FbxAnimStack* pAnimStack = nullptr, int pAnimLayerId = 0);

    /// The platform's own evaluation state of the node.
    [[nodiscard]] detail::NodeEvaluation& evaluation();

protected:
    void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    void childConnected(FbxNode& child);
    void childDisconnected(FbxNode& child);

    [[nodiscard]] detail::NodePivots& pivots() const;
    [[nodiscard]] detail::DestinationPivots& destinationPivots() const;
    [[nodiscard]] const FbxVector4& pivotVector(EPivotSet set, detail::PivotVector which) const;
    void setPivotVector(EPivotSet set, detail::PivotVector which, const FbxVector4& vector);

    FbxNode* mParent = nullptr;
    std::vector<FbxNode*> mChildren;
    std::vector<FbxNodeAttribute*> mAttributes;
    std::vector<FbxSurfaceMaterial*> mMaterials;
    EShadingMode mShadingMode = eHardShading;
    mutable std::unique_ptr<detail::NodePivots> mPivots; ///< made on first use
    std::unique_ptr<detail::NodeEvaluation> mEvaluation; ///< made on first use
};

FBXSDK_NAMESPACE_END
