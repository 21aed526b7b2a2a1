// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A take: a collection of animation layers with its time spans.
#pragma once

#include <fbxsdk/FbxCollection.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxAnimStack : public FbxCollection {
    FBXSDK_OBJECT_DECLARE(FbxAnimStack, FbxCollection)

public:
    FbxPropertyT<FbxString> Description;
    FbxPropertyT<FbxTime> LocalStart, LocalStop, ReferenceStart, ReferenceStop;

    /// The two stored times; unrelated to the keys.
    [[nodiscard]] FbxTimeSpan GetLocalTimeSpan() const;
    void SetLocalTimeSpan(const FbxTimeSpan& pTimeSpan);
    [[nodiscard]] FbxTimeSpan GetReferenceTimeSpan() const;
    void SetReferenceTimeSpan(const FbxTimeSpan& pTimeSpan);
    void Reset();
};

FBXSDK_NAMESPACE_END
