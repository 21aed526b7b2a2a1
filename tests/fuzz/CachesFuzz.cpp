// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Any bytes next to a valid FBX file, as its point cache, give points or a reason, and the same ones for every reader:
// the cache itself, the inspection of caches, and the facade.
//
// An input is a Max cache (POINTCACHE2…), a Maya data file (FOR4… or FOR8…), which is read with a valid description, or
// a description, with everything from the first FOR4 or FOR8 on as its data.
#include "fuzz/FuzzSupport.h"

#include <TnFbxMesh.h>
#include <fbxsdk.h>
#include <fbxsdk/extensions/CacheFacts.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <functional>
#include <limits>
#include <string>
#include <string_view>

namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxCache;
using fbxsdk::extensions::CacheFacts;
using fuzz::require;

/// More would only take time.
constexpr int kChannelsRead = 4;
constexpr std::uint64_t kMostPoints = std::uint64_t{1} << 16;

constexpr unsigned int kMeshPoints = 3;

std::string fbxFile(const std::string& cacheFile, FbxCache::EFileFormat format) {
    return "; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\n"
           "GlobalSettings: {\nProperties70: {\nP: \"TimeMode\", \"enum\", \"\", \"\",11\n}\n}\n"
           "Objects: {\nGeometry: 10, \"Geometry::g\", \"Mesh\" {\nVertices: *9 {\na: 0,0,9,1,0,9,2,0,9\n}\n"
           "PolygonVertexIndex: *3 {\na: 0,1,-3\n}\n}\nModel: 11, \"Model::m\", \"Mesh\" {\n}\n"
           "Deformer: 12, \"Deformer::d\", \"VertexCacheDeformer\" {\nProperties70: {\n"
           "P: \"ChannelName\", \"KString\", \"\", \"\", \"wave\"\n}\n}\n"
           "Cache: 13, \"Cache::c\", \"\" {\nProperties70: {\nP: \"CacheFileName\", \"KString\", \"\", \"\", \"" +
           cacheFile + "\"\nP: \"CacheFileType\", \"enum\", \"\", \"\"," + std::to_string(format) +
           "\n}\n}\nAnimationStack: 14, \"AnimStack::any\", \"\" {\n}\n}\nConnections: {\n"
           "C: \"OO\",11,0\nC: \"OO\",10,11\nC: \"OO\",12,10\nC: \"OO\",13,12\n}\n";
}

std::string soundDescription(bool oneFile, bool wide) {
    return std::string("<Autodesk_Cache_File><cacheType Type=\"") + (oneFile ? "OneFile" : "OneFilePerFrame") +
           "\" Format=\"" + (wide ? "mcx" : "mcc") +
           "\"/><time Range=\"0-1000\"/><cacheTimePerFrame TimePerFrame=\"250\"/><Channels>"
           "<channel0 ChannelName=\"wave\" ChannelType=\"DoubleVectorArray\" SamplingRate=\"250\" "
           "StartTime=\"0\" EndTime=\"1000\"/></Channels></Autodesk_Cache_File>";
}

struct ManagerOwner {
    fbxsdk::FbxManager* manager = fbxsdk::FbxManager::Create();
    ManagerOwner() = default;
    ManagerOwner(const ManagerOwner&) = delete;
    ManagerOwner& operator=(const ManagerOwner&) = delete;
    ~ManagerOwner() { manager->Destroy(); }
};

/// A folder with an FBX file for each kind of cache, and data of a valid cache.
struct Stage {
    support::TemporaryFolder folder;
    std::string narrowData, wideData;

    Stage() {
        fuzz::writeOldFile(folder, "maya.fbx", fbxFile("input.xml", FbxCache::eMayaCache));
        fuzz::writeOldFile(folder, "max.fbx", fbxFile("input.pc2", FbxCache::eMaxPointCacheV2));
        narrowData = soundData(FbxCache::eMCC, "sound.mc");
        wideData = soundData(FbxCache::eMCX, "sound.mcx");
    }

private:
    std::string soundData(FbxCache::EMCBinaryFormat layout, const std::string& dataFile) {
        const ManagerOwner owner;
        FbxCache* cache = FbxCache::Create(owner.manager, "");
        cache->SetCacheFileFormat(FbxCache::eMayaCache);
        cache->SetCacheFileName("", folder.file("sound.xml").c_str());
        require(cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "wave", layout), "a cache that cannot be written");
        for (const double seconds : {0.0, 1.0}) {
            double points[3 * kMeshPoints] = {seconds, 1, 2, 3, 4, 5, 6, 7, 8};
            fbxsdk::FbxTime time;
            time.SetSecondDouble(seconds);
            require(cache->Write(0, time, points, kMeshPoints), "a sample that cannot be written");
        }
        require(cache->CloseFile(), "a cache that cannot be closed");
        return folder.read(dataFile);
    }
};

/// Repeated reads give the same, as doubles and as floats, and fill all of the buffer.
template <class Read>
void readTwice(std::uint64_t pointCount, const Read& read) {
    std::vector<double> first(pointCount * 3, 1.0), second(pointCount * 3, 2.0);
    const bool isRead = read(first.data());
    require(read(second.data()) == isRead, "a sample that can be read only sometimes");
    require(!isRead || std::memcmp(first.data(), second.data(), first.size() * sizeof(double)) == 0,
            "a sample reads differently the second time");
}

void readMax(FbxCache& cache) {
    const unsigned int points = cache.GetPointCount(), samples = cache.GetSampleCount();
    require(points > 0 && samples > 0, "an open cache without points");
    const auto start = static_cast<unsigned int>(static_cast<std::int64_t>(
        std::clamp(cache.GetFrameStartOffset(), static_cast<double>(INT32_MIN), static_cast<double>(INT32_MAX))));
    for (const unsigned int frame : {0U, start, start + samples - 1, start + samples / 2, 0x80000000U, 0x7FFFFFFFU}) {
        for (const std::uint64_t count : {std::uint64_t{points}, std::uint64_t{kMeshPoints}})
            if (count <= kMostPoints)
                readTwice(
                    count, [&](double* to) { return cache.Read(frame, to, static_cast<unsigned int>(count)); });
    }
}

void readMaya(FbxCache& cache, const CacheFacts& facts) {
    const std::uint64_t most = facts.samples.empty() ? 0 : facts.samples.front().count;
    for (int channel = 0; channel < std::min(cache.GetChannelCount(), kChannelsRead); ++channel) {
        fbxsdk::FbxTime start, end;
        (void)cache.GetAnimationRange(channel, start, end);
        constexpr auto kFar = std::numeric_limits<fbxsdk::FbxLongLong>::max();
        for (const fbxsdk::FbxLongLong ticks : {start.Get(), end.Get(), start.Get() / 2 + end.Get() / 2, kFar, -kFar}) {
            fbxsdk::FbxTime time(ticks);
            for (const std::uint64_t count : {most, std::uint64_t{kMeshPoints}}) {
                if (count > 0 && count <= kMostPoints)
                    readTwice(
                        count,
                        [&](double* to) { return cache.Read(channel, time, to, static_cast<unsigned int>(count)); });
            }
        }
    }
}

/// False when there is no cache in the file at all.
bool inspect(const std::string& file, CacheFacts& facts) {
    fbxsdk::FbxStatus status;
    if (!fbxsdk::extensions::readCacheFacts(file.c_str(), /*verify=*/true, facts, status)) {
        require(status.Error() && status.GetErrorString()[0] != '\0', "an inspection that fails without a reason");
        return false;
    }
    for (const auto& sample : facts.samples) {
        require(sample.file < facts.fileNames.size() && sample.channel < facts.channelNames.size(),
                "a sample of no file or no channel");
        require(sample.offset <= facts.bytes && sample.bytes <= facts.bytes - sample.offset,
                "a sample outside of its file");
        require(sample.count <= sample.bytes / (sample.components * (sample.doubles ? 8U : 4U)),
                "a sample of more numbers than bytes");
    }
    return true;
}

/// The mesh has its points, those of the cache or its own, and a read without the cache reports it.
void readMesh(const std::string& file, bool faithful, bool cacheOpens) {
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("any");
    info.setFidelity(faithful ? kFbxFidelityFaithful : kFbxFidelityCompatible);
    info.setFrame(1);
    const fuzz::List<TnFbxMesh> meshes(info, &Fbx::getMeshes);
    require(meshes.read && meshes.count == 1, "a sound file that cannot be read for its cache");
    require(meshes.objects[0].getNumberOfControlPoints() == static_cast<int>(kMeshPoints), "a mesh of other points");
    fuzz::checkMesh(meshes.objects[0]);
    require(cacheOpens || !lastWarnings().empty(), "a cache that was left out without a warning");
}

void check(const Stage& stage, const std::string& cacheFile, const std::string& fbx, FbxCache::EFileFormat format,
           bool faithful) {
    CacheFacts facts;
    const std::string path = stage.folder.file(cacheFile);
    const bool isCache = inspect(path, facts);

    const ManagerOwner owner;
    FbxCache* cache = FbxCache::Create(owner.manager, "");
    cache->SetCacheFileFormat(format);
    cache->SetCacheFileName("", path.c_str());
    fbxsdk::FbxStatus status;
    const bool opens = cache->OpenFileForRead(&status);
    require(opens != status.Error(), "status and result disagree");
    const bool isSound = isCache && facts.format == format && facts.faults.empty() && !facts.samples.empty();
    require(opens || !isSound, "a cache without faults does not open");
    if (opens && format == FbxCache::eMaxPointCacheV2)
        readMax(*cache);
    else if (opens)
        readMaya(*cache, facts);
    readMesh(stage.folder.file(fbx), faithful, opens);
}

void checkMaya(const Stage& stage, const std::string& description, const std::string& narrow, const std::string& wide,
               bool faithful) {
    fuzz::writeOldFile(stage.folder, "input.xml", description);
    for (const char* name : {"input.mc", "inputFrame1.mc"})
        fuzz::writeOldFile(stage.folder, name, narrow);
    for (const char* name : {"input.mcx", "inputFrame1.mcx"})
        fuzz::writeOldFile(stage.folder, name, wide);
    check(stage, "input.xml", "maya.fbx", FbxCache::eMayaCache, faithful);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const Stage stage;
    const std::string content(reinterpret_cast<const char*>(bytes), size);
    const bool faithful = std::hash<std::string>{}(content) % 2 != 0;
    const auto data = std::min(content.find("FOR4"), content.find("FOR8"));
    if (content.starts_with("POINTCACHE2")) {
        fuzz::writeOldFile(stage.folder, "input.pc2", content);
        check(stage, "input.pc2", "max.fbx", FbxCache::eMaxPointCacheV2, faithful);
    } else if (data == 0) {
        for (const bool oneFile : {true, false})
            checkMaya(stage, soundDescription(oneFile, content.starts_with("FOR8")), content, content, faithful);
    } else if (data != std::string::npos) {
        checkMaya(stage, content.substr(0, data), content.substr(data), content.substr(data), faithful);
    } else {
        checkMaya(stage, content, stage.narrowData, stage.wideData, faithful);
    }
    return 0;
}
