// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Units and axis systems as values; the conversions of scenes are in UnitConversion and AxisConversion.
#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxSystemUnit.h>

#include <cstdlib>

FBXSDK_NAMESPACE_BEGIN

constinit const FbxSystemUnit FbxSystemUnit::mm(0.1);
constinit const FbxSystemUnit FbxSystemUnit::dm(10.0);
constinit const FbxSystemUnit FbxSystemUnit::cm(1.0);
constinit const FbxSystemUnit FbxSystemUnit::m(100.0);
constinit const FbxSystemUnit FbxSystemUnit::km(100000.0);
constinit const FbxSystemUnit FbxSystemUnit::Inch(2.54);
constinit const FbxSystemUnit FbxSystemUnit::Foot(30.48);
constinit const FbxSystemUnit FbxSystemUnit::Mile(160934.4);
constinit const FbxSystemUnit FbxSystemUnit::Yard(91.44);
constinit const FbxSystemUnit::ConversionOptions FbxSystemUnit::DefaultConversionOptions;

double FbxSystemUnit::GetConversionFactorTo(const FbxSystemUnit& pTarget) const {
    // kept: the multiplier is stored and has no part in conversions.
    return mScaleFactor / pTarget.mScaleFactor;
}

double FbxSystemUnit::GetConversionFactorFrom(const FbxSystemUnit& pSource) const {
    return pSource.GetConversionFactorTo(*this);
}

const FbxAxisSystem FbxAxisSystem::MayaZUp(FbxAxisSystem::eMayaZUp);
const FbxAxisSystem FbxAxisSystem::MayaYUp(FbxAxisSystem::eMayaYUp);
const FbxAxisSystem FbxAxisSystem::Max(FbxAxisSystem::eMax);
const FbxAxisSystem FbxAxisSystem::Motionbuilder(FbxAxisSystem::eMotionBuilder);
const FbxAxisSystem FbxAxisSystem::OpenGL(FbxAxisSystem::eOpenGL);
const FbxAxisSystem FbxAxisSystem::DirectX(FbxAxisSystem::eDirectX);
const FbxAxisSystem FbxAxisSystem::Lightwave(FbxAxisSystem::eLightwave);

namespace {

int signOf(int number) { return number < 0 ? -1 : 1; }

/// The two axes other than the up axis: even first, then odd.
constexpr int kOthers[3][2] = {{1, 2}, {0, 2}, {0, 1}};

/// Up × front with its sign: the third axis of a right-handed system.
int rightHandedSign(int up, int upSign, int front, int frontSign) {
    return upSign * frontSign * ((up + 1) % 3 == front ? 1 : -1);
}

} // namespace

FbxAxisSystem::FbxAxisSystem(EUpVector pUpVector, EFrontVector pFrontVector, ECoordSystem pCoorSystem)
    : mUp(static_cast<int>(pUpVector)), mFront(static_cast<int>(pFrontVector)),
      mCoorSystem(pCoorSystem == eLeftHanded ? eLeftHanded : eRightHanded) {
    const auto isSound = [](int value, int largest) { return value != 0 && value >= -largest && value <= largest; };
    if (!isSound(mUp, eZAxis) || !isSound(mFront, eParityOdd))
        *this = FbxAxisSystem();
}

FbxAxisSystem::FbxAxisSystem(EPreDefinedAxisSystem pAxisSystem) {
    if (pAxisSystem == eMayaZUp || pAxisSystem == eMax) {
        mUp = eZAxis;
        mFront = -eParityOdd;
    }
    if (pAxisSystem == eDirectX || pAxisSystem == eLightwave)
        mCoorSystem = eLeftHanded;
}

bool FbxAxisSystem::operator==(const FbxAxisSystem& pOther) const {
    return mUp == pOther.mUp && mFront == pOther.mFront && mCoorSystem == pOther.mCoorSystem;
}

FbxAxisSystem::EUpVector FbxAxisSystem::GetUpVector(int& pSign) const {
    pSign = signOf(mUp);
    return static_cast<EUpVector>(std::abs(mUp));
}

FbxAxisSystem::EFrontVector FbxAxisSystem::GetFrontVector(int& pSign) const {
    pSign = signOf(mFront);
    return static_cast<EFrontVector>(std::abs(mFront));
}

FbxAxisSystem FbxAxisSystem::fromAxes(int pUp, int pUpSign, int pFront, int pFrontSign, int pCoord, int pCoordSign) {
    const auto isAxis = [](int axis) { return axis >= 0 && axis <= 2; };
    if (!isAxis(pUp) || !isAxis(pFront) || !isAxis(pCoord) || pUp == pFront || pUp == pCoord || pFront == pCoord)
        return {};
    FbxAxisSystem system;
    system.mUp = signOf(pUpSign) * (pUp + 1);
    system.mFront = signOf(pFrontSign) * (kOthers[pUp][0] == pFront ? eParityEven : eParityOdd);
    const int rightHanded = rightHandedSign(pUp, signOf(pUpSign), pFront, signOf(pFrontSign));
    system.mCoorSystem = signOf(pCoordSign) == rightHanded ? eRightHanded : eLeftHanded;
    return system;
}

FbxAxisSystem::Axes FbxAxisSystem::axes() const {
    Axes axes{};
    axes.up = std::abs(mUp) - 1;
    axes.upSign = signOf(mUp);
    axes.front = kOthers[axes.up][std::abs(mFront) == eParityEven ? 0 : 1];
    axes.frontSign = signOf(mFront);
    axes.coord = 3 - axes.up - axes.front;
    axes.coordSign = rightHandedSign(axes.up, axes.upSign, axes.front, axes.frontSign);
    if (mCoorSystem == eLeftHanded)
        axes.coordSign = -axes.coordSign;
    return axes;
}

FBXSDK_NAMESPACE_END
