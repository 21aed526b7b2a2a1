// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "schema/NameIndex.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void NameIndex::add(const NameKey& name) {
    if (find(name) < 0) {
        std::size_t slot = name.hash() % kSlots;
        while (mSlots[slot] != 0)
            slot = (slot + 1) % kSlots;
        mSlots[slot] = static_cast<std::uint8_t>(mNames.size() + 1);
    }
    mNames.push_back(name);
}

int NameIndex::find(const NameKey& name) const {
    for (std::size_t slot = name.hash() % kSlots; mSlots[slot] != 0; slot = (slot + 1) % kSlots) {
        const auto row = static_cast<std::size_t>(mSlots[slot] - 1);
        if (mNames[row].matches(name))
            return static_cast<int>(row);
    }
    return -1;
}

} // namespace detail
FBXSDK_NAMESPACE_END
