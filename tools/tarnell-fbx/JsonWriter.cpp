// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// JSON output.
#include "JsonWriter.h"

#include <algorithm>

#include <nlohmann/json.hpp>

namespace tool {

JsonWriter::~JsonWriter() {
    try {
        flush();
    } catch (const std::ios_base::failure&) { // the document is incomplete because of another error, or of this one
    }
}

namespace {

/// Whether nothing has to be escaped. Without leaving the loop early: so characters are compared several at a time.
bool isPlain(std::string_view text) {
    bool plain = true;
    for (const char c : text)
        plain &= c >= ' ' && c <= '~' && c != '"' && c != '\\';
    return plain;
}

/// With the quotes.
std::string escaped(std::string_view value) {
    // Names may contain anything; invalid UTF-8 becomes the replacement character.
    const std::string text =
        nlohmann::json(std::string(value)).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
    // JSON allows the last control character of ASCII and those of the upper half, but terminals interpret them.
    std::string escaped;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool isControl = text[i] == '\xC2' && static_cast<unsigned char>(text[i + 1]) < 0xA0;
        if (isControl) {
            const auto code = static_cast<unsigned char>(text[++i]);
            escaped += code < 0x90 ? "\\u008" : "\\u009";
            escaped += "0123456789abcdef"[code & 0xFU];
        } else if (text[i] == '\x7F') {
            escaped += "\\u007f";
        } else {
            escaped += text[i];
        }
    }
    return escaped;
}

} // namespace

JsonKey::JsonKey(std::string_view name, std::string_view before) : mQuoted(std::string(before) + escaped(name)) {}

void JsonWriter::text(std::string_view value) {
    if (!isPlain(value))
        return raw(escaped(value));
    separate();
    put('"');
    put(value);
    put('"');
    finishValue();
}

void JsonWriter::reals(float value, std::size_t count) {
    constexpr std::size_t kTogether = 512;
    if (count == 0)
        return;
    real(value);
    if (count == 1)
        return;
    std::string next = ","; // the size that each of the others adds
    if (mPretty)
        next += '\n' + std::string(2 * static_cast<std::size_t>(mDepth), ' ');
    char digits[kFloatRoom];
    if (std::isfinite(value))
        next.append(digits, writeShortest(digits, value));
    else
        next += "null";

    std::size_t left = count - 1;
    std::string block;
    for (std::size_t i = 0; i < std::min(left, kTogether); ++i)
        block += next;
    for (; left >= kTogether; left -= kTogether)
        put(block);
    put(std::string_view(block).substr(0, left * next.size()));
}

void JsonWriter::open(char bracket) {
    separate();
    put(bracket);
    ++mDepth;
    mIsFirst = true;
}

void JsonWriter::close(char bracket) {
    --mDepth;
    if (!mIsFirst)
        breakLine();
    put(bracket);
    mIsFirst = false; // what was closed is a value of the level above
    finishValue();
}

void JsonWriter::indent() {
    put('\n');
    for (int i = 0; i < mDepth; ++i)
        put("  ");
}

void JsonWriter::flush() {
    mOut.write(mBlock.get(), static_cast<std::streamsize>(mUsed));
    mUsed = 0;
    ++mFlushes;
}

} // namespace tool
