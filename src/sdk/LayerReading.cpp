// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Normals, texture coordinates and colours of polygon corners, by the mapping and reference modes of their elements.
#include "LayerReading.h"

#include "PropertySampling.h"

namespace Tarnell::Fbx::detail {

using Element = fbxsdk::FbxLayerElement;

// ---- Normals and texture coordinates ----

CornerValues<fbxsdk::FbxVector4> layerNormals(fbxsdk::FbxLayer& layer) {
    const fbxsdk::FbxLayerElementNormal* element = layer.GetNormals();
    const Element::EMappingMode mapping = element != nullptr ? element->GetMappingMode() : Element::eNone;
    if (mapping == Element::eByControlPoint)
        return {mapping, ElementValues<fbxsdk::FbxVector4>(*element)};
    if (mapping == Element::eByPolygonVertex) // kept: here an index alone refers to a normal
        return {mapping, ElementValues<fbxsdk::FbxVector4>::numbered(*element)};
    return {};
}

CornerValues<fbxsdk::FbxVector2> layerUVs(fbxsdk::FbxLayer& layer) {
    const fbxsdk::FbxLayerElementUV* element = layer.GetUVs(Element::eTextureDiffuse);
    const Element::EMappingMode mapping = element != nullptr ? element->GetMappingMode() : Element::eNone;
    if (mapping == Element::eByControlPoint || mapping == Element::eByPolygonVertex)
        return {mapping, ElementValues<fbxsdk::FbxVector2>(*element)};
    return {};
}

// ---- Colours ----

namespace {

Colour colourOf(const fbxsdk::FbxSurfaceLambert& material) {
    const fbxsdk::FbxDouble3 diffuse = material.Diffuse.Get();
    return {toFloat(diffuse[0]), toFloat(diffuse[1]), toFloat(diffuse[2]),
            toFloat(1.0 - material.TransparencyFactor.Get())};
}

} // namespace

std::vector<std::optional<Colour>> materialColours(const fbxsdk::FbxMesh& mesh, const Colour& otherwise) {
    std::vector<std::optional<Colour>> colours;
    const fbxsdk::FbxNode* node = mesh.GetNode();
    const int count = node != nullptr ? node->GetMaterialCount() : 0;
    for (int i = 0; i < count; ++i) {
        const fbxsdk::FbxSurfaceMaterial* material = node->GetMaterial(i);
        if (material == nullptr)
            colours.emplace_back();
        else if (material->GetClassId().Is(fbxsdk::FbxSurfaceLambert::ClassId))
            colours.emplace_back(colourOf(*static_cast<const fbxsdk::FbxSurfaceLambert*>(material)));
        else
            colours.emplace_back(otherwise);
    }
    return colours;
}

LayerColours::LayerColours(fbxsdk::FbxLayer& layer, const std::vector<std::optional<Colour>>& materials)
    : mMaterials(materials), mFromMaterials(layer.GetVertexColors() == nullptr) {
    if (const fbxsdk::FbxLayerElementVertexColor* element = layer.GetVertexColors()) {
        mMapping = element->GetMappingMode();
        if (mMapping == Element::eByControlPoint || mMapping == Element::eByPolygonVertex)
            mVertexColours = ElementValues<fbxsdk::FbxColor>(*element);
    } else if (const fbxsdk::FbxLayerElementMaterial* material = layer.GetMaterials()) {
        mMapping = material->GetMappingMode();
        mMaterialReference = material->GetReferenceMode();
        const bool read = mMapping == Element::eByPolygon || mMapping == Element::eByPolygonVertex ||
                          mMapping == Element::eByControlPoint;
        if (read && mMaterialReference == Element::eIndexToDirect)
            mMaterialIndex = &material->GetIndexArray();
    }
}

bool LayerColours::hasAny() const {
    return mMapping == Element::eByControlPoint || mMapping == Element::eByPolygonVertex ||
           (mFromMaterials && mMapping == Element::eByPolygon);
}

std::optional<Colour> LayerColours::at(const Corner& corner) const {
    if (mFromMaterials && mMapping == Element::eByPolygon)
        return materialAt(corner.polygon);
    if (mMapping != Element::eByControlPoint && mMapping != Element::eByPolygonVertex)
        return std::nullopt; // kept: one material for the whole mesh gives no colour
    const int position = mMapping == Element::eByControlPoint ? corner.controlPoint : corner.polygonVertex;
    if (mFromMaterials)
        return materialAt(position);
    const std::optional<fbxsdk::FbxColor> colour = mVertexColours.at(position);
    return colour ? std::optional<Colour>({toFloat(colour->mRed), toFloat(colour->mGreen), toFloat(colour->mBlue),
                                           toFloat(colour->mAlpha)})
                  : std::nullopt;
}

std::optional<Colour> LayerColours::materialAt(int position) const {
    int number = position;
    if (mMaterialReference == Element::eIndexToDirect) {
        if (position < 0 || position >= mMaterialIndex->GetCount())
            return std::nullopt;
        number = mMaterialIndex->GetAt(position);
    } else if (mMaterialReference != Element::eDirect) {
        return std::nullopt;
    }
    return number >= 0 && static_cast<std::size_t>(number) < mMaterials.size()
               ? mMaterials[static_cast<std::size_t>(number)]
               : std::nullopt;
}

} // namespace Tarnell::Fbx::detail
