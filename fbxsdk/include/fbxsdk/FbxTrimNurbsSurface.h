// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A NURBS surface with parts cut out, and the outlines of the cuts.
#pragma once

#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>

FBXSDK_NAMESPACE_BEGIN

/// A closed outline of curves in the parameters of the surface: the boundary's source curves in order of connection.
class FBXSDK_DLL FbxBoundary : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxBoundary, FbxGeometry)

public:
    /// "OuterBoundary": the name of the property that marks the outline of the surface, as opposed to holes.
    static const char* const sOuterFlag;

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eBoundary.

    void AddCurve(FbxNurbsCurve* pCurve);    ///< Null and a curve that is already part of it change nothing.
    [[nodiscard]] int GetCurveCount() const; ///< How many curves the outline consists of.
    /// The curve at that index; null out of range.
    [[nodiscard]] FbxNurbsCurve* GetCurve(int pIndex) const;

protected:
    /// A boundary has no data in the file beyond its curves.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;
};

/// A NURBS surface cut by boundaries. Surface and boundaries are the object's sources.
class FBXSDK_DLL FbxTrimNurbsSurface : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxTrimNurbsSurface, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eTrimNurbsSurface.

    /// Replaces the surface that is cut; null removes it. Its manager still owns the surface.
    void SetNurbsSurface(const FbxNurbsSurface* pNurbs);
    [[nodiscard]] FbxNurbsSurface* GetNurbsSurface() const; ///< Null when there is none.
    bool AddBoundary(FbxBoundary* pBoundary);               ///< False for null and when it is already part of it.
    [[nodiscard]] int GetBoundaryCount() const;             ///< How many boundaries there are.
    /// The boundary at that index; null out of range.
    [[nodiscard]] FbxBoundary* GetBoundary(int pIndex) const;
    void SetFlipNormals(bool pFlip);           ///< Whether the normals are opposite to those of the surface.
    [[nodiscard]] bool GetFlipNormals() const; ///< False by default.

    /// The points are those of the surface; 0 without one.
    [[nodiscard]] int GetControlPointsCount() const override;
    /// Those of the surface. Null without a surface, the status untouched then, and without points.
    [[nodiscard]] FbxVector4* GetControlPoints(FbxStatus* pStatus = nullptr) const override;
    /// Changes the surface; no effect without one and out of range.
    void SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex) override;
    /// Of the surface; (0, 0, 0, 1) without one and out of range.
    [[nodiscard]] FbxVector4 GetControlPointAt(int pIndex) const override;

    /// The platform's own view: the data in memory, without reading the file.
    [[nodiscard]] bool& flipNormals() { return mFlipNormals; }

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;

private:
    bool mFlipNormals = false;
};

FBXSDK_NAMESPACE_END
