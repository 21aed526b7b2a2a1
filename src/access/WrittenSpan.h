// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Settings of all written nodes: their rotation order, and the span over which they are animated.
#pragma once

#include <fbxsdk.h>

#include <algorithm>

namespace Tarnell::Fbx::detail {

/// An order is used where a node's rotation settings are active, as they are for cameras and for lights with a
/// direction. Elsewhere every program rotates in the order XYZ.
inline void enforceRotationOrder(fbxsdk::FbxNode& node) {
    fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
    node.GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
    if (order != fbxsdk::FbxEuler::eOrderXYZ)
        node.SetRotationActive(true);
}

/// The span of time that a file states: that of its keys and of the range to write.
class WrittenSpan {
public:
    void addKeys(fbxsdk::FbxNode& node, fbxsdk::FbxAnimStack* stack) {
        mFound = node.GetAnimationInterval(mSpan, stack, /*pAnimLayerId*/ 0) || mFound;
    }

    void add(double seconds) {
        fbxsdk::FbxTime time;
        time.SetSecondDouble(seconds);
        mSpan.SetStart(std::min(mSpan.GetStart(), time));
        mSpan.SetStop(std::max(mSpan.GetStop(), time));
        mFound = true;
    }

    /// No effect without a span.
    void store(fbxsdk::FbxScene& scene, fbxsdk::FbxAnimStack* stack) const {
        if (mFound && stack != nullptr) {
            stack->SetLocalTimeSpan(mSpan);
            stack->SetReferenceTimeSpan(mSpan);
            scene.GetGlobalSettings().SetTimelineDefaultTimeSpan(mSpan);
        }
    }

private:
    fbxsdk::FbxTimeSpan mSpan{FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE};
    bool mFound = false;
};

} // namespace Tarnell::Fbx::detail
