// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <optional>

namespace tarrow {

/// Remembers who was signed in when a person was asked something. The answer may come after a sign-out, and
/// must then change nothing, because it was meant for a drive that the person no longer has. Any thread.
class AccountSession {
public:
    /// Begins with the account of now.
    AccountSession()
        : _account(current())
    {
    }

    /// Answers whether somebody is signed in, and is the same person.
    bool isCurrent() const { return _account && current() == _account; }

private:
    static std::optional<PropertyValue> current()
    {
        return services().cloudDocumentService().account().identityToken();
    }

    std::optional<PropertyValue> _account;
};

} // namespace tarrow
