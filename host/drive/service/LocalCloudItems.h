// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/LocalDocumentIdentifiers.h"
#include "host/drive/records/DriveDependencies.h"
#include "host/drive/records/DriveLayout.h"
#include "host/drive/service/RunningDownloads.h"
#include "platform/CloudItems.h"
#include "platform/Dispatch.h"

namespace host::drive {

struct Bookmark;

/// Finds and downloads items of the local store.
class LocalCloudItems : public platform::CloudItems {
public:
    LocalCloudItems(DriveLayout layout, std::shared_ptr<LocalDocumentIdentifiers> identifiers,
        std::shared_ptr<CloudStore> store, const DriveDependencies& dependencies);

    bool isInDocumentsArea(const platform::Url& url) const override;
    bool isInTrash(const platform::Url& url) const override;
    platform::Url realURL(const platform::Url& url) const override;
    std::optional<platform::Url> urlOfPath(const std::string& path) const override;
    void RZBookmarkableStringFromDocumentURL(const platform::Url& url,
        std::function<void(platform::Result<std::string>)> completion) const override;
    std::unique_ptr<platform::ItemDownload> startDownload(
        const platform::Url& url, platform::DownloadHandlers handlers) override;
    void download(const platform::Url& url,
        std::function<void(const std::optional<platform::Error>&)> completion) override;
    std::optional<platform::DownloadProgress> downloadProgress(const platform::Url& url) const override;
    void cancelDownload(const platform::Url& url) override;
    void decodeBookmark(const std::string& bookmark,
        std::function<void(platform::Result<platform::Url>)> completion) const override;

private:
    using Completion = std::function<void(const std::optional<platform::Error>&)>;
    Completion identifying(const platform::Url& url, Completion completion) const;

    DriveLayout _layout;
    std::shared_ptr<LocalDocumentIdentifiers> _identifiers;
    std::shared_ptr<RunningDownloads> _downloads;
    std::shared_ptr<platform::Queue> _queue;
};

} // namespace host::drive
