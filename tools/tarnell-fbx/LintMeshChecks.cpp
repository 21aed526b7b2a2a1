// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes and their point caches.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <system_error>

#include <fbxsdk/extensions/CacheFacts.h>

#include "CacheCheck.h"
#include "CameraOrigins.h"
#include "LintChecks.h"
#include "SceneFacts.h"

namespace tool {
namespace {

extensions::FileRecord childOf(const extensions::FileRecord& record, std::string_view name) {
    extensions::FileRecord child = record.firstChild();
    while (child && child.name() != name)
        child = child.nextSibling();
    return child;
}

/// Of a list; a single number is no list.
std::size_t numberCount(const extensions::FileRecord& record) {
    const extensions::RecordValue value = record.value(0);
    return value.type == extensions::RecordValue::eList ? value.count : record.valueCount();
}

std::string objectName(const extensions::FileRecord& record) {
    for (std::size_t i = 0; i < record.valueCount(); ++i) {
        const extensions::RecordValue value = record.value(i);
        if (value.type != extensions::RecordValue::eText)
            continue;
        return plainName(value.text);
    }
    return {};
}

/// A mesh's point cache, and where it was found.
struct UsedCache {
    FbxMesh* mesh;
    FbxCache* cache;
    std::string path; ///< empty: nowhere
};

std::string placeOf(const FbxCache& cache) {
    for (const std::string& place : extensions::cachePlaces(cache)) {
        std::error_code ignored;
        if (std::filesystem::exists(place, ignored))
            return place;
    }
    return {};
}

void forEachCache(const LintContext& context, const std::function<void(const UsedCache&)>& work) {
    for (FbxMesh* mesh : context.meshes) {
        auto* deformer = FbxCast<FbxVertexCacheDeformer>(mesh->GetDeformer(0, FbxDeformer::eVertexCache));
        FbxCache* cache = deformer ? deformer->GetCache() : nullptr;
        if (cache)
            work({mesh, cache, placeOf(*cache)});
    }
}

/// The content of a cache that was found; false where it cannot be inspected.
bool readFacts(const UsedCache& used, extensions::CacheFacts& facts) {
    FbxStatus status;
    return !used.path.empty() && extensions::readCacheFacts(used.path.c_str(), /*verify=*/false, facts, status) &&
           !facts.samples.empty();
}

} // namespace

void polygonsOutOfRange(const LintContext& context, LintReport& report) {
    forEachObjectRecord(
        context.records(),
        [&report](const extensions::FileRecord& record) {
            const extensions::FileRecord points = childOf(record, "Vertices");
            const extensions::FileRecord corners = childOf(record, "PolygonVertexIndex");
            if (!points || !corners)
                return;
            const auto count = static_cast<std::int64_t>(numberCount(points) / 3);
            std::vector<std::int64_t> indices(numberCount(corners));
            if (!corners.readNumbers(indices.data(), indices.size()))
                return;
            const auto bad = std::count_if(
                indices.begin(), indices.end(),
                [count](std::int64_t index) {
                    return (index < 0 ? -index - 1 : index) >= count; // the last corner of a polygon is negative
                });
            if (bad > 0)
                report.add(objectName(record), countOf(bad, "polygon vertex refers", "polygon vertices refer") +
                                                   " to a point beyond the " + std::to_string(count) + " of the mesh");
        });
}

void smallPolygons(const LintContext& context, LintReport& report) {
    constexpr int kTriangle = 3;
    for (const FbxMesh* mesh : context.meshes) {
        int small = 0;
        for (int i = 0; i < mesh->GetPolygonCount(); ++i)
            small += mesh->GetPolygonSize(i) < kTriangle ? 1 : 0;
        if (small > 0)
            report.add(nameOf(*mesh), std::to_string(small) + " of " +
                                          countOf(mesh->GetPolygonCount(), "polygon", "polygons") +
                                          " with fewer than three vertices");
    }
}

void meshWithoutPolygons(const LintContext& context, LintReport& report) {
    for (const FbxMesh* mesh : context.meshes)
        if (mesh->GetPolygonCount() == 0)
            report.add(nameOf(*mesh), countOf(mesh->GetControlPointsCount(), "point", "points") + " and no polygons");
}

void meshWithoutNormals(const LintContext& context, LintReport& report) {
    for (FbxMesh* mesh : context.meshes) {
        bool hasNormals = false;
        for (int i = 0; i < mesh->GetLayerCount(); ++i)
            hasNormals = hasNormals || mesh->GetLayer(i)->GetNormals() != nullptr;
        if (!hasNormals && mesh->GetPolygonCount() > 0)
            report.add(nameOf(*mesh), "it has no normals");
    }
}

void cacheMissing(const LintContext& context, LintReport& report) {
    forEachCache(
        context,
        [&](const UsedCache& used) {
            FbxString relative, absolute;
            used.cache->GetCacheFileName(relative, absolute);
            if (used.path.empty())
                report.add(nameOf(*used.mesh),
                           "there is no " + inQuotes(relative.Buffer()) + " next to the file" +
                               (absolute.IsEmpty() ? "" : ", and no " + inQuotes(absolute.Buffer())));
        });
}

void cacheForeignPath(const LintContext& context, LintReport& report) {
    forEachCache(
        context,
        [&](const UsedCache& used) {
            FbxString relative, absolute;
            used.cache->GetCacheFileName(relative, absolute);
            std::error_code ignored;
            const std::string name = absolute.Buffer();
            if (relative.IsEmpty())
                report.add(nameOf(*used.mesh),
                           "the only path of the cache is " + inQuotes(name) + ", which other machines may not have");
            else if (!used.path.empty() && !name.empty() && !std::filesystem::exists(name, ignored))
                report.add(nameOf(*used.mesh),
                           "there is no " + inQuotes(name) + "; " + inQuotes(relative.Buffer()) + " was found");
        });
}

void cacheUnusable(const LintContext& context, LintReport& report) {
    forEachCache(
        context,
        [&](const UsedCache& used) {
            const std::string fault = used.path.empty() ? "" : cacheFault(*used.mesh);
            if (!fault.empty())
                report.add(nameOf(*used.mesh), fault);
        });
}

void cacheRange(const LintContext& context, LintReport& report) {
    forEachCache(
        context,
        [&](const UsedCache& used) {
            extensions::CacheFacts facts;
            if (!context.take.exists || !readFacts(used, facts))
                return;
            const double toFrames = facts.frameRate > 0.0 ? context.take.frameRate / facts.frameRate : 1.0;
            const double first = facts.samples.front().frame * toFrames, last = facts.samples.back().frame * toFrames;
            constexpr double kHalfAFrame = 0.5;
            if (first > static_cast<double>(context.take.firstFrame) + kHalfAFrame ||
                last < static_cast<double>(context.take.lastFrame) - kHalfAFrame)
                report.add(nameOf(*used.mesh), "samples from frame " + rounded(first, 3) + " to " + rounded(last, 3) +
                                                   ", and the take goes from " +
                                                   std::to_string(context.take.firstFrame) + " to " +
                                                   std::to_string(context.take.lastFrame));
        });
}

void cacheRate(const LintContext& context, LintReport& report) {
    forEachCache(
        context,
        [&](const UsedCache& used) {
            extensions::CacheFacts facts;
            // Times of Maya caches are whole parts of 1/6000 second.
            constexpr double kTolerance = 0.02;
            if (readFacts(used, facts) && facts.frameRate > 0.0 &&
                std::abs(facts.frameRate - context.take.frameRate) > kTolerance)
                report.add(nameOf(*used.mesh),
                           rateText(facts.frameRate) + ", and the file has " + rateText(context.take.frameRate));
        });
}

} // namespace tool
