// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>

namespace platform {

/// Opens pages of the web in the person's own browser. Main thread only.
class LinkOpener {
public:
    /// Hears once, on the main queue, why the page could not be opened, or nothing when the browser took it
    /// over.
    using Completion = std::function<void(std::optional<Error>)>;

    virtual ~LinkOpener() = default;

    /// Opens an http or https URL and returns at once. Anything else is refused with
    /// FileErrorCode::Unsupported, so that a text from elsewhere cannot start another program. Other errors
    /// are the system's, with a sentence for the user.
    virtual void openLink(const std::string& url, Completion completion) = 0;
};

} // namespace platform
