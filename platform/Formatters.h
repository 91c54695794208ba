// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"

#include <cstdint>
#include <string>

namespace platform {

enum class ByteCountStyle {
    File, ///< units of 1000, as file sizes are shown
    Binary, ///< units of 1024
};
enum class ByteCountUnit { Included, LeftOut };

enum class DateStyle { None = 0, Short = 1, Medium = 2, Long = 3, Full = 4 };

/// Numbers and dates in the user's language and region. Any thread.
class Formatters {
public:
    virtual ~Formatters() = default;

    /// A size such as "1.2 GB", or "1.2" without its unit: no fraction up to kilobytes, at most one digit for
    /// megabytes, at most two from gigabytes on.
    virtual std::string byteCount(std::uint64_t bytes, ByteCountStyle style, ByteCountUnit unit) const = 0;
    /// The number that byteCount() shows without its unit.
    virtual double byteCountNumber(std::uint64_t bytes, ByteCountStyle style) const = 0;
    /// A whole number with the language's digits and grouping.
    virtual std::string number(std::int64_t value) const = 0;
    virtual std::string date(Date date, DateStyle dateStyle, DateStyle timeStyle) const = 0;
    /// Whether two texts are the same but for letter case, by the rules of the language.
    virtual bool equalIgnoringCase(const std::string& a, const std::string& b) const = 0;
};

} // namespace platform
