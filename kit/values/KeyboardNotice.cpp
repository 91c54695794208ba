// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/KeyboardNotice.h"

#include <array>

namespace kit {

namespace {

double number(const PropertyDictionary& dictionary, std::string_view key, double otherwise)
{
    const auto* value = find(dictionary, key);
    if (!value)
        return otherwise;
    if (const auto* real = value->get<double>())
        return *real;
    const auto integer = value->asInteger();
    return integer ? static_cast<double>(*integer) : otherwise;
}

Rect rect(const PropertyDictionary& dictionary, std::string_view key, const Rect& otherwise)
{
    const auto* value = find(dictionary, key);
    const auto* sides = value ? value->get<PropertyDictionary>() : nullptr;
    if (!sides)
        return otherwise;
    return {number(*sides, "x", 0), number(*sides, "y", 0), number(*sides, "width", 0),
        number(*sides, "height", 0)};
}

PropertyDictionary rectValue(const Rect& rect)
{
    return {{"x", rect.x}, {"y", rect.y}, {"width", rect.width}, {"height", rect.height}};
}

} // namespace

KeyboardNotice KeyboardNotice::fromUserInfo(const PropertyDictionary& userInfo)
{
    KeyboardNotice notice;
    const Rect heightAlone{0, 0, 0, number(userInfo, "height", 0)};
    notice.beginFrame = rect(userInfo, "beginFrame", heightAlone);
    notice.endFrame = rect(userInfo, "endFrame", heightAlone);
    notice.animationDuration = number(userInfo, "animationDuration", notice.animationDuration);
    notice.animationCurve = static_cast<int>(number(userInfo, "animationCurve", notice.animationCurve));
    return notice;
}

PropertyDictionary KeyboardNotice::toUserInfo() const
{
    return {{"height", endFrame.height}, {"beginFrame", rectValue(beginFrame)},
        {"endFrame", rectValue(endFrame)}, {"animationDuration", animationDuration},
        {"animationCurve", animationCurve}};
}

} // namespace kit
