// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A scene that is written and read again, in every version and both formats.
#pragma once

#include <array>
#include <ostream>
#include <string>
#include <vector>

#include <fbxsdk/FbxExporter.h>
#include <fbxsdk/FbxImporter.h>
#include <fbxsdk/FbxNode.h>

#include "platform/scene/SceneFixture.h"
#include "schema/VersionTraits.h"
#include "support/TemporaryFolder.h"

namespace exporting {

struct Layout {
    const char* version;
    int format; ///< 0 binary, 1 ASCII

    [[nodiscard]] bool hasIds() const { return fbxsdk::detail::findVersion(version)->generation == 7; }
    [[nodiscard]] bool hasInlineShapes() const { return fbxsdk::detail::findVersion(version)->inlineShapes; }
};

inline void PrintTo(const Layout& layout, std::ostream* stream) {
    *stream << layout.version << (layout.format == 1 ? " ASCII" : " binary");
}

inline std::vector<Layout> allLayouts() {
    std::vector<Layout> layouts;
    for (const auto& version : fbxsdk::detail::kVersionTraits) {
        layouts.push_back({version.name, 0});
        layouts.push_back({version.name, 1});
    }
    return layouts;
}

class ExportFixture : public SceneFixture {
protected:
    /// Writes the fixture's scene. A failure is one of the test.
    std::string write(const Layout& layout, const std::string& name = "out.fbx") {
        using fbxsdk::FbxExporter;
        FbxExporter* exporter = FbxExporter::Create(manager, "");
        EXPECT_TRUE(exporter->SetFileExportVersion(layout.version));
        EXPECT_TRUE(exporter->Initialize(folder.file(name).c_str(), layout.format));
        EXPECT_TRUE(exporter->Export(scene)) << exporter->GetStatus().GetErrorString();
        EXPECT_FALSE(exporter->GetStatus().Error());
        exporter->Destroy();
        return folder.read(name);
    }

    /// A new scene with the content of the file.
    fbxsdk::FbxScene* read(const std::string& name = "out.fbx") {
        using fbxsdk::FbxImporter;
        FbxImporter* importer = FbxImporter::Create(manager, "");
        fbxsdk::FbxScene* copy = fbxsdk::FbxScene::Create(manager, "copy");
        EXPECT_TRUE(importer->Initialize(folder.file(name).c_str())) << importer->GetStatus().GetErrorString();
        EXPECT_TRUE(importer->Import(copy)) << importer->GetStatus().GetErrorString();
        EXPECT_TRUE(importer->GetFileHeaderInfo()->mWarnings.empty());
        importer->GetFileVersion(version[0], version[1], version[2]);
        importer->Destroy();
        return copy;
    }

    fbxsdk::FbxScene* writeAndRead(const Layout& layout) {
        write(layout);
        return read();
    }

    /// A node below the root.
    fbxsdk::FbxNode* addNode(const char* name, fbxsdk::FbxNodeAttribute* attribute = nullptr) {
        fbxsdk::FbxNode* node = make<fbxsdk::FbxNode>(name);
        if (attribute)
            node->SetNodeAttribute(attribute);
        scene->GetRootNode()->AddChild(node);
        return node;
    }

    support::TemporaryFolder folder;
    std::array<int, 3> version{}; ///< of the file that was read last
};

class EveryLayout : public ExportFixture, public testing::WithParamInterface<Layout> {
protected:
    fbxsdk::FbxScene* writeAndRead() { return ExportFixture::writeAndRead(GetParam()); }
    std::string write() { return ExportFixture::write(GetParam()); }

    static fbxsdk::FbxNode* childOf(fbxsdk::FbxScene* copy, int index = 0) {
        return copy->GetRootNode()->GetChild(index);
    }
    /// The attribute of a node below the root. Having another one is a failure of the test.
    template <class T>
    static T* attributeOf(fbxsdk::FbxScene* copy, int index = 0) {
        fbxsdk::FbxNode* node = childOf(copy, index);
        T* attribute = node ? fbxsdk::FbxCast<T>(node->GetNodeAttribute()) : nullptr;
        EXPECT_NE(attribute, nullptr);
        return attribute;
    }
};

inline void expectVector(const fbxsdk::FbxDouble3& actual, double x, double y, double z) {
    EXPECT_EQ(actual[0], x);
    EXPECT_EQ(actual[1], y);
    EXPECT_EQ(actual[2], z);
}

} // namespace exporting
