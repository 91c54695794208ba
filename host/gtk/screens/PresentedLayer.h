// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>

namespace host::gtk {

/// A layer that shows a screen over the others. Main thread only.
class PresentedLayer {
public:
    using Done = std::function<void()>;

    virtual ~PresentedLayer() = default;
    /// `done` is called once, at the end of the movement, or at once without a movement.
    virtual void show(bool animated, Done done) = 0;
    /// `done` is called once, when the layer is gone.
    virtual void hide(bool animated, Done done) = 0;
    virtual void focus() = 0;
    /// A covered layer takes no input, because another layer lies above it.
    virtual void setCovered(bool covered) = 0;
};

} // namespace host::gtk
