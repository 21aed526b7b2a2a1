// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxNode;
class FbxScene;

/// The up axis, the front axis and the handedness of a coordinate system; and the conversion of scenes between systems.
class FBXSDK_DLL FbxAxisSystem {
public:
    /// The axis that points up; negative for down.
    enum EUpVector : int {
        eXAxis = 1, ///< X
        eYAxis = 2, ///< Y
        eZAxis = 3  ///< Z
    };
    /// Of the two axes other than the up axis, in the order X, Y, Z: the first is even, the second odd. The front
    /// points at the viewer. Negative for the opposite direction.
    enum EFrontVector : int {
        eParityEven = 1, ///< the first of the two
        eParityOdd = 2   ///< the second of the two
    };
    /// The handedness of the system.
    enum ECoordSystem : int {
        eRightHanded, ///< up × front is the third axis
        eLeftHanded   ///< up × front is its opposite
    };
    /// The systems of well-known programs.
    enum EPreDefinedAxisSystem {
        eMayaZUp,       ///< Z up, -Y front, right-handed
        eMayaYUp,       ///< Y up, Z front, right-handed
        eMax,           ///< as eMayaZUp
        eMotionBuilder, ///< as eMayaYUp
        eOpenGL,        ///< as eMayaYUp
        eDirectX,       ///< Y up, Z front, left-handed
        eLightwave      ///< as eDirectX
    };

    constexpr FbxAxisSystem() = default; ///< Y up, odd, right-handed
    /// Numbers that are no axis or no parity give the default system.
    FbxAxisSystem(EUpVector pUpVector, EFrontVector pFrontVector, ECoordSystem pCoorSystem);
    /// The system of that program.
    FbxAxisSystem(EPreDefinedAxisSystem pAxisSystem);

    bool operator==(const FbxAxisSystem& pOther) const; ///< Same axes, same signs and same handedness.
    bool operator!=(const FbxAxisSystem& pOther) const { return !(*this == pOther); } ///< The opposite.

    /// Rotates the nodes below the root, so that every global matrix is the old one expressed in the new system, and
    /// with them cameras and bind matrices. Rotation curves and mesh points stay. A change of handedness alone rotates
    /// nothing. The scene's global settings state this system afterwards; a scene that has it already, and null, are
    /// left unchanged.
    void ConvertScene(FbxScene* pScene) const;
    /// The same for the children of that node instead of the root's.
    void ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot) const;
    /// Rotates the children of the node only: cameras, bind matrices and global settings stay.
    void ConvertChildren(FbxNode* pRoot, const FbxAxisSystem& pSrcSystem) const;

    /// The axis without its sign, which becomes pSign: 1 or -1.
    [[nodiscard]] EUpVector GetUpVector(int& pSign) const;
    /// The parity without its sign, which becomes pSign: 1 or -1.
    [[nodiscard]] EFrontVector GetFrontVector(int& pSign) const;
    [[nodiscard]] ECoordSystem GetCoorSystem() const { return mCoorSystem; } ///< The handedness.

    static const FbxAxisSystem MayaZUp, ///< Z up, -Y front, right-handed
        MayaYUp,                        ///< Y up, Z front, right-handed
        Max,                            ///< Z up, -Y front, right-handed
        Motionbuilder,                  ///< Y up, Z front, right-handed
        OpenGL,                         ///< Y up, Z front, right-handed
        DirectX,                        ///< Y up, Z front, left-handed
        Lightwave;                      ///< Y up, Z front, left-handed

    /// The system of three axes as files state them: 0 X, 1 Y, 2 Z, each with a sign. Inconsistent axes
    /// give the default system.
    static FbxAxisSystem fromAxes(int pUp, int pUpSign, int pFront, int pFrontSign, int pCoord, int pCoordSign);
    /// The three axes as files state them.
    struct Axes {
        int up,        ///< 0 X, 1 Y, 2 Z
            upSign,    ///< 1 or -1
            front,     ///< 0 X, 1 Y, 2 Z
            frontSign, ///< 1 or -1
            coord,     ///< the third axis
            coordSign; ///< 1 or -1
    };
    [[nodiscard]] Axes axes() const; ///< The axes from which fromAxes creates this system.

private:
    int mUp = eYAxis;
    int mFront = eParityOdd;
    ECoordSystem mCoorSystem = eRightHanded;
};

FBXSDK_NAMESPACE_END
