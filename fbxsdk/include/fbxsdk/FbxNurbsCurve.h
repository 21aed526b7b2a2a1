// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A B-spline curve, in space or in the parameters of a surface.
#pragma once

#include <vector>

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// Knot counts are those of surfaces. The w of a control point is its weight and not multiplied into x, y, z.
class FBXSDK_DLL FbxNurbsCurve : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxNurbsCurve, FbxGeometry)

public:
    enum EDimension { e2D = 2, e3D = 3 };
    enum EType { eOpen, eClosed, ePeriodic };

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    using FbxGeometry::InitControlPoints;
    /// Sizes points and knots. To be called after SetOrder.
    void InitControlPoints(int pCount, EType pVType);
    void SetOrder(int pOrder);
    [[nodiscard]] int GetOrder() const;
    [[nodiscard]] EType GetType() const;
    [[nodiscard]] int GetKnotCount() const;
    /// Null when there are none.
    [[nodiscard]] double* GetKnotVector() const;
    void SetStep(int pStep);
    [[nodiscard]] int GetStep() const;
    void SetDimension(EDimension pDimension);
    [[nodiscard]] EDimension GetDimension() const;
    /// Whether the weights count.
    [[nodiscard]] bool IsRational() const;

    struct Content {
        int order = 4;
        int step = 4;
        EType type = eOpen;
        EDimension dimension = e3D;
        bool rational = false;
        std::vector<double> knots;
    };
    /// The platform's own view: as it is, without asking the file.
    [[nodiscard]] Content& content() { return mContent; }

protected:
    bool readSource(const detail::GeometrySource& pSource) override;

private:
    mutable Content mContent;
};

FBXSDK_NAMESPACE_END
