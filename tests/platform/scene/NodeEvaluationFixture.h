// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Nodes of a scene, and their matrices against plain ones.
#pragma once

#include <fbxsdk/FbxNode.h>

#include "PlainMatrix.h"
#include "SceneFixture.h"

/// Double arithmetic over products of a dozen matrices with elements of a few hundred.
inline constexpr double kMatrixTolerance = 1e-9;

class NodeEvaluationFixture : public SceneFixture {
protected:
    fbxsdk::FbxNode* addNode(const char* name = "node", fbxsdk::FbxNode* parent = nullptr) {
        fbxsdk::FbxNode* node = make<fbxsdk::FbxNode>(name);
        (parent ? parent : scene->GetRootNode())->AddChild(node);
        return node;
    }

    static void expectLocal(fbxsdk::FbxNode* node, const plain::Matrix& expected, const char* what = "") {
        const plain::Matrix actual = plain::of(node->EvaluateLocalTransform());
        EXPECT_LT(plain::difference(actual, expected), kMatrixTolerance) << what << "\n"
                                                                         << plain::text(actual) << "instead of\n"
                                                                         << plain::text(expected);
    }
    static void expectGlobal(fbxsdk::FbxNode* node, const plain::Matrix& expected,
                             fbxsdk::FbxTime time = fbxsdk::FBXSDK_TIME_INFINITE) {
        const plain::Matrix actual = plain::of(node->EvaluateGlobalTransform(time));
        EXPECT_LT(plain::difference(actual, expected), kMatrixTolerance * (1.0 + plain::largest(expected)))
            << node->GetName() << "\n"
            << plain::text(actual) << "instead of\n"
            << plain::text(expected);
    }
    static double globalX(fbxsdk::FbxNode* node, fbxsdk::FbxTime time = fbxsdk::FBXSDK_TIME_INFINITE) {
        return node->EvaluateGlobalTransform(time).GetT()[0];
    }
};
