// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects are written into a file of every version, as ASCII and as binary, to be read back.
#pragma once

#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "Fbx.h"
#include "TnFbxError.h"
#include "TnFbxWriteInfo.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <tuple>
#include <vector>

namespace Tarnell::Fbx::test {

using Samples = std::vector<float>;
using Transform = TnFbxTransform;

/// A version and whether the file is text.
using Variant = std::tuple<int, bool>;

class RoundTripFixture : public testing::TestWithParam<Variant> {
protected:
    TnFbxWriteInfo info() const {
        TnFbxWriteInfo info;
        info.setFileName(file());
        info.setAnimationStackName("Take 001");
        info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(std::get<0>(GetParam())));
        info.setFileFormat(std::get<1>(GetParam()));
        info.setAnimateMeshVertices(false);
        return info;
    }
    std::string file() const { return mFolder.file("shot.fbx"); }

    void write(const WrittenObjects& objects) { write(objects, info()); }
    void write(const WrittenObjects& objects, const TnFbxWriteInfo& options) {
        ASSERT_TRUE(Fbx().writeFile(options, objects.cameras, objects.lights, objects.transforms, objects.nulls,
                                    objects.meshes))
            << lastError();
    }

    support::TemporaryFolder mFolder;
};

inline auto everyVariant() { return testing::Combine(testing::Range(0, 6), testing::Bool()); }

inline std::string variantName(const testing::TestParamInfo<Variant>& variant) {
    constexpr std::array<const char*, 6> kNames = {"2010", "2011", "2012", "2013", "2014", "2016"};
    return std::string("Fbx") + kNames.at(static_cast<std::size_t>(std::get<0>(variant.param))) +
           (std::get<1>(variant.param) ? "Ascii" : "Binary");
}

} // namespace Tarnell::Fbx::test
