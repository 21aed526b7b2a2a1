// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rational B-spline surfaces.
#pragma once

#include <vector>

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// What both classes of NURBS surfaces consist of. U runs fastest through the control points; their w is the weight and
/// not multiplied into x, y, z.
///
/// A direction of n control points and a given order has, by its type, this many knots: open n + order, closed
/// n + order + 1 (the first point comes again), periodic n + 2 order - 1 (the first order - 1 points come again).
class FBXSDK_DLL FbxNurbsSurfaceBase : public FbxGeometry {
public:
    enum EType { ePeriodic, eClosed, eOpen };
    enum ESurfaceMode { eRaw, eLowNoNormals, eLow, eHighNoNormals, eHigh };

    using FbxGeometry::InitControlPoints;
    /// Sizes points and knots. To be called after SetOrder.
    void InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType);
    [[nodiscard]] int GetUCount() const { return direction(0).count; }
    [[nodiscard]] int GetVCount() const { return direction(1).count; }
    [[nodiscard]] EType GetNurbsUType() const { return direction(0).type; }
    [[nodiscard]] EType GetNurbsVType() const { return direction(1).type; }

    /// The order is the degree plus one.
    void SetOrder(FbxUInt pUOrder, FbxUInt pVOrder);
    [[nodiscard]] int GetUOrder() const { return direction(0).order; }
    [[nodiscard]] int GetVOrder() const { return direction(1).order; }

    [[nodiscard]] int GetUKnotCount() const { return static_cast<int>(direction(0).knots.size()); }
    [[nodiscard]] int GetVKnotCount() const { return static_cast<int>(direction(1).knots.size()); }
    /// Null when there are none.
    [[nodiscard]] double* GetUKnotVector() const { return knots(0); }
    [[nodiscard]] double* GetVKnotVector() const { return knots(1); }
    /// How often each knot counts, in files of older writers; null elsewhere. The knot vectors have every knot as often
    /// as it counts, whatever the file does.
    [[nodiscard]] int* GetUMultiplicityVector() const { return multiplicity(0); }
    [[nodiscard]] int* GetVMultiplicityVector() const { return multiplicity(1); }

    /// Subdivisions of each span between knots, for display and tessellation.
    void SetStep(int pUStep, int pVStep);
    [[nodiscard]] int GetUStep() const { return direction(0).step; }
    [[nodiscard]] int GetVStep() const { return direction(1).step; }

    void SetSurfaceMode(ESurfaceMode pMode) { mSurfaceMode = pMode; }
    [[nodiscard]] ESurfaceMode GetSurfaceMode() const { return mSurfaceMode; }
    /// Whether the normals point against du × dv.
    void SetFlipNormals(bool pFlipNormals);
    [[nodiscard]] bool GetFlipNormals() const;

    /// One parameter direction.
    struct Direction {
        int count = 0;
        int order = 4;
        int step = 4;
        EType type = eOpen;
        std::vector<double> knots;
        std::vector<int> multiplicity;
    };
    /// The platform's own view: 0 is U, 1 is V; as it is, without asking the file.
    [[nodiscard]] Direction& parameters(int pDirection) { return mDirections[pDirection]; }
    [[nodiscard]] bool& flipNormals() { return mFlipNormals; }

protected:
    FbxNurbsSurfaceBase(FbxManager& pManager, const detail::ClassInfo& pInfo);
    ~FbxNurbsSurfaceBase() override;

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

class FBXSDK_DLL FbxNurbsSurface : public FbxNurbsSurfaceBase {
    FBXSDK_OBJECT_DECLARE(FbxNurbsSurface, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

protected:
    bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
