// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

namespace tarrow {

/// Holds security-scoped access to a location for as long as this object lives, when the location needs it.
class AccessScope {
public:
    explicit AccessScope(const Url& url)
        : _url(url)
        , _started(access().startAccessing(url))
    {
    }
    ~AccessScope()
    {
        if (_started)
            access().stopAccessing(_url);
    }
    AccessScope(const AccessScope&) = delete;
    AccessScope& operator=(const AccessScope&) = delete;

private:
    static platform::SecurityScopedAccess& access()
    {
        return services().cloudDocumentService().securityScopedAccess();
    }

    Url _url;
    bool _started;
};

} // namespace tarrow
