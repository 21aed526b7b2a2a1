// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Streaming JSON output: no tree is built, so a mesh of millions of points takes no memory.
#pragma once

#include <charconv>
#include <cmath>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

namespace tool {

/// Writes one JSON document. Calls must nest properly: a value in an object follows a key. What was written has reached
/// the stream when the outermost value ends.
class JsonWriter {
public:
    JsonWriter(std::ostream& out, bool pretty) : mOut(out), mPretty(pretty) {}
    JsonWriter(const JsonWriter&) = delete;
    JsonWriter& operator=(const JsonWriter&) = delete;
    ~JsonWriter(); ///< An incomplete document reaches the stream as far as it goes.

    void beginObject() { open('{'); }
    void endObject() { close('}'); }
    void beginArray() { open('['); }
    void endArray() { close(']'); }

    void key(std::string_view name);
    void text(std::string_view value);
    void null() { raw("null"); }
    void boolean(bool value) { raw(value ? "true" : "false"); }
    void integer(long long value) { number(value); }
    /// A number that is already formatted; null for what is no JSON number (NaN and infinities).
    void digits(std::string_view spelling) { raw(spelling.find_first_of("in") == spelling.npos ? spelling : "null"); }
    void natural(unsigned long long value) { number(value); }
    /// Shortest digits that read back as the same number; null for NaN and infinities.
    void real(float value) { finite(value); }
    void real(double value) { finite(value); }
    /// The same value that many times, as elements of an array.
    void reals(float value, std::size_t count);

    // A key and its value.
    void text(std::string_view name, std::string_view value) { key(name), text(value); }
    void integer(std::string_view name, long long value) { key(name), integer(value); }
    void boolean(std::string_view name, bool value) { key(name), boolean(value); }
    void real(std::string_view name, double value) { key(name), real(value); }

private:
    void open(char bracket);
    void close(char bracket);
    /// The comma or line break before the next value.
    void separate();
    void raw(std::string_view characters) {
        separate();
        put(characters);
        if (mLevels.empty())
            flush();
    }
    /// To the stream in blocks: an insertion of its own for each number takes longer than formatting it.
    void put(std::string_view characters) {
        constexpr std::size_t kBlockSize = std::size_t{1} << 16;
        mBlock += characters;
        if (mBlock.size() >= kBlockSize)
            flush();
    }
    void flush();
    template <class Real>
    void finite(Real value) {
        if (std::isfinite(value))
            number(value);
        else
            null();
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
    std::string mBlock; ///< that is not in the stream yet
    bool mPretty;
    bool mAfterKey = false;
    std::vector<Level> mLevels;
};

} // namespace tool
