// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Every public header of the platform. Their namespace is opened to the includer unless FBXSDK_NAMESPACE_USING is 0.
#pragma once

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxArch.h>
#include <fbxsdk/FbxArray.h>
#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxCachedEffect.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCameraStereo.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxClassId.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxCollection.h>
#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxCriteria.h>
#include <fbxsdk/FbxDataType.h>
#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxDocument.h>
#include <fbxsdk/FbxEuler.h>
#include <fbxsdk/FbxExporter.h>
#include <fbxsdk/FbxGeometry.h>
#include <fbxsdk/FbxGeometryBase.h>
#include <fbxsdk/FbxGeometryConverter.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxGlobalLightSettings.h>
#include <fbxsdk/FbxGlobalSettings.h>
#include <fbxsdk/FbxGlobalTimeSettings.h>
#include <fbxsdk/FbxIOBase.h>
#include <fbxsdk/FbxIOPluginRegistry.h>
#include <fbxsdk/FbxIOSettings.h>
#include <fbxsdk/FbxImporter.h>
#include <fbxsdk/FbxLODGroup.h>
#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxLine.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxMatrix.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNodeAttribute.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxOpticalReference.h>
#include <fbxsdk/FbxPatch.h>
#include <fbxsdk/FbxPathUtils.h>
#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxProperty.h>
#include <fbxsdk/FbxQuaternion.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/FbxSceneRenamer.h>
#include <fbxsdk/FbxShape.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxStatus.h>
#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxSubDiv.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxSystemUnit.h>
#include <fbxsdk/FbxTakeInfo.h>
#include <fbxsdk/FbxTexture.h>
#include <fbxsdk/FbxTime.h>
#include <fbxsdk/FbxTransform.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>
#include <fbxsdk/FbxTypes.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>
#include <fbxsdk/FbxVideo.h>

#ifndef FBXSDK_NAMESPACE_USING
/// Whether this header opens the namespace to its includer; a host that defines it as 0 before writes
/// `fbxsdk::FbxNode`.
#define FBXSDK_NAMESPACE_USING 1
#endif
#if FBXSDK_NAMESPACE_USING
using namespace fbxsdk;
#endif
