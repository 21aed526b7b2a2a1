// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of formats. Readers and writers are the same two.
#include <fbxsdk/FbxIOPluginRegistry.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <iterator>

#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxString.h>

#include "container/Record.h"
#include "object/ManagerData.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

struct Format {
    const char* description;
    const char* extension;
};
constexpr int kBinary = 0, kAscii = 1;
constexpr Format kFormats[] = {{"FBX binary (*.fbx)", "fbx"}, {"FBX ascii (*.fbx)", "fbx"}};

/// The writable versions, terminated by null.
constexpr auto kVersions = [] {
    std::array<const char*, std::size(detail::kVersionTraits) + 1> names{};
    std::transform(std::begin(detail::kVersionTraits), std::end(detail::kVersionTraits), names.begin(),
                   [](const detail::VersionTraits& version) { return version.name; });
    return names;
}();

const Format* formatAt(int index) {
    return index >= 0 && index < static_cast<int>(std::size(kFormats)) ? &kFormats[index] : nullptr;
}

} // namespace

int FbxIOPluginRegistry::GetReaderFormatCount() const { return static_cast<int>(std::size(kFormats)); }
int FbxIOPluginRegistry::GetWriterFormatCount() const { return static_cast<int>(std::size(kFormats)); }

const char* FbxIOPluginRegistry::GetReaderFormatDescription(int pFileFormat) const {
    return GetWriterFormatDescription(pFileFormat);
}
const char* FbxIOPluginRegistry::GetWriterFormatDescription(int pFileFormat) const {
    const Format* format = formatAt(pFileFormat);
    return format ? format->description : "";
}
const char* FbxIOPluginRegistry::GetReaderFormatExtension(int pFileFormat) const {
    return GetWriterFormatExtension(pFileFormat);
}
const char* FbxIOPluginRegistry::GetWriterFormatExtension(int pFileFormat) const {
    const Format* format = formatAt(pFileFormat);
    return format ? format->extension : "";
}
bool FbxIOPluginRegistry::ReaderIsFBX(int pFileFormat) const { return formatAt(pFileFormat) != nullptr; }
bool FbxIOPluginRegistry::WriterIsFBX(int pFileFormat) const { return formatAt(pFileFormat) != nullptr; }
int FbxIOPluginRegistry::GetNativeReaderFormat() const { return kBinary; }
int FbxIOPluginRegistry::GetNativeWriterFormat() const { return kBinary; }

bool FbxIOPluginRegistry::DetectReaderFileFormat(const char* pFileName, int& pFileFormat) const {
    pFileFormat = -1;
    FbxStatus status;
    const detail::Container container =
        pFileName ? detail::containerOf(std::string(pFileName), status) : detail::Container::unknown;
    if (container == detail::Container::binary)
        pFileFormat = kBinary;
    if (container == detail::Container::ascii)
        pFileFormat = kAscii;
    return pFileFormat >= 0;
}

int FbxIOPluginRegistry::FindWriterIDByDescription(const char* pDescription) const {
    for (int i = 0; pDescription && i < GetWriterFormatCount(); ++i)
        if (std::strcmp(kFormats[i].description, pDescription) == 0)
            return i;
    return -1;
}

int FbxIOPluginRegistry::FindWriterIDByExtension(const char* pExtension) const {
    for (int i = 0; pExtension && i < GetWriterFormatCount(); ++i)
        if (FbxString(kFormats[i].extension).CompareNoCase(pExtension) == 0)
            return i;
    return -1;
}

char const* const* FbxIOPluginRegistry::GetWritableVersions(int pFileFormat) const {
    return formatAt(pFileFormat) ? kVersions.data() : nullptr;
}

FbxIOPluginRegistry* FbxManager::GetIOPluginRegistry() const {
    if (!mData->registry)
        mData->registry = std::make_shared<FbxIOPluginRegistry>();
    return mData->registry.get();
}

FBXSDK_NAMESPACE_END
