// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>

namespace testing_support {

/// A folder for one test, which is removed with everything in it at the end.
class TemporaryDirectory {
public:
    explicit TemporaryDirectory(const std::filesystem::path& above = std::filesystem::temp_directory_path())
    {
        auto pattern = (above / "tarrow-test-XXXXXX").string();
        if (!mkdtemp(pattern.data()))
            throw std::runtime_error("cannot make a temporary folder");
        // The path is canonical, so that it compares equal to the file system's answers.
        _path = std::filesystem::canonical(pattern);
    }
    ~TemporaryDirectory()
    {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    const std::filesystem::path& path() const { return _path; }
    /// Answers the path of an item below the folder.
    std::string at(std::string_view name) const { return (_path / name).string(); }
    /// Writes a file below the folder, and makes the folders above it. Answers its path.
    std::string write(std::string_view name, std::string_view content) const
    {
        const auto file = _path / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary)
            .write(content.data(), static_cast<std::streamsize>(content.size()));
        return file.string();
    }

private:
    std::filesystem::path _path;
};

} // namespace testing_support
