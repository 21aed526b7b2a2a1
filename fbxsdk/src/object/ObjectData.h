// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <algorithm>
#include <array>
#include <atomic>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include <fbxsdk/FbxObject.h>

#include "object/ConnectionList.h"
#include "schema/NameIndex.h"
#include "schema/PropertyRow.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// One class of objects. The rows are the whole list of the class, inherited ones included, in file order.
struct ClassInfo {
    const char* name; ///< "FbxNode"
    const ClassInfo* parent;
    std::span<const PropertyRow> rows;
    /// Creates an object of the class; null for abstract classes.
    FbxObject* (*construct)(FbxManager& manager, const ClassInfo& info) = nullptr;
    /// Created on the first look-up.
    mutable std::atomic<const NameIndex*> index = nullptr;

    /// The index of the row of that name; -1 when there is none.
    [[nodiscard]] int findRow(const NameKey& rowName) const;
};

/// One end of connections: an object, or one of its properties.
struct ConnectionPoint {
    FbxObject* object = nullptr;
    int property = -1; ///< index of the property; -1 for the object itself
    ConnectionList sources;
    ConnectionList destinations;
};

struct PropertyValue {
    std::array<double, 4> numbers{};
    std::int64_t integer = 0; ///< of whole-number types and times, exactly
    std::string text;
};

/// A property that differs from its row, is connected, or is dynamic.
struct PropertyData {
    int index = -1;
    FbxDataType type;
    unsigned flags = 0; ///< FbxPropertyFlags
    PropertyValue value;
    ConnectionPoint plug;
    std::string name, label;          ///< of dynamic properties
    const PropertyRow* row = nullptr; ///< null for dynamic ones
};

/// A file's properties of objects, for reading them later.
class PropertySource {
public:
    /// Sets the properties of the object, which has that index in the source.
    virtual void read(FbxObject& object, std::size_t place) const = 0;

protected:
    ~PropertySource() = default;
};

/// Interface of a scene to its members.
class Membership {
public:
    explicit Membership(FbxObject& owner) : scene(owner) {}
    Membership(const Membership&) = delete;
    Membership& operator=(const Membership&) = delete;

    /// Updates the scene's lists when an object becomes a member or stops being one.
    virtual void enter(FbxObject& member) = 0;
    virtual void leave(FbxObject& member) = 0;
    /// Whether the object is a permanent member: it exists as long as the scene.
    [[nodiscard]] virtual bool isFixed(const FbxObject& member) const = 0;

    FbxObject& scene;

protected:
    ~Membership() = default;
};

/// The data of an object: its class, its name, its properties and its connections.
///
/// A property of a class takes no memory until it is changed or connected: the class's row gives its type and
/// default, and a PropertyData is created on the first write. The properties of an object from a file are read on the
/// first access to any of them. Properties are addressed by index: the rows of the class first, in their order, then
/// the dynamic ones in order of creation.
struct ObjectData {
    ObjectData() = default;
    ObjectData(const ObjectData&) = delete;
    ObjectData& operator=(const ObjectData&) = delete;
    ~ObjectData();

    const ClassInfo* info = nullptr;
    FbxManager* manager = nullptr;
    FbxScene* scene = nullptr;        ///< null outside of scenes; a scene is a member of itself
    Membership* membership = nullptr; ///< of the same scene
    std::string name;
    ConnectionPoint plug;
    std::size_t managerSlot = 0; ///< position in the manager's list
    std::int64_t fileId = 0;     ///< id in the file it was read from; 0 if none
    bool doomed = false;         ///< about to be freed together with others

    /// The source sets the properties, once, on the first access. If that fails they stay unread.
    void readPropertiesLater(std::shared_ptr<const PropertySource> source, std::size_t place);

    /// Index by name over the rows of the class and the dynamic properties; -1 when there is none.
    [[nodiscard]] int findProperty(const NameKey& propertyName) const;
    [[nodiscard]] int findPropertyInAnyCase(std::string_view propertyName) const;
    /// The data of an index; null while the property equals its row.
    [[nodiscard]] PropertyData* property(int index) const;
    /// The same, created from the row on the first write.
    PropertyData& materialise(int index);
    /// Those that have data, sorted by index.
    [[nodiscard]] const std::vector<PropertyData*>& properties() const {
        readUnread();
        return mProperties;
    }
    [[nodiscard]] int propertyCount() const;
    /// A new dynamic property, after all others.
    PropertyData& appendProperty(const FbxDataType& type, std::string propertyName);

    /// Connects two ends, propagates membership and notifies both objects. False when they are connected already, when
    /// an object would be its own source, when the ends belong to two managers, and when an object refuses.
    static bool connect(ConnectionPoint& source, ConnectionPoint& destination);
    static bool disconnect(ConnectionPoint& source, ConnectionPoint& destination);
    /// The connection only, without notification.
    static void link(ConnectionPoint& source, ConnectionPoint& destination);
    /// Notifies both objects of a connection between them that was added or removed.
    static void announce(FbxObject& source, FbxObject& destination, bool connected);
    void announceScene(FbxScene* joined);
    /// Calls with each end that may have connections: those of the properties, then the object's own.
    template <class Use>
    void eachPlug(const Use& use) {
        // What is unread is not connected.
        for (PropertyData* each : mProperties)
            use(each->plug);
        use(plug);
    }
    /// Cuts the connections to objects that are not doomed.
    void disconnectFromSurvivors();

private:
    void readUnread() const {
        if (mUnread)
            const_cast<ObjectData*>(this)->readFromSource();
    }
    void readFromSource();
    void dropProperties() noexcept;
    void indexDynamicProperties();
    using PropertyPlace = std::vector<PropertyData*>::const_iterator;
    [[nodiscard]] PropertyPlace placeOf(int index) const;
    PropertyData& insertProperty(PropertyPlace place, int index, const FbxDataType& type);

    std::shared_ptr<const PropertySource> mUnread;
    std::size_t mUnreadPlace = 0;
    std::vector<PropertyData*> mProperties;        ///< sorted by index; owned, their memory is the manager's
    std::vector<PropertyData*> mDynamicProperties; ///< in order of creation
    /// Index by name, once there are many dynamic properties; of several of one name the first.
    std::unique_ptr<std::unordered_map<std::string_view, int>> mDynamicIndex;
};

/// Represents the root property: the parent of all properties of an object.
inline constexpr int kRootProperty = -1;

[[nodiscard]] PropertyValue defaultValue(const PropertyRow& row);
[[nodiscard]] unsigned defaultFlags(const PropertyRow& row);
[[nodiscard]] bool isConnected(const ConnectionPoint& source, const ConnectionPoint& destination);
[[nodiscard]] bool isScene(const FbxObject& object);
/// Makes the object, and all of its sources, a member of the member's scene; those in a scene already stay there.
void joinSceneOf(const FbxObject& member, FbxObject& object);
/// Ends the object's membership. Its sources stay: they are sources of the scene in their own right.
void leaveScene(FbxObject& object);

/// A typed member of a class, bound to the row of that name.
template <class T>
FbxPropertyT<T> bindProperty(FbxObject& object, const NameKey& name) {
    return FbxPropertyT<T>(FbxProperty(&object, object.data().info->findRow(name)));
}

/// A name as an argument of a template.
template <std::size_t size>
struct NameLiteral {
    consteval NameLiteral(const char (&name)[size]) { std::copy(name, name + size, text); }
    char text[size];
};

/// The same for classes of which a file or the library makes many: the row is searched once. Classes below it must
/// start with the same rows.
template <class T, const auto& rows, NameLiteral name>
FbxPropertyT<T> bindRow(FbxObject& object) {
    static const int row = rowIndex(rows, name.text);
    return FbxPropertyT<T>(FbxProperty(&object, row));
}

} // namespace detail

/// What every concrete class defines once, in its source: identity, rows and factories.
#define FBXSDK_OBJECT_IMPLEMENT(Class, Parent, Rows)                                                                   \
    namespace detail {                                                                                                 \
    extern const ClassInfo k##Class##Info;                                                                             \
    extern const ClassInfo k##Parent##Info;                                                                            \
    constinit const ClassInfo k##Class##Info{#Class, &k##Parent##Info, Rows, &ManagerData::construct<Class>};          \
    }                                                                                                                  \
    constinit const FbxClassId Class::ClassId{&detail::k##Class##Info};                                                \
    Class* Class::Create(FbxManager* pManager, const char* pName) {                                                    \
        return detail::ManagerData::create<Class>(pManager, pName);                                                    \
    }                                                                                                                  \
    Class* Class::Create(FbxObject* pContainer, const char* pName) {                                                   \
        return detail::ManagerData::create<Class>(pContainer, pName);                                                  \
    }

#define FBXSDK_ABSTRACT_IMPLEMENT(Class, Parent)                                                                       \
    namespace detail {                                                                                                 \
    extern const ClassInfo k##Class##Info;                                                                             \
    extern const ClassInfo k##Parent##Info;                                                                            \
    constinit const ClassInfo k##Class##Info{#Class, &k##Parent##Info, {}, nullptr};                                   \
    }                                                                                                                  \
    constinit const FbxClassId Class::ClassId{&detail::k##Class##Info};

FBXSDK_NAMESPACE_END
