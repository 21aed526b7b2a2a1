// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of objects: property slots, connections, and how membership in a scene propagates.
#include "object/ObjectData.h"

#include <algorithm>
#include <new>
#include <utility>

#include "object/ManagerData.h"
#include "schema/PropertyFlags.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool equalInAnyCase(std::string_view a, std::string_view b) {
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c; };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [&](char x, char y) { return lower(x) == lower(y); });
}

void noteChange(const FbxObject& object) { ++object.GetFbxManager()->data().revision; }

static_assert(kCameraStereoRows.size() <= NameIndex::kMostRows, "no class has more");

/// Up to this many dynamic properties are searched one by one; more get an index.
constexpr std::size_t kUnindexedProperties = 32;

/// Reserves memory for one more element, so that appending it cannot fail.
void makeRoom(std::vector<PropertyData*>& list) {
    constexpr std::size_t kFirst = 8;
    if (list.size() == list.capacity())
        list.reserve(std::max(kFirst, 2 * list.size()));
}

bool betweenObjects(const ConnectionPoint& source, const ConnectionPoint& destination) {
    return source.property < 0 && destination.property < 0;
}

} // namespace

int ClassInfo::findRow(const NameKey& rowName) const {
    const NameIndex* known = index.load(std::memory_order_acquire);
    if (!known) {
        // Several threads may be here at once: one of their tables stays.
        std::unique_ptr<const NameIndex> made;
        try {
            made = std::make_unique<NameIndex>(
                rows, [](const PropertyRow& row) { return row.name; });
        } catch (const std::bad_alloc&) {
            return rowIndex(rows, rowName.text);
        }
        known = index.compare_exchange_strong(known, made.get()) ? made.release() : known;
    }
    return known->find(rowName);
}

ObjectData::~ObjectData() { dropProperties(); }

void ObjectData::readPropertiesLater(std::shared_ptr<const PropertySource> source, std::size_t place) {
    mUnread = std::move(source);
    mUnreadPlace = place;
}

void ObjectData::readFromSource() {
    std::uint64_t& revision = manager->data().revision;
    const std::uint64_t before = revision;
    const std::shared_ptr<const PropertySource> source = std::move(mUnread); // it accesses properties itself
    try {
        source->read(*plug.object, mUnreadPlace);
    } catch (...) {
        dropProperties();
        mUnread = source;
        revision = before;
        throw;
    }
    revision = before; // no value has changed
}

void ObjectData::dropProperties() noexcept {
    for (PropertyData* each : mProperties)
        manager->data().properties.free(each);
    mProperties.clear();
    mDynamicProperties.clear();
    mDynamicIndex.reset();
}

int ObjectData::findProperty(const NameKey& propertyName) const {
    if (const int row = info->findRow(propertyName); row >= 0)
        return row;
    readUnread();
    if (mDynamicIndex) {
        const auto found = mDynamicIndex->find(propertyName.text);
        return found == mDynamicIndex->end() ? -1 : found->second;
    }
    for (const PropertyData* property : mDynamicProperties)
        if (property->name == propertyName.text)
            return property->index;
    return -1;
}

int ObjectData::findPropertyInAnyCase(std::string_view propertyName) const {
    for (std::size_t i = 0; i < info->rows.size(); ++i)
        if (equalInAnyCase(info->rows[i].name, propertyName))
            return static_cast<int>(i);
    readUnread();
    for (const PropertyData* property : mDynamicProperties)
        if (equalInAnyCase(property->name, propertyName))
            return property->index;
    return -1;
}

ObjectData::PropertyPlace ObjectData::placeOf(int index) const {
    readUnread();
    // Files list properties in the order of their rows: most are appended.
    if (mProperties.empty() || mProperties.back()->index < index)
        return mProperties.end();
    return std::lower_bound(mProperties.begin(), mProperties.end(), index,
                            [](const PropertyData* each, int wanted) { return each->index < wanted; });
}

PropertyData* ObjectData::property(int index) const {
    const auto place = placeOf(index);
    return place != mProperties.end() && (*place)->index == index ? *place : nullptr;
}

PropertyData& ObjectData::materialise(int index) {
    const auto place = placeOf(index);
    if (place != mProperties.end() && (*place)->index == index)
        return **place;
    const PropertyRow& row = info->rows[static_cast<std::size_t>(index)];
    PropertyValue value = defaultValue(row); // before the insertion: a text may take memory
    PropertyData& made = insertProperty(place, index, *row.type);
    made.row = &row;
    made.flags = defaultFlags(row);
    made.value = std::move(value);
    return made;
}

PropertyData& ObjectData::insertProperty(PropertyPlace place, int index, const FbxDataType& type) {
    const auto position = place - mProperties.begin();
    makeRoom(mProperties);
    PropertyData* const made = manager->data().properties.make();
    made->index = index;
    made->type = type;
    made->plug.object = plug.object;
    made->plug.property = index;
    mProperties.insert(mProperties.begin() + position, made);
    return *made;
}

PropertyData& ObjectData::appendProperty(const FbxDataType& type, std::string propertyName) {
    readUnread();
    makeRoom(mDynamicProperties);
    PropertyData& made = insertProperty(mProperties.end(), propertyCount(), type);
    made.name = std::move(propertyName);
    mDynamicProperties.push_back(&made);
    indexDynamicProperties();
    return made;
}

void ObjectData::indexDynamicProperties() {
    if (mDynamicProperties.size() <= kUnindexedProperties)
        return;
    if (mDynamicIndex) {
        mDynamicIndex->emplace(mDynamicProperties.back()->name, mDynamicProperties.back()->index);
        return;
    }
    mDynamicIndex = std::make_unique<std::unordered_map<std::string_view, int>>();
    for (const PropertyData* property : mDynamicProperties)
        mDynamicIndex->emplace(property->name, property->index);
}

int ObjectData::propertyCount() const {
    readUnread();
    return static_cast<int>(info->rows.size() + mDynamicProperties.size());
}

PropertyValue defaultValue(const PropertyRow& row) {
    PropertyValue value;
    value.numbers = row.numbers;
    value.integer = static_cast<std::int64_t>(row.numbers[0]);
    if (*row.text != '\0')
        value.text = row.text;
    return value;
}

unsigned defaultFlags(const PropertyRow& row) { return FbxPropertyFlags::eStatic | propertyFlags(row.flags); }

bool isConnected(const ConnectionPoint& source, const ConnectionPoint& destination) {
    // Either list has it; the shorter one is faster, and the list of a scene's members is long.
    const bool byEnds = source.destinations.size() <= destination.sources.size();
    return byEnds ? source.destinations.contains(destination) : destination.sources.contains(source);
}

bool isScene(const FbxObject& object) {
    const Membership* membership = object.data().membership;
    return membership && &membership->scene == &object;
}

void joinSceneOf(const FbxObject& member, FbxObject& object) {
    FbxScene* const scene = member.data().scene;
    Membership& membership = *member.data().membership;
    ConnectionPoint& scenePlug = membership.scene.data().plug;
    std::vector<FbxObject*> pending;
    const auto next = [&]() -> FbxObject* {
        if (pending.empty())
            return nullptr;
        FbxObject* const last = pending.back();
        pending.pop_back();
        return last;
    };
    for (FbxObject* each = &object; each; each = next()) {
        // A scene is a member of itself only.
        if (each->GetScene())
            continue;
        each->data().scene = scene;
        each->data().membership = &membership;
        membership.enter(*each);
        if (!isConnected(each->data().plug, scenePlug)) {
            ObjectData::link(each->data().plug, scenePlug);
            ObjectData::announce(*each, membership.scene, true);
        }
        each->data().announceScene(scene);
        // The sources of a member are members. Pushed in reverse, so that the first source enters first.
        const auto pushSources = [&](const ConnectionPoint& point) {
            const auto& sources = point.sources.all();
            for (auto source = sources.rbegin(); source != sources.rend(); ++source)
                pending.push_back((*source)->object);
        };
        each->data().eachPlug(pushSources);
    }
}

void leaveScene(FbxObject& object) {
    object.data().membership->leave(object);
    object.data().scene = nullptr;
    object.data().membership = nullptr;
    object.data().announceScene(nullptr);
}

void ObjectData::announceScene(FbxScene* joined) { plug.object->sceneChanged(joined); }

void ObjectData::announce(FbxObject& source, FbxObject& destination, bool connected) {
    source.connectionChanged(source, destination, connected);
    destination.connectionChanged(source, destination, connected);
}

void ObjectData::link(ConnectionPoint& source, ConnectionPoint& destination) {
    source.destinations.append(destination);
    destination.sources.append(source);
}

bool ObjectData::connect(ConnectionPoint& source, ConnectionPoint& destination) {
    FbxObject& from = *source.object;
    FbxObject& to = *destination.object;
    if (&source == &destination || isConnected(source, destination))
        return false;
    // Managers share nothing: one may be destroyed before the other.
    if (from.GetFbxManager() != to.GetFbxManager())
        return false;
    link(source, destination);
    noteChange(to);
    if (to.GetScene())
        joinSceneOf(to, from);
    if (!betweenObjects(source, destination))
        return true;
    announce(from, to, true);
    return isConnected(source, destination);
}

bool ObjectData::disconnect(ConnectionPoint& source, ConnectionPoint& destination) {
    if (!isConnected(source, destination))
        return false;
    FbxObject& from = *source.object;
    FbxObject& to = *destination.object;
    const bool leaves = isScene(to) && from.GetScene() == to.GetScene() && betweenObjects(source, destination);
    if (leaves && from.data().membership->isFixed(from))
        return false;
    source.destinations.remove(destination);
    destination.sources.remove(source);
    noteChange(to);
    if (!betweenObjects(source, destination))
        return true;
    announce(from, to, false);
    if (leaves)
        leaveScene(from);
    return true;
}

void ObjectData::disconnectFromSurvivors() {
    const auto cut = [](ConnectionPoint& point) {
        // In reverse order of connection, over copies: disconnecting changes the lists.
        const auto sources = point.sources.all();
        for (auto each = sources.rbegin(); each != sources.rend(); ++each)
            if (!(*each)->object->data().doomed)
                disconnect(**each, point);
        const auto destinations = point.destinations.all();
        for (auto each = destinations.rbegin(); each != destinations.rend(); ++each)
            if (!(*each)->object->data().doomed)
                disconnect(point, **each);
    };
    eachPlug(cut);
}

} // namespace detail
FBXSDK_NAMESPACE_END
