// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A point cache beside an FBX file: Maya caches (.xml with .mc or .mcx) and Max point caches (.pc2).
#pragma once

#include <memory>
#include <vector>

#include <fbxsdk/FbxObject.h>
#include <fbxsdk/FbxStatus.h>
#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {
class CacheFile;
class OutputFile;
} // namespace detail

class FBXSDK_DLL FbxCache : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxCache, FbxObject)

public:
    enum EFileFormat { eUnknownFileFormat, eMaxPointCacheV2, eMayaCache, eAlembic };
    enum EMCFileCount { eMCOneFile, eMCOneFilePerFrame };
    enum EMCDataType {
        eUnknownData,
        eDouble,
        eDoubleArray,
        eDoubleVectorArray,
        eInt32Array,
        eFloatArray,
        eFloatVectorArray
    };
    enum EMCBinaryFormat { eMCC, eMCX };
    enum EMCSamplingType { eSamplingRegular, eSamplingIrregular };

    /// Format and names can be set only while the cache is closed.
    void SetCacheFileFormat(EFileFormat pFileFormat, FbxStatus* pStatus = nullptr);
    [[nodiscard]] EFileFormat GetCacheFileFormat() const;
    void SetCacheFileName(const char* pRelativeFileName_UTF8, const char* pAbsoluteFileName_UTF8,
                          FbxStatus* pStatus = nullptr);
    void GetCacheFileName(FbxString& pRelativeFileName_UTF8, FbxString& pAbsoluteFileName_UTF8) const;

    /// Finds and opens the files for reading. False when they are missing or not of the format.
    bool OpenFileForRead(FbxStatus* pStatus = nullptr);
    bool IsOpen(FbxStatus* pStatus = nullptr) const;
    /// Closes the files; when writing, completes them first. False when not open or on a write error.
    ///
    /// What was written has its name then. Only a cache that has a property "AppearWithScene" that is true keeps other
    /// names until the scene it belongs to is exported: it appears together with the scene's file, or not at all.
    bool CloseFile(FbxStatus* pStatus = nullptr);

    /// Frames per second of the samples.
    double GetSamplingFrameRate(FbxStatus* pStatus = nullptr);
    FbxTime GetCacheTimePerFrame(FbxStatus* pStatus = nullptr);
    int GetChannelCount(FbxStatus* pStatus = nullptr);
    bool GetChannelName(int pChannelIndex, FbxString& pChannelName, FbxStatus* pStatus = nullptr);

    // Maya caches. Buffers hold three numbers per point. Why a file cannot be opened for writing is said without its
    // name, everything else with it.
    bool OpenFileForWrite(EMCFileCount pFileCount, double pSamplingFrameRate, const char* pChannelName,
                          EMCBinaryFormat pBinaryFormat, EMCDataType pMCDataType = eDoubleVectorArray,
                          const char* pInterpretation = "Points", FbxStatus* pStatus = nullptr);
    bool AddChannel(const char* pChannelName, EMCDataType pMCDataType, const char* pInterpretation,
                    unsigned int& pChannelIndex, FbxStatus* pStatus = nullptr);
    bool GetChannelDataType(int pChannelIndex, EMCDataType& pChannelType, FbxStatus* pStatus = nullptr);
    /// The channel of exactly that name; -1 when there is none or the cache is not open.
    int GetChannelIndex(const char* pChannelName, FbxStatus* pStatus = nullptr);
    /// The sample at the time: interpolated linearly between samples, held outside the range. False for a bad channel
    /// and when the cache's point count differs.
    bool Read(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount,
              FbxStatus* pStatus = nullptr);
    bool Read(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount,
              FbxStatus* pStatus = nullptr);
    bool BeginWriteAt(FbxTime& pTime, FbxStatus* pStatus = nullptr);
    bool EndWriteAt(FbxStatus* pStatus = nullptr);
    bool Write(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount,
               FbxStatus* pStatus = nullptr);
    bool Write(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount,
               FbxStatus* pStatus = nullptr);
    /// Times of the channel's first and last sample.
    bool GetAnimationRange(int pChannelIndex, FbxTime& pTimeStart, FbxTime& pTimeEnd, FbxStatus* pStatus = nullptr);

    // Max point caches. The frame index is the absolute frame number; the start offset is taken off inside.
    bool OpenFileForWrite(double pFrameStartOffset, double pSamplingFrameRate, unsigned int pSampleCount,
                          unsigned int pPointCount, FbxStatus* pStatus = nullptr);
    unsigned int GetSampleCount(FbxStatus* pStatus = nullptr);
    unsigned int GetPointCount(FbxStatus* pStatus = nullptr);
    double GetFrameStartOffset(FbxStatus* pStatus = nullptr);
    bool Read(unsigned int pFrameIndex, double* pBuffer, unsigned int pPointCount, FbxStatus* pStatus = nullptr);
    bool Write(unsigned int pFrameIndex, double* pBuffer, FbxStatus* pStatus = nullptr);

    /// The platform's own view of what waits for the scene's file, in the order in which it should appear.
    [[nodiscard]] std::vector<detail::OutputFile*> waitingFiles() const;
    /// Once they have their names, or never will.
    void forgetWaitingFiles();

private:
    std::unique_ptr<detail::CacheFile> mFile, mWaiting;
};

FBXSDK_NAMESPACE_END
