// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time record of every animated channel and of every read and write: a current frame, a
// closed range of whole frames and the rate that turns them into seconds.
#pragma once

#include "TnFbxExport.h"

namespace Tarnell::Fbx {

/// A frame, a frame range and a frame rate, passed by value.
/// No invariant holds: the range may be inverted and the rate zero or negative; code that uses a record checks what it
/// needs.
/// need.
class TARNELL_FBX_API TnFbxTime {
public:
    static constexpr float kDefaultTimeFrame = 0.0f;      ///< The current frame of a new record.
    static constexpr float kDefaultTimeFrameRate = 24.0f; ///< Frames per second of a new record.

    /// Frame 0, range 0 to 0, 24 frames per second.
    TnFbxTime();
    TnFbxTime(const TnFbxTime& other) = default;
    ~TnFbxTime();
    TnFbxTime& operator=(const TnFbxTime& other) = default;

    /// Restores the state of a new record; always true.
    /// @{
    bool initTime();
    bool deleteTime();
    /// @}

    /// Stores its arguments without a check; always true. The frame and the rate change only together with the rest.
    /// @{
    bool setTime(float frame, int startFrame, int endFrame, float frameRate);
    bool setStartFrame(int startFrame);
    bool setEndFrame(int endFrame);
    /// @}

    float getFrame() const;     ///< The current frame, possibly fractional.
    int getStartFrame() const;  ///< First frame of the range.
    int getEndFrame() const;    ///< Last frame of the range, inclusive.
    float getFrameRate() const; ///< Frames per second.

    /// The current frame, the first or the last one in seconds: frame ÷ rate in single precision, with no rounding and
    /// no offset. A rate of 0 gives the infinity or the NaN of that division.
    /// @{
    float getTime() const;
    float getStartTime() const;
    float getEndTime() const;
    /// @}

private:
    float mFrame;
    int mStartFrame;
    int mEndFrame;
    float mFrameRate;
};

} // namespace Tarnell::Fbx
