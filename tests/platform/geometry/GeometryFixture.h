// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A scene whose geometry is given as the records of a file.
#pragma once

#include <deque>
#include <initializer_list>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fbxsdk/FbxGeometryBase.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxScene.h>

#include "document/Document.h"
#include "geometry/GeometryReading.h"

class GeometryFixture : public testing::Test {
protected:
    GeometryFixture() : manager(fbxsdk::FbxManager::Create()), scene(fbxsdk::FbxScene::Create(manager, "scene")) {}
    ~GeometryFixture() override { manager->Destroy(); }

    template <class T>
    T* make(const char* name = "") {
        return T::Create(scene, name);
    }

    /// A document whose only object has these records as its body.
    std::shared_ptr<const fbxsdk::detail::Document> documentOf(const std::string& records) {
        fbxsdk::FbxStatus status;
        const std::string& text = mTexts.emplace_back("; FBX 7.4.0 project file\n" + records);
        auto document = std::make_shared<fbxsdk::detail::Document>();
        document->tree = fbxsdk::detail::readRecords(std::span(text.data(), text.size()), "test.fbx", status);
        EXPECT_NE(document->tree, nullptr) << status.GetErrorString();
        document->objects.emplace_back().body = &document->tree->root;
        return document;
    }

    /// Geometry that has these records in its file.
    template <class T>
    T* read(const std::string& records) {
        const auto document = documentOf(records);
        T* geometry = make<T>();
        fbxsdk::detail::attachSource(*geometry, document, document->objects.front());
        return geometry;
    }
    template <class T>
    T* readDeformer(const std::string& records) {
        const auto document = documentOf(records);
        T* deformer = make<T>();
        fbxsdk::detail::readDeformer(*deformer, document, document->objects.front());
        return deformer;
    }

private:
    std::deque<std::string> mTexts; ///< a tree points into its text
    // The manager is destroyed first: geometry may still point into the texts.
protected:
    fbxsdk::FbxManager* manager;
    fbxsdk::FbxScene* scene;
};

template <class T>
std::vector<T> itemsOf(const fbxsdk::FbxLayerElementArrayTemplate<T>& array) {
    std::vector<T> items;
    for (int i = 0; i < array.GetCount(); ++i)
        items.push_back(array.GetAt(i));
    return items;
}

inline std::vector<fbxsdk::FbxVector4> pointsOf(const fbxsdk::FbxGeometryBase& geometry) {
    const fbxsdk::FbxVector4* points = geometry.GetControlPoints();
    return {points, points + geometry.GetControlPointsCount()};
}

inline std::vector<std::vector<int>> polygonsOf(const fbxsdk::FbxMesh& mesh) {
    std::vector<std::vector<int>> polygons;
    for (int p = 0; p < mesh.GetPolygonCount(); ++p) {
        std::vector<int>& corners = polygons.emplace_back();
        for (int k = 0; k < mesh.GetPolygonSize(p); ++k)
            corners.push_back(mesh.GetPolygonVertex(p, k));
    }
    return polygons;
}

inline void addPolygon(fbxsdk::FbxMesh& mesh, std::initializer_list<int> corners) {
    mesh.BeginPolygon();
    for (const int corner : corners)
        mesh.AddPolygon(corner);
    mesh.EndPolygon();
}

namespace fbxsdk {
inline namespace tarnell {
inline void PrintTo(const FbxVector4& v, std::ostream* out) {
    *out << '(' << v[0] << ", " << v[1] << ", " << v[2] << ", " << v[3] << ')';
}
inline void PrintTo(const FbxVector2& v, std::ostream* out) { *out << '(' << v[0] << ", " << v[1] << ')'; }
} // namespace tarnell
} // namespace fbxsdk
