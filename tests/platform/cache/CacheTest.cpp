// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Point caches as objects: names and formats, both kinds of files written and read back, and every call in every state
// that does not support it.
#include <algorithm>
#include <array>
#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxScene.h>

#include "support/TemporaryFolder.h"

using namespace fbxsdk;

namespace {

using Points = std::array<double, 6>; // of two points

class FbxCacheTest : public testing::Test {
protected:
    ~FbxCacheTest() override { manager->Destroy(); }

    FbxCache* cacheAt(const std::string& file, FbxCache::EFileFormat format) {
        FbxCache* made = FbxCache::Create(manager, "cache");
        made->SetCacheFileFormat(format);
        made->SetCacheFileName("", file.c_str());
        return made;
    }
    static FbxTime frame(int number) {
        FbxTime time;
        time.SetSecondDouble(number / 24.0);
        return time;
    }
    static Points pointsOf(double f) { return {f, 0, -f, f, 1, -f}; }

    /// Frames 10, 11 and 12, closed.
    FbxCache* writtenMaya(FbxCache::EMCBinaryFormat layout = FbxCache::eMCC,
                          FbxCache::EMCDataType type = FbxCache::eDoubleVectorArray) {
        FbxCache* made = cacheAt(folder.file("ball.xml"), FbxCache::eMayaCache);
        EXPECT_TRUE(made->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", layout, type, "Points", &status))
            << status.GetErrorString();
        for (int f = 10; f <= 12; ++f) {
            Points points = pointsOf(f);
            FbxTime time = frame(f);
            EXPECT_TRUE(made->BeginWriteAt(time));
            EXPECT_TRUE(made->Write(0, time, points.data(), 2U, &status)) << status.GetErrorString();
            EXPECT_TRUE(made->EndWriteAt());
        }
        EXPECT_TRUE(made->CloseFile(&status)) << status.GetErrorString();
        return made;
    }
    FbxCache* writtenMax() {
        FbxCache* made = cacheAt(folder.file("ball.pc2"), FbxCache::eMaxPointCacheV2);
        EXPECT_TRUE(made->OpenFileForWrite(10.0, 24.0, 3U, 2U, &status)) << status.GetErrorString();
        for (unsigned int f = 10; f <= 12; ++f) {
            Points points = pointsOf(f);
            EXPECT_TRUE(made->Write(f, points.data(), &status)) << status.GetErrorString();
        }
        EXPECT_TRUE(made->CloseFile(&status)) << status.GetErrorString();
        return made;
    }

    support::TemporaryFolder folder;
    FbxManager* manager = FbxManager::Create();
    FbxStatus status;
};

} // namespace

TEST_F(FbxCacheTest, StartsClosedWithoutFormatAndName) {
    FbxCache* made = FbxCache::Create(manager, "cache");
    FbxString relative("x"), absolute("x");
    made->GetCacheFileName(relative, absolute);

    EXPECT_FALSE(made->IsOpen());
    EXPECT_EQ(made->GetCacheFileFormat(), FbxCache::eUnknownFileFormat);
    EXPECT_STREQ(relative.Buffer(), "");
    EXPECT_STREQ(absolute.Buffer(), "");
}

TEST_F(FbxCacheTest, KeepsNameAndFormatAsFilesHaveThem) {
    FbxCache* made = FbxCache::Create(manager, "cache");
    made->SetCacheFileName("rel/ä.xml", "/abs/ä.xml");
    made->SetCacheFileFormat(FbxCache::eMayaCache);
    FbxString relative, absolute;
    made->GetCacheFileName(relative, absolute);

    EXPECT_STREQ(relative.Buffer(), "rel/ä.xml");
    EXPECT_STREQ(absolute.Buffer(), "/abs/ä.xml");
    EXPECT_EQ(made->FindProperty("CacheFileType").Get<FbxEnum>(), 2);
    EXPECT_STREQ(made->FindProperty("CacheAbsoluteFileName").Get<FbxString>().Buffer(), "/abs/ä.xml");
    made->SetCacheFileName(nullptr, nullptr);
    made->GetCacheFileName(relative, absolute);
    EXPECT_STREQ(absolute.Buffer(), "");
}

TEST_F(FbxCacheTest, TakesAnInvalidFormatForUnknown) {
    FbxCache* made = FbxCache::Create(manager, "cache");
    for (const FbxEnum wrong : {-1, 4, std::numeric_limits<int>::max()}) {
        made->FindProperty("CacheFileType").Set(wrong);
        EXPECT_EQ(made->GetCacheFileFormat(), FbxCache::eUnknownFileFormat) << wrong;
    }
}

TEST_F(FbxCacheTest, ReadsBackAMayaCacheInEveryLayout) {
    for (const auto layout : {FbxCache::eMCC, FbxCache::eMCX}) {
        for (const auto type : {FbxCache::eDoubleVectorArray, FbxCache::eFloatVectorArray}) {
            FbxCache* made = writtenMaya(layout, type);
            ASSERT_TRUE(made->OpenFileForRead(&status)) << status.GetErrorString();
            EXPECT_TRUE(made->IsOpen());
            EXPECT_EQ(made->GetChannelCount(), 1);
            EXPECT_EQ(made->GetChannelIndex("ball"), 0);
            FbxString name;
            FbxCache::EMCDataType read = FbxCache::eUnknownData;
            EXPECT_TRUE(made->GetChannelName(0, name));
            EXPECT_STREQ(name.Buffer(), "ball");
            EXPECT_TRUE(made->GetChannelDataType(0, read));
            EXPECT_EQ(read, type);
            for (int f = 10; f <= 12; ++f) {
                Points points{};
                FbxTime time = frame(f);
                EXPECT_TRUE(made->Read(0, time, points.data(), 2U, &status)) << status.GetErrorString();
                EXPECT_EQ(points, pointsOf(f));
            }
            EXPECT_TRUE(made->CloseFile());
            EXPECT_FALSE(made->IsOpen());
        }
    }
}

TEST_F(FbxCacheTest, ReadsMayaSamplesAsFloatsToo) {
    FbxCache* made = writtenMaya();
    ASSERT_TRUE(made->OpenFileForRead());
    std::array<float, 6> points{};
    FbxTime time = frame(11);

    EXPECT_TRUE(made->Read(0, time, points.data(), 2U));
    EXPECT_EQ(points, (std::array<float, 6>{11, 0, -11, 11, 1, -11}));
}

TEST_F(FbxCacheTest, WritesMayaSamplesFromFloats) {
    FbxCache* made = cacheAt(folder.file("float.xml"), FbxCache::eMayaCache);
    ASSERT_TRUE(made->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
    std::array<float, 3> point = {1.5F, 2.5F, 3.5F};
    FbxTime time = frame(0);
    EXPECT_TRUE(made->Write(0, time, point.data(), 1U));
    EXPECT_TRUE(made->CloseFile());

    ASSERT_TRUE(made->OpenFileForRead(&status)) << status.GetErrorString();
    std::array<double, 3> read{};
    EXPECT_TRUE(made->Read(0, time, read.data(), 1U));
    EXPECT_EQ(read, (std::array<double, 3>{1.5, 2.5, 3.5}));
}

TEST_F(FbxCacheTest, KnowsTheRateAndRangeOfAMayaCache) {
    FbxCache* made = writtenMaya();
    ASSERT_TRUE(made->OpenFileForRead());
    FbxTime start, end;

    EXPECT_EQ(made->GetSamplingFrameRate(), 24.0);
    EXPECT_EQ(made->GetCacheTimePerFrame(), frame(1));
    EXPECT_TRUE(made->GetAnimationRange(0, start, end));
    EXPECT_EQ(start, frame(10));
    EXPECT_EQ(end, frame(12));
    EXPECT_FALSE(made->GetAnimationRange(1, start, end, &status));
    EXPECT_TRUE(status.Error());
}

TEST_F(FbxCacheTest, InterpolatesBetweenMayaSamplesAndHoldsTheEnds) {
    FbxCache* made = writtenMaya();
    ASSERT_TRUE(made->OpenFileForRead());
    const auto xAt = [&](double seconds) {
        Points points{};
        FbxTime time;
        time.SetSecondDouble(seconds);
        EXPECT_TRUE(made->Read(0, time, points.data(), 2U));
        return points[0];
    };

    EXPECT_NEAR(xAt(10.5 / 24), 10.5, 1e-9);
    EXPECT_EQ(xAt(-100), 10.0);
    EXPECT_EQ(xAt(100), 12.0);
}

TEST_F(FbxCacheTest, RefusesAnotherNumberOfPoints) {
    FbxCache* maya = writtenMaya();
    FbxCache* max = writtenMax();
    ASSERT_TRUE(maya->OpenFileForRead());
    ASSERT_TRUE(max->OpenFileForRead());
    std::array<double, 9> points{};
    FbxTime time = frame(10);

    for (const unsigned int wrong : {0U, 1U, 3U}) {
        EXPECT_FALSE(maya->Read(0, time, points.data(), wrong, &status)) << wrong;
        EXPECT_TRUE(status.Error());
        EXPECT_FALSE(max->Read(10U, points.data(), wrong, &status)) << wrong;
        EXPECT_TRUE(status.Error());
    }
}

TEST_F(FbxCacheTest, ReadsBackAMaxCacheByFrame) {
    FbxCache* made = writtenMax();
    ASSERT_TRUE(made->OpenFileForRead(&status)) << status.GetErrorString();

    EXPECT_EQ(made->GetSampleCount(), 3U);
    EXPECT_EQ(made->GetPointCount(), 2U);
    EXPECT_EQ(made->GetFrameStartOffset(), 10.0);
    const auto at = [&](unsigned int f) {
        Points points{};
        EXPECT_TRUE(made->Read(f, points.data(), 2U));
        return points;
    };
    EXPECT_EQ(at(10), pointsOf(10));
    EXPECT_EQ(at(12), pointsOf(12));
    EXPECT_EQ(at(0), pointsOf(10)); // outside the range the nearest sample holds
    EXPECT_EQ(at(1000), pointsOf(12));
}

TEST_F(FbxCacheTest, ReadsTheFramesBeforeZeroThatItWritesToAMaxCache) {
    FbxCache* made = cacheAt(folder.file("ball.pc2"), FbxCache::eMaxPointCacheV2);
    ASSERT_TRUE(made->OpenFileForWrite(-2.0, 24.0, 3U, 2U));
    for (int frame = -2; frame <= 0; ++frame) {
        Points points = pointsOf(frame);
        EXPECT_TRUE(made->Write(static_cast<unsigned int>(frame), points.data(), &status));
    }
    ASSERT_TRUE(made->CloseFile());
    ASSERT_TRUE(made->OpenFileForRead());

    for (int frame = -3; frame <= 1; ++frame) {
        Points points{};
        EXPECT_TRUE(made->Read(static_cast<unsigned int>(frame), points.data(), 2U, &status)) << frame;
        EXPECT_EQ(points, pointsOf(std::clamp(frame, -2, 0))) << frame;
    }
}

TEST_F(FbxCacheTest, WritesOnlyFramesThatWereAnnounced) {
    FbxCache* made = cacheAt(folder.file("ball.pc2"), FbxCache::eMaxPointCacheV2);
    ASSERT_TRUE(made->OpenFileForWrite(10.0, 24.0, 3U, 2U));
    Points points = pointsOf(1);

    for (const unsigned int wrong : {9U, 13U, 0xFFFFFFFFU})
        EXPECT_FALSE(made->Write(wrong, points.data(), &status)) << wrong;
    EXPECT_TRUE(made->Write(11U, points.data()));
    EXPECT_TRUE(made->CloseFile());
    ASSERT_TRUE(made->OpenFileForRead()); // complete although two samples were never written
    EXPECT_EQ(made->GetSampleCount(), 3U);
}

TEST_F(FbxCacheTest, LeavesAValidFileWithoutAnySample) {
    FbxCache* max = cacheAt(folder.file("empty.pc2"), FbxCache::eMaxPointCacheV2);
    ASSERT_TRUE(max->OpenFileForWrite(0.0, 24.0, 0U, 2U));
    EXPECT_TRUE(max->CloseFile(&status)) << status.GetErrorString();
    EXPECT_EQ(folder.read("empty.pc2").size(), 32U);

    FbxCache* maya = cacheAt(folder.file("empty.xml"), FbxCache::eMayaCache);
    ASSERT_TRUE(maya->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
    EXPECT_TRUE(maya->CloseFile(&status)) << status.GetErrorString();
    EXPECT_NE(folder.read("empty.xml").find("ball"), std::string::npos);
}

TEST_F(FbxCacheTest, AddsChannelsWhileWritingOnly) {
    FbxCache* made = cacheAt(folder.file("two.xml"), FbxCache::eMayaCache);
    unsigned int index = 99;
    EXPECT_FALSE(made->AddChannel("early", FbxCache::eDoubleVectorArray, "Points", index, &status));
    EXPECT_TRUE(status.Error());
    ASSERT_TRUE(made->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "first", FbxCache::eMCC));

    EXPECT_TRUE(made->AddChannel("second", FbxCache::eFloatVectorArray, "Points", index));

    EXPECT_EQ(index, 1U);
    EXPECT_EQ(made->GetChannelCount(), 2);
    EXPECT_EQ(made->GetChannelIndex("second"), 1);
    EXPECT_EQ(made->GetChannelIndex("Second"), -1);
    EXPECT_EQ(made->GetChannelIndex(nullptr), -1);
}

TEST_F(FbxCacheTest, KeepsNameAndFormatWhileItIsOpen) {
    FbxCache* made = writtenMaya();
    ASSERT_TRUE(made->OpenFileForRead());

    made->SetCacheFileFormat(FbxCache::eMaxPointCacheV2, &status);
    EXPECT_TRUE(status.Error());
    made->SetCacheFileName("other", "other", &status);
    EXPECT_TRUE(status.Error());

    EXPECT_EQ(made->GetCacheFileFormat(), FbxCache::eMayaCache);
    EXPECT_FALSE(made->OpenFileForRead(&status));
    EXPECT_FALSE(made->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
    EXPECT_TRUE(made->IsOpen());
}

TEST_F(FbxCacheTest, ReturnsNothingWhileItIsClosed) {
    FbxCache* made = writtenMaya();
    Points points{};
    FbxTime time, end;
    FbxString name;
    FbxCache::EMCDataType type = FbxCache::eUnknownData;

    EXPECT_FALSE(made->CloseFile(&status));
    EXPECT_TRUE(status.Error());
    EXPECT_EQ(made->GetSamplingFrameRate(&status), 0.0);
    EXPECT_EQ(made->GetCacheTimePerFrame(), FbxTime(0));
    EXPECT_EQ(made->GetChannelCount(&status), 0);
    EXPECT_TRUE(status.Error());
    EXPECT_FALSE(made->GetChannelName(0, name));
    EXPECT_FALSE(made->GetChannelDataType(0, type));
    EXPECT_EQ(made->GetChannelIndex("ball"), -1);
    EXPECT_FALSE(made->Read(0, time, points.data(), 2U));
    EXPECT_FALSE(made->Read(0U, points.data(), 2U));
    EXPECT_FALSE(made->Write(0, time, points.data(), 2U));
    EXPECT_FALSE(made->Write(0U, points.data()));
    EXPECT_FALSE(made->BeginWriteAt(time));
    EXPECT_FALSE(made->EndWriteAt());
    EXPECT_FALSE(made->GetAnimationRange(0, time, end));
    EXPECT_EQ(made->GetSampleCount(), 0U);
    EXPECT_EQ(made->GetPointCount(), 0U);
    EXPECT_EQ(made->GetFrameStartOffset(), 0.0);
}

TEST_F(FbxCacheTest, ReturnsNothingOfTheOtherFormat) {
    FbxCache* maya = writtenMaya();
    FbxCache* max = writtenMax();
    ASSERT_TRUE(maya->OpenFileForRead());
    ASSERT_TRUE(max->OpenFileForRead());
    Points points{};
    FbxTime time;

    EXPECT_EQ(maya->GetSampleCount(&status), 0U);
    EXPECT_TRUE(status.Error());
    EXPECT_FALSE(maya->Read(10U, points.data(), 2U));
    EXPECT_EQ(max->GetChannelCount(&status), 0);
    EXPECT_TRUE(status.Error());
    EXPECT_FALSE(max->Read(0, time, points.data(), 2U));
    EXPECT_FALSE(maya->Write(0, time, points.data(), 2U)); // open, but for reading
}

TEST_F(FbxCacheTest, OpensForWritingOnlyInItsOwnFormatAndOneFile) {
    FbxCache* maya = cacheAt(folder.file("a.xml"), FbxCache::eMayaCache);
    FbxCache* max = cacheAt(folder.file("a.pc2"), FbxCache::eMaxPointCacheV2);

    EXPECT_FALSE(maya->OpenFileForWrite(0.0, 24.0, 1U, 1U, &status));
    EXPECT_FALSE(max->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
    EXPECT_FALSE(maya->OpenFileForWrite(FbxCache::eMCOneFilePerFrame, 24.0, "ball", FbxCache::eMCC));
    EXPECT_FALSE(maya->OpenFileForWrite(FbxCache::eMCOneFile, 0.0, "ball", FbxCache::eMCC));
    EXPECT_FALSE(
        maya->OpenFileForWrite(FbxCache::eMCOneFile, std::numeric_limits<double>::quiet_NaN(), "ball", FbxCache::eMCC));
    EXPECT_FALSE(maya->IsOpen());
    EXPECT_FALSE(max->IsOpen());
}

TEST_F(FbxCacheTest, RefusesNullBuffers) {
    FbxCache* maya = writtenMaya();
    FbxCache* max = writtenMax();
    ASSERT_TRUE(maya->OpenFileForRead());
    ASSERT_TRUE(max->OpenFileForRead());
    FbxTime time = frame(10);

    EXPECT_FALSE(maya->Read(0, time, static_cast<double*>(nullptr), 2U));
    EXPECT_FALSE(maya->Read(0, time, static_cast<float*>(nullptr), 2U));
    EXPECT_FALSE(max->Read(10U, static_cast<double*>(nullptr), 2U));
    EXPECT_FALSE(maya->Write(0, time, static_cast<float*>(nullptr), 2U));
}

TEST_F(FbxCacheTest, SaysWhichFileIsMissing) {
    FbxCache* made = cacheAt(folder.file("missing.xml"), FbxCache::eMayaCache);

    EXPECT_FALSE(made->OpenFileForRead(&status));
    EXPECT_TRUE(status.Error());
    EXPECT_NE(std::string(status.GetErrorString()).find("missing.xml"), std::string::npos) << status.GetErrorString();
    EXPECT_FALSE(made->IsOpen());
    EXPECT_FALSE(made->OpenFileForRead(nullptr));
}

TEST_F(FbxCacheTest, SaysThatItNamesNoFileOrNoFormat) {
    FbxCache* nameless = cacheAt("", FbxCache::eMayaCache);
    EXPECT_FALSE(nameless->OpenFileForRead(&status));
    EXPECT_STREQ(status.GetErrorString(), "the cache has no file name");

    FbxCache* formless = cacheAt(folder.write("a.abc", "x"), FbxCache::eAlembic);
    EXPECT_FALSE(formless->OpenFileForRead(&status));
    EXPECT_STREQ(status.GetErrorString(), "the format of the cache is not supported");
}

TEST_F(FbxCacheTest, SaysThatAFileIsOfAnotherFormat) {
    for (const auto format : {FbxCache::eMayaCache, FbxCache::eMaxPointCacheV2}) {
        FbxCache* made = cacheAt(folder.write("text.bin", "neither the one nor the other"), format);
        EXPECT_FALSE(made->OpenFileForRead(&status));
        EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidFile);
        EXPECT_NE(std::string(status.GetErrorString()).find("text.bin"), std::string::npos);
    }
}

TEST_F(FbxCacheTest, SaysThatAFileCannotBeMade) {
    const std::string nowhere = folder.file("no such folder/a");
    FbxCache* maya = cacheAt(nowhere + ".xml", FbxCache::eMayaCache);
    FbxCache* max = cacheAt(nowhere + ".pc2", FbxCache::eMaxPointCacheV2);

    EXPECT_FALSE(maya->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC,
                                        FbxCache::eDoubleVectorArray, "Points", &status));
    EXPECT_TRUE(status.Error());
    EXPECT_FALSE(max->OpenFileForWrite(0.0, 24.0, 1U, 1U, &status));
    EXPECT_TRUE(status.Error());
}

TEST_F(FbxCacheTest, MayBeDestroyedWhileItIsOpen) {
    FbxCache* reading = writtenMaya();
    ASSERT_TRUE(reading->OpenFileForRead());
    FbxCache* writing = cacheAt(folder.file("half.pc2"), FbxCache::eMaxPointCacheV2);
    ASSERT_TRUE(writing->OpenFileForWrite(0.0, 24.0, 3U, 1U));

    reading->Destroy();
    writing->Destroy();
}
