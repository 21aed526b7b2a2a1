// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A null, or locator: an animated transform plus a display shape and its size.
#pragma once

#include "TnFbxExport.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx {

/// A null. It has no channels besides those of its transform.
class TARNELL_FBX_API TnFbxNull : public TnFbxTransform {
public:
    /// The display shape, numbered as in FBX.
    enum EFbxNullLookType : int {
        kFbxNullLookNone, ///< Not drawn.
        kFbxNullLookCross ///< Three lines that cross. The default.
    };

    static constexpr float kDefaultNullSize = 1.0f; ///< The size of a new null, scene units.

    /// A default transform, a cross of size 1.
    TnFbxNull();
    TnFbxNull(const TnFbxNull& other) = default;
    ~TnFbxNull() override;

    /// Copies the size and the look; the target keeps its own transform and name.
    TnFbxNull& operator=(const TnFbxNull& other);

    /// Restores a cross of size 1; the transform stays as it is. Always true.
    /// @{
    bool initNull();
    bool deleteNull();
    /// @}

    /// Stored without a check; always true.
    /// @{
    bool setNullSize(float size);
    bool setNullLookType(EFbxNullLookType lookType);
    /// @}
    float getNullSize() const;                ///< Display size, scene units. Default 1.
    EFbxNullLookType getNullLookType() const; ///< Default cross.

private:
    struct Properties {
        float size = kDefaultNullSize;
        EFbxNullLookType lookType = kFbxNullLookCross;
    };

    Properties mProperties;
};

} // namespace Tarnell::Fbx
