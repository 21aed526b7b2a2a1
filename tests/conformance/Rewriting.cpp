// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads and writes a file with the platform: data that the library would drop is kept.
#include "Rewriting.h"

#include <fbxsdk.h>

#include <memory>
#include <stdexcept>

namespace conformance {
namespace {

namespace fs = std::filesystem;

struct ManagerDeleter {
    void operator()(FbxManager* manager) const { manager->Destroy(); }
};

int writerFor(FbxManager& manager, bool ascii) {
    const FbxIOPluginRegistry& registry = *manager.GetIOPluginRegistry();
    for (int i = 0; i < registry.GetWriterFormatCount(); ++i)
        if (FbxString(registry.GetWriterFormatDescription(i)).Find(ascii ? "ascii" : "binary") >= 0)
            return i;
    throw std::runtime_error("the registry has no such writer");
}

} // namespace

std::optional<WrittenForm> parseWrittenForm(const std::string& text) {
    const std::size_t colon = text.find(':');
    const std::string encoding = colon == std::string::npos ? "" : text.substr(colon + 1);
    if (encoding != "ascii" && encoding != "binary")
        return std::nullopt;
    return WrittenForm{text.substr(0, colon), encoding == "ascii"};
}

RewrittenCorpus::RewrittenCorpus(const fs::path& corpus, WrittenForm form)
    : mSource(corpus / "fbx"), mForm(std::move(form)) {
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(mSource)) {
        const fs::path target = mFolder.file(fs::relative(entry.path(), mSource).string());
        if (entry.is_directory())
            fs::create_directories(target);
        else if (entry.path().extension() != ".fbx")
            fs::create_symlink(fs::absolute(entry.path()), target);
    }
}

std::optional<CorpusFile> RewrittenCorpus::rewrite(const CorpusFile& file) const {
    const std::unique_ptr<FbxManager, ManagerDeleter> manager(FbxManager::Create());
    manager->SetIOSettings(FbxIOSettings::Create(manager.get(), IOSROOT));
    FbxImporter* importer = FbxImporter::Create(manager.get(), "");
    FbxScene* scene = FbxScene::Create(manager.get(), "");
    if (!importer->Initialize(file.path.c_str()) || !importer->Import(scene))
        return std::nullopt;

    CorpusFile copy = file;
    copy.path = mFolder.file(fs::relative(file.path, mSource).string());
    FbxExporter* exporter = FbxExporter::Create(manager.get(), "");
    const bool written = exporter->SetFileExportVersion(mForm.version.c_str()) &&
                         exporter->Initialize(copy.path.c_str(), writerFor(*manager, mForm.ascii)) &&
                         exporter->Export(scene);
    if (!written)
        throw std::runtime_error(file.name + " cannot be written: " + exporter->GetStatus().GetErrorString());
    return copy;
}

} // namespace conformance
