// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Date.h"

#include <cstdint>
#include <string>

namespace platform {

/// How many bytes make a kilobyte.
enum class ByteCountStyle {
    File, ///< 1000, as file sizes are shown
    Binary, ///< 1024, as memory is counted
};
/// Whether a byte count names its unit.
enum class ByteCountUnit { Included, LeftOut };

/// How much of a date or a time is written, from "31/12/24" to "Tuesday, 31 December 2024" (in the language's
/// own order). None leaves that part out.
enum class DateStyle { None = 0, Short = 1, Medium = 2, Long = 3, Full = 4 };

/// Writes numbers and dates in the user's language and region. Any thread may call; no call fails. The texts
/// are for people: nothing reads them back.
class Formatters {
public:
    virtual ~Formatters() = default;

    /// Writes a size such as "1.2 GB", or "1.2" without its unit. There is no fraction up to kilobytes, at
    /// most one digit of it for megabytes and at most two from gigabytes on; petabytes are the largest unit.
    /// A size of 0 reads "Zero KB", and "0" without its unit.
    virtual std::string byteCount(std::uint64_t bytes, ByteCountStyle style, ByteCountUnit unit) const = 0;
    /// The number that byteCount() shows, rounded in the same way, for the choice of a plural form.
    virtual double byteCountNumber(std::uint64_t bytes, ByteCountStyle style) const = 0;
    /// Writes a whole number with the language's digits and grouping, such as "12,345".
    virtual std::string number(std::int64_t value) const = 0;
    /// Writes a date and a time of day in the user's time zone. The answer is empty when both styles are
    /// None.
    virtual std::string date(Date date, DateStyle dateStyle, DateStyle timeStyle) const = 0;
    /// Whether two texts are the same but for letter case, by the rules of the language; accents count. Texts
    /// that are no UTF-8 are compared with replacement characters in place of what is broken.
    virtual bool equalIgnoringCase(const std::string& a, const std::string& b) const = 0;
};

} // namespace platform
