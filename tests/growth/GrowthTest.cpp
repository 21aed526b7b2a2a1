// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Twice the objects take twice the work, or little more: every kind of object and connection, read, written, shown and
// converted at n, 2n and 4n. Work is counted in basic blocks, so the numbers are the same in every run.
#include "GrowingFiles.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <iostream>
#include <memory>
#include <streambuf>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk.h>

#include "Commands.h"
#include "support/TemporaryFolder.h"

namespace {

std::uint64_t gSteps = 0;

/// The work of a library function per step.
constexpr std::size_t kBytesPerStep = 16;

} // namespace

// Called by every basic block of the measured code, and linked in place of functions that process bytes.
extern "C" {
// NOLINTBEGIN(bugprone-reserved-identifier): the names are the compiler's and the linker's
void __sanitizer_cov_trace_pc() { ++gSteps; }

void* __real_memmove(void* to, const void* from, std::size_t size);
void* __real_memcpy(void* to, const void* from, std::size_t size);
void* __real_memchr(const void* bytes, int wanted, std::size_t size);
int __real_memcmp(const void* a, const void* b, std::size_t size);
std::size_t __real_strlen(const char* text);

void* __wrap_memmove(void* to, const void* from, std::size_t size) {
    gSteps += size / kBytesPerStep;
    return __real_memmove(to, from, size);
}
void* __wrap_memcpy(void* to, const void* from, std::size_t size) {
    gSteps += size / kBytesPerStep;
    return __real_memcpy(to, from, size);
}
void* __wrap_memchr(const void* bytes, int wanted, std::size_t size) {
    void* const found = __real_memchr(bytes, wanted, size);
    const auto* const first = static_cast<const char*>(bytes);
    gSteps += (found ? static_cast<std::size_t>(static_cast<const char*>(found) - first) : size) / kBytesPerStep;
    return found;
}
int __wrap_memcmp(const void* a, const void* b, std::size_t size) {
    gSteps += size / kBytesPerStep;
    return __real_memcmp(a, b, size);
}
std::size_t __wrap_strlen(const char* text) {
    const std::size_t length = __real_strlen(text);
    gSteps += length / kBytesPerStep;
    return length;
}
// NOLINTEND(bugprone-reserved-identifier)
}

namespace {

constexpr double kMostExponent = 1.2;
/// Takes what commands print.
class Discarded : public std::streambuf {
protected:
    int_type overflow(int_type character) override { return traits_type::not_eof(character); }
    std::streamsize xsputn(const char*, std::streamsize count) override { return count; }
};

class PrintsNothing {
public:
    PrintsNothing() : mFormer(std::cout.rdbuf(&mDiscarded)) {}
    PrintsNothing(const PrintsNothing&) = delete;
    PrintsNothing& operator=(const PrintsNothing&) = delete;
    ~PrintsNothing() { std::cout.rdbuf(mFormer); }

private:
    Discarded mDiscarded;
    std::streambuf* mFormer;
};

struct DestroyManager {
    void operator()(FbxManager* manager) const { manager->Destroy(); }
};

/// A file in the platform's scene.
class LoadedScene {
public:
    explicit LoadedScene(const std::string& file) : mManager(FbxManager::Create()) {
        FbxImporter* importer = FbxImporter::Create(mManager.get(), "");
        mScene = FbxScene::Create(mManager.get(), "");
        EXPECT_TRUE(importer->Initialize(file.c_str(), -1, nullptr)) << importer->GetStatus().GetErrorString();
        EXPECT_TRUE(importer->Import(mScene, false)) << importer->GetStatus().GetErrorString();
    }

    void write(const std::string& file, const char* version, int format) {
        FbxExporter* exporter = FbxExporter::Create(mManager.get(), "");
        exporter->SetFileExportVersion(version, FbxSceneRenamer::eNone);
        EXPECT_TRUE(exporter->Initialize(file.c_str(), format, nullptr)) << exporter->GetStatus().GetErrorString();
        EXPECT_TRUE(exporter->Export(mScene)) << exporter->GetStatus().GetErrorString();
        exporter->Destroy();
    }

private:
    std::unique_ptr<FbxManager, DestroyManager> mManager;
    FbxScene* mScene;
};

template <class Work>
std::uint64_t stepsOf(Work work) {
    const std::uint64_t before = gSteps;
    work();
    return gSteps - before;
}

constexpr int kBinary = 0, kAscii = 1;

struct Cost {
    const char* work;
    std::uint64_t steps;
};

int convertTo(int version, const std::string& input, const std::string& output) {
    tool::ConvertOptions options;
    options.input = input;
    options.output = output;
    options.version = version;
    options.force = true;
    return tool::convert(options);
}

int infoOf(const std::string& file) {
    tool::LookOptions options;
    options.files = {file};
    return tool::info(options);
}

int dumpOf(const std::string& file) {
    tool::DumpOptions options;
    options.file = file;
    return tool::dump(options);
}

/// Findings and differences are not failures.
bool cameraLintAndDiffRun(const std::string& file) {
    tool::CameraOptions camera;
    tool::LintOptions lint;
    camera.files = lint.files = {file};
    tool::DiffOptions diff;
    diff.a = diff.b = file;
    return tool::camera(camera) == 0 && tool::lint(lint) <= 1 && tool::diff(diff) == 0;
}

/// Runs works on a file of a kind and records the cost of each.
class Measurement {
public:
    Measurement(const growth::Kind& kind, int count)
        : mFile(mFolder.write("in.fbx", kind.file(count))), mBinary(mFolder.path() + "/7.fbx"),
          mOld(mFolder.path() + "/6.fbx"), mOut(mFolder.path() + "/out.fbx") {}

    /// Works that are little more than a traversal of all objects.
    std::vector<Cost> ofWalks() {
        {
            std::unique_ptr<LoadedScene> scene;
            measure(
                "read 7.4 ASCII", [&] { scene = std::make_unique<LoadedScene>(mFile); });
            measure("write 7.5 binary", [&] { scene->write(mBinary, "FBX201600", kBinary); });
        }
        measure(
            "read 7.5 binary", [&] { const LoadedScene scene(mBinary); });
        measure("info", [&] { EXPECT_EQ(infoOf(mFile), 0); });
        return mCosts;
    }

    /// Works that write or look at all properties of each object.
    std::vector<Cost> ofLongWorks() {
        measure(
            "write 6.1 ASCII", [&] { LoadedScene(mFile).write(mOld, "FBX201000", kAscii); });
        measure(
            "read 6.1 ASCII", [&] { const LoadedScene scene(mOld); });
        measure(
            "info of 6.1", [&] { EXPECT_EQ(infoOf(mOld), 0); });
        measure(
            "dump", [&] { EXPECT_EQ(dumpOf(mFile), 0); });
        measure(
            "dump of 6.1", [&] { EXPECT_EQ(dumpOf(mOld), 0); });
        measure(
            "camera, lint and diff", [&] { EXPECT_TRUE(cameraLintAndDiffRun(mFile)); });
        measure(
            "convert to 6.1", [&] { EXPECT_EQ(convertTo(0, mFile, mOut), 0); });
        measure("convert to 7.5", [&] { EXPECT_EQ(convertTo(5, mFile, mOut), 0); });
        return mCosts;
    }

private:
    template <class Work>
    void measure(const char* work, const Work& run) {
        const PrintsNothing quiet;
        mCosts.push_back({work, stepsOf(run)});
    }

    support::TemporaryFolder mFolder;
    std::string mFile, mBinary, mOld, mOut;
    std::vector<Cost> mCosts;
};

using Works = std::vector<Cost> (Measurement::*)();

void expectGrowth(const growth::Kind& kind, Works works, int count) {
    const auto costs = [&](int number) { return (Measurement(kind, number).*works)(); };
    costs(1); // what is computed once per process
    const std::vector<Cost> once = costs(count), twice = costs(2 * count), fourTimes = costs(4 * count);
    for (std::size_t i = 0; i < once.size(); ++i) {
        ASSERT_GT(once[i].steps, static_cast<std::uint64_t>(count)) << once[i].work << ": nothing counts";
        const double first = std::log2(static_cast<double>(twice[i].steps) / static_cast<double>(once[i].steps));
        const double second = std::log2(static_cast<double>(fourTimes[i].steps) / static_cast<double>(twice[i].steps));
        EXPECT_LE(std::max(first, second), kMostExponent)
            << once[i].work << ": " << once[i].steps << ", " << twice[i].steps << ", " << fourTimes[i].steps
            << " steps at " << count << ", " << 2 * count << ", " << 4 * count;
    }
}

class Growth : public testing::TestWithParam<growth::Kind> {};

TEST_P(Growth, OfWalksIsThatOfTheFile) { expectGrowth(GetParam(), &Measurement::ofWalks, 1000); }

TEST_P(Growth, OfLongWorksIsThatOfTheFile) { expectGrowth(GetParam(), &Measurement::ofLongWorks, 100); }

std::string nameOf(const testing::TestParamInfo<growth::Kind>& kind) { return kind.param.name; }

INSTANTIATE_TEST_SUITE_P(Kinds, Growth, testing::ValuesIn(growth::kinds()), nameOf);

} // namespace
