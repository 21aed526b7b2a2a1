// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scan over lists of numbers, which takes nearly all the time of reading an ASCII file.
#include "container/NumberRun.h"

#include <algorithm>
#include <atomic>
#include <cstring>
#include <string_view>
#include <utility>

#include <fbxsdk/extensions/Threads.h>

#include "container/NumberBlocks.h"
#include "container/NumberText.h"
#include "core/Parallel.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// The end of the number that starts here, the start itself when there is none. Where words count, any word is one.
const char* numberEnd(const char* text, const char* end, bool wordsCount) {
    const char* const plainEnd = plainNumberEnd(text, end);
    if (plainEnd != text && (plainEnd == end || chars::is(chars::delimiter, *plainEnd)))
        return plainEnd;
    const char* const after = tokenEnd(text, end);
    const std::string_view token(text, static_cast<std::size_t>(after - text));
    const bool isWord = !token.empty() && chars::is(chars::letter, token.front());
    return (isWord && wordsCount) || parseNonFinite(token) ? after : text;
}

/// Scanning or parsing this much text takes several times as long as starting a thread.
constexpr std::size_t kPieceBytes = std::size_t{1} << 18;

/// The numbers up to a given position; whether the run continues there.
struct PartialRun {
    NumberRun run;
    bool goesOn = false;
};

/// The position of the next number, given the one after a comma.
const char* behindComma(const char* text, const char* end) {
    return text != end && !chars::is(chars::digit, *text) && *text != '-' ? skipSeparators(text, end) : text;
}

/// Numbers that are looked at singly before whole blocks are tried (again): most lists are short.
constexpr std::uint64_t kSingleNumbers = 8;

/// Adds numbers as far as blocks of them go. The position of the next number.
const char* addBlocks(NumberRun& run, const char* text, const char* stop, const char* end) {
    const NumberBlocks numbers = skipNumberBlocks(text, stop);
    if (numbers.count == 0)
        return text;
    run.count += numbers.count;
    run.numbersEnd = numbers.lastComma;
    run.next = behindComma(numbers.lastComma + 1, end);
    run.afterComma = true;
    return run.next;
}

PartialRun scanUpTo(const char* stop, const char* text, const char* end, bool wordsCount) {
    NumberRun run{0, text, text, false};
    for (std::uint64_t single = 1; text < stop; ++single) {
        if (single % kSingleNumbers == 0)
            text = addBlocks(run, text, stop, end);
        if (text >= stop)
            break;
        const char* const after = numberEnd(text, end, wordsCount);
        const char* const next = after != end && *after == ',' ? after : skipBlanks(after, end);
        if (after == text || (next != end && *next == ':'))
            return {run, false}; // no number, or the name of the next record
        ++run.count;
        run.numbersEnd = after;
        run.next = next;
        run.afterComma = next != end && *next == ',';
        if (!run.afterComma)
            return {run, false};
        text = behindComma(next + 1, end);
        run.next = text;
    }
    return {run, true};
}

/// Positions after commas, at about equal distances: the starts of the pieces and the end of the last one.
std::vector<const char*> pieceStarts(const char* text, const char* end) {
    constexpr std::size_t kMostPieces = 256;
    std::vector<const char*> starts{text};
    while (starts.size() <= kMostPieces && static_cast<std::size_t>(end - starts.back()) > kPieceBytes) {
        const char* const from = starts.back() + kPieceBytes;
        const void* const comma = std::memchr(from, ',', static_cast<std::size_t>(end - from));
        if (comma == nullptr)
            break;
        starts.push_back(behindComma(static_cast<const char*>(comma) + 1, end));
    }
    return starts;
}

/// Adds the next piece; whether the run continues after it.
bool append(NumberRun& run, const PartialRun& piece) {
    run.next = piece.run.next;
    if (piece.run.count > 0) {
        run.count += piece.run.count;
        run.numbersEnd = piece.run.numbersEnd;
        run.afterComma = piece.run.afterComma;
    }
    return piece.goesOn;
}

/// Scans the pieces of a run. A piece counts only if the previous one ends exactly at its start: the comma may be part
/// of a comment, or of another list after the end of the run.
PartialRun scanPieces(const char* text, const char* end, bool wordsCount) {
    const std::vector<const char*> starts = pieceStarts(text, end);
    std::vector<PartialRun> pieces(starts.size() - 1);
    std::atomic<std::size_t> last{pieces.size()};
    forEachInParallel(pieces.size(), [&](std::size_t i) {
        if (i > last)
            return;
        pieces[i] = scanUpTo(starts[i + 1], starts[i], end, wordsCount);
        if (!pieces[i].goesOn || pieces[i].run.next != starts[i + 1]) {
            for (std::size_t before = last; i < before && !last.compare_exchange_weak(before, i);) {
            }
        }
    });
    PartialRun whole{{0, text, text, true}, true};
    for (std::size_t i = 0; i < pieces.size() && i <= last; ++i)
        whole.goesOn = append(whole.run, pieces[i]);
    return whole;
}

std::uint64_t countCommas(std::span<const char> text) {
    constexpr std::size_t kBlock = 128; // so that a byte can count them, sixteen at once
    std::uint64_t commas = 0;
    for (; text.size() >= kBlock; text = text.subspan(kBlock)) {
        std::uint8_t inBlock = 0;
        for (std::size_t i = 0; i < kBlock; ++i)
            inBlock = static_cast<std::uint8_t>(inBlock + (text[i] == ',' ? 1 : 0));
        commas += inBlock;
    }
    return commas + static_cast<std::uint64_t>(std::count(text.begin(), text.end(), ','));
}

} // namespace

NumberRun scanNumbers(const char* text, const char* end, bool wordsCount) {
    const bool isAlone = extensions::maximumThreads() == 1;
    const auto left = static_cast<std::size_t>(end - text);
    auto [run, goesOn] = scanUpTo(isAlone ? end : text + std::min(left, kPieceBytes), text, end, wordsCount);
    while (goesOn && run.next != end) {
        const char* const from = run.next;
        goesOn = append(run, scanPieces(from, end, wordsCount));
        if (goesOn && static_cast<std::size_t>(run.next - from) < kPieceBytes) { // nothing left to cut
            append(run, scanUpTo(end, run.next, end, wordsCount));
            return run;
        }
    }
    return run;
}

std::vector<NumberPiece> piecesOfRun(std::span<const char> run, std::uint64_t count) {
    if (extensions::maximumThreads() == 1 || run.size() < 2 * kPieceBytes)
        return {};
    std::vector<NumberPiece> pieces;
    const char* const end = run.data() + run.size();
    for (const char* text = run.data(); text != nullptr;) {
        pieces.push_back({text});
        const char* const from = text + std::min(kPieceBytes, static_cast<std::size_t>(end - text));
        const void* const comma = std::memchr(from, ',', static_cast<std::size_t>(end - from));
        text = comma != nullptr ? static_cast<const char*>(comma) + 1 : nullptr;
    }
    forEachInParallel(pieces.size(), [&](std::size_t i) {
        const char* const next = i + 1 < pieces.size() ? pieces[i + 1].text : end;
        pieces[i].count = countCommas({pieces[i].text, next});
    });
    ++pieces.back().count; // behind the last number there is none
    std::uint64_t numbers = 0;
    for (NumberPiece& piece : pieces)
        piece.first = std::exchange(numbers, numbers + piece.count);
    return numbers == count ? pieces : std::vector<NumberPiece>();
}

} // namespace detail
FBXSDK_NAMESPACE_END
