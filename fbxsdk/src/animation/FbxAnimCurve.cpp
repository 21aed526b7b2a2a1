// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves as objects: a sorted list of keys behind the documented interface. The arithmetic is in CurveEvaluation.
#include <fbxsdk/FbxAnimCurve.h>

#include <algorithm>
#include <cmath>
#include <iterator>

#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/extensions/CurveSamples.h>

#include "animation/CurveEvaluation.h"
#include "document/Document.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxAnimCurveBase, FbxObject)
FBXSDK_OBJECT_IMPLEMENT(FbxAnimCurve, FbxAnimCurveBase, std::span<const detail::PropertyRow>{})

FbxAnimCurveBase::FbxAnimCurveBase(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {}
FbxAnimCurveBase::~FbxAnimCurveBase() = default;

FbxAnimCurve::FbxAnimCurve(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxAnimCurveBase(pManager, pInfo) {}
FbxAnimCurve::~FbxAnimCurve() = default;

namespace {

bool hasKey(const detail::CurveKeys& keys, int index) {
    return index >= 0 && static_cast<std::size_t>(index) < keys.keyCount();
}

const detail::KeyAttributes& attributesOf(const detail::CurveKeys& keys, int index) {
    static const detail::KeyAttributes kDefaults;
    return hasKey(keys, index) ? keys.attributesOf(static_cast<std::size_t>(index)) : kDefaults;
}

/// The first key that is not before the time, or the number of keys.
std::size_t placeOf(const detail::CurveKeys& keys, std::int64_t ticks) {
    const auto found = std::lower_bound(keys.times.begin(), keys.times.end(), ticks);
    return static_cast<std::size_t>(found - keys.times.begin());
}

/// Removes the key at the index and inserts it at its new time; a key already at that time is replaced.
void moveKey(detail::CurveKeys& keys, std::size_t index, std::int64_t ticks) {
    const float value = keys.values[index];
    const std::uint32_t attribute = keys.attributeOfKey[index];
    const auto at = [](auto& list, std::size_t place) { return list.begin() + static_cast<std::ptrdiff_t>(place); };
    keys.times.erase(at(keys.times, index));
    keys.values.erase(at(keys.values, index));
    keys.attributeOfKey.erase(at(keys.attributeOfKey, index));
    const std::size_t place = placeOf(keys, ticks);
    if (place < keys.times.size() && keys.times[place] == ticks) {
        keys.values[place] = value;
        keys.attributeOfKey[place] = attribute;
        return;
    }
    keys.times.insert(at(keys.times, place), ticks);
    keys.values.insert(at(keys.values, place), value);
    keys.attributeOfKey.insert(at(keys.attributeOfKey, place), attribute);
}

constexpr std::uint32_t kInterpolationBits =
    detail::KeyFlag::constant | detail::KeyFlag::linear | detail::KeyFlag::cubic;
/// The tangent mode of a key; of a constant key its constant mode.
constexpr std::uint32_t kModeBits = 0x7F00;

bool isConstant(const detail::KeyAttributes& attributes) {
    return (attributes.flags & kInterpolationBits) == detail::KeyFlag::constant;
}

} // namespace

struct detail::CurveState {
    CurveKeys keys;
    CurveCursor cursor;
};

namespace {

/// Whether some of the numbers are not in memory yet.
bool standsInFile(const detail::DocumentObject& object) {
    for (const detail::Record& record : object.body->children()) {
        const detail::StoredArray* const array = record.array();
        if (array && array->file)
            return true;
    }
    return false;
}

} // namespace

void FbxAnimCurve::setSource(std::shared_ptr<const detail::Document> document, const detail::DocumentObject& object) {
    ++GetFbxManager()->data().revision;
    mState.reset();
    mDocument = std::move(document);
    mSource = &object;
    // A file that is changed meanwhile fails its import, not a later evaluation.
    if (standsInFile(object))
        static_cast<void>(state());
}

detail::CurveState& FbxAnimCurve::state() const {
    if (!mState) {
        auto read = std::make_unique<detail::CurveState>();
        if (mDocument)
            read->keys = detail::readCurve(*mDocument, *mSource);
        mDocument.reset();
        mState = std::move(read);
    }
    return *mState;
}

const detail::CurveKeys& FbxAnimCurve::keys() const { return state().keys; }

detail::CurveKeys& FbxAnimCurve::editKeys() {
    ++GetFbxManager()->data().revision;
    state().cursor = {};
    return state().keys;
}

void FbxAnimCurve::KeyModifyBegin() {}

void FbxAnimCurve::KeyModifyEnd() {
    if (!mState)
        return; // called by guards where memory for the first key is missing
    // No more keys for now: the lists release their spare capacity.
    detail::CurveKeys& keys = mState->keys;
    keys.times.shrink_to_fit();
    keys.values.shrink_to_fit();
    keys.attributeOfKey.shrink_to_fit();
}

void FbxAnimCurve::KeyClear() {
    detail::CurveKeys& keys = editKeys();
    keys.times.clear();
    keys.values.clear();
    keys.attributes.clear();
    keys.attributeOfKey.clear();
}

int FbxAnimCurve::KeyGetCount() const { return static_cast<int>(keys().keyCount()); }

int FbxAnimCurve::KeyAdd(FbxTime pTime, int* pLast) {
    detail::CurveKeys& keys = editKeys();
    const std::int64_t ticks = pTime.Get();
    // Keys usually come in order: the end is tried first.
    auto place = keys.times.size();
    if (keys.times.empty() || keys.times.back() < ticks) {
        keys.times.push_back(ticks);
        keys.values.push_back(0.0F);
        keys.attributeOfKey.push_back(detail::CurveKeys::kDefault);
    } else if (place = placeOf(keys, ticks); keys.times[place] != ticks) {
        const auto offset = static_cast<std::ptrdiff_t>(place);
        keys.times.insert(keys.times.begin() + offset, ticks);
        keys.values.insert(keys.values.begin() + offset, 0.0F);
        keys.attributeOfKey.insert(keys.attributeOfKey.begin() + offset, detail::CurveKeys::kDefault);
    }
    if (pLast)
        *pLast = static_cast<int>(place);
    return static_cast<int>(place);
}

bool FbxAnimCurve::KeyRemove(int pIndex) {
    if (!hasKey(keys(), pIndex))
        return false;
    detail::CurveKeys& keys = editKeys();
    keys.times.erase(keys.times.begin() + pIndex);
    keys.values.erase(keys.values.begin() + pIndex);
    keys.attributeOfKey.erase(keys.attributeOfKey.begin() + pIndex);
    return true;
}

FbxTime FbxAnimCurve::KeyGetTime(int pKeyIndex) const {
    return hasKey(keys(), pKeyIndex) ? FbxTime(keys().times[static_cast<std::size_t>(pKeyIndex)]) : FbxTime();
}

void FbxAnimCurve::KeySetTime(int pKeyIndex, FbxTime pTime) {
    if (hasKey(keys(), pKeyIndex))
        moveKey(editKeys(), static_cast<std::size_t>(pKeyIndex), pTime.Get());
}

float FbxAnimCurve::Evaluate(FbxTime pTime, int* pLast) {
    auto& [keys, cursor] = state();
    if (keys.keyCount() == 0)
        return GetValue(0);
    if (pLast)
        cursor.segment = static_cast<std::size_t>(std::max(*pLast, 0));
    const float value = detail::evaluate(keys, pTime.Get(), &cursor);
    if (pLast)
        *pLast = static_cast<int>(cursor.segment);
    return value;
}

void extensions::evaluate(FbxAnimCurve& curve, const FbxTime* times, int count, float* values) {
    if (curve.keys().keyCount() == 0)
        std::fill_n(values, std::max(count, 0), curve.GetValue(0));
    else
        detail::evaluate(curve.keys(), times, count, values);
}

namespace {

/// The time at a fraction, 0 to 1, from one time to a later one; they may be further apart than ticks can count.
std::int64_t ticksBetween(std::int64_t from, std::int64_t to, double part) {
    const std::uint64_t length = static_cast<std::uint64_t>(to) - static_cast<std::uint64_t>(from);
    const double steps = std::min(std::round(part * static_cast<double>(length)), 18446744073709549568.0);
    const std::uint64_t taken = std::min(static_cast<std::uint64_t>(steps), length);
    return static_cast<std::int64_t>(static_cast<std::uint64_t>(from) + taken);
}

} // namespace

float FbxAnimCurve::EvaluateIndex(double pIndex) {
    const std::size_t count = keys().keyCount();
    if (count == 0)
        return GetValue(0);
    if (!(pIndex > 0.0))
        return keys().values.front();
    if (pIndex >= static_cast<double>(count - 1))
        return keys().values[count - 1];
    const auto key = static_cast<std::size_t>(pIndex);
    return detail::evaluate(keys(),
                            ticksBetween(keys().times[key], keys().times[key + 1], pIndex - static_cast<double>(key)));
}

void FbxAnimCurve::SetPreExtrapolation(EExtrapolationType pExtrapolation) {
    editKeys().before.type = static_cast<detail::ExtrapolationType>(pExtrapolation);
}
FbxAnimCurveBase::EExtrapolationType FbxAnimCurve::GetPreExtrapolation() const {
    return static_cast<EExtrapolationType>(keys().before.type);
}
void FbxAnimCurve::SetPostExtrapolation(EExtrapolationType pExtrapolation) {
    editKeys().after.type = static_cast<detail::ExtrapolationType>(pExtrapolation);
}
FbxAnimCurveBase::EExtrapolationType FbxAnimCurve::GetPostExtrapolation() const {
    return static_cast<EExtrapolationType>(keys().after.type);
}

namespace {

/// The interface is unsigned, with 0 for "endless".
std::int32_t toCount(unsigned long count) {
    return count == 0 || count > static_cast<unsigned long>(INT32_MAX) ? -1 : static_cast<std::int32_t>(count);
}
unsigned long fromCount(std::int32_t count) { return count > 0 ? static_cast<unsigned long>(count) : 0UL; }

} // namespace

void FbxAnimCurve::SetPreExtrapolationCount(unsigned long pCount) { editKeys().before.count = toCount(pCount); }
unsigned long FbxAnimCurve::GetPreExtrapolationCount() const { return fromCount(keys().before.count); }
void FbxAnimCurve::SetPostExtrapolationCount(unsigned long pCount) { editKeys().after.count = toCount(pCount); }
unsigned long FbxAnimCurve::GetPostExtrapolationCount() const { return fromCount(keys().after.count); }

bool FbxAnimCurve::GetTimeInterval(FbxTimeSpan& pTimeInterval) const {
    if (keys().keyCount() == 0)
        return false;
    pTimeInterval.Set(FbxTime(keys().times.front()), FbxTime(keys().times[keys().keyCount() - 1]));
    return true;
}

void FbxAnimCurve::KeySet(int pKeyIndex, FbxTime pTime, float pValue,
                          FbxAnimCurveDef::EInterpolationType pInterpolation,
                          FbxAnimCurveDef::ETangentMode pTangentMode, float pData0, float pData1,
                          FbxAnimCurveDef::EWeightedMode pTangentWeightMode, float pWeight0, float pWeight1,
                          float pVelocity0, float pVelocity1) {
    if (!hasKey(keys(), pKeyIndex))
        return;
    detail::CurveKeys& keys = editKeys();
    const auto index = static_cast<std::size_t>(pKeyIndex);
    detail::KeyAttributes attributes;
    // A constant key has no tangents; their bits would read as its constant mode.
    const bool constant = pInterpolation == FbxAnimCurveDef::eInterpolationConstant;
    attributes.flags = static_cast<std::uint32_t>(pInterpolation) |
                       (constant ? 0U : static_cast<std::uint32_t>(pTangentMode)) |
                       static_cast<std::uint32_t>(pTangentWeightMode);
    attributes.data = {pData0, pData1, pWeight0, pWeight1, pVelocity0, pVelocity1};
    keys.values[index] = pValue;
    keys.setAttributes(index, attributes);
    if (keys.times[index] != pTime.Get())
        moveKey(keys, index, pTime.Get());
}

void extensions::addLinearKeys(FbxAnimCurve& curve, const FbxTime* times, const float* values, int count) {
    for (int i = 0; i < count; ++i) {
        const int index = curve.KeyAdd(times[i]);
        curve.KeySet(index, times[i], values[i], FbxAnimCurveDef::eInterpolationLinear);
        detail::CurveKeys& keys = curve.editKeys();
        if (static_cast<std::size_t>(index) + 1 != keys.times.size())
            continue;
        // Those that follow the last key have its attributes.
        int end = i + 1;
        while (end < count && times[end - 1] < times[end])
            ++end;
        const std::uint32_t attribute = keys.attributeOfKey.back();
        keys.attributeOfKey.resize(keys.times.size() + static_cast<std::size_t>(end - i - 1), attribute);
        keys.values.insert(keys.values.end(), values + i + 1, values + end);
        std::transform(times + i + 1, times + end, std::back_inserter(keys.times),
                       [](const FbxTime& time) { return time.Get(); });
        i = end - 1;
    }
}

float FbxAnimCurve::KeyGetValue(int pKeyIndex) const {
    return hasKey(keys(), pKeyIndex) ? keys().values[static_cast<std::size_t>(pKeyIndex)] : 0.0F;
}

void FbxAnimCurve::KeySetValue(int pKeyIndex, float pValue) {
    if (hasKey(keys(), pKeyIndex))
        editKeys().values[static_cast<std::size_t>(pKeyIndex)] = pValue;
}

FbxAnimCurveDef::EInterpolationType FbxAnimCurve::KeyGetInterpolation(int pKeyIndex) const {
    const std::uint32_t bits = attributesOf(keys(), pKeyIndex).flags & kInterpolationBits;
    return static_cast<FbxAnimCurveDef::EInterpolationType>(bits);
}

void FbxAnimCurve::KeySetInterpolation(int pKeyIndex, FbxAnimCurveDef::EInterpolationType pInterpolation) {
    if (!hasKey(keys(), pKeyIndex))
        return;
    detail::KeyAttributes attributes = attributesOf(keys(), pKeyIndex);
    const bool becomesConstant = pInterpolation == FbxAnimCurveDef::eInterpolationConstant;
    if (isConstant(attributes) != becomesConstant)
        attributes.flags = (attributes.flags & ~kModeBits) | (becomesConstant ? 0U : detail::KeyFlag::tangentAuto);
    attributes.flags = (attributes.flags & ~kInterpolationBits) | static_cast<std::uint32_t>(pInterpolation);
    editKeys().setAttributes(static_cast<std::size_t>(pKeyIndex), attributes);
}

FbxAnimCurveDef::EConstantMode FbxAnimCurve::KeyGetConstantMode(int pKeyIndex) const {
    const detail::KeyAttributes& attributes = attributesOf(keys(), pKeyIndex);
    const bool next = isConstant(attributes) && (attributes.flags & detail::KeyFlag::constantNext) != 0;
    return next ? FbxAnimCurveDef::eConstantNext : FbxAnimCurveDef::eConstantStandard;
}

void FbxAnimCurve::KeySetConstantMode(int pKeyIndex, FbxAnimCurveDef::EConstantMode pMode) {
    if (!hasKey(keys(), pKeyIndex) || !isConstant(attributesOf(keys(), pKeyIndex)))
        return;
    detail::KeyAttributes attributes = attributesOf(keys(), pKeyIndex);
    attributes.flags = (attributes.flags & ~detail::KeyFlag::constantNext) | static_cast<std::uint32_t>(pMode);
    editKeys().setAttributes(static_cast<std::size_t>(pKeyIndex), attributes);
}

FbxAnimCurveDef::ETangentMode FbxAnimCurve::KeyGetTangentMode(int pKeyIndex) const {
    const detail::KeyAttributes& attributes = attributesOf(keys(), pKeyIndex);
    return isConstant(attributes) ? FbxAnimCurveDef::eTangentAuto
                                  : static_cast<FbxAnimCurveDef::ETangentMode>(attributes.flags & kModeBits);
}

void FbxAnimCurve::KeySetTangentMode(int pKeyIndex, FbxAnimCurveDef::ETangentMode pTangent) {
    if (!hasKey(keys(), pKeyIndex) || isConstant(attributesOf(keys(), pKeyIndex)))
        return;
    detail::KeyAttributes attributes = attributesOf(keys(), pKeyIndex);
    attributes.flags = (attributes.flags & ~kModeBits) | static_cast<std::uint32_t>(pTangent);
    editKeys().setAttributes(static_cast<std::size_t>(pKeyIndex), attributes);
}

float FbxAnimCurve::KeyGetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex) const {
    const auto& data = attributesOf(keys(), pKeyIndex).data;
    return static_cast<std::size_t>(pIndex) < data.size() ? data[static_cast<std::size_t>(pIndex)] : 0.0F;
}

void FbxAnimCurve::KeySetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex, float pValue) {
    detail::KeyAttributes attributes = attributesOf(keys(), pKeyIndex);
    if (!hasKey(keys(), pKeyIndex) || static_cast<std::size_t>(pIndex) >= attributes.data.size())
        return;
    attributes.data[static_cast<std::size_t>(pIndex)] = pValue;
    editKeys().setAttributes(static_cast<std::size_t>(pKeyIndex), attributes);
}

void FbxAnimCurve::KeyMultValue(float pMultValue) { detail::multiplyValues(editKeys(), pMultValue); }

namespace {

struct Channel {
    FbxAnimCurveNode* node;
    unsigned int index;
};

/// The channel that the curve drives through its n-th curve node; no node when there is none.
Channel channelOf(const FbxAnimCurve& curve, int curveNodeIndex) {
    auto* node = curve.GetDstObject<FbxAnimCurveNode>(curveNodeIndex);
    for (unsigned int i = 0; node && i < node->GetChannelsCount(); ++i) {
        for (unsigned int id = 0; node->GetCurve(i, id); ++id)
            if (node->GetCurve(i, id) == &curve)
                return {node, i};
    }
    return {nullptr, 0};
}

} // namespace

float FbxAnimCurve::GetValue(int pCurveNodeIndex) const {
    const Channel channel = channelOf(*this, pCurveNodeIndex);
    return channel.node ? static_cast<float>(channel.node->channelValue(channel.index)) : keys().defaultValue;
}

void FbxAnimCurve::SetValue(float pValue, int pCurveNodeIndex) {
    editKeys().defaultValue = pValue;
    const Channel channel = channelOf(*this, pCurveNodeIndex);
    if (channel.node)
        channel.node->setChannelValue(channel.index, static_cast<double>(pValue));
}

FBXSDK_NAMESPACE_END
