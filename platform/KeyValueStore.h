// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>

namespace platform {

/// Small values that the account's devices share, such as the names and colours of tags. The program only
/// reads them. When another device or program changes them, Notification::KeyValueStoreDidChangeExternally is
/// posted on the main thread, and the new values can be read by then.
class KeyValueStore {
public:
    virtual ~KeyValueStore() = default;
    /// Answers the value under a key; nothing when there is none, and when the store is missing or cannot be
    /// read, which is logged with the reason. The first call reads one file of at most 1 MiB; later calls are
    /// answered from memory. Any thread.
    virtual std::optional<PropertyValue> objectForKey(const std::string& key) const = 0;
};

} // namespace platform
