// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Terminal.h"

#include <algorithm>
#include <charconv>
#include <cstdlib>

#include <sys/ioctl.h>
#include <unistd.h>

#include "TerminalText.h"
#include "Utf8.h"

namespace tool {
namespace {

constexpr std::size_t kNarrowest = 40;

const char* escapeOf(Ink ink) {
    switch (ink) {
    case Ink::plain:
        return "";
    case Ink::heading:
        return "\x1b[1m";
    case Ink::name:
        return "\x1b[36m";
    case Ink::number:
        return "\x1b[33m";
    case Ink::faint:
        return "\x1b[2m";
    case Ink::warning:
        return "\x1b[31m";
    }
    return "";
}

std::string_view environment(const char* name) {
    const char* const value = std::getenv(name);
    return value ? value : "";
}

std::size_t stated(std::string_view text) {
    std::size_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && end == text.data() + text.size() ? number : 0;
}

std::size_t widthOf(bool isShown) {
    std::size_t width = stated(environment("COLUMNS"));
    winsize size{};
    if (width == 0 && isShown && ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0)
        width = size.ws_col;
    return width == 0 ? 0 : std::max(width, kNarrowest);
}

} // namespace

std::string Terminal::paint(Ink ink, std::string_view text) const {
    if (!colour || ink == Ink::plain || text.empty())
        return std::string(text);
    return std::string(escapeOf(ink)) + std::string(text) + "\x1b[0m";
}

std::string Terminal::fit(std::string_view text, std::size_t taken) const {
    if (width == 0)
        return std::string(text);
    return fitted(text, taken < width ? width - taken : 0);
}

Terminal standardTerminal() {
    const bool isShown = isTerminal(stdout);
    return {isShown && environment("NO_COLOR").empty() && environment("TERM") != "dumb", widthOf(isShown)};
}

} // namespace tool
