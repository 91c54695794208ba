// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/Error.h"
#include "platform/PropertyValue.h"

#include <functional>
#include <optional>

namespace platform {

/// The signed-in cloud account. Notification::CloudIdentityDidChange is posted on the main thread when
/// another account, or none, is signed in; it is not posted when the same account's record is merely written
/// again.
class CloudAccount {
public:
    virtual ~CloudAccount() = default;

    /// Answers a token that tells accounts apart. It may be kept and compared, but its content means nothing.
    /// It is nothing when nobody is signed in, and when the account's record cannot be read, which is logged
    /// with the reason. Any thread may ask; each call reads at most one small file.
    virtual std::optional<PropertyValue> identityToken() const = 0;
    /// Answers what the last call of identityToken() answered, whoever made it: the account that the program
    /// knows of. It reads only when there was no such call. Any thread.
    virtual std::optional<PropertyValue> knownIdentityToken() const = 0;

    /// Makes an operation, to be put into an operation queue, that asks the account how many bytes are free.
    /// It calls `completion` once, on the thread that runs it, with the number of free bytes, or with the
    /// error of the system or the cloud. The operation may wait for a disk or a network. It keeps nothing of
    /// this object, so it may run after the account was changed.
    virtual Work makeQuotaFetchOperation(std::function<void(Result<std::int64_t>)> completion) const = 0;
};

} // namespace platform
