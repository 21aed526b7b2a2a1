// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Streaming JSON output: no tree is built, so a mesh of millions of points takes no memory.
#pragma once

#include <charconv>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <memory>
#include <ostream>
#include <string>
#include <string_view>

#include "FloatText.h"

namespace tool {

/// A key that is written many times: escaped once.
class JsonKey {
public:
    /// `before` is the text of other members in front of it, without line breaks and with a comma behind each.
    explicit JsonKey(std::string_view name, std::string_view before = {});

private:
    friend class JsonWriter;
    std::string mQuoted;
};

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

    void key(std::string_view name) {
        text(name);
        put(mPretty ? ": " : ":");
        mAfterKey = true;
    }
    void key(const JsonKey& name) {
        separate();
        put(name.mQuoted);
        put(mPretty ? ": " : ":");
        mAfterKey = true;
    }
    void text(std::string_view value);
    void null() { raw("null"); }
    [[nodiscard]] bool breaksLines() const { return mPretty; }
    void boolean(bool value) { raw(value ? "true" : "false"); }
    void integer(long long value) { number(value); }
    /// A number that is already formatted; null for what is no JSON number (NaN and infinities).
    void digits(std::string_view spelling) { raw(spelling.find_first_of("in") == spelling.npos ? spelling : "null"); }
    void natural(unsigned long long value) { number(value); }
    /// Shortest digits that read back as the same number; null for NaN and infinities.
    void real(float value) {
        if (std::isfinite(value))
            written([value](char* first) { return writeShortest(first, value); });
        else
            null();
    }
    void real(double value) {
        if (std::isfinite(value))
            number(value);
        else
            null();
    }
    /// The same value that many times, as elements of an array.
    void reals(float value, std::size_t count);

    /// Where something begins that may be repeated.
    struct Place {
        std::size_t flushes, used;
    };
    [[nodiscard]] Place place() const { return {mFlushes, mUsed}; }
    /// What was written from a place on; nothing when part of it has reached the stream. Valid until the next call.
    [[nodiscard]] std::string_view since(const Place& place) const {
        return place.flushes == mFlushes ? std::string_view(mBlock.get() + place.used, mUsed - place.used)
                                         : std::string_view();
    }
    /// Repeats a member where a whole object of the same kind has it too: behind as many others, at the same depth.
    void repeat(std::string_view member) {
        put(member);
        mIsFirst = false;
    }

    // A key and its value.
    void text(std::string_view name, std::string_view value) { key(name), text(value); }
    void integer(std::string_view name, long long value) { key(name), integer(value); }
    void boolean(std::string_view name, bool value) { key(name), boolean(value); }
    void real(std::string_view name, double value) { key(name), real(value); }

private:
    void open(char bracket);
    void close(char bracket);
    /// The comma or line break before the next value.
    void separate() {
        if (mAfterKey || mDepth == 0) {
            mAfterKey = false;
            return;
        }
        if (!mIsFirst)
            put(',');
        mIsFirst = false;
        breakLine();
    }
    void raw(std::string_view characters) {
        separate();
        put(characters);
        finishValue();
    }
    void finishValue() {
        if (mDepth == 0)
            flush();
    }
    /// To the stream in blocks: an insertion of its own for each number takes longer than formatting it.
    void put(std::string_view characters) {
        if (characters.size() > room(characters.size())) {
            mOut.write(characters.data(), static_cast<std::streamsize>(characters.size()));
            return;
        }
        std::memcpy(mBlock.get() + mUsed, characters.data(), characters.size());
        mUsed += characters.size();
    }
    void put(char character) {
        room(1);
        mBlock[mUsed++] = character;
    }
    /// Makes room for some characters, unless they are more than a block holds; returns how many fit.
    std::size_t room(std::size_t size) {
        if (size > kBlockSize - mUsed)
            flush();
        return kBlockSize - mUsed;
    }
    void flush();
    /// What `write` writes from a position on, which it returns the end of.
    template <class Write>
    void written(const Write& write) {
        separate();
        room(kFloatRoom);
        char* const first = mBlock.get() + mUsed;
        mUsed += static_cast<std::size_t>(write(first) - first);
        finishValue();
    }
    template <class Number>
    void number(Number value) {
        written([value](char* first) { return std::to_chars(first, first + kFloatRoom, value).ptr; });
    }
    void breakLine() {
        if (mPretty)
            indent();
    }
    void indent();

    static constexpr std::size_t kBlockSize = std::size_t{1} << 16;

    std::ostream& mOut;
    std::unique_ptr<char[]> mBlock{new char[kBlockSize]}; ///< whose first characters are not in the stream yet
    std::size_t mUsed = 0;
    std::size_t mFlushes = 0; ///< how often the block was emptied
    bool mPretty;
    bool mAfterKey = false;
    bool mIsFirst = true; ///< whether the next value is the first one of its object or array
    int mDepth = 0;       ///< of objects and arrays
};

} // namespace tool
