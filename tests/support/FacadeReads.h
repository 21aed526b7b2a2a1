// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading through the facade as a host does, with the array owned by the test.
#pragma once

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace Tarnell::Fbx::test {

template <class Object>
struct FacadeReader;
template <>
struct FacadeReader<TnFbxCamera> {
    static constexpr auto kRead = &Fbx::getCameras;
};
template <>
struct FacadeReader<TnFbxLight> {
    static constexpr auto kRead = &Fbx::getLights;
};
template <>
struct FacadeReader<TnFbxNull> {
    static constexpr auto kRead = &Fbx::getNulls;
};
template <>
struct FacadeReader<TnFbxTransform> {
    static constexpr auto kRead = &Fbx::getTransforms;
};
template <>
struct FacadeReader<TnFbxMarker> {
    static constexpr auto kRead = &Fbx::getMarkers;
};
template <>
struct FacadeReader<TnFbxMesh> {
    static constexpr auto kRead = &Fbx::getMeshes;
};

/// Local transforms, points unchanged.
inline TnFbxReadInfo localRead(const std::string& fileName) {
    TnFbxReadInfo info;
    info.setFileName(fileName);
    info.setAnimationStackName("any name will do");
    info.setGlobalTransform(false);
    info.setTransformPoints(false);
    return info;
}

/// Every object of a kind in a file.
template <class Object>
struct FacadeRead {
    explicit FacadeRead(const std::string& fileName) : FacadeRead(localRead(fileName)) {}
    explicit FacadeRead(TnFbxReadInfo info) {
        Object* made = nullptr;
        EXPECT_TRUE((Fbx().*FacadeReader<Object>::kRead)(info, &made, count)) << lastError();
        objects.reset(made);
    }

    /// The object of that name; a new one, and a failure of the test, when there is none.
    Object& operator[](const std::string& name) {
        for (int i = 0; i < count; ++i)
            if (objects[static_cast<std::size_t>(i)].getName() == name)
                return objects[static_cast<std::size_t>(i)];
        ADD_FAILURE() << "there is no object \"" << name << '"';
        return none;
    }

    std::vector<std::string> names() const {
        std::vector<std::string> all;
        for (int i = 0; i < count; ++i)
            all.push_back(objects[static_cast<std::size_t>(i)].getName());
        return all;
    }

    int count = 0;
    std::unique_ptr<Object[]> objects;
    Object none;
};

} // namespace Tarnell::Fbx::test
