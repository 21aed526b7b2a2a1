// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx cache: the content of point caches and their defects; those of an FBX file, or files of caches.
#include <algorithm>
#include <cctype>
#include <filesystem>
#include <map>
#include <optional>
#include <set>
#include <system_error>

#include <fbxsdk.h>
#include <fbxsdk/extensions/CacheFacts.h>
#include <fbxsdk/extensions/FileFacts.h>

#include "CacheCheck.h"
#include "Commands.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "ShowFiles.h"
#include "Table.h"
#include "TerminalText.h"

namespace tool {
namespace {

using extensions::CacheFacts;
using extensions::CacheSampleFacts;

/// How a mesh uses a cache.
struct MeshUse {
    std::string mesh;
    bool active = true;
    std::string channel;
    std::string relative, absolute; ///< the names that the FBX file has
    std::string fault;              ///< why the mesh shows without the cache
};

struct CacheEntry {
    std::optional<MeshUse> use;
    std::string path; ///< of the cache, where it was found; empty where there is none
    CacheFacts facts;

    [[nodiscard]] bool isSound() const { return facts.faults.empty() && !path.empty() && (!use || use->fault.empty()); }
};

bool isCacheFile(const std::string& file) {
    std::string extension = std::filesystem::path(file).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char letter) { return static_cast<char>(std::tolower(letter)); });
    const char* const known[] = {".xml", ".mc", ".mcx", ".pc2"};
    return std::find(std::begin(known), std::end(known), extension) != std::end(known);
}

std::vector<CacheEntry> entriesOfCacheFile(const std::string& file, bool verify) {
    CacheEntry entry;
    FbxStatus status;
    if (!extensions::readCacheFacts(file.c_str(), verify, entry.facts, status))
        throw Unreadable(status.GetErrorString());
    entry.path = file;
    return {entry};
}

void findCache(const FbxCache& cache, bool verify, CacheEntry& entry) {
    for (const std::string& place : extensions::cachePlaces(cache)) {
        std::error_code ignored;
        FbxStatus status;
        if (!std::filesystem::exists(place, ignored))
            continue;
        if (extensions::readCacheFacts(place.c_str(), verify, entry.facts, status)) {
            entry.path = place;
            return;
        }
    }
}

CacheEntry entryOf(FbxMesh& mesh, FbxVertexCacheDeformer& deformer, bool verify) {
    CacheEntry entry;
    MeshUse use;
    use.mesh = mesh.GetNodeCount() > 0 ? mesh.GetNode(0)->GetName() : mesh.GetName();
    use.active = deformer.Active.Get();
    use.channel = deformer.Channel.Get().Buffer();
    use.fault = cacheFault(mesh);
    if (const FbxCache* cache = deformer.GetCache()) {
        FbxString relative, absolute;
        cache->GetCacheFileName(relative, absolute);
        use.relative = relative.Buffer();
        use.absolute = absolute.Buffer();
        findCache(*cache, verify, entry);
    }
    entry.use = std::move(use);
    return entry;
}

std::vector<CacheEntry> entriesOfScene(const std::string& file, bool verify) {
    const SceneFile opened(file);
    std::vector<CacheEntry> entries;
    for (FbxObject* object : extensions::objectsOf(opened.scene())) {
        auto* mesh = FbxCast<FbxMesh>(object);
        for (int d = 0; mesh && d < mesh->GetDeformerCount(FbxDeformer::eVertexCache); ++d) {
            auto* deformer = FbxCast<FbxVertexCacheDeformer>(mesh->GetDeformer(d, FbxDeformer::eVertexCache));
            if (deformer)
                entries.push_back(entryOf(*mesh, *deformer, verify));
        }
    }
    return entries;
}

/// The common properties of a channel's samples.
struct ChannelSamples {
    std::uint64_t samples = 0, leastPoints = UINT64_MAX, mostPoints = 0;
    double first = 0.0, last = 0.0;
    std::string numbers; ///< "3 floats"
};

std::map<std::string, ChannelSamples> samplesByChannel(const CacheFacts& facts) {
    std::map<std::string, ChannelSamples> channels;
    for (const CacheSampleFacts& sample : facts.samples) {
        ChannelSamples& channel = channels[facts.channelNames[sample.channel]];
        channel.first = channel.samples == 0 ? sample.frame : channel.first;
        channel.last = sample.frame;
        ++channel.samples;
        channel.leastPoints = std::min(channel.leastPoints, sample.count);
        channel.mostPoints = std::max(channel.mostPoints, sample.count);
        channel.numbers = std::to_string(sample.components) + (sample.doubles ? " × double" : " × float");
    }
    return channels;
}

bool isMax(const CacheFacts& facts) { return facts.format == FbxCache::eMaxPointCacheV2; }

// ---- Text ----

std::string kindText(const CacheFacts& facts) {
    if (isMax(facts))
        return "Max point cache, " + numberText(facts.framesPerSample) +
               (facts.framesPerSample == 1.0 ? " frame per sample" : " frames per sample");
    std::string text = std::string("Maya cache, ") + (facts.wide ? "64-bit" : "32-bit") + " chunks, " +
                       (facts.oneFile ? "one data file" : "one data file per sample");
    if (facts.frameRate > 0.0)
        return text + ", " + rateText(facts.frameRate);
    return text + ", without description (frames at 24 per second)";
}

std::string framesText(double first, double last) { return numberText(first) + " to " + numberText(last); }

void printChannels(const CacheFacts& facts, std::ostream& out, const Terminal& terminal) {
    const std::map<std::string, ChannelSamples> found = samplesByChannel(facts);
    Table table({{"Channel", Table::Align::left, Ink::name},
                 {"Content"},
                 {"Type"},
                 {"Frames stated"},
                 {"Frames found"},
                 {"Samples", Table::Align::right},
                 {"Points", Table::Align::right, Ink::number}});
    const auto addRow = [&](const std::string& name, const std::string& holds, const std::string& stated) {
        const auto row = found.find(name);
        if (row == found.end()) {
            table.addRow({terminalText(name), holds, "", stated, "none", "0", ""});
            return;
        }
        const ChannelSamples& samples = row->second;
        const std::string points = std::to_string(samples.leastPoints);
        table.addRow({terminalText(name), holds, samples.numbers, stated, framesText(samples.first, samples.last),
                      std::to_string(samples.samples),
                      samples.leastPoints == samples.mostPoints
                          ? points
                          : points + " to " + std::to_string(samples.mostPoints)});
    };
    for (const extensions::CacheChannelFacts& channel : facts.channels)
        addRow(channel.name, terminalText(channel.interpretation + ", " + channel.type),
               framesText(channel.start, channel.end));
    for (const auto& [name, samples] : found) {
        const bool isStated = std::any_of(facts.channels.begin(), facts.channels.end(),
                                          [&name = name](const auto& channel) { return channel.name == name; });
        if (!isStated)
            addRow(name, isMax(facts) ? "points" : "", isMax(facts) ? framesText(facts.start, facts.end) : "");
    }
    if (!table.empty())
        table.print(out, terminal, 2);
}

void printSamples(const CacheFacts& facts, std::ostream& out, const Terminal& terminal) {
    Table table({{"Frame", Table::Align::right},
                 {"Channel", Table::Align::left, Ink::name},
                 {"Points", Table::Align::right},
                 {"Offset", Table::Align::right},
                 {"Bytes", Table::Align::right},
                 {"File"}});
    for (const CacheSampleFacts& sample : facts.samples)
        table.addRow({numberText(sample.frame), terminalText(facts.channelNames[sample.channel]),
                      std::to_string(sample.count), std::to_string(sample.offset), std::to_string(sample.bytes),
                      terminalText(facts.fileNames[sample.file])});
    table.print(out, terminal, 2);
}

void printUse(const MeshUse& use, const std::string& path, std::ostream& out, const Terminal& terminal) {
    out << terminal.paint(Ink::name, inQuotes(use.mesh)) << (use.active ? "" : "  (switched off)") << '\n';
    if (!use.channel.empty())
        out << "  Channel     " << inQuotes(use.channel) << '\n';
    out << "  Paths       " << (use.relative.empty() ? "no relative path" : inQuotes(use.relative)) << ", "
        << (use.absolute.empty() ? "no absolute path" : inQuotes(use.absolute)) << '\n';
    out << "  File        " << (path.empty() ? "not found" : terminalText(path)) << '\n';
    if (!use.fault.empty())
        out << "  " << terminal.paint(Ink::warning, "The mesh is shown without the cache: " + terminalText(use.fault))
            << '\n';
}

void printContent(const CacheFacts& facts, const CacheOptions& options, std::ostream& out, const Terminal& terminal) {
    out << "  " << kindText(facts) << "\n  " << facts.fileNames.size()
        << (facts.fileNames.size() == 1 ? " data file, " : " data files, ") << sizeText(facts.bytes) << '\n';
    printChannels(facts, out, terminal);
    if (options.samples)
        printSamples(facts, out, terminal);
    for (const extensions::CacheFaultFacts& fault : facts.faults)
        out << "  " << terminal.paint(Ink::warning, "Fault") << "  "
            << terminalText(fault.file + ": offset " + std::to_string(fault.offset) + ": " + fault.reason) << '\n';
    if (options.verify && facts.faults.empty())
        out << "  Verified: all samples exist and all values are finite\n";
}

/// A cache that several deformers use is printed once.
void printEntries(const std::vector<CacheEntry>& entries, const CacheOptions& options, Page& page, std::ostream& out) {
    std::set<std::string> shown;
    for (const CacheEntry& entry : entries) {
        if (entry.use)
            printUse(*entry.use, entry.path, out, page.terminal());
        if (entry.path.empty())
            continue;
        if (shown.insert(entry.path).second)
            printContent(entry.facts, options, out, page.terminal());
        else
            out << "  Content as above\n";
    }
}

// ---- For programs ----

void printUse(const std::optional<MeshUse>& use, JsonWriter& json) {
    json.key("use");
    if (!use) {
        json.null();
        return;
    }
    json.beginObject();
    json.text("mesh", use->mesh);
    json.boolean("active", use->active);
    json.text("channel", use->channel);
    json.text("relative", use->relative);
    json.text("absolute", use->absolute);
    json.text("fault", use->fault);
    json.endObject();
}

void printChannels(const CacheFacts& facts, JsonWriter& json) {
    json.key("channels");
    json.beginArray();
    for (const extensions::CacheChannelFacts& channel : facts.channels) {
        json.beginObject();
        json.text("name", channel.name);
        json.text("type", channel.type);
        json.text("interpretation", channel.interpretation);
        json.boolean("regular", channel.regular);
        json.real("step", channel.step);
        json.real("start", channel.start);
        json.real("end", channel.end);
        json.endObject();
    }
    json.endArray();
    json.key("found");
    json.beginArray();
    for (const auto& [name, samples] : samplesByChannel(facts)) {
        json.beginObject();
        json.text("channel", name);
        json.integer("samples", static_cast<long long>(samples.samples));
        json.integer("leastPoints", static_cast<long long>(samples.leastPoints));
        json.integer("mostPoints", static_cast<long long>(samples.mostPoints));
        json.real("first", samples.first);
        json.real("last", samples.last);
        json.endObject();
    }
    json.endArray();
}

void printSamples(const CacheFacts& facts, bool wanted, JsonWriter& json) {
    json.key("samples");
    if (!wanted) {
        json.null();
        return;
    }
    json.beginArray();
    for (const CacheSampleFacts& sample : facts.samples) {
        json.beginObject();
        json.real("frame", sample.frame);
        json.text("channel", facts.channelNames[sample.channel]);
        json.integer("points", static_cast<long long>(sample.count));
        json.integer("components", sample.components);
        json.text("numbers", sample.doubles ? "double" : "float");
        json.text("file", facts.fileNames[sample.file]);
        json.integer("offset", static_cast<long long>(sample.offset));
        json.integer("bytes", static_cast<long long>(sample.bytes));
        json.endObject();
    }
    json.endArray();
}

void printFaults(const CacheFacts& facts, JsonWriter& json) {
    json.key("faults");
    json.beginArray();
    for (const extensions::CacheFaultFacts& fault : facts.faults) {
        json.beginObject();
        json.text("file", fault.file);
        json.integer("offset", static_cast<long long>(fault.offset));
        json.text("reason", fault.reason);
        json.endObject();
    }
    json.endArray();
}

void printContent(const CacheFacts& facts, bool withSamples, JsonWriter& json) {
    json.beginObject();
    json.text("type", isMax(facts) ? "max" : "maya");
    json.text("description", facts.description);
    json.boolean("oneFile", facts.oneFile);
    json.integer("chunkBits", isMax(facts) ? 0 : facts.wide ? 64 : 32);
    json.key("frameRate");
    if (facts.frameRate > 0.0)
        json.real(facts.frameRate);
    else
        json.null();
    json.real("framesPerSample", facts.framesPerSample);
    json.real("start", facts.start);
    json.real("end", facts.end);
    json.integer("files", static_cast<long long>(facts.fileNames.size()));
    json.integer("bytes", static_cast<long long>(facts.bytes));
    printChannels(facts, json);
    printSamples(facts, withSamples, json);
    printFaults(facts, json);
    json.endObject();
}

void printJson(const std::vector<CacheEntry>& entries, const CacheOptions& options, JsonWriter& json) {
    json.boolean("verified", options.verify);
    json.key("caches");
    json.beginArray();
    for (const CacheEntry& entry : entries) {
        json.beginObject();
        json.text("path", entry.path);
        json.boolean("sound", entry.isSound());
        printUse(entry.use, json);
        json.key("content");
        if (entry.path.empty())
            json.null();
        else
            printContent(entry.facts, options.samples, json);
        json.endObject();
    }
    json.endArray();
}

} // namespace

int cache(const CacheOptions& options) {
    return showFiles(
        options, "cache",
        [&options](Page& page) -> int {
            const std::vector<CacheEntry> entries = isCacheFile(page.file())
                                                        ? entriesOfCacheFile(page.file(), options.verify)
                                                        : entriesOfScene(page.file(), options.verify);
            if (page.isJson()) {
                page.json(
                    "cache", [&](JsonWriter& json) { printJson(entries, options, json); });
            } else {
                std::ostream& out = page.begin();
                out << page.terminal().paint(Ink::heading, spoken(page.file())) << '\n';
                printEntries(entries, options, page, out);
                if (entries.empty())
                    out << "  no mesh has a point cache\n";
            }
            const auto faulty = std::count_if(
                entries.begin(), entries.end(), [](const CacheEntry& each) { return !each.isSound(); });
            if (!options.verify || faulty == 0)
                return kSuccess;
            printError(page.file(),
                       std::to_string(faulty) + " of " + std::to_string(entries.size()) + " caches have faults");
            return kUnreadable;
        });
}

} // namespace tool
