// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A NURBS surface with parts cut away, and the outlines of the cuts.
#pragma once

#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>

FBXSDK_NAMESPACE_BEGIN

/// A closed outline of curves in the parameters of the surface: the boundary's source curves in order of connection.
class FBXSDK_DLL FbxBoundary : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxBoundary, FbxGeometry)

public:
    static const char* const sOuterFlag;

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void AddCurve(FbxNurbsCurve* pCurve);
    [[nodiscard]] int GetCurveCount() const;
    /// Null out of range.
    [[nodiscard]] FbxNurbsCurve* GetCurve(int pIndex) const;

protected:
    bool readSource(const detail::GeometrySource& pSource) override;
};

/// Surface and boundaries are the object's sources.
class FBXSDK_DLL FbxTrimNurbsSurface : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxTrimNurbsSurface, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void SetNurbsSurface(const FbxNurbsSurface* pNurbs);
    [[nodiscard]] FbxNurbsSurface* GetNurbsSurface() const;
    bool AddBoundary(FbxBoundary* pBoundary);
    [[nodiscard]] int GetBoundaryCount() const;
    /// Null out of range.
    [[nodiscard]] FbxBoundary* GetBoundary(int pIndex) const;
    void SetFlipNormals(bool pFlip);
    [[nodiscard]] bool GetFlipNormals() const;

    // The points are those of the surface.
    [[nodiscard]] int GetControlPointsCount() const override;
    [[nodiscard]] FbxVector4* GetControlPoints(FbxStatus* pStatus = nullptr) const override;
    void SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex) override;
    [[nodiscard]] FbxVector4 GetControlPointAt(int pIndex) const override;

    /// The platform's own view: as it is, without asking the file.
    [[nodiscard]] bool& flipNormals() { return mFlipNormals; }

protected:
    bool readSource(const detail::GeometrySource& pSource) override;

private:
    bool mFlipNormals = false;
};

FBXSDK_NAMESPACE_END
