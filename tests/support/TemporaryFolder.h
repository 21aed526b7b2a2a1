// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A temporary folder for a test, removed at its end.
#pragma once

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>
#include <vector>

namespace support {

class TemporaryFolder {
public:
    TemporaryFolder() {
        // mkdtemp() replaces the letters X.
        std::string name = (std::filesystem::temp_directory_path() / "tarnell-test-XXXXXX").string();
        if (!mkdtemp(name.data()))
            throw std::runtime_error("no temporary folder");
        mPath = name;
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;
    ~TemporaryFolder() {
        std::error_code ignored;
        std::filesystem::permissions(mPath, std::filesystem::perms::owner_all, ignored);
        std::filesystem::remove_all(mPath, ignored);
    }

    [[nodiscard]] std::string path() const { return mPath.string(); }
    [[nodiscard]] std::string file(const std::string& name) const { return (mPath / name).string(); }

    std::string write(const std::string& name, const std::string& content) const {
        const std::filesystem::path target = mPath / name;
        std::filesystem::create_directories(target.parent_path());
        std::ofstream(target, std::ios::binary) << content;
        return target.string();
    }
    [[nodiscard]] std::string read(const std::string& name) const {
        std::ifstream in(mPath / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
    }

    /// The names in the folder, in order.
    [[nodiscard]] std::vector<std::string> files(const std::string& subfolder = ".") const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(mPath / subfolder))
            names.push_back(entry.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }

private:
    std::filesystem::path mPath;
};

} // namespace support
