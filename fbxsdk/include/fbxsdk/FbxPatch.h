// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Surfaces of spline patches.
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// U runs fastest through the control points.
class FBXSDK_DLL FbxPatch : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxPatch, FbxGeometry)

public:
    enum EType { eBezier, eBezierQuadric, eCardinal, eBSpline, eLinear };

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    using FbxGeometry::InitControlPoints;
    void InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType);
    [[nodiscard]] int GetUCount() const { return direction(0).count; }
    [[nodiscard]] int GetVCount() const { return direction(1).count; }
    [[nodiscard]] EType GetPatchUType() const { return direction(0).type; }
    [[nodiscard]] EType GetPatchVType() const { return direction(1).type; }

    /// Subdivisions of each segment between control points, for display and tessellation.
    void SetStep(int pUStep, int pVStep);
    [[nodiscard]] int GetUStep() const { return direction(0).step; }
    [[nodiscard]] int GetVStep() const { return direction(1).step; }

    /// A closed direction runs on from its last control points to its first.
    void SetClosed(bool pU, bool pV);
    [[nodiscard]] bool GetUClosed() const { return direction(0).closed; }
    [[nodiscard]] bool GetVClosed() const { return direction(1).closed; }

    void SetUCapped(bool pUBottom, bool pUTop);
    [[nodiscard]] bool GetUCappedBottom() const { return direction(0).cappedBottom; }
    [[nodiscard]] bool GetUCappedTop() const { return direction(0).cappedTop; }
    void SetVCapped(bool pVBottom, bool pVTop);
    [[nodiscard]] bool GetVCappedBottom() const { return direction(1).cappedBottom; }
    [[nodiscard]] bool GetVCappedTop() const { return direction(1).cappedTop; }

    struct Direction {
        int count = 0;
        int step = 4;
        EType type = eBezier;
        bool closed = false;
        bool cappedBottom = false;
        bool cappedTop = false;
    };
    /// The platform's own view: 0 is U, 1 is V; as it is, without asking the file.
    [[nodiscard]] Direction& parameters(int pDirection) { return mDirections[pDirection]; }

protected:
    bool readSource(const detail::GeometrySource& pSource) override;

private:
    [[nodiscard]] const Direction& direction(int pDirection) const {
        ensureLoaded();
        return mDirections[pDirection];
    }

    Direction mDirections[2];
};

FBXSDK_NAMESPACE_END
