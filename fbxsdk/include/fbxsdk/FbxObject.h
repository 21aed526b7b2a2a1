// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The base of everything a manager owns: a name, properties and connections.
#pragma once

#include <memory>
#include <string>

#include <fbxsdk/FbxClassId.h>
#include <fbxsdk/FbxCriteria.h>
#include <fbxsdk/FbxProperty.h>

FBXSDK_NAMESPACE_BEGIN

class FbxDocument;
class FbxManager;
class FbxScene;

namespace detail {
struct ClassInfo;
struct ObjectData;
class ManagerData;
} // namespace detail

struct FbxConnection {
    enum EType {
        eNone = 0,
        eSystem = 1 << 0,
        eUser = 1 << 1,
        eSystemOrUser = eUser | eSystem,
        eReference = 1 << 2,
        eContains = 1 << 3,
        eData = 1 << 4,
        eLinkType = 1 << 5,
        eDefault = eUser,
        eUnidirectional = 1 << 6
    };
};

/// What every class of objects declares: identity and the two factories.
///
/// With a manager the new object belongs to the manager alone; with a container it becomes a source of the container,
/// hence a member of the container's scene. A null name is the empty name. Null when the first argument is null.
#define FBXSDK_OBJECT_DECLARE(Class, Parent)                                                                           \
public:                                                                                                                \
    static const FbxClassId ClassId;                                                                                   \
    static Class* Create(FbxManager* pManager, const char* pName);                                                     \
    static Class* Create(FbxObject* pContainer, const char* pName);                                                    \
                                                                                                                       \
protected:                                                                                                             \
    Class(FbxManager& pManager, const detail::ClassInfo& pInfo);                                                       \
    ~Class() override;                                                                                                 \
                                                                                                                       \
private:                                                                                                               \
    friend class detail::ManagerData;

/// The same for classes that only others derive from.
#define FBXSDK_ABSTRACT_DECLARE(Class, Parent)                                                                         \
public:                                                                                                                \
    static const FbxClassId ClassId;                                                                                   \
                                                                                                                       \
protected:                                                                                                             \
    Class(FbxManager& pManager, const detail::ClassInfo& pInfo);                                                       \
    ~Class() override;                                                                                                 \
                                                                                                                       \
private:                                                                                                               \
    friend class detail::ManagerData;

/// Objects live until their manager is destroyed or Destroy is called; they are never deleted directly.
class FBXSDK_DLL FbxObject {
public:
    static const FbxClassId ClassId;
    static FbxObject* Create(FbxManager* pManager, const char* pName);
    static FbxObject* Create(FbxObject* pContainer, const char* pName);

    FbxObject(const FbxObject&) = delete;
    FbxObject& operator=(const FbxObject&) = delete;

    /// Disconnects the object from everything and frees it; with pRecursive also its source objects, and theirs. A
    /// scene takes its members along. A scene's root node and global settings stay: they go with the scene only.
    void Destroy(bool pRecursive = false);

    /// The class the object was created as.
    [[nodiscard]] FbxClassId GetClassId() const;
    template <class T>
    [[nodiscard]] bool Is() const {
        return GetClassId().Is(T::ClassId);
    }

    /// UTF-8; valid until the name changes or the object dies.
    [[nodiscard]] const char* GetName() const;
    void SetName(const char* pName);

    [[nodiscard]] FbxManager* GetFbxManager() const;
    /// The scene (document) that the object is a member of; null when it is in none.
    [[nodiscard]] FbxScene* GetScene() const;
    [[nodiscard]] FbxDocument* GetDocument() const;

    /// An invalid property when there is none of that name.
    [[nodiscard]] FbxProperty FindProperty(const char* pName, bool pCaseSensitive = true) const;
    [[nodiscard]] FbxProperty FindProperty(const char* pName, const FbxDataType& pDataType,
                                           bool pCaseSensitive = true) const;
    [[nodiscard]] FbxProperty GetFirstProperty() const;
    [[nodiscard]] FbxProperty GetNextProperty(const FbxProperty& pProperty) const;

    // Connections. A source is an input or a child; order is the order of connection. An index out of range gives null.
    bool ConnectSrcObject(FbxObject* pObject, FbxConnection::EType pType = FbxConnection::eNone);
    bool ConnectDstObject(FbxObject* pObject, FbxConnection::EType pType = FbxConnection::eNone);
    [[nodiscard]] bool IsConnectedSrcObject(const FbxObject* pObject) const;
    [[nodiscard]] bool IsConnectedDstObject(const FbxObject* pObject) const;
    bool DisconnectSrcObject(FbxObject* pObject);
    bool DisconnectDstObject(FbxObject* pObject);
    bool ConnectSrcProperty(const FbxProperty& pProperty);
    bool ConnectDstProperty(const FbxProperty& pProperty);

    [[nodiscard]] int GetSrcObjectCount() const;
    [[nodiscard]] int GetSrcObjectCount(const FbxCriteria& pCriteria) const;
    [[nodiscard]] FbxObject* GetSrcObject(int pIndex = 0) const;
    [[nodiscard]] FbxObject* GetSrcObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    template <class T>
    [[nodiscard]] int GetSrcObjectCount() const {
        return GetSrcObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    template <class T>
    [[nodiscard]] T* GetSrcObject(int pIndex = 0) const {
        return static_cast<T*>(GetSrcObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    [[nodiscard]] int GetDstObjectCount() const;
    [[nodiscard]] int GetDstObjectCount(const FbxCriteria& pCriteria) const;
    [[nodiscard]] FbxObject* GetDstObject(int pIndex = 0) const;
    [[nodiscard]] FbxObject* GetDstObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    template <class T>
    [[nodiscard]] int GetDstObjectCount() const {
        return GetDstObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    template <class T>
    [[nodiscard]] T* GetDstObject(int pIndex = 0) const {
        return static_cast<T*>(GetDstObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    [[nodiscard]] int GetSrcPropertyCount() const;
    [[nodiscard]] FbxProperty GetSrcProperty(int pIndex = 0) const;
    [[nodiscard]] int GetDstPropertyCount() const;
    [[nodiscard]] FbxProperty GetDstProperty(int pIndex = 0) const;

    /// Parent of the object's properties, for FbxProperty::Create.
    FbxProperty RootProperty;

    /// The platform's own view of the object.
    [[nodiscard]] detail::ObjectData& data() const { return *mData; }

protected:
    FbxObject(FbxManager& pManager, const detail::ClassInfo& pInfo);
    virtual ~FbxObject();

    /// Called on both ends after a connection between objects was made or cut, before anybody can ask for it.
    /// `pSource` becomes (or was) a source of `pDestination`; one of the two is this object.
    virtual void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected);
    /// Called when the object becomes a member of a scene (or leaves it: null).
    virtual void sceneChanged(FbxScene* pScene);

private:
    friend class detail::ManagerData;
    friend struct detail::ObjectData;
    std::unique_ptr<detail::ObjectData> mData;
};

/// The object as a T when it is one, else null; null for null.
template <class T>
[[nodiscard]] T* FbxCast(FbxObject* pObject) {
    return pObject && pObject->Is<T>() ? static_cast<T*>(pObject) : nullptr;
}
template <class T>
[[nodiscard]] const T* FbxCast(const FbxObject* pObject) {
    return pObject && pObject->Is<T>() ? static_cast<const T*>(pObject) : nullptr;
}

FBXSDK_NAMESPACE_END
