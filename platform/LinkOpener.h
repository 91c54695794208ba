// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>

namespace platform {

/// Opens pages of the web in the person's own browser.
class LinkOpener {
public:
    using Completion = std::function<void(std::optional<Error>)>;

    virtual ~LinkOpener() = default;

    /// Opens an http or https URL; anything else is refused with FileErrorCode::Unsupported. The completion
    /// is called once, on the main queue. Main thread.
    virtual void openLink(const std::string& url, Completion completion) = 0;
};

} // namespace platform
