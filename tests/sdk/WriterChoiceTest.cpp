// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The choice among more writers than the platform has.
#include "access/WriterChoice.h"

#include <gtest/gtest.h>

#include <utility>
#include <vector>

namespace Tarnell::Fbx {
namespace {

struct Writer {
    const char* description;
    bool isFbx;
};

/// Implements the platform's registry.
class Registry {
public:
    Registry(std::vector<Writer> writers, int native) : mWriters(std::move(writers)), mNative(native) {}
    int GetWriterFormatCount() const { return static_cast<int>(mWriters.size()); }
    bool WriterIsFBX(int format) const { return mWriters.at(static_cast<std::size_t>(format)).isFbx; }
    const char* GetWriterFormatDescription(int format) const {
        return mWriters.at(static_cast<std::size_t>(format)).description;
    }
    int GetNativeWriterFormat() const { return mNative; }

private:
    std::vector<Writer> mWriters;
    int mNative;
};

TEST(WriterChoice, IsTheFirstFbxWriterOfTheWord) {
    const Registry registry({{"Something ascii (*.txt)", false},
                             {"FBX binary (*.fbx)", true},
                             {"FBX ascii (*.fbx)", true},
                             {"FBX encrypted binary (*.fbx)", true},
                             {"FBX 6.0 ascii (*.fbx)", true}},
                            /*native*/ 3);

    EXPECT_EQ(detail::findWriter(registry, "ascii"), 2);
    EXPECT_EQ(detail::findWriter(registry, "binary"), 1);
}

TEST(WriterChoice, IsTheNativeWriterWhenNoneHasTheWord) {
    const Registry registry({{"Something ascii (*.txt)", false}, {"FBX ASCII (*.fbx)", true}, {"FBX (*.fbx)", true}},
                            /*native*/ 2);

    EXPECT_EQ(detail::findWriter(registry, "ascii"), 2) << "letters count as they are";
    EXPECT_EQ(detail::findWriter(registry, "binary"), 2);
    EXPECT_EQ(detail::findWriter(Registry({}, -1), "binary"), -1);
}

} // namespace
} // namespace Tarnell::Fbx
