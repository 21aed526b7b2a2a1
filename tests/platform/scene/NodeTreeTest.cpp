// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The tree of nodes: order, moves, cycles, and depths that exceed the call stack.
#include <climits>
#include <random>
#include <string>
#include <vector>

#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class NodeTreeTest : public SceneFixture {
protected:
    FbxNode* node(const char* name = "") { return make<FbxNode>(name); }

    static std::string childNames(FbxNode* parent) {
        std::string names;
        for (int i = 0; i < parent->GetChildCount(); ++i)
            names += parent->GetChild(i)->GetName();
        return names;
    }

    /// Whether the node's children and its source nodes are the same, in the same order, and have it as their parent.
    static void expectSound(FbxNode* parent) {
        ASSERT_EQ(parent->GetChildCount(), parent->GetSrcObjectCount<FbxNode>());
        for (int i = 0; i < parent->GetChildCount(); ++i) {
            EXPECT_EQ(parent->GetChild(i), parent->GetSrcObject<FbxNode>(i));
            EXPECT_EQ(parent->GetChild(i)->GetParent(), parent);
        }
    }
};

TEST_F(NodeTreeTest, KeepsChildrenInTheOrderOfAdding) {
    FbxNode* parent = node("parent");

    for (const char* name : {"a", "b", "c"})
        EXPECT_TRUE(parent->AddChild(node(name)));

    EXPECT_EQ(childNames(parent), "abc");
    EXPECT_EQ(parent->GetChild(1)->GetParent(), parent);
    expectSound(parent);
}

TEST_F(NodeTreeTest, GivesNullForAChildOutOfRange) {
    FbxNode* parent = node();
    parent->AddChild(node());
    const FbxNode* constParent = parent;

    EXPECT_EQ(parent->GetChild(-1), nullptr);
    EXPECT_EQ(parent->GetChild(1), nullptr);
    EXPECT_EQ(parent->GetChild(INT_MAX), nullptr);
    EXPECT_EQ(constParent->GetChild(1), nullptr);
    EXPECT_NE(constParent->GetChild(0), nullptr);
}

TEST_F(NodeTreeTest, MovesAChildThatHadAnotherParent) {
    FbxNode* first = node("first");
    FbxNode* second = node("second");
    for (const char* name : {"a", "b", "c"})
        first->AddChild(node(name));
    FbxNode* moved = first->GetChild(1);
    moved->LclTranslation.Set(FbxDouble3(1, 2, 3));

    EXPECT_TRUE(second->AddChild(moved));

    EXPECT_EQ(childNames(first), "ac");
    EXPECT_EQ(childNames(second), "b");
    EXPECT_EQ(moved->GetParent(), second);
    EXPECT_EQ(moved->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_FALSE(first->IsConnectedSrcObject(moved));
    expectSound(first);
    expectSound(second);
}

TEST_F(NodeTreeTest, KeepsThePlaceOfAChildThatIsAddedAgain) {
    FbxNode* parent = node();
    for (const char* name : {"a", "b"})
        parent->AddChild(node(name));

    EXPECT_TRUE(parent->AddChild(parent->GetChild(0)));

    EXPECT_EQ(childNames(parent), "ab");
    expectSound(parent);
}

TEST_F(NodeTreeTest, RefusesNullItselfAndItsAncestors) {
    FbxNode* top = node("top");
    FbxNode* middle = node("middle");
    FbxNode* bottom = node("bottom");
    top->AddChild(middle);
    middle->AddChild(bottom);

    EXPECT_FALSE(top->AddChild(nullptr));
    EXPECT_FALSE(top->AddChild(top));
    EXPECT_FALSE(bottom->AddChild(middle));
    EXPECT_FALSE(bottom->AddChild(top));

    EXPECT_EQ(top->GetParent(), nullptr);
    EXPECT_EQ(middle->GetParent(), top);
    EXPECT_EQ(bottom->GetChildCount(), 0);
    for (FbxNode* each : {top, middle, bottom})
        expectSound(each);
}

TEST_F(NodeTreeTest, FollowsGenericConnections) {
    FbxNode* parent = node("parent");
    FbxNode* child = node("child");

    parent->ConnectSrcObject(child);
    EXPECT_EQ(child->GetParent(), parent);
    EXPECT_EQ(parent->GetChild(0), child);

    child->DisconnectDstObject(parent);
    EXPECT_EQ(child->GetParent(), nullptr);
    EXPECT_EQ(parent->GetChildCount(), 0);

    child->ConnectDstObject(parent);
    EXPECT_EQ(child->GetParent(), parent);
    expectSound(parent);
}

TEST_F(NodeTreeTest, LeavesTheFirstParentWhenConnectedToASecond) {
    FbxNode* first = node("first");
    FbxNode* second = node("second");
    FbxNode* child = node("child");
    first->ConnectSrcObject(child);

    second->ConnectSrcObject(child);

    EXPECT_EQ(child->GetParent(), second);
    EXPECT_EQ(first->GetChildCount(), 0);
    EXPECT_EQ(child->GetDstObjectCount<FbxNode>(), 1);
    expectSound(first);
    expectSound(second);
}

TEST_F(NodeTreeTest, CutsAGenericConnectionThatWouldCloseACycle) {
    FbxNode* top = node("top");
    FbxNode* bottom = node("bottom");
    top->AddChild(bottom);

    bottom->ConnectSrcObject(top);
    top->ConnectSrcObject(top);

    EXPECT_EQ(top->GetParent(), nullptr);
    EXPECT_EQ(bottom->GetParent(), top);
    EXPECT_FALSE(bottom->IsConnectedSrcObject(top));
    EXPECT_FALSE(top->IsConnectedSrcObject(top));
    expectSound(top);
    expectSound(bottom);
}

TEST_F(NodeTreeTest, StaysSoundUnderRandomConnections) {
    std::mt19937 random(20240601);
    std::vector<FbxNode*> nodes;
    for (int i = 0; i < 60; ++i)
        nodes.push_back(node());
    const auto any = [&] { return nodes[random() % nodes.size()]; };

    for (int i = 0; i < 5000; ++i) {
        FbxNode* parent = any();
        FbxNode* child = any();
        switch (random() % 4) {
        case 0:
            parent->AddChild(child);
            break;
        case 1:
            parent->ConnectSrcObject(child);
            break;
        case 2:
            child->ConnectDstObject(parent);
            break;
        default:
            parent->RemoveChild(child);
            break;
        }
    }

    for (FbxNode* each : nodes) {
        expectSound(each);
        int depth = 0;
        for (FbxNode* up = each; up; up = up->GetParent())
            ASSERT_LE(++depth, 60);
    }
}

TEST_F(NodeTreeTest, RemovesAChild) {
    FbxNode* parent = node();
    for (const char* name : {"a", "b", "c"})
        parent->AddChild(node(name));
    FbxNode* removed = parent->GetChild(1);

    EXPECT_EQ(parent->RemoveChild(removed), removed);

    EXPECT_EQ(childNames(parent), "ac");
    EXPECT_EQ(removed->GetParent(), nullptr);
    EXPECT_EQ(removed->GetScene(), scene);
}

TEST_F(NodeTreeTest, RemovesNothingThatIsNoChild) {
    FbxNode* parent = node();
    FbxNode* child = node();
    FbxNode* grandchild = node();
    parent->AddChild(child);
    child->AddChild(grandchild);

    EXPECT_EQ(parent->RemoveChild(grandchild), nullptr);
    EXPECT_EQ(parent->RemoveChild(nullptr), nullptr);
    EXPECT_EQ(parent->RemoveChild(parent), nullptr);
    EXPECT_EQ(grandchild->GetParent(), child);
}

TEST_F(NodeTreeTest, ForgetsADestroyedChildAndADestroyedParent) {
    FbxNode* parent = node();
    FbxNode* child = node();
    FbxNode* grandchild = node();
    parent->AddChild(child);
    child->AddChild(grandchild);

    child->Destroy();

    EXPECT_EQ(parent->GetChildCount(), 0);
    EXPECT_EQ(grandchild->GetParent(), nullptr);
}

TEST_F(NodeTreeTest, CountsAndFindsChildrenAtEveryDepth) {
    FbxNode* top = node("top");
    FbxNode* left = node("left");
    FbxNode* right = node("right");
    FbxNode* under = node("under");
    top->AddChild(left);
    top->AddChild(right);
    left->AddChild(under);

    EXPECT_EQ(top->GetChildCount(), 2);
    EXPECT_EQ(top->GetChildCount(true), 3);
    EXPECT_EQ(under->GetChildCount(true), 0);
    EXPECT_EQ(top->FindChild("under"), under);
    EXPECT_EQ(top->FindChild("under", false), nullptr);
    EXPECT_EQ(top->FindChild("right", false), right);
    EXPECT_EQ(top->FindChild("top"), nullptr);
    EXPECT_EQ(top->FindChild("Under"), nullptr);
    EXPECT_EQ(top->FindChild(nullptr), nullptr);
}

TEST_F(NodeTreeTest, FindsTheUpperOfTwoNodesOfOneNameInABranch) {
    FbxNode* top = node("top");
    FbxNode* upper = node("雪");
    FbxNode* lower = node("雪");
    top->AddChild(upper);
    upper->AddChild(lower);

    EXPECT_EQ(top->FindChild("雪"), upper);
    EXPECT_EQ(upper->FindChild("雪"), lower);
}

TEST_F(NodeTreeTest, HandlesAChainOfAHundredThousandNodes) {
    constexpr int kDepth = 100000;
    FbxNode* top = node("top");
    FbxNode* bottom = top;
    for (int i = 1; i < kDepth; ++i) {
        FbxNode* next = node(i == kDepth - 1 ? "bottom" : "");
        ASSERT_TRUE(bottom->AddChild(next));
        bottom = next;
    }

    EXPECT_EQ(top->GetChildCount(true), kDepth - 1);
    EXPECT_EQ(top->FindChild("bottom"), bottom);
    EXPECT_FALSE(bottom->AddChild(top));
}

TEST_F(NodeTreeTest, BuildsADeepChainFromPairsWithoutWalkingItEachTime) {
    // Each join has a child that has a child, so a plain walk up from the parent would take half a billion steps.
    constexpr int kPairs = 30000;
    FbxNode* top = node();
    FbxNode* bottom = top;
    for (int i = 0; i < kPairs; ++i) {
        FbxNode* upper = node();
        FbxNode* lower = node();
        upper->AddChild(lower);
        ASSERT_TRUE(bottom->AddChild(upper));
        bottom = lower;
    }

    EXPECT_EQ(top->GetChildCount(true), 2 * kPairs);
}

TEST_F(NodeTreeTest, HandlesAHundredThousandChildrenOfOneMesh) {
    constexpr int kCount = 100000;
    FbxNode* parent = node();
    FbxMesh* mesh = make<FbxMesh>();
    for (int i = 0; i < kCount; ++i) {
        FbxNode* child = node();
        parent->AddChild(child);
        child->SetNodeAttribute(mesh);
    }
    ASSERT_EQ(parent->GetChildCount(), kCount);
    ASSERT_EQ(mesh->GetNodeCount(), kCount);

    FbxNode* last = parent->GetChild(kCount - 1);
    mesh->Destroy();
    parent->Destroy();

    EXPECT_EQ(last->GetParent(), nullptr);
    EXPECT_EQ(last->GetNodeAttribute(), nullptr);
}

TEST_F(NodeTreeTest, BringsNodesOfNoSceneIntoTheScene) {
    FbxNode* parent = node("parent");
    FbxNode* outside = FbxNode::Create(manager, "outside");
    FbxNode* under = FbxNode::Create(manager, "under");
    FbxNull* attribute = FbxNull::Create(manager, "null");
    FbxSurfacePhong* material = FbxSurfacePhong::Create(manager, "phong");
    outside->AddChild(under);
    under->SetNodeAttribute(attribute);
    under->AddMaterial(material);
    ASSERT_EQ(under->GetScene(), nullptr);

    parent->AddChild(outside);

    EXPECT_EQ(outside->GetScene(), scene);
    EXPECT_EQ(under->GetScene(), scene);
    EXPECT_EQ(attribute->GetScene(), scene);
    EXPECT_EQ(material->GetScene(), scene);
}

} // namespace
