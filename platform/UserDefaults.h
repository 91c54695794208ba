// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>

namespace platform {

/// Small values that the program keeps between runs. Main thread; writes are stored without waiting for the
/// disk.
class UserDefaults {
public:
    virtual ~UserDefaults() = default;
    /// The value under a key; nothing when there is none, it is no data, or the store cannot be read.
    virtual std::optional<Data> data(const std::string& key) const = 0;
    virtual void setData(const std::string& key, Data value) = 0;
    virtual void remove(const std::string& key) = 0;
};

/// Turns values into data and back. Any thread.
class KeyedArchiver {
public:
    virtual ~KeyedArchiver() = default;
    virtual Data archive(const PropertyValue& value) const = 0;
    /// Nothing for data that is damaged, larger than 64 KiB, nested deeper than 32 levels, or made by a newer
    /// version.
    virtual std::optional<PropertyValue> unarchive(const Data& data) const = 0;
};

} // namespace platform
