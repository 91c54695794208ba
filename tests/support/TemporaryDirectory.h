// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace testing_support {

/// A folder for one test, which is removed with everything in it at the end.
class TemporaryDirectory {
public:
    TemporaryDirectory();
    ~TemporaryDirectory();
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    const std::filesystem::path& path() const { return _path; }
    /// Answers the path of an item below the folder.
    std::string at(std::string_view name) const { return (_path / name).string(); }
    /// Writes a file below the folder, and makes the folders above it. Answers its path.
    std::string write(std::string_view name, std::string_view content) const;

private:
    std::filesystem::path _path;
};

} // namespace testing_support
