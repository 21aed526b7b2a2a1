// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Typed, named, animatable values of objects. A FbxProperty is a small handle: copying it does not copy the value.
#pragma once

#include <type_traits>

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxCriteria.h>
#include <fbxsdk/FbxDataType.h>
#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxTime.h>
#include <fbxsdk/FbxTypes.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurve;
class FbxAnimCurveNode;
class FbxAnimLayer;
class FbxAnimStack;
class FbxObject;

namespace detail {
struct PropertyData;
}

struct FbxPropertyFlags {
    enum EFlags {
        eNone = 0,
        eStatic = 1 << 0,
        eAnimatable = 1 << 1,
        eAnimated = 1 << 2,
        eImported = 1 << 3,
        eUserDefined = 1 << 4,
        eHidden = 1 << 5,
        eNotSavable = 1 << 6,
        eLockedMember0 = 1 << 7,
        eLockedMember1 = 1 << 8,
        eLockedMember2 = 1 << 9,
        eLockedMember3 = 1 << 10,
        eLockedAll = eLockedMember0 | eLockedMember1 | eLockedMember2 | eLockedMember3,
        eMutedMember0 = 1 << 11,
        eMutedMember1 = 1 << 12,
        eMutedMember2 = 1 << 13,
        eMutedMember3 = 1 << 14,
        eMutedAll = eMutedMember0 | eMutedMember1 | eMutedMember2 | eMutedMember3
    };
};

// The type code under which a C++ type is read from and written to a property.
constexpr EFbxType FbxTypeOf(const FbxBool&) { return eFbxBool; }
constexpr EFbxType FbxTypeOf(const FbxChar&) { return eFbxChar; }
constexpr EFbxType FbxTypeOf(const FbxUChar&) { return eFbxUChar; }
constexpr EFbxType FbxTypeOf(const FbxShort&) { return eFbxShort; }
constexpr EFbxType FbxTypeOf(const FbxUShort&) { return eFbxUShort; }
constexpr EFbxType FbxTypeOf(const FbxInt&) { return eFbxInt; }
constexpr EFbxType FbxTypeOf(const FbxUInt&) { return eFbxUInt; }
constexpr EFbxType FbxTypeOf(const FbxLongLong&) { return eFbxLongLong; }
constexpr EFbxType FbxTypeOf(const FbxULongLong&) { return eFbxULongLong; }
constexpr EFbxType FbxTypeOf(const FbxFloat&) { return eFbxFloat; }
constexpr EFbxType FbxTypeOf(const FbxDouble&) { return eFbxDouble; }
constexpr EFbxType FbxTypeOf(const FbxDouble2&) { return eFbxDouble2; }
constexpr EFbxType FbxTypeOf(const FbxDouble3&) { return eFbxDouble3; }
constexpr EFbxType FbxTypeOf(const FbxDouble4&) { return eFbxDouble4; }
inline EFbxType FbxTypeOf(const FbxColor&) { return eFbxDouble4; }
inline EFbxType FbxTypeOf(const FbxString&) { return eFbxString; }
inline EFbxType FbxTypeOf(const FbxTime&) { return eFbxTime; }
template <class T, std::enable_if_t<std::is_enum_v<T>, int> = 0>
constexpr EFbxType FbxTypeOf(const T&) {
    return eFbxEnum;
}

class FBXSDK_DLL FbxProperty {
public:
    /// Appends a dynamic property with the type's zero value to the object. With pCheckForDup an existing property of
    /// that name is returned as it is and *pWasFound says so. Invalid for a null or undefined argument.
    static FbxProperty Create(FbxObject* pObject, const FbxDataType& pDataType, const char* pName,
                              const char* pLabel = "", bool pCheckForDup = true, bool* pWasFound = nullptr);
    static FbxProperty Create(const FbxProperty& pCompoundProperty, const FbxDataType& pDataType, const char* pName,
                              const char* pLabel = "", bool pCheckForDup = true, bool* pWasFound = nullptr);

    FbxProperty() = default;

    [[nodiscard]] bool IsValid() const { return mObject != nullptr; }
    [[nodiscard]] FbxObject* GetFbxObject() const { return mObject; }
    /// Within its compound; the hierarchical name has those of all compounds before it: "Compound|Name".
    [[nodiscard]] FbxString GetName() const;
    [[nodiscard]] const char* GetNameAsCStr() const;
    [[nodiscard]] FbxString GetHierarchicalName() const;
    [[nodiscard]] FbxString GetLabel(bool pReturnNameIfEmpty = true) const;
    [[nodiscard]] FbxDataType GetPropertyDataType() const;

    /// The static value, never the animated one, converted to T where that makes sense; T() otherwise. Numbers convert
    /// among each other (truncated toward zero, NaN to 0, too far ones to the nearest), vectors by components, times to
    /// and from whole numbers as ticks; text only to text.
    template <class T>
    [[nodiscard]] T Get() const {
        T value{};
        readValue(&value, FbxTypeOf(value));
        return value;
    }
    /// Converts likewise; components that are not given stay. False when the property is invalid or no conversion
    /// exists.
    template <class T>
    bool Set(const T& pValue) {
        return writeValue(&pValue, FbxTypeOf(pValue));
    }
    bool Set(const char* pValue) { return Set(FbxString(pValue)); }
    /// The animated value at the time, over all layers of the scene's current stack.
    template <class T>
    [[nodiscard]] T EvaluateValue(const FbxTime& pTime = FBXSDK_TIME_INFINITE, bool = false) {
        T value{};
        evaluate(&value, FbxTypeOf(value), pTime);
        return value;
    }

    void ModifyFlag(FbxPropertyFlags::EFlags pFlag, bool pValue);
    [[nodiscard]] bool GetFlag(FbxPropertyFlags::EFlags pFlag) const;

    /// The curve of one component on one layer. With pCreate a missing curve node and curve are made; null for a null
    /// layer, an unknown component, a name that is not the property's, and where one would have to be made for a
    /// property that holds no number.
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, bool pCreate = false);
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, const char* pChannel, bool pCreate = false);
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, const char* pName, const char* pChannel, bool pCreate);
    FbxAnimCurveNode* GetCurveNode(bool pCreate = false);
    FbxAnimCurveNode* GetCurveNode(FbxAnimStack* pAnimStack, bool pCreate = false);
    FbxAnimCurveNode* GetCurveNode(FbxAnimLayer* pAnimLayer, bool pCreate = false);
    FbxAnimCurveNode* CreateCurveNode(FbxAnimLayer* pAnimLayer);
    [[nodiscard]] bool IsAnimated(FbxAnimLayer* pAnimLayer = nullptr) const;

    /// The compound, or the object's root property. The root property's children are those outside of compounds.
    [[nodiscard]] FbxProperty GetParent() const;
    [[nodiscard]] FbxProperty GetChild() const;
    [[nodiscard]] FbxProperty GetSibling() const;
    [[nodiscard]] FbxProperty Find(const char* pName, bool pCaseSensitive = true) const;

    // Connections, as on FbxObject.
    bool ConnectSrcObject(FbxObject* pObject);
    bool ConnectDstObject(FbxObject* pObject);
    bool DisconnectSrcObject(FbxObject* pObject);
    bool ConnectSrcProperty(const FbxProperty& pProperty);
    bool ConnectDstProperty(const FbxProperty& pProperty);
    [[nodiscard]] bool IsConnectedSrcObject(const FbxObject* pObject) const;
    [[nodiscard]] int GetSrcObjectCount() const;
    [[nodiscard]] int GetSrcObjectCount(const FbxCriteria& pCriteria) const;
    [[nodiscard]] FbxObject* GetSrcObject(int pIndex = 0) const;
    [[nodiscard]] FbxObject* GetSrcObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    template <class T>
    [[nodiscard]] int GetSrcObjectCount() const {
        return GetSrcObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    template <class T>
    [[nodiscard]] T* GetSrcObject(int pIndex = 0) const {
        return static_cast<T*>(GetSrcObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    [[nodiscard]] int GetDstObjectCount() const;
    [[nodiscard]] FbxObject* GetDstObject(int pIndex = 0) const;
    [[nodiscard]] int GetSrcPropertyCount() const;
    [[nodiscard]] FbxProperty GetSrcProperty(int pIndex = 0) const;

    bool operator==(const FbxProperty& pOther) const { return mObject == pOther.mObject && mIndex == pOther.mIndex; }
    bool operator!=(const FbxProperty& pOther) const { return !(*this == pOther); }

    /// The platform's own handle: the object and the index of the property in it (class rows first, dynamic ones
    /// after).
    FbxProperty(FbxObject* pObject, int pIndex) : mObject(pObject), mIndex(pIndex) {}
    [[nodiscard]] int index() const { return mIndex; }

protected:
    void readValue(void* pValue, EFbxType pType) const;
    bool writeValue(const void* pValue, EFbxType pType);
    void evaluate(void* pValue, EFbxType pType, const FbxTime& pTime);

    FbxObject* mObject = nullptr;
    int mIndex = -1;
};

/// A property of a class with a known type: the public members of nodes, cameras, lights, …
template <class T>
class FbxPropertyT : public FbxProperty {
public:
    using ValueType = T;

    FbxPropertyT() = default;
    FbxPropertyT(const FbxPropertyT&) = default;
    explicit FbxPropertyT(const FbxProperty& pProperty) : FbxProperty(pProperty) {}

    [[nodiscard]] T Get() const { return FbxProperty::Get<T>(); }
    operator T() const { return Get(); }
    FbxPropertyT& Set(const T& pValue) {
        FbxProperty::Set(pValue);
        return *this;
    }
    FbxPropertyT& operator=(const T& pValue) { return Set(pValue); }
    /// Copies the value, not the handle.
    FbxPropertyT& operator=(const FbxPropertyT& pOther) { return this == &pOther ? *this : Set(pOther.Get()); }
    [[nodiscard]] T EvaluateValue(const FbxTime& pTime = FBXSDK_TIME_INFINITE, bool pForceEval = false) {
        return FbxProperty::EvaluateValue<T>(pTime, pForceEval);
    }

    // The untyped forms stay reachable: `light->LightType.Get<FbxEnum>()`.
    template <class Other>
    [[nodiscard]] Other Get() const {
        return FbxProperty::Get<Other>();
    }
};

FBXSDK_NAMESPACE_END
