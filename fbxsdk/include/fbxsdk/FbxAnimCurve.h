// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animation curves: keys over time and their interpolation.
#pragma once

#include <memory>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {
struct CurveCursor;
struct CurveKeys;
} // namespace detail

struct FBXSDK_DLL FbxAnimCurveDef {
    static constexpr float sDEFAULT_WEIGHT = 1.0F / 3.0F;
    static constexpr float sMIN_WEIGHT = 0.0001F;
    static constexpr float sMAX_WEIGHT = 0.99F;
    static constexpr float sDEFAULT_VELOCITY = 0.0F;

    enum ETangentMode {
        eTangentAuto = 0x00000100,
        eTangentTCB = 0x00000200,
        eTangentUser = 0x00000400,
        eTangentGenericBreak = 0x00000800,
        eTangentBreak = eTangentGenericBreak | eTangentUser,
        eTangentAutoBreak = eTangentGenericBreak | eTangentAuto,
        eTangentGenericClamp = 0x00001000,
        eTangentGenericTimeIndependent = 0x00002000,
        eTangentGenericClampProgressive = 0x00004000 | eTangentGenericTimeIndependent
    };
    enum EInterpolationType {
        eInterpolationConstant = 0x00000002,
        eInterpolationLinear = 0x00000004,
        eInterpolationCubic = 0x00000008
    };
    enum EWeightedMode {
        eWeightedNone = 0x00000000,
        eWeightedRight = 0x01000000,
        eWeightedNextLeft = 0x02000000,
        eWeightedAll = eWeightedRight | eWeightedNextLeft
    };
    enum EConstantMode { eConstantStandard = 0x00000000, eConstantNext = 0x00000100 };
    enum EVelocityMode {
        eVelocityNone = 0x00000000,
        eVelocityRight = 0x10000000,
        eVelocityNextLeft = 0x20000000,
        eVelocityAll = eVelocityRight | eVelocityNextLeft
    };
    enum ETangentVisibility {
        eTangentShowNone = 0x00000000,
        eTangentShowLeft = 0x00100000,
        eTangentShowRight = 0x00200000,
        eTangentShowBoth = eTangentShowLeft | eTangentShowRight
    };
    enum EDataIndex {
        eRightSlope = 0,
        eNextLeftSlope = 1,
        eWeights = 2,
        eRightWeight = 2,
        eNextLeftWeight = 3,
        eVelocity = 4,
        eRightVelocity = 4,
        eNextLeftVelocity = 5,
        eTCBTension = 0,
        eTCBContinuity = 1,
        eTCBBias = 2
    };
};

class FBXSDK_DLL FbxAnimCurveBase : public FbxObject {
    FBXSDK_ABSTRACT_DECLARE(FbxAnimCurveBase, FbxObject)

public:
    enum EExtrapolationType {
        eConstant = 1,
        eRepetition = 2,
        eMirrorRepetition = 3,
        eKeepSlope = 4,
        eRelativeRepetition = 5
    };

    virtual void KeyClear() = 0;
    [[nodiscard]] virtual int KeyGetCount() const = 0;
    /// The index of the key at that time, which is made when there is none (value 0, cubic, auto tangents).
    virtual int KeyAdd(FbxTime pTime, int* pLast = nullptr) = 0;
    virtual bool KeyRemove(int pIndex) = 0;
    /// Zero for an index out of range.
    [[nodiscard]] virtual FbxTime KeyGetTime(int pKeyIndex) const = 0;
    virtual void KeySetTime(int pKeyIndex, FbxTime pTime) = 0;
    /// The value at the time; `pLast` is a search hint that the caller keeps between calls.
    [[nodiscard]] virtual float Evaluate(FbxTime pTime, int* pLast = nullptr) = 0;
    [[nodiscard]] virtual float EvaluateIndex(double pIndex) = 0;
    virtual void SetPreExtrapolation(EExtrapolationType pExtrapolation) = 0;
    [[nodiscard]] virtual EExtrapolationType GetPreExtrapolation() const = 0;
    virtual void SetPreExtrapolationCount(unsigned long pCount) = 0;
    [[nodiscard]] virtual unsigned long GetPreExtrapolationCount() const = 0;
    virtual void SetPostExtrapolation(EExtrapolationType pExtrapolation) = 0;
    [[nodiscard]] virtual EExtrapolationType GetPostExtrapolation() const = 0;
    virtual void SetPostExtrapolationCount(unsigned long pCount) = 0;
    [[nodiscard]] virtual unsigned long GetPostExtrapolationCount() const = 0;
    /// First to last key. False without keys.
    virtual bool GetTimeInterval(FbxTimeSpan& pTimeInterval) const = 0;
};

class FBXSDK_DLL FbxAnimCurve : public FbxAnimCurveBase {
    FBXSDK_OBJECT_DECLARE(FbxAnimCurve, FbxAnimCurveBase)

public:
    static FbxAnimCurve* Create(FbxScene* pContainer, const char* pName);

    /// Brackets a series of edits; auto tangents follow the keys in any case.
    virtual void KeyModifyBegin();
    virtual void KeyModifyEnd();

    void KeyClear() override;
    int KeyGetCount() const override;
    int KeyAdd(FbxTime pTime, int* pLast = nullptr) override;
    bool KeyRemove(int pIndex) override;
    FbxTime KeyGetTime(int pKeyIndex) const override;
    void KeySetTime(int pKeyIndex, FbxTime pTime) override;
    float Evaluate(FbxTime pTime, int* pLast = nullptr) override;
    float EvaluateIndex(double pIndex) override;
    void SetPreExtrapolation(EExtrapolationType pExtrapolation) override;
    EExtrapolationType GetPreExtrapolation() const override;
    void SetPreExtrapolationCount(unsigned long pCount) override;
    unsigned long GetPreExtrapolationCount() const override;
    void SetPostExtrapolation(EExtrapolationType pExtrapolation) override;
    EExtrapolationType GetPostExtrapolation() const override;
    void SetPostExtrapolationCount(unsigned long pCount) override;
    unsigned long GetPostExtrapolationCount() const override;
    bool GetTimeInterval(FbxTimeSpan& pTimeInterval) const override;

    /// Sets everything of one key. An index out of range changes nothing. A constant key has no tangents and holds its
    /// own value; KeySetConstantMode makes it hold the next one's.
    virtual void KeySet(int pKeyIndex, FbxTime pTime, float pValue,
                        FbxAnimCurveDef::EInterpolationType pInterpolation = FbxAnimCurveDef::eInterpolationCubic,
                        FbxAnimCurveDef::ETangentMode pTangentMode = FbxAnimCurveDef::eTangentAuto, float pData0 = 0.0F,
                        float pData1 = 0.0F,
                        FbxAnimCurveDef::EWeightedMode pTangentWeightMode = FbxAnimCurveDef::eWeightedNone,
                        float pWeight0 = FbxAnimCurveDef::sDEFAULT_WEIGHT,
                        float pWeight1 = FbxAnimCurveDef::sDEFAULT_WEIGHT,
                        float pVelocity0 = FbxAnimCurveDef::sDEFAULT_VELOCITY,
                        float pVelocity1 = FbxAnimCurveDef::sDEFAULT_VELOCITY);
    [[nodiscard]] virtual float KeyGetValue(int pKeyIndex) const;
    virtual void KeySetValue(int pKeyIndex, float pValue);
    [[nodiscard]] virtual FbxAnimCurveDef::EInterpolationType KeyGetInterpolation(int pKeyIndex) const;
    virtual void KeySetInterpolation(int pKeyIndex, FbxAnimCurveDef::EInterpolationType pInterpolation);
    [[nodiscard]] virtual FbxAnimCurveDef::EConstantMode KeyGetConstantMode(int pKeyIndex) const;
    virtual void KeySetConstantMode(int pKeyIndex, FbxAnimCurveDef::EConstantMode pMode);
    [[nodiscard]] virtual FbxAnimCurveDef::ETangentMode KeyGetTangentMode(int pKeyIndex) const;
    virtual void KeySetTangentMode(int pKeyIndex, FbxAnimCurveDef::ETangentMode pTangent);
    [[nodiscard]] virtual float KeyGetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex) const;
    virtual void KeySetData(int pKeyIndex, FbxAnimCurveDef::EDataIndex pIndex, float pValue);
    virtual void KeyMultValue(float pMultValue);

    /// The default value of the channel that the curve drives through its n-th curve node; also kept as the curve's
    /// own.
    [[nodiscard]] virtual float GetValue(int pCurveNodeIndex = 0) const;
    virtual void SetValue(float pValue, int pCurveNodeIndex = 0);

    /// The platform's own view of the keys.
    [[nodiscard]] const detail::CurveKeys& keys() const { return *mKeys; }
    [[nodiscard]] detail::CurveKeys& editKeys();

private:
    std::unique_ptr<detail::CurveKeys> mKeys;
    std::unique_ptr<detail::CurveCursor> mCursor;
};

FBXSDK_NAMESPACE_END
