// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/previews/MakePreviewLibraries.h"

#include "host/previews/DocumentThumbnails.h"
#include "host/previews/MediaPeer.h"
#include "host/previews/PdfPrinting.h"
#include "host/previews/PopplerDocuments.h"
#include "host/previews/TextPeer.h"
#include "host/previews/UchardetDecoder.h"

namespace host::previews {

namespace {
using gtk::PreviewPeer;

class Libraries : public gtk::PreviewLibraries {
public:
    const platform::PagedDocumentOpener& pagedDocuments() const override { return _documents; }
    const platform::TextDecoder& textDecoder() const override { return _decoder; }
    const platform::ThumbnailMaker& thumbnails() const override { return _thumbnails; }
    platform::Result<std::shared_ptr<gtk::PrintablePages>> readPrintablePdf(
        const std::string& path) const override
    {
        return previews::readPrintablePdf(path);
    }
    std::shared_ptr<PreviewPeer> makeTextPeer(
        const std::shared_ptr<screens::PreviewTextView>& view) const override
    {
        return std::make_shared<TextPeer>(view);
    }
    std::shared_ptr<PreviewPeer> makeMediaPeer(
        const std::shared_ptr<screens::PreviewMediaView>& view) const override
    {
        return std::make_shared<MediaPeer>(view);
    }

private:
    PopplerDocuments _documents;
    UchardetDecoder _decoder;
    DocumentThumbnails _thumbnails;
};

} // namespace

} // namespace host::previews

void trwMakePreviewLibraries(std::shared_ptr<host::gtk::PreviewLibraries>& made)
{
    made = std::make_shared<host::previews::Libraries>();
}
