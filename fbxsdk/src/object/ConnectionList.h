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

/// Hosts count the objects of a class and get them one by one, among thousands of others. So that each call takes
/// a few steps, a long list indexes those of the class from the first query on. Belongs to one thread at a time,
/// also for queries.
class ConnectionList {
public:
    ConnectionList();
    ~ConnectionList();
    ConnectionList(const ConnectionList&) = delete;
    ConnectionList& operator=(const ConnectionList&) = delete;

    [[nodiscard]] const std::vector<ConnectionPoint*>& all() const {
        if (mRemoval)
            endRemoval();
        return mPoints;
    }
    [[nodiscard]] auto begin() const { return all().begin(); }
    [[nodiscard]] auto end() const { return all().end(); }
    [[nodiscard]] std::size_t size() const;
    [[nodiscard]] bool empty() const { return size() == 0; }
    [[nodiscard]] bool contains(const ConnectionPoint& point) const;

    void append(ConnectionPoint& point);
    /// False when it is not in the list.
    bool remove(const ConnectionPoint& point);

    // Objects that meet the criteria, in order; null out of range.
    [[nodiscard]] int countObjects(const FbxCriteria& criteria) const;
    [[nodiscard]] FbxObject* objectAt(const FbxCriteria& criteria, int index) const;
    // Properties, in order; invalid out of range.
    [[nodiscard]] int countProperties() const;
    [[nodiscard]] FbxProperty propertyAt(int index) const;

private:
    struct Selection;
    struct Removal;

    // Null criteria: the properties.
    [[nodiscard]] Selection* selectionOf(const FbxCriteria* criteria) const;
    [[nodiscard]] int count(const FbxCriteria* criteria) const;
    [[nodiscard]] ConnectionPoint* at(const FbxCriteria* criteria, int index) const;

    /// Returned for a connection that is not in the list.
    [[nodiscard]] std::size_t placeOf(const ConnectionPoint& point);
    bool beginRemoval();
    void endRemoval() const;

    /// Has gaps during a removal.
    mutable std::vector<ConnectionPoint*> mPoints;
    /// Active while several are removed from a long list without an access in between.
    mutable std::unique_ptr<Removal> mRemoval;
    /// The queried selections; they are updated when they are queried again.
    mutable std::unique_ptr<std::vector<Selection>> mSelections;
};

} // namespace detail
FBXSDK_NAMESPACE_END
