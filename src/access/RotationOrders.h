// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The two numberings of rotation orders.
#pragma once

#include "TnFbxTransform.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// One table for both directions; where an order of the library occurs twice, its first row is used for the reverse.
struct OrderRow {
    fbxsdk::FbxEuler::EOrder fbx;
    TnFbxTransform::EFbxTransformRotationOrder library;
};
inline constexpr OrderRow kRotationOrders[] = {
    {fbxsdk::FbxEuler::eOrderXYZ, TnFbxTransform::kFbxRotationOrderXYZ},
    {fbxsdk::FbxEuler::eOrderXZY, TnFbxTransform::kFbxRotationOrderXZY},
    {fbxsdk::FbxEuler::eOrderYZX, TnFbxTransform::kFbxRotationOrderYZX},
    {fbxsdk::FbxEuler::eOrderYXZ, TnFbxTransform::kFbxRotationOrderYXZ},
    {fbxsdk::FbxEuler::eOrderZXY, TnFbxTransform::kFbxRotationOrderZXY},
    {fbxsdk::FbxEuler::eOrderZYX, TnFbxTransform::kFbxRotationOrderZYX},
    {fbxsdk::FbxEuler::eOrderSphericXYZ, TnFbxTransform::kFbxRotationOrderXYZ},
};

// kept: a number that is no order reads as ZXY, not as the first
inline constexpr OrderRow kFallbackOrder = {fbxsdk::FbxEuler::eOrderZXY, TnFbxTransform::kFbxRotationOrderZXY};

inline TnFbxTransform::EFbxTransformRotationOrder rotationOrderOf(fbxsdk::FbxEuler::EOrder order) {
    for (const OrderRow& row : kRotationOrders)
        if (row.fbx == order)
            return row.library;
    return kFallbackOrder.library;
}

inline fbxsdk::FbxEuler::EOrder rotationOrderOf(TnFbxTransform::EFbxTransformRotationOrder order) {
    for (const OrderRow& row : kRotationOrders)
        if (row.library == order)
            return row.fbx;
    return kFallbackOrder.fbx;
}

} // namespace Tarnell::Fbx::detail
