// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Any bytes give a record tree or a reason. Every number of a tree can be read in every type, twice with the same
// result, and only a compressed array may turn out to be corrupt: all else was checked when the file was read.
#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "container/Record.h"

using namespace fbxsdk::detail;

namespace {

/// More would only take time.
constexpr std::size_t kNumbersRead = 1 << 16;

void require(bool holds, const char* what) {
    if (!holds) {
        std::fprintf(stderr, "broken: %s\n", what);
        std::abort();
    }
}

bool mayBeCorrupt(const Record& record) {
    const auto isCompressed = [](const Value& value) {
        return value.type == Value::Type::array && value.array->compressed;
    };
    return std::any_of(record.values.begin(), record.values.end(), isCompressed);
}

bool read(const Record& record, std::span<std::uint32_t> destination) { return record.readFloatBits(destination); }

template <class Number>
bool read(const Record& record, std::span<Number> destination) {
    return record.readNumbers(destination);
}

template <class Number>
void readTwice(const Record& record) {
    const std::size_t count = std::min(record.numberCount(), kNumbersRead);
    std::vector<Number> first(count, Number{1});
    std::vector<Number> second(count, Number{2});

    const bool sound = read(record, std::span<Number>(first));

    require(read(record, std::span<Number>(second)) == sound, "an array is corrupt only sometimes");
    require(sound || mayBeCorrupt(record), "an array that is not compressed is corrupt");
    require(count == 0 || std::memcmp(first.data(), second.data(), count * sizeof(Number)) == 0,
            "an array reads differently the second time");
}

void visit(const Record& record, std::string& transcript) {
    transcript += record.name;
    for (const Value& value : record.values) {
        transcript += std::to_string(static_cast<int>(value.type)) + '/' + std::to_string(value.toInteger()) + '/' +
                      value.toLetter() + std::string(value.toText());
    }
    readTwice<double>(record);
    readTwice<float>(record);
    readTwice<std::int32_t>(record);
    readTwice<std::int64_t>(record);
    readTwice<std::uint32_t>(record);
    transcript += '{';
    for (const Record& child : record.children())
        visit(child, transcript);
    transcript += '}';
}

std::string transcriptOf(std::span<const char> bytes) {
    fbxsdk::FbxStatus status;
    const auto tree = readRecords(bytes, "fuzz.fbx", status);
    require(status.Error() == (tree == nullptr), "status and result disagree");
    if (!tree)
        return status.GetErrorString();
    std::string transcript = std::to_string(tree->version);
    visit(tree->root, transcript);
    return transcript;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const std::span text(static_cast<const char*>(static_cast<const void*>(bytes)), size);
    require(transcriptOf(text) == transcriptOf(text), "the same bytes give two trees");
    return 0;
}
