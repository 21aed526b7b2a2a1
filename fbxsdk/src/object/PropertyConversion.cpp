// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversions between a property's value and a caller's variable.
//
//   numbers among each other   by value: reals are truncated toward zero, values out of range become the end of the
//                              range, NaN becomes 0; as bool everything but 0 and NaN is true
//   vectors and numbers        by components: a number is the first one; missing components stay unchanged
//   times                      with whole numbers, as ticks
//   text                       with text only
#include "object/PropertyConversion.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxTime.h>

#include "schema/PropertyTypes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Holds every whole number of every type.
__extension__ typedef __int128 Wide;

enum class Family { none, whole, real, vector, text, time };

Family familyOf(EFbxType type) {
    switch (type) {
    case eFbxChar:
    case eFbxUChar:
    case eFbxShort:
    case eFbxUShort:
    case eFbxUInt:
    case eFbxLongLong:
    case eFbxULongLong:
    case eFbxBool:
    case eFbxInt:
    case eFbxEnum:
    case eFbxEnumM:
        return Family::whole;
    case eFbxHalfFloat:
    case eFbxFloat:
    case eFbxDouble:
    case eFbxDistance:
        return Family::real;
    case eFbxDouble2:
    case eFbxDouble3:
    case eFbxDouble4:
        return Family::vector;
    case eFbxString:
    case eFbxDateTime:
        return Family::text;
    case eFbxTime:
        return Family::time;
    case eFbxUndefined:
    case eFbxDouble4x4:
    case eFbxReference:
    case eFbxBlob:
    case eFbxTypeCount:
        return Family::none;
    }
    return Family::none; // a number that is no type
}

/// Calls with a value of the C++ type of a type of whole numbers.
template <class Use>
void withWholeType(EFbxType type, const Use& use) {
    switch (type) {
    case eFbxChar:
        use(FbxChar{});
        break;
    case eFbxUChar:
        use(FbxUChar{});
        break;
    case eFbxShort:
        use(FbxShort{});
        break;
    case eFbxUShort:
        use(FbxUShort{});
        break;
    case eFbxUInt:
        use(FbxUInt{});
        break;
    case eFbxLongLong:
        use(FbxLongLong{});
        break;
    case eFbxULongLong:
        use(FbxULongLong{});
        break;
    case eFbxBool:
        use(FbxBool{});
        break;
    default:
        use(FbxInt{});
        break; // int and enumerations
    }
}

Wide toWide(double number) {
    constexpr double kFar = 18446744073709551616.0; // 2⁶⁴: beyond every type
    return std::isnan(number) ? 0 : static_cast<Wide>(std::clamp(number, -kFar, kFar));
}

template <class Integer>
Integer nearest(Wide number) {
    if constexpr (std::is_same_v<Integer, bool>) {
        return number != 0;
    } else {
        using Limits = std::numeric_limits<Integer>;
        return static_cast<Integer>(std::clamp<Wide>(number, Limits::min(), Limits::max()));
    }
}

template <class Integer>
Integer nearest(double number) {
    if constexpr (std::is_same_v<Integer, bool>)
        return number != 0.0 && !std::isnan(number);
    else
        return nearest<Integer>(toWide(number));
}

/// Stores a number, whole or real, in a caller's variable of a type of whole numbers.
template <class Number>
void storeWhole(Number number, void* target, EFbxType type) {
    withWholeType(
        type,
        [&](auto sample) {
            using Integer = decltype(sample);
            *static_cast<Integer*>(target) = nearest<Integer>(number);
        });
}

Wide loadWhole(const void* source, EFbxType type) {
    Wide number = 0;
    withWholeType(type, [&](auto sample) { number = *static_cast<const decltype(sample)*>(source); });
    return number;
}

/// The bits under which a property of the type keeps the number.
template <class Number>
std::int64_t keptBits(Number number, EFbxType type) {
    std::int64_t bits = 0;
    withWholeType(type, [&](auto sample) { bits = static_cast<std::int64_t>(nearest<decltype(sample)>(number)); });
    return bits;
}

Wide keptWhole(const PropertyValue& value, EFbxType type) {
    return type == eFbxULongLong ? Wide{static_cast<std::uint64_t>(value.integer)} : Wide{value.integer};
}

void storeReal(double number, void* target, EFbxType type) {
    if (type == eFbxFloat)
        *static_cast<float*>(target) = static_cast<float>(number);
    else
        *static_cast<double*>(target) = number;
}

/// Stores the first `count` numbers in a caller's variable of numbers.
bool storeNumbers(const double* numbers, std::size_t count, void* target, EFbxType type) {
    switch (familyOf(type)) {
    case Family::whole:
        storeWhole(numbers[0], target, type);
        return true;
    case Family::real:
        storeReal(numbers[0], target, type);
        return true;
    case Family::vector:
        std::copy_n(numbers, std::min(count, componentCount(type)), static_cast<double*>(target));
        return true;
    default:
        return false;
    }
}

/// A property of single precision keeps no more precision than that.
double keptReal(double number, EFbxType type) {
    return type == eFbxFloat || type == eFbxHalfFloat ? double{static_cast<float>(number)} : number;
}

bool writeText(PropertyValue& value, const void* source) {
    const auto& text = *static_cast<const FbxString*>(source);
    value.text.assign(text.Buffer(), text.GetLen());
    return true;
}

bool writeWhole(PropertyValue& value, EFbxType to, Wide number) {
    switch (familyOf(to)) {
    case Family::whole:
        value.integer = keptBits(number, to);
        return true;
    case Family::time:
        value.integer = nearest<std::int64_t>(number);
        return true;
    case Family::real:
    case Family::vector:
        value.numbers[0] = keptReal(static_cast<double>(number), to);
        return true;
    default:
        return false;
    }
}

bool writeNumbers(PropertyValue& value, EFbxType to, const double* numbers, std::size_t count) {
    switch (familyOf(to)) {
    case Family::whole:
        value.integer = keptBits(numbers[0], to);
        return true;
    case Family::real:
        value.numbers[0] = keptReal(numbers[0], to);
        return true;
    case Family::vector:
        std::copy_n(numbers, std::min(count, componentCount(to)), value.numbers.data());
        return true;
    default:
        return false;
    }
}

bool writeTime(PropertyValue& value, EFbxType to, const FbxTime& time) {
    const Family kept = familyOf(to);
    return (kept == Family::time || kept == Family::whole) && writeWhole(value, to, time.Get());
}

} // namespace

bool convertNumbers(const std::array<double, 4>& numbers, void* target, EFbxType type) {
    return storeNumbers(numbers.data(), numbers.size(), target, type);
}

bool readPropertyValue(const PropertyValue& value, EFbxType from, void* target, EFbxType type) {
    const Family wanted = familyOf(type);
    switch (familyOf(from)) {
    case Family::text:
        if (wanted != Family::text)
            return false;
        *static_cast<FbxString*>(target) = FbxString(value.text.data(), value.text.size());
        return true;
    case Family::time:
        if (wanted == Family::whole)
            storeWhole(Wide{value.integer}, target, type);
        if (wanted == Family::time)
            *static_cast<FbxTime*>(target) = FbxTime(value.integer);
        return wanted == Family::whole || wanted == Family::time;
    case Family::whole: {
        const Wide number = keptWhole(value, from);
        const auto real = static_cast<double>(number);
        if (wanted == Family::time)
            *static_cast<FbxTime*>(target) = FbxTime(nearest<FbxLongLong>(number));
        if (wanted == Family::whole)
            storeWhole(number, target, type);
        return wanted == Family::time || wanted == Family::whole || storeNumbers(&real, 1, target, type);
    }
    case Family::real:
    case Family::vector:
        return storeNumbers(value.numbers.data(), componentCount(from), target, type);
    case Family::none:
        return false;
    }
    return false;
}

bool isWritable(EFbxType to, EFbxType type) {
    const Family kept = familyOf(to), given = familyOf(type);
    if (kept == Family::none || given == Family::none)
        return false;
    const bool isText = given == Family::text, isTime = given == Family::time;
    if (kept == Family::text || isText)
        return kept == given;
    return isTime ? kept == Family::time || kept == Family::whole : kept != Family::time || given == Family::whole;
}

bool writePropertyValue(PropertyValue& value, EFbxType to, const void* source, EFbxType type) {
    switch (familyOf(type)) {
    case Family::text:
        return familyOf(to) == Family::text && writeText(value, source);
    case Family::time:
        return writeTime(value, to, *static_cast<const FbxTime*>(source));
    case Family::whole:
        return writeWhole(value, to, loadWhole(source, type));
    case Family::real: {
        const double number =
            type == eFbxFloat ? double{*static_cast<const float*>(source)} : *static_cast<const double*>(source);
        return writeNumbers(value, to, &number, 1);
    }
    case Family::vector:
        return writeNumbers(value, to, static_cast<const double*>(source), componentCount(type));
    case Family::none:
        return false;
    }
    return false;
}

} // namespace detail
FBXSDK_NAMESPACE_END
