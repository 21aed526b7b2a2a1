// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that another program rewrites in place while they are read, as many exporters do: the old content, or a failure
// with a reason; never a signal, and never an empty mesh instead of one that could not be read.
#include <algorithm>
#include <atomic>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"
#include "TnFbxMesh.h"
#include "TnFbxReadInfo.h"
#include "TnFbxWriteInfo.h"
#include "support/TemporaryFolder.h"

namespace Tarnell::Fbx {
namespace {

constexpr int kSide = 90; // enough points for their arrays to be read late
constexpr int kPoints = kSide * kSide;
constexpr int kSets = 3;

std::unique_ptr<TnFbxMesh> wavingSheet() {
    auto mesh = std::make_unique<TnFbxMesh>();
    mesh->setName("sheet");
    mesh->allocateGeometryData(kPoints - kSide - 1, kPoints, 3 * (kPoints - kSide - 1));
    for (int i = 0; i < mesh->getNumberOfPolygons(); ++i) {
        mesh->setPolygonVertexSize(i, 3);
        mesh->setPointIndex(3 * i, i);
        mesh->setPointIndex(3 * i + 1, i + 1);
        mesh->setPointIndex(3 * i + 2, i + kSide);
    }
    for (int set = 0; set < kSets; ++set) {
        if (set > 0)
            mesh->addControlPointSet();
        for (int i = 0; i < kPoints; ++i) {
            const auto number = static_cast<float>(i);
            const float x = number * 0.37f, y = number * number * 0.11f, z = static_cast<float>(set);
            set == 0 ? mesh->setControlPoint(i, x, y, z) : mesh->addControlPoint(x, y, z);
        }
    }
    return mesh;
}

enum class Caches { none, maya, max };

struct Layout {
    const char* name;
    bool ascii;
    TnFbxWriteInfo::eCompatibilityVersion version;
    Caches caches;
    const char* changes; ///< the extension of the file that is rewritten
};

void PrintTo(const Layout& layout, std::ostream* out) { *out << layout.name; }

/// A scene on disk, of which one file is shortened and rewritten for as long as the object exists.
class Rewriting {
public:
    explicit Rewriting(std::string file) : mFile(std::move(file)) {
        std::ifstream in(mFile, std::ios::binary);
        mContent.assign(std::istreambuf_iterator<char>(in), {});
        mWriter = std::jthread([this](const std::stop_token& stop) {
            for (int round = 0; !stop.stop_requested(); ++round) {
                std::ofstream out(mFile, std::ios::binary | std::ios::trunc);
                const std::size_t half = mContent.size() / static_cast<std::size_t>(2 + round % 7);
                out.write(mContent.data(), static_cast<std::streamsize>(half));
                out.flush();
                std::this_thread::yield();
                out.write(mContent.data() + half, static_cast<std::streamsize>(mContent.size() - half));
                out.close();
                std::this_thread::sleep_for(std::chrono::milliseconds(round % 5)); // some reads find a complete file
            }
        });
    }

private:
    std::string mFile, mContent;
    std::jthread mWriter; // last, so that it ends first
};

class ChangingFile : public testing::TestWithParam<Layout> {
protected:
    void SetUp() override {
        const auto mesh = wavingSheet();
        TnFbxWriteInfo info;
        info.setFileName(fbx());
        info.setAnimationStackName("Take 001");
        info.setFileFormat(GetParam().ascii);
        info.setCompatibilityVersion(GetParam().version);
        info.setAnimateMeshVertices(GetParam().caches != Caches::none);
        info.setMayaVertexCacheFormat(GetParam().caches == Caches::maya);
        info.setFPS(24.0f);
        info.setStartFrame(0.0f);
        info.setEndFrame(static_cast<float>(kSets - 1));
        ASSERT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, {mesh.get()})) << lastError();
    }

    [[nodiscard]] std::string fbx() const { return mFolder.file("shot.fbx"); }
    [[nodiscard]] std::string changingFile() const {
        for (const auto& entry : std::filesystem::recursive_directory_iterator(mFolder.path()))
            if (entry.path().extension() == GetParam().changes)
                return entry.path().string();
        ADD_FAILURE() << "no file *" << GetParam().changes;
        return {};
    }
    TnFbxReadInfo options() const {
        TnFbxReadInfo info;
        info.setFileName(fbx());
        info.setAnimationStackName("Take 001");
        info.setFrame(1.0f);
        return info;
    }

    support::TemporaryFolder mFolder;
};

TEST_P(ChangingFile, IsReadAsItWasOrNotAtAll) {
    const Rewriting rewriting(changingFile());
    int successes = 0, failures = 0;
    for (int i = 0; i < 60; ++i) {
        TnFbxReadInfo info = options();
        TnFbxMesh* meshes = nullptr;
        int count = 0;
        const bool result = Fbx().getMeshes(info, &meshes, count);
        const std::unique_ptr<TnFbxMesh[]> owner(meshes);
        if (!result) {
            EXPECT_NE(lastError().find(GetParam().changes), std::string::npos) << lastError();
            ++failures;
            continue;
        }
        ++successes;
        for (int m = 0; m < count; ++m) {
            EXPECT_EQ(meshes[m].getNumberOfControlPoints(), kPoints);
            EXPECT_EQ(meshes[m].getNumberOfPolygons(), kPoints - kSide - 1);
        }
    }
    EXPECT_EQ(successes + failures, 60);
}

/// A cache is opened by the read that needs it.
class ChangingScene : public ChangingFile {};

TEST_P(ChangingScene, FailsTheReadThatComesTooLate) {
    for (const bool shortened : {true, false}) {
        SetUp();
        FbxSdk sdk;
        ASSERT_TRUE(Fbx().loadScene(fbx(), sdk)) << lastError();
        std::string content = mFolder.read("shot.fbx");
        std::reverse(content.begin(), content.end());
        mFolder.write("shot.fbx", content.substr(0, shortened ? 100 : content.size()));
        TnFbxReadInfo info = options();
        for (int tries = 0; tries < 2; ++tries) {
            TnFbxMesh mesh;
            const bool result = sdk.getMeshes(info, &mesh, 1);
            // Files without arrays, ASCII and binary ones before 7.x, are in memory as a whole.
            if (GetParam().ascii || GetParam().version == TnFbxWriteInfo::kFbxVersion2010) {
                EXPECT_TRUE(result) << lastError();
                EXPECT_EQ(mesh.getNumberOfControlPoints(), kPoints);
            } else {
                EXPECT_FALSE(result);
                EXPECT_EQ(lastError(), fbx() + ": the file was changed while it was read");
            }
        }
    }
}

constexpr Layout kScenes[] = {
    {"Binary7", false, TnFbxWriteInfo::kFbxVersion2016, Caches::none, ".fbx"},
    {"Binary6", false, TnFbxWriteInfo::kFbxVersion2010, Caches::none, ".fbx"},
    {"Ascii", true, TnFbxWriteInfo::kFbxVersion2014, Caches::none, ".fbx"},
};
constexpr Layout kCaches[] = {
    {"MayaDescription", false, TnFbxWriteInfo::kFbxVersion2014, Caches::maya, ".xml"},
    {"MayaNarrow", false, TnFbxWriteInfo::kFbxVersion2014, Caches::maya, ".mc"},
    {"MayaWide", false, TnFbxWriteInfo::kFbxVersion2016, Caches::maya, ".mcx"},
    {"Max", false, TnFbxWriteInfo::kFbxVersion2016, Caches::max, ".pc2"},
};

std::string nameOf(const testing::TestParamInfo<Layout>& layout) { return layout.param.name; }

INSTANTIATE_TEST_SUITE_P(Scenes, ChangingFile, testing::ValuesIn(kScenes), nameOf);
INSTANTIATE_TEST_SUITE_P(Caches, ChangingFile, testing::ValuesIn(kCaches), nameOf);
INSTANTIATE_TEST_SUITE_P(Scenes, ChangingScene, testing::ValuesIn(kScenes), nameOf);

} // namespace
} // namespace Tarnell::Fbx
