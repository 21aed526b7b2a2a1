// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// A camera: film back, lens, view and clipping planes. Looks along its node's positive X axis with Y up.
///
/// The properties are independent: setting one never changes another, so the caller keeps focal length and fields of
/// view consistent. Lengths are scene units unless stated otherwise.
class FBXSDK_DLL FbxCamera : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxCamera, FbxNodeAttribute)

public:
    /// The projection.
    enum EProjectionType : int {
        ePerspective, ///< perspective
        eOrthogonal   ///< parallel; OrthoZoom scales the picture
    };
    /// Which angle the property FieldOfView is, and which lens values are used.
    enum EApertureMode : int {
        eHorizAndVert, ///< FieldOfViewX and FieldOfViewY are used
        eHorizontal,   ///< FieldOfView is used, horizontal
        eVertical,     ///< FieldOfView is used, vertical; the default
        eFocalLength   ///< FocalLength is used
    };
    /// Film backs, width by height in inches.
    enum EApertureFormat : int {
        eCustomAperture,    ///< any other film back
        e16mmTheatrical,    ///< 0.404 × 0.295
        eSuper16mm,         ///< 0.493 × 0.292
        e35mmAcademy,       ///< 0.864 × 0.630
        e35mmTVProjection,  ///< 0.816 × 0.612, the default measures
        e35mmFullAperture,  ///< 0.980 × 0.735
        e35mm185Projection, ///< 0.825 × 0.446
        e35mmAnamorphic,    ///< 0.864 × 0.732, squeezed 2 to 1
        e70mmProjection,    ///< 2.066 × 0.906
        eVistaVision,       ///< 1.485 × 0.991
        eDynaVision,        ///< 2.080 × 1.480
        eIMAX               ///< 2.772 × 2.072
    };
    /// Picture formats by name. Setting one does not change the aspect properties.
    enum EFormat : int {
        eCustomFormat, ///< any other; the default
        eD1NTSC,       ///< 720 × 486
        eNTSC,         ///< 640 × 480
        ePAL,          ///< 570 × 486
        eD1PAL,        ///< 720 × 576
        eHD,           ///< 1920 × 1080
        e640x480,      ///< 640 × 480 pixels
        e320x200,      ///< 320 × 200 pixels
        e320x240,      ///< 320 × 240 pixels
        e128x128,      ///< 128 × 128 pixels
        eFullscreen    ///< that of the screen
    };
    /// What AspectWidth and AspectHeight mean.
    enum EAspectRatioMode : int {
        eWindowSize,      ///< nothing; the window determines the shape
        eFixedRatio,      ///< AspectWidth is the width for a height of 1
        eFixedResolution, ///< pixels
        eFixedWidth,      ///< AspectWidth is pixels, AspectHeight the height for a width of 1
        eFixedHeight      ///< AspectHeight is pixels, AspectWidth the width for a height of 1
    };
    /// How the film back is fitted to a picture of another shape.
    enum EGateFit : int {
        eFitNone,       ///< it is not fitted
        eFitVertical,   ///< by its height
        eFitHorizontal, ///< by its width
        eFitFill,       ///< so that it fills the picture
        eFitOverscan,   ///< so that all of it is in the picture
        eFitStretch     ///< stretched to the picture's shape
    };
    /// Where the plane of focus is.
    enum EFocusDistanceSource : int {
        eFocusSrcCameraInterest, ///< at the point of interest
        eFocusSpecificDistance   ///< FocusDistance away from the camera
    };

    FbxPropertyT<FbxDouble3> Position,      ///< position, in files that have it on the attribute; (0, 0, 0), animatable
        UpVector,                           ///< a direction; (0, 1, 0), animatable
        InterestPosition;                   ///< the point looked at; (0, 0, 0), animatable
    FbxPropertyT<FbxDouble> Roll;           ///< degrees; animatable
    FbxPropertyT<FbxDouble> OpticalCenterX, ///< 0, animatable; stored for applications
        OpticalCenterY;                     ///< 0, animatable; stored for applications
    FbxPropertyT<FbxDouble3> BackgroundColor;       ///< 0 to 1; (0.63, 0.63, 0.63), animatable
    FbxPropertyT<EAspectRatioMode> AspectRatioMode; ///< eWindowSize by default
    FbxPropertyT<FbxDouble> AspectWidth,            ///< as AspectRatioMode says; 320
        AspectHeight;                               ///< as AspectRatioMode says; 200
    FbxPropertyT<FbxDouble> PixelAspectRatio;       ///< width of a pixel over its height; 1
    FbxPropertyT<FbxDouble> FilmOffsetX,            ///< inches; 0, animatable
        FilmOffsetY;                                ///< inches; 0, animatable
    FbxPropertyT<FbxDouble> FilmWidth,              ///< inches; 0.816
        FilmHeight;                                 ///< inches; 0.612
    FbxPropertyT<FbxDouble> FilmAspectRatio,        ///< width over height; 4/3
        FilmSqueezeRatio;                           ///< squeeze factor of the lens in width; 1
    FbxPropertyT<EApertureFormat> FilmFormat;       ///< in files FilmFormatIndex; eCustomAperture by default
    FbxPropertyT<EApertureMode> ApertureMode;       ///< eVertical by default
    FbxPropertyT<EGateFit> GateFit;                 ///< eFitNone by default
    FbxPropertyT<FbxDouble>
        FieldOfView,  ///< degrees, of the full angle that ApertureMode names; about 25.115, animatable
        FieldOfViewX, ///< degrees, of the full horizontal angle; 40, animatable
        FieldOfViewY; ///< degrees, of the full vertical angle; 40, animatable
    FbxPropertyT<FbxDouble> FocalLength;            ///< millimetres; about 34.893, animatable
    FbxPropertyT<EFormat> CameraFormat;             ///< eCustomFormat by default
    FbxPropertyT<FbxDouble> NearPlane,              ///< distance of the near clipping plane; 10
        FarPlane;                                   ///< distance of the far clipping plane; 4000
    FbxPropertyT<FbxDouble> BackPlaneDistance,      ///< of the plane with the background image; 4000, animatable
        FrontPlaneDistance;                         ///< of the plane with the foreground image; 10, animatable
    FbxPropertyT<EProjectionType> ProjectionType;   ///< in files CameraProjectionType; ePerspective by default
    FbxPropertyT<FbxDouble> OrthoZoom;              ///< factor of an orthogonal view; 1
    FbxPropertyT<EFocusDistanceSource> FocusSource; ///< eFocusSrcCameraInterest by default
    FbxPropertyT<FbxDouble> FocusDistance;          ///< distance of the plane of focus; 200

    [[nodiscard]] EType GetAttributeType() const override; ///< eCamera.

    /// Sets AspectRatioMode, AspectWidth and AspectHeight together; nothing is checked.
    void SetAspect(EAspectRatioMode pRatioMode, double pWidth, double pHeight);
    void SetPixelRatio(double pRatio);          ///< The property PixelAspectRatio, unchecked.
    [[nodiscard]] double GetPixelRatio() const; ///< Width of a pixel over its height.
    /// The distance, clamped to 0.001 and 600000; the property itself accepts any.
    void SetNearPlane(double pDistance);
    [[nodiscard]] double GetNearPlane() const; ///< As stored, also when out of that range.
    /// The distance, clamped to 0.001 and 600000; the property itself accepts any.
    void SetFarPlane(double pDistance);
    [[nodiscard]] double GetFarPlane() const; ///< As stored, also when out of that range.

    void SetApertureMode(EApertureMode pMode);           ///< The property ApertureMode; no lens value changes.
    [[nodiscard]] EApertureMode GetApertureMode() const; ///< A number from a file may be no enumerator.
    /// With any format but the custom one, also sets the film's width, height, aspect and squeeze ratio.
    void SetApertureFormat(EApertureFormat pFormat);
    [[nodiscard]] EApertureFormat GetApertureFormat() const; ///< As stored; the film's dimensions may differ.
    void SetApertureWidth(double pWidth);                    ///< Inches; the format stays as it is.
    [[nodiscard]] double GetApertureWidth() const;           ///< Inches.
    void SetApertureHeight(double pHeight);                  ///< Inches; the format stays as it is.
    [[nodiscard]] double GetApertureHeight() const;          ///< Inches.
    void SetSqueezeRatio(double pRatio);                     ///< The property FilmSqueezeRatio, unchecked.
    [[nodiscard]] double GetSqueezeRatio() const;            ///< 1 for spherical lenses.

    /// The full angle in degrees that a focal length in millimetres has over the film: over its height in vertical
    /// mode, over its squeezed width in the others. Changes no property.
    [[nodiscard]] double ComputeFieldOfView(double pFocalLength) const;
    /// The focal length in millimetres that a full angle in degrees has over the same side of the film. Infinite for an
    /// angle of 0.
    [[nodiscard]] double ComputeFocalLength(double pAngleOfView) const;

private:
    /// The side of the film that angles are measured over, millimetres.
    [[nodiscard]] FBXSDK_LOCAL double apertureMillimetres() const;
};

FBXSDK_NAMESPACE_END
