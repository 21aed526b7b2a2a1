// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes large enough that their arrays stay in the file, plain and compressed, read in every way, by one thread and by
// several.
#include <cmath>
#include <numeric>

#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/extensions/Threads.h>

#include "GeometryFixture.h"
#include "support/BinaryRecordBuilder.h"
#include "support/TemporaryFolder.h"

using namespace fbxsdk;

namespace {

constexpr int kPoints = 30'000;
constexpr int kCorners = 3 * kPoints;

enum class Storage { plain, compressed, corrupt };

struct Reading {
    Storage storage;
    int threads;
};

class StoredMesh : public GeometryFixture, public testing::WithParamInterface<Reading> {
protected:
    StoredMesh() : mPoints(3 * kPoints), mNormals(3 * kCorners), mUvs(2 * kPoints), mUvIndex(kCorners) {
        std::iota(mPoints.begin(), mPoints.end(), 0.5);
        std::iota(mNormals.begin(), mNormals.end(), -7.25);
        std::iota(mUvs.begin(), mUvs.end(), 1.0 / 3.0);
        for (int i = 0; i < kCorners; ++i)
            mUvIndex[static_cast<std::size_t>(i)] = kPoints - 1 - i / 3;
    }

    ~StoredMesh() override { extensions::setMaximumThreads(1); }

    FbxMesh* mesh() {
        FbxStatus status;
        auto document = std::make_shared<detail::Document>();
        document->tree = detail::readRecords(mFolder.write("mesh.fbx", bytes()), status);
        EXPECT_TRUE(document->tree) << status.GetErrorString();
        document->objects.emplace_back().body = &document->tree->root;
        auto* made = make<FbxMesh>();
        detail::attachSource(*made, document, document->objects.front());
        return made;
    }
    static FbxVector4 item(const std::vector<double>& numbers, int index) {
        const double* const first = numbers.data() + 3 * static_cast<std::size_t>(index);
        return {first[0], first[1], first[2]};
    }
    const FbxLayerElementNormal& normalsOf(FbxMesh* mesh) { return *mesh->GetLayer(0)->GetNormals(); }
    const FbxLayerElementUV& uvsOf(FbxMesh* mesh) { return *mesh->GetLayer(0)->GetUVs(); }

    std::vector<double> mPoints, mNormals, mUvs;
    std::vector<int> mUvIndex;
    Storage mStorage = Storage::plain;

private:
    template <class Number>
    void list(BinaryRecordBuilder& file, const char* name, char code, const std::vector<Number>& numbers) {
        file.begin(name);
        if (mStorage == Storage::plain) {
            file.array(code, numbers);
        } else if (mStorage == Storage::compressed) {
            file.compressedArray(code, numbers);
        } else {
            std::string stream = BinaryRecordBuilder::deflated(file.encode(numbers));
            stream.resize(stream.size() / 2);
            file.arrayOf(code, numbers.size(), 1, stream);
        }
        file.end();
    }
    std::string bytes() {
        std::vector<int> corners(kCorners);
        for (int i = 0; i < kCorners; ++i)
            corners[static_cast<std::size_t>(i)] = i % 3 == 2 ? ~(i % kPoints) : i % kPoints;
        BinaryRecordBuilder file(7400);
        const Storage wanted = mStorage;
        mStorage = wanted == Storage::corrupt ? Storage::compressed : wanted;
        list(file, "PolygonVertexIndex", 'i', corners);
        list(file, "Vertices", 'd', mPoints);
        mStorage = wanted;
        const auto element = [&](const char* name, const char* reference) {
            file.begin(name).int32(0).block();
            file.begin("MappingInformationType").text("ByPolygonVertex").end();
            file.begin("ReferenceInformationType").text(reference).end();
        };
        element("LayerElementNormal", "Direct");
        list(file, "Normals", 'd', mNormals);
        file.end();
        element("LayerElementUV", "IndexToDirect");
        list(file, "UV", 'd', mUvs);
        list(file, "UVIndex", 'i', mUvIndex);
        file.end();
        return file.finish();
    }

    support::TemporaryFolder mFolder;
};

class SoundStoredMesh : public StoredMesh {
protected:
    SoundStoredMesh() {
        mStorage = GetParam().storage;
        extensions::setMaximumThreads(GetParam().threads);
    }
};

TEST_P(SoundStoredMesh, HasItsValuesInOrderAgainAndAgain) {
    FbxMesh* read = mesh();
    ASSERT_EQ(read->GetControlPointsCount(), kPoints);
    ASSERT_EQ(read->GetPolygonVertexCount(), kCorners);
    const auto& normals = normalsOf(read).GetDirectArray();
    ASSERT_EQ(normals.GetCount(), kCorners);
    for (int round = 0; round < 3; ++round) {
        for (int i = 0; i < kPoints; ++i)
            ASSERT_EQ(read->GetControlPointAt(i), item(mPoints, i));
        for (int i = 0; i < kCorners; ++i)
            ASSERT_EQ(normals.GetAt(i), item(mNormals, i));
    }
}

TEST_P(SoundStoredMesh, HasItsValuesBackwardsAndBehindIndices) {
    FbxMesh* read = mesh();
    const auto& uvs = uvsOf(read);
    for (int i = 0; i < kCorners; ++i) {
        const int index = uvs.GetIndexArray().GetAt(i);
        ASSERT_EQ(index, mUvIndex[static_cast<std::size_t>(i)]);
        const double* const uv = mUvs.data() + 2 * static_cast<std::size_t>(index);
        ASSERT_EQ(uvs.GetDirectArray().GetAt(index), FbxVector2(uv[0], uv[1]));
    }
    EXPECT_EQ(uvs.GetDirectArray().GetAt(-1), FbxVector2(0, 0));
    EXPECT_EQ(uvs.GetDirectArray().GetAt(kPoints), FbxVector2(0, 0));
}

TEST_P(SoundStoredMesh, HasAllOfThemBehindAPointer) {
    FbxMesh* read = mesh();
    EXPECT_EQ(read->GetControlPointAt(100), item(mPoints, 100));

    const FbxVector4* const points = read->GetControlPoints();
    const FbxVector4* const normals = normalsOf(read).GetDirectArray().GetLocked();

    for (int i = 0; i < kPoints; ++i)
        ASSERT_EQ(points[i], item(mPoints, i));
    for (int i = 0; i < kCorners; ++i)
        ASSERT_EQ(normals[i], item(mNormals, i));
}

TEST_P(SoundStoredMesh, KeepsWhatAHostWrites) {
    FbxMesh* read = mesh();
    auto& normals = normalsOf(read).GetDirectArray();
    EXPECT_EQ(normals.GetAt(0), item(mNormals, 0));

    normals.SetAt(1, FbxVector4(9, 9, 9));
    read->SetControlPointAt(FbxVector4(8, 8, 8), 2);

    EXPECT_EQ(normals.GetAt(1), FbxVector4(9, 9, 9));
    EXPECT_EQ(normals.GetAt(2), item(mNormals, 2));
    EXPECT_EQ(read->GetControlPointAt(2), FbxVector4(8, 8, 8));
    EXPECT_EQ(read->GetControlPointAt(3), item(mPoints, 3));
}

TEST_P(SoundStoredMesh, LosesTheCornersOfARemovedPolygon) {
    FbxMesh* read = mesh();

    read->RemovePolygon(0);

    const auto& normals = normalsOf(read).GetDirectArray();
    ASSERT_EQ(normals.GetCount(), kCorners - 3);
    EXPECT_EQ(normals.GetAt(0), item(mNormals, 3));
    EXPECT_EQ(uvsOf(read).GetIndexArray().GetAt(0), mUvIndex[3]);
}

INSTANTIATE_TEST_SUITE_P(Readings, SoundStoredMesh,
                         testing::Values(Reading{Storage::plain, 1}, Reading{Storage::compressed, 1},
                                         Reading{Storage::compressed, 3}),
                         [](const auto& suite) {
                             return std::string(suite.param.storage == Storage::plain ? "Plain" : "Compressed") + "By" +
                                    std::to_string(suite.param.threads);
                         });

TEST_F(StoredMesh, IsDestroyedWhileOtherThreadsReadIt) {
    mStorage = Storage::compressed;
    extensions::setMaximumThreads(3);
    for (int round = 0; round < 5; ++round) {
        FbxMesh* read = mesh();
        EXPECT_EQ(read->GetControlPointAt(1), item(mPoints, 1));
        read->Destroy();
    }
}

TEST_F(StoredMesh, HasNoItemsOfACorruptArray) {
    mStorage = Storage::corrupt;
    for (const int threads : {1, 2, 8}) {
        extensions::setMaximumThreads(threads);
        FbxMesh* read = mesh();

        EXPECT_EQ(read->GetPolygonCount(), kPoints);
        EXPECT_EQ(normalsOf(read).GetDirectArray().GetCount(), 0);
        EXPECT_EQ(uvsOf(read).GetIndexArray().GetCount(), 0);
    }
}

} // namespace
