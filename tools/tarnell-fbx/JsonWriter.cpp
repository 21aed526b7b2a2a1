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

void JsonWriter::key(std::string_view name) {
    text(name);
    put(mPretty ? ": " : ":");
    mAfterKey = true;
}

void JsonWriter::text(std::string_view value) {
    const auto isPlain = [](char c) { return c >= ' ' && c <= '~' && c != '"' && c != '\\'; };
    if (std::all_of(value.begin(), value.end(), isPlain)) {
        separate();
        put("\"");
        put(value);
        put("\"");
        if (mLevels.empty())
            flush();
        return;
    }
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
    raw(escaped);
}

void JsonWriter::reals(float value, std::size_t count) {
    constexpr std::size_t kTogether = 512;
    if (count == 0)
        return;
    real(value);
    std::string next = ","; // the size that each of the others adds
    if (mPretty)
        next += '\n' + std::string(2 * mLevels.size(), ' ');
    char digits[32];
    const auto [end, error] = std::to_chars(digits, digits + sizeof digits, value);
    next += std::isfinite(value) ? std::string_view(digits, static_cast<std::size_t>(end - digits)) : "null";

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
    put({&bracket, 1});
    mLevels.emplace_back();
}

void JsonWriter::close(char bracket) {
    const bool wasEmpty = mLevels.back().empty;
    mLevels.pop_back();
    if (!wasEmpty)
        breakLine();
    put({&bracket, 1});
    if (mLevels.empty())
        flush();
}

void JsonWriter::separate() {
    if (mAfterKey || mLevels.empty()) {
        mAfterKey = false;
        return;
    }
    if (!mLevels.back().empty)
        put(",");
    mLevels.back().empty = false;
    breakLine();
}

void JsonWriter::breakLine() {
    if (!mPretty)
        return;
    put("\n");
    for (std::size_t i = 0; i < mLevels.size(); ++i)
        put("  ");
}

void JsonWriter::flush() {
    mOut.write(mBlock.data(), static_cast<std::streamsize>(mBlock.size()));
    mBlock.clear();
}

} // namespace tool
