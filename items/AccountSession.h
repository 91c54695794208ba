// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <optional>

namespace tarrow {

/// Remembers who was signed in when a person was asked something. The answer may come after a sign-out, and
/// must then change nothing, because it was meant for a drive that the person no longer has. Main thread but
/// for the last question.
class AccountSession {
public:
    /// Begins with the account that the program knows of.
    AccountSession()
        : _account(account().knownIdentityToken())
    {
    }

    /// Answers whether somebody is signed in, and is the same person, as far as the program has heard.
    bool isCurrent() const { return _account && account().knownIdentityToken() == _account; }
    /// Asks the same of the account itself, which reads a small file. Whoever changes items asks this. Any
    /// thread.
    bool isSignedIn() const { return _account && account().identityToken() == _account; }

private:
    static platform::CloudAccount& account() { return services().cloudDocumentService().account(); }

    std::optional<PropertyValue> _account;
};

} // namespace tarrow
