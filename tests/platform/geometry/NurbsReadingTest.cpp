// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// NURBS from records, valid and invalid.
#include "geometry/NurbsReading.h"

#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "NurbsSamples.h"
#include "platform/scene/SceneFixture.h"

namespace fbxsdk::detail {
namespace {

std::string numbers(int count) {
    std::string text = "*" + std::to_string(count) + " { a: ";
    for (int i = 0; i < count; ++i)
        text += (i ? "," : "") + std::to_string(i);
    return text + " }\n";
}

/// A surface of 4 by 3 control points, order 4 by 2, with any record replaced.
struct SurfaceText {
    std::string order = "4,2", dimensions = "4,3", step = "5,6", form = "\"Open\",\"Open\"", rest;
    int points = 48, knotsU = 8, knotsV = 5;

    [[nodiscard]] std::string text(const std::string& orderName = "NurbsSurfaceOrder") const {
        return orderName + ": " + order + "\nDimensions: " + dimensions + "\nStep: " + step + "\nForm: " + form +
               "\nPoints: " + numbers(points) + "KnotVectorU: " + numbers(knotsU) + "KnotVectorV: " + numbers(knotsV) +
               rest;
    }
};

class NurbsReading : public SceneFixture {
protected:
    FbxNurbsSurface* read(const SurfaceText& text) {
        auto* surface = make<FbxNurbsSurface>();
        readNurbsSurface(*surface, RecordsOf(text.text()));
        return surface;
    }
    static void expectNoGeometry(const FbxNurbsSurfaceBase& surface) {
        EXPECT_EQ(surface.GetControlPointsCount(), 0);
        EXPECT_EQ(surface.GetUCount(), 0);
        EXPECT_EQ(surface.GetVCount(), 0);
        EXPECT_EQ(surface.GetUKnotCount(), 0);
        EXPECT_EQ(surface.GetVKnotVector(), nullptr);
    }
};

TEST_F(NurbsReading, ReadsASurface) {
    SurfaceText text;
    text.rest = "FlipNormals: 1\n";
    const FbxNurbsSurface& surface = *read(text);
    EXPECT_EQ(surface.GetUCount(), 4);
    EXPECT_EQ(surface.GetVCount(), 3);
    EXPECT_EQ(surface.GetUOrder(), 4);
    EXPECT_EQ(surface.GetVOrder(), 2);
    EXPECT_EQ(surface.GetUStep(), 5);
    EXPECT_EQ(surface.GetVStep(), 6);
    EXPECT_EQ(surface.GetNurbsUType(), FbxNurbsSurface::eOpen);
    EXPECT_EQ(surface.GetUKnotCount(), 8);
    EXPECT_EQ(surface.GetVKnotCount(), 5);
    EXPECT_EQ(surface.GetVKnotVector()[4], 4.0);
    EXPECT_EQ(surface.GetUMultiplicityVector(), nullptr);
    EXPECT_TRUE(surface.GetFlipNormals());
    ASSERT_EQ(surface.GetControlPointsCount(), 12);
    EXPECT_EQ(surface.GetControlPointAt(1), FbxVector4(4, 5, 6, 7));
    EXPECT_EQ(surface.GetAttributeType(), FbxNodeAttribute::eNurbsSurface);
}

TEST_F(NurbsReading, ExpectsAKnotMoreForAClosedDirectionAndAnOrderLessOneForAPeriodicOne) {
    SurfaceText text;
    text.form = "\"Periodic\",\"Closed\"";
    text.knotsU = 4 + 2 * 4 - 1;
    text.knotsV = 3 + 2 + 1;
    const FbxNurbsSurface& surface = *read(text);
    EXPECT_EQ(surface.GetControlPointsCount(), 12);
    EXPECT_EQ(surface.GetNurbsUType(), FbxNurbsSurface::ePeriodic);
    EXPECT_EQ(surface.GetNurbsVType(), FbxNurbsSurface::eClosed);
}

TEST_F(NurbsReading, TakesFourStepsWhereTheFileSaysNothing) {
    auto* surface = make<FbxNurbsSurface>();
    std::string text = SurfaceText().text();
    text.replace(text.find("Step:"), 5, "Stop:");
    readNurbsSurface(*surface, RecordsOf(text));
    EXPECT_EQ(surface->GetUStep(), 4);
    EXPECT_EQ(surface->GetVStep(), 4);
}

TEST_F(NurbsReading, KeepsHugeAndNegativeStepsWithinAnInt) {
    SurfaceText text;
    text.step = "4294967296,-7";
    const FbxNurbsSurface& surface = *read(text);
    EXPECT_EQ(surface.GetUStep(), 2147483647);
    EXPECT_EQ(surface.GetVStep(), 1);
}

TEST_F(NurbsReading, HasNoGeometryWhenNumbersDoNotFitTogether) {
    const auto unsound = [&](auto change) {
        SurfaceText text;
        change(text);
        SCOPED_TRACE(text.text());
        expectNoGeometry(*read(text));
    };
    unsound([](SurfaceText& text) { text.order = "1,2"; });
    unsound([](SurfaceText& text) { text.order = "5,2"; });
    unsound([](SurfaceText& text) { text.order = "4,4"; });
    unsound([](SurfaceText& text) { text.order = "4"; });
    unsound([](SurfaceText& text) { text.order = "-4,-2"; });
    unsound([](SurfaceText& text) { text.order = "9223372036854775807,2"; });
    unsound([](SurfaceText& text) { text.dimensions = "3,4"; });
    unsound([](SurfaceText& text) { text.dimensions = "4,2"; });
    unsound([](SurfaceText& text) { text.dimensions = "0,0"; });
    unsound([](SurfaceText& text) { text.dimensions = "-4,-3"; });
    unsound([](SurfaceText& text) { text.dimensions = "4294967300,3"; });
    unsound([](SurfaceText& text) { text.dimensions = "536870912,536870912"; });
    unsound([](SurfaceText& text) { text.points = 47; });
    unsound([](SurfaceText& text) { text.points = 52; });
    unsound([](SurfaceText& text) { text.points = 0; });
    unsound([](SurfaceText& text) { text.knotsU = 7; });
    unsound([](SurfaceText& text) { text.knotsU = 9; });
    unsound([](SurfaceText& text) { text.knotsV = 0; });
    unsound([](SurfaceText& text) { text.form = "\"Periodic\",\"Open\""; });
}

TEST_F(NurbsReading, HasNoGeometryWithoutRecords) {
    auto* surface = make<FbxNurbsSurface>();
    readNurbsSurface(*surface, RecordsOf("Type: \"NurbsSurface\""));
    expectNoGeometry(*surface);
    auto* nurbs = make<FbxNurbs>();
    readNurbs(*nurbs, RecordsOf(""));
    expectNoGeometry(*nurbs);
}

TEST_F(NurbsReading, ReadsTheRecordsOfOlderWriters) {
    auto* nurbs = make<FbxNurbs>();
    readNurbs(*nurbs, RecordsOf(SurfaceText().text("NurbOrder")));
    EXPECT_EQ(nurbs->GetAttributeType(), FbxNodeAttribute::eNurbs);
    EXPECT_EQ(nurbs->GetUCount(), 4);
    EXPECT_EQ(nurbs->GetControlPointsCount(), 12);
    EXPECT_EQ(nurbs->GetUKnotCount(), 8);
}

TEST_F(NurbsReading, RepeatsKnotsThatOlderWritersCount) {
    SurfaceText text;
    text.knotsU = 2;
    text.rest = "MultiplicityU: *2 { a: 4,4 }\nMultiplicityV: *5 { a: 1,1,1,1,1 }\n";
    auto* nurbs = make<FbxNurbs>();
    readNurbs(*nurbs, RecordsOf(text.text("NurbOrder")));
    ASSERT_EQ(nurbs->GetUKnotCount(), 8);
    EXPECT_EQ(std::vector<double>(nurbs->GetUKnotVector(), nurbs->GetUKnotVector() + 8),
              (std::vector<double>{0, 0, 0, 0, 1, 1, 1, 1}));
    EXPECT_EQ(nurbs->GetVKnotCount(), 5);
    EXPECT_EQ(nurbs->GetUMultiplicityVector()[1], 4);
}

TEST_F(NurbsReading, RefusesKnotCountsThatLeadToAnotherNumber) {
    for (const char* counts : {"4,3", "4,5", "8,0", "9,-1", "2147483647,2147483647"}) {
        SurfaceText text;
        text.knotsU = 2;
        text.rest = std::string("MultiplicityU: *2 { a: ") + counts + " }\n";
        auto* nurbs = make<FbxNurbs>();
        readNurbs(*nurbs, RecordsOf(text.text("NurbOrder")));
        expectNoGeometry(*nurbs);
    }
}

TEST_F(NurbsReading, ReadsACurve) {
    auto* curve = make<FbxNurbsCurve>();
    readNurbsCurve(*curve, RecordsOf("Order: 3\nDimension: 2\nForm: \"Periodic\"\nRational: 1\nPoints: " + numbers(20) +
                                     "KnotVector: " + numbers(10)));
    EXPECT_EQ(curve->GetControlPointsCount(), 5);
    EXPECT_EQ(curve->GetControlPointAt(4), FbxVector4(16, 17, 18, 19));
    EXPECT_EQ(curve->GetOrder(), 3);
    EXPECT_EQ(curve->GetDimension(), FbxNurbsCurve::e2D);
    EXPECT_EQ(curve->GetType(), FbxNurbsCurve::ePeriodic);
    EXPECT_TRUE(curve->IsRational());
    EXPECT_EQ(curve->GetKnotCount(), 10);
    EXPECT_EQ(curve->GetAttributeType(), FbxNodeAttribute::eNurbsCurve);
}

TEST_F(NurbsReading, LeavesACurveEmptyWhenNumbersDoNotFitTogether) {
    const struct {
        int order, points, knots;
    } kCases[] = {{1, 20, 6}, {6, 20, 11}, {3, 20, 7}, {3, 20, 9}, {3, 19, 8}, {3, 0, 0}, {20, 24, 10}};
    for (const auto& each : kCases) {
        auto* curve = make<FbxNurbsCurve>();
        readNurbsCurve(*curve, RecordsOf("Order: " + std::to_string(each.order) + "\nForm: \"Open\"\nPoints: " +
                                         numbers(each.points) + "KnotVector: " + numbers(each.knots)));
        EXPECT_EQ(curve->GetControlPointsCount(), 0) << each.order << " " << each.points;
        EXPECT_EQ(curve->GetKnotCount(), 0);
        EXPECT_EQ(curve->GetKnotVector(), nullptr);
    }
}

TEST_F(NurbsReading, ReadsWhetherATrimmedSurfaceIsFlipped) {
    auto* trimmed = make<FbxTrimNurbsSurface>();
    EXPECT_FALSE(trimmed->GetFlipNormals());
    readTrimNurbsSurface(*trimmed, RecordsOf("FlipNormals: 1"));
    EXPECT_TRUE(trimmed->GetFlipNormals());
}

} // namespace
} // namespace fbxsdk::detail
