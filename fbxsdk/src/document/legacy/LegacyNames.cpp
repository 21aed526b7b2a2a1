// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Two passes: unique names stay unchanged, whatever numbered names the others need.
#include "document/legacy/LegacyNames.h"

#include <bit>
#include <cassert>
#include <cstdint>
#include <functional>
#include <unordered_map>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The root is never declared, but no object may take its name.
constexpr std::string_view kRootClass = "Model", kRootName = "Scene";

struct HashOfName {
    std::size_t operator()(const LegacyName& name) const {
        constexpr std::size_t kFactor = 31;
        return std::hash<std::string_view>()(name.name) + kFactor * name.nameClass.size();
    }
};

/// A set of names: as many as a scene has objects, so that an allocation for each would be noticed. Open addressing.
class TakenNames {
public:
    /// For that many names.
    explicit TakenNames(std::size_t count) : mSlots(std::bit_ceil(2 * count + 1)) { mNames.reserve(count); }

    /// False when it is taken.
    bool insert(const LegacyName& name) {
        assert(2 * mNames.size() < mSlots.size());
        const auto hash = static_cast<std::uint32_t>(HashOfName()(name));
        std::size_t place = hash & (mSlots.size() - 1);
        for (; mSlots[place].name != 0; place = next(place))
            if (mSlots[place].hash == hash && mNames[mSlots[place].name - 1] == name)
                return false;
        mNames.push_back(name);
        mSlots[place] = {hash, static_cast<std::uint32_t>(mNames.size())};
        return true;
    }

private:
    struct Slot {
        std::uint32_t hash = 0;
        std::uint32_t name = 0; ///< its index and one; 0 in an empty slot
    };

    [[nodiscard]] std::size_t next(std::size_t place) const { return (place + 1) & (mSlots.size() - 1); }

    std::vector<LegacyName> mNames;
    std::vector<Slot> mSlots; ///< a power of two, more than twice as many
};

} // namespace

LegacyNames::LegacyNames(const std::vector<DocumentObject>& objects) {
    mNames.at(0) = {kRootClass, kRootName};
    TakenNames taken(objects.size() + 1);
    taken.insert(mNames[0]);
    std::vector<const DocumentObject*> clashing;
    for (const DocumentObject& object : objects) {
        const LegacyName name{object.content->nameClass, object.name};
        if (taken.insert(name))
            mNames.at(object.id) = name;
        else
            clashing.push_back(&object);
    }
    std::unordered_map<LegacyName, int, HashOfName> numbers; // the last one that was used after a name
    for (const DocumentObject* object : clashing) {
        int& number = numbers[{object->content->nameClass, object->name}];
        const std::string base = std::string(object->name) + "_ncl1_";
        LegacyName& name = mNames.at(object->id);
        std::string& text = mNumbered.emplace_back();
        do {
            text = base + std::to_string(++number);
            name = {object->content->nameClass, text};
        } while (!taken.insert(name));
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
