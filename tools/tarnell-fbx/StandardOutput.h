// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Standard output that is never lost silently: when it cannot be written, work ends and somebody hears why.
#pragma once

#include <array>
#include <exception>
#include <ostream>
#include <streambuf>

namespace tool {

/// Thrown out of whatever was printing. No std::exception: it is no fault of the file that is being read.
class OutputFailure {
public:
    explicit OutputFailure(int systemError) : mSystemError(systemError) {}
    [[nodiscard]] int systemError() const { return mSystemError; }
    /// The reader left, as `head` does when it has seen enough. Nobody needs to hear of it.
    [[nodiscard]] bool readerLeft() const;

private:
    int mSystemError;
};

/// While it lives, a stream writes to a file descriptor through it, and throws OutputFailure where that fails.
class CheckedOutput : public std::streambuf {
public:
    CheckedOutput(std::ostream& stream, int descriptor);
    ~CheckedOutput() override;
    CheckedOutput(const CheckedOutput&) = delete;
    CheckedOutput& operator=(const CheckedOutput&) = delete;

    /// Writes what is left. Throws OutputFailure.
    void finish();

protected:
    int_type overflow(int_type character) override;
    int sync() override;

private:
    void writeAll();

    std::ostream& mStream;
    std::streambuf* mBefore;
    std::ios::iostate mExceptionsBefore;
    int mDescriptor;
    std::array<char, std::size_t{1} << 16U> mBuffer;
};

} // namespace tool
