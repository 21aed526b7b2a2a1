// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Nodes with a new camera, light, null or mesh, and the two objects for surfaces: textures and materials.
#include "FbxSdk.h"

#include "access/MeshBuilding.h"
#include "calls/LastError.h"

namespace Tarnell::Fbx {

using detail::fail;
using detail::succeed;

namespace {

/// Notes why nothing is created; always null.
std::nullptr_t none(const char* reason) {
    fail(reason);
    return nullptr;
}

/// A node in the container, a scene or a manager, with the attribute. Null when either could not be created.
template <class Container>
fbxsdk::FbxNode* nodeWith(fbxsdk::FbxNodeAttribute* attribute, Container* container, const std::string& name) {
    fbxsdk::FbxNode* node = attribute != nullptr ? fbxsdk::FbxNode::Create(container, name.c_str()) : nullptr;
    if (node == nullptr)
        return none("the node cannot be created");
    node->SetNodeAttribute(attribute);
    succeed();
    return node;
}

/// Null, or why no mesh can be created.
const char* faultOf(const TnFbxMesh& mesh) {
    if (mesh.getNumberOfControlPoints() < 1 || mesh.getNumberOfPolygons() < 1 || mesh.getNumberOfPolygonVertices() < 1)
        return "the mesh has no geometry";
    return detail::claimsTooManyCorners(mesh) ? "the polygons have more polygon vertices than the mesh" : nullptr;
}

} // namespace

fbxsdk::FbxNode* FbxSdk::createCamera(fbxsdk::FbxScene* scene, const std::string& name) {
    if (scene == nullptr)
        return none("no scene to create a camera in");
    fbxsdk::FbxCamera* camera = fbxsdk::FbxCamera::Create(scene, name.c_str());
    if (camera != nullptr) {
        camera->SetApertureMode(fbxsdk::FbxCamera::eVertical);
        camera->SetApertureWidth(0.816); // inches
        camera->SetApertureHeight(0.612);
        camera->SetSqueezeRatio(1.0);
    }
    return nodeWith(camera, scene, name);
}

fbxsdk::FbxNode* FbxSdk::createNull(fbxsdk::FbxManager* manager, const std::string& name) {
    if (manager == nullptr)
        return none("no FBX manager to create a null with");
    fbxsdk::FbxNull* null = fbxsdk::FbxNull::Create(manager, name.c_str());
    if (null != nullptr) {
        null->Look.Set(fbxsdk::FbxNull::sDefaultLook);
        null->Size.Set(fbxsdk::FbxNull::sDefaultSize);
    }
    return nodeWith(null, manager, name);
}

fbxsdk::FbxNode* FbxSdk::createLight(fbxsdk::FbxScene* scene, TnFbxLight::EFbxLightType type, const std::string& name) {
    if (scene == nullptr)
        return none("no scene to create a light in");
    fbxsdk::FbxLight* light = fbxsdk::FbxLight::Create(scene, name.c_str());
    if (light != nullptr) {
        switch (type) {
        case TnFbxLight::kFbxLightPoint:
            light->LightType.Set(fbxsdk::FbxLight::ePoint);
            break;
        case TnFbxLight::kFbxLightDirectional:
            light->LightType.Set(fbxsdk::FbxLight::eDirectional);
            break;
        case TnFbxLight::kFbxLightSpot:
            light->LightType.Set(fbxsdk::FbxLight::eSpot);
            break;
        default: // a number that is no type: the light keeps its type
            break;
        }
        light->CastLight.Set(true);
    }
    return nodeWith(light, scene, name);
}

fbxsdk::FbxNode* FbxSdk::createMesh(fbxsdk::FbxManager* manager, const TnFbxMesh* mesh, const std::string& name) {
    if (manager == nullptr || mesh == nullptr)
        return none("no FBX manager or no source to create a mesh from");
    if (const char* fault = faultOf(*mesh))
        return none(fault);
    fbxsdk::FbxMesh* target = fbxsdk::FbxMesh::Create(manager, name.c_str());
    if (target == nullptr)
        return none("the mesh cannot be created");
    if (!detail::buildMesh(*mesh, *target))
        return none("the layer of the mesh cannot be created");
    fbxsdk::FbxNode* node = nodeWith(target, manager, name);
    if (node != nullptr)
        node->SetShadingMode(fbxsdk::FbxNode::eTextureShading);
    return node;
}

fbxsdk::FbxFileTexture* FbxSdk::createTexture(fbxsdk::FbxScene* scene, const std::string& fileName) {
    if (scene == nullptr)
        return none("no scene to create a texture in");
    using Texture = fbxsdk::FbxFileTexture;
    Texture* texture = Texture::Create(scene, fileName.c_str()); // kept: the file name is the object's name too
    if (texture == nullptr)
        return none("the texture cannot be created");
    texture->SetFileName(fileName.c_str());
    texture->SetTextureUse(Texture::eStandard);
    texture->SetMappingType(Texture::eUV);
    texture->SetMaterialUse(Texture::eModelMaterial);
    texture->SetSwapUV(false);
    texture->SetTranslation(0.0, 0.0);
    texture->SetScale(1.0, 1.0);
    texture->SetRotation(0.0, 0.0, 0.0);
    succeed();
    return texture;
}

fbxsdk::FbxSurfaceLambert* FbxSdk::createLambertMaterial(fbxsdk::FbxManager* manager, const std::string& name,
                                                         int index) {
    if (manager == nullptr)
        return none("no FBX manager to create a material with");
    const std::string numbered = name + std::to_string(index);
    fbxsdk::FbxSurfaceLambert* material = fbxsdk::FbxSurfaceLambert::Create(manager, numbered.c_str());
    if (material == nullptr)
        return none("the material cannot be created");
    constexpr fbxsdk::FbxDouble3 kBlack(0.0, 0.0, 0.0);
    constexpr fbxsdk::FbxDouble3 kGrey(0.5, 0.5, 0.5);
    material->Emissive.Set(kBlack);
    material->EmissiveFactor.Set(1.0);
    material->Ambient.Set(kBlack);
    material->AmbientFactor.Set(1.0);
    material->Diffuse.Set(kGrey);
    material->DiffuseFactor.Set(0.8);
    material->TransparentColor.Set(kBlack);
    material->TransparencyFactor.Set(0.0);
    material->ShadingModel.Set("Lambert");
    succeed();
    return material;
}

} // namespace Tarnell::Fbx
