// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Counts the nodes of a file through the installed platform alone.
#include <cstdio>

#include <fbxsdk.h>

int main(int argc, char** argv) {
    if (argc != 2)
        return 2;
    FbxManager* manager = FbxManager::Create();
    FbxImporter* importer = FbxImporter::Create(manager, "");
    FbxScene* scene = FbxScene::Create(manager, "");
    const bool read = importer->Initialize(argv[1], -1, nullptr) && importer->Import(scene);
    if (read)
        std::printf("%d\n", scene->GetRootNode()->GetChildCount(true));
    else
        std::fprintf(stderr, "%s\n", importer->GetStatus().GetErrorString());
    manager->Destroy();
    return read ? 0 : 1;
}
