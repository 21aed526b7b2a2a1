// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time record: four plain fields and three divisions.
#include "TnFbxTime.h"

namespace Tarnell::Fbx {

TnFbxTime::TnFbxTime() : mFrame(kDefaultTimeFrame), mStartFrame(0), mEndFrame(0), mFrameRate(kDefaultTimeFrameRate) {}

TnFbxTime::~TnFbxTime() = default;

bool TnFbxTime::initTime() { return setTime(kDefaultTimeFrame, 0, 0, kDefaultTimeFrameRate); }

bool TnFbxTime::deleteTime() { return initTime(); }

bool TnFbxTime::setTime(float frame, int startFrame, int endFrame, float frameRate) {
    mFrame = frame;
    mStartFrame = startFrame;
    mEndFrame = endFrame;
    mFrameRate = frameRate;
    return true;
}

bool TnFbxTime::setStartFrame(int startFrame) {
    mStartFrame = startFrame;
    return true;
}

bool TnFbxTime::setEndFrame(int endFrame) {
    mEndFrame = endFrame;
    return true;
}

float TnFbxTime::getFrame() const { return mFrame; }

int TnFbxTime::getStartFrame() const { return mStartFrame; }

int TnFbxTime::getEndFrame() const { return mEndFrame; }

float TnFbxTime::getFrameRate() const { return mFrameRate; }

// kept: a rate of 0 is not guarded against; hosts get the result of the division
float TnFbxTime::getTime() const { return mFrame / mFrameRate; }

float TnFbxTime::getStartTime() const { return static_cast<float>(mStartFrame) / mFrameRate; }

float TnFbxTime::getEndTime() const { return static_cast<float>(mEndFrame) / mFrameRate; }

} // namespace Tarnell::Fbx
