// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Triangulation of polygons by ear clipping, and decimation by merging the points of each cell of a grid.
#include "ReportMesh.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <unordered_map>
#include <utility>

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
    std::uint32_t before, after; ///< the adjacent ones among the remaining ones
};

/// Twice the area of the triangle; positive when it is counter-clockwise.
double turn(const Corner& a, const Corner& b, const Corner& c) {
    return (b.x - a.x) * (c.y - a.y) - (b.y - a.y) * (c.x - a.x);
}

/// The polygon seen along its normal, counter-clockwise.
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
    std::size_t axis = 0; // the dominant axis of the normal; the other two are its plane
    for (std::size_t k = 1; k < 3; ++k)
        axis = std::abs(normal[k]) > std::abs(normal[axis]) ? k : axis;
    const std::size_t u = (axis + 1) % 3, v = (axis + 2) % 3;
    const double side = normal[axis] < 0.0 ? -1.0 : 1.0;
    const auto count = static_cast<std::uint32_t>(polygon.size());
    std::vector<Corner> corners;
    corners.reserve(count);
    for (std::uint32_t i = 0; i < count; ++i) {
        const Point& point = points[polygon[i]];
        corners.push_back({point[u] * side, point[v], polygon[i], (i + count - 1) % count, (i + 1) % count});
    }
    return corners;
}

/// The reflex corners of a polygon, by their places: no others can lie in an ear.
class InwardCorners {
public:
    explicit InwardCorners(const std::vector<Corner>& corners) : mCorners(corners) {
        mLow = mHigh = {corners[0].x, corners[0].y};
        for (const Corner& corner : corners) {
            mLow = {std::min(mLow[0], corner.x), std::min(mLow[1], corner.y)};
            mHigh = {std::max(mHigh[0], corner.x), std::max(mHigh[1], corner.y)};
        }
        mSide = static_cast<std::size_t>(std::sqrt(static_cast<double>(corners.size()))) + 1;
        mCells.resize(mSide * mSide);
        for (std::uint32_t i = 0; i < corners.size(); ++i)
            if (turn(corners[corners[i].before], corners[i], corners[corners[i].after]) < 0.0)
                mCells[column(corners[i].y, 1) * mSide + column(corners[i].x, 0)].push_back(i);
    }

    /// Whether any lies in the triangle; those on its edge count unless `withinOnly`.
    [[nodiscard]] bool anyIn(const Corner& a, const Corner& b, const Corner& c, bool withinOnly) const {
        const auto [left, right] = std::minmax({a.x, b.x, c.x});
        const auto [bottom, top] = std::minmax({a.y, b.y, c.y});
        for (std::size_t y = column(bottom, 1); y <= column(top, 1); ++y) {
            for (std::size_t x = column(left, 0); x <= column(right, 0); ++x) {
                for (const std::uint32_t i : mCells[y * mSide + x])
                    if (isIn(i, a, b, c, withinOnly))
                        return true;
            }
        }
        return false;
    }

private:
    [[nodiscard]] std::size_t column(double place, std::size_t axis) const {
        const double length = mHigh[axis] - mLow[axis];
        const double part = length > 0.0 ? (place - mLow[axis]) / length : 0.0;
        return std::min(mSide - 1, static_cast<std::size_t>(part * static_cast<double>(mSide)));
    }

    [[nodiscard]] bool isIn(std::uint32_t i, const Corner& a, const Corner& b, const Corner& c, bool withinOnly) const {
        const Corner& p = mCorners[i];
        if (p.before == i || p.point == a.point || p.point == b.point || p.point == c.point) // removed, or one of them
            return false;
        const double least = std::min({turn(a, b, p), turn(b, c, p), turn(c, a, p)});
        return withinOnly ? least > 0.0 : least >= 0.0;
    }

    const std::vector<Corner>& mCorners;
    std::array<double, 2> mLow{}, mHigh{};
    std::size_t mSide = 1;
    std::vector<std::vector<std::uint32_t>> mCells;
};

/// Removes a corner from the polygon; a removed one refers to itself.
std::uint32_t remove(std::vector<Corner>& corners, std::uint32_t i) {
    const auto [before, after] = std::pair(corners[i].before, corners[i].after);
    corners[before].after = after;
    corners[after].before = before;
    corners[i].before = corners[i].after = i;
    return after;
}

void cutEars(std::vector<Corner> corners, std::vector<Triangle>& triangles) {
    const InwardCorners inward(corners);
    // Polygons that touch or cross themselves may have no strict ear: then one that others touch is used, and
    // at last any corner.
    enum { clear, touched, any } wanted = clear;
    std::uint32_t i = 0;
    std::size_t left = corners.size(), refused = 0;
    while (left > 3) {
        const Corner& a = corners[corners[i].before];
        const Corner& b = corners[i];
        const Corner& c = corners[b.after];
        const double area = turn(a, b, c);
        const bool isEar = area > 0.0 && !inward.anyIn(a, b, c, wanted == touched);
        if (isEar || area == 0.0 || wanted == any) { // a corner on a straight line is removed without a triangle
            if (area != 0.0)
                triangles.push_back({a.point, b.point, c.point});
            i = remove(corners, i);
            --left;
            refused = 0;
            wanted = clear;
            continue;
        }
        i = b.after;
        if (++refused < left)
            continue;
        refused = 0;
        wanted = wanted == clear ? touched : any;
    }
    triangles.push_back({corners[corners[i].before].point, corners[i].point, corners[corners[i].after].point});
}

void cut(const std::vector<std::uint32_t>& polygon, const std::vector<Point>& points,
         std::vector<Triangle>& triangles) {
    if (polygon.size() == 3)
        triangles.push_back({polygon[0], polygon[1], polygon[2]});
    else
        cutEars(flattened(polygon, points), triangles);
}

/// Lists the points that triangles use in the order of their numbers, and makes the triangles refer to that list.
void keepUsedPoints(ReportMesh& mesh, const std::vector<std::uint32_t>& numbers) {
    constexpr std::uint32_t kUnused = std::numeric_limits<std::uint32_t>::max();
    std::vector<std::uint32_t> places(numbers.size(), kUnused), kept;
    for (const Triangle& triangle : mesh.triangles)
        for (const std::uint32_t corner : triangle)
            places[corner] = 0;
    for (std::size_t i = 0; i < places.size(); ++i) {
        if (places[i] == kUnused)
            continue;
        places[i] = static_cast<std::uint32_t>(kept.size());
        kept.push_back(numbers[i]);
    }
    for (Triangle& triangle : mesh.triangles)
        for (std::uint32_t& corner : triangle)
            corner = places[corner];
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

    /// The remaining triangles when the first point of each cell replaces all of them.
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
                static_cast<std::size_t>(mesh.getPointIndex(corner)); // negative ones become much too large
            if (point < points.size() && isFinite(points[point]))
                polygon.push_back(static_cast<std::uint32_t>(point));
        }
        if (polygon.size() != static_cast<std::size_t>(std::max(size, 0)))
            ++result.droppedPolygons;
        else if (size >= 3)
            cut(polygon, points, result.triangles);
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
    // The finest grid with few enough triangles, within about an eighth.
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
