// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace platform {

/// What the preview can show.
class PreviewSupport {
public:
    virtual ~PreviewSupport() = default;
    /// Whether the preview has a view for what is at this location, judged by its type; the content is not
    /// read. Any thread.
    virtual bool canPreview(const Url& url) const = 0;
};

} // namespace platform
