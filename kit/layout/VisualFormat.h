// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/layout/LayoutConstraint.h"

#include <cstddef>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace kit {

/// The names and the alignment with which a visual format is read.
struct VisualFormatInput {
    std::map<std::string, std::shared_ptr<LayoutItem>, std::less<>>
        views; ///< by the names in square brackets
    std::map<std::string, double, std::less<>> metrics; ///< by the names in place of numbers
    /// Aligns all views of the format on this attribute (CenterY, Top, Leading, ...); None: no alignment.
    LayoutAttribute alignment = LayoutAttribute::None;
};

struct VisualFormatError {
    std::size_t position = 0; ///< byte offset in the format
    std::string message; ///< English, for developers
};

struct VisualFormatResult {
    LayoutConstraints constraints; ///< in the order of the format, not active; empty after an error
    std::optional<VisualFormatError> error;
};

/// Turns a line such as "H:|-16-[a(>=50@750)]-[b(==a)]-|" into constraints:
///   orientation  "H:" (the default) or "V:"
///   edge         "|", the superview's edge; horizontally the leading and the trailing one
///   view         "[name]", "[name(predicates)]" with predicates ">=50", "==other", "width@priority"
///   connection   "" (touching), "-" (the standard distance: 8 between views, 20 to the superview),
///                "-12-", "-metric-", "-(>=8,<=20@700)-"
namespace VisualFormat {

VisualFormatResult parse(std::string_view format, const VisualFormatInput& input);

/// Answers the constraints of a format that is known to be right. A wrong format gives none and a line in the
/// log.
LayoutConstraints constraints(std::string_view format, const VisualFormatInput& input);

} // namespace VisualFormat

} // namespace kit
