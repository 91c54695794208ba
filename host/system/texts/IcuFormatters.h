// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Formatters.h"

#include <memory>
#include <string>

namespace host::system {

/// Texts by ICU's locale data. Byte counts use bytes, KB, MB, GB, TB and PB. An amount that rounds up to a
/// full unit is shown in that unit, and zero as "Zero KB" ("0" without its unit).
class IcuFormatters : public platform::Formatters {
public:
    /// `locale` is ICU's name of a locale. `timeZone` is a name such as "Europe/Vienna"; empty means the
    /// system's.
    explicit IcuFormatters(const std::string& locale, const std::string& timeZone = {});
    ~IcuFormatters() override;

    std::string byteCount(
        std::uint64_t bytes, platform::ByteCountStyle style, platform::ByteCountUnit unit) const override;
    double byteCountNumber(std::uint64_t bytes, platform::ByteCountStyle style) const override;
    std::string number(std::int64_t value) const override;
    std::string date(
        platform::Date date, platform::DateStyle dateStyle, platform::DateStyle timeStyle) const override;
    bool equalIgnoringCase(const std::string& a, const std::string& b) const override;

private:
    struct Data;
    std::unique_ptr<Data> _data;
};

} // namespace host::system
