// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileSystem.h"

#include <optional>
#include <string>

namespace host::system {

/// The part of the file system that changes items; platform::FileSystem says what each call does.
class ItemChanges {
public:
    virtual ~ItemChanges() = default;

    virtual std::optional<platform::ItemVersion> versionOfItem(const std::string& path) const = 0;
    virtual std::optional<platform::Error> createFolder(const std::string& path) = 0;
    virtual std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) = 0;
    virtual std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) = 0;
    virtual platform::Result<platform::FileContent> contentToReplace(
        const std::string& path, std::size_t maximumBytes) const = 0;
    virtual platform::Result<platform::ItemVersion> replaceContent(
        const std::string& path, const platform::FileContent& before, std::string_view content) = 0;
    virtual std::optional<platform::Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) = 0;
};

} // namespace host::system
