// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/Geometry.h"

#include <cstdint>
#include <optional>

namespace kit {

class View;

/// Says which side of a view has changed.
enum class ViewChange : std::uint32_t {
    Frame = 1U << 0,
    Bounds = 1U << 1, ///< the origin of the bounds: the content was scrolled
    Subviews = 1U << 2, ///< which they are, or their order
    Visibility = 1U << 3, ///< hidden or alpha
    Style = 1U << 4, ///< background, border, corner radius, clipping
    Enabled = 1U << 5,
    Content = 1U << 6, ///< what the kind of view shows: text, image, font, colours, title, placeholder, ...
    Selection = 1U << 7, ///< the selected range of a text field
    Display = 1U << 8, ///< what `drawRect` draws
    Layout =
        1U << 9, ///< told on the root of a tree: `layoutIfNeeded` wants to be called, at best once a frame
    IntrinsicSize = 1U << 10,
    Accessibility = 1U << 11,
    Gestures = 1U << 12, ///< the recognisers, or whether the view takes input
};

/// A set of changes.
class ViewChanges {
public:
    constexpr ViewChanges() = default;
    constexpr ViewChanges(ViewChange change)
        : _bits(static_cast<std::uint32_t>(change))
    {
    }
    constexpr bool contains(ViewChange change) const
    {
        return (_bits & static_cast<std::uint32_t>(change)) != 0;
    }
    constexpr bool isEmpty() const { return _bits == 0; }
    constexpr ViewChanges& operator|=(ViewChanges other)
    {
        _bits |= other._bits;
        return *this;
    }
    friend constexpr ViewChanges operator|(ViewChanges a, ViewChanges b) { return a |= b; }

private:
    std::uint32_t _bits = 0;
};

constexpr ViewChanges operator|(ViewChange a, ViewChange b)
{
    return ViewChanges(a) | b;
}

/// Calls down that the kit makes to the peer of a view. They come on the main thread, at once at every
/// change, so a peer gathers the changes and mirrors them once a frame. The observer must not change the
/// model.
class ViewObserver {
public:
    virtual ~ViewObserver() = default;

    virtual void viewDidChange(View& view, ViewChanges changes) = 0;

    /// The view asks to get the keyboard focus or to lose it.
    virtual void viewWantsFocus(View& view, bool focus);

    /// Answers the size in points that the native widget needs for its content where it is at most `maxWidth`
    /// wide (0: any width). When it answers nothing, the kit measures by itself.
    virtual std::optional<Size> nativeSize(const View& view, double maxWidth);
};

} // namespace kit
