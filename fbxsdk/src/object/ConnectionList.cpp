// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A selection reads the list once, and later additions when it is used again; a removal from the middle
// discards all selections. The gaps that removals leave in a long list are closed on the next access.
#include "object/ConnectionList.h"

#include <algorithm>
#include <new>
#include <unordered_map>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// A list of up to this many connections is searched; longer ones keep selections.
constexpr std::size_t kSearched = 16;
/// A connection this close to either end of a list is searched before all positions are indexed.
constexpr std::size_t kNear = 32;

/// Properties for null criteria.
bool isSelected(const ConnectionPoint& point, const FbxCriteria* criteria) {
    if (!criteria)
        return point.property >= 0;
    return point.property < 0 && criteria->isMetBy(point.object->GetClassId());
}

} // namespace

struct ConnectionList::Selection {
    bool ofProperties;
    FbxCriteria criteria;
    std::size_t seen = 0; ///< the number of the list's connections that are covered
    std::vector<ConnectionPoint*> found;

    [[nodiscard]] const FbxCriteria* condition() const { return ofProperties ? nullptr : &criteria; }
    [[nodiscard]] bool answers(const FbxCriteria* asked) const {
        return asked ? !ofProperties && criteria.isSame(*asked) : ofProperties;
    }
};

struct ConnectionList::Removal {
    using Places = std::unordered_map<const ConnectionPoint*, std::size_t>;
    Places places; ///< of the existing ones
};

ConnectionList::ConnectionList() = default;
ConnectionList::~ConnectionList() = default;

std::size_t ConnectionList::size() const { return mRemoval ? mRemoval->places.size() : mPoints.size(); }

void ConnectionList::append(ConnectionPoint& point) {
    constexpr std::size_t kUsual = 4;
    if (mPoints.capacity() == 0)
        mPoints.reserve(kUsual);
    mPoints.push_back(&point);
    if (!mRemoval)
        return;
    try {
        mRemoval->places.emplace(&point, mPoints.size() - 1);
    } catch (const std::bad_alloc&) {
        endRemoval();
    }
}

bool ConnectionList::contains(const ConnectionPoint& point) const {
    if (mRemoval)
        return mRemoval->places.contains(&point);
    return std::find(mPoints.begin(), mPoints.end(), &point) != mPoints.end();
}

bool ConnectionList::remove(const ConnectionPoint& point) {
    const std::size_t index = placeOf(point);
    if (index == mPoints.size())
        return false;
    const auto isSeen = [index](const Selection& selection) { return index < selection.seen; };
    if (mSelections && std::any_of(mSelections->begin(), mSelections->end(), isSeen))
        mSelections.reset();
    if (mRemoval) {
        mPoints[index] = nullptr;
        mRemoval->places.erase(&point);
    } else {
        mPoints.erase(mPoints.begin() + static_cast<std::ptrdiff_t>(index));
    }
    return true;
}

std::size_t ConnectionList::placeOf(const ConnectionPoint& point) {
    const std::size_t count = mPoints.size();
    for (std::size_t near = 0; !mRemoval && near < std::min(kNear, count); ++near) {
        for (const std::size_t index : {count - 1 - near, near})
            if (mPoints[index] == &point)
                return index;
    }
    if (!mRemoval && count > kNear && !beginRemoval())
        return static_cast<std::size_t>(std::find(mPoints.begin(), mPoints.end(), &point) - mPoints.begin());
    if (!mRemoval)
        return count;
    const auto found = mRemoval->places.find(&point);
    return found == mRemoval->places.end() ? count : found->second;
}

/// False when memory runs out: the list then works without the index.
bool ConnectionList::beginRemoval() {
    try {
        mRemoval = std::make_unique<Removal>();
        for (std::size_t i = 0; i < mPoints.size(); ++i)
            mRemoval->places.emplace(mPoints[i], i);
        return true;
    } catch (const std::bad_alloc&) {
        mRemoval.reset();
        return false;
    }
}

void ConnectionList::endRemoval() const {
    std::erase(mPoints, nullptr);
    mRemoval.reset();
    mSelections.reset(); // their positions included the gaps
}

ConnectionList::Selection* ConnectionList::selectionOf(const FbxCriteria* criteria) const {
    if (all().size() <= kSearched || (criteria && criteria->isCombined()))
        return nullptr;
    if (!mSelections)
        mSelections = std::make_unique<std::vector<Selection>>();
    auto selection = std::find_if(mSelections->begin(), mSelections->end(),
                                  [&](const Selection& each) { return each.answers(criteria); });
    if (selection == mSelections->end()) {
        mSelections->push_back({criteria == nullptr, criteria ? *criteria : FbxCriteria(), 0, {}});
        selection = std::prev(mSelections->end());
    }
    for (; selection->seen < mPoints.size(); ++selection->seen) {
        ConnectionPoint* point = mPoints[selection->seen];
        if (isSelected(*point, criteria))
            selection->found.push_back(point);
    }
    return &*selection;
}

int ConnectionList::count(const FbxCriteria* criteria) const {
    if (mPoints.empty())
        return 0;
    if (const Selection* selection = selectionOf(criteria))
        return static_cast<int>(selection->found.size());
    return static_cast<int>(std::count_if(mPoints.begin(), mPoints.end(),
                                          [&](const ConnectionPoint* point) { return isSelected(*point, criteria); }));
}

ConnectionPoint* ConnectionList::at(const FbxCriteria* criteria, int index) const {
    if (index < 0)
        return nullptr;
    if (const Selection* selection = selectionOf(criteria)) {
        const auto place = static_cast<std::size_t>(index);
        return place < selection->found.size() ? selection->found[place] : nullptr;
    }
    for (ConnectionPoint* point : mPoints)
        if (isSelected(*point, criteria) && index-- == 0)
            return point;
    return nullptr;
}

int ConnectionList::countObjects(const FbxCriteria& criteria) const { return count(&criteria); }

FbxObject* ConnectionList::objectAt(const FbxCriteria& criteria, int index) const {
    const ConnectionPoint* point = at(&criteria, index);
    return point ? point->object : nullptr;
}

int ConnectionList::countProperties() const { return count(nullptr); }

FbxProperty ConnectionList::propertyAt(int index) const {
    const ConnectionPoint* point = at(nullptr, index);
    return point ? FbxProperty(point->object, point->property) : FbxProperty();
}

} // namespace detail
FBXSDK_NAMESPACE_END
