// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The kinds of nodes, and the values of a transform's channels at a frame.
#include "LibraryObjects.h"

#include "Tolerances.h"

#include <cmath>

namespace conformance {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNodeAttribute;

namespace {

Point valuesAt(const TnFbxTransform& transform, int firstChannel, double frame) {
    Point values{};
    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(firstChannel + i);
        values[static_cast<std::size_t>(i)] =
            static_cast<double>(transform.getTransformValueAt(channel, static_cast<float>(frame)));
    }
    return values;
}

} // namespace

FbxNodeAttribute::EType typeOf(const fbxsdk::FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eUnknown;
}

bool isSampled(const TnFbxTransform& transform, TnFbxTransform::EFbxTransformChannelType channel, double frame,
               double fps) {
    if (!transform.getTransformAnimated(channel))
        return false;
    const TnFbxTime time = transform.getTransformTime(channel);
    return static_cast<double>(time.getFrameRate()) == fps && frame == std::floor(frame) &&
           frame >= time.getStartFrame() && frame <= time.getEndFrame();
}

Placement placementAt(const TnFbxTransform& transform, double frame) {
    return {valuesAt(transform, TnFbxTransform::kFbxTransformPositionX, frame),
            valuesAt(transform, TnFbxTransform::kFbxTransformRotationX, frame),
            valuesAt(transform, TnFbxTransform::kFbxTransformScaleX, frame)};
}

bool atOrigin(const Placement& placement) { return placement.position == Point{0, 0, 0}; }

bool hasKind(const Reference& reference, const std::string& kind) {
    return std::ranges::find(reference.nodes, kind, &ReferenceNode::kind) != reference.nodes.end();
}

void compareMatrices(const Reference& reference, const ReferenceNode& node, std::size_t frameIndex,
                     const Matrix12& actual, const Matrix12& expected, Findings& findings) {
    findings.compare(
        sameMatrix(actual, expected, kHandedOutTolerance),
        [&] {
            return "\"" + node.name + "\" at frame " + printed(reference.frames[frameIndex]) + ": " +
                   printed(actual.data(), actual.size()) + " instead of " + printed(expected.data(), expected.size());
        });
}

Matrix12 contentInWorld(const ReferenceNode& node, std::size_t frameIndex, const Matrix12& turn) {
    return product(node.world[frameIndex], product(turn, node.geometric));
}

void compareInWorld(const Reference& reference, const ReferenceNode& node, const TnFbxTransform& transform,
                    const Matrix12& turn, Findings& findings) {
    for (std::size_t f = 0; f < node.world.size(); ++f) {
        const double frame = reference.frames[f];
        if (!isSampled(transform, TnFbxTransform::kFbxTransformPositionX, frame, reference.fps))
            continue;
        const Placement placement = placementAt(transform, frame);
        compareMatrices(reference, node, f, rebuilt(placement),
                        handedOut(contentInWorld(node, f, turn), atOrigin(placement)), findings);
    }
}

std::optional<double> stated(const NamedNumbers& values, const char* name, std::size_t component) {
    const auto found = values.find(name);
    if (found == values.end() || component >= found->second.size() || std::isnan(found->second[component]))
        return std::nullopt;
    return found->second[component];
}

void compareNumber(const ReferenceNode& node, const std::string& what, float actual, std::optional<double> expected,
                   Findings& findings) {
    if (!expected)
        return;
    findings.compare(closeTo(static_cast<double>(actual), *expected, kHandedOutTolerance), [&] {
        return "\"" + node.name + "\" " + what + ": " + printed(static_cast<double>(actual)) + " instead of " +
               printed(*expected);
    });
}

void compareEnum(const ReferenceNode& node, const std::string& what, int actual, std::optional<double> stored,
                 std::span<const NumberRow> rows, int otherwise, Findings& findings) {
    if (!stored)
        return;
    const auto found = std::ranges::find(rows, static_cast<int>(*stored), &NumberRow::stored);
    compareNumber(node, what, static_cast<float>(actual), found != rows.end() ? found->handedOut : otherwise, findings);
}

} // namespace conformance
