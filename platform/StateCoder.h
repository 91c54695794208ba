// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>
#include <string_view>

namespace platform {

/// The values of saved interface state. Main thread.
class StateCoder {
public:
    StateCoder() = default;
    explicit StateCoder(PropertyDictionary values)
        : _values(std::move(values))
    {
    }

    void encode(const std::string& key, PropertyValue value)
    {
        _values.insert_or_assign(key, std::move(value));
    }
    /// The value under a key; null when there is none.
    const PropertyValue* decode(std::string_view key) const { return find(_values, key); }
    const PropertyDictionary& values() const { return _values; }

private:
    PropertyDictionary _values;
};

} // namespace platform
