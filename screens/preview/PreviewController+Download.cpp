// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/Formatters.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/ErrorWords.h"
#include "screens/PlaceholderView.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewContent.h"
#include "screens/preview/PreviewController.h"
#include "screens/preview/PreviewLoader.h"
#include "screens/preview/PreviewScreenView.h"

#include <utility>

namespace screens {

namespace {

std::string progressText(const DownloadProgress& progress)
{
    const auto size = [](std::uint64_t bytes) {
        return services().formatters().byteCount(bytes, ByteCountStyle::File, ByteCountUnit::Included);
    };
    if (!progress.total)
        return localized("Downloading…");
    return localized("Downloading %1$@ of %2$@", {size(progress.done), size(*progress.total)});
}

std::optional<double> share(const DownloadProgress& progress)
{
    if (!progress.total || *progress.total == 0)
        return std::nullopt;
    return static_cast<double>(progress.done) / static_cast<double>(*progress.total);
}

} // namespace

void PreviewController::startDownload()
{
    if (_download || !_isDownloadWanted || !_content || _content->kind != PreviewContent::Kind::InCloud)
        return;
    _summary = nullptr;
    _download = services().cloudDocumentService().items().startDownload(*_item,
        {.progress = weakly(this, &PreviewController::showDownload),
            .completion = weakly(this, &PreviewController::downloadEnded)});
    showDownload({});
}

void PreviewController::showDownload(const DownloadProgress& progress)
{
    if (!_download || !_content || !_screen)
        return;
    if (!_summary) {
        _summary = PlaceholderView::create();
        _summary->setActions({{localized("Cancel"), weakly(this, &PreviewController::cancelDownload)}});
        _screen->setContent(_summary);
        connectPreview();
    }
    const auto done = share(progress);
    _summary->setContent({.iconName = _content->iconName,
        .title = _content->title,
        .message = progressText(progress),
        .isBusy = !done,
        .progress = done});
}

void PreviewController::cancelDownload()
{
    _isDownloadWanted = false;
    if (!_download)
        return;
    _download->cancel();
    _download = nullptr;
    if (_content && _screen)
        showSummary();
}

void PreviewController::startAgain()
{
    _isDownloadWanted = true;
    if (!_content)
        return;
    // A failed download leaves the promise as it was.
    auto promised = *_content;
    promised.kind = PreviewContent::Kind::InCloud;
    promised.canRetry = false;
    promised.note = localized("This document is in the cloud. It is not downloaded yet.");
    _content = std::make_shared<const PreviewContent>(std::move(promised));
    startDownload();
}

void PreviewController::leaveDownload()
{
    if (_download)
        _download->cancel();
    _download = nullptr;
    _isDownloadWanted = true;
}

void PreviewController::downloadEnded(const std::optional<Error>& error)
{
    // The download itself calls this function, so it is destroyed only after the call.
    const auto ended = std::shared_ptr<ItemDownload>(std::move(_download));
    services().dispatch().mainQueue()->async([ended] {});
    if (!error) {
        load(previewLimitsForMainScreen());
        return;
    }
    // The download was cancelled from another screen, such as the list.
    if (error->is(FileErrorCode::Cancelled)) {
        _isDownloadWanted = false;
        if (_screen)
            showSummary();
        return;
    }
    auto failure = *_content;
    failure.kind = PreviewContent::Kind::Failure;
    failure.note = localized("It could not be downloaded.") + '\n' + errorWords(*error);
    failure.canRetry = true;
    show(std::make_shared<const PreviewContent>(std::move(failure)));
}

} // namespace screens
