// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// The common part of both classes of NURBS surfaces. U runs fastest through the control points; their w is the weight
/// and not multiplied into x, y, z.
///
/// A direction of n control points and a given order has, by its type, this many knots: open n + order, closed
/// n + order + 1 (the first point is repeated), periodic n + 2 order - 1 (the first order - 1 points are repeated).
class FBXSDK_DLL FbxNurbsSurfaceBase : public FbxGeometry {
public:
    /// How a direction ends.
    enum EType {
        ePeriodic, ///< at its first points, without an edge
        eClosed,   ///< at its first points
        eOpen      ///< at its last points; the default
    };
    /// The level of detail at which applications draw the surface; kept in memory, not in files.
    enum ESurfaceMode {
        eRaw,           ///< its control points
        eLowNoNormals,  ///< coarsely, without normals
        eLow,           ///< coarsely
        eHighNoNormals, ///< finely, without normals
        eHigh           ///< finely; the default
    };

    using FbxGeometry::InitControlPoints;
    /// Sizes points and knots, which become zero; no knots in a direction whose order does not match its count. To be
    /// called after SetOrder.
    void InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType);
    [[nodiscard]] int GetUCount() const { return direction(0).count; }      ///< Control points along u.
    [[nodiscard]] int GetVCount() const { return direction(1).count; }      ///< Control points along v.
    [[nodiscard]] EType GetNurbsUType() const { return direction(0).type; } ///< eOpen by default.
    [[nodiscard]] EType GetNurbsVType() const { return direction(1).type; } ///< eOpen by default.

    /// The order is the degree plus one; points and knots stay.
    void SetOrder(FbxUInt pUOrder, FbxUInt pVOrder);
    [[nodiscard]] int GetUOrder() const { return direction(0).order; } ///< 4 by default.
    [[nodiscard]] int GetVOrder() const { return direction(1).order; } ///< 4 by default.

    /// 0 until points are created.
    [[nodiscard]] int GetUKnotCount() const { return static_cast<int>(direction(0).knots.size()); }
    /// 0 until points are created.
    [[nodiscard]] int GetVKnotCount() const { return static_cast<int>(direction(1).knots.size()); }
    /// The knots along u, ascending; writing to them changes the surface. Null when there are none; valid until their
    /// number changes.
    [[nodiscard]] double* GetUKnotVector() const { return knots(0); }
    [[nodiscard]] double* GetVKnotVector() const { return knots(1); } ///< The same along v.
    /// The multiplicity of each knot, in files of older writers; null elsewhere. The knot vectors repeat every knot by
    /// its multiplicity, whatever the file does.
    [[nodiscard]] int* GetUMultiplicityVector() const { return multiplicity(0); }
    [[nodiscard]] int* GetVMultiplicityVector() const { return multiplicity(1); } ///< The same along v.

    /// Subdivisions of each span between knots, for display and tessellation.
    void SetStep(int pUStep, int pVStep);
    [[nodiscard]] int GetUStep() const { return direction(0).step; } ///< 4 by default.
    [[nodiscard]] int GetVStep() const { return direction(1).step; } ///< 4 by default.

    void SetSurfaceMode(ESurfaceMode pMode) { mSurfaceMode = pMode; } ///< Any value is stored.
    /// eHigh by default, whatever a file says.
    [[nodiscard]] ESurfaceMode GetSurfaceMode() const { return mSurfaceMode; }
    /// Whether the normals point against du × dv.
    void SetFlipNormals(bool pFlipNormals);
    [[nodiscard]] bool GetFlipNormals() const; ///< False by default.

    /// One parameter direction.
    struct Direction {
        int count = 0;                 ///< control points
        int order = 4;                 ///< the degree plus one
        int step = 4;                  ///< subdivisions of each span
        EType type = eOpen;            ///< how it ends
        std::vector<double> knots;     ///< ascending
        std::vector<int> multiplicity; ///< as in files of older writers, else empty
    };
    /// The platform's own view: 0 is U, 1 is V; the data in memory, without reading the file.
    [[nodiscard]] Direction& parameters(int pDirection) { return mDirections[pDirection]; }
    [[nodiscard]] bool& flipNormals() { return mFlipNormals; } ///< The platform's own view of the flag.

protected:
    FBXSDK_LOCAL FbxNurbsSurfaceBase(FbxManager& pManager, const detail::ClassInfo& pInfo); ///< For derived classes.
    FBXSDK_LOCAL ~FbxNurbsSurfaceBase() override;

private:
    [[nodiscard]] const Direction& direction(int pDirection) const {
        ensureLoaded();
        return mDirections[pDirection];
    }
    [[nodiscard]] double* knots(int pDirection) const;
    [[nodiscard]] int* multiplicity(int pDirection) const;

    mutable Direction mDirections[2];
    ESurfaceMode mSurfaceMode = eHigh;
    bool mFlipNormals = false;
};

/// A NURBS surface as newer programs write it.
class FBXSDK_DLL FbxNurbsSurface : public FbxNurbsSurfaceBase {
    FBXSDK_OBJECT_DECLARE(FbxNurbsSurface, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eNurbsSurface.

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
