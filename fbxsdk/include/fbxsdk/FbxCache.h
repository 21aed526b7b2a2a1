// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// The points of a deforming mesh over time, in separate files: a Maya cache (a description next to its data) or a
/// Max point cache. The object holds names and format; the files are open between an Open call and CloseFile.
///
/// Every call that takes a status sets it: to success, or to why it failed. A cache that is destroyed while it is
/// written leaves no file.
class FBXSDK_DLL FbxCache : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxCache, FbxObject)

public:
    /// Which files the cache consists of.
    enum EFileFormat {
        eUnknownFileFormat, ///< not set; cannot be opened
        eMaxPointCacheV2,   ///< one file with the points of every frame (.pc2)
        eMayaCache,         ///< a description (.xml) and data (.mc, .mcx)
        eAlembic            ///< of the API; cannot be opened
    };
    /// How a Maya cache divides its data.
    enum EMCFileCount {
        eMCOneFile,        ///< all samples in one file
        eMCOneFilePerFrame ///< a file for each frame; read, not written
    };
    /// What a channel of a Maya cache holds at one time.
    enum EMCDataType {
        eUnknownData,       ///< none of the others
        eDouble,            ///< one double
        eDoubleArray,       ///< doubles
        eDoubleVectorArray, ///< three doubles for each point
        eInt32Array,        ///< whole numbers
        eFloatArray,        ///< floats
        eFloatVectorArray   ///< three floats for each point
    };
    /// The widths of sizes in the data of a Maya cache.
    enum EMCBinaryFormat {
        eMCC, ///< 32 bits, up to 2 GiB for a sample (.mc)
        eMCX  ///< 64 bits (.mcx)
    };
    /// How the samples of a Maya cache are spaced in time; no call here uses it.
    enum EMCSamplingType {
        eSamplingRegular,  ///< at equal distances
        eSamplingIrregular ///< anywhere
    };

    /// Any format is stored. An error while the cache is open.
    void SetCacheFileFormat(EFileFormat pFileFormat, FbxStatus* pStatus = nullptr);
    /// eUnknownFileFormat by default and for a number that is no format.
    [[nodiscard]] EFileFormat GetCacheFileFormat() const;
    /// Both names, UTF-8; null is the empty one. The relative one is relative to the folder of the scene's file. An
    /// error while the cache is open.
    void SetCacheFileName(const char* pRelativeFileName_UTF8, const char* pAbsoluteFileName_UTF8,
                          FbxStatus* pStatus = nullptr);
    /// Sets both names as they are stored.
    void GetCacheFileName(FbxString& pRelativeFileName_UTF8, FbxString& pAbsoluteFileName_UTF8) const;

    /// Finds and opens the files for reading: by the stored names, and next to the file that the scene was read from.
    /// False when they are missing or not of the format, when no name is set, for formats other than the two, and while
    /// the cache is open.
    bool OpenFileForRead(FbxStatus* pStatus = nullptr);
    bool IsOpen(FbxStatus* pStatus = nullptr) const; ///< Whether it is open for reading or for writing.
    /// Closes the files; when writing, completes them first. False when not open or on a write error.
    ///
    /// The written files then have their names. Only a cache whose property "AppearWithScene" is true keeps other
    /// names until its scene is exported: it appears together with the scene's file, or not at all.
    bool CloseFile(FbxStatus* pStatus = nullptr);

    /// Frames per second of the samples: of a Max point cache at the thread's global time mode. 0 when not open.
    double GetSamplingFrameRate(FbxStatus* pStatus = nullptr);
    /// The time from one frame to the next; zero when not open.
    FbxTime GetCacheTimePerFrame(FbxStatus* pStatus = nullptr);
    int GetChannelCount(FbxStatus* pStatus = nullptr); ///< Of an open Maya cache; 0 otherwise.
    /// Sets pChannelName to the name in the description. False for any other cache and out of range.
    bool GetChannelName(int pChannelIndex, FbxString& pChannelName, FbxStatus* pStatus = nullptr);

    /// Begins a Maya cache with one channel, whose index is 0. Files appear when it is closed; the absolute name
    /// is used, or the relative one when that is empty.
    ///
    /// False for another format, for eMCOneFilePerFrame, for a rate that is not greater than zero, when the files
    /// cannot be created, and while the cache is open. The status then does not contain the file's name.
    bool OpenFileForWrite(EMCFileCount pFileCount, double pSamplingFrameRate, const char* pChannelName,
                          EMCBinaryFormat pBinaryFormat, EMCDataType pMCDataType = eDoubleVectorArray,
                          const char* pInterpretation = "Points", FbxStatus* pStatus = nullptr);
    /// Adds a channel to a Maya cache that is being written and sets pChannelIndex. False for any other.
    bool AddChannel(const char* pChannelName, EMCDataType pMCDataType, const char* pInterpretation,
                    unsigned int& pChannelIndex, FbxStatus* pStatus = nullptr);
    /// Sets pChannelType; eUnknownData for a type that is not in the API. False for a cache that is no open Maya cache
    /// and out of range.
    bool GetChannelDataType(int pChannelIndex, EMCDataType& pChannelType, FbxStatus* pStatus = nullptr);
    /// The channel of exactly that name; -1 when there is none or the cache is not open.
    int GetChannelIndex(const char* pChannelName, FbxStatus* pStatus = nullptr);
    /// The sample of a Maya cache at the time, three numbers for each point: interpolated linearly between samples,
    /// held outside the range. False for a bad channel, a damaged file and when the cache's point count differs; the
    /// content of the buffer is unspecified then.
    bool Read(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount,
              FbxStatus* pStatus = nullptr);
    /// The same in single precision.
    bool Read(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount,
              FbxStatus* pStatus = nullptr);
    /// Whether a Maya cache is being written; no other effect.
    bool BeginWriteAt(FbxTime& pTime, FbxStatus* pStatus = nullptr);
    /// Whether a Maya cache is being written; no other effect.
    bool EndWriteAt(FbxStatus* pStatus = nullptr);
    /// Appends a sample to a channel of a Maya cache, three numbers for each point. False for a bad channel, for
    /// numbers that are not finite and on a write error; after one the cache cannot be completed.
    bool Write(int pChannelIndex, FbxTime& pTime, double* pBuffer, unsigned int pPointCount,
               FbxStatus* pStatus = nullptr);
    /// The same in single precision.
    bool Write(int pChannelIndex, FbxTime& pTime, float* pBuffer, unsigned int pPointCount,
               FbxStatus* pStatus = nullptr);
    /// Times of the first and last sample of a Maya cache that is open for reading; the same for all of its channels.
    /// False for any other, out of range and without samples.
    bool GetAnimationRange(int pChannelIndex, FbxTime& pTimeStart, FbxTime& pTimeEnd, FbxStatus* pStatus = nullptr);

    /// Begins a Max point cache of pSampleCount frames from pFrameStartOffset on, one sample for each. The rate is not
    /// stored. The file appears when it is closed. False as for a Maya cache.
    bool OpenFileForWrite(double pFrameStartOffset, double pSamplingFrameRate, unsigned int pSampleCount,
                          unsigned int pPointCount, FbxStatus* pStatus = nullptr);
    unsigned int GetSampleCount(FbxStatus* pStatus = nullptr); ///< Of an open Max point cache; 0 otherwise.
    unsigned int GetPointCount(FbxStatus* pStatus = nullptr);  ///< Of an open Max point cache; 0 otherwise.
    /// The frame of the first sample of an open Max point cache; 0 otherwise.
    double GetFrameStartOffset(FbxStatus* pStatus = nullptr);
    /// The points of a Max point cache at the absolute frame number: interpolated linearly between samples, held
    /// outside of them. A negative frame is passed converted to unsigned. False for any other cache, a damaged file and
    /// when the point count differs.
    bool Read(unsigned int pFrameIndex, double* pBuffer, unsigned int pPointCount, FbxStatus* pStatus = nullptr);
    /// Writes the points of the absolute frame number; frames may come in any order. False for a frame that was not
    /// announced and on a write error.
    bool Write(unsigned int pFrameIndex, double* pBuffer, FbxStatus* pStatus = nullptr);

    /// The platform's own view of the files that wait for the scene's file, in the order in which they should appear.
    [[nodiscard]] std::vector<detail::OutputFile*> waitingFiles() const;
    /// To be called once they have their names, or never will.
    void forgetWaitingFiles();

private:
    std::unique_ptr<detail::CacheFile> mFile, mWaiting;
};

FBXSDK_NAMESPACE_END
