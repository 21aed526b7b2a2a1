// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writes everything to a descriptor, or reports the reason.
#include "StandardOutput.h"

#include <cerrno>
#include <iostream>

#include <unistd.h>

namespace tool {

bool OutputFailure::readerLeft() const { return mSystemError == EPIPE; }

CheckedOutput::CheckedOutput(std::ostream& stream, int descriptor)
    : mStream(stream), mBefore(stream.rdbuf()), mExceptionsBefore(stream.exceptions()), mDescriptor(descriptor) {
    setp(mBuffer.data(), mBuffer.data() + mBuffer.size());
    mStream.rdbuf(this);
    // Standard error would flush the stream before it prints: on whatever thread that happens, and once more when
    // standard output has failed.
    std::cerr.tie(nullptr);
    // Exceptions of writing pass the stream only when the stream itself is set to throw.
    mStream.exceptions(std::ios::badbit);
}

CheckedOutput::~CheckedOutput() {
    mStream.exceptions(std::ios::goodbit);
    mStream.rdbuf(mBefore);
    mStream.clear();
    mStream.exceptions(mExceptionsBefore);
}

void CheckedOutput::finish() { writeAll(); }

CheckedOutput::int_type CheckedOutput::overflow(int_type character) {
    writeAll();
    if (!traits_type::eq_int_type(character, traits_type::eof())) {
        *pptr() = traits_type::to_char_type(character);
        pbump(1);
    }
    return traits_type::not_eof(character);
}

int CheckedOutput::sync() {
    writeAll();
    return 0;
}

void CheckedOutput::writeAll() {
    const char* next = pbase();
    while (next != pptr()) {
        const ssize_t written = write(mDescriptor, next, static_cast<std::size_t>(pptr() - next));
        if (written < 0 && errno == EINTR)
            continue;
        if (written < 0) {
            const int reason = errno;
            setp(mBuffer.data(), mBuffer.data() + mBuffer.size()); // it is lost: it must not be tried again
            throw OutputFailure(reason);
        }
        next += written;
    }
    setp(mBuffer.data(), mBuffer.data() + mBuffer.size());
}

} // namespace tool
