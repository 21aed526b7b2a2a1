// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polylines from records and from hosts.
#include <fbxsdk/FbxLine.h>

#include "NurbsSamples.h"
#include "geometry/GeometryReading.h"
#include "platform/scene/SceneFixture.h"

namespace fbxsdk::detail {
namespace {

class Line : public SceneFixture {
protected:
    FbxLine* read(const std::string& text) {
        auto* line = make<FbxLine>();
        readLine(*line, RecordsOf(text));
        return line;
    }
};

TEST_F(Line, IsReadWithItsEnds) {
    const FbxLine& line = *read("Points: *9 { a: 0,1,2,3,4,5,6,7,8 }\nPointsIndex: *5 { a: 0,1,-3,2,-1 }");
    EXPECT_EQ(line.GetAttributeType(), FbxNodeAttribute::eLine);
    ASSERT_EQ(line.GetControlPointsCount(), 3);
    EXPECT_EQ(line.GetControlPointAt(2), FbxVector4(6, 7, 8, 1));
    ASSERT_EQ(line.GetIndexArraySize(), 5);
    EXPECT_EQ(line.GetPointIndexAt(2), 2);
    EXPECT_EQ(line.GetPointIndexAt(4), 0);
    EXPECT_EQ(line.GetPointIndexAt(5), -1);
    EXPECT_EQ(line.GetPointIndexAt(-1), -1);
    EXPECT_EQ(line.GetEndPointCount(), 2);
    EXPECT_EQ(line.GetEndPointAt(0), 2);
    EXPECT_EQ(line.GetEndPointAt(1), 4);
    EXPECT_EQ(line.GetEndPointAt(2), -1);
    EXPECT_EQ(line.GetEndPointAt(-1), -1);
}

TEST_F(Line, SendsIndicesWithoutPointToTheFirstOne) {
    const FbxLine& line = *read("Points: *6 { a: 0,1,2,3,4,5 }\nPointsIndex: *5 { a: 2,1,-3,2147483647,-2147483648 }");
    ASSERT_EQ(line.GetIndexArraySize(), 5);
    const int expected[] = {0, 1, 0, 0, 0};
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(line.GetPointIndexAt(i), expected[i]) << i;
    EXPECT_EQ(line.GetEndPointCount(), 2);
}

TEST_F(Line, DropsHalfPointsAndIndicesWithoutPoints) {
    EXPECT_EQ(read("Points: *5 { a: 0,1,2,3,4 }")->GetControlPointsCount(), 1);
    EXPECT_EQ(read("Points: *5 { a: 0,1,2,3,4 }")->GetIndexArraySize(), 0);
    const FbxLine& empty = *read("PointsIndex: *2 { a: 0,-2 }");
    EXPECT_EQ(empty.GetControlPointsCount(), 0);
    EXPECT_EQ(empty.GetIndexArraySize(), 0);
    EXPECT_EQ(read("Points: *2 { a: 0,1 }\nPointsIndex: *1 { a: 0 }")->GetIndexArraySize(), 0);
}

TEST_F(Line, KeepsIndicesThatAreSet) {
    auto* line = make<FbxLine>();
    line->InitControlPoints(2);
    line->SetIndexArraySize(3);
    EXPECT_EQ(line->GetPointIndexAt(2), 0);
    EXPECT_TRUE(line->SetPointIndexAt(1, 0));
    EXPECT_TRUE(line->SetPointIndexAt(0, 2, true));
    EXPECT_FALSE(line->SetPointIndexAt(0, 3));
    EXPECT_FALSE(line->SetPointIndexAt(0, -1));
    EXPECT_FALSE(line->SetPointIndexAt(-1, 0));
    EXPECT_EQ(line->GetPointIndexAt(0), 1);
    EXPECT_EQ(line->GetEndPointCount(), 1);
    EXPECT_EQ(line->GetEndPointAt(0), 2);
    line->SetIndexArraySize(-5);
    EXPECT_EQ(line->GetIndexArraySize(), 0);
}

TEST_F(Line, IsNotRenderableUnlessItSaysSo) {
    auto* line = make<FbxLine>();
    EXPECT_FALSE(line->Renderable.Get());
    line->Renderable.Set(true);
    EXPECT_TRUE(line->FindProperty("Renderable").Get<FbxBool>());
}

} // namespace
} // namespace fbxsdk::detail
