// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// A surface of spline patches; FbxGeometryConverter converts it to a mesh. U runs fastest through the control points.
class FBXSDK_DLL FbxPatch : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxPatch, FbxGeometry)

public:
    /// The splines of a direction.
    enum EType {
        eBezier,        ///< cubic Bézier; the default
        eBezierQuadric, ///< quadratic Bézier
        eCardinal,      ///< cubic through the points
        eBSpline,       ///< cubic near the points
        eLinear         ///< straight lines
    };

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< ePatch.

    using FbxGeometry::InitControlPoints;
    /// Sizes the points, all of them (0, 0, 0, 1): none unless both counts are positive.
    void InitControlPoints(int pUCount, EType pUType, int pVCount, EType pVType);
    [[nodiscard]] int GetUCount() const { return direction(0).count; }      ///< Control points along u.
    [[nodiscard]] int GetVCount() const { return direction(1).count; }      ///< Control points along v.
    [[nodiscard]] EType GetPatchUType() const { return direction(0).type; } ///< eBezier by default.
    [[nodiscard]] EType GetPatchVType() const { return direction(1).type; } ///< eBezier by default.

    /// Subdivisions of each segment between control points, for display and tessellation.
    void SetStep(int pUStep, int pVStep);
    [[nodiscard]] int GetUStep() const { return direction(0).step; } ///< 4 by default.
    [[nodiscard]] int GetVStep() const { return direction(1).step; } ///< 4 by default.

    /// A closed direction continues from its last control points to its first.
    void SetClosed(bool pU, bool pV);
    [[nodiscard]] bool GetUClosed() const { return direction(0).closed; } ///< False by default.
    [[nodiscard]] bool GetVClosed() const { return direction(1).closed; } ///< False by default.

    void SetUCapped(bool pUBottom, bool pUTop); ///< Whether the ends along u are filled; stored for applications.
    [[nodiscard]] bool GetUCappedBottom() const { return direction(0).cappedBottom; } ///< False by default.
    [[nodiscard]] bool GetUCappedTop() const { return direction(0).cappedTop; }       ///< False by default.
    void SetVCapped(bool pVBottom, bool pVTop); ///< Whether the ends along v are filled; stored for applications.
    [[nodiscard]] bool GetVCappedBottom() const { return direction(1).cappedBottom; } ///< False by default.
    [[nodiscard]] bool GetVCappedTop() const { return direction(1).cappedTop; }       ///< False by default.

    /// One parameter direction.
    struct Direction {
        int count = 0;             ///< control points
        int step = 4;              ///< subdivisions of each segment
        EType type = eBezier;      ///< its splines
        bool closed = false;       ///< whether it continues to its first points
        bool cappedBottom = false; ///< whether its start is filled
        bool cappedTop = false;    ///< whether its end is filled
    };
    /// The platform's own view: 0 is U, 1 is V; the data in memory, without reading the file.
    [[nodiscard]] Direction& parameters(int pDirection) { return mDirections[pDirection]; }

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;

private:
    [[nodiscard]] const Direction& direction(int pDirection) const {
        ensureLoaded();
        return mDirections[pDirection];
    }

    Direction mDirections[2];
};

FBXSDK_NAMESPACE_END
