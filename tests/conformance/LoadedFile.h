// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file as the platform reads it: its nodes paired with those of the reference, values as stored, then the scene in
// the library's normal form (centimetres, Y up, right-handed).
#pragma once

#include "Corpus.h"
#include "Reference.h"

#include <FbxSdk.h>

#include <optional>
#include <string>
#include <vector>

namespace conformance {

/// A node of the scene, with what has to be read before the conversion changes it.
struct SceneNode {
    fbxsdk::FbxNode* node = nullptr;
    std::string name;             ///< with U+FFFD for invalid UTF-8, as references have it
    int parent = -1;              ///< index in the same list
    NamedNumbers curves;          ///< as stored: the sums over the layers, per frame of the reference
    NamedNumbers camera, light;   ///< as stored
    bool conversionMoves = false; ///< the conversion changes the node's own local values
};

/// Converted files have all nodes below the root, kind by kind, each kind in its order.
enum class FlatGroup { cameras, lights, transforms, nulls, meshes };
constexpr std::size_t kFlatGroups = 5;
struct FlatPlace {
    FlatGroup group;
    int index;
};
/// By the index in the reference; nothing for nodes that are not converted.
using FlatPlaces = std::vector<std::optional<FlatPlace>>;

/// For a node of a file, or for a converted one.
FlatGroup flatGroupOf(const fbxsdk::FbxNode& node, bool converted);

bool isWholeFrame(double frame);

class LoadedFile {
public:
    LoadedFile(const CorpusFile& file, const Reference& reference);
    /// A converted file.
    LoadedFile(const CorpusFile& file, const Reference& reference, const FlatPlaces& places);
    ~LoadedFile();
    LoadedFile(const LoadedFile&) = delete;
    LoadedFile& operator=(const LoadedFile&) = delete;

    [[nodiscard]] const CorpusFile& file() const { return mFile; }
    [[nodiscard]] const Reference& reference() const { return mReference; }
    [[nodiscard]] bool loaded() const { return mLoaded; }

    /// The scene, null when the file did not load.
    [[nodiscard]] fbxsdk::FbxScene* scene() const { return mScene; }
    [[nodiscard]] fbxsdk::FbxAnimStack* firstStack() const;
    /// The nodes below the root, parents before their children.
    [[nodiscard]] const std::vector<SceneNode>& nodes() const { return mNodes; }
    /// The counterpart of the reference's node at `index`; null when this scene has none.
    [[nodiscard]] const SceneNode* nodeOf(std::size_t index) const { return mNodeOfReference[index]; }
    /// Compares whole frames only: converted files have keys there.
    void compareWholeFrames() { mWholeFrames = true; }
    [[nodiscard]] bool compares(std::size_t frameIndex) const { return comparesFrame(mReference.frames[frameIndex]); }
    [[nodiscard]] bool comparesFrame(double frame) const { return !mWholeFrames || isWholeFrame(frame); }

    /// Whether the reference's node is one of the producer cameras, which this scene keeps outside of the tree.
    [[nodiscard]] bool besideTree(std::size_t index) const;

    /// Deforms the meshes; its own scene stays empty.
    [[nodiscard]] Tarnell::Fbx::FbxSdk& sdk() { return mSdk; }

private:
    void collectNodes(fbxsdk::FbxNode& parent, int parentIndex);
    void collectProducerCameras();
    void readStoredValues(SceneNode& node) const;
    void markMovedNodes();
    void normalise();
    void matchReference();
    void matchPlaces(const FlatPlaces& places);

    const CorpusFile& mFile;
    const Reference& mReference;
    Tarnell::Fbx::FbxSdk mSdk;
    fbxsdk::FbxManager* mManager = nullptr;
    fbxsdk::FbxScene* mScene = nullptr;
    bool mLoaded = false;
    bool mWholeFrames = false;
    std::vector<SceneNode> mNodes;
    std::vector<SceneNode> mProducers;
    std::vector<const SceneNode*> mNodeOfReference;
};

/// The frame's time in the file.
fbxsdk::FbxTime timeOfSeconds(double seconds);
/// The node's global transform at a time.
fbxsdk::FbxAMatrix worldMatrix(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time);
/// The node's geometric transform.
fbxsdk::FbxAMatrix geometricMatrix(const fbxsdk::FbxNode& node);
Matrix12 asMatrix12(const fbxsdk::FbxAMatrix& matrix);

} // namespace conformance
