// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A manager with a scene, freed after the test.
#pragma once

#include <gtest/gtest.h>

#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxScene.h>

class SceneFixture : public testing::Test {
protected:
    SceneFixture() : manager(fbxsdk::FbxManager::Create()), scene(fbxsdk::FbxScene::Create(manager, "scene")) {}
    ~SceneFixture() override { manager->Destroy(); }

    template <class T>
    T* make(const char* name = "") {
        return T::Create(scene, name);
    }

    fbxsdk::FbxManager* manager;
    fbxsdk::FbxScene* scene;
};
