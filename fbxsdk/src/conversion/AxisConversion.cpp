// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converting a scene from one axis system to another: the nodes below the root are rotated, so that every global matrix
// is the old one expressed in the new system. The rotation is added to the pre-rotation, so rotation curves stay.
#include <array>
#include <cmath>
#include <string>

#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "conversion/AnimatedValues.h"
#include "conversion/ClusterBinding.h"
#include "core/Rotation.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::SignedPermutation;

/// One axis of a system: which coordinate, and its direction.
struct SignedAxis {
    int index;
    int sign;
};

SignedAxis upAxis(const FbxAxisSystem& system) {
    int sign = 1;
    const int up = static_cast<int>(system.GetUpVector(sign));
    return {up - 1, sign};
}

SignedAxis frontAxis(const FbxAxisSystem& system) {
    int sign = 1;
    const bool even = system.GetFrontVector(sign) == FbxAxisSystem::eParityEven;
    // Of the two axes other than the up axis, in the order X, Y, Z, even is the first and odd the second.
    constexpr std::array<std::array<int, 2>, 3> kOthers = {{{1, 2}, {0, 2}, {0, 1}}};
    const auto& others = kOthers[static_cast<std::size_t>(upAxis(system).index)];
    return {even ? others[0] : others[1], sign};
}

/// Up × front, as a signed axis: the third axis of a right-handed system.
SignedAxis crossed(const SignedAxis& up, const SignedAxis& front) {
    const bool cyclic = (up.index + 1) % 3 == front.index;
    return {3 - up.index - front.index, up.sign * front.sign * (cyclic ? 1 : -1)};
}

/// The proper rotation that maps the source's up and front to the target's. A difference in handedness is ignored: it
/// would need a reflection, which only a conversion of all geometry can apply.
SignedPermutation turnBetween(const FbxAxisSystem& source, const FbxAxisSystem& target) {
    const std::array<SignedAxis, 2> from = {upAxis(source), frontAxis(source)};
    const std::array<SignedAxis, 2> to = {upAxis(target), frontAxis(target)};
    SignedPermutation turn;
    const auto carry = [&](const SignedAxis& a, const SignedAxis& b) {
        turn.source[static_cast<std::size_t>(b.index)] = a.index;
        turn.sign[static_cast<std::size_t>(b.index)] = a.sign * b.sign;
    };
    carry(from[0], to[0]);
    carry(from[1], to[1]);
    carry(crossed(from[0], from[1]), crossed(to[0], to[1]));
    return turn;
}

FbxVector4 turned(const FbxVector4& vector, const SignedPermutation& turn) {
    FbxVector4 result;
    for (int i = 0; i < 3; ++i) {
        const auto row = static_cast<std::size_t>(i);
        result[i] = vector[turn.source[row]] * turn.sign[row];
    }
    return result;
}

FbxAMatrix matrixOf(const SignedPermutation& turn) {
    FbxAMatrix matrix;
    for (int row = 0; row < 3; ++row) {
        FbxVector4 axis(0, 0, 0);
        axis[row] = 1.0;
        const FbxVector4 image = turned(axis, turn);
        for (int column = 0; column < 3; ++column)
            matrix[row][column] = image[column];
    }
    return matrix;
}

/// Pre-rotation M Rpre. Where rotation was not active, settings without effect are cleared before it is activated.
void turnRotation(FbxNode& node, const FbxAMatrix& turn) {
    constexpr auto kSet = FbxNode::eSourcePivot;
    FbxAMatrix before;
    if (node.GetRotationActive() && !node.GetRotationSpaceForLimitOnly(kSet)) {
        before = detail::rotationMatrix(node.GetPreRotation(kSet), FbxEuler::eOrderXYZ);
    } else {
        node.SetPostRotation(kSet, FbxVector4(0, 0, 0));
        node.SetRotationOrder(kSet, FbxEuler::eOrderXYZ);
        node.SetRotationSpaceForLimitOnly(kSet, false);
    }
    node.SetPreRotation(kSet, (turn * before).GetR());
    node.SetRotationActive(true);
}

/// One bound of the translation: its value, and for each component whether it is active.
struct Bound {
    FbxDouble3 value;
    std::array<bool, 3> holds{};
};
constexpr std::array<const char*, 3> kComponentNames = {"X", "Y", "Z"};

Bound readBound(const FbxNode& node, const std::string& name) {
    Bound bound{node.FindProperty(name.c_str()).Get<FbxDouble3>(), {}};
    for (std::size_t i = 0; i < 3; ++i)
        bound.holds[i] = node.FindProperty((name + kComponentNames[i]).c_str()).Get<FbxBool>();
    return bound;
}

void writeBound(FbxNode& node, const std::string& name, const Bound& bound) {
    node.FindProperty(name.c_str()).Set(bound.value);
    for (std::size_t i = 0; i < 3; ++i)
        node.FindProperty((name + kComponentNames[i]).c_str()).Set(bool{bound.holds[i]});
}

/// The limits are rotated with the translation; where a component changes its sign, lower and upper are exchanged.
void turnTranslationLimits(FbxNode& node, const SignedPermutation& turn) {
    const std::array<Bound, 2> old = {readBound(node, "TranslationMin"), readBound(node, "TranslationMax")};
    std::array<Bound, 2> turned;
    for (std::size_t side = 0; side < 2; ++side) {
        for (std::size_t i = 0; i < 3; ++i) {
            const Bound& from = old[turn.sign[i] < 0 ? 1 - side : side];
            turned[side].value[static_cast<int>(i)] = from.value[turn.source[i]] * turn.sign[i];
            turned[side].holds[i] = from.holds[static_cast<std::size_t>(turn.source[i])];
        }
    }
    writeBound(node, "TranslationMin", turned[0]);
    writeBound(node, "TranslationMax", turned[1]);
}

/// M T Roff Rp … becomes T' Roff' Rp M …: the rotation offset compensates for the pivot.
void turnNode(FbxNode& node, const SignedPermutation& turn) {
    constexpr auto kSet = FbxNode::eSourcePivot;
    detail::permuteAnimated(node.LclTranslation, turn);
    turnTranslationLimits(node, turn);
    turnRotation(node, matrixOf(turn));
    const FbxVector4 pivot = node.GetRotationPivot(kSet);
    const FbxVector4 offset = node.GetRotationOffset(kSet);
    FbxVector4 sum;
    for (int i = 0; i < 3; ++i)
        sum[i] = offset[i] + pivot[i];
    FbxVector4 moved = turned(sum, turn);
    for (int i = 0; i < 3; ++i)
        moved[i] -= pivot[i];
    node.SetRotationOffset(kSet, moved);
}

void turnCameras(FbxScene& scene, const SignedPermutation& turn) {
    for (FbxCamera* camera : detail::sourcesOf<FbxCamera>(scene)) {
        detail::permuteAnimated(camera->Position, turn);
        detail::permuteAnimated(camera->UpVector, turn);
        detail::permuteAnimated(camera->InterestPosition, turn);
    }
}

} // namespace

void FbxAxisSystem::ConvertChildren(FbxNode* pRoot, const FbxAxisSystem& pSrcSystem) const {
    const SignedPermutation turn = turnBetween(pSrcSystem, *this);
    if (!pRoot || turn.isIdentity())
        return;
    for (int i = 0; i < pRoot->GetChildCount(); ++i)
        turnNode(*pRoot->GetChild(i), turn);
}

void FbxAxisSystem::ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot) const {
    if (!pScene)
        return;
    FbxGlobalSettings& settings = pScene->GetGlobalSettings();
    const FbxAxisSystem source = settings.GetAxisSystem();
    if (source == *this)
        return;
    const SignedPermutation turn = turnBetween(source, *this);
    ConvertChildren(pFbxRoot, source);
    if (!turn.isIdentity()) {
        turnCameras(*pScene, turn);
        detail::transformBindMatrices(*pScene, matrixOf(turn));
    }
    settings.SetAxisSystem(*this);
}

void FbxAxisSystem::ConvertScene(FbxScene* pScene) const {
    ConvertScene(pScene, pScene ? pScene->GetRootNode() : nullptr);
}

FBXSDK_NAMESPACE_END
