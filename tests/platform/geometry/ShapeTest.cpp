// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Target shapes: full positions from a file's offsets.
#include "GeometryFixture.h"

#include <string>

#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxShape.h>

using namespace fbxsdk;
using testing::ElementsAre;

namespace {

class FbxShapeTest : public GeometryFixture {
protected:
    FbxShapeTest() : base(make<FbxMesh>()), channel(make<FbxBlendShapeChannel>()) {
        base->InitControlPoints(3);
        for (int i = 0; i < 3; ++i)
            base->SetControlPointAt(FbxVector4(i, 10, 20), i);
        auto* blendShape = make<FbxBlendShape>();
        blendShape->AddBlendShapeChannel(channel);
        base->AddDeformer(blendShape);
    }

    /// The shape's points after it became a target on the base.
    std::vector<FbxVector4> targetPoints(const std::string& records) {
        auto* shape = read<FbxShape>(records);
        channel->AddTargetShape(shape);
        return pointsOf(*shape);
    }

    FbxMesh* base;
    FbxBlendShapeChannel* channel;
};

} // namespace

TEST_F(FbxShapeTest, AddsOffsetsToThePointsOfItsGeometry) {
    EXPECT_THAT(targetPoints("Indexes: *2 { a: 2,0 }\nVertices: *6 { a: 1,2,3, -1,0,0.5 }"),
                ElementsAre(FbxVector4(-1, 10, 20.5), FbxVector4(1, 10, 20), FbxVector4(3, 12, 23)));
}

TEST_F(FbxShapeTest, IsTheBaseWhereNothingMoves) {
    const std::vector<FbxVector4> basePoints = pointsOf(*base);

    EXPECT_EQ(targetPoints(""), basePoints);
    EXPECT_EQ(targetPoints("Indexes: *1 { a: 1 }"), basePoints);
    EXPECT_EQ(targetPoints("Vertices: *0 { }\nIndexes: *0 { }"), basePoints);
}

TEST_F(FbxShapeTest, MovesTheFirstPointsWithoutIndices) {
    EXPECT_THAT(targetPoints("Vertices: *6 { a: 1,0,0, 0,1,0 }"),
                ElementsAre(FbxVector4(1, 10, 20), FbxVector4(1, 11, 20), FbxVector4(2, 10, 20)));
}

TEST_F(FbxShapeTest, SkipsOffsetsForPointsThatAreNotThere) {
    EXPECT_THAT(targetPoints("Indexes: *4 { a: 3,-1,2147483647,1 }\nVertices: *12 { a: 9,9,9, 9,9,9, 9,9,9, 0,0,1 }"),
                ElementsAre(FbxVector4(0, 10, 20), FbxVector4(1, 10, 21), FbxVector4(2, 10, 20)));
}

TEST_F(FbxShapeTest, SkipsIndicesWithoutOffset) {
    EXPECT_THAT(targetPoints("Indexes: *3 { a: 0,1,2 }\nVertices: *4 { a: 1,1,1, 7 }"),
                ElementsAre(FbxVector4(1, 11, 21), FbxVector4(1, 10, 20), FbxVector4(2, 10, 20)));
}

TEST_F(FbxShapeTest, AddsEveryOffsetOfAPointThatIsNamedTwice) {
    EXPECT_EQ(targetPoints("Indexes: *2 { a: 1,1 }\nVertices: *6 { a: 1,0,0, 1,0,0 }")[1], FbxVector4(3, 10, 20));
}

TEST_F(FbxShapeTest, KeepsTheWeightsOfTheBase) {
    base->SetControlPointAt(FbxVector4(0, 0, 0, 2.5), 0);

    EXPECT_EQ(targetPoints("Indexes: *1 { a: 0 }\nVertices: *3 { a: 1,1,1 }")[0], FbxVector4(1, 1, 1, 2.5));
}

TEST_F(FbxShapeTest, HasNoPointsBeforeItIsATarget) {
    auto* shape = read<FbxShape>("Indexes: *1 { a: 0 }\nVertices: *3 { a: 1,1,1 }");
    EXPECT_EQ(shape->GetControlPointsCount(), 0);
    EXPECT_EQ(shape->GetControlPoints(), nullptr);
    EXPECT_EQ(shape->GetBaseGeometry(), nullptr);

    channel->AddTargetShape(shape);

    EXPECT_EQ(shape->GetBaseGeometry(), base);
    EXPECT_EQ(shape->GetControlPointsCount(), 3);
    EXPECT_EQ(shape->GetControlPointAt(0), FbxVector4(1, 11, 21));
}

TEST_F(FbxShapeTest, ReadsItsGeometryFirst) {
    auto* mesh = read<FbxMesh>("Vertices: *6 { a: 1,2,3,4,5,6 }");
    auto* blendShape = make<FbxBlendShape>();
    auto* ownChannel = make<FbxBlendShapeChannel>();
    auto* shape = read<FbxShape>("Indexes: *1 { a: 1 }\nVertices: *3 { a: 1,1,1 }");
    mesh->AddDeformer(blendShape);
    blendShape->AddBlendShapeChannel(ownChannel);
    ownChannel->AddTargetShape(shape);

    EXPECT_THAT(pointsOf(*shape), ElementsAre(FbxVector4(1, 2, 3), FbxVector4(5, 6, 7)));
}

TEST_F(FbxShapeTest, TakesPointsFromTheHost) {
    auto* shape = make<FbxShape>();
    channel->AddTargetShape(shape);

    shape->InitControlPoints(1);
    shape->SetControlPointAt(FbxVector4(7, 8, 9), 0);

    EXPECT_EQ(shape->GetAttributeType(), FbxNodeAttribute::eShape);
    EXPECT_THAT(pointsOf(*shape), ElementsAre(FbxVector4(7, 8, 9)));
}

TEST_F(FbxShapeTest, ForgetsTheFileWhenTheHostSetsPoints) {
    auto* shape = read<FbxShape>("Indexes: *1 { a: 0 }\nVertices: *3 { a: 1,1,1 }");

    shape->InitControlPoints(1);
    channel->AddTargetShape(shape);

    EXPECT_THAT(pointsOf(*shape), ElementsAre(FbxVector4(0, 0, 0)));
}
