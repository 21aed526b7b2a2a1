// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What stands behind objects: property slots, connections, and how membership in a scene spreads.
#include "object/ObjectData.h"

#include <algorithm>
#include <new>

#include "object/ManagerData.h"
#include "object/RowIndex.h"
#include "schema/PropertyFlags.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool equalNames(std::string_view a, std::string_view b, bool caseSensitive) {
    if (caseSensitive)
        return a == b;
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c; };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [&](char x, char y) { return lower(x) == lower(y); });
}

int anyCaseRow(std::span<const PropertyRow> rows, std::string_view name) {
    for (std::size_t i = 0; i < rows.size(); ++i) {
        if (equalNames(rows[i].name, name, /*caseSensitive*/ false))
            return static_cast<int>(i);
    }
    return -1;
}

void noteChange(const FbxObject& object) { ++object.GetFbxManager()->data().revision; }

static_assert(kCameraStereoRows.size() <= RowIndex::kMostRows, "no class has more");

/// So many dynamic properties are searched one by one; more get an index.
constexpr std::size_t kUnindexedProperties = 32;

bool betweenObjects(const ConnectionPoint& source, const ConnectionPoint& destination) {
    return source.property < 0 && destination.property < 0;
}

} // namespace

int ClassInfo::findRow(std::string_view rowName) const {
    const RowIndex* known = index.load(std::memory_order_acquire);
    if (!known) {
        // Several threads may be here at once: one of their tables stays.
        std::unique_ptr<const RowIndex> made(new (std::nothrow) RowIndex(rows));
        if (!made)
            return rowIndex(rows, rowName);
        known = index.compare_exchange_strong(known, made.get()) ? made.release() : known;
    }
    return known->find(rowName);
}

int ObjectData::findProperty(std::string_view propertyName, bool caseSensitive) const {
    if (const int row = caseSensitive ? info->findRow(propertyName) : anyCaseRow(info->rows, propertyName); row >= 0)
        return row;
    if (dynamicIndex && caseSensitive) {
        const auto found = dynamicIndex->find(propertyName);
        return found == dynamicIndex->end() ? -1 : found->second;
    }
    for (const PropertyData* property : dynamicProperties) {
        if (equalNames(property->name, propertyName, caseSensitive))
            return property->index;
    }
    return -1;
}

PropertyData* ObjectData::property(int index) const {
    const auto place = std::lower_bound(properties.begin(), properties.end(), index,
                                        [](const auto& each, int wanted) { return each->index < wanted; });
    return place != properties.end() && (*place)->index == index ? place->get() : nullptr;
}

PropertyData& ObjectData::materialise(int index) {
    const auto place = std::lower_bound(properties.begin(), properties.end(), index,
                                        [](const auto& each, int wanted) { return each->index < wanted; });
    if (place != properties.end() && (*place)->index == index)
        return **place;
    auto made = std::make_unique<PropertyData>();
    const PropertyRow& row = info->rows[static_cast<std::size_t>(index)];
    made->index = index;
    made->row = &row;
    made->type = *row.type;
    made->flags = defaultFlags(row);
    made->value = defaultValue(row);
    made->plug.object = plug.object;
    made->plug.property = index;
    return **properties.insert(place, std::move(made));
}

PropertyData& ObjectData::appendProperty(const FbxDataType& type, std::string propertyName) {
    auto made = std::make_unique<PropertyData>();
    made->index = propertyCount();
    made->type = type;
    made->name = std::move(propertyName);
    made->plug.object = plug.object;
    made->plug.property = made->index;
    dynamicProperties.push_back(made.get());
    properties.push_back(std::move(made));
    indexDynamicProperties();
    return *properties.back();
}

void ObjectData::indexDynamicProperties() {
    if (dynamicProperties.size() <= kUnindexedProperties)
        return;
    if (dynamicIndex) {
        dynamicIndex->emplace(dynamicProperties.back()->name, dynamicProperties.back()->index);
        return;
    }
    dynamicIndex = std::make_unique<std::unordered_map<std::string_view, int>>();
    for (const PropertyData* property : dynamicProperties)
        dynamicIndex->emplace(property->name, property->index);
}

int ObjectData::propertyCount() const { return static_cast<int>(info->rows.size() + dynamicProperties.size()); }

PropertyValue defaultValue(const PropertyRow& row) {
    PropertyValue value;
    value.numbers = row.numbers;
    value.integer = static_cast<std::int64_t>(row.numbers[0]);
    value.text = row.text;
    return value;
}

unsigned defaultFlags(const PropertyRow& row) { return FbxPropertyFlags::eStatic | propertyFlags(row.flags); }

bool isConnected(const ConnectionPoint& source, const ConnectionPoint& destination) {
    // Either list tells; the shorter one is quicker, and the list of a scene's members is long.
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
    std::vector<FbxObject*> pending{&object};
    while (!pending.empty()) {
        FbxObject* each = pending.back();
        pending.pop_back();
        // A scene is a member of itself alone.
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
        // What feeds a member is a member. Pushed in reverse, so that the first source enters first.
        const auto pushSources = [&](const ConnectionPoint& point) {
            const auto& sources = point.sources.all();
            for (auto source = sources.rbegin(); source != sources.rend(); ++source)
                pending.push_back((*source)->object);
        };
        for (const auto& property : each->data().properties)
            pushSources(property->plug);
        pushSources(each->data().plug);
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
    // Managers share nothing: one may be gone before the other.
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
        // In reverse order of connection, over copies: cutting changes the lists.
        const auto sources = point.sources.all();
        for (auto each = sources.rbegin(); each != sources.rend(); ++each) {
            if (!(*each)->object->data().doomed)
                disconnect(**each, point);
        }
        const auto destinations = point.destinations.all();
        for (auto each = destinations.rbegin(); each != destinations.rend(); ++each) {
            if (!(*each)->object->data().doomed)
                disconnect(point, **each);
        }
    };
    for (const auto& property : properties)
        cut(property->plug);
    cut(plug);
}

} // namespace detail
FBXSDK_NAMESPACE_END
