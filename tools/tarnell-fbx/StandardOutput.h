// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Standard output that is never lost silently: when it cannot be written, work ends and the reason is reported.
#pragma once

#include <array>
#include <exception>
#include <ostream>
#include <streambuf>

namespace tool {

/// Thrown by failed output. Not a std::exception: it is not a fault of the file that is being read.
class OutputFailure {
public:
    explicit OutputFailure(int systemError) : mSystemError(systemError) {}
    [[nodiscard]] int systemError() const { return mSystemError; }
    /// The reader closed the pipe, as `head` does. No message is needed.
    [[nodiscard]] bool readerLeft() const;

private:
    int mSystemError;
};

/// For its lifetime, a stream writes to a file descriptor through it, and throws OutputFailure where that fails.
class CheckedOutput : public std::streambuf {
public:
    CheckedOutput(std::ostream& stream, int descriptor);
    ~CheckedOutput() override;
    CheckedOutput(const CheckedOutput&) = delete;
    CheckedOutput& operator=(const CheckedOutput&) = delete;

    /// Writes the rest. Throws OutputFailure.
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
