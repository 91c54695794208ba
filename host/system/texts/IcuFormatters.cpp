// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/IcuFormatters.h"

#include "host/system/texts/Translate.h"

#include <unicode/coll.h>
#include <unicode/datefmt.h>
#include <unicode/measunit.h>
#include <unicode/numberformatter.h>
#include <unicode/timezone.h>

#include <array>
#include <cmath>
#include <mutex>

namespace host::system {

using icu::number::LocalizedNumberFormatter;
using platform::ByteCountStyle;
using platform::ByteCountUnit;
using platform::DateStyle;

namespace {

constexpr int unitCount = 6; // bytes, KB, MB, GB, TB, PB
constexpr int styleCount = 5;

/// Answers the largest number of fraction digits that a unit shows.
int fractionDigits(int unit)
{
    return unit <= 1 ? 0 : unit == 2 ? 1 : 2;
}

/// An amount in its best unit, rounded as it is shown.
struct Amount {
    double number;
    int unit;
};

Amount amount(std::uint64_t bytes, ByteCountStyle style)
{
    const double base = style == ByteCountStyle::File ? 1000 : 1024;
    auto value = static_cast<double>(bytes);
    for (int unit = 0;; ++unit, value /= base) {
        const double scale = std::pow(10, fractionDigits(unit));
        const double shown = std::round(value * scale) / scale;
        if (shown < base || unit == unitCount - 1)
            return {shown, unit};
    }
}

std::string utf8(const icu::UnicodeString& text)
{
    std::string out;
    return text.toUTF8String(out);
}

std::string formatted(const LocalizedNumberFormatter& formatter, double value)
{
    UErrorCode status = U_ZERO_ERROR;
    return utf8(formatter.formatDouble(value, status).toString(status));
}

icu::MeasureUnit measureUnit(int unit)
{
    switch (unit) {
    case 0:
        return icu::MeasureUnit::getByte();
    case 1:
        return icu::MeasureUnit::getKilobyte();
    case 2:
        return icu::MeasureUnit::getMegabyte();
    case 3:
        return icu::MeasureUnit::getGigabyte();
    case 4:
        return icu::MeasureUnit::getTerabyte();
    default:
        return icu::MeasureUnit::getPetabyte();
    }
}

icu::DateFormat::EStyle icuStyle(DateStyle style)
{
    static constexpr icu::DateFormat::EStyle styles[] = {icu::DateFormat::kNone, icu::DateFormat::kShort,
        icu::DateFormat::kMedium, icu::DateFormat::kLong, icu::DateFormat::kFull};
    return styles[static_cast<std::size_t>(style)];
}

/// Replaces "kB", which the locale data has for many languages, by "KB".
std::string withCapitalK(std::string text)
{
    if (const auto unit = text.find("kB"); unit != std::string::npos)
        text[unit] = 'K';
    return text;
}

} // namespace

struct IcuFormatters::Data {
    icu::Locale locale;
    std::unique_ptr<icu::TimeZone> timeZone;
    LocalizedNumberFormatter integer;
    std::array<LocalizedNumberFormatter, unitCount> withUnit, withoutUnit;
    std::unique_ptr<icu::Collator> collator;
    // The formats are made at the first use, because each takes about a tenth of a millisecond.
    std::mutex datesMutex;
    std::array<std::unique_ptr<icu::DateFormat>, styleCount * styleCount> dates;

    icu::DateFormat* dateFormat(DateStyle dateStyle, DateStyle timeStyle)
    {
        auto& format =
            dates[static_cast<std::size_t>(dateStyle) * styleCount + static_cast<std::size_t>(timeStyle)];
        if (!format) {
            format.reset(
                icu::DateFormat::createDateTimeInstance(icuStyle(dateStyle), icuStyle(timeStyle), locale));
            if (format)
                format->setTimeZone(*timeZone);
        }
        return format.get();
    }
};

IcuFormatters::IcuFormatters(const std::string& locale, const std::string& timeZone)
    : _data(std::make_unique<Data>())
{
    _data->locale = icu::Locale(locale.c_str());
    _data->timeZone.reset(
        timeZone.empty() ? icu::TimeZone::createDefault() : icu::TimeZone::createTimeZone(timeZone.c_str()));
    const auto formatter = icu::number::NumberFormatter::withLocale(_data->locale);
    _data->integer = formatter.precision(icu::number::Precision::integer());
    for (int unit = 0; unit < unitCount; ++unit) {
        const auto plain = formatter.precision(icu::number::Precision::maxFraction(fractionDigits(unit)));
        const auto index = static_cast<std::size_t>(unit);
        _data->withoutUnit[index] = plain;
        _data->withUnit[index] =
            plain.unit(measureUnit(unit))
                .unitWidth(unit == 0 ? UNUM_UNIT_WIDTH_FULL_NAME : UNUM_UNIT_WIDTH_SHORT);
    }
    UErrorCode status = U_ZERO_ERROR;
    _data->collator.reset(icu::Collator::createInstance(_data->locale, status));
    // Secondary strength distinguishes accents but not letter case.
    if (_data->collator)
        _data->collator->setStrength(icu::Collator::SECONDARY);
}

IcuFormatters::~IcuFormatters() = default;

std::string IcuFormatters::byteCount(std::uint64_t bytes, ByteCountStyle style, ByteCountUnit unit) const
{
    if (bytes == 0 && unit == ByteCountUnit::Included)
        return translated("Zero KB");
    const auto [number, index] = amount(bytes, style);
    const auto& formatters = unit == ByteCountUnit::Included ? _data->withUnit : _data->withoutUnit;
    return withCapitalK(formatted(formatters[static_cast<std::size_t>(index)], number));
}

double IcuFormatters::byteCountNumber(std::uint64_t bytes, ByteCountStyle style) const
{
    return amount(bytes, style).number;
}

std::string IcuFormatters::number(std::int64_t value) const
{
    UErrorCode status = U_ZERO_ERROR;
    return utf8(_data->integer.formatInt(value, status).toString(status));
}

std::string IcuFormatters::date(platform::Date date, DateStyle dateStyle, DateStyle timeStyle) const
{
    if (dateStyle == DateStyle::None && timeStyle == DateStyle::None)
        return {};
    const std::lock_guard lock(_data->datesMutex);
    const auto* format = _data->dateFormat(dateStyle, timeStyle);
    icu::UnicodeString text;
    return format ? utf8(format->format(static_cast<UDate>(date.seconds() * 1000), text)) : std::string();
}

bool IcuFormatters::equalIgnoringCase(const std::string& a, const std::string& b) const
{
    if (a == b || !_data->collator)
        return a == b;
    UErrorCode status = U_ZERO_ERROR;
    return _data->collator->compareUTF8(a, b, status) == UCOL_EQUAL && U_SUCCESS(status);
}

} // namespace host::system
