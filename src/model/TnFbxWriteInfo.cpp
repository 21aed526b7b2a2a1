// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "TnFbxWriteInfo.h"

namespace Tarnell::Fbx {

TnFbxWriteInfo::TnFbxWriteInfo() { initWriteInfo(); }

TnFbxWriteInfo::~TnFbxWriteInfo() = default;

// kept: the compatibility version is not copied
TnFbxWriteInfo& TnFbxWriteInfo::operator=(const TnFbxWriteInfo& other) {
    if (this != &other)
        mOptions = other.mOptions;
    return *this;
}

bool TnFbxWriteInfo::initWriteInfo() {
    mOptions = Options();
    mCompatibilityVersion = kFbxVersion2016;
    return true;
}

bool TnFbxWriteInfo::deleteWriteInfo() { return initWriteInfo(); }

bool TnFbxWriteInfo::setFileName(const std::string& fileName) {
    mOptions.fileName = fileName;
    return true;
}

const std::string& TnFbxWriteInfo::getFileName() const { return mOptions.fileName; }

bool TnFbxWriteInfo::setAnimationStackName(const std::string& animationStackName) {
    mOptions.animationStackName = animationStackName;
    return true;
}

const std::string& TnFbxWriteInfo::getAnimationStackName() const { return mOptions.animationStackName; }

bool TnFbxWriteInfo::setFileFormat(bool fileFormat) {
    mOptions.fileFormat = fileFormat;
    return true;
}

bool TnFbxWriteInfo::getFileFormat() const { return mOptions.fileFormat; }

bool TnFbxWriteInfo::setWriteCameras(bool writeCameras) {
    mOptions.writeCameras = writeCameras;
    return true;
}

bool TnFbxWriteInfo::getWriteCameras() const { return mOptions.writeCameras; }

bool TnFbxWriteInfo::setWriteLights(bool writeLights) {
    mOptions.writeLights = writeLights;
    return true;
}

bool TnFbxWriteInfo::getWriteLights() const { return mOptions.writeLights; }

bool TnFbxWriteInfo::setWriteTransforms(bool writeTransforms) {
    mOptions.writeTransforms = writeTransforms;
    return true;
}

bool TnFbxWriteInfo::getWriteTransforms() const { return mOptions.writeTransforms; }

bool TnFbxWriteInfo::setWriteNulls(bool writeNulls) {
    mOptions.writeNulls = writeNulls;
    return true;
}

bool TnFbxWriteInfo::getWriteNulls() const { return mOptions.writeNulls; }

bool TnFbxWriteInfo::setWriteMeshes(bool writeMeshes) {
    mOptions.writeMeshes = writeMeshes;
    return true;
}

bool TnFbxWriteInfo::getWriteMeshes() const { return mOptions.writeMeshes; }

bool TnFbxWriteInfo::setAnimateMeshVertices(bool animateMeshVertices) {
    mOptions.animateMeshVertices = animateMeshVertices;
    return true;
}

bool TnFbxWriteInfo::getAnimateMeshVertices() const { return mOptions.animateMeshVertices; }

bool TnFbxWriteInfo::setMayaVertexCacheFormat(bool mayaVertexCacheFormat) {
    mOptions.mayaVertexCacheFormat = mayaVertexCacheFormat;
    return true;
}

bool TnFbxWriteInfo::getMayaVertexCacheFormat() const { return mOptions.mayaVertexCacheFormat; }

bool TnFbxWriteInfo::setFPS(float framesPerSecond) {
    mOptions.framesPerSecond = framesPerSecond;
    return true;
}

float TnFbxWriteInfo::getFPS() const { return mOptions.framesPerSecond; }

bool TnFbxWriteInfo::setStartFrame(float startFrame) {
    mOptions.startFrame = startFrame;
    return true;
}

float TnFbxWriteInfo::getStartFrame() const { return mOptions.startFrame; }

bool TnFbxWriteInfo::setEndFrame(float endFrame) {
    mOptions.endFrame = endFrame;
    return true;
}

float TnFbxWriteInfo::getEndFrame() const { return mOptions.endFrame; }

bool TnFbxWriteInfo::setCompatibilityVersion(eCompatibilityVersion compatibilityVersion) {
    mCompatibilityVersion = compatibilityVersion;
    return true;
}

TnFbxWriteInfo::eCompatibilityVersion TnFbxWriteInfo::getCompatibilityVersion() const { return mCompatibilityVersion; }

bool TnFbxWriteInfo::setFidelity(EFbxFidelity fidelity) {
    mOptions.fidelity = fidelity;
    return true;
}

EFbxFidelity TnFbxWriteInfo::getFidelity() const { return mOptions.fidelity; }

bool TnFbxWriteInfo::setComputeCameraRotation(bool computeCameraRotation) {
    mOptions.computeCameraRotation = computeCameraRotation;
    return true;
}

bool TnFbxWriteInfo::getComputeCameraRotation() const { return mOptions.computeCameraRotation; }

} // namespace Tarnell::Fbx
