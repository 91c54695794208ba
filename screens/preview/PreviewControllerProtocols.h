// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <cstddef>

namespace screens {

class PreviewController;

/// Answers the documents that a preview shows. Main thread only.
class PreviewControllerDataSource {
public:
    virtual ~PreviewControllerDataSource() = default;
    virtual std::size_t numberOfPreviewItemsInPreviewController(
        const PreviewController& controller) const = 0;
    /// `index` is below the number of items.
    virtual Url previewControllerPreviewItemAtIndex(
        const PreviewController& controller, std::size_t index) const = 0;
};

/// Decides what the preview may do with a document. Main thread only.
class PreviewControllerDelegate {
public:
    virtual ~PreviewControllerDelegate() = default;
    virtual bool previewControllerCanEditItem(const PreviewController&, const Url&) { return false; }
    virtual bool previewControllerShouldSaveEditedItem(const PreviewController&, const Url&) { return false; }
    /// Answers whether sounds and films play in the platform's media player. Otherwise they show as icon and
    /// name.
    virtual bool previewControllerWantsDefaultMediaPlayer(const PreviewController&, const Url&)
    {
        return true;
    }
};

} // namespace screens
