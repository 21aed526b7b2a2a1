// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Transform data of nodes: what is set, where it is stored, and invalid numbers in files.
#include <climits>
#include <cmath>
#include <limits>

#include <fbxsdk/FbxNode.h>

#include "SceneFixture.h"
#include "object/ObjectData.h"

namespace {

using namespace fbxsdk;

struct VectorCase {
    const char* property;
    void (FbxNode::*set)(FbxNode::EPivotSet, FbxVector4);
    FbxVector4 (*get)(const FbxNode&, FbxNode::EPivotSet);
    double initial;
};

const VectorCase kVectors[] = {
    {"PreRotation", &FbxNode::SetPreRotation,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetPreRotation(set)); }, 0},
    {"PostRotation", &FbxNode::SetPostRotation,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetPostRotation(set)); }, 0},
    {"RotationOffset", &FbxNode::SetRotationOffset,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetRotationOffset(set)); }, 0},
    {"RotationPivot", &FbxNode::SetRotationPivot,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetRotationPivot(set)); }, 0},
    {"ScalingOffset", &FbxNode::SetScalingOffset,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetScalingOffset(set)); }, 0},
    {"ScalingPivot", &FbxNode::SetScalingPivot,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return FbxVector4(node.GetScalingPivot(set)); }, 0},
    {"GeometricTranslation", &FbxNode::SetGeometricTranslation,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return node.GetGeometricTranslation(set); }, 0},
    {"GeometricRotation", &FbxNode::SetGeometricRotation,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return node.GetGeometricRotation(set); }, 0},
    {"GeometricScaling", &FbxNode::SetGeometricScaling,
     [](const FbxNode& node, FbxNode::EPivotSet set) { return node.GetGeometricScaling(set); }, 1},
};

class NodePivotsTest : public SceneFixture {
protected:
    FbxNode* node = make<FbxNode>("node");
};

TEST_F(NodePivotsTest, StartsFromTheDefaultsOfFiles) {
    for (const VectorCase& each : kVectors) {
        const FbxVector4 expected(each.initial, each.initial, each.initial, 1.0);
        EXPECT_EQ(each.get(*node, FbxNode::eSourcePivot), expected) << each.property;
        EXPECT_EQ(each.get(*node, FbxNode::eDestinationPivot), expected) << each.property;
    }
    EXPECT_TRUE(node->data().properties().empty());
}

TEST_F(NodePivotsTest, WritesTheSourceSetToItsPropertiesAndIgnoresW) {
    for (const VectorCase& each : kVectors) {
        SCOPED_TRACE(each.property);
        (node->*each.set)(FbxNode::eSourcePivot, FbxVector4(1.5, -2, 3, 77));

        EXPECT_EQ(node->FindProperty(each.property).Get<FbxDouble3>(), FbxDouble3(1.5, -2, 3));
        EXPECT_EQ(each.get(*node, FbxNode::eSourcePivot), FbxVector4(1.5, -2, 3, 1));
        EXPECT_EQ(each.get(*node, FbxNode::eDestinationPivot), FbxVector4(each.initial, each.initial, each.initial, 1));
    }
}

TEST_F(NodePivotsTest, ReadsTheSourceSetFromItsProperties) {
    for (const VectorCase& each : kVectors) {
        node->FindProperty(each.property).Set(FbxDouble3(4, 5, 6));
        EXPECT_EQ(each.get(*node, FbxNode::eSourcePivot), FbxVector4(4, 5, 6, 1)) << each.property;
    }
}

TEST_F(NodePivotsTest, KeepsTheDestinationSetApart) {
    for (const VectorCase& each : kVectors) {
        SCOPED_TRACE(each.property);
        (node->*each.set)(FbxNode::eDestinationPivot, FbxVector4(7, 8, 9, 0));

        EXPECT_EQ(each.get(*node, FbxNode::eDestinationPivot), FbxVector4(7, 8, 9, 1));
        EXPECT_EQ(each.get(*node, FbxNode::eSourcePivot), FbxVector4(each.initial, each.initial, each.initial, 1));
    }
    EXPECT_TRUE(node->data().properties().empty());
}

TEST_F(NodePivotsTest, KeepsReferencesToDifferentVectorsApart) {
    node->SetPreRotation(FbxNode::eSourcePivot, FbxVector4(1, 0, 0));
    node->SetPostRotation(FbxNode::eSourcePivot, FbxVector4(2, 0, 0));

    const FbxVector4& pre = node->GetPreRotation(FbxNode::eSourcePivot);
    const FbxVector4& post = node->GetPostRotation(FbxNode::eSourcePivot);

    EXPECT_EQ(pre[0], 1.0);
    EXPECT_EQ(post[0], 2.0);
}

TEST_F(NodePivotsTest, StoresWhatIsNoNumberAsItIs) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double infinity = std::numeric_limits<double>::infinity();

    node->SetRotationPivot(FbxNode::eSourcePivot, FbxVector4(nan, infinity, -infinity));

    const FbxVector4& pivot = node->GetRotationPivot(FbxNode::eSourcePivot);
    EXPECT_TRUE(std::isnan(pivot[0]));
    EXPECT_EQ(pivot[1], infinity);
    EXPECT_EQ(pivot[2], -infinity);
}

TEST_F(NodePivotsTest, KeepsTheRotationOrderOfEachSet) {
    FbxEuler::EOrder order = FbxEuler::eOrderSphericXYZ;
    node->GetRotationOrder(FbxNode::eSourcePivot, order);
    EXPECT_EQ(order, FbxEuler::eOrderXYZ);

    node->SetRotationOrder(FbxNode::eSourcePivot, eEulerZXY);
    node->SetRotationOrder(FbxNode::eDestinationPivot, eSphericXYZ);

    EXPECT_EQ(node->FindProperty("RotationOrder").Get<FbxEnum>(), 4);
    node->GetRotationOrder(FbxNode::eSourcePivot, order);
    EXPECT_EQ(order, FbxEuler::eOrderZXY);
    node->GetRotationOrder(FbxNode::eDestinationPivot, order);
    EXPECT_EQ(order, FbxEuler::eOrderSphericXYZ);
}

TEST_F(NodePivotsTest, TakesAnInvalidRotationOrderForXyz) {
    for (const FbxEnum wrong : {-1, 7, 100, INT_MAX, INT_MIN}) {
        node->FindProperty("RotationOrder").Set(wrong);
        FbxEuler::EOrder order = FbxEuler::eOrderZYX;
        node->GetRotationOrder(FbxNode::eSourcePivot, order);
        EXPECT_EQ(order, FbxEuler::eOrderXYZ) << wrong;
    }
}

TEST_F(NodePivotsTest, KeepsTheInheritType) {
    FbxTransform::EInheritType type = FbxTransform::eInheritRrs;
    node->GetTransformationInheritType(type);
    EXPECT_EQ(type, FbxTransform::eInheritRrSs);

    node->SetTransformationInheritType(FbxTransform::eInheritRrs);
    EXPECT_EQ(node->FindProperty("InheritType").Get<FbxEnum>(), 2);
    node->GetTransformationInheritType(type);
    EXPECT_EQ(type, FbxTransform::eInheritRrs);

    node->FindProperty("InheritType").Set(FbxEnum{3});
    node->GetTransformationInheritType(type);
    EXPECT_EQ(type, FbxTransform::eInheritRrSs);
}

TEST_F(NodePivotsTest, TurnsRotationOnOnlyWhenTold) {
    EXPECT_FALSE(node->GetRotationActive());

    node->SetRotationOrder(FbxNode::eSourcePivot, eEulerZYX);
    node->SetPreRotation(FbxNode::eSourcePivot, FbxVector4(1, 2, 3));
    EXPECT_FALSE(node->GetRotationActive());

    node->SetRotationActive(true);
    EXPECT_TRUE(node->GetRotationActive());
    EXPECT_TRUE(node->FindProperty("RotationActive").Get<FbxBool>());
}

TEST_F(NodePivotsTest, KeepsRotationSpaceForLimitsOfEachSet) {
    node->SetRotationSpaceForLimitOnly(FbxNode::eDestinationPivot, true);
    EXPECT_FALSE(node->GetRotationSpaceForLimitOnly(FbxNode::eSourcePivot));
    EXPECT_TRUE(node->GetRotationSpaceForLimitOnly(FbxNode::eDestinationPivot));

    node->SetRotationSpaceForLimitOnly(FbxNode::eSourcePivot, true);
    EXPECT_TRUE(node->FindProperty("RotationSpaceForLimitOnly").Get<FbxBool>());
}

} // namespace
