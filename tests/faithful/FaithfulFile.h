// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Faithful writes through the facade, and what a faithful read returns of the file.
#pragma once

#include "FaithfulFixture.h"

#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <fstream>
#include <iterator>
#include <string>
#include <vector>

namespace Tarnell::Fbx::test {

using Version = TnFbxWriteInfo::eCompatibilityVersion;

/// A file, written faithfully, removed with the object.
class FaithfulFile {
public:
    explicit FaithfulFile(Version version = TnFbxWriteInfo::kFbxVersion2016, bool ascii = false) {
        info.setFileName(mFolder.file("scene.fbx"));
        info.setFidelity(kFbxFidelityFaithful);
        info.setFileFormat(ascii);
        info.setCompatibilityVersion(version);
    }

    void write(const WrittenObjects& objects) {
        EXPECT_TRUE(
            Fbx().writeFile(info, objects.cameras, objects.lights, objects.transforms, objects.nulls, objects.meshes))
            << lastError();
        warnings = lastWarnings();
    }

    /// Without the transform in the points.
    TnFbxReadInfo readInfo() const {
        TnFbxReadInfo read = faithfulRead(info.getFileName());
        read.setTransformPoints(false);
        return read;
    }
    template <class Object>
    FacadeRead<Object> read() const {
        return FacadeRead<Object>(readInfo());
    }
    std::string bytes() const {
        std::ifstream stream(info.getFileName(), std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    std::string warningText() const {
        std::string text;
        for (const std::string& warning : warnings)
            text += warning + '\n';
        return text;
    }

    TnFbxWriteInfo info;
    std::vector<std::string> warnings;

private:
    support::TemporaryFolder mFolder;
};

} // namespace Tarnell::Fbx::test
