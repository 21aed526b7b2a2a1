// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The property templates of files, line by line as in ASCII files of version 7: name, type, second type,
// flags, values. The tables of the classes are compared with them.
#pragma once

#include <string_view>

namespace templates {

inline constexpr std::string_view kNode = R"(
"QuaternionInterpolate", "enum", "", "", 0
"RotationOffset", "Vector3D", "Vector", "", 0,0,0
"RotationPivot", "Vector3D", "Vector", "", 0,0,0
"ScalingOffset", "Vector3D", "Vector", "", 0,0,0
"ScalingPivot", "Vector3D", "Vector", "", 0,0,0
"TranslationActive", "bool", "", "", 0
"TranslationMin", "Vector3D", "Vector", "", 0,0,0
"TranslationMax", "Vector3D", "Vector", "", 0,0,0
"TranslationMinX", "bool", "", "", 0
"TranslationMinY", "bool", "", "", 0
"TranslationMinZ", "bool", "", "", 0
"TranslationMaxX", "bool", "", "", 0
"TranslationMaxY", "bool", "", "", 0
"TranslationMaxZ", "bool", "", "", 0
"RotationOrder", "enum", "", "", 0
"RotationSpaceForLimitOnly", "bool", "", "", 0
"RotationStiffnessX", "double", "Number", "", 0
"RotationStiffnessY", "double", "Number", "", 0
"RotationStiffnessZ", "double", "Number", "", 0
"AxisLen", "double", "Number", "", 10
"PreRotation", "Vector3D", "Vector", "", 0,0,0
"PostRotation", "Vector3D", "Vector", "", 0,0,0
"RotationActive", "bool", "", "", 0
"RotationMin", "Vector3D", "Vector", "", 0,0,0
"RotationMax", "Vector3D", "Vector", "", 0,0,0
"RotationMinX", "bool", "", "", 0
"RotationMinY", "bool", "", "", 0
"RotationMinZ", "bool", "", "", 0
"RotationMaxX", "bool", "", "", 0
"RotationMaxY", "bool", "", "", 0
"RotationMaxZ", "bool", "", "", 0
"InheritType", "enum", "", "", 0
"ScalingActive", "bool", "", "", 0
"ScalingMin", "Vector3D", "Vector", "", 0,0,0
"ScalingMax", "Vector3D", "Vector", "", 1,1,1
"ScalingMinX", "bool", "", "", 0
"ScalingMinY", "bool", "", "", 0
"ScalingMinZ", "bool", "", "", 0
"ScalingMaxX", "bool", "", "", 0
"ScalingMaxY", "bool", "", "", 0
"ScalingMaxZ", "bool", "", "", 0
"GeometricTranslation", "Vector3D", "Vector", "", 0,0,0
"GeometricRotation", "Vector3D", "Vector", "", 0,0,0
"GeometricScaling", "Vector3D", "Vector", "", 1,1,1
"MinDampRangeX", "double", "Number", "", 0
"MinDampRangeY", "double", "Number", "", 0
"MinDampRangeZ", "double", "Number", "", 0
"MaxDampRangeX", "double", "Number", "", 0
"MaxDampRangeY", "double", "Number", "", 0
"MaxDampRangeZ", "double", "Number", "", 0
"MinDampStrengthX", "double", "Number", "", 0
"MinDampStrengthY", "double", "Number", "", 0
"MinDampStrengthZ", "double", "Number", "", 0
"MaxDampStrengthX", "double", "Number", "", 0
"MaxDampStrengthY", "double", "Number", "", 0
"MaxDampStrengthZ", "double", "Number", "", 0
"PreferedAngleX", "double", "Number", "", 0
"PreferedAngleY", "double", "Number", "", 0
"PreferedAngleZ", "double", "Number", "", 0
"LookAtProperty", "object", "", ""
"UpVectorProperty", "object", "", ""
"Show", "bool", "", "", 1
"NegativePercentShapeSupport", "bool", "", "", 1
"DefaultAttributeIndex", "int", "Integer", "", -1
"Freeze", "bool", "", "", 0
"LODBox", "bool", "", "", 0
"Lcl Translation", "Lcl Translation", "", "A", 0,0,0
"Lcl Rotation", "Lcl Rotation", "", "A", 0,0,0
"Lcl Scaling", "Lcl Scaling", "", "A", 1,1,1
"Visibility", "Visibility", "", "A", 1
"Visibility Inheritance", "Visibility Inheritance", "", "", 1
)";

inline constexpr std::string_view kNodeAttribute = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
)";

inline constexpr std::string_view kCamera = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"Position", "Vector", "", "A", 0,0,0
"UpVector", "Vector", "", "A", 0,1,0
"InterestPosition", "Vector", "", "A", 0,0,0
"Roll", "Roll", "", "A", 0
"OpticalCenterX", "OpticalCenterX", "", "A", 0
"OpticalCenterY", "OpticalCenterY", "", "A", 0
"BackgroundColor", "Color", "", "A", 0.63,0.63,0.63
"TurnTable", "Number", "", "A", 0
"DisplayTurnTableIcon", "bool", "", "", 0
"UseMotionBlur", "bool", "", "", 0
"UseRealTimeMotionBlur", "bool", "", "", 1
"Motion Blur Intensity", "Number", "", "A", 1
"AspectRatioMode", "enum", "", "", 0
"AspectWidth", "double", "Number", "", 320
"AspectHeight", "double", "Number", "", 200
"PixelAspectRatio", "double", "Number", "", 1
"FilmOffsetX", "Number", "", "A", 0
"FilmOffsetY", "Number", "", "A", 0
"FilmWidth", "double", "Number", "", 0.816
"FilmHeight", "double", "Number", "", 0.612
"FilmAspectRatio", "double", "Number", "", 1.3333333333333333
"FilmSqueezeRatio", "double", "Number", "", 1
"FilmFormatIndex", "enum", "", "", 0
"PreScale", "Number", "", "A", 1
"FilmTranslateX", "Number", "", "A", 0
"FilmTranslateY", "Number", "", "A", 0
"FilmRollPivotX", "Number", "", "A", 0
"FilmRollPivotY", "Number", "", "A", 0
"FilmRollValue", "Number", "", "A", 0
"FilmRollOrder", "enum", "", "", 0
"ApertureMode", "enum", "", "", 2
"GateFit", "enum", "", "", 0
"FieldOfView", "FieldOfView", "", "A", 25.114999771118164
"FieldOfViewX", "FieldOfViewX", "", "A", 40
"FieldOfViewY", "FieldOfViewY", "", "A", 40
"FocalLength", "Number", "", "A", 34.89327621672628
"CameraFormat", "enum", "", "", 0
"UseFrameColor", "bool", "", "", 0
"FrameColor", "ColorRGB", "Color", "", 0.3,0.3,0.3
"ShowName", "bool", "", "", 1
"ShowInfoOnMoving", "bool", "", "", 1
"ShowGrid", "bool", "", "", 1
"ShowOpticalCenter", "bool", "", "", 0
"ShowAzimut", "bool", "", "", 1
"ShowTimeCode", "bool", "", "", 0
"ShowAudio", "bool", "", "", 0
"AudioColor", "Vector3D", "Vector", "", 0,1,0
"NearPlane", "double", "Number", "", 10
"FarPlane", "double", "Number", "", 4000
"AutoComputeClipPanes", "bool", "", "", 0
"ViewCameraToLookAt", "bool", "", "", 1
"ViewFrustumNearFarPlane", "bool", "", "", 0
"ViewFrustumBackPlaneMode", "enum", "", "", 2
"BackPlaneDistance", "Number", "", "A", 4000
"BackPlaneDistanceMode", "enum", "", "", 1
"ViewFrustumFrontPlaneMode", "enum", "", "", 2
"FrontPlaneDistance", "Number", "", "A", 10
"FrontPlaneDistanceMode", "enum", "", "", 1
"LockMode", "bool", "", "", 0
"LockInterestNavigation", "bool", "", "", 0
"BackPlateFitImage", "bool", "", "", 0
"BackPlateCrop", "bool", "", "", 0
"BackPlateCenter", "bool", "", "", 1
"BackPlateKeepRatio", "bool", "", "", 1
"BackgroundAlphaTreshold", "double", "Number", "", 0.5
"ShowBackplate", "bool", "", "", 1
"BackPlaneOffsetX", "Number", "", "A", 0
"BackPlaneOffsetY", "Number", "", "A", 0
"BackPlaneRotation", "Number", "", "A", 0
"BackPlaneScaleX", "Number", "", "A", 1
"BackPlaneScaleY", "Number", "", "A", 1
"Background Texture", "object", "", ""
"FrontPlateFitImage", "bool", "", "", 1
"FrontPlateCrop", "bool", "", "", 0
"FrontPlateCenter", "bool", "", "", 1
"FrontPlateKeepRatio", "bool", "", "", 1
"Foreground Opacity", "double", "Number", "", 1
"ShowFrontplate", "bool", "", "", 1
"FrontPlaneOffsetX", "Number", "", "A", 0
"FrontPlaneOffsetY", "Number", "", "A", 0
"FrontPlaneRotation", "Number", "", "A", 0
"FrontPlaneScaleX", "Number", "", "A", 1
"FrontPlaneScaleY", "Number", "", "A", 1
"Foreground Texture", "object", "", ""
"DisplaySafeArea", "bool", "", "", 0
"DisplaySafeAreaOnRender", "bool", "", "", 0
"SafeAreaDisplayStyle", "enum", "", "", 1
"SafeAreaAspectRatio", "double", "Number", "", 1.33333333333333
"Use2DMagnifierZoom", "bool", "", "", 0
"2D Magnifier Zoom", "Number", "", "A", 100
"2D Magnifier X", "Number", "", "A", 50
"2D Magnifier Y", "Number", "", "A", 50
"CameraProjectionType", "enum", "", "", 0
"OrthoZoom", "double", "Number", "", 1
"UseRealTimeDOFAndAA", "bool", "", "", 0
"UseDepthOfField", "bool", "", "", 0
"FocusSource", "enum", "", "", 0
"FocusAngle", "double", "Number", "", 3.5
"FocusDistance", "double", "Number", "", 200
"UseAntialiasing", "bool", "", "", 0
"AntialiasingIntensity", "double", "Number", "", 0.77777
"AntialiasingMethod", "enum", "", "", 0
"UseAccumulationBuffer", "bool", "", "", 0
"FrameSamplingCount", "int", "Integer", "", 7
"FrameSamplingType", "enum", "", "", 1
)";

inline constexpr std::string_view kStereoOnly = R"(
"Stereo", "enum", "", "", 0
"InteraxialSeparation", "Number", "", "A", 0
"ZeroParallax", "Number", "", "A", 0
"ToeInAdjust", "Number", "", "A", 0
"FilmOffsetRightCam", "Number", "", "A", 0
"FilmOffsetLeftCam", "Number", "", "A", 0
"RightCamera", "object", "", ""
"LeftCamera", "object", "", ""
"PrecompFileName", "KString", "", "", ""
"RelativePrecompFileName", "KString", "", "", ""
)";

inline constexpr std::string_view kCameraSwitcher = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"Camera Index", "Integer", "", "A", 0
)";

inline constexpr std::string_view kLight = R"(
"Color", "Color", "", "A", 1,1,1
"LightType", "enum", "", "", 0
"CastLightOnObject", "bool", "", "", 1
"DrawVolumetricLight", "bool", "", "", 1
"DrawGroundProjection", "bool", "", "", 1
"DrawFrontFacingVolumetricLight", "bool", "", "", 0
"Intensity", "Number", "", "A", 100
"InnerAngle", "Number", "", "A", 0
"OuterAngle", "Number", "", "A", 45
"Fog", "Number", "", "A", 50
"DecayType", "enum", "", "", 0
"DecayStart", "Number", "", "A", 0
"FileName", "KString", "", "", ""
"EnableNearAttenuation", "bool", "", "", 0
"NearAttenuationStart", "Number", "", "A", 0
"NearAttenuationEnd", "Number", "", "A", 0
"EnableFarAttenuation", "bool", "", "", 0
"FarAttenuationStart", "Number", "", "A", 0
"FarAttenuationEnd", "Number", "", "A", 0
"CastShadows", "bool", "", "", 0
"ShadowColor", "Color", "", "A", 0,0,0
"AreaLightShape", "enum", "", "", 0
"LeftBarnDoor", "Float", "", "A", 20
"RightBarnDoor", "Float", "", "A", 20
"TopBarnDoor", "Float", "", "A", 20
"BottomBarnDoor", "Float", "", "A", 20
"EnableBarnDoor", "Bool", "", "A", 0
)";

inline constexpr std::string_view kMarker = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"Look", "enum", "", "", 0
"DrawLink", "bool", "", "", 1
"Size", "double", "Number", "", 100
"ShowLabel", "bool", "", "", 0
"IKPivot", "Vector3D", "Vector", "", 0,0,0
)";

inline constexpr std::string_view kNull = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"Size", "double", "Number", "", 100
"Look", "enum", "", "", 1
)";

inline constexpr std::string_view kSkeleton = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"Size", "double", "Number", "", 100
"LimbLength", "double", "Number", "H", 1
)";

inline constexpr std::string_view kLodGroup = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"ThresholdsUsedAsPercentage", "bool", "", "", 0
"MinMaxDistance", "bool", "", "", 0
"MinDistance", "double", "Number", "", -100
"MaxDistance", "double", "Number", "", 100
"WorldSpace", "bool", "", "", 0
"Thresholds", "Compound", "", ""
"DisplayLevels", "Compound", "", ""
)";

inline constexpr std::string_view kMesh = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"BBoxMin", "Vector3D", "Vector", "", 0,0,0
"BBoxMax", "Vector3D", "Vector", "", 0,0,0
"Primary Visibility", "bool", "", "", 1
"Casts Shadows", "bool", "", "", 1
"Receive Shadows", "bool", "", "", 1
)";

inline constexpr std::string_view kLine = R"(
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"BBoxMin", "Vector3D", "Vector", "", 0,0,0
"BBoxMax", "Vector3D", "Vector", "", 0,0,0
"Primary Visibility", "bool", "", "", 1
"Casts Shadows", "bool", "", "", 1
"Receive Shadows", "bool", "", "", 1
"Renderable", "bool", "", "", 0
)";

inline constexpr std::string_view kVertexCacheDeformer = R"(
"ChannelName", "KString", "", "", ""
"Active", "bool", "", "", 1
"CacheSet", "KString", "", "", "FbxCacheExport"
"ChannelType", "enum", "", "", 0
)";

inline constexpr std::string_view kBlendShapeChannel = R"(
"DeformPercent", "Number", "", "A", 0
)";

inline constexpr std::string_view kCache = R"(
"CacheFileName", "KString", "", "", ""
"CacheAbsoluteFileName", "KString", "", "", ""
"CacheFileType", "enum", "", "", 0
)";

inline constexpr std::string_view kAnimStack = R"(
"Description", "KString", "", "", ""
"LocalStart", "KTime", "Time", "", 0
"LocalStop", "KTime", "Time", "", 0
"ReferenceStart", "KTime", "Time", "", 0
"ReferenceStop", "KTime", "Time", "", 0
)";

inline constexpr std::string_view kAnimLayer = R"(
"Weight", "Number", "", "A", 100
"Mute", "bool", "", "", 0
"Solo", "bool", "", "", 0
"Lock", "bool", "", "", 0
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"BlendMode", "enum", "", "", 0
"RotationAccumulationMode", "enum", "", "", 0
"ScaleAccumulationMode", "enum", "", "", 0
"BlendModeBypass", "ULongLong", "", "", 0
)";

inline constexpr std::string_view kAnimCurveNode = R"(
"d", "Compound", "", ""
)";

inline constexpr std::string_view kMaterial = R"(
"ShadingModel", "KString", "", "", "Unknown"
"MultiLayer", "bool", "", "", 0
)";

inline constexpr std::string_view kLambert = R"(
"ShadingModel", "KString", "", "", "Lambert"
"MultiLayer", "bool", "", "", 0
"EmissiveColor", "Color", "", "A", 0,0,0
"EmissiveFactor", "Number", "", "A", 1
"AmbientColor", "Color", "", "A", 0.2,0.2,0.2
"AmbientFactor", "Number", "", "A", 1
"DiffuseColor", "Color", "", "A", 0.8,0.8,0.8
"DiffuseFactor", "Number", "", "A", 1
"Bump", "Vector3D", "Vector", "", 0,0,0
"NormalMap", "Vector3D", "Vector", "", 0,0,0
"BumpFactor", "double", "Number", "", 1
"TransparentColor", "Color", "", "A", 0,0,0
"TransparencyFactor", "Number", "", "A", 0
"DisplacementColor", "ColorRGB", "Color", "", 0,0,0
"DisplacementFactor", "double", "Number", "", 1
"VectorDisplacementColor", "ColorRGB", "Color", "", 0,0,0
"VectorDisplacementFactor", "double", "Number", "", 1
)";

inline constexpr std::string_view kPhong = R"(
"ShadingModel", "KString", "", "", "Phong"
"MultiLayer", "bool", "", "", 0
"EmissiveColor", "Color", "", "A", 0,0,0
"EmissiveFactor", "Number", "", "A", 1
"AmbientColor", "Color", "", "A", 0.2,0.2,0.2
"AmbientFactor", "Number", "", "A", 1
"DiffuseColor", "Color", "", "A", 0.8,0.8,0.8
"DiffuseFactor", "Number", "", "A", 1
"Bump", "Vector3D", "Vector", "", 0,0,0
"NormalMap", "Vector3D", "Vector", "", 0,0,0
"BumpFactor", "double", "Number", "", 1
"TransparentColor", "Color", "", "A", 0,0,0
"TransparencyFactor", "Number", "", "A", 0
"DisplacementColor", "ColorRGB", "Color", "", 0,0,0
"DisplacementFactor", "double", "Number", "", 1
"VectorDisplacementColor", "ColorRGB", "Color", "", 0,0,0
"VectorDisplacementFactor", "double", "Number", "", 1
"SpecularColor", "Color", "", "A", 0.2,0.2,0.2
"SpecularFactor", "Number", "", "A", 1
"ShininessExponent", "Number", "", "A", 20
"ReflectionColor", "Color", "", "A", 0,0,0
"ReflectionFactor", "Number", "", "A", 1
)";

inline constexpr std::string_view kFileTexture = R"(
"TextureTypeUse", "enum", "", "", 0
"Texture alpha", "Number", "", "A", 1
"CurrentMappingType", "enum", "", "", 0
"WrapModeU", "enum", "", "", 0
"WrapModeV", "enum", "", "", 0
"UVSwap", "bool", "", "", 0
"PremultiplyAlpha", "bool", "", "", 1
"Translation", "Vector", "", "A", 0,0,0
"Rotation", "Vector", "", "A", 0,0,0
"Scaling", "Vector", "", "A", 1,1,1
"TextureRotationPivot", "Vector3D", "Vector", "", 0,0,0
"TextureScalingPivot", "Vector3D", "Vector", "", 0,0,0
"CurrentTextureBlendMode", "enum", "", "", 1
"UVSet", "KString", "", "", "default"
"UseMaterial", "bool", "", "", 0
"UseMipMap", "bool", "", "", 0
)";

inline constexpr std::string_view kLayeredTexture = R"(
"TextureTypeUse", "enum", "", "", 0
"Texture alpha", "Number", "", "A", 1
"CurrentMappingType", "enum", "", "", 0
"WrapModeU", "enum", "", "", 0
"WrapModeV", "enum", "", "", 0
"UVSwap", "bool", "", "", 0
"PremultiplyAlpha", "bool", "", "", 1
"Translation", "Vector", "", "A", 0,0,0
"Rotation", "Vector", "", "A", 0,0,0
"Scaling", "Vector", "", "A", 1,1,1
"TextureRotationPivot", "Vector3D", "Vector", "", 0,0,0
"TextureScalingPivot", "Vector3D", "Vector", "", 0,0,0
"CurrentTextureBlendMode", "enum", "", "", 1
"UVSet", "KString", "", "", "default"
)";

inline constexpr std::string_view kVideo = R"(
"Path", "KString", "XRefUrl", "", ""
"RelPath", "KString", "XRefUrl", "", ""
"Color", "ColorRGB", "Color", "", 0.8,0.8,0.8
"ClipIn", "KTime", "Time", "", 0
"ClipOut", "KTime", "Time", "", 0
"Offset", "KTime", "Time", "", 0
"PlaySpeed", "double", "Number", "", 0
"FreeRunning", "bool", "", "", 0
"Loop", "bool", "", "", 0
"Mute", "bool", "", "", 0
"AccessMode", "enum", "", "", 0
"ImageSequence", "bool", "", "", 0
"ImageSequenceOffset", "int", "Integer", "", 0
"FrameRate", "double", "Number", "", 0
"LastFrame", "int", "Integer", "", 0
"Width", "int", "Integer", "", 0
"Height", "int", "Integer", "", 0
"StartFrame", "int", "Integer", "", 0
"StopFrame", "int", "Integer", "", 0
"InterlaceMode", "enum", "", "", 0
)";

inline constexpr std::string_view kGlobalSettings = R"(
"UpAxis", "int", "Integer", "", 1
"UpAxisSign", "int", "Integer", "", 1
"FrontAxis", "int", "Integer", "", 2
"FrontAxisSign", "int", "Integer", "", 1
"CoordAxis", "int", "Integer", "", 0
"CoordAxisSign", "int", "Integer", "", 1
"OriginalUpAxis", "int", "Integer", "", -1
"OriginalUpAxisSign", "int", "Integer", "", 1
"UnitScaleFactor", "double", "Number", "", 1
"OriginalUnitScaleFactor", "double", "Number", "", 1
"AmbientColor", "ColorRGB", "Color", "", 0,0,0
"DefaultCamera", "KString", "", "", ""
"TimeMode", "enum", "", "", 0
"TimeProtocol", "enum", "", "", 2
"SnapOnFrameMode", "enum", "", "", 0
"TimeSpanStart", "KTime", "Time", "", 0
"TimeSpanStop", "KTime", "Time", "", 46186158000
"CustomFrameRate", "double", "Number", "", -1
"TimeMarker", "Compound", "", ""
"CurrentTimeMarker", "int", "Integer", "", -1
)";

} // namespace templates
