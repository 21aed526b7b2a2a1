// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Chunks of Maya cache data, read from files and written to strings.
#include "cache/MayaCacheData.h"

#include <algorithm>
#include <bit>
#include <cstdint>

#include "container/ByteOrder.h"
#include "container/FileBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr bool kSwap = needsSwap(/*bigEndian=*/true);

/// How the two layouts differ.
struct Layout {
    std::string_view groupTag;
    std::size_t headBytes;
    std::size_t alignment;
};
constexpr Layout kNarrow{"FOR4", 8, 4};
constexpr Layout kWide{"FOR8", 16, 8};

struct Chunk {
    std::string_view tag;
    std::span<const char> payload;
};

/// Reads the next chunk and advances. False at the end of the data and for a damaged chunk.
bool nextChunk(const Layout& layout, ReadAhead& ahead, std::span<const char>& rest, Chunk& chunk) {
    if (rest.size() < layout.headBytes)
        return false;
    ahead.need(rest.first(layout.headBytes));
    chunk.tag = std::string_view(rest.data(), 4);
    const std::uint64_t size = layout.alignment == 8 ? loadNumber<std::uint64_t>(rest.data() + 8, kSwap)
                                                     : loadNumber<std::uint32_t>(rest.data() + 4, kSwap);
    rest = rest.subspan(layout.headBytes);
    if (size > rest.size())
        return false;
    chunk.payload = rest.first(size);
    const std::uint64_t padded = (size + layout.alignment - 1) / layout.alignment * layout.alignment;
    rest = rest.subspan(std::min<std::uint64_t>(padded, rest.size()));
    return true;
}

/// The payload of a group begins with its type and is itself not padded.
bool nextGroup(const Layout& layout, ReadAhead& ahead, std::span<const char>& rest, std::string_view& type,
               std::span<const char>& content) {
    Chunk chunk;
    const std::span<const char> before = rest;
    if (!nextChunk(layout, ahead, rest, chunk) || chunk.tag != layout.groupTag || chunk.payload.size() < 4)
        return false;
    ahead.need(chunk.payload.first(4));
    rest = before.subspan(layout.headBytes + chunk.payload.size());
    type = std::string_view(chunk.payload.data(), 4);
    content = chunk.payload.subspan(4);
    return true;
}

struct DataTag {
    std::string_view tag;
    int components;
    bool doubles;
};
constexpr DataTag kDataTags[] = {
    {"DVCA", 3, true}, {"FVCA", 3, false}, {"DBLA", 1, true}, {"DBCA", 1, true}, {"FBCA", 1, false}};

const DataTag* dataTag(std::string_view tag) {
    const auto* found =
        std::find_if(std::begin(kDataTags), std::end(kDataTags), [&](const DataTag& row) { return row.tag == tag; });
    return found == std::end(kDataTags) ? nullptr : found;
}

bool onlyZeros(std::span<const char> bytes, ReadAhead& ahead) {
    constexpr std::size_t kPiece = std::size_t{1} << 16;
    for (; !bytes.empty(); bytes = bytes.subspan(std::min(kPiece, bytes.size()))) {
        const std::span<const char> piece = bytes.first(std::min(kPiece, bytes.size()));
        ahead.need(piece);
        if (!std::all_of(piece.begin(), piece.end(), [](char byte) { return byte == '\0'; }))
            return false;
    }
    return true;
}

std::string_view zeroTerminated(std::span<const char> bytes) {
    const std::string_view text(bytes.data(), bytes.size());
    return text.substr(0, text.find('\0'));
}

MayaCacheFrame parseFrame(const Layout& layout, ReadAhead& ahead, std::span<const char> content) {
    MayaCacheFrame frame;
    std::string_view channel;
    std::uint64_t elements = 0;
    Chunk chunk;
    while (nextChunk(layout, ahead, content, chunk)) {
        if (chunk.tag == "TIME" && chunk.payload.size() >= 4) {
            ahead.need(chunk.payload.first(4));
            frame.hasTime = true;
            frame.ticks = loadNumber<std::int32_t>(chunk.payload.data(), kSwap);
        } else if (chunk.tag == "CHNM") {
            ahead.need(chunk.payload);
            channel = zeroTerminated(chunk.payload);
        } else if (chunk.tag == "SIZE" && chunk.payload.size() >= 4) {
            ahead.need(chunk.payload.first(4));
            elements = loadNumber<std::uint32_t>(chunk.payload.data(), kSwap);
        } else if (const DataTag* data = dataTag(chunk.tag)) {
            const std::uint64_t elementBytes = static_cast<std::uint64_t>(data->components) * (data->doubles ? 8 : 4);
            // The size chunk is not trusted; the size of the data counts.
            const std::uint64_t count = std::min<std::uint64_t>(elements, chunk.payload.size() / elementBytes);
            frame.blocks.push_back({channel, count, data->components, data->doubles, chunk.payload});
        }
    }
    return frame;
}

void appendBig(std::string& bytes, std::uint64_t number, int size) {
    for (int shift = (size - 1) * 8; shift >= 0; shift -= 8)
        bytes.push_back(static_cast<char>(number >> shift & 0xFFU));
}

void appendChunk(std::string& bytes, const Layout& layout, std::string_view tag, std::string_view payload) {
    bytes += tag;
    if (layout.alignment == 8)
        bytes.append(4, '\0');
    appendBig(bytes, payload.size(), layout.alignment == 8 ? 8 : 4);
    bytes += payload;
    bytes.append((layout.alignment - payload.size() % layout.alignment) % layout.alignment, '\0');
}

std::string bigInteger(std::int32_t number) {
    std::string bytes;
    appendBig(bytes, static_cast<std::uint32_t>(number), 4);
    return bytes;
}

std::string group(const Layout& layout, std::string_view type, std::string_view chunks) {
    std::string bytes(layout.groupTag);
    if (layout.alignment == 8)
        bytes.append(4, '\0');
    appendBig(bytes, type.size() + chunks.size(), layout.alignment == 8 ? 8 : 4);
    bytes += type;
    bytes += chunks;
    return bytes;
}

std::string blockBytes(const MayaCacheWriteBlock& block) {
    std::string bytes;
    bytes.reserve(block.values.size() * (block.doubles ? 8 : 4));
    for (const double value : block.values)
        if (block.doubles)
            appendBig(bytes, std::bit_cast<std::uint64_t>(value), 8);
        else
            appendBig(bytes, std::bit_cast<std::uint32_t>(static_cast<float>(value)), 4);
    return bytes;
}

} // namespace

MayaCacheData parseMayaCacheData(std::span<const char> bytes, const FileBytes* file) {
    MayaCacheData data;
    ReadAhead ahead(bytes, file);
    ahead.need(bytes.first(std::min(bytes.size(), kWide.groupTag.size())));
    const bool wide = std::string_view(bytes.data(), bytes.size()).starts_with(kWide.groupTag);
    const Layout& layout = wide ? kWide : kNarrow;
    std::span<const char> rest = bytes;
    std::string_view type;
    std::span<const char> content;
    while (nextGroup(layout, ahead, rest, type, content)) {
        data.end = bytes.size() - rest.size();
        if (type == "MYCH")
            data.frames.push_back(parseFrame(layout, ahead, content));
    }
    if (onlyZeros(bytes.subspan(data.end), ahead))
        data.end = bytes.size();
    return data;
}

bool readMayaCacheBlock(const MayaCacheBlock& block, std::span<double> destination, const FileBytes* file) {
    if (block.componentCount != 3 || block.elementCount * 3 != destination.size())
        return false;
    const char* from = block.bytes.data();
    if (file) { // read to the end of the destination, then widened in place from the front
        const std::size_t size = destination.size() * (block.doubles ? 8 : 4);
        char* const to = reinterpret_cast<char*>(destination.data()) + destination.size_bytes() - size;
        file->read(block.bytes.first(size), to);
        from = to;
    }
    for (std::size_t i = 0; i < destination.size(); ++i) {
        destination[i] = block.doubles ? loadNumber<double>(from + i * 8, kSwap)
                                       : static_cast<double>(loadNumber<float>(from + i * 4, kSwap));
    }
    return true;
}

const char* mayaCacheSampleFault(bool wide, std::uint64_t pointCount, bool doubles) {
    // Some readers treat 32-bit sizes as signed.
    constexpr std::uint64_t kMost = INT32_MAX;
    // The chunks before the points, with the longest name there may be.
    constexpr std::uint64_t kOverhead = kMostMayaChannelName + 256;
    if (pointCount == 0)
        return "a sample has no points";
    if (pointCount > kMost)
        return "a sample has more points than Maya caches can store";
    if (!wide && pointCount * 3 * (doubles ? 8 : 4) + kOverhead > kMost)
        return "a sample exceeds the 2 GiB that caches with 32-bit sizes can store";
    return nullptr;
}

std::string mayaCacheHeader(bool wide, std::int32_t start, std::int32_t end) {
    const Layout& layout = wide ? kWide : kNarrow;
    std::string chunks;
    appendChunk(chunks, layout, "VRSN", std::string_view("0.1\0", 4));
    appendChunk(chunks, layout, "STIM", bigInteger(start));
    appendChunk(chunks, layout, "ETIM", bigInteger(end));
    return group(layout, "CACH", chunks);
}

std::string mayaCacheFrame(bool wide, const std::int32_t* ticks, std::span<const MayaCacheWriteBlock> blocks) {
    const Layout& layout = wide ? kWide : kNarrow;
    std::string chunks;
    if (ticks)
        appendChunk(chunks, layout, "TIME", bigInteger(*ticks));
    for (const MayaCacheWriteBlock& block : blocks) {
        appendChunk(chunks, layout, "CHNM", std::string(block.channel) + '\0');
        appendChunk(chunks, layout, "SIZE", bigInteger(static_cast<std::int32_t>(block.values.size() / 3)));
        appendChunk(chunks, layout, block.doubles ? "DVCA" : "FVCA", blockBytes(block));
    }
    return group(layout, "MYCH", chunks);
}

} // namespace detail
FBXSDK_NAMESPACE_END
