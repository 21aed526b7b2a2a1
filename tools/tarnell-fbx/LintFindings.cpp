// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The traversal for the checks of the rules, take by take, and their findings.
#include <algorithm>
#include <iterator>
#include <map>
#include <set>
#include <tuple>
#include <unordered_map>
#include <unordered_set>

#include <fbxsdk/extensions/FileFacts.h>

#include "LintChecks.h"
#include "SceneFacts.h"

namespace tool {
namespace {

void addChannels(LintContext& context) {
    const TakeLayers layers(context.stacks);
    context.channelsByTake.resize(std::max<std::size_t>(context.stacks.size(), 1));
    for (const FbxObject* object : context.objects) {
        for (const FbxProperty& property : propertiesOf(*object))
            for (TakeChannel& keyed : keyedChannels(property, layers))
                context.channelsByTake[keyed.take].push_back({object, std::move(keyed.channel)});
    }
}

LintContext contextOf(const std::string& file, const SceneFile& opened) {
    LintContext context{file, opened, {}, {}, {}, {}, {}, {}, {}, {}, {}, {}, {}};
    FbxScene& scene = opened.scene();
    for (int i = 0; i < scene.GetSrcObjectCount<FbxAnimStack>(); ++i) {
        context.stacks.push_back(scene.GetSrcObject<FbxAnimStack>(i));
        context.takes.push_back(takeFacts(opened, context.stacks.back()));
    }
    context.nodes = nodesInOrder(scene);
    context.objects = extensions::objectsOf(scene);
    for (FbxObject* object : context.objects)
        if (auto* mesh = FbxCast<FbxMesh>(object))
            context.meshes.push_back(mesh);
    addChannels(context);
    return context;
}

/// The objects that cameras depend on: their nodes, attributes and targets, with all ancestors.
std::unordered_set<const FbxObject*> cameraSources(const std::vector<TreeNode>& nodes) {
    std::unordered_set<const FbxObject*> sources;
    const auto addWithParents = [&sources](const FbxNode* node) {
        for (; node && sources.insert(node).second; node = node->GetParent()) {
        }
    };
    for (const TreeNode& each : nodes) {
        if (!each.node->GetCamera())
            continue;
        sources.insert(each.node->GetCamera());
        for (const FbxNode* node :
             {static_cast<const FbxNode*>(each.node), static_cast<const FbxNode*>(each.node->GetTarget()),
              static_cast<const FbxNode*>(each.node->GetTargetUp())})
            addWithParents(node);
    }
    return sources;
}

/// Makes one take after the other the current one.
class TakeVisitor {
public:
    explicit TakeVisitor(LintContext& context) : mContext(context), mCameras(context.fileName, context.file) {
        if (context.takes.size() > 1)
            mCameraSources = cameraSources(context.nodes);
    }

    /// From here on the checks see this take; a default in a file without takes.
    void enter(std::size_t index) {
        mContext.take = mContext.takes.empty() ? takeFacts(mContext.file, nullptr) : mContext.takes[index];
        mContext.channels = &mContext.channelsByTake[index];
        mContext.unreadable.clear();
        if (!mContext.stacks.empty())
            mContext.scene().SetCurrentAnimationStack(mContext.stacks[index]);
        if (index == 0) {
            readCameras("");
            mFirst = mContext.cameras;
            mFirstIsUnreadable = !mContext.unreadable.empty();
        } else if (!mayHaveOtherCameras(index)) {
            mContext.cameras = mFirst;
        } else if (isReachable(index)) {
            readCameras(mContext.take.name);
        } else { // it cannot be selected by its name
            mContext.cameras = std::make_shared<CameraList>();
        }
    }

private:
    /// Whether the cameras of the take may differ from those of the first one, or be unreadable.
    [[nodiscard]] bool mayHaveOtherCameras(std::size_t index) const {
        constexpr long long kManyFrames = 1 << 20;
        return mFirstIsUnreadable || drivesCameras(0) || drivesCameras(index) ||
               mContext.take.lastFrame - mContext.take.firstFrame > kManyFrames;
    }

    [[nodiscard]] bool drivesCameras(std::size_t index) const {
        const std::vector<KeyedChannel>& channels = mContext.channelsByTake[index];
        return std::any_of(channels.begin(), channels.end(),
                           [this](const KeyedChannel& keyed) { return mCameraSources.contains(keyed.object); });
    }

    [[nodiscard]] bool isReachable(std::size_t index) const {
        const std::string& name = mContext.take.name;
        return !name.empty() &&
               std::none_of(mContext.takes.begin(), mContext.takes.begin() + static_cast<std::ptrdiff_t>(index),
                            [&name](const TakeFacts& take) { return take.name == name; });
    }

    void readCameras(const std::string& take) {
        mContext.cameras = std::make_shared<CameraList>();
        try {
            mContext.cameras = std::make_shared<CameraList>(mCameras.read(take));
        } catch (const Unreadable& reason) {
            mContext.unreadable = reason.what();
        }
    }

    LintContext& mContext;
    CameraReader mCameras;
    std::unordered_set<const FbxObject*> mCameraSources;
    std::shared_ptr<const CameraList> mFirst;
    bool mFirstIsUnreadable = false;
};

/// Restores the current take of the scene.
class TakeRestorer {
public:
    explicit TakeRestorer(FbxScene& scene) : mScene(scene), mTake(scene.GetCurrentAnimationStack()) {}
    ~TakeRestorer() { mScene.SetCurrentAnimationStack(mTake); }
    TakeRestorer(const TakeRestorer&) = delete;
    TakeRestorer& operator=(const TakeRestorer&) = delete;

private:
    FbxScene& mScene;
    FbxAnimStack* mTake;
};

/// Merges the findings of takes: one that holds in several becomes one with the names of these.
class TakeFindings {
public:
    void add(std::vector<Finding> found, const TakeFacts& take) { add(std::move(found), {&take}); }
    /// The same of findings that hold in several.
    void add(std::vector<Finding> found, const std::vector<const TakeFacts*>& takes) {
        std::map<Key, int> seen; // equal findings of one take stay separate
        for (Finding& finding : found) {
            Key key{finding.rule, finding.object, finding.text, 0};
            std::get<3>(key) = seen[key]++;
            const auto [known, isNew] = mPlaces.try_emplace(std::move(key), mFindings.size());
            if (isNew)
                mFindings.push_back(std::move(finding));
            for (const TakeFacts* take : takes)
                if (take->exists)
                    mFindings[known->second].takes.push_back(take->name);
        }
    }
    std::vector<Finding> take() { return std::move(mFindings); }

private:
    using Key = std::tuple<const LintRule*, std::string, std::string, int>;
    std::map<Key, std::size_t> mPlaces;
    std::vector<Finding> mFindings;
};

void append(std::vector<Finding> found, std::vector<Finding>& findings) {
    findings.insert(findings.end(), std::make_move_iterator(found.begin()), std::make_move_iterator(found.end()));
}

/// The findings of the checks of the file, or of those of the current take.
std::vector<Finding> findingsOf(const LintContext& context, const std::vector<std::string>& ids,
                                LintCheck* LintRule::*check) {
    LintReport report;
    for (const LintRule& rule : lintRules()) {
        if (!(rule.*check) || (!ids.empty() && std::find(ids.begin(), ids.end(), rule.id) == ids.end()))
            continue;
        report.rule = &rule;
        (rule.*check)(context, report);
    }
    return std::move(report.findings);
}

/// Which nodes the keys of a take move, themselves or one above them, as indices in the order of the tree. All others
/// are the same in every take of that kind, so that they are checked once.
class MovedNodes {
public:
    explicit MovedNodes(const LintContext& context) : mTakes(context.nodes.size()) {
        for (std::size_t i = 0; i < context.nodes.size(); ++i)
            mIndices.emplace(context.nodes[i].node, i);
        for (std::size_t take = 0; take < context.channelsByTake.size(); ++take) {
            std::set<std::size_t> moved;
            for (const KeyedChannel& keyed : context.channelsByTake[take])
                addNodesOf(*keyed.object, moved);
            for (const std::size_t node : moved)
                mTakes[node].push_back(take);
            mNodes.emplace_back(moved.begin(), moved.end());
        }
    }

    [[nodiscard]] const std::vector<std::size_t>& in(std::size_t take) const { return mNodes[take]; }
    [[nodiscard]] bool isMoved(std::size_t node, std::size_t take) const {
        return std::binary_search(mTakes[node].begin(), mTakes[node].end(), take);
    }
    [[nodiscard]] bool isEverMoved(std::size_t node) const { return !mTakes[node].empty(); }

private:
    void addNodesOf(const FbxObject& object, std::set<std::size_t>& moved) const {
        if (const auto* node = FbxCast<FbxNode>(&object))
            return addBelow(*node, moved);
        const auto* attribute = FbxCast<FbxNodeAttribute>(&object);
        for (int i = 0; attribute && i < attribute->GetNodeCount(); ++i)
            addBelow(*attribute->GetNode(i), moved);
    }

    void addBelow(const FbxNode& top, std::set<std::size_t>& moved) const {
        std::vector<const FbxNode*> pending{&top};
        while (!pending.empty()) {
            const FbxNode* node = pending.back();
            pending.pop_back();
            const auto known = mIndices.find(node);
            if (known == mIndices.end() || !moved.insert(known->second).second)
                continue;
            for (int i = 0; i < node->GetChildCount(); ++i)
                pending.push_back(node->GetChild(i));
        }
    }

    std::unordered_map<const FbxNode*, std::size_t> mIndices;
    std::vector<std::vector<std::size_t>> mNodes; ///< by take
    std::vector<std::vector<std::size_t>> mTakes; ///< by node
};

/// The checks of all takes of a file with several: of a take its channels, its cameras and the nodes that it moves, and
/// of each node once how it is in the takes that do not move it.
class TakeChecks {
public:
    TakeChecks(LintContext& context, const std::vector<std::string>& ids)
        : mContext(context), mIds(ids), mMoved(context), mNodes(context.nodes) {
        for (std::size_t i = 0; i < mNodes.size(); ++i)
            mPending.push_back(i);
    }

    /// The take must be the current one.
    void check(std::size_t take) {
        select(mMoved.in(take));
        mFindings.add(run(), mContext.take);
        checkAtRest(take);
    }
    std::vector<Finding> take() { return mFindings.take(); }

private:
    void checkAtRest(std::size_t take) {
        // Only the checks of nodes find something.
        const std::vector<KeyedChannel> noChannels;
        mContext.channels = &noChannels;
        mContext.cameras = std::make_shared<CameraList>();
        mContext.unreadable.clear();
        std::vector<std::size_t> still, left;
        for (const std::size_t node : mPending) {
            if (mMoved.isMoved(node, take)) {
                left.push_back(node);
            } else if (!mMoved.isEverMoved(node)) {
                still.push_back(node);
            } else {
                select({node});
                if (std::vector<Finding> found = run(); !found.empty())
                    mFindings.add(std::move(found), takesAtRest(node));
            }
        }
        mPending = std::move(left);
        if (still.empty())
            return;
        select(still);
        if (std::vector<Finding> found = run(); !found.empty())
            mFindings.add(std::move(found), takesAtRest(still.front()));
    }

    void select(const std::vector<std::size_t>& nodes) {
        mContext.nodes.clear();
        for (const std::size_t node : nodes)
            mContext.nodes.push_back(mNodes[node]);
    }
    [[nodiscard]] std::vector<Finding> run() const { return findingsOf(mContext, mIds, &LintRule::checkInTake); }

    [[nodiscard]] std::vector<const TakeFacts*> takesAtRest(std::size_t node) const {
        std::vector<const TakeFacts*> takes;
        for (std::size_t take = 0; take < mContext.takes.size(); ++take)
            if (!mMoved.isMoved(node, take))
                takes.push_back(&mContext.takes[take]);
        return takes;
    }

    LintContext& mContext;
    const std::vector<std::string>& mIds;
    MovedNodes mMoved;
    std::vector<TreeNode> mNodes;      ///< all
    std::vector<std::size_t> mPending; ///< whose values at rest no take has shown yet
    TakeFindings mFindings;
};

} // namespace

std::string nameOf(const FbxObject& object) {
    const auto* attribute = FbxCast<FbxNodeAttribute>(&object);
    return attribute && attribute->GetNodeCount() > 0 ? attribute->GetNode(0)->GetName() : object.GetName();
}

void forEachObjectRecord(const extensions::RecordFile& file,
                         const std::function<void(const extensions::FileRecord&)>& work) {
    for (extensions::FileRecord top = file.first(); top; top = top.nextSibling()) {
        work(top); // before 6.0 objects are at the top level
        for (extensions::FileRecord record = top.firstChild(); top.name() == "Objects" && record;
             record = record.nextSibling())
            work(record);
    }
}

std::string plainName(std::string_view name) {
    const std::size_t binary = name.find(std::string_view("\0\x01", 2)), colons = name.find("::");
    return std::string(binary != name.npos   ? name.substr(0, binary)
                       : colons != name.npos ? name.substr(colons + 2)
                                             : name);
}

const extensions::RecordFile& LintContext::records() const {
    FbxStatus status;
    if (!openedRecords)
        openedRecords = extensions::RecordFile::open(fileName.c_str(), status);
    if (!openedRecords)
        throw Unreadable(status.GetErrorString());
    return *openedRecords;
}

FbxTime LintContext::firstMoment() const {
    FbxTime time;
    time.SetSecondDouble(static_cast<double>(take.firstFrame) / take.frameRate);
    return time;
}

FbxAMatrix LintContext::worldOf(FbxNode& node) const { return node.EvaluateGlobalTransform(firstMoment()); }

std::string Finding::sentence(std::size_t takeCount) const {
    if (takes.empty() || takes.size() == takeCount)
        return text;
    std::string names;
    for (const std::string& name : takes)
        names += (names.empty() ? "" : ", ") + inQuotes(name);
    return text + (takes.size() == 1 ? " (in take " : " (in takes ") + names + ')';
}

LintFindings lintFindings(const std::string& file, const SceneFile& opened, const std::vector<std::string>& ids) {
    const TakeRestorer restorer(opened.scene());
    LintContext context = contextOf(file, opened);
    TakeVisitor visitor(context);
    visitor.enter(0);
    LintFindings findings{findingsOf(context, ids, &LintRule::check), context.takes.size()};
    if (context.takes.size() < 2) {
        TakeFindings inTake;
        inTake.add(findingsOf(context, ids, &LintRule::checkInTake), context.take);
        append(inTake.take(), findings.all);
    } else {
        TakeChecks inTakes(context, ids);
        for (std::size_t take = 0; take < context.takes.size(); ++take) {
            if (take > 0)
                visitor.enter(take);
            inTakes.check(take);
        }
        append(inTakes.take(), findings.all);
    }
    std::stable_sort(findings.all.begin(), findings.all.end(),
                     [](const Finding& a, const Finding& b) { return a.rule < b.rule; });
    return findings;
}

} // namespace tool
