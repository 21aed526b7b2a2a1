// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include <fbxsdk/FbxManager.h>

#include "object/ObjectData.h"
#include "object/Slab.h"

FBXSDK_NAMESPACE_BEGIN
class FbxIOPluginRegistry;
namespace detail {

class EvaluationBudget;

/// The manager's list of objects, and the only functions that create and free objects.
class ManagerData {
public:
    template <class T>
    static FbxObject* construct(FbxManager& manager, const ClassInfo& info) {
        return new T(manager, info);
    }
    template <class T>
    static T* create(FbxManager* manager, const char* name) {
        return static_cast<T*>(createObject(manager, T::ClassId, name));
    }
    template <class T>
    static T* create(FbxObject* container, const char* name) {
        return static_cast<T*>(createObject(container, T::ClassId, name));
    }

    /// Null for a null manager or an abstract class.
    static FbxObject* createObject(FbxManager* manager, const FbxClassId& id, const char* name);
    /// The same, connected as a source of the container.
    static FbxObject* createObject(FbxObject* container, const FbxClassId& id, const char* name);
    /// Disconnects the objects from others and frees them. Connections between them are not removed one by one.
    static void destroyTogether(std::span<FbxObject* const> objects);
    /// Frees everything at once, without removing connections one by one.
    void destroyAll();

    void enter(FbxObject& object);
    void leave(FbxObject& object);

    std::vector<FbxObject*> objects;
    Slab<PropertyData> properties; ///< of all objects
    bool tearingDown = false;
    FbxIOSettings* settings = nullptr; ///< an object, which may be freed first
    /// Incremented with every change of a value, a key or a connection; evaluation caches compare it.
    std::uint64_t revision = 0;
    // Data that higher modules keep per manager, created on first use.
    std::shared_ptr<EvaluationBudget> evaluationBudget;
    std::shared_ptr<FbxIOPluginRegistry> registry;
};

} // namespace detail
FBXSDK_NAMESPACE_END
