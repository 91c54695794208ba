// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/support/TemporaryDirectory.h"

#include <cstdlib>
#include <fstream>
#include <stdexcept>

namespace testing_support {

TemporaryDirectory::TemporaryDirectory()
{
    auto pattern = (std::filesystem::temp_directory_path() / "tarrow-test-XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("cannot make a temporary folder");
    // The path is canonical, so that it compares equal to the file system's answers.
    _path = std::filesystem::canonical(pattern);
}

TemporaryDirectory::~TemporaryDirectory()
{
    std::error_code ignored;
    std::filesystem::remove_all(_path, ignored);
}

std::string TemporaryDirectory::write(std::string_view name, std::string_view content) const
{
    const auto file = _path / name;
    std::filesystem::create_directories(file.parent_path());
    std::ofstream(file, std::ios::binary).write(content.data(), static_cast<std::streamsize>(content.size()));
    return file.string();
}

} // namespace testing_support
