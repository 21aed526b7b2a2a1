// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// A node of the scene's tree: a transform, children, attributes (cameras, lights, geometry, …) and materials.
///
/// Children, attributes and materials are the node's source objects of those classes, in order of connection. A node
/// has at most one parent and is never its own descendant: a connection that would make it one is removed at once, and
/// a node that is connected to a second parent leaves the first.
///
/// Angles are degrees; lengths are units of the scene (FbxGlobalSettings::GetSystemUnit). Vectors of pivots come as (x,
/// y, z, 1), and the w of what is set is ignored; a reference to one is valid until the same vector of the node is
/// read again.
class FBXSDK_DLL FbxNode : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxNode, FbxObject)

public:
    /// How the node is drawn; stored and written, of no effect on anything else.
    enum EShadingMode {
        eHardShading,    ///< the default
        eWireFrame,      ///< edges only
        eFlatShading,    ///< one shade for each polygon
        eLightShading,   ///< lit, without textures
        eTextureShading, ///< lit, with textures
        eFullShading     ///< everything that the application can render
    };
    /// The source set is what files hold and what is evaluated; the destination set is only stored in memory.
    enum EPivotSet {
        eSourcePivot,     ///< the set that is evaluated
        eDestinationPivot ///< a second set for conversions by hosts
    };

    FbxPropertyT<FbxDouble3> LclTranslation; ///< relative to the parent, scene units; (0, 0, 0); animatable
    FbxPropertyT<FbxDouble3> LclRotation;    ///< Euler angles in the node's order, degrees; (0, 0, 0); animatable
    FbxPropertyT<FbxDouble3> LclScaling;     ///< factors; (1, 1, 1); animatable
    FbxPropertyT<FbxDouble> Visibility;      ///< 0 hidden, 1 visible (the default); animatable

    // Hierarchy.

    /// Appends the node, which leaves its former parent and keeps its local transform; a node that is a child already
    /// keeps its position. In a scene, objects that are in none join the scene. False for null, the node itself and its
    /// ancestors.
    bool AddChild(FbxNode* pNode);
    /// Removes the child from this node; it stays a member of the scene, unparented. Returns the node, or null when
    /// it is no child.
    FbxNode* RemoveChild(FbxNode* pNode);
    /// Of direct children, or of all descendants.
    [[nodiscard]] int GetChildCount(bool pRecursive = false) const;
    /// The child at that index in order of connection; null out of range.
    [[nodiscard]] FbxNode* GetChild(int pIndex);
    /// The same for a const node.
    [[nodiscard]] const FbxNode* GetChild(int pIndex) const;
    [[nodiscard]] FbxNode* GetParent() { return mParent; } ///< Null for the root node and for an unparented node.
    [[nodiscard]] const FbxNode* GetParent() const { return mParent; } ///< The same for a const node.
    /// The first descendant of that name, each node before its children; among the children only without
    /// pRecursive. Null when there is none and for a null name. Renaming is not recorded: the initial name is the
    /// current name.
    [[nodiscard]] FbxNode* FindChild(const char* pName, bool pRecursive = true, bool pInitial = false);

    // Attributes.

    /// Makes the attribute the default one and disconnects the previous one, which is returned (null when there was
    /// none) and still belongs to its manager and scene. Null only removes.
    FbxNodeAttribute* SetNodeAttribute(FbxNodeAttribute* pNodeAttribute);
    /// The default attribute: that of the property DefaultAttributeIndex when it names one, else the first. Null
    /// without attributes.
    [[nodiscard]] FbxNodeAttribute* GetNodeAttribute();
    /// The same for a const node.
    [[nodiscard]] const FbxNodeAttribute* GetNodeAttribute() const;
    [[nodiscard]] int GetNodeAttributeCount() const; ///< Usually none or one.
    /// The attribute at that index in order of connection; null out of range.
    [[nodiscard]] FbxNodeAttribute* GetNodeAttributeByIndex(int pIndex);
    /// The same for a const node.
    [[nodiscard]] const FbxNodeAttribute* GetNodeAttributeByIndex(int pIndex) const;

    /// The default attribute when it is a mesh, else null.
    [[nodiscard]] FbxMesh* GetMesh();
    /// The default attribute when it is a camera, stereo cameras included, else null.
    [[nodiscard]] FbxCamera* GetCamera();
    /// The default attribute when it is a light, else null.
    [[nodiscard]] FbxLight* GetLight();
    /// The default attribute when it is a null, else null; null also for a node without attributes.
    [[nodiscard]] FbxNull* GetNull();
    /// The default attribute when it is a marker, else null.
    [[nodiscard]] FbxMarker* GetMarker();
    /// The default attribute when it is a bone, else null.
    [[nodiscard]] FbxSkeleton* GetSkeleton();
    /// The default attribute when it is geometry of any kind, else null.
    [[nodiscard]] FbxGeometry* GetGeometry();

    /// Sets the node that this node's X axis points at, replacing any other; null removes it. Stored and
    /// written, but ignored by evaluation.
    void SetTarget(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetTarget() const; ///< Null when there is none.
    /// Sets the node that this node's up vector points at; otherwise as SetTarget.
    void SetTargetUp(FbxNode* pNode);
    [[nodiscard]] FbxNode* GetTargetUp() const; ///< Null when there is none.

    void SetShadingMode(EShadingMode pShadingMode) { mShadingMode = pShadingMode; } ///< Any value is stored.
    [[nodiscard]] EShadingMode GetShadingMode() const { return mShadingMode; }      ///< eHardShading by default.

    // Materials.

    /// Appends the material to the connections. The material's index, also when it is connected already; -1 for
    /// null.
    int AddMaterial(FbxSurfaceMaterial* pMaterial);
    [[nodiscard]] int GetMaterialCount() const; ///< How many materials layer elements can refer to.
    /// The material at that index in order of connection; null out of range.
    [[nodiscard]] FbxSurfaceMaterial* GetMaterial(int pIndex) const;

    // Transform.

    /// The order in which the angles of LclRotation are applied; used when rotation is active.
    void SetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder pRotationOrder);
    /// Sets pRotationOrder to the stored order, whether it is used or not. A number from a file that is no order counts
    /// as XYZ.
    void GetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder& pRotationOrder) const;
    /// Whether rotation order, pre- and post-rotation and rotation limits are used; false by default. Both sets
    /// share it.
    void SetRotationActive(bool pVal);
    [[nodiscard]] bool GetRotationActive() const; ///< Whether they are used.
    /// With true, rotation order, pre- and post-rotation apply to the limits only and do not rotate the node.
    void SetRotationSpaceForLimitOnly(EPivotSet pPivotSet, bool pUseForLimitOnly);
    [[nodiscard]] bool GetRotationSpaceForLimitOnly(EPivotSet pPivotSet) const; ///< False by default.
    /// Rotates the node after its own rotation: degrees, always applied X, Y, Z. Used when rotation is active.
    void SetPreRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetPreRotation(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// Its inverse rotates the node before its own rotation: degrees, always applied X, Y, Z. Used when rotation is
    /// active.
    void SetPostRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetPostRotation(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// Added to the translation, outside of the rotation about the pivot; applications use it to keep a node in place
    /// when its pivot is moved. Scene units.
    void SetRotationOffset(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetRotationOffset(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// The point about which the node rotates, scene units.
    void SetRotationPivot(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetRotationPivot(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// Added inside of the rotation and outside of the scaling about the pivot; the counterpart of the rotation offset.
    /// Scene units.
    void SetScalingOffset(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetScalingOffset(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// The point about which the node is scaled, scene units.
    void SetScalingPivot(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] const FbxVector4& GetScalingPivot(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.

    /// Moves the node's attributes only: children do not inherit it, and the transform matrices exclude it.
    /// Scene units.
    void SetGeometricTranslation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricTranslation(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// Rotates the node's attributes only: degrees, applied X, Y, Z.
    void SetGeometricRotation(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricRotation(EPivotSet pPivotSet) const; ///< (0, 0, 0, 1) by default.
    /// Scales the node's attributes only.
    void SetGeometricScaling(EPivotSet pPivotSet, FbxVector4 pVector);
    [[nodiscard]] FbxVector4 GetGeometricScaling(EPivotSet pPivotSet) const; ///< (1, 1, 1, 1) by default.

    /// How the parent's scaling is inherited; eInheritRrSs by default.
    void SetTransformationInheritType(FbxTransform::EInheritType pInheritType);
    /// Sets pInheritType to the stored type. A number from a file that is no inherit type counts as eInheritRrSs.
    void GetTransformationInheritType(FbxTransform::EInheritType& pInheritType) const;

    // Evaluation.

    /// The node's global transform at a time: that of all layers of the scene's current stack, the static one at
    /// FBXSDK_TIME_INFINITE and outside of scenes. All changes take effect. The matrix is owned by the node and valid
    /// until it is evaluated again. The last three arguments have no effect: the source pivots are used, and targets
    /// are ignored.
    FbxAMatrix& EvaluateGlobalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE,
                                        FbxNode::EPivotSet pPivotSet = FbxNode::eSourcePivot, bool pApplyTarget = false,
                                        bool pForceEval = false);
    /// The node's transform relative to its parent at a time: translation, pivots, rotation and scaling combined,
    /// without the geometric transform. Otherwise the same, in a separate matrix.
    FbxAMatrix& EvaluateLocalTransform(FbxTime pTime = FBXSDK_TIME_INFINITE,
                                       FbxNode::EPivotSet pPivotSet = FbxNode::eSourcePivot, bool pApplyTarget = false,
                                       bool pForceEval = false);
    /// Widens the interval by the keys of the node, its attributes, their shape channels and all descendants, on
    /// one layer of the stack (null: the scene's current one). False, and nothing changed, when there are no keys or no
    /// such layer.
    bool GetAnimationInterval(FbxTimeSpan& pInterval, FbxAnimStack* pAnimStack = nullptr, int pAnimLayerId = 0);

    /// The platform's own evaluation state of the node.
    [[nodiscard]] detail::NodeEvaluation& evaluation();

protected:
    /// Keeps parent, children, attributes and materials consistent with the connections.
    FBXSDK_LOCAL void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) override;

private:
    FBXSDK_LOCAL void childConnected(FbxNode& child);
    FBXSDK_LOCAL void childDisconnected(FbxNode& child);

    [[nodiscard]] FBXSDK_LOCAL detail::NodePivots& pivots() const;
    [[nodiscard]] FBXSDK_LOCAL detail::DestinationPivots& destinationPivots() const;
    [[nodiscard]] FBXSDK_LOCAL const FbxVector4& pivotVector(EPivotSet set, detail::PivotVector which) const;
    FBXSDK_LOCAL void setPivotVector(EPivotSet set, detail::PivotVector which, const FbxVector4& vector);

    FbxNode* mParent = nullptr;
    std::vector<FbxNode*> mChildren;
    std::vector<FbxNodeAttribute*> mAttributes;
    std::vector<FbxSurfaceMaterial*> mMaterials;
    EShadingMode mShadingMode = eHardShading;
    mutable std::unique_ptr<detail::NodePivots> mPivots; ///< created on first use
    std::unique_ptr<detail::NodeEvaluation> mEvaluation; ///< created on first use
};

FBXSDK_NAMESPACE_END
