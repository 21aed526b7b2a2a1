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
    int vertex;        // in the polygon
    int polygonVertex; // in the mesh
    int controlPoint;  // −1 or any number in a damaged file
};

struct Colour {
    float red, green, blue, alpha;
};

/// The values of a layer element by index, as its reference mode has it.
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

    /// The direct array alone, whatever the index array says.
    std::optional<Value> directAt(int position) const {
        if (mDirect == nullptr || position < 0 || position >= mDirect->GetCount()) {
            return std::nullopt;
        }
        return mDirect->GetAt(position);
    }

private:
    const fbxsdk::FbxLayerElementArrayTemplate<Value>* mDirect = nullptr;
    const fbxsdk::FbxLayerElementArrayTemplate<int>* mIndex = nullptr;
};

/// The normals of a layer. kept: mappings by polygon and all-same are not read.
class LayerNormals {
public:
    LayerNormals(fbxsdk::FbxMesh& mesh, fbxsdk::FbxLayer& layer);
    std::optional<fbxsdk::FbxVector4> at(const Corner& corner) const;

private:
    fbxsdk::FbxMesh& mMesh;
    fbxsdk::FbxLayerElement::EMappingMode mMapping = fbxsdk::FbxLayerElement::eNone;
    ElementValues<fbxsdk::FbxVector4> mByControlPoint;
};

/// The diffuse texture coordinates of a layer.
class LayerUVs {
public:
    LayerUVs(fbxsdk::FbxMesh& mesh, fbxsdk::FbxLayer& layer);
    std::optional<fbxsdk::FbxVector2> at(const Corner& corner) const;

private:
    fbxsdk::FbxMesh& mMesh;
    fbxsdk::FbxLayerElement::EMappingMode mMapping = fbxsdk::FbxLayerElement::eNone;
    ElementValues<fbxsdk::FbxVector2> mValues;
};

/// The materials of the node a mesh stands on, as colours: nothing for a missing one, `otherwise` for a material that
/// has no diffuse colour.
std::vector<std::optional<Colour>> materialColours(const fbxsdk::FbxMesh& mesh, const Colour& otherwise);

/// The colours of a layer: its vertex colours or, when it has no such element, those of the materials.
class LayerColours {
public:
    LayerColours(fbxsdk::FbxLayer& layer, const std::vector<std::optional<Colour>>& materials);
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
