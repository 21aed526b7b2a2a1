// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scene that is written: its stack, its rate, and the warnings about its objects.
#pragma once

#include "KeyWriting.h"
#include "access/ObjectWarnings.h"
#include "model/MeshArrays.h"

#include "TnFbxWriteInfo.h"

#include <fbxsdk.h>

#include <map>
#include <memory>
#include <set>
#include <string>
#include <unordered_set>

namespace Tarnell::Fbx::faithful {

/// An empty scene of one stack with one layer.
class WrittenScene {
public:
    WrittenScene() = default;
    ~WrittenScene();
    WrittenScene(const WrittenScene&) = delete;
    WrittenScene& operator=(const WrittenScene&) = delete;

    /// To be called once. False, with the reason noted, when no manager can be created.
    bool begin(const TnFbxWriteInfo& info);
    /// States the span, and reports the warnings.
    void finish();

    const TnFbxWriteInfo& info() const { return *mInfo; }
    fbxsdk::FbxManager& manager() const { return *mManager; }
    fbxsdk::FbxScene& scene() const { return *mScene; }
    KeyWriter& keys() { return *mKeys; }
    /// Frames per second, exactly.
    double rate() const { return mRate; }
    detail::ObjectWarnings& warnings() { return mWarnings; }

    /// A node of the name below another one, or below the root.
    fbxsdk::FbxNode& addNode(const std::string& name, fbxsdk::FbxNode* parent = nullptr);
    /// A new attribute of the node, with its name.
    template <class Attribute>
    Attribute& add(fbxsdk::FbxNode& node) {
        auto* attribute = Attribute::Create(mScene, node.GetName());
        node.SetNodeAttribute(attribute);
        return *attribute;
    }

    /// The mesh in the scene for those arrays; null at first.
    fbxsdk::FbxMesh*& meshFor(const detail::MeshArrays::Identity& arrays) { return mMeshes[arrays]; }

    /// A name for a point cache that no other cache of the file has, in whatever case.
    std::string cacheNameFor(const std::string& mesh);

private:
    const TnFbxWriteInfo* mInfo = nullptr;
    fbxsdk::FbxManager* mManager = nullptr; // owned
    fbxsdk::FbxScene* mScene = nullptr;     // owned by the manager
    fbxsdk::FbxAnimStack* mStack = nullptr;
    std::unique_ptr<KeyWriter> mKeys;
    double mRate = 24.0;
    detail::ObjectWarnings mWarnings;
    std::unordered_set<std::string> mNodeNames;
    std::set<std::string> mCacheNames;
    std::map<detail::MeshArrays::Identity, fbxsdk::FbxMesh*> mMeshes;
    std::map<std::string, int> mNextNumbers; // of caches, by the name of their mesh
};

} // namespace Tarnell::Fbx::faithful
