// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The values of a mesh's layers at each corner of its polygons: of every kind of element the first one with
// values, in every mapping and reference.
#pragma once

#include "access/LayerValues.h"

#include <fbxsdk.h>

#include <optional>
#include <vector>

namespace Tarnell::Fbx::faithful {

/// The values of one element. They are read one by one, so that values in a file need not be in memory
/// all at once.
template <class Value>
class MappedValues {
public:
    /// No values.
    MappedValues() = default;

    /// Throws std::runtime_error when the element has no direct array.
    explicit MappedValues(const fbxsdk::FbxLayerElementTemplate<Value>& element)
        : mMapping(element.GetMappingMode()), mValues(detail::ElementValues<Value>::numbered(element)) {}

    std::optional<Value> at(const detail::Corner& corner) const {
        switch (mMapping) {
        case fbxsdk::FbxLayerElement::eByControlPoint:
            return mValues.at(corner.controlPoint);
        case fbxsdk::FbxLayerElement::eByPolygonVertex:
            return mValues.at(corner.polygonVertex);
        case fbxsdk::FbxLayerElement::eByPolygon:
            return mValues.at(corner.polygon);
        case fbxsdk::FbxLayerElement::eAllSame:
            return mValues.at(0);
        default: // edges have two polygons, and it is not defined which of their values a corner has
            return std::nullopt;
        }
    }

    bool found() const {
        return mMapping != fbxsdk::FbxLayerElement::eNone && mMapping != fbxsdk::FbxLayerElement::eByEdge;
    }

private:
    fbxsdk::FbxLayerElement::EMappingMode mMapping = fbxsdk::FbxLayerElement::eNone;
    detail::ElementValues<Value> mValues;
};

MappedValues<fbxsdk::FbxVector4> meshNormals(fbxsdk::FbxMesh& mesh);
MappedValues<fbxsdk::FbxVector2> meshUVs(fbxsdk::FbxMesh& mesh);

/// The vertex colours or, without any, those of the materials of the mesh's node.
class MeshColours {
public:
    MeshColours(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxNode& node);
    std::optional<detail::Colour> at(const detail::Corner& corner) const;
    bool found() const { return mVertexColours.found() || mMaterialIndex != nullptr || mOneMaterial; }

private:
    std::optional<detail::Colour> materialAt(int number) const;

    MappedValues<fbxsdk::FbxColor> mVertexColours;
    std::vector<std::optional<detail::Colour>> mMaterials;
    fbxsdk::FbxLayerElement::EMappingMode mMapping = fbxsdk::FbxLayerElement::eNone;
    const fbxsdk::FbxLayerElementArrayTemplate<int>* mMaterialIndex = nullptr;
    bool mOneMaterial = false; // for all of the mesh, or numbered as the polygons are
};

} // namespace Tarnell::Fbx::faithful
