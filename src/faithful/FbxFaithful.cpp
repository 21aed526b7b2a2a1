// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "FbxFaithful.h"

#include "Reading.h"
#include "Scene.h"
#include "calls/LastError.h"

#include <string>

namespace Tarnell::Fbx {

struct FbxFaithful::File {
    TnFbxReadInfo info;
    faithful::Scene scene;
    bool hasMeshes = false;
};

namespace {

/// One call of the host, which fails for a fault of the file.
template <class Work>
bool call(const TnFbxReadInfo& info, const Work& work) {
    const detail::CallScope scope;
    return detail::failOnFault(info.getFileName(), [&] { return work() && detail::succeed(); });
}

} // namespace

FbxFaithful::FbxFaithful() : mFile(std::make_unique<File>()) {}
FbxFaithful::~FbxFaithful() = default;

bool FbxFaithful::load(const TnFbxReadInfo& info) {
    mFile->info = info;
    return call(info, [&] {
        return info.getFileName().empty() ? detail::fail("the read options have no file name")
                                          : mFile->scene.load(info);
    });
}

bool FbxFaithful::select(const TnFbxReadInfo& info) {
    return call(
        mFile->info,
        [&] {
            if (!mFile->scene.isLoaded())
                return detail::fail("no file is loaded");
            if (!mFile->scene.select(info))
                return false;
            const std::string fileName = mFile->info.getFileName();
            mFile->info = info;
            mFile->info.setFileName(fileName);
            return true;
        });
}

fbxsdk::FbxScene* FbxFaithful::getScene() const { return mFile->scene.isLoaded() ? &mFile->scene.scene() : nullptr; }

double FbxFaithful::getFrameRate() const { return mFile->scene.timeline().rate(); }
long long FbxFaithful::getFirstFrame() const { return mFile->scene.timeline().first(); }
long long FbxFaithful::getLastFrame() const { return mFile->scene.timeline().last(); }

bool FbxFaithful::setFrame(float frame) { return mFile->scene.setFrame(frame); }

bool FbxFaithful::makeMeshes() {
    return call(
        mFile->info,
        [&] {
            if (!mFile->hasMeshes) {
                faithful::triangulateSurfaces(mFile->scene);
                mFile->hasMeshes = true;
            }
            return true;
        });
}

template <class Object>
bool FbxFaithful::readAll(Object** objects, int& count) {
    *objects = nullptr;
    count = 0;
    return call(mFile->info, [&] {
        mFile->scene.forgetMemory();
        return faithful::readObjects(mFile->scene, mFile->info, objects, count);
    });
}

template <class Object>
bool FbxFaithful::read(fbxsdk::FbxNode& node, Object& object) {
    return call(
        mFile->info,
        [&] {
            object.setName(node.GetName());
            const bool isRead = faithful::readNode(mFile->scene, mFile->info, node, object);
            mFile->scene.warnings().report();
            mFile->scene.warnings().forget();
            return isRead;
        });
}

bool FbxFaithful::readPoints(fbxsdk::FbxNode& node, TnFbxMesh& mesh) {
    return call(
        mFile->info, [&] { return faithful::addPoints(mFile->scene, mFile->info, node, mesh); });
}

#define TARNELL_FBX_FAITHFUL(Object)                                                                                   \
    template bool FbxFaithful::readAll(Object**, int&);                                                                \
    template bool FbxFaithful::read(fbxsdk::FbxNode&, Object&);
TARNELL_FBX_FAITHFUL(TnFbxCamera)
TARNELL_FBX_FAITHFUL(TnFbxLight)
TARNELL_FBX_FAITHFUL(TnFbxMarker)
TARNELL_FBX_FAITHFUL(TnFbxMesh)
TARNELL_FBX_FAITHFUL(TnFbxNull)
TARNELL_FBX_FAITHFUL(TnFbxTransform)
#undef TARNELL_FBX_FAITHFUL

} // namespace Tarnell::Fbx
