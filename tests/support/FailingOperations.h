// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Faults in the single operations of writing a file.
#pragma once

#include <cerrno>
#include <cstdint>
#include <span>
#include <string>

#include "container/FileOperations.h"

namespace support {

/// Fails at the operation of that number.
class FailingOperations final : public fbxsdk::detail::FileOperations {
public:
    explicit FailingOperations(int failAt) : mFailAt(failAt) {}

    int create(const std::string& path, unsigned permissions, int& file) override {
        return fails() ? EIO : FileOperations::create(path, permissions, file);
    }
    int write(int file, std::span<const char> bytes) override {
        return fails() ? ENOSPC : FileOperations::write(file, bytes);
    }
    int writeAt(int file, std::uint64_t offset, std::span<const char> bytes) override {
        return fails() ? EIO : FileOperations::writeAt(file, offset, bytes);
    }
    int flush(int file) override { return fails() ? EIO : FileOperations::flush(file); }
    int close(int file) override {
        const int error = FileOperations::close(file);
        return fails() ? EIO : error;
    }
    int rename(const std::string& from, const std::string& to) override {
        return fails() ? EACCES : FileOperations::rename(from, to);
    }
    int link(const std::string& file, const std::string& secondName) override {
        return fails() ? EIO : FileOperations::link(file, secondName);
    }
    int openExisting(const std::string& path, int& file) override {
        return fails() ? EACCES : FileOperations::openExisting(path, file);
    }
    int readAt(int file, std::uint64_t offset, std::span<char> bytes) override {
        return fails() ? EIO : FileOperations::readAt(file, offset, bytes);
    }
    [[nodiscard]] int calls() const { return mCalls; }

private:
    bool fails() { return mCalls++ == mFailAt; }

    int mFailAt;
    int mCalls = 0;
};

} // namespace support
