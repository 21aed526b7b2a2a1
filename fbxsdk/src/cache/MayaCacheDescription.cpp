// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cache descriptions by pugixml. Any order of attributes and unknown tags are accepted.
#include "cache/MayaCacheDescription.h"

#include <algorithm>
#include <charconv>
#include <cstring>
#include <new>
#include <system_error>
#include <utility>

#include <pugixml.hpp>

#include "container/FileBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr const char* kRootTag = "Autodesk_Cache_File";
/// A description has four levels; deeper nesting is refused, since the parser recurses.
constexpr int kMaximumDepth = 32;
/// Descriptions are a few kilobytes.
constexpr std::size_t kMaximumBytes = std::size_t{16} << 20U;

int toTicks(const char* text, int fallback) {
    int number = 0;
    const auto [end, error] = std::from_chars(text, text + std::strlen(text), number);
    return error == std::errc() ? number : fallback;
}

/// "250-7500"; either number may be negative.
void readRange(const char* text, MayaCacheDescription& description) {
    const std::string range(text);
    const std::size_t dash = range.size() > 1 ? range.find('-', 1) : std::string::npos;
    if (dash == std::string::npos)
        return;
    description.start = toTicks(range.substr(0, dash).c_str(), 0);
    description.end = toTicks(range.substr(dash + 1).c_str(), 0);
}

bool nestsTooDeeply(const pugi::xml_node& root) {
    struct DepthWalker : pugi::xml_tree_walker {
        bool for_each(pugi::xml_node&) override { return depth() < kMaximumDepth; }
    } walker;
    pugi::xml_node start = root;
    return !start.traverse(walker);
}

MayaCacheChannel readChannel(const pugi::xml_node& node, const MayaCacheDescription& description) {
    MayaCacheChannel channel;
    channel.name = node.attribute("ChannelName").as_string();
    channel.type = node.attribute("ChannelType").as_string("DoubleVectorArray");
    channel.interpretation = node.attribute("ChannelInterpretation").as_string("positions");
    channel.regular = std::strcmp(node.attribute("SamplingType").as_string("Regular"), "Irregular") != 0;
    channel.samplingRate = toTicks(node.attribute("SamplingRate").as_string(), description.ticksPerFrame);
    channel.start = toTicks(node.attribute("StartTime").as_string(), description.start);
    channel.end = toTicks(node.attribute("EndTime").as_string(), description.end);
    return channel;
}

bool isChannelTag(const char* name) {
    constexpr const char* kPrefix = "channel";
    const std::size_t length = std::strlen(kPrefix);
    return std::strncmp(name, kPrefix, length) == 0 && name[length] >= '0' && name[length] <= '9';
}

// pugixml allocates by itself, and silently omits nodes when an allocation fails.

pugi::xml_node append(pugi::xml_node parent, pugi::xml_node_type type, const char* name) {
    pugi::xml_node node = parent.append_child(type);
    if (!node || !node.set_name(name))
        throw std::bad_alloc();
    return node;
}

template <class Value>
void set(pugi::xml_node node, const char* name, Value value) {
    pugi::xml_attribute attribute = node.append_attribute(name);
    if (!attribute || std::strcmp(attribute.name(), name) != 0 || !attribute.set_value(value))
        throw std::bad_alloc();
}

struct TextWriter : pugi::xml_writer {
    void write(const void* data, std::size_t size) override { text.append(static_cast<const char*>(data), size); }
    std::string text;
};

} // namespace

bool readMayaCacheDescription(const std::string& fileName, MayaCacheDescription& description, FbxStatus& status) {
    const auto file = FileBytes::open(fileName, status);
    if (!file)
        return false;
    if (file->bytes().size() > kMaximumBytes) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: the cache description is too large: %zu bytes", fileName.c_str(),
                       file->bytes().size());
        return false;
    }
    file->fetch(file->bytes());
    file->requireUnchanged();
    pugi::xml_document document;
    const pugi::xml_parse_result parsed = document.load_buffer(file->bytes().data(), file->bytes().size());
    if (parsed.status == pugi::status_out_of_memory)
        throw std::bad_alloc();
    if (!parsed) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: offset %td: %s", fileName.c_str(), parsed.offset,
                       parsed.description());
        return false;
    }
    const pugi::xml_node root = document.child(kRootTag);
    if (!root || nestsTooDeeply(root)) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: not a cache description", fileName.c_str());
        return false;
    }
    const pugi::xml_node type = root.child("cacheType");
    description = {};
    description.oneFile = std::strcmp(type.attribute("Type").as_string("OneFile"), "OneFilePerFrame") != 0;
    description.wide = std::strcmp(type.attribute("Format").as_string("mcc"), "mcx") == 0;
    description.ticksPerFrame =
        std::max(toTicks(root.child("cacheTimePerFrame").attribute("TimePerFrame").as_string(), 250), 1);
    readRange(root.child("time").attribute("Range").as_string(), description);
    for (const pugi::xml_node& node : root.child("Channels").children())
        if (isChannelTag(node.name()))
            description.channels.push_back(readChannel(node, description));
    return true;
}

std::string mayaCacheDescriptionText(const MayaCacheDescription& description) {
    pugi::xml_document document;
    pugi::xml_node declaration = append(document, pugi::node_declaration, "xml");
    set(declaration, "version", "1.0");
    pugi::xml_node root = append(document, pugi::node_element, kRootTag);
    pugi::xml_node type = append(root, pugi::node_element, "cacheType");
    set(type, "Type", description.oneFile ? "OneFile" : "OneFilePerFrame");
    set(type, "Format", description.wide ? "mcx" : "mcc");
    const std::string range = std::to_string(description.start) + "-" + std::to_string(description.end);
    set(append(root, pugi::node_element, "time"), "Range", range.c_str());
    set(append(root, pugi::node_element, "cacheTimePerFrame"), "TimePerFrame", description.ticksPerFrame);
    set(append(root, pugi::node_element, "cacheVersion"), "Version", "2.0");
    pugi::xml_node channels = append(root, pugi::node_element, "Channels");
    for (std::size_t i = 0; i < description.channels.size(); ++i) {
        const MayaCacheChannel& channel = description.channels[i];
        pugi::xml_node node = append(channels, pugi::node_element, ("channel" + std::to_string(i)).c_str());
        set(node, "ChannelName", channel.name.c_str());
        set(node, "ChannelType", channel.type.c_str());
        set(node, "ChannelInterpretation", channel.interpretation.c_str());
        set(node, "SamplingType", channel.regular ? "Regular" : "Irregular");
        set(node, "SamplingRate", channel.samplingRate);
        set(node, "StartTime", channel.start);
        set(node, "EndTime", channel.end);
    }
    TextWriter text;
    document.save(text, "  ");
    return std::move(text.text);
}

} // namespace detail
FBXSDK_NAMESPACE_END
