// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Point caches of every layout: between two samples, before the first and after the last one, at other rates than the
// scene's, and with an offset. The test stores the bytes of the caches itself.
#include "FaithfulFixture.h"

#include "FbxFaithful.h"
#include "TnFbxError.h"

#include <bit>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using fbxsdk::FbxCache;

constexpr int kPoints = 3;

/// The three numbers of each point: x is that of the point, y is the sample's, z is 1.
std::vector<double> numbersOf(double y) {
    std::vector<double> numbers;
    for (int point = 0; point < kPoints; ++point)
        numbers.insert(numbers.end(), {static_cast<double>(point), y, 1.0});
    return numbers;
}

template <class Unsigned>
std::string bytesOf(Unsigned number, bool bigEndian) {
    std::string bytes;
    for (std::size_t i = 0; i < sizeof number; ++i) {
        const std::size_t place = bigEndian ? sizeof number - 1 - i : i;
        bytes += static_cast<char>(static_cast<unsigned char>(number >> (8 * place)));
    }
    return bytes;
}
std::string little(std::uint32_t number) { return bytesOf(number, false); }
std::string little(float number) { return bytesOf(std::bit_cast<std::uint32_t>(number), false); }

std::string maxCache(float startFrame, float framesPerSample, const std::vector<double>& ys, int points = kPoints) {
    std::string bytes("POINTCACHE2\0", 12);
    bytes += little(1u) + little(static_cast<std::uint32_t>(points)) + little(startFrame) + little(framesPerSample) +
             little(static_cast<std::uint32_t>(ys.size()));
    for (const double y : ys)
        for (int i = 0; i < points * 3; ++i)
            bytes += little(static_cast<float>(numbersOf(y)[static_cast<std::size_t>(i % (kPoints * 3))]));
    return bytes;
}

/// The time of a sample in 6000ths of a second, and its y.
using Sample = std::pair<int, double>;

/// A Maya cache with one channel, "wave", of 250 ticks per frame.
struct MayaLayout {
    bool wide, doubles, filePerFrame;

    std::string chunk(const char* tag, const std::string& content) const {
        const std::size_t alignment = wide ? 8 : 4;
        const std::string padding((alignment - content.size() % alignment) % alignment, '\0');
        return head(tag, content.size()) + content + padding;
    }
    std::string head(const char* tag, std::size_t size) const {
        return wide ? tag + std::string(4, '\0') + bytesOf(static_cast<std::uint64_t>(size), true)
                    : tag + bytesOf(static_cast<std::uint32_t>(size), true);
    }
    std::string number(const char* tag, int value) const {
        return chunk(tag, bytesOf(static_cast<std::uint32_t>(value), true));
    }
    std::string group(const std::string& content) const {
        return head(wide ? "FOR8" : "FOR4", content.size()) + content;
    }
    std::string start(int first, int last) const {
        return group("CACH" + chunk("VRSN", std::string("0.1\0", 4)) + number("STIM", first) + number("ETIM", last));
    }
    std::string block(const std::string& channel, const std::vector<double>& numbers) const {
        std::string bytes;
        for (const double value : numbers)
            bytes += doubles ? bytesOf(std::bit_cast<std::uint64_t>(value), true)
                             : bytesOf(std::bit_cast<std::uint32_t>(static_cast<float>(value)), true);
        return chunk("CHNM", channel + '\0') + number("SIZE", static_cast<int>(numbers.size() / 3)) +
               chunk(doubles ? "DVCA" : "FVCA", bytes);
    }

    std::string description(const std::vector<std::string>& channels, int first, int last) const {
        std::string text = "<?xml version=\"1.0\"?>\n<Autodesk_Cache_File>\n<cacheType Type=\"" +
                           std::string(filePerFrame ? "OneFilePerFrame" : "OneFile") + "\" Format=\"" +
                           (wide ? "mcx" : "mcc") + "\"/>\n<time Range=\"" + std::to_string(first) + "-" +
                           std::to_string(last) +
                           "\"/>\n<cacheTimePerFrame TimePerFrame=\"250\"/>\n<cacheVersion Version=\"2.0\"/>\n"
                           "<Channels>\n";
        for (std::size_t i = 0; i < channels.size(); ++i) {
            text += "<channel" + std::to_string(i) + " ChannelName=\"" + channels[i] + "\" ChannelType=\"" +
                    (doubles ? "DoubleVectorArray" : "FloatVectorArray") +
                    "\" ChannelInterpretation=\"positions\" SamplingType=\"Irregular\" SamplingRate=\"250\" "
                    "StartTime=\"" +
                    std::to_string(first) + "\" EndTime=\"" + std::to_string(last) + "\"/>\n";
        }
        return text + "</Channels>\n</Autodesk_Cache_File>\n";
    }

    void write(const support::TemporaryFolder& folder, const std::vector<Sample>& samples) const {
        const char* suffix = wide ? ".mcx" : ".mc";
        folder.write("wave.xml", description({"wave"}, samples.front().first, samples.back().first));
        std::string all = start(0, 1);
        for (const auto& [ticks, y] : samples) {
            const std::string points = block("wave", numbersOf(y));
            all += group("MYCH" + number("TIME", ticks) + points);
            if (filePerFrame) {
                const int frame = ticks / 250, rest = ticks % 250;
                folder.write("waveFrame" + std::to_string(frame) + (rest != 0 ? "Tick" + std::to_string(rest) : "") +
                                 suffix,
                             start(ticks, ticks) + group("MYCH" + points));
            }
        }
        if (!filePerFrame)
            folder.write(std::string("wave") + suffix, all);
    }
};

/// A triangle whose points come from a cache next to it.
struct CachedScene : TestScene {
    explicit CachedScene(FbxCache::EFileFormat format) : TestScene(0, 24) {
        mesh = addTriangle(*this, "mesh")->GetMesh();
        addCache(format, "wave");
    }

    fbxsdk::FbxVertexCacheDeformer& addCache(FbxCache::EFileFormat format, const char* channel) {
        auto* cache = FbxCache::Create(scene, "cache");
        cache->SetCacheFileFormat(format);
        cache->SetCacheFileName("", folder.file(format == FbxCache::eMayaCache ? "wave.xml" : "wave.pc2").c_str());
        deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene, "deformer");
        deformer->SetCache(cache);
        deformer->Channel.Set(fbxsdk::FbxString(channel));
        deformer->Active.Set(true);
        mesh->AddDeformer(deformer);
        return *deformer;
    }

    support::TemporaryFolder folder;
    fbxsdk::FbxMesh* mesh = nullptr;
    fbxsdk::FbxVertexCacheDeformer* deformer = nullptr;
};

struct MaxScene : CachedScene {
    explicit MaxScene(const std::string& bytes) : CachedScene(FbxCache::eMaxPointCacheV2) {
        folder.write("wave.pc2", bytes);
    }
};

struct MayaScene : CachedScene {
    MayaScene(const MayaLayout& layout, const std::vector<Sample>& samples) : CachedScene(FbxCache::eMayaCache) {
        layout.write(folder, samples);
    }
};

/// The y of the points at a frame: of all of them, or a failure of the test.
double heightAt(TnFbxReadInfo info, double frame) {
    info.setFrame(static_cast<float>(frame));
    FacadeRead<TnFbxMesh> read(info);
    EXPECT_EQ(lastWarnings(), std::vector<std::string>());
    const Samples points = pointsOf(read["mesh"]);
    EXPECT_EQ(points.size(), std::size_t{kPoints} * 3);
    if (points.size() != std::size_t{kPoints} * 3)
        return -1.0;
    for (std::size_t point = 0; point < kPoints; ++point) {
        EXPECT_EQ(points[3 * point], static_cast<float>(point));
        EXPECT_NEAR(points[3 * point + 1], points[1], 1e-6f);
        EXPECT_EQ(points[3 * point + 2], 1.0f);
    }
    return static_cast<double>(points[1]);
}

using Heights = std::vector<std::pair<double, double>>;

void expectHeights(const TnFbxReadInfo& info, const Heights& heights, double tolerance = 1e-5) {
    for (const auto& [frame, height] : heights)
        EXPECT_NEAR(heightAt(info, frame), height, tolerance) << "at frame " << frame;
}

TnFbxReadInfo atRate(TnFbxReadInfo info, float framesPerSecond) {
    info.setUseSampleFPS(true);
    info.setSampleFPS(framesPerSecond);
    return info;
}

// ---- Max: by frames of the scene ----

TEST(FaithfulMaxCaches, AreLinearBetweenSamplesAndHeldBeyondThem) {
    MaxScene scene(maxCache(10.0f, 1.0f, {1.0, 3.0, 11.0}));
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{10.0, 1.0},
                                 {10.25, 1.5},
                                 {11.0, 3.0},
                                 {11.5, 7.0},
                                 {12.0, 11.0},
                                 {12.5, 11.0},
                                 {1000.0, 11.0},
                                 {9.5, 1.0},
                                 {0.0, 1.0},
                                 {-3.5, 1.0}});
}

TEST(FaithfulMaxCaches, CountFramesOfTheSceneWhateverRateIsRead) {
    MaxScene scene(maxCache(10.0f, 1.0f, {1.0, 3.0, 11.0})); // of 24 per second
    const SavedScene saved(scene);
    expectHeights(atRate(saved.info(), 48.0f), {{20.0, 1.0}, {21.0, 2.0}, {23.0, 7.0}, {24.0, 11.0}, {25.0, 11.0}});
    expectHeights(atRate(saved.info(), 12.0f), {{5.0, 1.0}, {5.25, 2.0}, {5.5, 3.0}, {6.0, 11.0}});
}

TEST(FaithfulMaxCaches, HaveAnExactFrameAtTheRatesOfTelevision) {
    MaxScene scene(maxCache(0.0f, 1.0f, std::vector<double>(5, 0.0)));
    std::vector<double> ys(3601);
    for (std::size_t i = 0; i < ys.size(); ++i)
        ys[i] = static_cast<double>(i);
    scene.folder.write("wave.pc2", maxCache(0.0f, 1.0f, ys));
    scene.scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFilmFullFrame);
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{1.0, 1.0}, {1000.0, 1000.0}, {3599.0, 3599.0}, {3599.5, 3599.5}}, 1e-3);
    // One second is 24000/1001 frames.
    expectHeights(atRate(saved.info(), 1.0f), {{1.0, 24000.0 / 1001.0}, {100.0, 2400000.0 / 1001.0}}, 1e-3);
}

TEST(FaithfulMaxCaches, MayStartBeforeFrameZero) {
    MaxScene scene(maxCache(-4.0f, 1.0f, {10.0, 20.0, 40.0, 80.0, 160.0, 320.0})); // −4 to 1
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{-5.5, 10.0},
                                 {-5.0, 10.0},
                                 {-4.0, 10.0},
                                 {-3.0, 20.0},
                                 {-2.75, 25.0},
                                 {-1.5, 60.0},
                                 {-0.25, 140.0},
                                 {0.0, 160.0},
                                 {0.5, 240.0},
                                 {1.5, 320.0}});
}

TEST(FaithfulMaxCaches, MayStartBetweenFrames) {
    MaxScene scene(maxCache(10.5f, 1.0f, {0.0, 8.0, 16.0}));
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{10.0, 0.0}, {11.0, 4.0}, {12.0, 12.0}, {13.0, 16.0}});
}

TEST(FaithfulMaxCaches, OfSeveralSamplesPerFrameHaveThoseOfWholeFrames) {
    MaxScene scene(maxCache(2.0f, 0.25f, {0.0, 1.0, 2.0, 3.0, 10.0, 11.0, 12.0, 13.0, 30.0})); // 2, 2.25 … 4
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{1.0, 0.0}, {2.0, 0.0}, {3.0, 10.0}, {4.0, 30.0}, {5.0, 30.0}});
}

// ---- Maya: by time ----

class FaithfulMayaCaches : public testing::TestWithParam<MayaLayout> {};

TEST_P(FaithfulMayaCaches, AreLinearBetweenSamplesAndHeldBeyondThem) {
    MayaScene scene(GetParam(), {{500, 1.0}, {750, 3.0}, {1250, 11.0}}); // frames 2, 3 and 5
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{2.0, 1.0},
                                 {2.25, 1.5},
                                 {3.0, 3.0},
                                 {4.0, 7.0},
                                 {4.5, 9.0},
                                 {5.0, 11.0},
                                 {6.5, 11.0},
                                 {1000.0, 11.0},
                                 {1.5, 1.0},
                                 {0.0, 1.0},
                                 {-7.0, 1.0}});
}

TEST_P(FaithfulMayaCaches, AreAtTheirTimesInASceneOfAnotherRate) {
    MayaScene scene(GetParam(), {{0, 0.0}, {250, 10.0}, {600, 24.0}}); // of 24 per second, and one in between
    scene.scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames30);
    const SavedScene saved(scene);
    // A frame of 30 per second is 200 ticks; 10 in 250 and 14 in 350 ticks are 0.04 per tick.
    expectHeights(saved.info(), {{0.0, 0.0}, {1.0, 8.0}, {1.25, 10.0}, {2.0, 16.0}, {3.0, 24.0}, {4.0, 24.0}});
    expectHeights(atRate(saved.info(), 60.0f), {{1.0, 4.0}, {5.0, 20.0}, {6.0, 24.0}});
    expectHeights(atRate(saved.info(), 30000.0f / 1001.0f), {{2.0, 400.4 * 0.04}}, 1e-4);
}

TEST_P(FaithfulMayaCaches, MayStartBeforeTheTimeZero) {
    MayaScene scene(GetParam(), {{-1000, 16.0}, {-500, 0.0}, {0, 2.0}}); // frames −4, −2 and 0
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{-5.0, 16.0}, {-4.0, 16.0}, {-3.0, 8.0}, {-2.5, 4.0}, {-1.0, 1.0}, {1.0, 2.0}});
}

TEST_P(FaithfulMayaCaches, HaveSamplesBetweenFrames) {
    MayaScene scene(GetParam(), {{0, 0.0}, {125, 10.0}, {250, 0.0}});
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{0.0, 0.0}, {0.25, 5.0}, {0.5, 10.0}, {0.75, 5.0}, {1.0, 0.0}});
}

std::string layoutName(const testing::TestParamInfo<MayaLayout>& layout) {
    return std::string(layout.param.wide ? "Wide" : "Narrow") + (layout.param.doubles ? "Doubles" : "Floats") +
           (layout.param.filePerFrame ? "OfAFilePerFrame" : "OfOneFile");
}
INSTANTIATE_TEST_SUITE_P(Layouts, FaithfulMayaCaches,
                         testing::Values(MayaLayout{false, false, false}, MayaLayout{false, true, false},
                                         MayaLayout{true, false, false}, MayaLayout{true, true, false},
                                         MayaLayout{false, false, true}, MayaLayout{true, true, true}),
                         layoutName);

constexpr MayaLayout kNarrow = {false, true, false};

TEST(FaithfulCaches, HoldTheNormalsOfCornersBetweenSamples) {
    CachedScene scene(FbxCache::eMayaCache);
    scene.addCache(FbxCache::eMayaCache, "wave_normals");
    auto* stored = fbxsdk::FbxLayerElementNormal::Create(scene.mesh, "");
    stored->SetMappingMode(fbxsdk::FbxLayerElement::eAllSame);
    stored->SetReferenceMode(fbxsdk::FbxLayerElement::eDirect);
    stored->GetDirectArray().Add({0.0, 1.0, 0.0});
    scene.mesh->GetLayer(scene.mesh->CreateLayer())->SetNormals(stored);
    const auto sample = [](int ticks, double y, const std::vector<double>& normals) {
        return kNarrow.group("MYCH" + kNarrow.number("TIME", ticks) + kNarrow.block("wave", numbersOf(y)) +
                             kNarrow.block("wave_normals", normals));
    };
    scene.folder.write("wave.xml", kNarrow.description({"wave", "wave_normals"}, 0, 500));
    scene.folder.write("wave.mc", kNarrow.start(0, 1) + sample(0, 0.0, {1, 0, 0, 0, 0, 1, 0, -1, 0}) +
                                      sample(500, 4.0, {0, 0, 1, 0, 0, 1, 0, -1, 0}));
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setFrame(1.0f); // halfway
    FacadeRead<TnFbxMesh> read(info);
    EXPECT_EQ(pointsOf(read["mesh"])[1], 2.0f);
    constexpr float half = 0.70710678f; // the mean, of unit length
    EXPECT_THAT(normalsOf(read["mesh"]), isNear({half, 0.0f, half, 0.0f, 0.0f, 1.0f, 0.0f, -1.0f, 0.0f}));
}

TEST(FaithfulCaches, ThatAreSwitchedOffMakeWayForTheNextOne) {
    MaxScene scene(maxCache(0.0f, 1.0f, {5.0}));
    scene.deformer->Active.Set(false);
    FbxCache* second = scene.addCache(FbxCache::eMaxPointCacheV2, "").GetCache();
    second->SetCacheFileName("", scene.folder.write("second.pc2", maxCache(0.0f, 1.0f, {7.0})).c_str());
    scene.addCache(FbxCache::eMaxPointCacheV2, ""); // that of the first again
    const SavedScene saved(scene);
    expectHeights(saved.info(), {{0.0, 7.0}});
}

/// The warning, with the points left to the other deformers, of which there are none.
void expectUnread(CachedScene& scene, float frame) {
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setFrame(frame);
    FacadeRead<TnFbxMesh> read(info);
    EXPECT_THAT(lastWarnings(), testing::ElementsAre(testing::HasSubstr("the point cache of \"mesh\" cannot be read")));
    EXPECT_THAT(pointsOf(read["mesh"]), isNear({0.0f, 0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 0.0f, 1.0f, 0.0f}));
}

TEST(FaithfulCaches, OfAnotherNumberOfPointsAreWarnedOf) {
    MaxScene max(maxCache(0.0f, 1.0f, {5.0, 6.0}, kPoints + 1));
    expectUnread(max, 0.0f);
    MayaScene maya(kNarrow, {{0, 5.0}, {250, 6.0}});
    maya.folder.write("wave.mc", kNarrow.start(0, 1) + kNarrow.group("MYCH" + kNarrow.number("TIME", 0) +
                                                                     kNarrow.block("wave", {1.0, 2.0, 3.0})));
    expectUnread(maya, 0.0f);
}

TEST(FaithfulCaches, OfWhichTheSampleAfterCannotBeReadAreWarnedOf) {
    MayaScene scene({false, true, true}, {{0, 5.0}, {250, 6.0}});
    scene.folder.write("waveFrame1.mc", "not a cache");
    expectUnread(scene, 0.5f);
    MayaScene sound({false, true, true}, {{0, 5.0}, {250, 6.0}});
    sound.folder.write("waveFrame1.mc", "not a cache");
    const SavedScene saved(sound);
    expectHeights(saved.info(), {{0.0, 5.0}});
}

TEST(FaithfulCaches, WithoutTheChannelOfTheirDeformerAreWarnedOf) {
    MayaScene scene(kNarrow, {{0, 5.0}});
    scene.deformer->Channel.Set(fbxsdk::FbxString("another"));
    expectUnread(scene, 0.0f);
}

TEST(FaithfulCaches, AddThePointsOfFurtherFrames) {
    MaxScene scene(maxCache(10.0f, 1.0f, {1.0, 3.0, 11.0}));
    const SavedScene saved(scene);
    FbxFaithful file;
    TnFbxMesh mesh;
    ASSERT_TRUE(file.load(saved.info()) && file.makeMeshes()) << lastError();
    fbxsdk::FbxNode& node = *file.getScene()->GetRootNode()->GetChild(0);
    ASSERT_TRUE(file.setFrame(10.0f) && file.read(node, mesh)) << lastError();
    for (const float frame : {11.5f, 20.0f})
        ASSERT_TRUE(file.setFrame(frame) && file.readPoints(node, mesh)) << lastError();
    ASSERT_EQ(mesh.getNumberOfControlPointSets(), 3);
    const float expected[] = {1.0f, 7.0f, 11.0f};
    for (int set = 0; set < 3; ++set) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        ASSERT_TRUE(mesh.getControlPoint(set * kPoints, x, y, z));
        EXPECT_NEAR(y, expected[set], 1e-6f);
    }
}

} // namespace
} // namespace Tarnell::Fbx::test
