// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The span of keys of a node and all its descendants on one layer.
#include <vector>

#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxGeometry.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

/// The widening of one interval by the keys that the objects' properties have on one layer.
class IntervalSearch {
public:
    IntervalSearch(FbxTimeSpan& span, const FbxAnimLayer& layer) : mSpan(span), mLayer(layer) {}

    void visitNode(FbxNode& node) {
        visitProperties(node);
        for (int i = 0; i < node.GetNodeAttributeCount(); ++i) {
            FbxNodeAttribute* attribute = node.GetNodeAttributeByIndex(i);
            visitProperties(*attribute);
            if (auto* geometry = FbxCast<FbxGeometry>(attribute))
                visitShapeChannels(*geometry);
        }
    }
    [[nodiscard]] bool found() const { return mFound; }

private:
    void visitProperties(FbxObject& object) {
        // Only properties with a connection can be animated.
        for (const detail::PropertyData* property : object.data().properties()) {
            for (const detail::ConnectionPoint* source : property->plug.sources)
                if (source->property < 0)
                    visitSource(*source->object);
        }
    }

    void visitSource(FbxObject& source) {
        const auto* curveNode = FbxCast<FbxAnimCurveNode>(&source);
        FbxTimeSpan span;
        if (!curveNode || !curveNode->IsConnectedDstObject(&mLayer) || !curveNode->GetAnimationInterval(span))
            return;
        if (span.GetStart() < mSpan.GetStart())
            mSpan.SetStart(span.GetStart());
        if (span.GetStop() > mSpan.GetStop())
            mSpan.SetStop(span.GetStop());
        mFound = true;
    }

    void visitShapeChannels(FbxGeometry& geometry) {
        for (int b = 0; b < geometry.GetDeformerCount(FbxDeformer::eBlendShape); ++b) {
            auto* blendShape = static_cast<FbxBlendShape*>(geometry.GetDeformer(b, FbxDeformer::eBlendShape));
            for (int c = 0; c < blendShape->GetBlendShapeChannelCount(); ++c)
                visitProperties(*blendShape->GetBlendShapeChannel(c));
        }
    }

    FbxTimeSpan& mSpan;
    const FbxAnimLayer& mLayer;
    bool mFound = false;
};

} // namespace

bool FbxNode::GetAnimationInterval(FbxTimeSpan& pInterval, FbxAnimStack* pAnimStack, int pAnimLayerId) {
    if (!pAnimStack && GetScene())
        pAnimStack = GetScene()->GetCurrentAnimationStack();
    const FbxAnimLayer* layer = pAnimStack ? pAnimStack->GetMember<FbxAnimLayer>(pAnimLayerId) : nullptr;
    if (!layer)
        return false;

    IntervalSearch search(pInterval, *layer);
    std::vector<FbxNode*> pending{this};
    while (!pending.empty()) {
        FbxNode* node = pending.back();
        pending.pop_back();
        search.visitNode(*node);
        for (int i = 0; i < node->GetChildCount(); ++i)
            pending.push_back(node->GetChild(i));
    }
    return search.found();
}

FBXSDK_NAMESPACE_END
