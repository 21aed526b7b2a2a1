// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A minimal writer of FBX 7.4 records for benchmark inputs, binary or ASCII. It is independent of the library, so that
// no error of the library's own writer can make its inputs easy to read.
#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>
#include <span>
#include <string>
#include <string_view>

namespace bench {

enum class Encoding { binaryRaw, binaryCompressed, ascii };

/// Records in the order of the file: begin, values, block if there are records inside, those, end.
class FbxEmitter {
public:
    virtual ~FbxEmitter() = default;

    virtual FbxEmitter& begin(std::string_view name) = 0;
    virtual FbxEmitter& integer(std::int32_t value) = 0;
    virtual FbxEmitter& id(std::int64_t value) = 0;
    virtual FbxEmitter& real(double value) = 0;
    virtual FbxEmitter& text(std::string_view value) = 0;
    /// An object's name; binary and ASCII files join name and class differently.
    virtual FbxEmitter& name(std::string_view value, std::string_view ofClass) = 0;
    virtual FbxEmitter& array(std::span<const double> values) = 0;
    virtual FbxEmitter& array(std::span<const float> values) = 0;
    virtual FbxEmitter& array(std::span<const std::int32_t> values) = 0;
    virtual FbxEmitter& array(std::span<const std::int64_t> values) = 0;
    virtual FbxEmitter& block() = 0;
    virtual void end() = 0;

    /// Writes the file; nothing may follow.
    virtual void save(const std::filesystem::path& path) = 0;
};

std::unique_ptr<FbxEmitter> makeEmitter(Encoding encoding);

} // namespace bench
