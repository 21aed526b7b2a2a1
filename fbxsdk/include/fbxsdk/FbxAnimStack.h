// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxCollection.h>

FBXSDK_NAMESPACE_BEGIN

/// One animation of the scene (a take): a collection of layers, the base layer first. A new stack has no layer; nothing
/// is animated until it has one.
class FBXSDK_DLL FbxAnimStack : public FbxCollection {
    FBXSDK_OBJECT_DECLARE(FbxAnimStack, FbxCollection)

public:
    FbxPropertyT<FbxString> Description; ///< free text; empty
    FbxPropertyT<FbxTime> LocalStart,    ///< where the animation begins; zero
        LocalStop,                       ///< where it ends; zero
        ReferenceStart,                  ///< where the span for reference begins; zero
        ReferenceStop;                   ///< where it ends; zero

    /// The two stored times; unrelated to the keys.
    [[nodiscard]] FbxTimeSpan GetLocalTimeSpan() const;
    /// Sets LocalStart and LocalStop. A span from zero to zero is written as that of the keys.
    void SetLocalTimeSpan(const FbxTimeSpan& pTimeSpan);
    [[nodiscard]] FbxTimeSpan GetReferenceTimeSpan() const;  ///< The two stored times.
    void SetReferenceTimeSpan(const FbxTimeSpan& pTimeSpan); ///< Sets ReferenceStart and ReferenceStop.
    void Reset();                                            ///< Empties the description and both spans; layers stay.
};

FBXSDK_NAMESPACE_END
