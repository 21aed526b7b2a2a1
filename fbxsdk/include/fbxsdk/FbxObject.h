// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// The kinds of connections of the API. They are accepted wherever a connection is made and have no effect: every
/// connection is of one kind here, and files hold no other.
struct FbxConnection {
    /// Combinable bits; no call of this platform evaluates them.
    enum EType {
        eNone = 0,                       ///< no kind in particular
        eSystem = 1 << 0,                ///< made by the platform itself
        eUser = 1 << 1,                  ///< made by a host
        eSystemOrUser = eUser | eSystem, ///< either of the two
        eReference = 1 << 2,             ///< the destination refers to the source
        eContains = 1 << 3,              ///< the destination contains the source
        eData = 1 << 4,                  ///< carries a value
        eLinkType = 1 << 5,              ///< the mask of the kinds that say what a connection is for
        eDefault = eUser,                ///< used when a host does not specify a kind
        eUnidirectional = 1 << 6         ///< visible to the source only
    };
};

/// The declarations common to all object classes: identity and the two factories.
///
/// With a manager the new object belongs to the manager alone; with a container it becomes a source of the container,
/// hence a member of the container's scene. A null name is the empty name; names need not be unique. Null when the
/// first argument is null.
#define FBXSDK_OBJECT_DECLARE(Class, Parent)                                                                           \
public:                                                                                                                \
    /** The identity of the class, for FbxObject::Is and FbxCriteria::ObjectType. */                                   \
    static const FbxClassId ClassId;                                                                                   \
    /** Makes an object that belongs to the manager alone and is in no scene. Null when the manager is null. */        \
    static Class* Create(FbxManager* pManager, const char* pName);                                                     \
    /** Makes an object that is a source of the container, hence a member of its scene. Null for a null container. */  \
    static Class* Create(FbxObject* pContainer, const char* pName);                                                    \
                                                                                                                       \
protected:                                                                                                             \
    /** For the factories. */                                                                                          \
    FBXSDK_LOCAL Class(FbxManager& pManager, const detail::ClassInfo& pInfo);                                          \
    /** Objects are freed by Destroy and by their manager. */                                                          \
    FBXSDK_LOCAL ~Class() override;                                                                                    \
                                                                                                                       \
private:                                                                                                               \
    friend class detail::ManagerData;

/// The same for classes that only others derive from.
#define FBXSDK_ABSTRACT_DECLARE(Class, Parent)                                                                         \
public:                                                                                                                \
    /** The identity of the class, which all derived classes meet. */                                                  \
    static const FbxClassId ClassId;                                                                                   \
                                                                                                                       \
protected:                                                                                                             \
    /** For derived classes. */                                                                                        \
    FBXSDK_LOCAL Class(FbxManager& pManager, const detail::ClassInfo& pInfo);                                          \
    /** Objects are freed by Destroy and by their manager. */                                                          \
    FBXSDK_LOCAL ~Class() override;                                                                                    \
                                                                                                                       \
private:                                                                                                               \
    friend class detail::ManagerData;

/// The base of everything that a manager owns: a class, a name, properties, connections and its scene.
///
/// Objects exist until their manager is destroyed or Destroy is called; they are never deleted directly. A manager and
/// all of its objects are used by one thread at a time.
class FBXSDK_DLL FbxObject {
public:
    /// The identity of the base class, which every object meets.
    static const FbxClassId ClassId;
    /// Makes a plain object that belongs to the manager alone. Null when the manager is null; a null name is the empty
    /// name.
    static FbxObject* Create(FbxManager* pManager, const char* pName);
    /// Makes a plain object that is a source of the container, hence a member of its scene. Null when the container is
    /// null.
    static FbxObject* Create(FbxObject* pContainer, const char* pName);

    /// Objects are not copied.
    FbxObject(const FbxObject&) = delete;
    /// Objects are not assigned.
    FbxObject& operator=(const FbxObject&) = delete;

    /// Disconnects the object from everything and frees it; with pRecursive also its source objects, and theirs. A
    /// scene frees its members as well. A scene's root node and global settings stay: they are freed with the scene
    /// only. All pointers and properties of what was freed are invalid afterwards.
    void Destroy(bool pRecursive = false);

    /// The class the object was created as.
    [[nodiscard]] FbxClassId GetClassId() const;
    /// Whether the object is a T or of a class derived from T.
    template <class T>
    [[nodiscard]] bool Is() const {
        return GetClassId().Is(T::ClassId);
    }

    /// UTF-8, never null; without the class prefix that files have, with the prefix of a namespace. Not unique within
    /// a scene. Valid until the name changes or the object is destroyed.
    [[nodiscard]] const char* GetName() const;
    void SetName(const char* pName); ///< Copies the name; null is the empty name.

    [[nodiscard]] FbxManager* GetFbxManager() const; ///< The manager that owns the object, never null.
    /// The scene that the object is a member of; null when it is in none. A scene is a member of itself.
    [[nodiscard]] FbxScene* GetScene() const;
    /// The same scene as a document.
    [[nodiscard]] FbxDocument* GetDocument() const;

    /// The property of that name; one in a compound has a hierarchical name, "Compound|Name". Case is ignored
    /// for ASCII letters only. An invalid property for null and when there is none; of several of
    /// one name the first.
    [[nodiscard]] FbxProperty FindProperty(const char* pName, bool pCaseSensitive = true) const;
    /// The same; invalid also when the property of that name has another data type.
    [[nodiscard]] FbxProperty FindProperty(const char* pName, const FbxDataType& pDataType,
                                           bool pCaseSensitive = true) const;
    /// The first property: those of the class come first, dynamic ones follow in order of creation. Invalid when there
    /// are none.
    [[nodiscard]] FbxProperty GetFirstProperty() const;
    /// The property after the one given, members of compounds included. Invalid after the last one and for a property
    /// of another object.
    [[nodiscard]] FbxProperty GetNextProperty(const FbxProperty& pProperty) const;

    // Connections.

    /// Makes the other object a source (an input or a child) of this one, as the last one. In a scene, an object
    /// that is in none joins the scene with all of its sources.
    ///
    /// False, and nothing changes, for null, when the two are connected already, for the object itself, for an object
    /// of another manager, and where the classes do not allow it (a node below itself).
    bool ConnectSrcObject(FbxObject* pObject, FbxConnection::EType pType = FbxConnection::eNone);
    /// The reverse: makes this object a source of the other one.
    bool ConnectDstObject(FbxObject* pObject, FbxConnection::EType pType = FbxConnection::eNone);
    /// Whether the other object is a source of this one; false for null.
    [[nodiscard]] bool IsConnectedSrcObject(const FbxObject* pObject) const;
    /// Whether this object is a source of the other one; false for null.
    [[nodiscard]] bool IsConnectedDstObject(const FbxObject* pObject) const;
    /// Removes the connection from the source. Disconnected from its scene, an object is no longer a member. False when
    /// there is no such connection and for the permanent members of a scene.
    bool DisconnectSrcObject(FbxObject* pObject);
    /// Removes the connection to the destination, otherwise as DisconnectSrcObject.
    bool DisconnectDstObject(FbxObject* pObject);
    /// Makes the property a source of this object. False for an invalid property, and otherwise as ConnectSrcObject.
    bool ConnectSrcProperty(const FbxProperty& pProperty);
    /// Makes this object a source of the property. False for an invalid property, and otherwise as ConnectSrcObject.
    bool ConnectDstProperty(const FbxProperty& pProperty);

    /// How many objects are sources of this one; properties that are sources do not count.
    [[nodiscard]] int GetSrcObjectCount() const;
    /// How many of the source objects meet the criterion.
    [[nodiscard]] int GetSrcObjectCount(const FbxCriteria& pCriteria) const;
    /// The source object at that index in order of connection; null out of range.
    [[nodiscard]] FbxObject* GetSrcObject(int pIndex = 0) const;
    /// The source object at that index among those that meet the criterion; null out of range.
    [[nodiscard]] FbxObject* GetSrcObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    /// How many of the source objects are a T.
    template <class T>
    [[nodiscard]] int GetSrcObjectCount() const {
        return GetSrcObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    /// The source object at that index among those that are a T; null out of range.
    template <class T>
    [[nodiscard]] T* GetSrcObject(int pIndex = 0) const {
        return static_cast<T*>(GetSrcObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    /// How many objects this one is a source of.
    [[nodiscard]] int GetDstObjectCount() const;
    /// How many of the destination objects meet the criterion.
    [[nodiscard]] int GetDstObjectCount(const FbxCriteria& pCriteria) const;
    /// The destination object at that index in order of connection; null out of range.
    [[nodiscard]] FbxObject* GetDstObject(int pIndex = 0) const;
    /// The destination object at that index among those that meet the criterion; null out of range.
    [[nodiscard]] FbxObject* GetDstObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    /// How many of the destination objects are a T.
    template <class T>
    [[nodiscard]] int GetDstObjectCount() const {
        return GetDstObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    /// The destination object at that index among those that are a T; null out of range.
    template <class T>
    [[nodiscard]] T* GetDstObject(int pIndex = 0) const {
        return static_cast<T*>(GetDstObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    [[nodiscard]] int GetSrcPropertyCount() const;                  ///< How many properties are sources of this object.
    [[nodiscard]] FbxProperty GetSrcProperty(int pIndex = 0) const; ///< In order of connection; invalid out of range.
    [[nodiscard]] int GetDstPropertyCount() const;                  ///< How many properties this object is a source of.
    [[nodiscard]] FbxProperty GetDstProperty(int pIndex = 0) const; ///< In order of connection; invalid out of range.

    /// The parent of the object's properties, for FbxProperty::Create, GetChild and Find. It has no name, no type and
    /// no value.
    FbxProperty RootProperty;

    /// The platform's own view of the object.
    [[nodiscard]] detail::ObjectData& data() const { return *mData; }

protected:
    /// Adds the object to the manager's list; for the factories.
    FBXSDK_LOCAL FbxObject(FbxManager& pManager, const detail::ClassInfo& pInfo);
    /// Removes the object from the manager's list.
    FBXSDK_LOCAL virtual ~FbxObject();

    /// Called on both ends after a connection between objects was added or removed, before the call that did it
    /// returns. `pSource` becomes (or was) a source of `pDestination`; one of the two is this object.
    FBXSDK_LOCAL virtual void connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected);
    /// Called when the object becomes a member of a scene (or leaves it: null).
    FBXSDK_LOCAL virtual void sceneChanged(FbxScene* pScene);

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
/// The same for a const object.
template <class T>
[[nodiscard]] const T* FbxCast(const FbxObject* pObject) {
    return pObject && pObject->Is<T>() ? static_cast<const T*>(pObject) : nullptr;
}

FBXSDK_NAMESPACE_END
