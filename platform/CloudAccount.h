// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/Error.h"
#include "platform/PropertyValue.h"

#include <functional>
#include <optional>

namespace platform {

/// The signed-in cloud account. Notification::CloudIdentityDidChange is posted on the main thread when it
/// changes.
class CloudAccount {
public:
    virtual ~CloudAccount() = default;

    /// What tells accounts apart, to be kept and compared but not looked into; nothing when signed out, when
    /// the drive is off and when the account's record cannot be read. Any thread; at most one small file is
    /// read.
    virtual std::optional<PropertyValue> identityToken() const = 0;

    /// An operation for an operation queue that asks how many bytes are free and calls `completion` once, on
    /// the thread that runs it, with the number or the error.
    virtual Work makeQuotaFetchOperation(std::function<void(Result<std::int64_t>)> completion) const = 0;
};

} // namespace platform
