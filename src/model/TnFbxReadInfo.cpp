// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "TnFbxReadInfo.h"

namespace Tarnell::Fbx {

TnFbxReadInfo::TnFbxReadInfo() { initReadInfo(); }

TnFbxReadInfo::~TnFbxReadInfo() = default;

TnFbxReadInfo& TnFbxReadInfo::operator=(const TnFbxReadInfo& other) {
    if (this != &other)
        mOptions = other.mOptions;
    return *this;
}

bool TnFbxReadInfo::initReadInfo() {
    mOptions = Options();
    return true;
}

bool TnFbxReadInfo::deleteReadInfo() { return initReadInfo(); }

bool TnFbxReadInfo::setFileName(const std::string& fileName) {
    mOptions.fileName = fileName;
    return true;
}

const std::string& TnFbxReadInfo::getFileName() const { return mOptions.fileName; }

bool TnFbxReadInfo::setAnimationStackName(const std::string& animationStackName) {
    mOptions.animationStackName = animationStackName;
    return true;
}

// kept: the spelling
const std::string& TnFbxReadInfo::getAimationStackName() const { return mOptions.animationStackName; }

bool TnFbxReadInfo::haveAnimationStack() const { return !mOptions.animationStackName.empty(); }

bool TnFbxReadInfo::setGlobalTransform(bool globalTransform) {
    mOptions.globalTransform = globalTransform;
    return true;
}

bool TnFbxReadInfo::getGlobalTransform() const { return mOptions.globalTransform; }

bool TnFbxReadInfo::setTransformPoints(bool transformPoints) {
    mOptions.transformPoints = transformPoints;
    return true;
}

bool TnFbxReadInfo::getTransformPoints() const { return mOptions.transformPoints; }

bool TnFbxReadInfo::setUseSampleFPS(bool useSampleFPS) {
    mOptions.useSampleFPS = useSampleFPS;
    return true;
}

bool TnFbxReadInfo::getUseSampleFPS() const { return mOptions.useSampleFPS; }

bool TnFbxReadInfo::setSampleFPS(float sampleFPS) {
    mOptions.sampleFPS = sampleFPS;
    return true;
}

float TnFbxReadInfo::getSampleFPS() const { return mOptions.sampleFPS; }

bool TnFbxReadInfo::setFrame(float frame) {
    mOptions.frame = frame;
    return true;
}

float TnFbxReadInfo::getFrame() const { return mOptions.frame; }

bool TnFbxReadInfo::setComputeCameraRotation(bool computeCameraRotation) {
    mOptions.computeCameraRotation = computeCameraRotation;
    return true;
}

bool TnFbxReadInfo::getComputeCameraRotation() const { return mOptions.computeCameraRotation; }

bool TnFbxReadInfo::setAllObjects(bool allObjects) {
    mOptions.allObjects = allObjects;
    return true;
}

bool TnFbxReadInfo::getAllObjects() const { return mOptions.allObjects; }

bool TnFbxReadInfo::setObjectName(const std::string& objectName) {
    mOptions.objectName = objectName;
    return true;
}

const std::string& TnFbxReadInfo::getObjectName() const { return mOptions.objectName; }

bool TnFbxReadInfo::setObjectID(int objectID) {
    mOptions.objectID = objectID;
    return true;
}

int TnFbxReadInfo::getObjectID() const { return mOptions.objectID; }

bool TnFbxReadInfo::setFidelity(EFbxFidelity fidelity) {
    mOptions.fidelity = fidelity;
    return true;
}

EFbxFidelity TnFbxReadInfo::getFidelity() const { return mOptions.fidelity; }

} // namespace Tarnell::Fbx
