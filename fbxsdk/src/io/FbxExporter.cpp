// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Exporters: choice of the file, the format and the version.
#include <fbxsdk/FbxExporter.h>

#include <charconv>
#include <chrono>
#include <cstdlib>
#include <new>
#include <optional>
#include <string_view>

#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxIOPluginRegistry.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxPathUtils.h>
#include <fbxsdk/FbxScene.h>

#include "container/AsciiSink.h"
#include "container/BinarySink.h"
#include "container/FileBytes.h"
#include "container/OutputFile.h"
#include "io/SceneWriting.h"
#include "object/ManagerData.h"
#include "object/SceneMembers.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxExporter, FbxIOBase, std::span<const detail::PropertyRow>{})

FbxExporter::FbxExporter(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxIOBase(pManager, pInfo) {}
FbxExporter::~FbxExporter() = default;

namespace {

/// The registry's number for the requested format; -1 when there is no such writer.
int writerOf(const FbxIOPluginRegistry& registry, const char* fileName, int format) {
    if (format >= 0)
        return format < registry.GetWriterFormatCount() ? format : -1;
    if (format != -1)
        return -1;
    const int byExtension = registry.FindWriterIDByExtension(FbxPathUtils::GetExtensionName(fileName).Buffer());
    return byExtension >= 0 ? byExtension : registry.GetNativeWriterFormat();
}

} // namespace

bool FbxExporter::Initialize(const char* pFileName, int pFileFormat, FbxIOSettings* pIOSettings) {
    mFileFormat = -1;
    if (!FbxIOBase::Initialize(pFileName, pFileFormat, pIOSettings))
        return false;
    const int writer = writerOf(*GetFbxManager()->GetIOPluginRegistry(), pFileName, pFileFormat);
    if (writer < 0) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no writer with index %d", pFileName, pFileFormat);
        return false;
    }
    const FbxString folder = FbxPathUtils::GetFolderName(FbxPathUtils::Resolve(pFileName));
    if (!FbxPathUtils::Exist(folder)) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: the folder %s does not exist", pFileName, folder.Buffer());
        return false;
    }
    if (FbxPathUtils::Exist(pFileName)) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: is a folder", pFileName);
        return false;
    }
    mFileFormat = writer;
    return true;
}

namespace {

using namespace detail;

/// The time in SOURCE_DATE_EPOCH, for reproducible output; null without it.
std::optional<std::chrono::system_clock::time_point> statedMoment() {
    const char* const text = std::getenv("SOURCE_DATE_EPOCH");
    if (!text)
        return std::nullopt;
    const std::string_view digits(text);
    // Beyond this the year has five digits.
    constexpr std::int64_t kLast = 253402300799;
    std::int64_t seconds = 0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), seconds);
    if (result.ec != std::errc() || result.ptr != digits.data() + digits.size() || seconds < 0 || seconds > kLast)
        return std::nullopt;
    return std::chrono::system_clock::time_point(std::chrono::seconds(seconds));
}

/// Files state local time; a time from SOURCE_DATE_EPOCH is stated as given.
void setCreationTime(Document& document) {
    const auto stated = statedMoment();
    const auto moment = stated.value_or(std::chrono::system_clock::now());
    document.createdGmt = utcTime(moment);
    document.created = stated ? document.createdGmt : localTime(moment);
}

/// Writes the document into the output. Empty, or why the version cannot hold it.
std::string writeRecords(Document& document, const VersionTraits& traits, bool binary, ByteOutput& output) {
    if (!binary) {
        AsciiSink sink(output, traits.version);
        writeDocument(document, traits, sink);
        sink.finish();
        return {};
    }
    BinarySink sink(output, traits.version);
    writeDocument(document, traits, sink);
    sink.finish(document.created);
    return sink.fault();
}

/// Renames the file, and before that the caches that wait for it: all of them, or none.
bool commitWithCaches(FbxScene& scene, OutputFile& file, FbxStatus& status) {
    const std::vector<FbxCache*> caches = sourcesOf<FbxCache>(scene);
    std::vector<OutputFile*> files;
    for (const FbxCache* cache : caches) {
        const std::vector<OutputFile*> waiting = cache->waitingFiles();
        files.insert(files.end(), waiting.begin(), waiting.end());
    }
    files.push_back(&file);
    const bool done = OutputFile::commitTogether(files, status);
    for (FbxCache* cache : caches)
        cache->forgetWaitingFiles();
    return done;
}

bool writeFile(FbxScene& scene, const std::string& fileName, const VersionTraits& traits, bool binary,
               FbxStatus& status) {
    Document document;
    document.tree = std::make_unique<RecordTree>();
    document.creator = FbxManager::GetVersion();
    setCreationTime(document);
    writeScene(scene, traits, document);
    OutputFile file(fileName);
    if (!file.open(status))
        return false;
    const std::string fault = writeRecords(document, traits, binary, file);
    if (!fault.empty()) {
        status.SetCode(FbxStatus::eFailure, "%s: cannot be written: %s", fileName.c_str(), fault.c_str());
        return false;
    }
    return commitWithCaches(scene, file, status);
}

} // namespace

bool FbxExporter::Export(FbxDocument* pDocument, bool) {
    mStatus.Clear();
    if (mFileFormat < 0) {
        mStatus.SetCode(FbxStatus::eFailure, "no file is open");
        return false;
    }
    auto* scene = FbxCast<FbxScene>(pDocument);
    if (!scene) {
        mStatus.SetCode(FbxStatus::eInvalidParameter, "%s: there is no scene to export", mFileName.c_str());
        return false;
    }
    const VersionTraits* const chosen = findVersion(mVersion);
    const bool binary = mFileFormat == GetFbxManager()->GetIOPluginRegistry()->GetNativeWriterFormat();
    try {
        return detail::faultToStatus(
            mStatus, [&] { return writeFile(*scene, mFileName, chosen ? *chosen : kNewestVersion, binary, mStatus); });
    } catch (const std::bad_alloc&) {
        mStatus.SetCode(FbxStatus::eInsufficientMemory, "%s: not enough memory to write it", mFileName.c_str());
        return false;
    }
}

bool FbxExporter::SetFileExportVersion(FbxString pVersion, FbxSceneRenamer::ERenamingMode) {
    for (char const* const* known = GetCurrentWritableVersions(); *known; ++known) {
        if (pVersion != *known)
            continue;
        mVersion = *known;
        return true;
    }
    return false;
}

char const* const* FbxExporter::GetCurrentWritableVersions() const {
    // All writers write the same versions, so the result does not depend on the chosen format.
    const FbxIOPluginRegistry& registry = *GetFbxManager()->GetIOPluginRegistry();
    return registry.GetWritableVersions(registry.GetNativeWriterFormat());
}

FBXSDK_NAMESPACE_END
