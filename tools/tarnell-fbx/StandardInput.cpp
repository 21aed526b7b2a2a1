// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A pipe can be read only once, while a command opens its file several times.
#include "StandardInput.h"

#include <array>
#include <cerrno>
#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <system_error>

#include <sys/mman.h>
#include <unistd.h>

namespace tool {
namespace {

constexpr const char* kSpoken = "standard input";
constexpr std::uint64_t kMostBytes = std::uint64_t{1} << 32U;

std::string& keptName() {
    static std::string name; // empty until standard input was read
    return name;
}

[[noreturn]] void fail(int error) {
    throw std::runtime_error(std::string(kSpoken) + ": cannot be read: " + std::generic_category().message(error));
}

/// Repeats a call interrupted by a signal.
template <class Call>
std::size_t transfer(const Call& call) {
    ssize_t count = -1;
    do {
        count = call();
    } while (count < 0 && errno == EINTR);
    if (count < 0)
        fail(errno);
    return static_cast<std::size_t>(count);
}

} // namespace

std::string keepStandardInput() {
    if (!keptName().empty())
        return keptName();
    const int file = ::memfd_create(kSpoken, MFD_CLOEXEC);
    if (file < 0)
        fail(errno);
    static std::array<char, std::size_t{1} << 16U> piece;
    std::uint64_t size = 0;
    while (const std::size_t count = transfer([] { return ::read(STDIN_FILENO, piece.data(), piece.size()); })) {
        size += count;
        if (size > kMostBytes)
            fail(EFBIG);
        for (std::size_t done = 0; done < count;)
            done += transfer([&] { return ::write(file, piece.data() + done, count - done); });
    }
    keptName() = "/proc/self/fd/" + std::to_string(file);
    return keptName();
}

std::string withoutKeptName(std::string text) {
    const std::string& name = keptName();
    for (std::size_t at = 0; !name.empty() && (at = text.find(name, at)) != std::string::npos;)
        text.replace(at, name.size(), kSpoken);
    return text;
}

} // namespace tool
