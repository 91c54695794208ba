// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/ItemChanges.h"
#include "platform/FileSystem.h"

#include <memory>

namespace host::system {

/// The kernel's file system. Enumeration works with descriptors and keeps few of them open, however deep the
/// folders lie; it opens nothing but folders. Without ItemChanges nothing can be changed (EROFS).
class PosixFileSystem : public platform::FileSystem {
public:
    explicit PosixFileSystem(std::shared_ptr<ItemChanges> changes = nullptr)
        : _changes(std::move(changes))
    {
    }
    platform::Result<platform::FileAttributes> attributesOfItem(const std::string& path) const override;
    platform::Result<std::string> destinationOfSymbolicLink(const std::string& path) const override;
    std::optional<platform::FileType> typeOfItem(const std::string& path) const override;
    std::optional<platform::Url> userDocumentsFolder() const override;
    void enumerateDeeply(const platform::Url& folder,
        const std::function<Continue(const platform::Url&, platform::FileType)>& entry,
        const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const override;
    void enumerateShallowly(const platform::Url& folder,
        const std::function<Continue(const platform::Url&, platform::FileType)>& entry,
        const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const override;
    std::optional<platform::ItemVersion> versionOfItem(const std::string& path) const override;
    std::optional<platform::Error> createFolder(const std::string& path) override;
    std::optional<platform::Error> removeItem(
        const std::string& path, const std::optional<platform::ItemVersion>& unchangedSince) override;
    std::optional<platform::Error> moveItem(const std::string& from, const std::string& to) override;
    platform::Result<platform::FileContent> contentToReplace(
        const std::string& path, std::size_t maximumBytes) const override;
    platform::Result<platform::ItemVersion> replaceContent(
        const std::string& path, const platform::FileContent& before, std::string_view content) override;
    std::optional<platform::Error> addDocument(
        const std::string& path, const std::string& like, std::string_view content) override;

private:
    std::shared_ptr<ItemChanges> _changes;
};

/// The extended attribute that hides a file's extension; its value is "1".
inline constexpr const char* hiddenExtensionAttribute = "user.tarrow.hidden-extension";

} // namespace host::system
