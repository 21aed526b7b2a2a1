// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A selection reads the list once, and what is appended later when it is asked again; what is taken out of the middle
// ends all selections.
#include "scene/ConnectionList.h"

#include <algorithm>

#include "scene/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// A list of so many connections is searched; longer ones keep selections.
constexpr std::size_t kSearched = 16;

/// Properties for no criteria.
bool isSelected(const ConnectionPoint& point, const FbxCriteria* criteria) {
    if (!criteria)
        return point.property >= 0;
    return point.property < 0 && criteria->isMetBy(point.object->GetClassId());
}

} // namespace

struct ConnectionList::Selection {
    bool ofProperties;
    FbxCriteria criteria;
    std::size_t seen = 0; ///< so many of the list's connections
    std::vector<ConnectionPoint*> found;

    [[nodiscard]] const FbxCriteria* condition() const { return ofProperties ? nullptr : &criteria; }
    [[nodiscard]] bool answers(const FbxCriteria* asked) const {
        return asked ? !ofProperties && criteria.isSame(*asked) : ofProperties;
    }
};

ConnectionList::ConnectionList() = default;
ConnectionList::~ConnectionList() = default;

bool ConnectionList::contains(const ConnectionPoint& point) const {
    return std::find(mPoints.begin(), mPoints.end(), &point) != mPoints.end();
}

bool ConnectionList::remove(const ConnectionPoint& point) {
    // What was connected last is mostly cut first: search from the back.
    const auto found = std::find(mPoints.rbegin(), mPoints.rend(), &point);
    if (found == mPoints.rend())
        return false;
    const auto place = std::next(found).base();
    const auto index = static_cast<std::size_t>(place - mPoints.begin());
    if (mSelections && std::any_of(mSelections->begin(), mSelections->end(),
                                   [&](const Selection& selection) { return index < selection.seen; }))
        mSelections.reset();
    mPoints.erase(place);
    return true;
}

ConnectionList::Selection* ConnectionList::selectionOf(const FbxCriteria* criteria) const {
    if (mPoints.size() <= kSearched || (criteria && criteria->isCombined()))
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
    for (ConnectionPoint* point : mPoints) {
        if (isSelected(*point, criteria) && index-- == 0)
            return point;
    }
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
