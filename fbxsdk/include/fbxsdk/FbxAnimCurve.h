// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {
struct CurveKeys;
struct CurveState;
struct Document;
struct DocumentObject;
} // namespace detail

/// How a key leads to the next one. The interpolation, tangents and weights of a segment of the curve are those of the
/// key at its start.
struct FBXSDK_DLL FbxAnimCurveDef {
    /// Length of a tangent's handle, as a fraction of the segment.
    static constexpr float sDEFAULT_WEIGHT = 1.0F / 3.0F;
    static constexpr float sMIN_WEIGHT = 0.0001F;    ///< The shortest handle that applications offer.
    static constexpr float sMAX_WEIGHT = 0.99F;      ///< The longest handle that applications offer.
    static constexpr float sDEFAULT_VELOCITY = 0.0F; ///< No velocity.

    /// Where the slopes of a cubic key come from. The generic bits add to auto and user tangents.
    enum ETangentMode {
        eTangentAuto = 0x00000100,                               ///< from the adjacent keys, always up to date
        eTangentTCB = 0x00000200,                                ///< from tension, continuity and bias
        eTangentUser = 0x00000400,                               ///< from the slopes that the key holds
        eTangentGenericBreak = 0x00000800,                       ///< left and right slope may differ
        eTangentBreak = eTangentGenericBreak | eTangentUser,     ///< slopes of the key, which may differ
        eTangentAutoBreak = eTangentGenericBreak | eTangentAuto, ///< automatic slopes that may differ
        eTangentGenericClamp = 0x00001000,                       ///< flat where an adjacent key has the same value
        /// the slope of the line through both adjacent keys, without a bias
        eTangentGenericTimeIndependent = 0x00002000,
        /// as flat as needed to stay between the adjacent keys
        eTangentGenericClampProgressive = 0x00004000 | eTangentGenericTimeIndependent
    };
    /// How the curve runs from a key to the next one.
    enum EInterpolationType {
        eInterpolationConstant = 0x00000002, ///< holds one value and then jumps
        eInterpolationLinear = 0x00000004,   ///< a straight line
        eInterpolationCubic = 0x00000008     ///< a cubic with the slopes of both keys
    };
    /// Which handles of a segment have a length of their own; the others have sDEFAULT_WEIGHT.
    enum EWeightedMode {
        eWeightedNone = 0x00000000,                       ///< none
        eWeightedRight = 0x01000000,                      ///< the one at the key
        eWeightedNextLeft = 0x02000000,                   ///< the one at the next key
        eWeightedAll = eWeightedRight | eWeightedNextLeft ///< both
    };
    /// Which value a constant key holds until the next key.
    enum EConstantMode {
        eConstantStandard = 0x00000000, ///< its own
        eConstantNext = 0x00000100      ///< the next key's
    };
    /// Which sides of a segment have a velocity. Velocities are kept for files and do not change the curve.
    enum EVelocityMode {
        eVelocityNone = 0x00000000,                       ///< none
        eVelocityRight = 0x10000000,                      ///< the one at the key
        eVelocityNextLeft = 0x20000000,                   ///< the one at the next key
        eVelocityAll = eVelocityRight | eVelocityNextLeft ///< both
    };
    /// Which handles applications show.
    enum ETangentVisibility {
        eTangentShowNone = 0x00000000,                          ///< none
        eTangentShowLeft = 0x00100000,                          ///< the left one
        eTangentShowRight = 0x00200000,                         ///< the right one
        eTangentShowBoth = eTangentShowLeft | eTangentShowRight ///< both
    };
    /// The numbers that a key holds besides its value. "Right" is the side of the key itself, "next left" the left side
    /// of the key after it. TCB tangents use the first three for their own parameters.
    enum EDataIndex {
        eRightSlope = 0,       ///< value per second; of an auto tangent a bias in percent toward the key after it
        eNextLeftSlope = 1,    ///< value per second; of an auto tangent a bias in percent toward the key before it
        eWeights = 2,          ///< the first of the two weights
        eRightWeight = 2,      ///< length of the handle, 0 to 1 of the segment
        eNextLeftWeight = 3,   ///< length of the handle, 0 to 1 of the segment
        eVelocity = 4,         ///< the first of the two velocities
        eRightVelocity = 4,    ///< stored, of no effect
        eNextLeftVelocity = 5, ///< stored, of no effect
        eTCBTension = 0,       ///< 0 for none
        eTCBContinuity = 1,    ///< 0 for none
        eTCBBias = 2           ///< 0 for none
    };
};

/// The interface of all curves over time. Values are single precision, times whole ticks; there is at most one key per
/// time, and keys are sorted by time. A curve is used by one thread at a time, also for evaluation: it caches
/// the place of the last evaluation.
class FBXSDK_DLL FbxAnimCurveBase : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxAnimCurveBase, FbxObject)

public:
    /// What a curve does before its first and after its last key.
    enum EExtrapolationType {
        eConstant = 1,          ///< it holds the value of that key; the default
        eRepetition = 2,        ///< the keys repeated
        eMirrorRepetition = 3,  ///< the keys repeated, every other time backward
        eKeepSlope = 4,         ///< continued as a straight line
        eRelativeRepetition = 5 ///< the keys repeated, each time from the last value
    };

    virtual void KeyClear() = 0;                       ///< Removes all keys; default value and extrapolation stay.
    [[nodiscard]] virtual int KeyGetCount() const = 0; ///< 0 for a new curve.
    /// The index of the key at that time, which is created when there is none (value 0, cubic, auto tangents); *pLast
    /// gets it too.
    virtual int KeyAdd(FbxTime pTime, int* pLast = nullptr) = 0;
    virtual bool KeyRemove(int pIndex) = 0; ///< False out of range.
    /// Zero for an index out of range.
    [[nodiscard]] virtual FbxTime KeyGetTime(int pKeyIndex) const = 0;
    /// Moves the key, which may change its index; a key that is already at that time is replaced by it. No effect out
    /// of range.
    virtual void KeySetTime(int pKeyIndex, FbxTime pTime) = 0;
    /// The value at the time: the default value without keys, extrapolated before and after them. `pLast` is a search
    /// hint that the caller keeps between calls.
    [[nodiscard]] virtual float Evaluate(FbxTime pTime, int* pLast = nullptr) = 0;
    /// The value at a fractional key index: 1.5 is half way in time from key 1 to key 2. Held at both ends.
    [[nodiscard]] virtual float EvaluateIndex(double pIndex) = 0;
    virtual void SetPreExtrapolation(EExtrapolationType pExtrapolation) = 0;   ///< Of the time before the first key.
    [[nodiscard]] virtual EExtrapolationType GetPreExtrapolation() const = 0;  ///< eConstant by default.
    virtual void SetPreExtrapolationCount(unsigned long pCount) = 0;           ///< Repetitions of the keys; 0: endless.
    [[nodiscard]] virtual unsigned long GetPreExtrapolationCount() const = 0;  ///< 0 (endless) by default.
    virtual void SetPostExtrapolation(EExtrapolationType pExtrapolation) = 0;  ///< Of the time after the last key.
    [[nodiscard]] virtual EExtrapolationType GetPostExtrapolation() const = 0; ///< eConstant by default.
    virtual void SetPostExtrapolationCount(unsigned long pCount) = 0;          ///< Repetitions of the keys; 0: endless.
    [[nodiscard]] virtual unsigned long GetPostExtrapolationCount() const = 0; ///< 0 (endless) by default.
    /// First to last key. False without keys; the span is untouched then.
    virtual bool GetTimeInterval(FbxTimeSpan& pTimeInterval) const = 0;
};

/// A curve of keys, which drives one component of a property through a channel of a curve node.
class FBXSDK_DLL FbxAnimCurve : public FbxAnimCurveBase {
    FBXSDK_OBJECT_DECLARE(FbxAnimCurve, FbxAnimCurveBase)

public:
    /// Creates a curve in the scene; null when the scene is null. It drives nothing until it is connected to a channel.
    static FbxAnimCurve* Create(FbxScene* pContainer, const char* pName);

    /// Begins a series of edits. Edits outside of one work too: auto tangents follow the keys in any case.
    virtual void KeyModifyBegin();
    /// Ends a series of edits; unused memory is released.
    virtual void KeyModifyEnd();

    void KeyClear() override;         ///< Removes all keys; default value and extrapolation stay.
    int KeyGetCount() const override; ///< 0 for a new curve.
    /// As in the base class. Appending keys in order of time is fastest.
    int KeyAdd(FbxTime pTime, int* pLast = nullptr) override;
    bool KeyRemove(int pIndex) override;                    ///< False out of range.
    FbxTime KeyGetTime(int pKeyIndex) const override;       ///< Zero out of range.
    void KeySetTime(int pKeyIndex, FbxTime pTime) override; ///< As in the base class.
    /// As in the base class; consecutive calls in order of time are fast without a hint.
    float Evaluate(FbxTime pTime, int* pLast = nullptr) override;
    float EvaluateIndex(double pIndex) override;                           ///< As in the base class.
    void SetPreExtrapolation(EExtrapolationType pExtrapolation) override;  ///< Of the time before the first key.
    EExtrapolationType GetPreExtrapolation() const override;               ///< eConstant by default.
    void SetPreExtrapolationCount(unsigned long pCount) override;          ///< Repetitions of the keys; 0: endless.
    unsigned long GetPreExtrapolationCount() const override;               ///< 0: endless.
    void SetPostExtrapolation(EExtrapolationType pExtrapolation) override; ///< Of the time after the last key.
    EExtrapolationType GetPostExtrapolation() const override;              ///< eConstant by default.
    void SetPostExtrapolationCount(unsigned long pCount) override;         ///< Repetitions of the keys; 0: endless.
    unsigned long GetPostExtrapolationCount() const override;              ///< 0: endless.
    bool GetTimeInterval(FbxTimeSpan& pTimeInterval) const override;       ///< First to last key. False without keys.

    /// Sets everything of one key; a new time may change its index. An index out of range changes nothing. A constant
    /// key has no tangents and holds its own value; KeySetConstantMode makes it hold the next one's.
    ///
    /// pData0 and pData1 are the right slope and the next key's left slope, in value per second, or tension and
    /// continuity; weights are fractions of the segment up to the next key.
    virtual void KeySet(int pKeyIndex, FbxTime pTime, float pValue,
                        FbxAnimCurveDef::EInterpolationType pInterpolation = FbxAnimCurveDef::eInterpolationCubic,
                        FbxAnimCurveDef::ETangentMode pTangentMode = FbxAnimCurveDef::eTangentAuto, float pData0 = 0.0F,
                        float pData1 = 0.0F,
                        FbxAnimCurveDef::EWeightedMode pTangentWeightMode = FbxAnimCurveDef::eWeightedNone,
                        float pWeight0 = FbxAnimCurveDef::sDEFAULT_WEIGHT,
                        float pWeight1 = FbxAnimCurveDef::sDEFAULT_WEIGHT,
                        float pVelocity0 = FbxAnimCurveDef::sDEFAULT_VELOCITY,
                        float pVelocity1 = FbxAnimCurveDef::sDEFAULT_VELOCITY);
    [[nodiscard]] virtual float KeyGetValue(int pKeyIndex) const; ///< 0 out of range.
    virtual void KeySetValue(int pKeyIndex, float pValue);        ///< No effect out of range.
    /// Cubic, as a new key is, out of range.
    [[nodiscard]] virtual FbxAnimCurveDef::EInterpolationType KeyGetInterpolation(int pKeyIndex) const;
    /// Keeps the tangents, unless the key becomes constant or was: it has none then, or automatic ones. No effect out
    /// of range.
    virtual void KeySetInterpolation(int pKeyIndex, FbxAnimCurveDef::EInterpolationType pInterpolation);
    /// Standard for keys that are not constant and out of range.
    [[nodiscard]] virtual FbxAnimCurveDef::EConstantMode KeyGetConstantMode(int pKeyIndex) const;
    /// No effect on keys that are not constant and out of range.
    virtual void KeySetConstantMode(int pKeyIndex, FbxAnimCurveDef::EConstantMode pMode);
    /// Auto for constant keys and out of range. With the generic bits.
    [[nodiscard]] virtual FbxAnimCurveDef::ETangentMode KeyGetTangentMode(int pKeyIndex) const;
    /// No effect on constant keys and out of range. The numbers of the key stay unchanged.
    virtual void KeySetTangentMode(int pKeyIndex, FbxAnimCurveDef::ETangentMode pTangent);
    /// The number as stored in the key, which excludes the computed slopes of auto tangents. Out of range that of a new
    /// key.
    [[nodiscard]] virtual float KeyGetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex) const;
    /// Any number is accepted. No effect out of range.
    virtual void KeySetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex, float pValue);
    /// Multiplies the whole curve: values, default value and slopes.
    virtual void KeyMultValue(float pMultValue);

    /// The default value of the channel that the curve drives through its n-th curve node; the curve's own when it
    /// drives none.
    [[nodiscard]] virtual float GetValue(int pCurveNodeIndex = 0) const;
    /// Sets that default value and the curve's own; keys stay.
    virtual void SetValue(float pValue, int pCurveNodeIndex = 0);

    /// The platform's own view of the keys.
    [[nodiscard]] const detail::CurveKeys& keys() const;
    /// The same for changing them: cached evaluations are discarded.
    [[nodiscard]] detail::CurveKeys& editKeys();
    /// The keys are those of an object of a file, read on the first access.
    void setSource(std::shared_ptr<const detail::Document> document, const detail::DocumentObject& object);

private:
    [[nodiscard]] FBXSDK_LOCAL detail::CurveState& state() const;

    mutable std::unique_ptr<detail::CurveState> mState; ///< created on the first access
    mutable std::shared_ptr<const detail::Document> mDocument;
    const detail::DocumentObject* mSource = nullptr; ///< owned by the document, null without one
};

FBXSDK_NAMESPACE_END
