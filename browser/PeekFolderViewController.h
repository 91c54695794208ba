// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "screens/list/DocumentListController.h"

namespace tarrow {

/// The folder list that a peek at a folder shows. Main thread.
class PeekFolderViewController : public screens::DocumentListController {
public:
    static std::shared_ptr<PeekFolderViewController> initWithURL(const platform::Url& url);
    /// Looks at nothing, for a folder whose name is known.
    static std::shared_ptr<PeekFolderViewController> initWithURLTitle(
        const platform::Url& url, const std::string& title);

    using DocumentListController::DocumentListController;

    /// The actions that the peek itself would offer. The program sets none.
    const kit::Menu& previewActionItems() const { return _previewActionItems; }
    void setPreviewActionItems(kit::Menu items) { _previewActionItems = std::move(items); }

    /// A peek has no room for a search field.
    bool shouldShowSearch() const override { return false; }

private:
    kit::Menu _previewActionItems;
};

} // namespace tarrow
