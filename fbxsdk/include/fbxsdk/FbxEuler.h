// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The orders in which three Euler angles are applied.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxEuler {
public:
    /// The letters stand in the order of application: eOrderXYZ turns about X first, then Y, then Z.
    enum EOrder : int { eOrderXYZ = 0, eOrderXZY, eOrderYZX, eOrderYXZ, eOrderZXY, eOrderZYX, eOrderSphericXYZ };
};

typedef FbxEuler::EOrder EFbxRotationOrder;

inline constexpr EFbxRotationOrder eEulerXYZ = FbxEuler::eOrderXYZ;
inline constexpr EFbxRotationOrder eEulerXZY = FbxEuler::eOrderXZY;
inline constexpr EFbxRotationOrder eEulerYZX = FbxEuler::eOrderYZX;
inline constexpr EFbxRotationOrder eEulerYXZ = FbxEuler::eOrderYXZ;
inline constexpr EFbxRotationOrder eEulerZXY = FbxEuler::eOrderZXY;
inline constexpr EFbxRotationOrder eEulerZYX = FbxEuler::eOrderZYX;
inline constexpr EFbxRotationOrder eSphericXYZ = FbxEuler::eOrderSphericXYZ;

FBXSDK_NAMESPACE_END
