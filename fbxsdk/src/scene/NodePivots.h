// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The pivot data of a node that is not stored in its properties.
#pragma once

#include <array>
#include <memory>

#include <fbxsdk/FbxEuler.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The vectors of a pivot set.
enum class PivotVector : unsigned char {
    preRotation,
    postRotation,
    rotationOffset,
    rotationPivot,
    scalingOffset,
    scalingPivot,
    geometricTranslation,
    geometricRotation,
    geometricScaling,
    count
};

using PivotVectors = std::array<FbxVector4, static_cast<std::size_t>(PivotVector::count)>;

/// A pivot set that is kept in memory only.
struct DestinationPivots {
    DestinationPivots();

    PivotVectors vectors;
    FbxEuler::EOrder rotationOrder = FbxEuler::eOrderXYZ;
    bool rotationSpaceForLimitOnly = false;
};

struct NodePivots {
    PivotVectors source; ///< what the getters return references to; the properties hold the values
    std::unique_ptr<DestinationPivots> destination;
};

} // namespace detail
FBXSDK_NAMESPACE_END
