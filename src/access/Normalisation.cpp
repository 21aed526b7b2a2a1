// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Normalisation.h"

namespace Tarnell::Fbx {

namespace {

fbxsdk::FbxAxisSystem targetAxisSystem() {
    using System = fbxsdk::FbxAxisSystem;
    return System(System::eYAxis, System::eParityOdd, System::eRightHanded);
}

} // namespace

void detail::convertToCentimetres(fbxsdk::FbxScene& scene) {
    const double difference = scene.GetGlobalSettings().GetSystemUnit().GetScaleFactor() - 1.0;
    if (difference < 0.0 || difference > 0.0) { // a unit that is no number is left alone
        const fbxsdk::FbxSystemUnit centimetre(/*pScaleFactor*/ 1.0, /*pMultiplier*/ 1.0);
        centimetre.ConvertScene(&scene, fbxsdk::FbxSystemUnit::DefaultConversionOptions);
    }
}

void detail::convertToYUp(fbxsdk::FbxScene& scene) {
    const fbxsdk::FbxAxisSystem target = targetAxisSystem();
    if (scene.GetGlobalSettings().GetAxisSystem() != target) {
        target.ConvertScene(&scene);
    }
}

void detail::triangulate(fbxsdk::FbxManager* manager, fbxsdk::FbxNode& node) {
    fbxsdk::FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (attribute == nullptr) {
        return;
    }
    const auto type = attribute->GetAttributeType();
    if (type == fbxsdk::FbxNodeAttribute::eNurbs || type == fbxsdk::FbxNodeAttribute::ePatch) {
        fbxsdk::FbxGeometryConverter converter(manager);
        converter.Triangulate(attribute, /*pReplace*/ true, /*pLegacy*/ false);
    }
}

} // namespace Tarnell::Fbx
