// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Paths are split into a root and components, changed, and joined again; the text functions never access files.
#include <fbxsdk/FbxPathUtils.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

FBXSDK_NAMESPACE_BEGIN
namespace {

namespace fs = std::filesystem;

/// A path split into its parts.
struct Path {
    std::string root;                    ///< "/", "C:/", "//server", or empty for a relative path
    std::vector<std::string> components; ///< none of them empty
};

std::string withForwardSlashes(const char* text) {
    std::string path(text ? text : "");
    for (char& letter : path)
        letter = letter == '\\' ? '/' : letter;
    return path;
}

bool isLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }

/// The length of the root of a path with forward slashes in bytes. "C:" without separator is a root only by itself.
size_t rootLength(std::string_view path) {
    if (path.size() >= 2 && isLetter(path[0]) && path[1] == ':')
        return path.size() == 2 ? 2 : path[2] == '/' ? 3 : 0;
    const bool server = path.size() > 2 && path[0] == '/' && path[1] == '/' && path[2] != '/';
    if (server)
        return std::min(path.find('/', 2), path.size());
    return path.empty() || path[0] != '/' ? 0 : 1;
}

bool isAbsolute(std::string_view path) { return rootLength(path) != 0; }

/// Splits a path, and drops redundant components: empty ones, ".", and ".." with the component before it.
Path parse(const std::string& text) {
    Path path;
    const size_t rootEnd = rootLength(text);
    path.root = text.substr(0, rootEnd);
    if (path.root.size() == 2 && path.root[1] == ':')
        path.root += '/';

    for (size_t begin = rootEnd; begin < text.size();) {
        const size_t end = std::min(text.find('/', begin), text.size());
        const std::string component = text.substr(begin, end - begin);
        begin = end + 1;
        if (component.empty() || component == ".")
            continue;
        const bool climbs = component == "..";
        if (climbs && !path.components.empty() && path.components.back() != "..")
            path.components.pop_back();
        else if (!climbs || path.root.empty())
            path.components.push_back(component);
    }
    return path;
}

std::string join(const Path& path) {
    std::string text = path.root;
    for (const std::string& component : path.components) {
        if (!text.empty() && text.back() != '/')
            text += '/';
        text += component;
    }
    return text;
}

std::string clean(const std::string& text) {
    const std::string result = join(parse(text));
    return result.empty() && !text.empty() ? "." : result;
}

std::string joined(std::string root, const std::string& file) {
    if (root.empty() || isAbsolute(file))
        return file;
    if (root.back() != '/')
        root += '/';
    return root + file;
}

fs::path toSystemPath(const std::string& utf8) { return fs::path(std::u8string(utf8.begin(), utf8.end())); }

std::string currentDirectory() {
    std::error_code error;
    const std::u8string utf8 = fs::current_path(error).generic_u8string();
    return std::string(utf8.begin(), utf8.end());
}

std::string resolve(const std::string& text) { return clean(joined(currentDirectory(), text)); }

/// Drive letters do not distinguish case; server names and components do.
bool sameRoot(const std::string& a, const std::string& b) {
    const bool drives = a.size() == 3 && b.size() == 3 && a[1] == ':' && b[1] == ':';
    return drives ? FbxString(a.c_str()).CompareNoCase(b.c_str()) == 0 : a == b;
}

std::string relativeTo(const Path& root, const Path& target) {
    size_t common = 0;
    while (common < root.components.size() && common < target.components.size() &&
           root.components[common] == target.components[common])
        ++common;
    Path relative;
    relative.components.assign(root.components.size() - common, "..");
    relative.components.insert(relative.components.end(),
                               target.components.begin() + static_cast<std::ptrdiff_t>(common),
                               target.components.end());
    return relative.components.empty() ? "." : join(relative);
}

/// Where the last component begins.
size_t nameBegin(const std::string& path) {
    const size_t separator = path.rfind('/');
    return std::max(rootLength(path), separator == std::string::npos ? 0 : separator + 1);
}

/// Position of the extension's dot, or of the end of the path.
size_t dotOf(const std::string& path) {
    const size_t dot = path.rfind('.');
    return dot == std::string::npos || dot < nameBegin(path) ? path.size() : dot;
}

FbxString toFbxString(const std::string& text) { return FbxString(text.c_str()); }

} // namespace

FbxString FbxPathUtils::Bind(const char* pRootPath, const char* pFilePath, bool pCleanPath) {
    const std::string path = joined(withForwardSlashes(pRootPath), withForwardSlashes(pFilePath));
    return toFbxString(pCleanPath ? clean(path) : path);
}

FbxString FbxPathUtils::GetFolderName(const char* pFilePath) {
    std::string path = withForwardSlashes(pFilePath);
    path.resize(nameBegin(path));
    while (path.size() > rootLength(path) && path.back() == '/')
        path.pop_back();
    return toFbxString(path);
}

FbxString FbxPathUtils::GetFileName(const char* pFilePath, bool pWithExtension) {
    std::string path = withForwardSlashes(pFilePath);
    const size_t begin = nameBegin(path);
    path.resize(pWithExtension ? path.size() : dotOf(path));
    return toFbxString(path.substr(begin));
}

FbxString FbxPathUtils::GetExtensionName(const char* pFilePath) {
    const std::string path = withForwardSlashes(pFilePath);
    const size_t dot = dotOf(path);
    return toFbxString(dot < path.size() ? path.substr(dot + 1) : std::string());
}

FbxString FbxPathUtils::ChangeExtension(const char* pFilePath, const char* pExtension) {
    std::string path = withForwardSlashes(pFilePath);
    std::string extension(pExtension ? pExtension : "");
    if (!extension.empty() && extension.front() != '.')
        extension.insert(extension.begin(), '.');
    path.resize(dotOf(path));
    return toFbxString(path + extension);
}

bool FbxPathUtils::Exist(const char* pFolderPathUTF8) {
    std::error_code error;
    return fs::is_directory(toSystemPath(withForwardSlashes(pFolderPathUTF8)), error);
}

bool FbxPathUtils::Create(const char* pFolderPathUTF8) {
    std::error_code error;
    fs::create_directories(toSystemPath(clean(withForwardSlashes(pFolderPathUTF8))), error);
    return Exist(pFolderPathUTF8); // also when it existed, or another process has created it
}

bool FbxPathUtils::Delete(const char* pFolderPathUTF8) {
    std::error_code error;
    return Exist(pFolderPathUTF8) && fs::remove(toSystemPath(clean(withForwardSlashes(pFolderPathUTF8))), error);
}

bool FbxPathUtils::IsEmpty(const char* pFolderPathUTF8) {
    std::error_code error;
    return Exist(pFolderPathUTF8) && fs::is_empty(toSystemPath(withForwardSlashes(pFolderPathUTF8)), error) && !error;
}

bool FbxPathUtils::IsRelative(const char* pPath) { return !isAbsolute(withForwardSlashes(pPath)); }

FbxString FbxPathUtils::GetRelativePath(const char* pRootPath, const char* pNewPath) {
    const Path root = parse(resolve(withForwardSlashes(pRootPath)));
    const Path target = parse(resolve(withForwardSlashes(pNewPath)));
    return toFbxString(sameRoot(root.root, target.root) ? relativeTo(root, target) : join(target));
}

FbxString FbxPathUtils::GetRelativeFilePath(const char* pRootPath, const char* pNewFilePath) {
    return GetRelativePath(pRootPath, pNewFilePath);
}

FbxString FbxPathUtils::Resolve(const char* pRelPath) { return toFbxString(resolve(withForwardSlashes(pRelPath))); }

FbxString FbxPathUtils::Clean(const char* pPath) { return toFbxString(clean(withForwardSlashes(pPath))); }

FbxString FbxPathUtils::GenerateFileName(const char* pFolder, const char* pPrefix) {
    constexpr int kAttempts = 100000;
    const std::string folder = withForwardSlashes(pFolder);
    for (int number = 1; number <= kAttempts; ++number) {
        const std::string path = joined(folder, std::string(pPrefix ? pPrefix : "") + std::to_string(number));
        std::error_code error;
        if (!fs::exists(toSystemPath(path), error))
            return toFbxString(path);
    }
    return {};
}

FBXSDK_NAMESPACE_END
