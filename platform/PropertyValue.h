// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"
#include "platform/Url.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace platform {

using Data = std::vector<std::byte>;

class PropertyValue;
using PropertyArray = std::vector<PropertyValue>;
using PropertyDictionary = std::map<std::string, PropertyValue, std::less<>>;

/// A value that can be kept: in user-information maps, archives, the key-value store and saved interface
/// state.
class PropertyValue {
public:
    using Variant = std::variant<std::monostate, bool, std::int64_t, std::uint64_t, double, std::string, Data,
        Date, Url, PropertyArray, PropertyDictionary>;

    PropertyValue() = default;
    PropertyValue(bool value)
        : _value(value)
    {
    }
    PropertyValue(int value)
        : _value(static_cast<std::int64_t>(value))
    {
    }
    PropertyValue(std::int64_t value)
        : _value(value)
    {
    }
    PropertyValue(std::uint64_t value)
        : _value(value)
    {
    }
    PropertyValue(double value)
        : _value(value)
    {
    }
    PropertyValue(const char* value)
        : _value(std::string(value))
    {
    }
    PropertyValue(std::string value)
        : _value(std::move(value))
    {
    }
    PropertyValue(Data value)
        : _value(std::move(value))
    {
    }
    PropertyValue(Date value)
        : _value(value)
    {
    }
    PropertyValue(Url value)
        : _value(std::move(value))
    {
    }
    PropertyValue(PropertyArray value)
        : _value(std::move(value))
    {
    }
    PropertyValue(PropertyDictionary value)
        : _value(std::move(value))
    {
    }

    const Variant& variant() const { return _value; }
    bool isNull() const { return std::holds_alternative<std::monostate>(_value); }

    /// The value when it is of just this kind, else null.
    template <typename T>
    const T* get() const
    {
        return std::get_if<T>(&_value);
    }

    /// Any of the number kinds as an integer of this width; nothing for another kind, for a fraction and for
    /// a number that does not fit.
    std::optional<std::int64_t> asInteger() const;
    std::optional<std::uint64_t> asUnsigned() const;

    bool operator==(const PropertyValue&) const = default;

private:
    Variant _value;
};

/// The value under a key; null when the dictionary has none.
const PropertyValue* find(const PropertyDictionary& dictionary, std::string_view key);

} // namespace platform
