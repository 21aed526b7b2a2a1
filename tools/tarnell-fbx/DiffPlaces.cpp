// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Global transforms of nodes, frame by frame, and the optics of cameras.
#include <algorithm>
#include <array>
#include <cmath>

#include "CameraOrigins.h"
#include "DiffSides.h"
#include "Placing.h"
#include "SceneFacts.h"

namespace tool {

using Tarnell::Fbx::TnFbxTransform;

namespace {

constexpr double kDegrees = 57.29577951308232;

bool changes(const TnFbxTransform& object) {
    for (int i = TnFbxTransform::kFbxTransformPositionX; i <= TnFbxTransform::kFbxTransformSkewZ; ++i)
        if (object.getTransformAnimated(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)))
            return true;
    return false;
}

double distance(const FbxVector4& a, const FbxVector4& b) { return lengthOf({a[0] - b[0], a[1] - b[1], a[2] - b[2]}); }

/// A node in both files: axes without the unit, which scales the topmost nodes when files are converted to
/// centimetres.
struct Places {
    FbxAMatrix a, b;
};

struct PlacedPair {
    const TnFbxTransform *a, *b;
    [[nodiscard]] bool change() const { return changes(*a) || changes(*b); }
};

class TransformComparison {
public:
    explicit TransformComparison(Comparison& comparison) : mComparison(comparison) {}

    void run() {
        for (const NodePair& pair : mComparison.pairs)
            if (pair.a && pair.b)
                compare(pair);
    }

private:
    void compare(const NodePair& pair) {
        const PlacedPair placed{mComparison.a.transformOf.at(pair.a), mComparison.b.transformOf.at(pair.b)};
        std::vector<Difference> found;
        add(found, pair, placed, "position", "cm", &positions);
        add(found, pair, placed, "rotation", "°", &directions);
        add(found, pair, placed, "scale", "", &lengths);
        if (found.empty())
            return;
        const auto above = mReported.find(pair.a->GetParent());
        if (above != mReported.end() && above->second.parentOfB == pair.b->GetParent() &&
            isCarried(placed, above->second.placed)) {
            ++mComparison.found[above->second.index].carried;
            mReported[pair.a] = {placed, pair.b, above->second.index};
            return;
        }
        mReported[pair.a] = {placed, pair.b, mComparison.found.size()};
        for (Difference& each : found)
            mComparison.found.push_back(std::move(each));
    }

    /// The distance of the two in one quantity, its reference, and each value.
    struct Apart {
        double amount = 0.0, size = 1.0;
        std::string a, b;
    };
    using Measure = Apart (*)(const Places&);

    void add(std::vector<Difference>& found, const NodePair& pair, const PlacedPair& placed, const char* what,
             const char* unit, Measure measure) const {
        const std::size_t count = placed.change() ? mComparison.moments.size() : 1;
        Difference worst{DiffKind::transform, pair.a->GetName(), what, {}, {}, {}, unit, {}, 0};
        for (std::size_t i = 0; i < count; ++i) {
            const DiffMoment moment = mComparison.moments[i];
            if (hasSameValues(placed, moment))
                continue;
            Apart apart = measure(placesAt(placed, moment));
            const bool differs = !(apart.amount <= mComparison.settings.tolerance * apart.size);
            const double amount = *unit == '\0' || *unit == 'c' ? apart.amount : apart.amount * kDegrees;
            if (!differs || (worst.amount && !(amount > *worst.amount)))
                continue;
            worst.amount = amount;
            worst.frame = moment.a;
            worst.a = std::move(apart.a);
            worst.b = std::move(apart.b);
        }
        if (worst.amount)
            found.push_back(std::move(worst));
    }

    /// Most frames of most clips: nothing needs to be computed then.
    bool hasSameValues(const PlacedPair& placed, const DiffMoment& moment) const {
        bool same = mComparison.a.unit == mComparison.b.unit &&
                    placed.a->getTransformRotationOrder() == placed.b->getTransformRotationOrder();
        for (int i = 0; same && i <= TnFbxTransform::kFbxTransformSkewZ; ++i) {
            const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
            same = placed.a->getTransformValueAt(channel, static_cast<float>(moment.a)) ==
                   placed.b->getTransformValueAt(channel, static_cast<float>(moment.b));
        }
        return same;
    }

    Places placesAt(const PlacedPair& placed, const DiffMoment& moment) const {
        Places places{placeAt(*placed.a, moment.a), placeAt(*placed.b, moment.b)};
        for (int axis = 0; axis < 3; ++axis) {
            for (int component = 0; component < 3; ++component) {
                places.a[axis][component] /= mComparison.a.unit;
                places.b[axis][component] /= mComparison.b.unit;
            }
        }
        return places;
    }

    static std::string text(const FbxVector4& vector) { return vectorText({vector[0], vector[1], vector[2]}, 4); }

    static Apart positions(const Places& places) {
        const FbxVector4 a = places.a.GetT(), b = places.b.GetT();
        return {distance(a, b), std::max({1.0, lengthOf(a), lengthOf(b)}), text(a), text(b)};
    }

    /// The largest angle between two axes.
    static Apart directions(const Places& places) {
        Apart apart;
        for (int axis = 0; axis < 3; ++axis) {
            const FbxVector4 a = places.a.GetRow(axis), b = places.b.GetRow(axis);
            const double sizeA = lengthOf(a), sizeB = lengthOf(b);
            if (!(sizeA > 0.0) || !(sizeB > 0.0))
                continue;
            const double chord =
                distance({a[0] / sizeA, a[1] / sizeA, a[2] / sizeA}, {b[0] / sizeB, b[1] / sizeB, b[2] / sizeB});
            apart.amount = std::max(apart.amount, 2.0 * std::asin(std::min(chord / 2.0, 1.0)));
        }
        return apart;
    }

    static Apart lengths(const Places& places) {
        FbxVector4 a, b;
        for (int axis = 0; axis < 3; ++axis) {
            a[axis] = lengthOf(places.a.GetRow(axis));
            b[axis] = lengthOf(places.b.GetRow(axis));
        }
        return {std::max({std::abs(a[0] - b[0]), std::abs(a[1] - b[1]), std::abs(a[2] - b[2])}),
                std::max({1.0, lengthOf(a), lengthOf(b)}), text(a), text(b)};
    }

    /// Whether the change of the parent is the change of the child, at every frame.
    bool isCarried(const PlacedPair& child, const PlacedPair& parent) const {
        const std::size_t count = child.change() || parent.change() ? mComparison.moments.size() : 1;
        for (std::size_t i = 0; i < count; ++i) {
            const Places own = placesAt(child, mComparison.moments[i]);
            const Places above = placesAt(parent, mComparison.moments[i]);
            FbxAMatrix fromA = above.a;
            const FbxAMatrix expected = above.b * fromA.Inverse() * own.a;
            const double size = std::max({1.0, lengthOf(own.b.GetT()), lengthOf(above.b.GetT())});
            for (int row = 0; row < 4; ++row)
                if (!(distance(expected.GetRow(row), own.b.GetRow(row)) <= mComparison.settings.tolerance * size))
                    return false;
        }
        return true;
    }

    struct Reported {
        PlacedPair placed{};
        const FbxNode* parentOfB = nullptr; ///< the node's own counterpart
        std::size_t index = 0;              ///< of the difference that is reported
    };
    Comparison& mComparison;
    std::unordered_map<const FbxNode*, Reported> mReported;
};

// ---- Cameras ----

struct OpticsRow {
    const char *what, *unit;
    double (*value)(const CameraMoment&);
};

constexpr std::array<OpticsRow, 7> kLens = {
    {{"focalLength", "mm", [](const CameraMoment& moment) { return moment.focalLength; }},
     {"filmWidth", "in", [](const CameraMoment& moment) { return moment.film.width; }},
     {"filmHeight", "in", [](const CameraMoment& moment) { return moment.film.height; }},
     {"filmOffsetX", "in", [](const CameraMoment& moment) { return moment.offsetX; }},
     {"filmOffsetY", "in", [](const CameraMoment& moment) { return moment.offsetY; }},
     {"near", "cm", [](const CameraMoment& moment) { return moment.nearPlane; }},
     {"far", "cm", [](const CameraMoment& moment) { return moment.farPlane; }}}};

/// The values derived from the lens, the picture and the gate fit.
constexpr std::array<OpticsRow, 2> kPicture = {
    {{"pictureFovX", "°", [](const CameraMoment& moment) { return moment.pictureFovX; }},
     {"pictureFovY", "°", [](const CameraMoment& moment) { return moment.pictureFovY; }}}};

constexpr std::array<OpticsRow, 3> kAim = {
    {{"directionX", "", [](const CameraMoment& moment) { return moment.direction[0]; }},
     {"directionY", "", [](const CameraMoment& moment) { return moment.direction[1]; }},
     {"directionZ", "", [](const CameraMoment& moment) { return moment.direction[2]; }}}};

class CameraComparison {
public:
    CameraComparison(Comparison& comparison, const CameraFacts& a, const CameraFacts& b)
        : mComparison(comparison), mA(a), mB(b) {}

    void run() {
        texts("projection", mA.orthographic ? "orthographic" : "perspective",
              mB.orthographic ? "orthographic" : "perspective");
        texts("driven by", driverText(mA.driver), driverText(mB.driver));
        texts("resolution", resolution(mA), resolution(mB));
        texts("squeeze", rounded(mA.squeeze, 6), rounded(mB.squeeze, 6));
        texts("gate fit", gateFitName(mA.gateFit), gateFitName(mB.gateFit));
        texts("target", mA.target, mB.target);
        const bool lens = mA.lensChanges || mB.lensChanges;
        rows(kLens, lens);
        rows(kPicture, lens);
        if (mA.hasTarget || mB.hasTarget)
            rows(kAim, mA.moves || mB.moves);
        if (mA.ortho && mB.ortho && mComparison.differ(mA.ortho->width, mB.ortho->width))
            texts("ortho width", significant(mA.ortho->width, 7) + " cm", significant(mB.ortho->width, 7) + " cm");
    }

private:
    static std::string resolution(const CameraFacts& camera) {
        return camera.pictureAspect <= 0.0
                   ? "none"
                   : rounded(camera.resolution[0], 3) + " × " + rounded(camera.resolution[1], 3) +
                         (camera.pixelAspect == 1.0 ? "" : ", pixels " + rounded(camera.pixelAspect, 4) + ":1");
    }

    void texts(const char* what, const std::string& a, const std::string& b) {
        if (a != b)
            mComparison.add(DiffKind::optics, mA.name, what, a, b);
    }

    template <std::size_t kCount>
    void rows(const std::array<OpticsRow, kCount>& table, bool changes) {
        for (const OpticsRow& row : table) {
            mComparison.addWorst(
                {DiffKind::optics, mA.name, row.what, {}, {}, {}, row.unit, {}, 0}, changes,
                [&](DiffMoment moment) { return std::pair(row.value(mA.at(moment.a)), row.value(mB.at(moment.b))); });
        }
    }

    Comparison& mComparison;
    const CameraFacts &mA, &mB;
};

} // namespace

void compareTransforms(Comparison& comparison) { TransformComparison(comparison).run(); }

void compareCameras(Comparison& comparison) {
    for (const auto& [nodeA, nodeB] : comparison.pairs) {
        const auto a = comparison.a.cameraOf.find(nodeA), b = comparison.b.cameraOf.find(nodeB);
        if (a != comparison.a.cameraOf.end() && b != comparison.b.cameraOf.end())
            CameraComparison(comparison, *a->second, *b->second).run();
    }
}

} // namespace tool
