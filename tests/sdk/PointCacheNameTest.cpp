// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names of nodes as names of files: plain ones unchanged, all others in a form that every system can hold.
#include "access/PointCacheName.h"

#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "Fbx.h"
#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <set>

namespace Tarnell::Fbx {
namespace {

using detail::pointCacheName;
using testing::MatchesRegex;
using testing::StartsWith;

TEST(PointCacheName, IsThatOfTheNodeWhereItIsPlain) {
    for (const char* name : {"ball", "ball 01", "ball.v2", ".ball", "ball_[a] (b) {c} #1 100% 50%x", "Kugel über 球",
                             "CONE", "NULL", "COM", "COM10", "con_01", "\U0001F3B2"})
        EXPECT_EQ(pointCacheName(name), name);
}

TEST(PointCacheName, EscapesCharactersThatFileNamesCannotContain) {
    const std::pair<const char*, const char*> rows[] = {
        {"a/b", "a%2Fb"},
        {"a\\b", "a%5Cb"},
        {"ns:ball", "ns%3Aball"},
        {"a*b?\"<>|", "a%2Ab%3F%22%3C%3E%7C"},
        {"../../up", "..%2F..%2Fup"},
        {"/root", "%2Froot"},
        {"a\nb\x01\x7F", "a%0Ab%01%7F"},
    };
    for (const auto& [name, expected] : rows)
        EXPECT_EQ(pointCacheName(name), expected);
}

TEST(PointCacheName, EscapesDotsAndBlanksAtTheEnd) {
    EXPECT_EQ(pointCacheName("."), "%2E");
    EXPECT_EQ(pointCacheName(".."), "%2E%2E");
    EXPECT_EQ(pointCacheName(" "), "%20");
    EXPECT_EQ(pointCacheName("ball. ."), "ball%2E%20%2E");
    EXPECT_EQ(pointCacheName(""), "%00");
}

TEST(PointCacheName, EscapesNamesThatSystemsReserve) {
    EXPECT_EQ(pointCacheName("CON"), "%43ON");
    EXPECT_EQ(pointCacheName("nul"), "%6Eul");
    EXPECT_EQ(pointCacheName("Aux.left"), "%41ux.left");
    EXPECT_EQ(pointCacheName("com1"), "%63om1");
    EXPECT_EQ(pointCacheName("LPT9"), "%4CPT9");
}

TEST(PointCacheName, EscapesBytesThatAreNoText) {
    EXPECT_EQ(pointCacheName("a\xFF"), "a%FF");
    EXPECT_EQ(pointCacheName("\xC3"), "%C3") << "cut off";
    EXPECT_EQ(pointCacheName("\xC0\xAF"), "%C0%AF") << "a slash in disguise";
    EXPECT_EQ(pointCacheName("\xED\xA0\x80"), "%ED%A0%80") << "half of a pair";
    EXPECT_EQ(pointCacheName("\xF4\x90\x80\x80"), "%F4%90%80%80") << "beyond the last character";
    EXPECT_EQ(pointCacheName("\xE2\x82z"), "%E2%82z");
}

TEST(PointCacheName, TellsEscapedNamesFromThoseThatLookLikeThem) {
    const std::set<std::string> names = {pointCacheName("a/b"), pointCacheName("a%2Fb"), pointCacheName("a%252Fb"),
                                         pointCacheName("a%2fb")};

    EXPECT_EQ(names.size(), 4u);
    EXPECT_EQ(pointCacheName("a%2Fb"), "a%252Fb");
}

TEST(PointCacheName, IsShortEnoughForAFileAndStillItsOwn) {
    const std::string longName(300, 'n');
    const std::string name = pointCacheName(longName);

    EXPECT_EQ(name.size(), 240u);
    EXPECT_THAT(name, StartsWith(std::string(223, 'n') + "~"));
    EXPECT_THAT(name.substr(223), MatchesRegex("~[0-9A-F]+"));
    EXPECT_NE(name, pointCacheName(longName + "n"));
    EXPECT_EQ(pointCacheName(std::string(240, 'n')), std::string(240, 'n'));
    EXPECT_LE(pointCacheName(std::string(100000, '/')).size(), 240u);
}

TEST(PointCacheName, IsCutBetweenCharactersAndEscapes) {
    for (const char* unit : {"\u00FC", "\u7403", "\U0001F3B2", "/"}) {
        for (int before = 0; before < 4; ++before) {
            std::string name(static_cast<std::size_t>(before), 'n');
            for (int i = 0; i < 300; ++i)
                name += unit;
            const std::string shortened = pointCacheName(name);
            const std::string kept = shortened.substr(0, shortened.rfind('~'));
            const std::string piece = pointCacheName(unit);
            EXPECT_LE(shortened.size(), 240u);
            EXPECT_EQ((kept.size() - static_cast<std::size_t>(before)) % piece.size(), 0u);
        }
    }
}

/// Nodes keep their names in the FBX file, whatever the names of their caches.
TEST(PointCacheName, LetsMeshesOfAnyNameComeBackWithTheirPoints) {
    for (const bool maya : {true, false}) {
        support::TemporaryFolder folder;
        std::vector<std::unique_ptr<TnFbxMesh>> meshes;
        test::WrittenObjects objects;
        for (const std::string& name :
             {std::string("a/b"), std::string("ns:ball"), std::string("../up"), std::string("CON"), std::string("."),
              std::string("ball. "), std::string(300, 'n'), std::string("tab\there")}) {
            meshes.push_back(test::movingMesh(name, 3));
            objects.meshes.push_back(meshes.back().get());
        }
        TnFbxWriteInfo info = test::writeInfo();
        info.setFileName(folder.file("shot.fbx"));
        info.setAnimateMeshVertices(true);
        info.setMayaVertexCacheFormat(maya);
        info.setStartFrame(10.0f);
        info.setEndFrame(12.0f);
        ASSERT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, objects.meshes)) << lastError();
        EXPECT_THAT(lastWarnings(), testing::IsEmpty());

        TnFbxReadInfo read;
        read.setFileName(folder.file("shot.fbx"));
        read.setAnimationStackName("any");
        read.setTransformPoints(false);
        read.setFrame(12.0f);
        TnFbxMesh* found = nullptr;
        int count = 0;
        ASSERT_TRUE(Fbx().getMeshes(read, &found, count)) << lastError();
        const std::unique_ptr<TnFbxMesh[]> owner(found);
        ASSERT_EQ(count, static_cast<int>(meshes.size()));
        for (int i = 0; i < count; ++i) {
            float x = 0.0f, y = 0.0f, z = 0.0f;
            EXPECT_EQ(found[i].getName(), meshes[static_cast<std::size_t>(i)]->getName());
            EXPECT_TRUE(found[i].getControlPoint(0, x, y, z));
            EXPECT_EQ(z, 2.0f) << found[i].getName();
        }
    }
}

} // namespace
} // namespace Tarnell::Fbx
