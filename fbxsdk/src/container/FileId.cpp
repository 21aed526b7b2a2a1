// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Both codes come from one chained exclusive-or over sixteen digits of the time. It reproduces the codes of every
// binary file that was examined, byte for byte.
#include "container/FileId.h"

#include <algorithm>
#include <ctime>
#include <initializer_list>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr FileCode kSeed{0x58, 0xAB, 0xA9, 0xF0, 0x6C, 0xA2, 0xD8, 0x3F,
                         0x4D, 0x47, 0x49, 0xA3, 0xB4, 0xB2, 0xE7, 0x3D};
constexpr FileCode kKey{0xE2, 0x4F, 0x7B, 0x5F, 0xCD, 0xE4, 0xC8, 0x6D, 0xDB, 0xD8, 0xFB, 0xD7, 0x40, 0x58, 0xC6, 0x78};

FileCode mixed(FileCode code, const FileCode& with) {
    std::uint8_t chain = 0x40;
    for (std::size_t i = 0; i < code.size(); ++i) {
        code[i] = static_cast<std::uint8_t>(code[i] ^ chain ^ with[i]);
        chain = code[i];
    }
    return code;
}

/// Second, month, hour, day, hundredths of a second, year, minute.
FileCode digitsOf(const CreationTime& time) {
    const struct {
        int number, digits;
    } kParts[] = {{time.second, 2},           {time.month, 2}, {time.hour, 2},  {time.day, 2},
                  {time.millisecond / 10, 2}, {time.year, 4},  {time.minute, 2}};
    FileCode digits{};
    std::size_t end = 0;
    for (const auto& part : kParts) {
        end += static_cast<std::size_t>(part.digits);
        int rest = part.number;
        for (std::size_t i = 1; i <= static_cast<std::size_t>(part.digits); ++i, rest /= 10)
            digits[end - i] = static_cast<std::uint8_t>('0' + rest % 10);
    }
    return digits;
}

/// Whole numbers with at least that many digits, each behind its separator.
struct TextPart {
    std::string_view separator;
    int number, digits;
};

std::string joined(std::initializer_list<TextPart> parts) {
    std::string text;
    for (const TextPart& part : parts) {
        const std::string number = std::to_string(part.number);
        const auto digits = static_cast<std::size_t>(part.digits);
        text += part.separator;
        text.append(digits - std::min(digits, number.size()), '0');
        text += number;
    }
    return text;
}

using Breakdown = std::tm* (*)(const std::time_t*, std::tm*);

CreationTime brokenDown(std::chrono::system_clock::time_point moment, Breakdown breakdown) {
    const auto whole = std::chrono::floor<std::chrono::seconds>(moment);
    const std::time_t seconds = std::chrono::system_clock::to_time_t(whole);
    const auto rest = std::chrono::duration_cast<std::chrono::milliseconds>(moment - whole);
    std::tm parts{};
    if (breakdown(&seconds, &parts) == nullptr)
        return {};
    // A leap second would need its own digit pair in the codes; files never have one.
    return {std::clamp(parts.tm_year, -1900, 9999 - 1900) + 1900,
            parts.tm_mon + 1,
            parts.tm_mday,
            parts.tm_hour,
            parts.tm_min,
            std::min(parts.tm_sec, 59),
            static_cast<int>(rest.count())};
}

} // namespace

std::string CreationTime::text() const {
    return joined({{"", year, 4},
                   {"-", month, 2},
                   {"-", day, 2},
                   {" ", hour, 2},
                   {":", minute, 2},
                   {":", second, 2},
                   {":", millisecond, 3}});
}

std::string CreationTime::dayFirstText() const {
    return joined({{"", day, 2},
                   {"/", month, 2},
                   {"/", year, 4},
                   {" ", hour, 2},
                   {":", minute, 2},
                   {":", second, 2},
                   {".", millisecond, 3}});
}

CreationTime utcTime(std::chrono::system_clock::time_point moment) { return brokenDown(moment, gmtime_r); }

CreationTime localTime(std::chrono::system_clock::time_point moment) { return brokenDown(moment, localtime_r); }

FileCode fileId(const CreationTime& time) { return mixed(kSeed, digitsOf(time)); }

FileCode footerCode(const CreationTime& time) { return mixed(mixed(fileId(time), kKey), digitsOf(time)); }

} // namespace detail
FBXSDK_NAMESPACE_END
