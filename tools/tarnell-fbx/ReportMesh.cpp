// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Triangles of polygons by cutting off ears, and fewer triangles by merging the points of each cell of a grid.
#include "ReportMesh.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <unordered_map>

namespace tool {
namespace {

using Tarnell::Fbx::TnFbxMesh;
using Triangle = std::array<std::uint32_t, 3>;

bool isFinite(const Point& point) {
    return std::isfinite(point[0]) && std::isfinite(point[1]) && std::isfinite(point[2]);
}

struct Corner {
    double x, y;
    std::uint32_t point;
};

/// Twice the area of the triangle; positive when it goes round against the clock.
double turn(const Corner& a, const Corner& b, const Corner& c) {
    return (b.x - a.x) * (c.y - a.y) - (b.y - a.y) * (c.x - a.x);
}

/// The polygon as seen along its normal, going round against the clock.
std::vector<Corner> flattened(const std::vector<std::uint32_t>& polygon, const std::vector<Point>& points) {
    std::array<double, 3> normal{};
    for (std::size_t i = 0; i < polygon.size(); ++i) {
        const Point& a = points[polygon[i]];
        const Point& b = points[polygon[(i + 1) % polygon.size()]];
        for (std::size_t k = 0; k < 3; ++k) {
            const std::size_t u = (k + 1) % 3, v = (k + 2) % 3;
            normal[k] += (static_cast<double>(a[u]) - b[u]) * (static_cast<double>(a[v]) + b[v]);
        }
    }
    std::size_t axis = 0; // that the polygon faces most; the other two are its plane
    for (std::size_t k = 1; k < 3; ++k)
        axis = std::abs(normal[k]) > std::abs(normal[axis]) ? k : axis;
    const std::size_t u = (axis + 1) % 3, v = (axis + 2) % 3;
    const double side = normal[axis] < 0.0 ? -1.0 : 1.0;
    std::vector<Corner> corners;
    corners.reserve(polygon.size());
    for (const std::uint32_t point : polygon)
        corners.push_back({points[point][u] * side, points[point][v], point});
    return corners;
}

bool isEar(const std::vector<Corner>& corners, std::size_t i) {
    const std::size_t count = corners.size();
    const Corner& a = corners[(i + count - 1) % count];
    const Corner& b = corners[i];
    const Corner& c = corners[(i + 1) % count];
    if (turn(a, b, c) <= 0.0)
        return false;
    return std::none_of(corners.begin(), corners.end(), [&](const Corner& p) {
        const bool isCorner = p.point == a.point || p.point == b.point || p.point == c.point;
        return !isCorner && turn(a, b, p) >= 0.0 && turn(b, c, p) >= 0.0 && turn(c, a, p) >= 0.0;
    });
}

void cutEars(std::vector<Corner> corners, std::vector<Triangle>& triangles) {
    std::size_t i = 0, refused = 0;
    while (corners.size() > 3) {
        const std::size_t count = corners.size();
        i %= count;
        // Polygons that cross themselves have no ears at some point: any corner will do then.
        if (refused < count && !isEar(corners, i)) {
            ++i, ++refused;
            continue;
        }
        triangles.push_back({corners[(i + count - 1) % count].point, corners[i].point, corners[(i + 1) % count].point});
        corners.erase(corners.begin() + static_cast<std::ptrdiff_t>(i));
        refused = 0;
    }
    triangles.push_back({corners[0].point, corners[1].point, corners[2].point});
}

void cut(const std::vector<std::uint32_t>& polygon, const std::vector<Point>& points,
         std::vector<Triangle>& triangles) {
    constexpr std::size_t kMostCorners = 3000; // cutting takes their square
    if (polygon.size() > 3 && polygon.size() <= kMostCorners) {
        cutEars(flattened(polygon, points), triangles);
        return;
    }
    for (std::size_t i = 1; i + 1 < polygon.size(); ++i)
        triangles.push_back({polygon[0], polygon[i], polygon[i + 1]});
}

/// Names the points that triangles use in the order of their numbers, and has the triangles name places among them.
void keepUsedPoints(ReportMesh& mesh, const std::vector<std::uint32_t>& numbers) {
    constexpr std::uint32_t kUnused = std::numeric_limits<std::uint32_t>::max();
    std::vector<std::uint32_t> places(numbers.size(), kUnused), kept;
    for (const Triangle& triangle : mesh.triangles) {
        for (const std::uint32_t corner : triangle)
            places[corner] = 0;
    }
    for (std::size_t i = 0; i < places.size(); ++i) {
        if (places[i] == kUnused)
            continue;
        places[i] = static_cast<std::uint32_t>(kept.size());
        kept.push_back(numbers[i]);
    }
    for (Triangle& triangle : mesh.triangles) {
        for (std::uint32_t& corner : triangle)
            corner = places[corner];
    }
    mesh.kept = std::move(kept);
}

/// The grid over the points that a mesh keeps, `size` cells along its longest side.
class Grid {
public:
    Grid(const ReportMesh& mesh, const std::vector<Point>& points) : mMesh(mesh), mPoints(points) {
        mLow.fill(std::numeric_limits<double>::max());
        std::array<double, 3> high;
        high.fill(std::numeric_limits<double>::lowest());
        for (const std::uint32_t number : mesh.kept) {
            for (std::size_t k = 0; k < 3; ++k) {
                mLow[k] = std::min(mLow[k], static_cast<double>(points[number][k]));
                high[k] = std::max(high[k], static_cast<double>(points[number][k]));
            }
        }
        for (std::size_t k = 0; k < 3; ++k)
            mLength = std::max(mLength, high[k] - mLow[k]);
    }

    /// The triangles that are left when the first point of each cell stands for all of them.
    [[nodiscard]] std::vector<Triangle> merged(std::uint32_t size) const {
        std::unordered_map<std::uint64_t, std::uint32_t> first;
        std::vector<std::uint32_t> stands(mMesh.kept.size());
        for (std::uint32_t i = 0; i < stands.size(); ++i)
            stands[i] = first.try_emplace(cellOf(mPoints[mMesh.kept[i]], size), i).first->second;
        std::vector<Triangle> left;
        for (const Triangle& triangle : mMesh.triangles) {
            const Triangle merged = {stands[triangle[0]], stands[triangle[1]], stands[triangle[2]]};
            if (merged[0] != merged[1] && merged[1] != merged[2] && merged[2] != merged[0])
                left.push_back(merged);
        }
        return left;
    }

private:
    [[nodiscard]] std::uint64_t cellOf(const Point& point, std::uint32_t size) const {
        std::uint64_t cell = 0;
        for (std::size_t k = 0; k < 3; ++k) {
            const double place = mLength > 0.0 ? (point[k] - mLow[k]) / mLength : 0.0;
            cell = cell << 20U | static_cast<std::uint64_t>(place * size);
        }
        return cell;
    }

    const ReportMesh& mMesh;
    const std::vector<Point>& mPoints;
    std::array<double, 3> mLow{};
    double mLength = 0.0;
};

} // namespace

std::vector<Point> pointsOf(const TnFbxMesh& mesh) {
    std::vector<Point> points(static_cast<std::size_t>(std::max(mesh.getNumberOfControlPoints(), 0)));
    for (std::size_t i = 0; i < points.size(); ++i)
        mesh.getControlPoint(static_cast<int>(i), points[i][0], points[i][1], points[i][2]);
    return points;
}

ReportMesh triangulated(const TnFbxMesh& mesh) {
    const std::vector<Point> points = pointsOf(mesh);
    ReportMesh result;
    result.pointCount = points.size();
    result.polygonCount = static_cast<std::size_t>(mesh.getNumberOfPolygons());
    int corner = 0;
    std::vector<std::uint32_t> polygon;
    for (int i = 0; i < mesh.getNumberOfPolygons(); ++i) {
        const int size = mesh.getPolygonVertexSize(i);
        polygon.clear();
        for (int k = 0; k < size; ++k, ++corner) {
            const auto point =
                static_cast<std::size_t>(mesh.getPointIndex(corner)); // negative ones become far too large
            if (point < points.size() && isFinite(points[point]))
                polygon.push_back(static_cast<std::uint32_t>(point));
        }
        if (polygon.size() != static_cast<std::size_t>(std::max(size, 0))) {
            ++result.droppedPolygons;
        } else if (size >= 3) {
            cut(polygon, points, result.triangles);
        }
    }
    result.triangleCount = result.triangles.size();
    std::vector<std::uint32_t> all(points.size());
    std::iota(all.begin(), all.end(), 0U);
    keepUsedPoints(result, all);
    return result;
}

void thin(ReportMesh& mesh, const std::vector<Point>& points, std::size_t mostTriangles) {
    if (mesh.triangles.size() <= mostTriangles)
        return;
    const Grid grid(mesh, points);
    // The finest grid that leaves few enough, to an eighth or so.
    constexpr std::uint32_t kFinest = 1U << 14U;
    std::uint32_t fits = 1, tooFine = kFinest;
    std::vector<Triangle> best;
    while (tooFine - fits > std::max(1U, fits / 8)) {
        const auto mean = static_cast<std::uint32_t>(std::sqrt(static_cast<double>(fits) * tooFine));
        const std::uint32_t middle = std::max(mean, fits + 1);
        std::vector<Triangle> left = grid.merged(middle);
        if (left.size() <= mostTriangles) {
            fits = middle;
            best = std::move(left);
        } else {
            tooFine = middle;
        }
    }
    const std::vector<std::uint32_t> numbers = mesh.kept;
    mesh.triangles = std::move(best);
    keepUsedPoints(mesh, numbers);
}

} // namespace tool
