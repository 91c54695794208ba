// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>

namespace host::gtk {

/// A screen that lies over the others. Main thread only.
class PresentedLayer {
public:
    using Done = std::function<void()>;

    virtual ~PresentedLayer() = default;
    /// `done` is called once, when the layer stands, or at once without movement.
    virtual void show(bool animated, Done done) = 0;
    /// `done` is called once, when the layer is gone.
    virtual void hide(bool animated, Done done) = 0;
    virtual void focus() = 0;
    /// While another layer lies above, this one takes no input.
    virtual void setCovered(bool covered) = 0;
};

} // namespace host::gtk
