// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deformers from the records of files.
#include "GeometryFixture.h"

#include <string>

#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxShape.h>
#include <fbxsdk/FbxSkin.h>

using namespace fbxsdk;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

class DeformerReading : public GeometryFixture {};

const std::string kLinkAtTen = "TransformLink: *16 { a: 1,0,0,0, 0,1,0,0, 0,0,1,0, 10,0,0,1 }\n";
/// A quarter turn about z: x becomes y.
const std::string kTurned = "Transform: *16 { a: 0,1,0,0, -1,0,0,0, 0,0,1,0, 0,5,0,1 }\n";

std::vector<std::pair<int, double>> influencesOf(const FbxCluster& cluster) {
    std::vector<std::pair<int, double>> influences;
    for (int i = 0; i < cluster.GetControlPointIndicesCount(); ++i)
        influences.emplace_back(cluster.GetControlPointIndices()[i], cluster.GetControlPointWeights()[i]);
    return influences;
}

std::vector<double> fullWeights(FbxBlendShapeChannel& channel) {
    const double* weights = channel.GetTargetShapeFullWeights();
    return {weights, weights + channel.GetTargetShapeCount()};
}

} // namespace

TEST_F(DeformerReading, ReadsTheKindOfSkinning) {
    constexpr struct {
        const char* spelling;
        FbxSkin::EType type;
    } kSpellings[] = {{"Rigid", FbxSkin::eRigid},
                      {"Linear", FbxSkin::eLinear},
                      {"DualQuaternion", FbxSkin::eDualQuaternion},
                      {"Blend", FbxSkin::eBlend},
                      {"unheard of", FbxSkin::eRigid}};
    for (const auto& row : kSpellings) {
        const auto* skin = readDeformer<FbxSkin>("SkinningType: \"" + std::string(row.spelling) + "\"");
        EXPECT_EQ(skin->GetSkinningType(), row.type) << row.spelling;
    }
    EXPECT_EQ(readDeformer<FbxSkin>("Link_DeformAcuracy: 25")->GetDeformAccuracy(), 25);
    EXPECT_EQ(readDeformer<FbxSkin>("")->GetDeformAccuracy(), 50);
}

TEST_F(DeformerReading, ReadsHowMuchOfTheDualQuaternionsPointsTake) {
    const auto* skin = readDeformer<FbxSkin>("SkinningType: \"Blend\"\nIndexes: *3 { a: 3,0,1 }\n"
                                             "BlendWeights: *2 { a: 0.25,1 }");
    ASSERT_EQ(skin->GetControlPointIndicesCount(), 2);
    EXPECT_EQ(skin->GetControlPointIndices()[0], 3);
    EXPECT_EQ(skin->GetControlPointBlendWeights()[0], 0.25);
    EXPECT_EQ(skin->GetControlPointBlendWeights()[1], 1.0);
    EXPECT_EQ(readDeformer<FbxSkin>("")->GetControlPointBlendWeights(), nullptr);
}

TEST_F(DeformerReading, ReadsIndicesAndWeights) {
    const auto* cluster = readDeformer<FbxCluster>("Indexes: *2 { a: 3,0 }\nWeights: *2 { a: 0.5,1 }");

    EXPECT_THAT(influencesOf(*cluster), ElementsAre(std::pair(3, 0.5), std::pair(0, 1.0)));
}

TEST_F(DeformerReading, CutsIndicesAndWeightsToTheShorter) {
    EXPECT_THAT(influencesOf(*readDeformer<FbxCluster>("Indexes: *3 { a: 3,0,1 }\nWeights: *1 { a: 0.5 }")),
                ElementsAre(std::pair(3, 0.5)));
    EXPECT_THAT(influencesOf(*readDeformer<FbxCluster>("Indexes: *1 { a: 3 }\nWeights: *2 { a: 0.5,1 }")),
                ElementsAre(std::pair(3, 0.5)));
}

TEST_F(DeformerReading, HasNoInfluencesWithoutIndicesOrWeights) {
    for (const char* records : {"", "Indexes: *2 { a: 1,2 }", "Weights: *2 { a: 1,1 }", "Indexes: \nWeights: "}) {
        const auto* cluster = readDeformer<FbxCluster>(records);
        EXPECT_THAT(influencesOf(*cluster), IsEmpty()) << records;
        EXPECT_EQ(cluster->GetControlPointIndices(), nullptr) << records;
    }
}

TEST_F(DeformerReading, KeepsIndicesUnchecked) {
    const auto* cluster = readDeformer<FbxCluster>("Indexes: *2 { a: -1,2147483647 }\nWeights: *2 { a: 1,nan }");

    ASSERT_EQ(cluster->GetControlPointIndicesCount(), 2);
    EXPECT_EQ(cluster->GetControlPointIndices()[0], -1);
    EXPECT_EQ(cluster->GetControlPointIndices()[1], 2147483647);
}

TEST_F(DeformerReading, AddsInfluencesToThoseOfTheFile) {
    auto* cluster = readDeformer<FbxCluster>("Indexes: *1 { a: 3 }\nWeights: *1 { a: 0.5 }");

    cluster->AddControlPointIndex(4, 1);

    EXPECT_THAT(influencesOf(*cluster), ElementsAre(std::pair(3, 0.5), std::pair(4, 1.0)));
}

TEST_F(DeformerReading, MakesTheGeometrysPlaceInTheWorldFromItsPlaceAsSeenFromTheLink) {
    const auto* cluster = readDeformer<FbxCluster>(kTurned + kLinkAtTen);
    FbxAMatrix matrix;

    EXPECT_EQ(cluster->GetTransformLinkMatrix(matrix).GetT(), FbxVector4(10, 0, 0));
    cluster->GetTransformMatrix(matrix);
    EXPECT_EQ(matrix.MultT(FbxVector4(0, 0, 0)), FbxVector4(10, 5, 0));
    EXPECT_EQ(matrix.MultT(FbxVector4(1, 0, 0)), FbxVector4(10, 6, 0));
}

TEST_F(DeformerReading, AppliesTheLinksTurnToTheGeometrysPlace) {
    const auto* cluster = readDeformer<FbxCluster>("TransformLink: *16 { a: 0,1,0,0, -1,0,0,0, 0,0,1,0, 1,2,3,1 }\n"
                                                   "Transform: *16 { a: 1,0,0,0, 0,1,0,0, 0,0,1,0, 7,0,0,1 }\n");
    FbxAMatrix matrix;

    EXPECT_EQ(cluster->GetTransformMatrix(matrix).GetT(), FbxVector4(1, 9, 3));
}

TEST_F(DeformerReading, UsesWhatMatricesThereAre) {
    FbxAMatrix matrix;

    const auto* withoutLink = readDeformer<FbxCluster>(kTurned);
    EXPECT_EQ(withoutLink->GetTransformMatrix(matrix).GetT(), FbxVector4(0, 5, 0));
    EXPECT_TRUE(withoutLink->GetTransformLinkMatrix(matrix).IsIdentity());

    const auto* withoutGeometry = readDeformer<FbxCluster>(kLinkAtTen);
    EXPECT_TRUE(withoutGeometry->GetTransformMatrix(matrix).IsIdentity());
    EXPECT_EQ(withoutGeometry->GetTransformLinkMatrix(matrix).GetT(), FbxVector4(10, 0, 0));

    const auto* tooShort = readDeformer<FbxCluster>("TransformLink: *3 { a: 1,2,3 }");
    EXPECT_TRUE(tooShort->GetTransformLinkMatrix(matrix).IsIdentity());
}

TEST_F(DeformerReading, ReadsTheAssociateModelsPlace) {
    const auto* cluster =
        readDeformer<FbxCluster>("TransformAssociateModel: *16 { a: 1,0,0,0, 0,1,0,0, 0,0,1,0, 0,0,4,1 }");
    FbxAMatrix matrix;

    EXPECT_EQ(cluster->GetTransformAssociateModelMatrix(matrix).GetT(), FbxVector4(0, 0, 4));
}

TEST_F(DeformerReading, TakesEveryMatrixForAnAffineOne) {
    const auto* cluster = readDeformer<FbxCluster>("TransformLink: *16 { a: 1,0,0,5, 0,1,0,6, 0,0,1,7, 1,2,3,8 }");
    FbxAMatrix matrix;

    EXPECT_EQ(cluster->GetTransformLinkMatrix(matrix).GetColumn(3), FbxVector4(0, 0, 0, 1));
}

TEST_F(DeformerReading, ReadsTheModeOfLinks) {
    EXPECT_EQ(readDeformer<FbxCluster>("")->GetLinkMode(), FbxCluster::eNormalize);
    EXPECT_EQ(readDeformer<FbxCluster>("Mode: \"Total1\"")->GetLinkMode(), FbxCluster::eTotalOne);
    EXPECT_EQ(readDeformer<FbxCluster>("Mode: \"Additive\"")->GetLinkMode(), FbxCluster::eAdditive);
    EXPECT_EQ(readDeformer<FbxCluster>("Mode: \"Nonsense\"")->GetLinkMode(), FbxCluster::eNormalize);
}

TEST_F(DeformerReading, ReadsThePercentageOfAChannel) {
    EXPECT_EQ(readDeformer<FbxBlendShapeChannel>("DeformPercent: 37.5")->DeformPercent.Get(), 37.5);
    EXPECT_EQ(readDeformer<FbxBlendShapeChannel>("")->DeformPercent.Get(), 0);
}

TEST_F(DeformerReading, PrefersThePropertyToTheRecord) {
    const auto source = documentOf("DeformPercent: 37.5");
    fbxsdk::detail::DocumentObject object;
    object.body = source->objects.front().body;
    object.properties.emplace_back().name = "DeformPercent";
    auto* channel = make<FbxBlendShapeChannel>();
    channel->DeformPercent.Set(60.0); // as the reader of properties does

    fbxsdk::detail::readDeformer(*channel, source, object);

    EXPECT_EQ(channel->DeformPercent.Get(), 60);
}

TEST_F(DeformerReading, ReadsFullWeights) {
    auto* channel = readDeformer<FbxBlendShapeChannel>("FullWeights: *3 { a: -49.9,-24.9,100 }");
    for (int i = 0; i < 3; ++i)
        channel->ConnectSrcObject(make<FbxShape>());

    EXPECT_THAT(fullWeights(*channel), ElementsAre(-49.9, -24.9, 100));
}

TEST_F(DeformerReading, CompletesFullWeightsThatAreTooFew) {
    auto* channel = readDeformer<FbxBlendShapeChannel>("FullWeights: *1 { a: 10 }");
    for (int i = 0; i < 4; ++i)
        channel->ConnectSrcObject(make<FbxShape>());

    EXPECT_THAT(fullWeights(*channel), ElementsAre(10, 50, 75, 100));
}

TEST_F(DeformerReading, KeepsTheFileForAClusterThatWasNotAccessed) {
    auto* cluster = make<FbxCluster>();
    {
        const auto document = documentOf("Indexes: *1 { a: 3 }\nWeights: *1 { a: 0.5 }");
        fbxsdk::detail::readDeformer(*cluster, document, document->objects.front());
    }

    EXPECT_THAT(influencesOf(*cluster), ElementsAre(std::pair(3, 0.5)));
}
