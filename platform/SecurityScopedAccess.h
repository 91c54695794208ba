// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace platform {

/// Leave to use a location that the system grants for a while only (a document that the user picked outside
/// the drive). Any thread.
class SecurityScopedAccess {
public:
    virtual ~SecurityScopedAccess() = default;

    /// Begins access and answers whether it was begun; false where the location needs no leave, or has none.
    virtual bool startAccessing(const Url& url) = 0;
    /// Ends one access that startAccessing() began. Call it once for each.
    virtual void stopAccessing(const Url& url) = 0;
};

} // namespace platform
