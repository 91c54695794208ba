// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/DownloadRemoval.h"

#include "items/ItemContents.h"
#include "platform/Localization.h"
#include "screens/DisplayName.h"

namespace tarrow {

namespace {

/// Answers the error with a sentence that names the document.
Error named(const Url& url, const Error& error)
{
    if (error.text(platform::errorKey::localizedDescription))
        return error;
    return Error(error.domain(), error.code(),
        {{std::string(platform::errorKey::localizedDescription),
             platform::localized("The download of “%@” was kept, because another program uses it.",
                 {screens::displayName(url.lastPathComponent())})},
            {std::string(platform::errorKey::filePath), url.path()}});
}

} // namespace

RemovedDownloads removeDownloads(ItemChange& change)
{
    auto found = findDocuments(change.items(), ContentPlace::Here, change.stillWanted());
    change.setCount(found.documents.size());
    RemovedDownloads outcome;
    outcome.errors = std::move(found.errors);
    for (const auto& document : found.documents) {
        if (!change.isWanted())
            break;
        if (const auto error = FileUtils::evict(document))
            outcome.errors.push_back(named(document, *error));
        else
            ++outcome.removed;
        change.oneDone();
    }
    outcome.isWhole = change.isWanted();
    return outcome;
}

} // namespace tarrow
