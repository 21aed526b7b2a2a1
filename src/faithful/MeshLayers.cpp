// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "MeshLayers.h"

#include "Sampling.h"

#include <cstddef>

namespace Tarnell::Fbx::faithful {

namespace {

using Element = fbxsdk::FbxLayerElement;
using detail::Colour;

/// The first element that has values for corners; `elementOf(layer)` is null where a layer has none.
template <class Value, class ElementOf>
MappedValues<Value> firstMapped(fbxsdk::FbxMesh& mesh, const ElementOf& elementOf) {
    for (int i = 0; i < mesh.GetLayerCount(); ++i) {
        const auto* element = elementOf(*mesh.GetLayer(i));
        if (element == nullptr)
            continue;
        MappedValues<Value> values(*element);
        if (values.found())
            return values;
    }
    return {};
}

/// The transmitted fraction of light: the factor times the mean of the transmitted colour.
double transparencyOf(const fbxsdk::FbxSurfaceLambert& material) {
    const fbxsdk::FbxDouble3 colour = material.TransparentColor.Get();
    return material.TransparencyFactor.Get() * (colour[0] + colour[1] + colour[2]) / 3.0;
}

std::optional<Colour> colourOf(const fbxsdk::FbxSurfaceMaterial& material) {
    if (material.GetClassId().Is(fbxsdk::FbxSurfaceLambert::ClassId)) {
        const auto& lambert = static_cast<const fbxsdk::FbxSurfaceLambert&>(material);
        const fbxsdk::FbxDouble3 diffuse = lambert.Diffuse.Get();
        return Colour{toFloat(diffuse[0]), toFloat(diffuse[1]), toFloat(diffuse[2]),
                      toFloat(1.0 - transparencyOf(lambert))};
    }
    const fbxsdk::FbxProperty property = material.FindProperty("DiffuseColor");
    if (!property.IsValid())
        return std::nullopt;
    const auto diffuse = property.Get<fbxsdk::FbxDouble3>();
    return Colour{toFloat(diffuse[0]), toFloat(diffuse[1]), toFloat(diffuse[2]), 1.0f};
}

std::vector<std::optional<Colour>> materialsOf(const fbxsdk::FbxNode& node) {
    std::vector<std::optional<Colour>> colours;
    for (int i = 0; i < node.GetMaterialCount(); ++i) {
        const fbxsdk::FbxSurfaceMaterial* material = node.GetMaterial(i);
        colours.push_back(material != nullptr ? colourOf(*material) : std::nullopt);
    }
    return colours;
}

} // namespace

MappedValues<fbxsdk::FbxVector4> meshNormals(fbxsdk::FbxMesh& mesh) {
    return firstMapped<fbxsdk::FbxVector4>(
        mesh, [](fbxsdk::FbxLayer& layer) { return layer.GetNormals(); });
}

MappedValues<fbxsdk::FbxVector2> meshUVs(fbxsdk::FbxMesh& mesh) {
    auto diffuse = firstMapped<fbxsdk::FbxVector2>(
        mesh, [](fbxsdk::FbxLayer& layer) { return layer.GetUVs(Element::eTextureDiffuse); });
    for (int channel = Element::eTextureDiffuse + 1; channel < Element::eTypeCount && !diffuse.found(); ++channel) {
        diffuse = firstMapped<fbxsdk::FbxVector2>(
            mesh, [channel](fbxsdk::FbxLayer& layer) { return layer.GetUVs(static_cast<Element::EType>(channel)); });
    }
    return diffuse;
}

MeshColours::MeshColours(fbxsdk::FbxMesh& mesh, const fbxsdk::FbxNode& node)
    : mVertexColours(
          firstMapped<fbxsdk::FbxColor>(mesh, [](fbxsdk::FbxLayer& layer) { return layer.GetVertexColors(); })) {
    if (mVertexColours.found())
        return;
    mMaterials = materialsOf(node);
    for (int i = 0; i < mesh.GetLayerCount() && mMapping == Element::eNone; ++i) {
        const fbxsdk::FbxLayerElementMaterial* element = mesh.GetLayer(i)->GetMaterials();
        if (element == nullptr || element->GetMappingMode() == Element::eByEdge)
            continue;
        mMapping = element->GetMappingMode();
        mOneMaterial = true;
        if (element->GetReferenceMode() != Element::eDirect)
            mMaterialIndex = &element->GetIndexArray();
    }
    if (mMapping == Element::eNone && !mMaterials.empty()) { // the material is not specified: it is the first one
        mMapping = Element::eAllSame;
        mOneMaterial = true;
    }
}

std::optional<Colour> MeshColours::at(const detail::Corner& corner) const {
    if (const std::optional<fbxsdk::FbxColor> colour = mVertexColours.at(corner))
        return Colour{toFloat(colour->mRed), toFloat(colour->mGreen), toFloat(colour->mBlue), toFloat(colour->mAlpha)};
    switch (mMapping) {
    case Element::eByControlPoint:
        return materialAt(corner.controlPoint);
    case Element::eByPolygonVertex:
        return materialAt(corner.polygonVertex);
    case Element::eByPolygon:
        return materialAt(corner.polygon);
    case Element::eAllSame:
        return materialAt(0);
    default:
        return std::nullopt;
    }
}

std::optional<Colour> MeshColours::materialAt(int position) const {
    int number = position;
    if (mMaterialIndex != nullptr && (mMapping != Element::eAllSame || mMaterialIndex->GetCount() > 0)) {
        if (position < 0 || position >= mMaterialIndex->GetCount())
            return std::nullopt;
        number = mMaterialIndex->GetAt(position);
    }
    return number >= 0 && static_cast<std::size_t>(number) < mMaterials.size()
               ? mMaterials[static_cast<std::size_t>(number)]
               : std::nullopt;
}

} // namespace Tarnell::Fbx::faithful
