// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Managers on different threads share nothing.
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxImporter.h>
#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "support/TemporaryFolder.h"

namespace {

using namespace fbxsdk;

constexpr int kThreads = 4;
constexpr int kRounds = 20;
constexpr int kNodes = 200;

/// The results of a thread; compared on the main thread.
struct Findings {
    double sum = 0;
    int nodes = 0;
    double frameRate = 0;
    std::string stack;
};

template <class Work>
std::vector<Findings> onAllThreads(const Work& work) {
    std::vector<Findings> findings(kThreads);
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i)
        threads.emplace_back([&, i] { findings[static_cast<std::size_t>(i)] = work(i); });
    for (std::thread& thread : threads)
        thread.join();
    return findings;
}

TEST(FbxManagerThreads, BuildScenesAtTheSameTime) {
    const auto findings = onAllThreads([](int thread) {
        Findings found;
        for (int round = 0; round < kRounds; ++round) {
            FbxManager* manager = FbxManager::Create();
            FbxScene* scene = FbxScene::Create(manager, "");
            for (int i = 0; i < kNodes; ++i) {
                FbxNode* node = FbxNode::Create(manager, "node");
                node->LclTranslation.Set(FbxDouble3(thread, i, 0));
                FbxProperty::Create(node, FbxDoubleDT, "extra").Set(1.0);
                scene->GetNode(i / 2)->AddChild(node);
            }
            scene->GlobalCameraSettings().CreateProducerCameras();
            for (int i = 1; i <= kNodes; ++i)
                found.sum += scene->GetNode(i)->LclTranslation.Get()[0] +
                             scene->GetNode(i)->FindProperty("extra").Get<FbxDouble>();
            found.nodes = scene->GetNodeCount();
            manager->Destroy();
        }
        return found;
    });

    for (int i = 0; i < kThreads; ++i) {
        EXPECT_EQ(findings[static_cast<std::size_t>(i)].nodes, 1 + kNodes + 8);
        EXPECT_EQ(findings[static_cast<std::size_t>(i)].sum, (i + 1.0) * kNodes * kRounds);
    }
}

TEST(FbxManagerThreads, HaveATimeModeEach) {
    constexpr FbxTime::EMode kModes[kThreads] = {FbxTime::eFrames24, FbxTime::ePAL, FbxTime::eFrames60,
                                                 FbxTime::eFrames120};
    constexpr double kRates[kThreads] = {24, 25, 60, 120};
    FbxTime::SetGlobalTimeMode(FbxTime::eFrames50);

    const auto findings = onAllThreads([&](int thread) {
        FbxManager* manager = FbxManager::Create();
        FbxScene* scene = FbxScene::Create(manager, "");
        scene->GetGlobalSettings().SetTimeMode(kModes[thread]);
        Findings found;
        std::this_thread::yield();
        found.frameRate = FbxTime::GetFrameRate(FbxTime::eDefaultMode);
        manager->Destroy();
        return found;
    });

    for (int i = 0; i < kThreads; ++i)
        EXPECT_EQ(findings[static_cast<std::size_t>(i)].frameRate, kRates[i]);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eDefaultMode), 50.0);
    FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode);
}

TEST(FbxManagerThreads, ReadTheSameFileAtTheSameTime) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("scene.fbx", R"(; FBX 7.4.0 project file
Objects:  {
	Model: 200, "Model::node", "Null" {
		Properties70:  {
			P: "Lcl Translation", "Lcl Translation", "", "A",1,2,3
		}
	}
	AnimationStack: 400, "AnimStack::Take 001", "" {
	}
}
Connections:  {
	C: "OO",200,0
}
)");

    const auto findings = onAllThreads([&](int) {
        Findings found;
        for (int round = 0; round < kRounds; ++round) {
            FbxManager* manager = FbxManager::Create();
            FbxScene* scene = FbxScene::Create(manager, "");
            FbxImporter* importer = FbxImporter::Create(manager, "");
            if (importer->Initialize(file.c_str()) && importer->Import(scene)) {
                found.nodes = scene->GetNodeCount();
                found.sum += scene->GetNode(1)->LclTranslation.Get()[2];
                found.stack = scene->GetCurrentAnimationStack()->GetName();
            }
            manager->Destroy();
        }
        return found;
    });

    for (const Findings& found : findings) {
        EXPECT_EQ(found.nodes, 2);
        EXPECT_EQ(found.sum, 3.0 * kRounds);
        EXPECT_EQ(found.stack, "Take 001");
    }
}

TEST(FbxManagerThreads, FailOnOneThreadWithoutASentenceOnAnother) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("fine.fbx", "; FBX 7.4.0 project file\nObjects:  {\n}\n");

    const auto findings = onAllThreads([&](int thread) {
        Findings found;
        FbxManager* manager = FbxManager::Create();
        FbxImporter* importer = FbxImporter::Create(manager, "");
        const std::string name = thread % 2 == 0 ? file : folder.file("missing.fbx");
        found.nodes = importer->Initialize(name.c_str()) ? 1 : 0;
        found.stack = importer->GetStatus().GetErrorString();
        manager->Destroy();
        return found;
    });

    for (int i = 0; i < kThreads; ++i) {
        const Findings& found = findings[static_cast<std::size_t>(i)];
        EXPECT_EQ(found.nodes, i % 2 == 0 ? 1 : 0);
        EXPECT_EQ(found.stack.empty(), i % 2 == 0) << found.stack;
    }
}

} // namespace
