// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Queries to a scene.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk.h>

#include "JsonWriter.h"

namespace tool {

/// A node of the tree. Unparented nodes are at depth 0, like the children of the root.
struct TreeNode {
    FbxNode* node;
    int parent; ///< index in the list; -1 at depth 0
    int depth;
    bool isLast;     ///< of its parent's children
    bool isDetached; ///< unparented
};

/// All nodes but the root, parents before children, children in their order; unparented ones come last.
std::vector<TreeNode> nodesInOrder(FbxScene& scene);

/// Whether any curve of any take drives the property.
bool isAnimated(const FbxProperty& property);

/// The channels of the blend shapes of the node's geometry.
std::vector<FbxBlendShapeChannel*> blendChannelsOf(FbxNode& node);

/// Whether the node is a producer camera, one of an application's own views.
bool isProducer(const FbxNode& node);

/// Whether a faithful write made the node only to skew the one below it, as it does wherever that is written again.
bool isSkewHelper(const FbxNode& node);

/// The object's properties in their order, those of compounds after the compound.
std::vector<FbxProperty> propertiesOf(const FbxObject& object);

/// The scene's objects of that name: nodes first, then the others.
std::vector<FbxObject*> objectsNamed(FbxScene& scene, const std::string& name);

/// The name of the object for people: an attribute without a name has that of its node.
std::string spokenName(const FbxObject& object);

/// The class without the prefix that all classes have: "Node", "Camera", "AnimLayer".
std::string className(const FbxObject& object);

/// The message that there is no object of the name, with similar names.
std::string unknownObject(FbxScene& scene, const std::string& name);

/// The key "id": the object's number in the file, null where files name objects otherwise.
void printId(const FbxObject& object, bool hasIds, JsonWriter& json);

} // namespace tool
