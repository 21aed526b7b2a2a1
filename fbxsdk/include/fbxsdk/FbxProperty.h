// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// The flags of properties.
struct FbxPropertyFlags {
    /// Combinable bits. Files hold those for animatable, animated, user-defined, hidden, locked and muted.
    enum EFlags {
        eNone = 0,            ///< no flag
        eStatic = 1 << 0,     ///< declared by the class, not dynamic
        eAnimatable = 1 << 1, ///< meant to be animated; a curve can be made for other numeric properties too
        /// had a curve node when the file was written; written for what has one, whatever is set here
        eAnimated = 1 << 2,
        eImported = 1 << 3,       ///< came from a file; never set here and never written
        eUserDefined = 1 << 4,    ///< added by a user or a host, shown as such by applications
        eHidden = 1 << 5,         ///< not shown by applications
        eNotSavable = 1 << 6,     ///< omitted from files
        eLockedMember0 = 1 << 7,  ///< the first component may not be edited in applications; Set still works
        eLockedMember1 = 1 << 8,  ///< the same for the second component
        eLockedMember2 = 1 << 9,  ///< the same for the third component
        eLockedMember3 = 1 << 10, ///< the same for the fourth component
        eLockedAll = eLockedMember0 | eLockedMember1 | eLockedMember2 | eLockedMember3, ///< all four components
        /// the animation of the first component is switched off in applications; evaluation here ignores it
        eMutedMember0 = 1 << 11,
        eMutedMember1 = 1 << 12,                                                  ///< the same for the second component
        eMutedMember2 = 1 << 13,                                                  ///< the same for the third component
        eMutedMember3 = 1 << 14,                                                  ///< the same for the fourth component
        eMutedAll = eMutedMember0 | eMutedMember1 | eMutedMember2 | eMutedMember3 ///< all four components
    };
};

/// The type code under which a value of the C++ type is read from and written to a property.
constexpr EFbxType FbxTypeOf(const FbxBool&) { return eFbxBool; }
constexpr EFbxType FbxTypeOf(const FbxChar&) { return eFbxChar; }           ///< For 8-bit numbers.
constexpr EFbxType FbxTypeOf(const FbxUChar&) { return eFbxUChar; }         ///< For 8-bit numbers without sign.
constexpr EFbxType FbxTypeOf(const FbxShort&) { return eFbxShort; }         ///< For 16-bit numbers.
constexpr EFbxType FbxTypeOf(const FbxUShort&) { return eFbxUShort; }       ///< For 16-bit numbers without sign.
constexpr EFbxType FbxTypeOf(const FbxInt&) { return eFbxInt; }             ///< For 32-bit numbers.
constexpr EFbxType FbxTypeOf(const FbxUInt&) { return eFbxUInt; }           ///< For 32-bit numbers without sign.
constexpr EFbxType FbxTypeOf(const FbxLongLong&) { return eFbxLongLong; }   ///< For 64-bit numbers.
constexpr EFbxType FbxTypeOf(const FbxULongLong&) { return eFbxULongLong; } ///< For 64-bit numbers without sign.
constexpr EFbxType FbxTypeOf(const FbxFloat&) { return eFbxFloat; }         ///< For single precision.
constexpr EFbxType FbxTypeOf(const FbxDouble&) { return eFbxDouble; }       ///< For double precision.
constexpr EFbxType FbxTypeOf(const FbxDouble2&) { return eFbxDouble2; }     ///< For two numbers.
constexpr EFbxType FbxTypeOf(const FbxDouble3&) { return eFbxDouble3; }     ///< For three numbers.
constexpr EFbxType FbxTypeOf(const FbxDouble4&) { return eFbxDouble4; }     ///< For four numbers.
inline EFbxType FbxTypeOf(const FbxColor&) { return eFbxDouble4; }          ///< Colours are four numbers.
inline EFbxType FbxTypeOf(const FbxString&) { return eFbxString; }          ///< For text.
inline EFbxType FbxTypeOf(const FbxTime&) { return eFbxTime; }              ///< For times.
/// For enumerations of any kind.
template <class T, std::enable_if_t<std::is_enum_v<T>, int> = 0>
constexpr EFbxType FbxTypeOf(const T&) {
    return eFbxEnum;
}

/// A handle to one typed, named value of an object. Copying the handle does not copy the value.
///
/// A handle is valid until its object is destroyed; it does not keep the object alive and does not detect its end. A
/// handle made without an object is invalid: reading from it gives T(), writing to it false, its related
/// properties are invalid.
class FBXSDK_DLL FbxProperty {
public:
    /// Appends a dynamic property with the type's zero value to the object. With pCheckForDup an existing property of
    /// that name is returned unchanged and *pWasFound is true. The new one has no flags. Invalid for a null object
    /// or name and for an undefined type.
    static FbxProperty Create(FbxObject* pObject, const FbxDataType& pDataType, const char* pName,
                              const char* pLabel = "", bool pCheckForDup = true, bool* pWasFound = nullptr);
    /// Appends a dynamic property to a compound, or to the object when given its RootProperty; otherwise the same.
    static FbxProperty Create(const FbxProperty& pCompoundProperty, const FbxDataType& pDataType, const char* pName,
                              const char* pLabel = "", bool pCheckForDup = true, bool* pWasFound = nullptr);

    FbxProperty() = default; ///< An invalid property.

    /// Whether the handle is that of a property or of an object's RootProperty.
    [[nodiscard]] bool IsValid() const { return mObject != nullptr; }
    /// The object that has the property; null when invalid.
    [[nodiscard]] FbxObject* GetFbxObject() const { return mObject; }
    /// The name within its compound, UTF-8; the hierarchical name has those of all compounds before it:
    /// "Compound|Name".
    [[nodiscard]] FbxString GetName() const;
    /// The same without a copy, never null; valid as long as the object.
    [[nodiscard]] const char* GetNameAsCStr() const;
    /// The name with those of all compounds before it, separated by bars; what FbxObject::FindProperty takes.
    [[nodiscard]] FbxString GetHierarchicalName() const;
    /// The name that applications display. Without a label: the name, or the empty string when
    /// pReturnNameIfEmpty is false.
    [[nodiscard]] FbxString GetLabel(bool pReturnNameIfEmpty = true) const;
    [[nodiscard]] FbxDataType GetPropertyDataType() const; ///< An undefined type when the property is invalid.

    /// The static value, never the animated one, converted to T where that is possible; T() otherwise. Numbers convert
    /// among each other (truncated toward zero, NaN to 0, clamped to the range), vectors by components, times to
    /// and from whole numbers as ticks; text only to text.
    template <class T>
    [[nodiscard]] T Get() const {
        T value{};
        readValue(&value, FbxTypeOf(value));
        return value;
    }
    /// Sets the static value, without changing curves. Converts as Get does; components that are not given stay.
    /// False when the property is invalid or no conversion exists.
    template <class T>
    bool Set(const T& pValue) {
        return writeValue(&pValue, FbxTypeOf(pValue));
    }
    /// Text, null meaning the empty one. False for a property that holds no text.
    bool Set(const char* pValue) { return Set(FbxString(pValue)); }
    /// The animated value at the time, over all layers of the scene's current stack; the static one at
    /// FBXSDK_TIME_INFINITE, outside of scenes and where nothing animates the property. Converts as Get does. The
    /// second argument has no effect.
    template <class T>
    [[nodiscard]] T EvaluateValue(const FbxTime& pTime = FBXSDK_TIME_INFINITE, bool = false) {
        T value{};
        evaluate(&value, FbxTypeOf(value), pTime);
        return value;
    }

    /// Sets or clears the bits; nothing happens to an invalid property.
    void ModifyFlag(FbxPropertyFlags::EFlags pFlag, bool pValue);
    /// Whether any of the bits is set; false for an invalid property.
    [[nodiscard]] bool GetFlag(FbxPropertyFlags::EFlags pFlag) const;

    /// The curve of the first component on one layer; see the last form.
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, bool pCreate = false);
    /// The curve of the component of that name ("X", "Y", "Z", also for colours; null: the first one) on one layer; see
    /// the last form.
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, const char* pChannel, bool pCreate = false);
    /// The curve of one component on one layer. With pCreate a missing curve node and curve are made; null for a null
    /// layer, an unknown component, a name that is not the property's, and where one would have to be created for a
    /// property that holds no number. The curve belongs to the manager.
    FbxAnimCurve* GetCurve(FbxAnimLayer* pAnimLayer, const char* pName, const char* pChannel, bool pCreate);
    /// The curve node on the first layer of the scene's current stack; null without a scene or a stack, and otherwise
    /// as for a layer.
    FbxAnimCurveNode* GetCurveNode(bool pCreate = false);
    /// The curve node on the first layer of the stack; null without a layer, and otherwise as for a layer.
    FbxAnimCurveNode* GetCurveNode(FbxAnimStack* pAnimStack, bool pCreate = false);
    /// The curve node through which the layer animates the property; null when there is none. With pCreate it is
    /// created, except for properties that hold no number.
    FbxAnimCurveNode* GetCurveNode(FbxAnimLayer* pAnimLayer, bool pCreate = false);
    /// The layer's curve node, created when there is none; null for a null layer and a property that holds no number.
    FbxAnimCurveNode* CreateCurveNode(FbxAnimLayer* pAnimLayer);
    /// Whether a curve with keys animates the property on the layer (null: the first layer of the scene's current
    /// stack).
    [[nodiscard]] bool IsAnimated(FbxAnimLayer* pAnimLayer = nullptr) const;

    /// The compound, or the object's root property. The root property's children are those outside of compounds.
    [[nodiscard]] FbxProperty GetParent() const;
    [[nodiscard]] FbxProperty GetChild() const;   ///< The first property of the compound; invalid when there is none.
    [[nodiscard]] FbxProperty GetSibling() const; ///< The next property of the same compound; invalid after the last.
    /// The property of that name in the compound; invalid when there is none.
    [[nodiscard]] FbxProperty Find(const char* pName, bool pCaseSensitive = true) const;

    /// Makes the object a source of the property, as FbxObject::ConnectSrcObject does. False also for an invalid
    /// property.
    bool ConnectSrcObject(FbxObject* pObject);
    /// Makes the property a source of the object; false likewise.
    bool ConnectDstObject(FbxObject* pObject);
    /// Removes the connection from the object; false when there is none.
    bool DisconnectSrcObject(FbxObject* pObject);
    /// Makes the other property a source of this one; false likewise.
    bool ConnectSrcProperty(const FbxProperty& pProperty);
    /// Makes this property a source of the other one; false likewise.
    bool ConnectDstProperty(const FbxProperty& pProperty);
    /// Whether the object is a source of the property.
    [[nodiscard]] bool IsConnectedSrcObject(const FbxObject* pObject) const;
    /// How many objects are sources: curve nodes, textures, targets.
    [[nodiscard]] int GetSrcObjectCount() const;
    /// How many of them meet the criterion.
    [[nodiscard]] int GetSrcObjectCount(const FbxCriteria& pCriteria) const;
    /// The source object at that index in order of connection; null out of range.
    [[nodiscard]] FbxObject* GetSrcObject(int pIndex = 0) const;
    /// The source object at that index among those that meet the criterion; null out of range.
    [[nodiscard]] FbxObject* GetSrcObject(const FbxCriteria& pCriteria, int pIndex = 0) const;
    /// How many of the source objects are a T.
    template <class T>
    [[nodiscard]] int GetSrcObjectCount() const {
        return GetSrcObjectCount(FbxCriteria::ObjectType(T::ClassId));
    }
    /// The source object at that index among those that are a T; null out of range.
    template <class T>
    [[nodiscard]] T* GetSrcObject(int pIndex = 0) const {
        return static_cast<T*>(GetSrcObject(FbxCriteria::ObjectType(T::ClassId), pIndex));
    }
    [[nodiscard]] int GetDstObjectCount() const;                    ///< How many objects the property is a source of.
    [[nodiscard]] FbxObject* GetDstObject(int pIndex = 0) const;    ///< In order of connection; null out of range.
    [[nodiscard]] int GetSrcPropertyCount() const;                  ///< How many properties are sources of this one.
    [[nodiscard]] FbxProperty GetSrcProperty(int pIndex = 0) const; ///< In order of connection; invalid out of range.

    /// Whether both are handles to the same property; values are not compared.
    bool operator==(const FbxProperty& pOther) const { return mObject == pOther.mObject && mIndex == pOther.mIndex; }
    /// The opposite.
    bool operator!=(const FbxProperty& pOther) const { return !(*this == pOther); }

    /// The platform's own handle: the object and the index of the property in it (class rows first, dynamic ones
    /// after).
    FbxProperty(FbxObject* pObject, int pIndex) : mObject(pObject), mIndex(pIndex) {}
    /// The index in the object; negative for a root property and an invalid one.
    [[nodiscard]] int index() const { return mIndex; }

protected:
    /// Stores the static value in a variable of that type; the variable is unchanged where no conversion exists.
    void readValue(void* pValue, EFbxType pType) const;
    /// Sets the static value from a variable of that type; false where no conversion exists.
    bool writeValue(const void* pValue, EFbxType pType);
    /// Stores the animated value in a variable of that type.
    void evaluate(void* pValue, EFbxType pType, const FbxTime& pTime);

    FbxObject* mObject = nullptr; ///< The object; null when invalid.
    int mIndex = -1;              ///< The index of the property in the object.
};

/// A property of a class with a known type: the public members of nodes, cameras, lights, …
///
/// It reads and writes like a variable of that type. Assigning one to another copies the value.
template <class T>
class FbxPropertyT : public FbxProperty {
public:
    using ValueType = T; ///< The type in which the value is read and written.

    FbxPropertyT() = default;                    ///< An invalid property.
    FbxPropertyT(const FbxPropertyT&) = default; ///< Another handle to the same property.
    /// The same property with a known type, which is not checked: values convert.
    explicit FbxPropertyT(const FbxProperty& pProperty) : FbxProperty(pProperty) {}

    /// The static value; T() when it cannot be converted.
    [[nodiscard]] T Get() const { return FbxProperty::Get<T>(); }
    operator T() const { return Get(); } ///< The static value.
    /// Sets the static value; no effect where it cannot be converted.
    FbxPropertyT& Set(const T& pValue) {
        FbxProperty::Set(pValue);
        return *this;
    }
    FbxPropertyT& operator=(const T& pValue) { return Set(pValue); } ///< The same as Set.
    /// Copies the value, not the handle.
    FbxPropertyT& operator=(const FbxPropertyT& pOther) { return this == &pOther ? *this : Set(pOther.Get()); }
    /// The animated value at the time, as FbxProperty::EvaluateValue gives it.
    [[nodiscard]] T EvaluateValue(const FbxTime& pTime = FBXSDK_TIME_INFINITE, bool pForceEval = false) {
        return FbxProperty::EvaluateValue<T>(pTime, pForceEval);
    }

    /// Keeps the untyped forms visible: `light->LightType.Get<FbxEnum>()`.
    template <class Other>
    [[nodiscard]] Other Get() const {
        return FbxProperty::Get<Other>();
    }
};

FBXSDK_NAMESPACE_END
