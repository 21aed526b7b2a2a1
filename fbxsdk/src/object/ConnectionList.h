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
    struct Removal;

    // No criteria: the properties.
    [[nodiscard]] Selection* selectionOf(const FbxCriteria* criteria) const;
    [[nodiscard]] int count(const FbxCriteria* criteria) const;
    [[nodiscard]] ConnectionPoint* at(const FbxCriteria* criteria, int index) const;

    /// Their number for what is not there.
    [[nodiscard]] std::size_t placeOf(const ConnectionPoint& point);
    bool beginRemoval();
    void endRemoval() const;

    /// With gaps during a removal.
    mutable std::vector<ConnectionPoint*> mPoints;
    /// While one after the other is taken out of a long list, and nobody looks.
    mutable std::unique_ptr<Removal> mRemoval;
    /// What was asked for; they follow the list when they are asked again.
    mutable std::unique_ptr<std::vector<Selection>> mSelections;
};

} // namespace detail
FBXSDK_NAMESPACE_END
