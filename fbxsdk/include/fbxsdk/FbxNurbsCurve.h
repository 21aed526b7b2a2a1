// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <vector>

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// A NURBS curve. Knot counts are those of surfaces (FbxNurbsSurfaceBase). The w of a control point is its weight and
/// not multiplied into x, y, z.
class FBXSDK_DLL FbxNurbsCurve : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxNurbsCurve, FbxGeometry)

public:
    /// The space of the points.
    enum EDimension {
        e2D = 2, ///< in the parameters of a surface, for trimming
        e3D = 3  ///< in space; the default
    };
    /// How the curve ends.
    enum EType {
        eOpen,    ///< at its last points; the default
        eClosed,  ///< at its first points
        ePeriodic ///< at its first points, without a corner
    };

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eNurbsCurve.

    using FbxGeometry::InitControlPoints;
    /// Sizes points and knots, which become zero; no knots when the order does not match the count. To be called after
    /// SetOrder.
    void InitControlPoints(int pCount, EType pVType);
    void SetOrder(int pOrder);              ///< The degree plus one; points and knots stay.
    [[nodiscard]] int GetOrder() const;     ///< 4 by default.
    [[nodiscard]] EType GetType() const;    ///< eOpen by default.
    [[nodiscard]] int GetKnotCount() const; ///< 0 until points are created.
    /// The knots, ascending; writing to them changes the curve. Null when there are none; valid until their number
    /// changes.
    [[nodiscard]] double* GetKnotVector() const;
    void SetStep(int pStep);                       ///< Subdivisions of each span between knots, for display.
    [[nodiscard]] int GetStep() const;             ///< 4 by default.
    void SetDimension(EDimension pDimension);      ///< The third coordinate of 2D curves is of no effect.
    [[nodiscard]] EDimension GetDimension() const; ///< e3D by default.
    /// Whether the weights are used, as the file states; false for curves created in memory.
    [[nodiscard]] bool IsRational() const;

    /// The data of the curve besides its points.
    struct Content {
        int order = 4;              ///< the degree plus one
        int step = 4;               ///< subdivisions of each span
        EType type = eOpen;         ///< how it ends
        EDimension dimension = e3D; ///< in which space
        bool rational = false;      ///< whether the weights are used
        std::vector<double> knots;  ///< ascending
    };
    /// The platform's own view: the data in memory, without reading the file.
    [[nodiscard]] Content& content() { return mContent; }

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;

private:
    mutable Content mContent;
};

FBXSDK_NAMESPACE_END
