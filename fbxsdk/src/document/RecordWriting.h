// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common records in one line each.
#pragma once

#include <exception>
#include <initializer_list>
#include <span>
#include <string_view>
#include <utility>
#include <vector>

#include "container/RecordSink.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void writeInteger(RecordSink& sink, std::string_view name, std::int32_t value);
void writeIntegers(RecordSink& sink, std::string_view name, std::initializer_list<std::int32_t> values);
void writeLong(RecordSink& sink, std::string_view name, std::int64_t value);
void writeLongs(RecordSink& sink, std::string_view name, std::initializer_list<std::int64_t> values);
void writeReal(RecordSink& sink, std::string_view name, double value);
void writeReals(RecordSink& sink, std::string_view name, std::initializer_list<double> values);
void writeText(RecordSink& sink, std::string_view name, std::string_view value);
void writeTexts(RecordSink& sink, std::string_view name, std::initializer_list<std::string_view> values);
void writeLetter(RecordSink& sink, std::string_view name, char value);
void writeEmpty(RecordSink& sink, std::string_view name);

template <class Number>
void writeArray(RecordSink& sink, std::string_view name, std::span<const Number> values) {
    sink.beginRecord(name);
    sink.array(values);
    sink.endRecord();
}

template <class Number>
void writeArray(RecordSink& sink, std::string_view name, std::vector<Number>&& values) {
    sink.beginRecord(name);
    sink.array(std::move(values));
    sink.endRecord();
}

/// A record with a block, open as long as the object exists. Ending it may need memory; a record that
/// is left by an exception is not ended, since the output is discarded.
class BlockScope {
public:
    BlockScope(RecordSink& sink, std::string_view name) : mSink(sink) {
        sink.beginRecord(name);
        sink.beginBlock();
    }
    BlockScope(RecordSink& sink, std::string_view name, std::int32_t value) : mSink(sink) {
        sink.beginRecord(name);
        sink.integer(value);
        sink.beginBlock();
    }
    BlockScope(RecordSink& sink, std::string_view name, std::string_view value) : mSink(sink) {
        sink.beginRecord(name);
        sink.text(value);
        sink.beginBlock();
    }
    BlockScope(const BlockScope&) = delete;
    BlockScope& operator=(const BlockScope&) = delete;
    ~BlockScope() noexcept(false) {
        if (std::uncaught_exceptions() == mExceptions)
            mSink.endRecord();
    }

private:
    RecordSink& mSink;
    int mExceptions = std::uncaught_exceptions();
};

} // namespace detail
FBXSDK_NAMESPACE_END
