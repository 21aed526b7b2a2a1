// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The conformance run fails when it should: on less agreement, on files that are not listed, and on stale lists.
#include "Expectations.h"

#include "../support/TemporaryFolder.h"

#include <gmock/gmock.h>

using namespace conformance;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace {

constexpr const char* kExpected = R"({"nodes": {"compared": 10, "agreeing": 9,
    "differing": [{"reason": "kept on purpose", "files": ["cube"]}]}})";

Results resultOf(std::int64_t compared, std::int64_t agreeing, std::set<std::string> differingFiles) {
    return {{"nodes", {compared, agreeing, 1, std::move(differingFiles)}}};
}

class ExpectationsTest : public testing::Test {
protected:
    support::TemporaryFolder folder;
    std::string path = folder.write("expected.json", kExpected);
    Expectations expectations{path};
};

} // namespace

TEST_F(ExpectationsTest, AcceptsWhatWasRecorded) {
    EXPECT_THAT(expectations.violations(resultOf(10, 9, {"cube"})), IsEmpty());
}

TEST_F(ExpectationsTest, RejectsLessAgreement) {
    EXPECT_THAT(expectations.violations(resultOf(10, 8, {"cube"})), ElementsAre(HasSubstr("8 of 9 values agree")));
}

TEST_F(ExpectationsTest, RejectsFewerComparisons) {
    EXPECT_THAT(expectations.violations(resultOf(9, 9, {"cube"})), ElementsAre(HasSubstr("9 of 10 values compared")));
}

TEST_F(ExpectationsTest, RejectsADifferingFileThatIsNotListed) {
    EXPECT_THAT(expectations.violations(resultOf(10, 9, {"cube", "cone"})), ElementsAre(HasSubstr("cone differs")));
}

TEST_F(ExpectationsTest, RejectsAListedFileThatAgrees) {
    EXPECT_THAT(expectations.violations(resultOf(10, 10, {})), ElementsAre(HasSubstr("cube agrees now")));
}

TEST_F(ExpectationsTest, KnowsTheReasonOfAListedFile) {
    EXPECT_EQ(expectations.reasonOf("nodes", "cube"), "kept on purpose");
    EXPECT_EQ(expectations.reasonOf("nodes", "cone"), "");
    EXPECT_EQ(expectations.reasonOf("curves", "cube"), "");
}

TEST_F(ExpectationsTest, RejectsARowWithoutExpectations) {
    const Results results = {{"curves", {3, 2, 1, {"cone"}}}};

    EXPECT_THAT(expectations.violations(results), ElementsAre(HasSubstr("curves: cone differs")));
}

TEST_F(ExpectationsTest, UpdateKeepsReasonsAndAsksForNewOnes) {
    expectations.update(resultOf(12, 10, {"cube", "cone"}));
    expectations.write();

    EXPECT_THAT(Expectations(path).violations(resultOf(12, 10, {"cube", "cone"})),
                ElementsAre(HasSubstr("cone differs without a stated reason")));
}

TEST_F(ExpectationsTest, UpdateDropsFilesThatAgree) {
    expectations.update(resultOf(10, 10, {}));
    expectations.write();

    EXPECT_THAT(Expectations(path).violations(resultOf(10, 10, {})), IsEmpty());
}
