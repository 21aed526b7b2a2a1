// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects as a host gets them, paired with the nodes of the reference that they were read from.
#pragma once

#include "Placement.h"
#include "Rows.h"

#include <Fbx.h>
#include <TnFbxError.h>

#include <algorithm>
#include <map>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace conformance {

template <class Object>
struct Handed {
    const Object* object;
    std::size_t nodeIndex; ///< of the reference's node
};

/// The array of one call.
template <class Object>
struct HandedList {
    std::unique_ptr<Object[]> objects;
    std::size_t count = 0;

    [[nodiscard]] std::span<const Object> span() const { return {objects.get(), count}; }
};

/// Reads all objects of a kind into an array created by the facade.
template <class Object>
using Reader = bool (Tarnell::Fbx::Fbx::*)(Tarnell::Fbx::TnFbxReadInfo&, Object**, int&) const;

/// Of a node without an attribute: unknown.
fbxsdk::FbxNodeAttribute::EType typeOf(const fbxsdk::FbxNode& node);

/// Pairs objects with the nodes of these types. The library returns parents before their children, which is
/// the scene's order once it has converted NURBS and patches to meshes.
template <class Object>
std::vector<Handed<Object>> matched(LoadedFile& file, std::span<const Object> objects,
                                    std::span<const fbxsdk::FbxNodeAttribute::EType> types, Findings& findings) {
    file.sdk().convertNurbsAndPatch(file.scene()->GetFbxManager(), file.scene());
    std::map<const SceneNode*, std::size_t> referenceIndex;
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i)
        referenceIndex[file.nodeOf(i)] = i;
    std::vector<Handed<Object>> result;
    std::size_t next = 0;
    for (const SceneNode& entry : file.nodes()) {
        if (std::ranges::find(types, typeOf(*entry.node)) == types.end())
            continue;
        const Object* object = next < objects.size() ? &objects[next] : nullptr;
        ++next;
        findings.compare(object && object->getName() == entry.node->GetName(), [&] {
            return std::string("no object of \"") + entry.node->GetName() + "\" at " + std::to_string(next - 1);
        });
        const auto found = referenceIndex.find(&entry);
        if (object && found != referenceIndex.end())
            result.push_back({object, found->second});
    }
    return result;
}

/// Reads all objects of a kind through the facade.
template <class Object>
HandedList<Object> read(const LoadedFile& file, Tarnell::Fbx::TnFbxReadInfo& info, Reader<Object> reader,
                        Findings& findings) {
    info.setFileName(file.file().path.string());
    info.setAnimationStackName("any"); // only must not be empty
    Object* objects = nullptr;
    int count = 0;
    const bool success = (Tarnell::Fbx::Fbx().*reader)(info, &objects, count);
    std::unique_ptr<Object[]> owner(objects);
    findings.compare(success, [] { return "not read: " + Tarnell::Fbx::lastError(); });
    return {std::move(owner), success ? static_cast<std::size_t>(count) : 0};
}

/// Whether the channel has a sample for that frame of the reference.
bool isSampled(const Tarnell::Fbx::TnFbxTransform& transform,
               Tarnell::Fbx::TnFbxTransform::EFbxTransformChannelType channel, double frame, double fps);

/// The channels at a frame.
Placement placementAt(const Tarnell::Fbx::TnFbxTransform& transform, double frame);
bool atOrigin(const Placement& placement);

bool hasKind(const Reference& reference, const std::string& kind);

void compareMatrices(const Reference& reference, const ReferenceNode& node, std::size_t frameIndex,
                     const Matrix12& actual, const Matrix12& expected, Findings& findings);

/// The placement of the node's content; `turn` is between the node and its geometric transform.
Matrix12 contentInWorld(const ReferenceNode& node, std::size_t frameIndex, const Matrix12& turn);

/// What a host reconstructs from the channels against the reference's matrix, at every frame that
/// was sampled. References have no more than the values at their frames.
void compareInWorld(const Reference& reference, const ReferenceNode& node,
                    const Tarnell::Fbx::TnFbxTransform& transform, const Matrix12& turn, Findings& findings);

/// A number that the reference states; nothing for what the file does not state.
std::optional<double> stated(const NamedNumbers& values, const char* name, std::size_t component = 0);
/// What is not stated is not compared.
void compareNumber(const ReferenceNode& node, const std::string& what, float actual, std::optional<double> expected,
                   Findings& findings);

/// One row of a table from numbers in files to enumerations of the library.
struct NumberRow {
    int stored, handedOut;
};

/// A number without a row is `otherwise`.
void compareEnum(const ReferenceNode& node, const std::string& what, int actual, std::optional<double> stored,
                 std::span<const NumberRow> rows, int otherwise, Findings& findings);

} // namespace conformance
