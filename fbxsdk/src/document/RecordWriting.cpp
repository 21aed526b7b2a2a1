// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Records with a few values of one kind.
#include "document/RecordWriting.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

template <class Values, class Put>
void writeValues(RecordSink& sink, std::string_view name, const Values& values, const Put& put) {
    sink.beginRecord(name);
    for (const auto& value : values)
        put(value);
    sink.endRecord();
}

} // namespace

void writeIntegers(RecordSink& sink, std::string_view name, std::initializer_list<std::int32_t> values) {
    writeValues(
        sink, name, values, [&](std::int32_t value) { sink.integer(value); });
}

void writeLongs(RecordSink& sink, std::string_view name, std::initializer_list<std::int64_t> values) {
    writeValues(
        sink, name, values, [&](std::int64_t value) { sink.longInteger(value); });
}

void writeReals(RecordSink& sink, std::string_view name, std::initializer_list<double> values) {
    writeValues(
        sink, name, values, [&](double value) { sink.real(value); });
}

void writeTexts(RecordSink& sink, std::string_view name, std::initializer_list<std::string_view> values) {
    writeValues(
        sink, name, values, [&](std::string_view value) { sink.text(value); });
}

void writeInteger(RecordSink& sink, std::string_view name, std::int32_t value) { writeIntegers(sink, name, {value}); }
void writeLong(RecordSink& sink, std::string_view name, std::int64_t value) { writeLongs(sink, name, {value}); }
void writeReal(RecordSink& sink, std::string_view name, double value) { writeReals(sink, name, {value}); }
void writeText(RecordSink& sink, std::string_view name, std::string_view value) { writeTexts(sink, name, {value}); }

void writeLetter(RecordSink& sink, std::string_view name, char value) {
    sink.beginRecord(name);
    sink.letter(value);
    sink.endRecord();
}

void writeEmpty(RecordSink& sink, std::string_view name) {
    sink.beginRecord(name);
    sink.endRecord();
}

} // namespace detail
FBXSDK_NAMESPACE_END
