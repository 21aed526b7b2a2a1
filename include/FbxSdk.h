// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The adapter between the value classes and the FBX platform: one manager with one scene, loaded, traversed and read,
// or built and saved. Hosts normally use it through `Fbx`, which creates one for every call.
#pragma once

#include "FbxPlatform.h"
#include "TnFbxCamera.h"
#include "TnFbxExport.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxTime.h"
#include "TnFbxTransform.h"
#include "TnFbxWriteInfo.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace Tarnell::Fbx {

namespace detail {
class FrameTimes;
class GlobalSampler;
class MemoryAccount;
class MeshInstances;
class ObjectWarnings;
class PropertySampler;
class ReadScope;
class SampleAccount;
} // namespace detail

/// One scene, and what can be read from it or written into it.
///
/// The order of calls is `initFbxSdkManager`, `loadScene` and any number of queries, or `createScene` and `saveScene`,
/// then `destroyFbxSdkManager`; the destructor calls the last one where the caller did not. A context belongs to one
/// thread at a time; contexts share nothing.
///
/// An operation whose result is a success or a failure sets `lastError()`; one whose false is a valid result (a walk
/// that found nothing, a mesh without deformers) leaves it unchanged. Scene objects are passed as pointers of the
/// platform and stay owned by the scene.
class TARNELL_FBX_API FbxSdk {
    friend class detail::ReadScope;

public:
    static const std::string kMayaVertexCacheFileExtension; ///< ".xml"
    static const std::string kMaxVertexCacheFileExtension;  ///< ".pc2"
    static const std::string kDefaultAnimationStackName;    ///< "Take 001"

    /// No manager and no scene.
    FbxSdk();
    /// Destroys the manager and with it everything that was read into the scene.
    ~FbxSdk();

    FbxSdk(const FbxSdk&) = delete;

    /// Copies nothing: a context that is not initialised yet gets a manager and an empty scene of its own, and an
    /// initialised one stays as it is.
    FbxSdk& operator=(const FbxSdk& other);

    // ---- Manager, scene and loading ----

    /// A manager with one empty scene; true at once when there is one already. False when no manager can be
    /// created.
    bool initFbxSdkManager();

    /// False when the context is not initialised.
    bool destroyFbxSdkManager();

    /// A manager and a scene that belong to the caller; this context's own are not touched. When no manager can
    /// be created, `*manager` is null, `*scene` unchanged, and the result false.
    bool initializeSdkObjects(fbxsdk::FbxManager** manager, fbxsdk::FbxScene** scene);

    /// Destroys the manager, if there is one, and sets the pointer to null; always true.
    bool destroySdkObjects(fbxsdk::FbxManager** manager);

    /// Imports a file into a scene without conversion. False when the file cannot be read; the scene may hold a part of
    /// it then.
    bool loadScene(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene, const std::string& fileName);

    /// Imports a file into the context's scene, converts it to centimetres and to a right-handed system with Y up,
    /// converts NURBS and patches to meshes if `convertGeometry` says so, and selects the first animation stack.
    /// A second file adds to the same scene. False when the context is not initialised or the file cannot be read; the
    /// scene may hold a part of it then.
    bool loadScene(const std::string& fileName, bool convertGeometry);

    /// The context's scene, null when not initialised.
    fbxsdk::FbxScene* getScene() const;

    /// Converts every NURBS and patch of the scene, or of the node and its descendants, to a mesh; always true.
    /// @{
    bool convertNurbsAndPatch(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene);
    bool convertNurbsAndPatchRecursive(fbxsdk::FbxManager* manager, fbxsdk::FbxNode* node);
    /// @}

    // ---- Animation stacks and time ----

    /// Selects the scene's first animation stack and gives it a layer; whichever is missing is created ("Take 001",
    /// "Default Layer").
    void initCreateAnimationStack();

    /// Selects the animation stack of exactly that name, which is used for all reading and evaluation from then on;
    /// false when there is none, and the selection stays.
    bool setCurrentAnimationStack(const std::string& name);

    /// Replaces `names` by the names of all animation stacks, in the scene's order. False without a scene.
    bool getAnimationStackNames(std::vector<std::string>& names);

    /// The current frame as given, the first and last frame of the current stack's time span, and the rate: the scene's
    /// own, or, with `useSampleFPS` and a rate above 0, `sampleFPS`, to which the frames are converted.
    /// False without a context or scene; `time` is a new record then.
    bool getGlobalAnimationStackTime(TnFbxTime& time, float frame, bool useSampleFPS, float sampleFPS);

    // ---- Counting and naming: `mask` selects kinds of nodes ----
    //
    // Meshes 4, cameras 32, lights 64, markers 1, nulls 0x4000, transforms 0x4005. The root node is never counted,
    // named or read. Functions that look for cameras create the seven producer cameras of a scene that has none.

    /// How many nodes below the root the mask selects; 0 without a context or scene.
    int getNumberOfNodeTypes(int mask) const;
    int getNumberOfMeshes() const;     ///< Nodes with a mesh, those made of NURBS and patches included.
    int getNumberOfCameras() const;    ///< The producer cameras included.
    int getNumberOfLights() const;     ///< Nodes with a light.
    int getNumberOfMarkers() const;    ///< Nodes with a marker.
    int getNumberOfNulls() const;      ///< NURBS surfaces included, which `getNulls` does not read.
    int getNumberOfTransforms() const; ///< NURBS surfaces included, which `getTransforms` does not read.

    /// Adds the number of selected nodes at and below a node to `count`; always true.
    bool getNumberOfNodeTypesRecursive(fbxsdk::FbxNode* node, int mask, int& count) const;

    /// Replaces `names` by the names of the selected nodes: producer cameras first, then parents before their children.
    /// Duplicates are kept. False without a scene.
    bool getNodeNames(long mask, std::vector<std::string>& names);

    /// Appends the names at and below a node; always true.
    bool getNodeNamesRecursive(fbxsdk::FbxNode* node, long mask, std::vector<std::string>& names);

    /// The time between the first and the last key of the scene, in seconds although the name says frames; in a scene
    /// without keys, the time that its Maya point caches cover.
    /// False without a root node, the outputs untouched then; false also when nothing is animated, `start` then being
    /// the largest float and `end` its negative.
    bool getAnimationFrameRange(float& start, float& end);

    /// Widens `start` and `end` (seconds) by the Maya point caches at and below a node; returns whether there were any.
    bool getAnimationFrameRangeRecursive(fbxsdk::FbxNode* node, float& start, float& end);

    // ---- Reading all objects of a kind ----

    /// Fills an array of `count` objects, parents before their children, or only its first element when `info` selects
    /// a single name. Producer cameras come first.
    ///
    /// False for a null array, a count below 1, without a context or scene, and when there are more objects than
    /// elements; what was filled until then stays. Elements without an object stay as they are.
    ///
    /// Animated channels get one sample for every whole frame; where all are equal they take no memory. False
    /// also when the samples of a list would take more than `memoryLimit()`: `lastError()` then states the frames and
    /// the memory that they would have needed. Channels left without samples are not animated then.
    /// @{
    bool getMeshes(TnFbxReadInfo& info, TnFbxMesh* meshes, int count);
    bool getCameras(TnFbxReadInfo& info, TnFbxCamera* cameras, int count);
    bool getLights(TnFbxReadInfo& info, TnFbxLight* lights, int count);
    bool getMarkers(TnFbxReadInfo& info, TnFbxMarker* markers, int count);
    bool getNulls(TnFbxReadInfo& info, TnFbxNull* nulls, int count);
    bool getTransforms(TnFbxReadInfo& info, TnFbxTransform* transforms, int count);
    /// @}

    /// Reads a node and its descendants, as the function without "Recursive" reads the scene. `index` is the next free
    /// element of the array and `count` its length; `found` reports that the single object was read and ends the walk.
    /// @{
    bool getMeshesRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS, bool allObjects,
                            bool transformPoints, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                            TnFbxMesh* meshes, int count, bool& found);
    bool getCamerasRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                             bool computeCameraRotation, bool allObjects, const std::string& objectName,
                             fbxsdk::FbxNode* node, int& index, TnFbxCamera* cameras, int count, bool& found);
    bool getLightsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS, bool allObjects,
                            const std::string& objectName, fbxsdk::FbxNode* node, int& index, TnFbxLight* lights,
                            int count, bool& found);
    bool getMarkersRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS, bool allObjects,
                             const std::string& objectName, fbxsdk::FbxNode* node, int& index, TnFbxMarker* markers,
                             int count, bool& found);
    bool getNullsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS, bool allObjects,
                           const std::string& objectName, fbxsdk::FbxNode* node, int& index, TnFbxNull* nulls,
                           int count, bool& found);
    bool getTransformsRecursive(TnFbxTime& time, bool globalTransform, bool useSampleFPS, float sampleFPS,
                                bool allObjects, const std::string& objectName, fbxsdk::FbxNode* node, int& index,
                                TnFbxTransform* transforms, int count, bool& found);
    /// @}

    /// Reads one producer camera into the array: into the element at `index`, which is advanced, or, for a read by
    /// name, into the first element if the names are equal. `index` is not compared with the array's length. False when
    /// the camera, its node or the array is null.
    bool getProducerCamera(fbxsdk::FbxCamera* camera, TnFbxReadInfo& info, TnFbxCamera* cameras, const char* name,
                           int& index);

    // ---- Reading one node ----

    /// Reads one node into an object.
    ///
    /// `time` is the range to sample, `global` selects transforms in the world, and with `useSampleFPS` the key frames
    /// are converted to `sampleFPS`. `geometric` is the node's geometric transform. False for a null node, for one
    /// without the attribute that the object is read from, and when its samples would take more than `memoryLimit()`;
    /// the object then keeps what was set before. Channels that the scene does not define keep their values.
    /// @{
    bool getTransform(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                      TnFbxTransform& transform, fbxsdk::FbxAMatrix& geometric);
    bool getLight(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                  TnFbxLight& light, fbxsdk::FbxAMatrix& geometric);
    bool getMarker(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                   TnFbxMarker& marker, fbxsdk::FbxAMatrix& geometric);
    /// @}
    /// As `getTransform`. A node without an attribute is a null of the default size.
    bool getNull(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                 TnFbxNull& null, fbxsdk::FbxAMatrix& geometric);

    /// As `getTransform`. The camera's own placement is always local; `global` concerns its target. With
    /// `useInterestPosition` a camera without a target looks at its interest position. The rotation of a camera with a
    /// target or an interest position follows from it.
    bool getCamera(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, bool useInterestPosition,
                   fbxsdk::FbxNode* node, TnFbxCamera& camera, fbxsdk::FbxAMatrix& geometric);

    /// A producer camera, static values only, called `name`; `node` may be null. False for a null camera.
    bool getProducerCamera(fbxsdk::FbxNode* node, fbxsdk::FbxCamera* camera, TnFbxCamera& out, const char* name);

    /// As `getTransform`: the mesh at `time.getFrame()`, deformed. With `transformPoints` points and normals are
    /// multiplied by the node's transform, and, unless `global`, by `geometric`. False also for a mesh without polygons
    /// or points. Throws std::runtime_error when a layer element has no direct array; the mesh is partly filled then.
    bool getMesh(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                 bool transformPoints, TnFbxMesh& mesh, fbxsdk::FbxAMatrix& geometric);

    /// Widens the range by that of `time`, takes its rate and sets `found`.
    void getCameraFrameRange(TnFbxTime time, bool& found, float& frameRate, int& startFrame, int& endFrame);

    // ---- Transforms ----

    /// Position, rotation (degrees) and scale in the world, one value per frame of `time`. Lights that shine along an
    /// axis are rotated by −90° about X.
    /// False, with empty vectors, when the range is empty, the node null, or the values would take more than
    /// `memoryLimit()`.
    bool getGlobalPositionRotationScaleValues(TnFbxTime& time, fbxsdk::FbxNode* node, fbxsdk::FbxAMatrix& geometric,
                                              std::vector<float>& positionX, std::vector<float>& positionY,
                                              std::vector<float>& positionZ, std::vector<float>& rotationX,
                                              std::vector<float>& rotationY, std::vector<float>& rotationZ,
                                              std::vector<float>& scaleX, std::vector<float>& scaleY,
                                              std::vector<float>& scaleZ);

    /// Euler angles in degrees of a rotation matrix without scale; always true.
    bool extractMatrixRotation(fbxsdk::FbxAMatrix matrix, float& x, float& y, float& z);

    /// The node's local translation, rotation and scaling, static and sampled; always true.
    bool setTransformValues(fbxsdk::FbxNode* node, TnFbxTime& time, bool useSampleFPS, float sampleFPS,
                            TnFbxTransform* transform);

    /// Converts between the rotation orders of FBX and of the library; a number out of range gives ZXY.
    /// @{
    TnFbxTransform::EFbxTransformRotationOrder getRotationOrderConstant(fbxsdk::FbxEuler::EOrder order);
    fbxsdk::FbxEuler::EOrder getRotationOrderConstant(TnFbxTransform::EFbxTransformRotationOrder order);
    /// @}

    /// The node's geometric offset: scene units, degrees and factors. Always true.
    bool getGeometricTransformation(fbxsdk::FbxNode* node, fbxsdk::FbxVector4& translation,
                                    fbxsdk::FbxVector4& rotation, fbxsdk::FbxVector4& scaling);
    /// The same as a matrix.
    fbxsdk::FbxAMatrix getGeometry(fbxsdk::FbxNode* node);

    /// The default values of the curves of the node's local transform on the layers of the current stack; components
    /// without a curve stay as they are. False without a node or a current stack.
    bool getDefaultAnimTransformation(fbxsdk::FbxNode* node, fbxsdk::FbxVector4& translation,
                                      fbxsdk::FbxVector4& rotation, fbxsdk::FbxVector4& scaling);

    // ---- Deformation ----

    /// Whether the mesh has an active vertex cache, a shape or a cluster.
    bool getDeformation(fbxsdk::FbxMesh* mesh);

    /// Stores a new array with the deformed control points, in the mesh's own space, in `*points`, and releases the
    /// previous one; the caller owns the array and releases it with `delete[]`. Nothing changes when an argument is
    /// null or the mesh has no points. `globalPosition` is the mesh's global transform, for its skin.
    void getDeformedControlPoints(fbxsdk::FbxNode* node, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                  fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxVector4** points);

    /// Overwrites the points, one per control point, with those of the mesh's vertex cache, whose file must be open. A
    /// cache that cannot be read leaves them as they are.
    void readVertexCacheData(fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time, fbxsdk::FbxVector4* points);
    /// Adds the blend shapes of the mesh to the points, one per control point.
    void computeShapeDeformation(fbxsdk::FbxNode* node, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                 fbxsdk::FbxVector4* points);
    /// Deforms the points, one per control point, by the skins of the mesh. `globalPosition` is the mesh's global
    /// transform.
    void computeClusterDeformation(fbxsdk::FbxAMatrix& globalPosition, fbxsdk::FbxMesh* mesh, fbxsdk::FbxTime& time,
                                   fbxsdk::FbxVector4* points);

    /// Opens (or closes) the file of every active vertex cache; one that does not open is switched off. False for a
    /// null scene.
    bool openClosePointCacheData(fbxsdk::FbxScene* scene, bool open);

    void matrixScale(fbxsdk::FbxAMatrix& matrix, double factor);        ///< Multiplies all sixteen elements.
    void matrixAddToDiagonal(fbxsdk::FbxAMatrix& matrix, double value); ///< Adds to the four elements of the diagonal.
    void matrixAdd(fbxsdk::FbxAMatrix& matrix, fbxsdk::FbxAMatrix& other); ///< Adds element by element.

    // ---- Building a scene ----
    //
    // What is created here belongs to the manager and stays when a later step fails. Names go into the scene unchanged.

    /// Global settings, animation stack and one node below the root per object, of the kinds that `info` selects:
    /// cameras, lights, transforms, nulls, meshes, each in the order of its list. Null pointers and meshes without
    /// geometry are skipped. Curves go into the stack "Take 001", whatever the name in `info`; its span is that of its
    /// keys and of the frames of `info`, unless those are 1 to 1 as in new options. Point caches of animated meshes are
    /// written at once, next to where the scene will be saved. What could not be written, and what no program can
    /// interpret, is in `lastWarnings()`. False when the context is not
    /// initialised. Throws std::runtime_error when a layer element has no direct array.
    bool createScene(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                     const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                     const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes);

    /// The global settings of a scene, and the stack of that name selected if the context's scene has one. False for a
    /// null manager or scene.
    bool createScene(fbxsdk::FbxManager* manager, fbxsdk::FbxScene* scene, float framesPerSecond,
                     const std::string& animationStackName);

    // The global settings one by one; false for a null scene.

    /// A fixed ambient colour and fog.
    bool setGlobalLightSettings(fbxsdk::FbxScene* scene);
    /// The camera switcher as default camera, and the producer cameras.
    bool setGlobalCameraSettings(fbxsdk::FbxScene* scene);
    /// The time mode within 0.00001 of the rate, or a custom one when there is none.
    bool setGlobalTimeSettings(fbxsdk::FbxScene* scene, float framesPerSecond);

    /// Creates a node with its attribute, unparented and owned by the manager; null when an argument is a null pointer.
    /// @{
    fbxsdk::FbxNode* createCamera(fbxsdk::FbxScene* scene, const std::string& name);
    fbxsdk::FbxNode* createNull(fbxsdk::FbxManager* manager, const std::string& name);
    fbxsdk::FbxNode* createLight(fbxsdk::FbxScene* scene, TnFbxLight::EFbxLightType type, const std::string& name);
    /// @}

    /// As `createNull`, with the first set of points, and normals, texture coordinates and colours by polygon vertex
    /// where they are valid. Null also for a mesh without polygons, points or polygon vertices, and for one whose
    /// polygons claim far more polygon vertices than there are.
    fbxsdk::FbxNode* createMesh(fbxsdk::FbxManager* manager, const TnFbxMesh* mesh, const std::string& name);

    /// A texture mapped by the texture coordinates, unscaled; null for a null scene.
    fbxsdk::FbxFileTexture* createTexture(fbxsdk::FbxScene* scene, const std::string& fileName);
    /// A grey material whose name is `name` followed by `index`; null for a null manager.
    fbxsdk::FbxSurfaceLambert* createLambertMaterial(fbxsdk::FbxManager* manager, const std::string& name, int index);

    // ---- Writing the channels of an object ----
    //
    // Onto a node and its attribute: static values into the properties, samples as linear keys into the first layer of
    // the current stack. What was written before a failure stays.

    /// The static value of a channel as the curve's default, unscaled, and its samples, times `scale`, as keys at the
    /// channel's own rate. False for a null argument.
    bool setCurveValues(fbxsdk::FbxAnimCurve* curve, TnFbxChannel* channel, float scale) const;

    /// Writes position, rotation, scale and rotation order; neither skew nor pivot. False for a null argument.
    bool setTransformCurveValues(fbxsdk::FbxNode* node, TnFbxTransform* transform);

    /// Writes the channels and properties of the object, those of its transform included. False for a null
    /// argument and for a node without the attribute of that kind.
    /// @{
    bool setCameraCurveValues(fbxsdk::FbxNode* node, TnFbxCamera* camera);
    bool setLightCurveValues(fbxsdk::FbxNode* node, TnFbxLight* light);
    bool setNullCurveValues(fbxsdk::FbxNode* node, TnFbxNull* null);
    /// @}

    // ---- Point caches and saving ----

    /// A vertex cache on the node's mesh: "<node>.xml" or ".pc2" in the folder "<file>_fpc" next to the FBX file, which
    /// is created. Characters not allowed in file names are escaped. False for a null argument, an empty file name, a
    /// node without geometry, and when the folder cannot be created.
    bool mapVertexCacheOnMesh(fbxsdk::FbxManager* manager, fbxsdk::FbxNode* meshNode, bool mayaFormat,
                              const std::string& fbxFileName);

    /// Writes the mesh's sets of points, one per frame of `time`, into the file of the node's vertex cache.
    /// False for a null argument, when there is not exactly one set per frame or no cache, and when the file cannot be
    /// written; when it cannot be opened, that is also printed to standard output.
    bool animateVertexCacheOnMesh(fbxsdk::FbxNode* meshNode, const TnFbxMesh* mesh, bool mayaFormat, bool useMcxFormat,
                                  const TnFbxTime& time);

    /// From now on, point caches do not appear until the scene is saved, together with its file: all of them, or none,
    /// and the previous files stay. Without this each appears when `animateVertexCacheOnMesh` returns.
    /// An external platform may rename the files at once all the same.
    void letPointCachesAppearWithScene();

    /// Writes the context's scene into the file that `info` names, in its format and version.
    bool saveScene(const TnFbxWriteInfo& info);

    /// With `embedMedia` the file is binary, whatever `asciiFormat` says. A number that is no version means the newest.
    bool saveScene(fbxsdk::FbxManager* manager, fbxsdk::FbxDocument* document, const std::string& fileName,
                   bool asciiFormat, TnFbxWriteInfo::eCompatibilityVersion version, bool embedMedia);

private:
    TARNELL_FBX_LOCAL fbxsdk::FbxAnimLayer* currentLayer() const;
    TARNELL_FBX_LOCAL void addPointCache(fbxsdk::FbxNode& node, const TnFbxMesh& mesh, const TnFbxWriteInfo& info,
                                         const TnFbxTime& time, detail::ObjectWarnings& warnings);
    template <class Object>
    TARNELL_FBX_LOCAL bool readList(TnFbxReadInfo& info, Object* objects, int count);
    template <class Walk>
    TARNELL_FBX_LOCAL bool walkSubtree(const Walk& walk, fbxsdk::FbxNode* top);
    TARNELL_FBX_LOCAL bool readProducerCameras(TnFbxReadInfo& info, TnFbxCamera* cameras, int count, int& index);
    TARNELL_FBX_LOCAL bool getTargetLookAt(TnFbxTime& time, bool global, fbxsdk::FbxNode& node, TnFbxCamera& camera,
                                           fbxsdk::FbxAMatrix& geometric, detail::PropertySampler& sampler);
    TARNELL_FBX_LOCAL void setLookAtRotation(TnFbxCamera& camera);
    TARNELL_FBX_LOCAL void storeGlobalTransform(const TnFbxTime& time, fbxsdk::FbxNode& node,
                                                fbxsdk::FbxAMatrix& geometric, TnFbxTransform& transform);
    TARNELL_FBX_LOCAL void setControlPoints(TnFbxTime& time, fbxsdk::FbxNode& node, fbxsdk::FbxMesh& source,
                                            const fbxsdk::FbxAMatrix* bake, detail::MeshArrays& arrays);
    TARNELL_FBX_LOCAL detail::PropertySampler sampler(const TnFbxTime& time, bool useSampleFPS, float sampleFPS);

    bool mInitialized = false;
    bool mCachesAppearWithScene = false;
    fbxsdk::FbxManager* mManager = nullptr; // owned
    fbxsdk::FbxScene* mScene = nullptr;     // owned by the manager
    fbxsdk::FbxAnimStack* mCurrentAnimStack = nullptr;
    std::string mFileName;                             // of the file that was loaded last; empty: none
    std::unique_ptr<detail::MemoryAccount> mMemory;    // of the call that is reading
    std::unique_ptr<detail::SampleAccount> mSamples;   // the part of it for samples
    std::unique_ptr<detail::ObjectWarnings> mWarnings; // of that call
    std::unique_ptr<detail::MeshInstances> mInstances; // returned by that call
    std::unique_ptr<detail::GlobalSampler> mGlobals;   // of the subtree that is being traversed; null: none
    std::unique_ptr<detail::FrameTimes> mFrameTimes;
    bool mIsReading = false;
};

} // namespace Tarnell::Fbx
