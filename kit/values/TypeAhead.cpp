// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TypeAhead.h"

namespace kit {

namespace {

constexpr double nanosecondsPerSecond = 1e9;

} // namespace

bool TypeAhead::isActive(Date now) const
{
    const auto since = static_cast<double>(now.nanoseconds - _last.nanoseconds);
    return !_text.empty() && since <= pause * nanosecondsPerSecond;
}

void TypeAhead::type(std::string_view character, Date now)
{
    if (!isActive(now)) {
        _text.clear();
        _first = character;
    }
    _text += character;
    _last = now;
}

bool TypeAhead::isRepeated() const
{
    for (std::size_t at = 0; at < _text.size(); at += _first.size()) {
        if (_text.compare(at, _first.size(), _first) != 0)
            return false;
    }
    return true;
}

std::string_view TypeAhead::sought() const
{
    return isRepeated() ? std::string_view(_first) : std::string_view(_text);
}

std::size_t TypeAhead::start(std::size_t focused) const
{
    return isRepeated() ? focused + 1 : focused;
}

} // namespace kit
