// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <optional>
#include <string>

namespace platform {

/// Small values that the program keeps between runs on this device. Main thread only. A value that is set can
/// be read at once, and is written to the disk in the background; one that cannot be written is logged and
/// tried again with the next one.
class UserDefaults {
public:
    virtual ~UserDefaults() = default;
    /// Answers the value under a key; nothing when there is none, when it is damaged, and when the store
    /// cannot be read.
    virtual std::optional<Data> data(const std::string& key) const = 0;
    /// Sets the value under a key, in place of the one before.
    virtual void setData(const std::string& key, Data value) = 0;
    /// Removes the value under a key; it is no error when there is none.
    virtual void remove(const std::string& key) = 0;
};

/// Turns values into data that can be stored, and back. Any thread may call.
class KeyedArchiver {
public:
    virtual ~KeyedArchiver() = default;
    /// Archives a value of any kind. It cannot fail; but what exceeds the limits below cannot be read again.
    virtual Data archive(const PropertyValue& value) const = 0;
    /// Answers the value that archive() made the data from, of the same kinds. It answers nothing for data
    /// that is damaged, larger than 64 KiB, nested deeper than 32 levels or made by a newer version, because
    /// such data may come from a file that others wrote.
    virtual std::optional<PropertyValue> unarchive(const Data& data) const = 0;
};

} // namespace platform
