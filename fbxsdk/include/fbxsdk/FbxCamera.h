// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A camera: film back, lens, view and clipping planes.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// Looks along its node's positive X axis with Y up. The properties are independent: setting one never changes another,
/// so focal length and fields of view are kept in step by whoever needs it.
class FBXSDK_DLL FbxCamera : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCamera, FbxNodeAttribute)

public:
    enum EProjectionType : int { ePerspective, eOrthogonal };
    /// Which angle the property FieldOfView is, and which lens values count.
    enum EApertureMode : int { eHorizAndVert, eHorizontal, eVertical, eFocalLength };
    enum EApertureFormat : int {
        eCustomAperture,
        e16mmTheatrical,
        eSuper16mm,
        e35mmAcademy,
        e35mmTVProjection,
        e35mmFullAperture,
        e35mm185Projection,
        e35mmAnamorphic,
        e70mmProjection,
        eVistaVision,
        eDynaVision,
        eIMAX
    };
    enum EFormat : int {
        eCustomFormat,
        eD1NTSC,
        eNTSC,
        ePAL,
        eD1PAL,
        eHD,
        e640x480,
        e320x200,
        e320x240,
        e128x128,
        eFullscreen
    };
    enum EAspectRatioMode : int { eWindowSize, eFixedRatio, eFixedResolution, eFixedWidth, eFixedHeight };
    enum EGateFit : int { eFitNone, eFitVertical, eFitHorizontal, eFitFill, eFitOverscan, eFitStretch };
    enum EFocusDistanceSource : int { eFocusSrcCameraInterest, eFocusSpecificDistance };

    FbxPropertyT<FbxDouble3> Position, UpVector, InterestPosition;
    FbxPropertyT<FbxDouble> Roll; ///< degrees
    FbxPropertyT<FbxDouble> OpticalCenterX, OpticalCenterY;
    FbxPropertyT<FbxDouble3> BackgroundColor;
    FbxPropertyT<EAspectRatioMode> AspectRatioMode;
    FbxPropertyT<FbxDouble> AspectWidth, AspectHeight;
    FbxPropertyT<FbxDouble> PixelAspectRatio;
    FbxPropertyT<FbxDouble> FilmOffsetX, FilmOffsetY; ///< inches
    FbxPropertyT<FbxDouble> FilmWidth, FilmHeight;    ///< inches
    FbxPropertyT<FbxDouble> FilmAspectRatio, FilmSqueezeRatio;
    FbxPropertyT<EApertureFormat> FilmFormat;
    FbxPropertyT<EApertureMode> ApertureMode;
    FbxPropertyT<EGateFit> GateFit;
    FbxPropertyT<FbxDouble> FieldOfView, FieldOfViewX, FieldOfViewY; ///< degrees
    FbxPropertyT<FbxDouble> FocalLength;                             ///< millimetres
    FbxPropertyT<EFormat> CameraFormat;
    FbxPropertyT<FbxDouble> NearPlane, FarPlane;
    FbxPropertyT<FbxDouble> BackPlaneDistance, FrontPlaneDistance;
    FbxPropertyT<EProjectionType> ProjectionType;
    FbxPropertyT<FbxDouble> OrthoZoom;
    FbxPropertyT<EFocusDistanceSource> FocusSource;
    FbxPropertyT<FbxDouble> FocusDistance;

    [[nodiscard]] EType GetAttributeType() const override;

    void SetAspect(EAspectRatioMode pRatioMode, double pWidth, double pHeight);
    void SetPixelRatio(double pRatio);
    [[nodiscard]] double GetPixelRatio() const;
    // Distances are held between 0.001 and 600000; the properties themselves take any.
    void SetNearPlane(double pDistance);
    [[nodiscard]] double GetNearPlane() const;
    void SetFarPlane(double pDistance);
    [[nodiscard]] double GetFarPlane() const;

    void SetApertureMode(EApertureMode pMode);
    [[nodiscard]] EApertureMode GetApertureMode() const;
    /// With any format but the custom one also sets the film's width, height, aspect and squeeze ratio.
    void SetApertureFormat(EApertureFormat pFormat);
    [[nodiscard]] EApertureFormat GetApertureFormat() const;
    void SetApertureWidth(double pWidth); ///< inches
    [[nodiscard]] double GetApertureWidth() const;
    void SetApertureHeight(double pHeight); ///< inches
    [[nodiscard]] double GetApertureHeight() const;
    void SetSqueezeRatio(double pRatio);
    [[nodiscard]] double GetSqueezeRatio() const;

    // Degrees and millimetres, over the film's height in vertical mode and over its squeezed width in the others.
    [[nodiscard]] double ComputeFieldOfView(double pFocalLength) const;
    /// Infinite for an angle of 0.
    [[nodiscard]] double ComputeFocalLength(double pAngleOfView) const;

private:
    /// The side of the film that angles are measured over, millimetres.
    [[nodiscard]] double apertureMillimetres() const;
};

FBXSDK_NAMESPACE_END
