// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx convert: what a file shows, read faithfully and written faithfully to another file.
#include <algorithm>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <memory>
#include <optional>
#include <set>
#include <system_error>

#include <stdlib.h> // mkdtemp

#include "Commands.h"
#include "ConvertLosses.h"
#include "Progress.h"
#include "SceneQueries.h"

#include "Fbx.h"
#include "FbxFaithful.h"
#include "TnFbxError.h"
#include "TnFbxWriteInfo.h"

namespace tool {
namespace {

using namespace Tarnell::Fbx;
namespace filesystem = std::filesystem;

constexpr const char* kStandardOutput = "standard output";

/// The objects of one kind.
template <class Object>
struct Objects {
    std::vector<std::unique_ptr<Object>> owned;
    std::vector<Object*> pointers; ///< as the facade takes them

    Object& add() {
        owned.push_back(std::make_unique<Object>());
        pointers.push_back(owned.back().get());
        return *owned.back();
    }
};

class Convert {
public:
    explicit Convert(const ConvertOptions& options) : mOptions(options), mLosses(options.kinds) {}

    /// False with the reason in lastError().
    bool read() {
        mProgress.say("reading " + mOptions.input);
        mLosses.addRecords(mOptions.input);
        TnFbxReadInfo info;
        info.setFileName(mOptions.input);
        info.setAnimationStackName(mOptions.stack);
        info.setGlobalTransform(!mOptions.local);
        info.setTransformPoints(false);
        info.setUseSampleFPS(mOptions.fps.has_value());
        if (mOptions.fps)
            info.setSampleFPS(*mOptions.fps);
        if (!done(mReader->load(info)))
            return false;
        mLosses.addScene(*mReader->getScene());
        mReader->setFrame(static_cast<float>(firstFrame()));
        const bool complete = done(mReader->makeMeshes()) && readNodes() && readFurtherPoints();
        addLosses();
        keepTimes();
        mMoving.clear();
        mReader.reset(); // the scene that is written takes as much memory
        return complete;
    }

    /// False with the reason in lastError().
    bool write(const std::string& file) {
        mProgress.say("writing " + mOptions.output);
        TnFbxWriteInfo info;
        info.setFidelity(kFbxFidelityFaithful);
        info.setComputeCameraRotation(false); // the rotations that were read determine the cameras' directions
        info.setFileName(file);
        info.setAnimationStackName(mStack);
        info.setFileFormat(mOptions.ascii);
        info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(mOptions.version));
        info.setFPS(static_cast<float>(mFrameRate));
        info.setAnimateMeshVertices(cachesPoints());
        info.setMayaVertexCacheFormat(mOptions.cache == PointCache::maya);
        setSpan(info);
        const bool written = done(Fbx().writeFile(info, mCameras.pointers, mLights.pointers, mTransforms.pointers,
                                                  mNulls.pointers, mMeshes.pointers));
        mProgress.hide();
        return written;
    }

    /// The losses: what is in the file that was read, and not in the one that is written.
    [[nodiscard]] const std::vector<std::string>& losses() const { return mLosses.sentences(); }
    /// The library's warnings.
    [[nodiscard]] const std::vector<std::string>& warnings() const { return mWarnings; }

private:
    [[nodiscard]] bool wants(const char* kind) const { return mLosses.wants(kind); }

    [[nodiscard]] bool cachesPoints() const { return mOptions.frames && mOptions.cache != PointCache::none; }
    [[nodiscard]] long long firstFrame() const {
        return mOptions.frames ? mOptions.frames->first : mReader->getFirstFrame();
    }

    /// Records the call's warnings.
    bool done(bool result) {
        for (const std::string& warning : lastWarnings())
            if (mKnownWarnings.insert(warning).second)
                mWarnings.push_back(warning);
        return result;
    }

    /// For each node the most specific object.
    bool readNodes() {
        for (const TreeNode& entry : nodesInOrder(*mReader->getScene())) {
            FbxNode& node = *entry.node;
            if (entry.isDetached || isProducer(node) || isSkewHelper(node))
                continue;
            const FbxNodeAttribute* attribute = node.GetNodeAttribute();
            if (!readNode(node, attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eNull))
                return false;
        }
        return true;
    }

    bool readNode(FbxNode& node, FbxNodeAttribute::EType type) {
        mMarkers += type == FbxNodeAttribute::eMarker ? 1 : 0;
        mBones += type == FbxNodeAttribute::eSkeleton ? 1 : 0;
        const bool isCamera = type == FbxNodeAttribute::eCamera || type == FbxNodeAttribute::eCameraStereo;
        if (isCamera && wants("cameras"))
            return done(mReader->read(node, mCameras.add()));
        if (type == FbxNodeAttribute::eLight && wants("lights"))
            return done(mReader->read(node, mLights.add()));
        if (type == FbxNodeAttribute::eNull && wants("nulls"))
            return done(mReader->read(node, mNulls.add()));
        if (type == FbxNodeAttribute::eMesh && wants("meshes"))
            return readMesh(node);
        return !wants("transforms") || done(mReader->read(node, mTransforms.add()));
    }

    bool readMesh(FbxNode& node) {
        TnFbxMesh& mesh = mMeshes.add();
        if (!done(mReader->read(node, mesh)))
            return false;
        const bool deforms = node.GetGeometry()->GetDeformerCount() > 0;
        if (deforms || moves(mesh))
            mMoving.emplace_back(&node, &mesh);
        const bool isInstance = !mKnownMeshes.insert(node.GetMesh()).second;
        mSplit += isInstance && (deforms || (cachesPoints() && moves(mesh))) ? 1 : 0;
        mDeforming += deforms ? 1 : 0;
        mWithoutPolygons += mesh.getNumberOfPolygons() < 1 ? 1 : 0;
        return true;
    }

    static bool moves(const TnFbxMesh& mesh) {
        for (int i = 0; i <= TnFbxTransform::kFbxTransformSkewZ; ++i)
            if (mesh.getTransformAnimated(static_cast<TnFbxTransform::EFbxTransformChannelType>(i)))
                return true;
        return false;
    }

    /// The points of moving meshes at all further frames.
    bool readFurtherPoints() {
        const long long last = cachesPoints() ? mOptions.frames->second : firstFrame();
        for (long long frame = firstFrame() + 1; frame <= last; ++frame) {
            mProgress.say("reading meshes, frame " + std::to_string(frame) + " of " + std::to_string(last));
            mReader->setFrame(static_cast<float>(frame));
            for (const auto& [node, mesh] : mMoving)
                if (!done(mReader->readPoints(*node, *mesh)))
                    return false;
        }
        return true;
    }

    void addLosses() {
        const bool still = !cachesPoints() && mReader->getFirstFrame() < mReader->getLastFrame();
        mLosses.add(still ? mDeforming : 0, "written as at the first frame (see --frames): deforming meshes");
        mLosses.add(mSplit, "written as a copy for each node: deforming meshes that several nodes share");
        mLosses.add(mWithoutPolygons, "written as points: meshes without polygons");
        if (wants("transforms")) {
            mLosses.add(mMarkers, "written as nulls without look, size and colour: markers");
            mLosses.add(mBones, "written as nulls: bones");
        } else {
            mLosses.add(mMarkers, "not written: markers");
            mLosses.add(mBones, "not written: bones");
        }
    }

    /// What the written file states about time.
    void keepTimes() {
        const FbxAnimStack* stack = mReader->getScene()->GetCurrentAnimationStack();
        mFrameRate = mReader->getFrameRate();
        mStack = stack ? stack->GetName() : "";
        const FbxTimeSpan span = stack ? stack->GetLocalTimeSpan() : FbxTimeSpan();
        if (span.GetStart() < span.GetStop()) // else the keys determine its length
            mSpan = {frameOf(span.GetStart()), frameOf(span.GetStop())};
    }

    [[nodiscard]] float frameOf(FbxTime time) const { return static_cast<float>(time.GetSecondDouble() * mFrameRate); }

    /// The span of the stack, to the fraction of a frame, or the frames of the point caches.
    void setSpan(TnFbxWriteInfo& info) const {
        if (mOptions.frames) {
            info.setStartFrame(static_cast<float>(mOptions.frames->first));
            info.setEndFrame(static_cast<float>(mOptions.frames->second));
        } else if (mSpan) {
            info.setStartFrame(mSpan->first);
            info.setEndFrame(mSpan->second);
        }
    }

    const ConvertOptions& mOptions;
    std::optional<FbxFaithful> mReader{std::in_place}; ///< until all is read
    std::string mStack;
    double mFrameRate = 0.0;
    std::optional<std::pair<float, float>> mSpan;
    Progress mProgress;
    Objects<TnFbxCamera> mCameras;
    Objects<TnFbxLight> mLights;
    Objects<TnFbxNull> mNulls;
    Objects<TnFbxTransform> mTransforms;
    Objects<TnFbxMesh> mMeshes;
    std::vector<std::pair<FbxNode*, TnFbxMesh*>> mMoving;
    std::set<const FbxMesh*> mKnownMeshes;
    int mMarkers = 0, mBones = 0, mDeforming = 0, mSplit = 0, mWithoutPolygons = 0;
    Losses mLosses;
    std::vector<std::string> mWarnings;
    std::set<std::string> mKnownWarnings;
};

/// The folder of the library for the point caches of a file.
filesystem::path cacheFolder(const filesystem::path& file) {
    return file.parent_path() / (file.stem().string() + "_fpc");
}

bool toStandardOutput(const ConvertOptions& options) { return options.output == "-"; }

bool writesCaches(const ConvertOptions& options) { return options.frames && options.cache != PointCache::none; }

/// Whether the name has the extension of another kind of file.
bool isOfAnotherKind(const std::string& output) {
    const std::string name = output.substr(output.find_last_of('/') + 1);
    const std::size_t dot = name.find_last_of('.');
    if (dot == std::string::npos)
        return false;
    std::string extension = name.substr(dot);
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; });
    return extension != ".fbx";
}

/// Why the output must not be written; empty when it may.
std::string refusal(const ConvertOptions& options) {
    if (toStandardOutput(options))
        return writesCaches(options) ? "cannot hold point caches; --cache none omits them" : "";
    if (isOfAnotherKind(options.output))
        return "the name of an FBX file must end with .fbx";
    std::error_code ignored;
    if (filesystem::equivalent(options.input, options.output, ignored))
        return "is also the input file";
    if (options.force)
        return {};
    if (filesystem::exists(options.output, ignored))
        return "exists; --force overwrites it";
    const filesystem::path caches = cacheFolder(options.output);
    if (writesCaches(options) && filesystem::exists(caches, ignored))
        return "its point caches exist in " + caches.string() + "; --force overwrites them";
    return {};
}

/// A temporary folder, removed with the object.
class TemporaryFolder {
public:
    TemporaryFolder() {
        // mkdtemp() replaces the letters X.
        std::string pattern = (filesystem::temp_directory_path() / "tarnell-fbx-XXXXXX").string();
        if (!::mkdtemp(pattern.data()))
            throw std::system_error(errno, std::generic_category(), pattern);
        mPath = pattern;
    }
    ~TemporaryFolder() {
        std::error_code ignored;
        filesystem::remove_all(mPath, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    [[nodiscard]] std::string file(const std::string& name) const { return (mPath / name).string(); }

private:
    filesystem::path mPath;
};

/// Writes the file, or all of it to standard output; false with the reason.
bool writeOut(Convert& conversion, const ConvertOptions& options, std::string& reason) {
    if (!toStandardOutput(options)) {
        const bool written = conversion.write(options.output);
        reason = lastError();
        return written;
    }
    const TemporaryFolder folder; // a file is written with seeks, and a pipe only forward
    const std::string file = folder.file("output.fbx");
    if (!conversion.write(file)) {
        reason = lastError();
        return false;
    }
    std::ifstream stream(file, std::ios::binary);
    std::cout << stream.rdbuf() << std::flush;
    reason = "cannot be written";
    return stream.good() && std::cout.good();
}

} // namespace

int convert(const ConvertOptions& options) {
    const std::string output = toStandardOutput(options) ? kStandardOutput : options.output;
    const std::string refused = refusal(options);
    if (!refused.empty()) {
        printError(output, refused);
        return kWrongUsage;
    }
    Convert conversion(options);
    if (!conversion.read()) {
        printError(options.input, lastError());
        return kUnreadable;
    }
    return guarded(output, [&]() -> int {
        std::string reason;
        const bool written = writeOut(conversion, options, reason);
        for (const std::string& loss : conversion.losses())
            printError(options.input, loss);
        for (const std::string& warning : conversion.warnings())
            printError(output, warning);
        const bool lossless = conversion.losses().empty() && conversion.warnings().empty();
        if (written)
            return options.strict && !lossless ? kLosses : kSuccess;
        printError(output, reason);
        return kUnreadable;
    });
}

} // namespace tool
