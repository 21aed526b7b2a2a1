// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Value objects to write and accessors for the results: a context with an empty scene, keyed channels,
// small meshes, and the resulting curves and nodes.
#pragma once

#include "FbxSdk.h"

#include <fbxsdk.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {

/// The lists of a scene's objects; the test owns the objects.
struct WrittenObjects {
    std::vector<TnFbxCamera*> cameras;
    std::vector<TnFbxLight*> lights;
    std::vector<TnFbxTransform*> transforms;
    std::vector<TnFbxNull*> nulls;
    std::vector<TnFbxMesh*> meshes;
};

/// Options for a write without point caches.
inline TnFbxWriteInfo writeInfo() {
    TnFbxWriteInfo info;
    info.setFileName("unused.fbx");
    info.setAnimationStackName("any name will do");
    info.setAnimateMeshVertices(false);
    return info;
}

/// A context into which scenes are written.
class WrittenScene {
public:
    WrittenScene() {
        EXPECT_TRUE(sdk.initFbxSdkManager());
        scene = sdk.getScene();
        manager = scene->GetFbxManager();
    }

    bool create(const WrittenObjects& objects, const TnFbxWriteInfo& info = writeInfo()) {
        return sdk.createScene(info, objects.cameras, objects.lights, objects.transforms, objects.nulls,
                               objects.meshes);
    }

    /// The stack and layer that curves are written to; for tests of single writers.
    void prepareStack() { sdk.initCreateAnimationStack(); }

    fbxsdk::FbxAnimLayer* layer() const {
        auto* stack = scene->GetSrcObject<fbxsdk::FbxAnimStack>(0);
        return stack != nullptr ? stack->GetSrcObject<fbxsdk::FbxAnimLayer>(0) : nullptr;
    }

    /// The curve that was written; null when there is none.
    fbxsdk::FbxAnimCurve* curve(fbxsdk::FbxProperty property, const char* component = nullptr) const {
        return property.GetCurve(layer(), property.GetName(), component, /*pCreate*/ false);
    }

    std::vector<std::string> childNames() const {
        std::vector<std::string> names;
        for (int i = 0; i < scene->GetRootNode()->GetChildCount(); ++i)
            names.emplace_back(scene->GetRootNode()->GetChild(i)->GetName());
        return names;
    }

    fbxsdk::FbxNode* child(int index = 0) const { return scene->GetRootNode()->GetChild(index); }

    FbxSdk sdk;
    fbxsdk::FbxScene* scene = nullptr;
    fbxsdk::FbxManager* manager = nullptr;
};

/// Ticks and value of every key, as the curve has them.
inline std::vector<std::pair<fbxsdk::FbxLongLong, float>> keysOf(const fbxsdk::FbxAnimCurve* curve) {
    std::vector<std::pair<fbxsdk::FbxLongLong, float>> keys;
    for (int i = 0; curve != nullptr && i < curve->KeyGetCount(); ++i)
        keys.emplace_back(curve->KeyGetTime(i).Get(), curve->KeyGetValue(i));
    return keys;
}

inline std::vector<float> valuesOf(const fbxsdk::FbxAnimCurve* curve) {
    std::vector<float> values;
    for (const auto& key : keysOf(curve))
        values.push_back(key.second);
    return values;
}

/// The samples of frames from `startFrame` on.
inline TnFbxTime timeOf(int startFrame, std::size_t count, float rate = 24.0f) {
    TnFbxTime time;
    time.setTime(0.0f, startFrame, startFrame + static_cast<int>(count) - 1, rate);
    return time;
}

/// One polygon over as many points as it has corners: a fan in the plane z = 0.
inline std::unique_ptr<TnFbxMesh> polygonMesh(const std::string& name, int corners = 3) {
    auto mesh = std::make_unique<TnFbxMesh>();
    mesh->setName(name);
    EXPECT_TRUE(mesh->allocateGeometryData(1, corners, corners));
    mesh->setPolygonVertexSize(0, corners);
    for (int i = 0; i < corners; ++i) {
        mesh->setPointIndex(i, i);
        mesh->setControlPoint(i, static_cast<float>(i), static_cast<float>(i * i), 0.0f);
    }
    return mesh;
}

/// The same with one set of points per frame: set s is moved by s along Z.
inline std::unique_ptr<TnFbxMesh> movingMesh(const std::string& name, int sets) {
    auto mesh = polygonMesh(name);
    for (int set = 1; set < sets; ++set) {
        mesh->addControlPointSet();
        for (int i = 0; i < mesh->getNumberOfControlPoints(); ++i)
            mesh->addControlPoint(static_cast<float>(i), static_cast<float>(i * i), static_cast<float>(set));
    }
    return mesh;
}

} // namespace Tarnell::Fbx::test
