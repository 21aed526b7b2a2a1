// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS surfaces against the Wavefront file of the same surface: its points lie on the surface, as do those of our
// mesh. The surface is evaluated here, by its definition, independently of the library's tessellation.
#include "Rows.h"
#include "Tolerances.h"
#include "WavefrontFile.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

namespace conformance {
namespace {

using namespace fbxsdk;

/// One parameter's degree and knots.
struct Direction {
    int order = 0;
    int count = 0;
    std::vector<double> knots;

    [[nodiscard]] int functions() const { return static_cast<int>(knots.size()) - order; }
    [[nodiscard]] double start() const { return knots[static_cast<std::size_t>(order - 1)]; }
    [[nodiscard]] double end() const { return knots[static_cast<std::size_t>(functions())]; }

    /// The value of every basis function, by the recursion of Cox and de Boor.
    [[nodiscard]] std::vector<double> basis(double t) const {
        const auto last = static_cast<std::size_t>(functions());
        std::size_t span = static_cast<std::size_t>(order - 1);
        while (span + 1 < last && t >= knots[span + 1])
            ++span;
        std::vector<double> values(knots.size() - 1, 0.0);
        values[span] = 1.0;
        for (std::size_t degree = 1; degree < static_cast<std::size_t>(order); ++degree) {
            for (std::size_t i = 0; i + degree + 1 < knots.size(); ++i) {
                const double left = knots[i + degree] - knots[i], right = knots[i + degree + 1] - knots[i + 1];
                values[i] = (left > 0 ? (t - knots[i]) / left * values[i] : 0.0) +
                            (right > 0 ? (knots[i + degree + 1] - t) / right * values[i + 1] : 0.0);
            }
        }
        values.resize(last);
        return values;
    }
};

class Surface {
public:
    explicit Surface(const FbxNurbsSurface& source)
        : mU{source.GetUOrder(), source.GetUCount(), knotsOf(source.GetUKnotVector(), source.GetUKnotCount())},
          mV{source.GetVOrder(), source.GetVCount(), knotsOf(source.GetVKnotVector(), source.GetVKnotCount())},
          mPoints(source.GetControlPoints(), source.GetControlPoints() + source.GetControlPointsCount()) {}

    [[nodiscard]] Point at(double u, double v) const {
        const std::vector<double> inU = mU.basis(u), inV = mV.basis(v);
        std::array<double, 4> sum{};
        for (int j = 0; j < mV.functions(); ++j) {
            for (int i = 0; i < mU.functions(); ++i) {
                // Closed surfaces repeat their first points.
                const FbxVector4& point = mPoints[static_cast<std::size_t>(j % mV.count * mU.count + i % mU.count)];
                const double weight = inU[static_cast<std::size_t>(i)] * inV[static_cast<std::size_t>(j)] * point[3];
                for (int k = 0; k < 3; ++k)
                    sum[static_cast<std::size_t>(k)] += weight * point[k];
                sum[3] += weight;
            }
        }
        return {sum[0] / sum[3], sum[1] / sum[3], sum[2] / sum[3]};
    }

    /// The distance of the point from the surface: from the nearest point of a grid, refined step by step.
    [[nodiscard]] double distance(const Point& point) const {
        constexpr int kGrid = 32;
        double u = 0, v = 0, best = HUGE_VAL;
        for (int i = 0; i <= kGrid; ++i) {
            for (int j = 0; j <= kGrid; ++j) {
                const double tryU = mU.start() + (mU.end() - mU.start()) * i / kGrid;
                const double tryV = mV.start() + (mV.end() - mV.start()) * j / kGrid;
                const double found = apart(at(tryU, tryV), point);
                if (found < best) {
                    best = found;
                    u = tryU;
                    v = tryV;
                }
            }
        }
        double step = 1.0 / kGrid;
        while (step > 1e-12) {
            const double stepU = step * (mU.end() - mU.start()), stepV = step * (mV.end() - mV.start());
            double nextU = u, nextV = v, next = best;
            for (const int i : {-1, 0, 1}) {
                for (const int j : {-1, 0, 1}) {
                    const double tryU = std::clamp(u + i * stepU, mU.start(), mU.end());
                    const double tryV = std::clamp(v + j * stepV, mV.start(), mV.end());
                    const double found = apart(at(tryU, tryV), point);
                    if (found < next) {
                        next = found;
                        nextU = tryU;
                        nextV = tryV;
                    }
                }
            }
            if (next == best)
                step /= 2;
            best = next;
            u = nextU;
            v = nextV;
        }
        return best;
    }

    [[nodiscard]] double size() const {
        double least = HUGE_VAL, most = -HUGE_VAL;
        for (const FbxVector4& point : mPoints) {
            for (int k = 0; k < 3; ++k) {
                least = std::min(least, point[k]);
                most = std::max(most, point[k]);
            }
        }
        return most - least;
    }

private:
    static std::vector<double> knotsOf(const double* knots, int count) { return {knots, knots + count}; }
    static double apart(const Point& a, const Point& b) { return std::hypot(a[0] - b[0], a[1] - b[1], a[2] - b[2]); }

    Direction mU, mV;
    std::vector<FbxVector4> mPoints;
};

/// Groups are named after the node, or after its shape.
bool isOf(const WavefrontBlock& block, const std::string& nodeName) {
    return std::ranges::any_of(
        block.names, [&](const std::string& name) { return name.starts_with(nodeName); });
}

void comparePoint(const Surface& surface, const Point& point, double tolerance, const char* whose, Findings& findings) {
    const double distance = surface.distance(point);
    findings.compare(distance <= tolerance, [&] {
        return std::string(whose) + " point " + printed(point.data(), 3) + " is " + printed(distance) +
               " from the surface";
    });
}

} // namespace

void checkNurbsSurfaces(LoadedFile& file, Findings& findings) {
    constexpr double kOfItsSize = 1e-6;
    if (!file.loaded() || file.file().wavefront.empty())
        return;
    FbxGeometryConverter converter(file.scene()->GetFbxManager());
    for (const SceneNode& entry : file.nodes()) {
        auto* source = FbxCast<FbxNurbsSurface>(entry.node->GetNodeAttribute());
        if (!source)
            continue;
        const Surface surface(*source);
        const double tolerance = kOfItsSize * surface.size();
        for (const WavefrontSibling& sibling : file.file().wavefront) {
            const WavefrontFile wavefront = readWavefront(sibling.path);
            for (const WavefrontBlock& block : wavefront.blocks)
                for (const Point& point : isOf(block, entry.name) ? block.points : std::vector<Point>())
                    comparePoint(surface, point, std::max(tolerance, wavefront.tolerance), "Wavefront", findings);
        }
        converter.Triangulate(source, /*pReplace=*/true);
        FbxMesh* mesh = entry.node->GetMesh();
        findings.compare(mesh != nullptr, [] { return std::string("the surface does not become a mesh"); });
        for (int i = 0; mesh && i < mesh->GetControlPointsCount(); ++i) {
            const FbxVector4 point = mesh->GetControlPointAt(i);
            comparePoint(surface, {point[0], point[1], point[2]}, tolerance, "our", findings);
        }
    }
}

} // namespace conformance
