// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a mesh's layers say about each corner of its polygons. Each class looks everything up once, when it is made, and
// then answers corner by corner without allocating.
#pragma once

#include <fbxsdk.h>

#include <optional>
#include <vector>

namespace Tarnell::Fbx::detail {

/// One vertex of one polygon.
struct Corner {
    int polygon;
    int polygonVertex; // in the mesh
    int controlPoint;  // −1 or any number in a damaged file
};

struct Colour {
    float red, green, blue, alpha;
};

/// The values of a layer element by index, as its reference mode has it. They are asked for one by one: values that
/// still stand in a file need not be in memory all at once for that.
template <class Value>
class ElementValues {
public:
    /// Nothing is found.
    ElementValues() = default;

    /// Throws std::runtime_error when the element has no direct array.
    explicit ElementValues(const fbxsdk::FbxLayerElementTemplate<Value>& element) {
        switch (element.GetReferenceMode()) {
        case fbxsdk::FbxLayerElement::eDirect:
            mDirect = &element.GetDirectArray();
            break;
        case fbxsdk::FbxLayerElement::eIndexToDirect:
            mDirect = &element.GetDirectArray();
            mIndex = &element.GetIndexArray();
            break;
        default: // an index alone leads nowhere
            break;
        }
    }

    /// Values that are numbered all the same where the element has indices only.
    static ElementValues numbered(const fbxsdk::FbxLayerElementTemplate<Value>& element) {
        ElementValues values;
        values.mDirect = &element.GetDirectArray();
        if (element.GetReferenceMode() != fbxsdk::FbxLayerElement::eDirect) {
            values.mIndex = &element.GetIndexArray();
        }
        return values;
    }

    std::optional<Value> at(int position) const {
        if (mIndex != nullptr) {
            if (position < 0 || position >= mIndex->GetCount()) {
                return std::nullopt;
            }
            position = mIndex->GetAt(position);
        }
        if (mDirect == nullptr || position < 0 || position >= mDirect->GetCount()) {
            return std::nullopt;
        }
        return mDirect->GetAt(position);
    }

private:
    const fbxsdk::FbxLayerElementArrayTemplate<Value>* mDirect = nullptr;
    const fbxsdk::FbxLayerElementArrayTemplate<int>* mIndex = nullptr;
};

/// The values of an element that is mapped by control point or by polygon vertex; nothing of any other.
template <class Value>
class CornerValues {
public:
    CornerValues() = default;
    CornerValues(fbxsdk::FbxLayerElement::EMappingMode mapping, const ElementValues<Value>& values)
        : mByControlPoint(mapping == fbxsdk::FbxLayerElement::eByControlPoint), mValues(values) {}

    std::optional<Value> at(const Corner& corner) const {
        return mValues.at(mByControlPoint ? corner.controlPoint : corner.polygonVertex);
    }

private:
    bool mByControlPoint = false;
    ElementValues<Value> mValues;
};

/// The normals of a layer. kept: mappings by polygon and all-same are not read.
CornerValues<fbxsdk::FbxVector4> layerNormals(fbxsdk::FbxLayer& layer);

/// The diffuse texture coordinates of a layer.
CornerValues<fbxsdk::FbxVector2> layerUVs(fbxsdk::FbxLayer& layer);

/// The materials of the node a mesh stands on, as colours: nothing for a missing one, `otherwise` for a material that
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
