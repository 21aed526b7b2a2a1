// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Of the letters Y, W and T are certain, by who writes them where; the others follow the modes' names.
#include "schema/ShadingLetters.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr struct {
    FbxNode::EShadingMode mode;
    char letter;
} kShadingLetters[] = {
    {FbxNode::eHardShading, 'Y'},  {FbxNode::eWireFrame, 'W'},      {FbxNode::eFlatShading, 'F'},
    {FbxNode::eLightShading, 'L'}, {FbxNode::eTextureShading, 'T'}, {FbxNode::eFullShading, 'U'},
};

} // namespace

FbxNode::EShadingMode shadingModeOf(char letter) {
    for (const auto& row : kShadingLetters) {
        if (row.letter == letter)
            return row.mode;
    }
    return FbxNode::eHardShading;
}

char shadingLetterOf(FbxNode::EShadingMode mode) {
    for (const auto& row : kShadingLetters) {
        if (row.mode == mode)
            return row.letter;
    }
    return kShadingLetters[0].letter;
}

} // namespace detail
FBXSDK_NAMESPACE_END
