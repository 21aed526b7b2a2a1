// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keys for writing.

#include "animation/CurveEvaluation.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Whether old files have a letter for the key's tangents.
bool hasLegacyForm(const KeyAttributes& attributes) {
    const auto has = [&](std::uint32_t flag) { return (attributes.flags & flag) != 0; };
    if (!has(KeyFlag::cubic) || has(KeyFlag::tangentTcb) || has(KeyFlag::tangentUser))
        return true;
    const bool plain = !has(KeyFlag::genericBreak) && !has(KeyFlag::genericClamp) &&
                       !has(KeyFlag::genericClampProgressive) && !has(KeyFlag::genericTimeIndependent);
    return plain && attributes.data[KeyData::rightSlope] == 0.0F && attributes.data[KeyData::nextLeftSlope] == 0.0F;
}

/// Whether the tangents of a cubic key depend only on the adjacent keys.
bool isAutomatic(std::uint32_t flags) {
    return (flags & KeyFlag::cubic) != 0 && (flags & KeyFlag::tangentAuto) != 0 &&
           (flags & (KeyFlag::tangentUser | KeyFlag::tangentTcb)) == 0;
}

/// Automatic tangents at the ends of a curve are flat in old files.
bool isBentEnd(const CurveKeys& keys, std::size_t key) {
    const bool isFirst = key == 0, isLast = key + 1 == keys.keyCount();
    return isAutomatic(keys.attributesOf(key).flags) &&
           ((isFirst && rightSlope(keys, key) != 0.0) || (isLast && leftSlope(keys, key) != 0.0));
}

/// Which keys an old file can hold unchanged. It has the slope at which a cubic key reaches the next one only where
/// that is computed from the next key, or set by the user.
std::vector<bool> keptKeys(const CurveKeys& keys) {
    constexpr std::uint32_t kStored = KeyFlag::tangentUser | KeyFlag::constant;
    constexpr std::uint32_t kWorkedOut = KeyFlag::tangentAuto | KeyFlag::tangentTcb;
    std::vector<bool> legacy(keys.keyCount());
    bool losesLeftSlope = false; // the following key
    for (std::size_t key = keys.keyCount(); key-- > 0;) {
        const KeyAttributes& attributes = keys.attributesOf(key);
        const bool cubic = (attributes.flags & KeyFlag::cubic) != 0;
        legacy[key] = hasLegacyForm(attributes) && !isBentEnd(keys, key) && !(cubic && losesLeftSlope);
        const bool workedOut = (attributes.flags & kStored) == 0 && (attributes.flags & kWorkedOut) != 0;
        losesLeftSlope = workedOut && !(cubic && legacy[key]);
    }
    return legacy;
}

/// The key with user tangents that give the same curve.
KeyAttributes userAttributes(const CurveKeys& keys, std::size_t key, bool nextStaysAuto) {
    constexpr std::uint32_t kWorkedOut = KeyFlag::tangentAuto | KeyFlag::tangentTcb | KeyFlag::genericClamp |
                                         KeyFlag::genericClampProgressive | KeyFlag::genericTimeIndependent;
    const KeyAttributes& source = keys.attributesOf(key);
    const bool tcb = (source.flags & KeyFlag::tangentTcb) != 0;
    KeyAttributes attribute = tcb ? CurveKeys::kDefaultAttributes : source;
    attribute.flags = (source.flags & ~kWorkedOut) | KeyFlag::tangentUser;
    attribute.data[KeyData::rightSlope] = static_cast<float>(rightSlope(keys, key));
    // Before an automatic tangent this is its bias.
    if (!nextStaysAuto)
        attribute.data[KeyData::nextLeftSlope] =
            key + 1 < keys.keyCount() ? static_cast<float>(leftSlope(keys, key + 1)) : 0.0F;
    return attribute;
}

} // namespace

CurveKeys legacyKeys(const CurveKeys& keys) {
    CurveKeys curve;
    const auto count = static_cast<std::ptrdiff_t>(keys.keyCount());
    curve.defaultValue = keys.defaultValue;
    curve.times.assign(keys.times.begin(), keys.times.begin() + count);
    curve.values.assign(keys.values.begin(), keys.values.begin() + count);
    curve.before = keys.before;
    curve.after = keys.after;
    const std::vector<bool> kept = keptKeys(keys);
    const auto staysAuto = [&](std::size_t key) {
        return key < kept.size() && kept[key] && isAutomatic(keys.attributesOf(key).flags);
    };
    const KeyAttributes* last = nullptr;
    for (std::size_t key = 0; key < keys.keyCount(); ++key) {
        const KeyAttributes& attributes = keys.attributesOf(key);
        if (!kept[key] || &attributes != last)
            curve.attributes.push_back(kept[key] ? attributes : userAttributes(keys, key, staysAuto(key + 1)));
        last = kept[key] ? &attributes : nullptr;
        curve.attributeOfKey.push_back(static_cast<std::uint32_t>(curve.attributes.size() - 1));
    }
    return curve;
}

} // namespace detail
FBXSDK_NAMESPACE_END
