// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "app/SchemeEntry.h"

#include "items/UrlResolution.h"
#include "platform/CloudDocumentService.h"
#include "platform/DocumentSharing.h"
#include "platform/Services.h"
#include "preview/PreviewMode.h"

namespace tarrow {

namespace {

std::optional<Url> targetOf(const Url& url)
{
    // Parsing the URL has already undone the outer encoding.
    const auto path = platform::percentDecoded(url.path());
    if (!path || !path->starts_with('/'))
        return std::nullopt;
    const auto location = services().cloudDocumentService().items().urlOfPath(*path);
    return location ? trw_URLByResolvingBookmark(*location) : std::nullopt;
}

int previewModeOf(const Url& url)
{
    int mode = PreviewModeQuick;
    for (const auto& item : url.queryItems()) {
        if (platform::percentDecoded(item.name) != "mode")
            continue;
        const auto value = platform::percentDecoded(item.value.value_or(""));
        if (value == "preview")
            mode = PreviewModeQuick;
        else if (value == "details" || value == "info")
            mode = PreviewModeDetails;
    }
    return mode;
}

} // namespace

std::optional<SchemeEntry> SchemeEntry::parse(std::string_view text)
{
    const auto url = Url::parse(text);
    if (!url || url->scheme() != platform::applicationScheme)
        return std::nullopt;
    return SchemeEntry{targetOf(*url), previewModeOf(*url)};
}

} // namespace tarrow
