// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The connections of one side of an object or property, in order.
#pragma once

#include <memory>
#include <vector>

#include <fbxsdk/FbxCriteria.h>
#include <fbxsdk/FbxProperty.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

struct ConnectionPoint;

/// Hosts count the objects of a class and ask for them one by one, among thousands of others. So that each answer costs
/// a few steps, a long list keeps those of the class apart from the first question on. Belongs to one thread at a time,
/// for questions too.
class ConnectionList {
public:
    ConnectionList();
    ~ConnectionList();
    ConnectionList(const ConnectionList&) = delete;
    ConnectionList& operator=(const ConnectionList&) = delete;

    [[nodiscard]] const std::vector<ConnectionPoint*>& all() const { return mPoints; }
    [[nodiscard]] auto begin() const { return mPoints.begin(); }
    [[nodiscard]] auto end() const { return mPoints.end(); }
    [[nodiscard]] std::size_t size() const { return mPoints.size(); }
    [[nodiscard]] bool empty() const { return mPoints.empty(); }
    [[nodiscard]] bool contains(const ConnectionPoint& point) const;

    void append(ConnectionPoint& point) { mPoints.push_back(&point); }
    /// False when it is not there.
    bool remove(const ConnectionPoint& point);

    // Objects that meet the criteria, in order; null out of range.
    [[nodiscard]] int countObjects(const FbxCriteria& criteria) const;
    [[nodiscard]] FbxObject* objectAt(const FbxCriteria& criteria, int index) const;
    // Properties, in order; invalid out of range.
    [[nodiscard]] int countProperties() const;
    [[nodiscard]] FbxProperty propertyAt(int index) const;

private:
    struct Selection;

    // No criteria: the properties.
    [[nodiscard]] Selection* selectionOf(const FbxCriteria* criteria) const;
    [[nodiscard]] int count(const FbxCriteria* criteria) const;
    [[nodiscard]] ConnectionPoint* at(const FbxCriteria* criteria, int index) const;

    std::vector<ConnectionPoint*> mPoints;
    /// What was asked for; they follow the list when they are asked again.
    mutable std::unique_ptr<std::vector<Selection>> mSelections;
};

} // namespace detail
FBXSDK_NAMESPACE_END
