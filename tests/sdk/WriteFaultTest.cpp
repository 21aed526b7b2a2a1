// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writing whole scenes while a resource fails: memory, the medium, the folder. The previous files stay, and
// nothing else is left behind.
//
// The allocation functions of this executable are replaced by ones that count and that fail on request.
#include "support/AsNobody.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <limits>
#include <new>
#include <thread>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

constexpr long kNever = std::numeric_limits<long>::max();

std::atomic<long> gAllocations{0};          ///< since the counters were set
std::atomic<long> gFirstFailing{kNever};    ///< the number of the first allocation that fails
std::atomic<long> gFirstWorkingAgain{0};    ///< the number of the first after those that fail
std::atomic<long> gLive{0};                 ///< allocations that are not freed
std::atomic<bool> gHasQuietlyFailed{false}; ///< without an exception, which some algorithms handle

void* allocate(std::size_t size) noexcept {
    const long number = gAllocations++;
    if (number >= gFirstFailing && number < gFirstWorkingAgain)
        return nullptr;
    void* memory = std::malloc(size != 0 ? size : 1);
    gLive += memory != nullptr ? 1 : 0;
    return memory;
}

void* allocateQuietly(std::size_t size) noexcept {
    void* memory = allocate(size);
    gHasQuietlyFailed = gHasQuietlyFailed || memory == nullptr;
    return memory;
}

void* allocateOrThrow(std::size_t size) {
    if (void* memory = allocate(size))
        return memory;
    throw std::bad_alloc();
}

void release(void* memory) noexcept {
    gLive -= memory != nullptr ? 1 : 0;
    std::free(memory);
}

} // namespace

void* operator new(std::size_t size) { return allocateOrThrow(size); }
void* operator new[](std::size_t size) { return allocateOrThrow(size); }
void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return allocateQuietly(size); }
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept { return allocateQuietly(size); }
void operator delete(void* memory) noexcept { release(memory); }
void operator delete[](void* memory) noexcept { release(memory); }
void operator delete(void* memory, std::size_t) noexcept { release(memory); }
void operator delete[](void* memory, std::size_t) noexcept { release(memory); }
void operator delete(void* memory, const std::nothrow_t&) noexcept { release(memory); }
void operator delete[](void* memory, const std::nothrow_t&) noexcept { release(memory); }

namespace Tarnell::Fbx {
namespace {

using support::AsNobody;
using support::TemporaryFolder;
using testing::AllOf;
using testing::Contains;
using testing::HasSubstr;
using testing::StartsWith;
namespace fs = std::filesystem;
using Names = std::vector<std::string>;

constexpr int kFirstFrame = 1, kLastFrame = 4;

/// One object of every kind, animated, and meshes with all of their layers and with a point cache.
class Shot {
public:
    Shot() : mBox(test::polygonMesh("box", 5)), mWaving(test::movingMesh("waving", kLastFrame - kFirstFrame + 1)) {
        mCamera.setName("camera");
        mCamera.setValueAt(TnFbxCamera::kFbxCameraFocalLength, frames(), {35.0f, 36.0f, 38.0f, 41.0f});
        for (TnFbxLight& light : mLights) {
            const auto type = static_cast<TnFbxLight::EFbxLightType>(&light - mLights.data());
            light.setName("light with a name that is longer than a short text " + std::to_string(type));
            light.setLightType(type);
            light.setValueAt(TnFbxLight::kFbxLightIntensity, frames(), {1.0f, 0.5f, 0.25f, 0.0f});
        }
        mNull.setName("null");
        mTransform.setName("transform");
        for (TnFbxTransform* object : transforms()) {
            object->setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, frames(), {1.0f, 2.0f, 4.0f, 7.0f});
            object->setTransformValueAt(TnFbxTransform::kFbxTransformRotationY, frames(), {9.0f, 8.0f, 6.0f, 3.0f});
        }
        for (int vertex = 0; vertex < 5; ++vertex) {
            mBox->setNormal(vertex, 0.0f, 0.0f, 1.0f);
            mBox->setUV(vertex, 0.25f, 0.5f);
            mBox->setColour(vertex, 0.25f, 0.5f, 0.75f, 1.0f);
        }
        mBox->setValidNormals(true);
        mBox->setValidUVs(true);
        mBox->setValidColours(true);
    }

    [[nodiscard]] test::WrittenObjects objects() {
        return {
            {&mCamera}, {&mLights[0], &mLights[1], &mLights[2]}, {&mTransform}, {&mNull}, {mBox.get(), mWaving.get()}};
    }

private:
    static TnFbxTime frames() { return test::timeOf(kFirstFrame, kLastFrame - kFirstFrame + 1); }
    std::vector<TnFbxTransform*> transforms() {
        return {&mCamera, &mLights[0], &mLights[1], &mLights[2], &mNull, &mTransform};
    }

    TnFbxCamera mCamera;
    std::array<TnFbxLight, 3> mLights;
    TnFbxNull mNull;
    TnFbxTransform mTransform;
    std::unique_ptr<TnFbxMesh> mBox, mWaving;
};

struct Layout {
    const char* name;
    bool ascii;
    TnFbxWriteInfo::eCompatibilityVersion version;
    bool mayaCache;
};

class WriteFault : public testing::TestWithParam<Layout> {
protected:
    // Files contain the time, in ASCII with a variable number of digits: without it all files are of one size.
    WriteFault() {
        ::setenv("SOURCE_DATE_EPOCH", "1585690463", 1);
        setFileName(file);
    }
    ~WriteFault() override { ::unsetenv("SOURCE_DATE_EPOCH"); }

    void setFileName(const std::string& name) {
        file = name;
        info.setFileName(name);
        info.setAnimationStackName("Take 001");
        info.setFileFormat(GetParam().ascii);
        info.setCompatibilityVersion(GetParam().version);
        info.setMayaVertexCacheFormat(GetParam().mayaCache);
        info.setStartFrame(kFirstFrame);
        info.setEndFrame(kLastFrame);
    }
    bool write() {
        return Fbx().writeFile(info, objects.cameras, objects.lights, objects.transforms, objects.nulls,
                               objects.meshes);
    }

    /// The files of the cache; the first one comes first.
    static Names cacheNames() {
        const Layout& layout = GetParam();
        if (!layout.mayaCache)
            return {"waving.pc2"};
        return {layout.version == TnFbxWriteInfo::kFbxVersion2016 ? "waving.mcx" : "waving.mc", "waving.xml"};
    }
    Names cacheContents() const {
        Names contents;
        for (const std::string& name : cacheNames())
            contents.push_back(folder.read("shot_fpc/" + name));
        return contents;
    }
    void writeOldFiles() const {
        folder.write("shot.fbx", "old");
        for (const std::string& name : cacheNames())
            folder.write("shot_fpc/" + name, "old " + name);
    }
    /// The files of a write without faults.
    void writeReference() {
        writeOldFiles();
        oldCache = cacheContents();
        ASSERT_TRUE(write()) << lastError();
        completeSize = folder.read("shot.fbx").size();
        completeCache = cacheContents();
        ASSERT_NE(oldCache, completeCache);
        writeOldFiles();
    }
    /// Scene and cache are unchanged.
    void expectOldFiles() const {
        EXPECT_EQ(folder.read("shot.fbx"), "old");
        expectNothingElse();
        EXPECT_EQ(cacheContents(), oldCache);
    }
    void expectNewFiles() const {
        EXPECT_EQ(folder.read("shot.fbx").size(), completeSize);
        expectNothingElse();
        EXPECT_EQ(cacheContents(), completeCache);
    }
    void expectNothingElse() const {
        EXPECT_EQ(folder.files(), (Names{"shot.fbx", "shot_fpc"}));
        EXPECT_EQ(folder.files("shot_fpc"), cacheNames());
    }

    TemporaryFolder folder;
    std::string file = folder.file("shot.fbx");
    Shot shot;
    test::WrittenObjects objects = shot.objects();
    TnFbxWriteInfo info;
    std::size_t completeSize = 0;
    Names oldCache, completeCache;
};

INSTANTIATE_TEST_SUITE_P(Layouts, WriteFault,
                         testing::Values(Layout{"Binary2010", false, TnFbxWriteInfo::kFbxVersion2010, false},
                                         Layout{"Binary2016", false, TnFbxWriteInfo::kFbxVersion2016, true},
                                         Layout{"Ascii2010", true, TnFbxWriteInfo::kFbxVersion2010, true},
                                         Layout{"Ascii2016", true, TnFbxWriteInfo::kFbxVersion2016, false}),
                         [](const auto& layout) { return layout.param.name; });

// ---- Memory ----

enum class Outcome { eWritten, eRefused, eThrown };

/// Makes allocations fail from one on, that many.
template <class Action>
Outcome outcomeWithoutMemory(long first, long count, const Action& action) {
    gHasQuietlyFailed = false;
    gAllocations = 0;
    gFirstWorkingAgain = first > kNever - count ? kNever : first + count;
    gFirstFailing = first;
    Outcome outcome = Outcome::eThrown;
    try {
        outcome = action() ? Outcome::eWritten : Outcome::eRefused;
    } catch (const std::bad_alloc&) {
    }
    gFirstFailing = kNever;
    return outcome;
}

/// Allocations that are not freed, except for the data of the last call.
long liveAllocations() {
    const auto allocates = [](const std::string& text) { return text.capacity() > std::string().capacity(); };
    const std::vector<std::string>& warnings = lastWarnings();
    return gLive - (allocates(lastError()) ? 1 : 0) - (warnings.capacity() > 0 ? 1 : 0) -
           std::count_if(warnings.begin(), warnings.end(), allocates);
}

TEST(FailedStart, OfAManagerLeavesNothingBehindWhenItIsRepeated) {
    const auto startTwice = [](long first) {
        FbxSdk sdk;
        const Outcome outcome = outcomeWithoutMemory(first, 1, [&sdk] { return sdk.initFbxSdkManager(); });
        EXPECT_TRUE(sdk.initFbxSdkManager());
        return outcome;
    };
    startTwice(kNever);
    const long live = liveAllocations();
    bool failed = true;
    for (long first = 0; failed; ++first) {
        failed = startTwice(first) == Outcome::eThrown;
        EXPECT_EQ(liveAllocations(), live) << first;
    }
}

/// All of the first and the last ones, and some hundred evenly between them.
std::vector<long> sampledAllocations(long count) {
    constexpr long kAtBothEnds = 200, kSamples = 400;
    std::vector<long> numbers;
    const long end = count - kAtBothEnds;
    const long stride = std::max(1L, (end - kAtBothEnds) / kSamples);
    for (long number = 0; number < count;) {
        numbers.push_back(number);
        number = number < kAtBothEnds || number >= end ? number + 1 : std::min(number + stride, end);
    }
    return numbers;
}

TEST_P(WriteFault, InAnyAllocationLeavesTheOldFileAndNothingElse) {
    writeReference();
    ASSERT_EQ(outcomeWithoutMemory(kNever, 0, [this] { return write(); }), Outcome::eWritten);
    const long count = gAllocations;
    ASSERT_GT(count, 1000);
    writeOldFiles();

    for (const long failures : {1L, kNever}) { // one, or all from there on
        for (const long first : sampledAllocations(count)) {
            SCOPED_TRACE("allocation " + std::to_string(first));
            const long before = liveAllocations();
            const Outcome outcome = outcomeWithoutMemory(first, failures, [this] { return write(); });
            const long leaked = liveAllocations() - before;

            EXPECT_EQ(leaked, 0);
            if (outcome == Outcome::eWritten) {
                EXPECT_TRUE(gHasQuietlyFailed);
                expectNewFiles();
                writeOldFiles();
                continue;
            }
            EXPECT_TRUE(outcome != Outcome::eRefused || !lastError().empty());
            expectOldFiles();
            if (HasFailure())
                return; // the others would repeat the same hundreds of times
        }
    }
}

// ---- The medium ----

/// The result of a write in another process.
struct Report {
    bool written = false;
    std::string error; ///< and a line for each warning
};

/// Writes in a process of its own, in which no file can be larger than that.
template <class Action>
Report writtenWithin(rlim_t bytes, const Action& action) {
    std::array<int, 2> pipe{};
    EXPECT_EQ(::pipe(pipe.data()), 0);
    const pid_t child = ::fork();
    if (child == 0) {
        ::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit{bytes, bytes};
        ::setrlimit(RLIMIT_FSIZE, &limit);
        const int nowhere = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
        ::dup2(nowhere, STDOUT_FILENO); // a cache that cannot be opened is reported there
        const bool written = action();
        std::string text = (written ? "1" : "0") + lastError();
        for (const std::string& warning : lastWarnings())
            text += '\n' + warning;
        ::_exit(::write(pipe[1], text.data(), text.size()) == static_cast<ssize_t>(text.size()) ? 0 : 1);
    }
    ::close(pipe[1]);
    std::string text;
    char piece[256];
    for (ssize_t count = 0; (count = ::read(pipe[0], piece, sizeof piece)) > 0;)
        text.append(piece, static_cast<std::size_t>(count));
    ::close(pipe[0]);
    int status = -1;
    EXPECT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_EQ(status, 0);
    return {!text.empty() && text[0] == '1', text.empty() ? "" : text.substr(1)};
}

/// The number of allocations of a call.
template <class Action>
long allocationsOf(const Action& action) {
    const long before = gAllocations;
    action();
    return gAllocations - before;
}

TEST_P(WriteFault, OfOptionsThatAreIncompleteComesBeforeAnythingIsMade) {
    const long ofAContext = allocationsOf([] {
        FbxSdk sdk;
        EXPECT_TRUE(sdk.initFbxSdkManager());
    });
    constexpr long kOfAReason = 8; // what its text takes
    ASSERT_GT(ofAContext, kOfAReason);
    const TnFbxWriteInfo complete = info;

    info.setAnimationStackName("");
    EXPECT_LE(allocationsOf([this] { EXPECT_FALSE(write()); }), kOfAReason);
    info = complete;
    info.setFileName("");
    EXPECT_LE(allocationsOf([this] { EXPECT_FALSE(write()); }), kOfAReason);
}

TEST_P(WriteFault, OfAMediumThatIsFullAtAnySizeLeavesTheOldFile) {
    writeReference();
    constexpr std::size_t kSteps = 40;
    std::vector<std::size_t> sizes = {0, 1, 30, 31, 32, 33, 100, 500, completeSize - 1, completeSize, completeSize + 1};
    for (std::size_t step = 1; step < kSteps; ++step)
        sizes.push_back(completeSize * step / kSteps);

    for (const std::size_t size : sizes) {
        SCOPED_TRACE("room for " + std::to_string(size) + " bytes");
        const Report report = writtenWithin(size, [this] { return write(); });

        EXPECT_EQ(report.written, size >= completeSize);
        if (report.written) {
            expectNewFiles();
        } else {
            EXPECT_THAT(report.error, StartsWith(file + ": "));
            EXPECT_THAT(report.error, HasSubstr("File too large"));
            expectOldFiles();
        }
        writeOldFiles();
    }
}

TEST_P(WriteFault, OfTheCacheOnAMediumThatIsFullWritesTheMeshWithoutItAndSaysSo) {
    constexpr int kFrames = 8000; // the cache is larger than the scene
    const auto waving = test::movingMesh("waving", kFrames);
    objects.meshes = {waving.get()};
    info.setEndFrame(kFirstFrame + kFrames - 1);
    ASSERT_TRUE(write()) << lastError();
    const std::size_t sceneSize = folder.read("shot.fbx").size();
    ASSERT_GT(folder.read("shot_fpc/" + cacheNames().front()).size(), sceneSize + 1000);
    for (const bool replacing : {false, true}) {
        SCOPED_TRACE(replacing ? "replacing" : "alone");
        fs::remove_all(folder.file("shot_fpc"));
        folder.write("shot.fbx", "old");
        if (replacing)
            writeOldFiles();

        const Report report = writtenWithin(sceneSize, [this] { return write(); });

        EXPECT_TRUE(report.written) << report.error;
        EXPECT_THAT(report.error, HasSubstr("waving: written without its animation: "));
        EXPECT_THAT(report.error, HasSubstr("File too large"));
        EXPECT_EQ(report.error.find("an older point cache still exists") != std::string::npos, replacing);
        EXPECT_EQ(folder.read("shot.fbx").find("_fpc"), std::string::npos) << "nothing refers to a cache";
        EXPECT_EQ(folder.files("shot_fpc"), replacing ? cacheNames() : Names{});
    }
}

TEST_P(WriteFault, OfADeviceThatIsFullIsReported) {
    fs::create_symlink("/dev/full", file);

    EXPECT_FALSE(write());

    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_THAT(lastError(), HasSubstr("No space left on device"));
    EXPECT_TRUE(fs::is_symlink(file));
    EXPECT_EQ(folder.files(), Names{"shot.fbx"}) << "nor is there a cache that nothing refers to";
}

TEST_P(WriteFault, OfAPipeThatBreaksIsReported) {
    ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
    test::WrittenObjects many = objects; // more than a pipe holds without a reader
    many.meshes.insert(many.meshes.end(), 100, objects.meshes[0]);
    objects = many;
    std::thread reader([this] {
        const int end = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
        char byte = 0;
        EXPECT_EQ(::read(end, &byte, 1), 1);
        ::close(end);
    });

    EXPECT_FALSE(write());

    reader.join();
    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_THAT(lastError(), HasSubstr("Broken pipe"));
}

// ---- The folder ----

TEST_P(WriteFault, OfAFolderThatCannotBeWrittenToLeavesTheOldFile) {
    folder.write("shot.fbx", "old");
    fs::permissions(folder.path(), fs::perms(0555));
    {
        const AsNobody nobody;
        EXPECT_FALSE(write());
    }
    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_THAT(lastError(), HasSubstr("Permission denied"));
    EXPECT_EQ(folder.read("shot.fbx"), "old");
    EXPECT_EQ(folder.files(), Names{"shot.fbx"});
}

TEST_P(WriteFault, OfAFileThatIsLockedLeavesIt) {
    folder.write("shot.fbx", "old");
    fs::permissions(folder.path(), fs::perms(0777));
    fs::permissions(file, fs::perms(0444));
    {
        const AsNobody nobody;
        EXPECT_FALSE(write());
    }
    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_THAT(lastError(), HasSubstr("Permission denied"));
    EXPECT_EQ(folder.read("shot.fbx"), "old");
    EXPECT_EQ(folder.files(), Names{"shot.fbx"});
}

TEST_P(WriteFault, OfAFileInThePlaceOfTheFolderLeavesIt) {
    folder.write("out", "no folder");
    setFileName(folder.file("out/shot.fbx"));

    EXPECT_FALSE(write());

    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_EQ(folder.read("out"), "no folder");
    EXPECT_EQ(folder.files(), Names{"out"});
}

TEST_P(WriteFault, OfAFolderThatWasRemovedIsReported) {
    fs::create_directory(folder.file("out"));
    setFileName(folder.file("out/shot.fbx"));
    test::WrittenScene scene;
    ASSERT_TRUE(scene.create(objects, info)) << lastError();

    fs::remove_all(folder.file("out"));

    EXPECT_FALSE(scene.sdk.saveScene(info));
    EXPECT_THAT(lastError(), StartsWith(file + ": "));
    EXPECT_TRUE(folder.files().empty());
}

TEST_P(WriteFault, OfTheCacheAloneLeavesTheOldCacheAndWritesTheScene) {
    writeReference();
    fs::permissions(folder.path(), fs::perms(0777));
    fs::permissions(folder.file("shot_fpc"), fs::perms(0555));
    fs::permissions(file, fs::perms(0666));
    testing::internal::CaptureStdout();
    {
        const AsNobody nobody;
        EXPECT_TRUE(write()) << lastError();
    }
    EXPECT_THAT(testing::internal::GetCapturedStdout(), HasSubstr("Permission denied"));
    EXPECT_THAT(lastWarnings(), Contains(AllOf(StartsWith("waving: written without its animation: "),
                                               HasSubstr("Permission denied"), HasSubstr("an older point cache"))));
    EXPECT_EQ(folder.read("shot.fbx").find("waving.xml"), std::string::npos) << "it would be read from the old cache";
    EXPECT_EQ(folder.read("shot.fbx").find("waving.pc2"), std::string::npos);
    EXPECT_EQ(cacheContents(), oldCache);
    EXPECT_EQ(folder.files("shot_fpc"), cacheNames());
}

} // namespace
} // namespace Tarnell::Fbx
