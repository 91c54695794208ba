// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

namespace platform {

/// Permission to use a location that the system grants for a while only, such as a document that the user
/// picked outside the drive. The local drive needs none, so its answers are all false. Any thread may call.
class SecurityScopedAccess {
public:
    virtual ~SecurityScopedAccess() = default;

    /// Begins access to a location and answers whether access was begun. False is no failure: the location
    /// needs no permission, or there is none, and using it will tell which.
    virtual bool startAccessing(const Url& url) = 0;
    /// Ends one access. It must be called once for every call of startAccessing() that answered true, and for
    /// no other.
    virtual void stopAccessing(const Url& url) = 0;
};

} // namespace platform
