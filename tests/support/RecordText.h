// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A record tree as one line of text, so that a test can state all of its expectation at once:
//
//     Objects: 17, "Cube", 'T', [1 2 3] { Child: { } }
#pragma once

#include <charconv>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "container/Record.h"

/// A copy on the heap of exactly the right size, so that a sanitizer sees any read beyond it.
class ExactBytes {
public:
    explicit ExactBytes(std::string_view bytes) : mSize(bytes.size()), mBytes(new char[bytes.size()]) {
        bytes.copy(mBytes.get(), mSize);
    }
    [[nodiscard]] std::span<const char> span() const { return {mBytes.get(), mSize}; }

private:
    std::size_t mSize;
    std::unique_ptr<char[]> mBytes;
};

[[nodiscard]] inline std::string realText(double number) {
    char digits[32];
    const auto result = std::to_chars(std::begin(digits), std::end(digits), number);
    return {digits, result.ptr};
}

[[nodiscard]] inline std::string valueText(const fbxsdk::detail::Record& record, const fbxsdk::detail::Value& value) {
    using Type = fbxsdk::detail::Value::Type;
    const std::string text(value.toText());
    switch (value.type) {
    case Type::none:
        return "none";
    case Type::integer:
        return std::to_string(value.integer);
    case Type::real:
        return realText(value.real) + (value.real == static_cast<double>(value.toInteger()) ? ".0" : "");
    case Type::text:
        return '"' + text + '"';
    case Type::raw:
        return "raw(" + text + ")";
    case Type::word:
        return '\'' + text + '\'';
    case Type::array:
        break;
    }
    std::vector<double> numbers(record.numberCount());
    if (!record.readNumbers(std::span(numbers)))
        return "[corrupt]";
    std::string result = "[";
    for (const double number : numbers)
        result += (result.size() > 1 ? " " : "") + realText(number);
    return result + "]";
}

[[nodiscard]] inline std::string recordsText(const fbxsdk::detail::Record& parent) {
    std::string result;
    for (const fbxsdk::detail::Record& record : parent.children()) {
        result += result.empty() ? "" : " ";
        result += std::string(record.name) + ":";
        for (const fbxsdk::detail::Value& value : record.values)
            result += (&value == record.values.data() ? " " : ", ") + valueText(record, value);
        if (record.hasBlock) {
            const std::string block = recordsText(record);
            result += block.empty() ? " { }" : " { " + block + " }";
        }
    }
    return result;
}

/// The records of a file's bytes, or the reason why there are none.
[[nodiscard]] inline std::string readText(std::string_view bytes) {
    const ExactBytes exact(bytes);
    fbxsdk::FbxStatus status;
    const auto tree = fbxsdk::detail::readRecords(exact.span(), "test.fbx", status);
    return tree ? recordsText(tree->root) : status.GetErrorString();
}
