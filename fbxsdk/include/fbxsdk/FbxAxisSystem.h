// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Axis systems: which way is up, which way is front, which hand; and the conversion of scenes between them.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;
class FbxScene;

class FBXSDK_DLL FbxAxisSystem {
public:
    enum EUpVector : int { eXAxis = 1, eYAxis = 2, eZAxis = 3 };
    /// Of the two axes beside the up axis, in the order X, Y, Z: the first is even, the second odd. The front points at
    /// the viewer. Both enumerations are negative for the opposite direction.
    enum EFrontVector : int { eParityEven = 1, eParityOdd = 2 };
    enum ECoordSystem : int { eRightHanded, eLeftHanded };
    enum EPreDefinedAxisSystem { eMayaZUp, eMayaYUp, eMax, eMotionBuilder, eOpenGL, eDirectX, eLightwave };

    constexpr FbxAxisSystem() = default; ///< Y up, odd, right-handed
    /// What is no axis or no parity gives the default system.
    FbxAxisSystem(EUpVector pUpVector, EFrontVector pFrontVector, ECoordSystem pCoorSystem);
    FbxAxisSystem(EPreDefinedAxisSystem pAxisSystem);

    bool operator==(const FbxAxisSystem& pOther) const;
    bool operator!=(const FbxAxisSystem& pOther) const { return !(*this == pOther); }

    /// Turns the nodes below the root, so that every global matrix is the old one seen from the new system. Rotation
    /// curves and mesh points stay. A change of handedness alone changes nothing.
    void ConvertScene(FbxScene* pScene) const;
    void ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot) const;
    void ConvertChildren(FbxNode* pRoot, const FbxAxisSystem& pSrcSystem) const;

    [[nodiscard]] EUpVector GetUpVector(int& pSign) const;
    [[nodiscard]] EFrontVector GetFrontVector(int& pSign) const;
    [[nodiscard]] ECoordSystem GetCoorSystem() const { return mCoorSystem; }

    static const FbxAxisSystem MayaZUp, MayaYUp, Max, Motionbuilder, OpenGL, DirectX, Lightwave;

    /// The system of three axes as files state them: 0 X, 1 Y, 2 Z, each with a sign. Axes that do not make a system
    /// give the default one.
    static FbxAxisSystem fromAxes(int pUp, int pUpSign, int pFront, int pFrontSign, int pCoord, int pCoordSign);
    struct Axes {
        int up, upSign, front, frontSign, coord, coordSign;
    };
    [[nodiscard]] Axes axes() const;

private:
    int mUp = eYAxis;
    int mFront = eParityOdd;
    ECoordSystem mCoorSystem = eRightHanded;
};

FBXSDK_NAMESPACE_END
