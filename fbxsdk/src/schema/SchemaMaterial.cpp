// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of materials, textures and clips. Order, types and defaults are those of files.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constinit const PropertyRow kMaterialTable[] = {
    {"ShadingModel", &FbxStringDT, "", {}, "Unknown"},
    {"MultiLayer", &FbxBoolDT, ""},
};

constinit const PropertyRow kLambertTable[] = {
    {"ShadingModel", &FbxStringDT, "", {}, "Lambert"},
    {"MultiLayer", &FbxBoolDT, ""},
    {"EmissiveColor", &FbxAnimatedColorDT, "A"},
    {"EmissiveFactor", &FbxNumberDT, "A", {1}},
    {"AmbientColor", &FbxAnimatedColorDT, "A", {0.2, 0.2, 0.2}},
    {"AmbientFactor", &FbxNumberDT, "A", {1}},
    {"DiffuseColor", &FbxAnimatedColorDT, "A", {0.8, 0.8, 0.8}},
    {"DiffuseFactor", &FbxNumberDT, "A", {1}},
    {"Bump", &FbxDouble3DT, ""},
    {"NormalMap", &FbxDouble3DT, ""},
    {"BumpFactor", &FbxDoubleDT, "", {1}},
    {"TransparentColor", &FbxAnimatedColorDT, "A"},
    {"TransparencyFactor", &FbxNumberDT, "A"},
    {"DisplacementColor", &FbxColor3DT, ""},
    {"DisplacementFactor", &FbxDoubleDT, "", {1}},
    {"VectorDisplacementColor", &FbxColor3DT, ""},
    {"VectorDisplacementFactor", &FbxDoubleDT, "", {1}},
};

constinit const PropertyRow kPhongTable[] = {
    {"ShadingModel", &FbxStringDT, "", {}, "Phong"},
    {"MultiLayer", &FbxBoolDT, ""},
    {"EmissiveColor", &FbxAnimatedColorDT, "A"},
    {"EmissiveFactor", &FbxNumberDT, "A", {1}},
    {"AmbientColor", &FbxAnimatedColorDT, "A", {0.2, 0.2, 0.2}},
    {"AmbientFactor", &FbxNumberDT, "A", {1}},
    {"DiffuseColor", &FbxAnimatedColorDT, "A", {0.8, 0.8, 0.8}},
    {"DiffuseFactor", &FbxNumberDT, "A", {1}},
    {"Bump", &FbxDouble3DT, ""},
    {"NormalMap", &FbxDouble3DT, ""},
    {"BumpFactor", &FbxDoubleDT, "", {1}},
    {"TransparentColor", &FbxAnimatedColorDT, "A"},
    {"TransparencyFactor", &FbxNumberDT, "A"},
    {"DisplacementColor", &FbxColor3DT, ""},
    {"DisplacementFactor", &FbxDoubleDT, "", {1}},
    {"VectorDisplacementColor", &FbxColor3DT, ""},
    {"VectorDisplacementFactor", &FbxDoubleDT, "", {1}},
    {"SpecularColor", &FbxAnimatedColorDT, "A", {0.2, 0.2, 0.2}},
    {"SpecularFactor", &FbxNumberDT, "A", {1}},
    {"ShininessExponent", &FbxNumberDT, "A", {20}},
    {"ReflectionColor", &FbxAnimatedColorDT, "A"},
    {"ReflectionFactor", &FbxNumberDT, "A", {1}},
};

constinit const PropertyRow kFileTextureTable[] = {
    {"TextureTypeUse", &FbxEnumDT, ""},
    {"Texture alpha", &FbxNumberDT, "A", {1}},
    {"CurrentMappingType", &FbxEnumDT, ""},
    {"WrapModeU", &FbxEnumDT, ""},
    {"WrapModeV", &FbxEnumDT, ""},
    {"UVSwap", &FbxBoolDT, ""},
    {"PremultiplyAlpha", &FbxBoolDT, "", {1}},
    {"Translation", &FbxVectorDT, "A"},
    {"Rotation", &FbxVectorDT, "A"},
    {"Scaling", &FbxVectorDT, "A", {1, 1, 1}},
    {"TextureRotationPivot", &FbxDouble3DT, ""},
    {"TextureScalingPivot", &FbxDouble3DT, ""},
    {"CurrentTextureBlendMode", &FbxEnumDT, "", {1}},
    {"UVSet", &FbxStringDT, "", {}, "default"},
    {"UseMaterial", &FbxBoolDT, ""},
    {"UseMipMap", &FbxBoolDT, ""},
};

constinit const PropertyRow kLayeredTextureTable[] = {
    {"TextureTypeUse", &FbxEnumDT, ""},
    {"Texture alpha", &FbxNumberDT, "A", {1}},
    {"CurrentMappingType", &FbxEnumDT, ""},
    {"WrapModeU", &FbxEnumDT, ""},
    {"WrapModeV", &FbxEnumDT, ""},
    {"UVSwap", &FbxBoolDT, ""},
    {"PremultiplyAlpha", &FbxBoolDT, "", {1}},
    {"Translation", &FbxVectorDT, "A"},
    {"Rotation", &FbxVectorDT, "A"},
    {"Scaling", &FbxVectorDT, "A", {1, 1, 1}},
    {"TextureRotationPivot", &FbxDouble3DT, ""},
    {"TextureScalingPivot", &FbxDouble3DT, ""},
    {"CurrentTextureBlendMode", &FbxEnumDT, "", {1}},
    {"UVSet", &FbxStringDT, "", {}, "default"},
};

constinit const PropertyRow kVideoTable[] = {
    {"Path", &FbxXRefUrlDT, ""},
    {"RelPath", &FbxXRefUrlDT, ""},
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"ClipIn", &FbxTimeDT, ""},
    {"ClipOut", &FbxTimeDT, ""},
    {"Offset", &FbxTimeDT, ""},
    {"PlaySpeed", &FbxDoubleDT, ""},
    {"FreeRunning", &FbxBoolDT, ""},
    {"Loop", &FbxBoolDT, ""},
    {"Mute", &FbxBoolDT, ""},
    {"AccessMode", &FbxEnumDT, ""},
    {"ImageSequence", &FbxBoolDT, ""},
    {"ImageSequenceOffset", &FbxIntDT, ""},
    {"FrameRate", &FbxDoubleDT, ""},
    {"LastFrame", &FbxIntDT, ""},
    {"Width", &FbxIntDT, ""},
    {"Height", &FbxIntDT, ""},
    {"StartFrame", &FbxIntDT, ""},
    {"StopFrame", &FbxIntDT, ""},
    {"InterlaceMode", &FbxEnumDT, ""},
};

} // namespace detail
FBXSDK_NAMESPACE_END
