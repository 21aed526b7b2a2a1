// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxQuaternion.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

/// An affine transform as sixteen contiguous doubles, m[row][column].
///
/// Rows 0, 1, 2 are the images of the x, y and z axes, row 3 is the translation, column 3 is (0, 0, 0, 1). Products and
/// formulas read as with column vectors all the same: `(a * b).MultT(v) == a.MultT(b.MultT(v))`.
///
/// Euler angles are in degrees and always of order XYZ. The w of vector arguments is ignored, that of results is 1
/// unless said otherwise.
class FBXSDK_DLL FbxAMatrix : public FbxDouble4x4 {
public:
    FbxAMatrix() { SetIdentity(); } ///< The identity.
    /// Translation, rotation and scaling, as SetTRS.
    FbxAMatrix(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) { SetTRS(pT, pR, pS); }

    /// Row pY, column pX, 0 to 3 each; not checked.
    [[nodiscard]] double Get(int pY, int pX) const { return mData[pY][pX]; }
    [[nodiscard]] FbxVector4 GetRow(int pY) const { return mData[pY]; } ///< 0 to 3; not checked.
    [[nodiscard]] FbxVector4 GetColumn(int pX) const;                   ///< 0 to 3; not checked.

    [[nodiscard]] FbxVector4 GetT() const; ///< The translation.
    /// Euler angles of the axes scaled to unit length. At a pitch of ±90° all of the rotation is assigned to x, and z
    /// is 0.
    ///
    /// An axis scaled to zero is taken perpendicular to the others; when two or three are zero, the undetermined ones
    /// follow the coordinate axes. The result is never NaN for a finite matrix.
    [[nodiscard]] FbxVector4 GetR() const;
    /// Lengths of the axes; all three negative when the matrix mirrors.
    [[nodiscard]] FbxVector4 GetS() const;
    [[nodiscard]] FbxQuaternion GetQ() const; ///< The same rotation as GetR, as a unit quaternion.

    void SetIdentity(); ///< No translation, no rotation, scale 1.
    /// Replaces the translation and keeps rotation and scale.
    void SetT(const FbxVector4& pT);
    void SetR(const FbxVector4& pR);    ///< Replaces the rotation by Euler angles and keeps the other two.
    void SetS(const FbxVector4& pS);    ///< Replaces the scale and keeps the other two; shear is lost.
    void SetQ(const FbxQuaternion& pQ); ///< Replaces the rotation and keeps the other two.
    /// Replaces everything: scales first, then rotates, then translates.
    void SetTRS(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS);
    /// The same with the rotation as a quaternion.
    void SetTQS(const FbxVector4& pT, const FbxQuaternion& pQ, const FbxVector4& pS);

    /// The transformed point. No division by w; the result has the argument's w.
    [[nodiscard]] FbxVector4 MultT(const FbxVector4& pVector) const;
    /// The Euler angles of this rotation applied after the given one.
    [[nodiscard]] FbxVector4 MultR(const FbxVector4& pVector) const;
    /// The scale applied to a scale, component by component.
    [[nodiscard]] FbxVector4 MultS(const FbxVector4& pVector) const;

    /// The full product of all sixteen elements; the right matrix acts first.
    FbxAMatrix operator*(const FbxAMatrix& pOther) const;
    /// The full product; the argument acts first.
    FbxAMatrix& operator*=(const FbxAMatrix& pOther) { return *this = *this * pOther; }

    /// Scalars act on all sixteen elements; the result is no longer affine, unless the scalar is 1.
    FbxAMatrix operator*(double pValue) const;
    FbxAMatrix operator/(double pValue) const;                               ///< All sixteen divided.
    FbxAMatrix operator-() const { return *this * -1.0; }                    ///< All sixteen negated.
    FbxAMatrix& operator*=(double pValue) { return *this = *this * pValue; } ///< All sixteen multiplied.
    FbxAMatrix& operator/=(double pValue) { return *this = *this / pValue; } ///< All sixteen divided.

    /// The inverse of the affine part; the identity when there is none.
    [[nodiscard]] FbxAMatrix Inverse() const;
    [[nodiscard]] FbxAMatrix Transpose() const; ///< Rows become columns; with a translation the result is not affine.
    /// Interpolates from this matrix (weight 0) to the other one (weight 1): rotation on the shorter arc at constant
    /// speed, translation and scale linearly.
    [[nodiscard]] FbxAMatrix Slerp(const FbxAMatrix& pOther, double pWeight) const;

    /// Equal when no element differs by more than FBXSDK_TOLERANCE.
    bool operator==(const FbxAMatrix& pOther) const;
    bool operator!=(const FbxAMatrix& pOther) const { return !(*this == pOther); } ///< The opposite.
    /// Whether no element differs from the identity by more than the threshold.
    [[nodiscard]] bool IsIdentity(const double pThreshold = FBXSDK_TOLERANCE) const;

    operator double*() { return mData[0].mData; }             ///< The sixteen elements, row by row.
    operator const double*() const { return mData[0].mData; } ///< The same for reading.
    using FbxDouble4x4::operator[];
};

static_assert(sizeof(FbxAMatrix) == 16 * sizeof(double), "hosts work on the raw sixteen doubles");

FBXSDK_NAMESPACE_END
