// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The transform data of nodes: pivots, offsets, pre- and post-rotation, order and inherit type. The source set is the
// node's properties; the destination set is stored separately.
#include "scene/NodePivots.h"

#include <fbxsdk/FbxNode.h>

#include "object/ObjectData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

namespace detail {

DestinationPivots::DestinationPivots() {
    vectors[static_cast<std::size_t>(PivotVector::geometricScaling)] = FbxVector4(1, 1, 1);
}

} // namespace detail

namespace {

using detail::PivotVector;

constexpr std::size_t placeOf(PivotVector which) { return static_cast<std::size_t>(which); }

struct PivotRows {
    /// In the order of PivotVector.
    std::array<int, placeOf(PivotVector::count)> vectors{
        row("PreRotation"),          row("PostRotation"),      row("RotationOffset"),
        row("RotationPivot"),        row("ScalingOffset"),     row("ScalingPivot"),
        row("GeometricTranslation"), row("GeometricRotation"), row("GeometricScaling")};
    int rotationOrder = row("RotationOrder");
    int rotationActive = row("RotationActive");
    int rotationSpaceForLimitOnly = row("RotationSpaceForLimitOnly");
    int inheritType = row("InheritType");

    static int row(std::string_view name) { return detail::rowIndex(detail::kNodeRows, name); }
};

const PivotRows& pivotRows() {
    static const PivotRows rows;
    return rows;
}

FbxProperty propertyOf(const FbxNode& node, int row) { return {const_cast<FbxNode*>(&node), row}; }

/// A number from a file as an enumerator: numbers outside 0 to `last` count as 0.
template <class Enum>
Enum enumeratorOf(const FbxProperty& property, Enum last) {
    const FbxEnum number = property.Get<FbxEnum>();
    return number >= 0 && number <= static_cast<FbxEnum>(last) ? static_cast<Enum>(number) : static_cast<Enum>(0);
}

} // namespace

detail::NodePivots& FbxNode::pivots() const {
    if (!mPivots)
        mPivots = std::make_unique<detail::NodePivots>();
    return *mPivots;
}

detail::DestinationPivots& FbxNode::destinationPivots() const {
    auto& destination = pivots().destination;
    if (!destination)
        destination = std::make_unique<detail::DestinationPivots>();
    return *destination;
}

const FbxVector4& FbxNode::pivotVector(EPivotSet set, detail::PivotVector which) const {
    static const detail::DestinationPivots defaults;
    const std::size_t place = placeOf(which);
    if (set == eDestinationPivot) {
        const bool stored = mPivots && mPivots->destination;
        return (stored ? *mPivots->destination : defaults).vectors[place];
    }
    // Vectors with their default values, which are most, need no memory.
    const int row = pivotRows().vectors[place];
    if (!data().property(row))
        return defaults.vectors[place];
    FbxVector4& vector = pivots().source[place];
    vector = propertyOf(*this, row).Get<FbxDouble3>();
    return vector;
}

void FbxNode::setPivotVector(EPivotSet set, detail::PivotVector which, const FbxVector4& vector) {
    const std::size_t place = placeOf(which);
    const FbxDouble3 value(vector[0], vector[1], vector[2]);
    if (set == eDestinationPivot)
        destinationPivots().vectors[place] = value;
    else
        propertyOf(*this, pivotRows().vectors[place]).Set(value);
}

void FbxNode::SetPreRotation(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::preRotation, pVector);
}

const FbxVector4& FbxNode::GetPreRotation(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::preRotation);
}

void FbxNode::SetPostRotation(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::postRotation, pVector);
}

const FbxVector4& FbxNode::GetPostRotation(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::postRotation);
}

void FbxNode::SetRotationOffset(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::rotationOffset, pVector);
}

const FbxVector4& FbxNode::GetRotationOffset(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::rotationOffset);
}

void FbxNode::SetRotationPivot(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::rotationPivot, pVector);
}

const FbxVector4& FbxNode::GetRotationPivot(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::rotationPivot);
}

void FbxNode::SetScalingOffset(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::scalingOffset, pVector);
}

const FbxVector4& FbxNode::GetScalingOffset(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::scalingOffset);
}

void FbxNode::SetScalingPivot(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::scalingPivot, pVector);
}

const FbxVector4& FbxNode::GetScalingPivot(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::scalingPivot);
}

void FbxNode::SetGeometricTranslation(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::geometricTranslation, pVector);
}

FbxVector4 FbxNode::GetGeometricTranslation(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::geometricTranslation);
}

void FbxNode::SetGeometricRotation(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::geometricRotation, pVector);
}

FbxVector4 FbxNode::GetGeometricRotation(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::geometricRotation);
}

void FbxNode::SetGeometricScaling(EPivotSet pPivotSet, FbxVector4 pVector) {
    setPivotVector(pPivotSet, PivotVector::geometricScaling, pVector);
}

FbxVector4 FbxNode::GetGeometricScaling(EPivotSet pPivotSet) const {
    return pivotVector(pPivotSet, PivotVector::geometricScaling);
}

void FbxNode::SetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder pRotationOrder) {
    if (pPivotSet == eDestinationPivot)
        destinationPivots().rotationOrder = pRotationOrder;
    else
        propertyOf(*this, pivotRows().rotationOrder).Set(pRotationOrder);
}

void FbxNode::GetRotationOrder(EPivotSet pPivotSet, EFbxRotationOrder& pRotationOrder) const {
    if (pPivotSet == eDestinationPivot) {
        const bool stored = mPivots && mPivots->destination;
        pRotationOrder = stored ? mPivots->destination->rotationOrder : FbxEuler::eOrderXYZ;
    } else {
        pRotationOrder = enumeratorOf(propertyOf(*this, pivotRows().rotationOrder), FbxEuler::eOrderSphericXYZ);
    }
}

void FbxNode::SetRotationActive(bool pVal) { propertyOf(*this, pivotRows().rotationActive).Set(pVal); }

bool FbxNode::GetRotationActive() const { return propertyOf(*this, pivotRows().rotationActive).Get<FbxBool>(); }

void FbxNode::SetRotationSpaceForLimitOnly(EPivotSet pPivotSet, bool pUseForLimitOnly) {
    if (pPivotSet == eDestinationPivot)
        destinationPivots().rotationSpaceForLimitOnly = pUseForLimitOnly;
    else
        propertyOf(*this, pivotRows().rotationSpaceForLimitOnly).Set(pUseForLimitOnly);
}

bool FbxNode::GetRotationSpaceForLimitOnly(EPivotSet pPivotSet) const {
    if (pPivotSet == eDestinationPivot)
        return mPivots && mPivots->destination && mPivots->destination->rotationSpaceForLimitOnly;
    return propertyOf(*this, pivotRows().rotationSpaceForLimitOnly).Get<FbxBool>();
}

void FbxNode::SetTransformationInheritType(FbxTransform::EInheritType pInheritType) {
    propertyOf(*this, pivotRows().inheritType).Set(pInheritType);
}

void FbxNode::GetTransformationInheritType(FbxTransform::EInheritType& pInheritType) const {
    pInheritType = enumeratorOf(propertyOf(*this, pivotRows().inheritType), FbxTransform::eInheritRrs);
}

FBXSDK_NAMESPACE_END
