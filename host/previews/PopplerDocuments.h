// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PagedDocument.h"

namespace host::previews {

/// Opens PDF documents with Poppler. A page is drawn on the calling thread, so call it on a worker.
class PopplerDocuments : public platform::PagedDocumentOpener {
public:
    platform::Result<std::shared_ptr<platform::PagedDocument>> open(const std::string& path) const override;
    platform::Result<std::shared_ptr<platform::PagedDocumentEditing>> openForEditing(
        std::shared_ptr<const std::string> bytes) const override;
};

} // namespace host::previews
