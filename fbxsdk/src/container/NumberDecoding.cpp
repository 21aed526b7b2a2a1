// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Stored arrays become numbers: inflated, swapped, converted, or parsed from text.
#include "container/NumberDecoding.h"

#include <atomic>
#include <bit>
#include <charconv>
#include <cstring>
#include <memory>
#include <type_traits>
#include <vector>

#include "container/ByteOrder.h"
#include "container/FileBytes.h"
#include "container/NumberConversion.h"
#include "container/NumberRun.h"
#include "container/NumberText.h"
#include "container/PageMemory.h"
#include "container/ZlibStream.h"
#include "core/Parallel.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// The bits of a float are copied as bits, so that no NaN loses its payload.
template <class Source, class Number>
constexpr bool kSameBits = std::is_same_v<Source, Number> ||
                           (std::is_same_v<Source, float> && std::is_same_v<Number, std::uint32_t>);

/// Elements in the order of their addresses; the source may be the tail of the destination as long as it is not wider.
template <class Source, class Number>
void convertElements(const char* source, std::size_t stride, bool swap, std::span<Number> destination) {
    if constexpr (kSameBits<Source, Number>) {
        if (stride == sizeof(Source) && !swap) {
            if (static_cast<const void*>(source) != destination.data())
                std::memcpy(destination.data(), source, destination.size_bytes());
            return;
        }
        for (Number& number : destination) {
            number = loadNumber<Number>(source, swap);
            source += stride;
        }
    } else {
        for (Number& number : destination) {
            number = convertNumber<Number>(loadNumber<Source>(source, swap));
            source += stride;
        }
    }
}

template <class Number>
void convertBytes(const StoredArray& array, const char* source, std::span<Number> destination) {
    const bool swap = needsSwap(array.bigEndian);
    const std::size_t stride = array.stride != 0 ? array.stride : elementSize(array.element);
    switch (array.element) {
    case StoredArray::Element::int8:
        return convertElements<std::uint8_t>(source, stride, swap, destination);
    case StoredArray::Element::int32:
        return convertElements<std::int32_t>(source, stride, swap, destination);
    case StoredArray::Element::int64:
        return convertElements<std::int64_t>(source, stride, swap, destination);
    case StoredArray::Element::float32:
        return convertElements<float>(source, stride, swap, destination);
    case StoredArray::Element::float64:
        return convertElements<double>(source, stride, swap, destination);
    case StoredArray::Element::text:
        return; // arrays never have this type
    }
}

template <class Number>
constexpr StoredArray::Element kElementOf = StoredArray::Element::text; // none
template <>
constexpr StoredArray::Element kElementOf<double> = StoredArray::Element::float64;
template <>
constexpr StoredArray::Element kElementOf<float> = StoredArray::Element::float32;
template <>
constexpr StoredArray::Element kElementOf<std::uint32_t> = StoredArray::Element::float32;
template <>
constexpr StoredArray::Element kElementOf<std::int32_t> = StoredArray::Element::int32;
template <>
constexpr StoredArray::Element kElementOf<std::int64_t> = StoredArray::Element::int64;

/// Elements that a file has in the requested layout are read directly into the destination.
template <class Number>
bool readDirectly(const StoredArray& array, std::span<Number> destination) {
    if (array.file == nullptr || array.element != kElementOf<Number> || array.stride != 0 || needsSwap(array.bigEndian))
        return false;
    array.file->read(array.bytes.first(destination.size_bytes()),
                     static_cast<char*>(static_cast<void*>(destination.data())));
    return true;
}

template <class Number>
bool inflateArray(const StoredArray& array, std::span<const char> stream, std::span<Number> destination) {
    const std::size_t size = static_cast<std::size_t>(array.count) * elementSize(array.element);
    if (destination.size() == array.count && size <= destination.size_bytes()) {
        // The tail of the destination serves as the buffer: widening from front to back never overtakes what it reads.
        char* const tail = static_cast<char*>(static_cast<void*>(destination.data())) + destination.size_bytes() - size;
        if (!inflateExactly(stream, {tail, size}))
            return false;
        convertBytes(array, tail, destination);
        return true;
    }
    const auto buffer = std::make_unique_for_overwrite<char[]>(size);
    if (!inflateExactly(stream, {buffer.get(), size}))
        return false;
    convertBytes(array, buffer.get(), destination);
    return true;
}

bool isWhole(const char* token, const char* end) {
    return skipDigits(token + (*token == '-' || *token == '+' ? 1 : 0), end) == end;
}

/// A token that is no number means the code of its first letter, as one-letter codes do everywhere.
double letterCode(char letter) { return static_cast<unsigned char>(letter); }

template <class Number>
Number parseElement(const char* token, const char* end, bool bitPatterns) {
    const std::string_view text(token, static_cast<std::size_t>(end - token));
    if (bitPatterns && isWhole(token, end)) {
        const auto bits = static_cast<std::uint32_t>(parseInteger(text).value_or(0));
        if constexpr (std::is_same_v<Number, std::uint32_t>)
            return bits;
        else
            return convertNumber<Number>(std::bit_cast<float>(bits));
    }
    if constexpr (std::is_same_v<Number, float> || std::is_same_v<Number, std::uint32_t>) {
        // Not through a double: the nearest float of the nearest double may be the wrong one.
        if (const std::optional<float> number = parseFloat(text))
            return convertNumber<Number>(*number);
    } else if constexpr (std::is_integral_v<Number>) {
        if (const std::optional<std::int64_t> number = parseInteger(text))
            return convertNumber<Number>(*number);
    }
    return convertNumber<Number>(parseReal(text).value_or(letterCode(*token)));
}

/// The common case, a number that std::from_chars accepts, in one pass; everything else token by token.
template <class Number>
const char* parseFast(const char* text, const char* end, Number& number) {
    if constexpr (!std::is_same_v<Number, std::uint32_t>) {
        const auto result = std::from_chars(text, end, number);
        if (result.ec == std::errc() && (result.ptr == end || chars::is(chars::delimiter, *result.ptr)))
            return result.ptr;
    }
    return nullptr;
}

/// Skips what separates two values: in long lists only a comma.
inline const char* nextValue(const char* text, const char* end) {
    const bool commaAlone = end - text > 1 && text[0] == ',' && (chars::is(chars::digit, text[1]) || text[1] == '-');
    return commaAlone ? text + 1 : skipSeparators(text, end);
}

/// Numbers from the first one on.
template <class Number>
bool parseNumbers(const char* text, const char* end, bool bitPatterns, std::span<Number> destination) {
    for (Number& number : destination) {
        const char* next = bitPatterns ? nullptr : parseFast(text, end, number);
        if (next == nullptr) {
            next = tokenEnd(text, end);
            if (next == text)
                return false;
            number = parseElement<Number>(text, next, bitPatterns);
        }
        text = nextValue(next, end);
    }
    return true;
}

template <class Number>
bool parseText(const StoredArray& array, std::span<Number> destination) {
    const char* const end = array.bytes.data() + array.bytes.size();
    const std::vector<NumberPiece> pieces =
        destination.size() == array.count ? piecesOfRun(array.bytes, array.count) : std::vector<NumberPiece>();
    if (pieces.empty())
        return parseNumbers(array.bytes.data(), end, array.bitPatterns, destination);
    std::atomic<bool> sound{true};
    forEachInParallel(pieces.size(), [&](std::size_t i) {
        const NumberPiece& piece = pieces[i];
        if (!parseNumbers(skipSeparators(piece.text, end), end, array.bitPatterns,
                          destination.subspan(piece.first, piece.count)))
            sound = false;
    });
    return sound;
}

} // namespace

std::size_t elementSize(StoredArray::Element element) {
    switch (element) {
    case StoredArray::Element::int8:
    case StoredArray::Element::text:
        return 1;
    case StoredArray::Element::int32:
    case StoredArray::Element::float32:
        return 4;
    case StoredArray::Element::int64:
    case StoredArray::Element::float64:
        return 8;
    }
    return 1;
}

std::span<const char> payloadOf(const StoredArray& array, std::unique_ptr<char[]>& memory) {
    if (array.file == nullptr)
        return array.bytes;
    memory = std::make_unique_for_overwrite<char[]>(array.bytes.size());
    preferLargePages({memory.get(), array.bytes.size()});
    array.file->read(array.bytes, memory.get());
    return {memory.get(), array.bytes.size()};
}

template <class Number>
bool decodeArray(const StoredArray& array, std::span<Number> destination) {
    if (destination.empty())
        return true;
    if (array.element == StoredArray::Element::text)
        return parseText(array, destination);
    if (!array.compressed && readDirectly(array, destination))
        return true;
    std::unique_ptr<char[]> memory;
    const std::span<const char> payload = payloadOf(array, memory);
    if (array.compressed)
        return inflateArray(array, payload, destination);
    convertBytes(array, payload.data(), destination);
    return true;
}

template bool decodeArray(const StoredArray&, std::span<double>);
template bool decodeArray(const StoredArray&, std::span<float>);
template bool decodeArray(const StoredArray&, std::span<std::int32_t>);
template bool decodeArray(const StoredArray&, std::span<std::int64_t>);
template bool decodeArray(const StoredArray&, std::span<std::uint32_t>);

} // namespace detail
FBXSDK_NAMESPACE_END
