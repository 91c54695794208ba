// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>
#include <string_view>

namespace platform {

/// Carries the values of saved interface state: objects encode theirs before the state is written, and decode
/// them after it was read at the next start. What comes back was on the disk meanwhile, so every value must
/// be checked. Main thread.
class StateCoder {
public:
    StateCoder() = default;
    /// Begins with values that were saved before.
    explicit StateCoder(PropertyDictionary values)
        : _values(std::move(values))
    {
    }

    /// Sets the value under a key, in place of one that is there.
    void encode(const std::string& key, PropertyValue value)
    {
        _values.insert_or_assign(key, std::move(value));
    }
    /// The value under a key; null when there is none. It is valid until the coder changes or ends.
    const PropertyValue* decode(std::string_view key) const { return find(_values, key); }
    /// All values, as they are written.
    const PropertyDictionary& values() const { return _values; }

private:
    PropertyDictionary _values;
};

} // namespace platform
