// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property handles: look-up, values, flags, compounds and connections.
#include <fbxsdk/FbxProperty.h>

#include <algorithm>
#include <bit>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

#include <fbxsdk/FbxObject.h>

#include "object/ManagerData.h"
#include "object/ObjectData.h"
#include "object/PropertyConversion.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::PropertyData;
using detail::PropertyRow;

const PropertyData* dataOf(const FbxProperty& property) {
    return property.GetFbxObject()->data().property(property.index());
}

/// The class's row of a property that has one; null for dynamic ones.
const PropertyRow* rowOf(const FbxProperty& property) {
    const auto rows = property.GetFbxObject()->data().info->rows;
    const auto index = static_cast<std::size_t>(property.index());
    return property.index() >= 0 && index < rows.size() ? &rows[index] : nullptr;
}

bool exists(const FbxProperty& property) { return property.IsValid() && property.index() >= 0; }

/// The properties of a compound are stored next to it, as "Compound|Child".
std::string_view fullName(const FbxProperty& property) {
    if (!exists(property))
        return {};
    if (const PropertyRow* row = rowOf(property))
        return row->name;
    const PropertyData* data = dataOf(property);
    return data ? std::string_view(data->name) : std::string_view();
}

/// The compound that the property belongs to: the longest part of its name before a bar that is the name of a property.
/// Invalid when there is none; a bar in the name is then an ordinary character.
FbxProperty compoundOf(const FbxProperty& property) {
    std::string_view name = fullName(property);
    for (std::size_t bar = name.rfind('|'); bar != std::string_view::npos; bar = name.rfind('|')) {
        name = name.substr(0, bar);
        const int index = property.GetFbxObject()->data().findProperty(detail::NameKey(name));
        if (index >= 0)
            return {property.GetFbxObject(), index};
    }
    return {};
}

PropertyData& editable(FbxProperty& property) { return property.GetFbxObject()->data().materialise(property.index()); }

/// Whether the value is the row's default, to the bit.
bool isDefault(const PropertyRow& row, const detail::PropertyValue& value) {
    const auto sameBits = [](double a, double b) {
        return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
    };
    return value.integer == static_cast<std::int64_t>(row.numbers[0]) &&
           std::equal(value.numbers.begin(), value.numbers.end(), row.numbers.begin(), sameBits) &&
           value.text == row.text;
}

/// Writes a property of the class that is not stored. A value that is the default need not be.
bool writeUnstored(detail::ObjectData& object, int index, const void* value, EFbxType type) {
    const PropertyRow& row = object.info->rows[static_cast<std::size_t>(index)];
    const EFbxType kept = row.type->GetType();
    detail::PropertyValue set = detail::defaultValue(row);
    if (!detail::isWritable(kept, type) || !detail::writePropertyValue(set, kept, value, type))
        return false;
    if (!isDefault(row, set))
        object.materialise(index).value = std::move(set);
    return true;
}

bool writeStored(PropertyData& property, const void* value, EFbxType type) {
    const EFbxType kept = property.type.GetType();
    return detail::isWritable(kept, type) && detail::writePropertyValue(property.value, kept, value, type);
}

/// The first property from the index on that belongs to the compound, or to none when that is invalid.
FbxProperty nextBelow(FbxObject& object, const FbxProperty& compound, int from) {
    const int count = object.data().propertyCount();
    for (int i = from; i < count; ++i) {
        const FbxProperty each(&object, i);
        if (compoundOf(each) == compound)
            return each;
    }
    return {};
}

} // namespace

FbxProperty FbxProperty::Create(FbxObject* pObject, const FbxDataType& pDataType, const char* pName, const char* pLabel,
                                bool pCheckForDup, bool* pWasFound) {
    if (pWasFound)
        *pWasFound = false;
    if (!pObject || !pName || !pDataType.Valid())
        return {};
    if (pCheckForDup) {
        const FbxProperty existing = pObject->FindProperty(pName);
        if (existing.IsValid()) {
            if (pWasFound)
                *pWasFound = true;
            return existing;
        }
    }
    PropertyData& made = pObject->data().appendProperty(pDataType, pName);
    if (pLabel)
        made.label = pLabel;
    ++pObject->GetFbxManager()->data().revision;
    return {pObject, made.index};
}

FbxProperty FbxProperty::Create(const FbxProperty& pCompoundProperty, const FbxDataType& pDataType, const char* pName,
                                const char* pLabel, bool pCheckForDup, bool* pWasFound) {
    if (!pCompoundProperty.IsValid() || !pName)
        return {};
    std::string name(fullName(pCompoundProperty));
    if (!name.empty())
        name += '|';
    name += pName;
    return Create(pCompoundProperty.GetFbxObject(), pDataType, name.c_str(), pLabel, pCheckForDup, pWasFound);
}

FbxString FbxProperty::GetName() const { return FbxString(GetNameAsCStr()); }

const char* FbxProperty::GetNameAsCStr() const {
    const std::string_view name = fullName(*this);
    if (name.empty())
        return "";
    const std::size_t compoundLength = fullName(compoundOf(*this)).size();
    return name.data() + (compoundLength == 0 ? 0 : compoundLength + 1);
}

FbxString FbxProperty::GetHierarchicalName() const {
    const std::string_view name = fullName(*this);
    return {name.data() ? name.data() : "", name.size()};
}

FbxString FbxProperty::GetLabel(bool pReturnNameIfEmpty) const {
    const PropertyData* data = exists(*this) ? dataOf(*this) : nullptr;
    if (data && !data->label.empty())
        return FbxString(data->label.c_str());
    return pReturnNameIfEmpty ? GetName() : FbxString();
}

FbxDataType FbxProperty::GetPropertyDataType() const {
    if (!exists(*this))
        return {};
    const PropertyData* data = dataOf(*this);
    return data ? data->type : *rowOf(*this)->type;
}

void FbxProperty::readValue(void* pValue, EFbxType pType) const {
    if (!exists(*this))
        return;
    if (const PropertyData* data = dataOf(*this)) {
        detail::readPropertyValue(data->value, data->type.GetType(), pValue, pType);
    } else {
        const PropertyRow& row = *rowOf(*this);
        detail::readPropertyValue(detail::defaultValue(row), row.type->GetType(), pValue, pType);
    }
}

bool FbxProperty::writeValue(const void* pValue, EFbxType pType) {
    if (!exists(*this))
        return false;
    detail::ObjectData& object = mObject->data();
    PropertyData* const stored = object.property(mIndex);
    const bool isWritten = stored ? writeStored(*stored, pValue, pType) : writeUnstored(object, mIndex, pValue, pType);
    if (isWritten)
        ++mObject->GetFbxManager()->data().revision;
    return isWritten;
}

void FbxProperty::ModifyFlag(FbxPropertyFlags::EFlags pFlag, bool pValue) {
    if (!exists(*this))
        return;
    const auto bits = static_cast<unsigned>(pFlag);
    PropertyData& data = editable(*this);
    data.flags = pValue ? data.flags | bits : data.flags & ~bits;
}

bool FbxProperty::GetFlag(FbxPropertyFlags::EFlags pFlag) const {
    if (!exists(*this))
        return false;
    const PropertyData* data = dataOf(*this);
    const unsigned flags = data ? data->flags : detail::defaultFlags(*rowOf(*this));
    return (flags & static_cast<unsigned>(pFlag)) != 0;
}

FbxProperty FbxProperty::GetParent() const {
    if (!exists(*this))
        return {};
    const FbxProperty compound = compoundOf(*this);
    return compound.IsValid() ? compound : mObject->RootProperty;
}

FbxProperty FbxProperty::GetChild() const {
    if (!IsValid())
        return {};
    return nextBelow(*mObject, exists(*this) ? *this : FbxProperty(), 0);
}

FbxProperty FbxProperty::GetSibling() const {
    return exists(*this) ? nextBelow(*mObject, compoundOf(*this), mIndex + 1) : FbxProperty();
}

FbxProperty FbxProperty::Find(const char* pName, bool pCaseSensitive) const {
    if (!IsValid() || !pName)
        return {};
    std::string name(fullName(*this));
    if (!name.empty())
        name += '|';
    return mObject->FindProperty((name + pName).c_str(), pCaseSensitive);
}

bool FbxProperty::ConnectSrcObject(FbxObject* pObject) {
    return exists(*this) && pObject && detail::ObjectData::connect(pObject->data().plug, editable(*this).plug);
}

bool FbxProperty::ConnectDstObject(FbxObject* pObject) {
    return exists(*this) && pObject && detail::ObjectData::connect(editable(*this).plug, pObject->data().plug);
}

bool FbxProperty::DisconnectSrcObject(FbxObject* pObject) {
    return exists(*this) && pObject && detail::ObjectData::disconnect(pObject->data().plug, editable(*this).plug);
}

bool FbxProperty::ConnectSrcProperty(const FbxProperty& pProperty) {
    FbxProperty source = pProperty;
    return exists(*this) && exists(source) && detail::ObjectData::connect(editable(source).plug, editable(*this).plug);
}

bool FbxProperty::ConnectDstProperty(const FbxProperty& pProperty) {
    FbxProperty destination = pProperty;
    return destination.ConnectSrcProperty(*this);
}

bool FbxProperty::IsConnectedSrcObject(const FbxObject* pObject) const {
    const PropertyData* data = exists(*this) ? dataOf(*this) : nullptr;
    return data && pObject && detail::isConnected(pObject->data().plug, data->plug);
}

namespace {

const detail::ConnectionList& sourcesOf(const FbxProperty& property) {
    static const detail::ConnectionList kNone;
    const PropertyData* data = exists(property) ? dataOf(property) : nullptr;
    return data ? data->plug.sources : kNone;
}

const detail::ConnectionList& destinationsOf(const FbxProperty& property) {
    static const detail::ConnectionList kNone;
    const PropertyData* data = exists(property) ? dataOf(property) : nullptr;
    return data ? data->plug.destinations : kNone;
}

} // namespace

int FbxProperty::GetSrcObjectCount() const { return sourcesOf(*this).countObjects(FbxCriteria()); }
int FbxProperty::GetSrcObjectCount(const FbxCriteria& pCriteria) const {
    return sourcesOf(*this).countObjects(pCriteria);
}
FbxObject* FbxProperty::GetSrcObject(int pIndex) const { return sourcesOf(*this).objectAt(FbxCriteria(), pIndex); }
FbxObject* FbxProperty::GetSrcObject(const FbxCriteria& pCriteria, int pIndex) const {
    return sourcesOf(*this).objectAt(pCriteria, pIndex);
}
int FbxProperty::GetDstObjectCount() const { return destinationsOf(*this).countObjects(FbxCriteria()); }
FbxObject* FbxProperty::GetDstObject(int pIndex) const { return destinationsOf(*this).objectAt(FbxCriteria(), pIndex); }
int FbxProperty::GetSrcPropertyCount() const { return sourcesOf(*this).countProperties(); }
FbxProperty FbxProperty::GetSrcProperty(int pIndex) const { return sourcesOf(*this).propertyAt(pIndex); }

FBXSDK_NAMESPACE_END
