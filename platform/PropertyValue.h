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

/// Bytes that nobody interprets.
using Data = std::vector<std::byte>;

class PropertyValue;
/// An ordered list of values.
using PropertyArray = std::vector<PropertyValue>;
/// Values under keys that are texts; it can be asked with a string_view without a copy.
using PropertyDictionary = std::map<std::string, PropertyValue, std::less<>>;

/// A value that can be kept: in an error's or a notice's user information, in archives, in the key-value
/// store and in saved interface state. It is null, a boolean, a number, a text, data, a date, a URL, an array
/// or a dictionary. It is a plain value: a copy shares nothing that can change.
class PropertyValue {
public:
    /// The kinds in which a value is held. Integers keep the signedness that they came with.
    using Variant = std::variant<std::monostate, bool, std::int64_t, std::uint64_t, double, std::string, Data,
        Date, Url, PropertyArray, PropertyDictionary>;

    /// Makes the null value; the constructors below make a value of their argument's kind.
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

    /// The value for std::visit.
    const Variant& variant() const { return _value; }
    /// Whether the value is null.
    bool isNull() const { return std::holds_alternative<std::monostate>(_value); }

    /// The value when it is of exactly this kind of Variant, else a null pointer: an int64_t is not found as
    /// a double.
    template <typename T>
    const T* get() const
    {
        return std::get_if<T>(&_value);
    }

    /// Answers a value of any of the number kinds as an integer. It answers nothing for another kind (a
    /// boolean is no number), for a fraction and for a number that does not fit.
    std::optional<std::int64_t> asInteger() const;
    std::optional<std::uint64_t> asUnsigned() const;

    /// Two values are equal when their kinds and contents are: 1 as a double is not 1 as an integer.
    bool operator==(const PropertyValue&) const = default;

private:
    Variant _value;
};

/// Finds the value under a key; null when the dictionary has none. The pointer is valid until the dictionary
/// changes.
const PropertyValue* find(const PropertyDictionary& dictionary, std::string_view key);

} // namespace platform
