// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Geometry.h"

#include <memory>

namespace platform::ui {

class LayoutConstraint;
class View;

/// Lays out one tree of views: brings the active constraints and the wanted sizes into a solver, reads the
/// frames out of it and calls `layoutSubviews` where it is due. The root view of the tree owns it.
class LayoutEngine {
public:
    explicit LayoutEngine(View& root);
    ~LayoutEngine();

    /// Which views, constraints or priorities there are has changed.
    void structureDidChange();
    void constantDidChange(const LayoutConstraint& constraint);
    void intrinsicSizeDidChange(const View& view);
    /// A view that is placed by its frame, or the root, got another one.
    void frameDidChange(const View& view);

    /// Lays out everything that is stale. Ends also when the views' answers do not settle. A call from within
    /// a layout does nothing.
    void layout();
    bool isRunning() const;
    /// The smallest size of the root; a positive target side is kept. For an engine that does nothing else.
    Size fittingSize(Size target);

private:
    struct Impl;
    std::unique_ptr<Impl> _impl;
};

} // namespace platform::ui
