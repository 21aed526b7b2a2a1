// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights as the facade returns them by default.
#include "LibraryObjects.h"

#include <array>

namespace conformance {
namespace {

using namespace Tarnell::Fbx;
using fbxsdk::FbxNodeAttribute;

constexpr std::array kLightTypes = {FbxNodeAttribute::eLight};
constexpr double kDirectional = 1, kSpot = 2; ///< as stored

constexpr NumberRow kLightKinds[] = {{1, TnFbxLight::kFbxLightDirectional}, {2, TnFbxLight::kFbxLightSpot}};
constexpr NumberRow kDecays[] = {{1, TnFbxLight::kFbxLightDecayLinear},
                                 {2, TnFbxLight::kFbxLightDecayQuadratic},
                                 {3, TnFbxLight::kFbxLightDecayCubic}};

void compareLight(const ReferenceNode& node, const TnFbxLight& light, Findings& findings) {
    const std::optional<double> percent = stated(node.light, "Intensity");
    compareNumber(node, "red", light.getValue(TnFbxLight::kFbxLightRed), stated(node.light, "Color", 0), findings);
    compareNumber(node, "green", light.getValue(TnFbxLight::kFbxLightGreen), stated(node.light, "Color", 1), findings);
    compareNumber(node, "blue", light.getValue(TnFbxLight::kFbxLightBlue), stated(node.light, "Color", 2), findings);
    compareNumber(node, "alpha", light.getValue(TnFbxLight::kFbxLightAlpha), 1.0, findings);
    compareNumber(node, "intensity", light.getValue(TnFbxLight::kFbxLightIntensity),
                  percent ? std::optional(*percent * 0.01) : percent, findings);
    compareNumber(node, "cone angle", light.getValue(TnFbxLight::kFbxLightConeAngle), stated(node.light, "OuterAngle"),
                  findings);
    compareEnum(node, "type", light.getLightType(), stated(node.light, "LightType"), kLightKinds,
                TnFbxLight::kFbxLightPoint, findings);
    compareEnum(node, "decay", light.getDecayType(), stated(node.light, "DecayType"), kDecays,
                TnFbxLight::kFbxLightDecayNone, findings);
}

/// Kept: lights that shine along an axis are rotated between the node and its geometric transform.
Matrix12 turnOf(const ReferenceNode& node) {
    const std::optional<double> type = stated(node.light, "LightType");
    return turned(type == kDirectional || type == kSpot ? Point{-90, 0, 0} : Point{});
}

} // namespace

void checkLibraryLights(LoadedFile& file, Findings& findings) {
    if (!file.loaded() || !hasKind(file.reference(), "light"))
        return;
    TnFbxReadInfo info;
    const auto list = read<TnFbxLight>(file, info, &Fbx::getLights, findings);
    for (const Handed<TnFbxLight>& handed : matched(file, list.span(), kLightTypes, findings)) {
        const ReferenceNode& node = file.reference().nodes[handed.nodeIndex];
        compareLight(node, *handed.object, findings);
        compareInWorld(file.reference(), node, *handed.object, turnOf(node), findings);
    }
}

} // namespace conformance
