// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// JSON as it goes out: no tree is built, so a mesh of millions of points costs no memory.
#pragma once

#include <charconv>
#include <cmath>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

namespace tool {

/// Writes one JSON document. Calls must nest properly: a value in an object follows a key.
class JsonWriter {
public:
    JsonWriter(std::ostream& out, bool pretty) : mOut(out), mPretty(pretty) {}

    void beginObject() { open('{'); }
    void endObject() { close('}'); }
    void beginArray() { open('['); }
    void endArray() { close(']'); }

    void key(std::string_view name);
    void text(std::string_view value);
    void null() { raw("null"); }
    void integer(long long value) { number(value); }
    /// Shortest digits that read back as the same float; null for NaN and infinities.
    void real(float value);

private:
    void open(char bracket);
    void close(char bracket);
    /// The comma or line break that stands before the next value.
    void separate();
    void raw(std::string_view characters) {
        separate();
        mOut << characters;
    }
    template <class Number>
    void number(Number value) {
        char digits[32];
        const auto [end, error] = std::to_chars(digits, digits + sizeof digits, value);
        raw(std::string_view(digits, static_cast<std::size_t>(end - digits)));
    }
    void breakLine();

    struct Level {
        bool empty = true;
    };
    std::ostream& mOut;
    bool mPretty;
    bool mAfterKey = false;
    std::vector<Level> mLevels;
};

} // namespace tool
