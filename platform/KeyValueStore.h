// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>

namespace platform {

/// Small values that the account's devices share. What another device or program changes is told by
/// Notification::KeyValueStoreDidChangeExternally, on the main thread, after the new values can be read.
class KeyValueStore {
public:
    virtual ~KeyValueStore() = default;
    /// The value under a key; nothing when there is none or the store cannot be read. Any thread.
    virtual std::optional<PropertyValue> objectForKey(const std::string& key) const = 0;
};

} // namespace platform
