// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Normalisation.h"

#include "calls/LastError.h"

#include <string>

namespace Tarnell::Fbx {

namespace {

fbxsdk::FbxAxisSystem targetAxisSystem() {
    using System = fbxsdk::FbxAxisSystem;
    return System(System::eYAxis, System::eParityOdd, System::eRightHanded);
}

/// Only the bundled platform reports it.
template <class Converter>
int coarserSurfaces(const Converter& converter) {
    if constexpr (requires { converter.coarserSurfaces(); })
        return converter.coarserSurfaces();
    else
        return 0;
}

} // namespace

void detail::convertToCentimetres(fbxsdk::FbxScene& scene) {
    const double difference = scene.GetGlobalSettings().GetSystemUnit().GetScaleFactor() - 1.0;
    if (difference < 0.0 || difference > 0.0) { // a unit that is not a number is left unchanged
        const fbxsdk::FbxSystemUnit centimetre(/*pScaleFactor*/ 1.0, /*pMultiplier*/ 1.0);
        centimetre.ConvertScene(&scene, fbxsdk::FbxSystemUnit::DefaultConversionOptions);
    }
}

void detail::convertToYUp(fbxsdk::FbxScene& scene) {
    const fbxsdk::FbxAxisSystem target = targetAxisSystem();
    if (scene.GetGlobalSettings().GetAxisSystem() != target)
        target.ConvertScene(&scene);
}

bool detail::Triangulation::visit(fbxsdk::FbxNode& node) {
    fbxsdk::FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (attribute == nullptr)
        return true;
    const auto type = attribute->GetAttributeType();
    return (type != fbxsdk::FbxNodeAttribute::eNurbs && type != fbxsdk::FbxNodeAttribute::ePatch) ||
           mConverter.Triangulate(attribute, /*pReplace*/ true, /*pLegacy*/ false) != nullptr;
}

void detail::Triangulation::warnOfCoarser() const {
    if (const int count = coarserSurfaces(mConverter); count > 0) {
        warn(std::to_string(count) + (count == 1 ? " surface was" : " surfaces were") +
             " tessellated more coarsely than requested: too few control points for the number of samples");
    }
}

} // namespace Tarnell::Fbx
