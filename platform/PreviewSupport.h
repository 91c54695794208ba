// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace platform {

/// Tells which documents the quick preview has a view for.
class PreviewSupport {
public:
    virtual ~PreviewSupport() = default;
    /// Whether the preview has a view for the document at a location. It is judged by the type of the name's
    /// extension; the content is not read, and the document need not be here. The answer is false for folders
    /// and for what is no file URL. Any thread.
    virtual bool canPreview(const Url& url) const = 0;
};

} // namespace platform
