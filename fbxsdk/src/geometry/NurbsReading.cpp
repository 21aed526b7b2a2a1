// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Surfaces, curves and trimmed surfaces from their records.
#include "geometry/NurbsReading.h"

#include <algorithm>
#include <string_view>

#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "geometry/NurbsNumbers.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Direction = FbxNurbsSurfaceBase::Direction;

bool isOrder(std::int64_t order, std::int64_t points) { return order >= 2 && order <= points; }

template <class Number>
std::vector<Number> numbersOf(const Record& body, std::string_view name) {
    const Record* record = body.child(name);
    std::vector<Number> numbers(record ? record->numberCount() : 0);
    if (record && !record->readNumbers(std::span<Number>(numbers)))
        numbers.clear();
    return numbers;
}

/// Old files may list each knot once, with its multiplicity.
std::vector<double> repeatKnots(const std::vector<double>& knots, const std::vector<int>& multiplicity,
                                std::size_t expected) {
    if (knots.size() == expected || multiplicity.size() != knots.size())
        return knots;
    std::vector<double> repeated;
    for (std::size_t i = 0; i < knots.size(); ++i) {
        if (multiplicity[i] < 1 || static_cast<std::size_t>(multiplicity[i]) > expected - repeated.size())
            return knots;
        repeated.insert(repeated.end(), static_cast<std::size_t>(multiplicity[i]), knots[i]);
    }
    return repeated;
}

/// The names of the records of the two classes of surfaces.
struct SurfaceRecords {
    std::string_view order;
    bool hasMultiplicity;
};

class SurfaceReader {
public:
    SurfaceReader(const SurfaceRecords& records, const Record& body) : mRecords(records), mBody(body) {}

    void read(FbxNurbsSurfaceBase& surface) {
        surface.flipNormals() = mBody.childValue("FlipNormals").toInteger() != 0;
        Direction u, v;
        if (!readDirection(u, 0) || !readDirection(v, 1) ||
            !readPoints(surface.points(), mBody, std::int64_t{u.count} * v.count, 4))
            return;
        surface.parameters(0) = std::move(u);
        surface.parameters(1) = std::move(v);
    }

private:
    [[nodiscard]] std::int64_t number(std::string_view name, std::size_t index, std::int64_t fallback) const {
        return integerAt(mBody.child(name), index, fallback);
    }
    [[nodiscard]] FbxNurbsSurfaceBase::EType form(std::size_t index) const {
        const Record* record = mBody.child("Form");
        const std::string_view stated = record ? record->value(index).toText() : std::string_view();
        return static_cast<FbxNurbsSurfaceBase::EType>(numberOf(kSurfaceForms, stated, FbxNurbsSurfaceBase::eOpen));
    }

    bool readDirection(Direction& direction, std::size_t index) const {
        const std::int64_t order = number(mRecords.order, index, 0);
        const std::int64_t count = number("Dimensions", index, 0);
        if (!isOrder(order, count) || count > kMostPoints)
            return false;
        direction.count = static_cast<int>(count);
        direction.order = static_cast<int>(order);
        direction.step = stepOf(number("Step", index, kUsualStep));
        direction.type = form(index);
        return readKnots(direction, index);
    }

    bool readKnots(Direction& direction, std::size_t index) const {
        constexpr std::string_view kKnots[] = {"KnotVectorU", "KnotVectorV"};
        constexpr std::string_view kMultiplicity[] = {"MultiplicityU", "MultiplicityV"};
        const int repeated = repeatedPoints(direction.type, direction.order);
        const auto expected = static_cast<std::size_t>(knotCount(direction.count, direction.order, repeated));
        direction.knots = numbersOf<double>(mBody, kKnots[index]);
        if (mRecords.hasMultiplicity) {
            direction.multiplicity = numbersOf<int>(mBody, kMultiplicity[index]);
            direction.knots = repeatKnots(direction.knots, direction.multiplicity, expected);
        }
        return direction.knots.size() == expected;
    }

    const SurfaceRecords& mRecords;
    const Record& mBody;
};

} // namespace

void readNurbs(FbxNurbs& nurbs, const Record& body) { SurfaceReader({"NurbOrder", true}, body).read(nurbs); }

void readNurbsSurface(FbxNurbsSurface& surface, const Record& body) {
    SurfaceReader({"NurbsSurfaceOrder", false}, body).read(surface);
}

void readNurbsCurve(FbxNurbsCurve& curve, const Record& body) {
    const int form = numberOf(kCurveForms, body.childValue("Form").toText(), FbxNurbsCurve::eOpen);
    const Record* points = body.child("Points");
    const std::size_t numbers = points ? points->numberCount() : 0;
    const std::int64_t order = body.childValue("Order").toInteger();
    const auto count = static_cast<std::int64_t>(numbers / 4);
    if (!isOrder(order, count) || count > kMostPoints)
        return;
    FbxNurbsCurve::Content content;
    content.order = static_cast<int>(order);
    content.type = static_cast<FbxNurbsCurve::EType>(form);
    content.dimension = body.childValue("Dimension").toInteger(3) == 2 ? FbxNurbsCurve::e2D : FbxNurbsCurve::e3D;
    content.rational = body.childValue("Rational").toInteger() != 0;
    content.step = stepOf(body.childValue("Step").toInteger(kUsualStep));
    content.knots = numbersOf<double>(body, "KnotVector");
    const int repeated = repeatedPoints(content.type, content.order);
    if (content.knots.size() != static_cast<std::size_t>(knotCount(static_cast<int>(count), content.order, repeated)))
        return;
    if (readPoints(curve.points(), body, count, 4))
        curve.content() = std::move(content);
}

void readTrimNurbsSurface(FbxTrimNurbsSurface& surface, const Record& body) {
    surface.flipNormals() = body.childValue("FlipNormals").toInteger() != 0;
}

void readBoundary(FbxBoundary&, const Record&) {}

} // namespace detail
FBXSDK_NAMESPACE_END
