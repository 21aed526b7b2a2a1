// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The values of a mesh's layers at each corner of its polygons. Each class looks everything up once, on construction,
// and then returns values corner by corner without allocating.
#pragma once

#include "access/LayerValues.h"

#include <fbxsdk.h>

#include <optional>
#include <vector>

namespace Tarnell::Fbx::detail {

/// The values of an element that is mapped by control point or by polygon vertex; none of any other.
template <class Value>
class CornerValues {
public:
    CornerValues() = default;
    CornerValues(fbxsdk::FbxLayerElement::EMappingMode mapping, const ElementValues<Value>& values)
        : mByControlPoint(mapping == fbxsdk::FbxLayerElement::eByControlPoint), mValues(values) {}

    /// Whether the first `count` corners have consecutive values.
    bool areInOrder(int count) const { return !mByControlPoint && mValues.areInOrder(count); }
    /// Calls `use(i, value)` for those of consecutive corners, i from 0 on.
    template <class Use>
    void forEach(int first, int count, const Use& use) const {
        mValues.forEach(first, count, use);
    }

    /// Whether the first `count` corners have consecutive indices of values.
    bool areIndexed(int count) const { return !mByControlPoint && mValues.areIndexed(count); }
    /// Calls `use(i, value)` for the values of consecutive corners, i from 0 on; with null where there is none.
    template <class Use>
    void forEachIndexed(int first, int count, const Use& use) const {
        mValues.forEachIndexed(first, count, use);
    }

    /// False when the corner has none; the value is unchanged then.
    bool read(const Corner& corner, Value& value) const {
        return mValues.read(mByControlPoint ? corner.controlPoint : corner.polygonVertex, value);
    }

private:
    bool mByControlPoint = false;
    ElementValues<Value> mValues;
};

/// The normals of a layer. kept: mappings by polygon and all-same are not read.
CornerValues<fbxsdk::FbxVector4> layerNormals(fbxsdk::FbxLayer& layer);

/// The diffuse texture coordinates of a layer.
CornerValues<fbxsdk::FbxVector2> layerUVs(fbxsdk::FbxLayer& layer);

/// The materials of the mesh's node, as colours: none for a missing one, `otherwise` for a material that
/// has no diffuse colour.
std::vector<std::optional<Colour>> materialColours(const fbxsdk::FbxMesh& mesh, const Colour& otherwise);

/// The colours of a layer: its vertex colours or, when it has no such element, those of the materials.
class LayerColours {
public:
    LayerColours(fbxsdk::FbxLayer& layer, const std::vector<std::optional<Colour>>& materials);
    /// Whether any corner can have one.
    bool hasAny() const;
    std::optional<Colour> at(const Corner& corner) const;

private:
    std::optional<Colour> materialAt(int position) const;

    fbxsdk::FbxLayerElement::EMappingMode mMapping = fbxsdk::FbxLayerElement::eNone;
    const std::vector<std::optional<Colour>>& mMaterials;
    bool mFromMaterials;
    ElementValues<fbxsdk::FbxColor> mVertexColours;
    fbxsdk::FbxLayerElement::EReferenceMode mMaterialReference = fbxsdk::FbxLayerElement::eDirect;
    const fbxsdk::FbxLayerElementArrayTemplate<int>* mMaterialIndex = nullptr;
};

} // namespace Tarnell::Fbx::detail
