// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"
#include "platform/PropertyValue.h"

namespace kit {

/// The area that the on-screen keyboard covers, in the window's coordinates, and how the keyboard moves
/// there.
struct KeyboardNotice {
    Rect beginFrame;
    Rect endFrame;
    double animationDuration = 0.25; ///< seconds
    int animationCurve = 7; ///< 0 to 3 are the curves of AnimationCurve, above that the keyboard's own

    /// Convert from and to the user information of the notices KeyboardWillShow and KeyboardWillHide
    /// ("height", "beginFrame", "endFrame", "animationDuration", "animationCurve"). A missing key keeps its
    /// default; "height" alone gives both frames that height.
    static KeyboardNotice fromUserInfo(const PropertyDictionary& userInfo);
    PropertyDictionary toUserInfo() const;

    bool operator==(const KeyboardNotice&) const = default;
};

} // namespace kit
