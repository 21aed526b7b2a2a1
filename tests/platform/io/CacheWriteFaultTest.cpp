// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Caches are written completely or not at all: faults of the medium, and samples that cannot be stored.
#include <array>
#include <cerrno>
#include <cmath>
#include <csignal>
#include <filesystem>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxExporter.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxScene.h>

#include "cache/MayaCache.h"
#include "cache/PointCache2.h"
#include "support/AsNobody.h"
#include "support/FailingOperations.h"
#include "support/TemporaryFolder.h"

using namespace fbxsdk;
using support::AsNobody;
using support::FailingOperations;
using testing::AnyOf;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

namespace {

namespace fs = std::filesystem;

/// Names and bytes of files.
using Contents = std::vector<std::pair<std::string, std::string>>;

enum class Kind { eNarrow, eWide, eMax };

std::string nameOf(const testing::TestParamInfo<Kind>& info) {
    constexpr const char* kNames[] = {"Narrow", "Wide", "Max"};
    return kNames[static_cast<int>(info.param)];
}

/// A cache of three frames in a folder.
class CacheWriting : public testing::TestWithParam<Kind> {
protected:
    ~CacheWriting() override { manager->Destroy(); }

    [[nodiscard]] static bool isMax() { return GetParam() == Kind::eMax; }
    [[nodiscard]] static std::string dataName() {
        return isMax() ? "ball.pc2" : (GetParam() == Kind::eWide ? "ball.mcx" : "ball.mc");
    }
    /// The file after which the cache is named.
    [[nodiscard]] static std::string mainName() { return isMax() ? "ball.pc2" : "ball.xml"; }

    void make() {
        cache = FbxCache::Create(manager, "ball");
        cache->SetCacheFileFormat(isMax() ? FbxCache::eMaxPointCacheV2 : FbxCache::eMayaCache);
        cache->SetCacheFileName("", folder.file(subfolder + mainName()).c_str());
    }
    bool open(unsigned int pointCount = 2, unsigned int frameCount = 3) {
        make();
        points.resize(std::size_t{pointCount} * 3, 1.0);
        const auto layout = GetParam() == Kind::eWide ? FbxCache::eMCX : FbxCache::eMCC;
        return isMax() ? cache->OpenFileForWrite(0.0, 24.0, frameCount, pointCount, &status)
                       : cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", layout,
                                                 FbxCache::eDoubleVectorArray, "Points", &status);
    }
    bool write(int frame) {
        FbxTime time;
        time.SetSecondDouble(frame / 24.0);
        return isMax() ? cache->Write(static_cast<unsigned int>(frame), points.data(), &status)
                       : cache->Write(0, time, points.data(), static_cast<unsigned int>(points.size() / 3), &status);
    }
    /// Writes everything regardless of errors, like writers that check only at the end.
    bool writeAll(unsigned int pointCount = 2) {
        if (!open(pointCount))
            return false;
        for (int frame = 0; frame < 3; ++frame)
            (void)write(frame);
        return cache->CloseFile(&status);
    }

    void writeOldFiles() const {
        for (const std::string& name : {dataName(), mainName()})
            folder.write(subfolder + name, "old " + name);
    }
    [[nodiscard]] Contents contents() const {
        Contents all;
        for (const std::string& name : folder.files(subfolder.empty() ? "." : subfolder))
            all.emplace_back(name, folder.read(subfolder + name));
        return all;
    }
    /// Both names are those of the same cache.
    /// Later faults name the file; the caller that opens a cache already has its name.
    void expectReason(const std::string& reason) const {
        const std::string message = status.GetErrorString();
        EXPECT_TRUE(status.Error());
        EXPECT_THAT(message, HasSubstr(reason));
        EXPECT_THAT(message,
                    AnyOf(StartsWith(folder.file(subfolder + dataName()) + ": "),
                          StartsWith(folder.file(subfolder + mainName()) + ": "), Not(HasSubstr(folder.file("")))));
    }

    support::TemporaryFolder folder;
    std::string subfolder; ///< empty, or with a slash at its end
    FbxManager* manager = FbxManager::Create();
    FbxCache* cache = nullptr;
    FbxStatus status;
    std::vector<double> points;
};

INSTANTIATE_TEST_SUITE_P(Formats, CacheWriting, testing::Values(Kind::eNarrow, Kind::eWide, Kind::eMax), nameOf);

/// Limits the size of files for its lifetime.
class SizeLimit {
public:
    explicit SizeLimit(rlim_t bytes) {
        EXPECT_EQ(::getrlimit(RLIMIT_FSIZE, &mBefore), 0);
        mHandler = ::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit{bytes, mBefore.rlim_max};
        EXPECT_EQ(::setrlimit(RLIMIT_FSIZE, &limit), 0);
    }
    SizeLimit(const SizeLimit&) = delete;
    SizeLimit& operator=(const SizeLimit&) = delete;
    ~SizeLimit() {
        EXPECT_EQ(::setrlimit(RLIMIT_FSIZE, &mBefore), 0);
        ::signal(SIGXFSZ, mHandler);
    }

private:
    rlimit mBefore{};
    void (*mHandler)(int) = nullptr;
};

} // namespace

// ---- Appearing ----

TEST_P(CacheWriting, ShowsNothingUnderItsNameBeforeItIsClosed) {
    writeOldFiles();
    const Contents before = contents();
    constexpr unsigned int kPoints = 50000; // more than is buffered before it is written
    ASSERT_TRUE(open(kPoints)) << status.GetErrorString();
    for (int frame = 0; frame < 3; ++frame)
        EXPECT_TRUE(write(frame)) << status.GetErrorString();
    for (const auto& [name, content] : before)
        EXPECT_EQ(folder.read(name), content);

    EXPECT_TRUE(cache->CloseFile(&status)) << status.GetErrorString();

    EXPECT_EQ(contents().size(), before.size());
    EXPECT_EQ(folder.read(dataName()).find("old"), std::string::npos);
    ASSERT_TRUE(cache->OpenFileForRead(&status)) << status.GetErrorString();
}

TEST_P(CacheWriting, LeavesNothingOfACacheThatIsDestroyedOpen) {
    ASSERT_TRUE(open(50000));
    EXPECT_TRUE(write(0));

    cache->Destroy();

    EXPECT_TRUE(contents().empty());
}

TEST_P(CacheWriting, LeavesTheOldFilesOfACacheThatIsDestroyedOpen) {
    writeOldFiles();
    const Contents before = contents();
    ASSERT_TRUE(open());
    EXPECT_TRUE(write(0));

    cache->Destroy();

    EXPECT_EQ(contents(), before);
}

TEST_P(CacheWriting, ReplacesACacheAsAWhole) {
    writeOldFiles();

    EXPECT_TRUE(writeAll()) << status.GetErrorString();

    EXPECT_EQ(contents().size(), isMax() ? 1U : 2U);
    ASSERT_TRUE(cache->OpenFileForRead(&status)) << status.GetErrorString();
}

TEST_P(CacheWriting, HoldsManyFrames) {
    constexpr int kFrames = 100000;
    ASSERT_TRUE(open(1, kFrames)) << status.GetErrorString();
    for (int frame = 0; frame < kFrames; ++frame) {
        points = {static_cast<double>(frame), 0.5, -1.0};
        ASSERT_TRUE(write(frame)) << status.GetErrorString();
    }
    ASSERT_TRUE(cache->CloseFile(&status)) << status.GetErrorString();

    ASSERT_TRUE(cache->OpenFileForRead(&status)) << status.GetErrorString();
    for (const int frame : {0, 1, 12345, kFrames - 1}) {
        std::array<double, 3> read{};
        FbxTime time;
        time.SetSecondDouble(frame / 24.0);
        EXPECT_TRUE(isMax() ? cache->Read(static_cast<unsigned int>(frame), read.data(), 1U, &status)
                            : cache->Read(0, time, read.data(), 1U, &status));
        EXPECT_NEAR(read[0], frame, 1e-6);
    }
}

// ---- Appearing with the scene ----

/// A cache in a scene, which is to appear together with the scene's file.
class CacheOfAScene : public CacheWriting {
protected:
    CacheOfAScene() {
        cache = FbxCache::Create(scene, "ball");
        FbxProperty property = FbxProperty::Create(cache, FbxBoolDT, "AppearWithScene");
        property.ModifyFlag(FbxPropertyFlags::eNotSavable, true);
        property.Set(true);
    }

    bool writeWaiting() {
        cache->SetCacheFileFormat(isMax() ? FbxCache::eMaxPointCacheV2 : FbxCache::eMayaCache);
        cache->SetCacheFileName("", folder.file(mainName()).c_str());
        points.resize(6, 1.0);
        const auto layout = GetParam() == Kind::eWide ? FbxCache::eMCX : FbxCache::eMCC;
        const bool opened = isMax() ? cache->OpenFileForWrite(0.0, 24.0, 1U, 2U, &status)
                                    : cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", layout,
                                                              FbxCache::eDoubleVectorArray, "Points", &status);
        return opened && write(0) && cache->CloseFile(&status);
    }
    bool exportScene(const std::string& name) {
        FbxExporter* exporter = FbxExporter::Create(manager, "");
        const bool done = exporter->Initialize(name.c_str(), 0) && exporter->Export(scene);
        exporter->Destroy();
        return done;
    }

    FbxScene* scene = FbxScene::Create(manager, "scene");
};

INSTANTIATE_TEST_SUITE_P(Formats, CacheOfAScene, testing::Values(Kind::eNarrow, Kind::eWide, Kind::eMax), nameOf);

TEST_P(CacheOfAScene, AppearsTogetherWithTheFileOfTheScene) {
    writeOldFiles();
    ASSERT_TRUE(writeWaiting()) << status.GetErrorString();
    EXPECT_FALSE(cache->IsOpen());
    EXPECT_EQ(folder.read(mainName()), "old " + mainName());
    EXPECT_EQ(folder.read(dataName()), "old " + dataName());

    EXPECT_TRUE(exportScene(folder.file("shot.fbx")));

    EXPECT_EQ(folder.files().size(), isMax() ? 2U : 3U);
    EXPECT_TRUE(fs::exists(folder.file("shot.fbx")));
    EXPECT_TRUE(cache->OpenFileForRead(&status)) << status.GetErrorString();
    EXPECT_EQ(folder.read("shot.fbx").find("AppearWithScene"), std::string::npos);
}

TEST_P(CacheOfAScene, StaysAsItWasWhenTheSceneCannotBeWritten) {
    writeOldFiles();
    ASSERT_TRUE(writeWaiting()) << status.GetErrorString();

    EXPECT_FALSE(exportScene("/dev/full"));

    EXPECT_EQ(folder.read(mainName()), "old " + mainName());
    EXPECT_EQ(folder.read(dataName()), "old " + dataName());
    EXPECT_EQ(folder.files().size(), isMax() ? 1U : 2U);
}

TEST_P(CacheOfAScene, LeavesNothingWithoutAnExport) {
    ASSERT_TRUE(writeWaiting()) << status.GetErrorString();

    scene->Destroy();

    EXPECT_TRUE(folder.files().empty());
}

TEST_P(CacheOfAScene, IsThatOfTheLastWriteWhenItIsWrittenAgain) {
    ASSERT_TRUE(writeWaiting()) << status.GetErrorString();
    ASSERT_TRUE(writeWaiting()) << status.GetErrorString();

    EXPECT_TRUE(exportScene(folder.file("shot.fbx")));

    EXPECT_EQ(folder.files().size(), isMax() ? 2U : 3U);
}

TEST_P(CacheOfAScene, FailsWhenItIsClosedOnAMediumThatIsFull) {
    {
        const SizeLimit full(20);
        EXPECT_FALSE(writeWaiting());
    }
    expectReason("File too large");
    EXPECT_TRUE(folder.files().empty());
}

// ---- Faults of the medium ----

TEST_P(CacheWriting, SurvivesAFaultInEverySingleOperation) {
    constexpr unsigned int kPoints = 20000;
    const std::vector<double> values(std::size_t{kPoints} * 3, 2.0);
    const std::string name = folder.file(mainName());
    const auto writeMax = [&](detail::FileOperations& operations) {
        const auto writer = detail::PointCacheWriter::open(name, {kPoints, 0.0, 1.0, 4}, status, operations);
        bool good = writer != nullptr;
        for (const int frame : {0, 1, 3, 2, 0}) // appended, with a gap, into the gap, and over the beginning
            good = good && writer->write(frame, values.data(), status);
        return good && writer->close(status);
    };
    const auto writeMaya = [&](detail::FileOperations& operations) {
        detail::MayaCacheDescription description;
        description.wide = GetParam() == Kind::eWide;
        description.channels.resize(1);
        const auto writer = detail::MayaCacheWriter::open(name, description, status, operations);
        bool good = writer != nullptr;
        for (int frame = 0; good && frame < 3; ++frame)
            good = writer->write(0, frame / 24.0, values, status);
        return good && writer->close(status);
    };
    const auto writeWith = [&](detail::FileOperations& operations) {
        return isMax() ? writeMax(operations) : writeMaya(operations);
    };
    for (const bool replacing : {false, true}) {
        const auto restore = [&] {
            fs::remove(folder.file(dataName()));
            fs::remove(folder.file(mainName()));
            if (replacing)
                writeOldFiles();
        };
        restore();
        const Contents before = contents();
        FailingOperations none(-1);
        ASSERT_TRUE(writeWith(none)) << status.GetErrorString();
        ASSERT_GE(none.calls(), isMax() ? 8 : 12);

        for (int failAt = 0; failAt < none.calls(); ++failAt) {
            restore();
            FailingOperations operations(failAt);
            status.Clear();

            EXPECT_FALSE(writeWith(operations)) << failAt;

            expectReason("cannot be written");
            EXPECT_EQ(contents(), before) << failAt;
        }
    }
}

TEST_P(CacheWriting, FailsOnAMediumThatIsFull) {
    writeOldFiles();
    const Contents before = contents();
    for (const rlim_t limit : {rlim_t{1}, rlim_t{20}, rlim_t{100}, rlim_t{100000}, rlim_t{300000}, rlim_t{600000}}) {
        bool written = true;
        {
            const SizeLimit full(limit);
            written = writeAll(limit > 1000 ? 20000 : 2);
        }
        EXPECT_FALSE(written) << limit;
        expectReason("File too large");
        EXPECT_EQ(contents(), before) << limit;
    }
}

TEST_P(CacheWriting, FailsOnADeviceThatIsFullAndPutsTheOldDataBack) {
    const std::string full = mainName(); // of a Maya cache, the file that comes last
    writeOldFiles();
    fs::remove(folder.file(full));
    fs::create_symlink("/dev/full", folder.file(full));
    const std::vector<std::string> before = folder.files();

    EXPECT_FALSE(writeAll(50000));

    expectReason("No space left on device");
    EXPECT_EQ(folder.files(), before);
    EXPECT_TRUE(isMax() || folder.read(dataName()) == "old " + dataName());
}

TEST_P(CacheWriting, FailsWhereItsFolderCannotBeWrittenTo) {
    writeOldFiles();
    const Contents before = contents();
    fs::permissions(folder.path(), fs::perms(0555));
    {
        const AsNobody nobody;
        EXPECT_FALSE(open());
    }
    expectReason("Permission denied");
    EXPECT_FALSE(cache->IsOpen());
    EXPECT_EQ(contents(), before);
}

TEST_P(CacheWriting, FailsForAFolderInThePlaceOfEitherFile) {
    for (const std::string& name : {dataName(), mainName()}) {
        fs::create_directory(folder.file(name));
        EXPECT_FALSE(open());
        expectReason("Is a directory");
        EXPECT_EQ(folder.files(), std::vector<std::string>{name});
        fs::remove(folder.file(name));
    }
}

TEST_P(CacheWriting, FailsWhenItsFolderVanishes) {
    subfolder = "sub/";
    fs::create_directory(folder.file(subfolder));
    ASSERT_TRUE(open()) << status.GetErrorString();
    EXPECT_TRUE(write(0));

    fs::remove_all(folder.file(subfolder));

    EXPECT_FALSE(cache->CloseFile(&status));
    expectReason("No such file or directory");
    EXPECT_TRUE(folder.files().empty());
    EXPECT_FALSE(cache->IsOpen());
}

TEST_P(CacheWriting, FailsWhenAPipeBreaks) {
    const std::string pipe = folder.file(dataName());
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    std::thread reader([&] {
        const int end = ::open(pipe.c_str(), O_RDONLY | O_CLOEXEC);
        char byte = 0;
        EXPECT_EQ(::read(end, &byte, 1), 1);
        ::close(end);
    });

    const bool written = writeAll(50000);

    reader.join();
    EXPECT_FALSE(written);
    expectReason("Broken pipe");
    EXPECT_EQ(folder.files(), std::vector<std::string>{dataName()});
}

TEST_P(CacheWriting, NeedsAName) {
    const std::string here = fs::current_path();
    fs::current_path(folder.path());
    cache = FbxCache::Create(manager, "nameless");
    cache->SetCacheFileFormat(isMax() ? FbxCache::eMaxPointCacheV2 : FbxCache::eMayaCache);

    EXPECT_FALSE(isMax() ? cache->OpenFileForWrite(0.0, 24.0, 1U, 1U, &status)
                         : cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC,
                                                   FbxCache::eDoubleVectorArray, "Points", &status));

    fs::current_path(here);
    EXPECT_TRUE(status.Error());
    EXPECT_TRUE(folder.files().empty());
}

// ---- Samples that cannot be stored ----

TEST_P(CacheWriting, RefusesPointsThatAreNotFinite) {
    writeOldFiles();
    const Contents before = contents();
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    for (const double wrong : {std::numeric_limits<double>::quiet_NaN(), kInfinity, -kInfinity}) {
        ASSERT_TRUE(open()) << status.GetErrorString();
        EXPECT_TRUE(write(0));
        points.back() = wrong;

        EXPECT_FALSE(write(1));
        expectReason("not finite");
        points.back() = 1.0;
        EXPECT_FALSE(write(2)) << "a cache with a hole is none";

        EXPECT_FALSE(cache->CloseFile(&status));
        expectReason("not finite");
        EXPECT_EQ(contents(), before);
    }
}

TEST_P(CacheWriting, RefusesSamplesWithoutPoints) {
    if (isMax()) {
        EXPECT_FALSE(open(0));
    } else {
        ASSERT_TRUE(open(0)) << status.GetErrorString();
        points.resize(3); // a null buffer is another fault
        FbxTime time;
        EXPECT_FALSE(cache->Write(0, time, points.data(), 0U, &status));
        expectReason("no points");
        EXPECT_FALSE(cache->CloseFile(&status));
    }
    expectReason("no points");
    EXPECT_TRUE(contents().empty());
}

TEST_P(CacheWriting, IgnoresWhatComesAfterAFault) {
    ASSERT_TRUE(open(20000)) << status.GetErrorString();
    {
        const SizeLimit full(1000);
        for (int round = 0; round < 3; ++round)
            (void)write(round);
        EXPECT_FALSE(write(0));
        expectReason("File too large");
    }
    for (int round = 0; round < 3; ++round)
        EXPECT_FALSE(write(round)) << "though there is room again";

    EXPECT_FALSE(cache->CloseFile(&status));

    expectReason("File too large");
    EXPECT_TRUE(contents().empty());
    EXPECT_FALSE(write(0)) << "closed";
    EXPECT_FALSE(cache->CloseFile(&status));
}

// ---- What the formats cannot count ----

using detail::mayaCacheSampleFault;

TEST(MayaCacheSizes, EndAtTwoGigabytesWhereSizesAreNarrow) {
    constexpr std::uint64_t kNarrowDoubles = (std::uint64_t{1} << 31U) / 24, kNarrowFloats = kNarrowDoubles * 2;

    EXPECT_EQ(mayaCacheSampleFault(/*wide=*/false, 80'000'000, /*doubles=*/true), nullptr);
    EXPECT_THAT(mayaCacheSampleFault(false, kNarrowDoubles, true), HasSubstr("2 GiB"));
    EXPECT_EQ(mayaCacheSampleFault(false, 160'000'000, false), nullptr);
    EXPECT_THAT(mayaCacheSampleFault(false, kNarrowFloats, false), HasSubstr("2 GiB"));
    EXPECT_THAT(mayaCacheSampleFault(false, std::uint64_t{1} << 30U, false), HasSubstr("2 GiB"));
}

TEST(MayaCacheSizes, EndWhereSignedCountsEndInWideFiles) {
    EXPECT_EQ(mayaCacheSampleFault(/*wide=*/true, 2'000'000'000, /*doubles=*/true), nullptr);
    EXPECT_EQ(mayaCacheSampleFault(true, INT32_MAX, true), nullptr);
    EXPECT_NE(mayaCacheSampleFault(true, std::uint64_t{INT32_MAX} + 1, true), nullptr);
    EXPECT_NE(mayaCacheSampleFault(true, UINT32_MAX, false), nullptr);
    EXPECT_NE(mayaCacheSampleFault(true, 0, true), nullptr);
}

TEST_P(CacheWriting, RefusesMorePointsThanItsSizesCanSay) {
    if (isMax()) {
        make();
        EXPECT_FALSE(cache->OpenFileForWrite(0.0, 24.0, 1U, 0x80000000U, &status));
        expectReason("more points");
        EXPECT_FALSE(cache->OpenFileForWrite(0.0, 24.0, 0xFFFFFFFFU, 1U, &status));
        expectReason("more points");
        EXPECT_FALSE(cache->OpenFileForWrite(0.0, 24.0, 0x7FFFFFFFU, 0x7FFFFFFFU, &status));
        expectReason("a file can store");
    } else {
        ASSERT_TRUE(open());
        FbxTime time;
        const unsigned int count = GetParam() == Kind::eWide ? 0x80000000U : 0x06000000U;
        EXPECT_FALSE(cache->Write(0, time, points.data(), count, &status)); // refused before a point is read
        expectReason(GetParam() == Kind::eWide ? "more points" : "2 GiB");
        EXPECT_FALSE(cache->CloseFile(&status));
    }
    EXPECT_TRUE(contents().empty());
}

TEST_P(CacheWriting, RefusesTimesThatItCannotState) {
    if (isMax()) {
        make();
        for (const double start : {16777217.0, -16777217.0, 1e30, std::numeric_limits<double>::infinity(),
                                   std::numeric_limits<double>::quiet_NaN()}) {
            EXPECT_FALSE(cache->OpenFileForWrite(start, 24.0, 1U, 1U, &status)) << start;
            expectReason("start frame");
        }
        EXPECT_TRUE(cache->OpenFileForWrite(16777216.0, 24.0, 1U, 1U, &status)) << status.GetErrorString();
        EXPECT_TRUE(cache->CloseFile(&status)) << status.GetErrorString();
        return;
    }
    for (const double seconds : {357914.0, -357914.0}) { // 2^31 six-thousandths of a second are 357913.9 seconds
        ASSERT_TRUE(open());
        FbxTime time;
        time.SetSecondDouble(seconds);
        EXPECT_FALSE(cache->Write(0, time, points.data(), 2U, &status)) << seconds;
        expectReason("at a time");
        EXPECT_FALSE(cache->CloseFile(&status));
        EXPECT_TRUE(contents().empty());
    }
}

TEST(MayaCacheFiles, RefusePointsBeyondFloatsWhereFloatsAreStored) {
    const support::TemporaryFolder folder;
    FbxManager* manager = FbxManager::Create();
    FbxCache* cache = FbxCache::Create(manager, "ball");
    cache->SetCacheFileFormat(FbxCache::eMayaCache);
    cache->SetCacheFileName("", folder.file("ball.xml").c_str());
    std::array<double, 3> large = {0, 1e39, 0};
    FbxTime time;
    FbxStatus status;

    for (const auto type : {FbxCache::eFloatVectorArray, FbxCache::eDoubleVectorArray}) {
        const bool fits = type == FbxCache::eDoubleVectorArray;
        ASSERT_TRUE(cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC, type));
        EXPECT_EQ(cache->Write(0, time, large.data(), 1U, &status), fits) << status.GetErrorString();
        EXPECT_EQ(cache->CloseFile(&status), fits);
    }
    manager->Destroy();
}

TEST(MayaCacheFiles, CannotHaveTheSameName) {
    const support::TemporaryFolder folder;
    detail::MayaCacheDescription description;
    FbxStatus status;

    EXPECT_FALSE(detail::MayaCacheWriter::open(folder.file("ball.mc"), description, status));
    EXPECT_STREQ(status.GetErrorString(), "the cache description has the name of its data file");
    description.wide = true;
    EXPECT_TRUE(detail::MayaCacheWriter::open(folder.file("ball.mc"), description, status));
    EXPECT_TRUE(folder.files().empty());
}
