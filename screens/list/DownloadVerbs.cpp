// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DownloadVerbs.h"

#include "platform/CloudDocumentService.h"
#include "platform/CloudItems.h"
#include "platform/Localization.h"
#include "platform/Services.h"

namespace screens {

namespace {

bool mayBeInCloud(const RowItem& item)
{
    return item.isPromise || opensAsFolder(item.kind);
}

bool mayBeHere(const RowItem& item)
{
    return !item.isPromise && item.kind != FolderEntryKind::Link;
}

void addEntry(kit::Menu& menu, std::string title,
    const std::function<void(const std::vector<Url>& items)>& verb, const std::vector<RowItem>& items,
    bool (*applies)(const RowItem&))
{
    std::vector<Url> urls;
    for (const auto& item : items) {
        if (applies(item))
            urls.push_back(item.url);
    }
    if (verb && !urls.empty())
        menu.push_back({.title = std::move(title),
            .handler = [verb, urls = std::move(urls)] { verb(urls); },
            .image = {}});
}

} // namespace

void addDownloadEntries(kit::Menu& menu, const DownloadVerbs& verbs, const std::vector<RowItem>& items)
{
    auto& cloud = services().cloudDocumentService().items();
    if (items.size() == 1 && cloud.downloadProgress(items.front().url)) {
        menu.push_back({.title = localized("Cancel Download"),
            .handler =
                [url = items.front().url] { services().cloudDocumentService().items().cancelDownload(url); },
            .image = {}});
        return;
    }
    addEntry(menu, localized("Download"), verbs.download, items, mayBeInCloud);
    addEntry(menu, localized("Remove Download"), verbs.remove, items, mayBeHere);
}

} // namespace screens
