// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Color.h"

#include <optional>
#include <string_view>

namespace tarrow {

/// The names of the compositing filters, which say how a colour that is laid over another one changes it.
namespace compositingFilter {

inline constexpr std::string_view normal = "normal"; ///< the same as sourceOver
inline constexpr std::string_view sourceOver = "sourceOver"; ///< covers by its opacity
inline constexpr std::string_view multiply = "multiply";
inline constexpr std::string_view screen = "screen";
inline constexpr std::string_view overlay = "overlay";
inline constexpr std::string_view darken = "darken";
inline constexpr std::string_view lighten = "lighten";
inline constexpr std::string_view colorDodge = "colorDodge";
inline constexpr std::string_view colorBurn = "colorBurn";
inline constexpr std::string_view plusLighter = "plusLighter";
inline constexpr std::string_view plusDarker = "plusDarker";

} // namespace compositingFilter

/// These functions add to the platform's colours the colour that results where one lies over another. They
/// draw nothing. Any thread.
inline namespace TarrowDriveApp_FileTagColors {

/// Answers the base colour with the blend colour over it, under the named filter; without a filter the blend
/// colour covers the base by its opacity. Every filter but that one keeps the base colour's alpha. Answers
/// the base colour itself without a blend colour, for one that is fully transparent, and for a filter that
/// nobody knows. Components of the result may lie outside 0 to 1 for colorDodge and colorBurn.
platform::Color trw_colorBlendedWithColorCompositingFilter(const platform::Color& base,
    const std::optional<platform::Color>& blend, std::optional<std::string_view> filter);

/// Does the same with the filter sourceOver.
platform::Color trw_colorBlendedWithColor(
    const platform::Color& base, const std::optional<platform::Color>& blend);

} // namespace TarrowDriveApp_FileTagColors

} // namespace tarrow
